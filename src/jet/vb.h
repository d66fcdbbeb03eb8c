#pragma once

#include <QDate>
#include <QDateTime>
#include <QString>
#include <QVariant>
#include <optional>

// The value rules of the component's original language, in one place: whole-number conversion,
// Val, date serials and Format. The database engine's functions and the routines share them.
namespace etq::vb {

// Whole-number conversion as CInt/CLng do it: halves go to the even neighbour (2.5 -> 2,
// 3.5 -> 4, -2.5 -> -2).
qint64 roundHalfEven(double value);

// CInt / CLng: the value as a 16- or 32-bit whole number, or nothing when it does not fit or
// is not a number (text is read when it is a number as a whole, as CInt reads "12").
std::optional<qint16> toInteger(const QVariant& value);
std::optional<qint32> toLong(const QVariant& value);
// The value as a number: numbers as they are, text when the whole text is a number
// (blanks around allowed), booleans -1/0; nothing otherwise.
std::optional<double> toNumber(const QVariant& value);

// Val: the number at the start of a text. Leading blanks, tabs and line feeds are skipped and
// blanks inside the digits are ignored ("1 2" is 12); "&H" and "&O" read hexadecimal and octal;
// reading stops at the first character that cannot continue the number. A text with no number
// gives 0. Null gives 0 too (the original raised an error there).
double val(QStringView text);
double val(const QVariant& value);

// Date serials: days since 30 December 1899, the fraction being the time of day.
double toSerial(QDate date);
double toSerial(const QDateTime& dateTime);
QDateTime fromSerial(double serial);
QDate dateFromSerial(double serial);
// DateSerial with the usual carry: month 13 is January of the next year, day 0 the last day
// of the month before, and so on. The year is taken as given (no two-digit window here).
QDate dateSerial(int year, int month, int day);
// Today as a serial day number (a whole number).
double today();

// The value as text the way CStr writes it: whole numbers without a decimal point, others with
// up to 15 significant digits; booleans "True"/"False"; dates as dd/mm/yyyy; Null as empty.
QString toText(const QVariant& value);

// Format(value, pattern) for the number and date patterns of the component ("0.00", "00.0",
// "#,##0.00", "dd/mm/yy", "Fixed", "Short Date", ...). A number is formatted as a date when the
// pattern is a date pattern (a date serial). An empty pattern gives toText(value). Numbers round
// half away from zero, as Format does (2.5 -> "3", 0.125 with "0.00" -> "0.13").
QString format(const QVariant& value, const QString& pattern);

}  // namespace etq::vb
