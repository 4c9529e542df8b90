// Veltrix — KPI dashboard for small businesses.
#include "consoleprompter.h"

#include <QTextStream>

using namespace Qt::StringLiterals;

Prompter::Answer ConsolePrompter::showMessage(const QString &text, const QString &title, Icon icon,
                                              Buttons buttons)
{
    if (icon == Icon::Exclamation || icon == Icon::Critical)
        ++m_problems;
    QTextStream err(stderr);
    const QString trimmedTitle = title.trimmed();
    if (!trimmedTitle.isEmpty())
        err << trimmedTitle << ": ";
    err << QString(text).replace(u"\r\n"_s, u"\n"_s) << Qt::endl;
    switch (buttons) {
    case Buttons::YesNo:
    case Buttons::YesNoCancel:
        return Answer::Yes;
    case Buttons::RetryCancel:
        return Answer::Retry;
    case Buttons::Ok:
    case Buttons::OkCancel:
        break;
    }
    return Answer::Ok;
}
