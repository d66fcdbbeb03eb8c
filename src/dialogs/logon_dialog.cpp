#include "dialogs/logon_dialog.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "import/connection.h"
#include "import/sql_source.h"
#include "platform/captions.h"
#include "platform/failure.h"
#include "platform/log.h"

namespace etq {

namespace {

// The check's result is shown in Hebrew whatever the language.
QString hebrewCaption(int n) {
    return GetCaption(n, 0);
}

QPushButton* makeButton(const QString& name, const QString& caption, QWidget* parent) {
    auto* button = new QPushButton(caption, parent);
    button->setObjectName(name);
    return button;
}

}  // namespace

LogonDialog::LogonDialog(Context& context, QWidget* parent) : QDialog(parent), context_(context) {
    setObjectName(QStringLiteral("frmLogon"));
    setWindowTitle(QStringLiteral("הגדרות התחברות למנהל-קלאסיק"));
    setLayoutDirection(Qt::RightToLeft);

    auto* frame = new QGroupBox(QStringLiteral("ערכי התחברות"), this);
    frame->setObjectName(QStringLiteral("fraStep3"));
    auto* serverLabel = new QLabel(QStringLiteral("שרת נוכחי:"), frame);
    serverLabel->setObjectName(QStringLiteral("lblStep3(2)"));
    auto* databaseLabel = new QLabel(QStringLiteral("שם תיק חברה:"), frame);
    databaseLabel->setObjectName(QStringLiteral("lblStep3(3)"));
    server_ = new QLineEdit(context.connection.server, frame);
    server_->setObjectName(QStringLiteral("txtConnServer"));
    server_->setMinimumWidth(300);
    database_ = new QLineEdit(context.connection.database, frame);
    database_->setObjectName(QStringLiteral("txtConnDatabase"));
    auto* fields = new QGridLayout(frame);
    fields->addWidget(serverLabel, 0, 0);
    fields->addWidget(server_, 0, 1);
    fields->addWidget(databaseLabel, 1, 0);
    fields->addWidget(database_, 1, 1);

    message_ = new QLabel(this);
    message_->setObjectName(QStringLiteral("LblMsg"));
    QPushButton* check = makeButton(QStringLiteral("CmdCheck"), QStringLiteral("בדיקה"), this);
    QPushButton* checkSql =
        makeButton(QStringLiteral("CmdCheckSql"), QStringLiteral("בדיקת SQL Server"), this);
    QPushButton* ok = makeButton(QStringLiteral("cmdOK"), QStringLiteral("אישור"), this);
    QPushButton* cancel = makeButton(QStringLiteral("cmdCancel"), QStringLiteral("ביטול"), this);
    ok->setDefault(true);

    auto* layout = new QGridLayout(this);
    layout->addWidget(frame, 0, 0, 1, 4);
    layout->addWidget(message_, 1, 0, 1, 4);
    layout->addWidget(check, 2, 0);
    layout->addWidget(checkSql, 2, 1);
    layout->addWidget(ok, 2, 2);
    layout->addWidget(cancel, 2, 3);

    connect(check, &QPushButton::clicked, this, &LogonDialog::check);
    connect(checkSql, &QPushButton::clicked, this, &LogonDialog::checkSqlServer);
    connect(ok, &QPushButton::clicked, this, &LogonDialog::accept);
    connect(cancel, &QPushButton::clicked, this, &LogonDialog::reject);
}

void LogonDialog::check() {
    const bool found = companyFolderHasAccounts(server_->text(), database_->text());
    message_->setText(hebrewCaption(found ? 2 : 3));
}

void LogonDialog::checkSqlServer() {
    ConnParams params = context_.connection;
    params.server = server_->text();
    params.database = database_->text();
    try {
        TestSqlServerConnection(params);
        message_->setText(hebrewCaption(2));
    } catch (const std::exception& e) {
        qCInfo(log::import) << "SQL Server source test:" << describe(e);
        message_->setText(hebrewCaption(3) + u'\n' + describe(e));
    }
}

void LogonDialog::accept() {
    QString server = server_->text();
    QString database = database_->text();
    context_.connection.server = server;
    context_.connection.database = database;
    SetGetRegConnParams(context_.applicationName, 1, server, database);
    QDialog::accept();
}

}  // namespace etq
