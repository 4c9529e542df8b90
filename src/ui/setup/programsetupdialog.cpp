// Veltrix — KPI dashboard for small businesses.
#include "programsetupdialog.h"

#include "celleditor.h"

#include "app/appcontext.h"
#include "views/gridview.h"

#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

ProgramSetupDialog::ProgramSetupDialog(AppContext &context, QWidget *owner)
    : QDialog(owner)
    , m_setup(context.mainDatabase(), context.prompter())
    , m_lists{new GridView(m_setup.grid(ProgramSetup::Mapping), this),
              new GridView(m_setup.grid(ProgramSetup::Benchmarks), this)}
    , m_txtEdit(new CellEditor(this))
    , m_butOK(new QPushButton(u"OK"_s, this))
    , m_butCancel(new QPushButton(u"Cancel"_s, this))
{
    setObjectName(u"frmSetup"_s);
    setWindowTitle(u"Program Setup"_s);
    lstA()->setObjectName(u"lstA"_s);
    lstB()->setObjectName(u"lstB"_s);
    m_butOK->setObjectName(u"butOK"_s);
    m_butCancel->setObjectName(u"butCancel"_s);
    m_butOK->setAutoDefault(false);
    m_butCancel->setAutoDefault(false);

    auto *lists = new QGridLayout;
    lists->addWidget(new QLabel(u"Account Code Mapping"_s, this), 0, 0);
    lists->addWidget(new QLabel(u"Benchmark Percentages"_s, this), 0, 1);
    lists->addWidget(lstA(), 1, 0);
    lists->addWidget(lstB(), 1, 1);
    auto *buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(m_butOK);
    buttons->addWidget(m_butCancel);
    auto *layout = new QVBoxLayout(this);
    layout->addLayout(lists, 1);
    layout->addLayout(buttons);
    resize(760, 520);

    m_setup.load();
    for (GridView *view : m_lists) {
        view->setCellEditing(true);
        view->setFittedColumn(ProgramSetup::LabelColumn);
        view->applyLayout();
        connect(view, &GridView::editRequested, this, [this, view](int row, int, QChar key) {
            // Headings are not edited.
            if (m_setup.isHeading(listOf(view), row))
                return;
            m_txtEdit->openCell(view, row, ProgramSetup::DataColumn, key);
        });
    }
    connect(m_txtEdit, &CellEditor::finished, this,
            [this](GridView *view, int row, const QString &text) {
                m_setup.commitEdit(listOf(view), row, text);
            });
    connect(m_butOK, &QPushButton::clicked, this, &ProgramSetupDialog::accept);
    connect(m_butCancel, &QPushButton::clicked, this, &QDialog::reject);
}

void ProgramSetupDialog::showModal(AppContext &context, QWidget *owner)
{
    ProgramSetupDialog dialog(context, owner);
    dialog.exec();
}

ProgramSetup::List ProgramSetupDialog::listOf(const GridView *view) const
{
    return view == lstB() ? ProgramSetup::Benchmarks : ProgramSetup::Mapping;
}

void ProgramSetupDialog::accept()
{
    m_txtEdit->commit();
    if (m_setup.save())
        QDialog::accept();
}
