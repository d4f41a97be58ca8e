// The pages "Halcyon" and "Halcyon Logs".
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TReport.h"

#include "report/ExpectedPage.h"
#include "sections/StorageFixture.h"

namespace braigrion {
namespace {

using testing::Has;
using testing::LinesStartingWith;
using testing::Link;
using testing::TRawDataRun;
using testing::TRepoBuilder;
using NORVTKR20::TCIMContext;

const char kController[] = "ORVSG_hcSCSIProtocolController.DeviceID=\"hc0\"";

// A controller of `type` with two logical drives (bad stripes "0 stripes"
// and "3 stripes"), three disk groups and one defunct device. Its serial
// number is null and it has no BIOS association.
TRepoBuilder HalcyonController(const std::string& type) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_hcSCSIProtocolController DeviceID=\"hc0\" ControllerNum=1 ControllerType=\"" + type +
               "\" ControllerStatus=\"Okay\" SerialNum=null:string");
    repo.Parse(R"(
        ORVSG_hcFirmwareVersion InstanceID="fw" Version="5.2-0"
        ORVSG_hcLogicalDisk DeviceID="ld0" LogicalDriveNum="0" LogicalDriveName="System" RaidLevel="RAID 1"
        ORVSG_hcLogicalDisk DeviceID="ld1" LogicalDriveNum="1" LogicalDriveName="Archive" RaidLevel="RAID 5"
        ORVSG_BadStripeData InstanceID="bs0" NumBadStripes="0 stripes"
        ORVSG_BadStripeData InstanceID="bs1" NumBadStripes="3 stripes"
        ORVSG_hcDiskGroup InstanceID="gA" Array="A" ControllerNum="1" StripeOrder="0:0 0:1"
        ORVSG_hcDiskGroup InstanceID="gB" Array="B" ControllerNum="1" StripeOrder="0:2 0:3"
        ORVSG_hcDiskGroup InstanceID="gC" Array="C" LogicalDrive="as collected" ControllerNum="1"
        ORVSG_hcDiskDrive DeviceID="pd3" ControllerNum="1" DeviceNumber="3" State="Defunct" FRU=null:string
        ORVSG_hcSCSISubStatData InstanceID="st0" ControllerNum="1" Channel="0" ScsiId="3"
        ORVSG_hcRawData InstanceID="r0" Command="hcconf getconfig 1" RawResults=string[]:"Controllers found: 1"
    )");
    Link(repo, "ORVSG_hcFirmwareOnController", "ORVSG_hcFirmwareVersion.InstanceID=\"fw\"", kController);
    for (const char* drive : {"ld0", "ld1"})
        Link(repo, "ORVSG_hcProtocolControllerForUnit", kController,
             std::string("ORVSG_hcLogicalDisk.DeviceID=\"") + drive + "\"");
    Link(repo, "ORVSG_ElementBadStripeData", "ORVSG_hcLogicalDisk.DeviceID=\"ld0\"",
         "ORVSG_BadStripeData.InstanceID=\"bs0\"", "ManagedElement", "Stats");
    Link(repo, "ORVSG_ElementBadStripeData", "ORVSG_hcLogicalDisk.DeviceID=\"ld1\"",
         "ORVSG_BadStripeData.InstanceID=\"bs1\"", "ManagedElement", "Stats");
    for (const char* group : {"gA", "gB", "gC"})
        Link(repo, "ORVSG_hcStripeOrderForController", kController,
             std::string("ORVSG_hcDiskGroup.InstanceID=\"") + group + "\"");
    Link(repo, "ORVSG_hcProtocolControllerForPhysicalDisk", kController, "ORVSG_hcDiskDrive.DeviceID=\"pd3\"");
    return repo;
}

std::string WriteHalcyonPage(TRawDataRun& run) {
    run.writer.WriteHalcyonReport(nullptr, "Halcyon");
    return run.Transcript();
}

std::string GroupDrive(TRepoBuilder& repo, size_t index) {
    const auto groups = testrepo::All(*repo.Namespace(), "ORVSG_hcDiskGroup");
    try {
        return groups.at(index)->GetProperty("LogicalDrive", TCIMContext())->GetValue().ToString(10);
    } catch (...) {
        return "(none)";
    }
}

// In LUZ mode: the raw-data link, the rows the collector gave values for,
// the bad stripe row of the drive that has bad stripes, stripe orders by
// logical drive, the transfer rate table. See storage/halcyon-luz.txt.
TEST(Halcyon, ControllerPageAsExpected) {
    TRepoBuilder repo = HalcyonController("Halcyon HC-7k");
    TRawDataRun run(repo.Namespace(), "html", "luz");
    const std::string page = WriteHalcyonPage(run);
    EXPECT_EQ(testing::ExpectedPage("storage/halcyon-luz.txt", page), page);
    // A null serial number has no row; the BIOS row stands without its association.
    EXPECT_FALSE(Has(page, "{SerialNum"));
    EXPECT_TRUE(Has(page, "label=\"BIOS Version\""));
    EXPECT_EQ(1u, LinesStartingWith(page, "WriteHeaderCell(<class ORVSG_hcLogicalDisk>, {NumBadStripes").size());
}

// Controllers numbered above 6 show disk groups by logical drive, stored
// into the group from the drive at the same position; a group beyond the
// drives keeps what was collected. Older controllers show the array.
TEST(Halcyon, StripeOrderByControllerGeneration) {
    struct TCase {
        const char* type;
        bool byDrive;
        const char* group0;
        const char* group2;
    } cases[] = {
        {"Halcyon HC-6k", false, "(none)", "as collected"},
        {"Halcyon HC-7k", true, "System 0", "as collected"},
        {"no number", false, "(none)", "as collected"},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo = HalcyonController(c.type);
        TRawDataRun run(repo.Namespace(), "html", "default");
        const std::string page = WriteHalcyonPage(run);
        EXPECT_EQ(c.byDrive ? 0u : 3u, LinesStartingWith(page, "WriteHeaderCell(<class ORVSG_hcDiskGroup>, {Array").size())
            << c.type;
        EXPECT_EQ(c.byDrive ? 3u : 0u,
                  LinesStartingWith(page, "WriteHeaderCell(<class ORVSG_hcDiskGroup>, {LogicalDrive").size())
            << c.type;
        EXPECT_EQ(c.group0, GroupDrive(repo, 0)) << c.type;
        EXPECT_EQ(c.group2, GroupDrive(repo, 2)) << c.type;
        // Outside LUZ mode: no raw link and no transfer rates.
        EXPECT_TRUE(Has(page, "WriteReportTitle(\"Halcyon\", \"\", \"\")")) << c.type;
        EXPECT_FALSE(Has(page, "Operating Data Rate of Disk")) << c.type;
    }
}

// A raw-data page that cannot write its result file gives no link; the
// controller page is written all the same.
TEST(Halcyon, FailedRawDataPageLeavesTheTitlePlain) {
    TRepoBuilder repo = HalcyonController("Halcyon HC-7k");
    TRawDataRun run(repo.Namespace(), "html", "luz");
    run.Block("hc_RawData_Results_0.txt");
    const std::string page = WriteHalcyonPage(run);
    EXPECT_TRUE(Has(page, "WriteReportTitle(\"Halcyon\", \"\", \"\")")) << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"hc\", \"Halcyon\", true)")) << page;
    EXPECT_TRUE(run.log.Contains("TWriter::WriteHalcyonRReport -- Exception was thrown from WriteHalcyonRawDataReport"));
}

TEST(Halcyon, NoControllerNoPage) {
    for (const char* repository : {"", "class ORVSG_hcSCSIProtocolController",
                                   "ORVSG_hcSCSIProtocolController DeviceID=\"hc0\"\nclass ORVSG_hcLogicalDisk"}) {
        TRepoBuilder repo;
        repo.Parse(repository);
        TRawDataRun run(repo.Namespace(), "html", "luz");
        EXPECT_EQ("WriteIndexEntry(\"hc\", \"Halcyon\", false)\n", WriteHalcyonPage(run)) << repository;
    }
}

// An inventory back-end asked for the Halcyon page gets both Halcyon pages.
TEST(Halcyon, InventoryPageHoldsBothPages) {
    TRepoBuilder repo = HalcyonController("Halcyon HC-7k");
    repo.Parse("ORVSG_LogRecord_RAIDMgrEvent RecordID=\"1\" Message=\"Build/Verify started\"");
    testing::TRecordingWriter writer("inventory");
    TWriter::TContext context;
    context["pageID"] = NORVTKR20::TCIMValue(std::string("Halcyon"));
    TReport report(repo.Namespace(), context, "out");
    report.GetPage(&writer, context);
    EXPECT_EQ((std::vector<std::string>{"WriteIndexEntry(\"hc\", \"Halcyon\", true)",
                                        "WriteIndexEntry(\"halcyonlogs\", \"Halcyon Logs\", true)"}),
              writer.CallsStartingWith("WriteIndexEntry("));
}

TRepoBuilder HalcyonLogs(const std::string& firstMessage, bool eventLogs = true) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_LogRecord_RAIDMgrEvent RecordID=\"2\" MessageTimestamp=datetime:\"20240311120942.000000+060\" "
               "Severity=\"Error\" Message=\"" + firstMessage + "\"");
    repo.Parse(R"(
        ORVSG_LogRecord_RAIDMgrEvent RecordID="1" MessageTimestamp=datetime:"20240311081503.000000+060" Severity="Informational" Message="Build/Verify started"
        ORVSG_LogRecord_hcDDD RecordID="1" Controller="1" Channel="0" ID="3" Reason="Drive not responding"
        ORVSG_hcSCSIDeviceData InstanceID="b" ControllerNum=1 Channel=0 ScsiId=3 NumHardErrors="27"
        ORVSG_hcSCSIDeviceData InstanceID="a" ControllerNum=1 Channel=0 ScsiId=0 NumHardErrors="0"
        ORVSG_hcManagerRawData InstanceID="m0" Command="cat events.log" RawResults=string[]:"03/11/2024 12:09:42 defunct"
    )");
    if (eventLogs) {
        repo.Parse("ORVSG_LogRecord_HardEvent RecordID=\"1\" Description=\"Hardware error\"\n"
                   "ORVSG_LogRecord_SoftEvent RecordID=\"1\" Description=\"Recovered data\"");
    }
    return repo;
}

std::string WriteLogsPage(TRawDataRun& run) {
    run.writer.WriteHalcyonLogsReport(nullptr, "HalcyonLogs");
    return run.Transcript();
}

// In LUZ mode the page links to the manager's raw data and hands the hard
// and soft event logs to the back-end; see storage/halcyon-logs-luz.txt.
// Outside it neither log's class is fetched.
TEST(HalcyonLogs, EventLogsInLuzModeOnly) {
    {
        TRepoBuilder repo = HalcyonLogs("Physical device 0:3 is defunct");
        TRawDataRun run(repo.Namespace(), "text", "luz");
        const std::string page = WriteLogsPage(run);
        EXPECT_EQ(testing::ExpectedPage("storage/halcyon-logs-luz.txt", page), page);
    }
    TRepoBuilder repo = HalcyonLogs("Physical device 0:3 is defunct", false);
    TRawDataRun run(repo.Namespace(), "html", "default");
    const std::string page = WriteLogsPage(run);
    EXPECT_FALSE(Has(page, "WriteHalcyonEventLog"));
    EXPECT_FALSE(run.log.Contains("Exiting TWriter::WriteHalcyonLogsReport(4), ex.fStatusCode.fStatusCode=15"));
    EXPECT_TRUE(Has(page, "WriteReportTitle(\"Halcyon Logs\", \"\", \"\")"));
}

// A collector that found no RAID manager leaves one event saying so; the
// events table is left out and the others are written. An empty device
// table and a missing defunct log give no table.
TEST(HalcyonLogs, TablesLeftOutWithoutEvents) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_LogRecord_RAIDMgrEvent RecordID="1" Message="RAID Manager is not installed."
        ORVSG_LogRecord_RAIDMgrEvent RecordID="2" Message="RAID Manager is not installed."
        class ORVSG_hcSCSIDeviceData
        class ORVSG_LogRecord_HardEvent
    )");
    TRawDataRun run(repo.Namespace(), "html", "luz");
    const std::string page = WriteLogsPage(run);
    EXPECT_EQ(0u, LinesStartingWith(page, "WriteTableTitle(").size()) << page;
    EXPECT_FALSE(Has(page, "WriteHalcyonEventLog")) << page;
    EXPECT_TRUE(Has(page, "WriteIndexEntry(\"halcyonlogs\", \"Halcyon Logs\", false)")) << page;
    EXPECT_TRUE(run.log.Contains("Exiting TWriter::WriteHalcyonLogsReport(2), ex.fStatusCode.fStatusCode=15"));
    EXPECT_TRUE(run.log.Contains("Exiting TWriter::WriteHalcyonLogsReport(5), ex.fStatusCode.fStatusCode=15"));
    EXPECT_FALSE(run.log.Contains("Exiting TWriter::WriteHalcyonLogsReport(3), ex.fStatusCode.fStatusCode=15"));
}

TEST(HalcyonLogs, NoManagerClassNoPage) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_LogRecord_hcDDD RecordID=\"1\"");
    TRawDataRun run(repo.Namespace(), "html", "luz");
    EXPECT_EQ("WriteIndexEntry(\"halcyonlogs\", \"Halcyon Logs\", false)\n", WriteLogsPage(run));
}

}  // namespace
}  // namespace braigrion
