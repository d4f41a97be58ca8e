#include "TBackendWriter.h"

#include <cctype>
#include <cerrno>
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <fstream>

#include "HtmlText.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {
namespace backends {

using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;

TBackendWriter::TBackendWriter(const std::string& writerType)
    : fPageOpen(false),
      fFooterWritten(false),
      fSortScriptAsked(false),
      fPageTables(0),
      fTableCounter(0),
      fCategoryOpen(false) {
    fWriterType = writerType;
}

TBackendWriter::~TBackendWriter() {}

void TBackendWriter::Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) {
    fNamespace = ns;
    fOutputPath = outputPath;
    // Lookup files of the sections are read relative to the working
    // directory, as the other lookup files are.
    fReportPath = ".";
    TContext::const_iterator mode = context.find("mode");
    fMode = mode == context.end() ? std::string("default") : static_cast<std::string>(mode->second);
    fIndex.clear();
    fCategoryOpen = false;
    fPageHadTable.clear();
    fWrittenStems.clear();
    fTableCounter = 0;
}

// --- report and index ---

void TBackendWriter::StartReport() {
    fIndex.clear();
    fCategoryOpen = false;
}

void TBackendWriter::EndCategory() {
    fCategoryOpen = false;
}

void TBackendWriter::WriteCategory(const std::string& categoryName) {
    TCategory category;
    category.fName = categoryName;
    fIndex.push_back(category);
    fCategoryOpen = true;
}

void TBackendWriter::EndReport() {
    if (fPageOpen) ClosePage();
    // A page that the logic only listed (its section found nothing to open
    // a page for) still gets a file, so that its link in the index leads
    // to a page that says there is no information.
    if (WritesListedPages()) {
        for (const TCategory& category : std::vector<TCategory>(fIndex)) {
            for (const TIndexEntry& entry : category.fEntries) {
                if (fWrittenStems.count(entry.fStem)) continue;
                OpenPage(fOutputPath + TOSSpecific::kFileSeparator + entry.fStem);
                WritePageHeader();
                WriteReportTitle(entry.fName, "", "");
                WritePageFooter();
                ClosePage();
            }
        }
    }
    // A heading with no page under it (its pages not written, or not in
    // this version) is left out of the index.
    fIndex.erase(std::remove_if(fIndex.begin(), fIndex.end(),
                                [](const TCategory& category) { return category.fEntries.empty(); }),
                 fIndex.end());
    WriteReportFiles();
}

void TBackendWriter::WriteIndexEntry(const std::string& linkName, const std::string& reportName,
                                     const bool& hasData) {
    TIndexEntry entry;
    entry.fStem = SafeFileStem(linkName);
    entry.fName = reportName;
    std::map<std::string, bool>::const_iterator printed = fPageHadTable.find(entry.fStem);
    entry.fHasData = hasData && (printed == fPageHadTable.end() || printed->second);
    if (!fCategoryOpen && (fIndex.empty() || !fIndex.back().fName.empty())) fIndex.push_back(TCategory());
    fIndex.back().fEntries.push_back(entry);
}

// --- pages ---

std::string TBackendWriter::StemFromPath(const std::string& path) const {
    std::string rest = path;
    if (!fOutputPath.empty() && path.compare(0, fOutputPath.size(), fOutputPath) == 0) {
        rest = path.substr(fOutputPath.size());
        while (rest.compare(0, TOSSpecific::kFileSeparator.size(), TOSSpecific::kFileSeparator) == 0 &&
               !TOSSpecific::kFileSeparator.empty())
            rest.erase(0, TOSSpecific::kFileSeparator.size());
    }
    return SafeFileStem(rest);
}

void TBackendWriter::OpenPage(const std::string& path) {
    if (fPageOpen) ClosePage();
    fPageOpen = true;
    fFooterWritten = false;
    fSortScriptAsked = false;
    fPageStem = StemFromPath(path);
    fPage.clear();
    fPageTables = 0;
    fHand = THandTable();
}

void TBackendWriter::ClosePage() {
    if (!fPageOpen) return;
    if (fHand.fOpen) EndTable();
    if (!fFooterWritten) FinishAbandonedPage();
    fPageHadTable[fPageStem] = fPageTables > 0;
    fWrittenStems.insert(fPageStem);
    SavePage(fPageStem, fPage);
    fPage.clear();
    fPageOpen = false;
}

void TBackendWriter::WriteSortScript() {
    fSortScriptAsked = true;
}

void TBackendWriter::WriteOutputFile(const std::string& fileName, const std::string& text) {
    std::string path = fOutputPath + TOSSpecific::kFileSeparator + fileName;
    std::ofstream out(path.c_str(), std::ios::binary | std::ios::trunc);
    if (out) out.write(text.data(), static_cast<std::streamsize>(text.size()));
    if (out) out.close();
    if (!out) RecordFailure("cannot write " + path + ": " + std::strerror(errno ? errno : EIO));
}

void TBackendWriter::RecordFailure(const std::string& message) {
    if (fFailure.empty()) fFailure = message;
}

void TBackendWriter::WriteSeparatePage(const std::string& stem, const std::string& title, TTable& table) {
    bool pageOpen = fPageOpen, footerWritten = fFooterWritten, sortScript = fSortScriptAsked;
    std::string pageStem = fPageStem, page = fPage;
    int pageTables = fPageTables;
    THandTable hand = fHand;

    fPageOpen = true;
    fFooterWritten = false;
    fSortScriptAsked = table.fSortable;
    fPageStem = SafeFileStem(stem);
    fPage.clear();
    fPageTables = 0;
    fHand = THandTable();
    WritePageHeader();
    WriteReportTitle(title, "", "");
    WriteTableGrid(table);
    WritePageFooter();
    fWrittenStems.insert(fPageStem);
    SavePage(fPageStem, fPage);

    fPageOpen = pageOpen;
    fFooterWritten = footerWritten;
    fSortScriptAsked = sortScript;
    fPageStem = pageStem;
    fPage = page;
    fPageTables = pageTables;
    fHand = hand;
}

// --- hand-written tables ---

void TBackendWriter::StartColumnTable(const std::string& tableWidth, const std::string& /*summary*/,
                                      bool sortable) {
    if (fHand.fOpen) EndTable();
    fHand = THandTable();
    fHand.fOpen = true;
    fHand.fWidth = tableWidth;
    fHand.fSortable = sortable;
}

void TBackendWriter::StartPropertyTable(const std::string& tableWidth, const std::string& headerWidth,
                                        const std::string& /*title*/) {
    if (fHand.fOpen) EndTable();
    fHand = THandTable();
    fHand.fOpen = true;
    fHand.fPropertyTable = true;
    fHand.fWidth = tableWidth;
    fHand.fHeaderWidth = headerWidth;
}

void TBackendWriter::EndTableHeader() {
    if (fHand.fRowOpen) EndRow();
}

void TBackendWriter::StartRow(const bool& /*first*/) {
    if (!fHand.fOpen) StartColumnTable("100%", "", false);
    fHand.fRows.push_back(std::vector<THandCell>());
    fHand.fRowOpen = true;
}

void TBackendWriter::EndRow() {
    fHand.fRowOpen = false;
}

void TBackendWriter::AddCell(const THandCell& cell) {
    if (!fHand.fOpen || !fHand.fRowOpen) StartRow(true);
    fHand.fRows.back().push_back(cell);
}

void TBackendWriter::WriteRowBreak(int /*span*/) {
    if (!fHand.fOpen) return;
    fHand.fRows.push_back(std::vector<THandCell>());
    THandCell cell;
    cell.fSpans = true;
    fHand.fRows.back().push_back(cell);
    fHand.fRowOpen = false;
}

void TBackendWriter::WriteHeaderCell(TClassPtr cls, TReportProperty property) {
    THandCell cell;
    cell.fHeader = true;
    cell.fWidth = property.GetColumnWidth();
    cell.fText = ColumnLabel(cls, property);
    AddCell(cell);
}

void TBackendWriter::WriteDeclarationHeader(TPropertyDeclPtr declaration) {
    THandCell cell;
    cell.fHeader = true;
    cell.fText = DeclarationLabel(declaration);
    AddCell(cell);
}

void TBackendWriter::WriteValueCell(TInstancePtr instance, TReportProperty property, std::string separator) {
    if (separator.empty()) separator = GetSeparatorText(property.GetArrayValueSeparator());
    std::string text;
    for (const TPropertyPtr& p : ColumnProperties(instance, property)) {
        std::string value = PropertyText(p, separator);
        if (value.empty()) continue;
        if (!text.empty()) text += separator;
        text += value;
    }
    if (text.empty()) text = EscapeText(property.GetPropertyDefaultValue());
    THandCell cell;
    cell.fText = text;
    cell.fWidth = property.GetColumnWidth();
    cell.fMonospaced = property.IsMonospaced();
    AddCell(cell);
}

void TBackendWriter::WriteTextCell(TReportProperty property, std::string text, std::string link) {
    THandCell cell;
    cell.fWidth = property.GetColumnWidth();
    cell.fMonospaced = property.IsMonospaced();
    if (link.empty()) {
        cell.fText = EscapeText(text);
    } else {
        cell.fText = LinkedText(EscapeText(text), link);
        cell.fFinal = true;
    }
    AddCell(cell);
}

void TBackendWriter::WriteMessageCell(TReportProperty /*property*/, const std::string& message) {
    THandCell cell;
    cell.fSpans = true;
    std::string text = message;
    while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) text.pop_back();
    cell.fText = EscapeText(text);
    AddCell(cell);
}

namespace {

// The sensor's unit as a reading is spoken: "Degrees C" becomes "degrees C",
// "Volts" "volts"; a word in capitals ("RPM") stays. "" when the sensor
// names no unit, or only "Unknown" or "Other".
std::string SpokenUnit(const TWriter::TInstancePtr& sensor) {
    std::string unit;
    try {
        TCIMContext context;
        unit = sensor->GetProperty("BaseUnits", context)->GetValueString();
    } catch (...) {
        return std::string();
    }
    if (unit == "Unknown" || unit == "Other") return std::string();
    std::string::size_type end = unit.find(' ');
    if (end == std::string::npos) end = unit.size();
    bool capitalised = end > 1 && std::isupper(static_cast<unsigned char>(unit[0]));
    for (std::string::size_type i = 1; i < end && capitalised; ++i) {
        capitalised = std::islower(static_cast<unsigned char>(unit[i])) != 0;
    }
    if (capitalised) unit[0] = static_cast<char>(std::tolower(static_cast<unsigned char>(unit[0])));
    return unit;
}

}  // namespace

void TBackendWriter::WriteSensorCell(TInstancePtr sensor, const std::string& readingProperty,
                                     const std::string& modifierProperty) {
    std::string text = "N/A";
    try {
        TCIMContext context;
        double reading = sensor->GetProperty(readingProperty, context)->GetValue(context).AsReal();
        double modifier = 0;
        if (!modifierProperty.empty()) {
            modifier = sensor->GetProperty(modifierProperty, context)->GetValue(context).AsReal();
        }
        double value = reading * std::pow(10.0, modifier);
        char buffer[64];
        std::snprintf(buffer, sizeof buffer, "%g", value);
        text = buffer;
        const std::string unit = SpokenUnit(sensor);
        if (!unit.empty()) text += " " + unit;
    } catch (...) {
        text = "N/A";
    }
    THandCell cell;
    cell.fText = EscapeText(text);
    AddCell(cell);
}

void TBackendWriter::WriteDriveHealthEntry(TPropertyPtr rawData) {
    std::string dump;
    try {
        TCIMContext context;
        const NORVTKR20::TCIMValue& value = rawData->GetValue(context);
        if (value.IsArray()) {
            // Bytes as a hex dump, sixteen to a line.
            const std::vector<NORVTKR20::TCIMValue>& bytes = value;
            char hex[8];
            for (size_t i = 0; i < bytes.size(); ++i) {
                if (i > 0) dump += (i % 16 == 0) ? "\n" : " ";
                std::snprintf(hex, sizeof hex, "%02X", static_cast<unsigned>(bytes[i].AsUnsigned() & 0xFF));
                dump += hex;
            }
        } else {
            dump = rawData->GetValueString();
        }
    } catch (...) {
        dump.clear();
    }
    THandCell cell;
    cell.fText = MonospacedBlock(EscapeText(dump));
    cell.fFinal = true;
    cell.fMonospaced = true;
    AddCell(cell);
}

void TBackendWriter::WriteDriveHealthValue(TInstancePtr /*instance*/, TPropertyPtr property) {
    THandCell cell;
    cell.fText = PropertyText(property, GetSeparatorText(TReportProperty::SEPARATOR_0));
    AddCell(cell);
}

void TBackendWriter::WriteRegisterValue(TInstancePtr /*instance*/, TPropertyPtr property) {
    THandCell cell;
    cell.fMonospaced = true;
    try {
        TCIMContext context;
        const NORVTKR20::TCIMValue& value = property->GetValue(context);
        bool integral = !value.IsNull() && !value.IsArray() && static_cast<int>(value.GetType()) >= 1 &&
                        static_cast<int>(value.GetType()) <= 8;
        cell.fText = integral ? EscapeText("0x" + value.ToString(16)) : PropertyText(property, " ");
    } catch (...) {
        cell.fText = PropertyText(property, " ");
    }
    AddCell(cell);
}

void TBackendWriter::EndTable() {
    if (!fHand.fOpen) return;
    THandTable hand = fHand;
    fHand = THandTable();
    if (hand.fRows.empty()) return;
    TTable table = BuildGrid(hand);
    WriteTableGrid(table);
}

TTable TBackendWriter::BuildGrid(const THandTable& hand) {
    size_t cols = 1;
    for (const auto& row : hand.fRows) cols = std::max(cols, row.size());
    TTable table(static_cast<int>(hand.fRows.size()), static_cast<int>(cols), false);
    int width = TReportParameters::ConvertPercent(hand.fWidth);
    table.fTableWidth = width > 0 ? width : 100;
    table.fSortable = hand.fSortable;
    bool headerRow = !hand.fPropertyTable && !hand.fRows[0].empty();
    for (const THandCell& cell : hand.fRows[0]) headerRow = headerRow && cell.fHeader;
    table.fColumnHeaders = headerRow;
    // A property table has its labels down the first column, as long as
    // every row that is not a break or a message starts with one.
    bool labelColumn = hand.fPropertyTable;
    for (const auto& row : hand.fRows) {
        if (!row.empty() && !row[0].fSpans) labelColumn = labelColumn && row[0].fHeader;
    }
    table.fRowHeaders = labelColumn;
    if (hand.fPropertyTable) {
        int header = TReportParameters::ConvertPercent(hand.fHeaderWidth);
        table.fColumnWidths[0] = header;
        for (size_t c = 1; c < cols; ++c) table.fColumnWidths[c] = (100 - header) / static_cast<int>(cols - 1);
    } else if (headerRow) {
        for (size_t c = 0; c < hand.fRows[0].size(); ++c)
            table.fColumnWidths[c] = TReportParameters::ConvertPercent(hand.fRows[0][c].fWidth);
    }
    for (size_t r = 0; r < hand.fRows.size(); ++r) {
        for (size_t c = 0; c < hand.fRows[r].size(); ++c) {
            const THandCell& from = hand.fRows[r][c];
            TTable::TCell& to = table.Cell(static_cast<int>(r), static_cast<int>(c));
            to.text = from.fText;
            to.monospaced = from.fMonospaced;
            to.flags[kSpansRow] = from.fSpans;
            to.flags[kFinalText] = from.fFinal;
            to.flags[kHeaderCell] = from.fHeader;
        }
    }
    return table;
}

// --- whole tables and pages ---

void TBackendWriter::WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                                          const std::string& title) {
    if (records.empty()) return;
    std::vector<std::string> names = PropertyNames(records.front());
    if (names.empty()) return;
    TTable table(static_cast<int>(records.size()) + 1, static_cast<int>(names.size()), false);
    table.fColumnHeaders = true;
    table.fSortable = true;
    TClassPtr cls;
    try {
        cls = records.front()->GetClass(TCIMContext());
    } catch (...) {
    }
    for (size_t c = 0; c < names.size(); ++c) {
        TReportProperty column(names[c], "", "", "", "", "");
        TTable::TCell& head = table.Cell(0, static_cast<int>(c));
        head.text = ColumnLabel(cls, column);
        head.flags[kHeaderCell] = true;
        for (size_t r = 0; r < records.size(); ++r) {
            std::string text;
            for (const TPropertyPtr& p : ColumnProperties(records[r], column)) text += PropertyText(p, ", ");
            table.Cell(static_cast<int>(r) + 1, static_cast<int>(c)).text = text;
        }
    }
    WriteSeparatePage(fileStem, title, table);
    // The open page points to the log's own page.
    std::string stem = SafeFileStem(fileStem);
    WriteTableTitle(title, false, false);
    TTable link(1, 1, false);
    link.Cell(0, 0).text = LinkedText(EscapeText(title), stem);
    link.Cell(0, 0).flags[kFinalText] = true;
    WriteTableGrid(link);
}

void TBackendWriter::WriteEventLogReport(TReportParameters params) {
    WriteGenericReport(params);
}

void TBackendWriter::WriteMergedLogPage(TReportParameters params) {
    WriteGenericReport(params);
}

void TBackendWriter::WriteMelodyPrologue(const std::string& headerText) {
    fMelodyPrologue = headerText;
}

// The heading text stands above the table, which the section opens itself.
void TBackendWriter::WriteMelodyTableStart() {
    if (fMelodyPrologue.empty()) return;
    TTable prologue(1, 1, false);
    prologue.Cell(0, 0).text = EscapeText(fMelodyPrologue);
    prologue.Cell(0, 0).flags[kSpansRow] = true;
    WriteTableGrid(prologue);
    fMelodyPrologue.clear();
}

// One cell per column of the section's header row: the device itself is
// told by the property and value columns.
void TBackendWriter::WriteMelodyDeviceRow(TInstancePtr /*device*/, const std::string& score, const std::string& type,
                                          const std::string& cimType, const std::string& propertyName,
                                          const std::string& value, const std::string& frequency,
                                          const std::string& commonValues, int commonFrequencies) {
    const std::string texts[] = {score, type,      cimType,      propertyName,
                                 value, frequency, commonValues, std::to_string(commonFrequencies)};
    for (const std::string& text : texts) {
        THandCell cell;
        cell.fText = EscapeText(text);
        AddCell(cell);
    }
}

std::string TBackendWriter::GetInventoryPage() {
    return std::string();
}

}  // namespace backends
}  // namespace braigrion
