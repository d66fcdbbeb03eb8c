#include "jet/vb.h"

#include <QStringList>
#include <algorithm>
#include <cmath>
#include <limits>

namespace etq::vb {

namespace {

const QDate kSerialEpoch(1899, 12, 30);

bool isDateType(const QVariant& v) {
    const int t = v.typeId();
    return t == QMetaType::QDate || t == QMetaType::QDateTime;
}

}  // namespace

// ---------------------------------------------------------------------------------------------
// Numbers

qint64 roundHalfEven(double value) {
    const double floor = std::floor(value);
    const double diff = value - floor;
    if (diff > 0.5) return qint64(floor) + 1;
    if (diff < 0.5) return qint64(floor);
    const qint64 f = qint64(floor);
    return (f % 2 == 0) ? f : f + 1;
}

std::optional<double> toNumber(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return std::nullopt;
    switch (value.typeId()) {
        case QMetaType::Bool:
            return value.toBool() ? -1.0 : 0.0;
        case QMetaType::QDate:
            return toSerial(value.toDate());
        case QMetaType::QDateTime:
            return toSerial(value.toDateTime());
        case QMetaType::QString:
        case QMetaType::QByteArray: {
            const QString text = value.toString().trimmed();
            if (text.isEmpty()) return std::nullopt;
            bool ok = false;
            const double d = text.toDouble(&ok);
            if (!ok || !std::isfinite(d)) return std::nullopt;
            return d;
        }
        default:
            break;
    }
    bool ok = false;
    const double d = value.toDouble(&ok);
    if (!ok) return std::nullopt;
    return d;
}

template <typename T>
static std::optional<T> toWhole(const QVariant& value) {
    const std::optional<double> d = toNumber(value);
    if (!d || !std::isfinite(*d)) return std::nullopt;
    if (*d < double(std::numeric_limits<T>::min()) - 0.5 ||
        *d > double(std::numeric_limits<T>::max()) + 0.5)
        return std::nullopt;
    const qint64 r = roundHalfEven(*d);
    if (r < std::numeric_limits<T>::min() || r > std::numeric_limits<T>::max()) return std::nullopt;
    return T(r);
}

std::optional<qint16> toInteger(const QVariant& value) {
    return toWhole<qint16>(value);
}
std::optional<qint32> toLong(const QVariant& value) {
    return toWhole<qint32>(value);
}

double val(QStringView text) {
    qsizetype i = 0;
    const qsizetype n = text.size();
    auto skipBlanks = [&] {
        while (i < n &&
               (text[i] == u' ' || text[i] == u'\t' || text[i] == u'\n' || text[i] == u'\r'))
            ++i;
    };
    skipBlanks();
    if (i + 1 < n && text[i] == u'&') {
        const QChar radixChar = text[i + 1].toUpper();
        const int radix = radixChar == u'H' ? 16 : radixChar == u'O' ? 8 : 0;
        if (radix) {
            i += 2;
            qint64 result = 0;
            for (; i < n; ++i) {
                const char16_t c = text[i].toLower().unicode();
                const int digit = (c >= u'0' && c <= u'9')   ? c - u'0'
                                  : (c >= u'a' && c <= u'f') ? c - u'a' + 10
                                                             : 99;
                if (digit >= radix) break;
                result = result * radix + digit;
            }
            return double(result);
        }
    }
    QString number;
    bool seenDigit = false, seenPoint = false, seenExponent = false;
    if (i < n && (text[i] == u'-' || text[i] == u'+')) number += text[i++];
    for (; i < n; ++i) {
        const QChar c = text[i];
        if (c == u' ' || c == u'\t' || c == u'\n' || c == u'\r') continue;
        if (c.isDigit() && c.unicode() < 128) {
            number += c;
            seenDigit = true;
        } else if (c == u'.' && !seenPoint && !seenExponent) {
            number += c;
            seenPoint = true;
        } else if ((c == u'e' || c == u'E' || c == u'd' || c == u'D') && seenDigit &&
                   !seenExponent) {
            // An exponent counts only when digits follow it.
            qsizetype j = i + 1;
            QString exponent = "e";
            if (j < n && (text[j] == u'+' || text[j] == u'-')) exponent += text[j++];
            if (j < n && text[j].isDigit()) {
                number += exponent;
                seenExponent = true;
                i = j - 1;
            } else {
                break;
            }
        } else {
            break;
        }
    }
    if (!seenDigit) return 0.0;
    bool ok = false;
    const double d = number.toDouble(&ok);
    return ok ? d : 0.0;
}

double val(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return 0.0;
    if (value.typeId() == QMetaType::Bool) return value.toBool() ? -1.0 : 0.0;
    if (value.typeId() != QMetaType::QString && value.typeId() != QMetaType::QByteArray) {
        if (const auto d = toNumber(value)) return *d;
    }
    return val(QStringView(value.toString()));
}

// ---------------------------------------------------------------------------------------------
// Dates

double toSerial(QDate date) {
    return double(kSerialEpoch.daysTo(date));
}

double toSerial(const QDateTime& dateTime) {
    const double days = toSerial(dateTime.date());
    const double fraction = dateTime.time().msecsSinceStartOfDay() / 86400000.0;
    // Before the epoch the fraction still counts forward in the day, as serials do.
    return days >= 0 ? days + fraction : days - fraction;
}

QDate dateFromSerial(double serial) {
    return kSerialEpoch.addDays(qint64(std::trunc(serial)));
}

QDateTime fromSerial(double serial) {
    const double whole = std::trunc(serial);
    const double fraction = std::fabs(serial - whole);
    const int msecs = int(std::llround(fraction * 86400000.0));
    // UTC: a serial is a wall-clock time, and local time would shift it over DST changes.
    const QDateTime dt(kSerialEpoch.addDays(qint64(whole)), QTime(0, 0), Qt::UTC);
    return dt.addMSecs(msecs);
}

QDate dateSerial(int year, int month, int day) {
    // Carry the months into the year first, then let the days run over the month ends.
    int y = year + (month - 1) / 12;
    int m = (month - 1) % 12;
    if (m < 0) {
        m += 12;
        --y;
    }
    const QDate first(y, m + 1, 1);
    return first.addDays(day - 1);
}

double today() {
    return toSerial(QDate::currentDate());
}

// ---------------------------------------------------------------------------------------------
// Text

static QString numberToText(double d) {
    if (!std::isfinite(d)) return QString::number(d);
    if (d == std::trunc(d) && std::fabs(d) < 1e15) return QString::number(qint64(d));
    QString s = QString::number(d, 'g', 15);
    const qsizetype e = s.indexOf(u'e');
    if (e >= 0) {
        // 1.5e+20 -> 1.5E+20, 1e-07 -> 1E-07
        s[e] = u'E';
    }
    return s;
}

QString toText(const QVariant& value) {
    if (value.isNull() || !value.isValid()) return {};
    switch (value.typeId()) {
        case QMetaType::Bool:
            return value.toBool() ? "True" : "False";
        case QMetaType::QDate:
            return value.toDate().toString("dd/MM/yyyy");
        case QMetaType::QDateTime: {
            const QDateTime dt = value.toDateTime();
            if (dt.time() == QTime(0, 0)) return dt.date().toString("dd/MM/yyyy");
            return dt.toString("dd/MM/yyyy HH:mm:ss");
        }
        case QMetaType::Double:
        case QMetaType::Float:
            return numberToText(value.toDouble());
        default:
            break;
    }
    return value.toString();
}

// ---------------------------------------------------------------------------------------------
// Format

namespace {

// The decimal digits of |value| rounded half away from zero to `decimals` places, read from
// its 15 significant digits (so 1.005 counts as 1.005, not 1.00499999...).
struct Digits {
    QString whole;     // no leading zeros; "0" for zero
    QString fraction;  // exactly `decimals` digits
};

Digits roundedDigits(double absValue, int decimals) {
    const QString sci = QString::number(absValue, 'e', 14);  // d.dddddddddddddde±xx
    const qsizetype e = sci.indexOf(u'e');
    QString mantissa = sci.left(e);
    mantissa.remove(u'.');
    const int exponent = sci.mid(e + 1).toInt();
    // Digits with the decimal point after position pointPos.
    QString digits = mantissa;
    int pointPos = exponent + 1;
    if (pointPos <= 0) {
        digits = QString(-pointPos + 1, u'0') + digits;
        pointPos = 1;
    }
    if (digits.size() < pointPos + decimals + 1)
        digits += QString(pointPos + decimals + 1 - digits.size(), u'0');
    const int keep = pointPos + decimals;
    const bool roundUp = digits[keep] >= u'5';
    QString kept = digits.left(keep);
    if (roundUp) {
        int i = keep - 1;
        for (; i >= 0; --i) {
            if (kept[i] == u'9') {
                kept[i] = u'0';
            } else {
                kept[i] = QChar(kept[i].unicode() + 1);
                break;
            }
        }
        if (i < 0) {
            kept.prepend(u'1');
            ++pointPos;
        }
    }
    Digits out;
    out.whole = kept.left(pointPos);
    out.fraction = kept.mid(pointPos);
    while (out.whole.size() > 1 && out.whole[0] == u'0')
        out.whole.remove(0, 1);
    if (out.whole.isEmpty()) out.whole = "0";
    return out;
}

QStringList splitSections(const QString& pattern) {
    QStringList sections;
    QString current;
    bool quoted = false;
    for (qsizetype i = 0; i < pattern.size(); ++i) {
        const QChar c = pattern[i];
        if (c == u'"') quoted = !quoted;
        if (c == u'\\' && i + 1 < pattern.size()) {
            current += c;
            current += pattern[++i];
            continue;
        }
        if (c == u';' && !quoted) {
            sections << current;
            current.clear();
        } else {
            current += c;
        }
    }
    sections << current;
    return sections;
}

// A pattern element: a literal text or one placeholder character.
struct Element {
    bool literal;
    QString text;
};

QList<Element> tokenizePattern(const QString& section) {
    QList<Element> out;
    for (qsizetype i = 0; i < section.size(); ++i) {
        const QChar c = section[i];
        if (c == u'"') {
            const qsizetype end = section.indexOf(u'"', i + 1);
            const qsizetype stop = end < 0 ? section.size() : end;
            out.append({true, section.mid(i + 1, stop - i - 1)});
            i = stop;
        } else if (c == u'\\' && i + 1 < section.size()) {
            out.append({true, QString(section[++i])});
        } else {
            out.append({false, QString(c)});
        }
    }
    return out;
}

bool isDatePattern(const QString& pattern) {
    bool hasDate = false;
    for (const Element& e : tokenizePattern(pattern)) {
        if (e.literal) continue;
        const QChar c = e.text[0].toLower();
        if (c == u'0' || c == u'#') return false;
        if (QStringView(u"dmyhnswq").contains(c)) hasDate = true;
    }
    return hasDate;
}

QString formatNumberSection(double value, const QString& section, bool addMinus) {
    const QList<Element> elements = tokenizePattern(section);
    // First pass: the shape of the number.
    int intPlaceholders = 0, intZeros = 0, fracPlaceholders = 0, fracMinDigits = 0;
    bool seenPoint = false, grouping = false, percent = false;
    int lastIntPlaceholder = -1;
    for (int i = 0; i < elements.size(); ++i) {
        const Element& e = elements[i];
        if (e.literal) continue;
        const QChar c = e.text[0];
        if (c == u'0' || c == u'#') {
            if (seenPoint) {
                ++fracPlaceholders;
                if (c == u'0') fracMinDigits = fracPlaceholders;
            } else {
                ++intPlaceholders;
                if (c == u'0') ++intZeros;
                lastIntPlaceholder = i;
            }
        } else if (c == u'.' && !seenPoint) {
            seenPoint = true;
        } else if (c == u',' && !seenPoint && intPlaceholders > 0) {
            grouping = true;
        } else if (c == u'%') {
            percent = true;
        }
    }
    Q_UNUSED(lastIntPlaceholder);
    double v = std::fabs(value) * (percent ? 100.0 : 1.0);
    Digits d = roundedDigits(v, fracPlaceholders);
    QString whole = d.whole == "0" && intZeros == 0 ? QString() : d.whole;
    if (whole.size() < intZeros) whole = QString(intZeros - whole.size(), u'0') + whole;
    QString fraction = d.fraction;
    while (fraction.size() > fracMinDigits && fraction.endsWith(u'0'))
        fraction.chop(1);
    if (grouping) {
        for (qsizetype pos = whole.size() - 3; pos > 0; pos -= 3)
            whole.insert(pos, u',');
    }
    const bool isZero = d.whole == "0" && std::all_of(d.fraction.begin(), d.fraction.end(),
                                                      [](QChar c) { return c == u'0'; });

    // Second pass: write it, digits right-aligned over the whole-part placeholders.
    QString out;
    if (addMinus && value < 0 && !isZero) out += u'-';
    int intSeen = 0, fracSeen = 0;
    qsizetype wholePos = 0;
    const qsizetype extra = std::max<qsizetype>(0, whole.size() - intPlaceholders);
    bool afterPoint = false;
    for (const Element& e : elements) {
        if (e.literal) {
            out += e.text;
            continue;
        }
        const QChar c = e.text[0];
        if ((c == u'0' || c == u'#') && !afterPoint) {
            ++intSeen;
            if (grouping) {
                if (intSeen == 1) out += whole;
                continue;
            }
            // This placeholder's digit, counted from the right; the first takes any extra.
            const qsizetype slot = intPlaceholders - intSeen;  // 0 = rightmost
            const qsizetype fromRight = whole.size() - 1 - slot;
            if (intSeen == 1 && extra > 0) {
                out += whole.left(extra + 1);
                wholePos = extra + 1;
            } else if (fromRight >= 0 && fromRight >= wholePos) {
                out += whole[fromRight];
                wholePos = fromRight + 1;
            }
        } else if ((c == u'0' || c == u'#') && afterPoint) {
            if (fracSeen < fraction.size()) out += fraction[fracSeen];
            ++fracSeen;
        } else if (c == u'.' && !afterPoint) {
            afterPoint = true;
            out += u'.';
        } else if (c == u',') {
            // A thousands separator is a flag, not a character of the result.
        } else {
            out += c;
        }
    }
    return out;
}

QString formatNumber(double value, const QString& pattern) {
    const QStringList sections = splitSections(pattern);
    if (value < 0 && sections.size() >= 2 && !sections[1].isEmpty())
        return formatNumberSection(-value, sections[1], false);
    if (value == 0 && sections.size() >= 3 && !sections[2].isEmpty())
        return formatNumberSection(0, sections[2], false);
    return formatNumberSection(value, sections[0], true);
}

const char* const kMonthNames[] = {"January",   "February", "March",    "April",
                                   "May",       "June",     "July",     "August",
                                   "September", "October",  "November", "December"};
const char* const kDayNames[] = {"Monday", "Tuesday",  "Wednesday", "Thursday",
                                 "Friday", "Saturday", "Sunday"};

QString formatDate(const QDateTime& dt, const QString& pattern) {
    const QDate date = dt.date();
    const QTime time = dt.time();
    const QList<Element> elements = tokenizePattern(pattern);
    QString out;
    bool lastWasHour = false;
    bool twelveHour = false;
    for (const Element& e : elements) {
        if (!e.literal && e.text[0].toLower() == u'a') twelveHour = true;
    }
    for (qsizetype i = 0; i < elements.size();) {
        const Element& e = elements[i];
        if (e.literal) {
            out += e.text;
            ++i;
            continue;
        }
        const QChar c = e.text[0];
        const QChar lower = c.toLower();
        qsizetype run = 1;
        while (i + run < elements.size() && !elements[i + run].literal &&
               elements[i + run].text[0].toLower() == lower)
            ++run;
        // AM/PM and A/P markers.
        if (lower == u'a') {
            QString rest;
            for (qsizetype k = i; k < elements.size() && k < i + 5 && !elements[k].literal; ++k)
                rest += elements[k].text;
            const bool pm = time.hour() >= 12;
            if (rest.startsWith("AM/PM", Qt::CaseInsensitive)) {
                out += rest.startsWith(u'a') ? (pm ? "pm" : "am") : (pm ? "PM" : "AM");
                i += 5;
                continue;
            }
            if (rest.startsWith("A/P", Qt::CaseInsensitive)) {
                out += rest.startsWith(u'a') ? (pm ? "p" : "a") : (pm ? "P" : "A");
                i += 3;
                continue;
            }
        }
        bool hour = false;
        switch (lower.unicode()) {
            case u'd':
                if (run == 1)
                    out += QString::number(date.day());
                else if (run == 2)
                    out += QString::asprintf("%02d", date.day());
                else if (run == 3)
                    out += QString(kDayNames[date.dayOfWeek() - 1]).left(3);
                else if (run == 4)
                    out += kDayNames[date.dayOfWeek() - 1];
                else
                    out += date.toString("dd/MM/yyyy");
                break;
            case u'm': {
                // m right after an hour is the minute.
                const bool minute = lastWasHour && run <= 2;
                if (minute)
                    out += run == 1 ? QString::number(time.minute())
                                    : QString::asprintf("%02d", time.minute());
                else if (run == 1)
                    out += QString::number(date.month());
                else if (run == 2)
                    out += QString::asprintf("%02d", date.month());
                else if (run == 3)
                    out += QString(kMonthNames[date.month() - 1]).left(3);
                else
                    out += kMonthNames[date.month() - 1];
                break;
            }
            case u'n':
                out += run == 1 ? QString::number(time.minute())
                                : QString::asprintf("%02d", time.minute());
                break;
            case u's':
                out += run == 1 ? QString::number(time.second())
                                : QString::asprintf("%02d", time.second());
                break;
            case u'h': {
                int h = time.hour();
                if (twelveHour) h = h % 12 == 0 ? 12 : h % 12;
                out += run == 1 ? QString::number(h) : QString::asprintf("%02d", h);
                hour = true;
                break;
            }
            case u'y':
                if (run == 1)
                    out += QString::number(date.dayOfYear());
                else if (run <= 3)
                    out += QString::asprintf("%02d", date.year() % 100);
                else
                    out += QString::asprintf("%04d", date.year());
                break;
            case u'w':
                out += QString::number(date.dayOfWeek() % 7 + 1);
                break;
            case u'q':
                out += QString::number((date.month() - 1) / 3 + 1);
                break;
            default:
                out += QString(run, c);
                break;
        }
        if (lower != u' ') lastWasHour = hour || (lastWasHour && (lower == u':'));
        i += run;
    }
    return out;
}

QString namedFormat(const QString& name, const QVariant& value, bool* handled) {
    *handled = true;
    const QString n = name.toLower();
    if (n == "general number") return toText(toNumber(value).value_or(0));
    if (n == "fixed") return formatNumber(toNumber(value).value_or(0), "0.00");
    if (n == "standard") return formatNumber(toNumber(value).value_or(0), "#,##0.00");
    if (n == "percent") return formatNumber(toNumber(value).value_or(0), "0.00%");
    if (n == "currency") return formatNumber(toNumber(value).value_or(0), "#,##0.00 ₪");
    if (n == "yes/no") return toNumber(value).value_or(0) != 0 ? "Yes" : "No";
    if (n == "true/false") return toNumber(value).value_or(0) != 0 ? "True" : "False";
    if (n == "on/off") return toNumber(value).value_or(0) != 0 ? "On" : "Off";
    const double serial = toNumber(value).value_or(0);
    if (n == "short date") return formatDate(fromSerial(serial), "dd/mm/yyyy");
    if (n == "medium date") return formatDate(fromSerial(serial), "dd-mmm-yy");
    if (n == "long date") return formatDate(fromSerial(serial), "dddd, d mmmm yyyy");
    if (n == "general date") return toText(QVariant(fromSerial(serial)));
    if (n == "short time") return formatDate(fromSerial(serial), "hh:nn");
    if (n == "medium time") return formatDate(fromSerial(serial), "hh:nn AM/PM");
    if (n == "long time") return formatDate(fromSerial(serial), "hh:nn:ss");
    *handled = false;
    return {};
}

}  // namespace

QString format(const QVariant& value, const QString& pattern) {
    if (value.isNull() || !value.isValid()) return {};
    if (pattern.isEmpty()) return toText(value);
    bool handled = false;
    if (const QString named = namedFormat(pattern, value, &handled); handled) return named;
    if (isDatePattern(pattern)) {
        if (isDateType(value)) return formatDate(value.toDateTime(), pattern);
        if (const auto serial = toNumber(value)) return formatDate(fromSerial(*serial), pattern);
        return value.toString();
    }
    const std::optional<double> number = toNumber(value);
    if (!number) return value.toString();  // text that is not a number is shown as it is
    return formatNumber(*number, pattern);
}

}  // namespace etq::vb
