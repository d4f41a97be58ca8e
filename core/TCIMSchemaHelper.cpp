#include "tkrcore/TCIMSchemaHelper.h"

#include "tkrcore/Callbacks.h"
#include "tkrcore/TTKRException.h"

namespace NORVTKR20 {

namespace {

const char kCollectionInfo[] = "ORVSG_CollectionInfo";

// The text of `property` on the first instance of `className`, or "" when the
// class, the instance or the property is missing or null.
std::string FirstInstanceText(const boost::shared_ptr<ICIMNamespace>& ns, const char* className,
                              const char* property, const TCIMContext& context) {
    if (!ns) return std::string();
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    try {
        boost::shared_ptr<ICIMClass> cls = ns->GetClass(className, context);
        cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, context);
        if (instances.empty()) return std::string();
        const TCIMValue& value = instances.front()->GetProperty(property, context)->GetValue(context);
        return value.ToString(10);
    } catch (const TTKRException& ex) {
        if (ex.fStatusCode.fStatusCode != kNotFound) throw;
    }
    return std::string();
}

}  // namespace

std::string TCIMSchemaHelper::GetDataSourceBuild(boost::shared_ptr<ICIMNamespace> ns, const TCIMContext& context) {
    return FirstInstanceText(ns, kCollectionInfo, "Build", context);
}

std::string TCIMSchemaHelper::GetDataSourceMajorVersion(boost::shared_ptr<ICIMNamespace> ns,
                                                        const TCIMContext& context) {
    return FirstInstanceText(ns, kCollectionInfo, "MajorVersion", context);
}

std::string TCIMSchemaHelper::GetDataSourceMinorVersion(boost::shared_ptr<ICIMNamespace> ns,
                                                        const TCIMContext& context) {
    return FirstInstanceText(ns, kCollectionInfo, "MinorVersion", context);
}

std::string TCIMSchemaHelper::GetOperatingSystemVersion(boost::shared_ptr<ICIMNamespace> ns) {
    return FirstInstanceText(ns, kCollectionInfo, "OSVersion", TCIMContext());
}

std::string TCIMSchemaHelper::GetRawSerialNumberString(boost::shared_ptr<ICIMNamespace> ns,
                                                       const TCIMContext& context) {
    std::string serial = FirstInstanceText(ns, kCollectionInfo, "SerialNumber", context);
    if (serial.empty()) serial = FirstInstanceText(ns, "ORVSG_ComputerSystem", "SerialNumber", context);
    return serial;
}

}  // namespace NORVTKR20
