// The ESXi writer frame: the generic page, the system overview and the
// helpers of the ESXi pages.
#include "TWriter_vmwesxi.h"

#include <stdexcept>

#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

const char kErrorLogName[] = "TKR Error Log";

}  // namespace

TWriter_vmwesxi::TWriter_vmwesxi() : fMode("default"), fCachingDates(false) {}

TWriter_vmwesxi::~TWriter_vmwesxi() {}

void TWriter_vmwesxi::SetUp(TNamespacePtr ns, const TContext& context, const std::string& outputPath) {
    fNamespace = ns;
    fOutputPath = outputPath;
    TContext::const_iterator mode = context.find("mode");
    fMode = mode == context.end() ? std::string("default") : static_cast<std::string>(mode->second);
}

void TWriter_vmwesxi::WriteGenericReport(TReportParameters params) {
    Trace("TWriter_vmwesxi::WriteGenericReport -- Enter");
    Trace("TWriter_vmwesxi::WriteGenericReport -- Current report name is " + params.GetReportName());
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    if (params.ShowReportTitle()) WriteReportTitle(params.GetReportName(), "", "");

    bool hasData = false;
    for (const TReportClass& reportClass : params.GetClasses()) {
        std::vector<TInstancePtr> instances = TWriterUtil::GetInstances(fNamespace, reportClass);
        // The patch check's table stands even when it found nothing.
        if (instances.empty() && reportClass.GetClass() != "ORVSG_PBResult") continue;
        WriteTable(reportClass, instances, true, false, TContext());
        hasData = true;
    }

    WritePageFooter();
    ClosePage();
    if (params.GetReportName() == kErrorLogName && fMode == "default") hasData = false;
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter_vmwesxi::WriteGenericReport -- Exiting ");
}

void TWriter_vmwesxi::WriteCustomSystemOverview(TReportParameters params) {
    Trace("THtmlWriter_vmwesxi::WriteSystemOverview -- Entering");
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    if (params.ShowReportTitle()) WriteReportTitle(params.GetReportName(), "", "");

    bool hasData = false;
    try {
        TCIMContext context;
        for (TReportClass reportClass : params.GetClasses()) {
            const std::string className = reportClass.GetClass();
            std::vector<TInstancePtr> instances;
            if (className == "CIM_PhysicalElement") {
                for (const TInstancePtr& instance : TWriterUtil::GetInstances(fNamespace, reportClass)) {
                    if (HasKey(instance, "ORV", "Model")) instances.push_back(instance);
                }
            } else if (className == "VMware_HypervisorSoftwareIdentity") {
                // The hypervisor is shown from the software identities that
                // name it, whichever class holds them; the definition's
                // columns and filters stay.
                reportClass.SetClass("CIM_SoftwareIdentity");
                reportClass.SetTitle("Operating System");
                for (const TInstancePtr& instance : TWriterUtil::GetInstances(fNamespace, reportClass)) {
                    if (HasKey(instance, "VMware ESX", "VersionString")) instances.push_back(instance);
                }
            } else {
                instances = TWriterUtil::GetInstances(fNamespace, reportClass);
            }
            if (className == "OMC_Chassis") {
                // A chassis without a serial number of its own shows the one
                // the system's identifying info carries.
                for (const TInstancePtr& chassis : instances) {
                    try {
                        boost::shared_ptr<ICIMProperty> serial = chassis->GetProperty("SerialNumber", context);
                        const std::string text = serial->GetValueString();
                        if (text.empty() || text == "none") serial->SetValue(TCIMValue(GetSerialNumber(text)), context);
                    } catch (const TTKRException&) {
                        // A chassis without the property keeps it absent.
                    }
                }
            }
            if (instances.empty()) continue;
            WriteTable(reportClass, instances, true, false, TContext());
            hasData = true;
        }
    } catch (...) {
        Trace("THtmlWriter_vmwesxi::WriteSystemOverview -- Exception when writting report");
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("THtmlWriter_vmwesxi::WriteSystemOverview -- Exiting");
}

std::string TWriter_vmwesxi::SwitchUUID(std::string uuid) {
    if (uuid.size() < 18) throw std::out_of_range("TWriter_vmwesxi::SwitchUUID: a UUID has at least 18 characters");
    std::string switched;
    switched += uuid.substr(6, 2) + uuid.substr(4, 2) + uuid.substr(2, 2) + uuid.substr(0, 2) + "-";
    switched += uuid.substr(11, 2) + uuid.substr(9, 2) + "-";
    switched += uuid.substr(16, 2) + uuid.substr(14, 2);
    return switched + uuid.substr(18);
}

bool TWriter_vmwesxi::HasKey(TInstancePtr instance, std::string key, std::string property) {
    if (!instance) return false;
    try {
        boost::shared_ptr<ICIMProperty> found = instance->GetProperty(property, TCIMContext());
        return found && found->GetValueString().find(key) != std::string::npos;
    } catch (...) {
        return false;
    }
}

std::string TWriter_vmwesxi::GetSerialNumber(std::string /*unused*/) {
    try {
        TCIMContext context;
        std::vector<TInstancePtr> systems;
        fNamespace->GetClass("OMC_UnitaryComputerSystem", context)
            ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(systems), true, context);
        for (const TInstancePtr& system : systems) {
            std::vector<std::string> infos;
            try {
                infos = system->GetProperty("OtherIdentifyingInfo", context)->GetValueStrings();
            } catch (const TTKRException&) {
                continue;
            }
            for (const std::string& info : infos) {
                const std::string::size_type colon = info.find(':');
                if (colon == std::string::npos || (!info.empty() && info.back() == '-')) continue;
                return info.substr(colon + 1);
            }
        }
    } catch (const TTKRException&) {
        // No system, no serial number.
    }
    return std::string();
}

}  // namespace braigrion
