// Veltrix — KPI dashboard for small businesses.
#include "sourcefactory.h"

#include "moneyworkssource.h"
#include "myobsource.h"
#include "restmoneyworkslink.h"

#include "common/settings.h"

using namespace Qt::StringLiterals;

std::unique_ptr<AccountingSource>
createAccountingSource(const Settings &settings, Prompter &prompter, const NumberFormat &numbers)
{
    if (settings.accPackage == u"MYOB"_s)
        return std::make_unique<MyobSource>(settings, prompter);
    if (settings.accPackage == u"MoneyWorks"_s) {
        return std::make_unique<MoneyWorksSource>(settings, prompter, numbers, [&settings] {
            return std::make_unique<RestMoneyWorksLink>(settings.accFileUser, settings.accFilePass,
                                                        settings.moneyWorksTimeoutSeconds);
        });
    }
    return nullptr;
}
