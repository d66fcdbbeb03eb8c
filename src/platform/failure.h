#pragma once

// The component's own failures. The logic throws them (and the engine's numbered JetError);
// it never shows a message. The boundaries (the dispatch of a control's command, a window, a
// command of etiquon-cli) turn them into what the user sees.

#include <QByteArray>
#include <QString>
#include <exception>

namespace etq {

// A failure with a description a user can act on: what went wrong, and where.
class Failure : public std::exception {
  public:
    explicit Failure(QString description);

    const QString& description() const { return description_; }
    const char* what() const noexcept override { return utf8_.constData(); }
    // Whether the window passes over this failure without a word, as the component always has
    // (a missing host file, say). The command line tells it all the same.
    virtual bool quietInWindow() const { return false; }

  private:
    QString description_;
    QByteArray utf8_;
};

// A host file the company folder lacks. The window stays silent, as the readers always have.
class HostFileMissing : public Failure {
  public:
    using Failure::Failure;
    bool quietInWindow() const override { return true; }
};

// A host file that cannot be read as what it should be: a damaged header, a record cut short,
// a device or pipe in place of a file.
class HostFileDamaged : public Failure {
  public:
    using Failure::Failure;
};

// A field of a host record that does not hold what it should: a group number that is no
// number, say. The description names the file, the record and the field.
class HostValueError : public Failure {
  public:
    using Failure::Failure;
};

// Another run is working on the same database folder.
class FolderBusy : public Failure {
  public:
    using Failure::Failure;
};

// A setting or an option that cannot be used as it stands.
class BadSetting : public Failure {
  public:
    using Failure::Failure;
};

// A failure the window passes over without a word where the component always has (a reader
// whose database cannot be written, say); the command line tells it.
class QuietFailure : public Failure {
  public:
    using Failure::Failure;
    bool quietInWindow() const override { return true; }
};

// The description of any failure: ours, the engine's, or another exception's text.
QString describe(const std::exception& failure);

// Whether the window keeps the failure to itself.
bool isQuietInWindow(const std::exception& failure);

}  // namespace etq
