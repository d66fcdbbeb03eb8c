// etiquon: the control's window on the desktop.
#include <QApplication>
#include <QCommandLineParser>
#include <QDir>
#include <QTabWidget>
#include <QTextStream>
#include <QVBoxLayout>

#include "card/main_card.h"
#include "dialogs/label_designer_window.h"
#include "platform/context.h"
#include "platform/qt_browser.h"
#include "platform/qt_messages.h"

namespace {

// Saves one PNG of the window per tab of the card: tab-0.png to tab-7.png.
int saveScreenshots(QWidget& window, etq::MainCard& card, const QString& folder) {
    if (!QDir().mkpath(folder)) {
        QTextStream(stderr) << "etiquon: cannot create " << folder << Qt::endl;
        return 1;
    }
    window.show();
    for (int tab = 0; tab < card.mainTab()->count(); ++tab) {
        card.mainTab()->setCurrentIndex(tab);
        QApplication::processEvents();
        const QString file = QDir(folder).filePath(QStringLiteral("tab-%1.png").arg(tab));
        if (!window.grab().save(file)) {
            QTextStream(stderr) << "etiquon: cannot write " << file << Qt::endl;
            return 1;
        }
    }
    // And the label designer, tab by tab: designer-0.png to designer-2.png.
    const std::unique_ptr<etq::LabelDesignerWindow> designer =
        card.makeLabelDesigner(card.control(QStringLiteral("txtDBPath")).text());
    designer->show();
    auto* tabs = designer->findChild<QTabWidget*>(QStringLiteral("SSTab1"));
    for (int tab = 0; tabs && tab < tabs->count(); ++tab) {
        tabs->setCurrentIndex(tab);
        QApplication::processEvents();
        const QString file = QDir(folder).filePath(QStringLiteral("designer-%1.png").arg(tab));
        if (!designer->grab().save(file)) {
            QTextStream(stderr) << "etiquon: cannot write " << file << Qt::endl;
            return 1;
        }
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("etiquon"));
    QApplication::setApplicationVersion(QStringLiteral(ETIQUON_VERSION));
    // The surface is Hebrew: prefer a Hebrew face, with a wide-coverage one behind it.
    QFont font = QApplication::font();
    font.setFamilies({QStringLiteral("Nachlieli CLM"), QStringLiteral("DejaVu Sans")});
    QApplication::setFont(font);

    QCommandLineParser parser;
    parser.setApplicationDescription(QStringLiteral(
        "Prints labels for the items and stock documents of a Hebrew accounting package."));
    parser.addHelpOption();
    parser.addVersionOption();
    const QCommandLineOption settingId(
        QStringLiteral("setting-id"),
        QStringLiteral("Use the settings of the hosting page with this SettingID."),
        QStringLiteral("N"));
    const QCommandLineOption english(QStringLiteral("english"),
                                     QStringLiteral("Messages and dialogs in English."));
    const QCommandLineOption screenshots(
        QStringLiteral("screenshots"),
        QStringLiteral("Save a picture of every tab into FOLDER and quit."),
        QStringLiteral("FOLDER"));
    parser.addOptions({settingId, english, screenshots});
    parser.process(app);

    QWidget window;
    window.setWindowTitle(QStringLiteral("Etiquon"));
    etq::Context context;
    etq::QtMessageSink sink(&window);
    context.setMessages(&sink);
    etq::DesktopPageViewer viewer;
    context.setPages(&viewer);
    auto* layout = new QVBoxLayout(&window);
    auto* card = new etq::MainCard(context, &window);
    layout->addWidget(card);

    card->InitProperties(parser.value(settingId));
    if (parser.isSet(english)) context.language = 1;

    if (parser.isSet(screenshots)) return saveScreenshots(window, *card, parser.value(screenshots));
    window.show();
    return app.exec();
}
