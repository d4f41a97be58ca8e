// What names the machine of a report: its host name, model, serial number
// and the date of the collection, each "" where the collection lacks it;
// and the count of report highlights the collection holds.
#pragma once

#include <string>

#include <boost/shared_ptr.hpp>

#include "tkrcore/CIMInterfaces.h"

namespace braigrion {
namespace backends {

struct TReportIdentity {
    std::string fHost;
    std::string fModel;
    std::string fSerial;
    std::string fDate;  // as collected: yyyy-mm-dd hh:mm
    int fHighlights = 0;

    // The parts that exist, joined by " · "; "Server report" when none does.
    std::string Title() const;
};

// Reads the identity from the first computer system and the collection
// record; a missing class or property leaves its part empty, never throws.
TReportIdentity ReadReportIdentity(const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns);

}  // namespace backends
}  // namespace braigrion
