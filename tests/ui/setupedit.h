// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "setup/celleditor.h"
#include "views/gridview.h"

#include <QTest>

// Types into a setup list's cell through its edit box, as the user does: a click on a cell
// opens the box on that row, the end key closes it.
inline void editCell(GridView *view, CellEditor *editor, int row, int column, const QString &text,
                     Qt::Key end = Qt::Key_Return)
{
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->cellRect(row, column).center());
    QVERIFY(editor->isOpen());
    editor->clear();
    QTest::keyClicks(editor, text);
    QTest::keyClick(editor, end);
}
