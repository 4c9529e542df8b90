// Veltrix — KPI dashboard for small businesses.
#include "printwindow.h"

#include "app/appcontext.h"
#include "app/widgetplacement.h"
#include "common/fileoperations.h"
#include "common/numberformat.h"
#include "common/settingsstore.h"
#include "report/reportrenderer.h"

#include <QCheckBox>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPageSetupDialog>
#include <QPrintDialog>
#include <QPrintPreviewDialog>
#include <QPushButton>
#include <QTextBrowser>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

namespace {

bool askWithPrintDialog(QPrinter &printer, QWidget *parent)
{
    QPrintDialog dialog(&printer, parent);
    return dialog.exec() == QDialog::Accepted;
}

bool askWithPageSetupDialog(QPrinter &printer, QWidget *parent)
{
    QPageSetupDialog dialog(&printer, parent);
    return dialog.exec() == QDialog::Accepted;
}

} // namespace

PrintWindow::PrintWindow(AppContext &context, QWidget *owner)
    : QDialog(owner)
    , m_context(context)
    , m_printer(QPrinter::HighResolution)
    , m_askPrint(askWithPrintDialog)
    , m_askPageSetup(askWithPageSetupDialog)
    , m_chkFormatting(new QCheckBox(u"Retain colours and formatting"_s, this))
    , m_chkDate(new QCheckBox(u"Today's Date (top right)"_s, this))
    , m_chkPages(new QCheckBox(u"Page Numbers (bottom right)"_s, this))
    , m_txtHeader(new QLineEdit(this))
    , m_ieFrame(new QTextBrowser(this))
    , m_butPrint(new QPushButton(u"Print"_s, this))
{
    setObjectName(u"frmPrint"_s);
    setWindowTitle(u"Page Preview"_s);
    m_chkFormatting->setObjectName(u"chkFormatting"_s);
    m_chkDate->setObjectName(u"chkDate"_s);
    m_chkPages->setObjectName(u"chkPages"_s);
    m_txtHeader->setObjectName(u"txtHeader"_s);
    m_ieFrame->setObjectName(u"IEFrame"_s);
    m_ieFrame->setOpenLinks(false);
    for (QCheckBox *box : {m_chkFormatting, m_chkDate, m_chkPages})
        box->setChecked(true);

    auto *butSetup = new QPushButton(u"Page &Setup"_s, this);
    auto *butPreview = new QPushButton(u"Print Preview"_s, this);
    auto *butClose = new QPushButton(u"Close"_s, this);
    m_butPrint->setObjectName(u"butPrint"_s);
    butSetup->setObjectName(u"butSetup"_s);
    butPreview->setObjectName(u"butPreview"_s);
    butClose->setObjectName(u"butClose"_s);
    for (QPushButton *button : {m_butPrint, butSetup, butPreview}) {
        button->setToolTip(u"Prints the above grid"_s);
        button->setAutoDefault(false);
    }
    butClose->setAutoDefault(false);

    auto *options = new QHBoxLayout;
    options->addWidget(m_chkFormatting);
    options->addWidget(m_chkDate);
    options->addWidget(m_chkPages);
    options->addStretch();
    auto *header = new QHBoxLayout;
    auto *lblTitle = new QLabel(u"Header Text"_s, this);
    lblTitle->setObjectName(u"lblTitle"_s);
    header->addWidget(lblTitle);
    header->addWidget(m_txtHeader, 1);
    auto *buttons = new QHBoxLayout;
    buttons->addWidget(m_butPrint);
    buttons->addWidget(butSetup);
    buttons->addWidget(butPreview);
    buttons->addStretch();
    buttons->addWidget(butClose);
    auto *layout = new QVBoxLayout(this);
    layout->addLayout(options);
    layout->addLayout(header);
    layout->addWidget(m_ieFrame, 1);
    layout->addLayout(buttons);

    connect(m_butPrint, &QPushButton::clicked, this, &PrintWindow::print);
    connect(butSetup, &QPushButton::clicked, this, &PrintWindow::pageSetup);
    connect(butPreview, &QPushButton::clicked, this, &PrintWindow::printPreview);
    connect(butClose, &QPushButton::clicked, this, &QDialog::accept);

    m_askPreview = [this](QPrinter &printer, QWidget *parent) {
        QPrintPreviewDialog preview(&printer, parent);
        connect(&preview, &QPrintPreviewDialog::paintRequested, this,
                [this](QPrinter *target) { renderTo(*target); });
        preview.exec();
        return false;
    };

    resize(800, 600);
    WidgetPlacement::restoreWindowPlacement(*this, m_context.settingsStore(), true);
    m_pageSetup = std::make_unique<PageSetupSession>(m_context.settingsStore());
}

PrintWindow::~PrintWindow()
{
    unload();
}

void PrintWindow::loadPage(AppContext &context, QWidget *owner, const QString &pagePath,
                           const QString &title)
{
    PrintWindow window(context, owner);
    window.showPage(pagePath, title);
    window.exec();
}

void PrintWindow::showPage(const QString &pagePath, const QString &title)
{
    m_pagePath = pagePath;
    m_html = FileOperations::readTextFile(pagePath);
    m_ieFrame->document()->setBaseUrl(
        QUrl::fromLocalFile(QFileInfo(pagePath).absolutePath() + u'/'));
    m_ieFrame->setHtml(ReportRenderer::printableHtml(m_html));
    ReportRenderer::showPicturesAtTheirSize(*m_ieFrame->document());
    m_txtHeader->setText(title);
}

void PrintWindow::applyPageOptions()
{
    m_pageSetup->applyPageOptions(m_chkFormatting->isChecked(), m_chkDate->isChecked(),
                                  m_chkPages->isChecked(), m_txtHeader->text());
}

int PrintWindow::renderTo(QPagedPaintDevice &device) const
{
    const PrintOptions options = PrintOptions::fromStore(
        m_context.settingsStore(), m_context.numberFormat().locale(), windowTitle());
    return ReportRenderer(m_html, QFileInfo(m_pagePath).absolutePath()).print(device, options);
}

void PrintWindow::print()
{
    applyPageOptions();
    if (m_askPrint(m_printer, this))
        renderTo(m_printer);
}

void PrintWindow::pageSetup()
{
    applyPageOptions();
    // The dialog shows the margins the report is printed with, and what is chosen there is
    // what the next print uses.
    const PrintOptions current = PrintOptions::fromStore(m_context.settingsStore());
    m_printer.setPageMargins(QMarginsF(current.marginLeftInches, current.marginTopInches,
                                       current.marginRightInches, current.marginBottomInches),
                             QPageLayout::Inch);
    if (!m_askPageSetup(m_printer, this))
        return;
    const QMarginsF chosen = m_printer.pageLayout().margins(QPageLayout::Inch);
    m_pageSetup->setMargins(chosen.top(), chosen.left(), chosen.right(), chosen.bottom());
}

void PrintWindow::printPreview()
{
    applyPageOptions();
    if (m_askPreview(m_printer, this))
        renderTo(m_printer);
}

void PrintWindow::done(int result)
{
    unload();
    QDialog::done(result);
}

void PrintWindow::unload()
{
    if (m_unloaded)
        return;
    m_unloaded = true;
    m_pageSetup->restore();
    WidgetPlacement::saveWindowPlacement(*this, m_context.settingsStore());
}
