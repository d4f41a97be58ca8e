// The probes by which the catalogue and the writers choose what a page shows:
// data source version, lookout service processor, multi-node system, NIC
// teams, hardware activation key, Red Hat. Each probe reads the repository
// anew. An absent class (status 15) gives the probe's "no" answer; any other
// failure of the repository is passed on.
#include <vector>

#include "braigrion/TReportParametersBuilder.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMSchemaHelper.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMSchemaHelper;
using NORVTKR20::TCIMValue;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;

namespace {

typedef std::vector<boost::shared_ptr<ICIMInstance>> TInstances;

// The instances of a class, deep. Throws status 15 when the class is absent.
TInstances InstancesOf(const TReportParametersBuilder& builder, const std::string& className) {
    TInstances instances;
    builder.GetClass(className)->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true,
                                                    TCIMContext());
    return instances;
}

// The value of a property, or a null value when the instance lacks it.
TCIMValue ValueOf(const boost::shared_ptr<ICIMInstance>& instance, const std::string& property) {
    TCIMContext context;
    try {
        boost::shared_ptr<ICIMProperty> found = instance->GetProperty(property, context);
        if (found) return found->GetValue(context);
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return TCIMValue();
}

}  // namespace

std::string TReportParametersBuilder::GetDataSourceVersion() const {
    TCIMContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));

    // A delta view has no one collector build to speak of.
    std::string build;
    if (!IsDelta()) build = TCIMSchemaHelper::GetDataSourceBuild(fNamespace, context);

    std::string major;
    std::string minor;
    try {
        major = TCIMSchemaHelper::GetDataSourceMajorVersion(fNamespace, context);
    } catch (const TTKRException&) {
    }
    try {
        minor = TCIMSchemaHelper::GetDataSourceMinorVersion(fNamespace, context);
    } catch (const TTKRException&) {
    }
    if (!minor.empty()) minor = minor.substr(0, 1);
    // The pre-boot edition has every table of the newest data layout.
    if (build.find("preboot") != std::string::npos && major < "3") major = "3";

    std::string version = major + "." + minor;
    Trace("Report - GetDataSourceVersion: " + version);
    return version;
}

bool TReportParametersBuilder::IsLookout() const {
    try {
        TInstances systems = InstancesOf(*this, "ORVSG_SP_LookoutSystem");
        if (systems.empty()) return false;
        TCIMValue present = ValueOf(systems.front(), "LookoutPresent");
        if (present.IsNull()) return false;
        return static_cast<bool>(present);
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return false;
}

bool TReportParametersBuilder::IsMultiNode() const {
    try {
        TInstances systems = InstancesOf(*this, "ORVSG_ComputerSystem");
        if (systems.empty()) return false;
        TCIMContext context;
        boost::shared_ptr<ICIMProperty> property = systems.front()->GetProperty("SystemNodes", context);
        if (!property) return false;
        // A null count is a fault of the collector and is passed on.
        unsigned int nodes = static_cast<unsigned char>(property->GetValue(context));
        Trace("TReportParametersBuilder::IsMultiNode() SystemNodes=" + std::to_string(nodes));
        return nodes >= 2;
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return false;
}

bool TReportParametersBuilder::HasTeamInfo() const {
    Trace("Report - HasTeamInfo: Enter");
    TInstances ports;
    try {
        ports = InstancesOf(*this, "ORVSG_PhysicalNetworkPort");
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
        Trace("Report - HasTeamInfo: Unknown");
        return false;
    }
    for (const boost::shared_ptr<ICIMInstance>& port : ports) {
        if (!ValueOf(port, "TeamName").IsNull() && !ValueOf(port, "TeamID").IsNull()) {
            Trace("Report - HasTeamInfo: True");
            return true;
        }
    }
    return false;
}

bool TReportParametersBuilder::IsSupportKMCKey() const {
    TInstances keys;
    try {
        keys = InstancesOf(*this, "ORV_ActivationKey");
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    if (keys.empty()) {
        Trace("Report - IsSupportKMCKey: Unknown");
        return false;
    }
    std::string description = static_cast<std::string>(ValueOf(keys.front(), "ActivationKeyDescription"));
    if (description.find("Hardware Activation Key") == std::string::npos) return false;
    Trace("Report - IsSupportKMCKey: True");
    return true;
}

bool TReportParametersBuilder::IsRedHat() const {
    TInstances systems;
    try {
        systems = InstancesOf(*this, "ORVSG_OperatingSystem");
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    if (systems.size() != 1) {
        Trace("Report - IsRedHat: Unknown");
        return false;
    }
    std::string vendor = static_cast<std::string>(ValueOf(systems.front(), "ProductVendor"));
    if (vendor.find("Red Hat") == std::string::npos) return false;
    Trace("Report - IsRedHat: True");
    return true;
}

}  // namespace braigrion
