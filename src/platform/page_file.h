#pragma once

#include <QFile>
#include <QString>

namespace etq {

// A generated page, written as the component writes its pages: text in windows-1255 (the code
// page the page declares), a character the code page lacks as a numeric character reference,
// every line ended with carriage return and line feed.
class PageFile {
  public:
    PageFile() = default;
    ~PageFile();
    PageFile(const PageFile&) = delete;
    PageFile& operator=(const PageFile&) = delete;

    // Replaces a file of that name. Throws std::runtime_error when it cannot be written.
    void open(const QString& path);
    bool isOpen() const { return file_.isOpen(); }
    // Text without a line end, and text followed by one.
    void write(QStringView text);
    void writeLine(QStringView text = {});
    // Writes what is buffered and closes; throws std::runtime_error when the disk refuses.
    void close();

  private:
    void flush();

    QFile file_;
    QByteArray buffer_;
};

// The text with &, <, >, " and ' written as HTML entities, so that a value shows as it is.
QString htmlEscaped(const QString& text);

}  // namespace etq
