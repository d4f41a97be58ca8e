// A writer back-end for tests: it records every back-end call it receives,
// with its arguments, one line per call, so that a test can compare the
// transcript of a page or a whole report with an expected one.
//
// Notation of the arguments:
//   text            "quoted", with \n, \t, \" and \\ escaped
//   bool            true / false
//   instance        <instance Class.Key="v"> (its object path), or null
//   class           <class Name>
//   property        <property Name>; a declaration <decl Name>
//   TReportProperty {Name width="25%" assoc="A" target="T" second="S"
//                    label="L" default="D" sep=1 mono}; empty parts left out
//   TReportParameters {link="x" name="y" title classes=[A,B]}
//   TTable          grid 2x3 width=100 widths=[20,30,50] colheaders rowheaders
//                   sortable marked | "a" "b" "c" | "d" "e" "f"
//                   a cell shows "text", then ~"raw" when it has a raw text,
//                   and a leading # when monospaced
//
// The raw-data operations that TWriter implements itself are not replaced,
// so their own logic runs and their back-end calls are what is recorded.
#pragma once

#include <map>
#include <string>
#include <vector>

#include "braigrion/TWriter.h"

namespace braigrion {
namespace testing {

class TRecordingWriter : public TWriter {
public:
    explicit TRecordingWriter(const std::string& writerType = "html");

    // --- the transcript ---
    const std::vector<std::string>& Calls() const { return fCalls; }
    // All calls, one per line, each line ending in "\n".
    std::string Transcript() const;
    // The calls whose line starts with `prefix` (for instance "WriteCategory(").
    std::vector<std::string> CallsStartingWith(const std::string& prefix) const;
    void Clear() { fCalls.clear(); }
    // Puts a line of the test's own into the transcript, such as a marker
    // for a page the driver asked for.
    void Note(const std::string& line) { fCalls.push_back(line); }

    // --- answers of the operations that return something ---
    void SetInventoryPage(const std::string& text) { fInventoryPage = text; }
    // Separator texts by number; numbers without one get ", ".
    void SetSeparatorText(int separator, const std::string& text);

    // --- the state the driver set, for assertions ---
    const TNamespacePtr& Namespace() const { return fNamespace; }
    const std::string& OutputPath() const { return fOutputPath; }
    const std::string& Mode() const { return fMode; }
    bool Preboot() const { return fPreboot; }
    bool KMC() const { return fKMC; }
    int ProviderType() const { return fProviderType; }
    int OSType() const { return fOSType; }

    // --- formatting, shared with tests that build expected lines ---
    static std::string Quote(const std::string& text);
    static std::string Describe(const TInstancePtr& instance);
    static std::string Describe(const TClassPtr& cls);
    static std::string Describe(const TPropertyPtr& property);
    static std::string Describe(const TPropertyDeclPtr& declaration);
    static std::string Describe(const TReportProperty& property);
    static std::string Describe(const TReportParameters& params);
    static std::string Describe(const TTable& table);

    // --- the back-end operations ---
    // Sets fOutputPath from `outputPath` and fMode from the context key
    // "mode" ("default" without it); the writer type is the constructor's.
    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override;
    void StartReport() override;
    void EndCategory() override;
    void WriteCategory(const std::string& categoryName) override;
    void EndReport() override;
    std::string GetInventoryPage() override;
    void WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                              const std::string& title) override;
    void WriteEventLogReport(TReportParameters params) override;
    void WriteMergedLogPage(TReportParameters params) override;
    void WriteMelodyPrologue(const std::string& headerText) override;
    void WriteMelodyDeviceRow(TInstancePtr device, const std::string& score, const std::string& type,
                              const std::string& cimType, const std::string& propertyName, const std::string& value,
                              const std::string& frequency, const std::string& commonValues,
                              int commonFrequencies) override;
    void WriteMelodyTableStart() override;
    void WriteDriveHealthEntry(TPropertyPtr rawData) override;
    void WriteDeclarationHeader(TPropertyDeclPtr declaration) override;
    void WriteDriveHealthValue(TInstancePtr instance, TPropertyPtr property) override;
    void WriteRegisterValue(TInstancePtr instance, TPropertyPtr property) override;
    void OpenPage(const std::string& path) override;
    void ClosePage() override;
    void WritePageHeader() override;
    void WritePageFooter() override;
    void WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) override;
    void WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                  const std::string& linkText) override;
    void WriteIndexEntry(const std::string& linkName, const std::string& reportName, const bool& hasData) override;
    void WriteTableBreak() override;
    void WriteTableTitle(const std::string& title, const bool& a, const bool& b) override;
    void StartColumnTable(const std::string& tableWidth, const std::string& summary, bool sortable) override;
    void StartPropertyTable(const std::string& tableWidth, const std::string& headerWidth,
                            const std::string& title) override;
    void WriteHeaderCell(TClassPtr cls, TReportProperty property) override;
    void EndTableHeader() override;
    void StartRow(const bool& first) override;
    void EndRow() override;
    void EndTable() override;
    void WriteRowBreak(int span) override;
    void WriteTableGrid(TTable& table) override;
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string text) override;
    void WriteTextCell(TReportProperty property, std::string text, std::string link) override;
    void WriteMessageCell(TReportProperty property, const std::string& message) override;
    void WriteSensorCell(TInstancePtr sensor, const std::string& readingProperty,
                         const std::string& modifierProperty) override;
    void WriteSortScript() override;
    // Answers the text unchanged.
    std::string EscapeText(std::string text) override;
    std::string GetSeparatorText(int separator) override;

private:
    void Record(const std::string& name, const std::vector<std::string>& args = std::vector<std::string>());

    std::string fConfiguredType;
    std::vector<std::string> fCalls;
    std::string fInventoryPage;
    std::map<int, std::string> fSeparators;
};

}  // namespace testing
}  // namespace braigrion
