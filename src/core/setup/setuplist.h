// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "grid/gridmodel.h"

#include <QHash>
#include <QString>
#include <QVariant>

#include <functional>

class MainDatabase;
class Prompter;
class RecordSet;

// One editable list of a setup dialog: rows read from a table, one editable column, and a
// save that writes that column back record by record through a standing record set.
class SetupList
{
public:
    struct Columns
    {
        int editable = 0; // 1-based
        int type = 0;     // 0 when the list has no type column (no headings)
    };

    SetupList(GridModel &grid, Columns columns);

    GridModel &grid() { return m_grid; }
    Columns columns() const { return m_columns; }
    bool isHeading(int row) const;

    // How a cell's text goes into the table's field.
    using Conversion = std::function<QVariant(const QString &)>;

    // Writes the editable cell of every row that is not a heading into the field of the
    // record of the row's ID in the record set (rows of the given table). Rows whose record
    // is gone, also when another copy deleted it meanwhile, are passed over; an unchanged
    // value is not written again. A change that meets another copy's change, or any other
    // failure, stops the save and is reported under the error context; rows written before
    // it stay written. False after a failure.
    bool saveInto(MainDatabase &database, Prompter &prompter, RecordSet &records,
                  const QString &table, const QString &field, const Conversion &conversion,
                  const QString &errorContext) const;

    // Runs the saves in one transaction, so that another copy reads all of their changes or
    // none. Rows written before a failure stay written, as they would one by one. False when
    // a save or the transaction failed; every failure is reported under the error context.
    static bool saveTogether(MainDatabase &database, Prompter &prompter,
                             const QString &errorContext, const std::function<bool()> &saves);

    // Remembers the editable texts as the list now shows them. A row whose text is still the
    // same at the save is not written: what is shown may be rounded from what is stored, and
    // nobody asked to change it.
    void rememberShownTexts();

private:
    GridModel &m_grid;
    Columns m_columns;
    QHash<QString, QString> m_shownTexts; // by the row's ID
};
