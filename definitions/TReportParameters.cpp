#include "braigrion/TReportParameters.h"

#include <cstdlib>

namespace braigrion {

int TReportParameters::ConvertPercent(std::string text) {
    std::string::size_type percent = text.find('%');
    if (percent != std::string::npos) text.erase(percent);
    return static_cast<int>(std::strtol(text.c_str(), nullptr, 10));
}

}  // namespace braigrion
