#pragma once

#include <QString>

namespace etq {

// The language selector of the component: 0 (or -1) is Hebrew, 1 is English. It starts at 0.
qint16 language();
void setLanguage(qint16 selector);
bool isEnglish();

// Caption n (1 to 54) of the caption table in the current language; empty text otherwise.
QString GetCaption(int n);

// Grid column alignment code for text columns: 7 (right, centred) in Hebrew, 1 (left,
// centred) in English.
qint16 GetColumnAlignment();

}  // namespace etq
