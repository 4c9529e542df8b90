// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "setup/programsetup.h"

#include <QDialog>

class AppContext;
class CellEditor;
class GridView;
class QPushButton;

// frmSetup: the accounting codes of the account fields and the benchmarks of the KPI fields,
// edited in place in two lists.
class ProgramSetupDialog : public QDialog
{
    Q_OBJECT

public:
    ProgramSetupDialog(AppContext &context, QWidget *owner = nullptr);

    static void showModal(AppContext &context, QWidget *owner);

    ProgramSetup &setup() { return m_setup; }
    GridView *lstA() const { return m_lists[ProgramSetup::Mapping]; }
    GridView *lstB() const { return m_lists[ProgramSetup::Benchmarks]; }
    CellEditor *txtEdit() const { return m_txtEdit; }
    QPushButton *butOK() const { return m_butOK; }
    QPushButton *butCancel() const { return m_butCancel; }

    // OK: writes both lists and closes; a failed save keeps the window open.
    void accept() override;

private:
    ProgramSetup::List listOf(const GridView *view) const;

    ProgramSetup m_setup;
    GridView *m_lists[2];
    CellEditor *m_txtEdit;
    QPushButton *m_butOK;
    QPushButton *m_butCancel;
};
