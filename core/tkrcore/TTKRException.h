// The one exception type of the core library and its status codes.
#pragma once

#include <exception>
#include <string>

namespace NORVTKR20 {

// Status codes the core library raises. The report logic only ever tests
// kNotFound; kSectionPrecondition and kSectionBadData are raised by the
// report's own section writers.
enum ETKRStatus {
    kSuccess = 0,
    kFailed = 1,
    kInvalidParameter = 4,
    kInvalidClass = 5,
    kSectionPrecondition = 11,
    kTypeMismatch = 13,
    kNotFound = 15,
    kNullValue = 16,
    kOutOfRange = 17,
    kNotSupported = 18,
    kSectionBadData = 27
};

struct TTKRStatusCode {
    int fStatusCode;

    TTKRStatusCode() : fStatusCode(kSuccess) {}
    explicit TTKRStatusCode(int code) : fStatusCode(code) {}

    // Message text for a status; unknown statuses get a generic text too.
    std::string TranslateStatusCode() const;
    const char* TranslateStatusCodeText() const;
};

class TTKRException : public std::exception {
public:
    TTKRStatusCode fStatusCode;

    explicit TTKRException(int status) : fStatusCode(status) {}
    explicit TTKRException(const TTKRStatusCode& status) : fStatusCode(status) {}

    const char* what() const noexcept override;
};

}  // namespace NORVTKR20
