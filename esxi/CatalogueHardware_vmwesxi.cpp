// ESXi definitions of the hardware and adapter pages. Several of them are
// walked by the ESXi section writers rather than the generic page writer:
// firmware, hardware inventory (with its slot tables), environmentals, the
// LSI controller and the service processor configuration.
#include "CatalogueSupport_vmwesxi.h"
#include "TReportParametersBuilder_vmwesxi.h"

namespace braigrion {

using namespace catalogue;

TReportParameters TReportParametersBuilder_vmwesxi::BuildHardwareInventoryParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildHardwareInventoryParams");
    TClasses classes = {
        Table("OMC_Card", "System Card Information", "100%", 30,
              {Column("Name", "10%"), Column("Caption", "20%"), Column("Manufacturer", "20%"), Column("Version", "10%"),
               Column("SerialNumber", "10%")}),
        Table("VMware_HypervisorStorageExtent", "System Devices", "100%", 8,
              {Column("DeviceID", "10%"), Column("Name", "10%"), Column("OperationalStatus", "10%"),
               Column("EnabledState", "10%"), Column("NumberOfBlocks", "10%"), Column("BlockSize", "10%"),
               Column("Description", "20%"), Column("Primordial", "10%")}),
        Table("OMC_PhysicalConnector", "Other Devices(physicalConnector)", "100%", 30,
              {Column("Tag", "20%"), Column("ElementName", "20%"), Column("Description", "30%"),
               Column("OtherIdentifyingInfo", "30%")}),
    };
    return PageOf("hardware_inventory", "Hardware Inventory", classes);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildHardwareInventoryMemorySlotsParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildHardwareInventoryMemorySlotsParams");
    return PageOf("hardware_inventory", "Hardware Inventory",
                  {SortedBy(RowTable("OMC_MemorySlot", "Memory Slots", "10%", "80%", 12,
                                     {Labelled("Tag", "25%", "MemorySlotID"), Labelled("ElementName", "25%", "Name"),
                                      Column("ConnectorLayout", "25%"), Column("Number", "25%")}),
                            "ElementName")},
                  false);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildHardwareInventoryCPUSlotsParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildHardwareInventoryCPUSlotsParams");
    return PageOf("hardware_inventory", "Hardware Inventory",
                  {SortedBy(RowTable("OMC_ProcessorSlot", "CPU Slots", "10%", "80%", 12,
                                     {Column("Tag", "25%"), Labelled("ElementName", "25%", "Name"),
                                      Column("ConnectorLayout", "25%"), Column("Number", "25%")}),
                            "Number")},
                  false);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildPCIInfoParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildPCIInfoParams");
    auto slot = [](const std::string& width) {
        return ViaThen("SlotAllInfo", width, "ORVSG_DeviceInSlot", "ORVSG_SystemSlot", "ORVSG_SystemBoard");
    };
    TReportClass devices = SortedBy(
        Table("ORVSG_PCIDevice", "Devices", "100%", TReportClass::kNoInstanceLimit,
              {Column("ClassCode", "20%"), Column("Description", "30%"), slot("15%"),
               Labelled("PciDeviceID", "5%", "DeviceID"), Column("VendorID", "5%"), Column("IRQ", "5%"),
               Separated("IOAddress", "5%", TReportProperty::SEPARATOR_3),
               Separated("IOLength", "5%", TReportProperty::SEPARATOR_3)}),
        "ClassCode");
    TReportClass bridges = SortedBy(Table("ORVSG_PCIBridge", "Bridges", "100%", TReportClass::kNoInstanceLimit,
                                          {Column("ClassCode", "15%"), Column("Description", "35%"), slot("10%"),
                                           Column("Location", "25%")}),
                                    "ClassCode");
    TReportClass slots = SortedBy(
        Table("ORVSG_SystemSlot", "Slots", "100%", TReportClass::kNoInstanceLimit,
              {Column("SlotDesignation", "15%"), Column("Tag", "15%"), Column("ConnectorType", "15%"),
               Column("SlotLength", "5%"), Column("MaxDataWidth", "10%"), Column("SupportsHotPlug", "5%"),
               Column("CurrentUsage", "10%"), Column("OperationalStatus", "10%"),
               Separated("VccMixedVoltageSupport", "15%", TReportProperty::SEPARATOR_1)}),
        "SlotDesignation");
    slots.SetTableSortable();
    return PageOf("pci_info", "PCI Information", {devices, bridges, slots});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildFirmwareParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildFirmwareParams");
    TClasses classes = {
        Table("OMC_MCFirmwareIdentity", "BMC Firmware", "80%", 10,
              {Column("Name", "15%"), Column("Manufacturer", "15%"), Column("VersionString", "15%"),
               Column("BuildNumber", "15%")}),
        Table("VMware_EPFirmwareSoftwareIdentity", "Device Firmware", "80%", 10,
              {Column("ElementName", "15%"), Column("Manufacturer", "15%"), Column("VersionString", "15%"),
               Column("BuildNumber", "15%")}),
        Table("OMC_SMASHFirmwareIdentity", "BIOS/uEFI", "80%", 10,
              {Column("ElementName", "15%"), Column("BuildNumber", "15%"), Column("VersionString", "15%"),
               Column("ReleaseDate", "15%")}),
        Table("OMC_PhysicalMemory", "Other VPD", "80%", 10,
              {Column("Name", "15%"), Column("Manufacturer", "15%"), Column("CanBeFRUed", "15%"),
               Column("PartNumber", "15%"), Column("SerialNumber", "15%")}),
        Table("OMC_PowerSupply", "", "80%", 10, {Column("Name", "15%")}),
    };
    return PageOf("firmware", "Firmware/VPD", classes);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildKMCConfigurationParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildKMCConfigurationParams");
    TClasses classes = {
        RowTable("CIM_DNSSettingData", "DNSSettingData", "40%", "70%", 1,
                 {Column("RequestedHostname", "10%"), Column("DNSServerAddresses", "10%"),
                  Column("ElementName", "10%")}),
        Keep(RowTable("CIM_IPProtocolEndpoint", "DHCP IP Address", "40%", "70%", 1,
                      {Column("IPv4Address", "10%"), Column("SubnetMask", "10%"), Column("SystemName", "10%"),
                       Column("AddressOrigin", "10%")}),
             "AddressOrigin", "4"),
        RowTable("OMC_IPMIIPProtocolEndpoint", "Static IP Address", "40%", "70%", 1,
                 {Column("Name", "10%"), Column("IPv4Address", "10%"), Column("SubnetMask", "10%"),
                  Column("IPv4DefaultGateway", "10%")}),
        RowTable("CIM_SNMPCommunityString", "SNMP Community", "40%", "70%", 1,
                 {Column("CommunityString", "10%"), Column("SystemName", "10%")}),
    };
    return PageOf("SPConfig", "KMC Configuration", classes);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildEnvironmentalsParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildEnvironmentalsParams");
    return PageOf("environmentals", "Environmentals",
                  {SortedBy(Table("OMC_NumericSensor", "Environmentals", "100%", 1000,
                                  {Labelled("ElementName", "25%", "Name"), Column("CurrentReading", "25%"),
                                   Column("BaseUnits", "25%")}),
                            "Name", true)});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildDriveHealthParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildDriveHealthParams");
    return PageOf("drive_health", "Drive Health", {TagTable("Drive Health")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildLsiControllerParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildLsiControllerParams");
    TReportClass bios;
    bios.SetClass("LSIESG_ControllerBIOSIdentity");
    bios.SetTitle("controller bios version");
    bios.SetAssociatorsFilter("LSIESG_ElementSoftwareIdentity", "LSIESG_ControllerBIOSIdentity", "", "");
    bios.SetProperties({Column("VersionString", "10%")});
    TReportClass firmware;
    firmware.SetClass("LSIESG_ControllerFirmwareIdentity");
    firmware.SetTitle("controller firmware version");
    firmware.SetAssociatorsFilter("LSIESG_ElementSoftwareIdentity", "LSIESG_ControllerFirmwareIdentity", "", "");
    firmware.SetProperties({Column("VersionString", "10%")});
    return PageOf("lsi_mir", "LSI Controller", {bios, firmware});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildLSIIDEParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildLSIIDEParams");
    return PageOf("lsiide", "LSI IDE Controller", {TagTable("LSI IDE Controller")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildPMCRAIDParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildPMCRAIDParams");
    return PageOf("pmc", "PMC RAID", {TagTable("PMC")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildHalcyonParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildHalcyonParams");
    return PageOf("halcyon", "Halcyon", {TagTable("Halcyon")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildHalcyonLogsParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildHalcyonLogsParams");
    return PageOf("halcyonlogs", "Halcyon Logs", {TagTable("Halcyon Logs")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildQlogicParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildQlogicParams");
    const TColumns columns = {Column("Name", "25%"), Column("Manufacturer", "25%"), Column("VersionString", "25%"),
                              Column("BuildNumber", "25%")};
    return PageOf("qlogic", "Qlogic",
                  {Keep(Table("QLogic_FCHBA_SoftwareIdentity", "Firmware", "80%", 1000, columns), "Name", "irmware"),
                   Keep(Table("QLogic_FCHBA_SoftwareIdentity", "BIOS", "80%", 5, columns), "Name", "BIOS")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildEmulexParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildEmulexParams");
    const TColumns byName = {Column("Name", "30%"), Column("VersionString", "30%"), Column("Description", "40%")};
    const TColumns byElement = {Labelled("ElementName", "30%", "Name"), Column("VersionString", "30%"),
                                Column("Description", "40%")};
    // Classifications: 10 firmware, 11 BIOS, 2 driver.
    auto identities = [&](const std::string& cls, const std::string& family) {
        return TClasses{
            Keep(Keep(Table(cls, family + " Firmware", "80%", 1000, byName), "Classifications", "10"), "Name",
                 "Firmware"),
            Keep(Table(cls, family + " BIOS", "80%", 1000, byElement), "Classifications", "11"),
            Keep(Table(cls, family + " Driver", "80%", 1000, byElement), "Classifications", "2"),
        };
    };
    TClasses classes = identities("ELXHBA_SoftwareIdentity", "ELXHBA");
    classes.push_back(SortedBy(Table("ELXUCNA_Product", "ELXUCNA Product", "80%", 1000,
                                     {Column("Name", "50%"), Column("IdentifyingNumber", "50%")}),
                               "Name"));
    const TClasses converged = identities("ELXUCNA_SoftwareIdentity", "EMXCNA");
    classes.insert(classes.end(), converged.begin(), converged.end());
    return PageOf("emulex", "Emulex", classes);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildBroadcomParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildBroadcomParams");
    const TColumns columns = {Column("Name", "30%"), Column("VersionString", "30%"), Column("Description", "40%")};
    return PageOf(
        "broadcom", "Broadcom",
        {Table("BRCM_NetworkController", "Network Controller", "60%", TReportClass::kNoInstanceLimit,
               {Column("Name", "30%"), Column("DriverVersion", "30%"), Column("Description", "40%")}),
         Keep(Keep(Table("CIM_SoftwareIdentity", "Broadcom Firmware", "60%", TReportClass::kNoInstanceLimit, columns),
                   "Classifications", "10"),
              "Manufacturer", "Broadcom"),
         Keep(Keep(Table("CIM_SoftwareIdentity", "Broadcom Driver", "60%", TReportClass::kNoInstanceLimit, columns),
                   "Classifications", "2"),
              "Manufacturer", "Broadcom")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildBrocadeAdapterParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildBrocadeAdapterParams");
    TReportClass ports = Table("BROCADE_FCPort", "FC Port", "60%", TReportClass::kNoInstanceLimit,
                               {Column("DeviceID", "30%"), Column("Caption", "30%")});
    ports.SetAssociatorsFilter("BROCADE_ControlledBy", "BROCADE_FCPort", "", "");
    TReportClass ethernet = Table("BROCADE_EthernetPort", "Ethernet Port", "100%", TReportClass::kNoInstanceLimit,
                                  {Column("DeviceID", "20%"), Column("PortType", "20%"), Column("ElementName", "20%"),
                                   Column("PermanentAddress", "20%"), Column("NetworkAddresses", "20%")});
    ethernet.SetAssociatorsFilter("BROCADE_EthernetPortControlledBy", "BROCADE_EthernetPort", "", "");
    TReportClass software =
        Table("BROCADE_AdapterSoftwareIdentity", "Adapter Software", "100%", TReportClass::kNoInstanceLimit,
              {Column("InstanceID", "30%"), Column("Description", "30%"), Labelled("VersionString", "40%", "Version")});
    software.SetAssociatorsFilter("BROCADE_AdapterElementSoftwareIdentity", "BROCADE_AdapterSoftwareIdentity", "", "");
    return PageOf("brocade_adapter", "Brocade Adapter", {ports, ethernet, software});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildGlowTraceParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildGlowTraceParams");
    TReportClass leds;
    if (IsMultiNode()) {
        leds = Table("CIM_IndicatorLED", "LED Settings", "80%", 1000,
                     {Labelled("NodeID", "10%", "SourceNode"), Labelled("ElementName", "10%", "LED"),
                      Column("DeviceID", "10%"), Labelled("ActivationState", "10%", "Current State"),
                      Column("ControlMode", "10%"), Column("Color", "10%"), Column("IndicatedConditions", "10%"),
                      Labelled("LocationIndicator", "10%", "Location info")});
        leds = SortedBy(SortedBy(leds, "NodeID"), "ElementName");
    } else {
        leds = SortedBy(Table("CIM_IndicatorLED", "LED Settings", "80%", 1000,
                              {Labelled("ElementName", "11%", "LED"), Column("DeviceID", "11%"),
                               Labelled("ActivationState", "11%", "Current State"), Column("ControlMode", "11%"),
                               Column("Color", "11%"), Column("IndicatedConditions", "11%"),
                               Labelled("LocationIndicator", "11%", "Location info")}),
                        "ElementName");
    }
    return PageOf("glowtrace", "Glow Trace", {leds});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildKMCBuiltinSelfTestParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildKMCBuiltinSelfTestParams");
    return PageOf("bist", "KMC Built-in Self Test",
                  {RowTable("VMware_IPMIOEMExtensionData", "IPMI BIST Results", "20%", "80%", 1,
                            {Column("Description", "10%"), Column("VersionString", "10%")})});
}

}  // namespace braigrion
