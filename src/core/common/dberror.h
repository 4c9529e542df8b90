// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

// A failed database step: the number the error report shows and the words that explain it.
struct DbError
{
    qint32 number = 0;
    QString description;

    // The database layer's general failure: the file or its share cannot be reached.
    static constexpr qint32 CommunicationFailure = -2147467259;
    // The row changed or vanished since it was read, so the change was not made.
    static constexpr qint32 RowNotFound = -2147217864;
    // The record set has no current record for the operation.
    static constexpr qint32 NoCurrentRecord = 3021;
    // The record set is closed.
    static constexpr qint32 RecordsetClosed = 3704;
};
