#pragma once

#include <QString>

#include "platform/context.h"

namespace etq {

// Reads the four connection parameters from section Params of the context's settings store
// (with their defaults) into context.connection.
void GetConnParams(Context& context);

// The parameters as text, by form: 1 ODBC connection text, 2 OLE DB connection text, 3 the
// company folder (server, "/", database; a server ending with "/" or "\" gets no second
// separator). Any other form gives empty text.
QString BuildConnString(const QString& server, const QString& user, const QString& password,
                        const QString& database, qint16 form);

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
