#pragma once

#include <QHash>
#include <functional>
#include <memory>
#include <vector>

#include "surface/surface.h"

namespace etq {

struct ControlSpec;

// The surface without a display: the same controls as the window, held in memory, for the
// command line and tests. Controls start as the window's do: captions, tags, tooltips and the
// fixed combo lists of the design, empty texts, nothing selected, the progress frame 600 wide.
class MemorySurface : public Surface {
  public:
    MemorySurface();
    ~MemorySurface() override;

    int elementCount(const QString& name) const override;

    // Called with the control's name and its new width whenever a routine sets a width: the
    // progress bar moves through widths, and tests follow its every step.
    using WidthWatcher = std::function<void(const QString& name, int width)>;
    void watchWidths(WidthWatcher watcher) { widthWatcher_ = std::move(watcher); }

  protected:
    Control* find(const QString& name, int index) const override;

  private:
    class MemoryControl;
    friend class MemoryControl;

    void clearOtherOptions(const MemoryControl& selected);

    WidthWatcher widthWatcher_;
    std::vector<std::unique_ptr<MemoryControl>> controls_;
    QHash<QString, MemoryControl*> byName_;
};

}  // namespace etq
