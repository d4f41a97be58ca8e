// The names the report is built from: writer types, the categories that group
// the pages in the navigation, and the page identifiers by which the driver
// asks for a page, and with them the mark-up fragments of the HTML back-end.
// Each translation unit that includes this header gets its own set of these
// strings, initialised when it is loaded.
#pragma once

#include <string>

#include "braigrion/MarkupConstants.h"

namespace TKR_REPORT_DEFINITION {

// Writer types. The default writer is the HTML one.
const std::string TKR_WRITER_TYPE_HTML = "html";
const std::string TKR_WRITER_TYPE_DEFAULT = TKR_WRITER_TYPE_HTML;
const std::string TKR_WRITER_TYPE_TEXT = "text";
const std::string TKR_WRITER_TYPE_INVENTORY = "inventory";

// Categories.
const std::string CATEGORY_SOFTWARE = "Software";
const std::string CATEGORY_HARDWARE = "Hardware";
const std::string CATEGORY_OS_LOGS = "OS Logs";
const std::string CATEGORY_WINDOWS_LOGS = "Windows Logs";
const std::string CATEGORY_LINUX_LOGS = "Linux Logs";
const std::string CATEGORY_SERVPROC_LOGS = "ServProc Logs";
const std::string CATEGORY_KMC_LOGS = "KMC Logs";
const std::string CATEGORY_SP_LOGS = "SP Logs";
const std::string CATEGORY_ORV_SERVICE = "ORV Service";
const std::string CATEGORY_ANALYSIS = "Analysis";
const std::string CATEGORY_TKR_ERROR_LOG = "TKR Error Log";

// Page identifiers. An identifier names a page to the driver and the writers;
// the page's file stem is its link name, which the page definition holds.
const std::string PAGE_SYSTEM_OVERVIEW = "SystemConfig";
const std::string PAGE_REPORT_HIGHLIGHTS = "CriticalDetails";
const std::string PAGE_OS_INSTALLATIONS = "OSInstallations";
const std::string PAGE_NETWORK_SETTINGS = "NetworkWithTeaming";
const std::string PAGE_RESOURCE_UTILIZATION = "ResourceUtilization";
const std::string PAGE_PROCESS_INFORMATION = "Processes";
const std::string PAGE_OS_CONFIGURATION = "OSConfiguration";
const std::string PAGE_HARDWARE_INVENTORY = "HardwareInfo";
const std::string PAGE_PCI_INFORMATION = "PCIInfo";
const std::string PAGE_FIRMWARE_VPD = "Firmware";
const std::string PAGE_SERV_PROC_CONFIGURATION = "ServProcConfig";
const std::string PAGE_KMC_CONFIGURATION = "KMCConfig";
const std::string PAGE_ENVIRONMENTALS = "Environmentals";
const std::string PAGE_DRIVE_HEALTH = "DriveHealth";
const std::string PAGE_LSI_CONTROLLER = "LSI";
const std::string PAGE_LSI_IDE_CONTROLLER = "LSIIDE";
const std::string PAGE_MELLANOX = "Mellanox";
const std::string PAGE_SOLARFLARE = "Solarflare";
const std::string PAGE_DIABLO = "Diablo";
const std::string PAGE_FUSIONIO = "FusionIO";
const std::string PAGE_PMC_RAID = "PMC";
const std::string PAGE_HALCYON = "Halcyon";
const std::string PAGE_HALCYON_LOGS = "HalcyonLogs";
const std::string PAGE_QLOGIC = "Qlogic";
const std::string PAGE_EMULEX = "Emulex";
const std::string PAGE_BROADCOM = "Broadcom";
const std::string PAGE_BROCADE_ADAPTER = "Brocade";
const std::string PAGE_VMWARE_ESXI = "Vmware3i";
const std::string PAGE_GLOW_TRACE = "GlowTrace";
const std::string PAGE_KMC_BIST = "KMCBIST";
const std::string PAGE_BIST = "BIST";
const std::string PAGE_KMC_LICENSE_KEY = "KMCLicenseKey";
const std::string PAGE_BIOS_SETTINGS = "BIOSSettings";
const std::string PAGE_VCX = "VCX";
const std::string PAGE_OS_LOGS = "OSLogs";
const std::string PAGE_KMC_LOGS = "KMCLogs";
const std::string PAGE_SP_LOGS = "SPLogs";
const std::string PAGE_QVA_CHIPSET_REGISTER = "QVAChipsetRegister";
const std::string PAGE_CFT_SETTING = "CFTSetting";
const std::string PAGE_AMDATICONFIG_LOG = "AMDAticonfigLog";
const std::string PAGE_NVSMI_LOG = "NVSMILog";
const std::string PAGE_SPINT_LOG = "SPINTLog";
const std::string PAGE_MERGED_LOG = "MergedLog";
const std::string PAGE_MERGED_DEVICE = "MergedDevice";
const std::string PAGE_MELODY_DEVICE = "MelodyDeviceAnalysis";
const std::string PAGE_PATCHBEACON = "PatchBeacon";
const std::string PAGE_FILE_LOADER = "FileLoaderResult";
const std::string PAGE_DIAGNOSTIC = "DiagsFull";
const std::string PAGE_INVENTORY_ANALYSIS = "Analysis";
const std::string PAGE_TKR_ERROR_LOGS = "TKRLog";

}  // namespace TKR_REPORT_DEFINITION
