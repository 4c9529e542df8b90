// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QList>
#include <QWidget>

class BarGraphItem;
class NumberFormat;
class QLabel;

// The bar graph of the Summary tab: a scale from 10 to 100 and one bar per percentage Field
// (per Field and period in a comparison) spread over the whole width, standing on the base
// line with its variant written above it and the Field's row number below.
class GraphArea : public QWidget
{
    Q_OBJECT

public:
    struct BarSpec
    {
        qint64 fieldId = 0;
        QString benchmark;
        double value = 0.0;
        QString name;   // below the bars: the Field's row number
        QString label;  // the Field's label, in the tip
        QString period; // in a comparison, the period the bar shows
    };

    explicit GraphArea(const NumberFormat &numbers, QWidget *parent = nullptr);

    // Replaces the bars. In a comparison of periods (the produced one and the earlier ones)
    // the bars of one Field touch, carry no labels and share the graph's width.
    void setBars(const QList<BarSpec> &bars, bool compare);
    const QList<BarGraphItem *> &bars() const { return m_bars; }
    const QList<QLabel *> &variantLabels() const { return m_labels; }
    const QList<QLabel *> &nameLabels() const { return m_names; }

    QSize sizeHint() const override;

    // The scale's numbers stand in a margin left of the bars.
    static constexpr int ScaleMargin = 30;

Q_SIGNALS:
    void barFocused(qint64 fieldId);

protected:
    void paintEvent(QPaintEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;

private:
    void layoutBars();
    int scaleRight() const;

    int toPixelsX(int twips) const;
    int toPixelsY(int twips) const;

    const NumberFormat &m_numbers;
    QList<BarGraphItem *> m_bars;
    QList<QLabel *> m_labels;
    QList<QLabel *> m_names;
    bool m_compare = false;
};
