// The ESXi back-ends over the base ones: an ESXi writer that hands every
// output operation to a base back-end (HTML or text) which it owns, so that
// an ESXi report has the look, the built-in assets, the index and the
// safety rules of the base report (escaped values, file names kept inside
// the report, links checked) from one rendering layer. The ESXi report
// logic stays in TWriter_vmwesxi; the base back-end is used only through
// its output operations.
#pragma once

#include <string>

#include "TWriter_vmwesxi.h"
#include "braigrion/TWriter.h"

namespace braigrion {
namespace backends {

template <class TBase>
class TBackendWriter_vmwesxi : public TWriter_vmwesxi {
public:
    // The first failure to write output ("" when there was none).
    const std::string& GetFailure() const { return fBase.GetFailure(); }
    const TBase& GetBase() const { return fBase; }
    // Whether the report reached its end; a report whose page sequence
    // stopped on a failure has no index.
    bool IsEnded() const { return fEnded; }

    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override {
        SetUp(ns, context, outputPath);
        fEnded = false;
        fBase.Initialize(ns, context, outputPath);
        fBase.StartReport();
    }
    void EndCategory() override { fBase.EndCategory(); }
    void WriteCategory(const std::string& categoryName) override { fBase.WriteCategory(categoryName); }
    void EndReport() override {
        fBase.EndReport();
        fEnded = true;
    }
    void OpenPage(const std::string& path) override { fBase.OpenPage(path); }
    void ClosePage() override { fBase.ClosePage(); }
    void WritePageHeader() override { fBase.WritePageHeader(); }
    void WritePageFooter() override { fBase.WritePageFooter(); }
    void WriteHeaderCell(TClassPtr cls, TReportProperty property) override { fBase.WriteHeaderCell(cls, property); }
    void WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) override {
        fBase.WriteReportTitle(title, link, linkText);
    }
    void WriteIndexEntry(const std::string& linkName, const std::string& reportName, bool hasData) override {
        fBase.WriteIndexEntry(linkName, reportName, hasData);
    }
    void WriteTableTitle(const std::string& title, bool subTitle, bool unused) override {
        fBase.WriteTableTitle(title, subTitle, unused);
    }
    void WriteTableGrid(TTable& table) override { fBase.WriteTableGrid(table); }
    void StartTable(const std::string& width, const std::string& id, bool sortable) override {
        fBase.StartColumnTable(width, id, sortable);
    }
    void StartRow(bool first) override { fBase.StartRow(first); }
    void EndRow() override { fBase.EndRow(); }
    std::string GetSeparatorText(int separator) override { return fBase.GetSeparatorText(separator); }

    // Every declared page of the ESXi report is a generic page.
    void WriteInstalledApps(TReportParameters params) override { WriteGenericReport(params); }
    void WriteKernelModules(TReportParameters params) override { WriteGenericReport(params); }
    void WriteNetworking(TReportParameters params) override { WriteGenericReport(params); }
    void WriteResourceUtilization(TReportParameters params) override { WriteGenericReport(params); }
    void WriteProcesses(TReportParameters params) override { WriteGenericReport(params); }
    void WriteOSConfig(TReportParameters params) override { WriteGenericReport(params); }
    void WriteSysConfig(TReportParameters params) override { WriteGenericReport(params); }
    void WriteChassisEventLog(TReportParameters params) override { WriteGenericReport(params); }
    void WriteMergedLog(TReportParameters params) override { WriteGenericReport(params); }
    void WriteMergedDevices(TReportParameters params) override { WriteGenericReport(params); }
    void WritePBReport(TReportParameters params) override { WriteGenericReport(params); }
    void WritePCIInfo(TReportParameters params) override { WriteGenericReport(params); }
    void WriteDriveHealth(TReportParameters params) override { WriteGenericReport(params); }
    void WriteLSIIDE(TReportParameters params) override { WriteGenericReport(params); }
    void WritePMCRAID(TReportParameters params) override { WriteGenericReport(params); }
    void WriteHalcyon(TReportParameters params) override { WriteGenericReport(params); }
    void WriteHalcyonLogs(TReportParameters params) override { WriteGenericReport(params); }
    void WriteQlogic(TReportParameters params) override { WriteGenericReport(params); }
    void WriteEmulex(TReportParameters params) override { WriteGenericReport(params); }
    void WriteBroadcom(TReportParameters params) override { WriteGenericReport(params); }
    void WriteBrocadeAdapter(TReportParameters params) override { WriteGenericReport(params); }
    void WriteGlowTrace(TReportParameters params) override { WriteGenericReport(params); }
    void WriteKMCBuiltinSelfTest(TReportParameters params) override { WriteGenericReport(params); }
    void WriteLogPage(TReportParameters params) override { WriteGenericReport(params); }
    void WriteIPMIEvent(TReportParameters params) override { WriteGenericReport(params); }

    void EndTableHeader() override { fBase.EndTableHeader(); }
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string separator) override {
        fBase.WriteValueCell(instance, property, separator);
    }
    void WriteTextCell(TReportProperty property, std::string text, std::string link) override {
        fBase.WriteTextCell(property, text, link);
    }
    void EndTable() override { fBase.EndTable(); }
    void WriteTableBreak() override { fBase.WriteTableBreak(); }
    std::string EscapeText(std::string text) override { return fBase.EscapeText(text); }

private:
    TBase fBase;
    bool fEnded = false;
};

}  // namespace backends
}  // namespace braigrion
