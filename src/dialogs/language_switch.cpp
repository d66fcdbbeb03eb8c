#include "dialogs/language_switch.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QComboBox>
#include <QLabel>
#include <QPushButton>

namespace etq {

namespace {

QWidget* scope(QWidget* window, QWidget* container) {
    return container ? container : window;
}

// Views keep the direction they were designed with; their columns are aligned by the callers.
bool hasMirrorForm(const QWidget* control) {
    return !qobject_cast<const QAbstractItemView*>(control);
}

}  // namespace

void MirrorControls(QWidget* window, QWidget* container) {
    QWidget* root = scope(window, container);
    for (QWidget* control : root->findChildren<QWidget*>()) {
        if (!hasMirrorForm(control)) {
            // Pinned, so the switch of the window around it does not reach it.
            control->setLayoutDirection(control->layoutDirection());
            continue;
        }
        if (control->parentWidget() && !hasMirrorForm(control->parentWidget())) continue;
        ClearRightToLeft(control);
        if (auto* label = qobject_cast<QLabel*>(control)) AlignLabelLeft(label);
    }
    root->setLayoutDirection(Qt::LeftToRight);
}

void ClearRightToLeft(QWidget* control) {
    if (!hasMirrorForm(control)) return;
    if (control->layoutDirection() == Qt::RightToLeft) control->setLayoutDirection(Qt::LeftToRight);
}

void AlignLabelLeft(QLabel* label) {
    const Qt::Alignment alignment = label->alignment();
    if (alignment & (Qt::AlignHCenter | Qt::AlignJustify)) return;
    label->setAlignment((alignment & Qt::AlignVertical_Mask) | Qt::AlignLeft | Qt::AlignAbsolute);
}

void ApplyTagCaptions(QWidget* window, QWidget* container) {
    for (QWidget* control : scope(window, container)->findChildren<QWidget*>()) {
        const QString tag = control->property("Tag").toString();
        if (tag.isEmpty()) continue;
        if (auto* label = qobject_cast<QLabel*>(control))
            label->setText(tag);
        else if (auto* button = qobject_cast<QAbstractButton*>(control))
            button->setText(tag);
    }
}

void FillComboFromList(QComboBox* combo, const QString& list) {
    combo->clear();
    combo->addItems(list.split(u';'));
    combo->setCurrentIndex(-1);
}

}  // namespace etq
