#pragma once

#include <QHash>
#include <memory>

#include "surface/surface.h"

class QWidget;

namespace etq {

// The controls of a dialog window as a surface, so that its settings group moves between the
// store and the window by control name (GetSetParams). The combo boxes and text boxes among the
// window's children are its controls, found by objectName ("cmbAltSearchBy(0)" for an element of
// an array); a combo box offers its list and position, a text box its text. The surface looks at
// the window as it is when made.
class DialogSurface : public Surface {
  public:
    explicit DialogSurface(QWidget& window);
    ~DialogSurface() override;

    int elementCount(const QString& name) const override;

  protected:
    Control* find(const QString& name, int index) const override;

  private:
    class WidgetControl;
    QHash<QString, std::shared_ptr<WidgetControl>> controls_;  // by element name
};

}  // namespace etq
