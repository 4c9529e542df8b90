// Veltrix — KPI dashboard for small businesses.
#include "base64armour.h"

#include <array>

using namespace Qt::StringLiterals;

namespace Base64Armour {

namespace {

constexpr char Alphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

int sextet(QChar c)
{
    const char16_t u = c.unicode();
    if (u >= u'A' && u <= u'Z')
        return u - u'A';
    if (u >= u'a' && u <= u'z')
        return u - u'a' + 26;
    if (u >= u'0' && u <= u'9')
        return u - u'0' + 52;
    if (u == u'+')
        return 62;
    if (u == u'/')
        return 63;
    return -1;
}

} // namespace

QString encode(const QByteArray &bytes, int lineLength)
{
    lineLength = std::max(lineLength, 10);
    QString text;
    text.reserve(bytes.size() * 4 / 3 + 8);
    int currentLine = 0;
    for (qsizetype i = 0; i < bytes.size(); i += 3) {
        const qsizetype remaining = bytes.size() - i;
        const auto b0 = static_cast<unsigned char>(bytes[i]);
        const auto b1 = remaining > 1 ? static_cast<unsigned char>(bytes[i + 1]) : 0u;
        const auto b2 = remaining > 2 ? static_cast<unsigned char>(bytes[i + 2]) : 0u;
        const unsigned group = (b0 << 16) | (b1 << 8) | b2;
        text += QLatin1Char(Alphabet[(group >> 18) & 0x3F]);
        text += QLatin1Char(Alphabet[(group >> 12) & 0x3F]);
        text += remaining > 1 ? QLatin1Char(Alphabet[(group >> 6) & 0x3F]) : QLatin1Char('=');
        text += remaining > 2 ? QLatin1Char(Alphabet[group & 0x3F]) : QLatin1Char('=');
        currentLine += 4;
        if (currentLine >= lineLength) {
            text += u"\r\n"_s;
            currentLine = 0;
        }
    }
    return text;
}

QByteArray decode(const QString &text)
{
    QString compact;
    compact.reserve(text.size());
    for (const QChar c : text) {
        if (c != u'\r' && c != u'\n')
            compact.append(c);
    }
    if (compact.size() < 4)
        return {};

    QByteArray bytes;
    bytes.reserve(compact.size() / 4 * 3);
    const qsizetype groups = compact.size() / 4;
    for (qsizetype g = 0; g < groups; ++g) {
        std::array<int, 4> values{};
        int padding = 0;
        for (int k = 0; k < 4; ++k) {
            const QChar c = compact.at(g * 4 + k);
            if (c == u'=' && k >= 2 && g == groups - 1) {
                ++padding;
                values[k] = 0;
                continue;
            }
            // Padding may only close the last group, and nothing may follow it.
            if (padding > 0)
                return {};
            values[k] = sextet(c);
            if (values[k] < 0)
                return {};
        }
        const unsigned group = (values[0] << 18) | (values[1] << 12) | (values[2] << 6) | values[3];
        bytes.append(static_cast<char>((group >> 16) & 0xFF));
        if (padding < 2)
            bytes.append(static_cast<char>((group >> 8) & 0xFF));
        if (padding < 1)
            bytes.append(static_cast<char>(group & 0xFF));
    }
    return bytes;
}

} // namespace Base64Armour
