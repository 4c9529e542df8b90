// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <memory>

class QSettings;

// The per-user settings store: string values under named keys, the registry on Windows and an
// INI file under the XDG configuration folder elsewhere. Reads never fail (a missing or
// unreadable value is empty) and writes fail silently, so callers need no error handling.
class SettingsStore
{
public:
    static inline const QString DefaultKey = QStringLiteral("SOFTWARE\\Veltrix");
    static inline const QString FormsKey = QStringLiteral("SOFTWARE\\Veltrix\\Forms");
    // Longer values are treated as unreadable, as a fixed read buffer would.
    static constexpr int MaxValueLength = 1000;

    // The user's own store in the platform's native place.
    SettingsStore();
    // A store kept in the given INI file, for tests and provisioning tools.
    explicit SettingsStore(const QString &iniFile);
    ~SettingsStore();
    SettingsStore(const SettingsStore &) = delete;
    SettingsStore &operator=(const SettingsStore &) = delete;

    // An empty key means the default key. The value comes back trimmed of spaces; an empty
    // result is replaced by the default value.
    QString readSetting(const QString &valueName, const QString &key = {},
                        const QString &defaultValue = {}) const;
    // Writes and saves at once. On Unix the file is kept for its owner alone: it holds the
    // enciphered accounting password.
    void writeSetting(const QString &valueName, const QString &value, const QString &key = {});
    // A value is stored but too long to be used: it reads as empty.
    bool isTooLong(const QString &valueName, const QString &key = {}) const;

    QString fileName() const;
    // Writes what is still held in memory to the store now.
    void sync();

private:
    QString settingPath(const QString &valueName, const QString &key) const;

    std::unique_ptr<QSettings> m_settings;
};
