// Veltrix — KPI dashboard for small businesses.
#include "cipher/huffmancodec.h"

#include <QTest>
#include <QtEndian>

namespace {

// Packs a run of bits written as text ("0110"), least significant bit first.
QByteArray packBits(const QByteArray &bits)
{
    QByteArray bytes((bits.size() + 7) / 8, '\0');
    for (qsizetype t = 0; t < bits.size(); ++t) {
        if (bits[t] == '1')
            bytes[t / 8] = char(bytes[t / 8] | (1 << (t % 8)));
    }
    return bytes;
}

// A coded container built by hand from a code table of our choosing.
QByteArray codedContainer(const QByteArray &plain, const QMap<char, QByteArray> &codes,
                          std::optional<quint32> lengthOverride = std::nullopt)
{
    quint8 check = 0;
    for (const char c : plain)
        check ^= quint8(c);
    QByteArray out("HE3\r");
    out.append(char(check));
    char number[4];
    qToLittleEndian<quint32>(lengthOverride.value_or(quint32(plain.size())), number);
    out.append(number, 4);
    qToLittleEndian<quint16>(quint16(codes.size()), number);
    out.append(number, 2);
    QByteArray tableBits;
    for (auto it = codes.cbegin(); it != codes.cend(); ++it) {
        out.append(it.key());
        out.append(char(it.value().size()));
        tableBits += it.value();
    }
    out += packBits(tableBits);
    QByteArray dataBits;
    for (const char c : plain)
        dataBits += codes.value(c);
    out += packBits(dataBits);
    return out;
}

} // namespace

class TestHuffmanCodec : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void roundTrips_data();
    void roundTrips();
    void writesTheDocumentedLayout();
    void decodesWhatItIsGiven_data();
    void decodesWhatItIsGiven();
};

void TestHuffmanCodec::roundTrips_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<QByteArray>("tag");
    // Fewer than two distinct bytes cannot be coded: they are stored as they are.
    QTest::newRow("empty") << QByteArray() << QByteArray("HE0\r");
    QTest::newRow("one byte repeated") << QByteArray("zzzz") << QByteArray("HE0\r");
    QTest::newRow("skewed frequencies")
        << QByteArray(1000, 'a') + QByteArray("bcdefgh") << QByteArray("HE3\r");
    QByteArray all;
    for (int round = 0; round < 4; ++round) {
        for (int b = 0; b < 256; ++b)
            all.append(char(b));
    }
    QTest::newRow("every byte value") << all << QByteArray("HE3\r");
}

void TestHuffmanCodec::roundTrips()
{
    QFETCH(QByteArray, bytes);
    QFETCH(QByteArray, tag);
    const QByteArray container = HuffmanCodec::encode(bytes);
    if (tag == "HE0\r")
        QCOMPARE(container, tag + bytes);
    QVERIFY(container.startsWith(tag));
    const HuffmanCodec::Decoded decoded = HuffmanCodec::decode(container);
    QCOMPARE(decoded.status, HuffmanCodec::Status::Ok);
    QCOMPARE(decoded.bytes, bytes);
}

void TestHuffmanCodec::writesTheDocumentedLayout()
{
    // Frequencies 4, 2, 1, 1 give code lengths 1, 2, 3 and 3 whatever the tie-breaks.
    const QByteArray plain("aaaabbcd");
    const QByteArray container = HuffmanCodec::encode(plain);
    QVERIFY(container.startsWith("HE3\r"));
    QCOMPARE(quint8(container[4]), quint8('a' ^ 'a' ^ 'a' ^ 'a' ^ 'b' ^ 'b' ^ 'c' ^ 'd'));
    QCOMPARE(qFromLittleEndian<quint32>(container.constData() + 5), quint32(8));
    QCOMPARE(qFromLittleEndian<quint16>(container.constData() + 9), quint16(4));
    QCOMPARE(container.mid(11, 8), QByteArray("a\x01"
                                              "b\x02"
                                              "c\x03"
                                              "d\x03",
                                              8));
    // 9 bits of codes take two bytes; 4 + 4 + 3 + 3 = 14 bits of data take two more.
    QCOMPARE(container.size(), 11 + 8 + 2 + 2);
    // The last byte of the table has its unused high bits clear.
    QCOMPARE(quint8(container[20]) & 0xFE, 0);
}

void TestHuffmanCodec::decodesWhatItIsGiven_data()
{
    QTest::addColumn<QByteArray>("container");
    QTest::addColumn<HuffmanCodec::Status>("status");
    QTest::addColumn<QByteArray>("plain");
    const QMap<char, QByteArray> codes{{'a', "0"}, {'b', "10"}, {'c', "11"}};
    const QByteArray good = codedContainer("abcabc", codes);
    using enum HuffmanCodec::Status;

    // Codes this encoder would not choose are still read (a value written elsewhere with the
    // ones first is among the stored values of the password cipher test).
    QTest::newRow("lengths beyond need")
        << codedContainer("abcab", {{'a', "0"}, {'b', "10"}, {'c', "1110"}}) << Ok
        << QByteArray("abcab");
    QTest::newRow("no data") << codedContainer({}, {}) << Ok << QByteArray();
    QTest::newRow("unknown tag") << QByteArray("HE4\rabc") << NotIdentified << QByteArray();
    QTest::newRow("too short for a tag") << QByteArray("HE") << NotIdentified << QByteArray();
    QTest::newRow("header cut short") << good.left(9) << Corrupt << QByteArray();
    QTest::newRow("table cut short") << good.left(13) << Corrupt << QByteArray();
    QTest::newRow("data cut short") << good.left(good.size() - 1) << Corrupt << QByteArray();
    QTest::newRow("length far beyond the data")
        << codedContainer("abcabc", codes, 0xFFFFFFFFu) << Corrupt << QByteArray();
    QTest::newRow("one code the prefix of another")
        << codedContainer("ab", {{'a', "1"}, {'b', "10"}}) << Corrupt << QByteArray();
    QTest::newRow("two values with one code")
        << codedContainer("ab", {{'a', "01"}, {'b', "01"}}) << Corrupt << QByteArray();
    QTest::newRow("code of no bits")
        << codedContainer("a", {{'a', ""}, {'b', "1"}}) << Corrupt << QByteArray();
    QByteArray strayBits = codedContainer("ab", {{'a', "00"}, {'b', "01"}});
    strayBits.back() = char(0xFF); // "11" is no code
    QTest::newRow("data leads outside the codes") << strayBits << Corrupt << QByteArray();
    QByteArray tooManyValues = good;
    tooManyValues[9] = char(0x01);
    tooManyValues[10] = char(0x01); // 257 values
    QTest::newRow("more values than bytes have") << tooManyValues << Corrupt << QByteArray();
    // A wrong check byte is a row of the password cipher test, through the whole cipher.
}

void TestHuffmanCodec::decodesWhatItIsGiven()
{
    QFETCH(QByteArray, container);
    QFETCH(HuffmanCodec::Status, status);
    QFETCH(QByteArray, plain);
    const HuffmanCodec::Decoded decoded = HuffmanCodec::decode(container);
    QCOMPARE(decoded.status, status);
    if (status == HuffmanCodec::Status::Ok)
        QCOMPARE(decoded.bytes, plain);
}

QTEST_GUILESS_MAIN(TestHuffmanCodec)
#include "tst_huffmancodec.moc"
