#include "Progress.h"

#include <ostream>

namespace braigrion {
namespace cli {

TProgressLine::TProgressLine(std::ostream& out, bool show) : fOut(out), fShow(show), fLineShown(false) {}

TProgressLine::~TProgressLine() { Finish(); }

void TProgressLine::Page(size_t number, size_t total, const std::string& pageID) {
    if (!fShow) return;
    fOut << "\r\033[Kbraigrion: page " << number << " of " << total << ": " << pageID << std::flush;
    fLineShown = true;
}

void TProgressLine::Finish() {
    if (fLineShown) fOut << "\r\033[K" << std::flush;
    fLineShown = false;
}

}  // namespace cli
}  // namespace braigrion
