// Veltrix — KPI dashboard for small businesses.
#include "passwordcipher.h"

#include "base64armour.h"
#include "huffmancodec.h"
#include "keystream.h"
#include "windows1252.h"

#include "common/texttrim.h"

#include <QRandomGenerator>

using namespace Qt::StringLiterals;

namespace {

// Long enough that a stored password always stays on one line.
constexpr int ArmourLineLength = 9999;
constexpr int FooterSize = 2;

} // namespace

PasswordCipher::PasswordCipher(QRandomGenerator *random)
    : m_random(random ? random : QRandomGenerator::system())
{}

QString PasswordCipher::encryptText(const QString &text, const QString &key,
                                    const QString &secondKey)
{
    setError(NoError);
    if (text.isEmpty())
        return {};
    const QByteArray keyBytes = Windows1252::fromUnicode(key);
    if (keyBytes.isEmpty()) {
        setError(NoKey);
        return {};
    }

    // The header is drawn before the key stream is set up; it only needs to be unpredictable.
    const QByteArray header = makeHeader(*m_random);
    const QByteArray framed =
        header + HuffmanCodec::encode(Windows1252::fromUnicode(text)) + header.right(FooterSize);
    KeyStream stream(keyBytes, Windows1252::fromUnicode(secondKey));
    return Base64Armour::encode(stream.encipher(framed), ArmourLineLength);
}

QString PasswordCipher::decryptText(const QString &stored, const QString &key)
{
    setError(NoError);
    const QString trimmed = trimmedOf(stored, u" \t\r\n");
    std::optional<QByteArray> plain;
    if (trimmed.isEmpty())
        setError(NoText);
    else if (!keyIsUsable(key))
        setError(KeyUnusable);
    else
        plain = decode(trimmed, key);

    if (m_error != NoError || !plain)
        return stored;
    return Windows1252::toUnicode(*plain);
}

std::optional<QByteArray> PasswordCipher::decode(const QString &armoured, const QString &key)
{
    const QByteArray cipher = Base64Armour::decode(armoured);
    const QByteArray framed = KeyStream(Windows1252::fromUnicode(key), {}).decipher(cipher);

    const qsizetype size = framed.size();
    const int headerSize = size > 0 ? static_cast<quint8>(framed[0]) : 0;
    if (size == 0 || headerSize < 2 || headerSize > size - FooterSize ||
        framed[size - 2] != framed[headerSize - 2] || framed[size - 1] != framed[headerSize - 1]) {
        setError(TextDecodingFailed);
        return std::nullopt;
    }

    const HuffmanCodec::Decoded decoded =
        HuffmanCodec::decode(framed.sliced(headerSize, size - headerSize - FooterSize));
    switch (decoded.status) {
    case HuffmanCodec::Status::Ok:
        return decoded.bytes;
    case HuffmanCodec::Status::ChecksumMismatch:
        setError(ChecksumError);
        return std::nullopt;
    case HuffmanCodec::Status::NotIdentified:
    case HuffmanCodec::Status::Corrupt:
        // A wrong key that happens to pass the footer check lands here; treat it like any
        // other value that is not ours rather than stopping the caller.
        setError(TextDecodingFailed);
        return std::nullopt;
    }
    return std::nullopt;
}

bool PasswordCipher::keyIsUsable(const QString &key)
{
    const qsizetype length = key.size();
    if (length < 5)
        return false;
    for (qsizetype period = 1; period <= length / 2; ++period) {
        const QStringView first = QStringView(key).first(period);
        bool repeats = true;
        for (qsizetype start = period; start < length && repeats; start += period)
            repeats = QStringView(key).sliced(start).left(period) == first;
        if (repeats)
            return false;
    }
    return true;
}

std::optional<QString> PasswordCipher::cryptoErrorText(int number, const QString &fileErrorText)
{
    switch (number) {
    case 0:
        return QString();
    case 1:
        return u"Cannot continue without text (Error 1)"_s;
    case 2:
        return u"Cannot continue without key (Error 2)"_s;
    case 3:
        return u"Key too small/is repeating (Error 3)"_s;
    case 4:
        return u"Source file not found (Error 4)"_s;
    case 5:
        return u"Compression checksum error (Error 5)"_s;
    case 6:
        return u"Cannot process empty file (Error 6)"_s;
    case 10:
        return u"Crypto version unknown/contains errors (Error 10)"_s;
    case 11:
        return u"Encoding has been aborted by user"_s;
    case 12:
        return u"File error: "_s + fileErrorText + u" (Error 12)"_s;
    case 20:
        return u"Crypto file version unknown/contains errors (Error 20)"_s;
    case 21:
        return u"Decoding has been aborted by user"_s;
    case 22:
        return u"File error: "_s + fileErrorText + u" (Error 22)"_s;
    case 23:
        return u"Failed decoding the file (Error 23)"_s;
    case 30:
        return u"Crypto header or footer format incomplete/contains errors (Error 30)"_s;
    case 33:
        return u"Failed decoding the text (Error 33)"_s;
    default:
        return std::nullopt;
    }
}

QByteArray PasswordCipher::makeHeader(QRandomGenerator &random)
{
    const int length = 32 + int(random.bounded(224));
    QByteArray header(length, Qt::Uninitialized);
    header[0] = static_cast<char>(length);
    for (int i = 1; i < length; ++i)
        header[i] = static_cast<char>(random.bounded(256));
    return header;
}

void PasswordCipher::setError(qint16 number)
{
    m_error = number;
    if (const auto message = cryptoErrorText(number))
        m_message = *message;
}
