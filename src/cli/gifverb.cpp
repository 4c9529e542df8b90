// Veltrix — KPI dashboard for small businesses.
#include "gifverb.h"

#include "report/gifencoder.h"

#include <QCommandLineParser>
#include <QImageReader>
#include <QTextStream>

using namespace Qt::StringLiterals;

namespace GifVerb {

int encodeGif(const QStringList &arguments)
{
    QCommandLineParser parser;
    parser.addOption({u"transparent"_s, u"transparent colour"_s, u"RRGGBB"_s});
    parser.addPositionalArgument(u"in"_s, u"picture"_s);
    parser.addPositionalArgument(u"out"_s, u"GIF file"_s);
    QTextStream err(stderr);
    if (!parser.parse(QStringList{u"veltrix-cli encode-gif"_s} + arguments) ||
        parser.positionalArguments().size() != 2) {
        err << "usage: veltrix-cli encode-gif IN OUT.gif [--transparent RRGGBB]" << Qt::endl;
        return 2;
    }
    std::optional<QRgb> transparent;
    if (parser.isSet(u"transparent"_s)) {
        const QString text = parser.value(u"transparent"_s).remove(u'#');
        bool ok = false;
        const uint rgb = text.toUInt(&ok, 16);
        if (!ok || text.size() != 6) {
            err << "veltrix-cli encode-gif: --transparent is a colour written RRGGBB" << Qt::endl;
            return 2;
        }
        transparent = rgb;
    }
    const QString in = parser.positionalArguments().at(0);
    QImageReader reader(in);
    const QImage picture = reader.read();
    if (picture.isNull()) {
        err << "veltrix-cli encode-gif: cannot read " << in << ": " << reader.errorString()
            << Qt::endl;
        return 1;
    }
    GifEncoder encoder;
    if (!encoder.saveGif(picture, parser.positionalArguments().at(1), transparent)) {
        err << "veltrix-cli encode-gif: " << encoder.errorString() << Qt::endl;
        return 1;
    }
    return 0;
}

} // namespace GifVerb
