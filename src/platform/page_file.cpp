#include "platform/page_file.h"

#include <stdexcept>

#include "platform/codepage1255.h"

namespace etq {

namespace {

constexpr qsizetype kFlushSize = 1 << 16;

[[noreturn]] void cannotWrite(const QFile& file) {
    throw std::runtime_error(QStringLiteral("Cannot write %1: %2")
                                 .arg(file.fileName(), file.errorString())
                                 .toStdString());
}

}  // namespace

PageFile::~PageFile() {
    // A page abandoned after a failure keeps what was written; its error was reported then.
    if (file_.isOpen()) {
        file_.write(buffer_);
        file_.close();
    }
}

void PageFile::open(const QString& path) {
    if (file_.isOpen()) close();
    buffer_.clear();
    file_.setFileName(path);
    if (!file_.open(QIODevice::WriteOnly | QIODevice::Truncate)) cannotWrite(file_);
}

void PageFile::write(QStringView text) {
    buffer_ += encode1255(text, Unmappable::CharacterReference);
    if (buffer_.size() >= kFlushSize) flush();
}

void PageFile::writeLine(QStringView text) {
    write(text);
    buffer_ += "\r\n";
}

void PageFile::flush() {
    if (file_.write(buffer_) != buffer_.size()) cannotWrite(file_);
    buffer_.clear();
}

void PageFile::close() {
    if (!file_.isOpen()) return;
    flush();
    if (!file_.flush()) cannotWrite(file_);
    file_.close();
}

QString htmlEscaped(const QString& text) {
    QString out;
    out.reserve(text.size());
    for (QChar c : text) {
        switch (c.unicode()) {
            case u'&':
                out += QLatin1String("&amp;");
                break;
            case u'<':
                out += QLatin1String("&lt;");
                break;
            case u'>':
                out += QLatin1String("&gt;");
                break;
            case u'"':
                out += QLatin1String("&quot;");
                break;
            case u'\'':
                out += QLatin1String("&#39;");
                break;
            default:
                out += c;
        }
    }
    return out;
}

}  // namespace etq
