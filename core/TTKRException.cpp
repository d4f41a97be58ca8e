#include "tkrcore/TTKRException.h"

namespace NORVTKR20 {

const char* TTKRStatusCode::TranslateStatusCodeText() const {
    switch (fStatusCode) {
        case kSuccess: return "Success";
        case kFailed: return "The operation failed";
        case kInvalidParameter: return "Invalid parameter";
        case kInvalidClass: return "Invalid class";
        case kSectionPrecondition: return "The section's preconditions are not met";
        case kTypeMismatch: return "The value does not have the requested type";
        case kNotFound: return "Not found";
        case kNullValue: return "The value is null";
        case kOutOfRange: return "The value is out of range for the requested type";
        case kNotSupported: return "Not supported";
        case kSectionBadData: return "The section found bad data";
        default: return "Unknown status code";
    }
}

std::string TTKRStatusCode::TranslateStatusCode() const { return TranslateStatusCodeText(); }

const char* TTKRException::what() const noexcept { return fStatusCode.TranslateStatusCodeText(); }

}  // namespace NORVTKR20
