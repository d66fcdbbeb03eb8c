#pragma once

#include <QList>
#include <QStringList>

#include "platform/progress.h"

namespace etq::test {

// Keeps what a run tells of its progress: every step, and every move of the bar as "done/total",
// "clear" or "fill", in order.
class RecordingProgress : public Progress {
  public:
    void step(const QString& text) override {
        steps << text;
        events << "step " + text;
    }
    void show(qint64 done, qint64 total) override {
        events << QStringLiteral("%1/%2").arg(done).arg(total);
    }
    void clear() override { events << QStringLiteral("clear"); }
    void fill() override { events << QStringLiteral("fill"); }

    QStringList steps;
    QStringList events;
};

}  // namespace etq::test
