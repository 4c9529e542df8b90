// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "setup/hourlyrates.h"

#include <QDialog>

class AppContext;
class CellEditor;
class GridView;
class QPushButton;

// frmSetupHours: the hourly rate of each department, edited in place.
class HourlyRatesDialog : public QDialog
{
    Q_OBJECT

public:
    HourlyRatesDialog(AppContext &context, QWidget *owner = nullptr);

    static void showModal(AppContext &context, QWidget *owner);

    HourlyRates &rates() { return m_rates; }
    GridView *lstRates() const { return m_lstRates; }
    CellEditor *txtEdit() const { return m_txtEdit; }
    QPushButton *butOK() const { return m_butOK; }
    QPushButton *butCancel() const { return m_butCancel; }

    // OK: writes the rates and closes; a failed save keeps the window open.
    void accept() override;

private:
    HourlyRates m_rates;
    GridView *m_lstRates;
    CellEditor *m_txtEdit;
    QPushButton *m_butOK;
    QPushButton *m_butCancel;
};
