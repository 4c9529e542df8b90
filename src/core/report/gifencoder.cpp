// Veltrix — KPI dashboard for small businesses.
#include "gifencoder.h"

#include "common/rounding.h"

#include <QCoreApplication>
#include <QSaveFile>

#include <memory>
#include <vector>

using namespace Qt::StringLiterals;

namespace {

constexpr int CodeBits = 9;
constexpr int MaxCode = 511;
constexpr int SubBlockSize = 255;
constexpr int ProgressEvery = 10;

// Level number (0 to 4) of the nearest of 0, 64, 128, 192 and 255 for each channel value; a
// value half-way between two levels takes the lower one.
const std::array<quint8, 256> &levelTable()
{
    static const std::array<quint8, 256> table = [] {
        constexpr int levels[GifEncoder::CubeLevels] = {0, 64, 128, 192, 255};
        std::array<quint8, 256> t{};
        for (int v = 0; v < 256; ++v) {
            int best = 0;
            for (int l = 1; l < GifEncoder::CubeLevels; ++l) {
                if (std::abs(v - levels[l]) < std::abs(v - levels[best]))
                    best = l;
            }
            t[v] = quint8(best);
        }
        return t;
    }();
    return table;
}

// Codes packed least significant bit first into a flat stream, which is then cut into
// sub-blocks of at most 255 bytes.
class CodeWriter
{
public:
    explicit CodeWriter(qsizetype expectedCodes) { m_bytes.reserve(expectedCodes * 9 / 8 + 8); }

    void write(int code)
    {
        m_accumulator |= quint32(code) << m_bitCount;
        m_bitCount += CodeBits;
        while (m_bitCount >= 8) {
            m_bytes.push_back(char(m_accumulator & 0xFF));
            m_accumulator >>= 8;
            m_bitCount -= 8;
        }
    }

    void appendSubBlocks(QByteArray &out)
    {
        if (m_bitCount > 0) {
            m_bytes.push_back(char(m_accumulator & 0xFF));
            m_accumulator = 0;
            m_bitCount = 0;
        }
        for (qsizetype at = 0; at < m_bytes.size(); at += SubBlockSize) {
            const qsizetype length = std::min<qsizetype>(SubBlockSize, m_bytes.size() - at);
            out.append(char(length));
            out.append(m_bytes.constData() + at, length);
        }
    }

private:
    QByteArray m_bytes;
    quint32 m_accumulator = 0;
    int m_bitCount = 0;
};

// The strings of one row: a string is its prefix's code followed by one pixel. Entries of
// earlier rows are told apart by a generation number, so emptying costs nothing.
class StringTable
{
public:
    StringTable()
        : m_entries(std::make_unique<Entry[]>(MaxCode * 256))
    {}

    void clear()
    {
        ++m_generation;
        m_count = 0;
    }
    int count() const { return m_count; }

    int find(int prefix, quint8 pixel) const
    {
        const Entry &entry = m_entries[prefix * 256 + pixel];
        return entry.generation == m_generation ? entry.code : -1;
    }

    void add(int prefix, quint8 pixel)
    {
        Entry &entry = m_entries[prefix * 256 + pixel];
        entry.generation = m_generation;
        entry.code = quint16(GifEncoder::FirstStringCode + m_count++);
    }

private:
    struct Entry
    {
        quint32 generation = 0;
        quint16 code = 0;
    };
    std::unique_ptr<Entry[]> m_entries;
    quint32 m_generation = 1;
    int m_count = 0;
};

void appendWord(QByteArray &out, int value)
{
    out.append(char(value & 0xFF));
    out.append(char((value >> 8) & 0xFF));
}

struct IndexedPicture
{
    std::vector<quint8> pixels; // rows top to bottom, width bytes each
    GifEncoder::Palette palette{};
};

IndexedPicture indexedPicture(const QImage &picture)
{
    IndexedPicture result;
    const int width = picture.width();
    const int height = picture.height();
    result.pixels.resize(size_t(width) * size_t(height));
    if (picture.format() == QImage::Format_Indexed8) {
        const QList<QRgb> table = picture.colorTable();
        for (int i = 0; i < 256; ++i)
            result.palette[i] = i < table.size() ? (table[i] | 0xFF000000u) : qRgb(0, 0, 0);
        for (int y = 0; y < height; ++y)
            std::copy_n(picture.constScanLine(y), width, result.pixels.begin() + y * width);
        return result;
    }
    if (picture.format() == QImage::Format_Grayscale8) {
        for (int i = 0; i < 256; ++i)
            result.palette[i] = qRgb(i, i, i);
        for (int y = 0; y < height; ++y)
            std::copy_n(picture.constScanLine(y), width, result.pixels.begin() + y * width);
        return result;
    }
    result.palette = GifEncoder::fixedPalette();
    const QImage rgb = picture.convertToFormat(QImage::Format_RGB32);
    const std::array<quint8, 256> &level = levelTable();
    for (int y = 0; y < height; ++y) {
        const auto *line = reinterpret_cast<const QRgb *>(rgb.constScanLine(y));
        quint8 *out = result.pixels.data() + size_t(y) * size_t(width);
        for (int x = 0; x < width; ++x) {
            const QRgb c = line[x];
            out[x] = quint8(level[qRed(c)] + 5 * level[qGreen(c)] + 25 * level[qBlue(c)]);
        }
    }
    return result;
}

} // namespace

GifEncoder::GifEncoder(QObject *parent)
    : QObject(parent)
{}

const GifEncoder::Palette &GifEncoder::fixedPalette()
{
    static const Palette palette = [] {
        constexpr int levels[CubeLevels] = {0, 64, 128, 192, 255};
        Palette p;
        p.fill(qRgb(0, 0, 0));
        for (int b = 0; b < CubeLevels; ++b) {
            for (int g = 0; g < CubeLevels; ++g) {
                for (int r = 0; r < CubeLevels; ++r)
                    p[25 * b + 5 * g + r] = qRgb(levels[r], levels[g], levels[b]);
            }
        }
        return p;
    }();
    return palette;
}

quint8 GifEncoder::nearestCubeIndex(QRgb colour)
{
    const std::array<quint8, 256> &level = levelTable();
    return quint8(level[qRed(colour)] + 5 * level[qGreen(colour)] + 25 * level[qBlue(colour)]);
}

bool GifEncoder::saveGif(const QImage &picture, const QString &fileName,
                         std::optional<QRgb> transparentColour)
{
    if (m_busy)
        return false;
    const std::optional<QByteArray> bytes = encode(picture, transparentColour);
    if (!bytes)
        return false;
    // Written beside the target and renamed over it, so a failed write never leaves half a
    // picture behind.
    QSaveFile file(fileName);
    if (!file.open(QIODevice::WriteOnly) || file.write(*bytes) != bytes->size() || !file.commit()) {
        m_error = u"Could not write the picture to %1: %2"_s.arg(fileName, file.errorString());
        return false;
    }
    return true;
}

std::optional<QByteArray> GifEncoder::encode(const QImage &picture,
                                             std::optional<QRgb> transparentColour)
{
    if (m_busy)
        return std::nullopt;
    m_error.clear();
    if (picture.isNull() || picture.width() < 1 || picture.height() < 1) {
        m_error = u"The picture is empty."_s;
        return std::nullopt;
    }
    if (picture.width() > 0xFFFF || picture.height() > 0xFFFF) {
        m_error = u"The picture is larger than a GIF file can hold (65535 pixels a side)."_s;
        return std::nullopt;
    }
    m_busy = true;
    QByteArray bytes = encodeImage(picture, transparentColour);
    m_busy = false;
    return bytes;
}

QByteArray GifEncoder::encodeImage(const QImage &picture, std::optional<QRgb> transparentColour)
{
    const int width = picture.width();
    const int height = picture.height();
    const IndexedPicture indexed = indexedPicture(picture);

    int transparentIndex = 0;
    if (transparentColour) {
        const QRgb wanted = *transparentColour & 0xFFFFFF;
        for (int i = 0; i < 256; ++i) {
            if ((indexed.palette[i] & 0xFFFFFF) == wanted) {
                transparentIndex = i;
                break;
            }
        }
    }

    QByteArray out;
    out.reserve(800 + qsizetype(width) * height * 9 / 8 + 4096);
    out.append(transparentColour ? "GIF89a" : "GIF87a");
    appendWord(out, width);
    appendWord(out, height);
    out.append(char(0xF7));
    out.append(char(0));
    out.append(char(0));
    for (const QRgb colour : indexed.palette) {
        out.append(char(qRed(colour)));
        out.append(char(qGreen(colour)));
        out.append(char(qBlue(colour)));
    }
    if (transparentColour) {
        out.append("\x21\xF9\x04\x09\x00\x00", 6);
        out.append(char(transparentIndex));
        out.append(char(0));
    }
    out.append(char(0x2C));
    appendWord(out, 0);
    appendWord(out, 0);
    appendWord(out, width);
    appendWord(out, height);
    out.append(char(0x07));
    out.append(char(8));

    CodeWriter codes(qsizetype(width) * height);
    StringTable strings;
    for (int row = 1; row <= height; ++row) {
        const quint8 *pixels = indexed.pixels.data() + size_t(row - 1) * size_t(width);
        strings.clear();
        codes.write(ClearCode);
        int current = pixels[0];
        for (int k = 1; k < width; ++k) {
            const quint8 pixel = pixels[k];
            const int found = strings.find(current, pixel);
            if (found >= 0) {
                current = found;
                continue;
            }
            codes.write(current);
            if (strings.count() >= MaxStrings) {
                codes.write(ClearCode);
                strings.clear();
            } else {
                strings.add(current, pixel);
            }
            current = pixel;
        }
        codes.write(current);
        if (row % ProgressEvery == 0) {
            // A true half (62.5 for row 10 of 16) is exact in binary and goes to the even one.
            Q_EMIT progress(int(Rounding::halfToEven(row * 100.0 / height, 0)));
            if (QCoreApplication::instance())
                QCoreApplication::processEvents();
        }
    }
    codes.write(EndCode);
    codes.appendSubBlocks(out);
    out.append(char(0));
    out.append(char(0x3B));
    return out;
}
