// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QByteArray>
#include <QString>

#include <optional>

// The Western European single-byte code page, which stored passwords are written in whatever
// the platform's own code page, so that a stored value means the same bytes everywhere.
namespace Windows1252 {

// Characters the code page cannot hold become "?".
QByteArray fromUnicode(const QString &text);
QString toUnicode(const QByteArray &bytes);
// The first character of the text the code page cannot hold (a pair of surrogates counts as
// one character), or nothing when it can hold them all.
std::optional<QString> firstUnheldCharacter(const QString &text);

} // namespace Windows1252
