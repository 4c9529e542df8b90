// Veltrix — KPI dashboard for small businesses.
#include "graphsnapshot.h"

#include "gifencoder.h"

#include "common/fileoperations.h"

#include <QImageReader>
#include <QPainter>

using namespace Qt::StringLiterals;

namespace GraphSnapshot {

std::optional<QString> writeSnapshot(const QImage &grabbed, const Files &files)
{
    if (grabbed.isNull())
        return u"The graph could not be drawn."_s;
    // Worked on pixel for pixel: a grab from a high-density screen would otherwise be painted
    // at half its size over the reduced picture, which has no density of its own.
    QImage rendered = grabbed;
    rendered.setDevicePixelRatio(1.0);
    const QRgb transparent = rendered.pixel(0, 0) & 0xFFFFFF;
    GifEncoder encoder;
    if (!encoder.saveGif(rendered, files.gif, transparent))
        return encoder.errorString();

    QImageReader reader(files.gif, "gif");
    const QImage reduced = reader.read();
    FileOperations::deleteFile(files.gif);
    if (reduced.isNull())
        return u"The graph picture could not be read back: %1"_s.arg(reader.errorString());

    QImage surface(rendered.size(), QImage::Format_RGB32);
    surface.fill(SurfaceColour);
    {
        QPainter painter(&surface);
        painter.drawImage(0, 0, rendered);
        painter.drawImage(0, 0, reduced);
    }
    FileOperations::deleteFile(files.bmp);
    // A picture grabbed from a high-density screen has more pixels than the graph has points;
    // its density goes into the file so that the page shows it at the graph's own size.
    const int dotsPerMeter = int(std::lround(96.0 / 0.0254 * grabbed.devicePixelRatio()));
    surface.setDotsPerMeterX(dotsPerMeter);
    surface.setDotsPerMeterY(dotsPerMeter);
    if (!surface.save(files.bmp, "BMP"))
        return u"The graph picture could not be written to %1."_s.arg(files.bmp);
    return std::nullopt;
}

} // namespace GraphSnapshot
