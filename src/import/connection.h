#pragma once

#include <QString>

#include "platform/context.h"

namespace etq {

// Reads the four connection parameters from section Params of the context's settings store
// (with their defaults) into context.connection.
void GetConnParams(Context& context);

// The parameters as text, by form: 1 ODBC connection text for `driver` (empty: the default of
// the driver setting), 2 OLE DB connection
// text, 3 the company folder (server, "/", database; a server ending with "/" or "\" gets no
// second separator). Any other form gives empty text.
//
// The ODBC text is "Driver={driver};Server=...;UID=...;Database=...;PWD=...", every value as
// odbc::attributeValue writes it, so that a ";" or "}" in a password cannot change the text. A
// server that names neither an instance ("host\name") nor a port ("host,port") gets SQL
// Server's port 1433, which the SQL Server client assumes and FreeTDS does not. The password
// comes last: a driver that reads the text naively still finds every other value.
QString BuildConnString(const QString& server, const QString& user, const QString& password,
                        const QString& database, qint16 form, const QString& driver = {});

// The ODBC connection text of the parameters, with their driver: the SQL Server source.
QString sqlServerConnString(const ConnParams& params);

// The company folder the parameters name.
QString companyFolder(const ConnParams& params);

// The connection dialog's transfer of its two texts in the store of `application`: action 1
// saves them as ConnServer and ConnDataBase, action 2 reads them.
void SetGetRegConnParams(const QString& application, quint8 action, QString& server,
                         QString& database);

// Whether the company folder of these texts holds the accounts file ocrd.dbf: the connection
// dialog's check.
bool companyFolderHasAccounts(const QString& server, const QString& database);

}  // namespace etq
