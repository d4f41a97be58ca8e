#include "RawDataSupport.h"

#include <cerrno>
#include <cctype>

#include "braigrion/ReportDefinition.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {
namespace rawdata {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

const char kCommandsIssued[] = "Commands Issued";
const char kCommandOpen[] = "<font face=\"Courier\">";
const char kCommandClose[] = "</font>";
const char kResultLinkOpen[] = "<a href=\"";
const char kResultLinkClose[] = "\">View Results</a>";

namespace {

const int kTableWidth = 75;
const int kCommandWidth = 80;
const int kResultWidth = 20;
const size_t kMaxFileName = 255;

bool EndsWithNoCase(const std::string& text, const std::string& suffix) {
    if (text.size() < suffix.size()) return false;
    for (size_t i = 0; i < suffix.size(); ++i) {
        if (std::tolower(static_cast<unsigned char>(text[text.size() - suffix.size() + i])) != suffix[i]) return false;
    }
    return true;
}

}  // namespace

TInstances InstancesOf(const TWriter::TNamespacePtr& ns, const std::string& className) {
    TCIMContext context;
    TInstances instances;
    ns->GetClass(className, context)
        ->EnumerateInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(instances), true, context);
    return instances;
}

TInstances RawDataInstances(const TWriter::TNamespacePtr& ns, const std::string& function,
                            const std::string& className) {
    TInstances instances;
    try {
        instances = InstancesOf(ns, className);
    } catch (...) {
        Trace(function + " -- Exception when getting class " + className);
    }
    if (instances.empty()) Trace(function + " -- No instance of class " + className);
    return instances;
}

void OpenRawPage(TWriter& writer, const std::string& outputPath, const std::string& link, const std::string& title,
                 const std::string& standardLink) {
    writer.OpenPage(outputPath + TOSSpecific::kFileSeparator + link);
    writer.WritePageHeader();
    writer.WriteReportTitle(title, TKR_REPORT_DEFINITION::kTKRShowStandard, standardLink);
}

TTable CommandsTable(size_t instances, const std::string& commandHeading, const std::string& resultHeading) {
    TTable table(static_cast<int>(instances) + 1, 2, false);
    table.fTableWidth = kTableWidth;
    table.fColumnHeaders = true;
    table.fColumnWidths[0] = kCommandWidth;
    table.fColumnWidths[1] = kResultWidth;
    table.Cell(0, 0).text = commandHeading;
    table.Cell(0, 1).text = resultHeading;
    return table;
}

std::string NumberedFileName(const std::string& prefix, int index) {
    return prefix + std::to_string(index) + ".txt";
}

bool IsSafeFileName(const std::string& name) {
    if (name.empty() || name.size() > kMaxFileName || name == "." || name == "..") return false;
    if (name.find('/') != std::string::npos || name.find('\0') != std::string::npos) return false;
    // The report's own pages and files are of these kinds; a result must
    // not take the place of one of them.
    for (const char* kind : {".html", ".htm", ".css", ".js"}) {
        if (EndsWithNoCase(name, kind)) return false;
    }
    return true;
}

std::string ResultFileName(const std::string& name, const std::string& fallback, std::set<std::string>& used) {
    std::string chosen = IsSafeFileName(name) && used.count(name) == 0 ? name : fallback;
    // A command may itself read like a numbered name taken before.
    while (used.count(chosen) != 0) chosen = "_" + chosen;
    used.insert(chosen);
    return chosen;
}

TResultFile::TResultFile(const std::string& path) {
    errno = 0;
    fFile.open(path.c_str(), std::ios::out | std::ios::trunc | std::ios::binary);
    if (!fFile.is_open()) throw TTKRException(errno == EACCES ? kResultFileDenied : kResultFileFailed);
}

void TResultFile::WriteLine(const std::string& text) {
    fFile << text << '\n';
    fFile.flush();
}

std::vector<std::string> ResultLines(const TCIMValue& value) {
    std::vector<std::string> lines;
    if (value.IsNull()) return lines;
    if (!value.IsArray()) {
        lines.push_back(value.ToString(10));
        return lines;
    }
    const std::vector<TCIMValue>& elements = value;
    for (const TCIMValue& element : elements) lines.push_back(element.ToString(10));
    return lines;
}

const TCIMValue& ValueOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    TCIMContext context;
    return instance->GetProperty(property, context)->GetValue(context);
}

std::string CommandCell(TWriter& writer, const std::string& command, const std::string& opening) {
    return opening + writer.EscapeText(command) + kCommandClose;
}

std::string ResultLinkCell(const std::string& fileName, const std::string& opening) {
    static const char kHex[] = "0123456789ABCDEF";
    std::string link;
    for (unsigned char c : fileName) {
        if ((c < 0x80 && std::isalnum(c)) || c == '-' || c == '.' || c == '_' || c == '~') {
            link += static_cast<char>(c);
        } else {
            link += '%';
            link += kHex[c >> 4];
            link += kHex[c & 0x0F];
        }
    }
    return opening + link + kResultLinkClose;
}

TTable FillCommandsTable(TWriter& writer, const std::string& outputPath, const TInstances& instances,
                         const TCommandTable& layout) {
    TTable table = CommandsTable(instances.size(), layout.commandHeading, layout.resultHeading);
    int index = 0;
    int row = 1;
    for (const TWriter::TInstancePtr& instance : instances) {
        const std::string fileName = NumberedFileName(layout.filePrefix, index);
        const std::string command = static_cast<std::string>(ValueOf(instance, layout.commandProperty));
        table.Cell(row, 0).text = CommandCell(writer, command);
        table.Cell(row, 1).text = ResultLinkCell(fileName);
        TResultFile file(outputPath + TOSSpecific::kFileSeparator + fileName);
        for (const std::string& line : ResultLines(ValueOf(instance, layout.resultProperty))) file.WriteLine(line);
        file.Close();
        ++index;
        ++row;
    }
    return table;
}

}  // namespace rawdata
}  // namespace braigrion
