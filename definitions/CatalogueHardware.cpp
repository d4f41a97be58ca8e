// Definitions of the hardware pages: the hardware inventory, the PCI
// information and the firmware page (the last one is walked by the firmware
// section, the others by the generic page writer).
#include "CatalogueSupport.h"
#include "braigrion/TReportParametersBuilder.h"

namespace braigrion {

using namespace catalogue;

namespace {

// The slot of a device and the board that holds the slot.
TReportProperty SlotColumn(const std::string& width) {
    return ViaThen("SlotAllInfo", width, "ORVSG_DeviceInSlot", "ORVSG_SystemSlot", "ORVSG_SystemBoard");
}

// Firmware images and the device each one runs on.
TColumns FirmwareColumns() {
    return {Column("Name", "15%"),
            Column("Manufacturer", "15%"),
            Via("ProductID", "15%", "ORVSG_DeviceFirmware", "ORVSG_SysBusDevice"),
            Via("OtherIdentifyingInfo", "20%", "ORVSG_DeviceFirmware", "CIM_LogicalDevice", "Device"),
            Column("Version", "10%"),
            Column("BuildNumber", "10%"),
            Column("BuildDate", "15%")};
}

}  // namespace

TReportParameters TReportParametersBuilder::BuildHardwareInfoParams() const {
    TTrace trace("TReportParametersBuilder::BuildHardwareInfoParams");
    const int os = GetOSType();
    const bool windows = os == kOSWindows || os == kOSWindowsServer;
    const bool preboot = IsPreboot();
    const std::string version = GetDataSourceVersion();

    TReportParameters params = Page("hw_info", "Hardware Inventory");
    TClasses classes;
    TReportClass cls;
    TReportClass nested;  // the table written under each instance of `cls`

    cls.SetClass("ORVSG_Processor");
    cls.SetTitle("Processor/Core");
    RowReport(cls, "40%", "75%", 6);
    cls.SetUniqueIdProperty("DeviceId");
    cls.GetInstanceSorter().AddProperty("DeviceID", true, false);
    cls.GetInstanceSorter().AddProperty("Core", true, false);
    TColumns columns = {Column("DeviceID"), Column("Core"),
                        Column("Manufacturer"), Column("Name"),
                        Column("Stepping"), Column("CurrentClockSpeed"),
                        Column("CPUStatus")};
    // The ESXi collector reports no hyper-threading state.
    if (os != kOSVMwareESX) Append(columns, {Column("HTSupported"), Column("HTEnabled")});
    Append(columns, {Column("L1OperationalMode"), Column("L1Enabled"), Column("L2OperationalMode"),
                     Column("L2Enabled"), Column("L3OperationalMode"), Column("L3Enabled")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    // Older collectors know memory only by bank; later ones read the SPD (at the end of the page).
    if (version < "1.1") {
        cls.Reset();
        cls.SetClass("ORVSG_PhysicalMemory");
        cls.SetTitle("Memory");
        cls.SetUniqueIdProperty("Tag");
        cls.SetProperties({Column("Tag", "34%"), Column("Capacity", "33%"), Column("BankLabel", "33%")});
        classes.push_back(cls);
    }

    cls.Reset();
    cls.SetClass("ORVSG_MediaAccessDevice");
    cls.SetTitle("Disk Information");
    cls.SetTableSortable();
    cls.SetUniqueIdProperty("DeviceId");
    cls.GetInstanceSorter().AddProperty("Name", true, true);
    cls.SetAssociatedClass();
    if (os == kOSLinux) {
        cls.SetProperties({Column("Name", "20%"), Column("Size", "40%"), Column("NoOfPartitions", "40%")});
    } else {
        cls.SetProperties({Column("Name", "20%"), Column("DiskType", "20%"), Column("DiskStatus", "20%"),
                           Column("Size", "20%"), Column("NoOfPartitions", "20%")});
    }
    nested.SetClass("ORVSG_DiskPartition");
    nested.ClearTitle();
    nested.SetUniqueIdProperty("DeviceId");
    nested.GetInstanceSorter().AddProperty("DeviceID", true, true);
    nested.SetAssociatorsFilter("ORVSG_PartitionPresent", "ORVSG_DiskPartition", "", "");
    nested.SetProperties({Column("DeviceID", "15%"), Column("PartitionType", "15%"),
                          Labelled("PartitionSubType", "15%", "PartitionSubType"),
                          Via("FileSystemName", "15%", "ORVSG_LogicalDiskBasedOnPartition", "ORVSG_LogicalDisk",
                              "Format"),
                          Column("Size", "15%"), Column("StartingOffset", "15%"), Column("FaultTolerant", "10%")});
    cls.SetAssociatedClasses({nested});
    classes.push_back(cls);

    // Reset keeps the nested tables: the partition table stays attached to the
    // classes below until one sets its own. The page writer walks nested
    // tables only under a class reached by association.
    cls.Reset();
    cls.SetClass("ORVSG_LogicalDisk");
    cls.SetTitle("Volumes/Mount Points");
    cls.SetUniqueIdProperty("DeviceId");
    cls.GetInstanceSorter().AddProperty("DeviceID", true, false);
    if (windows) {
        cls.SetProperties({Column("DeviceID", "5%"), Column("OtherIdentifyingInfo", "15%"),
                           Column("VolumeLayout", "10%"), Column("FileSystemName", "10%"),
                           Column("VolumeState", "10%"), Column("FreeSpace", "10%"), Column("TotalSpace", "10%"),
                           Column("DiskQuotaStatus", "10%"), Column("UserDiskQuota", "10%"),
                           Column("UserDiskFreeSpace", "10%")});
    } else {
        cls.SetProperties({Column("DeviceID", "20%"), Column("OtherIdentifyingInfo", "30%"),
                           Column("FileSystemName", "20%"), Column("FreeSpace", "15%"), Column("TotalSpace", "15%")});
    }
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORV_IntelMICInfo");
    cls.SetTitle("Intel MIC Info");
    RowReport(cls, "40%", "75%", 6);
    cls.SetUniqueIdProperty("ID");
    cls.GetInstanceSorter().AddProperty("ID", true, false);
    columns.clear();
    for (const char* property : {"ID", "FlashVersion", "UOSVersion", "DevSerialNO", "VendorID", "DeviceID",
                                 "SubSystemID", "SteppingID", "PCIeWidth", "PCIeSpeed", "PCIeMaxPayloadSize",
                                 "PCIeMaxReadReqSize", "Model", "ModelExt", "Type", "Family", "FamilyExt", "Stepping",
                                 "BoardSKU", "ECCMode", "SMCHWRevision", "Voltage", "Frequency", "FanSpeedControl",
                                 "SMCFwVersion", "FSCStrap", "FanRPM", "FanRWM", "DieTemp", "GDDRVendor",
                                 "GDDRVersion", "GDDRDensity", "GDDRSize", "GDDRTechnology", "GDDRSpeed",
                                 "GDDRFrequency", "GDDRVoltage"}) {
        columns.push_back(Column(property));
    }
    cls.SetProperties(columns);
    classes.push_back(cls);

    // The pre-boot edition has no display driver to ask.
    if (!preboot) {
        cls.Reset();
        cls.SetClass("ORVSG_VideoController");
        cls.SetTitle("Video Controller");
        cls.SetUniqueIdProperty("DeviceId");
        cls.SetAssociatedClass();
        cls.SetProperties({Column("Name", "20%"), Column("StatusDescriptions", "10%"), Column("BiosString", "15%"),
                           Column("VideoRamSize", "10%"), Column("VideoProcessor", "25%"), Column("DACType", "20%")});
        nested.Reset();
        nested.SetClass("ORVSG_VideoHead");
        RowReport(nested, "20%", "100%", 1);
        nested.SetUniqueIdProperty("DeviceId");
        nested.SetAssociatorsFilter("ORVSG_HeadOfVideoController", "ORVSG_VideoHead", "", "");
        nested.SetProperties({Column("HeadNumber"), Column("MonitorString"), Column("CurrentHorizontalResolution"),
                              Column("CurrentVerticalResolution"), Column("CurrentBitsPerPixel"),
                              Column("CurrentRefreshRate"), Column("CurrentScanMode"), Column("MaxRefreshRate"),
                              Column("MinRefreshRate")});
        cls.SetAssociatedClasses({nested});
        classes.push_back(cls);
    }

    cls.Reset();
    cls.SetClass("ORVSG_DesktopMonitor");
    cls.SetTitle("Monitor");
    cls.SetTableWidth("100%");
    cls.SetTableSortable();
    cls.SetUniqueIdProperty("DeviceId");
    cls.SetAssociatedClass();
    cls.SetProperties({Column("Name", "10%"), Column("Description", "10%"), Column("MonitorManufacturer", "10%"),
                       Column("ManufacturingDate", "15%"), Labelled("OperationalStatus", "5%", "Status"),
                       Labelled("StatusDescriptions", "10%", "State"), Column("DPMSActiveOff", "10%"),
                       Column("DPMSStandby", "10%"), Column("DPMSSuspend", "10%"), Column("EDIDVersion", "10%")});
    nested.Reset();
    nested.SetClass("ORVSG_MonitorResolution");
    nested.ClearTitle();
    nested.SetTableWidth("50%");
    nested.SetTableSortable();
    nested.SetUniqueIdProperty("SettingID");
    // A pre-boot collection lists the resolutions by device, as it does the partitions.
    if (preboot) nested.GetInstanceSorter().AddProperty("DeviceID", true, true);
    nested.SetAssociatorsFilter("ORVSG_MonitorSetting", "ORVSG_MonitorResolution", "", "");
    nested.SetProperties({Column("HorizontalResolution", "25%"), Column("VerticalResolution", "25%"),
                          Column("RefreshRate", "20%"), Column("ScanMode", "30%")});
    cls.SetAssociatedClasses({nested});
    classes.push_back(cls);

    // The device tables from here on keep the monitor resolutions as their nested table.
    cls.Reset();
    cls.SetClass("ORVSG_Card");
    cls.SetTitle("System Card Information");
    cls.SetProperties({Column("Tag", "20%"), Column("CardType", "20%"), Column("Manufacturer", "20%"),
                       Column("Version", "20%"), Column("SerialNumber", "20%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_SysBusDevice");
    cls.SetTitle("System Devices");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("HostAdapterId", true, false);
    cls.GetInstanceSorter().AddProperty("TargetId", true, false);
    cls.GetInstanceSorter().AddProperty("Lun", true, false);
    // Outside Windows the optical drives are system bus devices too; they have a table of their own.
    if (!windows) {
        cls.GetPropertyFilters().push_back(
            TReportClass::TPropertyFilter("ORVSG_CDVDDevice", "CreationClassName", true));
    }
    cls.SetProperties({Column("VendorId", "10%"), Column("ProductId", "15%"), Column("DeviceType", "15%"),
                       Column("serialNum", "15%"), Column("Revision", "10%"), Column("HostAdapterId", "11%"),
                       Column("TargetId", "11%"), Column("Bus", "7%"), Column("Lun", "6%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_USBHub");
    cls.SetTitle("USB Hub");
    cls.SetProperties({Column("Description", "80%"), Column("NumberOfPorts", "20%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_USBDevice");
    cls.SetTitle("USB Devices");
    cls.SetProperties({Column("VendorId", "20%"), Column("USBDeviceId", "20%"), Column("Manufacturer", "20%"),
                       Column("Description", "20%"), Column("Speed", "20%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_CDVDDevice");
    cls.SetTitle("Optical Device Capabilities");
    if (os == kOSLinux || os == kOSVMwareESX) {
        columns = {Column("DeviceId", "19%")};
    } else {
        columns = {Column("VendorId", "9%"), Column("ProductId", "10%")};
    }
    Append(columns, {Column("DvdRamRead", "9%"), Column("DvdRRead", "9%"), Column("DvdRomRead", "9%"),
                     Column("DvdRamWrite", "9%"), Column("DvdRWrite", "9%"), Column("CdRwRead", "9%"),
                     Column("CdRRead", "9%"), Column("CdRwWrite", "9%"), Column("CdRWrite", "9%")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_QVAPort");
    cls.SetTitle("QVA Ports");
    cls.GetInstanceSorter().AddProperty("Chassis", true, false);
    cls.SetProperties({Column("Chassis", "10%"), Column("PortLocation", "20%"), Column("Name", "40%"),
                       Column("PortType", "20%"), Column("PortStatus", "10%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_QpiPort");
    cls.SetTitle("QPI Ports");
    cls.GetInstanceSorter().AddProperty("Description", true, false);
    cls.SetProperties({Column("Description", "30%"), Column("PortLocation", "10%"), Column("EnabledState", "10%"),
                       Column("OperationalStatus", "10%"), Column("StatusDescriptions", "25%"),
                       Column("Speed", "15%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_LogicalDevice");
    cls.SetTitle("Other Devices");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("DeviceClass", true, false);
    cls.SetProperties({Column("DeviceClass", "10%"), Column("ElementName", "20%"),
                       Labelled("Manufacturer", "24%", "Vendor Info"), Column("OtherIdentifyingInfo", "46%")});
    classes.push_back(cls);

    if (version >= "1.1") {
        TReportClass memory;
        memory.SetClass("ORVSG_SPDData");
        memory.SetTitle("Memory");
        RowReport(memory, "25%", "75%", 8);
        memory.SetUniqueIdProperty("Tag");
        memory.GetInstanceSorter().AddProperty("Index", true, true);
        memory.SetProperties({Column("Tag"), Column("BankLabel"), Column("Capacity"), Column("MemoryTypeA"),
                              Labelled("DimmSpeed", "", "Max Speed (Mhz)"), Column("ErrorMethodology"),
                              Column("Manufacturer"), Column("PartNumber"), Column("SerialNumber")});
        classes.push_back(memory);
    }

    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildPCIInfoParams() const {
    TTrace trace("TReportParametersBuilder::BuildPCIInfoParams");
    const int os = GetOSType();
    const bool windows = os == kOSWindows || os == kOSWindowsServer;

    TReportParameters params = Page("pci_info", "PCI Information");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_PCIDevice");
    cls.SetTitle("Devices");
    cls.GetInstanceSorter().AddProperty("ClassCode", true, false);
    // Only Windows reports a device status.
    TColumns columns = {Column("ClassCode", "20%")};
    if (windows) {
        Append(columns, {Column("Description", "30%"), Column("StatusDescriptions", "10%")});
    } else {
        columns.push_back(Column("Description", "40%"));
    }
    Append(columns, {SlotColumn("15%"), Labelled("PciDeviceID", "5%", "DeviceID"), Column("VendorID", "5%"),
                     Column("IRQ", "5%"), Separated("IOAddress", "5%", TReportProperty::SEPARATOR_3),
                     Separated("IOLength", "5%", TReportProperty::SEPARATOR_3)});
    cls.SetProperties(columns);
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_PCIBridge");
    cls.SetTitle("Bridges");
    cls.GetInstanceSorter().AddProperty("ClassCode", true, false);
    columns = {Column("ClassCode", "15%")};
    if (windows) {
        Append(columns, {Column("Description", "35%"), Column("StatusDescriptions", "15%")});
    } else {
        columns.push_back(Column("Description", "50%"));
    }
    Append(columns, {SlotColumn("10%"), Column("Location", "25%")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_SystemSlot");
    cls.SetTitle("Slots");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("SlotDesignation", true, false);
    cls.SetProperties({Column("SlotDesignation", "15%"), Column("Tag", "15%"), Column("ConnectorType", "15%"),
                       Column("SlotLength", "5%"), Column("MaxDataWidth", "10%"), Column("SupportsHotPlug", "5%"),
                       Column("CurrentUsage", "10%"), Column("OperationalStatus", "10%"),
                       Separated("VccMixedVoltageSupport", "15%", TReportProperty::SEPARATOR_1)});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildFirmwareParams() const {
    TTrace trace("TReportParametersBuilder::BuildFirmwareParams");
    const bool multiNode = IsMultiNode();

    TReportParameters params = Page("firmware", "Firmware/VPD");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_FirmwareElement");
    cls.SetTitle("Firmware");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties(FirmwareColumns());
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("EMXCNA_FirmwareVersion");
    cls.SetTitle("Emulex Firmware");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties(FirmwareColumns());
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("CIM_BIOSElement");
    cls.SetTitle("BIOS/uEFI");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    TColumns columns;
    if (multiNode) {
        columns = {Column("Name", "20%"), Column("SourceNode", "20%"), Column("BuildNumber", "20%"),
                   Column("Version", "20%"), Column("ReleaseDate", "20%")};
    } else {
        columns = {Column("Name", "30%"), Column("BuildNumber", "20%"), Column("Version", "20%"),
                   Column("ReleaseDate", "30%")};
    }
    cls.SetProperties(columns);
    classes.push_back(cls);

    // The list goes on from the BIOS columns: the post BIOS VPD table shows
    // the BIOS columns ahead of its own.
    cls.Reset();
    cls.SetClass("ORVSG_PostBIOSVPD");
    cls.SetTitle("Post BIOS VPD");
    Append(columns, {Column("BuildNumber", "15%"), Column("BuildDate", "20%"), Column("Version", "25%"),
                     Column("Filename", "15%"), Column("UniqueID", "25%")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_DiagnosticVPD");
    cls.SetTitle("Diagnostic VPD");
    if (multiNode) {
        cls.SetProperties({Column("BuildNumber", "30%"), Column("SourceNode", "20%"), Column("Filename", "25%"),
                           Column("UniqueID", "25%")});
    } else {
        cls.SetProperties({Column("BuildNumber", "30%"), Column("Filename", "35%"), Column("UniqueID", "35%")});
    }
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_SPROMFirmwareVPDMain");
    cls.SetTitle("SP Firmware Main VPD");
    cls.SetProperties({Column("Name", "20%"), Column("BuildNumber", "20%"), Column("BuildDate", "20%"),
                       Column("Version", "20%"), Column("Filename", "20%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_SPROMFirmwareVPDBootROM");
    cls.SetTitle("SP Firmware BootROM VPD");
    cls.SetProperties({Column("BuildNumber", "25%"), Column("BuildDate", "25%"), Column("Version", "25%"),
                       Column("Filename", "25%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_HardwareRevisionLevel");
    cls.SetTitle("SP Hardware Revision");
    cls.SetProperties({Column("Hardwarelevel", "100%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_FRU");
    cls.SetTitle("Other VPD");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "20%"), Column("Vendor", "20%"), Column("FRUNumber", "20%"),
                       Column("PartNumber", "20%"), Column("SerialNumber", "20%")});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

}  // namespace braigrion
