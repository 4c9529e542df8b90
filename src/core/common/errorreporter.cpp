// Veltrix — KPI dashboard for small businesses.
#include "errorreporter.h"

#include "prompter.h"

using namespace Qt::StringLiterals;

void ErrorReporter::reportError(qint32 number, const QString &description,
                                const QString &context) const
{
    if (number == 0)
        return;
    m_prompter.setNormalPointer();
    if (number == CommunicationFailure) {
        m_prompter.message(u"Could not communicate with database. Check the network connection "
                           u"and ensure the database server is switched on."_s,
                           u"Communication Error"_s, Prompter::Icon::Exclamation);
        return;
    }
    const QString numberText = QString::number(number);
    m_prompter.message(u"Error "_s + numberText + u"\r\n\r\n"_s + description,
                       context + u" Error "_s + numberText, Prompter::Icon::Exclamation);
}
