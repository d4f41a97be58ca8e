// What the HTML, text and inventory back-ends share: page and index
// bookkeeping, the hand-written tables (gathered cell by cell and printed as
// one grid, so each format has a single table printer), and the reading of
// values for cells that a section hands over as an instance and a column.
#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include "braigrion/TWriter.h"

namespace braigrion {
namespace backends {

class TBackendWriter : public TWriter {
public:
    // One line of the index.
    struct TIndexEntry {
        std::string fStem;  // file stem of the page
        std::string fName;  // the page's name as the navigation shows it
        bool fHasData;      // false: the page is listed as holding no data
    };
    // A heading of the index and its pages. The pages after the last
    // category closes stand in a group with an empty name.
    struct TCategory {
        std::string fName;
        std::vector<TIndexEntry> fEntries;
    };

    // The meaning of TTable::TCell::flags in the grids this family prints.
    enum TCellFlag {
        kSpansRow = 0,   // the cell stands across the whole row
        kFinalText = 1,  // the text is finished output of the back-end, printed as it is
        kHeaderCell = 2  // a label cell, wherever it stands
    };

    explicit TBackendWriter(const std::string& writerType);
    ~TBackendWriter() override;

    // The first failure to write output ("" when there was none). Writing
    // goes on after a failure, so that a caller sees every page it can, but
    // a report with a failure is not complete.
    const std::string& GetFailure() const { return fFailure; }
    const std::vector<TCategory>& GetIndex() const { return fIndex; }

    // --- report and index ---
    // Takes the output directory and the mode ("mode" of the context,
    // "default" without it). The writer type is the back-end's own.
    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override;
    void StartReport() override;
    void EndCategory() override;
    void WriteCategory(const std::string& categoryName) override;
    void EndReport() override;
    void WriteIndexEntry(const std::string& linkName, const std::string& reportName, const bool& hasData) override;

    // --- pages ---
    // A page still open (one the logic abandoned) is closed first.
    void OpenPage(const std::string& path) override;
    void ClosePage() override;
    void WriteSortScript() override;

    // --- hand-written tables, gathered and printed by WriteTableGrid ---
    void StartColumnTable(const std::string& tableWidth, const std::string& summary, bool sortable) override;
    void StartPropertyTable(const std::string& tableWidth, const std::string& headerWidth,
                            const std::string& title) override;
    void WriteHeaderCell(TClassPtr cls, TReportProperty property) override;
    void EndTableHeader() override;
    void StartRow(const bool& first) override;
    void EndRow() override;
    void EndTable() override;
    void WriteRowBreak(int span) override;
    // The third argument, when not empty, is the text put between the
    // elements of an array; otherwise the column's own separator is used.
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string separator) override;
    void WriteTextCell(TReportProperty property, std::string text, std::string link) override;
    void WriteMessageCell(TReportProperty property, const std::string& message) override;
    // The reading times ten to the power of the modifier, followed by the
    // sensor's unit as a reading is spoken ("23.75 degrees C"); "N/A" when
    // either number cannot be read.
    void WriteSensorCell(TInstancePtr sensor, const std::string& readingProperty,
                         const std::string& modifierProperty) override;
    void WriteDeclarationHeader(TPropertyDeclPtr declaration) override;
    void WriteDriveHealthEntry(TPropertyPtr rawData) override;
    void WriteDriveHealthValue(TInstancePtr instance, TPropertyPtr property) override;
    void WriteRegisterValue(TInstancePtr instance, TPropertyPtr property) override;

    // --- whole tables and pages that the logic leaves to the back-end ---
    void WriteHalcyonEventLog(const std::vector<TInstancePtr>& records, const std::string& fileStem,
                              const std::string& title) override;
    void WriteEventLogReport(TReportParameters params) override;
    void WriteMergedLogPage(TReportParameters params) override;
    void WriteMelodyPrologue(const std::string& headerText) override;
    void WriteMelodyTableStart() override;
    void WriteMelodyDeviceRow(TInstancePtr device, const std::string& score, const std::string& type,
                              const std::string& cimType, const std::string& propertyName, const std::string& value,
                              const std::string& frequency, const std::string& commonValues,
                              int commonFrequencies) override;

    std::string GetInventoryPage() override;

protected:
    // --- what each format supplies ---
    // `text` is already in the format; the result is finished cell output.
    virtual std::string LinkedText(const std::string& text, const std::string& link) = 0;
    // The text of a block of raw data (a hex dump, say), finished.
    virtual std::string MonospacedBlock(const std::string& text) = 0;
    // Stores a finished page under its stem.
    virtual void SavePage(const std::string& stem, const std::string& text) = 0;
    // Writes the index and whatever else the report needs beside its pages.
    virtual void WriteReportFiles() = 0;
    // Whether EndReport gives a page file to every page the index lists;
    // the inventory back-end hands over one page at a time and does not.
    virtual bool WritesListedPages() const { return true; }
    // Finishes a page that the logic left without its foot.
    virtual void FinishAbandonedPage() = 0;

    // Writes `text` to `fileName` in the output directory; a failure is
    // recorded (see GetFailure), not thrown.
    void WriteOutputFile(const std::string& fileName, const std::string& text);
    void RecordFailure(const std::string& message);
    // The stem of a page from the path the logic gives OpenPage: the part
    // after the output directory, made safe by SafeFileStem.
    std::string StemFromPath(const std::string& path) const;
    // Writes a whole page of one grid to its own file, leaving the open page
    // as it stands.
    void WriteSeparatePage(const std::string& stem, const std::string& title, TTable& table);

    // --- values of cells (TBackendWriterValues.cpp) ---
    // The properties behind a column of `instance`: its own property, or the
    // property of the instances reached through the column's association.
    std::vector<TPropertyPtr> ColumnProperties(TInstancePtr instance, const TReportProperty& property);
    // The text of one property in this format: a date as the report shows
    // dates, an array's elements joined by `separator`, any value escaped.
    std::string PropertyText(TPropertyPtr property, const std::string& separator);
    // The label of a column: its override, else the declaration's display
    // name on the class that holds the property, else the property's name.
    std::string ColumnLabel(TClassPtr cls, const TReportProperty& property);
    std::string DeclarationLabel(TPropertyDeclPtr declaration);
    // A short name of an instance for a row label.
    std::string InstanceLabel(TInstancePtr instance);
    // Property names of an instance, in its order.
    std::vector<std::string> PropertyNames(TInstancePtr instance);

    // The page being written.
    bool fPageOpen;
    bool fFooterWritten;
    bool fSortScriptAsked;
    std::string fPageStem;
    std::string fPage;
    int fPageTables;  // tables printed on the open page
    int fTableCounter;  // tables printed in the report, for their ids

    std::vector<TCategory> fIndex;
    bool fCategoryOpen;

private:
    struct THandCell {
        std::string fText;
        std::string fWidth;
        bool fHeader = false;
        bool fSpans = false;
        bool fFinal = false;
        bool fMonospaced = false;
    };
    struct THandTable {
        bool fOpen = false;
        bool fPropertyTable = false;
        std::string fWidth;
        std::string fHeaderWidth;
        bool fSortable = false;
        std::vector<std::vector<THandCell>> fRows;
        bool fRowOpen = false;
    };

    void AddCell(const THandCell& cell);
    TTable BuildGrid(const THandTable& hand);
    // Whether each stem's page printed a table, for its index entry.
    std::map<std::string, bool> fPageHadTable;
    std::set<std::string> fWrittenStems;  // pages saved so far
    THandTable fHand;
    std::string fMelodyPrologue;
    std::string fFailure;
};

}  // namespace backends
}  // namespace braigrion
