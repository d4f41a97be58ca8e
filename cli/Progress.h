// Progress of a report on a terminal: "page N of M: PageID", updated in
// place as the report starts each page.
#pragma once

#include <iosfwd>
#include <string>

namespace braigrion {
namespace cli {

class TProgressLine {
public:
    // With `show` false nothing is written (quiet, or not a terminal).
    TProgressLine(std::ostream& out, bool show);
    ~TProgressLine();

    // Observer of TReport::Write.
    void Page(size_t number, size_t total, const std::string& pageID);
    // Clears the progress line.
    void Finish();

private:
    std::ostream& fOut;
    bool fShow;
    bool fLineShown;
};

}  // namespace cli
}  // namespace braigrion
