// The main job end to end, as tools/demo.sh runs it on the demo company: the label page it
// prints is rendered by a real browser (headless Chromium), and its barcode bitmaps are read
// back by a real decoder (zbarimg).
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
#include "support/test_env.h"

#include "demo_fixture.h"

namespace etq::print::test {
namespace {

using etq::test::ProcessResult;
using etq::test::runProcess;

// What the browser saw once the page had loaded: the labels that hold a record, and each
// image's source with its natural width (0 when it did not load).
struct Rendered {
    int labels = -1;
    QList<std::pair<QString, int>> images;
};

// A copy of the page beside it, with a script that writes what the browser loaded into the
// page itself; Chromium's --dump-dom returns the page after its load event.
Rendered renderInChromium(const QString& page) {
    QFile original(page);
    if (!original.open(QIODevice::ReadOnly)) return {};
    QByteArray bytes = original.readAll();
    const QByteArray script =
        "<script>window.addEventListener('load', function () {\r\n"
        "  var out = [];\r\n"
        "  for (var i = 0; i < document.images.length; i++)\r\n"
        "    out.push(document.images[i].getAttribute('src') + '=' + document.images[i].naturalWidth);\r\n"
        "  var labels = 0, all = document.querySelectorAll('table.Lab');\r\n"
        "  for (var j = 0; j < all.length; j++) if (!all[j].querySelector('td[nowrap]')) labels++;\r\n"
        "  var p = document.createElement('pre'); p.id = 'etq-check';\r\n"
        "  p.textContent = 'labels=' + labels + ';' + out.join(';');\r\n"
        "  document.body.appendChild(p);\r\n"
        "});</script>\r\n";
    bytes.replace("</BODY>", script + "</BODY>");
    const QString check = QFileInfo(page).path() + "/etq-check.htm";
    QFile copy(check);
    if (!copy.open(QIODevice::WriteOnly) || copy.write(bytes) != bytes.size()) return {};
    copy.close();

    QTemporaryDir profile;
    const ProcessResult chromium = runProcess(
        "chromium",
        {"--headless", "--no-sandbox", "--disable-gpu", "--disable-quic", "--no-first-run",
         "--disable-background-networking", "--disable-component-update", "--disable-sync",
         "--user-data-dir=" + profile.path(), "--dump-dom", "file://" + check});
    QFile::remove(check);
    const QRegularExpressionMatch match =
        QRegularExpression(R"(<pre id="etq-check">labels=(\d+);?([^<]*)</pre>)")
            .match(chromium.out);
    if (!match.hasMatch()) {
        ADD_FAILURE() << "no result from chromium: " << chromium.err.left(2000).toStdString();
        return {};
    }
    Rendered rendered;
    rendered.labels = match.captured(1).toInt();
    for (const QString& image : match.captured(2).split(u';', Qt::SkipEmptyParts)) {
        const qsizetype eq = image.lastIndexOf(u'=');
        rendered.images.append({image.left(eq), image.mid(eq + 1).toInt()});
    }
    return rendered;
}

using DemoPageTest = DemoTest;

TEST_F(DemoPageTest, BrowserShowsEveryLabelAndBarcodeOfTheDemoPage) {
    const ProcessResult demo = runDemo();
    ASSERT_EQ(demo.exitCode, 0) << demo.err.toStdString();
    const QString line = lastLine(demo.out);
    ASSERT_TRUE(line.startsWith("The label page: ")) << line.toStdString();
    const QString page = line.mid(int(sizeof("The label page: ")) - 1);
    ASSERT_TRUE(QFile::exists(page)) << page.toStdString();

    // Twelve items, two copies each: one full sheet of 4 x 6.
    const Rendered rendered = renderInChromium(page);
    EXPECT_EQ(rendered.labels, 24);
    ASSERT_EQ(rendered.images.size(), 24);
    for (const auto& [source, width] : rendered.images) {
        EXPECT_TRUE(source.startsWith("B04")) << source.toStdString();
        EXPECT_GT(width, 0) << source.toStdString() << " did not load";
    }

    // The bitmaps read back as the items' EAN-13 barcodes, record by record.
    const QStringList barcodes = marked("BarCode");
    ASSERT_EQ(barcodes.size(), 12);
    const QString folder = QFileInfo(page).path();
    for (int record = 1; record <= 12; ++record)
        EXPECT_EQ(decode(QString("%1/B04%2.BMP").arg(folder).arg(record, 5, 10, QChar('0'))),
                  barcodes[record - 1])
            << record;
}

TEST_F(DemoPageTest, Code128BitmapsReadBackAsTheItemKeys) {
    ASSERT_EQ(runDemo().exitCode, 0);
    ASSERT_EQ(cli({"config", "set", "LabelBar", "BarType", "2"}).exitCode, 0);  // CODE-128
    ASSERT_EQ(cli({"config", "set", "1LabelDef", "FldID", "0"}).exitCode, 0);   // ItemKey
    const ProcessResult print = cli({"print-items", "--db", work.path() + "/db"});
    ASSERT_EQ(print.exitCode, 0) << print.err.toStdString();
    const QString folder = QFileInfo(lastLine(print.out)).path();
    const QStringList keys = marked("ItemKey");
    ASSERT_EQ(keys.size(), 12);
    EXPECT_TRUE(keys.contains("KT-1005"));
    for (int record = 1; record <= 12; ++record)
        EXPECT_EQ(decode(QString("%1/B00%2.BMP").arg(folder).arg(record, 5, 10, QChar('0'))),
                  keys[record - 1])
            << record;
    EXPECT_EQ(renderInChromium(lastLine(print.out)).labels, 24);
}

// The document road of the demo: one label per copy of every included line of an included
// document whose item is known, in a thermal printer's order (document file, document and line
// descending), each with the line's item barcode.
TEST_F(DemoPageTest, BrowserShowsALabelPerCopyOfTheChosenDocumentLines) {
    const ProcessResult demo = runProcess(
        "bash", {etq::test::sourceDir() + "/tools/demo.sh", "--no-build", "--documents"}, env);
    ASSERT_EQ(demo.exitCode, 0) << demo.err.toStdString();
    const QString line = lastLine(demo.out);
    ASSERT_TRUE(line.startsWith("The label page: ")) << line.toStdString();
    const QString page = line.mid(int(sizeof("The label page: ")) - 1);

    // Record by record, as the label query should give them: copies and barcode.
    jet::Database workDb = jet::Database::open(work.path() + "/db/etiqondb.tmp");
    QList<std::pair<int, QString>> records;
    for (jet::Recordset rs = workDb.openRecordset(
             "SELECT L.Copies, I.BarCode FROM tTempDocLines AS L, tTempDocHeaders AS H, tItems "
             "AS I WHERE L.WizFileID = H.WizFileID AND L.HeadNumber = H.[Number] AND I.ItemKey = "
             "L.ItemKey AND H.Include = True AND L.Include = True ORDER BY L.WizFileID DESC, "
             "L.HeadNumber DESC, L.LineNum DESC");
         !rs.eof(); rs.moveNext())
        records.append({rs.value(0).toInt(), rs.value(1).toString()});
    QStringList expectedImages;
    for (int record = 1; record <= records.size(); ++record)
        for (int copy = 0; copy < records[record - 1].first; ++copy)
            expectedImages << QString("B04%1.BMP").arg(record, 5, 10, QChar('0'));
    ASSERT_EQ(expectedImages.size(), 15);  // as the demo chooses them
    EXPECT_EQ(records.last().first, 3);    // the first line of the first document, last

    const Rendered rendered = renderInChromium(page);
    EXPECT_EQ(rendered.labels, expectedImages.size());
    QStringList images;
    for (const auto& [source, width] : rendered.images) {
        images << source;
        EXPECT_GT(width, 0) << source.toStdString() << " did not load";
    }
    EXPECT_EQ(images, expectedImages);
    const QString folder = QFileInfo(page).path();
    for (int record = 1; record <= records.size(); ++record) {
        if (records[record - 1].first == 0) continue;
        EXPECT_EQ(decode(QString("%1/B04%2.BMP").arg(folder).arg(record, 5, 10, QChar('0'))),
                  records[record - 1].second)
            << record;
    }
}

}  // namespace
}  // namespace etq::print::test
