#include "import/connection.h"

#include <QFileInfo>
#include <QStringList>

#include "import/host_reading.h"
#include "import/odbc.h"
#include "platform/settings_keys.h"
#include "platform/settings_store.h"
#include "platform/user_paths.h"

namespace etq {

namespace {

const QString kParams = QStringLiteral("Params");

QString readParam(const SettingsStore& store, const QString& key) {
    return store.read(kParams, key, settingDefault(kParams, key));
}

}  // namespace

void GetConnParams(Context& context) {
    const SettingsStore store(context.applicationName);
    ConnParams& p = context.connection;
    p.server = readParam(store, QStringLiteral("ConnServer"));
    p.user = readParam(store, QStringLiteral("ConnUID"));
    p.password = readParam(store, QStringLiteral("ConnPWD"));
    p.database = readParam(store, QStringLiteral("ConnDataBase"));
    p.driver = readParam(store, QStringLiteral("ConnDriver"));
}

namespace {

QString serverWithPort(const QString& server) {
    if (server.isEmpty() || server.contains(u'\\') || server.contains(u',')) return server;
    return server + QStringLiteral(",1433");
}

}  // namespace

QString BuildConnString(const QString& server, const QString& user, const QString& password,
                        const QString& database, qint16 form, const QString& driver) {
    switch (form) {
        case 1:
            return QStringList{
                QStringLiteral("Driver=") +
                    odbc::bracedValue(driver.isEmpty() ? settingDefault(kParams, u"ConnDriver")
                                                       : driver),
                odbc::attribute(QStringLiteral("Server"), serverWithPort(server)),
                odbc::attribute(QStringLiteral("UID"), user),
                odbc::attribute(QStringLiteral("Database"), database),
                odbc::attribute(QStringLiteral("PWD"), password)}
                .join(u';');
        case 2:
            return QStringLiteral(
                       "Provider=sqloledb;Data Source=%1;User Id=%2;Password=%3;Initial Catalog=%4")
                .arg(server, user, password, database);
        case 3:
            // Settings written on Windows end the server folder with a backslash.
            if (server.endsWith(u'\\')) return joinPath(server.chopped(1), database);
            return joinPath(server, database);
        default:
            return {};
    }
}

QString sqlServerConnString(const ConnParams& p) {
    return BuildConnString(p.server, p.user, p.password, p.database, 1, p.driver);
}

QString companyFolder(const ConnParams& p) {
    return BuildConnString(p.server, p.user, p.password, p.database, 3);
}

void SetGetRegConnParams(const QString& application, quint8 action, QString& server,
                         QString& database) {
    SettingsStore store(application);
    if (action == 1) {
        store.write(kParams, QStringLiteral("ConnServer"), server);
        store.write(kParams, QStringLiteral("ConnDataBase"), database);
        store.sync();  // the dialog goes on whether or not the store took the values
    } else if (action == 2) {
        server = readParam(store, QStringLiteral("ConnServer"));
        database = readParam(store, QStringLiteral("ConnDataBase"));
    }
}

bool companyFolderHasAccounts(const QString& server, const QString& database) {
    const QString folder = BuildConnString(server, {}, {}, database, 3);
    return QFileInfo(hostread::hostFilePath(folder, host::ocrd::kLayout)).isFile();
}

}  // namespace etq
