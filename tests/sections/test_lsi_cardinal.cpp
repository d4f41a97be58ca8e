// The page "LSI Controller" through the vendor's own provider: the choice of
// provider, the controller tables, the raw-data switch and the tables of
// SSDs that close the page.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/ExpectedPage.h"
#include "sections/StorageFixture.h"

namespace braigrion {
namespace {

using testing::Has;
using testing::LinesStartingWith;
using testing::Link;
using testing::Subclass;
using testing::TRawDataRun;
using testing::TRepoBuilder;
using NORVTKR20::TCIMContext;

const char kHBA[] = "LSIESG_MegaRAIDHBA.Name=\"hba0\"";
const char kIRSystem[] = "LSIESG_StorageSystem.Name=\"ir1\"";

// The classes whose presence makes the provider's data usable, without
// instances.
void DeclareProviderClasses(TRepoBuilder& repo) {
    repo.Parse(R"(
        class CIM_ComputerSystem
        class CIM_PhysicalPackage
        class LSIESG_DiskDrive
        class LSIESG_StorageVolume
        class LSIESG_DiskExtent
        class ORV_LSIRawData
        class LSIESG_ControllerFirmwareIdentity
        class LSIESG_ControllerBIOSIdentity
    )");
}

// Two controllers: a MegaRAID one on a SAS3108 chip with an enclosure
// package listed between its chip and a second chip, and an IR one whose
// first chip the provider could not name and whose second, a SAS2004, is
// sold as a product of its own. The MegaRAID controller has one volume
// over two drives; one drive has a physical drive without vendor, the other
// none at all.
void AddControllers(TRepoBuilder& repo) {
    Subclass(repo, "LSIESG_MegaRAIDHBA", "CIM_ComputerSystem");
    Subclass(repo, "LSIESG_StorageSystem", "CIM_ComputerSystem");
    Subclass(repo, "LSIESG_IntegratedRaidChip", "CIM_PhysicalPackage");
    Subclass(repo, "LSIESG_InitiatorTargetChip", "CIM_PhysicalPackage");
    Subclass(repo, "LSIESG_EnclosureChassis", "CIM_PhysicalPackage");
    repo.Parse(R"(
        LSIESG_MegaRAIDHBA Name="hba0" ElementName="MegaRAID SAS 9361-8i"
        LSIESG_StorageSystem Name="ir1" ElementName="SAS3008 IR"
        LSIESG_IntegratedRaidChip Tag="chip0" Model="SAS3108" PartNumber="L3-25413"
        LSIESG_EnclosureChassis Tag="encl0" Model="backplane"
        LSIESG_InitiatorTargetChip Tag="chip0b" Model="SAS3x28"
        LSIESG_IntegratedRaidChip Tag="chip1" Model="UNKNOWN" PartNumber="L3-NWD-BLP4-1600-B"
        LSIESG_IntegratedRaidChip Tag="chip2" Model="LSI SAS2004"
        LSIESG_IntegratedRaidProduct Name="SAS2004 ROMB"
        ORV_PCIeSSDWrapDriveInfo Name="wd0" BoardName="NWD-BLP4-1600"
        LSIESG_InitiatorTargetProduct Name="SAS3x28 expander product"
        LSIESG_ControllerBIOSIdentity InstanceID="b0" VersionString="6.36"
        LSIESG_StorageVolume DeviceID="v1" Name="VD 1"
        LSIESG_StorageVolume DeviceID="v0" Name="VD 0"
        LSIESG_StorageVolumeSetting InstanceID="s0" ElementName="RAID1"
        LSIESG_DiskExtent DeviceID="e1" Name="Extent 1"
        LSIESG_DiskExtent DeviceID="e0" Name="Extent 0"
        LSIESG_DiskDrive DeviceID="d1" Name="Drive 1"
        LSIESG_DiskDrive DeviceID="d0" Name="Drive 0"
        LSIESG_PhysicalDrive Tag="p0" FRUNumber="FRU-0" Vendor="" Manufacturer="HGST"
    )");
    Link(repo, "LSIESG_SystemPackaging", "LSIESG_IntegratedRaidChip.Tag=\"chip0\"", kHBA);
    Link(repo, "LSIESG_SystemPackaging", "LSIESG_EnclosureChassis.Tag=\"encl0\"", kHBA);
    Link(repo, "LSIESG_SystemPackaging", "LSIESG_InitiatorTargetChip.Tag=\"chip0b\"", kHBA);
    Link(repo, "LSIESG_ProductPhysicalComponent", "LSIESG_InitiatorTargetProduct.Name=\"SAS3x28 expander product\"",
         "LSIESG_InitiatorTargetChip.Tag=\"chip0b\"");
    Link(repo, "LSIESG_SystemPackaging", "LSIESG_IntegratedRaidChip.Tag=\"chip1\"", kIRSystem);
    Link(repo, "LSIESG_SystemPackaging", "LSIESG_IntegratedRaidChip.Tag=\"chip2\"", kIRSystem);
    Link(repo, "LSIESG_ProductPhysicalComponent", "LSIESG_IntegratedRaidProduct.Name=\"SAS2004 ROMB\"",
         "LSIESG_IntegratedRaidChip.Tag=\"chip2\"");
    Link(repo, "LSIESG_ElementSoftwareIdentity", "LSIESG_ControllerBIOSIdentity.InstanceID=\"b0\"", kHBA);
    for (const char* volume : {"LSIESG_StorageVolume.DeviceID=\"v1\"", "LSIESG_StorageVolume.DeviceID=\"v0\""})
        Link(repo, "LSIESG_SystemDevice", kHBA, volume, "GroupComponent", "PartComponent");
    Link(repo, "LSIESG_ElementSettingData", "LSIESG_StorageVolume.DeviceID=\"v0\"",
         "LSIESG_StorageVolumeSetting.InstanceID=\"s0\"", "ManagedElement", "SettingData");
    for (const char* extent : {"LSIESG_DiskExtent.DeviceID=\"e1\"", "LSIESG_DiskExtent.DeviceID=\"e0\""})
        Link(repo, "LSIESG_ConcreteDependency", extent, "LSIESG_StorageVolume.DeviceID=\"v0\"");
    for (const char* drive : {"LSIESG_DiskDrive.DeviceID=\"d1\"", "LSIESG_DiskDrive.DeviceID=\"d0\""})
        Link(repo, "LSIESG_SystemDevice", kHBA, drive, "GroupComponent", "PartComponent");
    Link(repo, "LSIESG_MediaPresent", "LSIESG_DiskDrive.DeviceID=\"d0\"", "LSIESG_DiskExtent.DeviceID=\"e0\"");
    Link(repo, "LSIESG_Realizes", "LSIESG_PhysicalDrive.Tag=\"p0\"", "LSIESG_DiskDrive.DeviceID=\"d0\"");
}

std::string WriteLSIPage(TRawDataRun& run) {
    run.writer.WriteLSIReport(nullptr, "LSIController");
    return run.Transcript();
}

TEST(LSIProvider, CardinalNeedsItsClassesAndOneInstance) {
    struct TCase {
        const char* name;
        bool declareAll;
        const char* extra;
        bool cardinal;
    } cases[] = {
        {"classes without instances", true, "", false},
        {"a drive", true, "LSIESG_DiskDrive DeviceID=\"d0\"", true},
        {"raw data only", true, "ORV_LSIRawData Command=\"storcli /c0 show\"", true},
        {"a controller system is not enough", true, "CIM_ComputerSystem Name=\"x\"", false},
        {"one class missing", false, "LSIESG_DiskDrive DeviceID=\"d0\"", false},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        if (c.declareAll) {
            DeclareProviderClasses(repo);
        } else {
            repo.Parse("class CIM_ComputerSystem\nclass CIM_PhysicalPackage");
        }
        repo.Parse(c.extra);
        TRawDataRun run(repo.Namespace(), "html", "default");
        EXPECT_EQ(c.cardinal, run.writer.isCardinalSupport()) << c.name;
        WriteLSIPage(run);
        EXPECT_EQ(c.cardinal, run.log.Contains("TWriter::WriteLSIReport -- Cardinal support is ok, invoke "
                                                "WriteLSIReportWithCardinal"))
            << c.name;
    }
}

// The controller tables of both systems, the enclosure between the chips
// passed over; the MegaRAID system's two chips each get a controller table
// but its drives are listed once; the drive without physical drive has
// empty origin cells. See storage/lsi-cardinal.txt.
TEST(LSICardinal, ControllerTablesAsExpected) {
    TRepoBuilder repo;
    DeclareProviderClasses(repo);
    AddControllers(repo);
    TRawDataRun run(repo.Namespace(), "html", "default");
    const std::string page = WriteLSIPage(run);
    EXPECT_EQ(testing::ExpectedPage("storage/lsi-cardinal.txt", page), page);
    EXPECT_EQ(4u, LinesStartingWith(page, "WriteTableTitle(\"Controller Information\"").size());
    EXPECT_TRUE(Has(page, "WriteValueCell(<instance LSIESG_IntegratedRaidProduct.Name=\"SAS2004 ROMB\">, {Name"));
    EXPECT_EQ(1u, LinesStartingWith(page, "WriteTableTitle(\"Physical drive information\"").size());
    EXPECT_TRUE(run.log.Contains(
        "TWriter::WriteLSIReportWithCardinal -- Current card is an MR controller, write Package Build vesrion "));
    EXPECT_TRUE(run.log.Contains(
        "TWriter::WriteLSIReportWithCardinal -- Current card is an IR controller, no Package Build vesrion "));
}

// A drive without a physical drive borrows FRU number and manufacturer from
// the legacy collector's drive at its own position in the name order, when
// the legacy list reaches that far.
TEST(LSICardinal, DriveWithoutPhysicalDriveBorrowsFromTheLegacyList) {
    struct TCase {
        int legacyDrives;
        const char* fruCell;
    } cases[] = {
        {0, "WriteValueCell(<instance LSIESG_DiskDrive.DeviceID=\"d1\",Name=\"Drive 1\">, {FRUNumber width=\"0%\" "
            "assoc=\"LSIESG_Realizes\""},
        {1, "WriteValueCell(<instance LSIESG_DiskDrive.DeviceID=\"d1\",Name=\"Drive 1\">, {FRUNumber width=\"0%\" "
            "assoc=\"LSIESG_Realizes\""},
        {2, "WriteValueCell(<instance ORVSG_MegaLSIDiskDrive.DeviceID=\"m1\",ORVFruCru=\"FRU-m1\">, {ORVFruCru"},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        DeclareProviderClasses(repo);
        AddControllers(repo);
        for (int i = 0; i < c.legacyDrives; ++i) {
            const std::string id = "m" + std::to_string(i);
            repo.Parse("ORVSG_MegaLSIDiskDrive DeviceID=\"" + id + "\" ORVFruCru=\"FRU-" + id + "\"");
        }
        TRawDataRun run(repo.Namespace(), "html", "default");
        const std::string page = WriteLSIPage(run);
        EXPECT_TRUE(Has(page, c.fruCell)) << c.legacyDrives;
        // The drive with a physical drive never borrows.
        EXPECT_FALSE(Has(page, "ORVSG_MegaLSIDiskDrive.DeviceID=\"m0\"")) << c.legacyDrives;
    }
}

// A chip the provider calls "UNKNOWN" takes the name of the flash board its
// part number holds, in the repository, so later pages see it too.
TEST(LSICardinal, UnknownChipTakesItsBoardName) {
    TRepoBuilder repo;
    DeclareProviderClasses(repo);
    AddControllers(repo);
    TRawDataRun run(repo.Namespace(), "html", "default");
    WriteLSIPage(run);
    const auto chips = testrepo::All(*repo.Namespace(), "LSIESG_IntegratedRaidChip");
    ASSERT_EQ(3u, chips.size());
    EXPECT_EQ("SAS3108", chips[0]->GetProperty("Model", TCIMContext())->GetValue().ToString(10));
    EXPECT_EQ("NWD-BLP4-1600", chips[1]->GetProperty("Model", TCIMContext())->GetValue().ToString(10));
}

// The raw-data switch: in LUZ mode with an HTML writer a raw page puts its
// link into the title and stands for the controllers, so the page says no
// "No LSI RAID card detected" even without any.
TEST(LSICardinal, RawDataSwitchInLuzModeOnly) {
    struct TCase {
        const char* writerType;
        const char* mode;
        bool link;
    } cases[] = {
        {"html", "luz", true},
        {"html", "default", false},
        {"text", "luz", false},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        DeclareProviderClasses(repo);
        repo.Parse("ORV_LSIRawData ControllerNumber=0 Utility=\"storcli64\" Command=\"storcli64 /c0 show\" "
                   "CommandResult=\"Controller = 0\"");
        TRawDataRun run(repo.Namespace(), c.writerType, c.mode);
        const std::string page = WriteLSIPage(run);
        const std::string title = LinesStartingWith(page, "WriteReportTitle(\"LSI Controller\"").at(0);
        EXPECT_EQ(c.link, Has(title, "lsi_rawData")) << c.writerType << " " << c.mode << ": " << title;
        EXPECT_EQ(!c.link, Has(page, "No LSI RAID card detected")) << c.writerType << " " << c.mode;
        EXPECT_EQ(c.link, Has(page, "WriteIndexEntry(\"lsi_mir\", \"LSI Controller\", true)"))
            << c.writerType << " " << c.mode;
    }
}

// A server with only an LSI 1030 chip and no package class gets the 1030
// report and the message that no RAID card was found.
TEST(LSICardinal, Only1030ChipGetsItsReportAndTheMessage) {
    TRepoBuilder repo;
    repo.Parse(R"(
        class CIM_ComputerSystem
        class LSIESG_DiskDrive
        class LSIESG_StorageVolume
        class LSIESG_DiskExtent
        class ORV_LSIRawData
        class LSIESG_ControllerFirmwareIdentity
        LSIESG_ControllerBIOSIdentity InstanceID="b0"
        ORVSG_LSISCSIProtocolController DeviceID="c0" ControllerNum=0 ControllerType="LSI 53C1030"
    )");
    TRawDataRun run(repo.Namespace(), "html", "default");
    // Without the package class the provider is not used...
    EXPECT_FALSE(run.writer.isCardinalSupport());
    // ...but its page, asked directly, still shows the chip.
    run.writer.WriteLSIReportWithCardinal(nullptr, "LSIController");
    const std::string page = run.Transcript();
    EXPECT_TRUE(Has(page, "WriteTableTitle(\"Controller Information\", false, false)")) << page;
    EXPECT_TRUE(Has(page, "No LSI RAID card detected")) << page;
    EXPECT_TRUE(run.log.Contains("TWriter::WriteLSIIntegratedRaidReport -- No major class found"));
}

// The SSD tables close the page whichever provider fed it; each counts as
// data of the page. Without their classes nothing is written for them.
TEST(LSISSDTables, WrittenWhenTheirClassesHoldInstances) {
    struct TCase {
        const char* repository;
        bool warranty, adapter, hasData;
    } cases[] = {
        {"", false, false, false},
        {"ORV_SSDWarrantyInfo SSDID=\"252:6\" SSDPercentOfLifeRe=\"96%\"", true, false, true},
        {"ORV_PCIeSSDWrapDriveInfo Name=\"wd0\" BoardName=\"NWD-BLP4-1600\"", false, true, true},
        {"class ORV_SSDWarrantyInfo", false, false, false},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TRawDataRun run(repo.Namespace(), "html", "default");
        EXPECT_EQ(c.warranty, run.writer.WriteSSDWarrantyInfoReport()) << c.repository;
        EXPECT_EQ(c.adapter, run.writer.WriteLSIPCIeSSDReport()) << c.repository;
        const std::string tables = run.Transcript();
        EXPECT_EQ(c.warranty, Has(tables, "WriteTableTitle(\"SSD Warranty Information\"")) << c.repository;
        EXPECT_EQ(c.adapter, Has(tables, "WriteTableTitle(\"LSI PCIe SLC/MLC Adapter Information\""))
            << c.repository;
        // Each table block ends with a footer of its own.
        EXPECT_EQ(static_cast<size_t>(c.warranty + c.adapter), LinesStartingWith(tables, "WritePageFooter").size());
        run.writer.Clear();
        const std::string page = WriteLSIPage(run);
        EXPECT_TRUE(Has(page, std::string("WriteIndexEntry(\"lsi_mir\", \"LSI Controller\", ") +
                                  (c.hasData ? "true" : "false") + ")"))
            << c.repository;
    }
}

}  // namespace
}  // namespace braigrion
