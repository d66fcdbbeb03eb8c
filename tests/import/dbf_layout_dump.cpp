// dbf-layout-dump DIR: prints, as JSON, every field of every host file in DIR as our fixed
// layouts read it, so that dbfread_check.py can compare with what a dBASE reader reads by name.
// Text and decimal fields are trimmed text, dates their 8 characters, binary integers numbers.
#include <QCoreApplication>
#include <QDir>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTextStream>

#include "import/dbf_file.h"
#include "import/host_layouts.h"

namespace {

namespace h = etq::host;

const h::HostLayout& layoutFor(const QString& fileName) {
    for (const h::HostLayout* layout :
         {&h::oitm::kLayout, &h::oitg::kLayout, &h::oitb::kLayout, &h::opln::kLayout,
          &h::ocrn::kLayout, &h::ospp::kLayout, &h::ocrd::kLayout})
        if (fileName == QLatin1StringView(layout->fileName.data(), layout->fileName.size()))
            return *layout;
    return h::stockdoc::kLayout;  // the document files are named by the document database
}

QJsonObject dumpFile(const QString& path, const h::HostLayout& layout) {
    const etq::DbfFile file(path);
    h::requireLayout(file, layout);
    const QList<h::PlacedField> fields = h::placedFields(layout);
    QJsonArray records;
    for (qint64 i = 0; i < file.recordCount(); ++i) {
        QJsonObject values;
        for (const h::PlacedField& f : fields) {
            const QString name = QString::fromLatin1(f.name);
            if (f.type == 'I')
                values[name] = file.int32(i, f.offset);
            else
                values[name] = file.text(i, f.offset, f.width);
        }
        records.append(QJsonObject{{"deleted", file.isDeleted(i)}, {"values", values}});
    }
    QJsonObject types;
    for (const h::PlacedField& f : fields)
        types[QString::fromLatin1(f.name)] = QString(QChar(f.type));
    return {{"recordCount", file.recordCount()}, {"types", types}, {"records", records}};
}

}  // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    if (app.arguments().size() != 2) {
        QTextStream(stderr) << "usage: dbf-layout-dump DIR\n";
        return 2;
    }
    const QDir dir(app.arguments()[1]);
    QJsonObject out;
    try {
        for (const QString& name : dir.entryList({"*.dbf"}, QDir::Files, QDir::Name))
            out[name] = dumpFile(dir.filePath(name), layoutFor(name));
    } catch (const etq::DbfError& e) {
        QTextStream(stderr) << e.message() << "\n";
        return 1;
    }
    QTextStream(stdout) << QJsonDocument(out).toJson(QJsonDocument::Compact);
    return 0;
}
