// Whole pages of the three back-ends, rendered from the fixture report and
// compared with the expected files; and what hostile values and names do.
#include <gtest/gtest.h>

#include <filesystem>

#include "Assets.h"
#include "THtmlWriter.h"
#include "TInventoryWriter.h"
#include "TTextWriter.h"
#include "backends/BackendFiles.h"
#include "backends/FixtureReport.h"
#include "repository/MemoryRepository.h"

namespace braigrion {
namespace testing {
namespace {

namespace fs = std::filesystem;

struct TRendered {
    TScratchDir scratch;
    std::string report;  // two levels down, so that "../../x" would still land inside the scratch
    std::string failure;
};

void Render(backends::TBackendWriter& writer, TRendered& out) {
    out.report = out.scratch.Path() + "/outer/inner/report";
    fs::create_directories(out.report);
    WriteFixtureReport(writer, out.report);
    out.failure = writer.GetFailure();
}

const std::set<std::string> kPageStems = {"slots", "Environmentals", "lsi_rawData", "___.._escape", "tkrlog"};


// Every file inside the report directory, no other; each page as expected,
// the HTML report's style sheet and sort script as built in.
TEST(Backends, WriteTheReportDirectoryAsExpected) {
    backends::THtmlWriter html;
    backends::TTextWriter text;
    const struct {
        backends::TBackendWriter* writer;
        std::string kind;  // the expected files' folder, and the pages' extension
        std::vector<std::string> others;
    } cases[] = {{&html, "html", {"index", "navbar"}}, {&text, "txt", {"index"}}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.kind);
        TRendered out;
        Render(*c.writer, out);
        ASSERT_EQ("", out.failure);
        std::vector<std::string> pages = c.others;
        pages.insert(pages.end(), kPageStems.begin(), kPageStems.end());
        std::set<std::string> expected;
        for (const std::string& stem : pages) expected.insert("outer/inner/report/" + stem + "." + c.kind);
        if (c.kind == "html") {
            expected.insert("outer/inner/report/global.css");
            expected.insert("outer/inner/report/tkr_sort.js");
            EXPECT_EQ(std::string(backends::assets::kGlobalCss), ReadWholeFile(out.report + "/global.css"));
            EXPECT_EQ(std::string(backends::assets::kSortScript), ReadWholeFile(out.report + "/tkr_sort.js"));
        }
        EXPECT_EQ(expected, FilesUnder(out.scratch.Path()));
        const std::string index = ReadWholeFile(out.report + "/" + pages[c.kind == "html" ? 1 : 0] + "." + c.kind);
        EXPECT_EQ(std::string::npos, index.find("Empty heading")) << "a heading without pages";
        EXPECT_NE(std::string::npos, index.find("Hardware")) << index;
        for (const std::string& stem : pages) {
            std::string actual = ReadWholeFile(out.report + "/" + stem + "." + c.kind);
            EXPECT_EQ(ExpectedText((c.kind == "txt" ? "text/" : "html/") + stem + "." + c.kind, actual), actual) << stem;
        }
    }
}

TEST(InventoryBackend, GivesThePageJustWrittenAndWritesNoFile) {
    backends::TInventoryWriter writer;
    TScratchDir scratch;
    writer.Initialize(boost::shared_ptr<NORVTKR20::ICIMNamespace>(), {}, scratch.Path());
    WriteFixturePage(writer, scratch.Path());
    std::string page = writer.GetInventoryPage();
    EXPECT_EQ(ExpectedText("inventory/slots.html", page), page);
    EXPECT_TRUE(FilesUnder(scratch.Path()).empty());
    EXPECT_EQ("", writer.GetInventoryPage()) << "the page is handed over once";
    EXPECT_EQ("inventory", writer.GetWriterType());
}

// Blocks of label and value rows written one after another, as the adapter
// sections write them, are kept apart in the text report; a page left open
// by its section is finished when the report ends.
TEST(TextBackend, SeparatesBlocksThatFollowEachOther) {
    backends::TTextWriter writer;
    TScratchDir scratch;
    writer.Initialize(boost::shared_ptr<NORVTKR20::ICIMNamespace>(), {}, scratch.Path());
    writer.OpenPage(scratch.Path() + "/blocks");
    writer.WritePageHeader();
    for (const char* value : {"first", "second"}) {
        TTable block(1, 2, false);
        block.fRowHeaders = true;
        block.Cell(0, 0).text = "Name";
        block.Cell(0, 1).text = value;
        writer.WriteTableGrid(block);
    }
    writer.WriteIndexEntry("blocks", "Blocks", true);
    writer.EndReport();
    const std::string page = ReadWholeFile(scratch.Path() + "/blocks.txt");
    EXPECT_NE(std::string::npos, page.find("first\n\nName")) << page;
}

// Whatever the fixture's hostile values and names became, in every page.
TEST(HtmlBackend, HostileValuesStayTextAndLinksStayInside) {
    backends::THtmlWriter writer;
    TRendered out;
    Render(writer, out);
    for (const std::string& file : FilesUnder(out.report)) {
        if (file.size() < 5 || file.substr(file.size() - 5) != ".html") continue;
        SCOPED_TRACE(file);
        std::string page = ReadWholeFile(out.report + "/" + file);
        EXPECT_EQ(std::string::npos, page.find("<script>alert")) << "a value became a script";
        EXPECT_EQ(std::string::npos, page.find("<img")) << "a value became an element";
        EXPECT_EQ(std::string::npos, page.find("<b>")) << "a page name became mark-up";
        EXPECT_EQ(std::string::npos, page.find("href=\"javascript:")) << "a link runs script";
        EXPECT_EQ(std::string::npos, page.find("href=\"../")) << "a link leaves the report";
        EXPECT_EQ(std::string::npos, page.find("&amp;lt;")) << "a value was escaped twice";
    }
    std::string slots = ReadWholeFile(out.report + "/slots.html");
    EXPECT_NE(std::string::npos, slots.find("&lt;script&gt;alert(1)&lt;/script&gt;"));
    EXPECT_NE(std::string::npos, slots.find("a &quot;quoted&quot; &amp; &#39;single&#39; value"));
    std::string raw = ReadWholeFile(out.report + "/lsi_rawData.html");
    EXPECT_NE(std::string::npos, raw.find("<a href=\"LSI_RawData_Rresults_0.txt\">View Results</a>"))
        << "the logic's own link to a result file stays a link";
    EXPECT_NE(std::string::npos, raw.find("<a class=\"switch\" href=\"lsi_mir.html\"> - [Show Standard Report]</a>"));
}

TEST(HtmlBackend, AFailureToWriteIsReported) {
    backends::THtmlWriter writer;
    TScratchDir scratch;
    std::string missing = scratch.Path() + "/not-there";
    WriteFixtureReport(writer, missing);
    EXPECT_NE(std::string::npos, writer.GetFailure().find(missing + "/slots.html")) << writer.GetFailure();
}

// A section that closes a block of tables with a footer of its own before
// the page's footer: the tables after it stay inside the page, which ends
// with one footer.
TEST(HtmlBackend, ARepeatedFooterStaysAtTheEnd) {
    backends::THtmlWriter writer;
    TScratchDir scratch;
    writer.Initialize(repository::TMemoryNamespace::Create(), {}, scratch.Path());
    writer.StartReport();
    writer.OpenPage(scratch.Path() + "/lsi_mir");
    writer.WritePageHeader();
    writer.WriteReportTitle("LSI Controller", "", "");
    const TReportProperty cell("Name", "100%", "", "", "", "");
    for (const char* text : {"SSD Warranty Information", "LSI PCIe SLC/MLC Adapter Information"}) {
        writer.StartPropertyTable("50%", "40%", text);
        writer.StartRow(true);
        writer.WriteTextCell(cell, text, "");
        writer.EndRow();
        writer.EndTable();
        writer.WritePageFooter();
    }
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry("lsi_mir", "LSI Controller", true);
    writer.EndReport();
    const std::string page = ReadWholeFile(scratch.Path() + "/lsi_mir.html");
    const size_t body = page.find("</body>");
    ASSERT_NE(std::string::npos, body) << page;
    EXPECT_EQ(std::string::npos, page.find("</body>", body + 1)) << page;
    EXPECT_LT(page.find("Adapter Information"), body) << page;
}

// A page that a section only lists in the index, without opening it, still
// gets a file in both formats, so that its link leads somewhere; a listed
// page that was written keeps its own file.
TEST(Backends, APageOnlyListedInTheIndexGetsAFile) {
    backends::THtmlWriter html;
    backends::TTextWriter text;
    const struct {
        backends::TBackendWriter* writer;
        std::string extension;
    } cases[] = {{&html, ".html"}, {&text, ".txt"}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.extension);
        TScratchDir scratch;
        c.writer->Initialize(repository::TMemoryNamespace::Create(), {}, scratch.Path());
        c.writer->StartReport();
        c.writer->WriteCategory("Storage");
        c.writer->WriteIndexEntry("lsiide", "LSI IDE Controller", false);
        c.writer->OpenPage(scratch.Path() + "/written");
        c.writer->WritePageHeader();
        c.writer->WriteReportTitle("Written page", "", "");
        c.writer->WritePageFooter();
        c.writer->ClosePage();
        c.writer->WriteIndexEntry("written", "Written page", false);
        c.writer->EndCategory();
        c.writer->EndReport();
        const std::string listed = ReadWholeFile(scratch.Path() + "/lsiide" + c.extension);
        EXPECT_NE(std::string::npos, listed.find("LSI IDE Controller")) << listed;
        EXPECT_NE(std::string::npos, listed.find("No information is available")) << listed;
        EXPECT_NE(std::string::npos, ReadWholeFile(scratch.Path() + "/written" + c.extension).find("Written page"));
    }
}

}  // namespace
}  // namespace testing
}  // namespace braigrion
