#include "TextLayout.h"

#include <algorithm>

namespace braigrion {
namespace backends {

namespace {

const std::string kGap = "  ";
// Tokens up to this many characters are never cut: their column is widened.
const size_t kWholeToken = 40;

bool IsContinuation(char c) {
    return (static_cast<unsigned char>(c) & 0xC0) == 0x80;
}

// Byte length of the first `count` code points of `text` from `start`.
size_t BytesOf(const std::string& text, size_t start, size_t count) {
    size_t i = start;
    while (i < text.size() && count > 0) {
        ++i;
        while (i < text.size() && IsContinuation(text[i])) ++i;
        --count;
    }
    return i - start;
}

std::vector<std::string> SplitLines(const std::string& text) {
    std::vector<std::string> lines;
    size_t start = 0;
    while (true) {
        size_t end = text.find('\n', start);
        lines.push_back(text.substr(start, end == std::string::npos ? std::string::npos : end - start));
        if (end == std::string::npos) break;
        start = end + 1;
    }
    return lines;
}

size_t LongestLine(const std::string& text) {
    size_t longest = 0;
    for (const std::string& line : SplitLines(text)) longest = std::max(longest, TextWidth(line));
    return longest;
}

// The longest token (a run of characters between blanks and line feeds) of
// at most `limit` characters; longer tokens are cut anyway.
size_t LongestTokenUpTo(const std::string& text, size_t limit) {
    size_t longest = 0;
    size_t current = 0;
    for (size_t i = 0; i <= text.size(); ++i) {
        if (i == text.size() || text[i] == ' ' || text[i] == '\n') {
            if (current <= limit) longest = std::max(longest, current);
            current = 0;
        } else if (!IsContinuation(text[i])) {
            ++current;
        }
    }
    return longest;
}

std::string Padded(const std::string& text, size_t width) {
    size_t w = TextWidth(text);
    return w >= width ? text : text + std::string(width - w, ' ');
}

std::string TrimRight(std::string line) {
    while (!line.empty() && line.back() == ' ') line.pop_back();
    return line;
}

bool IsHeaderCell(const TTable& table, int r, int c) {
    return (r == 0 && table.fColumnHeaders) || (c == 0 && table.fRowHeaders) || table.Cell(r, c).flags[2];
}

// Widths of the columns: the percentages shared out over `available`, then
// cut to what the content needs, the room saved going to columns that need
// more. Last, every column is made wide enough for its longest token of up
// to kWholeToken characters: first with room from columns that can spare
// it without cutting a token of their own, then by making the line longer.
std::vector<size_t> ColumnWidths(const TTable& table, size_t available) {
    size_t cols = static_cast<size_t>(table.fCols);
    std::vector<size_t> natural(cols, 1);
    std::vector<size_t> least(cols, 1);
    for (int r = 0; r < table.fRows; ++r) {
        if (table.Cell(r, 0).flags[0]) continue;
        for (size_t c = 0; c < cols; ++c) {
            const std::string& text = table.Cell(r, static_cast<int>(c)).text;
            natural[c] = std::max(natural[c], LongestLine(text));
            least[c] = std::max(least[c], LongestTokenUpTo(text, kWholeToken));
        }
    }
    std::vector<double> share(cols, 0);
    int given = 0, unset = 0;
    for (size_t c = 0; c < cols; ++c) {
        int w = table.fColumnWidths[c];
        if (w > 0) given += w;
        else ++unset;
    }
    double rest = unset ? std::max(100 - given, 10 * unset) / static_cast<double>(unset) : 0;
    double total = 0;
    for (size_t c = 0; c < cols; ++c) {
        share[c] = table.fColumnWidths[c] > 0 ? table.fColumnWidths[c] : rest;
        total += share[c];
    }
    std::vector<size_t> width(cols);
    size_t used = 0;
    for (size_t c = 0; c < cols; ++c) {
        size_t allotted = std::max<size_t>(4, static_cast<size_t>(available * share[c] / total));
        width[c] = std::min(natural[c], allotted);
        used += width[c];
    }
    // Hand the room left over to the columns whose content was cut.
    while (used < available) {
        bool grew = false;
        for (size_t c = 0; c < cols && used < available; ++c) {
            if (width[c] < natural[c]) {
                ++width[c];
                ++used;
                grew = true;
            }
        }
        if (!grew) break;
    }
    for (size_t c = 0; c < cols; ++c) {
        while (width[c] < least[c]) {
            size_t donor = cols;
            for (size_t d = 0; d < cols; ++d) {
                if (d == c || width[d] <= std::max<size_t>(least[d], 4)) continue;
                if (donor == cols || width[d] - least[d] > width[donor] - least[donor]) donor = d;
            }
            if (donor != cols) --width[donor];
            ++width[c];
        }
    }
    return width;
}

}  // namespace

size_t TextWidth(const std::string& text) {
    size_t count = 0;
    for (char c : text) {
        if (!IsContinuation(c)) ++count;
    }
    return count;
}

std::vector<std::string> WrapText(const std::string& text, size_t width) {
    if (width == 0) width = 1;
    std::vector<std::string> out;
    for (const std::string& source : SplitLines(text)) {
        std::string line;
        size_t i = 0;
        while (i < source.size()) {
            size_t blank = source.find(' ', i);
            std::string word = source.substr(i, blank == std::string::npos ? std::string::npos : blank - i);
            i = blank == std::string::npos ? source.size() : blank + 1;
            // A word too long for any line is cut into pieces of a line each.
            while (TextWidth(word) > width) {
                if (!line.empty()) {
                    out.push_back(line);
                    line.clear();
                }
                size_t cut = BytesOf(word, 0, width);
                out.push_back(word.substr(0, cut));
                word.erase(0, cut);
            }
            if (line.empty()) {
                line = word;
            } else if (TextWidth(line) + 1 + TextWidth(word) <= width) {
                line += " " + word;
            } else {
                out.push_back(line);
                line = word;
            }
        }
        out.push_back(line);
    }
    return out;
}

std::string RenderTextGrid(const TTable& table, size_t lineWidth) {
    size_t cols = static_cast<size_t>(table.fCols);
    size_t tableWidth = lineWidth * static_cast<size_t>(table.fTableWidth > 0 ? table.fTableWidth : 100) / 100;
    size_t gaps = kGap.size() * (cols - 1);
    size_t available = std::max(tableWidth, gaps + 4 * cols) - gaps;
    std::vector<size_t> width = ColumnWidths(table, available);
    size_t fullWidth = gaps;
    for (size_t w : width) fullWidth += w;

    std::string out;
    for (int r = 0; r < table.fRows; ++r) {
        if (table.Cell(r, 0).flags[0]) {
            for (const std::string& line : WrapText(table.Cell(r, 0).text, fullWidth)) out += TrimRight(line) + "\n";
            continue;
        }
        std::vector<std::vector<std::string>> cells(cols);
        size_t height = 1;
        for (size_t c = 0; c < cols; ++c) {
            cells[c] = WrapText(table.Cell(r, static_cast<int>(c)).text, width[c]);
            height = std::max(height, cells[c].size());
        }
        for (size_t l = 0; l < height; ++l) {
            std::string line;
            for (size_t c = 0; c < cols; ++c) {
                if (c > 0) line += kGap;
                line += Padded(l < cells[c].size() ? cells[c][l] : std::string(), width[c]);
            }
            out += TrimRight(line) + "\n";
        }
        if (r == 0 && table.fColumnHeaders && IsHeaderCell(table, 0, 0)) {
            std::string rule;
            for (size_t c = 0; c < cols; ++c) rule += (c > 0 ? kGap : std::string()) + std::string(width[c], '-');
            out += rule + "\n";
        }
    }
    return out;
}

}  // namespace backends
}  // namespace braigrion
