#pragma once

#include <QString>

namespace etq {

// Shows a generated page to the user. The window opens it in the user's default browser; a
// headless run prints the page's path on stdout, and opens it too when asked.
class PageViewer {
  public:
    virtual ~PageViewer() = default;
    // Throws Failure, with the reason, when the page could not be handed to a browser.
    virtual void showPage(const QString& path) = 0;
};

// Prints the path as the last line on stdout; with `open`, also starts xdg-open on it.
class HeadlessPageViewer : public PageViewer {
  public:
    explicit HeadlessPageViewer(bool open = false) : open_(open) {}
    void showPage(const QString& path) override;

  private:
    bool open_;
};

}  // namespace etq
