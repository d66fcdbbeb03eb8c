#include "platform/settings_store.h"

#include <QRegularExpression>

namespace etq {

namespace {

const QString kOrganisation = QStringLiteral("Etiquon");

QString storeKey(const QString& section, const QString& key) {
    return section + QLatin1Char('/') + key;
}

// An INI value with an unquoted comma reads back as a list; as text it is the joined items.
QString asText(const QVariant& value) {
    if (value.typeId() == QMetaType::QStringList) return value.toStringList().join(u',');
    return value.toString();
}

}  // namespace

SettingsStore::SettingsStore(const QString& application)
    : application_(application),
      settings_(std::make_unique<QSettings>(QSettings::IniFormat, QSettings::UserScope,
                                            kOrganisation, application)) {}

SettingsStore::~SettingsStore() = default;

QString SettingsStore::filePath() const {
    return settings_->fileName();
}

QString SettingsStore::read(const QString& section, const QString& key,
                            const QString& fallback) const {
    const QVariant value = settings_->value(storeKey(section, key));
    return value.isValid() ? asText(value) : fallback;
}

bool SettingsStore::contains(const QString& section, const QString& key) const {
    return settings_->contains(storeKey(section, key));
}

void SettingsStore::write(const QString& section, const QString& key, const QString& value) {
    settings_->setValue(storeKey(section, key), value);
}

QStringList SettingsStore::sections() const {
    return settings_->childGroups();
}

QStringList SettingsStore::keys(const QString& section) const {
    settings_->beginGroup(section);
    QStringList result = settings_->childKeys();
    settings_->endGroup();
    return result;
}

bool SettingsStore::sync(QString* error) {
    settings_->sync();
    switch (settings_->status()) {
        case QSettings::NoError:
            return true;
        case QSettings::AccessError:
            if (error) *error = QStringLiteral("cannot write the settings file %1").arg(filePath());
            return false;
        case QSettings::FormatError:
            if (error) *error = QStringLiteral("the settings file %1 is damaged").arg(filePath());
            return false;
    }
    return false;
}

QString readSetting(const QString& application, const QString& section, const QString& key,
                    const QString& fallback) {
    return SettingsStore(application).read(section, key, fallback);
}

void writeSetting(const QString& application, const QString& section, const QString& key,
                  const QString& value) {
    SettingsStore(application).write(section, key, value);
}

QString applicationNameFor(const QString& settingId) {
    static const QRegularExpression number(
        QStringLiteral(R"(^[+-]?(\d+\.?\d*|\.\d+)([eE][+-]?\d+)?$)"));
    const QString id = settingId.trimmed();
    if (id.isEmpty() || !number.match(id).hasMatch()) return QStringLiteral("Etiquon");
    return QStringLiteral("Etiquon") + id;
}

}  // namespace etq
