// Facts about a collection, read from its ORVSG_CollectionInfo instance.
#pragma once

#include <string>

#include <boost/shared_ptr.hpp>

#include "tkrcore/CIMInterfaces.h"

namespace NORVTKR20 {

class TCIMSchemaHelper {
public:
    static std::string GetDataSourceBuild(boost::shared_ptr<ICIMNamespace> ns, const TCIMContext& context);
    static std::string GetDataSourceMajorVersion(boost::shared_ptr<ICIMNamespace> ns, const TCIMContext& context);
    static std::string GetDataSourceMinorVersion(boost::shared_ptr<ICIMNamespace> ns, const TCIMContext& context);
    static std::string GetOperatingSystemVersion(boost::shared_ptr<ICIMNamespace> ns);
    // SerialNumber of the collection, else of the first ORVSG_ComputerSystem.
    static std::string GetRawSerialNumberString(boost::shared_ptr<ICIMNamespace> ns, const TCIMContext& context);
};

}  // namespace NORVTKR20
