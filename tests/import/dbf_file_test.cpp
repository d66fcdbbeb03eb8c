#include "import/dbf_file.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QtEndian>
#include <atomic>
#include <functional>
#include <thread>

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

    static QByteArray contents(const QString& file) {
        QFile in(file);
        return in.open(QIODevice::ReadOnly) ? in.readAll() : QByteArray();
    }
    static void write(const QString& file, const QByteArray& bytes) {
        QFile out(file);
        ASSERT_TRUE(out.open(QIODevice::WriteOnly | QIODevice::Truncate));
        ASSERT_EQ(out.write(bytes), bytes.size());
    }

    // Opens `file` and expects it refused with a message naming it and saying `expected`.
    static void expectRefused(const QString& file, const QString& expected) {
        try {
            DbfFile opened(file);
            ADD_FAILURE() << "opened";
        } catch (const DbfError& e) {
            EXPECT_TRUE(e.message().contains(file)) << e.what();
            EXPECT_TRUE(e.message().contains(expected)) << e.what();
        }
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

// A header whose lengths are off by a byte or two would shift every field into its neighbour:
// keys into garbage, prices times 256, deleted records read. Such a file is refused.
TEST_F(DbfFileTest, AHeaderThatDoesNotDescribeItsRecordsIsRefused) {
    struct Damage {
        const char* what;
        std::function<void(QByteArray&)> apply;
        QString expected;
    };
    auto setU16 = [](QByteArray& b, int at, int by) {
        qToLittleEndian<quint16>(quint16(qFromLittleEndian<quint16>(b.constData() + at) + by),
                                 b.data() + at);
    };
    auto oneRecord = [](QByteArray& b) { qToLittleEndian<quint32>(1, b.data() + 4); };
    const QString file = writeItems({milk(), milk(), milk()});
    const int header = DbfFile(file).headerLength();
    const Damage damages[] = {
        {"header one byte long", [&](QByteArray& b) { setU16(b, 8, 1); },
         QStringLiteral("the header length %1 does not fit its").arg(header + 1)},
        {"header two bytes long",
         [&](QByteArray& b) {
             setU16(b, 8, 2);
             oneRecord(b);
         },
         QStringLiteral("the header length %1 does not fit its").arg(header + 2)},
        {"header one byte short", [&](QByteArray& b) { setU16(b, 8, -1); },
         "without their terminator (0x0D)"},
        {"header two bytes short", [&](QByteArray& b) { setU16(b, 8, -2); },
         "without their terminator (0x0D)"},
        {"no terminator", [&](QByteArray& b) { b[header - 1] = ' '; },
         "without their terminator (0x0D)"},
        {"record one byte short", [&](QByteArray& b) { setU16(b, 10, -1); },
         "the record length 429 does not fit its field descriptors, which add up to 430 bytes"},
        {"record one byte long",
         [&](QByteArray& b) {
             setU16(b, 10, 1);
             oneRecord(b);
         },
         "the record length 431 does not fit"},
        {"a record without its flag", [&](QByteArray& b) { b[header + 2 * 430] = 'X'; },
         "record 3 begins with the byte 0x58, not with a deletion flag"},
    };
    const QByteArray original = contents(file);
    for (const Damage& damage : damages) {
        SCOPED_TRACE(damage.what);
        QByteArray bytes = original;
        damage.apply(bytes);
        const QString damaged = path(QStringLiteral("damaged %1.dbf").arg(damage.what));
        write(damaged, bytes);
        expectRefused(damaged, damage.expected);
    }
}

// Files written by common dBASE tools open as they are: dBASE III and Clipper by python3-dbf,
// Visual FoxPro with its 263-byte link after the header, dBASE III by shapelib, and the one NUL
// byte after the terminator that some writers add.
TEST_F(DbfFileTest, FilesOfCommonWritersOpen) {
    const QString script = QStringLiteral(
        "import dbf, sys\n"
        "for kind in sys.argv[2:]:\n"
        "    t = dbf.Table(sys.argv[1] + '/' + kind + '.dbf', 'code C(13); name C(40); qty N(8,2)',"
        " dbf_type=kind)\n"
        "    t.open(dbf.READ_WRITE)\n"
        "    t.append(('A1', 'Milk', 1.5))\n"
        "    t.append(('A2', 'Bread', 2))\n"
        "    dbf.delete(t[1])\n"
        "    t.close()\n");
    QProcess python;
    python.start(ETIQUON_PYTHON3, {"-c", script, dir_.path(), "db3", "clp", "vfp"});
    ASSERT_TRUE(python.waitForFinished(60000));
    ASSERT_EQ(python.exitCode(), 0) << python.readAllStandardError().data();
    const QString shape = path("shapelib");
    ASSERT_EQ(QProcess::execute("dbfcreate", {shape, "-s", "code", "13", "-s", "name", "40", "-n",
                                              "qty", "8", "2"}),
              0);
    ASSERT_EQ(QProcess::execute("dbfadd", {shape + ".dbf", "A1", "Milk", "1.5"}), 0);
    ASSERT_EQ(QProcess::execute("dbfadd", {shape + ".dbf", "A2", "Bread", "2"}), 0);

    // The shapelib file again, with a NUL after its terminator and the header length saying so.
    QByteArray padded = contents(shape + ".dbf");
    const int header = qFromLittleEndian<quint16>(padded.constData() + 8);
    padded.insert(header, '\0');
    qToLittleEndian<quint16>(quint16(header + 1), padded.data() + 8);
    write(path("padded.dbf"), padded);

    struct Written {
        const char* name;
        int headerLength;
        bool secondDeleted;
    };
    for (const Written& w :
         {Written{"db3", 129, true}, Written{"clp", 129, true}, Written{"vfp", 129 + 263, true},
          Written{"shapelib", 129, false}, Written{"padded", 130, false}}) {
        SCOPED_TRACE(w.name);
        const DbfFile file(path(QStringLiteral("%1.dbf").arg(w.name)));
        EXPECT_EQ(file.headerLength(), w.headerLength);
        ASSERT_EQ(file.recordCount(), 2);
        ASSERT_NE(file.field(u"name"), nullptr);
        EXPECT_EQ(file.field(u"name")->offset, 14);
        EXPECT_EQ(file.text(1, 1, 13), "A2");
        EXPECT_EQ(file.text(1, file.field(u"name")->offset, 40), "Bread");
        EXPECT_EQ(file.text(0, file.field(u"qty")->offset, 8).toDouble(), 1.5);
        EXPECT_FALSE(file.isDeleted(0));
        EXPECT_EQ(file.isDeleted(1), w.secondDeleted);
    }
}

// A pipe, a device or a folder in place of a host file is refused at once: a pipe must not
// hold the import forever, /dev/zero must not be read until memory runs out.
TEST_F(DbfFileTest, OnlyRegularFilesAreRead) {
    const QString pipe = path("pipe.dbf");
    ASSERT_EQ(::mkfifo(QFile::encodeName(pipe).constData(), 0600), 0);
    const QString zero = path("zero.dbf");
    ASSERT_TRUE(QFile::link("/dev/zero", zero));
    const QString folder = path("folder.dbf");
    ASSERT_TRUE(QDir().mkpath(folder));

    // Should an open wait on the pipe, a writer that comes and goes at once releases it.
    std::atomic<bool> done = false;
    std::thread writer([&] {
        while (!done) {
            const int fd = ::open(QFile::encodeName(pipe).constData(), O_WRONLY | O_NONBLOCK);
            if (fd >= 0) ::close(fd);
            std::this_thread::sleep_for(std::chrono::milliseconds(20));
        }
    });
    expectRefused(pipe, "it is a pipe, not a file");
    done = true;
    writer.join();
    expectRefused(zero, "it is a device, not a file");
    expectRefused(folder, "it is a folder, not a file");
}

// Nothing past the records the header announces is read: a file far longer than that (here
// a sparse terabyte after three items) opens at once with its three items.
TEST_F(DbfFileTest, NothingPastTheAnnouncedRecordsIsRead) {
    QList<ItemRecord> items(3, milk());
    items.last().key = "LAST";
    const QString file = writeItems(items);
    ASSERT_TRUE(QFile::resize(file, qint64(1) << 40));
    const DbfFile dbf(file);
    EXPECT_EQ(dbf.recordCount(), 3);
    EXPECT_EQ(dbf.text(2, h::oitm::kItemKey), "LAST");
}

}  // namespace
}  // namespace etq
