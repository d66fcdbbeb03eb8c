#pragma once

#include <QList>
#include <QStringList>

#include "platform/progress.h"

namespace etq::test {

// Keeps what a run tells of its progress: every step, every move of the bar as "done/total",
// "clear" or "fill", in order, and the widths the bar would take in a frame of 600.
class RecordingProgress : public Progress {
  public:
    static constexpr int kWidth = 600;

    void step(const QString& text) override {
        steps << text;
        events << "step " + text;
    }
    void show(qint64 done, qint64 total) override {
        events << QStringLiteral("%1/%2").arg(done).arg(total);
        if (total < 1 || done < 0 || done > total) return;
        widths << int(double(done) / double(total) * kWidth + 0.5);
    }
    void clear() override {
        events << QStringLiteral("clear");
        widths << 0;
    }
    void fill() override {
        events << QStringLiteral("fill");
        widths << kWidth;
    }

    QStringList steps;
    QStringList events;
    QList<int> widths;
};

}  // namespace etq::test
