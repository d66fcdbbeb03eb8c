#include "jet/types.h"

#include <QRegularExpression>

namespace etq::jet {

namespace {
struct TypeName {
    FieldType type;
    const char* declared;
    const char* display;
};
// One row per type: how it is declared in the file and how messages name it.
constexpr TypeName kTypes[] = {
    {FieldType::Boolean, "BIT", "Yes/No"},    {FieldType::Byte, "BYTE", "Byte"},
    {FieldType::Integer, "SHORT", "Integer"}, {FieldType::Long, "LONG", "Long"},
    {FieldType::Double, "DOUBLE", "Double"},  {FieldType::Date, "DATETIME", "Date"},
    {FieldType::Text, "TEXT", "Text"},
};
}  // namespace

const FieldDef* TableDef::field(const QString& fieldName) const {
    for (const FieldDef& f : fields)
        if (f.name.compare(fieldName, Qt::CaseInsensitive) == 0) return &f;
    return nullptr;
}

QString LinkDef::sourcePath() const {
    // The engine writes DATABASE last, so its path runs to the end of the text: a ';' in a
    // folder's name is part of the path, not the start of another part.
    const QString key = ";DATABASE=";
    const qsizetype at = connect.indexOf(key, 0, Qt::CaseInsensitive);
    if (at < 0) return {};
    return connect.mid(at + key.size());
}

QString declaredType(const FieldDef& field) {
    for (const TypeName& t : kTypes) {
        if (t.type != field.type) continue;
        if (field.type == FieldType::Text) return QString("TEXT(%1)").arg(field.size);
        return t.declared;
    }
    return {};
}

bool parseDeclaredType(const QString& declared, FieldType* type, int* size) {
    static const QRegularExpression textType(R"(^\s*TEXT\s*\(\s*(\d+)\s*\)\s*$)",
                                             QRegularExpression::CaseInsensitiveOption);
    if (const auto m = textType.match(declared); m.hasMatch()) {
        *type = FieldType::Text;
        *size = m.captured(1).toInt();
        return true;
    }
    for (const TypeName& t : kTypes) {
        if (declared.trimmed().compare(t.declared, Qt::CaseInsensitive) == 0) {
            *type = t.type;
            *size = 0;
            return true;
        }
    }
    return false;
}

bool parseTypeName(const QString& name, FieldType* type) {
    for (const TypeName& t : kTypes) {
        if (name.compare(QLatin1String(t.display), Qt::CaseInsensitive) == 0) {
            *type = t.type;
            return true;
        }
    }
    return false;
}

QString typeName(FieldType type) {
    for (const TypeName& t : kTypes)
        if (t.type == type) return t.display;
    return "?";
}

}  // namespace etq::jet
