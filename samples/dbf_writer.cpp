#include "samples/dbf_writer.h"

#include <QtEndian>
#include <stdexcept>

#include "platform/codepage1255.h"

namespace etq::demo {

namespace {

constexpr char kVersionDbase3 = 0x03;
constexpr char kHebrewWindowsDriver = 0x7D;  // language driver id of code page 1255
constexpr char kHeaderTerminator = 0x0D;
constexpr char kEndOfFile = 0x1A;
constexpr int kMaxCharWidth = 254;
constexpr int kMaxNameLength = 10;

std::runtime_error fileError(const QFile& file, const char* doing) {
    return std::runtime_error(
        QStringLiteral("Cannot %1 %2: %3")
            .arg(QLatin1StringView(doing), file.fileName(), file.errorString())
            .toStdString());
}

void appendFillers(QList<host::PlacedField>& fields, int from, int to) {
    for (int at = from; at < to; at += kMaxCharWidth)
        fields.append({"FILL" + QByteArray::number(at).rightJustified(4, '0'), 'C', at,
                       std::min(kMaxCharWidth, to - at), 0});
}

QByteArray fieldDescriptor(const host::PlacedField& field) {
    QByteArray d(32, '\0');
    d.replace(0, field.name.size(), field.name);
    d[11] = field.type;
    qToLittleEndian<quint32>(quint32(field.offset), d.data() + 12);
    d[16] = char(field.width);
    d[17] = char(field.decimals);
    return d;
}

}  // namespace

QList<host::PlacedField> describeRecord(const host::HostLayout& layout) {
    QList<host::PlacedField> described;
    int next = 1;
    for (const host::PlacedField& field : host::placedFields(layout)) {
        if (field.offset < next || field.width < 1 || field.width > 255 ||
            field.name.size() > kMaxNameLength)
            throw std::logic_error("layout field " + field.name.toStdString() +
                                   " overlaps another or cannot be described");
        appendFillers(described, next, field.offset);
        described.append(field);
        next = field.offset + field.width;
    }
    if (next > layout.recordLength)
        throw std::logic_error("layout fields go past the record length");
    appendFillers(described, next, layout.recordLength);
    return described;
}

DbfRecord::DbfRecord(int length) : bytes_(length, ' ') {}

void DbfRecord::setDeleted(bool deleted) {
    bytes_[0] = deleted ? '*' : ' ';
}

char* DbfRecord::place(int offset, qsizetype length, int width) {
    if (offset < 1 || width < 0 || offset + width > bytes_.size())
        throw std::invalid_argument("field at offset " + std::to_string(offset) +
                                    " lies outside the record");
    if (length > width)
        throw std::invalid_argument(std::to_string(length) + " bytes do not fit the " +
                                    std::to_string(width) + "-byte field at offset " +
                                    std::to_string(offset));
    return bytes_.data() + offset;
}

void DbfRecord::setText(FixedField field, QStringView text) {
    const QByteArray encoded = encode1255(text, Unmappable::QuestionMark);
    char* at = place(field.offset, encoded.size(), field.width);
    std::fill_n(at, field.width, ' ');
    std::copy(encoded.begin(), encoded.end(), at);
}

void DbfRecord::setNumberText(FixedField field, QStringView text) {
    const QByteArray encoded = encode1255(text, Unmappable::QuestionMark);
    char* at = place(field.offset, encoded.size(), field.width);
    std::fill_n(at, field.width, ' ');
    std::copy(encoded.begin(), encoded.end(), at + field.width - encoded.size());
}

void DbfRecord::setNumber(FixedField field, qint64 value) {
    setNumberText(field, QString::number(value));
}

void DbfRecord::setNumber(FixedField field, double value, int decimals) {
    setNumberText(field, QString::number(value, 'f', decimals));
}

void DbfRecord::setDate(FixedField field, QDate date) {
    setText(field, date.isValid() ? date.toString(u"yyyyMMdd") : QString());
}

void DbfRecord::setInt32(FixedField field, qint32 value) {
    qToLittleEndian<qint32>(value, place(field.offset, 4, field.width));
}

void DbfRecord::setBytes(int offset, QByteArrayView bytes) {
    std::copy(bytes.begin(), bytes.end(), place(offset, bytes.size(), int(bytes.size())));
}

DbfWriter::DbfWriter(const QString& path, const host::HostLayout& layout, QDate lastUpdate)
    : file_(path), recordLength_(layout.recordLength) {
    const QList<host::PlacedField> fields = describeRecord(layout);
    if (!file_.open(QIODevice::WriteOnly | QIODevice::Truncate)) throw fileError(file_, "write");
    const int headerLength = 32 + 32 * int(fields.size()) + 1;
    QByteArray header(32, '\0');
    header[0] = kVersionDbase3;
    header[1] = char(lastUpdate.year() - 1900);
    header[2] = char(lastUpdate.month());
    header[3] = char(lastUpdate.day());
    qToLittleEndian<quint16>(quint16(headerLength), header.data() + 8);
    qToLittleEndian<quint16>(quint16(recordLength_), header.data() + 10);
    header[29] = kHebrewWindowsDriver;
    for (const host::PlacedField& field : fields)
        header += fieldDescriptor(field);
    header += kHeaderTerminator;
    write(header);
}

DbfWriter::~DbfWriter() = default;

void DbfWriter::write(QByteArrayView bytes) {
    if (file_.write(bytes.data(), bytes.size()) != bytes.size()) throw fileError(file_, "write");
}

void DbfWriter::append(const DbfRecord& record) {
    if (record.bytes().size() != recordLength_)
        throw std::invalid_argument("record length differs from the file's");
    write(record.bytes());
    ++count_;
}

void DbfWriter::close() {
    write(QByteArrayView(&kEndOfFile, 1));
    char count[4];
    qToLittleEndian<quint32>(quint32(count_), count);
    if (!file_.seek(4)) throw fileError(file_, "write");
    write(QByteArrayView(count, 4));
    if (!file_.flush()) throw fileError(file_, "write");
    file_.close();
}

}  // namespace etq::demo
