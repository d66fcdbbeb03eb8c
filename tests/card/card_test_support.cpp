#include "card_test_support.h"

#include <QDate>
#include <QFile>
#include <QtEndian>
#include <stdexcept>

namespace etq::test {

void writeEmptyDbf(const QString& path, const QByteArray& fieldName, int fieldLength) {
    QByteArray header(32, '\0');
    const QDate today = QDate::currentDate();
    header[0] = 0x03;
    header[1] = char(today.year() - 1900);
    header[2] = char(today.month());
    header[3] = char(today.day());
    qToLittleEndian<quint32>(0, header.data() + 4);                 // records
    qToLittleEndian<quint16>(32 + 32 + 1, header.data() + 8);       // header length
    qToLittleEndian<quint16>(1 + fieldLength, header.data() + 10);  // record length
    QByteArray field(32, '\0');
    field.replace(0, fieldName.size(), fieldName);
    field[11] = 'C';
    field[16] = char(fieldLength);
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly)) throw std::runtime_error("cannot write the dBASE file");
    file.write(header + field + '\x0d' + '\x1a');
}

}  // namespace etq::test
