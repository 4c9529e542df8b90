// Veltrix — KPI dashboard for small businesses.
#include "moneyworkssource.h"

#include "shortdate.h"

#include "common/errorreporter.h"
#include "common/fileoperations.h"
#include "common/numberformat.h"

using namespace Qt::StringLiterals;

namespace {
constexpr int MaxJobs = 32767;
}

MoneyWorksSource::MoneyWorksSource(const Settings &settings, Prompter &prompter,
                                   const NumberFormat &numbers, LinkFactory makeLink)
    : m_settings(settings)
    , m_prompter(prompter)
    , m_numbers(numbers)
    , m_makeLink(std::move(makeLink))
{}

MoneyWorksSource::~MoneyWorksSource() = default;

MoneyWorksLink &MoneyWorksSource::link()
{
    if (!m_link)
        m_link = m_makeLink();
    return *m_link;
}

bool MoneyWorksSource::isReachable()
{
    const MoneyWorksLink::Answer answer = link().evaluate(u"DocumentPath"_s);
    return !answer.error && !answer.text.isEmpty();
}

std::optional<DbError> MoneyWorksSource::openDataFile()
{
    m_link = m_makeLink();
    return m_link->openDocument(m_settings.accFilePath);
}

void MoneyWorksSource::disconnect()
{
    m_link.reset();
}

QString MoneyWorksSource::movementExpression(const QString &accountCode, const QDate &from,
                                             const QDate &to) const
{
    const QLocale &locale = m_numbers.locale();
    return u"GetMovement(`accountcode = \\\""_s + accountCode + u"\\\"`, '"_s +
           ShortDate::format(from, locale) + u" ', '"_s + ShortDate::format(to, locale) + u"')"_s;
}

QString MoneyWorksSource::jobsSearch(const QDate &from, const QDate &to) const
{
    const QLocale &locale = m_numbers.locale();
    return u"type = `DI@` and transdate >= '"_s + ShortDate::format(from, locale) +
           u"' and transdate <= '"_s + ShortDate::format(to, locale) + u"'"_s;
}

double MoneyWorksSource::accountMovement(const QString &accountCode, const QDate &from,
                                         const QDate &to)
{
    const MoneyWorksLink::Answer answer =
        link().evaluate(movementExpression(accountCode, from, to));
    if (answer.error) {
        ErrorReporter(m_prompter)
            .reportError(answer.error->number, answer.error->description, u"GetMWValue"_s);
        return 0.0;
    }
    const QString text = answer.text.trimmed();
    if (const std::optional<double> value = m_numbers.parseNumber(text))
        return *value;
    // MoneyWorks answers an expression it cannot evaluate with its error text: that is a 0,
    // not a failure. Any other answer is not what an evaluation gives, so it is no figure.
    if (!text.startsWith(u"[ERROR]"_s)) {
        ErrorReporter(m_prompter)
            .reportError(MoneyWorksLink::UnexpectedAnswerError,
                         u"MoneyWorks answered something that is not a number: "_s + text.left(80),
                         u"GetMWValue"_s);
    }
    return 0.0;
}

qint16 MoneyWorksSource::jobsCount(const QDate &from, const QDate &to)
{
    std::optional<DbError> error =
        link().exportRecords(u"Transaction.TransDate"_s, jobsSearch(from, to), jobsFile());
    int jobs = 0;
    if (!error) {
        jobs = countJobReferences(FileOperations::readTextFile(jobsFile()));
        if (jobs > MaxJobs)
            error = DbError{6, u"Overflow: more than %1 jobs in the range."_s.arg(MaxJobs)};
    }
    if (error) {
        ErrorReporter(m_prompter).reportError(error->number, error->description, u"GetMWJobs"_s);
        return 0;
    }
    return qint16(jobs);
}

std::optional<QDate> MoneyWorksSource::currentPeriodEnd()
{
    const MoneyWorksLink::Answer answer = link().evaluate(u"periodtodate(currentperiod())"_s);
    if (answer.error)
        return QDate();
    return ShortDate::parse(answer.text, m_numbers.locale());
}

int MoneyWorksSource::countJobReferences(const QString &exportText)
{
    const QStringList lines = exportText.split(u"\r\n"_s);
    if (lines.isEmpty())
        return 0;
    int referenceColumn = 0;
    int accountColumn = 0;
    const QStringList names = lines.first().split(u'\t');
    for (int i = 0; i < names.size(); ++i) {
        const QString name = names[i].toLower();
        if (name == u"theirref"_s)
            referenceColumn = i;
        else if (name == u"u.detail.account"_s)
            accountColumn = i;
    }
    QStringList references;
    for (qsizetype n = 1; n < lines.size(); ++n) {
        const QStringList cells = lines[n].split(u'\t');
        if (cells.size() <= referenceColumn)
            continue;
        const QString &reference = cells[referenceColumn];
        if (reference.trimmed().isEmpty())
            continue;
        if (cells.size() > accountColumn && cells[accountColumn].toUpper() == u"EI"_s)
            continue;
        if (!references.contains(reference))
            references << reference;
    }
    return int(references.size());
}
