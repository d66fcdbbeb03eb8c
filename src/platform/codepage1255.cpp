#include "platform/codepage1255.h"

#include <array>

namespace etq {

namespace {

constexpr char16_t kUndefined = 0xFFFD;

// Bytes 0x80-0xFF, eight a row; kNone is undefined. Windows maps 0xCA to HOLAM HASER FOR VAV,
// which older tables leave out. The new sheqel sign is 0xA4, the host's currency code "¦" 0xA6.
constexpr char16_t kNone = kUndefined;
// clang-format off
constexpr std::array<char16_t, 128> kHigh = {
    0x20AC, kNone,  0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021,  // 0x80
    0x02C6, 0x2030, kNone,  0x2039, kNone,  kNone,  kNone,  kNone,
    kNone,  0x2018, 0x2019, 0x201C, 0x201D, 0x2022, 0x2013, 0x2014,  // 0x90
    0x02DC, 0x2122, kNone,  0x203A, kNone,  kNone,  kNone,  kNone,
    0x00A0, 0x00A1, 0x00A2, 0x00A3, 0x20AA, 0x00A5, 0x00A6, 0x00A7,  // 0xA0
    0x00A8, 0x00A9, 0x00D7, 0x00AB, 0x00AC, 0x00AD, 0x00AE, 0x00AF,
    0x00B0, 0x00B1, 0x00B2, 0x00B3, 0x00B4, 0x00B5, 0x00B6, 0x00B7,  // 0xB0
    0x00B8, 0x00B9, 0x00F7, 0x00BB, 0x00BC, 0x00BD, 0x00BE, 0x00BF,
    0x05B0, 0x05B1, 0x05B2, 0x05B3, 0x05B4, 0x05B5, 0x05B6, 0x05B7,  // 0xC0: points
    0x05B8, 0x05B9, 0x05BA, 0x05BB, 0x05BC, 0x05BD, 0x05BE, 0x05BF,
    0x05C0, 0x05C1, 0x05C2, 0x05C3, 0x05F0, 0x05F1, 0x05F2, 0x05F3,  // 0xD0
    0x05F4, kNone,  kNone,  kNone,  kNone,  kNone,  kNone,  kNone,
    0x05D0, 0x05D1, 0x05D2, 0x05D3, 0x05D4, 0x05D5, 0x05D6, 0x05D7,  // 0xE0: letters
    0x05D8, 0x05D9, 0x05DA, 0x05DB, 0x05DC, 0x05DD, 0x05DE, 0x05DF,
    0x05E0, 0x05E1, 0x05E2, 0x05E3, 0x05E4, 0x05E5, 0x05E6, 0x05E7,  // 0xF0
    0x05E8, 0x05E9, 0x05EA, kNone,  kNone,  0x200E, 0x200F, kNone,
};
// clang-format on

constexpr std::array<char16_t, 256> makeDecodeTable() {
    std::array<char16_t, 256> table{};
    for (int b = 0; b < 0x80; ++b)
        table[b] = char16_t(b);
    for (int b = 0x80; b < 0x100; ++b)
        table[b] = kHigh[b - 0x80];
    return table;
}

constexpr std::array<char16_t, 256> kDecode = makeDecodeTable();

// Reverse lookup for the characters above ASCII: 0 means "not in the code page" (no character
// at or above U+0080 encodes to byte 0). 64 KiB, built once.
struct EncodeTable {
    std::array<unsigned char, 0x10000> byteOf{};
    EncodeTable() {
        for (int b = 0x80; b < 0x100; ++b)
            if (kHigh[b - 0x80] != kUndefined)
                byteOf[kHigh[b - 0x80]] = static_cast<unsigned char>(b);
    }
};

const EncodeTable& encodeTable() {
    static const EncodeTable table;
    return table;
}

void appendUnmappable(QByteArray& out, char32_t codePoint, Unmappable mode) {
    if (mode == Unmappable::QuestionMark) {
        out.append('?');
        return;
    }
    out.append("&#");
    out.append(QByteArray::number(quint32(codePoint)));
    out.append(';');
}

}  // namespace

char16_t unicodeOf1255(unsigned char byte) {
    return kDecode[byte];
}

QString decode1255(QByteArrayView bytes) {
    QString text(bytes.size(), Qt::Uninitialized);
    QChar* out = text.data();
    for (char c : bytes)
        *out++ = QChar(kDecode[static_cast<unsigned char>(c)]);
    return text;
}

QByteArray encode1255(QStringView text, Unmappable mode) {
    const auto& table = encodeTable().byteOf;
    QByteArray out;
    out.reserve(text.size());
    for (qsizetype i = 0; i < text.size(); ++i) {
        const char16_t c = text[i].unicode();
        if (c < 0x80) {
            out.append(char(c));
        } else if (const unsigned char b = table[c]) {
            out.append(char(b));
        } else if (QChar::isHighSurrogate(c) && i + 1 < text.size() &&
                   QChar::isLowSurrogate(text[i + 1].unicode())) {
            appendUnmappable(out, QChar::surrogateToUcs4(c, text[i + 1].unicode()), mode);
            ++i;
        } else {
            appendUnmappable(out, c, mode);
        }
    }
    return out;
}

}  // namespace etq
