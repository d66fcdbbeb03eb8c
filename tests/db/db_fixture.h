#pragma once

#include <gtest/gtest.h>

#include "support/jet_rows.h"
#include "support/qt_print.h"

#include <QFile>
#include <QTemporaryDir>
#include <optional>

#include "db/file_names.h"
#include "db/local_databases.h"
#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "platform/failure.h"

namespace etq::db::test {

// What a routine threw: the description and, for our own failures, their title.
struct Failed {
    QString description;
    QString title;
};

// A database folder as a first run leaves it: the delivered document database, an item
// database with its account tables, and a log database.
class DbFolderTest : public ::testing::Test {
  protected:
    void SetUp() override {
        ASSERT_TRUE(QFile::copy(ETIQUON_DELIVERED_KDB, path(kDocDatabaseFile)));
        QFile::setPermissions(path(kDocDatabaseFile), QFile::ReadOwner | QFile::WriteOwner);
        CreateItemDatabase(path(kItemDatabaseFile));
        AddAccountTables(path(kItemDatabaseFile));
        CreateLogDatabase(path(kLogDatabaseFile));
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
};

// The failure `work` throws, or nothing when it runs to its end.
template <class Work>
std::optional<Failed> failureOf(Work&& work) {
    try {
        work();
        return std::nullopt;
    } catch (const std::exception& e) {
        const auto* ours = dynamic_cast<const Failure*>(&e);
        return Failed{describe(e), ours ? ours->title() : QString()};
    }
}

}  // namespace etq::db::test
