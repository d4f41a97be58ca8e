// Whole declared pages as the back-end receives them: frame, title, tables
// and index entry, the classes with rules of their own, and the error log
// page of a text report. Each case's transcript is compared with
// engine/generic-pages.txt under the case's name.
#include <functional>
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/EngineFixture.h"
#include "report/ExpectedPage.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TEngineRun;
using testing::TRecordingWriter;
using testing::TRepoBuilder;

TReportParameters Page(const std::string& link, const std::string& name, const std::vector<TReportClass>& classes,
                       bool showTitle = true) {
    TReportParameters page;
    page.SetLinkName(link);
    page.SetReportName(name);
    page.SetShowReportTitle(showTitle);
    page.SetClasses(classes);
    return page;
}

TReportClass Table(const std::string& className, const std::string& title, const std::vector<std::string>& properties) {
    TReportClass table;
    table.SetClass(className);
    table.SetTitle(title);
    std::vector<TReportProperty> columns;
    const std::string width = std::to_string(100 / properties.size()) + "%";
    for (const std::string& property : properties) columns.push_back(TReportProperty(property, width, "", "", "", ""));
    table.SetProperties(columns);
    return table;
}

template <typename TWriterType = TRecordingWriter>
std::string WritePage(const std::string& repository, const TReportParameters& page,
                      const std::string& writerType = "html", const std::string& mode = "default") {
    TRepoBuilder repo;
    repo.Parse(repository);
    TEngineRun<TWriterType> run(repo.Namespace(), writerType, mode);
    run.writer.WriteGenericReport(page);
    return run.Transcript();
}

std::string MemoryModules(int count) {
    std::string text = "class ORVSG_SPDData\n";
    for (int i = 0; i < count; ++i) text += "ORVSG_SPDData Name=\"DIMM " + std::to_string(i) + "\"\n";
    return text;
}

TEST(GenericPage, WritesThePagesAsExpected) {
    const TReportClass missing = Table("ORVSG_NoSuchClass", "Missing", {"Name"});
    const TReportClass disks = Table("ORVSG_Disk", "Disks", {"Name"});
    TReportClass fans = Table("ORVSG_Fan", "Fans", {"Name"});
    fans.GetInstanceSorter().AddProperty("Name", false, false);
    const char kHardware[] = "ORVSG_Fan Name=\"Fan 2\"\nORVSG_Fan Name=\"Fan 10\"\nORVSG_Fan Name=\"Fan 1\"\n"
                             "ORVSG_Disk Name=\"sda\"";
    const TReportParameters spd = Page("spd", "SPD", {Table("ORVSG_SPDData", "SPD", {"Name"})});
    const TReportParameters fru = Page("fru", "FRU", {Table("ORVSG_FRU", "Units", {"Part"})});
    const TReportParameters errors = Page("tkrlog", "TKR Error Log", {Table("ORVSG_TKRLogRecord", "Errors", {"Message"})});
    const char kError[] = "ORVSG_TKRLogRecord Message=\"collector failed\"";
    const std::vector<std::pair<std::string, std::function<std::string()>>> cases = {
        // Tables in the order declared, a class without a declaration left
        // out; a page without its title shown is still listed.
        {"frame", [&] { return WritePage(kHardware, Page("hardware", "Hardware Information", {fans, missing, disks})); }},
        {"no title", [&] { return WritePage(kHardware, Page("hardware", "Hardware", {disks}, false)); }},
        // Memory module data come in tables of eight modules.
        {"8 memory modules", [&] { return WritePage(MemoryModules(8), spd); }},
        {"9 memory modules", [&] { return WritePage(MemoryModules(9), spd); }},
        {"17 memory modules", [&] { return WritePage(MemoryModules(17), spd); }},
        // Field replaceable units leave out memory modules; with memory
        // modules only, the table keeps its title and has no grid.
        {"field replaceable units", [&] {
             return WritePage("ORVSG_FRU Name=\"DIMM 3\" Part=\"m\"\nORVSG_FRU Name=\"PSU 1\" Part=\"p\"\n"
                              "ORVSG_FRU Part=\"unnamed\"", fru) +
                    WritePage("ORVSG_FRU Name=\"DIMM 1\" Part=\"m\"", fru);
         }},
        // Patch results run by type, then by name.
        {"patch results", [&] {
             return WritePage("ORVSG_PBResult Type=\"B\" Name=\"x\"\nORVSG_PBResult Type=\"A\" Name=\"y\"\n"
                              "ORVSG_PBResult Type=\"A\" Name=\"x\"",
                              Page("pb", "Patches", {Table("ORVSG_PBResult", "", {"Type", "Name"})}));
         }},
        // The error log of a text report in the default mode stays open and
        // unlisted; an HTML report lists it without data.
        {"error log, text, default", [&] { return WritePage(kError, errors, "text"); }},
        {"error log, html, default", [&] { return WritePage(kError, errors, "html"); }},
        {"error log, text, luz", [&] { return WritePage(kError, errors, "text", "luz"); }},
    };
    std::string dump;
    for (const auto& c : cases) dump += "## " + c.first + "\n" + c.second();
    EXPECT_EQ(testing::ExpectedPage("engine/generic-pages.txt", dump), dump);
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

// The page stays as far as it was written: no further table, no index entry.
TEST(GenericPage, AFailureEndsThePageWhereItStood) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_Fan Name=\"Fan 1\"\nORVSG_Disk Name=\"sda\"");
    TEngineRun<TFailingGridWriter> run(repo.Namespace());
    EXPECT_THROW(run.writer.WriteGenericReport(Page("hw", "Hardware", {Table("ORVSG_Fan", "Fans", {"Name"}),
                                                                       Table("ORVSG_Disk", "Disks", {"Name"})})),
                 std::runtime_error);
    EXPECT_EQ("WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | \"Name\" | \"Fan 1\")", run.Calls().back());
}

}  // namespace
}  // namespace braigrion
