// The writer's part of a report run: reading the mode flags, and turning a
// page id into the work of its generator, with a failed page contained.
#include <algorithm>
#include <stdexcept>

#include "braigrion/ReportDefinition.h"
#include "braigrion/Trace.h"
#include "braigrion/TWriter.h"
#include "delta/TClassDelta.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {

using NORVTKR20::INamespaceProvider;
using NORVTKR20::TRootObject;
using namespace TKR_REPORT_DEFINITION;

namespace {

typedef void (TWriter::*TGenerator)(TWriter::TBuilderPtr, std::string);

struct TRoute {
    const std::string& pageID;
    TGenerator generator;
};

// Page ids and their generators, in the order in which a page id is
// compared with them; the first match wins.
const TRoute kRoutes[] = {
    {PAGE_SYSTEM_OVERVIEW, &TWriter::Generator_SystemOverview},
    {PAGE_REPORT_HIGHLIGHTS, &TWriter::Generator_CriticalDetails},
    {PAGE_OS_INSTALLATIONS, &TWriter::Generator_OSInstallation},
    {PAGE_NETWORK_SETTINGS, &TWriter::Generator_NetworkSettings},
    {PAGE_RESOURCE_UTILIZATION, &TWriter::Generator_ResourceUtilization},
    {PAGE_PROCESS_INFORMATION, &TWriter::Generator_Processes},
    {PAGE_OS_CONFIGURATION, &TWriter::Generator_OSConfiguration},
    {PAGE_HARDWARE_INVENTORY, &TWriter::Generator_HardwareInventory},
    {PAGE_PCI_INFORMATION, &TWriter::Generator_PCIInformation},
    {PAGE_FIRMWARE_VPD, &TWriter::Generator_FirmwareVPD},
    {PAGE_KMC_CONFIGURATION, &TWriter::Generator_ServProcConfiguration},
    {PAGE_SERV_PROC_CONFIGURATION, &TWriter::Generator_ServProcConfiguration},
    {PAGE_ENVIRONMENTALS, &TWriter::Generator_Environmentals},
    {PAGE_DRIVE_HEALTH, &TWriter::Generator_DriveHealth},
    {PAGE_LSI_CONTROLLER, &TWriter::Generator_LSIController},
    {PAGE_LSI_IDE_CONTROLLER, &TWriter::Generator_LSIIDEController},
    {PAGE_MELLANOX, &TWriter::Generator_Mellanox},
    {PAGE_SOLARFLARE, &TWriter::Generator_Solarflare},
    {PAGE_FUSIONIO, &TWriter::Generator_FusionIO},
    {PAGE_PMC_RAID, &TWriter::Generator_PMCRAID},
    {PAGE_HALCYON, &TWriter::Generator_Halcyon},
    {PAGE_HALCYON_LOGS, &TWriter::Generator_HalcyonLogs},
    {PAGE_QLOGIC, &TWriter::Generator_QLogic},
    {PAGE_EMULEX, &TWriter::Generator_Emulex},
    {PAGE_BROADCOM, &TWriter::Generator_Broadcom},
    {PAGE_BROCADE_ADAPTER, &TWriter::Generator_BrocadeAdapter},
    {PAGE_VMWARE_ESXI, &TWriter::Generator_VMwareESXi},
    {PAGE_GLOW_TRACE, &TWriter::Generator_GlowTrace},
    {PAGE_KMC_BIST, &TWriter::Generator_SelfBIST},
    {PAGE_BIST, &TWriter::Generator_SelfBIST},
    {PAGE_KMC_LICENSE_KEY, &TWriter::Generator_KMCLicenseKey},
    {PAGE_BIOS_SETTINGS, &TWriter::Generator_BIOSSettings},
    {PAGE_VCX, &TWriter::Generator_VCX},
    {PAGE_OS_LOGS, &TWriter::Generator_OSLogs},
    {PAGE_KMC_LOGS, &TWriter::Generator_ServProcEvent},
    {PAGE_SP_LOGS, &TWriter::Generator_ServProcEvent},
    {PAGE_QVA_CHIPSET_REGISTER, &TWriter::Generator_QVAChipsetRegister},
    {PAGE_CFT_SETTING, &TWriter::Generator_CFTSetting},
    {PAGE_NVSMI_LOG, &TWriter::Generator_NVSMILog},
    {PAGE_AMDATICONFIG_LOG, &TWriter::Generator_AMDAticonfigLog},
    {PAGE_SPINT_LOG, &TWriter::Generator_SPINTLog},
    {PAGE_MERGED_LOG, &TWriter::Generator_MergedLog},
    {PAGE_MERGED_DEVICE, &TWriter::Generator_MergedDevice},
    {PAGE_MELODY_DEVICE, &TWriter::Generator_Melody},
    {PAGE_PATCHBEACON, &TWriter::Generator_PatchBeacon},
    {PAGE_FILE_LOADER, &TWriter::Generator_FileLoader},
    {PAGE_DIAGNOSTIC, &TWriter::Generator_DiagnosticLog},
    {PAGE_INVENTORY_ANALYSIS, &TWriter::Generator_MergedDevice},
    {PAGE_TKR_ERROR_LOGS, &TWriter::Generator_TKRErrorLog},
};

}  // namespace

void TWriter::BaseInitialize(TNamespacePtr ns, TContext context, TBuilderPtr builder) {
    Trace("TWriter::BaseInitialize -- Entering ");
    fNamespace = ns;
    try {
        if (!builder) throw std::invalid_argument("no report parameters builder");
        fPreboot = builder->IsPreboot();
        fKMC = builder->IsKMC();
        TContext empty;
        if (!ns) throw std::invalid_argument("no namespace");
        boost::shared_ptr<INamespaceProvider> provider = ns->GetNamespaceProvider(empty);
        if (!provider) throw std::invalid_argument("namespace without provider");
        fProviderType = provider->GetProviderType(empty);
        fOSType = builder->GetOSType();
    } catch (...) {
        Trace("TWriter::BaseInitialize -- Exception when initializing member variable");
    }
    if (fProviderType == 1) TClassDelta::Init(ns, context);
    Trace("TWriter::BaseInitialize -- Exiting ");
}

void TWriter::BaseDispose() {
    Trace("TWriter::BaseDispose -- Entering ");
    TClassDelta::Uninit();
    Trace("TWriter::BaseDispose -- Exiting ");
}

void TWriter::WriteReportPage(TBuilderPtr builder, std::string pageID) {
    Trace("TWriter::WriteReportPage -- Entering ");
    Trace("TWriter::WriteReportPage -- WriterType = [" + fWriterType + "] PageID = [" + pageID + "]");
    try {
        const TRoute* route = nullptr;
        for (const TRoute& candidate : kRoutes) {
            if (pageID == candidate.pageID) {
                route = &candidate;
                break;
            }
        }
        if (route == nullptr) {
            Trace("TWriter::WriteReportPage -- Unknow PageID = " + pageID);
        } else {
            (this->*route->generator)(builder, pageID);
            // An inventory back-end shows the Halcyon logs with the Halcyon page.
            if (pageID == PAGE_HALCYON && fWriterType == TKR_WRITER_TYPE_INVENTORY) {
                Generator_HalcyonLogs(builder, pageID);
            }
        }
    } catch (...) {
        // A failed page stays as far as it was written, without its index
        // line; the next page starts afresh.
    }
    Trace("TWriter::WriteReportPage -- Exiting ");
}

void TWriter::NotYetGenerated(const std::string& pageID) {
    Trace("TWriter::WriteReportPage -- Unknow PageID = " + pageID);
    if (std::find(fUnavailablePages.begin(), fUnavailablePages.end(), pageID) == fUnavailablePages.end())
        fUnavailablePages.push_back(pageID);
}

}  // namespace braigrion
