// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class Prompter;

// The program's one way of telling the user that an operation failed: a message box titled
// with what was being done and the error number.
class ErrorReporter
{
public:
    // The database layer's general failure, almost always a lost network share or server.
    static constexpr qint32 CommunicationFailure = -2147467259;

    explicit ErrorReporter(Prompter &prompter)
        : m_prompter(prompter)
    {}

    // Number 0 means no error and shows nothing.
    void reportError(qint32 number, const QString &description, const QString &context) const;

private:
    Prompter &m_prompter;
};
