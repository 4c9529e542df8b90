// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "views/barlayout.h"

#include <QWidget>

class NumberFormat;

// One bar of the KPI graph: a percentage Field in one period, judged against its benchmark and
// drawn green, yellow or red, as tall as the larger of value and optimal, with the span
// between them marked at the top and a line at the optimal level.
class BarGraphItem : public QWidget
{
    Q_OBJECT

public:
    BarGraphItem(const NumberFormat &numbers, QWidget *parent = nullptr);

    bool autoWidth() const { return m_autoWidth; }
    void setAutoWidth(bool on);
    QString optimalString() const { return m_optimalString; }
    // Set the benchmark and the tag first: the value is judged against the benchmark set at
    // the time, and a figure of the wrong sign for the Field in the tag is red.
    void setOptimalString(const QString &benchmark) { m_optimalString = benchmark; }
    double actualValue() const { return m_actual; }
    void setActualValue(double value);
    quint8 optimalType() const { return m_bar.evaluation.optimalType; }
    double optimalValue() const { return m_bar.evaluation.optimal; }
    double variantValue() const { return m_bar.evaluation.variant; }
    quint8 band() const { return m_bar.evaluation.band; }
    const BarLayout::Bar &layout() const { return m_bar; }
    qint64 tag() const { return m_tag; }
    void setTag(qint64 fieldId) { m_tag = fieldId; }

    static double twipsPerPixelY(const QWidget *widget);
    static double twipsPerPixelX(const QWidget *widget);

Q_SIGNALS:
    void focused(qint64 fieldId);

protected:
    void paintEvent(QPaintEvent *event) override;
    void focusInEvent(QFocusEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;

private:
    const NumberFormat &m_numbers;
    bool m_autoWidth = true;
    QString m_optimalString;
    double m_actual = 0.0;
    qint64 m_tag = 0;
    BarLayout::Bar m_bar;
};
