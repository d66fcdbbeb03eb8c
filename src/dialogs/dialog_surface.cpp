#include "dialogs/dialog_surface.h"

#include <QComboBox>
#include <QLineEdit>

namespace etq {

// A combo box or text box of the window. What neither has reads as empty and takes nothing.
class DialogSurface::WidgetControl : public Control {
  public:
    explicit WidgetControl(QWidget* widget)
        : combo_(qobject_cast<QComboBox*>(widget)), box_(qobject_cast<QLineEdit*>(widget)) {}

    ControlKind kind() const override {
        return combo_ ? ControlKind::ComboBox : ControlKind::TextBox;
    }
    int tab() const override { return -1; }

    QString text() const override { return box_ ? box_->text() : QString(); }
    void setText(const QString& text) override {
        if (box_) box_->setText(text);
    }
    int listIndex() const override { return combo_ ? combo_->currentIndex() : -1; }
    void setListIndex(int index) override {
        if (combo_) combo_->setCurrentIndex(index);
    }
    int listCount() const override { return combo_ ? combo_->count() : 0; }
    QString itemText(int i) const override { return combo_ ? combo_->itemText(i) : QString(); }
    int itemData(int i) const override { return combo_ ? combo_->itemData(i).toInt() : 0; }
    void addItem(const QString& text, int data) override {
        if (combo_) combo_->addItem(text, data);
    }
    void clearList() override {
        if (combo_) combo_->clear();
    }

    QString caption() const override { return {}; }
    void setCaption(const QString&) override {}
    int state() const override { return 0; }
    void setState(int) override {}
    int currentTab() const override { return -1; }
    void setCurrentTab(int) override {}
    int tabCount() const override { return 0; }
    bool visible() const override { return !widget()->isHidden(); }
    void setVisible(bool visible) override { widget()->setVisible(visible); }
    QString tag() const override { return widget()->property("Tag").toString(); }
    void setTag(const QString& tag) override { widget()->setProperty("Tag", tag); }
    QString toolTip() const override { return widget()->toolTip(); }
    void setToolTip(const QString& toolTip) override { widget()->setToolTip(toolTip); }
    int width() const override { return widget()->width(); }
    void setWidth(int width) override { widget()->setFixedWidth(width); }
    void setFocus() override { widget()->setFocus(); }

  private:
    QWidget* widget() const { return combo_ ? static_cast<QWidget*>(combo_) : box_; }

    QComboBox* combo_;
    QLineEdit* box_;
};

DialogSurface::DialogSurface(QWidget& window) {
    for (QWidget* child : window.findChildren<QWidget*>()) {
        if (child->objectName().isEmpty()) continue;
        if (qobject_cast<QComboBox*>(child) || qobject_cast<QLineEdit*>(child))
            controls_.insert(child->objectName(), std::make_shared<WidgetControl>(child));
    }
}

DialogSurface::~DialogSurface() = default;

int DialogSurface::elementCount(const QString& name) const {
    const QString prefix = name + u'(';
    int count = 0;
    for (auto it = controls_.cbegin(); it != controls_.cend(); ++it)
        if (it.key().startsWith(prefix)) ++count;
    return count;
}

Control* DialogSurface::find(const QString& name, int index) const {
    return controls_.value(elementName(name, index)).get();
}

}  // namespace etq
