// etiquon-cli mark-items and print-items as a script runs them: exit codes, messages and what
// they leave in the item database and the print folder.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QProcess>
#include <QRegularExpression>
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
    EXPECT_TRUE(page.endsWith("/etiqon1.htm")) << page.toStdString();
    EXPECT_TRUE(QFileInfo(QFileInfo(page).path()).path().endsWith("/etiquon/etiqon"))
        << page.toStdString();
    QFile file(page);
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    EXPECT_EQ(file.readAll().count("<td class='L0'>"), 2);
}

TEST_F(CliPrintTest, PrintItemsWithWindowsLabelSoftwareChosenFails) {
    ASSERT_EQ(cli5({"config", "set", "GeneralParams", "OptOLE3", "False"}).exitCode, 0);
    ASSERT_EQ(cli5({"config", "set", "GeneralParams", "OptOLE0", "True"}).exitCode, 0);
    const ProcessResult r = cli5({"print-items", "--db", db()});
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains("NiceLabel is not available here")) << r.err.toStdString();
    EXPECT_TRUE(r.err.contains(" In Line 2, LabelID = 0")) << r.err.toStdString();
    EXPECT_EQ(cli5({"print-items"}).exitCode, 2);
}

// The same label settings for every run of these tests, under a SettingID of their own: the
// item's name as text and its barcode as an EAN-13 bitmap.
class CliPrintRunTest : public ::testing::Test {
  protected:
    void SetUp() override {
        env = QProcessEnvironment::systemEnvironment();
        env.insert("XDG_RUNTIME_DIR", runtime.path());
        for (const char* kv :
             {"0LabelDef UseCell True", "0LabelDef FldID 1", "1LabelDef UseCell True",
              "1LabelDef FldID 4", "1LabelDef ViewType 1", "LabelBar BarType 6",
              "GeneralParams OptOLE0 False", "GeneralParams OptOLE3 True"})
            ASSERT_EQ(cli(QStringList{"config", "set"} + QString(kv).split(' ')).exitCode, 0);
    }
    ProcessResult cli(const QStringList& args) const {
        return runProcess(ETIQUON_CLI, QStringList{"--setting-id", "6"} + args, env);
    }

    // A database folder whose items are named "<prefix> n" with EAN-13 barcodes of their own,
    // all marked for printing.
    QString folderWithItems(const QString& prefix, int firstBarcode, int count) {
        const QString folder = dir.path() + "/" + prefix;
        EXPECT_EQ(runProcess(ETIQUON_CLI, {"init-db", "--db", folder}).exitCode, 0);
        jet::Database items = jet::Database::open(folder + "/etqnitm.kdb");
        jet::Recordset rs = items.openRecordset("tItems");
        for (int i = 0; i < count; ++i) {
            rs.addNew();
            rs.setValue("ItemKey", QString("%1%2").arg(prefix).arg(i, 3, 10, QLatin1Char('0')));
            rs.setValue("ItemName", QString("%1 %2").arg(prefix).arg(i));
            rs.setValue("BarCode", ean13(firstBarcode + i));
            rs.setValue("Coin", QStringLiteral("¦"));
            rs.setValue("Price", 1);
            rs.setValue("Copies", 1);
            rs.setValue("PrintLabel", true);
            rs.update();
        }
        return folder;
    }

    // "729" and nine digits of n, with the check digit.
    static QString ean13(int n) {
        const QString digits = QString("729%1").arg(n, 9, 10, QLatin1Char('0'));
        int sum = 0;
        for (int i = 0; i < 12; ++i)
            sum += digits[i].digitValue() * (i % 2 ? 3 : 1);
        return digits + QString::number((10 - sum % 10) % 10);
    }

    QTemporaryDir dir;
    QTemporaryDir runtime;
    QProcessEnvironment env;
};

QStringList captures(const QString& text, const QString& pattern) {
    QStringList out;
    for (const QRegularExpressionMatch& m : QRegularExpression(pattern).globalMatch(text))
        out << m.captured(1);
    return out;
}

// Two print runs at once on two database folders: each page shows its own items, and the
// bitmaps beside it, decoded by zbarimg, are its own items' barcodes.
TEST_F(CliPrintRunTest, TwoRunsAtOnceEachShowOnlyTheirOwnLabels) {
    constexpr int kItems = 30;
    struct Run {
        QString prefix;
        int firstBarcode = 0;
        QString folder{};
        QProcess process{};
    };
    Run runs[2] = {{"Left", 1000}, {"Right", 5000}};
    for (Run& run : runs)
        run.folder = folderWithItems(run.prefix, run.firstBarcode, kItems);
    for (int round = 0; round < 2; ++round) {
        for (Run& run : runs) {
            run.process.setProcessEnvironment(env);
            run.process.start(ETIQUON_CLI,
                              {"--setting-id", "6", "print-items", "--db", run.folder});
        }
        QStringList pages;
        for (Run& run : runs) {
            SCOPED_TRACE(run.prefix.toStdString());
            ASSERT_TRUE(run.process.waitForFinished(180000));
            ASSERT_EQ(run.process.exitCode(), 0) << run.process.readAllStandardError().data();
            const QString page =
                QString::fromUtf8(run.process.readAllStandardOutput()).trimmed().split('\n').last();
            pages << page;
            QFile file(page);
            ASSERT_TRUE(file.open(QIODevice::ReadOnly)) << page.toStdString();
            const QString html = QString::fromLatin1(file.readAll());
            QStringList expectedNames, expectedBarcodes;
            for (int i = 0; i < kItems; ++i) {
                expectedNames << QString("%1 %2").arg(run.prefix).arg(i);
                expectedBarcodes << ean13(run.firstBarcode + i);
            }
            QStringList names = captures(html, "<td class='L0'>([^<]*)</td>");
            names.sort();
            expectedNames.sort();
            EXPECT_EQ(names, expectedNames);

            QStringList bitmaps;
            for (const QString& name : captures(html, "<img src='([^']*)'"))
                bitmaps << QFileInfo(page).path() + "/" + name;
            ASSERT_EQ(bitmaps.size(), kItems);
            const ProcessResult decoded =
                runProcess("zbarimg", QStringList{"-q", "--raw"} + bitmaps);
            QStringList barcodes = decoded.out.split('\n', Qt::SkipEmptyParts);
            barcodes.sort();
            EXPECT_EQ(barcodes, expectedBarcodes) << decoded.err.toStdString();
        }
        EXPECT_NE(pages[0], pages[1]);
    }
}

// A link planted where the print folder should be: the run is refused and the folder it points
// at keeps its files and its mode.
TEST_F(CliPrintRunTest, APlantedPrintFolderLinkIsRefused) {
    const QString folder = folderWithItems("Item", 1000, 2);
    const QString victim = dir.path() + "/victim";
    ASSERT_TRUE(QDir().mkpath(victim));
    ASSERT_TRUE(QFile::setPermissions(victim, QFile::ReadOwner | QFile::WriteOwner |
                                                  QFile::ExeOwner | QFile::ReadOther |
                                                  QFile::ExeOther));
    QFile precious(victim + "/precious.txt");
    ASSERT_TRUE(precious.open(QIODevice::WriteOnly));
    precious.write("keep me");
    precious.close();
    ASSERT_TRUE(QDir().mkpath(runtime.path() + "/etiquon"));
    ASSERT_TRUE(QFile::setPermissions(runtime.path() + "/etiquon",
                                      QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner));
    ASSERT_TRUE(QFile::link(victim, runtime.path() + "/etiquon/etiqon"));

    const ProcessResult r = cli({"print-items", "--db", folder});
    EXPECT_EQ(r.exitCode, 1);
    EXPECT_TRUE(r.err.contains(runtime.path() + "/etiquon/etiqon")) << r.err.toStdString();
    EXPECT_EQ(QDir(victim).entryList(QDir::AllEntries | QDir::NoDotAndDotDot),
              QStringList{"precious.txt"});
    EXPECT_TRUE(QFileInfo(victim).permissions() & QFile::ReadOther);
}

}  // namespace
}  // namespace etq::print::test
