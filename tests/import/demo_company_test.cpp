#include "samples/demo_company.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QMap>
#include <QRegularExpression>
#include <QSet>
#include <QTemporaryDir>

#include "import/dbf_file.h"
#include "import/host_layouts.h"

namespace etq {
namespace {

namespace h = host;

QByteArray contents(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

bool isValidEan13(const QString& code) {
    if (code.size() != 13) return false;
    int sum = 0;
    for (int i = 0; i < 13; ++i) {
        if (!code[i].isDigit()) return false;
        sum += code[i].digitValue() * (i % 2 ? 3 : 1);
    }
    return sum % 10 == 0;
}

class DemoCompanyTest : public ::testing::Test {
  protected:
    static void SetUpTestSuite() {
        dir_ = new QTemporaryDir;
        demo::writeDemoCompany(dir_->path());
    }
    static void TearDownTestSuite() { delete dir_; }
    static QString path(const QString& name) { return dir_->filePath(name); }
    static QTemporaryDir* dir_;
};
QTemporaryDir* DemoCompanyTest::dir_ = nullptr;

TEST_F(DemoCompanyTest, SameSeedSameBytesOtherSeedOtherData) {
    QTemporaryDir again, other;
    demo::writeDemoCompany(again.path());
    demo::writeDemoCompany(other.path(), {.items = 300, .seed = 99});
    const QStringList files = QDir(dir_->path()).entryList({"*.dbf"}, QDir::Files, QDir::Name);
    EXPECT_EQ(files.size(), 14);
    for (const QString& name : files)
        EXPECT_EQ(contents(path(name)), contents(again.filePath(name))) << name.toStdString();
    EXPECT_NE(contents(path("oitm.dbf")), contents(other.filePath("oitm.dbf")));
}

TEST_F(DemoCompanyTest, ItemsHaveValidBarcodesPricesInSeveralCurrenciesAndKnownGroups) {
    const DbfFile groups(path("oitb.dbf"));
    QSet<QString> groupNumbers;
    for (qint64 i = 0; i < groups.recordCount(); ++i)
        groupNumbers.insert(groups.text(i, h::oitb::kNumber));

    const DbfFile items(path("oitm.dbf"));
    h::requireLayout(items, h::oitm::kLayout);
    ASSERT_EQ(items.recordCount(), 300);
    int blankBarcodes = 0, deleted = 0, lettered = 0;
    QSet<QString> keys, currencies, names;
    for (qint64 i = 0; i < items.recordCount(); ++i) {
        const QString key = items.text(i, h::oitm::kItemKey);
        EXPECT_FALSE(keys.contains(key)) << key.toStdString();
        keys.insert(key);
        lettered += key.contains(QRegularExpression("[A-Z]"));
        deleted += items.isDeleted(i);
        const QString barcode = items.text(i, h::oitm::kBarcode);
        if (barcode.isEmpty())
            ++blankBarcodes;
        else
            EXPECT_TRUE(isValidEan13(barcode)) << barcode.toStdString();
        EXPECT_TRUE(groupNumbers.contains(items.text(i, h::oitm::kGroup)));
        names.insert(items.text(i, h::oitm::kItemName));
        EXPECT_GT(items.int32(i, h::oitm::price(1).offset), 0);
        for (int n = 1; n <= h::oitm::kPriceCount; ++n)
            if (items.int32(i, h::oitm::price(n).offset) != 0)
                currencies.insert(items.text(i, h::oitm::currency(n)));
    }
    EXPECT_GT(blankBarcodes, 0);
    EXPECT_LT(blankBarcodes, 100);
    EXPECT_GT(deleted, 0);
    EXPECT_GT(lettered, 0);
    EXPECT_GT(names.size(), 250);
    EXPECT_EQ(currencies, (QSet<QString>{"", "$", "EU"}));

    const DbfFile coins(path("ocrn.dbf"));
    QStringList codes;
    for (qint64 i = 0; i < coins.recordCount(); ++i)
        codes << coins.text(i, h::ocrn::kCode);
    EXPECT_TRUE(codes.contains(QStringLiteral("¦")));
    EXPECT_TRUE(codes.contains("$"));
    EXPECT_TRUE(codes.contains("EU"));

    const DbfFile lists(path("opln.dbf"));
    ASSERT_EQ(lists.recordCount(), 10);
    for (qint64 i = 0; i < 10; ++i)
        EXPECT_EQ(lists.text(i, h::opln::kNumber).toInt(), i + 1);
}

// What a document file must show for the readers to be exercised: pages that continue a
// document, drafts, a record marked "I", dates of 2025-2026, lines naming real items but one,
// and quantities that are negative, beyond 999 labels, and nothing.
TEST_F(DemoCompanyTest, DocumentFilesHoldContinuedDocumentsDraftsAndOneIgnoredRecord) {
    const DbfFile items(path("oitm.dbf"));
    QSet<QString> itemKeys;
    for (qint64 i = 0; i < items.recordCount(); ++i)
        itemKeys.insert(items.text(i, h::oitm::kItemKey));

    namespace s = h::stockdoc;
    int ignored = 0, drafts = 0, threePages = 0, unknownItems = 0;
    QSet<double> quantities;
    for (const demo::DemoDocumentFile& type : demo::kDemoDocumentFiles) {
        const DbfFile file(path(QString::fromLatin1(type.baseName) + ".dbf"));
        h::requireLayout(file, s::kLayout);
        QMap<QString, int> pages;
        QMap<QString, int> lines;
        for (qint64 i = 0; i < file.recordCount(); ++i) {
            const QString number = file.text(i, s::kNumber);
            EXPECT_EQ(file.text(i, s::kPage).toInt(), pages.value(number, 0))
                << number.toStdString();
            pages[number] = pages.value(number, 0) + 1;
            const QDate date = QDate::fromString(file.text(i, s::kDate), "yyyyMMdd");
            EXPECT_TRUE(date.year() == 2025 || date.year() == 2026)
                << date.toString().toStdString();
            ignored += file.text(i, s::kStatus) == "I";
            drafts += file.text(i, s::kPage) == "0" && file.text(i, s::kDraftMark) != "N";
            for (int k = 1; k <= s::kLinesPerRecord; ++k) {
                const QString key = file.text(i, s::slot(k, s::line::kItemKey));
                if (key.isEmpty()) continue;
                unknownItems += !itemKeys.contains(key);
                const QString quantity = file.text(i, s::slot(k, s::line::kQuantity));
                EXPECT_FALSE(quantity.isEmpty());
                quantities.insert(quantity.toDouble());
                lines[number] += 1;
            }
        }
        for (auto it = lines.cbegin(); it != lines.cend(); ++it) {
            EXPECT_GE(it.value(), 1);
            EXPECT_LE(it.value(), 23);
            EXPECT_EQ(pages[it.key()], (it.value() + 9) / 10);
        }
        threePages += int(std::count(pages.cbegin(), pages.cend(), 3));
    }
    EXPECT_EQ(ignored, 1);
    EXPECT_EQ(unknownItems, 1);
    for (const double quantity : {-3.6, 2500.0, 0.0})
        EXPECT_TRUE(quantities.contains(quantity)) << quantity;
    EXPECT_GE(drafts, 3);
    EXPECT_GE(threePages, 1);
}

TEST_F(DemoCompanyTest, AccountsAndSpecialPricesNameEachOther) {
    const DbfFile accounts(path("ocrd.dbf"));
    QSet<QString> keys;
    for (qint64 i = 0; i < accounts.recordCount(); ++i)
        keys.insert(accounts.text(i, h::ocrd::kAccountKey));
    EXPECT_GE(keys.size(), 20);
    const DbfFile prices(path("ospp.dbf"));
    ASSERT_GT(prices.recordCount(), 0);
    for (qint64 i = 0; i < prices.recordCount(); ++i) {
        EXPECT_TRUE(keys.contains(prices.text(i, h::ospp::kAccountKey)));
        EXPECT_GT(prices.int32(i, h::ospp::kPrice.offset), 0);
    }
}

}  // namespace
}  // namespace etq
