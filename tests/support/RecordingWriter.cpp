#include "support/RecordingWriter.h"

#include <cstdio>
#include <sstream>

namespace braigrion {
namespace testing {

using NORVTKR20::TCIMContext;

namespace {

std::string Bool(bool value) {
    return value ? "true" : "false";
}

std::string Int(int value) {
    return std::to_string(value);
}

std::string Cell(const TTable::TCell& cell) {
    std::string text = cell.monospaced ? "#" : "";
    text += TRecordingWriter::Quote(cell.text);
    if (!cell.rawText.empty()) text += "~" + TRecordingWriter::Quote(cell.rawText);
    return text;
}

}  // namespace

TRecordingWriter::TRecordingWriter(const std::string& writerType) : fConfiguredType(writerType) {
    fWriterType = writerType;
}

std::string TRecordingWriter::Transcript() const {
    std::string text;
    for (const std::string& call : fCalls) text += call + "\n";
    return text;
}

std::vector<std::string> TRecordingWriter::CallsStartingWith(const std::string& prefix) const {
    std::vector<std::string> result;
    for (const std::string& call : fCalls) {
        if (call.compare(0, prefix.size(), prefix) == 0) result.push_back(call);
    }
    return result;
}

void TRecordingWriter::SetSeparatorText(int separator, const std::string& text) {
    fSeparators[separator] = text;
}

void TRecordingWriter::Record(const std::string& name, const std::vector<std::string>& args) {
    std::string line = name + "(";
    for (size_t i = 0; i < args.size(); ++i) {
        if (i > 0) line += ", ";
        line += args[i];
    }
    fCalls.push_back(line + ")");
}

// --- formatting ---

std::string TRecordingWriter::Quote(const std::string& text) {
    std::string out = "\"";
    for (unsigned char c : text) {
        switch (c) {
            case '"': out += "\\\""; break;
            case '\\': out += "\\\\"; break;
            case '\n': out += "\\n"; break;
            case '\r': out += "\\r"; break;
            case '\t': out += "\\t"; break;
            default:
                if (c < 0x20) {
                    char buffer[8];
                    std::snprintf(buffer, sizeof buffer, "\\x%02x", c);
                    out += buffer;
                } else {
                    out += static_cast<char>(c);
                }
        }
    }
    return out + "\"";
}

std::string TRecordingWriter::Describe(const TInstancePtr& instance) {
    if (!instance) return "null";
    try {
        return "<instance " + instance->GetPath(TCIMContext()).GetPath() + ">";
    } catch (...) {
        return "<instance ?>";
    }
}

std::string TRecordingWriter::Describe(const TClassPtr& cls) {
    if (!cls) return "null";
    return "<class " + cls->GetClassName(TCIMContext()) + ">";
}

std::string TRecordingWriter::Describe(const TPropertyPtr& property) {
    if (!property) return "null";
    try {
        TPropertyDeclPtr declaration = property->GetDeclaration(TCIMContext());
        if (declaration) return "<property " + declaration->GetName(TCIMContext()) + ">";
    } catch (...) {
    }
    return "<property ?>";
}

std::string TRecordingWriter::Describe(const TPropertyDeclPtr& declaration) {
    if (!declaration) return "null";
    return "<decl " + declaration->GetName(TCIMContext()) + ">";
}

std::string TRecordingWriter::Describe(const TReportProperty& property) {
    std::string text = "{" + property.GetProperty();
    if (!property.GetColumnWidth().empty()) text += " width=" + Quote(property.GetColumnWidth());
    if (property.HasAssociationClass()) text += " assoc=" + Quote(property.GetAssociationClass());
    if (property.HasAssociationTarget()) text += " target=" + Quote(property.GetAssociationTarget());
    if (property.HasSecondaryAssociationTarget()) text += " second=" + Quote(property.GetSecondaryAssociationTarget());
    if (property.HasLabelOverride()) text += " label=" + Quote(property.GetLabelOverride());
    if (!property.GetPropertyDefaultValue().empty()) text += " default=" + Quote(property.GetPropertyDefaultValue());
    if (property.GetArrayValueSeparator() != 0) text += " sep=" + Int(property.GetArrayValueSeparator());
    if (property.IsMonospaced()) text += " mono";
    return text + "}";
}

std::string TRecordingWriter::Describe(const TReportParameters& params) {
    std::string text = "{link=" + Quote(params.GetLinkName()) + " name=" + Quote(params.GetReportName());
    if (params.ShowReportTitle()) text += " title";
    if (params.GetLinkSortable()) text += " sortable";
    text += " classes=[";
    for (size_t i = 0; i < params.GetClasses().size(); ++i) {
        if (i > 0) text += ",";
        text += params.GetClasses()[i].GetClass();
    }
    return text + "]}";
}

std::string TRecordingWriter::Describe(const TTable& table) {
    std::ostringstream out;
    out << "grid " << table.fRows << "x" << table.fCols << " width=" << table.fTableWidth << " widths=[";
    for (size_t i = 0; i < table.fColumnWidths.size(); ++i) out << (i > 0 ? "," : "") << table.fColumnWidths[i];
    out << "]";
    if (table.fColumnHeaders) out << " colheaders";
    if (table.fRowHeaders) out << " rowheaders";
    if (table.fSortable) out << " sortable";
    if (table.fMarked) out << " marked";
    for (int row = 0; row < table.fRows; ++row) {
        out << " |";
        for (int col = 0; col < table.fCols; ++col) out << " " << Cell(table.Cell(row, col));
    }
    return out.str();
}

// --- the back-end operations ---

void TRecordingWriter::Initialize(TNamespacePtr /*ns*/, TContext context, const std::string& outputPath) {
    fOutputPath = outputPath;
    TContext::const_iterator mode = context.find("mode");
    fMode = mode == context.end() ? "default" : static_cast<std::string>(mode->second);
    fWriterType = fConfiguredType;
    Record("Initialize", {Quote(outputPath), "mode=" + Quote(fMode)});
}

void TRecordingWriter::StartReport() { Record("StartReport"); }
void TRecordingWriter::EndCategory() { Record("EndCategory"); }
void TRecordingWriter::WriteCategory(const std::string& categoryName) { Record("WriteCategory", {Quote(categoryName)}); }
void TRecordingWriter::EndReport() { Record("EndReport"); }

std::string TRecordingWriter::GetInventoryPage() {
    Record("GetInventoryPage");
    return fInventoryPage;
}

void TRecordingWriter::WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                                            const std::string& title) {
    std::string list = "[";
    for (size_t i = 0; i < records.size(); ++i) list += (i > 0 ? "," : "") + Describe(records[i]);
    Record("WriteHalcyonEventLog", {list + "]", Quote(fileStem), Quote(title)});
}

void TRecordingWriter::WriteEventLogReport(TReportParameters params) { Record("WriteEventLogReport", {Describe(params)}); }
void TRecordingWriter::WriteMergedLogPage(TReportParameters params) { Record("WriteMergedLogPage", {Describe(params)}); }
void TRecordingWriter::WriteMelodyPrologue(const std::string& headerText) { Record("WriteMelodyPrologue", {Quote(headerText)}); }

void TRecordingWriter::WriteMelodyDeviceRow(TInstancePtr device, const std::string& score, const std::string& type,
                                            const std::string& cimType, const std::string& propertyName,
                                            const std::string& value, const std::string& frequency,
                                            const std::string& commonValues, int commonFrequencies) {
    Record("WriteMelodyDeviceRow", {Describe(device), Quote(score), Quote(type), Quote(cimType), Quote(propertyName),
                                    Quote(value), Quote(frequency), Quote(commonValues), Int(commonFrequencies)});
}

void TRecordingWriter::WriteMelodyTableStart() { Record("WriteMelodyTableStart"); }
void TRecordingWriter::WriteDriveHealthEntry(TPropertyPtr rawData) { Record("WriteDriveHealthEntry", {Describe(rawData)}); }
void TRecordingWriter::WriteDeclarationHeader(TPropertyDeclPtr declaration) {
    Record("WriteDeclarationHeader", {Describe(declaration)});
}
void TRecordingWriter::WriteDriveHealthValue(TInstancePtr instance, TPropertyPtr property) {
    Record("WriteDriveHealthValue", {Describe(instance), Describe(property)});
}
void TRecordingWriter::WriteRegisterValue(TInstancePtr instance, TPropertyPtr property) {
    Record("WriteRegisterValue", {Describe(instance), Describe(property)});
}
void TRecordingWriter::OpenPage(const std::string& path) { Record("OpenPage", {Quote(path)}); }
void TRecordingWriter::ClosePage() { Record("ClosePage"); }
void TRecordingWriter::WritePageHeader() { Record("WritePageHeader"); }
void TRecordingWriter::WritePageFooter() { Record("WritePageFooter"); }
void TRecordingWriter::WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) {
    Record("WriteReportTitle", {Quote(title), Quote(link), Quote(linkText)});
}
void TRecordingWriter::WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                                const std::string& linkText) {
    Record("WriteReportTitleWithLink", {Quote(title), Quote(link), Quote(linkText)});
}
void TRecordingWriter::WriteIndexEntry(const std::string& linkName, const std::string& reportName, const bool& hasData) {
    Record("WriteIndexEntry", {Quote(linkName), Quote(reportName), Bool(hasData)});
}
void TRecordingWriter::WriteTableBreak() { Record("WriteTableBreak"); }
void TRecordingWriter::WriteTableTitle(const std::string& title, const bool& a, const bool& b) {
    Record("WriteTableTitle", {Quote(title), Bool(a), Bool(b)});
}
void TRecordingWriter::StartColumnTable(const std::string& tableWidth, const std::string& summary, bool sortable) {
    Record("StartColumnTable", {Quote(tableWidth), Quote(summary), Bool(sortable)});
}
void TRecordingWriter::StartPropertyTable(const std::string& tableWidth, const std::string& headerWidth,
                                          const std::string& title) {
    Record("StartPropertyTable", {Quote(tableWidth), Quote(headerWidth), Quote(title)});
}
void TRecordingWriter::WriteHeaderCell(TClassPtr cls, TReportProperty property) {
    Record("WriteHeaderCell", {Describe(cls), Describe(property)});
}
void TRecordingWriter::EndTableHeader() { Record("EndTableHeader"); }
void TRecordingWriter::StartRow(const bool& first) { Record("StartRow", {Bool(first)}); }
void TRecordingWriter::EndRow() { Record("EndRow"); }
void TRecordingWriter::EndTable() { Record("EndTable"); }
void TRecordingWriter::WriteRowBreak(int span) { Record("WriteRowBreak", {Int(span)}); }
void TRecordingWriter::WriteTableGrid(TTable& table) { Record("WriteTableGrid", {Describe(table)}); }
void TRecordingWriter::WriteValueCell(TInstancePtr instance, TReportProperty property, std::string text) {
    Record("WriteValueCell", {Describe(instance), Describe(property), Quote(text)});
}
void TRecordingWriter::WriteTextCell(TReportProperty property, std::string text, std::string link) {
    Record("WriteTextCell", {Describe(property), Quote(text), Quote(link)});
}
void TRecordingWriter::WriteMessageCell(TReportProperty property, const std::string& message) {
    Record("WriteMessageCell", {Describe(property), Quote(message)});
}
void TRecordingWriter::WriteSensorCell(TInstancePtr sensor, const std::string& readingProperty,
                                       const std::string& modifierProperty) {
    Record("WriteSensorCell", {Describe(sensor), Quote(readingProperty), Quote(modifierProperty)});
}
void TRecordingWriter::WriteSortScript() { Record("WriteSortScript"); }

std::string TRecordingWriter::EscapeText(std::string text) {
    Record("EscapeText", {Quote(text)});
    return text;
}

std::string TRecordingWriter::GetSeparatorText(int separator) {
    Record("GetSeparatorText", {Int(separator)});
    std::map<int, std::string>::const_iterator entry = fSeparators.find(separator);
    return entry == fSeparators.end() ? ", " : entry->second;
}

}  // namespace testing
}  // namespace braigrion
