#pragma once

// gLabels as label software that prints on this system. gLabels 3 has no automation of its own:
// its glabels-3-batch merges a design (.glabels) with a text merge source into a PDF. So the
// object made here keeps the records of the open design, and when the design is closed writes
// them as the design's merge file, has glabels-3-batch make the PDF in the run's private print
// folder (print_folder.h, kept there so the user can see what was printed) and sends it to CUPS
// with lp.
//
// Class kGLabelsClass; its members, reached through the automation layer:
//   Printer = name         the CUPS printer; left unset, lp's default
//   OutputFile = path      keep the labels in that PDF instead of printing them
//   Open(design)           checks the design file and reads its merge fields and merge type
//   SetField(name, text)   fills a field of the current record; "-" (a field slot that names
//                          no variable) is passed over unless the design merges such a field
//   PrintRecord(copies)    queues the current record `copies` times (one merge row each: gLabels
//                          has no quantity of its own)
//   Close()                prints what the open design has queued, and closes it
//   Quit()                 with OutputFile, writes every PDF of the session there, joined
// Whatever would print fewer labels than asked fails instead: a missing glabels-3-batch, a
// design without a text merge source, a field the design does not merge, a merge field no
// value was given for, a PDF that glabels-3-batch did not write. Records queued when the
// object is released without Close are not printed.

#include <QString>
#include <QStringList>
#include <functional>

#include "platform/automation.h"

namespace etq {

inline constexpr QStringView kGLabelsClass = u"gLabels.Application";
inline constexpr QStringView kGLabelsBatch = u"glabels-3-batch";

// What a gLabels design takes from its merge source.
struct GLabelsDesign {
    QStringList fields;  // the merge fields its objects name, in the order they first appear
    QChar delimiter;     // between the fields of a merge line
};

// Reads a design file, plain or gzip-compressed XML as gLabels writes it. Throws Failure when
// the file is missing or no gLabels design, or when it has no text merge source whose first
// line names the fields (merge type "Text/Comma/Line1Keys" and its Tab, Colon and Semicolon
// siblings).
GLabelsDesign readGLabelsDesign(const QString& path);

// One merge line of values: each value quoted, with the escapes gLabels reads back.
QByteArray glabelsMergeLine(const QStringList& values, QChar delimiter);

class GLabelsProvider : public AutomationProvider {
  public:
    // `made` hears of every PDF the objects make, printed or kept.
    using Listener = std::function<void(const QString& pdf)>;
    explicit GLabelsProvider(Listener made = {}) : made_(std::move(made)) {}

    bool provides(const QString& className) const override;
    // Throws Failure when glabels-3-batch is not installed or the print folder cannot be used.
    AutomationObject create(const QString& className) override;

  private:
    Listener made_;
};

}  // namespace etq
