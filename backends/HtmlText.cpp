#include "HtmlText.h"

#include <cctype>
#include <cstring>
#include <vector>

namespace braigrion {
namespace backends {

namespace {

const char kReplacement[] = "\xEF\xBF\xBD";  // U+FFFD

// Length of the UTF-8 sequence that starts at `i`, or 0 when the bytes there
// are not one (overlong forms, surrogates and values above U+10FFFF included).
size_t Utf8Length(const std::string& s, size_t i) {
    unsigned char c = static_cast<unsigned char>(s[i]);
    if (c < 0x80) return 1;
    size_t n;
    unsigned cp;
    if (c >= 0xC2 && c <= 0xDF) {
        n = 2;
        cp = c & 0x1F;
    } else if (c >= 0xE0 && c <= 0xEF) {
        n = 3;
        cp = c & 0x0F;
    } else if (c >= 0xF0 && c <= 0xF4) {
        n = 4;
        cp = c & 0x07;
    } else {
        return 0;
    }
    if (i + n > s.size()) return 0;
    for (size_t k = 1; k < n; ++k) {
        unsigned char t = static_cast<unsigned char>(s[i + k]);
        if ((t & 0xC0) != 0x80) return 0;
        cp = (cp << 6) | (t & 0x3F);
    }
    if (n == 3 && (cp < 0x800 || (cp >= 0xD800 && cp <= 0xDFFF))) return 0;
    if (n == 4 && (cp < 0x10000 || cp > 0x10FFFF)) return 0;
    return n;
}

// Length of the character reference at `i` (which holds '&'), or 0.
size_t ReferenceLength(const std::string& s, size_t i) {
    size_t j = i + 1;
    if (j < s.size() && s[j] == '#') {
        ++j;
        bool hex = j < s.size() && (s[j] == 'x' || s[j] == 'X');
        if (hex) ++j;
        size_t start = j;
        while (j < s.size() && (hex ? std::isxdigit(static_cast<unsigned char>(s[j]))
                                    : std::isdigit(static_cast<unsigned char>(s[j]))))
            ++j;
        size_t digits = j - start;
        if (digits == 0 || digits > (hex ? 6u : 7u)) return 0;
    } else {
        size_t start = j;
        if (j >= s.size() || !std::isalpha(static_cast<unsigned char>(s[j]))) return 0;
        while (j < s.size() && std::isalnum(static_cast<unsigned char>(s[j]))) ++j;
        if (j - start > 31) return 0;
    }
    if (j >= s.size() || s[j] != ';') return 0;
    return j + 1 - i;
}

void AppendUtf8(unsigned long cp, std::string& out) {
    if (cp == 0 || cp > 0x10FFFF || (cp >= 0xD800 && cp <= 0xDFFF)) cp = 0xFFFD;
    if (cp < 0x80) {
        out += static_cast<char>(cp);
    } else if (cp < 0x800) {
        out += static_cast<char>(0xC0 | (cp >> 6));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    } else if (cp < 0x10000) {
        out += static_cast<char>(0xE0 | (cp >> 12));
        out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    } else {
        out += static_cast<char>(0xF0 | (cp >> 18));
        out += static_cast<char>(0x80 | ((cp >> 12) & 0x3F));
        out += static_cast<char>(0x80 | ((cp >> 6) & 0x3F));
        out += static_cast<char>(0x80 | (cp & 0x3F));
    }
}

// The text as a browser reads it in an attribute: numeric references, with
// or without their ';', and the named ones that matter in a link. Any other
// '&' stays as it is (SafeHref then refuses a link that still holds a
// complete reference).
std::string DecodeReferences(const std::string& s) {
    static const struct {
        const char* name;
        const char* text;
    } kNamed[] = {{"amp;", "&"},    {"lt;", "<"},     {"gt;", ">"},        {"quot;", "\""},   {"apos;", "'"},
                  {"colon;", ":"},  {"sol;", "/"},    {"bsol;", "\\"},    {"period;", "."},   {"Tab;", "\t"},
                  {"NewLine;", "\n"}, {"lpar;", "("}, {"rpar;", ")"},       {"num;", "#"},      {"quest;", "?"},
                  {"equals;", "="}, {"percnt;", "%"}, {"nbsp;", "\xC2\xA0"}};
    if (s.find('&') == std::string::npos) return s;
    std::string out;
    out.reserve(s.size());
    for (size_t i = 0; i < s.size();) {
        if (s[i] != '&') {
            out += s[i++];
            continue;
        }
        size_t j = i + 1;
        if (j < s.size() && s[j] == '#') {
            ++j;
            const bool hex = j < s.size() && (s[j] == 'x' || s[j] == 'X');
            if (hex) ++j;
            const size_t start = j;
            unsigned long cp = 0;
            while (j < s.size() && (hex ? std::isxdigit(static_cast<unsigned char>(s[j]))
                                        : std::isdigit(static_cast<unsigned char>(s[j])))) {
                const int digit = std::isdigit(static_cast<unsigned char>(s[j]))
                                      ? s[j] - '0'
                                      : std::tolower(static_cast<unsigned char>(s[j])) - 'a' + 10;
                if (cp <= 0x10FFFF) cp = cp * (hex ? 16 : 10) + static_cast<unsigned long>(digit);
                ++j;
            }
            if (j > start) {
                if (j < s.size() && s[j] == ';') ++j;
                AppendUtf8(cp, out);
                i = j;
                continue;
            }
        } else {
            bool matched = false;
            for (const auto& named : kNamed) {
                const size_t n = std::strlen(named.name);
                if (s.compare(j, n, named.name) == 0) {
                    out += named.text;
                    i = j + n;
                    matched = true;
                    break;
                }
            }
            if (matched) continue;
        }
        out += s[i++];
    }
    return out;
}

// Appends the character at `i` escaped, and returns how many bytes it took.
size_t EscapeOne(const std::string& s, size_t i, std::string& out) {
    unsigned char c = static_cast<unsigned char>(s[i]);
    switch (c) {
        case '<': out += "&lt;"; return 1;
        case '>': out += "&gt;"; return 1;
        case '"': out += "&quot;"; return 1;
        case '\'': out += "&#39;"; return 1;
        case '&': {
            size_t ref = ReferenceLength(s, i);
            if (ref) {
                out.append(s, i, ref);
                return ref;
            }
            out += "&amp;";
            return 1;
        }
        default: break;
    }
    if (c < 0x20 && c != '\t' && c != '\n' && c != '\r') {
        out += kReplacement;
        return 1;
    }
    if (c == 0x7F) {
        out += kReplacement;
        return 1;
    }
    size_t n = Utf8Length(s, i);
    if (n == 0) {
        out += kReplacement;
        return 1;
    }
    out.append(s, i, n);
    return n;
}

bool StartsWithNoCase(const std::string& s, size_t i, const char* prefix) {
    size_t n = std::strlen(prefix);
    if (i + n > s.size()) return false;
    for (size_t k = 0; k < n; ++k) {
        if (std::tolower(static_cast<unsigned char>(s[i + k])) != std::tolower(static_cast<unsigned char>(prefix[k])))
            return false;
    }
    return true;
}

// The tags a cell may keep, written in the one form the report logic uses.
enum TTag { kNone, kBreak, kFontOpen, kFontClose, kAnchorOpen, kAnchorClose };

// Recognises an allowed tag at `i`; sets `length` and, for an anchor, `href`.
TTag MatchTag(const std::string& s, size_t i, size_t& length, std::string& href) {
    static const char* const kBreaks[] = {"<br>", "<br/>", "<br />"};
    for (const char* form : kBreaks) {
        if (StartsWithNoCase(s, i, form)) {
            length = std::strlen(form);
            return kBreak;
        }
    }
    if (StartsWithNoCase(s, i, "<font face=\"Courier\">")) {
        length = std::strlen("<font face=\"Courier\">");
        return kFontOpen;
    }
    if (StartsWithNoCase(s, i, "</font>")) {
        length = 7;
        return kFontClose;
    }
    if (StartsWithNoCase(s, i, "</a>")) {
        length = 4;
        return kAnchorClose;
    }
    for (const char* open : {"<a href=\"", "<a href= \""}) {
        if (!StartsWithNoCase(s, i, open)) continue;
        size_t start = i + std::strlen(open);
        size_t quote = s.find('"', start);
        if (quote == std::string::npos || quote + 1 >= s.size() || s[quote + 1] != '>') return kNone;
        std::string target = s.substr(start, quote - start);
        if (target.find_first_of("<>") != std::string::npos) return kNone;
        href = SafeHref(target, false);
        if (href.empty()) return kNone;
        length = quote + 2 - i;
        return kAnchorOpen;
    }
    return kNone;
}

}  // namespace

std::string EscapeHtml(const std::string& text) {
    std::string out;
    out.reserve(text.size() + text.size() / 8);
    for (size_t i = 0; i < text.size();) i += EscapeOne(text, i, out);
    return out;
}

std::string SanitizeCellMarkup(const std::string& text) {
    std::string out;
    out.reserve(text.size() + text.size() / 8);
    std::vector<TTag> open;  // the font and anchor tags still open, innermost last
    for (size_t i = 0; i < text.size();) {
        if (text[i] != '<') {
            i += EscapeOne(text, i, out);
            continue;
        }
        size_t length = 0;
        std::string href;
        TTag tag = MatchTag(text, i, length, href);
        bool closes = tag == kFontClose || tag == kAnchorClose;
        TTag opener = tag == kFontClose ? kFontOpen : kAnchorOpen;
        if (tag == kNone || (closes && (open.empty() || open.back() != opener))) {
            i += EscapeOne(text, i, out);
            continue;
        }
        switch (tag) {
            case kBreak: out += "<br>"; break;
            case kFontOpen: out += "<font face=\"Courier\">"; open.push_back(kFontOpen); break;
            case kAnchorOpen: out += "<a href=\"" + EscapeHtml(href) + "\">"; open.push_back(kAnchorOpen); break;
            default: out += tag == kFontClose ? "</font>" : "</a>"; open.pop_back(); break;
        }
        i += length;
    }
    while (!open.empty()) {
        out += open.back() == kFontOpen ? "</font>" : "</a>";
        open.pop_back();
    }
    return out;
}

std::string SafeHref(const std::string& source, bool allowWeb) {
    // Judge the link the browser will follow: the attribute's character
    // references decoded. What is returned is that decoded link, holding no
    // reference, so that escaping it writes back exactly what was judged.
    const std::string link = DecodeReferences(source);
    if (link.empty()) return std::string();
    for (size_t i = 0; i < link.size(); ++i) {
        if (link[i] == '&' && ReferenceLength(link, i)) return std::string();
    }
    for (unsigned char c : link) {
        if (c < 0x20 || c == 0x7F || c == '"' || c == '\'' || c == '<' || c == '>' || c == '\\' || c == '`')
            return std::string();
    }
    size_t colon = link.find(':');
    size_t slash = link.find('/');
    if (colon != std::string::npos && (slash == std::string::npos || colon < slash)) {
        // A scheme: only the web's, and only where the caller allows them.
        if (allowWeb && (StartsWithNoCase(link, 0, "http://") || StartsWithNoCase(link, 0, "https://")) &&
            link.size() > (StartsWithNoCase(link, 0, "https://") ? 8u : 7u))
            return link;
        return std::string();
    }
    if (link[0] == '/') return std::string();
    // No step may climb out of the report directory.
    size_t start = 0;
    while (start <= link.size()) {
        size_t end = link.find('/', start);
        if (end == std::string::npos) end = link.size();
        std::string step = link.substr(start, end - start);
        if (step == "..") return std::string();
        start = end + 1;
    }
    return link;
}

std::string SafeFileStem(const std::string& linkName) {
    std::string stem;
    for (unsigned char c : linkName) {
        bool keep = std::isalnum(c) || c == '_' || c == '-' || c == '.';
        stem += keep && c < 0x80 ? static_cast<char>(c) : '_';
    }
    for (size_t i = 0; i < stem.size() && stem[i] == '.'; ++i) stem[i] = '_';
    if (stem.empty()) return "page";
    std::string lower;
    for (char c : stem) lower += static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    if (lower == "index" || lower == "navbar") stem = "page_" + stem;
    return stem;
}

std::string ValidUtf8(const std::string& text) {
    std::string out;
    out.reserve(text.size());
    for (size_t i = 0; i < text.size();) {
        size_t n = Utf8Length(text, i);
        if (n == 0) {
            out += kReplacement;
            ++i;
        } else {
            out.append(text, i, n);
            i += n;
        }
    }
    return out;
}

}  // namespace backends
}  // namespace braigrion
