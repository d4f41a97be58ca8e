// A small report driven through a back-end's operations directly, in the
// order the report logic calls them: a page of declared tables, a page of
// hand-written tables, a raw-data page with its switch, a page without
// tables under a hostile link name, and the index. Values include hostile
// ones, escaped the way the logic escapes them (through the back-end's own
// EscapeText) or, for the raw-data cells, not at all.
#pragma once

#include <string>

#include "braigrion/TWriter.h"

namespace braigrion {
namespace testing {

// Writes the fixture report into `outputDir` through `writer`.
void WriteFixtureReport(TWriter& writer, const std::string& outputDir);

// Writes just the page of declared tables, as an inventory page is asked for.
void WriteFixturePage(TWriter& writer, const std::string& outputDir);

}  // namespace testing
}  // namespace braigrion
