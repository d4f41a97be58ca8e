// The report of a collection taken from an ESXi host: a fixed list of
// categories and pages, the same for every host, written through an ESXi
// writer back-end. It has no delta mode and no page conditions.
#pragma once

#include <map>
#include <string>

#include <boost/shared_ptr.hpp>

#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TWriter_vmwesxi;

class TReport_vmwesxi {
public:
    typedef std::map<std::string, NORVTKR20::TCIMValue> TContext;

    // Reads "mode" from the context ("default" without it).
    TReport_vmwesxi(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, TContext context, std::string outputPath);

    // Writes every page. A failure that escapes a page ends the sequence
    // there: it is logged, the report is not ended, and Write returns.
    void Write(TWriter_vmwesxi* writer, TContext context);

    // Whether a collection comes from an ESXi host: it holds an instance of
    // one of the host's identifying classes (OMC_UnitaryComputerSystem,
    // VMware_HypervisorSoftwareIdentity, OMC_Chassis) and no operating
    // system of the base collectors (ORVSG_OperatingSystem).
    static bool IsESXiCollection(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns);

    std::string GetMode() const { return fMode; }

private:
    boost::shared_ptr<NORVTKR20::ICIMNamespace> fNamespace;
    std::string fOutputPath;
    std::string fMode;
};

}  // namespace braigrion
