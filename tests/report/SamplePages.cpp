#include "report/SamplePages.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>

#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "repository/CIMXMLReader.h"

namespace braigrion {
namespace testing {

namespace fs = std::filesystem;

namespace {

const char kOutput[] = "out";

std::string CellText(const TTable::TCell& cell) {
    std::string text = cell.monospaced ? "#" : "";
    text += TRecordingWriter::Quote(cell.text);
    if (!cell.rawText.empty()) text += "~" + TRecordingWriter::Quote(cell.rawText);
    return text;
}

bool StartsWith(const std::string& text, const std::string& prefix) {
    return text.compare(0, prefix.size(), prefix) == 0;
}

std::string ExpectedFile(const std::string& sample, const std::string& link) {
    return std::string(BRAIGRION_SOURCE_DIR) + "/tests/fixtures/pages/" + sample + "/" + link + ".txt";
}

std::vector<std::string> Lines(const std::string& text) {
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);) lines.push_back(line);
    return lines;
}

}  // namespace

std::vector<std::string> TRecordedGrid::RowLabels() const {
    std::vector<std::string> labels;
    for (const std::vector<std::string>& row : rows) labels.push_back(row.empty() ? "" : row[0]);
    return labels;
}

std::vector<std::string> TRecordedGrid::ColumnLabels() const {
    return rows.empty() ? std::vector<std::string>() : rows[0];
}

void TPageRecorder::OpenPage(const std::string& path) {
    TRecordingWriter::OpenPage(path);
    fPage = path.substr(path.find_last_of('/') + 1);
    fTitle.clear();
}

void TPageRecorder::WriteTableTitle(const std::string& title, const bool& a, const bool& b) {
    TRecordingWriter::WriteTableTitle(title, a, b);
    fTitle = title;
}

// The grid's shape on one line, then one line per row.
void TPageRecorder::WriteTableGrid(TTable& table) {
    const std::string described = Describe(table);
    Note("WriteTableGrid(" + described.substr(0, described.find(" |")) + ")");
    TRecordedGrid grid;
    grid.title = fTitle;
    for (int row = 0; row < table.fRows; ++row) {
        std::string line = "  |";
        grid.rows.emplace_back();
        for (int col = 0; col < table.fCols; ++col) {
            line += " " + CellText(table.Cell(row, col));
            grid.rows.back().push_back(table.Cell(row, col).text);
        }
        Note(line);
    }
    fGrids.insert(std::make_pair(fPage, grid));
}

std::vector<TRecordedGrid> TPageRecorder::Grids(const std::string& link) const {
    std::vector<TRecordedGrid> grids;
    auto range = fGrids.equal_range(link);
    for (auto it = range.first; it != range.second; ++it) grids.push_back(it->second);
    return grids;
}

TSampleReport::TSampleReport(const std::string& sample) : fSample(sample), fWriter("html") {
    std::vector<std::string> files;
    for (const auto& entry : fs::directory_iterator(std::string(BRAIGRION_SOURCE_DIR) + "/samples/" + sample)) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    repository::TLoadResult loaded = repository::LoadCollection(files);
    TReport report(loaded.fNamespace, {}, kOutput);
    report.Write(&fWriter, {});

    // Cut the transcript into pages; the calls that only make text safe
    // are left out.
    std::string link;
    std::string page;
    for (const std::string& call : fWriter.Calls()) {
        if (StartsWith(call, "EscapeText(") || StartsWith(call, "GetSeparatorText(")) continue;
        if (StartsWith(call, "OpenPage(")) {
            link = call.substr(call.find_last_of('/') + 1);
            link = link.substr(0, link.find('"'));
            page.clear();
        }
        if (link.empty()) continue;
        page += call + "\n";
        if (StartsWith(call, "WriteIndexEntry(")) {
            EXPECT_EQ(0u, fPages.count(link)) << "two pages with the link " << link;
            fPages[link] = page;
            fLinks.push_back(link);
            link.clear();
        }
    }
    EXPECT_TRUE(link.empty()) << "the page " << link << " was left unfinished";
}

std::string TSampleReport::Page(const std::string& link) const {
    std::map<std::string, std::string>::const_iterator page = fPages.find(link);
    return page == fPages.end() ? std::string() : page->second;
}

std::vector<std::string> TSampleReport::TableTitles(const std::string& link) const {
    std::vector<std::string> titles;
    for (const TRecordedGrid& grid : Grids(link)) {
        if (titles.empty() || titles.back() != grid.title) titles.push_back(grid.title);
    }
    return titles;
}

TRecordedGrid TSampleReport::Grid(const std::string& link, const std::string& title) const {
    std::vector<TRecordedGrid> found;
    for (const TRecordedGrid& grid : Grids(link)) {
        if (grid.title == title) found.push_back(grid);
    }
    EXPECT_EQ(1u, found.size()) << "grids titled \"" << title << "\" on the page " << link;
    return found.empty() ? TRecordedGrid() : found.front();
}

void TSampleReport::ExpectPageAsRecorded(const std::string& link) const {
    const std::string file = ExpectedFile(fSample, link);
    const std::string actual = Page(link);
    ASSERT_FALSE(actual.empty()) << fSample << " has no page " << link;
    const char* update = std::getenv("BRAIGRION_UPDATE_PAGES");
    if (update != nullptr && std::string(update) == "1") {
        fs::create_directories(fs::path(file).parent_path());
        std::ofstream(file) << actual;
        std::cout << "wrote " << file << "\n";
        return;
    }
    std::ifstream in(file);
    ASSERT_TRUE(in.good()) << "no expected page " << file << " (BRAIGRION_UPDATE_PAGES=1 writes it)";
    std::ostringstream text;
    text << in.rdbuf();
    const std::vector<std::string> expected = Lines(text.str());
    const std::vector<std::string> got = Lines(actual);
    for (size_t i = 0; i < std::max(expected.size(), got.size()); ++i) {
        const std::string want = i < expected.size() ? expected[i] : "(end of page)";
        const std::string have = i < got.size() ? got[i] : "(end of page)";
        if (want != have) {
            ADD_FAILURE() << file << ":" << (i + 1) << ": the page differs\n  expected: " << want
                          << "\n  written:  " << have;
            return;
        }
    }
}

}  // namespace testing
}  // namespace braigrion
