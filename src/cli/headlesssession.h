// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "views/comparisonranges.h"

#include <QDate>
#include <QString>

#include <memory>
#include <optional>
#include <variant>

class AppContext;
class ConsolePrompter;
class QCommandLineParser;

// What the verbs that produce a range share: the options naming the range, the user and the
// settings, and a session that starts up, logs in and produces as the main window would.
namespace HeadlessSession {

struct Options
{
    QDate from; // first day of the first month
    QDate to;   // first day of the last month
    QString user;
    QString password;
    QString settingsFile; // empty: the user's own settings
    std::optional<ComparisonRanges::Kind> compareKind;
    int compareCount = 0;
    bool rememberRange = false; // write the range to the settings, as the window does
};

// Exit codes of the verbs that produce.
enum ExitCode { Success = 0, Refused = 2, IncompleteFigures = 3 };

// The environment variable a script may hand the login password in.
inline constexpr char PasswordVariable[] = "VELTRIX_PASSWORD";

void addOptions(QCommandLineParser &parser);
// The options, or what is wrong with them.
std::variant<Options, QString> readOptions(const QCommandLineParser &parser);

class Session
{
public:
    Session();
    ~Session();
    Session(const Session &) = delete;
    Session &operator=(const Session &) = delete;

    // Starts up, logs in and produces slot 0; 0 on success, else the exit code (the reason
    // has been written to standard error).
    int open(const Options &options);
    // Loads the earlier periods of the options' comparison into slots 1 to N.
    void loadComparison(const Options &options);
    // Whether the accounting package reported a problem since the login: the figures are not
    // complete. Says so on standard error.
    bool figuresIncomplete(const QString &verb) const;

    AppContext &context() { return *m_context; }

private:
    std::unique_ptr<ConsolePrompter> m_prompter;
    std::unique_ptr<AppContext> m_context;
    bool m_connected = false;
    int m_problemsBeforeProduce = 0;
};

} // namespace HeadlessSession
