// The page "LSI Controller" from the legacy collectors: integrated RAID
// controllers with their status, logical and physical drives and
// enclosures, MegaRAID controllers with their firmware package, and the
// LSI 1030 report.
#include <string>

#include <gtest/gtest.h>

#include "report/ExpectedPage.h"
#include "sections/StorageFixture.h"

namespace braigrion {
namespace {

using testing::Has;
using testing::LinesStartingWith;
using testing::Link;
using testing::TRawDataRun;
using testing::TRepoBuilder;

const char kController[] = "ORVSG_LSISCSIProtocolController.DeviceID=\"c0\"";

// An IR controller of `type` with `operation`, one logical drive, and four
// devices: a disk on bus 0, an enclosure device (type 13), a disk on bus 1
// and one more on bus 1.
TRepoBuilder IRController(int type, const std::string& operation) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_LSISCSIProtocolController DeviceID=\"c0\" ControllerNum=0 ControllerType=\"LSI SAS2008\" "
               "LSIType=uint8:" + std::to_string(type) +
               (operation.empty() ? std::string() : " CurrentOperation=\"" + operation + "\""));
    repo.Parse(R"(
        ORVSG_LSIBIOSElement InstanceID="bios" Version="7.39"
        ORVSG_LSILogicalDisk DeviceID="v0" VolumeNumber="0" RAIDLevel="RAID 1"
        ORVSG_LSIDiskDrive DeviceID="d0" DeviceType=uint16:14 Bus=0 ChannelNum=0 TargetID="9"
        ORVSG_LSIDiskDrive DeviceID="e0" DeviceType=uint16:13 Bus=0 ChannelNum=0 TargetID="31"
        ORVSG_LSIDiskDrive DeviceID="d1" DeviceType=uint16:14 Bus=1 ChannelNum=1 TargetID="12"
        ORVSG_LSIDiskDrive DeviceID="d2" DeviceType=uint16:14 Bus=1 ChannelNum=1 TargetID="13"
        ORVSG_LSIEnclosureInformation InstanceID="encl1" EnclosureNum="1" Numslots="8"
    )");
    Link(repo, "ORVSG_LSIControllerBIOSElement", kController, "ORVSG_LSIBIOSElement.InstanceID=\"bios\"");
    Link(repo, "ORVSG_LSIProtocolControllerForUnit", kController, "ORVSG_LSILogicalDisk.DeviceID=\"v0\"");
    for (const char* disk : {"d0", "e0", "d1", "d2"}) {
        Link(repo, "ORVSG_LSIProtocolControllerForPhysicalDisk", kController,
             std::string("ORVSG_LSIDiskDrive.DeviceID=\"") + disk + "\"");
    }
    return repo;
}

std::string WriteLegacyPage(TRawDataRun& run) {
    run.writer.WriteLSIReportWithLegacyProvider(nullptr, "LSIController");
    return run.Transcript();
}

// A SAS controller (type 3) mid-resync: status with progress, volume ids,
// enclosure table; the enclosure device has no table, and the second
// channel is named inside the first table of its disks. See
// storage/lsi-legacy-ir.txt.
TEST(LSILegacy, IntegratedRaidControllerAsExpected) {
    TRepoBuilder repo = IRController(3, "Resync");
    TRawDataRun run(repo.Namespace(), "html", "default");
    const std::string page = WriteLegacyPage(run);
    EXPECT_EQ(testing::ExpectedPage("storage/lsi-legacy-ir.txt", page), page);
    EXPECT_TRUE(run.log.Contains("TWriter::WriteLSIIntegratedRaidReport -- Filter instance which type is not hard disk"));
}

// The status table follows the current operation: none without one, three
// progress rows fewer when it is "None"; the channel title before the first
// disk only with LSIType 0; enclosures and volume ids only with type 3.
TEST(LSILegacy, StatusChannelAndEnclosureRulesFollowTheController) {
    struct TCase {
        int type;
        const char* operation;
        size_t statusTables, progressRows, channelTitles, enclosureTables, volumeIdRows;
    } cases[] = {
        {3, "Resync", 1, 1, 1, 1, 2},
        {3, "None", 1, 0, 1, 1, 2},
        {3, "", 0, 0, 1, 1, 1},
        {0, "None", 1, 0, 2, 0, 0},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo = IRController(c.type, c.operation);
        TRawDataRun run(repo.Namespace(), "html", "default");
        const std::string page = WriteLegacyPage(run);
        const std::string what = std::to_string(c.type) + " \"" + c.operation + "\"";
        EXPECT_EQ(c.statusTables, LinesStartingWith(page, "WriteTableTitle(\"Controller Status\"").size()) << what;
        EXPECT_EQ(c.progressRows,
                  LinesStartingWith(page, "WriteHeaderCell(<class ORVSG_LSISCSIProtocolController>, {PercentComplete")
                      .size())
            << what;
        EXPECT_EQ(c.channelTitles, LinesStartingWith(page, "WriteTableTitle(\"Channel #: ").size()) << what;
        EXPECT_EQ(c.enclosureTables, LinesStartingWith(page, "WriteTableTitle(\"Enclosure Information\"").size())
            << what;
        EXPECT_EQ(c.volumeIdRows, LinesStartingWith(page, "WriteHeaderCell(<class ORVSG_LSISCSIProtocolController>, "
                                                          "{VolumeID")
                                          .size() +
                                      LinesStartingWith(page, "WriteHeaderCell(<class ORVSG_LSILogicalDisk>, {VolumeID")
                                          .size())
            << what;
        // Three hard disks of four devices.
        EXPECT_EQ(3u, LinesStartingWith(page, "StartPropertyTable(\"50%\", \"40%\", \"Controller #0 Configuration -- "
                                              "Physical device information\")")
                          .size())
            << what;
    }
}

// An MR-only server: the IR report finds no controller and says so, the MR
// report finds one; no message. The firmware package of controller 1 also
// matches an element of controller 11. See storage/lsi-legacy-mr.txt.
TEST(LSILegacy, MegaRaidOnlyServerHasNoMessage) {
    TRepoBuilder repo;
    repo.Parse(R"(
        class ORVSG_LSISCSIProtocolController
        ORVSG_MegaLSISCSIProtocolController DeviceID="m1" ControllerNum=1 ControllerType="MegaRAID SAS 9260-8i"
        ORVSG_MegaLSIFWPackageBuildFirmwareElement SoftwareElementID="package 1" Version="12.15.0-0239"
        ORVSG_MegaLSIFWPackageBuildFirmwareElement SoftwareElementID="package 11" Version="12.15.0-0300"
        ORVSG_MegaLSIFWPackageBuildFirmwareElement SoftwareElementID="package 2" Version="12.15.0-0400"
        ORVSG_MegaLSIDiskDrive DeviceID="md0" ModelNumber="ST2000NM0023" State="Failed"
    )");
    Link(repo, "ORVSG_MegaLSIProtocolControllerForPhysicalDisk", "ORVSG_MegaLSISCSIProtocolController.DeviceID=\"m1\"",
         "ORVSG_MegaLSIDiskDrive.DeviceID=\"md0\"");
    TRawDataRun run(repo.Namespace(), "html", "default");
    const std::string page = WriteLegacyPage(run);
    EXPECT_EQ(testing::ExpectedPage("storage/lsi-legacy-mr.txt", page), page);
    EXPECT_TRUE(run.log.Contains(
        "TWriter::WriteLSIIntegratedRaidReport --no instance of ORVSG_LSISCSIProtocolController found"));
    EXPECT_FALSE(Has(page, "No LSI RAID card detected"));
}

// The MegaRAID tool's raw data brings the raw-data switch in any mode, the
// other tools' only in LUZ mode; never for a writer other than HTML.
TEST(LSILegacy, RawDataSwitch) {
    struct TCase {
        const char* repository;
        const char* writerType;
        const char* mode;
        bool link;
    } cases[] = {
        {"ORVSG_MegaLSIRawData Command=\"MegaCli -AdpAllInfo -aALL\" RawResults=string[]:\"Adapter #0\"", "html",
         "default", true},
        {"ORVSG_lsiRawData Command=\"lsiutil -p1 -a 21\" RawResults=string[]:\"Adapter\"", "html", "default", false},
        {"ORVSG_lsiRawData Command=\"lsiutil -p1 -a 21\" RawResults=string[]:\"Adapter\"", "html", "luz", true},
        {"ORVSG_MegaLSIRawData Command=\"MegaCli -AdpAllInfo -aALL\" RawResults=string[]:\"Adapter #0\"", "text",
         "luz", false},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TRawDataRun run(repo.Namespace(), c.writerType, c.mode);
        const std::string page = WriteLegacyPage(run);
        const std::string what = std::string(c.repository) + " " + c.writerType + " " + c.mode;
        EXPECT_EQ(c.link, Has(page, "WriteReportTitle(\"LSI Controller\", \" - [Show Rawdata Report]\", "
                                    "\"lsi_rawData\")"))
            << what;
        EXPECT_EQ(!c.link, Has(page, "No LSI RAID card detected")) << what;
    }
}

// The 1030 report takes only 1030 chips, always names the channel, has no
// FRU row and joins its captions without a blank.
TEST(LSILegacy, Report1030) {
    TRepoBuilder repo = IRController(3, "Resync");
    repo.Parse("ORVSG_LSISCSIProtocolController DeviceID=\"c1\" ControllerNum=1 ControllerType=\"LSI 53C1030\" "
               "LSIType=uint8:3 CurrentOperation=\"None\"");
    Link(repo, "ORVSG_LSIProtocolControllerForPhysicalDisk", "ORVSG_LSISCSIProtocolController.DeviceID=\"c1\"",
         "ORVSG_LSIDiskDrive.DeviceID=\"d0\"");
    TRawDataRun run(repo.Namespace(), "html", "default");
    EXPECT_TRUE(run.writer.isLSIIntegratedRaid1030Exsited());
    run.writer.WriteLSIIntegratedRaid1030Report();
    const std::string page = run.Transcript();
    EXPECT_EQ(testing::ExpectedPage("storage/lsi-1030.txt", page), page);
}

// The report from the vendor classes joined by identifiers: the card,
// BIOS and RAID level are those whose ids hold the port's or the pool's id,
// not their neighbours'; a drive without matching extent shows empty size
// cells. Without the card class nothing is written.
TEST(LSIMegaRaidByIdentifiers, JoinsByTheIdsTheyHold) {
    TRepoBuilder repo;
    repo.Parse(R"(
        LSIESG_MegaRAIDHBA Name="hba0"
        LSIESG_DAPort InstanceID="500605B0:0"
        LSIESG_PhysicalCard Tag="other card" Model="wrong"
        LSIESG_PhysicalCard Tag="card 500605B0:0" Model="MegaRAID SAS 9361-8i"
        LSIESG_ControllerBIOSIdentity InstanceID="BIOS 500605B0:0" VersionString="6.36"
        LSIESG_StoragePool InstanceID="pool 1" ElementName="DG 1"
        LSIESG_StorageVolumeSetting InstanceID="setting pool 2" ElementName="RAID0"
        LSIESG_StorageVolumeSetting InstanceID="setting pool 1" ElementName="RAID5"
        LSIESG_DiskExtent DeviceID="extent 252:3" ExtentStatus=uint16:2
        LSIESG_DiskDrive DeviceID="252:4" Name="Drive 252:4"
    )");
    const std::string hba = "LSIESG_MegaRAIDHBA.Name=\"hba0\"";
    Link(repo, "LSIESG_SystemDevice", hba, "LSIESG_DAPort.InstanceID=\"500605B0:0\"", "GroupComponent",
         "PartComponent");
    Link(repo, "LSIESG_HostedStoragePool", hba, "LSIESG_StoragePool.InstanceID=\"pool 1\"", "GroupComponent",
         "PartComponent");
    Link(repo, "LSIESG_MemberOfCollection", "LSIESG_StoragePool.InstanceID=\"pool 1\"",
         "LSIESG_DiskExtent.DeviceID=\"extent 252:3\"", "Collection", "Member");
    Link(repo, "LSIESG_SystemDevice", hba, "LSIESG_DiskDrive.DeviceID=\"252:4\"", "GroupComponent", "PartComponent");
    TRawDataRun run(repo.Namespace(), "html", "default");
    bool noCard = true;
    run.writer.WriteLSIMegaRaidReport(noCard);
    const std::string page = run.Transcript();
    EXPECT_FALSE(noCard);
    EXPECT_EQ(testing::ExpectedPage("storage/lsi-megaraid-by-ids.txt", page), page);

    TRepoBuilder withoutCards;
    withoutCards.Parse("LSIESG_MegaRAIDHBA Name=\"hba0\"");
    TRawDataRun empty(withoutCards.Namespace(), "html", "default");
    noCard = true;
    empty.writer.WriteLSIMegaRaidReport(noCard);
    EXPECT_TRUE(noCard);
    EXPECT_EQ("", empty.Transcript());
    EXPECT_TRUE(empty.log.Contains("TWriter::WriteLSIMegaRaidReport -- raidCSClass = NULL && raidCardClass = NULL"));
}

}  // namespace
}  // namespace braigrion
