#pragma once

#include <QString>

namespace etq {

// The caption table: every message, progress text and grid header the component writes, in
// Hebrew and English. The language selector is 0 (or -1) for Hebrew and 1 for English; a run
// keeps its selector in its Context.

// Caption n (1 to 54) in the language of `selector`; empty text otherwise.
QString GetCaption(int n, qint16 selector);

// Grid column alignment code for text columns: 7 (right, centred) in Hebrew, 1 (left,
// centred) in English.
qint16 GetColumnAlignment(qint16 selector);

}  // namespace etq
