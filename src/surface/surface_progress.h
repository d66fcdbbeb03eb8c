#pragma once

#include "platform/progress.h"

namespace etq {

class Surface;

// A run's progress on the surface: the step on the message line Message1, the share done as
// the width of the shape ProgressFill drawn over ProgressFrame, whose width is the whole bar.
class SurfaceProgress : public Progress {
  public:
    explicit SurfaceProgress(const Surface& surface) : surface_(surface) {}

    void step(const QString& text) override;
    // That share of the frame's width, rounded.
    void show(qint64 done, qint64 total) override;
    void clear() override;
    void fill() override;

  private:
    void setFill(int width);
    int frameWidth() const;

    const Surface& surface_;
};

}  // namespace etq
