// Progress of a run on a terminal, one line updated in place: what is being
// loaded or compared, then "page N of M: PageID" as the report starts each
// page.
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

    // A step before the pages, such as "loading collection 2 of 3: DIR".
    void Step(const std::string& text);
    // Observer of TReport::Write.
    void Page(size_t number, size_t total, const std::string& pageID);
    // Clears the progress line, as anything else written to the stream
    // must first.
    void Finish();

private:
    std::ostream& fOut;
    bool fShow;
    bool fLineShown;
};

}  // namespace cli
}  // namespace braigrion
