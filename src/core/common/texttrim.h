// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>
#include <QStringView>

// Trimming of exactly the given characters. QString::trimmed() takes every kind of white
// space, where the stored settings and passwords are trimmed of spaces (and blanks) only.
inline QString trimmedOf(const QString &text, QStringView characters)
{
    qsizetype first = 0;
    qsizetype last = text.size();
    while (first < last && characters.contains(text.at(first)))
        ++first;
    while (last > first && characters.contains(text.at(last - 1)))
        --last;
    return text.mid(first, last - first);
}

inline QString trimmedOfSpaces(const QString &text)
{
    return trimmedOf(text, u" ");
}
