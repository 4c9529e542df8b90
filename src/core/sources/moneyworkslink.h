// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/dberror.h"

#include <QString>

#include <optional>

// What the program asks of a running MoneyWorks: evaluate an expression in the open document,
// open a document, export records to a file.
class MoneyWorksLink
{
public:
    struct Answer
    {
        QString text;
        std::optional<DbError> error;
    };

    // An answer longer than any the command gives: reading stops there.
    static constexpr qint32 AnswerTooLargeError = 7;
    // An answer that is not what the command answers, such as an export without its columns.
    static constexpr qint32 UnexpectedAnswerError = 13;

    virtual ~MoneyWorksLink() = default;

    // "DocumentPath" answers the open document's path, empty when none is open.
    virtual Answer evaluate(const QString &expression) = 0;
    virtual std::optional<DbError> openDocument(const QString &document) = 0;
    // Writes the records the search finds, sorted by the field, to the file.
    virtual std::optional<DbError> exportRecords(const QString &sortField, const QString &search,
                                                 const QString &outputFile) = 0;
};
