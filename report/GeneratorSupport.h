// What the page generators share: their trace lines and the plain form of a
// generator. Internal to the report library.
#pragma once

#include <string>

#include "braigrion/Trace.h"

namespace braigrion {
namespace generators {

// The provider type of a namespace that is a delta view.
const int kDeltaProviderType = 1;

const char kEntering[] = " -- Entering";
const char kExiting[] = " -- Exiting";
const char kDeltaDoNothing[] = " -- Under DELTA mode [Do Nothing]";
const char kDeltaDoComparison[] = " -- Under DELTA mode [Do Comparison]";

// The plain form of a generator: outside delta mode `write` writes the page;
// in delta mode the generator says that it does nothing.
template <typename TWrite>
void WriteUnlessDelta(const std::string& name, bool delta, TWrite write) {
    Trace(name + kEntering);
    if (delta) {
        Trace(name + kDeltaDoNothing);
    } else {
        write();
    }
    Trace(name + kExiting);
}

// The comparing form: outside delta mode `write` writes the page, in delta
// mode `compare` writes the differences.
template <typename TWrite, typename TCompare>
void WriteOrCompare(const std::string& name, bool delta, TWrite write, TCompare compare) {
    Trace(name + kEntering);
    if (delta) {
        Trace(name + kDeltaDoComparison);
        compare();
    } else {
        write();
    }
    Trace(name + kExiting);
}

}  // namespace generators
}  // namespace braigrion
