// The pages of a sample collection's report as the back-end receives them:
// the report is written through a recording writer, and its transcript is
// cut into pages by link name. A page's transcript is compared with an
// expected file under tests/fixtures/pages/<sample>/<link>.txt; run the test
// with BRAIGRION_UPDATE_PAGES=1 to write the expected files instead (then
// read every changed file before keeping it).
#pragma once

#include <map>
#include <string>
#include <vector>

#include "support/RecordingWriter.h"

namespace braigrion {
namespace testing {

// One grid of a page: the title written before it and its cells by row.
struct TRecordedGrid {
    std::string title;
    std::vector<std::vector<std::string>> rows;

    // The first cell of each row: the labels of a row report.
    std::vector<std::string> RowLabels() const;
    // The texts of the first row: the labels of a column report.
    std::vector<std::string> ColumnLabels() const;
};

// A recording writer whose grids show one row per line, so that an expected
// page reads as a table, and which keeps each grid with its title.
class TPageRecorder : public TRecordingWriter {
public:
    using TRecordingWriter::TRecordingWriter;

    void OpenPage(const std::string& path) override;
    void WriteTableTitle(const std::string& title, const bool& a, const bool& b) override;
    void WriteTableGrid(TTable& table) override;

    // The grids of the page written under `link`, in order.
    std::vector<TRecordedGrid> Grids(const std::string& link) const;

private:
    std::string fPage;   // the link of the open page
    std::string fTitle;  // the last table title of the open page
    std::multimap<std::string, TRecordedGrid> fGrids;
};

class TSampleReport {
public:
    // Loads samples/<sample>/*.xml and writes its whole HTML report in the
    // default mode through the recorder.
    explicit TSampleReport(const std::string& sample);

    // The link names of the pages written, in the order written.
    const std::vector<std::string>& Links() const { return fLinks; }
    // The calls of the page `link`, from OpenPage to WriteIndexEntry, one
    // per line; "" when no page has that link.
    std::string Page(const std::string& link) const;
    std::vector<TRecordedGrid> Grids(const std::string& link) const { return fWriter.Grids(link); }
    // The titles of the tables of a page that have a grid, in order.
    std::vector<std::string> TableTitles(const std::string& link) const;
    // The grid under a title; fails the test when there is not exactly one.
    TRecordedGrid Grid(const std::string& link, const std::string& title) const;

    // Compares the page with its expected file (or writes the file when
    // updating); adds a test failure naming the file on a difference.
    void ExpectPageAsRecorded(const std::string& link) const;

private:
    std::string fSample;
    TPageRecorder fWriter;
    std::vector<std::string> fLinks;
    std::map<std::string, std::string> fPages;
};

}  // namespace testing
}  // namespace braigrion
