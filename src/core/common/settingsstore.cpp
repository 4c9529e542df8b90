// Veltrix — KPI dashboard for small businesses.
#include "settingsstore.h"

#include "texttrim.h"

#include <QFile>
#include <QSettings>

using namespace Qt::StringLiterals;

SettingsStore::SettingsStore()
#ifdef Q_OS_WIN
    : m_settings(std::make_unique<QSettings>(u"HKEY_CURRENT_USER"_s, QSettings::NativeFormat))
#else
    : m_settings(std::make_unique<QSettings>(QSettings::NativeFormat, QSettings::UserScope,
                                             u"Veltrix"_s, u"veltrix"_s))
#endif
{}

SettingsStore::SettingsStore(const QString &iniFile)
    : m_settings(std::make_unique<QSettings>(iniFile, QSettings::IniFormat))
{}

SettingsStore::~SettingsStore() = default;

QString SettingsStore::settingPath(const QString &valueName, const QString &key) const
{
    QString path = key.isEmpty() ? DefaultKey : key;
    path.replace(u'\\', u'/');
    return path + u'/' + valueName;
}

QString SettingsStore::readSetting(const QString &valueName, const QString &key,
                                   const QString &defaultValue) const
{
    // Another copy of the program may have written since this store was opened.
    m_settings->sync();
    const QVariant stored = m_settings->value(settingPath(valueName, key));
    QString text = stored.typeId() == QMetaType::QStringList ? stored.toStringList().join(u',')
                                                             : stored.toString();
    if (text.endsWith(QChar(u'\0')))
        text.chop(1);
    if (text.size() > MaxValueLength)
        text.clear();
    text = trimmedOfSpaces(text);
    return text.isEmpty() ? defaultValue : text;
}

void SettingsStore::writeSetting(const QString &valueName, const QString &value, const QString &key)
{
    m_settings->setValue(settingPath(valueName, key), value);
    m_settings->sync();
#ifdef Q_OS_UNIX
    QFile::setPermissions(m_settings->fileName(), QFileDevice::ReadOwner | QFileDevice::WriteOwner);
#endif
}

bool SettingsStore::isTooLong(const QString &valueName, const QString &key) const
{
    m_settings->sync();
    return m_settings->value(settingPath(valueName, key)).toString().size() > MaxValueLength;
}

QString SettingsStore::fileName() const
{
    return m_settings->fileName();
}

void SettingsStore::sync()
{
    m_settings->sync();
}
