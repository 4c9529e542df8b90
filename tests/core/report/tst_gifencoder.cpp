// Veltrix — KPI dashboard for small businesses.
#include "report/gifencoder.h"

#include <QBuffer>
#include <QImageReader>
#include <QRandomGenerator>
#include <QTemporaryDir>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

// The sub-blocks of the image data joined, then read back as 9-bit codes up to the end code.
QList<int> codesOf(const QByteArray &gif)
{
    QByteArray data;
    qsizetype at = gif.startsWith("GIF89a") ? 800 : 792; // past the header and palette
    while (at < gif.size() && gif[at] != 0) {
        const int length = quint8(gif[at]);
        data.append(gif.mid(at + 1, length));
        at += 1 + length;
    }
    QList<int> codes;
    qsizetype bit = 0;
    while (bit + 9 <= data.size() * 8) {
        int code = 0;
        for (int i = 0; i < 9; ++i, ++bit) {
            if (quint8(data[bit / 8]) & (1 << (bit % 8)))
                code |= 1 << i;
        }
        codes << code;
        if (code == GifEncoder::EndCode)
            break;
    }
    return codes;
}

QImage randomImage(QRandomGenerator &random, int width, int height, bool indexed)
{
    if (indexed) {
        QImage image(width, height, QImage::Format_Indexed8);
        QList<QRgb> table;
        for (int i = 0; i < 256; ++i)
            table << qRgb(random.bounded(256), random.bounded(256), random.bounded(256));
        image.setColorTable(table);
        // Few colours, so that strings repeat and grow.
        const int colours = 1 + random.bounded(256);
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x)
                image.setPixel(x, y, uint(random.bounded(colours)));
        }
        return image;
    }
    QImage image(width, height, QImage::Format_RGB32);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            image.setPixel(x, y,
                           random.bounded(4) == 0 ? qRgb(255, 255, 255)
                                                  : qRgb(random.bounded(256), random.bounded(256),
                                                         random.bounded(256)));
        }
    }
    return image;
}

QImage decodeWithQt(const QByteArray &gif)
{
    QBuffer buffer;
    buffer.setData(gif);
    QImageReader reader(&buffer, "gif");
    return reader.read().convertToFormat(QImage::Format_RGB32);
}

QRgb expectedColour(const QImage &source, int x, int y)
{
    if (source.format() == QImage::Format_Indexed8)
        return source.color(source.pixelIndex(x, y)) | 0xFF000000u;
    return GifEncoder::fixedPalette()[GifEncoder::nearestCubeIndex(source.pixel(x, y))];
}

} // namespace

class TestGifEncoder : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void nearestLevel_data();
    void nearestLevel();
    void codes_data();
    void codes();
    void fileLayout_data();
    void fileLayout();
    void progressEveryTenRows_data();
    void progressEveryTenRows();
    void decodesThroughQt_data();
    void decodesThroughQt();
    void saveGif();
};

void TestGifEncoder::nearestLevel_data()
{
    QTest::addColumn<int>("channel");
    QTest::addColumn<int>("level");
    const int cases[][2] = {{0, 0},   {31, 0},  {32, 0},  {33, 1},  {96, 1}, {97, 2},
                            {160, 2}, {161, 3}, {223, 3}, {224, 4}, {255, 4}};
    for (const auto &c : cases)
        QTest::addRow("%d", c[0]) << c[0] << c[1];
}

void TestGifEncoder::nearestLevel()
{
    QFETCH(int, channel);
    QFETCH(int, level);
    QCOMPARE(GifEncoder::nearestCubeIndex(qRgb(channel, 0, 0)), level);
    QCOMPARE(GifEncoder::nearestCubeIndex(qRgb(0, channel, 0)), 5 * level);
    QCOMPARE(GifEncoder::nearestCubeIndex(qRgb(0, 0, channel)), 25 * level);
    QCOMPARE(GifEncoder::nearestCubeIndex(qRgb(255, 255, 255)), 124);
    QCOMPARE(GifEncoder::fixedPalette()[124], qRgb(255, 255, 255));
    QCOMPARE(GifEncoder::fixedPalette()[125], qRgb(0, 0, 0));
}

void TestGifEncoder::codes_data()
{
    QTest::addColumn<QImage>("image");
    QTest::addColumn<QList<int>>("codes"); // the first codes written
    QImage column(1, 3, QImage::Format_RGB32);
    column.setPixel(0, 0, qRgb(255, 255, 255));
    column.setPixel(0, 1, qRgb(0, 0, 0));
    column.setPixel(0, 2, qRgb(64, 128, 192));
    QTest::newRow("one-pixel rows: clear, then the pixel")
        << column << QList<int>{256, 124, 256, 0, 256, 1 + 5 * 2 + 25 * 3, 257};
    // A long run of one colour: strings of 1, 2, 3 ... pixels, coded 124, 258, 259, ...
    QImage run(600, 1, QImage::Format_RGB32);
    run.fill(qRgb(250, 250, 250));
    QTest::newRow("a run of one colour") << run << QList<int>{256, 124, 258, 259, 260};
    // 0, 1, 2, ... 255, 0, 1, ...: every pair is new, so each pixel after the first is a miss
    // and the dictionary is full after 253 of them; it is cleared in the middle of the row.
    QImage ramp(600, 1, QImage::Format_Indexed8);
    ramp.setColorCount(256);
    for (int i = 0; i < 256; ++i)
        ramp.setColor(i, qRgb(i, 255 - i, (i * 7) % 256));
    QList<int> missEveryPixel{256};
    for (int x = 0; x < 600; ++x)
        ramp.setPixel(x, 0, uint(x % 256));
    for (int i = 0; i <= 253; ++i)
        missEveryPixel << i;
    QTest::newRow("full dictionary") << ramp << (missEveryPixel << 256 << 254);
}

void TestGifEncoder::codes()
{
    QFETCH(QImage, image);
    QFETCH(QList<int>, codes);
    GifEncoder encoder;
    QCOMPARE(codesOf(encoder.encode(image).value()).mid(0, codes.size()), codes);
}

void TestGifEncoder::fileLayout_data()
{
    QTest::addColumn<bool>("transparent");
    QTest::addColumn<QRgb>("colour");
    QTest::addColumn<int>("transparentIndex");
    QTest::newRow("no transparency") << false << QRgb(0) << -1;
    QTest::newRow("white") << true << qRgb(255, 255, 255) << 124;
    QTest::newRow("cube colour") << true << qRgb(64, 0, 128) << 1 + 50;
    QTest::newRow("in no entry") << true << qRgb(1, 2, 3) << 0;
}

void TestGifEncoder::fileLayout()
{
    QFETCH(bool, transparent);
    QFETCH(QRgb, colour);
    QFETCH(int, transparentIndex);
    QImage image(300, 2, QImage::Format_RGB32);
    image.fill(qRgb(255, 255, 255));
    GifEncoder encoder;
    const QByteArray gif =
        encoder.encode(image, transparent ? std::optional<QRgb>(colour) : std::nullopt).value();

    QCOMPARE(gif.left(6), transparent ? QByteArray("GIF89a") : QByteArray("GIF87a"));
    QCOMPARE(quint8(gif[6]) | quint8(gif[7]) << 8, 300);
    QCOMPARE(quint8(gif[8]) | quint8(gif[9]) << 8, 2);
    QCOMPARE(quint8(gif[10]), 0xF7);
    QCOMPARE(gif.mid(13 + 3 * 124, 3), QByteArray("\xFF\xFF\xFF", 3));
    const qsizetype separator = transparent ? 789 : 781;
    if (transparent) {
        QCOMPARE(gif.mid(781, 7),
                 QByteArray("\x21\xF9\x04\x09\x00\x00", 6) + char(transparentIndex));
        QCOMPARE(gif[788], char(0));
    }
    QCOMPARE(quint8(gif[separator]), 0x2C);
    QCOMPARE(gif.mid(separator + 1, 4), QByteArray(4, '\0'));
    QCOMPARE(quint8(gif[separator + 9]), 0x07);
    QCOMPARE(quint8(gif[separator + 10]), 8);
    QCOMPARE(gif.right(2), QByteArray("\x00\x3B", 2));
    // One short sub-block: its length, the codes, then the block terminator.
    QCOMPARE(separator + 12 + quint8(gif[separator + 11]) + 2, gif.size());
}

void TestGifEncoder::progressEveryTenRows_data()
{
    QTest::addColumn<int>("rows");
    QTest::addColumn<QList<int>>("reports");
    QTest::newRow("9 rows") << 9 << QList<int>{};
    QTest::newRow("10 rows") << 10 << QList<int>{100};
    QTest::newRow("25 rows") << 25 << QList<int>{40, 80};
    // 10 of 16 is 62.5 and 30 of 48 is 62.5: halves go to the even number.
    QTest::newRow("16 rows") << 16 << QList<int>{62};
    QTest::newRow("80 rows") << 80 << QList<int>{12, 25, 38, 50, 62, 75, 88, 100};
}

void TestGifEncoder::progressEveryTenRows()
{
    QFETCH(int, rows);
    QFETCH(QList<int>, reports);
    QImage image(3, rows, QImage::Format_RGB32);
    image.fill(Qt::red);
    GifEncoder encoder;
    QList<int> seen;
    connect(&encoder, &GifEncoder::progress, this, [&seen](int percent) { seen << percent; });
    QVERIFY(encoder.encode(image).has_value());
    QCOMPARE(seen, reports);
}

void TestGifEncoder::decodesThroughQt_data()
{
    QTest::addColumn<int>("width");
    QTest::addColumn<int>("height");
    QTest::addColumn<bool>("indexed");
    QTest::addColumn<bool>("transparent");
    QTest::newRow("1x1") << 1 << 1 << false << false;
    QTest::newRow("2x40 indexed") << 2 << 40 << true << true;
    QTest::newRow("97x13") << 97 << 13 << false << true;
    QTest::newRow("640x31 indexed") << 640 << 31 << true << false;
    QTest::newRow("1000x7") << 1000 << 7 << false << true;
    QTest::newRow("333x60 indexed") << 333 << 60 << true << true;
}

void TestGifEncoder::decodesThroughQt()
{
    QFETCH(int, width);
    QFETCH(int, height);
    QFETCH(bool, indexed);
    QFETCH(bool, transparent);
    QRandomGenerator random(quint32(width * 7919 + height));
    for (int round = 0; round < 5; ++round) {
        const QImage image = randomImage(random, width, height, indexed);
        GifEncoder encoder;
        const std::optional<QRgb> key =
            transparent ? std::optional<QRgb>(image.pixel(0, 0)) : std::nullopt;
        const QByteArray gif = encoder.encode(image, key).value();

        const QImage decoded = decodeWithQt(gif);
        QCOMPARE(decoded.size(), image.size());
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x) {
                if ((decoded.pixel(x, y) & 0xFFFFFF) != (expectedColour(image, x, y) & 0xFFFFFF))
                    QFAIL(qPrintable(u"pixel %1,%2 differs"_s.arg(x).arg(y)));
            }
        }
    }
}

void TestGifEncoder::saveGif()
{
    QTemporaryDir folder;
    // An existing file is replaced.
    const QString path = folder.filePath(u"tmp.gif"_s);
    {
        QFile old(path);
        QVERIFY(old.open(QIODevice::WriteOnly));
        old.write(QByteArray(5000, 'x'));
    }
    QImage image(8, 20, QImage::Format_RGB32);
    image.fill(Qt::blue);
    GifEncoder encoder;
    QVERIFY(encoder.saveGif(image, path));
    QFile written(path);
    QVERIFY(written.open(QIODevice::ReadOnly));
    QCOMPARE(written.readAll(), encoder.encode(image).value());
    QVERIFY(!encoder.isBusy());

    // A second save while the first is busy writes nothing.
    const QString inner = folder.filePath(u"inner.gif"_s);
    std::optional<bool> innerResult;
    auto connection = connect(&encoder, &GifEncoder::progress, this, [&] {
        if (!innerResult)
            innerResult = encoder.saveGif(image, inner);
    });
    QVERIFY(encoder.saveGif(image, folder.filePath(u"outer.gif"_s)));
    disconnect(connection);
    QCOMPARE(innerResult, std::optional<bool>(false));
    QVERIFY(!QFile::exists(inner));

    // Unusable pictures and places are refused, and the encoder stays usable.
    QVERIFY(!encoder.saveGif(QImage(), folder.filePath(u"a.gif"_s)));
    QVERIFY(!encoder.errorString().isEmpty());
    QVERIFY(!encoder.saveGif(image, folder.filePath(u"missing/folder/a.gif"_s)));
    QVERIFY(encoder.errorString().contains(u"missing/folder"_s));
    QVERIFY(encoder.saveGif(image, folder.filePath(u"b.gif"_s)));
}

QTEST_GUILESS_MAIN(TestGifEncoder)
#include "tst_gifencoder.moc"
