#include "db/delivered_database.h"

#include <QCoreApplication>
#include <QFile>
#include <QFileInfo>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <stdexcept>

#include "db/file_names.h"
#include "jet/database.h"
#include "jet/recordset.h"

namespace etq::db {

namespace {

[[noreturn]] void badDefinition(const QString& file, const QString& what) {
    throw std::runtime_error(QString("%1: %2").arg(file, what).toStdString());
}

jet::TableDef tableFrom(const QJsonObject& t, const QString& file) {
    jet::TableDef def;
    def.name = t["name"].toString();
    for (const QJsonValue& f : t["fields"].toArray()) {
        const QJsonArray a = f.toArray();
        jet::FieldDef field{a.at(0).toString(), jet::FieldType::Text, a.at(2).toInt()};
        if (!jet::parseTypeName(a.at(1).toString(), &field.type))
            badDefinition(file, QString("unknown type '%1' of %2.%3")
                                    .arg(a.at(1).toString(), def.name, field.name));
        def.fields.append(field);
    }
    for (const QJsonValue& k : t["primaryKey"].toArray())
        def.primaryKey << k.toString();
    return def;
}

}  // namespace

void buildDocumentDatabase(const QString& definitionFile, const QString& outPath) {
    QFile in(definitionFile);
    if (!in.open(QIODevice::ReadOnly)) badDefinition(definitionFile, in.errorString());
    QJsonParseError parseError;
    const QJsonDocument doc = QJsonDocument::fromJson(in.readAll(), &parseError);
    if (doc.isNull()) badDefinition(definitionFile, parseError.errorString());

    QFile::remove(outPath);
    jet::Database db = jet::Database::create(outPath);
    db.beginTrans();
    for (const QJsonValue& tv : doc["tables"].toArray()) {
        const QJsonObject t = tv.toObject();
        const jet::TableDef def = tableFrom(t, definitionFile);
        db.createTable(def);
        jet::Recordset rs = db.openRecordset(def.name);
        for (const QJsonValue& rv : t["rows"].toArray()) {
            const QJsonArray row = rv.toArray();
            if (row.size() != def.fields.size())
                badDefinition(definitionFile, QString("a row of %1 has %2 values for %3 fields")
                                                  .arg(def.name)
                                                  .arg(row.size())
                                                  .arg(def.fields.size()));
            rs.addNew();
            for (int i = 0; i < row.size(); ++i)
                rs.setValue(i, row[i].toVariant());
            rs.update();
        }
    }
    for (const QJsonValue& qv : doc["queries"].toArray())
        db.createQuery(qv["name"].toString(), qv["sql"].toString());
    db.commitTrans();
}

QString deliveredDocumentDatabase() {
    // ETIQUON_DATA_DIR names the folder outright (tests, a relocated data folder); otherwise the
    // file lies beside the program in a build, or in share/etiquon of the installed tree.
    const QString dataDir = qEnvironmentVariable("ETIQUON_DATA_DIR");
    const QString programDir = QCoreApplication::applicationDirPath();
    const QStringList candidates = {
        dataDir.isEmpty() ? QString() : inFolder(dataDir, kDocDatabaseFile),
        inFolder(programDir, kDocDatabaseFile),
        inFolder(programDir, QStringLiteral("../share/etiquon/") + kDocDatabaseFile),
    };
    for (const QString& path : candidates)
        if (!path.isEmpty() && QFileInfo::exists(path)) return QFileInfo(path).absoluteFilePath();
    return {};
}

}  // namespace etq::db
