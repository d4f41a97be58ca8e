#include "TTextWriter.h"

#include "HtmlText.h"
#include "TextLayout.h"
#include "braigrion/ReportDefinition.h"

namespace braigrion {
namespace backends {

namespace {

std::string Underlined(const std::string& text, char rule) {
    return text + "\n" + std::string(TextWidth(text), rule) + "\n";
}

// The no-information notice without its mark-up.
const char kNoInformation[] =
    "No information is available for this section. You may not have the applicable hardware or a problem may "
    "have occurred while gathering the data. If you suspect this is due to an error, see the TKR Error Log page "
    "for more details.";

bool IsSwitchText(const std::string& text) {
    return text.compare(0, 4, " - [") == 0;
}

}  // namespace

TTextWriter::TTextWriter() : TBackendWriter(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_TEXT) {}

void TTextWriter::WritePageHeader() {}

void TTextWriter::WritePageFooter() {
    if (fPageTables == 0) {
        fPage += "\n";
        for (const std::string& line : WrapText(kNoInformation, kLineWidth)) fPage += line + "\n";
    }
    fFooterWritten = true;
}

void TTextWriter::FinishAbandonedPage() {
    fFooterWritten = true;
}

std::string TTextWriter::LinkTarget(const std::string& link) const {
    std::string target = SafeHref(link, true);
    if (target == link && link.find_first_of(":/.") == std::string::npos) target = PageFileName(SafeFileStem(link));
    return target;
}

void TTextWriter::WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) {
    bool swapped = IsSwitchText(link) && !IsSwitchText(linkText);
    WriteReportTitleWithLink(title, swapped ? linkText : link, swapped ? link : linkText);
}

void TTextWriter::WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                           const std::string& linkText) {
    std::string heading = EscapeText(title);
    std::string target = link.empty() ? std::string() : LinkTarget(link);
    fPage += Underlined(heading, '=');
    if (target.empty()) return;
    std::string text = linkText.empty() ? std::string("See") : linkText;
    if (IsSwitchText(text)) text.erase(0, 3);  // " - [Show ...]" reads "[Show ...]" on a line of its own
    fPage += EscapeText(text) + ": " + target + "\n";
}

void TTextWriter::WriteTableBreak() {
    fPage += "\n";
}

void TTextWriter::WriteTableTitle(const std::string& title, const bool& subTitle, const bool& /*unused*/) {
    fPage += "\n" + (subTitle ? EscapeText(title) + "\n" : Underlined(EscapeText(title), '-'));
}

void TTextWriter::WriteTableGrid(TTable& table) {
    // Grids with nothing between them (the blocks of one table, one per
    // instance) are kept apart by a blank line.
    if (fPageTables > 0 && fPage.size() == fGridEnd) fPage += "\n";
    ++fPageTables;
    ++fTableCounter;
    fPage += RenderTextGrid(table, kLineWidth);
    fGridEnd = fPage.size();
}

std::string TTextWriter::EscapeText(std::string text) {
    std::string valid = ValidUtf8(text);
    std::string out;
    out.reserve(valid.size());
    for (char ch : valid) {
        unsigned char c = static_cast<unsigned char>(ch);
        if (c == '\t') out += ' ';
        else if (c == '\n' || c >= 0x20) {
            if (c != 0x7F) out += ch;
        }
    }
    return out;
}

std::string TTextWriter::GetSeparatorText(int separator) {
    switch (separator) {
        case 1: return "\n";
        case 2: return "; ";
        case 3: return ",\n";
        default: return ", ";
    }
}

std::string TTextWriter::LinkedText(const std::string& text, const std::string& link) {
    std::string target = LinkTarget(link);
    return target.empty() ? text : text + " <" + target + ">";
}

std::string TTextWriter::MonospacedBlock(const std::string& text) {
    return text;
}

void TTextWriter::SavePage(const std::string& stem, const std::string& text) {
    WriteOutputFile(PageFileName(stem), text);
}

void TTextWriter::WriteReportFiles() {
    std::string out = Underlined("Server report", '=');
    size_t nameWidth = 0;
    for (const TCategory& category : fIndex) {
        for (const TIndexEntry& entry : category.fEntries)
            nameWidth = std::max(nameWidth, TextWidth(EscapeText(entry.fName)));
    }
    for (const TCategory& category : fIndex) {
        out += "\n";
        if (!category.fName.empty()) out += EscapeText(category.fName) + "\n";
        for (const TIndexEntry& entry : category.fEntries) {
            std::string name = EscapeText(entry.fName);
            std::string line = "  " + name + std::string(nameWidth - TextWidth(name) + 2, ' ') +
                               PageFileName(entry.fStem);
            if (!entry.fHasData) line += "  (no data)";
            out += line + "\n";
        }
    }
    WriteOutputFile("index.txt", out);
}

}  // namespace backends
}  // namespace braigrion
