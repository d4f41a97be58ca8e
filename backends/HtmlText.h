// Text rules of the HTML back-ends: collected values become text, never
// mark-up, and names become file names that stay inside the report.
#pragma once

#include <string>

namespace braigrion {
namespace backends {

// Escapes `<`, `>`, `&`, `"` and `'`, replaces bytes that are not UTF-8 and
// control characters other than tab, line feed and carriage return by U+FFFD.
// An `&` that already begins a character reference (`&lt;`, `&#60;`) is
// kept, so that a text escaped twice reads as one escaped once: the report
// logic escapes some texts before they reach the back-end.
std::string EscapeHtml(const std::string& text);

// Cell text as the report logic hands it over: escaped values, plus the few
// tags the logic itself puts into cells (a line break between array
// elements, the monospaced font of a command, a link to a result file beside
// the page). Those tags stay; everything else is escaped as EscapeHtml does.
// Tags left open are closed at the end.
std::string SanitizeCellMarkup(const std::string& text);

// A link target that may stand in an href: a relative path inside the
// report (no scheme, no leading "/", no ".." step), or with `allowWeb` an
// http or https address. The target is judged as a browser reads it, its
// character references decoded, and the decoded target is returned: it
// holds no complete reference, so escaping it with EscapeHtml writes exactly
// what was judged. "" when the target is not acceptable; the caller then
// shows the text without a link. The result is not yet attribute-escaped.
std::string SafeHref(const std::string& link, bool allowWeb);

// A file stem for a page's link name: letters, digits, "_", "-" and "."
// stay, every other byte becomes "_", leading dots become "_", so the name
// can neither leave the report directory nor hide. The stems of the report's
// own files ("index", "navbar") get a "page_" prefix; "" becomes "page".
std::string SafeFileStem(const std::string& linkName);

// The text with every byte sequence that is not UTF-8 replaced by U+FFFD.
std::string ValidUtf8(const std::string& text);

}  // namespace backends
}  // namespace braigrion
