#include "TReportParametersBuilder_vmwesxi.h"

#include <vector>

#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TTKRException;

TReportParametersBuilder_vmwesxi::TReportParametersBuilder_vmwesxi(TNamespacePtr ns, std::string mode)
    : fNamespace(ns), fMode(mode) {}

boost::shared_ptr<ICIMClass> TReportParametersBuilder_vmwesxi::GetClass(const std::string& name) const {
    TCIMContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));
    return fNamespace->GetClass(name, context);
}

bool TReportParametersBuilder_vmwesxi::IsMultiNode() const {
    try {
        std::vector<boost::shared_ptr<ICIMInstance>> chassis;
        GetClass("OMC_Chassis")->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(chassis), true,
                                                    TCIMContext());
        if (chassis.empty()) return false;
        TCIMContext context;
        boost::shared_ptr<ICIMProperty> property = chassis.front()->GetProperty("IpmiNodeCount", context);
        if (!property) return false;
        const TCIMValue& value = property->GetValue(context);
        if (value.IsNull()) return false;
        unsigned int nodes = static_cast<unsigned short>(value) & 0xFFu;
        Trace("TReportParametersBuilder_vmwesxi::IsMultiNode() IpmiNodeCount=" + std::to_string(nodes));
        return nodes >= 2;
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return false;
}

}  // namespace braigrion
