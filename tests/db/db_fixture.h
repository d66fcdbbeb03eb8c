#pragma once

#include <gtest/gtest.h>

#include "support/qt_print.h"

#include <QFile>
#include <QTemporaryDir>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "support/recording_messages.h"

namespace etq::db::test {

// A database folder as a first run leaves it: the delivered document database, an item
// database with its account tables, and a log database.
class DbFolderTest : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(QFile::copy(ETIQUON_DELIVERED_KDB, path(kDocDatabaseFile)));
        QFile::setPermissions(path(kDocDatabaseFile), QFile::ReadOwner | QFile::WriteOwner);
        ASSERT_FALSE(CreateItemDatabase(path(kItemDatabaseFile)).isEmpty());
        ASSERT_FALSE(AddAccountTables(path(kItemDatabaseFile)).isEmpty());
        ASSERT_FALSE(CreateLogDatabase(path(kLogDatabaseFile)).isEmpty());
    }

    QString path(const QString& name) const { return inFolder(dir.path(), name); }

    QString createWork(bool withLog = true) {
        return CreateDocDatabase(path(kDocDatabaseFile), path(kItemDatabaseFile),
                                 path(kWorkDatabaseFile),
                                 withLog ? path(kLogDatabaseFile) : QString());
    }

    // Rows as "a|b|c" texts, values written as the component writes them.
    static QStringList rows(jet::Database& db, const QString& sql) {
        QStringList out;
        jet::Recordset rs = db.openRecordset(sql);
        for (; !rs.eof(); rs.moveNext()) {
            QStringList cells;
            for (int i = 0; i < rs.fieldCount(); ++i) {
                const QVariant v = rs.value(i);
                cells << (v.isNull() ? QString("Null") : vb::toText(v));
            }
            out << cells.join(u'|');
        }
        return out;
    }

    QTemporaryDir dir;
    etq::test::RecordingMessages messages;
};

}  // namespace etq::db::test
