// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <optional>

class QRandomGenerator;

// Keeps the accounting file's password out of the settings in clear: the password is
// compressed, framed by a random header and a check footer, enciphered with a key stream and
// armoured as Base64. A stored value that does not decipher (a password typed in by hand) is
// handed back unchanged.
class PasswordCipher
{
public:
    enum CryptoError : qint16 {
        NoError = 0,
        NoText = 1,
        NoKey = 2,
        KeyUnusable = 3,
        ChecksumError = 5,
        TextDecodingFailed = 33,
    };

    // The header comes from the given generator (the system's by default).
    explicit PasswordCipher(QRandomGenerator *random = nullptr);

    // Empty text gives empty text. With an empty key nothing can be enciphered: the result is
    // empty and the error is NoKey.
    QString encryptText(const QString &text, const QString &key, const QString &secondKey = {});
    // On failure sets the error and returns the stored text exactly as given.
    QString decryptText(const QString &stored, const QString &key);

    // The outcome of the last call and its message.
    qint16 cryptoError() const { return m_error; }
    QString cryptoErrorMessage() const { return m_message; }

    // Keys shorter than five characters, or made of one group repeated, are too weak.
    static bool keyIsUsable(const QString &key);
    // The message of an error number; nothing for numbers without one.
    static std::optional<QString> cryptoErrorText(int number, const QString &fileErrorText = {});
    static QByteArray makeHeader(QRandomGenerator &random);

private:
    void setError(qint16 number);
    std::optional<QByteArray> decode(const QString &armoured, const QString &key);

    QRandomGenerator *m_random;
    qint16 m_error = NoError;
    QString m_message;
};
