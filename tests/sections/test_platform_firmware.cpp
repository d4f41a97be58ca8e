// The "Firmware/VPD" page: the merged firmware and BIOS tables, the VPD
// tables, and the rows the LSI Cardinal provider replaces. Whole pages are
// compared with tests/fixtures/pages/platform/.
#include <string>

#include <gtest/gtest.h>

#include "report/EngineFixture.h"
#include "report/ExpectedPage.h"
#include "sections/PlatformRepo.h"

namespace braigrion {
namespace {

using testing::TEngineRun;
using testing::TPlatformRepo;

const char kOneNode[] = "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:1\n";
const char kTwoNodes[] = "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:2\n";

std::string WriteFirmwarePage(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns) {
    TEngineRun<> run(ns);
    run.writer.WriteCustomFirmwareReport(boost::make_shared<TReportParametersBuilder>(ns, "default", false), "");
    return run.Transcript();
}

// Firmware elements and every vendor class the page merges, none of them
// from the Cardinal provider.
TPlatformRepo VendorFirmware(const std::string& nodes) {
    TPlatformRepo repo;
    repo.Keyed("CIM_BIOSElement").Keyed("EMXCNA_BIOSVersion", "CIM_BIOSElement");
    repo.Keyed("BROCADE_PortController").Keyed("BROCADE_AdapterSoftwareIdentity");
    repo.Parse(nodes + R"(
        ORVSG_FirmwareElement Name="UEFI Diagnostics" Manufacturer="Norvane" Version="4.10" BuildNumber="DGN389"
        ORVSG_FirmwareElement Name="Baseboard Management Controller" Manufacturer="Norvane" Version="2.80"
        CIM_BIOSElement Id="uefi" Name="System UEFI" Version="2.31" BuildNumber="TSE148" SourceNode="Node 1"
        EMXCNA_BIOSVersion Id="oce" Name="OneConnect Boot BIOS" Version="11.2"
        BROCADE_PortController Id="port0"
        BROCADE_AdapterSoftwareIdentity Id="fw" Description="Adapter Firmware" Manufacturer="Brocade" VersionString="3.2.5.1"
        BROCADE_AdapterSoftwareIdentity Id="bios" Description="Adapter BIOS" BuildNumber="77" VersionString="3.2.5.0"
        EMXCNA_FirmwareVersion Name="OneConnect OCe14102" Version="11.2.1153.23"
        MLNX_FirmwareIdentity Name="ConnectX-4 Lx" Manufacturer="Mellanox" InstanceID="mt4117" VersionString="14.28.2006" BuildNumber="2006"
        FIO_SoftwareIdentity Name="ioDrive2" ElementName="ioDrive2 Firmware" Manufacturer="Fusion-io" VersionString="7.1.17"
        FIO_SoftwareIdentity Name="ioMemory VSL" ElementName="ioMemory VSL driver" VersionString="3.2.16"
        PMC_FirmwareSoftwareIdentity InstanceID="ctrl0" VersionString="3.00.16"
        PMC_BiosSoftwareIdentity InstanceID="ctrl0" VersionString="1.04"
        ORVSG_PostBIOSVPD BuildNumber="PB12" Version="1.2" Filename="postbios.bin" UniqueID="PB-1"
        ORVSG_DiagnosticVPD BuildNumber="DGN389" SourceNode="Node 1"
        ORVSG_FRU Name="Power Supply 10" Vendor="Norvane" FRUNumber="94Y8118"
        ORVSG_FRU Name="Backplane" Vendor="Norvane" FRUNumber="00AM512"
        ORVSG_FRU Name="Power Supply 2" Vendor="Norvane" FRUNumber="94Y8118"
    )");
    repo.Link("BROCADE_AdapterElementSoftwareIdentity", "BROCADE_PortController:port0",
              "BROCADE_AdapterSoftwareIdentity:fw");
    repo.Link("BROCADE_AdapterElementSoftwareIdentity", "BROCADE_PortController:port0",
              "BROCADE_AdapterSoftwareIdentity:bios");
    return repo;
}

// Vendor rows follow the sorted firmware elements in a fixed order; the
// converged adapter's BIOS and Fusion-io's driver stay out; PMC's firmware
// row has one cell more than the header and its BIOS row no node cell. A
// multi-node system adds the node column to the BIOS and diagnostic tables.
TEST(FirmwarePage, MergesEveryVendorIntoTheSharedTables) {
    const std::string single = WriteFirmwarePage(VendorFirmware(kOneNode).Namespace());
    const std::string multi = WriteFirmwarePage(VendorFirmware(kTwoNodes).Namespace());
    EXPECT_EQ(testing::ExpectedPage("platform/firmware-merged.txt", single), single);
    EXPECT_EQ(testing::ExpectedPage("platform/firmware-merged-multinode.txt", multi), multi);
}

// Without firmware elements and BIOS elements the vendors' rows have no
// table to join; with no table at all the index says the page is empty.
TEST(FirmwarePage, VendorRowsNeedTheirTable) {
    TPlatformRepo repo;
    repo.Parse(R"(
        MLNX_FirmwareIdentity Name="ConnectX-4 Lx" VersionString="14.28.2006"
        PMC_FirmwareSoftwareIdentity InstanceID="ctrl0" VersionString="3.00.16"
        PMC_BiosSoftwareIdentity InstanceID="ctrl0" VersionString="1.04"
        class ORVSG_FirmwareElement
    )");
    const std::string page = WriteFirmwarePage(repo.Namespace());
    EXPECT_EQ(std::string::npos, page.find("StartRow")) << page;
    EXPECT_NE(std::string::npos, page.find("WriteIndexEntry(\"firmware\", \"Firmware/VPD\", false)")) << page;
}

// A server whose LSI controllers the Cardinal provider reports: a MegaRAID
// controller with a drive, a package build and an enclosure, an IR
// controller whose model is "UNKNOWN", and the legacy elements (controller
// and drive firmware) of a 1030 controller (kept) and of a SAS controller
// (replaced).
TPlatformRepo CardinalServer() {
    TPlatformRepo repo;
    repo.Keyed("ORVSG_FirmwareElement").Keyed("ORVSG_LSIFirmwareElement", "ORVSG_FirmwareElement");
    repo.Keyed("CIM_BIOSElement").Keyed("ORVSG_LSIBIOSElement", "CIM_BIOSElement");
    repo.Keyed("ORVSG_LSIDiskFirmwareElement", "ORVSG_FirmwareElement").Keyed("ORVSG_LSIDiskDrive");
    repo.Keyed("ORVSG_LSISCSIProtocolController");
    repo.Keyed("CIM_ComputerSystem").Keyed("LSIESG_MegaRAIDHBA", "CIM_ComputerSystem");
    repo.Keyed("LSIESG_IRController", "CIM_ComputerSystem");
    repo.Keyed("CIM_PhysicalPackage").Keyed("LSIESG_PhysicalCard", "CIM_PhysicalPackage");
    repo.Keyed("LSIESG_EnclosureChassis", "CIM_PhysicalPackage");
    repo.Keyed("LSIESG_DiskDrive").Keyed("LSIESG_ControllerFirmwareIdentity").Keyed("LSIESG_ControllerBIOSIdentity");
    repo.Keyed("LSIESG_DriveFirmwareIdentity").Keyed("LSIESG_FirmwarePackageIdentity");
    repo.Parse(std::string(kOneNode) + R"(
        class LSIESG_StorageVolume
        class LSIESG_DiskExtent
        class ORV_LSIRawData
        ORVSG_FirmwareElement Id="bmc" Name="Baseboard Management Controller" Version="2.80"
        ORVSG_LSIFirmwareElement Id="old1030" Name="LSI 53C1030 Firmware" Version="1.03.39"
        ORVSG_LSIFirmwareElement Id="oldsas" Name="LSI SAS3008 Firmware" Version="16.00.01"
        ORVSG_LSIBIOSElement Id="oldbios" Name="LSI SAS3008 BIOS" Version="8.37"
        ORVSG_LSIDiskFirmwareElement Id="disk1030" Name="LSI Disk Firmware, 1030 bus" Version="HPD4"
        ORVSG_LSIDiskFirmwareElement Id="disksas" Name="LSI Disk Firmware, SAS bus" Version="N003"
        ORVSG_LSIDiskDrive Id="pd1030"
        ORVSG_LSIDiskDrive Id="pdsas"
        CIM_BIOSElement Id="uefi" Name="System UEFI" Version="2.31"
        ORVSG_LSISCSIProtocolController Id="c1030" ControllerType="LSI 53C1030"
        ORVSG_LSISCSIProtocolController Id="c3008" ControllerType="SAS3008 IR"
        LSIESG_MegaRAIDHBA Id="mr0" ElementName="MegaRAID SAS 9460-16i"
        LSIESG_IRController Id="ir0" ElementName="SAS3008 IR"
        LSIESG_PhysicalCard Id="card0" Model="9460-16i" PartNumber="03-50077-00"
        LSIESG_PhysicalCard Id="card1" Model="UNKNOWN" PartNumber="L3-25413-04C"
        LSIESG_EnclosureChassis Id="enc0" Name="Enclosure 1"
        ORV_PCIeSSDWrapDriveInfo BoardName="Nytro WarpDrive"
        LSIESG_ControllerFirmwareIdentity Id="cf0" Manufacturer="LSI" VersionString="50.6.3-0109" BuildNumber="2018"
        LSIESG_ControllerBIOSIdentity Id="cb0" BuildNumber="B7" VersionString="7.06.02.0" ReleaseDate="2018-06-01"
        LSIESG_FirmwarePackageIdentity Id="pk0" Manufacturer="LSI" VersionString="51.6.0-1990" BuildNumber="P1"
        LSIESG_DiskDrive Id="d0" Name="Drive 0:0"
        LSIESG_DriveFirmwareIdentity Id="df0" Manufacturer="SEAGATE" VersionString="N003" BuildNumber="N003"
    )");
    repo.Link("ORVSG_LSIControllerFirmwareElement", "ORVSG_LSIFirmwareElement:old1030",
              "ORVSG_LSISCSIProtocolController:c1030");
    repo.Link("ORVSG_LSIControllerFirmwareElement", "ORVSG_LSIFirmwareElement:oldsas",
              "ORVSG_LSISCSIProtocolController:c3008");
    // Drive firmware belongs to the controller of its drive.
    repo.Link("ORVSG_LSIDiskFirmware", "ORVSG_LSIDiskFirmwareElement:disk1030", "ORVSG_LSIDiskDrive:pd1030");
    repo.Link("ORVSG_LSIDiskFirmware", "ORVSG_LSIDiskFirmwareElement:disksas", "ORVSG_LSIDiskDrive:pdsas");
    repo.Link("ORVSG_LSIProtocolControllerForPhysicalDisk", "ORVSG_LSISCSIProtocolController:c1030",
              "ORVSG_LSIDiskDrive:pd1030");
    repo.Link("ORVSG_LSIProtocolControllerForPhysicalDisk", "ORVSG_LSISCSIProtocolController:c3008",
              "ORVSG_LSIDiskDrive:pdsas");
    repo.Link("ORVSG_LSIControllerBIOSElement", "ORVSG_LSIBIOSElement:oldbios", "ORVSG_LSISCSIProtocolController:c3008");
    repo.Link("LSIESG_SystemPackaging", "LSIESG_MegaRAIDHBA:mr0", "LSIESG_PhysicalCard:card0");
    repo.Link("LSIESG_SystemPackaging", "LSIESG_MegaRAIDHBA:mr0", "LSIESG_EnclosureChassis:enc0");
    repo.Link("LSIESG_SystemPackaging", "LSIESG_IRController:ir0", "LSIESG_PhysicalCard:card1");
    repo.Link("LSIESG_ElementSoftwareIdentity", "LSIESG_ControllerFirmwareIdentity:cf0", "LSIESG_MegaRAIDHBA:mr0");
    repo.Link("LSIESG_ElementSoftwareIdentity", "LSIESG_ControllerBIOSIdentity:cb0", "LSIESG_MegaRAIDHBA:mr0");
    repo.Link("LSIESG_ElementSoftwareIdentity", "LSIESG_FirmwarePackageIdentity:pk0", "LSIESG_MegaRAIDHBA:mr0");
    repo.Link("LSIESG_SystemDevice", "LSIESG_MegaRAIDHBA:mr0", "LSIESG_DiskDrive:d0");
    repo.Link("LSIESG_ElementSoftwareIdentity", "LSIESG_DriveFirmwareIdentity:df0", "LSIESG_DiskDrive:d0");
    return repo;
}

TEST(FirmwarePage, CardinalControllersReplaceTheirLegacyRows) {
    TPlatformRepo repo = CardinalServer();
    auto ns = repo.Namespace();
    TEngineRun<> run(ns);
    run.writer.WriteCustomFirmwareReport(boost::make_shared<TReportParametersBuilder>(ns, "default", false), "");
    const std::string page = run.Transcript();
    EXPECT_EQ(testing::ExpectedPage("platform/firmware-cardinal.txt", page), page);

    const std::string kVendor = "TWriter::WriteCustomFirmwareReport  -- ";
    for (const std::string& line :
         {kVendor + "Do not skip current LSI Firmware instance with controller type = LSI 53C1030",
          kVendor + "Skip current LSI IR/MR Firmware instsance with controller type = SAS3008 IR",
          kVendor + "Skip current LSI IR/MR BIOS instsance with controller type = SAS3008 IR",
          kVendor + "Skip Current Raid Controller Instances -- Enclosure 1",
          kVendor + "Current Controller Is MR Type, Process Build Pakage Infomation",
          kVendor + "Current Controller Is IR Type, No Build Pakage Infomation",
          kVendor + "Current Controller Is Not Connected To Disk Dirve",
          kVendor + "End of processing LSI IR/MR controller firmware in Firmware/VPD",
          std::string("TWriter::WriteCustomFirmwareReport -- End of processing LSI IR/MR controller bios in BIOS/uEFI")}) {
        EXPECT_TRUE(run.log.Contains(line)) << line;
    }
}

// Without any package build identity an MR controller gets no "Package
// Build" row, and the log says why.
TEST(FirmwarePage, MegaRAIDWithoutPackageBuild) {
    TPlatformRepo repo = CardinalServer();
    auto ns = repo.Namespace();
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> builds =
        testrepo::All(*ns, "LSIESG_FirmwarePackageIdentity");
    for (auto& build : builds) build->Delete(NORVTKR20::TCIMContext());
    TEngineRun<> run(ns);
    run.writer.WriteCustomFirmwareReport(boost::make_shared<TReportParametersBuilder>(ns, "default", false), "");
    EXPECT_EQ(std::string::npos, run.Transcript().find("Package Build"));
    EXPECT_TRUE(run.log.Contains(
        "TWriter::WriteCustomFirmwareReport  -- Cannot Retrieve Current MR Controller Package Build Information"));
}

}  // namespace
}  // namespace braigrion
