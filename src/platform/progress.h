#pragma once

#include <QString>
#include <QtGlobal>

namespace etq {

// How a long run tells how far it has come: the step it is on and the share of it done. The
// window draws it on the message line and the progress bar; the command line on a terminal;
// tests record it.
class Progress {
  public:
    virtual ~Progress() = default;

    // The step the run is on now (a caption such as "Scanning items...").
    virtual void step(const QString& text) = 0;
    // `done` of `total` records. Nothing happens for an empty total or a count beyond it.
    virtual void show(qint64 done, qint64 total) = 0;
    // The bar emptied, or filled to its end.
    virtual void clear() = 0;
    virtual void fill() = 0;
};

// Progress that nobody watches.
class NoProgress : public Progress {
  public:
    void step(const QString&) override {}
    void show(qint64, qint64) override {}
    void clear() override {}
    void fill() override {}
};

}  // namespace etq
