// Laying out plain text: widths counted in characters (UTF-8 code points),
// lines wrapped at blanks, and a grid printed as aligned columns.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TTable.h"

namespace braigrion {
namespace backends {

// Number of UTF-8 code points (each counts as one column).
size_t TextWidth(const std::string& text);

// The text in lines of at most `width` characters: line feeds break lines,
// lines break at blanks, a word longer than a line is cut between
// characters, never inside one.
std::vector<std::string> WrapText(const std::string& text, size_t width);

// The grid as aligned columns within `lineWidth` characters for a table
// of width 100%. Column widths follow the table's percentages as upper
// bounds, a narrower content gives its room to the columns that need it, and
// longer values wrap inside their column, at blanks. A column is never
// narrower than its longest token of up to 40 characters (a number, a
// version, an address, a word): it takes room from the other columns, or
// the line grows longer than `lineWidth`; only a longer token is cut. Header rows are underlined; a cell
// flagged to span the row (flag 0) is printed across it.
std::string RenderTextGrid(const TTable& table, size_t lineWidth);

}  // namespace backends
}  // namespace braigrion
