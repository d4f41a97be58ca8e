// The rendering of property values shared by the value readers of TWriter
// and the table engine. Internal to the report library.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "braigrion/TWriter.h"

namespace braigrion {
namespace rendering {

// Remembers, per property declaration, how asking it for "NOTIMEPRECISION"
// ended: a table asks the same few declarations once per cell, and an
// absent qualifier answers by an exception, which is dear. A cache lives
// while one table is written, when the declarations cannot change.
class TDateQualifierCache {
public:
    // 0 when the qualifier is there, else the status its lookup failed with.
    int StatusOf(const TWriter::TPropertyDeclPtr& declaration);

private:
    // The declarations are held, so that their addresses stay theirs.
    std::vector<std::pair<TWriter::TPropertyDeclPtr, int>> fStatuses;
};

// The text of one property (see TWriter::GetValueFromProperty); failures of
// the repository pass to the caller. `cache` may be null.
std::string RenderProperty(TWriter& writer, NORVTKR20::ICIMProperty& property, const std::string& separator,
                           bool useMappedText, TDateQualifierCache* cache);

// TWriter::GetValuesFromProperties, with a cache that may be null.
std::string ValuesFromProperties(TWriter& writer, const std::vector<TWriter::TPropertyPtr>& properties,
                                 const std::string& separator, bool useMappedText, TDateQualifierCache* cache);

}  // namespace rendering
}  // namespace braigrion
