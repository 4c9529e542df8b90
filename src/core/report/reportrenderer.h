// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "pagesetup.h"

#include <QDate>
#include <QLocale>
#include <QString>

class QPagedPaintDevice;
class QTextDocument;

// Prints a report page onto any paged device (a printer, a PDF file) the way a browser prints
// a page: inside the page set-up margins, shrunk to the page width when wider, with or without
// background colours, a header at the top and a footer at the bottom.
class ReportRenderer
{
public:
    struct Margins
    {
        QString left;
        QString centre;
        QString right;
    };

    ReportRenderer(const QString &html, const QString &baseFolder);
    ~ReportRenderer();
    ReportRenderer(const ReportRenderer &) = delete;
    ReportRenderer &operator=(const ReportRenderer &) = delete;

    // The number of pages printed, 0 when the device could not be painted on.
    int print(QPagedPaintDevice &device, const PrintOptions &options,
              const QDate &today = QDate::currentDate()) const;

    // A header or footer with its codes expanded: "&b" separates the left, centre and right
    // parts (one "&b" gives left and right), "&d"/"&D" the date in short/long form, "&p" the
    // page, "&P" the pages, "&w" the window title, "&&" an ampersand.
    static Margins expandCodes(const QString &text, int page, int pages, const QDate &today,
                               const QLocale &locale, const QString &windowTitle = {});

    // The page as the renderer lays it out, for tests and previews.
    static QString printableHtml(const QString &html);
    // Pictures stored at a screen's higher density are shown at the size they stand for
    // (a browser would show every pixel of them); the preview does the same. With a width,
    // a wider picture is scaled down to it rather than shrinking the whole page around it.
    static void showPicturesAtTheirSize(QTextDocument &document, double maxWidth = 0.0);

private:
    QString m_html;
    QString m_baseFolder;
};
