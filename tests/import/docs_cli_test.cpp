// etiquon-cli's document road on the demo company as a script runs it: reading the documents,
// the scan ranges, the types to scan, choosing documents, lines and copies, and the exit codes
// and messages of what cannot be done.
#include <QFileInfo>

#include "import_fixture.h"
#include "platform/captions.h"
#include "samples/demo_company.h"
#include "support/process_run.h"

namespace etq::test {
namespace {

class DocsCliTest : public ImportTest {
  protected:
    void SetUp() override {
        ImportTest::SetUp();
        demo::writeDemoCompany(company(), {.items = 300, .seed = 1});
        ASSERT_EQ(cli({"init-db", "--db", folder()}).exitCode, 0);
        ASSERT_EQ(cli({"import-items", "--company", company(), "--db", folder()}).exitCode, 0);
    }
    // Runs etiquon-cli with the settings of SettingID 12.
    static ProcessResult cli(const QStringList& args) {
        return runProcess(ETIQUON_CLI, QStringList{"--setting-id", "12"} + args);
    }
    ProcessResult importDocs(const QStringList& more = {}) {
        return cli(QStringList{"import-docs", "--company", company(), "--db", folder(),
                               "--from-date", "01/01/2025", "--to-date", "31/12/2030"} +
                   more);
    }
    QStringList work(const QString& sql) const { return rows(db::kWorkDatabaseFile, sql); }
};

TEST_F(DocsCliTest, ImportReadsTheTypesToScanIncrementally) {
    // The delivered types to scan are 1 and 2; of their seven documents each, a draft is left
    // out, and a deleted one (type 1), and one marked "I" (type 2, the draft).
    ProcessResult r = importDocs();
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(r.out,
              "document type 1: records 1 to 11: 5 documents, 62 lines\n"
              "document type 2: records 1 to 11: 6 documents, 69 lines\n" +
                  GetCaption(38, 0) + "\n");
    EXPECT_EQ(work("SELECT count(*), sum(Include) FROM tTempDocHeaders"), QStringList{"11|0"});
    EXPECT_EQ(cli({"scan-ranges", "--db", folder()}).out.split('\n').mid(0, 3),
              (QStringList{"11\t12\tתעודת משלוח", "11\t12\tחשבונית מס", "0\t0\tתעודת החזרה"}));

    // Nothing new since: nothing read. The types and their drafts follow tDocTypes.
    EXPECT_EQ(
        cli({"doc-types", "--db", folder(), "--no-scan", "2", "--drafts", "1"})
            .out.split('\n')
            .mid(0, 2),
        (QStringList{"1\tscan yes\tdrafts yes\tתעודת משלוח", "2\tscan no\tdrafts no\tחשבונית מס"}));
    r = importDocs({"--fast"});
    EXPECT_EQ(r.out.split('\n').first(), "document type 1: no records after record 11");
    EXPECT_TRUE(work("SELECT * FROM tTempDocHeaders").isEmpty());

    // Reset: everything again, the draft too, included at once the fast way; a to number keeps
    // the scan position.
    r = cli({"scan-ranges", "--db", folder(), "--reset"});
    EXPECT_TRUE(r.out.startsWith("11\t0\t")) << r.out.toStdString();
    r = importDocs({"--fast", "--from-num", "10502", "--to-num", "10504"});
    EXPECT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(work("SELECT [Number], Include, IsDraft FROM tTempDocHeaders ORDER BY [Number]"),
              (QStringList{"102|True|False", "103|True|False", "104|True|True"}));
    EXPECT_TRUE(cli({"scan-ranges", "--db", folder()}).out.startsWith("11\t0\t"));

    // What a script gets wrong: a usage line, or one line saying why, and no success.
    for (const auto& [args, code, message] : {
             std::tuple{QStringList{"import-docs", "--db", folder()}, 2, "usage: "},
             {QStringList{"import-docs", "--company", company(), "--db", folder(), "--from-num",
                          "x1"},
              2, "--from-num"},
             {QStringList{"import-docs", "--company", company(), "--db", folder(), "--to-date",
                          "31.12.2030"},
              1, "31.12.2030"},
             {QStringList{"doc-types", "--db", folder(), "--scan", "1,x"}, 1, "1,x"},
             {QStringList{"include-docs", "--db", folder(), "7/7"}, 1, "7/7"},
             {QStringList{"set-copies", "--db", folder(), "1/102", "1"}, 2, "usage: "},
         }) {
        r = cli(args);
        EXPECT_EQ(r.exitCode, code) << args.join(' ').toStdString();
        EXPECT_TRUE(r.err.contains(message)) << r.err.toStdString();
        EXPECT_EQ(r.err.count('\n'), 1) << r.err.toStdString();
    }
}

TEST_F(DocsCliTest, DocumentsLinesAndCopiesAreChosenForPrinting) {
    for (const char* kv : {"0LabelDef UseCell True", "0LabelDef FldID 1"})
        ASSERT_EQ(cli(QStringList{"config", "set"} + QString(kv).split(' ')).exitCode, 0);
    ASSERT_EQ(importDocs().exitCode, 0);
    ASSERT_EQ(cli({"include-docs", "--db", folder(), "1/101", "1/102"}).exitCode, 0);
    ASSERT_EQ(cli({"exclude-lines", "--db", folder(), "1/102", "--all"}).exitCode, 0);
    ASSERT_EQ(cli({"include-lines", "--db", folder(), "1/102", "1", "4"}).exitCode, 0);
    ASSERT_EQ(cli({"set-copies", "--db", folder(), "1/102", "4", "2"}).exitCode, 0);
    ASSERT_EQ(cli({"exclude-lines", "--db", folder(), "1/101", "2"}).exitCode, 0);
    EXPECT_EQ(work("SELECT WizFileID, [Number] FROM tTempDocHeaders WHERE Include"),
              (QStringList{"1|101", "1|102"}));
    EXPECT_EQ(work("SELECT HeadNumber, LineNum, Copies FROM tTempDocLines WHERE Include AND "
                   "WizFileID = 1 AND HeadNumber IN (101, 102) AND ItemKey IN (SELECT ItemKey "
                   "FROM tItems) ORDER BY 1, 2"),
              (QStringList{"101|1|15", "101|3|5", "102|1|19", "102|4|2"}));

    const ProcessResult listed = cli({"list-docs", "--db", folder(), "--lines", "1/102"});
    ASSERT_EQ(listed.exitCode, 0);
    const QStringList lines = listed.out.split('\n', Qt::SkipEmptyParts);
    EXPECT_EQ(lines[0], "1/102\tתעודת משלוח\t10502\t01/05/25\t20016\tyes\tסיטונאות הגליל בעמ");
    EXPECT_EQ(lines[4], "  4\t10269\tופלים במילוי מבצע\t11\t3\t2\tyes");
    EXPECT_EQ(lines.size(), 10);  // line 9 names an item the item file no longer holds

    const ProcessResult printed = cli({"print-docs", "--db", folder()});
    EXPECT_EQ(printed.exitCode, 0) << printed.err.toStdString();
    EXPECT_TRUE(QFileInfo(printed.out.trimmed().split('\n').last()).isFile());

    // The fast way, as saved in the settings: the documents are read again first, all included.
    for (const QStringList& kv : {QStringList{"LabelByDocs", "OnlyLine0", "1"},
                                  {"LabelByDocs", "UseFastWay", "1"},
                                  {"LabelByDocs", "ToDate", "31/12/2030"},
                                  {"Params", "ConnServer", dir.path()},
                                  {"Params", "ConnDataBase", "company"},
                                  {"GeneralParams", "DBPath", "/nowhere"}})
        ASSERT_EQ(cli(QStringList{"config", "set"} + kv).exitCode, 0);
    ASSERT_EQ(cli({"scan-ranges", "--db", folder(), "--reset"}).exitCode, 0);
    const ProcessResult fast = cli({"print-docs", "--db", folder()});
    EXPECT_EQ(fast.exitCode, 0) << fast.err.toStdString();
    EXPECT_EQ(work("SELECT count(*) FROM tTempDocHeaders WHERE Include"), QStringList{"11"});
}

}  // namespace
}  // namespace etq::test
