#include "support/RecordingWriter.h"

#include <cstdio>
#include <sstream>

namespace braigrion {
namespace testing {

using NORVTKR20::TCIMContext;

namespace {

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
    if (property.GetArrayValueSeparator() != 0) text += " sep=" + std::to_string(property.GetArrayValueSeparator());
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

void TRecordingWriter::WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                                            const std::string& title) {
    std::string list = "[";
    for (size_t i = 0; i < records.size(); ++i) list += (i > 0 ? "," : "") + Describe(records[i]);
    Record("WriteHalcyonEventLog", {list + "]", Quote(fileStem), Quote(title)});
}

TGridLinesRecorder::TGridLinesRecorder(const std::string& writerType) : TRecordingWriter(writerType), fMarks() {}

TGridLinesRecorder::TGridLinesRecorder(const std::string& writerType, TMarks marks)
    : TRecordingWriter(writerType), fMarks(marks) {}

void TGridLinesRecorder::WriteTableGrid(TTable& table) {
    const std::string described = Describe(table);
    Note("WriteTableGrid(" + described.substr(0, described.find(" |")) + ")");
    for (int row = 0; row < table.fRows; ++row) {
        std::string line = "  |";
        for (int col = 0; col < table.fCols; ++col) {
            const TTable::TCell& cell = table.Cell(row, col);
            line += " ";
            if (fMarks.monospaced && cell.monospaced) line += "#";
            if (fMarks.agreement && cell.flags[0]) line += "=";
            line += Quote(cell.text);
            if (fMarks.rawText && !cell.rawText.empty()) line += "~" + Quote(cell.rawText);
        }
        Note(line);
    }
}

}  // namespace testing
}  // namespace braigrion
