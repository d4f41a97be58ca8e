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

// How a page with a raw-data page beside it (in LUZ mode) asks for it: it
// says that it writes the raw data first, runs `writeRaw` (a raw-data
// writer, named `rawWriter`) inside a guard of its own, and says when that
// gave no page. The result is the raw page's link name, "" when there is
// none: the caller then writes its page without the switch. Whatever the
// raw page throws (a back-end failure, a result file that cannot be
// written) stops here, so the caller's own page is still written.
template <typename TWriteRaw>
std::string WriteRawDataFirst(const std::string& caller, const std::string& rawWriter, TWriteRaw writeRaw) {
    Trace(caller + " -- Under LUZ mode, write RawData first");
    std::string link;
    try {
        link = writeRaw();
    } catch (...) {
        Trace(caller + " -- Exception was thrown from " + rawWriter);
        link.clear();
    }
    if (link.empty()) Trace(caller + " -- " + rawWriter + " failed, write the page without RawData");
    return link;
}

}  // namespace generators
}  // namespace braigrion
