// Captures the lines of the core logger for the lifetime of the object, so a
// test can check what the report logged and at which level.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include <boost/function.hpp>

#include "tkrcore/TRootObject.h"

namespace braigrion {
namespace testing {

class TLogCapture : public NORVTKR20::TLogger {
public:
    TLogCapture() { NORVTKR20::TRootObject::SetCoreLogger(this); }
    // Gives the default logger back.
    ~TLogCapture() override { NORVTKR20::TRootObject::SetCoreLogger(nullptr); }

    void Log(int level, const std::string& message) override {
        fLines.emplace_back(level, message);
        if (fListener) fListener(level, message);
    }

    // Messages in order.
    std::vector<std::string> Messages() const {
        std::vector<std::string> result;
        for (const auto& line : fLines) result.push_back(line.second);
        return result;
    }
    // How many lines equal `message` exactly.
    size_t Count(const std::string& message) const {
        size_t n = 0;
        for (const auto& line : fLines) n += line.second == message;
        return n;
    }
    bool Contains(const std::string& message) const { return IndexOf(message) >= 0; }
    // Index of the first line equal to `message`, -1 when there is none.
    int IndexOf(const std::string& message) const {
        for (size_t i = 0; i < fLines.size(); ++i) {
            if (fLines[i].second == message) return static_cast<int>(i);
        }
        return -1;
    }
    // Level of the first line equal to `message`, -1 when there is none.
    int LevelOf(const std::string& message) const {
        const int index = IndexOf(message);
        return index < 0 ? -1 : fLines[static_cast<size_t>(index)].first;
    }
    void Clear() { fLines.clear(); }
    // Also hands every line to `listener` as it comes, for instance to
    // interleave log lines with a writer's transcript.
    void SetListener(boost::function<void(int, const std::string&)> listener) { fListener = listener; }

private:
    std::vector<std::pair<int, std::string>> fLines;
    boost::function<void(int, const std::string&)> fListener;
};

}  // namespace testing
}  // namespace braigrion
