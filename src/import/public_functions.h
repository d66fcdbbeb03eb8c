#pragma once

#include <QDate>
#include <QString>
#include <QVariant>

// The conversions every reader and page writer shares. Each takes a value that may be Null.
namespace etq {

// Null gives empty text; anything else its text without leading and trailing blanks.
QString NullToText(const QVariant& value);
// Null gives "&nbsp;"; anything else its text, HTML-escaped so that a name with "<" or "&"
// cannot break the page it is written into.
QString NullToHtml(const QVariant& value);
// Every double quote becomes an apostrophe (host item keys).
QString QuoteToApostrophe(const QString& text);
// Null gives 0; anything else the value as a number (a text that is no number throws
// JetError 3464).
double NullToDouble(const QVariant& value);
// Every carriage return becomes `separator`, the separator between the lines of an address that
// the document import run chooses (CR LF, or a comma; a run keeps it in its Context). Null gives
// empty text.
QString ReplaceLineBreaks(const QVariant& value, const QString& separator);
// The binary digits of a whole number, most significant first ("100" for 4, "0" for 0).
QString ToBinaryText(qint32 value);
// Trimmed numeric text as a 32-bit whole number; anything else 0.
qint32 TextToLong(const QString& text);
// An eight-character dBASE date YYYYMMDD; a null date when it is not one.
QDate DbfDateToDate(const QString& text);
// Null gives 0; anything else the value as a 16-bit whole number (throws JetError 3464 when it
// is none).
qint16 NullToInteger(const QVariant& value);

}  // namespace etq
