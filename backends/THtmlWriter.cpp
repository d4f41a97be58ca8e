#include "THtmlWriter.h"

#include <algorithm>
#include <cctype>
#include <cstring>

#include "Assets.h"
#include "HtmlText.h"
#include "HumanSize.h"
#include "braigrion/ReportDefinition.h"

namespace braigrion {
namespace backends {

using namespace TKR_REPORT_DEFINITION;

namespace {

// Stands in a page's head until the page's title is known.
const char kTitlePlaceholder[] = "<title>Report page</title>";
// The title of the table that the navigation's highlights link points at.
const char kHighlightsTitle[] = "Report Highlights";

std::string Percent(int width) {
    return width > 0 ? std::to_string(width) + "%" : std::string();
}

bool IsSwitchText(const std::string& text) {
    return text.compare(0, 4, " - [") == 0;
}

// Tokens of up to this many characters are kept on one line.
const size_t kWholeToken = 40;

// Whether a browser may break a line inside `token` (finished HTML text,
// no tag), and the token is short enough to be kept whole: it holds a
// character after which lines break, such as the hyphen of a date
// (2021-04-08) or a version (4.620.00-5164) or a path's slash.
bool BreaksInside(const std::string& token) {
    size_t characters = 0;
    bool breaks = false;
    for (size_t i = 0; i < token.size(); ++i) {
        const unsigned char c = static_cast<unsigned char>(token[i]);
        if (c == '&') {
            const size_t end = token.find(';', i);
            if (end != std::string::npos) i = end;
        } else if ((c & 0xC0) == 0x80) {
            continue;  // inside a character
        } else if (std::strchr("-/\\?!)]}%+|", c) != nullptr && c != '\0' && i + 1 < token.size()) {
            breaks = true;  // a line may break after these, when more follows
        }
        ++characters;
    }
    return breaks && characters <= kWholeToken;
}

// Cell mark-up with each token (a run of characters between blanks, outside
// the tags) that a browser could break inside held together: a cell then
// wraps between words only, whatever the browser's line breaking allows
// after a hyphen or a slash. The text itself is unchanged.
std::string KeepTokensWhole(const std::string& html) {
    std::string out;
    out.reserve(html.size());
    size_t i = 0;
    while (i < html.size()) {
        const char c = html[i];
        if (c == '<') {
            const size_t end = html.find('>', i);
            const size_t stop = end == std::string::npos ? html.size() : end + 1;
            out.append(html, i, stop - i);
            i = stop;
        } else if (std::isspace(static_cast<unsigned char>(c))) {
            out += c;
            ++i;
        } else {
            size_t j = i;
            while (j < html.size() && html[j] != '<' && !std::isspace(static_cast<unsigned char>(html[j]))) ++j;
            const std::string token = html.substr(i, j - i);
            out += BreaksInside(token) ? "<span class=\"nw\">" + token + "</span>" : token;
            i = j;
        }
    }
    return out;
}

// The head of a document page, up to and with the opening of its body.
std::string DocumentHead(const std::string& stem) {
    const std::string page = EscapeHtml(stem);
    return "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
           "<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\">\n" +
           std::string(kTitlePlaceholder) +
           "\n<link href=\"global.css\" rel=\"stylesheet\">\n"
           "<script src=\"tkr_sort.js\" defer></script>\n</head>\n<body data-page=\"" +
           page +
           "\">\n<nav class=\"pagetools\" aria-label=\"Page\">"
           "<a class=\"backtoindex\" href=\"index.html#" +
           page +
           "\" target=\"_top\">&larr; Report index</a>"
           "<a class=\"openalone\" href=\"" +
           page +
           ".html\" target=\"_blank\" rel=\"noopener\">Open this page alone</a>"
           "<button type=\"button\" id=\"printpage\">Print</button></nav>\n<main>\n";
}

// The tooltip of a cell: its second text, and its size as a person reads
// it when its property declares a byte unit.
std::string CellTooltip(const TTable& table, int row, int col) {
    const TTable::TCell& cell = table.Cell(row, col);
    const size_t property = static_cast<size_t>(table.fRowHeaders ? row : col);
    const std::string size =
        property < table.fUnits.size() ? HumanSize(cell.text, table.fUnits[property]) : std::string();
    if (size.empty()) return cell.rawText;
    return cell.rawText.empty() ? size : cell.rawText + " (" + size + ")";
}

// A cell of a big table's data: its mark-up, or [mark-up, tooltip, mono]
// when it has either. Text for a script element: "<" never stands in it.
std::string JsonString(const std::string& text) {
    std::string out = "\"";
    for (unsigned char c : text) {
        switch (c) {
            case '"': out += "\\\""; break;
            case '\\': out += "\\\\"; break;
            case '\n': out += "\\n"; break;
            case '\r': out += "\\r"; break;
            case '\t': out += "\\t"; break;
            case '<': out += "\\u003c"; break;
            case '>': out += "\\u003e"; break;
            case '&': out += "\\u0026"; break;
            default:
                if (c < 0x20) {
                    static const char kHex[] = "0123456789abcdef";
                    out += "\\u00";
                    out += kHex[c >> 4];
                    out += kHex[c & 15];
                } else {
                    out += static_cast<char>(c);
                }
        }
    }
    return out + "\"";
}

}  // namespace

THtmlWriter::THtmlWriter() : THtmlWriter(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML) {}

THtmlWriter::THtmlWriter(const std::string& writerType) : TBackendWriter(writerType), fPageHasSortable(false) {}

void THtmlWriter::Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) {
    TBackendWriter::Initialize(ns, context, outputPath);
    fIdentity = ReadReportIdentity(ns);
    fHighlightsPage.clear();
    fHighlightsAnchor.clear();
}

std::string THtmlWriter::PageHeader(bool sortHeader) const {
    if (WritesDocuments()) return DocumentHead(fPageStem);
    return sortHeader ? kHtmlSortHeaderUTF8 + kHtmlSortScript : kHtmlHeaderUTF8;
}

void THtmlWriter::WritePageHeader() {
    fPageHasSortable = false;
    fPageAnchors.clear();
    fPage += PageHeader(fSortScriptAsked);
}

void THtmlWriter::WritePageFooter() {
    // A section may close a block of tables with a footer before the page's
    // own; the page keeps one footer, after all that was written.
    if (fFooterWritten && fPage.compare(std::min(fFooterAt, fPage.size()), fFooterText.size(), fFooterText) == 0)
        fPage.erase(fFooterAt, fFooterText.size());
    fFooterText.clear();
    if (fPageTables == 0) fFooterText += kNoInfoText1 + " " + kNoInfoText2 + " " + kNoInfoText3 + "\n";
    // Sortable tables on a page that did not ask for the script get it here.
    if (fPageHasSortable && !fSortScriptAsked && !WritesDocuments()) fFooterText += kHtmlSortScript;
    fFooterText += PageEnd();
    fFooterAt = fPage.size();
    fPage += fFooterText;
    fFooterWritten = true;
}

std::string THtmlWriter::PageEnd() const {
    return std::string(WritesDocuments() ? "</main>\n" : "") + "</body>\n" + kHtmlFooter;
}

void THtmlWriter::FinishAbandonedPage() {
    fPage += PageEnd();
    fFooterWritten = true;
}

void THtmlWriter::WriteTitle(const std::string& title, const std::string& target, const std::string& text) {
    std::string heading = EscapeHtml(title);
    size_t placeholder = fPage.find(kTitlePlaceholder);
    if (placeholder != std::string::npos) {
        // The window names the page and the machine.
        std::string windowTitle = heading + " \u2013 " + EscapeHtml(fIdentity.Title());
        fPage.replace(placeholder, sizeof(kTitlePlaceholder) - 1, "<title>" + windowTitle + "</title>");
        fPage += "<div class=\"pageheader\" role=\"heading\" aria-level=\"1\">" + heading;
    } else {
        fPage += "<title>" + heading + "</title>\n" + kReporTitleBeg + heading;
    }
    std::string href;
    if (!target.empty()) {
        href = SafeHref(target, true);
        // A bare name is the link name of a page of this report.
        if (href == target && target.find_first_of(":/.") == std::string::npos) href = PageFileName(SafeFileStem(target));
    }
    if (!href.empty()) {
        fPage += "<a class=\"switch\" href=\"" + EscapeHtml(href) + "\">" + EscapeHtml(text.empty() ? target : text) +
                 "</a>";
    }
    fPage += kReporTitleEnd + "\n";
}

void THtmlWriter::WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) {
    // Declared pages give the link name first and the switch text second;
    // hand-written pages the other way round.
    if (IsSwitchText(link) && !IsSwitchText(linkText)) {
        WriteTitle(title, linkText, link);
    } else {
        WriteTitle(title, link, linkText);
    }
}

void THtmlWriter::WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                           const std::string& linkText) {
    WriteTitle(title, link, linkText);
}

void THtmlWriter::WriteTableBreak() {
    fPage += "<br>\n";
}

std::string THtmlWriter::TitleAnchor(const std::string& title) {
    std::string anchor;
    for (char c : title) {
        if ((c >= 'a' && c <= 'z') || (c >= '0' && c <= '9')) {
            anchor += c;
        } else if (c >= 'A' && c <= 'Z') {
            anchor += static_cast<char>(c - 'A' + 'a');
        } else if (!anchor.empty() && anchor.back() != '-') {
            anchor += '-';
        }
    }
    while (!anchor.empty() && anchor.back() == '-') anchor.pop_back();
    if (anchor.empty()) anchor = "table";
    std::string unique = anchor;
    for (int n = 2; std::find(fPageAnchors.begin(), fPageAnchors.end(), unique) != fPageAnchors.end(); ++n) {
        unique = anchor + "-" + std::to_string(n);
    }
    fPageAnchors.push_back(unique);
    return unique;
}

void THtmlWriter::WriteTableTitle(const std::string& title, const bool& subTitle, const bool& /*unused*/) {
    if (!WritesDocuments()) {
        fPage += (subTitle ? kTableSubTitleBeg : kTableTitleBeg) + EscapeHtml(title) + "</div>\n";
        return;
    }
    const std::string anchor = TitleAnchor(title);
    if (!subTitle && fHighlightsPage.empty() && title == kHighlightsTitle) {
        fHighlightsPage = fPageStem;
        fHighlightsAnchor = anchor;
    }
    fPage += std::string(subTitle ? "<div class=\"tablesubtitle\" role=\"heading\" aria-level=\"3\""
                                  : "<br><div class=\"tabletitle\" role=\"heading\" aria-level=\"2\"") +
             " id=\"" + anchor + "\">" + EscapeHtml(title) + "</div>\n";
}

void THtmlWriter::WriteTableData(const TTable& table, int firstBodyRow) {
    fPage += "<script type=\"application/json\" id=\"t" + std::to_string(fTableCounter) + "-rows\">{\"rowHeaders\":" +
             (table.fRowHeaders ? "true" : "false") + ",\"rows\":[";
    for (int r = firstBodyRow; r < table.fRows; ++r) {
        fPage += r == firstBodyRow ? "[" : ",\n[";
        for (int c = 0; c < table.fCols; ++c) {
            const TTable::TCell& cell = table.Cell(r, c);
            std::string html = cell.flags[kFinalText] ? cell.text : SanitizeCellMarkup(cell.text);
            if (c > 0) fPage += ",";
            const std::string tooltip = CellTooltip(table, r, c);
            if (cell.monospaced || !tooltip.empty()) {
                fPage += "[" + JsonString(html) + "," + JsonString(EscapeHtml(tooltip)) + "," +
                         (cell.monospaced ? "1" : "0") + "]";
            } else {
                fPage += JsonString(html);
            }
        }
        fPage += "]";
    }
    fPage += "]}</script>\n";
}

void THtmlWriter::WriteTableGrid(TTable& table) {
    ++fPageTables;
    ++fTableCounter;
    const bool documents = WritesDocuments();
    const int firstBodyRow = table.fColumnHeaders ? 1 : 0;
    const int bodyRows = table.fRows - firstBodyRow;
    // A table of one row has nothing to sort.
    bool sortable = table.fSortable && table.fColumnHeaders && bodyRows > 1;
    // A grid of differences marks its cells one by one and stays whole.
    bool asData = documents && sortable && !table.fFlagB && bodyRows > kWholeTableRows;
    for (int r = firstBodyRow; asData && r < table.fRows; ++r) asData = !table.Cell(r, 0).flags[kSpansRow];
    fPageHasSortable = fPageHasSortable || sortable;
    std::string& out = fPage;
    out += table.fRowHeaders ? kRowTableHeaderBeg : kColTableHeaderBeg;
    if (sortable) out += kTableHeaderSort;
    // Many rows are laid out by the widths of the header alone, so that a
    // sort or a filter does not measure every cell again.
    if (documents && bodyRows > kFixedLayoutRows) out += " bigtable";
    out += kTableHeaderWidth + Percent(table.fTableWidth > 0 ? table.fTableWidth : 100) + kTableHeaderMid + "t" +
           std::to_string(fTableCounter) + kTableHeaderEnd;

    // A cell with all three flags agrees with the baseline of a grid of
    // differences: its text is plain, and it is shown subdued.
    auto agrees = [](const TTable::TCell& cell) {
        return cell.flags[kSpansRow] && cell.flags[kFinalText] && cell.flags[kHeaderCell];
    };
    auto cellText = [&agrees](const TTable::TCell& cell) {
        if (agrees(cell)) return KeepTokensWhole(EscapeHtml(cell.text));
        return KeepTokensWhole(cell.flags[kFinalText] ? cell.text : SanitizeCellMarkup(cell.text));
    };
    // Column and row labels come from the collection's DisplayName
    // qualifiers as often as from the catalogue: text, never mark-up.
    auto labelText = [](const TTable::TCell& cell) {
        return cell.flags[kFinalText] ? cell.text : EscapeHtml(cell.text);
    };
    auto headerCell = [&](const std::string& content, int c, const char* scope, bool button) {
        out += "<th scope=\"" + std::string(scope) + "\" class=\"tableheader\" width=\"" +
               Percent(table.fColumnWidths[static_cast<size_t>(c)]) + kTableHeaderElementMid;
        // A column without a label offers no sort button: a button needs a name.
        const bool named = content.find_first_not_of(" \t\n") != std::string::npos;
        out += button && named ? "<button type=\"button\" class=\"sortbutton\">" + content + "</button>" : content;
        out += kTableHeaderElementEnd;
    };
    if (table.fColumnHeaders) {
        out += "<thead>" + kTableRowBeg + kTableRowMid;
        for (int c = 0; c < table.fCols; ++c) headerCell(labelText(table.Cell(0, c)), c, "col", sortable && documents);
        out += kTableRowEnd + "</thead>\n";
    }
    out += "<tbody>\n";
    for (int r = asData ? table.fRows : firstBodyRow; r < table.fRows; ++r) {
        const TTable::TCell& first = table.Cell(r, 0);
        if (first.flags[kSpansRow] && !agrees(first)) {
            out += kTableRowBeg + " class=\"spanrow\"" + kTableRowMid + "<td colspan=\"" + std::to_string(table.fCols) +
                   "\">" + cellText(first) + "</td>" + kTableRowEnd + "\n";
            continue;
        }
        out += kTableRowBeg + kTableRowMid;
        for (int c = 0; c < table.fCols; ++c) {
            const TTable::TCell& cell = table.Cell(r, c);
            if ((c == 0 && table.fRowHeaders) || (cell.flags[kHeaderCell] && !agrees(cell))) {
                headerCell(c == 0 && table.fRowHeaders ? labelText(cell) : cellText(cell), c, "row", false);
                continue;
            }
            const std::string tooltip = CellTooltip(table, r, c);
            out += "<td";
            std::string classes = cell.monospaced ? "mono" : "";
            if (agrees(cell)) {
                classes += classes.empty() ? "same" : " same";
            } else if (table.fFlagB && r >= 2 && c >= 1 && !cell.text.empty()) {
                // In a grid of differences, row 1 is the baseline; a value
                // below it differs from the baseline's.
                classes += classes.empty() ? "differs" : " differs";
            }
            if (!classes.empty()) out += " class=\"" + classes + "\"";
            if (!tooltip.empty()) out += " title=\"" + EscapeHtml(tooltip) + "\"";
            out += ">" + cellText(cell) + "</td>";
        }
        out += kTableRowEnd + "\n";
    }
    out += "</tbody>\n" + kTableFooter + "\n";
    if (asData) WriteTableData(table, firstBodyRow);
}

std::string THtmlWriter::EscapeText(std::string text) {
    return EscapeHtml(text);
}

std::string THtmlWriter::GetSeparatorText(int separator) {
    switch (separator) {
        case 1: return "<br>";
        case 2: return "; ";
        case 3: return ",<br>";
        default: return ", ";
    }
}

std::string THtmlWriter::LinkedText(const std::string& text, const std::string& link) {
    std::string href = SafeHref(link, true);
    if (href.empty()) return SanitizeCellMarkup(text);
    if (href == link && link.find_first_of(":/.") == std::string::npos) href = PageFileName(SafeFileStem(link));
    return "<a href=\"" + EscapeHtml(href) + "\">" + SanitizeCellMarkup(text) + "</a>";
}

std::string THtmlWriter::MonospacedBlock(const std::string& text) {
    return "<pre>" + text + "</pre>";
}

void THtmlWriter::SavePage(const std::string& stem, const std::string& text) {
    WriteOutputFile(PageFileName(stem), text);
}

std::string THtmlWriter::NavigationPage() const {
    std::string out =
        "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n<title>Navigation</title>\n"
        "<link href=\"global.css\" rel=\"stylesheet\">\n<script src=\"tkr_sort.js\" defer></script>\n</head>\n"
        "<body class=\"navigation\">\n<nav id=\"navbar\" aria-label=\"Report pages\">\n";
    // The machine, and what to look at first.
    out += "<div class=\"brand\">\n";
    const TReportIdentity& id = fIdentity;
    out += "<h1 class=\"machine\">" + EscapeHtml(id.fHost.empty() ? id.Title() : id.fHost) + "</h1>\n";
    if (!id.fModel.empty()) out += "<div class=\"fact\">" + EscapeHtml(id.fModel) + "</div>\n";
    if (!id.fSerial.empty()) out += "<div class=\"fact\">Serial " + EscapeHtml(id.fSerial) + "</div>\n";
    if (!id.fDate.empty()) out += "<div class=\"fact\">Collected " + EscapeHtml(id.fDate) + "</div>\n";
    if (!fHighlightsPage.empty()) {
        std::string count = std::to_string(id.fHighlights);
        out += "<a class=\"highlights\" href=\"" + EscapeHtml(PageFileName(fHighlightsPage)) + "#" + fHighlightsAnchor +
               "\" target=\"data_frame\">" + (id.fHighlights > 0 ? count : std::string("No")) + " report highlight" +
               (id.fHighlights == 1 ? "" : "s") + "</a>\n";
    }
    out += "</div>\n";
    bool listOpen = false;
    for (const TCategory& category : fIndex) {
        if (category.fEntries.empty()) continue;
        if (listOpen) out += "</ul>\n";
        if (!category.fName.empty()) out += "<h2>" + EscapeHtml(category.fName) + "</h2>\n";
        out += "<ul>\n";
        listOpen = true;
        for (const TIndexEntry& entry : category.fEntries) {
            out += "<li><a href=\"" + EscapeHtml(PageFileName(entry.fStem)) + "\" target=\"data_frame\"";
            if (!entry.fHasData) out += " class=\"nodata\"";
            out += ">" + EscapeHtml(entry.fName);
            if (!entry.fHasData) out += " <span class=\"note\">(no data)</span>";
            out += "</a></li>\n";
        }
    }
    if (listOpen) out += "</ul>\n";
    out += "</nav>\n</body>\n</html>\n";
    return out;
}

std::string THtmlWriter::IndexPage() const {
    // The page shown first: the first page with data, else the first page.
    std::string first, firstWithData;
    for (const TCategory& category : fIndex) {
        for (const TIndexEntry& entry : category.fEntries) {
            if (first.empty()) first = entry.fStem;
            if (firstWithData.empty() && entry.fHasData) firstWithData = entry.fStem;
        }
    }
    if (!firstWithData.empty()) first = firstWithData;
    std::string start = first.empty() ? std::string("about:blank") : PageFileName(first);
    return "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
           "<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\">\n<title>" +
           EscapeHtml(fIdentity.Title()) +
           "</title>\n<link href=\"global.css\" rel=\"stylesheet\">\n"
           "<script src=\"tkr_sort.js\" defer></script>\n</head>\n<body class=\"index\">\n"
           "<button type=\"button\" id=\"navtoggle\" aria-controls=\"nav_frame\" aria-expanded=\"true\">"
           "Hide navigation</button>\n"
           "<div class=\"frames\">\n"
           "<iframe class=\"navframe\" id=\"nav_frame\" name=\"nav_frame\" title=\"Navigation\" src=\"" +
           kNavBarName +
           "\"></iframe>\n"
           "<iframe class=\"dataframe\" name=\"data_frame\" title=\"Report page\" src=\"" +
           EscapeHtml(start) + "\"></iframe>\n</div>\n</body>\n</html>\n";
}

void THtmlWriter::WriteReportFiles() {
    WriteOutputFile(kNavBarName, NavigationPage());
    WriteOutputFile("index.html", IndexPage());
    WriteOutputFile("global.css", assets::kGlobalCss);
    WriteOutputFile("tkr_sort.js", assets::kSortScript);
}

}  // namespace backends
}  // namespace braigrion
