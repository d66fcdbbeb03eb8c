#pragma once

#include "platform/browser.h"

namespace etq {

// Opens pages in the desktop's default browser.
class DesktopPageViewer : public PageViewer {
  public:
    bool showPage(const QString& path, QString* error) override;
};

}  // namespace etq
