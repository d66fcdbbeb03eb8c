#pragma once

#include <QString>

namespace etq::db {

// The files of the database folder.
inline const QString kDocDatabaseFile = QStringLiteral("etiquon.kdb");  // delivered
inline const QString kItemDatabaseFile = QStringLiteral("etqnitm.kdb");
inline const QString kLogDatabaseFile = QStringLiteral("etqnlog.kdb");
inline const QString kWorkDatabaseFile = QStringLiteral("etiqondb.tmp");
inline const QString kTempItemDatabaseFile = QStringLiteral("etiqonti.tmp");

// A file of a folder: the folder, "/", the name.
inline QString inFolder(const QString& folder, const QString& name) {
    if (folder.endsWith(u'/')) return folder + name;
    return folder + u'/' + name;
}

}  // namespace etq::db
