#pragma once

#include <QString>

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QWidget;

// The controls the dialog windows are made of, each carrying its name as objectName and, for
// those with a caption, its English caption in the property "Tag" (ApplyTagCaptions of
// language_switch.h puts it in place in English mode).
namespace etq {

// The entries of the sort order lists (position 1 descending), in Hebrew and in English.
inline const QString kSortOrderList = QStringLiteral("עולה;יורד");
inline const QString kEnglishSortOrderList = QStringLiteral("Up;Down");

QPushButton* makeButton(const QString& name, const QString& hebrew, const QString& english,
                        QWidget* parent);
QLabel* makeLabel(const QString& name, const QString& hebrew, const QString& english,
                  QWidget* parent);
QLineEdit* makeBox(const QString& name, QWidget* parent);
// A combo box holding the ";"-separated entries of `items`, none selected.
QComboBox* makeList(const QString& name, const QString& items, QWidget* parent);

}  // namespace etq
