#pragma once

#include <QSettings>
#include <QString>
#include <QStringList>
#include <memory>

namespace etq {

// The per-user store of the component's settings: text values addressed by application name,
// section and key. One INI file per application name in the user's config folder, under the
// organisation folder "Etiquon" (~/.config/Etiquon/Etiquon3.ini for application "Etiquon3").
class SettingsStore {
  public:
    explicit SettingsStore(const QString& application);
    ~SettingsStore();
    SettingsStore(const SettingsStore&) = delete;
    SettingsStore& operator=(const SettingsStore&) = delete;

    const QString& application() const { return application_; }
    QString filePath() const;

    // The stored text, or `fallback` when the key holds no value.
    QString read(const QString& section, const QString& key, const QString& fallback) const;
    bool contains(const QString& section, const QString& key) const;
    void write(const QString& section, const QString& key, const QString& value);

    QStringList sections() const;
    QStringList keys(const QString& section) const;

    // Writes pending changes to disk; false with the reason in `error` when the file could not
    // be written or read. The destructor syncs too, silently.
    bool sync(QString* error = nullptr);

  private:
    QString application_;
    std::unique_ptr<QSettings> settings_;
};

// The store's two primitives, for callers that move a single value.
QString readSetting(const QString& application, const QString& section, const QString& key,
                    const QString& fallback);
void writeSetting(const QString& application, const QString& section, const QString& key,
                  const QString& value);

// "Etiquon", followed by the trimmed SettingID when that text is a number, so that several
// hosting pages keep separate settings.
QString applicationNameFor(const QString& settingId);

}  // namespace etq
