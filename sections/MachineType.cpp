// The two machine-type helpers: the machine type read from the product
// name, which chooses documentation links, and the test for IPMI records
// left by a multi-tool, which chooses the frame of the IPMI page.
#include <vector>

#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;

// A product name such as "Norvane Stratus NS2480 M4 -[4712AC1]-" holds
// the machine type as the first four characters inside "-[...]". Only a
// bracket that closes after those four characters counts: a shorter text in
// the brackets ("-[12]-") is no machine type.
std::string TWriter::GetMTFromRepository() {
    Trace("TWriter::GetMTFromRepository -- Entering");
    std::string machineType;
    std::vector<TInstancePtr> systems;
    TClassPtr cls;
    try {
        cls = fNamespace->GetClass("ORVSG_ComputerSystem", TCIMContext());
    } catch (...) {
        Trace("Exception when getting class ORVSG_ComputerSystem");
    }
    if (cls) {
        try {
            cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(systems), true, TCIMContext());
        } catch (...) {
            Trace("Exception when enumerating instances of ORVSG_ComputerSystem");
            systems.clear();
        }
    }
    if (!systems.empty()) {
        try {
            std::string product = static_cast<std::string>(
                systems.front()->GetProperty("ProductName", TCIMContext())->GetValue(TCIMContext()));
            Trace("ProductName value is " + product);
            std::string::size_type open = product.find("-[");
            std::string::size_type close = open == std::string::npos ? open : product.find(']', open);
            if (open != std::string::npos && close != std::string::npos && close - open > 5) {
                machineType = product.substr(open + 2, 4);
            }
        } catch (...) {
            Trace("Exception when getting property ProductName from ORVSG_ComputerSystem");
        }
    }
    Trace("TWriter::GetMTFromRepository -- Exiting with " + machineType);
    return machineType;
}

// Each record in turn sets `out` to its "Action" text, so the last record
// decides; a record whose "Action" cannot be read answers false.
bool TWriter::IsMultitool(std::string& out) {
    Trace("TWriter::IsMultitool -- Entering");
    bool multitool = false;
    std::vector<TInstancePtr> records;
    try {
        fNamespace->GetClass("ORVSG_IPMILogRecord", TCIMContext())
            ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(records), true, TCIMContext());
    } catch (...) {
        Trace("TWriter::IsMultitool -- Exception when enumerating instances of ORVSG_IPMILogRecord");
        records.clear();
    }
    for (const TInstancePtr& record : records) {
        try {
            out = static_cast<std::string>(record->GetProperty("Action", TCIMContext())->GetValue(TCIMContext()));
            multitool = !out.empty();
        } catch (...) {
            multitool = false;
        }
    }
    Trace("TWriter::IsMultitool -- Exiting");
    return multitool;
}

}  // namespace braigrion
