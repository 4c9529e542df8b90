// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QByteArray>
#include <QImage>
#include <QObject>
#include <QString>

#include <array>
#include <optional>

// Writes a picture as an 8-bit GIF file, optionally with one transparent colour. Pictures of
// more than 8 bits per pixel are reduced to a fixed cube of 125 colours (five levels per
// channel); 8-bit pictures keep their own colour table. The LZW coder keeps a fixed 9-bit code
// width and restarts its dictionary on every row, so any decoder reads the file.
class GifEncoder : public QObject
{
    Q_OBJECT

public:
    // 0, 64, 128, 192, 255 on each channel; index = 25 * blue + 5 * green + red level.
    static constexpr int CubeLevels = 5;
    static constexpr int CubeColours = CubeLevels * CubeLevels * CubeLevels;
    static constexpr int ClearCode = 256;
    static constexpr int EndCode = 257;
    static constexpr int FirstStringCode = 258;
    static constexpr int MaxStrings = 253; // codes 258 to 510: the width never reaches 10 bits

    using Palette = std::array<QRgb, 256>;

    explicit GifEncoder(QObject *parent = nullptr);

    // Writes the file, replacing an existing one. With a transparent colour the file is a
    // GIF89a whose first palette entry of that colour (or entry 0) is transparent, otherwise
    // a GIF87a. False when another save on this object is running or the picture or the file
    // cannot be used; errorString() then says why.
    bool saveGif(const QImage &picture, const QString &fileName,
                 std::optional<QRgb> transparentColour = std::nullopt);
    // The same bytes, in memory.
    std::optional<QByteArray> encode(const QImage &picture,
                                     std::optional<QRgb> transparentColour = std::nullopt);

    bool isBusy() const { return m_busy; }
    QString errorString() const { return m_error; }

    static const Palette &fixedPalette();
    // The cube entry nearest to a colour, channel by channel.
    static quint8 nearestCubeIndex(QRgb colour);

Q_SIGNALS:
    // Percent of the rows written, after every tenth row.
    void progress(int percent);

private:
    QByteArray encodeImage(const QImage &picture, std::optional<QRgb> transparentColour);

    bool m_busy = false;
    QString m_error;
};
