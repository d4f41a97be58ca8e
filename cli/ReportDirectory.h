// The directory a report is written to. The report is written into a
// temporary directory beside the target and moved into place only when it is
// complete, so that an interrupted or failed run leaves an earlier report
// intact and nothing half-written behind.
#pragma once

#include <string>

namespace braigrion {
namespace cli {

class TReportDirectory {
public:
    // The file that marks a directory as a braigrion report.
    static const char* const kMarkerName;

    // Checks the target: it may be missing, empty, or an earlier report;
    // anything else is refused with TInputError unless `force`. A target
    // that is not a directory is always refused. Then creates the work
    // directory beside it (std::runtime_error when that fails) and removes
    // work directories that interrupted runs left there.
    TReportDirectory(const std::string& target, bool force);
    // Removes the work directory unless the report was committed.
    ~TReportDirectory();

    const std::string& WorkPath() const { return fWork; }
    const std::string& TargetPath() const { return fTarget; }

    // Marks the work directory as a report of `format` and puts it in the
    // target's place; an earlier report there goes. Throws
    // std::runtime_error when the move fails, leaving the target as it was.
    void Commit(const std::string& format);

private:
    TReportDirectory(const TReportDirectory&) = delete;
    TReportDirectory& operator=(const TReportDirectory&) = delete;

    std::string fTarget;  // absolute
    std::string fWork;    // absolute, beside the target
    bool fCommitted;
};

}  // namespace cli
}  // namespace braigrion
