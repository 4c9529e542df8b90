// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QByteArray>
#include <QString>

// Standard Base64 that breaks its output into lines, as stored passwords are written.
namespace Base64Armour {

// After each group of four characters that brings the line to lineLength characters or more,
// CR LF follows. Lengths below 10 count as 10.
QString encode(const QByteArray &bytes, int lineLength);
// Line breaks are ignored. Text shorter than four characters, or with characters outside the
// alphabet, decodes to nothing.
QByteArray decode(const QString &text);

} // namespace Base64Armour
