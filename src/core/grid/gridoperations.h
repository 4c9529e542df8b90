// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "gridmodel.h"

class NumberFormat;
class RecordSet;

// The operations every list of the program shares.
namespace GridOperations {

// Gives each column its sort type by its key: numbers for keys naming IDs, amounts and
// sizes, dates for "date" keys, text for the rest.
void setupGrid(GridModel &grid);
// Clears the rows and adds one per record; each column takes the field of its key.
void fillGrid(GridModel &grid, RecordSet &records, bool dates);
// Setup lists: a heading directly under another heading is removed, headings are styled,
// the editable column of every other row is marked.
void formatSetupList(GridModel &grid, int column);
// The width left for the column once the other visible columns have theirs (at least 16).
int fitColumn(GridModel &grid, int column, int gridWidthPixels, int scrollBarSize, bool hasBorder);
void sortGrid(GridModel &grid, int column, bool ascending);
void selectRowById(GridModel &grid, qint64 id);
// The first row whose cell equals the text, ignoring case; 0 when none.
int findGridRow(const GridModel &grid, int column, const QString &text);
// Colours left out (nullopt) and bold off leave the cell as it was.
void setCellStyle(GridModel &grid, int row, int column, std::optional<QColor> back, bool bold,
                  std::optional<QColor> fore = std::nullopt);
void setHeadingStyle(GridModel &grid, int row, int column);
QString getCellText(const GridModel &grid, int row, int column);
double getCellNumber(const GridModel &grid, int row, int column, const NumberFormat &numbers);

inline const QColor HeadingBack = QColor(0xDD, 0x68, 0x00);
inline const QColor EditableBack = QColor(0xD3, 0xED, 0xF7);

} // namespace GridOperations
