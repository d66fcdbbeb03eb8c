#include "print/label_software.h"

#include <QStringList>

#include "platform/file_chooser.h"
#include "platform/glabels_automation.h"

namespace etq {

namespace {

struct KindSoftware {
    qint16 kind;
    QStringView labelFiles;
    QStringView software;
    QStringView automationClass;
    QStringView program;
};

constexpr KindSoftware kKinds[] = {
    {kCodeSoft, u"All Files (*.*)|*.*|CodeSoft Files (*.lab)|*.lab",
     u"All Software (*.exe)|*.exe|CodeSoft Software|Lppa.exe", u"LPPX.Application", u"CodeSoft"},
    {kBarTender, u"All Files (*.*)|*.*|BarTender Files (*.btw)|*.btw",
     u"All Software (*.exe)|*.exe|BarTender Software|Bartend.exe", u"BarTender.Application",
     u"BarTender"},
    {kNiceLabel, u"All Files (*.*)|*.*|NiceLabel Files (*.lbl)|*.lbl",
     u"All Software (*.exe)|*.exe|NiceLabel Software|Nice3.exe", u"NiceLabel.Application",
     u"NiceLabel"},
    {kFastLabel, u"All Files (*.*)|*.*|FastLabel Files (*.lbl)|*.lbl",
     u"All Software (*.exe)|*.exe|FastLabel Software|fastlbl.exe", u"FastLabel.FastLabelX",
     u"FastLabel"},
    // gLabels' program has no extension here; its designer is glabels-3.
    {kGLabels, u"All Files (*.*)|*.*|gLabels Files (*.glabels)|*.glabels",
     u"All Software (*.*)|*.*|gLabels Software|glabels-3", u"gLabels.Application", u"gLabels"},
};

const KindSoftware* softwareOf(qint16 kind) {
    for (const KindSoftware& f : kKinds)
        if (f.kind == kind) return &f;
    return nullptr;
}

// The dialogs preselect the kind's own files, the second filter.
constexpr int kPreselectedFilter = 2;

QString choose(const QString& filter, FileChooser& chooser) {
    return chooser.chooseFile(toQtFilter(filter), kPreselectedFilter);
}

}  // namespace

QString labelFileFilter(qint16 kind) {
    const KindSoftware* f = softwareOf(kind);
    return f ? f->labelFiles.toString() : QString();
}

LabelSoftware labelSoftwareOf(qint16 kind) {
    const KindSoftware* f = softwareOf(kind);
    return f ? LabelSoftware{f->automationClass.toString(), f->program.toString()}
             : LabelSoftware{};
}

QString labelSoftwareFilter(qint16 kind) {
    const KindSoftware* f = softwareOf(kind);
    return f ? f->software.toString() : QString();
}

QString toQtFilter(const QString& filter) {
    const QStringList parts = filter.split(u'|');
    QStringList filters;
    for (qsizetype i = 0; i + 1 < parts.size(); i += 2) {
        QString name = parts[i].trimmed();
        // The name may show its patterns already; Qt reads them from the parentheses.
        const qsizetype open = name.lastIndexOf(u'(');
        if (open > 0 && name.endsWith(u')')) name = name.left(open).trimmed();
        QStringList patterns = parts[i + 1].split(u';', Qt::SkipEmptyParts);
        for (QString& p : patterns)
            if (p.trimmed() == u"*.*") p = QStringLiteral("*");
        filters.append(QStringLiteral("%1 (%2)").arg(name, patterns.join(u' ')));
    }
    return filters.join(QStringLiteral(";;"));
}

QString SelectLabelFile(qint16 kind, FileChooser& chooser) {
    return choose(labelFileFilter(kind), chooser);
}

QString SelectLabelSoftware(qint16 kind, FileChooser& chooser) {
    return choose(labelSoftwareFilter(kind), chooser);
}

}  // namespace etq
