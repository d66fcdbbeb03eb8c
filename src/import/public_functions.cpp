#include "import/public_functions.h"

#include "jet/error.h"
#include "jet/vb.h"

namespace etq {

namespace {

QString trimBlanks(const QString& text) {
    qsizetype from = 0, to = text.size();
    while (from < to && text[from] == u' ')
        ++from;
    while (to > from && text[to - 1] == u' ')
        --to;
    return text.mid(from, to - from);
}

[[noreturn]] void notANumber(const QVariant& value) {
    jet::fail(jet::err::kTypeMismatch,
              QString("Type mismatch: '%1' is not a number.").arg(vb::toText(value)));
}
}  // namespace

QString NullToText(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return {};
    return trimBlanks(vb::toText(value));
}

QString NullToHtml(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return QStringLiteral("&nbsp;");
    return vb::toText(value).toHtmlEscaped();
}

QString QuoteToApostrophe(const QString& text) {
    QString out = text;
    out.replace(u'"', u'\'');
    return out;
}

double NullToDouble(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return 0;
    const std::optional<double> d = vb::toNumber(value);
    if (!d) notANumber(value);
    return *d;
}

QString ReplaceLineBreaks(const QVariant& value, const QString& separator) {
    if (value.isNull() || !value.isValid()) return {};
    QString text = vb::toText(value);
    text.replace(u'\r', separator);
    return text;
}

QString ToBinaryText(qint32 value) {
    return QString::number(quint32(value), 2);
}

qint32 TextToLong(const QString& text) {
    return vb::toLong(text.trimmed()).value_or(0);
}

QDate DbfDateToDate(const QString& text) {
    if (text.size() < 8) return {};
    bool okYear = false, okMonth = false, okDay = false;
    const int year = text.left(4).toInt(&okYear);
    const int month = text.mid(4, 2).toInt(&okMonth);
    const int day = text.mid(6, 2).toInt(&okDay);
    if (!okYear || !okMonth || !okDay) return {};
    return vb::dateSerial(year, month, day);
}

qint16 NullToInteger(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return 0;
    const std::optional<qint16> v = vb::toInteger(value);
    if (!v) notANumber(value);
    return *v;
}

}  // namespace etq
