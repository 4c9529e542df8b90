// Veltrix — KPI dashboard for small businesses.
#include "sourcefactory.h"

#include "myobsource.h"

#include "app/settings.h"

using namespace Qt::StringLiterals;

std::unique_ptr<AccountingSource> createAccountingSource(const Settings &settings,
                                                         Prompter &prompter)
{
    if (settings.accPackage == u"MYOB"_s)
        return std::make_unique<MyobSource>(settings, prompter);
    return nullptr;
}
