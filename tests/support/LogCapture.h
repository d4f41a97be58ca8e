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
    typedef std::pair<int, std::string> TLine;

    TLogCapture();            // becomes the core logger
    ~TLogCapture() override;  // gives the default logger back

    void Log(int level, const std::string& message) override;

    const std::vector<TLine>& Lines() const { return fLines; }
    // Messages in order, optionally only those of one level.
    std::vector<std::string> Messages() const;
    std::vector<std::string> Messages(int level) const;
    // How many lines equal `message` exactly.
    size_t Count(const std::string& message) const;
    bool Contains(const std::string& message) const { return Count(message) > 0; }
    // Level of the first line equal to `message`, -1 when there is none.
    int LevelOf(const std::string& message) const;
    // Index of the first line equal to `message`, -1 when there is none.
    int IndexOf(const std::string& message) const;
    void Clear() { fLines.clear(); }
    // Also hands every line to `listener` as it comes, for instance to
    // interleave log lines with a writer's transcript.
    void SetListener(boost::function<void(int, const std::string&)> listener) { fListener = listener; }

private:
    std::vector<TLine> fLines;
    boost::function<void(int, const std::string&)> fListener;
};

}  // namespace testing
}  // namespace braigrion
