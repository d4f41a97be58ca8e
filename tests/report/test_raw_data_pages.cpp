// The raw-data pages as the back-end receives them and the result files they
// leave beside the report: no page without data, each page with data
// (compared with its expected dump under tests/fixtures/pages/raw/), a result
// file that cannot be written, and the PCI page's switch in a "luz" report.
#include <unistd.h>

#include <filesystem>
#include <functional>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
#include "report/ExpectedPage.h"
#include "report/RawDataRun.h"
#include "support/RepoBuilder.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {
namespace {

using testing::TRawDataRun;
using testing::TRepoBuilder;
typedef std::vector<std::string> TNames;
typedef std::function<std::string(TWriter&)> TWrite;

struct TRawWriter {
    TWrite write;
    TNames classes;  // the classes it reads
};

const std::map<std::string, TRawWriter> kWriters = {
    {"PCI", {[](TWriter& w) { return w.WritePCIRawDataReport("pci_info"); }, {"ORVSG_PCIRawData"}}},
    {"LSI", {[](TWriter& w) { std::string link = "lsi_info"; return w.WriteLSIRawDataReport(link); },
             {"ORV_LSIRawData", "ORVSG_MegaLSIRawData", "ORVSG_lsiRawData"}}},
    {"Halcyon", {[](TWriter& w) { return w.WriteHalcyonRawDataReport("hc_info"); }, {"ORVSG_hcRawData"}}},
    {"HalcyonManager",
     {[](TWriter& w) { return w.WriteHalcyonManagerRawDataReport("hc_logs"); }, {"ORVSG_hcManagerRawData"}}},
    {"FIO", {[](TWriter& w) { return w.WriteFIORawDataReport("fio_info"); }, {"ORV_FIORawData"}}},
    {"Emulex", {[](TWriter& w) { return w.WriteEmulexRawDataReport("emulex_info"); }, {"EMXCNA_RawData"}}},
    {"QLogic", {[](TWriter& w) { return w.WriteQLogicRawDataReport("qlogic_info"); },
                {"ORVSG_QLogicFibreChannelRawData", "ORVSG_QLogicIScsiRawData"}}},
};

// Whether the classes are missing or declared without instances, no page is
// opened, no file written and the link is empty.
TEST(NoRawData, GivesNoPageAndAnEmptyLink) {
    for (const auto& writer : kWriters) {
        for (bool declared : {false, true}) {
            TRepoBuilder repo;
            repo.Parse("ORVSG_PCIDevice Name=\"unrelated\"");
            if (declared) {
                for (const std::string& cls : writer.second.classes) repo.Declare(cls, {"Command"});
            }
            TRawDataRun run(repo.Namespace());
            SCOPED_TRACE(writer.first + (declared ? " declared" : " missing"));
            EXPECT_EQ("", writer.second.write(run.writer));
            EXPECT_EQ("", run.Transcript());
            EXPECT_TRUE(run.Files().empty());
        }
    }
}

struct TPageCase {
    const char* name;  // also the expected dump's file name, raw/<name>.txt
    const char* writer;
    const char* repository;
    const char* blocked;  // a result file that cannot be written, or null
};

void PrintTo(const TPageCase& c, std::ostream* os) {
    *os << c.name;
}

class RawDataPage : public ::testing::TestWithParam<TPageCase> {};

// The link, the page and every result file, as in the expected dump.
TEST_P(RawDataPage, IsWrittenAsExpected) {
    const TPageCase& c = GetParam();
    TRepoBuilder repo;
    repo.Parse(c.repository);
    TRawDataRun run(repo.Namespace());
    if (c.blocked) run.Block(c.blocked);
    const std::string dump = run.Dump(kWriters.at(c.writer).write(run.writer));
    EXPECT_EQ(testing::ExpectedPage(std::string("raw/") + c.name + ".txt", dump), dump);
}

INSTANTIATE_TEST_SUITE_P(
    Pages, RawDataPage,
    ::testing::Values(
        // A file that cannot be written leaves its row blank and the page goes on.
        TPageCase{"pci", "PCI", R"(
            ORVSG_PCIRawData Command="lspci -tv" RawResult=string[]:"-[0000:00]-+-00.0","           +-01.0"
            ORVSG_PCIRawData Command="lspci -vvv" RawResult=string[]:"00:00.0 Host bridge"
            ORVSG_PCIRawData Command="lspci -n" RawResult=string[]:"00:00.0 0600: 8086:2020",""
        )", "pci_raw_data_1.txt"},
        // No result: an empty file, the row kept; no command: the file kept, the row blank.
        TPageCase{"pci-unreadable", "PCI", R"(
            ORVSG_PCIRawData Command="lspci -k"
            ORVSG_PCIRawData RawResult=string[]:"orphan output"
        )", nullptr},
        // With every file failing the page is written and closed, but not linked.
        TPageCase{"pci-no-file", "PCI", R"(ORVSG_PCIRawData Command="lspci" RawResult=string[]:"x")", "pci_raw_data_0.txt"},
        TPageCase{"halcyon", "Halcyon",
                  R"(ORVSG_hcRawData Command="hccli show ctrl" RawResults=string[]:"Ctrl 0: OK","Ctrl 1: OK")", nullptr},
        TPageCase{"halcyon-manager", "HalcyonManager",
                  R"(ORVSG_hcManagerRawData Command="hcmgr events" RawResults=string[]:"no events")", nullptr},
        // Rows are labelled by the adapter command.
        TPageCase{"emulex", "Emulex", R"(
            EMXCNA_RawData InstanceID="10:00:00" RawData="Port 0: Link Up"
            EMXCNA_RawData Caption="no id, no data"
        )", nullptr},
        // iSCSI data alone: the page opens with the iSCSI table.
        TPageCase{"qlogic-iscsi", "QLogic", R"(
            class ORVSG_QLogicFibreChannelRawData
            ORVSG_QLogicIScsiRawData Command="iscli -i" RawResults=string[]:"iSCSI port 0"
        )", nullptr},
        // Both: one page, the Fibre Channel table first.
        TPageCase{"qlogic-both", "QLogic", R"(
            ORVSG_QLogicFibreChannelRawData Command="qaucli -i" RawResults=string[]:"HBA 0"
            ORVSG_QLogicIScsiRawData Command="iscli -i" RawResults=string[]:"iSCSI port 0"
        )", nullptr},
        // Three tables on one page, the utility commands ordered by the text
        // of controller and utility: "10" before "1s" before "2"; equal keys
        // keep their order.
        TPageCase{"lsi", "LSI", R"(
            ORV_LSIRawData ControllerNumber=2 Utility="storcli" Command="storcli /c2 show" CommandResult="c2"
            ORV_LSIRawData ControllerNumber=10 Utility="storcli" Command="storcli /c10 show" CommandResult="c10"
            ORV_LSIRawData ControllerNumber=1 Utility="storcli" Command="storcli /c1 show" CommandResult="c1"
            ORV_LSIRawData ControllerNumber=1 Utility="storcli" Command="storcli /c1 show all" CommandResult="c1 all"
            ORVSG_MegaLSIRawData Command="MegaCli -AdpAllInfo -aALL" RawResults=string[]:"Adapter #0","RAID 930-8i"
            ORVSG_lsiRawData Command="lsiutil -p1 -a 1" RawResults=string[]:"SAS3 Port 1"
        )", nullptr},
        // A failing table is left out and the page goes on: the utility table
        // stands with an empty command, the MegaRAID table is gone.
        TPageCase{"lsi-failing-table", "LSI", R"(
            ORVSG_MegaLSIRawData Command="MegaCli -v" RawResults=string[]:"8.07"
            ORVSG_lsiRawData Command="lsiutil -v" RawResults=string[]:"1.72"
            ORV_LSIRawData CommandResult="no command"
        )", "MegaLSI_RawData_Rresults_0.txt"}),
    [](const ::testing::TestParamInfo<TPageCase>& info) {
        std::string name = info.param.name;
        std::replace(name.begin(), name.end(), '-', '_');
        return name;
    });

TEST(QLogicRawData, AClassThatCannotBeFetchedGivesNoPage) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_QLogicIScsiRawData Command=\"iscli -i\" RawResults=string[]:\"iSCSI port 0\"");
    TRawDataRun run(repo.Namespace());
    EXPECT_EQ("", run.writer.WriteQLogicRawDataReport("qlogic_info"));
    EXPECT_EQ("", run.Transcript());
}

// Unlike the other pages, the Halcyon pages let an unwritable file reach the
// caller, with a status of its own for denied access.
TEST(HalcyonRawData, MissingClassIsLoggedAndAnUnwritableFileReachesTheCaller) {
    TRepoBuilder empty;
    TRawDataRun missing(empty.Namespace());
    EXPECT_EQ("", missing.writer.WriteHalcyonManagerRawDataReport("hc_logs"));
    EXPECT_EQ(2, missing.log.LevelOf(
                     "TWriter::WriteHalcyonManagerRawDataReport -- Exception when getting class ORVSG_hcManagerRawData"));

    TRepoBuilder repo;
    repo.Parse("ORVSG_hcRawData Command=\"hccli\" RawResults=string[]:\"x\"");
    TRawDataRun run(repo.Namespace());
    run.Block("hc_RawData_Results_0.txt");
    try {
        run.writer.WriteHalcyonRawDataReport("hc_info");
        ADD_FAILURE() << "no exception";
    } catch (const NORVTKR20::TTKRException& e) {
        EXPECT_EQ(11, e.fStatusCode.fStatusCode);
    }
    if (geteuid() == 0) return;  // root is never denied
    std::filesystem::remove(run.Dir() + "/hc_RawData_Results_0.txt");
    std::filesystem::permissions(run.Dir(), std::filesystem::perms::owner_read | std::filesystem::perms::owner_exec);
    try {
        run.writer.WriteHalcyonRawDataReport("hc_info");
        ADD_FAILURE() << "no exception";
    } catch (const NORVTKR20::TTKRException& e) {
        EXPECT_EQ(27, e.fStatusCode.fStatusCode);
    }
    std::filesystem::permissions(run.Dir(), std::filesystem::perms::owner_all);
}

// In a "luz" HTML report the PCI page links to its raw page, written and
// closed before it, and has no sort script; a text report and the default
// mode have no raw page; without raw data the luz page has a switch with no
// link. See raw/pci-luz.txt.
TEST(PCIRawData, TheLuzPCIPageLinksToItsRawPage) {
    const char kPCI[] = R"(
        ORVSG_OperatingSystem ProductVendor="Red Hat" OSType=uint16:36
        ORVSG_PCIDevice ClassCode="0200" Description="Ethernet controller"
    )";
    struct TCase {
        const char* writerType;
        const char* mode;
        bool rawData;
    } cases[] = {{"html", "luz", true}, {"text", "luz", true}, {"html", "default", true}, {"html", "luz", false}};
    std::string dump;
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(kPCI);
        if (c.rawData) repo.Parse("ORVSG_PCIRawData Command=\"lspci\" RawResult=string[]:\"00:00.0 Host bridge\"");
        TRawDataRun run(repo.Namespace(), c.writerType, c.mode);
        run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), c.mode, false),
                                   TKR_REPORT_DEFINITION::PAGE_PCI_INFORMATION);
        dump += std::string("## ") + c.writerType + " " + c.mode + (c.rawData ? "" : " without raw data") + "\n" +
                run.Dump("");
    }
    EXPECT_EQ(testing::ExpectedPage("raw/pci-luz.txt", dump), dump);
}

// Each table of a raw page has its title before its rows are filled (the
// commands escaped for their cells) and before its result files are
// written. The writer notes, at each table title, how many result files
// the directory holds by then.
class TTitleWatchingWriter : public testing::TEscapingWriter {
public:
    using TEscapingWriter::TEscapingWriter;
    void WriteTableTitle(const std::string& title, const bool& subTitle, const bool& other) override {
        size_t files = 0;
        for (const auto& entry : std::filesystem::directory_iterator(OutputPath())) files += entry.is_regular_file();
        TEscapingWriter::WriteTableTitle(title, subTitle, other);
        Note("files " + std::to_string(files));
    }
};

TEST(RawDataPages, TitleComesBeforeTheRowsAndTheirFiles) {
    for (const auto& raw : kWriters) {
        SCOPED_TRACE(raw.first);
        TRepoBuilder repo;
        for (const std::string& cls : raw.second.classes) {
            repo.Add(cls, {testing::Str("Command", "tool -a"), testing::Str("InstanceID", "1:2"),
                           testing::Str("CommandResult", "out"), testing::Str("RawData", "out"),
                           testing::StrArray("RawResult", {"out"}), testing::StrArray("RawResults", {"out"})});
        }
        testing::TBasicRawDataRun<TTitleWatchingWriter> run(repo.Namespace());
        EXPECT_NE("", raw.second.write(run.writer));
        // Between a grid (or the page's start) and the next title no cell
        // text is made, and at the title the files are those of the tables
        // before it: one per table, as each class has one instance.
        size_t tables = 0;
        bool cellMade = false;
        for (const std::string& call : run.writer.Calls()) {
            if (call.compare(0, 11, "EscapeText(") == 0) cellMade = true;
            if (call.compare(0, 15, "WriteTableTitle") == 0) {
                EXPECT_FALSE(cellMade) << call;
            }
            if (call.compare(0, 6, "files ") == 0) {
                EXPECT_EQ("files " + std::to_string(tables), call);
            }
            if (call.compare(0, 14, "WriteTableGrid") == 0) {
                ++tables;
                cellMade = false;
            }
        }
        EXPECT_EQ(raw.second.classes.size(), tables);
    }
}

// A back-end that fails while the PCI raw page is written (here at the
// raw page's foot) costs the raw page only: the PCI page is still written,
// without the switch, and the log tells what happened.
class TRawPageFailingWriter : public testing::TEscapingWriter {
public:
    using TEscapingWriter::TEscapingWriter;
    void OpenPage(const std::string& path) override {
        fOpen = path;
        TEscapingWriter::OpenPage(path);
    }
    void WritePageFooter() override {
        TEscapingWriter::WritePageFooter();
        if (fOpen.size() >= 11 && fOpen.compare(fOpen.size() - 11, 11, "pci_rawdata") == 0)
            throw std::runtime_error("disk full");
    }

private:
    std::string fOpen;
};

TEST(PCIRawData, AFailureInsideTheRawPageLeavesThePCIPageWithoutSwitch) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_OperatingSystem ProductVendor="Red Hat" OSType=uint16:36
        ORVSG_PCIDevice ClassCode="0200" Description="Ethernet controller"
        ORVSG_PCIRawData Command="lspci" RawResult=string[]:"00:00.0 Host bridge"
    )");
    testing::TBasicRawDataRun<TRawPageFailingWriter> run(repo.Namespace());
    run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "luz", false),
                               TKR_REPORT_DEFINITION::PAGE_PCI_INFORMATION);
    const std::string transcript = run.Transcript();
    EXPECT_NE(std::string::npos, transcript.find("OpenPage(\"out/pci_info\")")) << transcript;
    EXPECT_NE(std::string::npos, transcript.find("WriteReportTitle(\"PCI Information\", \"\", \" - [Show Rawdata Report]\")"))
        << transcript;
    EXPECT_NE(std::string::npos, transcript.find("WriteIndexEntry(\"pci_info\"")) << transcript;

    const std::string name = "TWriter::Generator_PCIInformation";
    const std::vector<std::string> inOrder = {
        name + " -- Under LUZ mode, write RawData first",
        name + " -- Exception was thrown from TWriter::WritePCIRawDataReport",
        name + " -- TWriter::WritePCIRawDataReport failed, write the page without RawData",
        "TWriter::WriteGenericReport -- Enter",
        "TWriter::WriteGenericReport -- Current report name is PCI Information",
        "Exiting TWriter::WriteGenericReportWithLink",
        name + " -- Exiting"};
    int last = -1;
    for (const std::string& line : inOrder) {
        const int at = run.log.IndexOf(line);
        EXPECT_GT(at, last) << line;
        last = at;
    }
}

}  // namespace
}  // namespace braigrion
