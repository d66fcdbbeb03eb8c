#pragma once

#include <QString>

namespace etq {

class Surface;

// The label software kind chosen with the option array OptOLE: 5 NiceLabel (option 0),
// 2 CodeSoft (1), 4 BarTender (2), 6 the built-in label page (3), 7 FastLabel (4), 0 when no
// option is selected.
qint16 GetLabelSoftwareKind(const Surface& surface);

// The file dialog of the component. The window shows a real one; a headless run has none and
// every question is answered as cancelled.
class FileChooser {
  public:
    virtual ~FileChooser() = default;
    // An existing file chosen by the user, or empty text when cancelled. `filter` is in Qt's
    // syntax ("All Files (*);;CodeSoft Files (*.lab)"), empty for none; `filterIndex` counts
    // the filters from 1.
    virtual QString chooseFile(const QString& filter, int filterIndex) = 0;
};

class CancelFileChooser : public FileChooser {
  public:
    QString chooseFile(const QString&, int) override { return {}; }
};

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
