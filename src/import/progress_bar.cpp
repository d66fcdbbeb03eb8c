#include "import/progress_bar.h"

#include <cmath>

#include "shell/surface.h"

namespace etq {

namespace {

ProgressBar::Observer& observer() {
    static ProgressBar::Observer instance;
    return instance;
}

}  // namespace

void ProgressBar::setObserver(Observer watcher) {
    observer() = std::move(watcher);
}

int ProgressBar::frameWidth() const {
    return surface_.control(QStringLiteral("ProgressFrame")).width();
}

void ProgressBar::setFill(int width, int frame) {
    surface_.control(QStringLiteral("ProgressFill")).setWidth(width);
    if (observer()) observer()(width, frame);
}

void ProgressBar::clear() {
    setFill(0, frameWidth());
}

void ProgressBar::fill() {
    const int frame = frameWidth();
    setFill(frame, frame);
}

void ProgressBar::show(qint64 done, qint64 total) {
    if (total < 1 || done < 0 || done > total) return;
    const int frame = frameWidth();
    setFill(int(std::lround(double(done) / double(total) * frame)), frame);
}

}  // namespace etq
