#pragma once

#include <QString>

class QComboBox;
class QLabel;
class QWidget;

namespace etq {

// The steps with which a dialog turns its Hebrew, right-to-left design into English when the
// language selector is English. Layouts mirror positions by themselves once the direction is
// left to right.

// Turns the window (or only the controls inside `container`) left to right. Grids and views
// have no left-to-right form and keep their direction; labels are left-justified.
void MirrorControls(QWidget* window, QWidget* container = nullptr);

// One control's step of MirrorControls: a right-to-left control becomes left to right.
void ClearRightToLeft(QWidget* control);

// One label's step of MirrorControls: a label justified to a side becomes left-justified;
// centred labels stay centred.
void AlignLabelLeft(QLabel* label);

// Every label, button and check box of the window (or of `container`) whose property "Tag"
// is not empty takes that text as its caption.
void ApplyTagCaptions(QWidget* window, QWidget* container = nullptr);

// Empties the combo box and adds the entries of `list`, split at ";", in order, leaving none
// selected.
void FillComboFromList(QComboBox* combo, const QString& list);

}  // namespace etq
