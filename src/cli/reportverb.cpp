// Veltrix — KPI dashboard for small businesses.
#include "reportverb.h"

#include "headlesssession.h"

#include "app/appcontext.h"
#include "common/fileoperations.h"
#include "common/settingsstore.h"
#include "report/gridhtml.h"
#include "report/gridreport.h"
#include "report/pagesetup.h"
#include "report/reportrenderer.h"
#include "views/comparewindow.h"
#include "views/kpitabview.h"
#include "views/tabviewbuilder.h"

#include <QCommandLineParser>
#include <QEventLoop>
#include <QFileInfo>
#include <QPdfWriter>
#include <QTextStream>

#include <memory>

using namespace Qt::StringLiterals;

namespace ReportVerb {

namespace {

int usageError(const QString &problem)
{
    QTextStream err(stderr);
    err << "veltrix-cli report: " << problem << "\n"
        << "usage: veltrix-cli report --from YYYY-MM --to YYYY-MM --user NAME --password PW\n"
        << "       [--settings FILE] [--tab N] [--compare years|periods --count N]\n"
        << "       --out FILE.html|FILE.pdf" << Qt::endl;
    return 2;
}

// The view the window would show: the main window's tab, or the comparison window's once
// every earlier period is loaded.
class ReportView
{
public:
    ReportView(AppContext &context, const HeadlessSession::Options &options, int tab)
    {
        if (options.compareKind) {
            m_compare = std::make_unique<CompareWindow>(context, *options.compareKind,
                                                        options.compareCount);
            m_compare->resize(1100, 800);
            QEventLoop loop;
            QObject::connect(m_compare.get(), &CompareWindow::loaded, &loop, &QEventLoop::quit);
            m_compare->show();
            loop.exec();
            m_compare->selectTab(tab);
            m_view = m_compare->tabView();
        } else {
            m_main = std::make_unique<KpiTabView>(context);
            m_main->resize(1100, 800);
            m_main->show();
            m_main->showTab(tab);
            m_view = m_main.get();
        }
    }

    KpiTabView &view() { return *m_view; }

private:
    std::unique_ptr<CompareWindow> m_compare;
    std::unique_ptr<KpiTabView> m_main;
    KpiTabView *m_view = nullptr;
};

int writePdf(AppContext &context, const KpiTabView &view, const QString &picture,
             const QString &out)
{
    // The same page set-up the print window applies with its boxes ticked, put back after.
    const QString title = GridReport::pageTitle(context, view);
    const GridModel &grid = view.grid();
    PageSetupSession pageSetup(context.settingsStore());
    pageSetup.applyPageOptions(true, true, true, title);
    const PrintOptions options = PrintOptions::fromStore(
        context.settingsStore(), context.numberFormat().locale(), u"Page Preview"_s);
    QPdfWriter writer(out);
    writer.setTitle(title);
    writer.setCreator(u"Veltrix"_s);
    const QString html = GridHtml::reportPage(grid, u"id"_s, picture);
    if (ReportRenderer(html, context.settings().tempFolder).print(writer, options) == 0) {
        QTextStream(stderr) << "veltrix-cli report: could not write " << out << Qt::endl;
        return 1;
    }
    return 0;
}

int writeHtml(AppContext &context, const GridModel &grid, const QString &picture,
              const QString &out)
{
    // The page names its picture by path; it goes beside the page, not in the temporary folder
    // that is cleared when the program ends.
    QString keptPicture;
    if (!picture.isEmpty()) {
        const QFileInfo target(out);
        keptPicture = target.absolutePath() + u'/' + target.completeBaseName() + u".bmp"_s;
        if (!FileOperations::copyFile(picture, keptPicture, true)) {
            QTextStream(stderr) << "veltrix-cli report: could not write " << keptPicture
                                << Qt::endl;
            return 1;
        }
    }
    if (!FileOperations::writeTextFile(out, GridHtml::reportPage(grid, u"id"_s, keptPicture),
                                       context.prompter()))
        return 1;
    return 0;
}

} // namespace

int report(const QStringList &arguments)
{
    QCommandLineParser parser;
    HeadlessSession::addOptions(parser);
    parser.addOptions({{u"tab"_s, u"tab 0 to 6 (1 is the Summary with the graph)"_s, u"N"_s,
                        QString::number(TabViewBuilder::SummaryTab)},
                       {u"out"_s, u"report file"_s, u"FILE.html|FILE.pdf"_s}});
    if (!parser.parse(QStringList{u"veltrix-cli report"_s} + arguments))
        return usageError(parser.errorText());
    const auto read = HeadlessSession::readOptions(parser);
    if (const QString *problem = std::get_if<QString>(&read))
        return usageError(*problem);
    const auto &options = std::get<HeadlessSession::Options>(read);
    bool tabOk = false;
    const int tab = parser.value(u"tab"_s).toInt(&tabOk);
    if (!tabOk || tab < 0 || tab >= TabViewBuilder::TabCount)
        return usageError(u"--tab is a number from 0 to 6"_s);
    const QString out = parser.value(u"out"_s);
    const QString suffix = QFileInfo(out).suffix().toLower();
    if (out.isEmpty() || (suffix != u"html"_s && suffix != u"htm"_s && suffix != u"pdf"_s))
        return usageError(u"--out names a .html or .pdf file"_s);

    HeadlessSession::Session session;
    if (const int failed = session.open(options))
        return failed;
    AppContext &context = session.context();
    ReportView report(context, options, tab);
    KpiTabView &view = report.view();

    if (session.figuresIncomplete(u"report"_s))
        return HeadlessSession::IncompleteFigures;
    const QString picture = GridReport::graphPicture(context, view);
    if (suffix == u"pdf"_s)
        return writePdf(context, view, picture, out);
    return writeHtml(context, view.grid(), picture, out);
}

} // namespace ReportVerb
