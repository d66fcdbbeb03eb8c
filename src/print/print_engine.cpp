#include "print/print_engine.h"

#include <QCoreApplication>
#include <memory>
#include <thread>

#include "jet/database.h"
#include "jet/recordset.h"
#include "jet/vb.h"
#include "platform/automation.h"
#include "platform/context.h"
#include "platform/failure.h"
#include "platform/label_fields.h"
#include "platform/progress.h"
#include "print/label_software.h"

namespace etq {

PrintPacing::Clock::time_point SystemPacing::now() {
    return Clock::now();
}

void SystemPacing::sleepFor(Clock::duration duration) {
    std::this_thread::sleep_for(duration);
}

void SystemPacing::yield() {
    if (QCoreApplication::instance()) QCoreApplication::processEvents();
}

namespace {

// Where a run stands; the error message tells it.
struct RunState {
    qint32 line = 0;     // the marker of the step under way
    qint16 labelId = 0;  // NiceLabel's handle of the open design
    QString lastVariable;
    QString lastValue;
};

// One kind's calls for the steps of a run. CodeSoft and BarTender have always left the step
// markers alone (the engine still sets 7 and 17 for them); the other kinds mark their steps.
class Driver {
  public:
    Driver(AutomationObject application, RunState& state, bool marksSteps)
        : app_(std::move(application)), state_(state), marksSteps_(marksSteps) {}
    virtual ~Driver() = default;

    void mark(qint32 line) {
        if (marksSteps_) state_.line = line;
    }

    virtual void open(const QString& file, bool head) = 0;
    // Before a detail record's variables are filled.
    virtual void beginRecord() {}
    virtual void setVariable(const QString& name, const QVariant& value, const QString& text) = 0;
    virtual void printRecord(const QVariant& copies) = 0;
    virtual void printHead() = 0;
    virtual void closeBeforeHead() = 0;
    virtual void closeBeforeRecord() = 0;
    virtual void endOfRun() = 0;

  protected:
    AutomationObject app_;
    RunState& state_;

  private:
    bool marksSteps_;
};

class CodeSoftDriver : public Driver {
  public:
    CodeSoftDriver(AutomationObject app, RunState& state) : Driver(std::move(app), state, false) {}

    void open(const QString& file, bool) override {
        app_.set(QStringLiteral("Visible"), false);
        document_ = app_.object(QStringLiteral("ActiveDocument"));
        document_.call(QStringLiteral("Open"), {file});
    }
    void setVariable(const QString& name, const QVariant& value, const QString&) override {
        document_.object(QStringLiteral("Variables"), {name}).set(QStringLiteral("Value"), value);
    }
    void printRecord(const QVariant& copies) override {
        document_.call(QStringLiteral("PrintLabel"), {copies});
    }
    void printHead() override { printRecord(1); }
    void closeBeforeHead() override {
        document_.call(QStringLiteral("FormFeed"));
        document_.call(QStringLiteral("Close"), {0});
    }
    void closeBeforeRecord() override { closeBeforeHead(); }
    void endOfRun() override { document_.call(QStringLiteral("FormFeed")); }

  private:
    AutomationObject document_;
};

class BarTenderDriver : public Driver {
  public:
    BarTenderDriver(AutomationObject app, RunState& state) : Driver(std::move(app), state, false) {}

    void open(const QString& file, bool) override {
        app_.set(QStringLiteral("Visible"), false);
        formats_ = app_.object(QStringLiteral("Formats"));
        format_ = formats_.callObject(QStringLiteral("Open"), {file, false, QString()});
    }
    void setVariable(const QString& name, const QVariant&, const QString& text) override {
        format_.call(QStringLiteral("SetNamedSubStringValue"), {name, text});
    }
    void printRecord(const QVariant& copies) override {
        format_.set(QStringLiteral("IdenticalCopiesOfLabel"), copies);
        format_.call(QStringLiteral("PrintOut"), {true, false});
    }
    void printHead() override { printRecord(1); }
    void closeBeforeHead() override { format_.call(QStringLiteral("Close"), {1}); }
    void closeBeforeRecord() override { closeBeforeHead(); }
    void endOfRun() override { app_.call(QStringLiteral("Quit"), {1}); }

  private:
    AutomationObject formats_;
    AutomationObject format_;
};

class NiceLabelDriver : public Driver {
  public:
    NiceLabelDriver(AutomationObject app, RunState& state, bool a4)
        : Driver(std::move(app), state, true), a4_(a4) {}

    void open(const QString& file, bool head) override {
        const QVariant handle = app_.call(QStringLiteral("LabelOpen"), {file});
        state_.labelId = vb::toInteger(handle).value_or(0);
        mark(head ? 16 : 6);
        if (a4_) app_.call(QStringLiteral("LabelSessionStart"), {state_.labelId});
    }
    void setVariable(const QString& name, const QVariant&, const QString& text) override {
        app_.call(QStringLiteral("LabelSetVar"), {state_.labelId, name, text, -9999, -9999});
    }
    void printRecord(const QVariant& copies) override {
        mark(8);
        print(vb::toText(copies) + QStringLiteral(",0"));
    }
    void printHead() override { print(QStringLiteral("1,0")); }
    void closeBeforeHead() override { close(14); }
    void closeBeforeRecord() override {
        mark(3);
        close(4);
    }
    void endOfRun() override {
        close(11);
        mark(12);
        app_.call(QStringLiteral("Quit"));
    }

  private:
    void print(const QString& quantity) {
        app_.call(a4_ ? QStringLiteral("LabelSessionPrint") : QStringLiteral("LabelPrint"),
                  {state_.labelId, quantity});
    }
    // The session ends before the design closes, at the marker already set.
    void close(qint32 closeLine) {
        if (a4_) app_.call(QStringLiteral("LabelSessionEnd"), {state_.labelId});
        mark(closeLine);
        app_.call(QStringLiteral("LabelClose"), {state_.labelId});
    }

    bool a4_;
};

class FastLabelDriver : public Driver {
  public:
    FastLabelDriver(AutomationObject app, RunState& state) : Driver(std::move(app), state, true) {}

    void open(const QString& file, bool) override {
        app_.call(QStringLiteral("LabelOpen"), {file, QString()});
        newBatch_ = true;
    }
    void beginRecord() override {
        if (!newBatch_) app_.call(QStringLiteral("AddRecord"));
    }
    void setVariable(const QString& name, const QVariant&, const QString& text) override {
        app_.call(QStringLiteral("LabelSetVar"), {name, text});
    }
    void printRecord(const QVariant& copies) override {
        app_.set(QStringLiteral("LabelQty"), copies);
        newBatch_ = false;
    }
    void printHead() override {
        app_.set(QStringLiteral("LabelQty"), 1);
        app_.call(QStringLiteral("LabelPrint"));
        newBatch_ = true;
    }
    void closeBeforeHead() override { app_.call(QStringLiteral("LabelPrint")); }
    // The records queued for the design are printed before another design opens; dropping
    // them printed fewer labels than asked, without a word.
    void closeBeforeRecord() override {
        if (!newBatch_) app_.call(QStringLiteral("LabelPrint"));
        newBatch_ = true;
    }
    void endOfRun() override { app_.call(QStringLiteral("LabelPrint")); }

  private:
    bool newBatch_ = true;
};

class GLabelsDriver : public Driver {
  public:
    GLabelsDriver(AutomationObject app, RunState& state, const LabelSoftwareOptions& options)
        : Driver(std::move(app), state, true) {
        if (options.printer) app_.set(QStringLiteral("Printer"), *options.printer);
        if (!options.outputFile.isEmpty())
            app_.set(QStringLiteral("OutputFile"), options.outputFile);
    }

    void open(const QString& file, bool) override { app_.call(QStringLiteral("Open"), {file}); }
    void setVariable(const QString& name, const QVariant&, const QString& text) override {
        app_.call(QStringLiteral("SetField"), {name, text});
    }
    void printRecord(const QVariant& copies) override {
        mark(8);
        app_.call(QStringLiteral("PrintRecord"), {vb::toLong(copies).value_or(0)});
    }
    void printHead() override { app_.call(QStringLiteral("PrintRecord"), {1}); }
    void closeBeforeHead() override { app_.call(QStringLiteral("Close")); }
    void closeBeforeRecord() override { closeBeforeHead(); }
    void endOfRun() override {
        app_.call(QStringLiteral("Close"));
        app_.call(QStringLiteral("Quit"));
    }
};

std::unique_ptr<Driver> createDriver(const LabelSoftwareOptions& options, RunState& state,
                                     const AutomationRegistry& registry) {
    const LabelSoftware software = labelSoftwareOf(options.kind);
    state.line = 2;
    if (software.automationClass.isEmpty())
        throw Failure(
            QStringLiteral("No label software is chosen to print with (label software kind %1)")
                .arg(options.kind));
    AutomationObject app = registry.create(software.automationClass, software.program);
    switch (options.kind) {
        case kCodeSoft:
            return std::make_unique<CodeSoftDriver>(std::move(app), state);
        case kBarTender:
            return std::make_unique<BarTenderDriver>(std::move(app), state);
        case kNiceLabel:
            return std::make_unique<NiceLabelDriver>(std::move(app), state, options.a4);
        case kFastLabel:
            return std::make_unique<FastLabelDriver>(std::move(app), state);
        default:
            return std::make_unique<GLabelsDriver>(std::move(app), state, options);
    }
}

qint16 printDelayOf(const QString& typed) {
    if (typed.trimmed().isEmpty()) return 0;
    const std::optional<qint16> seconds = vb::toInteger(typed);
    if (!seconds)
        throw Failure(
            QStringLiteral(
                "The print delay \"%1\" is no whole number of seconds from -32768 to 32767")
                .arg(typed));
    return *seconds;
}

QString priceFormatOf(const QString& given) {
    const QString format = given.trimmed();
    return format.isEmpty() ? QStringLiteral("0.00") : format;
}

// The whole run, from the open query to the end-of-run step.
class Run {
  public:
    Run(const LabelSoftwareOptions& options, RunState& state)
        : options_(options),
          state_(state),
          delay_(printDelayOf(options.printDelay)),
          priceFormat_(priceFormatOf(options.priceFormat)) {}

    void go(Context& context, Progress& progress, PrintPacing& pacing) {
        db_ = jet::Database::open(options_.workDatabase);
        rs_ = db_.openRecordset(BuildLabelQuery(options_.query));
        state_.line = 1;
        progress.clear();
        driver_ = createDriver(options_, state_, context.automation());

        rs_.moveLast();
        const qint32 total = rs_.recordCount();
        rs_.moveFirst();
        qint32 counter = 0;
        for (; !rs_.eof(); rs_.moveNext()) {
            if (options_.headLabels) printHeadOnNewDocument();
            openDesignOfRecord();
            driver_->beginRecord();
            state_.line = 7;
            fillVariables();
            pacing.yield();
            driver_->printRecord(rs_.value(QStringLiteral("Copies")));
            progress.show(++counter, total);
            wait(pacing);
        }
        driver_->mark(10);
        driver_->endOfRun();
        progress.step(context.caption(44));
        rs_.close();
        db_.close();
    }

  private:
    void printHeadOnNewDocument() {
        const qint32 file = vb::toLong(rs_.value(QStringLiteral("WizFileID"))).value_or(0);
        const qint32 number = vb::toLong(rs_.value(QStringLiteral("Number"))).value_or(0);
        if (file == previousFile_ && number == previousNumber_) return;
        previousFile_ = file;
        previousNumber_ = number;
        if (!currentLabelFile_.isEmpty()) {
            driver_->mark(13);
            driver_->closeBeforeHead();
        }
        driver_->mark(15);
        driver_->open(options_.headLabelFile, true);
        state_.line = 17;
        fillVariables();
        driver_->mark(18);
        driver_->printHead();
        currentLabelFile_ = options_.headLabelFile;
    }

    void openDesignOfRecord() {
        const QString account = vb::toText(rs_.value(QStringLiteral("AccountLabel")));
        const QString design = account.isEmpty() ? options_.labelFile : account;
        if (design == currentLabelFile_) return;
        if (!currentLabelFile_.isEmpty()) {
            driver_->mark(4);
            driver_->closeBeforeRecord();
        }
        driver_->mark(5);
        driver_->open(design, false);
        currentLabelFile_ = design;
    }

    void fillVariables() {
        for (const LabelFieldSlot& slot : labelFieldSlots()) {
            if (!options_.query.fieldChecks[size_t(slot.slot)]) continue;
            QVariant value = rs_.value(slot.column.toString());
            if (value.isNull()) value = QStringLiteral("");
            state_.lastVariable = slot.variable.toString();
            switch (fieldFormat(slot.formatTag)) {
                case FieldFormat::Price:
                    state_.lastValue = vb::format(value, priceFormat_);
                    break;
                case FieldFormat::Date:
                    state_.lastValue = vb::format(value, QStringLiteral("dd/mm/yy"));
                    break;
                case FieldFormat::Plain:
                    state_.lastValue = vb::toText(value);
                    break;
            }
            driver_->setVariable(state_.lastVariable, value, state_.lastValue);
        }
    }

    // Waits the print delay on the clock, without letting the window in.
    void wait(PrintPacing& pacing) const {
        if (delay_ == 0) return;
        const auto until = pacing.now() + std::chrono::seconds(delay_);
        for (auto now = pacing.now(); now < until; now = pacing.now())
            pacing.sleepFor(until - now);
    }

    const LabelSoftwareOptions& options_;
    RunState& state_;
    const qint16 delay_;
    const QString priceFormat_;
    jet::Database db_;
    jet::Recordset rs_;
    std::unique_ptr<Driver> driver_;
    QString currentLabelFile_;
    qint32 previousFile_ = -1;
    qint32 previousNumber_ = -1;
};

}  // namespace

void printWithLabelSoftware(const LabelSoftwareOptions& options, Context& context,
                            Progress& progress, PrintPacing& pacing) {
    RunState state;
    try {
        Run(options, state).go(context, progress, pacing);
    } catch (const std::exception& e) {
        throw Failure(describe(e) + QStringLiteral(" In Line ") + QString::number(state.line) +
                      QStringLiteral(", LabelID = ") + QString::number(state.labelId) +
                      QStringLiteral(", Var = ") + state.lastVariable +
                      QStringLiteral(", Value = ") + state.lastValue);
    }
}

}  // namespace etq
