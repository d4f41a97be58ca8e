// The files a report carries beside its pages, built into the library from
// backends/assets/ so that the command needs nothing installed next to it.
#pragma once

namespace braigrion {
namespace backends {
namespace assets {

extern const char* const kGlobalCss;     // global.css
extern const char* const kGlobalGuiCss;  // global_GUI.css, for inventory pages
extern const char* const kSortScript;    // tkr_sort.js

}  // namespace assets
}  // namespace backends
}  // namespace braigrion
