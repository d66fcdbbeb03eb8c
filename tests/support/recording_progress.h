#pragma once

#include <QList>
#include <QStringList>

#include "platform/progress.h"

namespace etq::test {

// Keeps every step and every share a run shows, the share as the width of a bar of 600.
class RecordingProgress : public Progress {
  public:
    static constexpr int kWidth = 600;

    void step(const QString& text) override { steps << text; }
    void show(qint64 done, qint64 total) override {
        if (total < 1 || done < 0 || done > total) return;
        widths << int(double(done) / double(total) * kWidth + 0.5);
    }
    void clear() override { widths << 0; }
    void fill() override { widths << kWidth; }

    QStringList steps;
    QList<int> widths;
};

}  // namespace etq::test
