// braigrion page: one page through the inventory back-end, on standard output.
#include <CLI/CLI.hpp>

#include <algorithm>
#include <filesystem>
#include <ostream>
#include <stdexcept>

#include <unistd.h>

#include "CollectionLoader.h"
#include "Commands.h"
#include "RunContext.h"
#include "TInventoryWriter.h"
#include "braigrion/ReportDefinition.h"
#include "braigrion/TReport.h"

namespace fs = std::filesystem;

namespace braigrion {
namespace cli {

namespace {

using namespace TKR_REPORT_DEFINITION;

const std::vector<std::string>& PageIDs() {
    static const std::vector<std::string> ids = {
        PAGE_SYSTEM_OVERVIEW, PAGE_REPORT_HIGHLIGHTS, PAGE_OS_INSTALLATIONS, PAGE_NETWORK_SETTINGS,
        PAGE_RESOURCE_UTILIZATION, PAGE_PROCESS_INFORMATION, PAGE_OS_CONFIGURATION, PAGE_HARDWARE_INVENTORY,
        PAGE_PCI_INFORMATION, PAGE_FIRMWARE_VPD, PAGE_SERV_PROC_CONFIGURATION, PAGE_KMC_CONFIGURATION,
        PAGE_ENVIRONMENTALS, PAGE_DRIVE_HEALTH, PAGE_LSI_CONTROLLER, PAGE_LSI_IDE_CONTROLLER, PAGE_MELLANOX,
        PAGE_SOLARFLARE, PAGE_DIABLO, PAGE_FUSIONIO, PAGE_PMC_RAID, PAGE_HALCYON, PAGE_HALCYON_LOGS, PAGE_QLOGIC,
        PAGE_EMULEX, PAGE_BROADCOM, PAGE_BROCADE_ADAPTER, PAGE_VMWARE_ESXI, PAGE_GLOW_TRACE, PAGE_KMC_BIST,
        PAGE_BIST, PAGE_KMC_LICENSE_KEY, PAGE_BIOS_SETTINGS, PAGE_VCX, PAGE_OS_LOGS, PAGE_KMC_LOGS, PAGE_SP_LOGS,
        PAGE_QVA_CHIPSET_REGISTER, PAGE_CFT_SETTING, PAGE_AMDATICONFIG_LOG, PAGE_NVSMI_LOG, PAGE_SPINT_LOG,
        PAGE_MERGED_LOG, PAGE_MERGED_DEVICE, PAGE_INVENTORY_ANALYSIS, PAGE_MELODY_DEVICE, PAGE_PATCHBEACON,
        PAGE_FILE_LOADER, PAGE_DIAGNOSTIC, PAGE_TKR_ERROR_LOGS};
    return ids;
}

// A private directory for whatever a page might write beside itself; the
// inventory back-end itself writes nothing.
class TScratchDirectory {
public:
    TScratchDirectory() {
        std::string pattern = (fs::temp_directory_path() / "braigrion-page-XXXXXX").string();
        std::vector<char> buffer(pattern.begin(), pattern.end());
        buffer.push_back('\0');
        if (::mkdtemp(buffer.data()) == nullptr) throw std::runtime_error("cannot create a temporary directory");
        fPath = buffer.data();
    }
    ~TScratchDirectory() {
        std::error_code ignored;
        fs::remove_all(fPath, ignored);
    }
    const std::string& Path() const { return fPath; }

private:
    std::string fPath;
};

}  // namespace

CLI::App* AddPageCommand(CLI::App& app, TPageOptions& options) {
    CLI::App* command = app.add_subcommand("page", "Print one page of a collection's report as an inventory page");
    command->add_option("page", options.fPageID, "Page id, such as SystemConfig or HardwareInfo")
        ->required()
        ->type_name("PAGE_ID");
    command->add_option("collection", options.fFiles, "CIM-XML files that together form one collection")
        ->required()
        ->type_name("FILE");
    AddRunOptions(*command, options.fRun);
    std::string ids;
    for (size_t i = 0; i < PageIDs().size(); ++i) ids += (i % 6 == 0 ? "\n  " : " ") + PageIDs()[i];
    command->footer("Page ids:" + ids);
    return command;
}

int RunPage(const TPageOptions& options, std::ostream& out, std::ostream& err) {
    bool known = false;
    for (const std::string& id : PageIDs()) known = known || id == options.fPageID;
    if (!known) throw TInputError("unknown page id '" + options.fPageID + "' (see braigrion page --help)");
    SetUpLog(options.fRun);
    repository::TLoadResult loaded = LoadFiles(options.fFiles);
    for (const std::string& warning : loaded.fWarnings) err << "braigrion: warning: " << warning << '\n';

    TScratchDirectory scratch;
    TContextMap context = MakeContext(options.fRun);
    context["pageID"] = NORVTKR20::TCIMValue(options.fPageID);
    TReport report(loaded.fNamespace, context, scratch.Path());
    backends::TInventoryWriter writer;
    ApplyLogLinkOptions(options.fRun, writer);
    std::string page = report.GetPage(&writer, context);
    const std::vector<std::string>& unavailable = writer.GetUnavailablePages();
    if (page.empty() && std::find(unavailable.begin(), unavailable.end(), options.fPageID) != unavailable.end()) {
        throw std::runtime_error("page " + options.fPageID + " is not available in this version");
    }
    if (page.empty()) {
        throw std::runtime_error("page " + options.fPageID + " has nothing to show for this collection in " +
                                 options.fRun.fMode + " mode");
    }
    out << page;
    return 0;
}

}  // namespace cli
}  // namespace braigrion
