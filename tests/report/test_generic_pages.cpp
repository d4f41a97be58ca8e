// Whole declared pages as the back-end receives them: frame, title, tables
// and index entry, the classes with rules of their own, and the error log
// page of a text report.
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/EngineFixture.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TEngineRun;
using testing::TRecordingWriter;
using testing::TRepoBuilder;

TReportParameters Page(const std::string& link, const std::string& name, const std::vector<TReportClass>& classes) {
    TReportParameters page;
    page.SetLinkName(link);
    page.SetReportName(name);
    page.SetShowReportTitle(true);
    page.SetClasses(classes);
    return page;
}

TReportClass Table(const std::string& className, const std::string& title, const std::string& property) {
    TReportClass table;
    table.SetClass(className);
    table.SetTitle(title);
    table.SetProperties({TReportProperty(property, "100%", "", "", "", "")});
    return table;
}

// The rows of each grid of a transcript, by their first cells.
std::vector<int> GridRows(const std::vector<std::string>& grids) {
    std::vector<int> rows;
    for (const std::string& grid : grids) rows.push_back(std::stoi(grid.substr(grid.find("grid ") + 5)));
    return rows;
}

TEST(GenericPage, WritesFrameTitleTablesAndIndexEntry) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Fan Name="Fan 2"
        ORVSG_Fan Name="Fan 10"
        ORVSG_Fan Name="Fan 1"
        ORVSG_Disk Name="sda"
    )");
    TReportClass fans = Table("ORVSG_Fan", "Fans", "Name");
    fans.GetInstanceSorter().AddProperty("Name", false, false);
    TReportParameters page = Page("hardware", "Hardware Information",
                                  {fans, Table("ORVSG_NoSuchClass", "Missing", "Name"), Table("ORVSG_Disk", "Disks", "Name")});
    TEngineRun<> run(repo.Namespace());
    run.writer.WriteGenericReport(page);
    EXPECT_EQ(R"(OpenPage("out/hardware")
WriteSortScript()
WritePageHeader()
WriteReportTitle("Hardware Information", "", "")
WriteTableTitle("Fans", false, false)
WriteTableGrid(grid 4x1 width=100 widths=[100] colheaders | "Name" | "Fan 10" | "Fan 2" | "Fan 1")
WriteTableBreak()
WriteTableTitle("Disks", false, false)
WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | "Name" | "sda")
WriteTableBreak()
WritePageFooter()
ClosePage()
WriteIndexEntry("hardware", "Hardware Information", true)
)",
              run.Transcript());
    EXPECT_EQ("TWriter::WriteGenericReport -- Enter", run.log.Messages().front());
    EXPECT_TRUE(run.log.Contains("TWriter::WriteGenericReport -- Current report name is Hardware Information"));
    EXPECT_EQ("TWriter::WriteGenericReport -- Exiting ", run.log.Messages().back());
}

TEST(GenericPage, WithoutClassesOrTitleItStillHasItsIndexEntry) {
    TRepoBuilder repo;
    TEngineRun<> run(repo.Namespace());
    TReportParameters page = Page("empty", "Empty", {});
    page.SetShowReportTitle(false);
    run.writer.WriteGenericReport(page);
    EXPECT_EQ(R"(OpenPage("out/empty")
WriteSortScript()
WritePageHeader()
WritePageFooter()
ClosePage()
WriteIndexEntry("empty", "Empty", true)
)",
              run.Transcript());
}

TEST(GenericPage, MemoryModuleDataComeInTablesOfEight) {
    struct TCase {
        int modules;
        std::vector<int> rows;  // of each grid, header row included
    } cases[] = {{0, {}}, {1, {2}}, {8, {9}}, {9, {9, 2}}, {16, {9, 9}}, {17, {9, 9, 2}}};
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Declare("ORVSG_SPDData", {"Name"});
        for (int i = 0; i < c.modules; ++i) repo.Add("ORVSG_SPDData", {testing::Str("Name", "DIMM " + std::to_string(i))});
        TEngineRun<> run(repo.Namespace());
        run.writer.WriteGenericReport(Page("spd", "SPD", {Table("ORVSG_SPDData", "SPD", "Name")}));
        EXPECT_EQ(c.rows, GridRows(run.Grids())) << c.modules << " modules";
        EXPECT_EQ(c.rows.size(), run.writer.CallsStartingWith("WriteTableTitle(").size());
    }
}

TEST(GenericPage, FieldReplaceableUnitsLeaveOutMemoryModules) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_FRU Name="DIMM 3" Part="m"
        ORVSG_FRU Name="PSU 1" Part="p"
        ORVSG_FRU Part="unnamed"
        ORVSG_FRU Name="Fan Tray" Part="f"
    )");
    TEngineRun<> run(repo.Namespace());
    run.writer.WriteGenericReport(Page("fru", "FRU", {Table("ORVSG_FRU", "Units", "Part")}));
    EXPECT_EQ((std::vector<std::string>{
                  "WriteTableGrid(grid 4x1 width=100 widths=[100] colheaders | \"Part\" | \"p\" | \"unnamed\" | \"f\")"}),
              run.Grids());

    // With memory modules only, the table keeps its title and has no grid.
    TRepoBuilder dimms;
    dimms.Parse("ORVSG_FRU Name=\"DIMM 1\" Part=\"m\"");
    TEngineRun<> only(dimms.Namespace());
    only.writer.WriteGenericReport(Page("fru", "FRU", {Table("ORVSG_FRU", "Units", "Part")}));
    EXPECT_EQ(1u, only.writer.CallsStartingWith("WriteTableTitle(\"Units\"").size());
    EXPECT_TRUE(only.Grids().empty());
}

TEST(GenericPage, PatchResultsRunByTypeThenName) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_PBResult Type="B" Name="x"
        ORVSG_PBResult Type="A" Name="y"
        ORVSG_PBResult Type="A" Name="x"
        ORVSG_Other Name="untyped"
    )");
    TReportClass results;
    results.SetClass("ORVSG_PBResult");
    results.SetProperties({TReportProperty("Type", "50%", "", "", "", ""), TReportProperty("Name", "50%", "", "", "", "")});
    TEngineRun<> run(repo.Namespace());
    run.writer.WriteGenericReport(Page("pb", "Patches", {results}));
    EXPECT_EQ((std::vector<std::string>{"WriteTableGrid(grid 4x2 width=100 widths=[50,50] colheaders | \"Type\" "
                                        "\"Name\" | \"A\" \"x\" | \"A\" \"y\" | \"B\" \"x\")"}),
              run.Grids());

    // A result whose text cannot be read orders before nothing.
    std::vector<TWriter::TInstancePtr> typed = testrepo::All(*repo.Namespace(), "ORVSG_PBResult");
    TWriter::TInstancePtr untyped = testrepo::All(*repo.Namespace(), "ORVSG_Other")[0];
    EXPECT_TRUE(pb_comp_type(typed[1], typed[0]));
    EXPECT_FALSE(pb_comp_type(untyped, typed[0]));
    EXPECT_FALSE(pb_comp_type(typed[0], untyped));
    EXPECT_TRUE(pb_comp_name(untyped, typed[0]));
    EXPECT_FALSE(pb_comp_name(typed[0], typed[2]));
}

TEST(GenericPage, ErrorLogOfATextReportInDefaultModeStaysOpenAndUnlisted) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_TKRLogRecord Message=\"collector failed\"");
    const std::string frame = R"(OpenPage("out/tkrlog")
WriteSortScript()
WritePageHeader()
WriteReportTitle("TKR Error Log", "", "")
)";
    const std::string rest = R"(WriteTableTitle("Errors", false, false)
WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | "Message" | "collector failed")
WriteTableBreak()
WritePageFooter()
ClosePage()
)";
    struct TCase {
        std::string writerType;
        std::string mode;
        std::string expected;
    } cases[] = {
        {"text", "default", frame},
        {"html", "default", frame + rest + "WriteIndexEntry(\"tkrlog\", \"TKR Error Log\", false)\n"},
        {"text", "luz", frame + rest + "WriteIndexEntry(\"tkrlog\", \"TKR Error Log\", true)\n"},
        {"inventory", "luz", frame + rest + "WriteIndexEntry(\"tkrlog\", \"TKR Error Log\", true)\n"},
    };
    for (const TCase& c : cases) {
        TEngineRun<> run(repo.Namespace(), c.writerType, c.mode);
        run.writer.WriteGenericReport(Page("tkrlog", "TKR Error Log", {Table("ORVSG_TKRLogRecord", "Errors", "Message")}));
        EXPECT_EQ(c.expected, run.Transcript()) << c.writerType << " " << c.mode;
    }
}

TEST(GenericPage, WithLinkTitlesTheRawDataLinkOnHtmlOnly) {
    TRepoBuilder repo;
    for (int i = 0; i < 9; ++i) repo.Add("ORVSG_SPDData", {testing::Str("Name", "DIMM " + std::to_string(i))});
    TReportParameters page = Page("pci", "PCI Information", {Table("ORVSG_SPDData", "SPD", "Name")});
    page.SetShowReportTitle(false);  // the title is written all the same

    TEngineRun<> html(repo.Namespace(), "html", "luz");
    html.writer.WriteGenericReportWithLink(page, "pci_rawdata");
    TEngineRun<> text(repo.Namespace(), "text", "luz");
    text.writer.WriteGenericReportWithLink(page, "pci_rawdata");
    const std::string title[] = {"WriteReportTitle(\"PCI Information\", \"pci_rawdata\", \" - [Show Rawdata Report]\")",
                                 "WriteReportTitle(\"PCI Information\", \"\", \"\")"};
    TEngineRun<>* runs[] = {&html, &text};
    for (int i = 0; i < 2; ++i) {
        std::vector<std::string> calls = runs[i]->Calls();
        ASSERT_EQ(9u, calls.size());
        EXPECT_EQ("OpenPage(\"out/pci\")", calls[0]);  // no sort script
        EXPECT_EQ("WritePageHeader()", calls[1]);
        EXPECT_EQ(title[i], calls[2]);
        // Every class is one table here, memory modules too.
        EXPECT_EQ((std::vector<int>{10}), GridRows(runs[i]->Grids()));
        EXPECT_EQ("WriteIndexEntry(\"pci\", \"PCI Information\", true)", calls.back());
    }
    EXPECT_EQ("Exiting TWriter::WriteGenericReportWithLink", html.log.Messages().back());
}

// A back-end that fails while printing a grid.
class TFailingGridWriter : public TRecordingWriter {
public:
    using TRecordingWriter::TRecordingWriter;
    void WriteTableGrid(TTable& table) override {
        TRecordingWriter::WriteTableGrid(table);
        throw std::runtime_error("disk full");
    }
};

TEST(GenericPage, AFailureEndsThePageWhereItStood) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Fan Name="Fan 1"
        ORVSG_Disk Name="sda"
    )");
    TEngineRun<TFailingGridWriter> run(repo.Namespace());
    TReportParameters page = Page("hw", "Hardware", {Table("ORVSG_Fan", "Fans", "Name"), Table("ORVSG_Disk", "Disks", "Name")});
    EXPECT_THROW(run.writer.WriteGenericReport(page), std::runtime_error);
    EXPECT_EQ(R"(OpenPage("out/hw")
WriteSortScript()
WritePageHeader()
WriteReportTitle("Hardware", "", "")
WriteTableTitle("Fans", false, false)
WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | "Name" | "Fan 1")
)",
              run.Transcript());
}

}  // namespace
}  // namespace braigrion
