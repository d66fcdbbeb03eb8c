// The command line and the window, given the same stored settings, do the same work: the same
// rows from an item import, the same label page from a print.
#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>

#include "card/card_controller.h"
#include "card/component.h"
#include "db/file_names.h"
#include "jet/database.h"
#include "platform/browser.h"
#include "platform/context.h"
#include "platform/settings_store.h"
#include "samples/demo_company.h"
#include "support/jet_rows.h"
#include "support/process_run.h"
#include "support/recording_messages.h"
#include "support/test_env.h"
#include "surface/memory_surface.h"

namespace etq::test {
namespace {

class KeptPage : public PageViewer {
  public:
    void showPage(const QString& path) override {
        QFile page(path);
        if (page.open(QIODevice::ReadOnly)) bytes = page.readAll();
    }
    QByteArray bytes;
};

class CliWindowTest : public ::testing::Test {
  protected:
    void SetUp() override {
        resetSettings();
        demo::writeDemoCompany(dir.filePath("host/company"), {.items = 80, .seed = 9});
        SettingsStore store("Etiquon4");
        const QStringList settings = {"Params/ConnServer=" + dir.filePath("host"),
                                      "Params/ConnDataBase=company",
                                      "ImportItems/PriceField=1",
                                      "ImportItems/Copies=3",
                                      "ImportItems/ReadPriceList=1",
                                      "ImportItems/ImportAlterPrices=1",
                                      "ImportItems/FromItemKey=10010",
                                      "ImportItems/ToItemKey=10060",
                                      "ImportItems/UseItmBelong=1",
                                      "ImportItems/ItmBelong=0",
                                      "LabelVars/FldSend03=1",
                                      "LabelVars/PriceFormat=0.0",
                                      "GeneralParams/OptPrinter1=True",
                                      "0LabelDef/UseCell=-1",
                                      "0LabelDef/FldID=1",
                                      "1LabelDef/UseCell=-1",
                                      "1LabelDef/FldID=6",
                                      "DirectLabel/PageRows=3",
                                      "DirectLabel/PageCols=2"};
        for (const QString& setting : settings) {
            const QString key = setting.section(u'=', 0, 0);
            store.write(key.section(u'/', 0, 0), key.section(u'/', 1), setting.section(u'=', 1));
        }
        store.sync();
        for (const char* folder : {"cli", "window"})
            ASSERT_EQ(cli({"init-db", "--db", dir.filePath(folder)}).exitCode, 0);
    }

    static ProcessResult cli(const QStringList& args) {
        return runProcess(ETIQUON_CLI, QStringList{"--setting-id", "4"} + args);
    }

    // The window on the headless surface, started with the same SettingID.
    struct Window {
        explicit Window(const QString& folder) {
            context.setMessages(&messages);
            context.setPages(&page);
            connectParts(controller, surface);
            controller.hooks().installedPrinters = [] { return QStringList(); };
            controller.InitProperties("4");
            surface.control("txtDBPath").setText(folder);
        }
        MemorySurface surface;
        RecordingMessages messages;
        KeptPage page;
        Context context;
        CardController controller{surface, context};
    };

    QStringList table(const char* folder, const QString& file, const QString& sql) {
        jet::Database db = jet::Database::open(dir.filePath(folder) + "/" + file);
        return jetRows(db, sql);
    }

    QTemporaryDir dir;
};

TEST_F(CliWindowTest, ImportAndPrintGiveTheSameRowsAndTheSamePage) {
    const ProcessResult imported = cli(
        {"import-items", "--company", dir.filePath("host/company"), "--db", dir.filePath("cli")});
    ASSERT_EQ(imported.exitCode, 0) << imported.err.toStdString();
    Window window(dir.filePath("window"));
    window.controller.click("CmdImportItems");
    ASSERT_TRUE(window.messages.shown.isEmpty()) << window.messages.shown[0].text.toStdString();

    const QStringList itemTables = {"SELECT * FROM tItems ORDER BY ItemKey",
                                    "SELECT * FROM tPriceList ORDER BY ItemKey, PriceList",
                                    "SELECT * FROM tAlterPrices ORDER BY AccountKey, ItemKey"};
    for (const QString& sql : itemTables) {
        const QStringList rows = table("cli", db::kItemDatabaseFile, sql);
        EXPECT_FALSE(rows.isEmpty()) << sql.toStdString();
        EXPECT_EQ(rows, table("window", db::kItemDatabaseFile, sql)) << sql.toStdString();
    }
    EXPECT_EQ(table("cli", db::kDocDatabaseFile, "SELECT * FROM tCurrencies ORDER BY Currency"),
              table("window", db::kDocDatabaseFile, "SELECT * FROM tCurrencies ORDER BY Currency"));

    for (const char* folder : {"cli", "window"}) {
        jet::Database items = jet::Database::open(dir.filePath(folder) + "/etqnitm.kdb");
        items.execute("UPDATE tItems SET PrintLabel = True WHERE ItemKey < '10050'");
    }
    const ProcessResult printed = cli({"print-items", "--db", dir.filePath("cli")});
    ASSERT_EQ(printed.exitCode, 0) << printed.err.toStdString();
    QFile cliPage(printed.out.trimmed().section(u'\n', -1));
    ASSERT_TRUE(cliPage.open(QIODevice::ReadOnly));
    const QByteArray cliBytes = cliPage.readAll();
    window.controller.click("cmdPrintItmes");
    ASSERT_TRUE(window.messages.shown.isEmpty()) << window.messages.shown[0].text.toStdString();
    EXPECT_GT(cliBytes.count("<td class='L0'>"), 5);  // three copies of each marked item
    EXPECT_EQ(cliBytes, window.page.bytes);
}

}  // namespace
}  // namespace etq::test
