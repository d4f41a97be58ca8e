// The finished cell grid of one table: what the report logic fills and a
// back-end prints. Cells are addressed as row * fCols + col.
#pragma once

#include <string>
#include <vector>

namespace braigrion {

class TTable {
public:
    struct TCell {
        std::string text;
        std::string rawText;  // second text of the cell; blank when it would equal `text`
        bool monospaced = false;
        bool flags[3] = {false, false, false};  // for the back-ends' own use
    };

    // Throws std::invalid_argument when `rows` or `cols` is 0.
    TTable(int rows, int cols, bool marked);

    TCell& Cell(int row, int col) { return fCells[static_cast<size_t>(row * fCols + col)]; }
    const TCell& Cell(int row, int col) const { return fCells[static_cast<size_t>(row * fCols + col)]; }

    std::vector<int> fColumnWidths;  // percent of the table width per column; 0 at first
    // The unit declared for each property shown ("Bytes", "KiloBytes"): by
    // column, or by row when the first column holds the labels; "" where
    // none is declared, and empty when the table's filler does not say.
    std::vector<std::string> fUnits;
    int fTableWidth;                 // percent; 100 at first
    bool fSortable;                  // the reader may sort the table by its header
    bool fFlagB;
    bool fRowHeaders;                // the first column holds row labels (row report)
    int fColumns;                    // copy of the column count
    std::vector<TCell> fCells;       // rows * cols cells, row by row
    bool fColumnHeaders;             // the first row holds column labels
    int fRows;
    int fCols;
    bool fMarked;
};

}  // namespace braigrion
