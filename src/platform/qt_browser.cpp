#include "platform/qt_browser.h"

#include <QDesktopServices>
#include <QUrl>

#include "platform/failure.h"

namespace etq {

void DesktopPageViewer::showPage(const QString& path) {
    if (!QDesktopServices::openUrl(QUrl::fromLocalFile(path)))
        throw Failure(QStringLiteral("No browser could be started to show %1").arg(path));
}

}  // namespace etq
