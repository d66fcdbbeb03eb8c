#pragma once

#include "platform/browser.h"

namespace etq {

// Opens pages in the desktop's default browser.
class DesktopPageViewer : public PageViewer {
  public:
    void showPage(const QString& path) override;
};

}  // namespace etq
