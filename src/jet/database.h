#pragma once

#include <QList>
#include <QString>
#include <QStringList>
#include <memory>

#include "jet/error.h"
#include "jet/types.h"

namespace etq::jet {

namespace detail {
class Connection;
}
class Recordset;

// The collating locale every file of the component records: Hebrew sort order, code page 1255.
inline const QString kHebrewLocale = QStringLiteral(";LANGID=0x040D;CP=1255;COUNTRY=0");

// One database file of the component, opened shared and read-write. Its tables, links and
// saved queries are defined here; its data is reached through execute() and recordsets.
// Copies share the same open file; close() closes it for all of them.
class Database {
  public:
    Database() = default;

    // Creates a new file. Creating over an existing file fails (3204): callers delete first.
    static Database create(const QString& path, const QString& locale = kHebrewLocale);
    // Opens an existing file (3024 when it is missing, 3343 when it is not a database of ours).
    static Database open(const QString& path);

    bool isOpen() const { return bool(conn_); }
    void close();
    QString path() const;
    QString locale() const;

    // Definitions ---------------------------------------------------------------------------
    // A table from its field list and primary key ("PrimaryKey", primary and unique).
    void createTable(const TableDef& def);
    // The definition of a local or linked table, as the file records it (3078 when none).
    TableDef tableDef(const QString& name) const;
    bool hasTable(const QString& name) const;
    QStringList tableNames() const;  // local tables, then links, each in creation order

    // Links the table of the same name in another database file. The file and its table must
    // exist (3024, 3078); the link is kept in this file, with the file's absolute path, and
    // resolved on every open.
    void linkTable(const QString& name, const QString& sourcePath, const QString& sourceTable = {});
    QList<LinkDef> links() const;

    // Saved queries keep their text exactly as given.
    void createQuery(const QString& name, const QString& sql);
    QString querySql(const QString& name) const;  // empty when there is none
    bool hasQuery(const QString& name) const;
    QStringList queryNames() const;

    // Work ----------------------------------------------------------------------------------
    // Runs an action statement, or the saved action query of that name. Rows that would break
    // a key or a field rule are skipped, as the engine does unless told to fail on errors.
    // Returns the number of rows written.
    enum ExecuteOption { SkipFailingRows, FailOnError };
    int execute(const QString& sqlOrQueryName, ExecuteOption option = SkipFailingRows);

    // A recordset over a table, a saved select query or a SELECT statement.
    Recordset openRecordset(const QString& source);

    // Memory for the pages of the file and of each file its links reach, in MiB a file; 16 for
    // the file itself until set. A run that writes a large table in one transaction gives it
    // more, so that the engine does not write (and sync) pages half-way through the transaction.
    void setCacheSize(int mebibytes);
    // The file holds nothing that must outlive a crash (a scratch file each run builds anew):
    // its writes skip the rollback journal and the syncs. The files its links reach keep both.
    void setScratch();

    void beginTrans();
    void commitTrans();
    void rollback();

    detail::Connection& connection() const;  // for the engine's own parts

  private:
    friend class StagedDatabase;
    explicit Database(std::shared_ptr<detail::Connection> conn) : conn_(std::move(conn)) {}
    // The catalog of a new file at `path`, which is missing or empty.
    static Database initialize(const QString& path, const QString& locale);
    bool nameTaken(const QString& name) const;
    void attachLinks();

    std::shared_ptr<detail::Connection> conn_;
};

// A database file that appears at its path only when it is complete. It is built under a
// temporary name in the same folder; commit() closes it, forces it to disk, renames it over
// whatever file the path held and forces the folder to disk, so that whoever opens the path,
// and whatever a kill leaves behind, finds the old file or the new one, whole. Destroyed
// without commit() (a failure while building), it deletes the temporary file and the old file
// stays as it was.
class StagedDatabase {
  public:
    // A new, empty database to be put at `path`.
    explicit StagedDatabase(const QString& path, const QString& locale = kHebrewLocale);
    // A copy of the database file `source` to be put at `path`; the copy must open as a
    // database of ours (3024, 3343).
    static StagedDatabase copyOf(const QString& source, const QString& path);
    ~StagedDatabase();
    StagedDatabase(StagedDatabase&& other) noexcept;
    StagedDatabase& operator=(StagedDatabase&&) = delete;
    StagedDatabase(const StagedDatabase&) = delete;
    StagedDatabase& operator=(const StagedDatabase&) = delete;

    // The file being built. Copies of it and recordsets on it must be gone, and no transaction
    // open, by commit().
    Database& database() { return db_; }
    // The temporary file, for messages and tests.
    const QString& stagedPath() const { return staged_; }
    // Puts the file at its path. Throws JetError when it cannot; the old file then stays.
    void commit();

  private:
    struct FileOnly {};
    StagedDatabase(FileOnly, const QString& path);  // the temporary file, still empty
    void discard() noexcept;

    QString path_;
    QString staged_;
    Database db_;
    bool done_ = false;
};

}  // namespace etq::jet
