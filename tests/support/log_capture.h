#pragma once

#include <QLoggingCategory>
#include <QStringList>

namespace etq::test {

// Keeps what the component writes to its diagnostic log while it lives, for tests of failures
// that the component passes over without a word.
class LogCapture {
  public:
    LogCapture() : previous_(qInstallMessageHandler(&LogCapture::keep)) { lines().clear(); }
    ~LogCapture() { qInstallMessageHandler(previous_); }
    LogCapture(const LogCapture&) = delete;
    LogCapture& operator=(const LogCapture&) = delete;

    // Every message so far, each as "category: text".
    QStringList messages() const { return lines(); }
    bool contains(const QString& part) const {
        for (const QString& line : lines())
            if (line.contains(part)) return true;
        return false;
    }

  private:
    static QStringList& lines() {
        static QStringList kept;
        return kept;
    }
    static void keep(QtMsgType, const QMessageLogContext& context, const QString& message) {
        lines().append(QString::fromLatin1(context.category ? context.category : "") + ": " +
                       message);
    }

    QtMessageHandler previous_;
};

}  // namespace etq::test
