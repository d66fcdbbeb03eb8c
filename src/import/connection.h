#pragma once

#include <QString>

namespace etq {

// The four connection parameters of the host accounting package. In folder form they name the
// company folder of dBASE files (server folder, then company subfolder); in connection-text
// form they reach the package's SQL Server database.
struct ConnParams {
    QString server;    // ConnServer
    QString user;      // ConnUID
    QString password;  // ConnPWD
    QString database;  // ConnDataBase
};

// The parameters of this run, shared by every part that reaches the host.
ConnParams& connParams();

// Reads the four parameters from section Params of the settings store (with their defaults)
// into connParams().
void GetConnParams();

// The parameters as text, by form: 1 ODBC connection text, 2 OLE DB connection text, 3 the
// company folder (server, "/", database; a server ending with "/" or "\" gets no second
// separator). Any other form gives empty text.
QString BuildConnString(const QString& server, const QString& user, const QString& password,
                        const QString& database, qint16 form);

// The company folder of the current parameters.
QString companyFolder();

// The connection dialog's transfer of its two texts: action 1 saves them as ConnServer and
// ConnDataBase, action 2 reads them from the store.
void SetGetRegConnParams(quint8 action, QString& server, QString& database);

// Whether the company folder of these texts holds the accounts file ocrd.dbf: the connection
// dialog's check.
bool companyFolderHasAccounts(const QString& server, const QString& database);

}  // namespace etq
