// Progress of a report on a terminal: "page N of M: PageID", updated in
// place as the report asks for each page.
#pragma once

#include <iosfwd>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "braigrion/TReport.h"
#include "braigrion/TReportParametersBuilder.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {
namespace cli {

// The pages a whole report asks for, in order, for the flags of `report`
// and the operating system that `builder` finds: the sequence the report
// walks, so that progress can say how many pages are left.
std::vector<std::string> PlannedPages(const TReport& report, const TReportParametersBuilder& builder);

// Becomes the core logger while it lives: every line goes on to the default
// logger, and the report's line for the start of each page moves the
// progress on.
class TProgressLog : public NORVTKR20::TLogger {
public:
    TProgressLog(std::ostream& out, size_t total, bool show);
    ~TProgressLog() override;

    void Log(int level, const std::string& message) override;
    size_t PagesSeen() const { return fSeen; }
    // Clears the progress line.
    void Finish();

private:
    std::ostream& fOut;
    size_t fTotal;
    size_t fSeen;
    bool fShow;
    bool fLineShown;
};

}  // namespace cli
}  // namespace braigrion
