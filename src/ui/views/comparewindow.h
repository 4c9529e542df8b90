// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "engine/perioddataset.h"
#include "views/comparisonranges.h"

#include <QDialog>

class AppContext;
class KpiTabView;
class QLabel;
class QPushButton;
class QTimer;
class TabButtons;

// frmCompare: the produced range beside the same range in up to four earlier years or earlier
// periods of equal length. It loads the earlier ranges into slots 1 to N while a progress bar
// moves period by period, then shows the tabs with a column per period, the averages, and on
// the Summary tab a bar per Field and period.
class CompareWindow : public QDialog
{
    Q_OBJECT

public:
    CompareWindow(AppContext &context, ComparisonRanges::Kind kind, int count,
                  QWidget *owner = nullptr);
    ~CompareWindow() override;

    // Opens the window modally over the owner; returns when it is closed.
    static void compareData(AppContext &context, QWidget *owner, const QString &kind, int count);

    // "Jul 03 - Jun 04".
    static QString rangeHeader(const PeriodDataSet::Range &range, const QLocale &locale);

    void selectTab(int tab);
    void print();
    bool isLoading() const { return m_loading; }

    KpiTabView *tabView() const { return m_tabView; }
    QWidget *picLoad() const { return m_picLoad; }
    QLabel *lblLoad() const { return m_lblLoad; }
    // What the graph's bars and the highlighted cells stand for.
    QLabel *lblLegend() const { return m_lblLegend; }
    QWidget *shpProgress() const { return m_shpProgress; }
    QPushButton *tabButton(int tab) const;

    static constexpr int MinimumHeightTwips = 7875;

Q_SIGNALS:
    // Every earlier period is loaded and the first tab shows.
    void loaded();

public Q_SLOTS:
    void done(int result) override;

protected:
    void resizeEvent(QResizeEvent *event) override;

private:
    void loadPeriods();
    void layoutLoadingPanel();

    AppContext &m_context;
    const ComparisonRanges::Kind m_kind;
    const int m_count;
    int m_currentTab = 0;
    bool m_loading = true;
    bool m_unloaded = false;

    QTimer *m_tmrStart;
    KpiTabView *m_tabView;
    TabButtons *m_tabButtons;
    QWidget *m_picLoad;
    QLabel *m_lblLoad;
    QLabel *m_lblLegend;
    QWidget *m_picProgress;
    QWidget *m_shpProgress;
};
