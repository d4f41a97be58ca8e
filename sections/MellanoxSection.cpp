// The Mellanox adapter page: the classes of the vendor's own provider, every
// instance as a block of label and value rows. The page is left open for the
// back-end to finish; its index entry counts the firmware identity alone.
#include "MellanoxBlocks.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "Mellanox";
const char kTableWidth[] = "40%";
const char kLabelWidth[] = "50%";

// The drivers shown: the core driver of the adapter family and the two
// driver packages. Other software identities of the provider stay off.
bool IsShownDriver(const TWriter::TInstancePtr& instance) {
    const std::string id = ValueText(instance, "InstanceID");
    return id == "mlx4_core.ko" || id == "MLNX_VPI" || id == "MLNX_EN";
}

}  // namespace

void TWriter::WriteMellanoxReport(TBuilderPtr /*builder*/, std::string reportName) {
    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle("Mellanox Adapter", "", "");

    const std::string notFound = "::WriteMellanoxReport, ex.fStatusCode.fStatusCode=";
    TClassPtr software = GuardedVendorClass(fNamespace, "MLNX_SoftwareIdentity", notFound);
    TClassPtr firmware = GuardedVendorClass(fNamespace, "MLNX_FirmwareIdentity", notFound);
    TClassPtr pciDevice = GuardedVendorClass(fNamespace, "MLNX_PCIDevice", notFound);
    TClassPtr ethernetPort = GuardedVendorClass(fNamespace, "MLNX_EthernetPort", notFound);
    TClassPtr ibPort = GuardedVendorClass(fNamespace, "MLNX_IBPort", notFound);
    // Fetched with the others; no table shows the links of firmware to elements.
    GuardedVendorClass(fNamespace, "MLNX_ElementFirmwareIdentity", notFound);

    bool hasFirmware = false;

    const TInstances drivers = DeepInstances(software);
    if (!drivers.empty()) Trace("SoftwareIdentity_Class exists");
    bool driverTitle = false;
    const std::vector<TReportProperty> driverRows =
        BlockColumns({"Caption", "Description", "ElementName", "InstanceID", "IsEntity", "MajorVersion",
                      "Manufacturer", "MinorVersion", "Name", "OperationalStatus", "RevisionNumber",
                      "VersionString"});
    for (const TInstancePtr& instance : drivers) {
        if (!IsShownDriver(instance)) continue;
        if (!driverTitle) WriteTableTitle("Driver", false, false);
        driverTitle = true;
        WritePropertyBlock(*this, software, instance, "Driver", driverRows, kTableWidth, kLabelWidth);
    }

    struct TBlock {
        const char* title;
        TClassPtr cls;
        const char* existsLine;
        std::vector<std::string> properties;
    };
    const TBlock blocks[] = {
        {"Firmware Identity", firmware, "FirmwareIdentity_Class exists",
         {"Caption", "Description", "ElementName", "InstanceID", "Location", "MajorVersion", "Manufacturer",
          "MinorVersion", "Name", "RevisionNumber", "VersionString"}},
        {"PCI Device", pciDevice, "PCIDevice_Class exists",
         {"InstanceID", "Caption", "Description", "ElementName", "Name", "OperationalStatus", "StatusDescriptions",
          "HealthState", "PrimaryStatus", "EnabledState", "RequestedState", "SystemCreationClassName", "SystemName",
          "CreationClassName", "DeviceID", "BusNumber", "DeviceNumber", "FunctionNumber", "PCIDeviceID", "VendorID",
          "RevisionID"}},
        {"Ethernet Port", ethernetPort, "EthernetPort_Class exists",
         {"DeviceID", "ElementName", "ActiveMaximumTransmissionUnit", "AutoSense", "Caption", "CreationClassName",
          "Description", "EnabledCapabilities", "FullDuplex", "InstanceID", "LinkTechnology", "MaxSpeed", "Name",
          "NetworkAddresses", "OperationalStatus", "PermanentAddress", "Speed", "SupportedMaximumTransmissionUnit",
          "SystemName", "SystemCreationClassName"}},
        {"IB Port", ibPort, "IBPort_Class exists",
         {"DeviceID", "ElementName", "AutoSense", "Caption", "CreationClassName", "Description", "EnabledState",
          "EnabledCapabilities", "FullDuplex", "InstanceID", "LIDMask", "LinkTechnology", "LinkSpeedActive",
          "LinkWidthActive", "MaxSpeed", "Name", "NetworkAddresses", "OperationalStatus", "PermanentAddress",
          "PortNumber", "PortType", "Speed", "StatusDescriptions", "SystemCreationClassName", "SystemName"}},
    };
    for (const TBlock& block : blocks) {
        const TInstances instances = DeepInstances(block.cls);
        if (instances.empty()) continue;
        Trace(block.existsLine);
        if (block.cls == firmware) hasFirmware = true;
        WriteTableTitle(block.title, false, false);
        const std::vector<TReportProperty> rows = BlockColumns(block.properties);
        for (const TInstancePtr& instance : instances)
            WritePropertyBlock(*this, block.cls, instance, block.title, rows, kTableWidth, kLabelWidth);
    }

    // Only the firmware identity makes the page count as holding data.
    WriteIndexEntry(kLinkName, reportName, hasFirmware);
}

}  // namespace braigrion
