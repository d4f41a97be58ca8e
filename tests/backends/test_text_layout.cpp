// Plain-text layout: widths in characters, wrapping, aligned columns.
#include <gtest/gtest.h>

#include <algorithm>
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

// A token of up to 40 characters is never cut: its column takes room from
// the others (a column of short words gives it), or the line grows longer;
// only a longer token is cut.
TEST(TextLayout, TokensOfUpToFortyCharactersStayWhole) {
    struct {
        std::vector<int> widths;
        std::vector<std::string> cells;
        size_t lineWidth;
        std::vector<std::string> whole;
        bool longer;  // whether the line may (must) exceed lineWidth
    } cases[] = {
        {{10, 10, 80}, {"4294967264", "301448916992", "words of a note that can wrap anywhere between them"}, 40,
         {"4294967264", "301448916992"}, false},
        {{50, 50}, {"0000:3a:00.0-e810-c7a1-4f0b-9d2c", "fe80::3efd:feff:fe7a:1c20%ens1f0"}, 30,
         {"0000:3a:00.0-e810-c7a1-4f0b-9d2c", "fe80::3efd:feff:fe7a:1c20%ens1f0"}, true},
        {{20, 80}, {"Running", "a b c d e f g h"}, 22, {"Running"}, false},
    };
    for (const auto& c : cases) {
        TTable table(1, static_cast<int>(c.cells.size()), false);
        table.fColumnWidths = c.widths;
        for (size_t i = 0; i < c.cells.size(); ++i) table.Cell(0, static_cast<int>(i)).text = c.cells[i];
        const std::string out = RenderTextGrid(table, c.lineWidth);
        for (const std::string& token : c.whole) EXPECT_NE(std::string::npos, out.find(token)) << out;
        size_t longest = 0;
        for (const std::string& line : Lines(out)) longest = std::max(longest, TextWidth(line));
        EXPECT_EQ(c.longer, longest > c.lineWidth) << out;
    }

    TTable table(1, 2, false);
    table.fColumnWidths = {50, 50};
    const std::string tooLong(41, '7');
    table.Cell(0, 0).text = tooLong;
    table.Cell(0, 1).text = "x";
    const std::string out = RenderTextGrid(table, 30);
    EXPECT_EQ(std::string::npos, out.find(tooLong)) << out;
    for (const std::string& line : Lines(out)) EXPECT_LE(TextWidth(line), 30u) << line;
}

}  // namespace
}  // namespace backends
}  // namespace braigrion
