#include "import/dbf_file.h"

#include <QFile>
#include <QtEndian>

#include "platform/codepage1255.h"

namespace etq {

namespace {

constexpr int kFileHeaderSize = 32;
constexpr int kDescriptorSize = 32;
constexpr char kHeaderTerminator = 0x0D;

quint16 u16At(const char* p) {
    return qFromLittleEndian<quint16>(p);
}
quint32 u32At(const char* p) {
    return qFromLittleEndian<quint32>(p);
}

// Padding in a text field: blanks, and the NUL bytes some writers leave in unused fields.
bool isPadding(char c) {
    return c == ' ' || c == '\0';
}

}  // namespace

DbfError::DbfError(QString message) : message_(std::move(message)), utf8_(message_.toUtf8()) {}

DbfFile::DbfFile(const QString& path) : path_(path) {
    QFile file(path_);
    if (!file.open(QIODevice::ReadOnly))
        throw DbfError(QStringLiteral("Cannot open %1: %2").arg(path_, file.errorString()));
    contents_ = file.readAll();
    if (file.error() != QFileDevice::NoError)
        throw DbfError(QStringLiteral("Cannot read %1: %2").arg(path_, file.errorString()));
    // What was read is what counts: a file the host shortens meanwhile fails the checks below.
    const qint64 size = contents_.size();
    if (size < kFileHeaderSize)
        fail(QStringLiteral("it is %1 bytes long, shorter than a dBASE header (32 bytes)")
                 .arg(size));
    readHeader(size);
    readFieldDescriptors();
}

DbfFile::DbfFile(const QString& path, qint64 firstRecord) : path_(path) {
    QFile file(path_);
    if (!file.open(QIODevice::ReadOnly))
        throw DbfError(QStringLiteral("Cannot open %1: %2").arg(path_, file.errorString()));
    const qint64 size = file.size();
    contents_ = file.read(kFileHeaderSize);
    if (contents_.size() < kFileHeaderSize)
        fail(QStringLiteral("it is %1 bytes long, shorter than a dBASE header (32 bytes)")
                 .arg(contents_.size()));
    contents_ += file.read(qMax(0, int(u16At(contents_.constData() + 8)) - kFileHeaderSize));
    readHeader(size);
    if (contents_.size() < headerLength_) fail(QStringLiteral("it ends inside its header"));
    readFieldDescriptors();

    firstRecord_ = qBound<qint64>(0, firstRecord, recordCount_);
    const qint64 wanted = (recordCount_ - firstRecord_) * recordLength_;
    QByteArray records;
    if (wanted > 0 && file.seek(headerLength_ + firstRecord_ * recordLength_))
        records = file.read(wanted);
    if (file.error() != QFileDevice::NoError)
        throw DbfError(QStringLiteral("Cannot read %1: %2").arg(path_, file.errorString()));
    if (records.size() < wanted)
        fail(QStringLiteral("it ended after %1 of the %2 bytes of records %3 to %4")
                 .arg(records.size())
                 .arg(wanted)
                 .arg(firstRecord_ + 1)
                 .arg(recordCount_));
    contents_ += records;
}

DbfFile::~DbfFile() = default;
DbfFile::DbfFile(DbfFile&&) noexcept = default;
DbfFile& DbfFile::operator=(DbfFile&&) noexcept = default;

void DbfFile::fail(const QString& what) const {
    throw DbfError(QStringLiteral("%1 is not a readable dBASE file: %2").arg(path_, what));
}

void DbfFile::readHeader(qint64 fileSize) {
    recordCount_ = u32At(contents_.constData() + 4);
    headerLength_ = u16At(contents_.constData() + 8);
    recordLength_ = u16At(contents_.constData() + 10);
    if (headerLength_ < kFileHeaderSize + 1)
        fail(QStringLiteral("the header length %1 is less than 33 bytes").arg(headerLength_));
    if (headerLength_ > fileSize)
        fail(QStringLiteral("the header length %1 goes past the end of the file (%2 bytes)")
                 .arg(headerLength_)
                 .arg(fileSize));
    if (recordLength_ == 0) fail(QStringLiteral("the record length is 0"));
    const qint64 needed = headerLength_ + recordCount_ * recordLength_;
    if (fileSize < needed)
        fail(
            QStringLiteral(
                "the header announces %1 records of %2 bytes after %3 header bytes, %4 bytes in all, but the file has only %5 bytes")
                .arg(recordCount_)
                .arg(recordLength_)
                .arg(headerLength_)
                .arg(needed)
                .arg(fileSize));
}

void DbfFile::readFieldDescriptors() {
    int offset = 1;
    for (int pos = kFileHeaderSize;
         pos + kDescriptorSize <= headerLength_ && contents_[pos] != kHeaderTerminator;
         pos += kDescriptorSize) {
        const char* d = contents_.constData() + pos;
        DbfField field;
        field.name = decode1255(QByteArrayView(d, qstrnlen(d, 11)));
        field.type = d[11];
        field.length = static_cast<unsigned char>(d[16]);
        field.decimals = static_cast<unsigned char>(d[17]);
        field.offset = offset;
        offset += field.length;
        fields_.append(field);
    }
}

const DbfField* DbfFile::field(QStringView name) const {
    for (const DbfField& f : fields_)
        if (name.compare(f.name, Qt::CaseInsensitive) == 0) return &f;
    return nullptr;
}

void DbfFile::requireRecordLength(int length, const QString& what) const {
    if (recordLength_ < length)
        throw DbfError(
            QStringLiteral("%1: its records are %2 bytes long, shorter than the %3 (%4 bytes)")
                .arg(path_)
                .arg(recordLength_)
                .arg(what)
                .arg(length));
}

void DbfFile::failAccess(qint64 record, int offset, int width) const {
    throw DbfError(
        QStringLiteral(
            "%1: cannot read %2 bytes at offset %3 of record %4: the file has %5 records of %6 bytes")
            .arg(path_)
            .arg(width)
            .arg(offset)
            .arg(record)
            .arg(recordCount_)
            .arg(recordLength_));
}

QByteArrayView DbfFile::record(qint64 record) const {
    return QByteArrayView(at(record, 0, recordLength_), recordLength_);
}

bool DbfFile::isDeleted(qint64 record) const {
    return *at(record, 0, 1) == '*';
}

QString DbfFile::text(qint64 record, int offset, int width) const {
    const char* begin = at(record, offset, width);
    const char* end = begin + width;
    while (begin < end && isPadding(*begin))
        ++begin;
    while (end > begin && isPadding(end[-1]))
        --end;
    return decode1255(QByteArrayView(begin, end));
}

QString DbfFile::rawText(qint64 record, int offset, int width) const {
    return decode1255(QByteArrayView(at(record, offset, width), width));
}

qint32 DbfFile::int32(qint64 record, int offset) const {
    return qFromLittleEndian<qint32>(at(record, offset, 4));
}

QByteArrayView DbfFile::bytes(qint64 record, int offset, int width) const {
    return QByteArrayView(at(record, offset, width), width);
}

}  // namespace etq
