#include "support/LogCapture.h"

namespace braigrion {
namespace testing {

TLogCapture::TLogCapture() {
    NORVTKR20::TRootObject::SetCoreLogger(this);
}

TLogCapture::~TLogCapture() {
    NORVTKR20::TRootObject::SetCoreLogger(nullptr);
}

void TLogCapture::Log(int level, const std::string& message) {
    fLines.push_back(TLine(level, message));
    if (fListener) fListener(level, message);
}

std::vector<std::string> TLogCapture::Messages() const {
    std::vector<std::string> result;
    for (const TLine& line : fLines) result.push_back(line.second);
    return result;
}

std::vector<std::string> TLogCapture::Messages(int level) const {
    std::vector<std::string> result;
    for (const TLine& line : fLines) {
        if (line.first == level) result.push_back(line.second);
    }
    return result;
}

size_t TLogCapture::Count(const std::string& message) const {
    size_t n = 0;
    for (const TLine& line : fLines) {
        if (line.second == message) ++n;
    }
    return n;
}

int TLogCapture::LevelOf(const std::string& message) const {
    int index = IndexOf(message);
    return index < 0 ? -1 : fLines[static_cast<size_t>(index)].first;
}

int TLogCapture::IndexOf(const std::string& message) const {
    for (size_t i = 0; i < fLines.size(); ++i) {
        if (fLines[i].second == message) return static_cast<int>(i);
    }
    return -1;
}

}  // namespace testing
}  // namespace braigrion
