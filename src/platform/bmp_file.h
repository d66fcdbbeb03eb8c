#pragma once

#include <QByteArray>
#include <QString>

namespace etq {

// Writes a raster of 3 bytes a pixel (red, green, blue; rows top to bottom, as libzint's
// ZBarcode_Buffer gives it) as a 1-bit BMP: white and black, a pixel dark when its red is
// below half. The file is the one libzint's own BMP output writes for the same raster, made
// with one write. Returns false, with the reason in `error`, when the file cannot be written.
bool writeMonochromeBmp(const QByteArray& fileName, const unsigned char* rgb, int width, int height,
                        QString* error);

}  // namespace etq
