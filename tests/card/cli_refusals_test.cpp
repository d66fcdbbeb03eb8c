// What etiquon-cli refuses and why it says it stopped: a folder another run holds, a grid no
// sheet can hold, failures the window keeps to itself, and options that make no sense.
#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>

#include "jet/database.h"
#include "platform/folder_lock.h"
#include "platform/settings_store.h"
#include "samples/demo_company.h"
#include "support/process_run.h"
#include "support/test_env.h"

namespace etq::test {
namespace {

class CliRefusalsTest : public ::testing::Test {
  protected:
    void SetUp() override {
        resetSettings();
        demo::writeDemoCompany(company(), {.items = 20, .seed = 3});
        ASSERT_EQ(cli({"init-db", "--db", db()}).exitCode, 0);
    }
    QString company() const { return dir.filePath("company"); }
    QString db() const { return dir.filePath("db"); }
    static ProcessResult cli(const QStringList& args) { return runProcess(ETIQUON_CLI, args); }
    ProcessResult importItems() {
        return cli({"import-items", "--company", company(), "--db", db()});
    }
    QTemporaryDir dir;
};

TEST_F(CliRefusalsTest, ABusyFolderIsRefusedByEveryRunThatRebuildsItsFiles) {
    const FolderLock held(db());
    for (const QStringList& args :
         {QStringList{"import-items", "--company", company(), "--db", db()},
          QStringList{"init-db", "--db", db()}, QStringList{"upgrade", "--db", db()}}) {
        const ProcessResult r = cli(args);
        EXPECT_NE(r.exitCode, 0) << args.join(' ').toStdString();
        EXPECT_TRUE(r.err.contains("busy")) << r.err.toStdString();
    }
}

TEST_F(CliRefusalsTest, FailuresTheWindowKeepsToItselfAreToldOnTheCommandLine) {
    // The company without its item file: the window says nothing, the command line names it.
    QFile::remove(company() + "/oitm.dbf");
    ProcessResult r = importItems();
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains(company() + "/oitm.dbf")) << r.err.toStdString();

    // A currency table the engine cannot write: the window passes over it.
    demo::writeDemoCompany(company(), {.items = 20, .seed = 3});
    jet::Database::open(db() + "/etiquon.kdb").execute("DROP TABLE tCurrencies");
    r = importItems();
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains("tCurrencies")) << r.err.toStdString();
}

TEST_F(CliRefusalsTest, OptionsThatMakeNoSenseAreRefused) {
    struct Case {
        QStringList args;
        int exitCode;
        const char* said;
    };
    const Case cases[] = {
        {{"--setting-id", "abc", "config", "list"}, 2, "--setting-id"},
        {{"config", "set", "GeneralParams", "", "x"}, 2, "not empty"},
        {{"upgrade", "--db", dir.filePath("none")}, 1, "There is no database folder"},
    };
    for (const Case& c : cases) {
        const ProcessResult r = cli(c.args);
        EXPECT_EQ(r.exitCode, c.exitCode) << c.args.join(' ').toStdString();
        EXPECT_TRUE(r.err.contains(c.said)) << r.err.toStdString();
    }
}

TEST_F(CliRefusalsTest, AGridNoSheetCanHoldIsRefusedBeforeAnythingIsWritten) {
    ASSERT_EQ(importItems().exitCode, 0);
    ASSERT_EQ(cli({"mark-items", "--db", db(), "--all"}).exitCode, 0);
    SettingsStore store("Etiquon");
    store.write("0LabelDef", "UseCell", "-1");
    store.write("0LabelDef", "FldID", "1");
    store.write("DirectLabel", "PageRows", "3000");
    store.write("DirectLabel", "PageCols", "3000");
    store.sync();
    const ProcessResult r = cli({"print-items", "--db", db()});
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains("3000 rows and 3000 columns")) << r.err.toStdString();
    EXPECT_TRUE(r.out.isEmpty()) << r.out.toStdString();
}

}  // namespace
}  // namespace etq::test
