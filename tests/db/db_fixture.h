#pragma once

#include <gtest/gtest.h>

#include "support/jet_rows.h"
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

    static QStringList rows(jet::Database& db, const QString& sql) {
        return etq::test::jetRows(db, sql);
    }

    QTemporaryDir dir;
    etq::test::RecordingMessages messages;
};

}  // namespace etq::db::test
