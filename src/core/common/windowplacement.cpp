// Veltrix — KPI dashboard for small businesses.
#include "windowplacement.h"

#include "settingsstore.h"

#include <algorithm>

#include <cmath>

using namespace Qt::StringLiterals;

namespace {

std::optional<int> wholeNumber(const QString &text)
{
    bool ok = false;
    const int number = text.toInt(&ok);
    return ok ? std::optional<int>(number) : std::nullopt;
}

} // namespace

WindowPlacement::WindowPlacement(SettingsStore &store, double twipsPerPixel)
    : m_store(store)
    , m_twipsPerPixel(twipsPerPixel > 0 ? twipsPerPixel : 15.0)
{}

double WindowPlacement::twipsPerPixelAt(double dotsPerInch)
{
    return dotsPerInch > 0 ? 1440.0 / dotsPerInch : 15.0;
}

void WindowPlacement::save(const QString &windowName, const QRect &normalGeometry, State state)
{
    if (state == State::Normal) {
        writePixels(windowName, u"Top"_s, normalGeometry.top());
        writePixels(windowName, u"Left"_s, normalGeometry.left());
        writePixels(windowName, u"Width"_s, normalGeometry.width());
        writePixels(windowName, u"Height"_s, normalGeometry.height());
    }
    if (state != State::Minimised) {
        m_store.writeSetting(windowName + u"State"_s, QString::number(static_cast<int>(state)),
                             SettingsStore::FormsKey);
    }
}

QRect WindowPlacement::restore(const QString &windowName, const QRect &current) const
{
    QRect geometry = current;
    if (const auto top = readPixels(windowName, u"Top"_s))
        geometry.moveTop(*top);
    if (const auto left = readPixels(windowName, u"Left"_s))
        geometry.moveLeft(*left);
    if (const auto height = readPixels(windowName, u"Height"_s))
        geometry.setHeight(*height);
    if (const auto width = readPixels(windowName, u"Width"_s))
        geometry.setWidth(*width);
    return geometry;
}

bool WindowPlacement::hasSavedPosition(const QString &windowName) const
{
    return readPixels(windowName, u"Left"_s).has_value() &&
           readPixels(windowName, u"Top"_s).has_value();
}

QRect WindowPlacement::fittedInto(const QRect &wanted, const QRect &area)
{
    if (!area.isValid())
        return wanted;
    QRect fitted(wanted.topLeft(), wanted.size().boundedTo(area.size()));
    fitted.moveLeft(std::clamp(fitted.left(), area.left(), area.right() - fitted.width() + 1));
    fitted.moveTop(std::clamp(fitted.top(), area.top(), area.bottom() - fitted.height() + 1));
    return fitted;
}

QRect WindowPlacement::centredOver(const QSize &size, const QRect &over, const QRect &area)
{
    QRect centred(QPoint(0, 0), size);
    centred.moveCenter((over.isValid() ? over : area).center());
    return fittedInto(centred, area);
}

std::optional<WindowPlacement::State> WindowPlacement::savedState(const QString &windowName) const
{
    const auto state =
        wholeNumber(m_store.readSetting(windowName + u"State"_s, SettingsStore::FormsKey));
    if (state == 0)
        return State::Normal;
    if (state == 2)
        return State::Maximised;
    return std::nullopt;
}

std::optional<int> WindowPlacement::readPixels(const QString &windowName, const QString &item) const
{
    const auto twips = wholeNumber(m_store.readSetting(windowName + item, SettingsStore::FormsKey));
    if (!twips)
        return std::nullopt;
    return static_cast<int>(std::lround(*twips / m_twipsPerPixel));
}

void WindowPlacement::writePixels(const QString &windowName, const QString &item, int pixels)
{
    const long twips = std::lround(pixels * m_twipsPerPixel);
    m_store.writeSetting(windowName + item, QString::number(twips), SettingsStore::FormsKey);
}
