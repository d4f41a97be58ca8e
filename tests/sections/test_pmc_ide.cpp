// The pages "PMC RAID" and "LSI IDE Controller".
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

const char kSystem[] = "PMC_ControllerComputerSystem.Name=\"pmc0\"";

// One controller with its card, firmware (no driver or BIOS), and a volume
// over two extents, the first with its drive and package.
TRepoBuilder PMCController() {
    TRepoBuilder repo;
    repo.Parse(R"(
        PMC_ControllerComputerSystem Name="pmc0"
        PMC_ApplicationSoftwareIdentity InstanceID="app" Name="PMC Storage Manager" VersionString="2.06.00"
        PMC_Card Tag="card" Model="ASR-8805" Manufacturer="PMC-Sierra"
        PMC_FirmwareSoftwareIdentity InstanceID="fw" VersionString="7.5-0"
        PMC_StorageVolume DeviceID="ld0" RAIDLevel="RAID 1"
        PMC_StorageExtent DeviceID="pd0" Capacity="572325 MB"
        PMC_StorageExtent DeviceID="pd1" Capacity="572325 MB"
        PMC_DiskDrive DeviceID="dd0" ProductName="ST600MM0006"
        PMC_DiskDrivePhysicalPackage Tag="pkg0" Manufacturer="SEAGATE"
    )");
    Link(repo, "PMC_SystemPackaging", "PMC_Card.Tag=\"card\"", kSystem);
    Link(repo, "PMC_FirmwareElementSoftwareIdentity", "PMC_FirmwareSoftwareIdentity.InstanceID=\"fw\"", kSystem);
    Link(repo, "PMC_StorageVolumeSystemDevice", kSystem, "PMC_StorageVolume.DeviceID=\"ld0\"", "GroupComponent",
         "PartComponent");
    for (const char* extent : {"pd0", "pd1"})
        Link(repo, "PMC_StorageVolumeConcreteDependency", std::string("PMC_StorageExtent.DeviceID=\"") + extent + "\"",
             "PMC_StorageVolume.DeviceID=\"ld0\"");
    Link(repo, "PMC_MediaPresent", "PMC_DiskDrive.DeviceID=\"dd0\"", "PMC_StorageExtent.DeviceID=\"pd0\"");
    Link(repo, "PMC_DiskDriveRealizes", "PMC_DiskDrivePhysicalPackage.Tag=\"pkg0\"", "PMC_DiskDrive.DeviceID=\"dd0\"");
    return repo;
}

// Card, volume and extents have a title line and a caption, the software
// identities, drives and packages a caption only; tables nest under their
// volume and extent. See storage/pmc.txt.
TEST(PMC, ControllerPageAsExpected) {
    TRepoBuilder repo = PMCController();
    TRawDataRun run(repo.Namespace(), "html", "default");
    run.writer.WritePMCReport(nullptr, "PMCRAID");
    const std::string page = run.Transcript();
    EXPECT_EQ(testing::ExpectedPage("storage/pmc.txt", page), page);
}

// Without the provider's classes, or without a controller, the page is
// started and left: a title, no tables, no footer, an index entry without
// data.
TEST(PMC, PageStartedEvenWithoutData) {
    for (const char* repository : {"", "class PMC_ControllerComputerSystem\nclass PMC_ApplicationSoftwareIdentity",
                                   "PMC_ApplicationSoftwareIdentity Name=\"PMC Storage Manager\"\nclass PMC_ControllerComputerSystem"}) {
        TRepoBuilder repo;
        repo.Parse(repository);
        TRawDataRun run(repo.Namespace(), "html", "default");
        run.writer.WritePMCReport(nullptr, "PMCRAID");
        EXPECT_EQ("OpenPage(\"out/pmc\")\nWritePageHeader()\nWriteReportTitle(\"PMC RAID\", \"\", \"\")\n"
                  "WriteIndexEntry(\"pmc\", \"PMC RAID\", false)\n",
                  run.Transcript())
            << repository;
    }
}

const char kIDE[] = "ORVSG_LSIIDEProtocolController.DeviceID=\"ide0\"";

// A controller with a logical disk and a physical disk on channel 1 (with
// its firmware through the disk), and one without disks, which shows its
// configuration alone. See storage/lsi-ide.txt.
TEST(LSIIDE, ControllersAsExpected) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_LSIIDEProtocolController DeviceID="ide0" ControllerNum=0 ControllerType="LSI IDE RAID"
        ORVSG_LSIIDEProtocolController DeviceID="ide1" ControllerNum=1 ControllerType="LSI IDE RAID"
        ORVSG_LSIIDEBIOSElement InstanceID="bios" Version="2.1.0.52"
        ORVSG_LSIIDELogicalDisk DeviceID="v0" VolumeNumber="0" RAIDLevel="RAID 1"
        ORVSG_LSIIDEDiskDrive DeviceID="p1" Bus=1 DriveStatus="Online"
        ORVSG_LSIIDEFirmwareElement InstanceID="fw1" Version="05.01D05"
    )");
    Link(repo, "ORVSG_LSIIDEControllerBIOSElement", kIDE, "ORVSG_LSIIDEBIOSElement.InstanceID=\"bios\"");
    Link(repo, "ORVSG_LSIIDEProtocolControllerForUnit", kIDE, "ORVSG_LSIIDELogicalDisk.DeviceID=\"v0\"");
    Link(repo, "ORVSG_LSIIDEProtocolControllerForPhysicalDisk", kIDE, "ORVSG_LSIIDEDiskDrive.DeviceID=\"p1\"");
    Link(repo, "ORVSG_LSIIDEControllerFirmwareElement", "ORVSG_LSIIDEDiskDrive.DeviceID=\"p1\"",
         "ORVSG_LSIIDEFirmwareElement.InstanceID=\"fw1\"");
    TRawDataRun run(repo.Namespace(), "html", "default");
    run.writer.WriteLSIIDEReport(nullptr, "LSIIDEController");
    const std::string page = run.Transcript();
    EXPECT_EQ(testing::ExpectedPage("storage/lsi-ide.txt", page), page);
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"Channel #: 1\", false, false)"));
}

TEST(LSIIDE, NoClassNoPage) {
    TRepoBuilder repo;
    TRawDataRun run(repo.Namespace(), "html", "default");
    run.writer.WriteLSIIDEReport(nullptr, "LSIIDEController");
    EXPECT_EQ("WriteIndexEntry(\"lsiide\", \"LSI IDE Controller\", false)\n", run.Transcript());
    EXPECT_TRUE(run.log.Contains("Exiting TWriter::WriteLSIIDEReport, ex.fStatusCode.fStatusCode=15"));
}

}  // namespace
}  // namespace braigrion
