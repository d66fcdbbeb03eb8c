// The dialect's functions and operators, as SQLite functions. The translator writes calls to
// these names; each follows the value rules of the original engine (vb.h).

#include <QDateTime>
#include <cmath>

#include "jet/connection.h"
#include "jet/vb.h"

namespace etq::jet::detail {

namespace {

QVariant arg(sqlite3_value* v) {
    switch (sqlite3_value_type(v)) {
        case SQLITE_INTEGER:
            return QVariant(qlonglong(sqlite3_value_int64(v)));
        case SQLITE_FLOAT:
            return QVariant(sqlite3_value_double(v));
        case SQLITE_TEXT:
            return QVariant(QString::fromUtf8(reinterpret_cast<const char*>(sqlite3_value_text(v)),
                                              sqlite3_value_bytes(v)));
        case SQLITE_BLOB:
            return QVariant(QByteArray(static_cast<const char*>(sqlite3_value_blob(v)),
                                       sqlite3_value_bytes(v)));
        default:
            return QVariant();
    }
}

bool isNull(sqlite3_value* v) {
    return sqlite3_value_type(v) == SQLITE_NULL;
}
bool isText(sqlite3_value* v) {
    return sqlite3_value_type(v) == SQLITE_TEXT;
}

void resultText(sqlite3_context* ctx, const QString& text) {
    const QByteArray utf8 = text.toUtf8();
    sqlite3_result_text(ctx, utf8.constData(), int(utf8.size()), SQLITE_TRANSIENT);
}

// A whole number stays whole, so that it fits integer fields and compares as one.
void resultNumber(sqlite3_context* ctx, double d) {
    if (std::isfinite(d) && d == std::trunc(d) && std::fabs(d) < 9e15)
        sqlite3_result_int64(ctx, qint64(d));
    else
        sqlite3_result_double(ctx, d);
}

void resultError(sqlite3_context* ctx, const QString& message) {
    const QByteArray utf8 = message.toUtf8();
    sqlite3_result_error(ctx, utf8.constData(), int(utf8.size()));
}

std::optional<double> number(sqlite3_context* ctx, sqlite3_value* v) {
    const std::optional<double> d = vb::toNumber(arg(v));
    if (!d)
        resultError(ctx,
                    QString("Data type mismatch in criteria expression ('%1' is not a number).")
                        .arg(vb::toText(arg(v))));
    return d;
}

void registerOne(sqlite3* db, const char* name, int argc,
                 void (*f)(sqlite3_context*, int, sqlite3_value**), bool deterministic = true) {
    const int flags = SQLITE_UTF8 | (deterministic ? SQLITE_DETERMINISTIC : 0);
    sqlite3_create_function_v2(db, name, argc, flags, nullptr, f, nullptr, nullptr, nullptr);
}

// --- operators ------------------------------------------------------------------------------

// The arithmetic operators: Null on either side gives Null, texts count when they are numbers.
// `op` returns false after it has set an error.
template <typename Op>
void arithmetic(sqlite3_context* ctx, sqlite3_value** argv, Op op) {
    if (isNull(argv[0]) || isNull(argv[1])) return sqlite3_result_null(ctx);
    const auto a = number(ctx, argv[0]);
    if (!a) return;
    const auto b = number(ctx, argv[1]);
    if (!b) return;
    op(*a, *b);
}

// + joins two texts and adds anything else; a Null on either side gives Null.
void add(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isText(argv[0]) && isText(argv[1]))
        return resultText(ctx, arg(argv[0]).toString() + arg(argv[1]).toString());
    arithmetic(ctx, argv, [ctx](double a, double b) { resultNumber(ctx, a + b); });
}

// & always joins texts; a Null side counts as the empty text.
void concat(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0]) && isNull(argv[1])) return sqlite3_result_null(ctx);
    resultText(ctx, vb::toText(arg(argv[0])) + vb::toText(arg(argv[1])));
}

void divide(sqlite3_context* ctx, int, sqlite3_value** argv) {
    arithmetic(ctx, argv, [ctx](double a, double b) {
        if (b == 0) return resultError(ctx, "Division by zero.");
        resultNumber(ctx, a / b);
    });
}

// \ and Mod round both sides to whole numbers first.
void intDivide(sqlite3_context* ctx, int, sqlite3_value** argv) {
    arithmetic(ctx, argv, [ctx](double a, double b) {
        const qint64 d = vb::roundHalfEven(b);
        if (d == 0) return resultError(ctx, "Division by zero.");
        sqlite3_result_int64(ctx, vb::roundHalfEven(a) / d);
    });
}

void modulo(sqlite3_context* ctx, int, sqlite3_value** argv) {
    arithmetic(ctx, argv, [ctx](double a, double b) {
        const qint64 d = vb::roundHalfEven(b);
        if (d == 0) return resultError(ctx, "Division by zero.");
        sqlite3_result_int64(ctx, vb::roundHalfEven(a) % d);
    });
}

void power(sqlite3_context* ctx, int, sqlite3_value** argv) {
    arithmetic(ctx, argv, [ctx](double a, double b) { resultNumber(ctx, std::pow(a, b)); });
}

// Like: * any run, ? one character, # one digit, [abc] [!abc] [a-z] one of a set; texts
// compare case-insensitively, as the engine compares text.
bool likeMatch(QStringView text, QStringView pattern) {
    qsizetype t = 0, p = 0;
    qsizetype starP = -1, starT = 0;
    auto oneMatches = [&](qsizetype& pi, QChar c) -> int {  // -1 bad pattern, 0 no, 1 yes
        const QChar pc = pattern[pi];
        if (pc == u'?') {
            ++pi;
            return 1;
        }
        if (pc == u'#') {
            ++pi;
            return c.isDigit() ? 1 : 0;
        }
        if (pc == u'[') {
            const qsizetype close = pattern.indexOf(u']', pi + 1);
            if (close < 0) return -1;
            QStringView set = pattern.mid(pi + 1, close - pi - 1);
            pi = close + 1;
            bool negate = false;
            if (set.startsWith(u'!')) {
                negate = true;
                set = set.mid(1);
            }
            bool in = false;
            const QChar lc = c.toLower();
            for (qsizetype k = 0; k < set.size(); ++k) {
                if (k + 2 < set.size() && set[k + 1] == u'-') {
                    if (lc >= set[k].toLower() && lc <= set[k + 2].toLower()) in = true;
                    k += 2;
                } else if (set[k].toLower() == lc) {
                    in = true;
                }
            }
            return in != negate ? 1 : 0;
        }
        ++pi;
        return pc.toLower() == c.toLower() ? 1 : 0;
    };
    while (t < text.size()) {
        if (p < pattern.size() && pattern[p] == u'*') {
            starP = ++p;
            starT = t;
            continue;
        }
        if (p < pattern.size()) {
            qsizetype next = p;
            const int m = oneMatches(next, text[t]);
            if (m < 0) return false;
            if (m == 1) {
                p = next;
                ++t;
                continue;
            }
        }
        if (starP < 0) return false;
        p = starP;
        t = ++starT;
    }
    while (p < pattern.size() && pattern[p] == u'*')
        ++p;
    return p == pattern.size();
}

void like(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0]) || isNull(argv[1])) return sqlite3_result_null(ctx);
    const QString text = vb::toText(arg(argv[0]));
    const QString pattern = vb::toText(arg(argv[1]));
    sqlite3_result_int(ctx, likeMatch(text, pattern) ? -1 : 0);
}

// --- functions ------------------------------------------------------------------------------

void format(sqlite3_context* ctx, int argc, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    const QString pattern = argc > 1 ? vb::toText(arg(argv[1])) : QString();
    resultText(ctx, vb::format(arg(argv[0]), pattern));
}

void val(sqlite3_context* ctx, int, sqlite3_value** argv) {
    resultNumber(ctx, vb::val(arg(argv[0])));
}

void date(sqlite3_context* ctx, int, sqlite3_value**) {
    sqlite3_result_int64(ctx, qint64(vb::today()));
}
void now(sqlite3_context* ctx, int, sqlite3_value**) {
    sqlite3_result_double(ctx, vb::toSerial(QDateTime::currentDateTime()));
}
void time(sqlite3_context* ctx, int, sqlite3_value**) {
    const double serial = vb::toSerial(QDateTime::currentDateTime());
    sqlite3_result_double(ctx, serial - std::floor(serial));
}

void left(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    resultText(ctx, vb::toText(arg(argv[0])).left(std::max(0, sqlite3_value_int(argv[1]))));
}
void right(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    resultText(ctx, vb::toText(arg(argv[0])).right(std::max(0, sqlite3_value_int(argv[1]))));
}
void mid(sqlite3_context* ctx, int argc, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    const QString s = vb::toText(arg(argv[0]));
    const int start = std::max(1, sqlite3_value_int(argv[1]));
    if (argc > 2) return resultText(ctx, s.mid(start - 1, std::max(0, sqlite3_value_int(argv[2]))));
    resultText(ctx, s.mid(start - 1));
}

// Trim, LTrim and RTrim take blanks only.
template <bool Front, bool Back>
void trim(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    QString s = vb::toText(arg(argv[0]));
    qsizetype from = 0, to = s.size();
    if (Front)
        while (from < to && s[from] == u' ')
            ++from;
    if (Back)
        while (to > from && s[to - 1] == u' ')
            --to;
    resultText(ctx, s.mid(from, to - from));
}

void nz(sqlite3_context* ctx, int argc, sqlite3_value** argv) {
    if (!isNull(argv[0])) return sqlite3_result_value(ctx, argv[0]);
    if (argc > 1) return sqlite3_result_value(ctx, argv[1]);
    resultText(ctx, QString());
}

void cint(sqlite3_context* ctx, int, sqlite3_value** argv) {
    const auto v = vb::toInteger(arg(argv[0]));
    if (!v) return resultError(ctx, "Overflow or type mismatch in CInt.");
    sqlite3_result_int64(ctx, *v);
}
void clng(sqlite3_context* ctx, int, sqlite3_value** argv) {
    const auto v = vb::toLong(arg(argv[0]));
    if (!v) return resultError(ctx, "Overflow or type mismatch in CLng.");
    sqlite3_result_int64(ctx, *v);
}
void cdbl(sqlite3_context* ctx, int, sqlite3_value** argv) {
    const auto d = number(ctx, argv[0]);
    if (d) sqlite3_result_double(ctx, *d);
}
void cstr(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return resultError(ctx, "Invalid use of Null.");
    resultText(ctx, vb::toText(arg(argv[0])));
}
// Str puts a blank where a positive number's sign would be.
void str(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    const auto d = number(ctx, argv[0]);
    if (!d) return;
    const QString text = vb::toText(*d);
    resultText(ctx, *d >= 0 ? " " + text : text);
}
void intPart(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    if (const auto d = number(ctx, argv[0])) resultNumber(ctx, std::floor(*d));
}
void fixPart(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    if (const auto d = number(ctx, argv[0])) resultNumber(ctx, std::trunc(*d));
}
void sgn(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    if (const auto d = number(ctx, argv[0])) sqlite3_result_int(ctx, *d > 0 ? 1 : *d < 0 ? -1 : 0);
}

// InStr([start,] text, part): 1-based position, 0 when not found.
void instr(sqlite3_context* ctx, int argc, sqlite3_value** argv) {
    int start = 1;
    int i = 0;
    if (argc == 3) {
        start = std::max(1, sqlite3_value_int(argv[0]));
        i = 1;
    }
    if (isNull(argv[i]) || isNull(argv[i + 1])) return sqlite3_result_null(ctx);
    const QString text = vb::toText(arg(argv[i]));
    const QString part = vb::toText(arg(argv[i + 1]));
    sqlite3_result_int64(ctx, text.indexOf(part, start - 1, Qt::CaseInsensitive) + 1);
}

template <int Part>
void datePart(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    const auto d = number(ctx, argv[0]);
    if (!d) return;
    const QDateTime dt = vb::fromSerial(*d);
    int v = 0;
    switch (Part) {
        case 0:
            v = dt.date().year();
            break;
        case 1:
            v = dt.date().month();
            break;
        case 2:
            v = dt.date().day();
            break;
        case 3:
            v = dt.date().dayOfWeek() % 7 + 1;
            break;  // Sunday = 1
        case 4:
            v = dt.time().hour();
            break;
        case 5:
            v = dt.time().minute();
            break;
        default:
            v = dt.time().second();
            break;
    }
    sqlite3_result_int(ctx, v);
}

void dateSerial(sqlite3_context* ctx, int, sqlite3_value** argv) {
    for (int i = 0; i < 3; ++i)
        if (isNull(argv[i])) return sqlite3_result_null(ctx);
    const QDate d = vb::dateSerial(sqlite3_value_int(argv[0]), sqlite3_value_int(argv[1]),
                                   sqlite3_value_int(argv[2]));
    sqlite3_result_int64(ctx, qint64(vb::toSerial(d)));
}

void cdate(sqlite3_context* ctx, int, sqlite3_value** argv) {
    if (isNull(argv[0])) return sqlite3_result_null(ctx);
    const QVariant v = arg(argv[0]);
    if (v.typeId() == QMetaType::QString) {
        const QString text = v.toString().trimmed();
        for (const char* f : {"d/M/yyyy", "d/M/yy", "yyyy-MM-dd"}) {
            QDate date = QDate::fromString(text, QString::fromLatin1(f));
            if (date.isValid()) {
                if (QString(f) == "d/M/yy" && date.year() < 1930) date = date.addYears(100);
                return resultNumber(ctx, vb::toSerial(date));
            }
        }
    }
    if (const auto d = number(ctx, argv[0])) resultNumber(ctx, *d);
}

}  // namespace

void registerFunctions(sqlite3* db) {
    registerOne(db, "jet_add", 2, add);
    registerOne(db, "jet_concat", 2, concat);
    registerOne(db, "jet_div", 2, divide);
    registerOne(db, "jet_idiv", 2, intDivide);
    registerOne(db, "jet_mod", 2, modulo);
    registerOne(db, "jet_pow", 2, power);
    registerOne(db, "jet_like", 2, like);
    registerOne(db, "jet_format", 1, format);
    registerOne(db, "jet_format", 2, format);
    registerOne(db, "jet_val", 1, val);
    registerOne(db, "jet_date", 0, date, false);
    registerOne(db, "jet_now", 0, now, false);
    registerOne(db, "jet_time", 0, time, false);
    registerOne(db, "jet_left", 2, left);
    registerOne(db, "jet_right", 2, right);
    registerOne(db, "jet_mid", 2, mid);
    registerOne(db, "jet_mid", 3, mid);
    registerOne(db, "jet_trim", 1, trim<true, true>);
    registerOne(db, "jet_ltrim", 1, trim<true, false>);
    registerOne(db, "jet_rtrim", 1, trim<false, true>);
    registerOne(db, "jet_nz", 1, nz);
    registerOne(db, "jet_nz", 2, nz);
    registerOne(db, "jet_cint", 1, cint);
    registerOne(db, "jet_clng", 1, clng);
    registerOne(db, "jet_cdbl", 1, cdbl);
    registerOne(db, "jet_cstr", 1, cstr);
    registerOne(db, "jet_str", 1, str);
    registerOne(db, "jet_int", 1, intPart);
    registerOne(db, "jet_fix", 1, fixPart);
    registerOne(db, "jet_sgn", 1, sgn);
    registerOne(db, "jet_instr", 2, instr);
    registerOne(db, "jet_instr", 3, instr);
    registerOne(db, "jet_year", 1, datePart<0>);
    registerOne(db, "jet_month", 1, datePart<1>);
    registerOne(db, "jet_day", 1, datePart<2>);
    registerOne(db, "jet_weekday", 1, datePart<3>);
    registerOne(db, "jet_hour", 1, datePart<4>);
    registerOne(db, "jet_minute", 1, datePart<5>);
    registerOne(db, "jet_second", 1, datePart<6>);
    registerOne(db, "jet_dateserial", 3, dateSerial);
    registerOne(db, "jet_cdate", 1, cdate);
}

}  // namespace etq::jet::detail
