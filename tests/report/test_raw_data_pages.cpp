// The raw-data pages as the back-end receives them and the result files they
// leave beside the report: no page without data, the PCI page and its blank
// rows, the Halcyon, Emulex and QLogic pages, and the PCI page's switch in a
// "luz" report.
#include <unistd.h>

#include <functional>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
#include "report/RawDataRun.h"
#include "support/RepoBuilder.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {
namespace {

using testing::Str;
using testing::StrArray;
using testing::TRawDataRun;
using testing::TRepoBuilder;
typedef std::vector<std::string> TNames;

std::string StdLink() {
    return "std_page";
}

struct TWriterCase {
    std::string name;
    std::function<std::string(TWriter&)> write;
    TNames classes;  // the classes the writer reads
};

void PrintTo(const TWriterCase& c, std::ostream* os) {
    *os << c.name;
}

std::vector<TWriterCase> AllWriters() {
    return {
        {"PCI", [](TWriter& w) { return w.WritePCIRawDataReport(StdLink()); }, {"ORVSG_PCIRawData"}},
        {"LSI", [](TWriter& w) { std::string link = StdLink(); return w.WriteLSIRawDataReport(link); },
         {"ORV_LSIRawData", "ORVSG_MegaLSIRawData", "ORVSG_lsiRawData"}},
        {"Halcyon", [](TWriter& w) { return w.WriteHalcyonRawDataReport(StdLink()); }, {"ORVSG_hcRawData"}},
        {"HalcyonManager", [](TWriter& w) { return w.WriteHalcyonManagerRawDataReport(StdLink()); },
         {"ORVSG_hcManagerRawData"}},
        {"FIO", [](TWriter& w) { return w.WriteFIORawDataReport(StdLink()); }, {"ORV_FIORawData"}},
        {"Emulex", [](TWriter& w) { return w.WriteEmulexRawDataReport(StdLink()); }, {"EMXCNA_RawData"}},
        {"QLogic", [](TWriter& w) { return w.WriteQLogicRawDataReport(StdLink()); },
         {"ORVSG_QLogicFibreChannelRawData", "ORVSG_QLogicIScsiRawData"}},
    };
}

class NoRawData : public ::testing::TestWithParam<TWriterCase> {};

// Whether the classes are missing or declared without instances, no page is
// opened, no file written and the link is empty.
TEST_P(NoRawData, GivesNoPageAndAnEmptyLink) {
    for (bool declared : {false, true}) {
        TRepoBuilder repo;
        repo.Parse("ORVSG_PCIDevice Name=\"unrelated\"");
        if (declared) {
            for (const std::string& cls : GetParam().classes) repo.Declare(cls, {"Command"});
        }
        TRawDataRun<> run(repo.Namespace());
        EXPECT_EQ("", GetParam().write(run.writer)) << "declared=" << declared;
        EXPECT_EQ("", run.Transcript()) << "declared=" << declared;
        EXPECT_TRUE(run.Files().empty()) << "declared=" << declared;
    }
}

INSTANTIATE_TEST_SUITE_P(Writers, NoRawData, ::testing::ValuesIn(AllWriters()),
                         [](const ::testing::TestParamInfo<TWriterCase>& info) { return info.param.name; });

TEST(PCIRawData, AnUnwritableFileLeavesItsRowBlankAndThePageGoesOn) {
    TRepoBuilder repo;
    repo.Add("ORVSG_PCIRawData", {Str("Command", "lspci -tv"), StrArray("RawResult", {"-[0000:00]-+-00.0", "           +-01.0"})})
        .Add("ORVSG_PCIRawData", {Str("Command", "lspci -vvv"), StrArray("RawResult", {"00:00.0 Host bridge"})})
        .Add("ORVSG_PCIRawData", {Str("Command", "lspci -n"), StrArray("RawResult", {"00:00.0 0600: 8086:2020", ""})});
    TRawDataRun<> run(repo.Namespace());
    run.Block("pci_raw_data_1.txt");

    EXPECT_EQ("pci_rawdata", run.writer.WritePCIRawDataReport("pci_info"));
    EXPECT_EQ(R"(OpenPage("out/pci_rawdata")
WritePageHeader()
WriteReportTitle("PCI Raw Data Information", " - [Show Standard Report]", "pci_info")
WriteTableTitle("Commands Issued", false, false)
WriteTableGrid(grid 4x2 width=75 widths=[80,20] colheaders | "Command" "Raw Data" | "<font face=\"Courier\">lspci -tv</font>" "<a href= \"pci_raw_data_0.txt\">View Results</a>" | "" "" | "<font face=\"Courier\">lspci -n</font>" "<a href= \"pci_raw_data_2.txt\">View Results</a>")
WritePageFooter()
ClosePage()
)",
              run.Transcript());
    EXPECT_EQ("-[0000:00]-+-00.0\n           +-01.0\n", run.Read("pci_raw_data_0.txt"));
    EXPECT_EQ("00:00.0 0600: 8086:2020\n\n", run.Read("pci_raw_data_2.txt"));
    EXPECT_TRUE(run.log.Contains("TWriter::WritePCIRawDataReport - Access to file failed."));
}

TEST(PCIRawData, UnreadablePropertiesAreLoggedAndOnlyAPageWithARowIsLinked) {
    TRepoBuilder repo;
    repo.Add("ORVSG_PCIRawData", {Str("Command", "lspci -k")})                   // no result: empty file, row kept
        .Add("ORVSG_PCIRawData", {StrArray("RawResult", {"orphan output"})});  // no command: file kept, row blank
    TRawDataRun<> run(repo.Namespace());
    EXPECT_EQ("pci_rawdata", run.writer.WritePCIRawDataReport("pci_info"));
    EXPECT_EQ("", run.Read("pci_raw_data_0.txt"));
    EXPECT_EQ("orphan output\n", run.Read("pci_raw_data_1.txt"));
    EXPECT_NE(std::string::npos, run.Transcript().find(
        R"(| "<font face=\"Courier\">lspci -k</font>" "<a href= \"pci_raw_data_0.txt\">View Results</a>" | "" "")"));
    EXPECT_TRUE(run.log.Contains("TWriter::WritePCIRawDataReport - Exception cautht when get property \"RawResult\""));
    EXPECT_TRUE(run.log.Contains("TWriter::WritePCIRawDataReport - Exception caught when get property \"Command\""));

    // Every file failing: the page is still written and closed, but not linked.
    TRepoBuilder single;
    single.Add("ORVSG_PCIRawData", {Str("Command", "lspci"), StrArray("RawResult", {"x"})});
    TRawDataRun<> failing(single.Namespace());
    failing.Block("pci_raw_data_0.txt");
    EXPECT_EQ("", failing.writer.WritePCIRawDataReport("pci_info"));
    EXPECT_EQ("ClosePage()\n", failing.Transcript().substr(failing.Transcript().size() - 12));
}

TEST(HalcyonRawData, ControllerAndManagerPagesDifferInNamesOnly) {
    TRepoBuilder repo;
    repo.Add("ORVSG_hcRawData", {Str("Command", "hccli show ctrl"), StrArray("RawResults", {"Ctrl 0: OK", "Ctrl 1: OK"})})
        .Add("ORVSG_hcManagerRawData", {Str("Command", "hcmgr events"), StrArray("RawResults", {"no events"})});
    TRawDataRun<> run(repo.Namespace());
    EXPECT_EQ("hc_rawData_index", run.writer.WriteHalcyonRawDataReport("hc_info"));
    EXPECT_EQ("hcmanager_rawData_index", run.writer.WriteHalcyonManagerRawDataReport("hc_logs"));
    const std::string transcript = run.Transcript();
    for (const char* expected :
         {R"(WriteReportTitle("Halcyon Raw Data Information", " - [Show Standard Report]", "hc_info"))",
          R"(| "Command" "Result" | "<font face=\"Courier\">hccli show ctrl</font>" "<a href=\"hc_RawData_Results_0.txt\">View Results</a>")",
          R"(WriteReportTitle("Halcyon Manager Raw Data Infomation", " - [Show Standard Report]", "hc_logs"))",
          R"("<a href=\"hc_Manager_RawData_Results_0.txt\">View Results</a>")"}) {
        EXPECT_NE(std::string::npos, transcript.find(expected)) << expected;
    }
    EXPECT_EQ(2u, run.writer.CallsStartingWith("ClosePage(").size());
    EXPECT_EQ("Ctrl 0: OK\nCtrl 1: OK\n", run.Read("hc_RawData_Results_0.txt"));
    EXPECT_EQ("no events\n", run.Read("hc_Manager_RawData_Results_0.txt"));
}

TEST(HalcyonRawData, MissingClassIsLoggedAndAnUnwritableFileReachesTheCaller) {
    TRepoBuilder empty;
    TRawDataRun<> missing(empty.Namespace());
    EXPECT_EQ("", missing.writer.WriteHalcyonManagerRawDataReport("hc_logs"));
    EXPECT_EQ(2, missing.log.LevelOf(
                     "TWriter::WriteHalcyonManagerRawDataReport -- Exception when getting class ORVSG_hcManagerRawData"));

    TRepoBuilder repo;
    repo.Add("ORVSG_hcRawData", {Str("Command", "hccli"), StrArray("RawResults", {"x"})});
    TRawDataRun<> run(repo.Namespace());
    run.Block("hc_RawData_Results_0.txt");
    try {
        run.writer.WriteHalcyonRawDataReport("hc_info");
        ADD_FAILURE() << "no exception";
    } catch (const NORVTKR20::TTKRException& e) {
        EXPECT_EQ(11, e.fStatusCode.fStatusCode);
    }
    // Denied access has a status of its own; root is never denied.
    if (geteuid() == 0) return;
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

TEST(EmulexRawData, RowsAreLabelledByTheAdapterCommand) {
    TRepoBuilder repo;
    repo.Add("EMXCNA_RawData", {Str("InstanceID", "10:00:00"), Str("RawData", "Port 0: Link Up")})
        .Add("EMXCNA_RawData", {Str("Caption", "no id, no data")});
    TRawDataRun<> run(repo.Namespace());
    EXPECT_EQ("emulex_rawData", run.writer.WriteEmulexRawDataReport("emulex_info"));
    EXPECT_EQ(R"(OpenPage("out/emulex_rawData")
WritePageHeader()
WriteReportTitle("Emulex Raw Data Information", " - [Show Standard Report]", "emulex_info")
WriteTableTitle("EmulexCNA Raw Data", false, false)
WriteTableGrid(grid 3x2 width=75 widths=[80,20] colheaders | "Command" "Raw Result" | "<font face=\"Courier\"> HbaCmd: 10-00-00</font>" "<a href=\"ELXCNA_RawData_Results_0.txt\">View Results</a>" | "<font face=\"Courier\"> HbaCmd: </font>" "<a href=\"ELXCNA_RawData_Results_1.txt\">View Results</a>")
WritePageFooter()
ClosePage()
)",
              run.Transcript());
    EXPECT_EQ("Port 0: Link Up\n", run.Read("ELXCNA_RawData_Results_0.txt"));
    EXPECT_EQ("\n", run.Read("ELXCNA_RawData_Results_1.txt"));
    EXPECT_TRUE(run.log.Contains("TWriter::WriteEmulexRawDataReport -- Exception when processing property InstanceID"));
}

TEST(QLogicRawData, EitherTableOpensThePageAndBothShareIt) {
    const std::string fc = "ORVSG_QLogicFibreChannelRawData";
    const std::string iscsi = "ORVSG_QLogicIScsiRawData";
    // iSCSI data alone: the page opens with the iSCSI table.
    TRepoBuilder iscsiOnly;
    iscsiOnly.Declare(fc, {"Command", "RawResults"})
        .Add(iscsi, {Str("Command", "iscli -i"), StrArray("RawResults", {"iSCSI port 0"})});
    TRawDataRun<> run(iscsiOnly.Namespace());
    EXPECT_EQ("QLogic_RawData", run.writer.WriteQLogicRawDataReport("qlogic_info"));
    EXPECT_EQ(R"(OpenPage("out/QLogic_RawData")
WritePageHeader()
WriteReportTitle("QLogic Raw Data Information", " - [Show Standard Report]", "qlogic_info")
WriteTableTitle("Commands Issued", false, false)
WriteTableGrid(grid 2x2 width=75 widths=[80,20] colheaders | "Command" "Raw Result" | "<font face=\"Courier\">iscli -i</font>" "<a href=\"iSCSI_QLogic_RawData_Results_0.txt\">View Results</a>")
WritePageFooter()
ClosePage()
)",
              run.Transcript());
    EXPECT_EQ((TNames{"iSCSI_QLogic_RawData_Results_0.txt"}), run.Files());

    // Both: one page, the Fibre Channel table first.
    TRepoBuilder both;
    both.Add(fc, {Str("Command", "qaucli -i"), StrArray("RawResults", {"HBA 0"})})
        .Add(iscsi, {Str("Command", "iscli -i"), StrArray("RawResults", {"iSCSI port 0"})});
    TRawDataRun<> twoTables(both.Namespace());
    EXPECT_EQ("QLogic_RawData", twoTables.writer.WriteQLogicRawDataReport("qlogic_info"));
    EXPECT_EQ(1u, twoTables.writer.CallsStartingWith("OpenPage(").size());
    EXPECT_EQ(1u, twoTables.writer.CallsStartingWith("ClosePage(").size());
    EXPECT_EQ(2u, twoTables.writer.CallsStartingWith("WriteTableGrid(").size());
    EXPECT_EQ((TNames{"FC_QLogic_RawData_Results_0.txt", "iSCSI_QLogic_RawData_Results_0.txt"}), twoTables.Files());

    // A class that cannot be fetched gives no page, even with the other's data.
    TRepoBuilder fcMissing;
    fcMissing.Add(iscsi, {Str("Command", "iscli -i"), StrArray("RawResults", {"iSCSI port 0"})});
    TRawDataRun<> none(fcMissing.Namespace());
    EXPECT_EQ("", none.writer.WriteQLogicRawDataReport("qlogic_info"));
    EXPECT_EQ("", none.Transcript());
}

// In a "luz" HTML report the PCI page links to its raw page, written and
// closed before it; a text report and the default mode have no raw page.
TEST(PCIRawData, TheLuzPCIPageLinksToItsRawPage) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_OperatingSystem ProductVendor="Red Hat" OSType=uint16:36
        ORVSG_PCIDevice ClassCode="0200" Description="Ethernet controller"
    )");
    repo.Add("ORVSG_PCIRawData", {Str("Command", "lspci"), StrArray("RawResult", {"00:00.0 Host bridge"})});
    struct TCase {
        std::string writerType, mode, titleCall;
        bool rawPage;
    } cases[] = {
        {"html", "luz", R"(WriteReportTitle("PCI Information", "pci_rawdata", " - [Show Rawdata Report]"))", true},
        {"text", "luz", R"(WriteReportTitle("PCI Information", "", ""))", false},
        {"html", "default", R"(WriteReportTitle("PCI Information", "", ""))", false},
    };
    for (const TCase& c : cases) {
        TRawDataRun<> run(repo.Namespace(), c.writerType, c.mode);
        run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), c.mode, false),
                                   TKR_REPORT_DEFINITION::PAGE_PCI_INFORMATION);
        const std::string transcript = run.Transcript();
        const std::string pciPage = "OpenPage(\"out/pci_info\")";
        EXPECT_NE(std::string::npos, transcript.find(c.titleCall)) << c.writerType << " " << c.mode;
        if (c.rawPage) {
            EXPECT_EQ(0u, transcript.find("OpenPage(\"out/pci_rawdata\")"));
            EXPECT_NE(std::string::npos, transcript.find("ClosePage()\n" + pciPage));
            EXPECT_EQ((TNames{"pci_raw_data_0.txt"}), run.Files());
        } else {
            EXPECT_EQ(0u, transcript.find(pciPage)) << c.writerType << " " << c.mode;
            EXPECT_TRUE(run.Files().empty());
        }
    }

    // Without raw data the luz page is written with no switch.
    TRepoBuilder plain;
    plain.Parse("ORVSG_PCIDevice ClassCode=\"0200\" Description=\"Ethernet controller\"");
    TRawDataRun<> run(plain.Namespace());
    run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(plain.Namespace(), "luz", false),
                               TKR_REPORT_DEFINITION::PAGE_PCI_INFORMATION);
    EXPECT_EQ(0u, run.Transcript().find("OpenPage(\"out/pci_info\")"));
    EXPECT_NE(std::string::npos,
              run.Transcript().find(R"(WriteReportTitle("PCI Information", "", " - [Show Rawdata Report]"))"));
}

}  // namespace
}  // namespace braigrion
