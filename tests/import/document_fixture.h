#pragma once

#include <gtest/gtest.h>

#include "support/qt_print.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "import/dbf_file.h"
#include "import/document_reader.h"
#include "jet/database.h"
#include "platform/context.h"
#include "samples/host_records.h"
#include "support/jet_rows.h"
#include "support/recording_messages.h"
#include "support/recording_progress.h"

namespace etq::test {

// A company folder for the host's document files, and a database folder as a document import
// finds it: the delivered document database, an item database, and the working database made
// from them by the component's own creation routine.
class DocumentTest : public ::testing::Test {
  protected:
    static constexpr qint16 kDeliveryNotes = 1;  // dlvnote.dbf in the delivered database
    static inline const QDate kDay{2025, 3, 10};

    void SetUp() override {
        ASSERT_TRUE(QDir().mkpath(company()));
        ASSERT_TRUE(QDir().mkpath(folder()));
        ASSERT_TRUE(QFile::copy(ETIQUON_DELIVERED_KDB, path(db::kDocDatabaseFile)));
        QFile::setPermissions(path(db::kDocDatabaseFile), QFile::ReadOwner | QFile::WriteOwner);
        ASSERT_FALSE(db::CreateItemDatabase(path(db::kItemDatabaseFile)).isEmpty());
        ASSERT_FALSE(db::AddAccountTables(path(db::kItemDatabaseFile)).isEmpty());
        freshWorkDatabase();
        context.setMessages(&messages);
    }

    QString company() const { return dir.filePath("company"); }
    QString folder() const { return dir.filePath("db"); }
    QString path(const QString& name) const { return db::inFolder(folder(), name); }

    // The working database as every import run leaves it before reading: no documents.
    void freshWorkDatabase() {
        ASSERT_FALSE(db::CreateDocDatabase(path(db::kDocDatabaseFile), path(db::kItemDatabaseFile),
                                           path(db::kWorkDatabaseFile), {})
                         .isEmpty());
    }

    void writeDocuments(const QString& fileName, const QList<demo::StockDocument>& documents) {
        demo::writeHostFile(company() + u'/' + fileName, documents);
    }

    // Overwrites a field of a written record with raw bytes, as a damaged host file holds them.
    void patch(const QString& fileName, qint64 record, FixedField field, const QByteArray& bytes) {
        const QString filePath = company() + u'/' + fileName;
        qint64 at = 0;
        {
            const DbfFile file(filePath);
            at = file.headerLength() + record * file.recordLength() + field.offset;
        }
        QFile file(filePath);
        ASSERT_TRUE(file.open(QIODevice::ReadWrite));
        ASSERT_TRUE(file.seek(at));
        ASSERT_EQ(file.write(bytes.leftJustified(field.width, ' ', true)), field.width);
    }

    StockDocReadOptions options(qint16 type = kDeliveryNotes) const {
        StockDocReadOptions o;
        o.companyFolder = company();
        o.workDbPath = path(db::kWorkDatabaseFile);
        o.wizFileType = type;
        return o;
    }
    StockDocScan read(const StockDocReadOptions& o) {
        return readStockDocuments(o, context, progress);
    }

    QStringList rows(const QString& file, const QString& sql) const {
        jet::Database db = jet::Database::open(path(file));
        return jetRows(db, sql);
    }
    QStringList work(const QString& sql) const { return rows(db::kWorkDatabaseFile, sql); }
    // Document numbers of the headers, in number order.
    QStringList numbers() const {
        return work("SELECT Number FROM tTempDocHeaders ORDER BY Number");
    }

    // The scan position of a document file as "LastIndx|FromIndx".
    QString range(qint16 type = kDeliveryNotes) const {
        const QStringList found = rows(
            db::kDocDatabaseFile,
            QStringLiteral("SELECT LastIndx, FromIndx FROM tWizFileRanges WHERE WizFileID = %1")
                .arg(type));
        return found.value(0);
    }
    void setRange(qint64 last, qint64 next, qint16 type = kDeliveryNotes) {
        jet::Database db = jet::Database::open(path(db::kDocDatabaseFile));
        db.execute(QStringLiteral("UPDATE tWizFileRanges SET LastIndx = %1, FromIndx = %2 "
                                  "WHERE WizFileID = %3")
                       .arg(last)
                       .arg(next)
                       .arg(type),
                   jet::Database::FailOnError);
    }

    static demo::DocumentLine line(const QString& key, std::optional<double> quantity = 1.0) {
        demo::DocumentLine l;
        l.itemKey = key;
        l.itemName = QStringLiteral("פריט ") + key;
        l.quantity = quantity;
        return l;
    }
    // Document `number` of one or more lines (items "K1", "K2", ...), dated kDay, reference
    // 1000 + number.
    static demo::StockDocument document(int number, int lines = 1, QDate date = kDay) {
        demo::StockDocument d;
        d.number = number;
        d.reference = QString::number(1000 + number);
        d.accountKey = QStringLiteral("20001");
        d.date = date;
        d.dueDate = date.addDays(30);
        d.customerName = QStringLiteral("מכולת אצל שמעון");
        for (int n = 1; n <= lines; ++n)
            d.lines.append(line(QStringLiteral("K%1").arg(n)));
        return d;
    }
    static QList<demo::StockDocument> documents(int count, int firstNumber = 1) {
        QList<demo::StockDocument> list;
        for (int n = 0; n < count; ++n)
            list.append(document(firstNumber + n));
        return list;
    }

    QTemporaryDir dir;
    RecordingMessages messages;
    Context context;
    RecordingProgress progress;
};

}  // namespace etq::test
