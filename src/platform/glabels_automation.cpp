#include "platform/glabels_automation.h"

#include <zlib.h>

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QHash>
#include <QSet>
#include <QStandardPaths>
#include <QXmlStreamReader>
#include <memory>
#include <optional>

#include "platform/failure.h"
#include "platform/print_folder.h"
#include "platform/printers.h"

namespace etq {

namespace {

// A large batch is drawn page by page; give it time.
constexpr int kBatchTimeoutMs = 10 * 60 * 1000;
constexpr int kJoinTimeoutMs = 60 * 1000;

// The whole file, inflated when gzip-compressed (gzread passes plain files through).
QByteArray readDesignFile(const QString& path) {
    const QFileInfo info(path);
    if (!info.isFile())
        throw Failure(QStringLiteral("The label design %1 does not exist").arg(path));
    gzFile file = gzopen(QFile::encodeName(path).constData(), "rb");
    if (!file) throw Failure(QStringLiteral("Cannot read the label design %1").arg(path));
    QByteArray data;
    char buffer[1 << 16];
    int n = 0;
    while ((n = gzread(file, buffer, sizeof buffer)) > 0)
        data.append(buffer, n);
    const bool failed = n < 0;
    gzclose(file);
    if (failed) throw Failure(QStringLiteral("Cannot read the label design %1").arg(path));
    return data;
}

std::optional<QChar> delimiterOf(QStringView mergeType) {
    static const struct {
        QStringView name;
        QChar delimiter;
    } kTypes[] = {{u"Comma", u','}, {u"Tab", u'\t'}, {u"Colon", u':'}, {u"Semicolon", u';'}};
    const QList<QStringView> parts = mergeType.split(u'/');
    if (parts.size() != 3 || parts[0] != u"Text" || parts[2] != u"Line1Keys") return std::nullopt;
    for (const auto& t : kTypes)
        if (parts[1] == t.name) return t.delimiter;
    return std::nullopt;
}

// The design of the session: what it merges, and the records queued for it.
struct OpenDesign {
    QString path;
    GLabelsDesign design;
    QHash<QString, QString> record;  // the current record, by field
    QList<QStringList> rows;         // queued merge rows, in the design's field order
};

class GLabelsServer : public AutomationServer {
  public:
    GLabelsServer(QString batch, GLabelsProvider::Listener made)
        : batch_(std::move(batch)), made_(std::move(made)) {}

    QVariant invoke(Invoke how, const QString& member, const QVariantList& args) override {
        const auto is = [&](QStringView name) {
            return member.compare(name, Qt::CaseInsensitive) == 0;
        };
        if (how == Invoke::Put && is(u"Printer")) {
            printer_ = args.value(0).toString();
        } else if (how == Invoke::Put && is(u"OutputFile")) {
            outputFile_ = args.value(0).toString();
        } else if (how == Invoke::Method && is(u"Open")) {
            open(args.value(0).toString());
        } else if (how == Invoke::Method && is(u"SetField")) {
            setField(args.value(0).toString(), args.value(1).toString());
        } else if (how == Invoke::Method && is(u"PrintRecord")) {
            printRecord(args.value(0).toLongLong());
        } else if (how == Invoke::Method && is(u"Close")) {
            close();
        } else if (how == Invoke::Method && is(u"Quit")) {
            quit();
        } else {
            throw Failure(
                QStringLiteral("Object doesn't support this property or method: %1").arg(member));
        }
        return {};
    }

  private:
    OpenDesign& design() {
        if (!design_) throw Failure(QStringLiteral("No gLabels design is open"));
        return *design_;
    }

    void open(const QString& path) {
        close();
        design_ = OpenDesign{QFileInfo(path).absoluteFilePath(), readGLabelsDesign(path), {}, {}};
    }

    void setField(const QString& name, const QString& text) {
        OpenDesign& d = design();
        if (!d.design.fields.contains(name)) {
            if (name == u"-") return;
            throw Failure(
                QStringLiteral("The label design %1 has no merge field \"%2\"").arg(d.path, name));
        }
        d.record.insert(name, text);
    }

    void printRecord(qint64 copies) {
        OpenDesign& d = design();
        QStringList row;
        for (const QString& field : d.design.fields) {
            const auto value = d.record.constFind(field);
            if (value == d.record.constEnd())
                throw Failure(
                    QStringLiteral(
                        "The label design %1 merges the field \"%2\", which was given no value: check that field on the label data tab")
                        .arg(d.path, field));
            row.append(*value);
        }
        for (qint64 i = 0; i < copies; ++i)
            d.rows.append(row);
    }

    void close() {
        if (!design_) return;
        const OpenDesign d = std::move(*design_);
        design_.reset();
        if (d.rows.isEmpty()) return;
        ++batches_;
        const QString base =
            QDir(folder_.path()).filePath(QStringLiteral("labels-%1").arg(batches_));
        const QString csv = base + QStringLiteral(".csv");
        const QString pdf = base + QStringLiteral(".pdf");
        writeMergeFile(csv, d);
        const ToolOutput out =
            runPrintTool(batch_, {QStringLiteral("-o"), pdf, QStringLiteral("-i"), csv, d.path},
                         kBatchTimeoutMs);
        // glabels-3-batch ends well also when it wrote nothing.
        if (QFileInfo(pdf).size() <= 0)
            throw Failure(QStringLiteral("%1 made no labels from %2: %3")
                              .arg(kGLabelsBatch, d.path, batchComplaint(out.err)));
        madePdfs_.append(pdf);
        if (outputFile_.isEmpty()) sendToPrinter(pdf, printer_);
        if (made_) made_(pdf);
    }

    void quit() {
        close();
        if (outputFile_.isEmpty()) return;
        if (madePdfs_.isEmpty())
            throw Failure(
                QStringLiteral("No labels were printed: %1 is not written").arg(outputFile_));
        if (QFileInfo::exists(outputFile_) && !QFile::remove(outputFile_))
            throw Failure(QStringLiteral("Cannot replace %1").arg(outputFile_));
        if (madePdfs_.size() == 1) {
            if (!QFile::copy(madePdfs_[0], outputFile_))
                throw Failure(QStringLiteral("Cannot write %1").arg(outputFile_));
            return;
        }
        runPrintTool(QStringLiteral("pdfunite"), QStringList(madePdfs_) << outputFile_,
                     kJoinTimeoutMs);
    }

    static void writeMergeFile(const QString& path, const OpenDesign& d) {
        QFile file(path);
        if (!file.open(QIODevice::WriteOnly | QIODevice::NewOnly))
            throw Failure(QStringLiteral("Cannot write %1: %2").arg(path, file.errorString()));
        QByteArray text = glabelsMergeLine(d.design.fields, d.design.delimiter);
        for (const QStringList& row : d.rows)
            text += glabelsMergeLine(row, d.design.delimiter);
        if (file.write(text) != text.size() || !file.flush())
            throw Failure(QStringLiteral("Cannot write %1: %2").arg(path, file.errorString()));
    }

    // What glabels-3-batch said, less its greeting and the desktop bus it could not reach.
    static QString batchComplaint(const QByteArray& err) {
        QStringList lines;
        for (const QString& line : QString::fromLocal8Bit(err).split(u'\n', Qt::SkipEmptyParts))
            if (!line.startsWith(u"Connection ") && !line.startsWith(u"LABEL FILE"))
                lines.append(line.trimmed());
        return lines.isEmpty() ? QStringLiteral("it gave no reason") : lines.join(u' ');
    }

    QString batch_;
    GLabelsProvider::Listener made_;
    std::optional<QString> printer_;
    QString outputFile_;
    std::optional<OpenDesign> design_;
    const PrintRunFolder folder_;
    int batches_ = 0;
    QStringList madePdfs_;
};

}  // namespace

GLabelsDesign readGLabelsDesign(const QString& path) {
    QXmlStreamReader xml(readDesignFile(path));
    GLabelsDesign design;
    bool root = true;
    bool merges = false;
    QString mergeType;
    const auto addField = [&](const QString& name) {
        if (!name.isEmpty() && !design.fields.contains(name)) design.fields.append(name);
    };
    while (!xml.atEnd()) {
        if (xml.readNext() != QXmlStreamReader::StartElement) continue;
        const QStringView name = xml.name();
        if (root) {
            if (name != u"Glabels-document") break;
            root = false;
        }
        const QXmlStreamAttributes attributes = xml.attributes();
        if (name == u"Field") {
            addField(attributes.value(QStringLiteral("name")).toString());
        } else if (name.startsWith(u"Object-")) {
            addField(attributes.value(QStringLiteral("field")).toString());
        } else if (name == u"Merge") {
            merges = true;
            mergeType = attributes.value(QStringLiteral("type")).toString();
        }
    }
    if (root || xml.hasError())
        throw Failure(
            QStringLiteral("The label design %1 is no gLabels design%2")
                .arg(path, xml.hasError() ? QStringLiteral(": ") + xml.errorString() : QString()));
    if (!merges || mergeType.isEmpty() || mergeType == u"None")
        throw Failure(
            QStringLiteral(
                "The label design %1 has no merge source: give it a text merge source with the field names on its first line (Text/Comma/Line1Keys)")
                .arg(path));
    const std::optional<QChar> delimiter = delimiterOf(mergeType);
    if (!delimiter)
        throw Failure(
            QStringLiteral(
                "The label design %1 merges from \"%2\": only a text merge source with the field names on its first line can be filled (Text/Comma/Line1Keys)")
                .arg(path, mergeType));
    design.delimiter = *delimiter;
    return design;
}

QByteArray glabelsMergeLine(const QStringList& values, QChar delimiter) {
    QString line;
    for (qsizetype i = 0; i < values.size(); ++i) {
        if (i > 0) line += delimiter;
        QString value = values[i];
        value.replace(u'\\', QStringLiteral("\\\\")).replace(u'"', QStringLiteral("\"\""));
        line += u'"' + value + u'"';
    }
    return (line + u'\n').toUtf8();
}

bool GLabelsProvider::provides(const QString& className) const {
    return className.compare(kGLabelsClass, Qt::CaseInsensitive) == 0;
}

AutomationObject GLabelsProvider::create(const QString&) {
    const QString batch = QStandardPaths::findExecutable(kGLabelsBatch.toString());
    if (batch.isEmpty())
        throw Failure(
            QStringLiteral(
                "gLabels is not available here: %1 is not installed (Debian package glabels)")
                .arg(kGLabelsBatch));
    return AutomationObject(std::make_shared<GLabelsServer>(batch, made_));
}

}  // namespace etq
