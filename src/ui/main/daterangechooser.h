// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "engine/rangeselection.h"

#include <QHash>
#include <QSet>
#include <QWidget>

#include <functional>
#include <optional>

class Prompter;
class QComboBox;
class QLocale;

// The choice of months: "From date" and "To date" as a month list and a year box each, and the
// buttons that step the range by a month or a year within its limits. Typed years are refused
// with a message when they fall outside the limits.
class DateRangeChooser : public QWidget
{
    Q_OBJECT

public:
    DateRangeChooser(const QLocale &locale, int currentYear, Prompter &prompter,
                     QWidget *parent = nullptr);

    RangeSelection::Selection selection() const;
    void showSelection(const RangeSelection::Selection &selection);
    void showRemembered(const RangeSelection::Remembered &remembered);
    // Typed years are checked before a command uses them; false after saying which is wrong.
    bool checkYears();

    // Each step shows the new range and announces it, or says the limit is reached.
    void stepPreviousMonth();
    void stepFollowingMonth();
    void stepPreviousYear();
    void stepFollowingYear();

    QComboBox *lstMonth1() const { return m_lstMonth1; }
    QComboBox *lstMonth2() const { return m_lstMonth2; }
    QComboBox *lstYear1() const { return m_lstYear1; }
    QComboBox *lstYear2() const { return m_lstYear2; }

Q_SIGNALS:
    // A step button moved the range; the window produces it.
    void stepped();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    QComboBox *monthList(const QLocale &locale, const QString &name);
    QComboBox *yearBox(const QString &name);
    void step(const std::function<
              std::optional<RangeSelection::Selection>(const RangeSelection::Selection &)> &next);
    bool isRefusable(const QComboBox *box) const;
    void refuseYear(QComboBox *box);

    const int m_currentYear;
    Prompter &m_prompter;
    // The year boxes whose text the user typed. Only typed years are checked: the year
    // buttons may choose the year after the current one as the end of a financial year.
    QSet<const QComboBox *> m_typedYears;
    // The invalid text each year box was last refused for, so that leaving it again is not
    // refused again: the user is told once and never held in the box.
    QHash<const QComboBox *, QString> m_refusedYears;
    QComboBox *m_lstMonth1 = nullptr;
    QComboBox *m_lstMonth2 = nullptr;
    QComboBox *m_lstYear1 = nullptr;
    QComboBox *m_lstYear2 = nullptr;
};
