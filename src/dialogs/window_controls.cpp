#include "dialogs/window_controls.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "dialogs/language_switch.h"

namespace etq {

QPushButton* makeButton(const QString& name, const QString& hebrew, const QString& english,
                        QWidget* parent) {
    auto* button = new QPushButton(hebrew, parent);
    button->setObjectName(name);
    button->setProperty("Tag", english);
    return button;
}

QLabel* makeLabel(const QString& name, const QString& hebrew, const QString& english,
                  QWidget* parent) {
    auto* label = new QLabel(hebrew, parent);
    label->setObjectName(name);
    label->setProperty("Tag", english);
    return label;
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
