// The gLabels provider without printing: what it reads from designs, the merge lines it writes,
// and the calls it refuses.
#include "platform/glabels_automation.h"

#include <gtest/gtest.h>
#include <zlib.h>

#include <QFile>
#include <QStandardPaths>
#include <QTemporaryDir>

#include "platform/failure.h"
#include "support/qt_print.h"

namespace etq {
namespace {

const QString kSample = QStringLiteral(ETIQUON_SOURCE_DIR "/samples/labels/demo-items.glabels");

class GLabelsTest : public ::testing::Test {
  protected:
    QString write(const QString& name, const QByteArray& text) {
        QFile file(dir.filePath(name));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(text);
        return file.fileName();
    }
    static QString failureOf(const std::function<void()>& work) {
        try {
            work();
            return {};
        } catch (const Failure& e) {
            return e.description();
        }
    }
    QTemporaryDir dir;
};

// A design as gLabels saves it (gzip-compressed) or as written by hand gives the fields its
// objects merge, in order, and its merge source's delimiter.
TEST_F(GLabelsTest, DesignsGiveTheirMergeFields) {
    QFile sample(kSample);
    ASSERT_TRUE(sample.open(QIODevice::ReadOnly));
    const QByteArray xml = sample.readAll();
    const QString packed = dir.filePath("packed.glabels");
    gzFile gz = gzopen(QFile::encodeName(packed).constData(), "wb");
    gzwrite(gz, xml.constData(), unsigned(xml.size()));
    gzclose(gz);
    for (const QString& path : {kSample, packed}) {
        const GLabelsDesign design = readGLabelsDesign(path);
        EXPECT_EQ(design.fields, (QStringList{"ItemName", "BarCode", "Price", "CoinSign"}));
        EXPECT_EQ(design.delimiter, u',');
    }
    QByteArray tabs = xml;
    tabs.replace("Text/Comma/Line1Keys", "Text/Tab/Line1Keys");
    EXPECT_EQ(readGLabelsDesign(write("tabs.glabels", tabs)).delimiter, u'\t');

    const struct {
        const char* name;
        QByteArray from, to;
        QString says;
    } broken[] = {
        {"no merge", R"(<Merge type="Text/Comma/Line1Keys" src="items.csv"/>)", "",
         "has no merge source"},
        {"merge none", "Text/Comma/Line1Keys", "None", "has no merge source"},
        {"no keys", "Text/Comma/Line1Keys", "Text/Comma", "merges from \"Text/Comma\""},
        {"address book", "Text/Comma/Line1Keys", "ebook/eds", "merges from \"ebook/eds\""},
        {"not a design", "Glabels-document", "Glabels-template", "is no gLabels design"},
        {"cut short", "</Glabels-document>", "</Glabels", "is no gLabels design: "},
    };
    for (const auto& b : broken) {
        SCOPED_TRACE(b.name);
        QByteArray text = xml;
        const QString path = write(QString(b.name) + ".glabels", text.replace(b.from, b.to));
        EXPECT_TRUE(failureOf([&] { readGLabelsDesign(path); }).contains(b.says))
            << failureOf([&] { readGLabelsDesign(path); }).toStdString();
    }
    EXPECT_EQ(failureOf([&] { readGLabelsDesign(dir.filePath("none.glabels")); }),
              "The label design " + dir.filePath("none.glabels") + " does not exist");
}

// Every value quoted, quotes doubled and backslashes escaped, as gLabels reads them back; line
// breaks stay inside the quotes; UTF-8.
TEST_F(GLabelsTest, MergeLinesQuoteEveryValue) {
    EXPECT_EQ(glabelsMergeLine({"סבון, ריחני", R"(12" \ 3)", "", "a\nb"}, u','),
              QString(R"("סבון, ריחני","12"" \\ 3","","a)"
                      "\n"
                      R"(b")"
                      "\n")
                  .toUtf8());
    EXPECT_EQ(glabelsMergeLine({"x", "y"}, u'\t'), "\"x\"\t\"y\"\n");
}

// The object refuses what would print a label short of a value, and is not made without
// glabels-3-batch.
TEST_F(GLabelsTest, FieldsTheDesignDoesNotMergeOrLacksAreRefused) {
    GLabelsProvider provider;
    const AutomationObject app = provider.create("gLabels.Application");
    app.call("Open", {kSample});
    app.call("SetField", {"-", "passed over"});
    EXPECT_EQ(failureOf([&] {
                  app.call("SetField", {"ItemKey", "A1"});
              }),
              "The label design " + kSample + " has no merge field \"ItemKey\"");
    for (const char* field : {"ItemName", "BarCode", "Price"})
        app.call("SetField", {field, "1"});
    EXPECT_EQ(
        failureOf([&] { app.call("PrintRecord", {1}); }),
        "The label design " + kSample +
            " merges the field \"CoinSign\", which was given no value: check that field on the label data tab");
    EXPECT_TRUE(failureOf([&] { app.call("Print", {1}); }).contains("doesn't support"));

    const QByteArray path = qgetenv("PATH");
    qputenv("PATH", dir.path().toLocal8Bit());
    EXPECT_EQ(
        failureOf([&] { provider.create("gLabels.Application"); }),
        "gLabels is not available here: glabels-3-batch is not installed (Debian package glabels)");
    qputenv("PATH", path);
}

}  // namespace
}  // namespace etq
