// Veltrix — KPI dashboard for small businesses.
#include "cipher/passwordcipher.h"

#include <QRandomGenerator>
#include <QTest>

using namespace Qt::StringLiterals;

// Stored values come from a settings store anyone can edit. Whatever is in there, decrypting
// it must end: either with the password or with an error and the value handed back as it was.
class TestCipherFuzz : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void randomText();
    void mutatedStoredValues();

private:
    void decryptSafely(PasswordCipher &cipher, const QString &stored);
};

void TestCipherFuzz::decryptSafely(PasswordCipher &cipher, const QString &stored)
{
    const QString result = cipher.decryptText(stored, u"Rv5HnW2j"_s);
    if (cipher.cryptoError() != PasswordCipher::NoError)
        QCOMPARE(result, stored);
    else
        QVERIFY(cipher.cryptoErrorMessage().isEmpty());
}

void TestCipherFuzz::randomText()
{
    static const QString Base64Characters =
        u"ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/= \r\n"_s;
    QRandomGenerator random(1);
    PasswordCipher cipher(&random);
    for (int i = 0; i < 5000; ++i) {
        QString stored;
        const int length = int(random.bounded(400));
        for (int k = 0; k < length; ++k)
            stored.append(Base64Characters.at(random.bounded(Base64Characters.size())));
        decryptSafely(cipher, stored);
        if (QTest::currentTestFailed())
            return;
    }
}

void TestCipherFuzz::mutatedStoredValues()
{
    QRandomGenerator random(2);
    PasswordCipher cipher(&random);
    int decodedAnyway = 0;
    for (int i = 0; i < 5000; ++i) {
        QString password;
        const int length = 1 + int(random.bounded(40));
        for (int k = 0; k < length; ++k)
            password.append(QChar(char16_t(0x20 + random.bounded(0x5F))));
        QString stored = cipher.encryptText(password, u"Rv5HnW2j"_s);

        // Damage it: flip characters, cut it, or graft on a piece of another value.
        switch (random.bounded(3)) {
        case 0:
            for (int flips = 1 + int(random.bounded(3)); flips > 0; --flips)
                stored[random.bounded(stored.size())] =
                    QChar(char16_t(0x2B + random.bounded(0x50)));
            break;
        case 1:
            stored.truncate(random.bounded(stored.size()));
            break;
        default:
            stored.insert(random.bounded(stored.size()),
                          cipher.encryptText(u"x"_s, u"Rv5HnW2j"_s).left(8));
            break;
        }
        decryptSafely(cipher, stored);
        if (QTest::currentTestFailed())
            return;
        if (cipher.cryptoError() == PasswordCipher::NoError)
            ++decodedAnyway;
    }
    // Damage to the header only still decodes; everything else must be caught.
    QVERIFY2(decodedAnyway < 2500, qPrintable(QString::number(decodedAnyway)));
}

QTEST_GUILESS_MAIN(TestCipherFuzz)
#include "tst_cipherfuzz.moc"
