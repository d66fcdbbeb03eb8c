#pragma once

#include <QString>

namespace etq {

// Shows a generated page to the user. The window opens it in the user's default browser; a
// headless run prints the page's path on stdout, and opens it too when asked.
class PageViewer {
  public:
    virtual ~PageViewer() = default;
    // False, with the reason in `error`, when the page could not be handed to a browser.
    virtual bool showPage(const QString& path, QString* error) = 0;
};

// Prints the path as the last line on stdout; with `open`, also starts xdg-open on it.
class HeadlessPageViewer : public PageViewer {
  public:
    explicit HeadlessPageViewer(bool open = false) : open_(open) {}
    bool showPage(const QString& path, QString* error) override;

  private:
    bool open_;
};

}  // namespace etq
