#pragma once

// The print engine of the label software routes: it opens the label query on the working
// database, creates the kind's label software through the run's automation registry
// (Context::automation) and, record by record, opens the record's design (its account's, or
// the default), fills the design's variables from the checked field slots, and prints the
// record's copies; for document lines it can print one head label before each document's
// lines. Each kind has its own calls for those steps, as its program expects them.
//
// A failure anywhere ends the run with one Failure whose description tells where the run
// stood: "<reason> In Line <marker>, LabelID = <NiceLabel handle>, Var = <variable>, Value =
// <text>". What was printed before it stays printed; the label software is neither closed nor
// told to quit, only released.

#include <QString>
#include <chrono>
#include <optional>

#include "print/label_query.h"

namespace etq {

class Context;
class Progress;

// What a print run through label software does.
struct LabelSoftwareOptions {
    QString workDatabase;  // the working database the label query runs on
    qint16 kind = 0;       // the label software kind (label_software.h)
    QString labelFile;     // the default design
    bool headLabels = false;
    QString headLabelFile;  // the head label's design (head labels only)
    // The query: item labels or document lines, in the printer type's order.
    LabelQueryInput query;
    // Seconds to wait after each record, as typed: empty is 0; otherwise it must be a whole
    // number that fits 16 bits.
    QString printDelay;
    bool a4 = false;      // "A4" printer type: NiceLabel prints in label sessions
    QString priceFormat;  // for values of price fields; blank: "0.00"
    // Where gLabels puts its labels: the printer (lp's default when none) or, when outputFile is
    // not empty, that PDF file and no printer.
    std::optional<QString> printer;
    QString outputFile;
};

// The time a run waits and lets the window breathe: the real clock in a run, a recording one in
// tests.
class PrintPacing {
  public:
    using Clock = std::chrono::steady_clock;
    virtual ~PrintPacing() = default;
    virtual Clock::time_point now() = 0;
    virtual void sleepFor(Clock::duration duration) = 0;
    // Lets the window handle its pending events (repaint, clicks).
    virtual void yield() = 0;
};

// The clock of the system; yield processes the application's pending events, when there is an
// application.
class SystemPacing : public PrintPacing {
  public:
    Clock::time_point now() override;
    void sleepFor(Clock::duration duration) override;
    void yield() override;
};

// Prints the records of the label query through the kind's label software, then shows caption
// 44 as the run's step. Throws Failure (described above) when the run does not reach its end.
void printWithLabelSoftware(const LabelSoftwareOptions& options, Context& context,
                            Progress& progress, PrintPacing& pacing);

}  // namespace etq
