#include "platform/browser.h"

#include <QProcess>
#include <QTextStream>

namespace etq {

namespace {

HeadlessPageViewer g_printingViewer;
PageViewer* g_viewer = nullptr;

}  // namespace

bool HeadlessPageViewer::showPage(const QString& path, QString* error) {
    QTextStream(stdout) << path << Qt::endl;
    if (!open_) return true;
    if (QProcess::startDetached(QStringLiteral("xdg-open"), {path})) return true;
    if (error) *error = QStringLiteral("Cannot start xdg-open to show %1").arg(path);
    return false;
}

PageViewer& pageViewer() {
    return g_viewer ? *g_viewer : g_printingViewer;
}

void setPageViewer(PageViewer* viewer) {
    g_viewer = viewer;
}

}  // namespace etq
