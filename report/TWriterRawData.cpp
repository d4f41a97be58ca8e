// The raw-data pages that a back-end may replace. Until the pages that read
// the tools' verbatim output are part of the library, each writes no page and
// answers "", which its callers take as "no raw page": the standard page then
// stands alone.
#include "braigrion/TWriter.h"

namespace braigrion {

std::string TWriter::WriteLSIRawDataReport(std::string& /*linkName*/) {
    return std::string();
}

std::string TWriter::WriteHalcyonRawDataReport(std::string /*linkName*/) {
    return std::string();
}

std::string TWriter::WriteHalcyonManagerRawDataReport(std::string /*linkName*/) {
    return std::string();
}

std::string TWriter::WriteQLogicRawDataReport(std::string /*linkName*/) {
    return std::string();
}

std::string TWriter::WriteEmulexRawDataReport(std::string /*linkName*/) {
    return std::string();
}

}  // namespace braigrion
