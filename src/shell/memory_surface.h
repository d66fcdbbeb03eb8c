#pragma once

#include <QHash>
#include <memory>
#include <vector>

#include "shell/surface.h"

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

  protected:
    Control* find(const QString& name, int index) const override;

  private:
    class MemoryControl;
    friend class MemoryControl;

    void clearOtherOptions(const MemoryControl& selected);

    std::vector<std::unique_ptr<MemoryControl>> controls_;
    QHash<QString, MemoryControl*> byName_;
};

}  // namespace etq
