// Veltrix — KPI dashboard for small businesses.
#include "configvalues.h"

#include "maindatabase.h"
#include "recordoperations.h"

#include "common/prompter.h"
#include "common/version.h"

using namespace Qt::StringLiterals;

ConfigValues::ConfigValues(MainDatabase &database, Prompter &prompter)
    : m_database(database)
    , m_prompter(prompter)
{}

bool ConfigValues::findRow(qint32 id) const
{
    RecordSet &config = m_database.configRecordset();
    config.requery();
    if (RecordOperations(m_database, m_prompter).findRecordById(config, id))
        return true;
    m_prompter.message(u"Unable to set configuration with ID "_s + QString::number(id) +
                           u"\r\nPlease contact the system administrator!"_s,
                       AppInfo::Title, Prompter::Icon::None);
    return false;
}

QString ConfigValues::getConfigValue(qint32 id) const
{
    if (!findRow(id))
        return {};
    return m_database.configRecordset().value(u"Value"_s).toString();
}

std::optional<DbError> ConfigValues::setConfigValue(qint32 id, const QString &value) const
{
    if (!findRow(id))
        return std::nullopt;
    RecordSet &config = m_database.configRecordset();
    if (const auto error = config.setValue(u"Value"_s, value))
        return error;
    if (const auto error = config.update()) {
        config.cancelUpdate();
        return error;
    }
    return std::nullopt;
}
