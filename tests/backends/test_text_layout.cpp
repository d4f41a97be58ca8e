// Plain-text layout: widths in characters, wrapping, aligned columns.
#include <gtest/gtest.h>

#include <sstream>

#include "TextLayout.h"

namespace braigrion {
namespace backends {
namespace {

std::vector<std::string> Lines(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);) lines.push_back(line);
    return lines;
}

TEST(TextLayout, WrapsAtBlanksAndNeverInsideACharacter) {
    struct {
        std::string text;
        size_t width;
        std::vector<std::string> lines;
    } cases[] = {
        {"", 5, {""}},
        {"short", 10, {"short"}},
        {"one two three", 7, {"one two", "three"}},
        {"line\nfeed kept", 20, {"line", "feed kept"}},
        {"abcdefghij", 4, {"abcd", "efgh", "ij"}},
        {"ab verylongword c", 5, {"ab", "veryl", "ongwo", "rd c"}},
        {"ÄÖÜäöü ßé", 3, {"ÄÖÜ", "äöü", "ßé"}},
        {"日本語テキスト", 4, {"日本語テ", "キスト"}},
    };
    for (const auto& c : cases) EXPECT_EQ(c.lines, WrapText(c.text, c.width)) << c.text;
    EXPECT_EQ(6u, TextWidth("ÄÖÜäöü"));
}

TEST(TextLayout, ColumnsAlignAndStayWithinTheirWidths) {
    TTable table(4, 3, false);
    table.fColumnHeaders = true;
    table.fColumnWidths = {20, 30, 50};
    const char* const cells[4][3] = {{"Slot", "Device", "Notes"},
                                     {"Slot 10", "Ethernet", "a long note that must wrap inside its own column"},
                                     {"Slot 9", "Äpfel ünïcödé", ""},
                                     {"S1", "x", "y"}};
    for (int r = 0; r < 4; ++r) {
        for (int c = 0; c < 3; ++c) table.Cell(r, c).text = cells[r][c];
    }
    std::vector<std::string> lines = Lines(RenderTextGrid(table, 40));
    ASSERT_GE(lines.size(), 6u);
    // Every column starts at the same character on every line.
    // Of 36 characters the device column's 30% is 10, and it gets the one
    // character the first column leaves; the notes column keeps its 18.
    size_t second = TextWidth("Slot 10") + 2;
    size_t third = second + 11 + 2;
    EXPECT_EQ("Slot     Device       Notes", lines[0]);
    EXPECT_EQ(std::string(7, '-') + "  " + std::string(11, '-') + "  " + std::string(18, '-'), lines[1]);
    for (const std::string& line : lines) {
        EXPECT_LE(TextWidth(line), 40u) << line;
        if (line.find("Ethernet") != std::string::npos) {
            EXPECT_EQ(second, line.find("Ethernet"));
        }
        if (line.find("Äpfel") != std::string::npos) {
            EXPECT_EQ(second, TextWidth(line.substr(0, line.find("Äpfel"))));
        }
    }
    EXPECT_EQ("Slot 10  Ethernet     a long note that", lines[2]);
    EXPECT_EQ(std::string(third, ' ') + "must wrap inside", lines[3]);
}

}  // namespace
}  // namespace backends
}  // namespace braigrion
