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
    void SetSeparatorText(int separator, const std::string& text) { fSeparators[separator] = text; }

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

    // --- the back-end operations: each records its call ---
    // Sets fOutputPath from `outputPath` and fMode from the context key
    // "mode" ("default" without it); the writer type is the constructor's.
    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override;
    void StartReport() override { Record("StartReport"); }
    void EndCategory() override { Record("EndCategory"); }
    void WriteCategory(const std::string& categoryName) override { Record("WriteCategory", {Quote(categoryName)}); }
    void EndReport() override { Record("EndReport"); }
    std::string GetInventoryPage() override {
        Record("GetInventoryPage");
        return fInventoryPage;
    }
    void WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                              const std::string& title) override;
    void WriteEventLogReport(TReportParameters params) override { Record("WriteEventLogReport", {Describe(params)}); }
    void WriteMergedLogPage(TReportParameters params) override { Record("WriteMergedLogPage", {Describe(params)}); }
    void WriteMelodyPrologue(const std::string& headerText) override {
        Record("WriteMelodyPrologue", {Quote(headerText)});
    }
    void WriteMelodyDeviceRow(TInstancePtr device, const std::string& score, const std::string& type,
                              const std::string& cimType, const std::string& propertyName, const std::string& value,
                              const std::string& frequency, const std::string& commonValues,
                              int commonFrequencies) override {
        Record("WriteMelodyDeviceRow", {Describe(device), Quote(score), Quote(type), Quote(cimType),
                                        Quote(propertyName), Quote(value), Quote(frequency), Quote(commonValues),
                                        std::to_string(commonFrequencies)});
    }
    void WriteMelodyTableStart() override { Record("WriteMelodyTableStart"); }
    void WriteDriveHealthEntry(TPropertyPtr rawData) override { Record("WriteDriveHealthEntry", {Describe(rawData)}); }
    void WriteDeclarationHeader(TPropertyDeclPtr declaration) override {
        Record("WriteDeclarationHeader", {Describe(declaration)});
    }
    void WriteDriveHealthValue(TInstancePtr instance, TPropertyPtr property) override {
        Record("WriteDriveHealthValue", {Describe(instance), Describe(property)});
    }
    void WriteRegisterValue(TInstancePtr instance, TPropertyPtr property) override {
        Record("WriteRegisterValue", {Describe(instance), Describe(property)});
    }
    void OpenPage(const std::string& path) override { Record("OpenPage", {Quote(path)}); }
    void ClosePage() override { Record("ClosePage"); }
    void WritePageHeader() override { Record("WritePageHeader"); }
    void WritePageFooter() override { Record("WritePageFooter"); }
    void WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) override {
        Record("WriteReportTitle", {Quote(title), Quote(link), Quote(linkText)});
    }
    void WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                  const std::string& linkText) override {
        Record("WriteReportTitleWithLink", {Quote(title), Quote(link), Quote(linkText)});
    }
    void WriteIndexEntry(const std::string& linkName, const std::string& reportName, const bool& hasData) override {
        Record("WriteIndexEntry", {Quote(linkName), Quote(reportName), Flag(hasData)});
    }
    void WriteTableBreak() override { Record("WriteTableBreak"); }
    void WriteTableTitle(const std::string& title, const bool& a, const bool& b) override {
        Record("WriteTableTitle", {Quote(title), Flag(a), Flag(b)});
    }
    void StartColumnTable(const std::string& tableWidth, const std::string& summary, bool sortable) override {
        Record("StartColumnTable", {Quote(tableWidth), Quote(summary), Flag(sortable)});
    }
    void StartPropertyTable(const std::string& tableWidth, const std::string& headerWidth,
                            const std::string& title) override {
        Record("StartPropertyTable", {Quote(tableWidth), Quote(headerWidth), Quote(title)});
    }
    void WriteHeaderCell(TClassPtr cls, TReportProperty property) override {
        Record("WriteHeaderCell", {Describe(cls), Describe(property)});
    }
    void EndTableHeader() override { Record("EndTableHeader"); }
    void StartRow(const bool& first) override { Record("StartRow", {Flag(first)}); }
    void EndRow() override { Record("EndRow"); }
    void EndTable() override { Record("EndTable"); }
    void WriteRowBreak(int span) override { Record("WriteRowBreak", {std::to_string(span)}); }
    void WriteTableGrid(TTable& table) override { Record("WriteTableGrid", {Describe(table)}); }
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string text) override {
        Record("WriteValueCell", {Describe(instance), Describe(property), Quote(text)});
    }
    void WriteTextCell(TReportProperty property, std::string text, std::string link) override {
        Record("WriteTextCell", {Describe(property), Quote(text), Quote(link)});
    }
    void WriteMessageCell(TReportProperty property, const std::string& message) override {
        Record("WriteMessageCell", {Describe(property), Quote(message)});
    }
    void WriteSensorCell(TInstancePtr sensor, const std::string& readingProperty,
                         const std::string& modifierProperty) override {
        Record("WriteSensorCell", {Describe(sensor), Quote(readingProperty), Quote(modifierProperty)});
    }
    void WriteSortScript() override { Record("WriteSortScript"); }
    // Answers the text unchanged.
    std::string EscapeText(std::string text) override {
        Record("EscapeText", {Quote(text)});
        return text;
    }
    std::string GetSeparatorText(int separator) override {
        Record("GetSeparatorText", {std::to_string(separator)});
        return fSeparators.count(separator) ? fSeparators[separator] : ", ";
    }

private:
    void Record(const std::string& name, const std::vector<std::string>& args = std::vector<std::string>());
    static std::string Flag(bool value) { return value ? "true" : "false"; }

    std::string fConfiguredType;
    std::vector<std::string> fCalls;
    std::string fInventoryPage;
    std::map<int, std::string> fSeparators;
};

// A recording writer whose grids show one row per line, so that an expected
// page reads as a table. Each cell is quoted; the marks chosen put "#"
// before a monospaced cell, "=" before a cell flagged as agreeing with a
// baseline (its first back-end flag), and "~" and the second text after a
// cell that has one.
class TGridLinesRecorder : public TRecordingWriter {
public:
    struct TMarks {
        bool monospaced = false;
        bool agreement = false;
        bool rawText = false;
    };
    explicit TGridLinesRecorder(const std::string& writerType = "html");
    TGridLinesRecorder(const std::string& writerType, TMarks marks);
    void WriteTableGrid(TTable& table) override;

private:
    TMarks fMarks;
};

}  // namespace testing
}  // namespace braigrion
