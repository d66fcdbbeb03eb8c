#include "platform/browser.h"

#include <QProcess>
#include <QTextStream>

#include "platform/failure.h"

namespace etq {

void HeadlessPageViewer::showPage(const QString& path) {
    QTextStream(stdout) << path << Qt::endl;
    if (open_ && !QProcess::startDetached(QStringLiteral("xdg-open"), {path}))
        throw Failure(QStringLiteral("Cannot start xdg-open to show %1").arg(path));
}

}  // namespace etq
