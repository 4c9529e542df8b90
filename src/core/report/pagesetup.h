// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QLocale>
#include <QString>
#include <QStringList>

class SettingsStore;

// The page set-up values a report is printed with, kept where the user's own page set-up
// lives. While the print window is open the report's margins and options replace the user's;
// restore() puts every one of them back as it was, an absent value as an empty one.
class PageSetupSession
{
public:
    static inline const QString Key =
        QStringLiteral("Software\\Microsoft\\Internet Explorer\\PageSetup");
    static const QStringList &valueNames();

    explicit PageSetupSession(SettingsStore &store);
    ~PageSetupSession();
    PageSetupSession(const PageSetupSession &) = delete;
    PageSetupSession &operator=(const PageSetupSession &) = delete;

    // Run before each print command: backgrounds, the header with the date on the right and
    // the page numbers at the bottom right.
    void applyPageOptions(bool retainFormatting, bool todaysDate, bool pageNumbers,
                          const QString &headerText);
    void restore();
    // Margins chosen in the page set-up dialog, in inches; they last until the window closes.
    void setMargins(double top, double left, double right, double bottom);

    QString keptValue(const QString &valueName) const;

private:
    SettingsStore &m_store;
    QStringList m_kept;
    bool m_restored = false;
};

// What the renderer needs of the page set-up values.
struct PrintOptions
{
    double marginTopInches = 0.75;
    double marginBottomInches = 0.75;
    double marginLeftInches = 0.75;
    double marginRightInches = 0.75;
    bool shrinkToFit = true;
    bool printBackground = false;
    QString header; // page set-up codes: &b &d &D &p &P &w &&
    QString footer;
    QString windowTitle;
    QLocale locale; // of the date in the header and footer

    static PrintOptions fromStore(const SettingsStore &store, const QLocale &locale = QLocale(),
                                  const QString &windowTitle = {});
};
