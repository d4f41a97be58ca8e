// Sizes in bytes as a person reads them: the tooltip of a cell whose
// property declares a byte unit.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "HumanSize.h"
#include "THtmlWriter.h"
#include "backends/BackendFiles.h"
#include "braigrion/TTable.h"

namespace braigrion {
namespace testing {
namespace {

TEST(HumanSize, ReadsWholeCountsOfByteUnits) {
    const struct {
        const char* text;
        const char* unit;
        const char* shown;
    } cases[] = {
        {"20512304", "KiloBytes", "19.56 GiB \u00b7 21.00 GB"},
        {"4000787030016", "Bytes", "3.64 TiB \u00b7 4.00 TB"},
        {"1024", "Bytes", "1.00 KiB \u00b7 1.02 KB"},
        {" 2048 ", "bytes", "2.00 KiB \u00b7 2.05 KB"},
        {"1536", "MegaBytes", "1.50 GiB \u00b7 1.61 GB"},
        {"3", "byte * 2^10", "3.00 KiB \u00b7 3.07 KB"},
        // Small sizes read well as they are; other units and texts get nothing.
        {"1023", "Bytes", ""},
        {"0", "KiloBytes", ""},
        {"2400", "MegaHertz", ""},
        {"4096", "", ""},
        {"4 GB", "Bytes", ""},
        {"-4096", "Bytes", ""},
        {"4096, 8192", "Bytes", ""},
        {"", "Bytes", ""},
        {"123456789012345678901234", "Bytes", ""},
    };
    for (const auto& c : cases) EXPECT_EQ(c.shown, backends::HumanSize(c.text, c.unit)) << c.text << " " << c.unit;
}

// A page of one table through the HTML back-end; the page's text.
std::string WritePage(const TScratchDir& scratch, TTable& table) {
    backends::THtmlWriter writer;
    writer.Initialize(boost::shared_ptr<NORVTKR20::ICIMNamespace>(), {}, scratch.Path());
    writer.StartReport();
    writer.WriteCategory("Hardware");
    writer.OpenPage(scratch.Path() + "/disks");
    writer.WritePageHeader();
    writer.WriteReportTitle("Disks", "", "");
    writer.WriteTableGrid(table);
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("disks", "Disks", true);
    writer.EndCategory();
    writer.EndReport();
    return ReadWholeFile(scratch.Path() + "/disks.html");
}

// The tooltip joins a cell's second text; the cell's text stays as written,
// in a table written as rows, as labelled rows, and as data.
TEST(HumanSize, ShowsAsTheTooltipOfTheCell) {
    TScratchDir scratch;
    TTable columns(3, 2, false);
    columns.fColumnHeaders = true;
    columns.fUnits = {"", "KiloBytes"};
    const char* const texts[3][2] = {{"Name", "Memory"}, {"a", "20512304"}, {"b", "1048576"}};
    for (int r = 0; r < 3; ++r) {
        for (int c = 0; c < 2; ++c) columns.Cell(r, c).text = texts[r][c];
    }
    columns.Cell(2, 1).rawText = "One";
    std::string page = WritePage(scratch, columns);
    EXPECT_NE(std::string::npos, page.find("<td title=\"19.56 GiB \u00b7 21.00 GB\">20512304</td>"));
    EXPECT_NE(std::string::npos, page.find("<td title=\"One (1.00 GiB \u00b7 1.07 GB)\">1048576</td>"));
    EXPECT_EQ(std::string::npos, page.find("title=\"\""));

    TTable rows(2, 2, false);
    rows.fRowHeaders = true;
    rows.fUnits = {"", "Bytes"};
    const char* const labelled[2][2] = {{"Name", "sda"}, {"Size", "4000787030016"}};
    for (int r = 0; r < 2; ++r) {
        for (int c = 0; c < 2; ++c) rows.Cell(r, c).text = labelled[r][c];
    }
    page = WritePage(scratch, rows);
    EXPECT_NE(std::string::npos, page.find("<td title=\"3.64 TiB \u00b7 4.00 TB\">4000787030016</td>"));
    EXPECT_EQ(1u, std::count(page.begin(), page.end(), '\xb7'));

    const int many = backends::THtmlWriter::kWholeTableRows + 1;
    TTable data(many + 1, 2, false);
    data.fColumnHeaders = true;
    data.fSortable = true;
    data.fUnits = {"", "Bytes"};
    for (int r = 0; r <= many; ++r) {
        data.Cell(r, 0).text = "Disk " + std::to_string(r);
        data.Cell(r, 1).text = r == 0 ? "Size" : "2048";
    }
    page = WritePage(scratch, data);
    EXPECT_NE(std::string::npos, page.find("[\"Disk 1\",[\"2048\",\"2.00 KiB \u00b7 2.05 KB\",0]]"));
}

}  // namespace
}  // namespace testing
}  // namespace braigrion
