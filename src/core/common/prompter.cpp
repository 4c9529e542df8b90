// Veltrix — KPI dashboard for small businesses.
#include "prompter.h"

using namespace Qt::StringLiterals;

Prompter::Answer Prompter::message(const QString &text, const QString &title, Icon icon,
                                   Buttons buttons)
{
    return showMessage(capped(text, MaxTextLength, MaxTextLines), capped(title, MaxTitleLength, 1),
                       icon, buttons);
}

QString Prompter::capped(const QString &text, qsizetype maxLength, qsizetype maxLines)
{
    qsizetype end = qMin(text.size(), maxLength);
    qsizetype lines = 1;
    for (qsizetype i = 0; i < end; ++i) {
        if (text[i] == u'\n' && ++lines > maxLines) {
            end = i;
            break;
        }
    }
    if (end == text.size())
        return text;
    // Never leave half of a character that takes two code units.
    if (end > 0 && text[end - 1].isHighSurrogate())
        --end;
    QString kept = text.left(end);
    while (kept.endsWith(u'\r') || kept.endsWith(u'\n'))
        kept.chop(1);
    return kept + u"…"_s;
}
