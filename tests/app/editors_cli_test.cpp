// etiquon-cli items, alt-keys, accounts, price-lists and carriers, run as the program on a
// database folder that init-db prepared.
#include <gtest/gtest.h>

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTemporaryDir>

#include "platform/user_paths.h"
#include "support/process_run.h"
#include "support/qt_print.h"
#include "support/sql_source_file.h"
#include "support/test_env.h"

namespace etq {
namespace {

class EditorsCliTest : public ::testing::Test {
  protected:
    void SetUp() override {
        test::resetSettings();
        ASSERT_EQ(cli({"init-db", "--db", db()}).exitCode, 0);
    }
    QString db() const { return dir.filePath("db"); }
    static test::ProcessResult cli(const QStringList& args) {
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert("ETIQUON_DATA_DIR", ETIQUON_BUILD_DIR "/src/app");
        return test::runProcess(ETIQUON_CLI, args, env);
    }
    // The lines a command printed; a failed command fails the test.
    QStringList lines(const QStringList& args) {
        const test::ProcessResult run = cli(args);
        EXPECT_EQ(run.exitCode, 0) << args.join(' ').toStdString() << ": " << run.err.toStdString();
        return run.out.split('\n', Qt::SkipEmptyParts);
    }
    void run(const QStringList& args) { lines(args); }
    QTemporaryDir dir;
};

TEST_F(EditorsCliTest, ItemsAreListedFilteredSortedAndChanged) {
    run({"items", "add", "--db", db(), "300", "--name", "ספוג 12", "--barcode", "7290300",
         "--price", "3"});
    run({"items", "add", "--db", db(), "100", "--name", "A*B", "--unit", "יח", "--price", "5"});
    run({"items", "add", "--db", db(), "200", "--name", "O'Neil", "--barcode", "7290200"});
    struct Case {
        QStringList flags;
        QStringList lines;
    };
    const Case cases[] = {
        {{}, {"100\tA*B\tיח\t\t5", "200\tO'Neil\t\t7290200\t", "300\tספוג 12\t\t7290300\t3"}},
        {{"--search-by", "name", "--search", "12"}, {"300\tספוג 12\t\t7290300\t3"}},
        {{"--search-by", "name", "--search", "*"}, {"100\tA*B\tיח\t\t5"}},
        {{"--search-by", "name", "--search", "'"}, {"200\tO'Neil\t\t7290200\t"}},
        {{"--search-by", "barcode", "--search", "02"}, {"200\tO'Neil\t\t7290200\t"}},
        {{"--search", "2"}, {"200\tO'Neil\t\t7290200\t"}},  // the key, as the window starts
    };
    for (const Case& c : cases)
        EXPECT_EQ(lines(QStringList{"items", "--db", db()} + c.flags), c.lines)
            << c.flags.join(' ').toStdString();
    QStringList keys;
    for (const QString& line : lines({"items", "--db", db(), "--sort-by", "name", "--desc"}))
        keys << line.section('\t', 0, 0);
    EXPECT_EQ(keys, QStringList({"300", "200", "100"}));

    run({"items", "set", "--db", db(), "200", "--price", "12.5", "--barcode", ""});
    const QJsonArray json =
        QJsonDocument::fromJson(
            cli({"items", "--db", db(), "--search", "200", "--format", "json"}).out.toUtf8())
            .array();
    ASSERT_EQ(json.size(), 1);
    EXPECT_EQ(json[0].toObject()["Price"].toDouble(), 12.5);
    EXPECT_TRUE(json[0].toObject()["BarCode"].isNull());
    const QStringList table = lines({"items", "--db", db(), "--format", "table"});
    EXPECT_TRUE(table.value(0).startsWith("ItemKey  ItemName"));

    run({"items", "remove", "--db", db(), "100", "300"});
    EXPECT_EQ(lines({"items", "--db", db()}).size(), 1);

    const struct {
        QStringList args;
        int exitCode;
        const char* said;
    } failures[] = {
        {{"items", "add", "--db", db(), "200"}, 1, "duplicate"},
        {{"items", "set", "--db", db(), "999", "--name", "x"}, 1, "no item 999"},
        {{"items", "remove", "--db", db(), "999"}, 1, "no item 999"},
        {{"items", "set", "--db", db(), "200", "--price", "cheap"}, 2, "--price takes a number"},
        {{"items", "--db", db(), "--sort-by", "price"}, 2, "--sort-by takes key|name|barcode"},
        {{"items", "--db", db(), "--format", "xml"}, 2, "--format takes"},
        {{"items", "set", "--db", db(), "200"}, 2, "usage: etiquon-cli items add|set"},
    };
    for (const auto& f : failures) {
        const test::ProcessResult r = cli(f.args);
        EXPECT_EQ(r.exitCode, f.exitCode) << f.args.join(' ').toStdString();
        EXPECT_TRUE(r.err.contains(f.said)) << r.err.toStdString();
    }
}

TEST_F(EditorsCliTest, AlternateKeysAndAccountsAreKeptByTheirKeys) {
    run({"alt-keys", "add", "--db", db(), "C1", "100", "--alt-num", "A-100"});
    run({"alt-keys", "add", "--db", db(), "C1", "200", "--alt-num", "A-200"});
    run({"alt-keys", "add", "--db", db(), "O'K", "100", "--alt-num", "B-100", "--alt-bar", "55"});
    run({"alt-keys", "set", "--db", db(), "C1", "200", "--alt-bar", "7299"});
    EXPECT_EQ(lines({"alt-keys", "--db", db(), "--account", "C1", "--item", "200"}),
              QStringList{"C1\t200\tA-200\t7299"});
    EXPECT_EQ(lines({"alt-keys", "--db", db(), "--account", "O'K"}),
              QStringList{"O'K\t100\tB-100\t55"});
    QStringList nums;
    for (const QString& line : lines({"alt-keys", "--db", db(), "--sort-by", "alt-num", "--desc"}))
        nums << line.section('\t', 2, 2);
    EXPECT_EQ(nums, QStringList({"B-100", "A-200", "A-100"}));
    run({"alt-keys", "remove", "--db", db(), "C1", "100"});
    EXPECT_EQ(lines({"alt-keys", "--db", db(), "--item", "100"}),
              QStringList{"O'K\t100\tB-100\t55"});

    run({"accounts", "add", "--db", db(), "00000000"});
    run({"accounts", "add", "--db", db(), "C1", "--price-list", "4", "--label", "/labels/c1.lbl"});
    run({"accounts", "set", "--db", db(), "00000000", "--price-list", "1"});
    EXPECT_EQ(lines({"accounts", "--db", db()}),
              QStringList({"00000000\t1\t" + defaultLabelFile(), "C1\t4\t/labels/c1.lbl"}));
    run({"accounts", "remove", "--db", db(), "00000000"});
    EXPECT_EQ(lines({"accounts", "--db", db()}).size(), 1);
}

TEST_F(EditorsCliTest, PriceListsAndCarriersComeFromTheSqlServerSource) {
    const QString source = dir.filePath("host.db");
    test::writeSqlSourceFile(source);
    const ConnParams params = test::sqlSourceParams(source);
    for (const auto& [key, value] : {std::pair{"ConnDriver", params.driver},
                                     {"ConnServer", params.server},
                                     {"ConnUID", params.user},
                                     {"ConnPWD", params.password},
                                     {"ConnDataBase", params.database}})
        run({"config", "set", "Params", key, value});
    EXPECT_EQ(lines({"price-lists"}), QStringList({"1\tמחירון בסיס", "4\tסיטונאי"}));
    EXPECT_EQ(lines({"carriers"}), QStringList({"3\tדואר ישראל", "7\tשליחויות צפון"}));

    run({"config", "set", "Params", "ConnDriver", "No Such Driver"});
    const test::ProcessResult failed = cli({"carriers"});
    EXPECT_EQ(failed.exitCode, 1);
    EXPECT_TRUE(failed.err.contains("No Such Driver")) << failed.err.toStdString();
}

}  // namespace
}  // namespace etq
