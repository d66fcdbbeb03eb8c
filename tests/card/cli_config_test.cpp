// etiquon-cli config, run as a program on the settings folder of this test run.
#include <gtest/gtest.h>

#include <QFile>
#include <QProcess>

#include "card_test_support.h"
#include "platform/settings_store.h"
#include "platform/user_paths.h"
#include "surface/memory_surface.h"
#include "surface/settings_groups.h"

namespace etq {
namespace {

struct CliRun {
    int exitCode;
    QString out;
    QString err;
};

CliRun cli(const QStringList& args) {
    QProcess process;
    process.start(ETIQUON_CLI, QStringList{"config"} + args);
    EXPECT_TRUE(process.waitForFinished(30000));
    return {process.exitCode(), QString::fromUtf8(process.readAllStandardOutput()),
            QString::fromUtf8(process.readAllStandardError())};
}

class CliConfigTest : public ::testing::Test {
  protected:
    void SetUp() override { test::resetSettings(); }
};

TEST_F(CliConfigTest, GetGivesTheStoredTextOrTheTablesDefault) {
    EXPECT_EQ(cli({"get", "GeneralParams", "OptOLE3"}).out, "True\n");
    EXPECT_EQ(cli({"get", "GeneralParams", "OptOLE0"}).out, "False\n");
    EXPECT_EQ(cli({"get", "LabelVars", "FldSend40"}).out, "0\n");
    EXPECT_EQ(cli({"get", "LabelByDocs", "ToDate"}).out, "01/01/2025\n");
    EXPECT_EQ(cli({"get", "GeneralParams", "DBPath"}).out, userDataFolder() + "\n");
    EXPECT_EQ(cli({"get", "Params", "ConnDataBase"}).out, "corvan02\n");

    const CliRun unknown = cli({"get", "LabelVars", "FldSend41"});
    EXPECT_EQ(unknown.exitCode, 1);
    EXPECT_TRUE(unknown.err.contains("LabelVars/FldSend41")) << unknown.err.toStdString();
    EXPECT_EQ(cli({"get", "LabelVars"}).exitCode, 2);
}

TEST_F(CliConfigTest, SetThenGetRoundTripsAndTheControlLoadsIt) {
    ASSERT_EQ(cli({"set", "GeneralParams", "CompanyName", "חנות הדוגמה"}).exitCode, 0);
    ASSERT_EQ(cli({"set", "LabelVars", "FldSend05", "1"}).exitCode, 0);
    ASSERT_EQ(cli({"set", "0LabelDef", "UseCell", "-1"}).exitCode, 0);
    EXPECT_EQ(cli({"get", "GeneralParams", "CompanyName"}).out, "חנות הדוגמה\n");
    EXPECT_EQ(cli({"get", "0LabelDef", "UseCell"}).out, "-1\n");

    MemorySurface surface;
    GetSetParams(surface, "Etiquon", 1, LoadSettings);
    GetSetParams(surface, "Etiquon", 3, LoadSettings);
    EXPECT_EQ(surface.control("txtCompanyName").text(), "חנות הדוגמה");
    EXPECT_EQ(surface.control("ChkFldSend", 5).value().toInt(), 1);

    const QString list = "\n" + cli({"list"}).out;
    EXPECT_TRUE(list.contains("\nGeneralParams/CompanyName=חנות הדוגמה\n"));
    EXPECT_TRUE(list.contains("\n# GeneralParams/OptOLE3=True\n"));
    EXPECT_TRUE(list.contains("\nLabelVars/FldSend05=1\n"));
    EXPECT_TRUE(list.contains("\n# LabelVars/FldSend40=0\n"));
    EXPECT_TRUE(list.contains("\n0LabelDef/UseCell=-1\n"));
}

TEST_F(CliConfigTest, ASettingIdWritesItsOwnStore) {
    ASSERT_EQ(cli({"set", "LabelByDocs", "FromDate", "01/06/2024", "--setting-id", "3"}).exitCode,
              0);
    EXPECT_TRUE(QFile::exists(test::settingsFile("Etiquon3")));
    EXPECT_FALSE(QFile::exists(test::settingsFile("Etiquon")));
    EXPECT_EQ(cli({"--setting-id=3", "get", "LabelByDocs", "FromDate"}).out, "01/06/2024\n");
    EXPECT_EQ(cli({"get", "LabelByDocs", "FromDate"}).out, "01/01/1980\n");
    EXPECT_EQ(readSetting("Etiquon3", "LabelByDocs", "FromDate", ""), "01/06/2024");
}

}  // namespace
}  // namespace etq
