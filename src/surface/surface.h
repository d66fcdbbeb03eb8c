#pragma once

#include <QString>
#include <QVariant>
#include <functional>
#include <optional>
#include <stdexcept>

namespace etq {

// The kinds of control on the surface. What a control offers follows from its kind.
enum class ControlKind {
    TextBox,
    Label,
    CommandButton,
    CheckBox,
    OptionButton,
    ComboBox,
    Frame,
    Picture,
    Shape,
    Grid,
    TabStrip,
};

// A control that does not exist, or a property it does not have or a value it does not take.
class SurfaceError : public std::runtime_error {
  public:
    explicit SurfaceError(const QString& message);
    QString message() const { return QString::fromUtf8(what()); }
};

// The primitive state of one control, as an implementation keeps it. Callers never see this:
// they go through ControlRef, which checks kinds and values for every implementation alike.
class Control {
  public:
    virtual ~Control() = default;
    virtual ControlKind kind() const = 0;
    virtual int tab() const = 0;  // the tab of MainTab the control sits on; -1 outside the tabs

    virtual QString text() const = 0;  // text box
    virtual void setText(const QString& text) = 0;
    virtual QString caption() const = 0;  // label, button, check box, option button, frame
    virtual void setCaption(const QString& caption) = 0;
    virtual int state() const = 0;  // check box 0/1/2, option button 0/1
    virtual void setState(int state) = 0;
    virtual int listIndex() const = 0;  // combo box
    virtual void setListIndex(int index) = 0;
    virtual int listCount() const = 0;
    virtual QString itemText(int i) const = 0;
    virtual int itemData(int i) const = 0;
    virtual void addItem(const QString& text, int data) = 0;
    virtual void clearList() = 0;
    virtual int currentTab() const = 0;  // tab strip
    virtual void setCurrentTab(int tab) = 0;
    virtual int tabCount() const = 0;

    virtual bool visible() const = 0;
    virtual void setVisible(bool visible) = 0;
    virtual QString tag() const = 0;
    virtual void setTag(const QString& tag) = 0;
    virtual QString toolTip() const = 0;
    virtual void setToolTip(const QString& toolTip) = 0;
    virtual int width() const = 0;
    virtual void setWidth(int width) = 0;
    virtual void setFocus() = 0;
};

// One control of a surface, found by name and index, with the properties the routines use.
// Asking a control for a property its kind lacks, or giving a property a value it cannot take,
// throws SurfaceError naming the control.
class ControlRef {
  public:
    ControlRef(Control* control, QString name) : control_(control), name_(std::move(name)) {}

    const QString& name() const { return name_; }  // "txtDBPath", "OptOLE(3)"
    ControlKind kind() const { return control_->kind(); }
    int tab() const { return control_->tab(); }

    // Text box: its text. Combo box: the selected entry's text; setting it selects the entry
    // with that text and fails when there is none.
    QString text() const;
    void setText(const QString& text) const;

    // Check box: 0 clear, 1 checked, 2 grey (an int). Option button: selected (a bool).
    // setValue takes those, or their text ("1", "True", "False", ...).
    QVariant value() const;
    void setValue(const QVariant& value) const;
    // The value as the settings store writes it: "0"/"1"/"2", or "True"/"False".
    QString valueText() const;

    // Combo box: the selected position, -1 for none; a position outside the list fails.
    int listIndex() const;
    void setListIndex(int index) const;
    int listCount() const;
    QString listItem(int i) const;
    int itemData(int i) const;
    int selectedItemData() const;  // fails when nothing is selected
    void clearList() const;
    void addItem(const QString& text, int data = 0) const;

    // Tab strip: the current tab.
    int currentTab() const;
    void setCurrentTab(int tab) const;

    QString caption() const;
    void setCaption(const QString& caption) const;
    bool visible() const { return control_->visible(); }
    void setVisible(bool visible) const { control_->setVisible(visible); }
    QString tag() const { return control_->tag(); }
    void setTag(const QString& tag) const { control_->setTag(tag); }
    QString toolTip() const { return control_->toolTip(); }
    void setToolTip(const QString& toolTip) const { control_->setToolTip(toolTip); }
    int width() const { return control_->width(); }
    void setWidth(int width) const;
    void setFocus() const { control_->setFocus(); }

  private:
    void require(bool has, const char* property) const;
    int checkedListPosition(int i) const;

    Control* control_;
    QString name_;
};

// The surface of the control: every control reachable by name, and by index for control
// arrays. The Qt window and the headless surface both implement it from one control table.
class Surface {
  public:
    virtual ~Surface() = default;

    // The control, or SurfaceError when the surface has none of that name and index.
    ControlRef control(const QString& name, int index = -1) const;
    bool hasControl(const QString& name, int index = -1) const;
    // How many elements the control array `name` has (0 when there is no such array).
    virtual int elementCount(const QString& name) const = 0;

    // Called after a control's text, or the tab of MainTab, has changed, whether the user or a
    // routine changed it.
    using ChangeListener = std::function<void(const QString& name, int index)>;
    void setChangeListener(ChangeListener listener) { changeListener_ = std::move(listener); }

  protected:
    virtual Control* find(const QString& name, int index) const = 0;
    void notifyChanged(const QString& name, int index) const;

  private:
    ChangeListener changeListener_;
};

// The state a check box takes from a value: 0, 1 or 2, as numbers or their text; nothing for
// anything else.
std::optional<int> checkStateOf(const QVariant& value);
// The state an option button takes from a value: a boolean, "True"/"False" in any case, or a
// number (not 0 = selected); nothing for anything else.
std::optional<bool> optionStateOf(const QVariant& value);

// "OptOLE(3)" for an array element, the plain name otherwise.
QString elementName(const QString& name, int index);
// Splits "OptOLE(3)" into "OptOLE" and 3; a plain name gives index -1.
std::pair<QString, int> splitElementName(const QString& fullName);

}  // namespace etq
