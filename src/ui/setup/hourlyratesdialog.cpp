// Veltrix — KPI dashboard for small businesses.
#include "hourlyratesdialog.h"

#include "celleditor.h"

#include "app/appcontext.h"
#include "views/gridview.h"

#include <QHBoxLayout>
#include <QPushButton>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

HourlyRatesDialog::HourlyRatesDialog(AppContext &context, QWidget *owner)
    : QDialog(owner)
    , m_rates(context.mainDatabase(), context.prompter(), context.numberFormat())
    , m_lstRates(new GridView(m_rates.grid(), this))
    , m_txtEdit(new CellEditor(this))
    , m_butOK(new QPushButton(u"OK"_s, this))
    , m_butCancel(new QPushButton(u"Cancel"_s, this))
{
    setObjectName(u"frmSetupHours"_s);
    setWindowTitle(u"Hourly Rates"_s);
    m_lstRates->setObjectName(u"lstRates"_s);
    m_lstRates->setCellEditing(true);
    m_lstRates->setFittedColumn(2); // the department
    m_butOK->setObjectName(u"butOK"_s);
    m_butCancel->setObjectName(u"butCancel"_s);
    // Enter belongs to the edit box, not to a default button.
    m_butOK->setAutoDefault(false);
    m_butCancel->setAutoDefault(false);

    auto *buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(m_butOK);
    buttons->addWidget(m_butCancel);
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(m_lstRates, 1);
    layout->addLayout(buttons);
    resize(420, 320);

    m_rates.load();
    m_lstRates->applyLayout();

    connect(m_lstRates, &GridView::editRequested, this, [this](int row, int, QChar key) {
        m_txtEdit->openCell(m_lstRates, row, HourlyRates::RateColumn, key);
    });
    connect(m_txtEdit, &CellEditor::finished, this,
            [this](GridView *, int row, const QString &text) { m_rates.commitEdit(row, text); });
    connect(m_butOK, &QPushButton::clicked, this, &HourlyRatesDialog::accept);
    connect(m_butCancel, &QPushButton::clicked, this, &QDialog::reject);
}

void HourlyRatesDialog::showModal(AppContext &context, QWidget *owner)
{
    HourlyRatesDialog dialog(context, owner);
    dialog.exec();
}

void HourlyRatesDialog::accept()
{
    // An edit still open counts, as leaving the box would.
    m_txtEdit->commit();
    if (m_rates.save())
        QDialog::accept();
}
