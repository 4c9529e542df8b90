// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QImage>
#include <QString>

#include <optional>

// The picture of a graph a printed report shows: the rendered graph reduced to the GIF
// encoder's fixed palette, its background colour (the top-left pixel) left transparent, laid
// over the full-colour rendering. Where the reduced picture is transparent the graph's own
// colours show.
namespace GraphSnapshot {

struct Files
{
    QString gif; // intermediate, deleted afterwards
    QString bmp; // the result
};

// Writes files.bmp from the rendered graph; std::nullopt on success, else why it failed.
std::optional<QString> writeSnapshot(const QImage &rendered, const Files &files);

// The light grey the snapshot surface shows where neither picture covers it.
inline constexpr QRgb SurfaceColour = 0xFFE0E0E0;

} // namespace GraphSnapshot
