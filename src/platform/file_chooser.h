#pragma once

#include <QString>

namespace etq {

// The file dialog of the component. The window shows a real one; a headless run has none and
// every question is answered as cancelled.
class FileChooser {
  public:
    virtual ~FileChooser() = default;
    // An existing file chosen by the user, or empty text when cancelled. `filter` is in Qt's
    // syntax ("All Files (*);;CodeSoft Files (*.lab)"), empty for none; `filterIndex` counts
    // the filters from 1.
    virtual QString chooseFile(const QString& filter, int filterIndex) = 0;
};

class CancelFileChooser : public FileChooser {
  public:
    QString chooseFile(const QString&, int) override { return {}; }
};

}  // namespace etq
