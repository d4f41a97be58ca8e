// The ESXi driver and writer frame: the fixed page list, the end of the
// sequence on a failure, the generic page's two exceptions, the system
// overview's serial number, the value helpers and the table engine.
#include <stdexcept>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "RecordingWriter_vmwesxi.h"
#include "TReport_vmwesxi.h"
#include "support/LogCapture.h"
#include "support/RepoBuilder.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace {

using testing::TLogCapture;
using testing::TRecordingWriter_vmwesxi;
using testing::TRepoBuilder;

typedef TReport_vmwesxi::TContext TContext;

// Writes the report of `repository` and returns the writer.
void WriteReport(TRecordingWriter_vmwesxi& writer, const std::string& repository, const std::string& mode = "default") {
    TRepoBuilder repo;
    repo.Parse(repository);
    TContext context;
    if (!mode.empty()) context["mode"] = NORVTKR20::TCIMValue(mode);
    TReport_vmwesxi report(repo.Namespace(), context, "out");
    report.Write(&writer, context);
}

// The categories, category ends, pages (by link) and end of a run, in order.
std::vector<std::string> Outline(const TRecordingWriter_vmwesxi& writer) {
    std::vector<std::string> outline;
    for (const std::string& call : writer.Calls()) {
        if (call.compare(0, 14, "WriteCategory(") == 0 || call == "EndCategory()" || call == "EndReport()") {
            outline.push_back(call);
        } else if (call.compare(0, 9, "OpenPage(") == 0) {
            outline.push_back(call.substr(call.find_last_of('/') + 1, call.size() - call.find_last_of('/') - 3));
        }
    }
    return outline;
}

const std::vector<std::string> kOutline = {
    "WriteCategory(\"Software\")", "system_overview", "installedapps", "kernelmodules", "net", "resource", "process",
    "os_config", "linux_config", "EndCategory()", "WriteCategory(\"Hardware\")", "hardware_inventory", "pci_info",
    "firmware", "SPConfig", "environmentals", "drive_health", "lsi_mir", "lsiide", "pmc", "halcyon", "halcyonlogs",
    "qlogic", "emulex", "broadcom", "brocade_adapter", "glowtrace", "bist", "EndCategory()",
    "WriteCategory(\"KMC Logs\")", "chassis_event", "ipmi_event", "EndCategory()", "WriteCategory(\"Analysis\")",
    "mergedlog", "mergedDevices", "pb", "EndCategory()", "WriteCategory(\"Log\")", "vmware_privilege_log",
    "EndCategory()", "tkr_log", "EndReport()"};

// Every host gets the same pages in the same order, whatever it holds and
// whatever the mode.
TEST(DriverVmwesxi, WritesTheSamePageListForEveryHost) {
    const char* const repositories[] = {
        "",
        "OMC_Chassis IpmiNodeCount=uint16:2 SerialNumber=\"none\"",
        "ORVSG_OperatingSystem OSType=uint16:36\nORVSG_ComputerSystem SystemNodes=uint8:2",
    };
    for (const char* repository : repositories) {
        for (const char* mode : {"default", "luz", ""}) {
            TRecordingWriter_vmwesxi writer;
            WriteReport(writer, repository, mode);
            EXPECT_EQ(kOutline, Outline(writer)) << repository << " in mode " << mode;
            EXPECT_EQ(1u, writer.CallsStartingWith("Initialize(").size());
        }
    }
}

TEST(DriverVmwesxi, AFailingPageEndsTheSequenceWithoutEndingTheReport) {
    TLogCapture log;
    TRecordingWriter_vmwesxi writer;
    writer.ThrowOn("WriteEmulex");
    WriteReport(writer, "");
    const std::vector<std::string> outline = Outline(writer);
    ASSERT_FALSE(outline.empty());
    EXPECT_EQ("qlogic", outline.back());
    EXPECT_TRUE(writer.CallsStartingWith("EndReport(").empty());
    EXPECT_TRUE(log.Contains("TWriter_vmwesxi::Write -- Exception when generating TKR HTML report for ESXi"));
    EXPECT_EQ(static_cast<int>(log.Messages().size()) - 1, log.IndexOf("TWriter_vmwesxi::Write -- Exiting "));
}

// The error log is indexed without data in the default mode, tables or not.
TEST(DriverVmwesxi, ErrorLogHasNoDataInTheDefaultModeOnly) {
    const char* const log = "ORVSG_TKRLogRecord RecordID=uint32:1 Source=\"Collector\" Message=\"started\"";
    struct TCase {
        const char* mode;
        const char* entry;
    } const cases[] = {
        {"default", "WriteIndexEntry(\"tkr_log\", \"TKR Error Log\", false)"},
        {"", "WriteIndexEntry(\"tkr_log\", \"TKR Error Log\", false)"},
        {"luz", "WriteIndexEntry(\"tkr_log\", \"TKR Error Log\", true)"},
    };
    for (const TCase& c : cases) {
        TRecordingWriter_vmwesxi writer;
        WriteReport(writer, log, c.mode);
        const std::string page = writer.Page("tkr_log");
        EXPECT_NE(std::string::npos, page.find("\"started\"")) << c.mode;
        EXPECT_NE(std::string::npos, page.find(c.entry)) << c.mode << "\n" << page;
    }
}

// The patch results table stands without results: its headings alone.
TEST(DriverVmwesxi, PatchResultsTableIsWrittenWithoutInstances) {
    for (const char* repository : {"", "class ORVSG_PBResult"}) {
        TRecordingWriter_vmwesxi writer;
        WriteReport(writer, repository);
        EXPECT_EQ("OpenPage(\"out/pb\")\nWritePageHeader()\nWriteReportTitle(\"PatchBeacon\", \"\", \"\")\n"
                  "WriteTableGrid(grid 1x4 width=80 widths=[25,25,25,25] colheaders)\n"
                  "  | \"Type\" \"Name\" \"InstalledVersion\" \"PBVersion\"\nWriteTableBreak()\n"
                  "WritePageFooter()\nClosePage()\nWriteIndexEntry(\"pb\", \"PatchBeacon\", true)\n",
                  writer.Page("pb"))
            << repository;
    }
    // Any other class without instances leaves its page empty.
    TRecordingWriter_vmwesxi writer;
    WriteReport(writer, "class VMware_Privilege");
    EXPECT_EQ(std::string::npos, writer.Page("vmware_privilege_log").find("WriteTableGrid"));
    EXPECT_NE(std::string::npos, writer.Page("vmware_privilege_log").find("false)"));
}

// A chassis whose serial number is missing ("" or "none") shows the one
// the system's identifying info carries, and keeps it in the repository.
TEST(SystemOverviewVmwesxi, SerialNumberComesFromTheSystemIdentifyingInfo) {
    struct TCase {
        const char* serial;
        const char* system;
        const char* shown;
    } const cases[] = {
        {"none", "OtherIdentifyingInfo=string[]:\"MTM:NS2480-\",\"PSN:NVS7M3\",\"Tag:X\"", "NVS7M3"},
        {"", "OtherIdentifyingInfo=string[]:\"PSN:A:B\"", "A:B"},
        {"none", "OtherIdentifyingInfo=string[]:\"no colon\",\"ends:-\"", ""},
        {"none", "Name=\"esx\"", ""},
        {"NVS1234", "OtherIdentifyingInfo=string[]:\"PSN:OTHER\"", "NVS1234"},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(std::string("OMC_Chassis Manufacturer=\"Norvane\" ChassisPackageType=uint16:17 SerialNumber=\"") + c.serial + "\"\n" +
                   "OMC_UnitaryComputerSystem " + c.system);
        TRecordingWriter_vmwesxi writer;
        TReport_vmwesxi(repo.Namespace(), TContext(), "out").Write(&writer, TContext());
        const std::string page = writer.Page("system_overview");
        EXPECT_NE(std::string::npos, page.find(std::string("| \"Serial Number\" \"") + c.shown + "\"")) << page;

        std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> chassis;
        NORVTKR20::TCIMContext context;
        repo.Namespace()->GetClass("OMC_Chassis", context)->EnumerateInstances(
            NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(chassis), true, context);
        EXPECT_EQ(c.shown, chassis.front()->GetProperty("SerialNumber", context)->GetValueString());
    }
}

// The operating system comes from the software identities that name the
// hypervisor; blade enclosures are no host chassis.
TEST(SystemOverviewVmwesxi, ShowsTheHypervisorIdentityAndTheHostChassisOnly) {
    TRecordingWriter_vmwesxi writer;
    WriteReport(writer,
        "OMC_Chassis Model=\"Enclosure\" ChassisPackageType=uint16:28 SerialNumber=\"E1\"\n"
        "OMC_Chassis Model=\"NS2480\" ChassisPackageType=uint16:17 SerialNumber=\"S1\"\n"
        "VMware_HypervisorSoftwareIdentity Name=\"VMware ESXi\" VersionString=\"VMware ESXi 7.0.3\"\n"
        "CIM_SoftwareIdentity Name=\"VMware ESXi\" VersionString=\"VMware ESXi 7.0.3\"\n"
        "CIM_SoftwareIdentity Name=\"VMware ESXi (Alternate Boot Bank)\" VersionString=\"VMware ESXi 7.0.2\"\n"
        "CIM_SoftwareIdentity Name=\"bnxtnet\" VersionString=\"222.0\"");
    const std::string page = writer.Page("system_overview");
    EXPECT_NE(std::string::npos, page.find("\"NS2480\"")) << page;
    EXPECT_EQ(std::string::npos, page.find("Enclosure")) << page;
    EXPECT_NE(std::string::npos, page.find("WriteTableTitle(\"Operating System\", false, false)\n"
                                           "WriteTableGrid(grid 5x2 width=60 widths=[20,80] rowheaders)\n"
                                           "  | \"Name\" \"VMware ESXi\"\n"))
        << page;
    EXPECT_EQ(std::string::npos, page.find("Boot Bank")) << page;
    EXPECT_EQ(std::string::npos, page.find("bnxtnet")) << page;
    EXPECT_NE(std::string::npos, page.find("WriteIndexEntry(\"system_overview\", \"System Overview\", true)"));
}

// The helpers of the frame, on a writer that marks every escaped text.
class WriterFrameVmwesxi : public ::testing::Test {
protected:
    void SetUp() override {
        fRepo.Parse(
            "OMC_Card Name=\"Riser <1>\" Slots=string[]:\"x16\",\"x8\" Installed=datetime:\"20240311141502.000000+000\"");
        fWriter.SetEscapeMark("!");
        fWriter.Initialize(fRepo.Namespace(), TContext(), "out");
        NORVTKR20::TCIMContext context;
        std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> cards;
        fRepo.Namespace()->GetClass("OMC_Card", context)->EnumerateInstances(
            NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(cards), true, context);
        fCard = cards.front();
    }
    TRepoBuilder fRepo;
    TRecordingWriter_vmwesxi fWriter;
    boost::shared_ptr<NORVTKR20::ICIMInstance> fCard;
};

TEST_F(WriterFrameVmwesxi, PropertyValuesAreEscapedElementByElement) {
    EXPECT_EQ("!Riser <1>", fWriter.GetPropertyValue(fCard, "Name", " "));
    EXPECT_EQ("!x16 / !x8", fWriter.GetPropertyValue(fCard, "Slots", " / "));
    EXPECT_EQ("2024-03-11 14:15:02", fWriter.GetPropertyValue(fCard, "Installed", " "));
    EXPECT_EQ("", fWriter.GetPropertyValue(fCard, "Missing", " "));
}

TEST_F(WriterFrameVmwesxi, SwitchUUIDReversesTheBytesOfTheFirstThreeGroups) {
    EXPECT_EQ("DDCCBBAA-FFEE-HHGG-IIJJ-KKLL", fWriter.SwitchUUID("AABBCCDD-EEFF-GGHH-IIJJ-KKLL"));
    EXPECT_EQ("4b53564e-372d-334d-5832-503800000000", fWriter.SwitchUUID("4e56534b-2d37-4d33-5832-503800000000"));
    EXPECT_EQ("DDCCBBAA-FFEE-HHGG", fWriter.SwitchUUID("AABBCCDD-EEFF-GGHH"));
    EXPECT_THROW(fWriter.SwitchUUID("AABBCCDD-EEFF-GGH"), std::out_of_range);
}

// A table is cut into grids of at most MaxInstancesPerTable instances; an
// empty first column reads "N/A", other empty columns their default.
TEST(TableEngineVmwesxi, GroupsInstancesAndFillsEmptyCells) {
    TRepoBuilder repo;
    repo.Parse("OMC_Card Name=\"A\" Version=\"1\"\nOMC_Card Version=\"2\"\nOMC_Card Name=\"C\"");
    TRecordingWriter_vmwesxi writer;
    writer.Initialize(repo.Namespace(), TContext(), "out");
    TReportClass cls;
    cls.SetClass("OMC_Card");
    cls.SetTitle("Cards");
    cls.SetTableWidth("80%");
    cls.SetMaxInstancesPerTable(2);
    cls.SetProperties({TReportProperty("Name", "50%", "", "", "", ""),
                       TReportProperty("Version", "50%", "", "", "Level", "unknown")});
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> cards;
    NORVTKR20::TCIMContext context;
    repo.Namespace()->GetClass("OMC_Card", context)->EnumerateInstances(
        NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(cards), true, context);
    writer.WriteTable(cls, cards, true, false, TContext());
    const std::string transcript = writer.Transcript();
    EXPECT_EQ("WriteTableTitle(\"Cards\", false, false)\n"
              "WriteTableGrid(grid 3x2 width=80 widths=[50,50] colheaders)\n"
              "  | \"Name\" \"Level\"\n  | \"A\" \"1\"\n  | \"N/A\" \"2\"\nWriteTableBreak()\n"
              "WriteTableGrid(grid 2x2 width=80 widths=[50,50] colheaders)\n"
              "  | \"Name\" \"Level\"\n  | \"C\" \"unknown\"\nWriteTableBreak()\n",
              transcript.substr(transcript.find('\n') + 1));
}

}  // namespace
}  // namespace braigrion
