#include "THtmlWriter.h"

#include <algorithm>
#include <cctype>
#include <cstring>

#include "Assets.h"
#include "HtmlText.h"
#include "braigrion/ReportDefinition.h"

namespace braigrion {
namespace backends {

using namespace TKR_REPORT_DEFINITION;

namespace {

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

}  // namespace

THtmlWriter::THtmlWriter() : THtmlWriter(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML) {}

THtmlWriter::THtmlWriter(const std::string& writerType) : TBackendWriter(writerType), fPageHasSortable(false) {}

std::string THtmlWriter::PageHeader(bool sortHeader) const {
    return sortHeader ? kHtmlSortHeaderUTF8 + kHtmlSortScript : kHtmlHeaderUTF8;
}

void THtmlWriter::WritePageHeader() {
    fPageHasSortable = false;
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
    if (fPageHasSortable && !fSortScriptAsked) fFooterText += kHtmlSortScript;
    fFooterText += "</body>\n" + kHtmlFooter;
    fFooterAt = fPage.size();
    fPage += fFooterText;
    fFooterWritten = true;
}

void THtmlWriter::FinishAbandonedPage() {
    fPage += "</body>\n" + kHtmlFooter;
    fFooterWritten = true;
}

void THtmlWriter::WriteTitle(const std::string& title, const std::string& target, const std::string& text) {
    std::string heading = EscapeHtml(title);
    fPage += "<title>" + heading + "</title>\n" + kReporTitleBeg + heading;
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

void THtmlWriter::WriteTableTitle(const std::string& title, const bool& subTitle, const bool& /*unused*/) {
    fPage += (subTitle ? kTableSubTitleBeg : kTableTitleBeg) + EscapeHtml(title) + "</div>\n";
}

void THtmlWriter::WriteTableGrid(TTable& table) {
    ++fPageTables;
    ++fTableCounter;
    bool sortable = table.fSortable && table.fColumnHeaders && table.fRows > 1;
    fPageHasSortable = fPageHasSortable || sortable;
    std::string& out = fPage;
    out += table.fRowHeaders ? kRowTableHeaderBeg : kColTableHeaderBeg;
    if (sortable) out += kTableHeaderSort;
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
    int firstBodyRow = 0;
    if (table.fColumnHeaders) {
        out += "<thead>" + kTableRowBeg + kTableRowMid;
        for (int c = 0; c < table.fCols; ++c) {
            out += kTableHeaderElementBegin + Percent(table.fColumnWidths[static_cast<size_t>(c)]) +
                   kTableHeaderElementMid + labelText(table.Cell(0, c)) + kTableHeaderElementEnd;
        }
        out += kTableRowEnd + "</thead>\n";
        firstBodyRow = 1;
    }
    out += "<tbody>\n";
    for (int r = firstBodyRow; r < table.fRows; ++r) {
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
                out += kTableHeaderElementBegin + Percent(table.fColumnWidths[static_cast<size_t>(c)]) +
                       kTableHeaderElementMid + (c == 0 && table.fRowHeaders ? labelText(cell) : cellText(cell)) +
                       kTableHeaderElementEnd;
                continue;
            }
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
            if (!cell.rawText.empty()) out += " title=\"" + EscapeHtml(cell.rawText) + "\"";
            out += ">" + cellText(cell) + "</td>";
        }
        out += kTableRowEnd + "\n";
    }
    out += "</tbody>\n" + kTableFooter + "\n";
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
    std::string out = kHtmlIndexHeader;
    out += "<TR><TD class=\"brand\">Server report</TD></TR>\n";
    for (const TCategory& category : fIndex) {
        if (category.fName.empty()) {
            out += "<TR><TD class=\"navgap\"></TD></TR>\n";
        } else {
            out += kHtmlIndexCatBeg + EscapeHtml(category.fName) + kHtmlIndexCatEnd;
        }
        for (const TIndexEntry& entry : category.fEntries) {
            out += kNavBegin + kNavLinkBegin + "\"" + EscapeHtml(PageFileName(entry.fStem)) + "\"";
            if (!entry.fHasData) out += " class=\"nodata\"";
            out += kNavLinkMid + EscapeHtml(entry.fName);
            if (!entry.fHasData) out += " <span class=\"note\">(no data)</span>";
            out += kNavLinkEnd + kNavEnd + "\n";
        }
    }
    // The script marks the link of the page on show.
    out += kHtmlIndexLine + kHtmlSortScript + kHtmlIndexFooter;
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
    return kHtmlHeaderUTF8 + "<title>Server report</title>\n" +
           "<div class=\"frames\">\n"
           "<iframe class=\"navframe\" name=\"nav_frame\" title=\"Navigation\" src=\"" +
           kNavBarName +
           "\"></iframe>\n"
           "<iframe class=\"dataframe\" name=\"data_frame\" title=\"Report page\" src=\"" +
           EscapeHtml(start) + "\"></iframe>\n</div>\n</body>\n" + kHtmlFooter;
}

void THtmlWriter::WriteReportFiles() {
    WriteOutputFile(kNavBarName, NavigationPage());
    WriteOutputFile("index.html", IndexPage());
    WriteOutputFile("global.css", assets::kGlobalCss);
    WriteOutputFile("tkr_sort.js", assets::kSortScript);
}

}  // namespace backends
}  // namespace braigrion
