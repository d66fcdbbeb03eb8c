#include "surface/surface_progress.h"

#include <cmath>

#include "surface/surface.h"

namespace etq {

int SurfaceProgress::frameWidth() const {
    return surface_.control(QStringLiteral("ProgressFrame")).width();
}

void SurfaceProgress::setFill(int width) {
    surface_.control(QStringLiteral("ProgressFill")).setWidth(width);
}

void SurfaceProgress::step(const QString& text) {
    surface_.control(QStringLiteral("Message1")).setCaption(text);
}

void SurfaceProgress::clear() {
    setFill(0);
}

void SurfaceProgress::fill() {
    setFill(frameWidth());
}

void SurfaceProgress::show(qint64 done, qint64 total) {
    if (total < 1 || done < 0 || done > total) return;
    setFill(int(std::lround(double(done) / double(total) * frameWidth())));
}

}  // namespace etq
