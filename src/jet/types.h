#pragma once

#include <QList>
#include <QString>
#include <QStringList>

namespace etq::jet {

// The engine's field types, numbered as the engine numbers them.
enum class FieldType : int {
    Boolean = 1,  // Yes/No: -1 or 0
    Byte = 2,     // 0..255
    Integer = 3,  // 16-bit signed
    Long = 4,     // 32-bit signed
    Double = 7,
    Date = 8,   // serial day number, fraction = time of day
    Text = 10,  // at most `size` characters, never the empty text
};

struct FieldDef {
    QString name;
    FieldType type = FieldType::Text;
    int size = 0;  // characters, for Text; 0 otherwise

    bool operator==(const FieldDef&) const = default;
};

// Every index the component makes is named "PrimaryKey" and is primary and unique.
inline const QString kPrimaryKeyName = QStringLiteral("PrimaryKey");

struct TableDef {
    QString name;
    QList<FieldDef> fields;
    QStringList primaryKey;  // fields of the "PrimaryKey" index, in order; empty = none

    const FieldDef* field(const QString& fieldName) const;
};

// A table that lives in another database file and is reached through this one.
struct LinkDef {
    QString name;                // the name under which this database reaches it
    QString connect;             // ";DATABASE=" followed by the source file's absolute path
    QString sourceTable;         // the table's name in the source file
    QString sourcePath() const;  // the rest of the text after ";DATABASE="
};

// The declared SQL type of a field, as stored in the file ("TEXT(20)", "LONG", ...).
QString declaredType(const FieldDef& field);
// The field type and size of a declared type; false when it is none of ours.
bool parseDeclaredType(const QString& declared, FieldType* type, int* size);
QString typeName(FieldType type);  // "Text", "Long", "Yes/No", ...
bool parseTypeName(const QString& name, FieldType* type);

}  // namespace etq::jet
