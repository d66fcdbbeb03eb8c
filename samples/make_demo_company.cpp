// make-demo-company OUTDIR [--items N] [--seed S]: writes the demo host company folder.
#include <QCoreApplication>
#include <QTextStream>
#include <exception>

#include "samples/demo_company.h"

namespace {

int usage(const QString& problem) {
    QTextStream err(stderr);
    if (!problem.isEmpty()) err << "make-demo-company: " << problem << "\n";
    err << "usage: make-demo-company OUTDIR [--items N] [--seed S]\n";
    return 2;
}

}  // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    const QStringList args = app.arguments().mid(1);
    QString outDir;
    etq::demo::DemoOptions options;
    for (int i = 0; i < args.size(); ++i) {
        const QString& arg = args[i];
        if (arg == u"--items" || arg == u"--seed") {
            bool ok = false;
            const qulonglong value = i + 1 < args.size() ? args[++i].toULongLong(&ok) : 0;
            if (!ok) return usage(arg + QStringLiteral(" needs a number"));
            if (arg == u"--items") {
                if (value < 1 || value > 10'000'000)
                    return usage(u"--items takes 1 to 10000000"_qs);
                options.items = int(value);
            } else {
                options.seed = value;
            }
        } else if (arg.startsWith(u'-') || !outDir.isEmpty()) {
            return usage(u"unexpected argument "_qs + arg);
        } else {
            outDir = arg;
        }
    }
    if (outDir.isEmpty()) return usage({});
    try {
        etq::demo::writeDemoCompany(outDir, options);
    } catch (const std::exception& e) {
        QTextStream(stderr) << "make-demo-company: " << QString::fromUtf8(e.what()) << "\n";
        return 1;
    }
    return 0;
}
