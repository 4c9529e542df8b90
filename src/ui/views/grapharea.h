// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QList>
#include <QWidget>

class BarGraphItem;
class NumberFormat;
class QLabel;

// The bar graph of the Summary tab: a scale from 10 to 100 and one bar per percentage Field,
// standing on the base line, with its variant written above it.
class GraphArea : public QWidget
{
    Q_OBJECT

public:
    struct BarSpec
    {
        qint64 fieldId = 0;
        QString benchmark;
        double value = 0.0;
    };

    explicit GraphArea(const NumberFormat &numbers, QWidget *parent = nullptr);

    // Replaces the bars. In a comparison of periods (the produced one and the earlier ones)
    // the bars of one Field touch, carry no labels and share the graph's width.
    void setBars(const QList<BarSpec> &bars, bool compare, int periods = 1);
    const QList<BarGraphItem *> &bars() const { return m_bars; }
    const QList<QLabel *> &variantLabels() const { return m_labels; }

    QSize sizeHint() const override;

    // The scale's numbers stand in a margin left of the bars.
    static constexpr int ScaleMargin = 30;

Q_SIGNALS:
    void barFocused(qint64 fieldId);

protected:
    void paintEvent(QPaintEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;

private:
    void layoutCompareBars();
    int scaleRight() const;

    int toPixelsX(int twips) const;
    int toPixelsY(int twips) const;

    const NumberFormat &m_numbers;
    QList<BarGraphItem *> m_bars;
    QList<QLabel *> m_labels;
    bool m_compare = false;
    int m_periods = 1;
};
