// etiquon-cli mark-items and print-items as a script runs them: exit codes, messages and what
// they leave in the item database and the print folder.
#include <gtest/gtest.h>

#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QTemporaryDir>

#include "jet/database.h"
#include "jet/recordset.h"
#include "support/process_run.h"
#include "support/qt_print.h"

namespace etq::print::test {
namespace {

using etq::test::ProcessResult;
using etq::test::runProcess;

class CliPrintTest : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_EQ(cli({"init-db", "--db", db()}).exitCode, 0);
        jet::Database items = jet::Database::open(db() + "/etqnitm.kdb");
        items.execute(
            "INSERT INTO tItems (ItemKey, ItemName, BarCode, Coin, Price, Copies, PrintLabel) VALUES ('A1', 'סבון', '7290000000015', '¦', 1, 1, False), ('B2', 'מברשת', '7290000000022', '¦', 2, 1, False)");
        // Settings of this SettingID stay between tests run in one process: each starts from these.
        for (const char* kv : {"0LabelDef UseCell True", "0LabelDef FldID 1",
                               "GeneralParams OptOLE0 False", "GeneralParams OptOLE3 True"})
            ASSERT_EQ(
                cli(QStringList{"--setting-id", "5", "config", "set"} + QString(kv).split(' '))
                    .exitCode,
                0);
    }
    QString db() const { return dir.path() + "/db"; }
    static ProcessResult cli(const QStringList& args) { return runProcess(ETIQUON_CLI, args); }
    static ProcessResult cli5(const QStringList& args) {
        return cli(QStringList{"--setting-id", "5"} + args);
    }
    QStringList stored() {
        jet::Database items = jet::Database::open(db() + "/etqnitm.kdb");
        QStringList out;
        jet::Recordset rs =
            items.openRecordset("SELECT ItemKey, PrintLabel, Copies FROM tItems ORDER BY ItemKey");
        for (; !rs.eof(); rs.moveNext())
            out << rs.value(0).toString() + (rs.value(1).toBool() ? " yes " : " no ") +
                       rs.value(2).toString();
        return out;
    }
    QTemporaryDir dir;
};

TEST_F(CliPrintTest, MarkItemsTicksAndSetsCopies) {
    ProcessResult r = cli5({"mark-items", "--db", db(), "b", "--copies", "3"});
    EXPECT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(r.out.contains("marked B2 מברשת"));
    EXPECT_TRUE(r.out.endsWith("1 of 2 items marked for printing\n"));
    EXPECT_EQ(stored(), QStringList({"A1 no 1", "B2 yes 3"}));
    EXPECT_EQ(cli5({"mark-items", "--db", db(), "--all"}).exitCode, 0);
    EXPECT_EQ(stored(), QStringList({"A1 yes 1", "B2 yes 3"}));
    EXPECT_EQ(cli5({"mark-items", "--db", db(), "--none"}).exitCode, 0);
    EXPECT_EQ(stored(), QStringList({"A1 no 1", "B2 no 3"}));
}

TEST_F(CliPrintTest, MarkItemsRefusesWhatItCannotDo) {
    EXPECT_EQ(cli5({"mark-items", "--db", db()}).exitCode, 2);
    EXPECT_EQ(cli5({"mark-items", "--db", db(), "--all", "--none"}).exitCode, 2);
    EXPECT_EQ(cli5({"mark-items", "--db", db(), "--all", "--copies", "0"}).exitCode, 2);
    EXPECT_EQ(cli5({"mark-items", "--db", db(), "--all", "--copies", "256"}).exitCode, 2);
    const ProcessResult missing = cli5({"mark-items", "--db", db(), "Z9"});
    EXPECT_EQ(missing.exitCode, 1);
    EXPECT_TRUE(missing.err.contains("Z9"));
    EXPECT_EQ(cli5({"mark-items", "--db", dir.path() + "/none", "--all"}).exitCode, 1);
    EXPECT_EQ(stored(), QStringList({"A1 no 1", "B2 no 1"}));
}

TEST_F(CliPrintTest, PrintItemsEndsWithThePagePath) {
    ASSERT_EQ(cli5({"mark-items", "--db", db(), "A1", "--copies", "2"}).exitCode, 0);
    const ProcessResult r = cli5({"print-items", "--db", db()});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    const QString page = r.out.trimmed().split('\n').last();
    EXPECT_TRUE(page.endsWith("/etiqon/etiqon1.htm")) << page.toStdString();
    QFile file(page);
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(file.readAll().count("<td class='L0'>"), 2);
}

TEST_F(CliPrintTest, PrintItemsWithLabelSoftwareChosenFails) {
    ASSERT_EQ(cli5({"config", "set", "GeneralParams", "OptOLE3", "False"}).exitCode, 0);
    ASSERT_EQ(cli5({"config", "set", "GeneralParams", "OptOLE0", "True"}).exitCode, 0);
    const ProcessResult r = cli5({"print-items", "--db", db()});
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains("\"Direct\"")) << r.err.toStdString();
    EXPECT_EQ(cli5({"print-items"}).exitCode, 2);
}

}  // namespace
}  // namespace etq::print::test
