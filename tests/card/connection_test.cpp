// The connection parameters, their texts and the connection dialog.
#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTemporaryDir>

#include "card_test_support.h"
#include "dialogs/logon_dialog.h"
#include "import/connection.h"
#include "platform/context.h"
#include "platform/settings_store.h"
#include "support/log_capture.h"
#include "support/sql_source_file.h"

namespace etq {
namespace {

class ConnectionTest : public ::testing::Test {
  protected:
    void SetUp() override { test::resetSettings(); }
    Context context;
};

TEST_F(ConnectionTest, ConnectionTextsByForm) {
    EXPECT_EQ(BuildConnString("srv", "sa", "pw", "corvan02", 1),
              "Driver={FreeTDS};Server={srv,1433};UID=sa;Database=corvan02;PWD=pw");
    EXPECT_EQ(BuildConnString("srv", "sa", "pw", "corvan02", 2),
              "Provider=sqloledb;Data Source=srv;User Id=sa;Password=pw;Initial Catalog=corvan02");
    EXPECT_EQ(BuildConnString("srv", "sa", QString(), "db", 2),
              "Provider=sqloledb;Data Source=srv;User Id=sa;Password=;Initial Catalog=db");
    EXPECT_EQ(BuildConnString("srv", "sa", "%1", "db", 1),
              "Driver={FreeTDS};Server={srv,1433};UID=sa;Database=db;PWD=%1");
    EXPECT_EQ(BuildConnString("srv", "sa", "pw", "db", 0), "");
    EXPECT_EQ(BuildConnString("srv", "sa", "pw", "db", 4), "");
}

TEST_F(ConnectionTest, TheCompanyFolderHasOneSeparator) {
    for (const char* server : {"/srv/menahel", "/srv/menahel/", "/srv/menahel\\"})
        EXPECT_EQ(BuildConnString(server, "sa", "", "corvan02", 3), "/srv/menahel/corvan02")
            << server;
}

TEST_F(ConnectionTest, ParametersComeFromTheStoreOrTheirDefaults) {
    GetConnParams(context);
    EXPECT_EQ(context.connection.server, "server");
    EXPECT_EQ(context.connection.user, "sa");
    EXPECT_EQ(context.connection.password, "");
    EXPECT_EQ(context.connection.database, "corvan02");

    context.applicationName = "Etiquon3";
    SettingsStore store("Etiquon3");
    store.write("Params", "ConnServer", "/srv/host");
    store.write("Params", "ConnUID", "reader");
    store.write("Params", "ConnPWD", "סוד");
    store.sync();
    GetConnParams(context);
    EXPECT_EQ(context.connection.server, "/srv/host");
    EXPECT_EQ(context.connection.user, "reader");
    EXPECT_EQ(context.connection.password, "סוד");
    EXPECT_EQ(context.connection.database, "corvan02");
    EXPECT_EQ(companyFolder(context.connection), "/srv/host/corvan02");
}

TEST_F(ConnectionTest, TheDialogChecksForTheAccountsFileAndSavesOnAccept) {
    QTemporaryDir host;
    QDir(host.path()).mkpath("demo");
    test::writeEmptyDbf(host.filePath("demo/oitm.dbf"), "ITEMCODE", 13);
    context.connection.server = host.path();
    context.connection.database = "demo";

    LogonDialog dialog(context);
    auto* server = dialog.findChild<QLineEdit*>("txtConnServer");
    auto* database = dialog.findChild<QLineEdit*>("txtConnDatabase");
    auto* message = dialog.findChild<QLabel*>("LblMsg");
    auto* check = dialog.findChild<QPushButton*>("CmdCheck");
    ASSERT_TRUE(server && database && message && check);
    EXPECT_EQ(server->text(), host.path());
    EXPECT_EQ(database->text(), "demo");

    check->click();  // the items file alone is not enough
    EXPECT_EQ(message->text(), "הבדיקה לא הסתיימה בהצלחה");
    test::writeEmptyDbf(host.filePath("demo/ocrd.dbf"), "CARDCODE", 15);
    server->setText(host.path() + "/");
    check->click();
    EXPECT_EQ(message->text(), "הבדיקה הסתיימה בהצלחה");

    dialog.findChild<QPushButton*>("cmdCancel")->click();
    EXPECT_FALSE(SettingsStore("Etiquon").contains("Params", "ConnServer"));
    EXPECT_EQ(context.connection.server, host.path());

    dialog.findChild<QPushButton*>("cmdOK")->click();
    EXPECT_EQ(dialog.result(), QDialog::Accepted);
    EXPECT_EQ(context.connection.server, host.path() + "/");
    EXPECT_EQ(readSetting("Etiquon", "Params", "ConnServer", ""), host.path() + "/");
    EXPECT_EQ(readSetting("Etiquon", "Params", "ConnDataBase", ""), "demo");
    EXPECT_FALSE(SettingsStore("Etiquon").contains("Params", "ConnUID"));
}

TEST_F(ConnectionTest, TheDialogTestsTheSqlServerSourceWithTheTypedTexts) {
    QTemporaryDir dir;
    test::writeSqlSourceFile(dir.filePath("host.db"));
    context.connection = test::sqlSourceParams(dir.filePath("elsewhere.db"));
    context.connection.database = "not used";
    LogonDialog dialog(context);
    auto* database = dialog.findChild<QLineEdit*>("txtConnDatabase");
    auto* message = dialog.findChild<QLabel*>("LblMsg");
    auto* check = dialog.findChild<QPushButton*>("CmdCheckSql");
    ASSERT_TRUE(database && message && check);
    database->setText(dir.filePath("host.db"));
    check->click();
    EXPECT_EQ(message->text(), "הבדיקה הסתיימה בהצלחה");

    context.connection.driver = "No Such Driver";
    test::LogCapture log;
    check->click();
    EXPECT_TRUE(message->text().startsWith("הבדיקה לא הסתיימה בהצלחה\n"));
    EXPECT_TRUE(message->text().contains("No Such Driver"));
    EXPECT_TRUE(log.contains("etiquon.import: SQL Server source test:"));
    EXPECT_FALSE(SettingsStore("Etiquon").contains("Params", "ConnDataBase"));
}

}  // namespace
}  // namespace etq
