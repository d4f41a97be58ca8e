// A back-end of the ESXi writer for tests: it records every back-end call
// with its arguments, one line per call, in the notation of the base
// recording writer (support/RecordingWriter.h). A grid is shown with one
// line per row. The page operations record their name and then write the
// generic page, as the real back-ends do; a test may make one of them
// throw to stop the driver.
#pragma once

#include <stdexcept>
#include <string>
#include <vector>

#include "TWriter_vmwesxi.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace testing {

class TRecordingWriter_vmwesxi : public TWriter_vmwesxi {
public:
    typedef TRecordingWriter R;

    const std::vector<std::string>& Calls() const { return fCalls; }
    std::string Transcript() const {
        std::string text;
        for (const std::string& call : fCalls) text += call + "\n";
        return text;
    }
    // The lines that start with `prefix`.
    std::vector<std::string> CallsStartingWith(const std::string& prefix) const {
        std::vector<std::string> found;
        for (const std::string& call : fCalls) {
            if (call.compare(0, prefix.size(), prefix) == 0) found.push_back(call);
        }
        return found;
    }
    // The calls of the page written to `link`, from OpenPage to its index entry.
    std::string Page(const std::string& link) const {
        std::string text;
        bool in = false;
        for (const std::string& call : fCalls) {
            if (call.compare(0, 9, "OpenPage(") == 0) in = call.find("/" + link + "\")") != std::string::npos;
            if (in) text += call + "\n";
            if (in && call.compare(0, 16, "WriteIndexEntry(") == 0) in = false;
        }
        return text;
    }
    // The page operation named here throws instead of writing its page.
    void ThrowOn(const std::string& operation) { fThrowOn = operation; }

    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override {
        SetUp(ns, context, outputPath);
        Record("Initialize", {R::Quote(outputPath), R::Quote(fMode)});
    }
    void EndCategory() override { Record("EndCategory"); }
    void WriteCategory(const std::string& name) override { Record("WriteCategory", {R::Quote(name)}); }
    void EndReport() override { Record("EndReport"); }
    void OpenPage(const std::string& path) override { Record("OpenPage", {R::Quote(path)}); }
    void ClosePage() override { Record("ClosePage"); }
    void WritePageHeader() override { Record("WritePageHeader"); }
    void WritePageFooter() override { Record("WritePageFooter"); }
    void WriteHeaderCell(TClassPtr cls, TReportProperty property) override {
        Record("WriteHeaderCell", {R::Describe(cls), R::Describe(property)});
    }
    void WriteReportTitle(const std::string& title, const std::string& link, const std::string& text) override {
        Record("WriteReportTitle", {R::Quote(title), R::Quote(link), R::Quote(text)});
    }
    void WriteIndexEntry(const std::string& link, const std::string& name, bool hasData) override {
        Record("WriteIndexEntry", {R::Quote(link), R::Quote(name), hasData ? "true" : "false"});
    }
    void WriteTableTitle(const std::string& title, bool a, bool b) override {
        Record("WriteTableTitle", {R::Quote(title), a ? "true" : "false", b ? "true" : "false"});
    }
    void WriteTableGrid(TTable& table) override {
        const std::string described = R::Describe(table);
        Record("WriteTableGrid", {described.substr(0, described.find(" |"))});
        for (int row = 0; row < table.fRows; ++row) {
            std::string line = "  |";
            for (int col = 0; col < table.fCols; ++col) {
                const TTable::TCell& cell = table.Cell(row, col);
                line += std::string(" ") + (cell.monospaced ? "#" : "") + R::Quote(cell.text);
                if (!cell.rawText.empty()) line += "~" + R::Quote(cell.rawText);
            }
            fCalls.push_back(line);
        }
    }
    void StartTable(const std::string& width, const std::string& id, bool sortable) override {
        Record("StartTable", {R::Quote(width), R::Quote(id), sortable ? "true" : "false"});
    }
    void StartRow(bool first) override { Record("StartRow", {first ? "true" : "false"}); }
    void EndRow() override { Record("EndRow"); }
    std::string GetSeparatorText(int separator) override { return separator == 1 ? "\n" : ", "; }

#define BRAIGRION_PAGE_OPERATION(name) \
    void name(TReportParameters params) override { PageOperation(#name, params); }
    BRAIGRION_PAGE_OPERATION(WriteInstalledApps)
    BRAIGRION_PAGE_OPERATION(WriteKernelModules)
    BRAIGRION_PAGE_OPERATION(WriteNetworking)
    BRAIGRION_PAGE_OPERATION(WriteResourceUtilization)
    BRAIGRION_PAGE_OPERATION(WriteProcesses)
    BRAIGRION_PAGE_OPERATION(WriteOSConfig)
    BRAIGRION_PAGE_OPERATION(WriteSysConfig)
    BRAIGRION_PAGE_OPERATION(WriteChassisEventLog)
    BRAIGRION_PAGE_OPERATION(WriteMergedLog)
    BRAIGRION_PAGE_OPERATION(WriteMergedDevices)
    BRAIGRION_PAGE_OPERATION(WritePBReport)
    BRAIGRION_PAGE_OPERATION(WritePCIInfo)
    BRAIGRION_PAGE_OPERATION(WriteDriveHealth)
    BRAIGRION_PAGE_OPERATION(WriteLSIIDE)
    BRAIGRION_PAGE_OPERATION(WritePMCRAID)
    BRAIGRION_PAGE_OPERATION(WriteHalcyon)
    BRAIGRION_PAGE_OPERATION(WriteHalcyonLogs)
    BRAIGRION_PAGE_OPERATION(WriteQlogic)
    BRAIGRION_PAGE_OPERATION(WriteEmulex)
    BRAIGRION_PAGE_OPERATION(WriteBroadcom)
    BRAIGRION_PAGE_OPERATION(WriteBrocadeAdapter)
    BRAIGRION_PAGE_OPERATION(WriteGlowTrace)
    BRAIGRION_PAGE_OPERATION(WriteKMCBuiltinSelfTest)
    BRAIGRION_PAGE_OPERATION(WriteLogPage)
    BRAIGRION_PAGE_OPERATION(WriteIPMIEvent)
#undef BRAIGRION_PAGE_OPERATION

    void EndTableHeader() override { Record("EndTableHeader"); }
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string separator) override {
        Record("WriteValueCell", {R::Describe(instance), R::Describe(property), R::Quote(separator)});
    }
    void WriteTextCell(TReportProperty property, std::string text, std::string link) override {
        Record("WriteTextCell", {R::Describe(property), R::Quote(text), R::Quote(link)});
    }
    void EndTable() override { Record("EndTable"); }
    void WriteTableBreak() override { Record("WriteTableBreak"); }
    // Marks the text as made safe, so that a test sees which texts were.
    std::string EscapeText(std::string text) override { return fEscapeMark + text; }
    void SetEscapeMark(const std::string& mark) { fEscapeMark = mark; }

private:
    void PageOperation(const std::string& operation, const TReportParameters& params) {
        Record(operation, {R::Describe(params)});
        if (operation == fThrowOn) throw std::runtime_error("page failed: " + operation);
        WriteGenericReport(params);
    }
    void Record(const std::string& name, const std::vector<std::string>& args = {}) {
        std::string line = name + "(";
        for (size_t i = 0; i < args.size(); ++i) line += (i ? ", " : "") + args[i];
        fCalls.push_back(line + ")");
    }

    std::vector<std::string> fCalls;
    std::string fThrowOn;
    std::string fEscapeMark;
};

}  // namespace testing
}  // namespace braigrion
