#pragma once

#include <QDate>
#include <QString>
#include <QVariant>

// Small conversions the importers share.
namespace etq::db {

// The value without apostrophes, double quotes and commas; Null or empty gives empty text.
// Names pass through it before they go into statements and document headers.
QString RemoveQuoteChars(const QVariant& value);

// The label copies of a document line from its quantity: rounded to a whole number (halves to
// even), made positive, and 999 for anything outside -999..999.
qint16 CopiesFromQuantity(double quantity);

// A date written day/month/year. Two-digit years 80..99 are 1980..1999 and 0..79 are
// 2000..2079; months and days out of range carry over. An unreadable text gives a null date.
QDate ParseDayMonthYear(const QString& text);

}  // namespace etq::db
