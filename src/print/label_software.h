#pragma once

#include <QString>

namespace etq {

class FileChooser;

// The label software kinds: the print routes the user chooses among.
inline constexpr qint16 kNoLabelSoftware = 0;
inline constexpr qint16 kCodeSoft = 2;
inline constexpr qint16 kBarTender = 4;
inline constexpr qint16 kNiceLabel = 5;
inline constexpr qint16 kBuiltInPage = 6;
inline constexpr qint16 kFastLabel = 7;
// gLabels: designs merged and printed by glabels-3-batch, driven like the others.
inline constexpr qint16 kGLabels = 8;

// The label software of a kind as the print engine drives it: the automation class it creates
// and the program's name. Kinds without label software (none chosen, the built-in page) have
// an empty class.
struct LabelSoftware {
    QString automationClass;
    QString program;
};
LabelSoftware labelSoftwareOf(qint16 kind);

// The file filters of a kind, as the component writes them ("Name|pattern|Name|pattern"):
// for its label design files and for its program. Kinds without label software have none.
QString labelFileFilter(qint16 kind);
QString labelSoftwareFilter(qint16 kind);

// "All Files (*.*)|*.*|CodeSoft Files (*.lab)|*.lab" -> "All Files (*);;CodeSoft Files (*.lab)".
QString toQtFilter(const QString& filter);

// Open-file dialogs for a label design file and for the label software's program, with the
// kind's filters and the second filter preselected. Empty text when cancelled.
QString SelectLabelFile(qint16 kind, FileChooser& chooser);
QString SelectLabelSoftware(qint16 kind, FileChooser& chooser);

}  // namespace etq
