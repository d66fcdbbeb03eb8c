#pragma once

#include <QByteArray>
#include <QByteArrayView>
#include <QString>
#include <QStringView>

namespace etq {

// Windows-1255, the Hebrew code page of the host's dBASE files and of the pages we write.
// Our own table: no conversion library is needed, and every call is plain table lookups.

// What encode1255 writes for a character the code page lacks.
enum class Unmappable {
    CharacterReference,  // "&#NNNN;" with the decimal code point: for HTML pages
    QuestionMark,        // "?": for dBASE text
};

// Bytes the code page leaves undefined decode to U+FFFD.
QString decode1255(QByteArrayView bytes);

// A character outside the code page (also a lone surrogate) becomes what `mode` says; a pair
// of surrogates is one character, so an emoji becomes one "&#128512;" or one "?".
QByteArray encode1255(QStringView text, Unmappable mode);

// The character a single byte stands for (U+FFFD when undefined).
char16_t unicodeOf1255(unsigned char byte);

}  // namespace etq
