// The small conversions the readers and pages share.
#include <gtest/gtest.h>

#include "db/db_values.h"
#include "import/public_functions.h"
#include "jet/error.h"

namespace etq::db {
namespace {

TEST(DbValues, RemoveQuoteCharsDropsApostrophesQuotesAndCommas) {
    EXPECT_EQ(RemoveQuoteChars(QString("O'Brien, \"Best\" Ltd")), "OBrien Best Ltd");
    EXPECT_EQ(RemoveQuoteChars(QString("מ\"מ, בע'מ")), "ממ בעמ");
    EXPECT_EQ(RemoveQuoteChars(QVariant()), "");
    EXPECT_EQ(RemoveQuoteChars(QString()), "");
}

TEST(DbValues, CopiesFromQuantityRoundsHalvesToEvenAndClamps) {
    EXPECT_EQ(CopiesFromQuantity(2.5), 2);
    EXPECT_EQ(CopiesFromQuantity(3.5), 4);
    EXPECT_EQ(CopiesFromQuantity(-7), 7);
    EXPECT_EQ(CopiesFromQuantity(-3.6), 4);
    EXPECT_EQ(CopiesFromQuantity(999.4), 999);
    EXPECT_EQ(CopiesFromQuantity(1000), 999);
    EXPECT_EQ(CopiesFromQuantity(-1000), 999);
    EXPECT_EQ(CopiesFromQuantity(2500), 999);
    EXPECT_EQ(CopiesFromQuantity(0), 0);
}

TEST(DbValues, ParseDayMonthYearWindowsTwoDigitYears) {
    EXPECT_EQ(ParseDayMonthYear("5/3/79"), QDate(2079, 3, 5));
    EXPECT_EQ(ParseDayMonthYear("5/3/80"), QDate(1980, 3, 5));
    EXPECT_EQ(ParseDayMonthYear("05/03/2004"), QDate(2004, 3, 5));
    EXPECT_EQ(ParseDayMonthYear("01/01/1980"), QDate(1980, 1, 1));
    EXPECT_EQ(ParseDayMonthYear("31/12/99"), QDate(1999, 12, 31));
    EXPECT_EQ(ParseDayMonthYear("0/1/00"), QDate(1999, 12, 31));    // day 0 carries back
    EXPECT_EQ(ParseDayMonthYear("32/12/2024"), QDate(2025, 1, 1));  // and over
    EXPECT_EQ(ParseDayMonthYear("1/13/2024"), QDate(2025, 1, 1));
    EXPECT_FALSE(ParseDayMonthYear("").isValid());
    EXPECT_FALSE(ParseDayMonthYear("1.1.2024").isValid());
    EXPECT_FALSE(ParseDayMonthYear("aa/bb/cc").isValid());
}

TEST(PublicFunctions, NullsTextsAndNumbers) {
    EXPECT_EQ(NullToText(QVariant()), "");
    EXPECT_EQ(NullToText(QString("  abc  ")), "abc");
    EXPECT_EQ(NullToText(12.5), "12.5");
    EXPECT_EQ(NullToHtml(QVariant()), "&nbsp;");
    EXPECT_EQ(NullToHtml(QString("A & B <b>")), "A &amp; B &lt;b&gt;");
    EXPECT_EQ(QuoteToApostrophe("AB\"C\""), "AB'C'");
    EXPECT_EQ(NullToDouble(QVariant()), 0);
    EXPECT_EQ(NullToDouble(QString("2.5")), 2.5);
    EXPECT_THROW(NullToDouble(QString("two")), jet::JetError);
    EXPECT_EQ(NullToInteger(QVariant()), 0);
    EXPECT_EQ(NullToInteger(7.5), 8);
    EXPECT_THROW(NullToInteger(40000), jet::JetError);
    EXPECT_EQ(TextToLong("  123 "), 123);
    EXPECT_EQ(TextToLong("12a"), 0);
    EXPECT_EQ(TextToLong(""), 0);
    EXPECT_EQ(ToBinaryText(4), "100");
    EXPECT_EQ(ToBinaryText(0), "0");
    EXPECT_EQ(DbfDateToDate("20250131"), QDate(2025, 1, 31));
    EXPECT_FALSE(DbfDateToDate("        ").isValid());
}

TEST(PublicFunctions, LineBreaksBecomeTheAddressSeparator) {
    EXPECT_EQ(ReplaceLineBreaks(QString("a\rb\rc"), ","), "a,b,c");
    EXPECT_EQ(ReplaceLineBreaks(QString("a\rb"), "\r\n"), "a\r\nb");
    EXPECT_EQ(ReplaceLineBreaks(QVariant(), ","), "");
}

}  // namespace
}  // namespace etq::db
