// Veltrix — KPI dashboard for small businesses.
#include "windows1252.h"

#include <array>

namespace Windows1252 {

namespace {

// 0x80 to 0x9F; the five unassigned bytes map to the control characters of the same number,
// as the platform's own conversion does, so that every byte survives a round trip.
constexpr std::array<char16_t, 32> HighControlRange = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

char byteFor(char16_t unicode)
{
    if (unicode < 0x80 || (unicode >= 0xA0 && unicode <= 0xFF))
        return static_cast<char>(unicode);
    for (std::size_t i = 0; i < HighControlRange.size(); ++i) {
        if (HighControlRange[i] == unicode)
            return static_cast<char>(0x80 + i);
    }
    return '?';
}

} // namespace

QByteArray fromUnicode(const QString &text)
{
    QByteArray bytes;
    bytes.reserve(text.size());
    for (qsizetype i = 0; i < text.size(); ++i) {
        const QChar c = text.at(i);
        // A character outside the basic plane is one "?", not two.
        if (c.isHighSurrogate() && i + 1 < text.size() && text.at(i + 1).isLowSurrogate())
            ++i;
        bytes.append(c.isSurrogate() ? '?' : byteFor(c.unicode()));
    }
    return bytes;
}

std::optional<QString> firstUnheldCharacter(const QString &text)
{
    for (qsizetype i = 0; i < text.size(); ++i) {
        const QChar c = text.at(i);
        if (c.isSurrogate()) {
            const bool pair =
                c.isHighSurrogate() && i + 1 < text.size() && text.at(i + 1).isLowSurrogate();
            return text.mid(i, pair ? 2 : 1);
        }
        // "?" is the one character that comes back as itself from the fallback.
        if (c != u'?' && byteFor(c.unicode()) == '?')
            return QString(c);
    }
    return std::nullopt;
}

QString toUnicode(const QByteArray &bytes)
{
    QString text;
    text.reserve(bytes.size());
    for (const char byte : bytes) {
        const auto value = static_cast<unsigned char>(byte);
        if (value >= 0x80 && value < 0xA0)
            text.append(QChar(HighControlRange[value - 0x80]));
        else
            text.append(QChar(char16_t(value)));
    }
    return text;
}

} // namespace Windows1252
