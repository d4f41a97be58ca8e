#include "braigrion/TReport.h"
#include "braigrion/Trace.h"

#include <algorithm>
#include <cctype>
#include <stdexcept>
#include <vector>

#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMSchemaHelper.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using namespace TKR_REPORT_DEFINITION;
using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::INamespaceProvider;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;

namespace {

std::string Upper(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
    return text;
}

std::string Lower(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

// The text of a context key; `found` tells whether the key was there.
std::string ContextText(const TReport::TContext& context, const std::string& key, bool& found) {
    TReport::TContext::const_iterator it = context.find(key);
    found = it != context.end();
    return found ? static_cast<std::string>(it->second) : std::string();
}


void StartCategoryLog(const std::string& name) {
    Trace("TReport::Write -- Start generating category [" + name + "]");
}

}  // namespace

TReport::TReport(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, TContext context, std::string outputPath)
    : fNamespace(ns),
      fOutputPath(outputPath),
      fMode("default"),
      fKMC(false),
      fDelta(false),
      fPreboot(false),
      fSpare(false) {
    Trace("TReport::TReport -- Entering");
    if (!fNamespace) throw std::invalid_argument("TReport: the namespace is null");

    bool found = false;
    std::string mode = ContextText(context, "mode", found);
    if (found) fMode = mode;
    Trace("TReport::TReport -- TKR mode = " + fMode);

    // "VCX" is read after "KMC", so that it decides when both are given.
    std::string kmc = ContextText(context, "KMC", found);
    if (found) {
        fKMC = Upper(kmc) == "TRUE";
    } else {
        Trace("TReport::TReport -- Can not detected KMC from TCIMContext, set fKMC to FALSE ");
    }
    std::string vcx = ContextText(context, "VCX", found);
    if (found) {
        fKMC = Upper(vcx) == "TRUE";
    } else {
        Trace("TReport::TReport -- Can not detected VCX from TCIMContext, set fKMC to FALSE ");
    }

    TContext empty;
    boost::shared_ptr<INamespaceProvider> provider = fNamespace->GetNamespaceProvider(empty);
    if (provider && provider->GetProviderType(empty) == 1) {
        fDelta = true;
        Trace("TReport::TReport -- Generation mode is DELTA ");
    } else {
        Trace("TReport::TReport -- Generation mode is not DELTA ");
    }

    // A delta view is never pre-boot data.
    if (!fDelta) {
        std::string build = NORVTKR20::TCIMSchemaHelper::GetDataSourceBuild(fNamespace, empty);
        if (build.find("preboot") != std::string::npos) {
            fPreboot = true;
            Trace("TReport::TReport -- TKR type is Preboot ");
        } else {
            Trace("TReport::TReport -- TKR type is not Preboot ");
        }
    }

    fPageID = ContextText(context, "pageID", found);
    fViewID = ContextText(context, "viewID", found);
    fDataID = ContextText(context, "dataID", found);
    fTestID = ContextText(context, "testID", found);
}

TReport::~TReport() {}

boost::shared_ptr<TReportParametersBuilder> TReport::MakeBuilder() const {
    return boost::shared_ptr<TReportParametersBuilder>(new TReportParametersBuilder(fNamespace, fMode, fKMC));
}

void TReport::Write(TWriter* writer, TContext context) {
    Trace("TReport::Writet -- Entering");
    if (writer == nullptr) {
        Log(0, "TReport::Write -- Null-Pointor exception: Parameter (TWriter *writer == NULL)");
        return;
    }

    if (!fDelta) {
        Trace("TReport::Write -- Under Non-DELTA mode, invoking fixing functions");
        fixCriticalDetailforRaidDiskRemoval();
        fixProductNameofComputerSystem();
        fixRedundantMonitorInfo(context);
        AddManufacturerForMem();
        ConvertEmulexKoSTypeIDToHex();
    } else {
        Trace("TReport::Write -- Under DELTA mode, don't invok fixing functions");
    }

    boost::shared_ptr<TReportParametersBuilder> builder = MakeBuilder();
    Trace("TReport::Write -- Start generating TKR output report");
    writer->BaseInitialize(fNamespace, context, builder);
    writer->Initialize(fNamespace, context, fOutputPath);

    WriteCategories(writer, builder);

    writer->EndReport();
    Trace("TReport::Write -- End of generating TKR output report");
    writer->BaseDispose();
    Trace("TReport::Write -- Exiting");
}

// One step of a report's walk. The walk is planned first, then carried out,
// so that the pages it will ask for can be counted before it starts. The
// operating system logs are planned as one step, kOSLogs, that stands for
// the steps OSLogsSteps gives: the OS type is asked only when the walk
// reaches that category, so that what finding it logs stands inside it.
// The count takes the type the writer found when it was set up.
struct TReport::TStep {
    enum EKind { kCategoryLog, kTrace, kError, kStartReport, kWriteCategory, kEndCategory, kPage, kOSLogs };
    EKind fKind;
    std::string fText;
};

// The heading and page of the operating system logs for an OS type: Windows
// (0, 1) or Linux (2, 3) logs; any other type has neither.
std::vector<TReport::TStep> TReport::OSLogsSteps(int osType) {
    std::vector<TStep> steps;
    if (osType == 0 || osType == 1) {
        steps.push_back(TStep{TStep::kWriteCategory, CATEGORY_WINDOWS_LOGS});
        steps.push_back(TStep{TStep::kPage, PAGE_OS_LOGS});
    } else if (osType == 2 || osType == 3) {
        steps.push_back(TStep{TStep::kWriteCategory, CATEGORY_LINUX_LOGS});
        steps.push_back(TStep{TStep::kPage, PAGE_OS_LOGS});
    } else {
        steps.push_back(TStep{TStep::kError, "TReport::Write -- Unknow OS type]"});
    }
    return steps;
}

std::vector<TReport::TStep> TReport::PlanCategories() const {
    std::vector<TStep> plan;
    auto step = [&](TStep::EKind kind, const std::string& text) { plan.push_back(TStep{kind, text}); };
    auto pages = [&](std::initializer_list<std::string> ids) {
        for (const std::string& id : ids) step(TStep::kPage, id);
    };

    step(TStep::kCategoryLog, CATEGORY_SOFTWARE);
    step(TStep::kStartReport, "");
    step(TStep::kWriteCategory, CATEGORY_SOFTWARE);
    pages({PAGE_SYSTEM_OVERVIEW, PAGE_OS_INSTALLATIONS, PAGE_NETWORK_SETTINGS, PAGE_RESOURCE_UTILIZATION,
           PAGE_PROCESS_INFORMATION, PAGE_OS_CONFIGURATION});

    step(TStep::kCategoryLog, CATEGORY_HARDWARE);
    step(TStep::kEndCategory, "");
    step(TStep::kWriteCategory, CATEGORY_HARDWARE);
    pages({PAGE_HARDWARE_INVENTORY, PAGE_PCI_INFORMATION, PAGE_FIRMWARE_VPD, PAGE_SERV_PROC_CONFIGURATION,
           PAGE_ENVIRONMENTALS, PAGE_DRIVE_HEALTH, PAGE_LSI_CONTROLLER, PAGE_LSI_IDE_CONTROLLER, PAGE_MELLANOX,
           PAGE_SOLARFLARE, PAGE_FUSIONIO, PAGE_PMC_RAID, PAGE_HALCYON, PAGE_HALCYON_LOGS, PAGE_QLOGIC, PAGE_EMULEX,
           PAGE_BROADCOM, PAGE_BROCADE_ADAPTER, PAGE_VMWARE_ESXI, PAGE_GLOW_TRACE, PAGE_BIST, PAGE_KMC_LICENSE_KEY,
           PAGE_BIOS_SETTINGS});
    if (fKMC) step(TStep::kPage, PAGE_VCX);

    // Pre-boot data hold no operating system logs. No EndCategory either, so
    // the next category's EndCategory closes "Hardware".
    step(TStep::kCategoryLog, CATEGORY_OS_LOGS);
    if (fPreboot) {
        step(TStep::kTrace, "TReport::Write -- Under pTKR, no OS Logs information needed");
    } else {
        step(TStep::kEndCategory, "");
        step(TStep::kOSLogs, "");
    }

    step(TStep::kCategoryLog, CATEGORY_SERVPROC_LOGS);
    step(TStep::kEndCategory, "");
    step(TStep::kWriteCategory, fKMC ? CATEGORY_KMC_LOGS : CATEGORY_SP_LOGS);
    step(TStep::kPage, PAGE_SP_LOGS);

    step(TStep::kCategoryLog, CATEGORY_ORV_SERVICE);
    if (fMode == "luz") {
        step(TStep::kEndCategory, "");
        step(TStep::kWriteCategory, CATEGORY_ORV_SERVICE);
        pages({PAGE_QVA_CHIPSET_REGISTER, PAGE_CFT_SETTING, PAGE_NVSMI_LOG, PAGE_AMDATICONFIG_LOG, PAGE_SPINT_LOG});
    } else {
        step(TStep::kTrace, "TReport::Write -- Under Non-LUZ (default) mode, no ORV Service information needed");
    }

    step(TStep::kCategoryLog, CATEGORY_ANALYSIS);
    step(TStep::kEndCategory, "");
    step(TStep::kWriteCategory, CATEGORY_ANALYSIS);
    pages({PAGE_MERGED_LOG, PAGE_MERGED_DEVICE, PAGE_MELODY_DEVICE, PAGE_PATCHBEACON, PAGE_FILE_LOADER,
           PAGE_DIAGNOSTIC});

    // The error log closes the index: its category has no heading of its own.
    step(TStep::kCategoryLog, CATEGORY_TKR_ERROR_LOG);
    step(TStep::kEndCategory, "");
    step(TStep::kPage, PAGE_TKR_ERROR_LOGS);
    return plan;
}

std::vector<std::string> TReport::PlannedPages(const TReportParametersBuilder& builder) const {
    std::vector<std::string> pages;
    for (const TStep& s : PlanCategories()) {
        if (s.fKind == TStep::kPage) pages.push_back(s.fText);
        if (s.fKind != TStep::kOSLogs) continue;
        for (const TStep& os : OSLogsSteps(builder.GetOSType()))
            if (os.fKind == TStep::kPage) pages.push_back(os.fText);
    }
    return pages;
}

void TReport::WriteCategories(TWriter* writer, const boost::shared_ptr<TReportParametersBuilder>& builder) {
    const std::vector<TStep> plan = PlanCategories();
    auto pages = [](const std::vector<TStep>& steps) {
        size_t n = 0;
        for (const TStep& s : steps) n += s.fKind == TStep::kPage;
        return n;
    };
    // The operating system logs are counted by the type the writer's set-up
    // found; should the type asked in their category differ, the total
    // follows it.
    const size_t osPagesPlanned = pages(OSLogsSteps(writer->GetOSType()));
    size_t total = pages(plan), done = 0;
    for (const TStep& s : plan) total += s.fKind == TStep::kOSLogs ? osPagesPlanned : 0;
    for (const TStep& planned : plan) {
        std::vector<TStep> steps(1, planned);
        if (planned.fKind == TStep::kOSLogs) {
            steps = OSLogsSteps(builder->GetOSType());
            total = total - osPagesPlanned + pages(steps);
        }
        for (const TStep& s : steps) RunStep(writer, builder, s, done, total);
    }
}

void TReport::RunStep(TWriter* writer, const boost::shared_ptr<TReportParametersBuilder>& builder, const TStep& s,
                      size_t& done, size_t total) {
    switch (s.fKind) {
        case TStep::kCategoryLog: StartCategoryLog(s.fText); break;
        case TStep::kTrace: Trace(s.fText); break;
        case TStep::kError: Log(0, s.fText); break;
        case TStep::kStartReport: writer->StartReport(); break;
        case TStep::kWriteCategory: writer->WriteCategory(s.fText); break;
        case TStep::kEndCategory: writer->EndCategory(); break;
        case TStep::kPage:
            if (fPageObserver) fPageObserver(++done, total, s.fText);
            writer->WriteReportPage(builder, s.fText);
            break;
        case TStep::kOSLogs: break;  // replaced by its steps before it runs
    }
}

std::string TReport::GetPage(TWriter* writer, TContext context) {
    Trace("TReport::GetPage -- Entering");
    if (writer == nullptr) {
        Log(0, "TReport::GetPage -- Null-Pointor exception: Parameter (TWriter *writer == NULL)");
        return std::string();
    }

    boost::shared_ptr<TReportParametersBuilder> builder = MakeBuilder();
    writer->BaseInitialize(fNamespace, context, builder);
    writer->Initialize(fNamespace, context, fOutputPath);

    std::string page;
    if (writer->GetWriterType().find(TKR_WRITER_TYPE_INVENTORY) == std::string::npos) {
        Trace("TReport::GetPage -- Writer type is not inventory, just return void string");
    } else {
        Trace("TReport::GetPage -- Start generating TKR inventory page, ID = [" + fPageID + "]");
        // Only the repairs that the asked page needs.
        if (fPageID == PAGE_INVENTORY_ANALYSIS) {
            Trace("TReport::GetPage -- Invoking memory manufacture fixing function for Analysis page");
            AddManufacturerForMem();
        } else if (fPageID == PAGE_HARDWARE_INVENTORY) {
            AddManufacturerForMem();
            fixRedundantMonitorInfo(context);
        } else if (fPageID == PAGE_REPORT_HIGHLIGHTS) {
            fixCriticalDetailforRaidDiskRemoval();
        } else if (fPageID == PAGE_SYSTEM_OVERVIEW) {
            fixCriticalDetailforRaidDiskRemoval();
            fixProductNameofComputerSystem();
        } else if (fPageID == PAGE_EMULEX) {
            ConvertEmulexKoSTypeIDToHex();
        }
        writer->WriteReportPage(builder, fPageID);
        page = writer->GetInventoryPage();
    }

    writer->BaseDispose();
    Trace("TReport::GetPage -- Exiting");
    return page;
}

void TReport::DetermineKMC() {
    Trace("TReport::DetermineKMC -- Entering");
    try {
        TContext empty;
        boost::shared_ptr<ICIMClass> cls = fNamespace->GetClass("ORVSG_IPMIFirmwareElement", empty);
        std::vector<boost::shared_ptr<ICIMInstance>> instances;
        cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, empty);
        if (instances.empty()) {
            Trace("TReport::DetermineKMC -- There is no instance of ORVSG_IPMIFirmwareElement");
        }
        for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
            std::string name = Lower(static_cast<std::string>(instance->GetProperty("Name", empty)->GetValue(empty)));
            if (name.find("kinetic management core") != std::string::npos) fKMC = true;
        }
    } catch (const TTKRException&) {
        Trace("TReport::DetermineKMC -- Exception when determining is KMC or not");
    }
    Trace("TReport::DetermineKMC -- Exiting");
}

}  // namespace braigrion
