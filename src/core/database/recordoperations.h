// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "recordset.h"

#include <QStringList>

class MainDatabase;
class Prompter;

// The record chores the dialogs and the engine share, on the main connection.
class RecordOperations
{
public:
    struct Query
    {
        RecordSet records;
        std::optional<DbError> error;
    };

    // Items of a list and, position by position, the IDs of their rows.
    struct ListContent
    {
        QStringList items;
        QStringList ids;
    };

    RecordOperations(MainDatabase &database, Prompter &prompter);

    // " LIKE ? ESCAPE '\'" with the text to bind for it: a case-blind comparison in which
    // every character of the text stands for itself, wildcards included.
    static QString likeLiteralClause();
    static QString likeLiteral(const QString &text);
    // "SELECT * FROM table [WHERE filter]", opened when asked. Values the filter takes from
    // the user go in as bindings for its "?" marks, never into the text.
    Query openQuery(const QString &table, const QString &filter, bool open,
                    const QVariantList &bindings = {}) const;
    // Positions the record set on the record with that ID. A failure is reported under
    // "Find Record".
    bool findRecordById(RecordSet &records, qint64 id) const;
    // Asks first; true when the record is gone afterwards.
    bool deleteRecordById(RecordSet &records, qint64 id) const;
    // Whether some row's column equals the value, letters in any case. The value is bound and
    // matched literally, so quotes, "%" and "_" in it are just characters.
    std::optional<bool> valueExists(const QString &table, const QString &column,
                                    const QString &value, DbError *error = nullptr) const;
    // Replaces the list with the column of every row, when there are rows; otherwise the list
    // keeps what it held. With warn, an empty list at the end is reported.
    void loadList(ListContent &list, const QString &table, const QString &column,
                  const QString &filter, bool warn) const;

    static bool hasRecords(const RecordSet &records);

private:
    MainDatabase &m_database;
    Prompter &m_prompter;
};
