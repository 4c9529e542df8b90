// Veltrix — KPI dashboard for small businesses.
#include "pagesetup.h"

#include "common/settingsstore.h"

using namespace Qt::StringLiterals;

namespace {

const QString MarginTop = u"margin_top"_s;
const QString MarginLeft = u"margin_left"_s;
const QString MarginRight = u"margin_right"_s;
const QString MarginBottom = u"margin_bottom"_s;
const QString Header = u"header"_s;
const QString Footer = u"footer"_s;
const QString PrintBackground = u"Print_Background"_s;
const QString ShrinkToFit = u"Shrink_To_Fit"_s;

double inches(const SettingsStore &store, const QString &name, double fallback)
{
    bool ok = false;
    const double value = store.readSetting(name, PageSetupSession::Key).toDouble(&ok);
    return ok && value >= 0.0 && value < 10.0 ? value : fallback;
}

} // namespace

const QStringList &PageSetupSession::valueNames()
{
    // The bottom margin is kept too: the page set-up dialog may change it while the window
    // is open, and the user's own value must come back afterwards all the same.
    static const QStringList names = {MarginTop, MarginLeft, MarginRight,     MarginBottom,
                                      Header,    Footer,     PrintBackground, ShrinkToFit};
    return names;
}

PageSetupSession::PageSetupSession(SettingsStore &store)
    : m_store(store)
{
    for (const QString &name : valueNames())
        m_kept << m_store.readSetting(name, Key);
    m_store.writeSetting(MarginTop, u"0.5"_s, Key);
    m_store.writeSetting(MarginLeft, u"0.4"_s, Key);
    m_store.writeSetting(MarginRight, u"0.4"_s, Key);
    m_store.writeSetting(ShrinkToFit, u"yes"_s, Key);
}

PageSetupSession::~PageSetupSession()
{
    restore();
}

void PageSetupSession::applyPageOptions(bool retainFormatting, bool todaysDate, bool pageNumbers,
                                        const QString &headerText)
{
    m_store.writeSetting(PrintBackground, retainFormatting ? u"yes"_s : u"no"_s, Key);
    m_store.writeSetting(Header, todaysDate ? headerText + u"&b&d"_s : headerText, Key);
    m_store.writeSetting(Footer, pageNumbers ? u"&bPage &p of &P"_s : QString(), Key);
}

void PageSetupSession::setMargins(double top, double left, double right, double bottom)
{
    const auto text = [](double inches) { return QString::number(inches, 'g', 4); };
    m_store.writeSetting(MarginTop, text(top), Key);
    m_store.writeSetting(MarginLeft, text(left), Key);
    m_store.writeSetting(MarginRight, text(right), Key);
    m_store.writeSetting(MarginBottom, text(bottom), Key);
}

void PageSetupSession::restore()
{
    if (m_restored)
        return;
    m_restored = true;
    for (int i = 0; i < valueNames().size(); ++i)
        m_store.writeSetting(valueNames().at(i), m_kept.at(i), Key);
}

QString PageSetupSession::keptValue(const QString &valueName) const
{
    const qsizetype index = valueNames().indexOf(valueName);
    return index < 0 ? QString() : m_kept.at(index);
}

PrintOptions PrintOptions::fromStore(const SettingsStore &store, const QLocale &locale,
                                     const QString &windowTitle)
{
    PrintOptions options;
    options.locale = locale;
    options.windowTitle = windowTitle;
    options.marginTopInches = inches(store, MarginTop, options.marginTopInches);
    options.marginBottomInches = inches(store, MarginBottom, options.marginBottomInches);
    options.marginLeftInches = inches(store, MarginLeft, options.marginLeftInches);
    options.marginRightInches = inches(store, MarginRight, options.marginRightInches);
    options.shrinkToFit = store.readSetting(ShrinkToFit, PageSetupSession::Key)
                              .compare(u"no"_s, Qt::CaseInsensitive) != 0;
    options.printBackground = store.readSetting(PrintBackground, PageSetupSession::Key)
                                  .compare(u"yes"_s, Qt::CaseInsensitive) == 0;
    options.header = store.readSetting(Header, PageSetupSession::Key);
    options.footer = store.readSetting(Footer, PageSetupSession::Key);
    return options;
}
