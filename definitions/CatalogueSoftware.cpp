// Definitions of the operating-system and software pages: system overview,
// OS configuration, configuration files, installed software, services,
// drivers, kernel modules, processes, resource utilization, the ESXi
// inventory and the patch check. One builder operation per page; a
// definition varies only with the probes of the collection.
#include "CatalogueSupport.h"
#include "braigrion/TReportParametersBuilder.h"

namespace braigrion {

using namespace catalogue;

TReportParameters TReportParametersBuilder::BuildSystemConfigParams() const {
    TTrace trace("TReportParametersBuilder::BuildSystemConfigParams");
    const int os = GetOSType();  // asked once: every probe walks the repository
    const bool windows = os == kOSWindows || os == kOSWindowsServer;
    const bool preboot = IsPreboot();
    const bool multiNode = IsMultiNode();
    const std::string version = GetDataSourceVersion();

    TReportParameters params = Page("system_overview", "System Overview");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_ComputerSystem");
    cls.SetTitle("Computer System");
    RowReport(cls, "30%", "60%", 1);
    TColumns columns = {Column("Manufacturer"), Column("Version"), Column("ProductName")};
    // The nodes of a multi-node system have serial numbers and names of their own.
    if (!multiNode) Append(columns, {Column("SerialNumber"), Column("Name")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    if (multiNode) {
        cls.Reset();
        cls.SetClass("ORVSG_ComputerNode");
        cls.SetTitle("Computer System Nodes");
        RowReport(cls, "30%", "60%", 1);
        cls.SetProperties({Column("NodeID"), Column("SerialNumber"), Column("Name")});
        classes.push_back(cls);
    }

    // The pre-boot edition runs before any operating system.
    if (!preboot) {
        cls.Reset();
        cls.SetClass("ORVSG_OperatingSystem");
        cls.SetTitle("Operating System");
        RowReport(cls, "30%", "60%", 1);
        if (windows) {
            columns = {Column("Name"),          Column("OSType"),          Column("OSSubType"),
                       Column("Version"),       Column("FixLevel"),        Column("BuildID"),
                       Column("ProductVendor"), Column("RegisteredOwner"), Column("ProductID"),
                       Column("InstallDate")};
        } else if (os == kOSVMwareESX) {
            columns = {Column("Name"),          Column("OSType"),        Column("Version"),
                       Column("BuildID"),       Column("ProductVendor"), Column("KernelName"),
                       Column("KernelRelease"), Column("HardwarePlatform")};
        } else {
            columns = {Column("Name"),          Column("OSType"),        Column("BuildID"),
                       Column("ProductVendor"), Column("KernelName"),    Column("KernelRelease"),
                       Column("HardwarePlatform")};
        }
        if (version >= "1.1") Append(columns, {Column("UpTime"), Column("LastBootUpTime")});
        cls.SetProperties(columns);
        classes.push_back(cls);
    }

    if (!preboot && version >= "1.3") {
        cls.Reset();
        cls.SetClass("ORVSG_TimeZone");
        cls.SetTitle("TimeZone");
        RowReport(cls, "30%", "60%", 1);
        columns = {Column("LocalDateTime"), Column("TheTimeZone")};
        if (windows) columns.push_back(Column("GMTDateTime"));
        cls.SetProperties(columns);
        classes.push_back(cls);

        cls.Reset();
        cls.SetClass("ORVSG_ComputerSystem");
        cls.SetTitle("Current User");
        RowReport(cls, "30%", "60%", 1);
        cls.SetProperties({Via("Name", "30%", "ORVSG_CurrentAccountOnSystem", "ORVSG_Account")});
        classes.push_back(cls);
    }

    cls.Reset();
    cls.SetClass("ORVSG_HeavyHittersLogRecord");
    cls.SetTitle("Report Highlights");
    if (version < "1.3") {
        cls.SetTableWidth("60%");
        cls.SetMaxInstancesPerTable(1);
    }
    cls.GetInstanceSorter().AddProperty("ElementName", false, false);
    cls.SetProperties({Column("Message", "100%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_TKRProduct");
    cls.SetTitle("Data Source");
    RowReport(cls, "30%", "60%", 1);
    cls.GetInstanceSorter().AddProperty("ElementName", false, false);
    columns = {Column("Name"), Column("Version")};
    if (version >= "1.2") columns.push_back(Column("Build"));
    columns.push_back(Labelled("SEPVersion", "", "SEP Version"));
    cls.SetProperties(columns);
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildOSConfigParams() const {
    TTrace trace("TReportParametersBuilder::BuildOSConfigParams");
    const int os = GetOSType();
    const bool windows = os == kOSWindows || os == kOSWindowsServer;
    const bool linuxOrVMware = os == kOSLinux || os == kOSVMwareESX;

    TReportParameters params = Page("os_config", "OS Configuration");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_OperatingSystem");
    cls.SetTitle("Boot Configuration");
    RowReport(cls, "10%", "100%", 1);
    cls.SetProperties({Column("BootConfigurationFileName"), Monospaced("BootConfigurationFileContents")});
    classes.push_back(cls);

    if (linuxOrVMware) {
        cls.Reset();
        cls.SetClass("ORVSG_OperatingSystem");
        cls.SetTitle("Init Configuration");
        RowReport(cls, "10%", "100%", 1);
        cls.SetProperties({Column("InitConfigurationFileName"), Monospaced("InitConfigurationFileContents")});
        classes.push_back(cls);

        cls.Reset();
        cls.SetClass("ORVSG_LinuxModulesConfigurationSetting");
        cls.SetTitle("Kernel Modules Configuration");
        RowReport(cls, "10%", "100%", 1);
        cls.SetProperties({Column("ElementName"), Monospaced("ModulesConf")});
        classes.push_back(cls);

        cls.Reset();
        cls.SetClass("ORVSG_OperatingSystem");
        cls.SetTitle("Kernel Ring Buffer");
        RowReport(cls, "10%", "100%", 1);
        cls.SetProperties({Column("KernelRingBufferName"), Monospaced("KernelRingBufferContents")});
        classes.push_back(cls);
    }

    cls.Reset();
    cls.SetClass("ORVSG_Account");
    cls.SetTitle("Active User Information");
    RowReport(cls, "10%", "100%", 1);
    TColumns columns = {Column("Name"), Column("UserID"), Column("Descriptions"), Column("LastLogon")};
    if (windows) Append(columns, {Column("Domain"), Column("LogonServer")});
    cls.SetProperties(columns);
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_UserEnvironmentVariable");
    cls.SetTitle("User Environment Variables");
    cls.SetProperties({Column("SettingID", "15%"), Column("SettingValue", "85%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_SystemEnvironmentVariable");
    cls.SetTitle("System Environment Variables");
    cls.GetInstanceSorter().AddProperty("SettingID", true, false);
    cls.SetProperties({Column("SettingID", "15%"), Column("SettingValue", "85%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_PageFile");
    cls.SetTitle("Paging File");
    cls.SetTableWidth("60%");
    cls.GetInstanceSorter().AddProperty("SettingID", true, false);
    cls.SetProperties({Column("Name", "60%"), Column("FileSize", "40%")});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildSysConfigParams() const {
    TTrace trace("TReportParametersBuilder::BuildSysConfigParams");
    TReportParameters params = Page("linux_config", "Linux Config Files");
    TReportClass cls;
    // One table per configuration file, the file named in its first row.
    cls.SetClass("ORVSG_SysConfigSettingData");
    cls.ClearTitle();
    RowReport(cls, "10%", "100%", 1);
    cls.SetAssociatorsFilter("ORVSG_SysConfigAssoc", "ORVSG_SysConfigSettingData", "", "");
    cls.SetProperties({Column("FilePath"), Column("SettingData")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildInstalledAppsParams() const {
    TTrace trace("TReportParametersBuilder::BuildInstalledAppsParams");
    TReportParameters params = Page("installedapps", "Installed Applications");
    TReportClass cls;
    cls.SetClass("ORVSG_InstalledApplication");
    cls.ClearTitle();
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("ProductName", true, false);
    cls.SetProperties({Column("ProductName", "50%"), Column("ProductVersion", "20%"), Column("ProductVendor", "20%"),
                       Column("ProductInstallDate", "10%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildInstalledFixesParams() const {
    TTrace trace("TReportParametersBuilder::BuildInstalledFixesParams");
    TReportParameters params = Page("installedfixes", "Installed Hotfixes");
    TReportClass cls;
    cls.SetClass("ORVSG_InstalledFix");
    cls.SetTitle("Installed Hotfixes");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("ProductName", true, false);
    cls.SetProperties({Labelled("ProductName", "50%", "Description"), Column("ProductVersion", "20%"),
                       Column("ProductVendor", "20%"), Column("ProductInstallDate", "10%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildInstalledRPMParams() const {
    TTrace trace("TReportParametersBuilder::BuildInstalledRPMParams");
    TReportParameters params = Page("installed_packages", "Installed Packages");
    TReportClass cls;
    cls.SetClass("ORVSG_InstalledRPM");
    cls.SetTitle("Installed Packages");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("ProductName", true, false);
    cls.SetProperties({Column("ProductName", "10%"), Column("ProductVersion", "5%"), Column("Group", "20%"),
                       Column("Summary", "30%"), Labelled("Size", "5%", "Size (byte)"), Column("License", "15%"),
                       Column("ProductInstallDate", "15%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildWindowsComponentsParams() const {
    TTrace trace("TReportParametersBuilder::BuildWindowsComponentsParams");
    TReportParameters params = Page("win_components", "Windows Components");
    TReportClass cls;
    cls.SetClass("ORVSG_OSComponent");
    cls.ClearTitle();
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "20%"), Column("ProductName", "40%"), Column("Version", "20%"),
                       Column("ComponentInstalled", "20%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildSystemServiceParams() const {
    TTrace trace("TReportParametersBuilder::BuildSystemServiceParams");
    TReportParameters params = Page("systemservice", "System Services");
    TReportClass cls;
    cls.SetClass("ORVSG_SystemServiceInfo");
    cls.ClearTitle();
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "11%"), Column("Description", "17%"), Column("CurrentState", "6%"),
                       Column("StartupState", "7%"), Column("Manufacturer", "12%"), Column("Version", "10%"),
                       Column("InstallDate", "11%"), Labelled("FileSize", "5%", "File Size (byte)"),
                       Column("Path", "21%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildDeviceDriverParams() const {
    TTrace trace("TReportParametersBuilder::BuildDeviceDriverParams");
    TReportParameters params = Page("devicedriver", "Device Drivers");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_DeviceDriverInfo");
    cls.ClearTitle();
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "8%"), Column("Description", "16%"), Column("CurrentState", "6%"),
                       Column("StartupState", "6%"), Column("Manufacturer", "10%"), Column("Version", "14%"),
                       Column("CreationTime", "12%"), Labelled("FileSize", "6%", "File Size (byte)"),
                       Column("Path", "22%")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_DeviceDriverRollBack");
    cls.SetTitle("RollBack Drivers");
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "24%"), Column("CurrentState", "6%"), Column("StartupState", "6%"),
                       Column("Manufacturer", "10%"), Column("Version", "14%"), Column("CreationTime", "12%"),
                       Labelled("FileSize", "6%", "File Size (byte)"), Column("Path", "22%")});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildKernelModuleParams() const {
    TTrace trace("TReportParametersBuilder::BuildKernelModuleParams");
    TReportParameters params = Page("kernelmodules", "Kernel Modules");
    TReportClass cls;
    cls.SetClass("ORVSG_LinuxKernelModule");
    cls.SetTitle("Kernel Modules");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetProperties({Column("Name", "10%"), Column("Description", "25%"), Column("SoftwareElementState", "10%"),
                       Column("Manufacturer", "15%"), Column("Version", "10%"), Column("Path", "30%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildProcessesParams() const {
    TTrace trace("TReportParametersBuilder::BuildProcessesParams");
    TReportParameters params = Page("processes", "Processes");
    TReportClass cls;
    cls.SetClass("ORVSG_Process");
    cls.SetTitle("Processes");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("Handle", true, true);
    cls.SetProperties({Column("Handle", "5%"), Column("Name", "20%"), Column("User", "10%"),
                       Column("ExecutionState", "10%"), Column("Priority", "5%"), Column("KernelModeTime", "12%"),
                       Column("UserModeTime", "12%"), Column("WorkingSetSize", "11%"), Column("CreationDate", "15%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildResourceUtilizationParams() const {
    TTrace trace("TReportParametersBuilder::BuildResourceUtilizationParams");
    TReportParameters params = Page("resource", "Resource Utilization");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("ORVSG_OperatingSystem");
    cls.SetTitle("Memory Utilization");
    RowReport(cls, "25%", "75%", 1);
    cls.SetProperties({Column("MemoryLoad"),
                       Column("SwapUtilization"),
                       Column("TotalVirtualMemorySize"),
                       Column("FreeVirtualMemory"),
                       Column("SizeStoredInPagingFiles"),
                       Column("FreeSpaceInPagingFiles"),
                       Column("FreeSwapSpaceSize"),
                       Column("TotalSwapSpaceSize"),
                       Column("HandleCount"),
                       Column("ThreadCount"),
                       Column("ProcessCount"),
                       Column("TotalVisibleMemorySize"),
                       Column("FreePhysicalMemory"),
                       Column("SystemCache"),
                       Column("CommitTotal"),
                       Column("CommitLimit"),
                       Column("CommitPeak"),
                       Column("KernelTotal"),
                       Column("KernelPaged"),
                       Column("KernelNonpaged")});
    classes.push_back(cls);

    cls.Reset();
    cls.SetClass("ORVSG_SystemPerformanceData");
    cls.SetTitle("Performance Data");
    cls.SetTableWidth("85%");
    cls.GetInstanceSorter().AddProperty("ObjectName", true, false);
    cls.SetProperties({Column("ObjectName", "15%"), Column("CounterName", "15%"), Column("InstanceName", "55%"),
                       Column("CounterValue", "15%")});
    classes.push_back(cls);

    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildVmware3iParams() const {
    TTrace trace("TReportParametersBuilder::BuildVmware3iParams");
    TReportParameters params = Page("vmware_esxi", "VMware ESXi");
    TReportClass cls;
    cls.SetClass("ORVSG_VMWARE3I_SoftwareElement");
    cls.SetTitle("VMware ESXi");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("Node", true, false);
    cls.SetProperties({Column("Node", "20%"), Column("BootbankVersion", "20%"), Column("BootbankLicense", "20%"),
                       Labelled("Manufacturer", "20%", "VendorID"), Labelled("SerialNumber", "20%", "DeviceID")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildPBParams() const {
    TTrace trace("TReportParametersBuilder::BuildPBParams");
    TReportParameters params = Page("pb", "PatchBeacon");
    TReportClass cls;
    cls.SetClass("ORVSG_PBResult");
    cls.ClearTitle();
    cls.SetTableWidth("80%");
    cls.SetProperties({Column("Type", "25%"), Column("Name", "25%"), Column("InstalledVersion", "25%"),
                       Column("PBVersion", "25%")});
    params.SetClasses({cls});
    return params;
}

}  // namespace braigrion
