#pragma once

#include <QByteArray>
#include <QDate>
#include <QFile>
#include <QString>
#include <QStringView>

#include "import/dbf_file.h"
#include "import/host_layouts.h"

namespace etq::demo {

// The last-update date our files carry unless told otherwise, so that a run writes the same
// bytes every time.
inline const QDate kDefaultLastUpdate{2026, 1, 15};

// One record's bytes, blank-filled, set field by field. Setting a value that does not fit its
// field throws std::invalid_argument: test data is never cut short without a word.
class DbfRecord {
  public:
    explicit DbfRecord(int length);

    void setDeleted(bool deleted);
    // Windows-1255, left-aligned, blank-padded; a character the code page lacks becomes "?".
    void setText(FixedField field, QStringView text);
    // Decimal text right-aligned, as dBASE writes numbers; any text is written as given.
    void setNumberText(FixedField field, QStringView text);
    void setNumber(FixedField field, qint64 value);
    void setNumber(FixedField field, double value, int decimals);
    // YYYYMMDD; an invalid (null) date leaves the field blank.
    void setDate(FixedField field, QDate date);
    // Signed 32-bit little-endian.
    void setInt32(FixedField field, qint32 value);
    void setBytes(int offset, QByteArrayView bytes);

    const QByteArray& bytes() const { return bytes_; }

  private:
    char* place(int offset, qsizetype length, int width);
    QByteArray bytes_;
};

// Writes a dBASE III file whose field descriptors describe exactly the bytes of a host layout:
// the layout's fields with their names and types, and 'C' filler fields over the gaps, so any
// dBASE reader reads by field name what our readers read at fixed offsets. Records go straight
// to disk; close() puts the record count into the header and the end mark after the records.
class DbfWriter {
  public:
    // Opens `path` for writing and writes the header; throws std::runtime_error.
    DbfWriter(const QString& path, const host::HostLayout& layout,
              QDate lastUpdate = kDefaultLastUpdate);
    ~DbfWriter();

    DbfRecord newRecord() const { return DbfRecord(recordLength_); }
    void append(const DbfRecord& record);
    qint64 count() const { return count_; }
    // Finishes the file; throws std::runtime_error when the disk refuses.
    void close();

  private:
    void write(QByteArrayView bytes);

    QFile file_;
    int recordLength_ = 0;
    qint64 count_ = 0;
};

// The field descriptors DbfWriter writes for `layout`: its fields in record order with 'C'
// fillers over the gaps. Throws std::logic_error when fields overlap or leave the record.
QList<host::PlacedField> describeRecord(const host::HostLayout& layout);

}  // namespace etq::demo
