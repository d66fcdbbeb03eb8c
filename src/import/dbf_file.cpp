#include "import/dbf_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <QtEndian>
#include <cerrno>
#include <cstring>

#include "platform/codepage1255.h"
#include "platform/unique_fd.h"

namespace etq {

namespace {

constexpr int kFileHeaderSize = 32;
constexpr int kDescriptorSize = 32;
constexpr char kHeaderTerminator = 0x0D;
// Visual FoxPro tables keep the path of their database container (or NULs) after the
// terminator; they say so in the version byte.
constexpr int kFoxProBacklinkSize = 263;

quint16 u16At(const char* p) {
    return qFromLittleEndian<quint16>(p);
}
quint32 u32At(const char* p) {
    return qFromLittleEndian<quint32>(p);
}

bool isFoxPro(char version) {
    return version == 0x30 || version == 0x31 || version == 0x32;
}

// Padding in a text field: blanks, and the NUL bytes some writers leave in unused fields.
bool isPadding(char c) {
    return c == ' ' || c == '\0';
}

bool isDeletionFlag(char c) {
    return c == ' ' || c == '*';
}

QString systemError(int error) {
    return QString::fromLocal8Bit(std::strerror(error));
}

QString kindOf(mode_t mode) {
    if (S_ISFIFO(mode)) return QStringLiteral("a pipe");
    if (S_ISCHR(mode) || S_ISBLK(mode)) return QStringLiteral("a device");
    if (S_ISDIR(mode)) return QStringLiteral("a folder");
    if (S_ISSOCK(mode)) return QStringLiteral("a socket");
    return QStringLiteral("no regular file");
}

// Reads `size` bytes at `offset`; fewer only where the file ends. -1 on a read error.
qint64 readAt(int fd, char* into, qint64 size, qint64 offset) {
    qint64 done = 0;
    while (done < size) {
        const ssize_t n = ::pread(fd, into + done, size_t(size - done), offset + done);
        if (n < 0 && errno == EINTR) continue;
        if (n < 0) return -1;
        if (n == 0) break;
        done += n;
    }
    return done;
}

}  // namespace

DbfFile::DbfFile(const QString& path) : path_(path) {
    // Without O_NONBLOCK a pipe in the file's place would hold the open until a writer came.
    const UniqueFd fd(
        ::open(QFile::encodeName(path_).constData(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    if (!fd.isOpen())
        throw DbfError(QStringLiteral("Cannot open %1: %2").arg(path_, systemError(errno)));
    struct stat info;
    if (::fstat(fd.get(), &info) != 0)
        throw DbfError(QStringLiteral("Cannot read %1: %2").arg(path_, systemError(errno)));
    if (!S_ISREG(info.st_mode))
        fail(QStringLiteral("it is %1, not a file").arg(kindOf(info.st_mode)));
    readContents(fd.get(), info.st_size);
    readFieldDescriptors();
    checkDeletionFlags();
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

// Reads the header, then the records it announces and not a byte more: whatever follows them
// (the end mark, or anything else) is never read.
void DbfFile::readContents(int fd, qint64 fileSize) {
    contents_.resize(kFileHeaderSize);
    const qint64 header = readAt(fd, contents_.data(), kFileHeaderSize, 0);
    if (header < 0)
        throw DbfError(QStringLiteral("Cannot read %1: %2").arg(path_, systemError(errno)));
    if (header < kFileHeaderSize)
        fail(QStringLiteral("it is %1 bytes long, shorter than a dBASE header (32 bytes)")
                 .arg(header));
    readHeader(fileSize);
    const qint64 needed = headerLength_ + recordCount_ * recordLength_;
    contents_.resize(needed);
    const qint64 rest =
        readAt(fd, contents_.data() + kFileHeaderSize, needed - kFileHeaderSize, kFileHeaderSize);
    if (rest < 0)
        throw DbfError(QStringLiteral("Cannot read %1: %2").arg(path_, systemError(errno)));
    // What was read is what counts: a file the host shortens meanwhile fails like a short one.
    readHeader(kFileHeaderSize + rest);
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
    int pos = kFileHeaderSize;
    for (; pos < headerLength_ && contents_[pos] != kHeaderTerminator; pos += kDescriptorSize) {
        if (pos + kDescriptorSize > headerLength_) break;
        const char* d = contents_.constData() + pos;
        DbfField field;
        field.name = decode1255(QByteArrayView(d, qstrnlen(d, 11)));
        field.type = d[11];
        field.length = static_cast<unsigned char>(d[16]);
        field.decimals = static_cast<unsigned char>(d[17]);
        fields_.append(field);
    }
    if (pos >= headerLength_ || contents_[pos] != kHeaderTerminator)
        fail(QStringLiteral("its field descriptors run to the header length %1 without their "
                            "terminator (0x0D)")
                 .arg(headerLength_));
    checkHeaderLength(pos);
    placeFields();
}

void DbfFile::checkHeaderLength(int terminator) const {
    const int end = terminator + 1;
    if (headerLength_ == end) return;
    // Some writers leave one NUL byte after the terminator.
    if (headerLength_ == end + 1 && contents_[end] == '\0') return;
    if (isFoxPro(contents_[0]) && headerLength_ == end + kFoxProBacklinkSize) return;
    fail(QStringLiteral("the header length %1 does not fit its %2 field descriptors, whose "
                        "terminator (0x0D) is byte %3")
             .arg(headerLength_)
             .arg(fields_.size())
             .arg(terminator));
}

// The fields' lengths must add up to the record length. Clipper and FoxPro write a text field
// longer than 255 bytes with the high byte of its length in the decimals; such a file adds up
// only when read that way.
void DbfFile::placeFields() {
    int plain = 1;
    int wide = 1;
    for (const DbfField& f : fields_) {
        plain += f.length;
        wide += f.type == 'C' ? f.length + 256 * f.decimals : f.length;
    }
    if (plain != recordLength_ && wide != recordLength_)
        fail(QStringLiteral("the record length %1 does not fit its field descriptors, which add "
                            "up to %2 bytes with the deletion flag")
                 .arg(recordLength_)
                 .arg(plain));
    int offset = 1;
    for (DbfField& f : fields_) {
        if (plain != recordLength_ && f.type == 'C') {
            f.length += 256 * f.decimals;
            f.decimals = 0;
        }
        f.offset = offset;
        offset += f.length;
    }
}

// A record that does not begin with its flag means the records are not where the header puts
// them. One pass over bytes already in memory: far quicker than the readers that follow.
void DbfFile::checkDeletionFlags() const {
    const char* flag = contents_.constData() + headerLength_;
    for (qint64 record = 0; record < recordCount_; ++record, flag += recordLength_) {
        if (!isDeletionFlag(*flag))
            fail(QStringLiteral("record %1 begins with the byte 0x%2, not with a deletion flag "
                                "(a blank or '*')")
                     .arg(record + 1)
                     .arg(uchar(*flag), 2, 16, QLatin1Char('0')));
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
