// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QRect>
#include <QString>

class SettingsStore;

// Remembers where a window stood, per window name, in twips (1/1440 inch) so that the values
// mean the same on screens of any density.
class WindowPlacement
{
public:
    enum class State { Normal = 0, Minimised = 1, Maximised = 2 };

    // twipsPerPixel is 15 on a 96 dpi screen.
    WindowPlacement(SettingsStore &store, double twipsPerPixel);

    static double twipsPerPixelAt(double dotsPerInch);

    // A maximised window keeps its last normal geometry and records only its state; a
    // minimised one records nothing.
    void save(const QString &windowName, const QRect &normalGeometry, State state);
    // The geometry with every saved edge and size applied; a missing or non-numeric value
    // leaves that one as it was.
    QRect restore(const QString &windowName, const QRect &current) const;
    std::optional<State> savedState(const QString &windowName) const;
    // Whether the window's place was ever saved.
    bool hasSavedPosition(const QString &windowName) const;

    // The window as large as it wants to be but no larger than the area, moved just enough to
    // lie wholly inside it: a window saved on a larger screen, or at another scaling, never
    // opens with its title bar or its controls out of reach.
    static QRect fittedInto(const QRect &wanted, const QRect &area);
    // A window of that size centred over another (its parent), then fitted into the area.
    static QRect centredOver(const QSize &size, const QRect &over, const QRect &area);

private:
    std::optional<int> readPixels(const QString &windowName, const QString &item) const;
    void writePixels(const QString &windowName, const QString &item, int pixels);

    SettingsStore &m_store;
    double m_twipsPerPixel;
};
