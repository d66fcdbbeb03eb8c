#pragma once

#include <QString>

namespace etq {

// The folder of the built-in label page and its barcode bitmaps: "etiqon" inside the user's
// private temporary folder, made (mode 0700) when missing. Throws std::runtime_error when it
// cannot be made.
QString printFolder();

// Deletes every file of the folder (sub-folders stay). Throws std::runtime_error naming the
// first file that cannot be deleted.
void deleteFilesIn(const QString& folder);

}  // namespace etq
