#include "platform/codepage1255.h"

#include <gtest/gtest.h>
#include <iconv.h>

#include <QList>

namespace etq {
namespace {

QByteArray byteString(std::initializer_list<int> bytes) {
    QByteArray out;
    for (int b : bytes)
        out.append(char(b));
    return out;
}

TEST(Codepage1255, HebrewAndCurrencySignsRoundTrip) {
    const QString text = QStringLiteral("חלב 3% ¦ ₪12.90 € \"בע\"מ\" ×÷");
    const QByteArray bytes = encode1255(text, Unmappable::QuestionMark);
    EXPECT_EQ(bytes.size(), text.size());
    EXPECT_EQ(bytes.left(3), byteString({0xE7, 0xEC, 0xE1}));  // ח ל ב
    EXPECT_EQ(bytes[7], char(0xA6));                           // ¦, the host's local currency
    EXPECT_EQ(bytes[9], char(0xA4));                           // ₪
    EXPECT_EQ(bytes[16], char(0x80));                          // €
    EXPECT_EQ(decode1255(bytes), text);
}

TEST(Codepage1255, EveryDefinedByteRoundTripsAndUndefinedOnesDecodeToReplacement) {
    const QList<int> undefined = {0x81, 0x8A, 0x8C, 0x8D, 0x8E, 0x8F, 0x90, 0x9A, 0x9C, 0x9D, 0x9E,
                                  0x9F, 0xD9, 0xDA, 0xDB, 0xDC, 0xDD, 0xDE, 0xDF, 0xFB, 0xFC, 0xFF};
    for (int b = 0; b < 256; ++b) {
        const QByteArray one(1, char(b));
        const QString decoded = decode1255(one);
        ASSERT_EQ(decoded.size(), 1);
        if (undefined.contains(b)) {
            EXPECT_EQ(decoded[0].unicode(), 0xFFFD) << "byte " << b;
        } else {
            EXPECT_NE(decoded[0].unicode(), 0xFFFD) << "byte " << b;
            EXPECT_EQ(encode1255(decoded, Unmappable::CharacterReference), one) << "byte " << b;
        }
    }
}

// The system's converter knows the same code page; only 0xCA differs: newer Windows tables map
// it to HOLAM HASER FOR VAV, which glibc's table predates.
TEST(Codepage1255, AgreesWithTheSystemConverterByteForByte) {
    iconv_t cd = iconv_open("UTF-16LE", "CP1255");
    if (cd == iconv_t(-1)) GTEST_SKIP() << "no CP1255 converter in this C library";
    for (int b = 1; b < 256; ++b) {
        char in[1] = {char(b)};
        char16_t out[4] = {};
        char* inPtr = in;
        char* outPtr = reinterpret_cast<char*>(out);
        size_t inLeft = 1, outLeft = sizeof out;
        iconv(cd, nullptr, nullptr, nullptr, nullptr);
        const bool converted = iconv(cd, &inPtr, &inLeft, &outPtr, &outLeft) != size_t(-1) &&
                               iconv(cd, nullptr, nullptr, &outPtr, &outLeft) != size_t(-1);
        const char16_t ours = unicodeOf1255(static_cast<unsigned char>(b));
        if (converted) {
            EXPECT_EQ(int(ours), int(out[0])) << "byte " << b;
        } else if (b != 0xCA) {
            EXPECT_EQ(int(ours), 0xFFFD) << "byte " << b;
        }
    }
    iconv_close(cd);
    EXPECT_EQ(unicodeOf1255(0xCA), u'\u05BA');
}

TEST(Codepage1255, UnmappableCharactersBecomeReferencesOrQuestionMarks) {
    struct Case {
        QString text;
        QByteArray asReference;
        QByteArray asQuestion;
    };
    const Case cases[] = {
        {QStringLiteral("a☃b"), "a&#9731;b", "a?b"},
        {QStringLiteral("ש😀"), "\xF9&#128512;", "\xF9?"},    // a pair of surrogates is one
        {QString(QChar(0xD83D)) + u'x', "&#55357;x", "?x"},  // a lone surrogate
        {QStringLiteral("\uFFFD"), "&#65533;", "?"},
        {QStringLiteral("Ж"), "&#1046;", "?"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(encode1255(c.text, Unmappable::CharacterReference), c.asReference)
            << c.text.toStdString();
        EXPECT_EQ(encode1255(c.text, Unmappable::QuestionMark), c.asQuestion)
            << c.text.toStdString();
    }
    EXPECT_EQ(encode1255(u"", Unmappable::QuestionMark), QByteArray());
}

}  // namespace
}  // namespace etq
