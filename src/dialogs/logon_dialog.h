#pragma once

#include <QDialog>

class QLabel;
class QLineEdit;

namespace etq {

class Context;

// The connection dialog frmLogon: edits the server folder and the company folder of the
// connection parameters, checks that the company folder holds the host's accounts file, and
// saves both texts to the context's connection parameters and its settings store on accept.
// CmdCheckSql tests the SQL Server source instead: the two texts as server and database, with
// the stored user, password and driver; a failure shows the driver's words under caption 3 and
// goes to the log.
class LogonDialog : public QDialog {
    Q_OBJECT

  public:
    explicit LogonDialog(Context& context, QWidget* parent = nullptr);

  private:
    void check();
    void checkSqlServer();
    void accept() override;

    QLineEdit* server_;
    QLineEdit* database_;
    Context& context_;
    QLabel* message_;
};

}  // namespace etq
