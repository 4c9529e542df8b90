// Veltrix — KPI dashboard for small businesses.
#include "cipher/base64armour.h"
#include "cipher/huffmancodec.h"
#include "cipher/keystream.h"
#include "cipher/passwordcipher.h"
#include "cipher/windows1252.h"

#include <QRandomGenerator>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

const QString Key = u"Rv5HnW2j"_s;

// A fixed 40-byte header, so that values written elsewhere can be rebuilt byte for byte.
QByteArray fixedHeader()
{
    QByteArray header(1, char(40));
    for (int i = 0; i < 39; ++i)
        header.append(char((i * 37 + 11) % 256));
    return header;
}

QString armour(const QByteArray &framed, const QString &key = Key)
{
    KeyStream stream(Windows1252::fromUnicode(key), {});
    return Base64Armour::encode(stream.encipher(framed), 9999);
}

QString randomSingleByteText(QRandomGenerator &random)
{
    const int length = 1 + int(random.bounded(64));
    QByteArray bytes;
    for (int i = 0; i < length; ++i) {
        // Mostly printable, sometimes any byte, sometimes long runs of one character.
        const quint32 kind = random.bounded(10);
        if (kind < 6)
            bytes.append(char(0x20 + random.bounded(0x5F)));
        else if (kind < 9)
            bytes.append(char(1 + random.bounded(255)));
        else
            bytes.append(QByteArray(int(random.bounded(20)), 'x'));
    }
    return Windows1252::toUnicode(bytes);
}

} // namespace

class TestPasswordCipher : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void roundTripsThousandsOfTextsOnlyUnderTheirKey();
    void decryptsValuesWrittenElsewhere_data();
    void decryptsValuesWrittenElsewhere();
    void secondKeyChangesTheStream();
    void failedDecryptionReturnsInputUnchanged_data();
    void failedDecryptionReturnsInputUnchanged();
    void keyUsability_data();
    void keyUsability();
    void errorMessages_data();
    void errorMessages();
    void headerLengthStaysInRange();
    void codePageMapsSpecialCharacters_data();
    void codePageMapsSpecialCharacters();
    void armourBreaksLongLines();
    void arbitraryStoredValues();
};

void TestPasswordCipher::roundTripsThousandsOfTextsOnlyUnderTheirKey()
{
    QRandomGenerator random(20261206);
    PasswordCipher cipher(&random);
    for (int i = 0; i < 3000; ++i) {
        const QString text = randomSingleByteText(random);
        const QString stored = cipher.encryptText(text, Key);
        QVERIFY(!stored.contains(u'\n'));
        const QString back = cipher.decryptText(stored, Key);
        QCOMPARE(cipher.cryptoError(), PasswordCipher::NoError);
        QCOMPARE(back, text);
        QCOMPARE(cipher.decryptText(stored, u"Xq7LmP0z"_s), stored);
        QVERIFY(cipher.cryptoError() != PasswordCipher::NoError);
    }
    // The same text enciphers differently each time.
    const QString first = cipher.encryptText(u"workshop2024"_s, Key);
    QVERIFY(first != cipher.encryptText(u"workshop2024"_s, Key));
    QCOMPARE(cipher.encryptText(QString(), Key), QString());
    QCOMPARE(cipher.cryptoError(), PasswordCipher::NoError);
}

void TestPasswordCipher::decryptsValuesWrittenElsewhere_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("password");
    // Written by an independent implementation of the same format, with the fixed header
    // above: one stored as is, one Huffman-coded with codes this encoder would not choose.
    QTest::newRow("stored container")
        << u"GYxg2TqI8sbepAQLv4chh/rk8P14wmswP5FOtg9s8ENP/hcI/h4PeVaN1FPz88e5yKI="_s << u"zzzz"_s;
    QTest::newRow("coded container")
        << u"GYxg2TqI8sbepAQLv4chh/rk8P14wmswP5FOtg9s8ENP/hcI/h4PeVaN1zLOhROJb57hX1KEsHZnluzrvaJE2/W/0d0oreQ="_s
        << u"secrete!"_s;
    QTest::newRow("blanks around the value")
        << u" \t\r\nGYxg2TqI8sbepAQLv4chh/rk8P14wmswP5FOtg9s8ENP/hcI/h4PeVaN1FPz88e5yKI=\r\n"_s
        << u"zzzz"_s;
}

void TestPasswordCipher::decryptsValuesWrittenElsewhere()
{
    QFETCH(QString, stored);
    QFETCH(QString, password);
    PasswordCipher cipher;
    QCOMPARE(cipher.decryptText(stored, Key), password);
    QCOMPARE(cipher.cryptoError(), PasswordCipher::NoError);
    QCOMPARE(cipher.cryptoErrorMessage(), QString());
}

void TestPasswordCipher::secondKeyChangesTheStream()
{
    // The stream of one key is proven by the values written elsewhere; a second key changes it.
    const QByteArray framed =
        fixedHeader() + QByteArrayLiteral("HE0\rCaf\xe9") + fixedHeader().right(2);
    const QByteArray written = Base64Armour::decode(
        u"Wr5iG7jhzZ20m5NE9yaHsw/6zAJ2DSlGITuWhtiK60MFUPjBfgQxD2MrMF0F4CMDGps="_s);
    QCOMPARE(
        KeyStream(QByteArrayLiteral("Rv5HnW2j"), QByteArrayLiteral("Second")).decipher(written),
        framed);
    QVERIFY(KeyStream(QByteArrayLiteral("Rv5HnW2j"), {}).decipher(written) != framed);
}

void TestPasswordCipher::failedDecryptionReturnsInputUnchanged_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("key");
    QTest::addColumn<int>("error");

    const QByteArray header = fixedHeader();
    const QByteArray footer = header.right(2);

    QTest::newRow("empty") << QString() << Key << 1;
    QTest::newRow("only blanks") << u" \t \r\n "_s << Key << 1;
    QTest::newRow("key of four characters") << u"anything"_s << u"Rv5H"_s << 3;
    QTest::newRow("password typed in clear") << u"hunter22"_s << Key << 33;
    QTest::newRow("not Base64 at all") << u"my pass word!"_s << Key << 33;
    QTest::newRow("shorter than one group") << u"abc"_s << Key << 33;
    QTest::newRow("footer does not match")
        << armour(header + QByteArrayLiteral("HE0\rabc") + QByteArrayLiteral("xy")) << Key << 33;
    QTest::newRow("header longer than the value")
        << armour(QByteArray(1, char(200)) + QByteArrayLiteral("HE0\rabc")) << Key << 33;
    QTest::newRow("header length below two")
        << armour(QByteArray(1, char(1)) + QByteArrayLiteral("HE0\rab")) << Key << 33;
    QTest::newRow("container not identified")
        << armour(header + QByteArrayLiteral("HE9\rabc") + footer) << Key << 33;
    QTest::newRow("container cut short")
        << armour(header + QByteArrayLiteral("HE3\r\x01\x05") + footer) << Key << 33;

    // A coded container whose check byte disagrees with what it decodes to.
    QByteArray coded = HuffmanCodec::encode(QByteArrayLiteral("secret password"));
    QVERIFY(coded.startsWith("HE3\r"));
    coded[4] = char(coded[4] ^ 0x5A);
    QTest::newRow("check byte wrong") << armour(header + coded + footer) << Key << 5;
}

void TestPasswordCipher::failedDecryptionReturnsInputUnchanged()
{
    QFETCH(QString, stored);
    QFETCH(QString, key);
    QFETCH(int, error);
    PasswordCipher cipher;
    QCOMPARE(cipher.decryptText(stored, key), stored);
    QCOMPARE(int(cipher.cryptoError()), error);
    QCOMPARE(cipher.cryptoErrorMessage(), *PasswordCipher::cryptoErrorText(error));

    // The outcome belongs to the last call only.
    cipher.decryptText(cipher.encryptText(u"ok"_s, Key), Key);
    QCOMPARE(cipher.cryptoError(), PasswordCipher::NoError);
    QCOMPARE(cipher.cryptoErrorMessage(), QString());
}

void TestPasswordCipher::keyUsability_data()
{
    QTest::addColumn<QString>("key");
    QTest::addColumn<bool>("usable");
    // Four characters are refused by a row of the decryption failures.
    QTest::newRow("five different") << u"abcde"_s << true;
    QTest::newRow("one character repeated") << u"aaaaa"_s << false;
    QTest::newRow("three letters twice") << u"abcabc"_s << false;
    QTest::newRow("two letters three times") << u"ababab"_s << false;
    QTest::newRow("repetition with a shorter tail") << u"abcabca"_s << true;
    QTest::newRow("repeat only at the start") << u"aabcd"_s << true;
}

void TestPasswordCipher::keyUsability()
{
    QFETCH(QString, key);
    QFETCH(bool, usable);
    QCOMPARE(PasswordCipher::keyIsUsable(key), usable);
}

void TestPasswordCipher::errorMessages_data()
{
    QTest::addColumn<int>("number");
    QTest::addColumn<QString>("message");
    QTest::newRow("0") << 0 << QString();
    QTest::newRow("1") << 1 << u"Cannot continue without text (Error 1)"_s;
    QTest::newRow("2") << 2 << u"Cannot continue without key (Error 2)"_s;
    QTest::newRow("3") << 3 << u"Key too small/is repeating (Error 3)"_s;
    QTest::newRow("4") << 4 << u"Source file not found (Error 4)"_s;
    QTest::newRow("5") << 5 << u"Compression checksum error (Error 5)"_s;
    QTest::newRow("6") << 6 << u"Cannot process empty file (Error 6)"_s;
    QTest::newRow("10") << 10 << u"Crypto version unknown/contains errors (Error 10)"_s;
    QTest::newRow("11") << 11 << u"Encoding has been aborted by user"_s;
    QTest::newRow("12") << 12 << u"File error: Disk full (Error 12)"_s;
    QTest::newRow("20") << 20 << u"Crypto file version unknown/contains errors (Error 20)"_s;
    QTest::newRow("21") << 21 << u"Decoding has been aborted by user"_s;
    QTest::newRow("22") << 22 << u"File error: Disk full (Error 22)"_s;
    QTest::newRow("23") << 23 << u"Failed decoding the file (Error 23)"_s;
    QTest::newRow("30")
        << 30 << u"Crypto header or footer format incomplete/contains errors (Error 30)"_s;
    QTest::newRow("33") << 33 << u"Failed decoding the text (Error 33)"_s;
    QTest::newRow("7 is no error") << 7 << u"<none>"_s;
    QTest::newRow("-1 is no error") << -1 << u"<none>"_s;
}

void TestPasswordCipher::errorMessages()
{
    QFETCH(int, number);
    QFETCH(QString, message);
    QCOMPARE(PasswordCipher::cryptoErrorText(number, u"Disk full"_s).value_or(u"<none>"_s),
             message);
}

void TestPasswordCipher::headerLengthStaysInRange()
{
    QRandomGenerator random(99);
    int shortest = 255;
    int longest = 0;
    for (int i = 0; i < 5000; ++i) {
        const QByteArray header = PasswordCipher::makeHeader(random);
        const int length = quint8(header[0]);
        QCOMPARE(header.size(), length);
        shortest = std::min(shortest, length);
        longest = std::max(longest, length);
    }
    QCOMPARE(shortest, 32);
    QCOMPARE(longest, 255);
}

void TestPasswordCipher::codePageMapsSpecialCharacters_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<QByteArray>("bytes");
    QTest::newRow("euro sign") << u"\u20AC5"_s
                               << QByteArrayLiteral("\x80"
                                                    "5");
    QTest::newRow("e acute") << u"Caf\u00E9"_s << QByteArrayLiteral("Caf\xE9");
    QTest::newRow("curly quotes") << u"\u201Cq\u201D"_s << QByteArrayLiteral("\x93q\x94");
    QTest::newRow("outside the basic plane") << u"a\U0001F600b"_s << QByteArrayLiteral("a?b");
    QByteArray all;
    for (int b = 0; b < 256; ++b)
        all.append(char(b));
    QTest::newRow("every byte round trips") << Windows1252::toUnicode(all) << all;
}

void TestPasswordCipher::codePageMapsSpecialCharacters()
{
    QFETCH(QString, text);
    QFETCH(QByteArray, bytes);
    QCOMPARE(Windows1252::fromUnicode(text), bytes);
}

void TestPasswordCipher::armourBreaksLongLines()
{
    const QByteArray bytes(30, 'a'); // 40 characters of Base64
    const QString text = Base64Armour::encode(bytes, 16);
    QCOMPARE(text.split(u"\r\n"_s).first().size(), 16);
    QCOMPARE(Base64Armour::decode(text), bytes);
    // Below ten counts as ten: a break after every twelfth character.
    QCOMPARE(Base64Armour::encode(bytes, 3).split(u"\r\n"_s).first().size(), 12);
    QCOMPARE(Base64Armour::decode(u"YW="_s), QByteArray());
}

void TestPasswordCipher::arbitraryStoredValues()
{
    QRandomGenerator random(1);
    PasswordCipher cipher(&random);
    // Real values damaged: characters flipped (to any Base64 character, '=' or others), cut
    // short, or a piece of another value grafted on.
    int decodedAnyway = 0;
    for (int i = 0; i < 5000; ++i) {
        QString password;
        const int length = 1 + int(random.bounded(40));
        for (int k = 0; k < length; ++k)
            password.append(QChar(char16_t(0x20 + random.bounded(0x5F))));
        QString stored = cipher.encryptText(password, Key);
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
            stored.insert(random.bounded(stored.size()), cipher.encryptText(u"x"_s, Key).left(8));
            break;
        }
        // Stored values come from a settings store anyone can edit. Whatever is in there,
        // decrypting it must end: with the password, or with an error and the value as it was.
        const QString result = cipher.decryptText(stored, Key);
        if (cipher.cryptoError() != PasswordCipher::NoError)
            QCOMPARE(result, stored);
        else
            ++decodedAnyway;
    }
    // Damage to the header only still decodes; everything else must be caught.
    QVERIFY2(decodedAnyway < 2500, qPrintable(QString::number(decodedAnyway)));
}

QTEST_GUILESS_MAIN(TestPasswordCipher)
#include "tst_passwordcipher.moc"
