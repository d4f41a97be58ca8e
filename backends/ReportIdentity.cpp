#include "ReportIdentity.h"

#include <vector>

#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace backends {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;

namespace {

std::vector<boost::shared_ptr<ICIMInstance>> Instances(const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns,
                                                       const std::string& className) {
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    try {
        boost::shared_ptr<ICIMClass> cls = ns->GetClass(className, TCIMContext());
        if (cls) cls->EnumerateInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(instances), true, TCIMContext());
    } catch (...) {
        instances.clear();
    }
    return instances;
}

// The first of `names` that the instance holds as a text that is not blank.
std::string FirstText(const boost::shared_ptr<ICIMInstance>& instance, std::initializer_list<const char*> names) {
    for (const char* name : names) {
        try {
            const TCIMValue& value = instance->GetProperty(name, TCIMContext())->GetValue(TCIMContext());
            if (value.IsNull()) continue;
            std::string text = value.ToString(10);
            if (text.find_first_not_of(" \t") != std::string::npos) return text;
        } catch (...) {
            // The next name, if any.
        }
    }
    return std::string();
}

// "20240311141502.000000-300" as "2024-03-11 14:15"; anything shorter than
// a date is left as it is.
std::string ReadableDate(const std::string& value) {
    if (value.size() < 12 || value.find_first_not_of("0123456789") < 12) return value;
    return value.substr(0, 4) + "-" + value.substr(4, 2) + "-" + value.substr(6, 2) + " " + value.substr(8, 2) + ":" +
           value.substr(10, 2);
}

}  // namespace

std::string TReportIdentity::Title() const {
    std::string title;
    for (const std::string* part : {&fHost, &fModel, &fSerial, &fDate}) {
        if (part->empty()) continue;
        if (!title.empty()) title += " \u00b7 ";
        title += *part;
    }
    return title.empty() ? std::string("Server report") : title;
}

TReportIdentity ReadReportIdentity(const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns) {
    TReportIdentity identity;
    if (!ns) return identity;
    std::vector<boost::shared_ptr<ICIMInstance>> systems = Instances(ns, "ORVSG_ComputerSystem");
    std::vector<boost::shared_ptr<ICIMInstance>> collections = Instances(ns, "ORVSG_CollectionInfo");
    if (!systems.empty()) {
        identity.fHost = FirstText(systems.front(), {"Name", "ElementName"});
        identity.fModel = FirstText(systems.front(), {"ProductName", "Model"});
        identity.fSerial = FirstText(systems.front(), {"SerialNumber"});
    }
    if (!collections.empty()) {
        if (identity.fHost.empty()) identity.fHost = FirstText(collections.front(), {"HostName"});
        if (identity.fSerial.empty()) identity.fSerial = FirstText(collections.front(), {"SerialNumber"});
        identity.fDate = ReadableDate(FirstText(collections.front(), {"CollectionTime"}));
    }
    identity.fHighlights = static_cast<int>(Instances(ns, "ORVSG_HeavyHittersLogRecord").size());
    return identity;
}

}  // namespace backends
}  // namespace braigrion
