#pragma once

#include <QString>
#include <memory>

namespace etq {

class AutomationRegistry;
class MessageSink;
class PageViewer;
struct LabelDefinition;

// The four connection parameters of the host accounting package. In folder form they name the
// company folder of dBASE files (server folder, then company subfolder); in connection-text
// form they reach the package's SQL Server database. A new value holds the stored defaults.
struct ConnParams {
    ConnParams();
    QString server;    // ConnServer
    QString user;      // ConnUID
    QString password;  // ConnPWD
    QString database;  // ConnDataBase
    QString driver;    // ConnDriver: the ODBC driver of the SQL Server source
};

// What a run needs from its surroundings: where its settings are kept, how it talks to the
// user, the language, the host's connection parameters, the built-in label definition and the
// separator of address lines. One per window, per command-line run and per test, passed to
// what needs it; there is no process-wide state, so contexts can live side by side (worker
// threads take what they need by value).
class Context {
  public:
    // The plain application name "Etiquon", Hebrew, the default connection parameters,
    // messages on stderr (questions answered Yes) and pages whose paths are printed.
    Context();
    ~Context();
    Context(const Context&) = delete;
    Context& operator=(const Context&) = delete;

    // The settings store's application name: "Etiquon", optionally followed by a SettingID.
    QString applicationName;
    // 0 (or -1) Hebrew, 1 English.
    qint16 language = 0;
    ConnParams connection;
    // Between the lines of an address written into a document: CR LF, or as chosen.
    QString addressSeparator;

    // The message boxes and the page viewer in use (not owned). nullptr restores the defaults.
    MessageSink& messages() const { return *messages_; }
    void setMessages(MessageSink* sink);
    PageViewer& pages() const { return *pages_; }
    void setPages(PageViewer* viewer);

    // The built-in label definition of this run, made empty on first use.
    LabelDefinition& labelDefinition();

    // The automation classes this run can create: on first use, the label software that can be
    // driven on this system (gLabels). A test or a command adds providers of its own here.
    AutomationRegistry& automation();

    bool isEnglish() const { return language > 0; }
    // Caption n of the caption table in this context's language.
    QString caption(int n) const;

  private:
    std::unique_ptr<MessageSink> defaultMessages_;
    std::unique_ptr<PageViewer> defaultPages_;
    MessageSink* messages_;
    PageViewer* pages_;
    std::shared_ptr<LabelDefinition> labelDefinition_;
    std::unique_ptr<AutomationRegistry> automation_;
};

}  // namespace etq
