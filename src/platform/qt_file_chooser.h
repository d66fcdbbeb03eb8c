#pragma once

#include <QPointer>
#include <QWidget>

#include "platform/file_chooser.h"

namespace etq {

// The component's file dialog on the desktop: Qt's open-file dialog over a parent window.
class QtFileChooser : public FileChooser {
  public:
    explicit QtFileChooser(QWidget* parent = nullptr) : parent_(parent) {}
    QString chooseFile(const QString& filter, int filterIndex) override;

  private:
    QPointer<QWidget> parent_;
};

}  // namespace etq
