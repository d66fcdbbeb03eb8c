#pragma once

#include <gtest/gtest.h>

#include "support/qt_print.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "card/import_adapters.h"
#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "platform/context.h"
#include "samples/host_records.h"
#include "support/recording_messages.h"
#include "surface/memory_surface.h"

namespace etq::test {

// A company folder the tests write host files into, the connection parameters pointing at it,
// a database folder holding the delivered document database, and the headless surface.
class ImportTest : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(QDir().mkpath(company()));
        ASSERT_TRUE(QDir().mkpath(folder()));
        ASSERT_TRUE(QFile::copy(ETIQUON_DELIVERED_KDB, path(db::kDocDatabaseFile)));
        QFile::setPermissions(path(db::kDocDatabaseFile), QFile::ReadOwner | QFile::WriteOwner);
        context.connection.server = dir.path();
        context.connection.database = QStringLiteral("company");
        context.setMessages(&messages);
        surface.control("txtDBPath").setText(folder());
        surface.watchWidths([this](const QString& name, int width) {
            if (name != u"ProgressFill") return;
            widths << width;
            steps << surface.control("Message1").caption();
        });
    }

    QString company() const { return dir.filePath("company"); }
    QString folder() const { return dir.filePath("db"); }
    QString path(const QString& name) const { return db::inFolder(folder(), name); }

    template <class Record>
    void write(const QString& fileName, const QList<Record>& records) {
        demo::writeHostFile(company() + u'/' + fileName, records);
    }

    // The item database and the temporary items database as a run prepares them.
    QString prepareTempDatabase() {
        const QString items = path(db::kItemDatabaseFile);
        if (!QFile::exists(items)) {
            db::CreateItemDatabase(items);
            db::AddAccountTables(items);
        }
        return db::CreateTempItemDatabase(path(db::kTempItemDatabaseFile), items);
    }

    // Rows of a statement as "a|b|c" texts, Null written as "Null".
    QStringList rows(const QString& file, const QString& sql) const {
        jet::Database db = jet::Database::open(path(file));
        QStringList out;
        for (jet::Recordset rs = db.openRecordset(sql); !rs.eof(); rs.moveNext()) {
            QStringList cells;
            for (int i = 0; i < rs.fieldCount(); ++i)
                cells << (rs.value(i).isNull() ? QString("Null") : vb::toText(rs.value(i)));
            out << cells.join(u'|');
        }
        return out;
    }

    static demo::ItemRecord item(const QString& key, const QString& name = "x", qint32 price = 0) {
        demo::ItemRecord record;
        record.key = key;
        record.name = name;
        record.prices[0] = {price, {}};
        return record;
    }

    QTemporaryDir dir;
    MemorySurface surface;
    RecordingMessages messages;
    Context context;
    QList<int> widths;  // every width the progress bar took
    QStringList steps;  // Message1 at each of those moments
};

}  // namespace etq::test
