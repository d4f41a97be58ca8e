// ESXi definitions of the software, log and analysis pages.
#include "CatalogueSupport_vmwesxi.h"
#include "TReportParametersBuilder_vmwesxi.h"

namespace braigrion {

using namespace catalogue;

TReportParameters TReportParametersBuilder_vmwesxi::BuildSystemOverviewParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildSystemOverviewParams");
    // Blade enclosures (28) and their sub-chassis (29) describe no host.
    TReportClass chassis = RowTable("OMC_Chassis", "Computer System", "20%", "60%", 1,
                                    {Column("Manufacturer", "10%"), Labelled("Model", "10%", "Product Name"),
                                     Column("Version", "10%"), Labelled("SerialNumber", "10%", "Serial Number"),
                                     Labelled("uuid", "10%", "System UUID")});
    chassis = Drop(Drop(chassis, "ChassisPackageType", "29"), "ChassisPackageType", "28");
    TReportClass hypervisor = Drop(
        RowTable("VMware_HypervisorSoftwareIdentity", "Operating System", "20%", "60%", 1,
                 {Column("Name", "10%"), Column("Manufacturer", "10%"), Labelled("LargeBuildNumber", "10%", "BuildNumber"),
                  Column("VersionString", "10%"), Labelled("LastStartTime", "10%", "Time of Last Boot")}),
        "Name", "Boot Bank");
    TReportClass product =
        RowTable("ORVSG_TKRProduct", "Data Source", "20%", "60%", 1, {Column("Name", "10%"), Column("Version", "10%")});
    return PageOf("system_overview", "System Overview", {chassis, hypervisor, product});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildInstalledAppsParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildInstalledAppsParams");
    return PageOf("installedapps", "Installed Applications",
                  {Table("VMware_ComponentSoftwareIdentity", "Installed Packages", "80%", 1000,
                         {Column("ElementName", "25%"), Labelled("VersionString", "20%", "Version"),
                          Column("Caption", "30%"), Column("InstallDate", "25%")})});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildKernelModuleParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildKernelModuleParams");
    return PageOf("kernelmodules", "Kernel Modules", {TagTable("Kernel Modules")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildNetworkingParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildNetworkingParams");
    TClasses classes = {
        RowTable("VMware_EthernetPort", "Physical Network Ports", "20%", "80%", 9,
                 {Column("Name", "15%"), Column("DeviceID", "15%"), Column("LinkTechnology", "10%"),
                  Column("PermanentAddress", "10%"), Column("NetworkAddresses", "10%"),
                  Column("ActiveMaximumTransmissionUnit", "10%"), Column("EnabledState", "10%"),
                  Column("FullDuplex", "10%")}),
        RowTable("VMware_KernelIPv4ProtocolEndpoint", "IPv4 Endpoint", "20%", "80%", 1000,
                 {Column("Name", "15%"), Column("TransitioningToState", "15%"), Column("SubnetMask", "10%"),
                  Column("RequestedState", "10%"), Column("ProtocolIFType", "10%"), Column("IPv4Address", "10%"),
                  Column("EnabledState", "10%")}),
        RowTable("VMware_KernelIPv6ProtocolEndpoint", "IPv6 Endpoint", "20%", "80%", 1000,
                 {Column("Name", "15%"), Column("TransitioningToState", "15%"), Column("SubnetMask", "10%"),
                  Column("AvailableRequestedStates", "10%"), Column("ProtocolIFType", "10%"),
                  Column("IPv6Address", "10%"), Column("EnabledState", "10%")}),
        // "OEM_PahrtNumber" is the property's name as the provider spells it.
        RowTable("IANet_EthernetPort", "EthernetPort", "20%", "80%", 6,
                 {Column("DeviceID", "15%"), Column("OEM_PahrtNumber", "15%"), Column("OEM_MACType", "10%"),
                  Column("PermanentAddress", "10%"), Column("Description", "10%"), Column("NetworkAddresses", "10%"),
                  Column("ElementName", "10%")}),
        RowTable("IANet_SoftwareIdentity", "Intel Software Identity", "20%", "80%", 4,
                 {Column("InstanceID", "20%"), Column("ElementName", "10%"), Column("Description", "10%"),
                  Column("Name", "10%"), Column("VersionString", "10%"), Column("Manufacturer", "10%"),
                  Column("Classifications", "10%"), Column("ClassificationDescriptions", "10%")}),
        RowTable("IANet_PCIDevice", "Intel PCIDevice", "20%", "80%", 6,
                 {Column("DeviceID", "15%"), Column("ElementName", "15%"), Column("Caption", "10%"),
                  Column("SubsystemID", "10%"), Column("SubsystemVendorID", "10%"), Column("VendorID", "10%"),
                  Column("RevisionID", "10%")}),
    };
    return PageOf("net", "Network Settings", classes);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildResourceUtilizationParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildResourceUtilizationParams");
    return PageOf("resource", "Resource Utilization", {TagTable("")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildProcessesParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildProcessesParams");
    return PageOf("process", "Processes", {TagTable("")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildOSConfigParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildOSConfigParams");
    return PageOf("os_config", "OS Configuration", {TagTable("")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildSysConfigParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildSysConfigParams");
    return PageOf("linux_config", "Linux Config Files", {TagTable("")});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildMergedLogParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildMergedLogParams");
    return PageOf("mergedlog", "Merged Logs",
                  {Table("OMC_IpmiLogRecord", "Merged Logs", "80%", 1000,
                         {Column("Description", "10%"), Column("MessageTimestamp", "20%")})});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildMergedDevicesParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildMergedDevicesParams");
    // The device columns every table of the page shares after its name.
    auto device = [](TReportProperty name, const std::string& description) {
        return TColumns{name, Labelled("Manufacturer", "10%", "VendorInfo"), Column("OperationalStatus", "10%"),
                        Column("VersionString", "10%"),
                        description == "Description" ? Column("Description", "10%")
                                                     : Labelled(description, "10%", "Description")};
    };
    TClasses classes = {
        Table("OMC_SMASHFirmwareIdentity", "Bios/uEFI", "80%", 1000, device(Column("Name", "10%"), "Description")),
        Table("ORVSG_PCIBridge", "Bridge", "80%", 1000, device(Labelled("DeviceID", "10%", "Name"), "Description")),
        Keep(Table("VMware_HypervisorStorageExtent", "Cdrom", "80%", 1000,
                   device(Labelled("ElementName", "10%", "Name"), "Description")),
             "ElementName", "CD-ROM"),
        Table("OMC_Processor", "Cpu", "80%", 1000,
              {Labelled("ModelName", "10%", "Name"), Labelled("IdentifyingDescriptions", "10%", "VendorInfo"),
               Column("OperationalStatus", "10%"), Column("VersionString", "10%"), Column("Description", "10%")}),
        Drop(Table("VMware_HypervisorStorageExtent", "Disk", "80%", 1000, device(Column("Name", "10%"), "Description")),
             "ElementName", "CD-ROM"),
        Table("OMC_PhysicalMemory", "Memory", "80%", 1000, device(Column("ElementName", "10%"), "Description")),
        Table("VMware_EthernetPort", "Network", "80%", 1000, device(Column("ElementName", "10%"), "Caption")),
    };
    return PageOf("mergedDevices", "Merged Devices", classes);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildPBParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildPBParams");
    return PageOf("pb", "PatchBeacon",
                  {Table("ORVSG_PBResult", "", "80%", TReportClass::kNoInstanceLimit,
                         {Column("Type", "25%"), Column("Name", "25%"), Column("InstalledVersion", "25%"),
                          Column("PBVersion", "25%")})});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildIPMIEventParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildIPMIEventParams");
    return PageOf("ipmi_event", "IPMI Event",
                  {SortedBy(Table("OMC_IpmiLogRecord", "IPMI Event", "80%", 1000,
                                  {Column("RecordID", "10%"), Column("MessageTimestamp", "20%"),
                                   Column("Description", "25%")}),
                            "RecordID", true)});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildChassisEventLogParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildChassisEventLogParams");
    TColumns columns;
    if (IsMultiNode()) {
        columns = {Column("NodeID", "10%"), Column("LogName", "10%"), Column("CreationTimeStamp", "20%"),
                   Column("EventID", "10%"), Column("MessageID", "10%"), Column("Message", "30%"),
                   Column("PerceivedSeverity", "10%")};
    } else {
        columns = {Column("LogName", "15%"), Column("CreationTimeStamp", "20%"), Column("EventID", "10%"),
                   Column("MessageID", "10%"), Column("Message", "35%"), Column("PerceivedSeverity", "10%")};
    }
    TReportClass log = SortedBy(Table("ORV_StandardMessageLogEntry", "Chassis Event Log", "100%",
                                      TReportClass::kNoInstanceLimit, columns),
                                "CreationTimeStamp");
    log.SetTableSortable();
    // This page leaves its report title off.
    TReportParameters params = PageOf("chassis_event", "Chassis Event Log", {log}, false);
    params.SetLinkSortable();
    return params;
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildVMwarePrivilegeLogParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildVMwarePrivilegeLogParams");
    return PageOf("vmware_privilege_log", "VMware Privilege Log",
                  {Table("VMware_Privilege", "VMware Privilege Log", "80%", 100,
                         {Column("ElementName", "10%"), Column("InstanceID", "20%"), Column("PrivilegeGranted", "10%"),
                          Column("RepresentsAuthorizationRights", "10%")})},
                  false);
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildTKRLogParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildTKRLogParams");
    TReportClass log = SortedBy(Table("ORVSG_TKRLogRecord", "TKR Error Log", "100%", TReportClass::kNoInstanceLimit,
                                      {Column("MessageTimestamp", "11%"), Column("Source", "13%"),
                                       Column("Type", "7%"), Column("Message", "69%")}),
                                "RecordID", true);
    log.SetTableSortable();
    TReportParameters params = PageOf("tkr_log", "TKR Error Log", {log});
    params.SetLinkSortable();
    return params;
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildHealthStatusParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildHealthStatusParams");
    return PageOf("health_status", "Health Status",
                  {Table("VMware_StoreLibSoftwareIdentity", "Storage", "80%", 1,
                         {Column("InstanceID", "10%"), Column("VersionString", "10%"), Column("ReleaseDate", "10%"),
                          Column("HealthState", "10%")})});
}

TReportParameters TReportParametersBuilder_vmwesxi::BuildRegisteredProfileParams() const {
    TTrace trace("TReportParametersBuilder_vmwesxi::BuildRegisteredProfileParams");
    const TColumns profile = {Column("RegisteredName", "10%"), Column("RegisteredOrganization", "10%"),
                              Column("RegisteredVersion", "10%")};
    return PageOf("registered_profile", "Registered Profile",
                  {Table("VMware_PowerManagementServiceRegisteredProfile", "VMware", "80%", 100, profile),
                   Table("OMC_RegisteredProfile", "OMC", "80%", 100, profile)});
}

}  // namespace braigrion
