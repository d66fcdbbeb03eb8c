#include "db/db_values.h"

#include "jet/vb.h"

namespace etq::db {

QString RemoveQuoteChars(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return {};
    QString text = vb::toText(value);
    text.removeIf([](QChar c) { return c == u'\'' || c == u'"' || c == u','; });
    return text;
}

qint16 CopiesFromQuantity(double quantity) {
    const qint64 whole = vb::roundHalfEven(quantity);
    if (whole > 999 || whole < -999) return 999;
    return qint16(whole < 0 ? -whole : whole);
}

QDate ParseDayMonthYear(const QString& text) {
    // The first "/" is looked for from the first character, the second from the fourth, so
    // that a one-digit day still finds its own separator first.
    const qsizetype first = text.indexOf(u'/');
    if (first < 0) return {};
    const qsizetype second = text.indexOf(u'/', 3);
    if (second <= first) return {};
    bool okDay = false, okMonth = false, okYear = false;
    const int day = text.left(first).trimmed().toInt(&okDay);
    const int month = text.mid(first + 1, second - first - 1).trimmed().toInt(&okMonth);
    int year = text.mid(second + 1).trimmed().toInt(&okYear);
    if (!okDay || !okMonth || !okYear) return {};
    if (year >= 80 && year <= 99)
        year += 1900;
    else if (year >= 0 && year <= 79)
        year += 2000;
    return vb::dateSerial(year, month, day);
}

}  // namespace etq::db
