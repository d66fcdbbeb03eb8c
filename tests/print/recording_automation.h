#pragma once

#include <QHash>
#include <QStringList>
#include <chrono>
#include <memory>

#include "platform/automation.h"
#include "platform/failure.h"
#include "print/print_engine.h"

namespace etq::print::test {

// Stands in for the label software programs, which this system does not have: every call made
// on the objects it creates is kept as a line ("app.LabelSetVar(7, "ItemKey", "A", -9999,
// -9999)", "app.LabelQty = 2"); property reads are not kept. A member answers what `results`
// says, or a new object named after it (`names` gives shorter names: ActiveDocument -> doc). One
// call can be made to fail.
class RecordingAutomation : public AutomationProvider {
  public:
    RecordingAutomation() {
        results.insert("LabelOpen", 7);
        names = {{"ActiveDocument", "doc"},
                 {"Formats", "formats"},
                 {"Open", "format"},
                 {"Variables", "var"}};
    }

    bool provides(const QString& className) const override {
        return QStringList{"LPPX.Application", "BarTender.Application", "NiceLabel.Application",
                           "FastLabel.FastLabelX", "gLabels.Application"}
            .contains(className);
    }
    AutomationObject create(const QString& className) override {
        calls << "new " + className;
        return object("app");
    }

    QStringList calls;
    QHash<QString, QVariant> results;
    QHash<QString, QString> names;
    // The member whose call number `failingCall` (1 = its first) throws "<member> failed".
    QString failing;
    int failingCall = 1;

    // The calls that contain any of the texts.
    QStringList callsWith(const QStringList& texts) const {
        QStringList out;
        for (const QString& call : calls)
            for (const QString& text : texts)
                if (call.contains(text)) {
                    out << call;
                    break;
                }
        return out;
    }

  private:
    class Server : public AutomationServer {
      public:
        Server(RecordingAutomation& owner, QString name) : owner_(owner), name_(std::move(name)) {}
        QVariant invoke(Invoke how, const QString& member, const QVariantList& args) override {
            return owner_.invoke(name_, how, member, args);
        }

      private:
        RecordingAutomation& owner_;
        QString name_;
    };

    AutomationObject object(const QString& name) {
        return AutomationObject(std::make_shared<Server>(*this, name));
    }

    static QString text(const QVariant& v) {
        if (v.metaType().id() == QMetaType::QString) return '"' + v.toString() + '"';
        if (v.metaType().id() == QMetaType::Bool) return v.toBool() ? "True" : "False";
        return v.toString();
    }
    static QString list(const QVariantList& args) {
        QStringList out;
        for (const QVariant& a : args)
            out << text(a);
        return out.join(", ");
    }

    QVariant invoke(const QString& object, Invoke how, const QString& member,
                    const QVariantList& args) {
        if (how == Invoke::Put)
            calls << object + "." + member + " = " + text(args.value(0));
        else if (how == Invoke::Method)
            calls << object + "." + member + "(" + list(args) + ")";
        if (how != Invoke::Get && member == failing && ++seen_[member] == failingCall)
            throw Failure(member + " failed");
        if (results.contains(member)) return results.value(member);
        QString child = names.value(member, member);
        if (how == Invoke::Get && !args.isEmpty()) child += "(" + list(args) + ")";
        return this->object(child).toVariant();
    }

    QHash<QString, int> seen_;
};

// A clock that moves only when the run sleeps; every sleep and yield is kept among the calls.
class RecordingPacing : public PrintPacing {
  public:
    explicit RecordingPacing(QStringList& calls) : calls_(calls) {}
    Clock::time_point now() override { return now_; }
    void sleepFor(Clock::duration duration) override {
        now_ += duration;
        calls_ << QStringLiteral("sleep %1 ms")
                      .arg(std::chrono::duration_cast<std::chrono::milliseconds>(duration).count());
    }
    void yield() override { calls_ << "yield"; }
    Clock::duration elapsed() const { return now_ - Clock::time_point(); }

  private:
    QStringList& calls_;
    Clock::time_point now_{};
};

}  // namespace etq::print::test
