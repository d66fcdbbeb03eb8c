#include "platform/qt_browser.h"

#include <QDesktopServices>
#include <QUrl>

namespace etq {

bool DesktopPageViewer::showPage(const QString& path, QString* error) {
    if (QDesktopServices::openUrl(QUrl::fromLocalFile(path))) return true;
    if (error) *error = QStringLiteral("No browser could be started to show %1").arg(path);
    return false;
}

}  // namespace etq
