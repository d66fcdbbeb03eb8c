#pragma once

#include <QtGlobal>
#include <functional>

namespace etq {

class Surface;

// The progress bar of the surface: the shape ProgressFill drawn over the shape ProgressFrame,
// whose width is the whole bar. The readers and the import runs move it through here.
class ProgressBar {
  public:
    explicit ProgressBar(const Surface& surface) : surface_(surface) {}

    void clear();
    void fill();
    // `done` of `total` records: that share of the frame's width, rounded. Nothing happens
    // for an empty file or a count beyond the total.
    void show(qint64 done, qint64 total);

    // Someone who watches the bar besides the surface (the command line draws it on a
    // terminal). Called after every change with the fill's and the frame's widths; an empty
    // function stops the watching.
    using Observer = std::function<void(int fillWidth, int frameWidth)>;
    static void setObserver(Observer observer);

  private:
    void setFill(int width, int frameWidth);
    int frameWidth() const;

    const Surface& surface_;
};

}  // namespace etq
