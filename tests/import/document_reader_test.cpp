#include "import/document_reader.h"

#include "document_fixture.h"
#include "import/host_reading.h"
#include "import/scan_ranges.h"

namespace etq::test {
namespace {

namespace doc = host::stockdoc;
using demo::StockDocument;

class DocumentReaderTest : public DocumentTest {};

// A document of 23 lines fills three records (pages 0, 1 and 2): one header, whose values come
// from the first record, and lines numbered page x 10 + slot, each with the index of its record.
TEST_F(DocumentReaderTest, LongDocumentIsOneHeaderWithLinesNumberedByPage) {
    StockDocument d = document(101, 23);
    d.reference = "501";
    d.accountKey = "O\"NEIL";
    d.customerReference = "PO-77";
    d.address = QStringLiteral("רחוב הרצל 12\rתל אביב");
    d.remarks = QStringLiteral("לפרוק בבוקר");
    d.customerName = QStringLiteral("סופרמרקט \"השכונה\", בע'מ");
    d.contactName = QStringLiteral("יוסי כהן");
    d.lines[0].vendorCatalogNumber = "V-1";
    d.lines[0].serialNumber = "SN-1";
    d.lines[0].warehouse = 2;
    d.lines[10].itemKey = "A\"B";
    writeDocuments("dlvnote.dbf", {d, document(102)});

    const StockDocScan scan = read(options());
    EXPECT_EQ(scan.recordCount, 4);
    EXPECT_EQ(scan.headers, 2);
    EXPECT_EQ(scan.lines, 24);
    EXPECT_EQ(work("SELECT WizFileID, Number, RecIndex, DocType, Reference1, DocDate, DocDueDate, "
                   "AccountKey, CardName, Address, NumAtCard, CntctName, Comments, Copies, "
                   "TotalCrates, Include, IsDraft FROM tTempDocHeaders ORDER BY Number"),
              (QStringList{QStringLiteral("1|101|0|1|501|10/03/2025|09/04/2025|O'NEIL|"
                                          "סופרמרקט השכונה בעמ|רחוב הרצל 12\r\nתל אביב|PO-77|"
                                          "יוסי כהן|לפרוק בבוקר|1|1|False|False"),
                           QStringLiteral("1|102|3|1|1102|10/03/2025|09/04/2025|20001|"
                                          "מכולת אצל שמעון|Null|Null|Null|Null|1|1|False|False")}));

    const QStringList lines = work(
        "SELECT LineNum, Number, ItemKey, ItemName, Quantity, Warehouse, Copies, Include, "
        "SerialNum, VendorNum FROM tTempDocLines WHERE HeadNumber = 101 ORDER BY LineNum");
    ASSERT_EQ(lines.size(), 23);
    EXPECT_EQ(lines[0], QStringLiteral("1|0|K1|פריט K1|1|2|1|True|SN-1|V-1"));
    EXPECT_EQ(lines[9], QStringLiteral("10|0|K10|פריט K10|1|Null|1|True|Null|Null"));
    EXPECT_EQ(lines[10], QStringLiteral("11|1|A'B|פריט K11|1|Null|1|True|Null|Null"));
    EXPECT_EQ(lines[22], QStringLiteral("23|2|K23|פריט K23|1|Null|1|True|Null|Null"));
    EXPECT_EQ(work("SELECT WizFileID, HeadNumber, LineNum, Number FROM tTempDocLines "
                   "WHERE HeadNumber = 102"),
              QStringList{"1|102|1|3"});
    EXPECT_TRUE(messages.shown.isEmpty());
}

TEST_F(DocumentReaderTest, QuantitiesGiveCopiesRoundedPositiveAndAtMost999) {
    struct Case {
        std::optional<double> quantity;  // none: blank
        QString stored;
        int copies;
    };
    const Case cases[] = {{-3.6, "-3.6", 4},     {2500, "2500", 999},   {0.0, "0", 0},
                          {{}, "0", 0},          {2.5, "2.5", 2},       {3.5, "3.5", 4},
                          {-1000, "-1000", 999}, {999.4, "999.4", 999}, {12.25, "12.25", 12}};
    StockDocument d = document(7, 0);
    for (const Case& c : cases)
        d.lines.append(line(QString::number(d.lines.size() + 1), c.quantity));
    writeDocuments("dlvnote.dbf", {d});
    read(options());
    const QStringList lines = work("SELECT Quantity, Copies FROM tTempDocLines ORDER BY LineNum");
    ASSERT_EQ(lines.size(), int(std::size(cases)));
    for (int i = 0; i < lines.size(); ++i)
        EXPECT_EQ(lines[i], QStringLiteral("%1|%2").arg(cases[i].stored).arg(cases[i].copies));
}

TEST_F(DocumentReaderTest, AddressLinesTakeTheSeparatorAndTransfersTakeNoContactName) {
    struct Case {
        qint16 type;
        QString file;
        QString separator;
        QString expected;  // "Address|CntctName"
    };
    const Case cases[] = {
        {1, "dlvnote.dbf", "\r\n", QStringLiteral("משק 23\r\nמושב בני דרום\r\nד.נ. נגב|שרה")},
        {1, "dlvnote.dbf", ",", QStringLiteral("משק 23,מושב בני דרום,ד.נ. נגב|שרה")},
        {12, "transf.dbf", ",", QStringLiteral("משק 23,מושב בני דרום,ד.נ. נגב|Null")},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.file.toStdString() + " " + c.separator.toStdString());
        freshWorkDatabase();
        setRange(0, 0, c.type);
        StockDocument d = document(5);
        d.address = QStringLiteral("משק 23\rמושב בני דרום\rד.נ. נגב");
        d.contactName = QStringLiteral("שרה");
        writeDocuments(c.file, {d});
        StockDocReadOptions o = options(c.type);
        o.addressSeparator = c.separator;
        read(o);
        EXPECT_EQ(work("SELECT Address, CntctName FROM tTempDocHeaders"), QStringList{c.expected});
    }
}

// Records the host marks "I" and records deleted from the file are never read; drafts (any
// mark but "N", blank too) only when asked, and then flagged.
TEST_F(DocumentReaderTest, DraftsOnlyWhenAskedNeverIgnoredOrDeletedRecords) {
    QList<StockDocument> docs = documents(6);
    docs[1].draftMark = "Y";
    docs[2].draftMark = "";
    docs[3].status = "I";
    docs[4].deleted = true;
    docs[5].status = "C";
    writeDocuments("dlvnote.dbf", docs);
    struct Case {
        bool drafts;
        QStringList headers;  // Number|IsDraft
    };
    const Case cases[] = {{false, {"1|False", "6|False"}},
                          {true, {"1|False", "2|True", "3|True", "6|False"}}};
    for (const Case& c : cases) {
        freshWorkDatabase();
        setRange(0, 0);
        StockDocReadOptions o = options();
        o.includeDrafts = c.drafts;
        read(o);
        EXPECT_EQ(work("SELECT Number, IsDraft FROM tTempDocHeaders ORDER BY Number"), c.headers)
            << c.drafts;
    }
}

TEST_F(DocumentReaderTest, DateWindowIncludesBothEnds) {
    const QDate dates[] = {
        {2024, 12, 31}, {2025, 1, 1}, {2025, 6, 15}, {2025, 6, 30}, {2025, 7, 1}};
    QList<StockDocument> docs;
    for (const QDate& date : dates)
        docs.append(document(int(docs.size()) + 1, 1, date));
    writeDocuments("dlvnote.dbf", docs);
    struct Case {
        QDate from, to;
        QStringList numbers;
    };
    const Case cases[] = {
        {{2025, 1, 1}, {2025, 6, 30}, {"2", "3", "4"}},
        {{}, {2025, 1, 1}, {"1", "2"}},
        {{2025, 6, 30}, {}, {"4", "5"}},
        {{}, {}, {"1", "2", "3", "4", "5"}},
        {{2025, 6, 16}, {2025, 6, 29}, {}},
    };
    for (const Case& c : cases) {
        freshWorkDatabase();
        setRange(0, 0);
        StockDocReadOptions o = options();
        o.fromDate = c.from;
        o.toDate = c.to;
        read(o);
        EXPECT_EQ(numbers(), c.numbers)
            << c.from.toString().toStdString() << " - " << c.to.toString().toStdString();
    }
}

// A record with a blank or impossible document date cannot be placed in the window and is
// passed over; a blank or impossible due date is no due date. Neither ends the scan.
TEST_F(DocumentReaderTest, BadDatesGiveNullOrSkipTheRecordAndNeverEndTheScan) {
    writeDocuments("dlvnote.dbf", documents(8));
    struct Patch {
        FixedField field;
        QByteArray bytes;
    };
    const Patch patches[] = {
        {doc::kDate, "        "},    {doc::kDate, "20251301"}, {doc::kDate, "2025 3 1"},
        {doc::kDate, "20250229"},    {doc::kDueDate, ""},      {doc::kDueDate, "20250431"},
        {doc::kDueDate, "00000000"},
    };
    for (qint64 record = 0; record < qint64(std::size(patches)); ++record)
        patch("dlvnote.dbf", record, patches[record].field, patches[record].bytes);
    const StockDocScan scan = read(options());
    EXPECT_EQ(scan.recordCount, 8);
    EXPECT_EQ(work("SELECT Number, DocDate, DocDueDate FROM tTempDocHeaders ORDER BY Number"),
              (QStringList{"5|10/03/2025|Null", "6|10/03/2025|Null", "7|10/03/2025|Null",
                           "8|10/03/2025|09/04/2025"}));
    EXPECT_EQ(range(), "8|9");
}

// From and to numbers bound the reference number, both ends included; a reference that is no
// number counts as 0. A scan with a from number starts at the first record whatever the stored
// position; a scan limited by a to number leaves the position where it was.
TEST_F(DocumentReaderTest, ReferenceNumberBoundsAndTheirScanPosition) {
    QList<StockDocument> docs = documents(4);
    const char* references[] = {"5", "10", "15", "ABC"};
    for (int i = 0; i < 4; ++i)
        docs[i].reference = references[i];
    writeDocuments("dlvnote.dbf", docs);
    struct Case {
        qint32 from, to;
        bool toEntered;
        QStringList headers;  // Number|Reference1
        QString range;
    };
    // The stored position starts the scan at the third record.
    const Case cases[] = {
        {0, 0, false, {"3|15", "4|0"}, "4|5"}, {10, 0, false, {"2|10", "3|15"}, "4|5"},
        {0, 10, true, {"4|0"}, "2|3"},         {10, 10, true, {"2|10"}, "2|3"},
        {5, 5, true, {"1|5"}, "2|3"},          {0, 0, true, {"3|15", "4|0"}, "2|3"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(QStringLiteral("%1..%2").arg(c.from).arg(c.to).toStdString());
        freshWorkDatabase();
        setRange(2, 3);
        StockDocReadOptions o = options();
        o.fromNumber = c.from;
        o.toNumber = c.to;
        o.toNumberEntered = c.toEntered;
        read(o);
        EXPECT_EQ(work("SELECT Number, Reference1 FROM tTempDocHeaders ORDER BY Number"),
                  c.headers);
        EXPECT_EQ(range(), c.range);
    }
}

TEST_F(DocumentReaderTest, FastWayIncludesNewHeadersWhileLinesAreAlwaysIncluded) {
    writeDocuments("dlvnote.dbf", {document(1, 3)});
    for (const bool fast : {false, true}) {
        freshWorkDatabase();
        setRange(0, 0);
        StockDocReadOptions o = options();
        o.fastWay = fast;
        read(o);
        EXPECT_EQ(work("SELECT Include FROM tTempDocHeaders"),
                  QStringList{fast ? "True" : "False"});
        EXPECT_EQ(work("SELECT Include FROM tTempDocLines"), (QStringList{"True", "True", "True"}));
    }
}

// Each scan starts with the first record the one before did not read, so appended documents are
// read once and none is lost. A reset reads everything again, and so does a stored start beyond
// the end of a file the host has packed.
TEST_F(DocumentReaderTest, IncrementalScansReadEachAppendedRecordOnce) {
    QList<StockDocument> docs = {document(1), document(2, 12), document(3)};  // four records
    writeDocuments("dlvnote.dbf", docs);
    auto scan = [&] {
        freshWorkDatabase();
        const StockDocScan s = read(options());
        return QStringLiteral("%1 from %2: ").arg(s.recordCount).arg(s.firstRecord) +
               work("SELECT RecIndex FROM tTempDocHeaders ORDER BY RecIndex").join(',') + " / " +
               range();
    };
    EXPECT_EQ(scan(), "4 from 0: 0,1,3 / 4|5");
    EXPECT_EQ(scan(), "4 from 4:  / 4|5");

    docs << document(4) << document(5, 11);  // records 5, 6 and 7 (1-based)
    writeDocuments("dlvnote.dbf", docs);
    EXPECT_EQ(scan(), "7 from 4: 4,5 / 7|8");
    EXPECT_EQ(work("SELECT Number, LineNum FROM tTempDocLines WHERE HeadNumber = 5").size(), 11);

    // A position edited in the window counts from 1: record 7 on, the second page of document 5.
    setRange(7, 7);
    EXPECT_EQ(scan(), "7 from 6: 6 / 7|8");

    // The window's reset-all, then positions meaning "from the first record" and "beyond the end".
    EXPECT_EQ(resetScanRanges(path(db::kDocDatabaseFile)), 7);
    EXPECT_EQ(range(), "7|0");
    EXPECT_EQ(scan(), "7 from 0: 0,1,3,4,5 / 7|8");
    for (const qint64 next : {1, 9, 100000}) {
        setRange(7, next);
        EXPECT_EQ(scan(), "7 from 0: 0,1,3,4,5 / 7|8") << next;
    }
}

// Record indexes are counted with 32 bits and more: nothing ends at 32,768 records.
TEST_F(DocumentReaderTest, FileOfFortyThousandRecordsIsReadWhole) {
    constexpr int kRecords = 40000;
    const QString filePath = company() + "/dlvnote.dbf";
    {
        demo::DbfWriter writer(filePath, doc::kLayout);
        StockDocument ignored = document(1);
        ignored.status = "I";  // read and passed over: the file stays quick to scan
        for (int i = 0; i < kRecords; ++i) {
            const bool wanted = i == 0 || i == 32767 || i == 32768 || i == kRecords - 1;
            StockDocument d = wanted ? document(i + 1) : ignored;
            demo::append(writer, d);
        }
        writer.close();
    }
    const StockDocScan scan = read(options());
    EXPECT_EQ(scan.recordCount, kRecords);
    EXPECT_EQ(work("SELECT RecIndex, Number FROM tTempDocHeaders ORDER BY RecIndex"),
              (QStringList{"0|1", "32767|32768", "32768|32769", "39999|40000"}));
    EXPECT_EQ(work("SELECT Number FROM tTempDocLines ORDER BY Number"),
              (QStringList{"0", "32767", "32768", "39999"}));
    EXPECT_EQ(range(), "40000|40001");

    // Emptied, then moved every fifth record, then emptied; under the scanning caption.
    EXPECT_EQ(progress.steps, QStringList{context.caption(45)});
    EXPECT_EQ(progress.events.mid(0, 4),
              (QStringList{"clear", "step " + context.caption(45), "4/40000", "9/40000"}));
    EXPECT_EQ(progress.events.mid(progress.events.size() - 2),
              (QStringList{"39999/40000", "clear"}));
    EXPECT_EQ(progress.events.size(), 2 + kRecords / 5 + 1);
}

TEST_F(DocumentReaderTest, MissingOrEmptyFilesReadNothingAndUpperCaseNamesAreFound) {
    struct Case {
        QString onDisk;  // empty: no file
        int documents;
        qint64 recordCount;
        QString range;
    };
    const Case cases[] = {
        {"", 0, 0, "0|0"},
        {"dlvnote.dbf", 0, 0, "0|0"},
        {"DLVNOTE.DBF", 2, 2, "2|3"},
        {"Dlvnote.Dbf", 1, 1, "1|2"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.onDisk.toStdString());
        for (const QString& name : QDir(company()).entryList(QDir::Files))
            QFile::remove(company() + u'/' + name);
        if (!c.onDisk.isEmpty()) writeDocuments(c.onDisk, documents(c.documents));
        freshWorkDatabase();
        setRange(0, 0);
        const StockDocScan scan = read(options());
        EXPECT_EQ(scan.recordCount, c.recordCount);
        EXPECT_EQ(numbers().size(), c.documents);
        EXPECT_EQ(range(), c.range);
    }
    EXPECT_TRUE(messages.shown.isEmpty());
}

// tItems need not know a line's item: the line is imported all the same; the document line
// query joins tItems and so does not show it.
TEST_F(DocumentReaderTest, LinesOfItemsMissingFromTheItemsAreImportedButNotListed) {
    {
        jet::Database items = jet::Database::open(path(db::kItemDatabaseFile));
        items.execute("INSERT INTO tItems (ItemKey, ItemName) VALUES ('K1', 'one')");
        items.execute("INSERT INTO tItems (ItemKey, ItemName) VALUES ('K3', 'three')");
    }
    writeDocuments("dlvnote.dbf", {document(1, 3)});
    read(options());
    EXPECT_EQ(work("SELECT ItemKey FROM tTempDocLines ORDER BY LineNum"),
              (QStringList{"K1", "K2", "K3"}));
    EXPECT_EQ(work("qSelectDocLines"),
              (QStringList{"1|K1|one|1|Null|1|True", "3|K3|three|1|Null|1|True"}));
}

// A record the reader cannot take ends the scan: the rows read before it stay, the scan position
// stays, and the next scan reads the file again from the same place.
TEST_F(DocumentReaderTest, DamagedRecordEndsTheScanKeepingRowsAndPosition) {
    writeDocuments("dlvnote.dbf", documents(4));
    patch("dlvnote.dbf", 2, doc::kNumber, "12X");
    setRange(0, 0);
    EXPECT_THROW(read(options()), std::exception);
    EXPECT_EQ(numbers(), (QStringList{"1", "2"}));
    EXPECT_EQ(range(), "0|0");

    // A header that announces more records than the file holds.
    QFile file(company() + "/dlvnote.dbf");
    ASSERT_TRUE(file.resize(file.size() - 100));
    freshWorkDatabase();
    EXPECT_THROW(read(options()), DbfError);
    EXPECT_TRUE(numbers().isEmpty());
}

}  // namespace
}  // namespace etq::test
