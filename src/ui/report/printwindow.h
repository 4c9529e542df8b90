// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "report/pagesetup.h"

#include <QDialog>
#include <QPrinter>

#include <functional>
#include <memory>

class AppContext;
class QCheckBox;
class QLineEdit;
class QPushButton;
class QTextBrowser;

// frmPrint: shows a report page and prints it, sets up the page or previews it. While the
// window is open the report's page set-up (margins, shrink to fit) replaces the user's own;
// closing it puts the user's values back.
class PrintWindow : public QDialog
{
    Q_OBJECT

public:
    // Asks about the printer before printing, setting up the page or previewing; true goes on.
    // The platform's dialogs by default; tests put their own answers here.
    using PrinterQuestion = std::function<bool(QPrinter &printer, QWidget *parent)>;

    PrintWindow(AppContext &context, QWidget *owner);
    ~PrintWindow() override;

    // Shows the page modally over the owner with the title as header text, until closed.
    static void loadPage(AppContext &context, QWidget *owner, const QString &pagePath,
                         const QString &title);
    void showPage(const QString &pagePath, const QString &title);

    void print();
    void pageSetup();
    void printPreview();

    void setPrintQuestion(PrinterQuestion question) { m_askPrint = std::move(question); }
    void setPageSetupQuestion(PrinterQuestion question) { m_askPageSetup = std::move(question); }
    void setPreviewQuestion(PrinterQuestion question) { m_askPreview = std::move(question); }

    QCheckBox *chkFormatting() const { return m_chkFormatting; }
    QCheckBox *chkDate() const { return m_chkDate; }
    QCheckBox *chkPages() const { return m_chkPages; }
    QLineEdit *txtHeader() const { return m_txtHeader; }
    QTextBrowser *ieFrame() const { return m_ieFrame; }
    QPushButton *butPrint() const { return m_butPrint; }
    QPrinter &printer() { return m_printer; }

    // Renders the page onto a printer or PDF device with the current page set-up values.
    int renderTo(QPagedPaintDevice &device) const;

public Q_SLOTS:
    void done(int result) override;

private:
    void applyPageOptions();
    void unload();

    AppContext &m_context;
    std::unique_ptr<PageSetupSession> m_pageSetup;
    QString m_pagePath;
    QString m_html;
    QPrinter m_printer;
    PrinterQuestion m_askPrint;
    PrinterQuestion m_askPageSetup;
    PrinterQuestion m_askPreview;
    bool m_unloaded = false;

    QCheckBox *m_chkFormatting;
    QCheckBox *m_chkDate;
    QCheckBox *m_chkPages;
    QLineEdit *m_txtHeader;
    QTextBrowser *m_ieFrame;
    QPushButton *m_butPrint;
};
