// The value rules shared by the engine and the routines.
#include <gtest/gtest.h>

#include "jet/vb.h"

namespace etq::vb {
namespace {

TEST(VbValues, WholeNumbersRoundHalvesToEven) {
    EXPECT_EQ(roundHalfEven(2.5), 2);
    EXPECT_EQ(roundHalfEven(3.5), 4);
    EXPECT_EQ(roundHalfEven(-2.5), -2);
    EXPECT_EQ(roundHalfEven(-3.6), -4);
    EXPECT_EQ(toInteger(32767.4), std::optional<qint16>(32767));
    EXPECT_EQ(toInteger(32767.5), std::nullopt);
    EXPECT_EQ(toInteger(QString(" 12 ")), std::optional<qint16>(12));
    EXPECT_EQ(toInteger(QString("12a")), std::nullopt);
    EXPECT_EQ(toLong(QVariant()), std::nullopt);
}

TEST(VbValues, ValReadsTheNumberAtTheStart) {
    EXPECT_EQ(val(QStringView(u"  42 boxes")), 42);
    EXPECT_EQ(val(QStringView(u"1 2 3")), 123);
    EXPECT_EQ(val(QStringView(u"-.5")), -0.5);
    EXPECT_EQ(val(QStringView(u"1e3")), 1000);
    EXPECT_EQ(val(QStringView(u"1e")), 1);
    EXPECT_EQ(val(QStringView(u"&o17")), 15);
    EXPECT_EQ(val(QStringView(u"x1")), 0);
    EXPECT_EQ(val(QStringView(u"")), 0);
    EXPECT_EQ(val(QVariant()), 0);
}

TEST(VbValues, DateSerialsCarryAndCountFrom1899) {
    EXPECT_EQ(toSerial(QDate(1899, 12, 30)), 0);
    EXPECT_EQ(toSerial(QDate(2025, 1, 1)), 45658);
    EXPECT_EQ(dateSerial(2024, 13, 1), QDate(2025, 1, 1));
    EXPECT_EQ(dateSerial(2024, 3, 0), QDate(2024, 2, 29));
    EXPECT_EQ(dateSerial(2024, 0, 1), QDate(2023, 12, 1));
    EXPECT_EQ(dateSerial(2024, 1, 32), QDate(2024, 2, 1));
    EXPECT_EQ(fromSerial(45658.75).time(), QTime(18, 0));
    EXPECT_EQ(toSerial(fromSerial(45658.25)), 45658.25);
}

TEST(VbValues, FormatNumbersAndDates) {
    EXPECT_EQ(format(12.5, "0.00"), "12.50");
    EXPECT_EQ(format(2.5, "0"), "3");  // Format rounds halves away from zero
    EXPECT_EQ(format(0.125, "0.00"), "0.13");
    EXPECT_EQ(format(1.005, "0.00"), "1.01");
    EXPECT_EQ(format(-1234.5, "#,##0.00"), "-1,234.50");
    EXPECT_EQ(format(16.6667, "00.0"), "16.7");
    EXPECT_EQ(format(8.3333, "00.0"), "08.3");
    EXPECT_EQ(format(5, "#.##"), "5.");
    EXPECT_EQ(format(0.5, "#.##"), ".5");
    EXPECT_EQ(format(-3, "0;(0)"), "(3)");
    EXPECT_EQ(format(0, "0.0;-0.0;\"zero\""), "zero");
    EXPECT_EQ(format(0.256, "0%"), "26%");
    EXPECT_EQ(format(QString("7"), "0.00"), "7.00");
    EXPECT_EQ(format(QString("abc"), "0.00"), "abc");
    EXPECT_EQ(format(45658, "dd/mm/yy"), "01/01/25");
    EXPECT_EQ(format(QDate(2079, 3, 5), "d/m/yyyy"), "5/3/2079");
    EXPECT_EQ(format(45658.5, "hh:mm"), "12:00");
    EXPECT_EQ(format(12.5, "Fixed"), "12.50");
    EXPECT_EQ(format(QVariant(), "0.00"), "");
}

TEST(VbValues, TextIsWrittenAsCStrWritesIt) {
    EXPECT_EQ(toText(12.0), "12");
    EXPECT_EQ(toText(12.25), "12.25");
    EXPECT_EQ(toText(0.1 + 0.2), "0.3");
    EXPECT_EQ(toText(true), "True");
    EXPECT_EQ(toText(QDate(2025, 3, 5)), "05/03/2025");
    EXPECT_EQ(toText(QVariant()), "");
}

}  // namespace
}  // namespace etq::vb
