#include "THtmlWriter.h"

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
    if (fPageTables == 0) fPage += kNoInfoText1 + " " + kNoInfoText2 + " " + kNoInfoText3 + "\n";
    // Sortable tables on a page that did not ask for the script get it here.
    if (fPageHasSortable && !fSortScriptAsked) fPage += kHtmlSortScript;
    fPage += "</body>\n" + kHtmlFooter;
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
        if (agrees(cell)) return EscapeHtml(cell.text);
        return cell.flags[kFinalText] ? cell.text : SanitizeCellMarkup(cell.text);
    };
    int firstBodyRow = 0;
    if (table.fColumnHeaders) {
        out += "<thead>" + kTableRowBeg + kTableRowMid;
        for (int c = 0; c < table.fCols; ++c) {
            out += kTableHeaderElementBegin + Percent(table.fColumnWidths[static_cast<size_t>(c)]) +
                   kTableHeaderElementMid + cellText(table.Cell(0, c)) + kTableHeaderElementEnd;
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
                       kTableHeaderElementMid + cellText(cell) + kTableHeaderElementEnd;
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
