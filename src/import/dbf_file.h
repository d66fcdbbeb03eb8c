#pragma once

#include <QByteArray>
#include <QByteArrayView>
#include <QList>
#include <QString>

#include "platform/failure.h"

namespace etq {

// A host file that cannot be read as a dBASE file, or a read outside its records. The message
// names the file and says what is wrong.
class DbfError : public HostFileDamaged {
  public:
    using HostFileDamaged::HostFileDamaged;
    const QString& message() const { return description(); }
};

// A field at a fixed place in a record: byte offset from the record's start (byte 0 is the
// deletion flag) and width in bytes.
struct FixedField {
    int offset = 0;
    int width = 0;
};

// A field descriptor of the file's header, as the file describes itself.
struct DbfField {
    QString name;
    char type = 'C';
    int length = 0;
    int decimals = 0;
    int offset = 0;  // from the record's start: the first field starts at 1
};

// A host dBASE file opened for reading. The host's readers take fields at fixed offsets, so
// the field descriptors are parsed for inspection only. The file's records are read into
// memory when it is opened (one read of a few tens of megabytes at most): the host package may
// rewrite its files while we read them, and a mapped file cut short under us would kill the
// process on the next access instead of failing cleanly.
//
// Only a regular file is read (a pipe or a device in its place is refused without waiting on
// it), and never more of it than its header announces. The header must describe the records
// exactly: the descriptors end in their terminator (0x0D) where the header length says, give
// or take the one blank byte some writers add and Visual FoxPro's 263-byte link to its
// database container; the field lengths add up to the record length; and every record begins
// with its deletion flag. A header length or record length that is off by a byte or two would
// otherwise shift every field into its neighbour without a word. Every access is checked too
// (the field against the record length, the record against the record count). A failure
// throws DbfError and nothing is ever read past a record or the file.
class DbfFile {
  public:
    // Opens and validates `path`; throws DbfError.
    explicit DbfFile(const QString& path);
    // The same, reading only the records from `firstRecord` (0-based) on: a scan that goes on
    // where the last one ended need not read a long file whole. The records before it cannot be
    // accessed; a first record beyond the last reads none (the header only).
    DbfFile(const QString& path, qint64 firstRecord);
    ~DbfFile();
    DbfFile(DbfFile&&) noexcept;
    DbfFile& operator=(DbfFile&&) noexcept;

    const QString& path() const { return path_; }
    qint64 recordCount() const { return recordCount_; }
    qint64 firstRecord() const { return firstRecord_; }  // the first record read
    int headerLength() const { return headerLength_; }
    int recordLength() const { return recordLength_; }
    const QList<DbfField>& fields() const { return fields_; }
    // The descriptor called `name` (case-insensitive), or nullptr.
    const DbfField* field(QStringView name) const;

    // A reader whose layout needs `length` bytes a record calls this first; a shorter record
    // throws DbfError naming `what` (the layout, e.g. "item record").
    void requireRecordLength(int length, const QString& what) const;

    // Record access. `record` counts from 0. Bytes returned point into the file's contents
    // and stay valid while this object lives.
    QByteArrayView record(qint64 record) const;
    bool isDeleted(qint64 record) const;
    // Windows-1255 text, trimmed of leading and trailing blanks (spaces, and the NUL bytes
    // some writers leave in unused fields).
    QString text(qint64 record, int offset, int width) const;
    QString text(qint64 record, FixedField field) const {
        return text(record, field.offset, field.width);
    }
    // The same, untrimmed.
    QString rawText(qint64 record, int offset, int width) const;
    QString rawText(qint64 record, FixedField field) const {
        return rawText(record, field.offset, field.width);
    }
    // Signed 32-bit little-endian integer.
    qint32 int32(qint64 record, int offset) const;
    QByteArrayView bytes(qint64 record, int offset, int width) const;
    QByteArrayView bytes(qint64 record, FixedField field) const {
        return bytes(record, field.offset, field.width);
    }

  private:
    void readContents(int fd, qint64 fileSize);
    void readHeader(qint64 fileSize);
    void readFieldDescriptors();
    void checkHeaderLength(int terminator) const;
    void placeFields();
    void checkDeletionFlags() const;
    [[noreturn]] void fail(const QString& what) const;
    const char* at(qint64 record, int offset, int width) const {
        if (record < firstRecord_ || record >= recordCount_ || offset < 0 || width < 0 ||
            offset > recordLength_ - width)
            failAccess(record, offset, width);
        return contents_.constData() + headerLength_ + (record - firstRecord_) * recordLength_ +
               offset;
    }
    [[noreturn]] void failAccess(qint64 record, int offset, int width) const;

    QString path_;
    QByteArray contents_;
    qint64 recordCount_ = 0;
    qint64 firstRecord_ = 0;  // the first record read into contents_, after the header
    int headerLength_ = 0;
    int recordLength_ = 0;
    QList<DbfField> fields_;
};

}  // namespace etq
