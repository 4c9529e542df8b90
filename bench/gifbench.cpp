// Veltrix — KPI dashboard for small businesses.
// Encoding a 1000 x 400 picture that looks like a graph (white ground, scale lines, shaded
// bars, numbers) as the print snapshot does. Target: under 15 ms.

#include "report/gifencoder.h"

#include <QElapsedTimer>
#include <QGuiApplication>
#include <QImage>
#include <QLinearGradient>
#include <QPainter>
#include <QTextStream>

#include <algorithm>

using namespace Qt::StringLiterals;

namespace {

QImage graphPicture()
{
    QImage image(1000, 400, QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter painter(&image);
    for (int i = 0; i <= 10; ++i) {
        painter.setPen(i == 0 ? QColor(0x80, 0x80, 0x80) : QColor(0xE0, 0xE0, 0xE0));
        painter.drawLine(30, 380 - 34 * i, 990, 380 - 34 * i);
        painter.drawText(0, 385 - 34 * i, QString::number(i * 10));
    }
    const QColor colours[] = {QColor(0xC8, 0xFF, 0x51), QColor(0xFF, 0xE5, 0x6D),
                              QColor(0xFF, 0x98, 0x87)};
    for (int bar = 0; bar < 28; ++bar) {
        const int height = 60 + (bar * 97) % 300;
        const QRect body(40 + bar * 34, 380 - height, 30, height);
        QLinearGradient shade(body.topLeft(), body.topRight());
        shade.setColorAt(0, colours[bar % 3].lighter(135));
        shade.setColorAt(0.5, colours[bar % 3]);
        shade.setColorAt(1, colours[bar % 3].lighter(135));
        painter.fillRect(body, shade);
        painter.drawText(body.left(), body.top() - 6, u"+%1%"_s.arg(bar % 9));
    }
    return image;
}

} // namespace

int main(int argc, char *argv[])
{
    // Text on the picture needs fonts, and so a platform; no display is needed.
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    const int rounds = argc > 1 ? QString::fromLocal8Bit(argv[1]).toInt() : 100;
    const QImage picture = graphPicture();
    GifEncoder encoder;
    qsizetype bytes = encoder.encode(picture, qRgb(255, 255, 255))->size(); // warm

    QList<double> timings;
    for (int round = 0; round < rounds; ++round) {
        QElapsedTimer timer;
        timer.start();
        bytes = encoder.encode(picture, qRgb(255, 255, 255))->size();
        timings << timer.nsecsElapsed() / 1e6;
    }
    std::sort(timings.begin(), timings.end());
    QTextStream(stdout) << "gif encode 1000x400 (" << bytes << " bytes): median "
                        << timings.at(timings.size() / 2) << " ms, best " << timings.first()
                        << " ms, worst " << timings.last() << " ms (target 15 ms)" << Qt::endl;
    return 0;
}
