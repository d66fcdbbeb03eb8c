#pragma once

#include <QString>

namespace etq {

class Surface;

// The item print button (cmdPrintItmes): labels for the marked items. With the built-in label
// page chosen ("Direct") it makes the chosen printer the default one and runs the built-in
// print run on the working database of txtDBPath, creating that database when it is missing.
// Returns the page's path, or empty text when nothing was printed (the reason was shown).
QString PrintItemLabels(Surface& surface);

}  // namespace etq
