#include "dialogs/window_controls.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "dialogs/language_switch.h"

namespace etq {

namespace {
template <class Control>
Control* named(Control* control, const QString& name, const QString& english) {
    control->setObjectName(name);
    control->setProperty("Tag", english);
    return control;
}
}  // namespace

QPushButton* makeButton(const QString& name, const QString& hebrew, const QString& english,
                        QWidget* parent) {
    return named(new QPushButton(hebrew, parent), name, english);
}

QLabel* makeLabel(const QString& name, const QString& hebrew, const QString& english,
                  QWidget* parent) {
    return named(new QLabel(hebrew, parent), name, english);
}

QLineEdit* makeBox(const QString& name, QWidget* parent) {
    auto* box = new QLineEdit(parent);
    box->setObjectName(name);
    return box;
}

QComboBox* makeList(const QString& name, const QString& items, QWidget* parent) {
    auto* combo = new QComboBox(parent);
    combo->setObjectName(name);
    FillComboFromList(combo, items);
    return combo;
}

}  // namespace etq
