// The directory a report is written to. The report is written into a
// temporary directory beside the target and moved into place only when it is
// complete, so that an interrupted or failed run leaves an earlier report
// intact and nothing half-written behind. A report never deletes or
// overwrites a file it did not write: its marker file lists the files of the
// report, and only those are replaced.
#pragma once

#include <string>
#include <vector>

namespace braigrion {
namespace cli {

class TReportDirectory {
public:
    // The file that marks a directory as a braigrion report.
    static const char* const kMarkerName;

    // Checks the target: it may be missing, empty, or an earlier report
    // (a directory whose marker names it one); anything else is refused with
    // TInputError unless `force`, which writes the report among the files
    // already there. A target that is not a directory is always refused.
    // Then creates the work directory beside it (std::runtime_error when
    // that fails) and removes work directories that killed runs left there.
    TReportDirectory(const std::string& target, bool force);
    // Removes the work directory unless the report was committed.
    ~TReportDirectory();

    const std::string& WorkPath() const { return fWork; }
    const std::string& TargetPath() const { return fTarget; }

    // Marks the work directory as a report of `format` and puts it in the
    // target's place. When the target holds only an earlier report, the
    // two are swapped and the earlier one removed; otherwise the report's
    // files are moved in one by one, the files of an earlier report that
    // this one does not write are removed, and every other file stays.
    // Throws std::runtime_error when the move fails or a file of the report
    // would replace one it did not write, leaving the target as it was.
    void Commit(const std::string& format);

private:
    TReportDirectory(const TReportDirectory&) = delete;
    TReportDirectory& operator=(const TReportDirectory&) = delete;

    void MoveInAmong(const std::vector<std::string>& files);

    std::string fTarget;  // absolute
    std::string fWork;    // absolute, beside the target
    bool fCommitted;
};

}  // namespace cli
}  // namespace braigrion
