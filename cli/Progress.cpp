#include "Progress.h"

#include <ostream>

namespace braigrion {
namespace cli {

TProgressLine::TProgressLine(std::ostream& out, bool show) : fOut(out), fShow(show), fLineShown(false) {}

TProgressLine::~TProgressLine() { Finish(); }

void TProgressLine::Step(const std::string& text) {
    if (!fShow) return;
    fOut << "\r\033[Kbraigrion: " << text << std::flush;
    fLineShown = true;
}

void TProgressLine::Page(size_t number, size_t total, const std::string& pageID) {
    Step("page " + std::to_string(number) + " of " + std::to_string(total) + ": " + pageID);
}

void TProgressLine::Finish() {
    if (fLineShown) fOut << "\r\033[K" << std::flush;
    fLineShown = false;
}

}  // namespace cli
}  // namespace braigrion
