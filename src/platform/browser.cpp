#include "platform/browser.h"

#include <QProcess>
#include <QTextStream>

namespace etq {

bool HeadlessPageViewer::showPage(const QString& path, QString* error) {
    QTextStream(stdout) << path << Qt::endl;
    if (!open_) return true;
    if (QProcess::startDetached(QStringLiteral("xdg-open"), {path})) return true;
    if (error) *error = QStringLiteral("Cannot start xdg-open to show %1").arg(path);
    return false;
}

}  // namespace etq
