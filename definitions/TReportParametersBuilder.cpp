#include "braigrion/TReportParametersBuilder.h"
#include "braigrion/Trace.h"

#include <vector>

#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMSchemaHelper.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::INamespaceProvider;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;

namespace {

const char* const kWindowsEventRecordClasses[] = {
    "ORVSG_WindowsSystemEventLogRecord",
    "ORVSG_WindowsApplicationEventLogRecord",
    "ORVSG_WindowsSecurityEventLogRecord",
};

}  // namespace

TReportParametersBuilder::TReportParametersBuilder(boost::shared_ptr<ICIMNamespace> ns, std::string mode, bool kmc)
    : fNamespace(ns), fMode(mode), fKMC(kmc) {}

boost::shared_ptr<ICIMClass> TReportParametersBuilder::GetClass(std::string name) const {
    TCIMContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));
    return fNamespace->GetClass(name, context);
}

bool TReportParametersBuilder::IsDelta() const {
    if (!fNamespace) return false;
    TCIMContext context;
    boost::shared_ptr<INamespaceProvider> provider = fNamespace->GetNamespaceProvider(context);
    if (!provider) return false;
    if (provider->GetProviderType(context) == 1) {
        Trace("TReportParametersBuilder::IsDelta -- Generation mode is DELTA ");
        return true;
    }
    Trace("TReportParametersBuilder::IsDelta -- Generation mode is not DELTA ");
    return false;
}

bool TReportParametersBuilder::IsPreboot() const {
    if (IsDelta()) return false;
    std::string build = NORVTKR20::TCIMSchemaHelper::GetDataSourceBuild(fNamespace, TCIMContext());
    return build.find("preboot") != std::string::npos;
}

int TReportParametersBuilder::GetOSType() const {
    Trace("TReportParametersBuilder::GetOSType -- Entering");
    int type = kOSUnknown;
    if (IsPreboot()) {
        type = kOSLinux;  // the pre-boot edition runs on Linux
    } else {
        type = OSTypeFromOperatingSystem();
        if (type == kOSUnknown && HasWindowsEventRecords()) type = kOSWindows;
    }
    Trace("TReportParametersBuilder::GetOSType -- Exiting");
    return type;
}

int TReportParametersBuilder::OSTypeFromOperatingSystem() const {
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    try {
        GetClass("ORVSG_OperatingSystem")->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true,
                                                               TCIMContext());
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
        return kOSUnknown;
    }
    // More than one operating system (several nodes, several boots) says
    // nothing reliable; the event records decide then.
    if (instances.size() != 1) return kOSUnknown;

    TCIMContext context;
    std::string vendor;
    bool hasOSType = false;
    unsigned int osType = 0;
    try {
        vendor = static_cast<std::string>(instances[0]->GetProperty("ProductVendor", context)->GetValue(context));
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    try {
        const TCIMValue& value = instances[0]->GetProperty("OSType", context)->GetValue(context);
        if (!value.IsNull()) {
            osType = static_cast<unsigned int>(value);
            hasOSType = true;
        }
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }

    if (vendor.find("Microsoft") != std::string::npos) {
        return (hasOSType && osType > 73) ? kOSWindowsServer : kOSWindows;
    }
    if (!hasOSType) return kOSUnknown;
    if (osType == 36) return kOSLinux;
    if (osType == 78 || osType == 81) return kOSVMwareESX;
    return kOSUnknown;
}

bool TReportParametersBuilder::HasWindowsEventRecords() const {
    for (const char* name : kWindowsEventRecordClasses) {
        bool found = false;
        try {
            GetClass(name)->EnumerateInstances(
                [&found](boost::shared_ptr<ICIMInstance>) {
                    found = true;
                    return false;  // one record is enough
                },
                true, TCIMContext());
        } catch (const TTKRException& ex) {
            if (!IsNotFound(ex)) throw;
        }
        if (found) return true;
    }
    return false;
}

}  // namespace braigrion
