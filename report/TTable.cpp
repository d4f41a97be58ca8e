#include "braigrion/TTable.h"

#include <stdexcept>

namespace braigrion {

namespace {

// Checked before any member is built, so a refused table allocates nothing.
int RequireCount(int rows, int cols) {
    if (rows == 0 || cols == 0) throw std::invalid_argument("rows and cols must not be 0");
    if (rows < 0 || cols < 0) throw std::invalid_argument("rows and cols must not be negative");
    return cols;
}

}  // namespace

TTable::TTable(int rows, int cols, bool marked)
    : fColumnWidths(static_cast<size_t>(RequireCount(rows, cols)), 0),
      fTableWidth(100),
      fSortable(false),
      fFlagB(false),
      fRowHeaders(false),
      fColumns(cols),
      fCells(static_cast<size_t>(rows) * static_cast<size_t>(cols)),
      fColumnHeaders(false),
      fRows(rows),
      fCols(cols),
      fMarked(marked) {}

}  // namespace braigrion
