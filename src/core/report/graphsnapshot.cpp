// Veltrix — KPI dashboard for small businesses.
#include "graphsnapshot.h"

#include "gifencoder.h"

#include "common/fileoperations.h"

#include <QImageReader>
#include <QPainter>

using namespace Qt::StringLiterals;

namespace GraphSnapshot {

std::optional<QString> writeSnapshot(const QImage &rendered, const Files &files)
{
    if (rendered.isNull())
        return u"The graph could not be drawn."_s;
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
    if (!surface.save(files.bmp, "BMP"))
        return u"The graph picture could not be written to %1."_s.arg(files.bmp);
    return std::nullopt;
}

} // namespace GraphSnapshot
