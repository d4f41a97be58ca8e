#include "Progress.h"

#include <ostream>

#include "braigrion/ReportDefinition.h"

namespace braigrion {
namespace cli {

using namespace TKR_REPORT_DEFINITION;

std::vector<std::string> PlannedPages(const TReport& report, const TReportParametersBuilder& builder) {
    std::vector<std::string> pages = {PAGE_SYSTEM_OVERVIEW, PAGE_OS_INSTALLATIONS, PAGE_NETWORK_SETTINGS,
                                      PAGE_RESOURCE_UTILIZATION, PAGE_PROCESS_INFORMATION, PAGE_OS_CONFIGURATION,
                                      PAGE_HARDWARE_INVENTORY, PAGE_PCI_INFORMATION, PAGE_FIRMWARE_VPD,
                                      PAGE_SERV_PROC_CONFIGURATION, PAGE_ENVIRONMENTALS, PAGE_DRIVE_HEALTH,
                                      PAGE_LSI_CONTROLLER, PAGE_LSI_IDE_CONTROLLER, PAGE_MELLANOX, PAGE_SOLARFLARE,
                                      PAGE_FUSIONIO, PAGE_PMC_RAID, PAGE_HALCYON, PAGE_HALCYON_LOGS, PAGE_QLOGIC,
                                      PAGE_EMULEX, PAGE_BROADCOM, PAGE_BROCADE_ADAPTER, PAGE_VMWARE_ESXI,
                                      PAGE_GLOW_TRACE, PAGE_BIST, PAGE_KMC_LICENSE_KEY, PAGE_BIOS_SETTINGS};
    if (report.IsKMC()) pages.push_back(PAGE_VCX);
    int os = builder.GetOSType();
    if (!report.IsPreboot() && os >= 0 && os <= 3) pages.push_back(PAGE_OS_LOGS);
    pages.push_back(PAGE_SP_LOGS);
    if (report.GetMode() == "luz") {
        pages.insert(pages.end(), {PAGE_QVA_CHIPSET_REGISTER, PAGE_CFT_SETTING, PAGE_NVSMI_LOG,
                                   PAGE_AMDATICONFIG_LOG, PAGE_SPINT_LOG});
    }
    pages.insert(pages.end(), {PAGE_MERGED_LOG, PAGE_MERGED_DEVICE, PAGE_MELODY_DEVICE, PAGE_PATCHBEACON,
                               PAGE_FILE_LOADER, PAGE_DIAGNOSTIC, PAGE_TKR_ERROR_LOGS});
    return pages;
}

TProgressLog::TProgressLog(std::ostream& out, size_t total, bool show)
    : fOut(out), fTotal(total), fSeen(0), fShow(show), fLineShown(false) {
    NORVTKR20::TRootObject::SetCoreLogger(this);
}

TProgressLog::~TProgressLog() {
    Finish();
    NORVTKR20::TRootObject::SetCoreLogger(nullptr);
}

void TProgressLog::Log(int level, const std::string& message) {
    NORVTKR20::TRootObject::GetDefaultLogger().Log(level, message);
    // The report logs this line once as it starts each page.
    static const std::string kPageStart = "TWriter::WriteReportPage -- WriterType = [";
    static const std::string kPageID = "] PageID = [";
    if (message.compare(0, kPageStart.size(), kPageStart) != 0) return;
    size_t at = message.find(kPageID);
    if (at == std::string::npos) return;
    std::string page = message.substr(at + kPageID.size());
    if (!page.empty() && page.back() == ']') page.pop_back();
    ++fSeen;
    if (!fShow) return;
    fOut << "\r\033[Kbraigrion: page " << fSeen << " of " << (fSeen > fTotal ? fSeen : fTotal) << ": " << page
         << std::flush;
    fLineShown = true;
}

void TProgressLog::Finish() {
    if (fLineShown) fOut << "\r\033[K" << std::flush;
    fLineShown = false;
}

}  // namespace cli
}  // namespace braigrion
