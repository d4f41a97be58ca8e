// A back-end that writes nothing: what a page costs without the cost of
// any output. It counts the cells of the grids it is given; a benchmark that
// wants more (pages, bytes, cells written one at a time) overrides those
// operations.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TWriter.h"

namespace bench {

class TNullWriter : public braigrion::TWriter {
public:
    size_t fCells = 0;

    void Initialize(TNamespacePtr, TContext, const std::string& outputPath) override { fOutputPath = outputPath; }
    void StartReport() override {}
    void EndCategory() override {}
    void WriteCategory(const std::string&) override {}
    void EndReport() override {}
    std::string GetInventoryPage() override { return std::string(); }
    void WriteHalcyonEventLog(const std::vector<TInstancePtr>&, const std::string&, const std::string&) override {}
    void WriteEventLogReport(braigrion::TReportParameters) override {}
    void WriteMergedLogPage(braigrion::TReportParameters) override {}
    void WriteMelodyPrologue(const std::string&) override {}
    void WriteMelodyDeviceRow(TInstancePtr, const std::string&, const std::string&, const std::string&,
                              const std::string&, const std::string&, const std::string&, const std::string&,
                              int) override {}
    void WriteMelodyTableStart() override {}
    void WriteDriveHealthEntry(TPropertyPtr) override {}
    void WriteDeclarationHeader(TPropertyDeclPtr) override {}
    void WriteDriveHealthValue(TInstancePtr, TPropertyPtr) override {}
    void WriteRegisterValue(TInstancePtr, TPropertyPtr) override {}
    void OpenPage(const std::string&) override {}
    void ClosePage() override {}
    void WritePageHeader() override {}
    void WritePageFooter() override {}
    void WriteReportTitle(const std::string&, const std::string&, const std::string&) override {}
    void WriteReportTitleWithLink(const std::string&, const std::string&, const std::string&) override {}
    void WriteIndexEntry(const std::string&, const std::string&, const bool&) override {}
    void WriteTableBreak() override {}
    void WriteTableTitle(const std::string&, const bool&, const bool&) override {}
    void StartColumnTable(const std::string&, const std::string&, bool) override {}
    void StartPropertyTable(const std::string&, const std::string&, const std::string&) override {}
    void WriteHeaderCell(TClassPtr, braigrion::TReportProperty) override {}
    void EndTableHeader() override {}
    void StartRow(const bool&) override {}
    void EndRow() override {}
    void EndTable() override {}
    void WriteRowBreak(int) override {}
    void WriteTableGrid(braigrion::TTable& table) override { fCells += table.fCells.size(); }
    void WriteValueCell(TInstancePtr, braigrion::TReportProperty, std::string) override {}
    void WriteTextCell(braigrion::TReportProperty, std::string, std::string) override {}
    void WriteMessageCell(braigrion::TReportProperty, const std::string&) override {}
    void WriteSensorCell(TInstancePtr, const std::string&, const std::string&) override {}
    void WriteSortScript() override {}
    std::string EscapeText(std::string text) override { return text; }
    std::string GetSeparatorText(int) override { return ", "; }
};

}  // namespace bench
