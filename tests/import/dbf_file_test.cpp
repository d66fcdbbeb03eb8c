#include "import/dbf_file.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <QtEndian>
#include <functional>

#include "import/host_layouts.h"
#include "samples/host_records.h"

namespace etq {
namespace {

namespace h = host;
using demo::ItemRecord;
using demo::StockDocument;

class DbfFileTest : public ::testing::Test {
  protected:
    QString path(const QString& name) const { return dir_.filePath(name); }

    QString writeItems(const QList<ItemRecord>& items) const {
        const QString file = path("oitm.dbf");
        demo::writeHostFile(file, items);
        return file;
    }

    static ItemRecord milk() {
        ItemRecord item;
        item.key = "10023";
        item.name = QStringLiteral("חלב 3% 1 ליטר");
        item.foreignName = "Milk 3%";
        item.group = "12";
        item.barcode = "7290000066318";
        item.supplierCatalogNumber = "S-77";
        item.unit = QStringLiteral("ליטר");
        item.prices[0] = {1999, {}};
        item.prices[3] = {-250, "$"};
        item.prices[9] = {123456789, "EU"};
        item.queryGroups = "5";
        return item;
    }

    QTemporaryDir dir_;
};

TEST_F(DbfFileTest, ReadsItemFieldsAtTheirFixedOffsets) {
    ItemRecord blank;
    blank.key = "  A7";  // leading blanks are trimmed too
    blank.deleted = true;
    const DbfFile file(writeItems({milk(), blank}));

    EXPECT_EQ(file.recordCount(), 2);
    EXPECT_EQ(file.recordLength(), h::oitm::kLayout.recordLength);
    EXPECT_EQ(file.text(0, h::oitm::kItemKey), "10023");
    EXPECT_EQ(file.text(0, h::oitm::kItemName), QStringLiteral("חלב 3% 1 ליטר"));
    EXPECT_EQ(file.text(0, h::oitm::kForeignName), "Milk 3%");
    EXPECT_EQ(file.text(0, h::oitm::kGroup), "12");
    EXPECT_EQ(file.text(0, h::oitm::kBarcode), "7290000066318");
    EXPECT_EQ(file.text(0, h::oitm::kSupplierCatalogNumber), "S-77");
    EXPECT_EQ(file.text(0, h::oitm::kUnit), QStringLiteral("ליטר"));
    EXPECT_EQ(file.text(0, h::oitm::kQueryGroups), "5");
    EXPECT_EQ(file.int32(0, h::oitm::price(1).offset), 1999);
    EXPECT_EQ(file.text(0, h::oitm::currency(1)), "");
    EXPECT_EQ(file.int32(0, h::oitm::price(4).offset), -250);
    EXPECT_EQ(file.text(0, h::oitm::currency(4)), "$");
    EXPECT_EQ(file.int32(0, h::oitm::price(10).offset), 123456789);
    EXPECT_EQ(file.text(0, h::oitm::currency(10)), "EU");
    EXPECT_EQ(file.int32(0, h::oitm::price(2).offset), 0);
    EXPECT_FALSE(file.isDeleted(0));

    EXPECT_TRUE(file.isDeleted(1));
    EXPECT_EQ(file.text(1, h::oitm::kItemKey), "A7");
    EXPECT_EQ(file.rawText(1, h::oitm::kItemKey), "  A7         ");
    EXPECT_EQ(file.text(1, h::oitm::kItemName), "");
    EXPECT_EQ(file.bytes(0, h::oitm::kItemKey).toByteArray(), "10023        ");
    EXPECT_EQ(file.record(1).size(), file.recordLength());
}

TEST_F(DbfFileTest, DescribesItsFieldsAsTheLayoutPlacesThem) {
    const DbfFile file(writeItems({milk()}));
    for (const h::PlacedField& placed : h::placedFields(h::oitm::kLayout)) {
        const DbfField* field = file.field(QString::fromLatin1(placed.name).toLower());
        ASSERT_NE(field, nullptr) << placed.name.constData();
        EXPECT_EQ(field->offset, placed.offset) << placed.name.constData();
        EXPECT_EQ(field->length, placed.width) << placed.name.constData();
        EXPECT_EQ(field->type, placed.type) << placed.name.constData();
    }
    const DbfField& last = file.fields().constLast();
    EXPECT_EQ(last.offset + last.length, file.recordLength());
    EXPECT_EQ(file.headerLength(), 32 + 32 * file.fields().size() + 1);
}

TEST_F(DbfFileTest, TrimsBlanksAndNulPaddingButKeepsInnerText) {
    const QString file = path("oitb.dbf");
    {
        demo::DbfWriter writer(file, h::oitb::kLayout);
        demo::DbfRecord r = writer.newRecord();
        r.setText(h::oitb::kName, QStringLiteral(" ירקות  ופירות "));
        writer.append(r);
        r = writer.newRecord();
        r.setBytes(h::oitb::kName.offset, QByteArray("ab\0\0 ", 5));
        writer.append(r);
        writer.close();
    }
    const DbfFile dbf(file);
    EXPECT_EQ(dbf.text(0, h::oitb::kName), QStringLiteral("ירקות  ופירות"));
    EXPECT_EQ(dbf.text(1, h::oitb::kName), "ab");
    EXPECT_EQ(dbf.text(0, h::oitb::kNumber), "");
}

TEST_F(DbfFileTest, ALongDocumentContinuesOverRecordsWithTheSameNumber) {
    StockDocument doc;
    doc.number = 4711;
    doc.reference = "20501";
    doc.accountKey = "20001";
    doc.date = QDate(2025, 11, 30);
    doc.draftMark = "";
    doc.address = QStringLiteral("רחוב הרצל 12\rתל אביב");
    doc.dueDate = QDate(2025, 12, 30);
    doc.customerName = QStringLiteral("סופרמרקט השכונה בע\"מ");
    doc.contactName = QStringLiteral("יוסי כהן");
    for (int n = 1; n <= 23; ++n)
        doc.lines.append({n == 23 ? std::optional<double>() : -3.6 + n, QString::number(10000 + n),
                          QStringLiteral("פריט %1").arg(n), "V" + QString::number(n), "", n % 3});
    const QString file = path("dlvnote.dbf");
    demo::writeHostFile(file, QList{doc});

    const DbfFile dbf(file);
    h::requireLayout(dbf, h::stockdoc::kLayout);
    namespace s = h::stockdoc;
    ASSERT_EQ(dbf.recordCount(), 3);
    for (int page = 0; page < 3; ++page) {
        EXPECT_EQ(dbf.text(page, s::kNumber), "4711");
        EXPECT_EQ(dbf.text(page, s::kPage), QString::number(page));
        EXPECT_EQ(dbf.text(page, s::kDate), "20251130");
        EXPECT_EQ(dbf.text(page, s::kAddress), QStringLiteral("רחוב הרצל 12\rתל אביב"));
    }
    EXPECT_EQ(dbf.text(0, s::kDraftMark), "");
    EXPECT_EQ(dbf.text(0, s::kDueDate), "20251230");
    EXPECT_EQ(dbf.text(0, s::kCustomerName), QStringLiteral("סופרמרקט השכונה בע\"מ"));
    EXPECT_EQ(dbf.text(0, s::kContactName), QStringLiteral("יוסי כהן"));
    EXPECT_EQ(dbf.text(0, s::slot(1, s::line::kQuantity)), "-2.60");
    EXPECT_EQ(dbf.text(1, s::slot(10, s::line::kItemKey)), "10020");
    EXPECT_EQ(dbf.text(2, s::slot(3, s::line::kItemName)), QStringLiteral("פריט 23"));
    EXPECT_EQ(dbf.text(2, s::slot(3, s::line::kQuantity)), "");
    EXPECT_EQ(dbf.text(2, s::slot(2, s::line::kVendorCatalogNumber)), "V22");
    EXPECT_EQ(dbf.text(2, s::slot(2, s::line::kWarehouse)), "1");
    EXPECT_EQ(dbf.text(2, s::slot(4, s::line::kItemKey)), "");
}

TEST_F(DbfFileTest, EveryAccessOutsideTheRecordsThrows) {
    const DbfFile file(writeItems({milk()}));
    const int length = file.recordLength();
    const std::function<void()> outside[] = {
        [&] { file.text(1, h::oitm::kItemKey); },
        [&] { file.text(-1, h::oitm::kItemKey); },
        [&] { file.text(0, length - 4, 5); },
        [&] { file.text(0, -1, 2); },
        [&] { file.int32(0, length - 3); },
        [&] { file.bytes(0, 0, length + 1); },
        [&] { file.isDeleted(1); },
        [&] { file.record(7); },
    };
    for (const auto& read : outside)
        EXPECT_THROW(read(), DbfError);
    EXPECT_NO_THROW(file.int32(0, length - 4));
    EXPECT_NO_THROW(file.text(0, length, 0));
}

TEST_F(DbfFileTest, AFileWithNoRecordsOpensEmpty) {
    const DbfFile file(writeItems({}));
    EXPECT_EQ(file.recordCount(), 0);
    EXPECT_THROW(file.isDeleted(0), DbfError);
}

// Each damage is done byte-wise on a generated file of three items.
TEST_F(DbfFileTest, DamagedFilesGiveAClearErrorNamingTheFile) {
    struct Damage {
        const char* what;
        std::function<void(QByteArray&)> apply;
        QString expected;
    };
    auto setU16 = [](QByteArray& b, int at, quint16 v) { qToLittleEndian(v, b.data() + at); };
    auto setU32 = [](QByteArray& b, int at, quint32 v) { qToLittleEndian(v, b.data() + at); };
    const Damage damages[] = {
        {"shorter than a header", [](QByteArray& b) { b.truncate(20); },
         "it is 20 bytes long, shorter than a dBASE header"},
        {"empty", [](QByteArray& b) { b.clear(); }, "it is 0 bytes long"},
        {"header length past the end", [&](QByteArray& b) { setU16(b, 8, 60000); },
         "the header length 60000 goes past the end of the file"},
        {"header length too small", [&](QByteArray& b) { setU16(b, 8, 32); },
         "the header length 32 is less than 33 bytes"},
        {"zero record length", [&](QByteArray& b) { setU16(b, 10, 0); }, "the record length is 0"},
        {"lying record count", [&](QByteArray& b) { setU32(b, 4, 1000); },
         "1000 records of 430 bytes"},
        {"huge record count", [&](QByteArray& b) { setU32(b, 4, 0xFFFFFFFF); },
         "4294967295 records of 430 bytes"},
        {"truncated in the last record", [](QByteArray& b) { b.chop(100); },
         "3 records of 430 bytes"},
    };
    const QString file = writeItems({milk(), milk(), milk()});
    QFile in(file);
    ASSERT_TRUE(in.open(QIODevice::ReadOnly));
    const QByteArray original = in.readAll();
    in.close();
    for (const Damage& damage : damages) {
        QByteArray bytes = original;
        damage.apply(bytes);
        const QString damaged = path(QStringLiteral("damaged %1.dbf").arg(damage.what));
        QFile out(damaged);
        ASSERT_TRUE(out.open(QIODevice::WriteOnly));
        out.write(bytes);
        out.close();
        try {
            DbfFile opened(damaged);
            ADD_FAILURE() << damage.what << ": opened";
        } catch (const DbfError& e) {
            EXPECT_TRUE(e.message().contains(damaged)) << e.what();
            EXPECT_TRUE(e.message().contains(damage.expected)) << damage.what << ": " << e.what();
        }
    }
}

TEST_F(DbfFileTest, TruncationMessageSaysTheNumbers) {
    const QString file = writeItems({milk(), milk(), milk()});
    const qint64 header = DbfFile(file).headerLength();
    QFile f(file);
    ASSERT_TRUE(f.resize(f.size() - 101));  // the end mark and 100 bytes of the last record
    try {
        DbfFile opened(file);
        FAIL() << "opened";
    } catch (const DbfError& e) {
        const qint64 needed = header + 3 * 430;
        EXPECT_TRUE(e.message().contains(QStringLiteral("%1 bytes in all").arg(needed)))
            << e.what();
        EXPECT_TRUE(e.message().contains(QStringLiteral("only %1 bytes").arg(needed - 100)))
            << e.what();
    }
}

TEST_F(DbfFileTest, ALayoutLongerThanTheRecordIsRefusedBeforeReading) {
    const QString file = path("ocrn.dbf");
    demo::writeHostFile(file, QList<demo::CurrencyRecord>{{"$", "Dollar", "$", "$"}});
    const DbfFile dbf(file);
    EXPECT_NO_THROW(h::requireLayout(dbf, h::ocrn::kLayout));
    try {
        h::requireLayout(dbf, h::oitm::kLayout);
        FAIL() << "accepted";
    } catch (const DbfError& e) {
        EXPECT_EQ(
            e.message(),
            file + ": its records are 72 bytes long, shorter than the item record (430 bytes)");
    }
}

// The host may rewrite a file while we read it: what was opened stays readable (a mapped
// file cut short under the reader killed the process with SIGBUS).
TEST_F(DbfFileTest, AFileCutShortAfterOpeningStaysReadable) {
    QList<ItemRecord> items(300, milk());
    items.last().key = "LAST";
    const QString file = writeItems(items);
    const DbfFile dbf(file);
    ASSERT_TRUE(QFile::resize(file, 0));
    EXPECT_EQ(dbf.text(299, h::oitm::kItemKey), "LAST");
    EXPECT_EQ(dbf.int32(299, h::oitm::price(1).offset), 1999);
}

TEST_F(DbfFileTest, AMissingFileIsReported) {
    try {
        DbfFile opened(path("nothing.dbf"));
        FAIL() << "opened";
    } catch (const DbfError& e) {
        EXPECT_TRUE(e.message().startsWith("Cannot open " + path("nothing.dbf"))) << e.what();
    }
}

}  // namespace
}  // namespace etq
