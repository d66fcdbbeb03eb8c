#include "platform/bmp_file.h"

#include <fcntl.h>
#include <unistd.h>

#include <QtEndian>
#include <cerrno>
#include <cstring>
#include <vector>

namespace etq {

namespace {

constexpr int kFileHeaderSize = 14;
constexpr int kInfoHeaderSize = 40;
constexpr int kPaletteSize = 2 * 4;  // white, then black
constexpr int kDataOffset = kFileHeaderSize + kInfoHeaderSize + kPaletteSize;

void put16(unsigned char* at, quint16 value) {
    qToLittleEndian(value, at);
}
void put32(unsigned char* at, quint32 value) {
    qToLittleEndian(value, at);
}

void writeHeader(unsigned char* out, int width, int height, quint32 fileSize) {
    std::memset(out, 0, kDataOffset);
    out[0] = 'B';
    out[1] = 'M';
    put32(out + 2, fileSize);
    put32(out + 10, kDataOffset);
    put32(out + 14, kInfoHeaderSize);
    put32(out + 18, quint32(width));
    put32(out + 22, quint32(height));  // positive: the bottom row comes first
    put16(out + 26, 1);                // planes
    put16(out + 28, 1);                // bits a pixel
    put32(out + 46, 2);                // colours used
    put32(out + 50, 2);                // colours important
    out[54] = out[55] = out[56] = 0xff;
}

// One raster row as bits, the leftmost pixel in the highest bit, a set bit dark.
void packRow(const unsigned char* rgb, int width, unsigned char* out) {
    for (int x = 0; x < width; ++x)
        if (rgb[3 * x] < 0x80) out[x >> 3] |= static_cast<unsigned char>(0x80 >> (x & 7));
}

}  // namespace

bool writeMonochromeBmp(const QByteArray& fileName, const unsigned char* rgb, int width, int height,
                        QString* error) {
    const size_t rowBytes = size_t((width + 31) / 32) * 4;
    const size_t rgbRow = size_t(width) * 3;
    const size_t fileSize = kDataOffset + rowBytes * size_t(height);
    std::vector<unsigned char> file(fileSize, 0);
    writeHeader(file.data(), width, height, quint32(fileSize));

    // Barcodes repeat their rows: a row like the one above it is copied, not packed again.
    const unsigned char* packed = nullptr;
    const unsigned char* previous = nullptr;
    for (int y = 0; y < height; ++y) {
        const unsigned char* source = rgb + size_t(y) * rgbRow;
        unsigned char* target = file.data() + kDataOffset + size_t(height - 1 - y) * rowBytes;
        if (previous && std::memcmp(source, previous, rgbRow) == 0) {
            std::memcpy(target, packed, rowBytes);
        } else {
            packRow(source, width, target);
        }
        previous = source;
        packed = target;
    }

    const int fd = ::open(fileName.constData(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0644);
    bool written = fd >= 0;
    for (size_t done = 0; written && done < fileSize;) {
        const ssize_t n = ::write(fd, file.data() + done, fileSize - done);
        if (n < 0 && errno == EINTR) continue;
        written = n > 0;
        if (written) done += size_t(n);
    }
    const int writeErrno = errno;
    if (fd >= 0 && ::close(fd) != 0) written = false;
    if (!written) {
        if (error)
            *error =
                QStringLiteral("Cannot write %1: %2")
                    .arg(QString::fromLocal8Bit(fileName),
                         QString::fromLocal8Bit(std::strerror(writeErrno ? writeErrno : errno)));
        if (fd >= 0) ::unlink(fileName.constData());
        return false;
    }
    return true;
}

}  // namespace etq
