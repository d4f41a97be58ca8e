// A plain-text form of a page definition, one line per setting, for
// comparison with expected definitions kept as fixture files (see
// tests/fixtures/catalogue/). Settings at their defaults are left out, so a
// line says what a definition chose.
#pragma once

#include <string>

#include "braigrion/TReportParameters.h"

namespace braigrion {
namespace testing {

std::string DumpDefinition(const TReportParameters& params);

}  // namespace testing
}  // namespace braigrion
