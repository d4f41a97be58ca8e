// The software, network and hardware pages of the sample collections'
// reports as the back-end receives them. Each sample's report is written in
// the default mode through a recording writer and cut into pages by link
// name; the pages written must be exactly those with an expected file under
// tests/fixtures/pages/<sample>/<link>.txt, and each must read as its file.
#include <algorithm>
#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "report/ExpectedPage.h"
#include "repository/CIMXMLReader.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace {

namespace fs = std::filesystem;
using testing::TGridLinesRecorder;

// Grids one row per line, monospaced cells and second texts marked.
TGridLinesRecorder::TMarks PageMarks() {
    TGridLinesRecorder::TMarks marks;
    marks.monospaced = true;
    marks.rawText = true;
    return marks;
}

bool StartsWith(const std::string& text, const std::string& prefix) {
    return text.compare(0, prefix.size(), prefix) == 0;
}

// The pages of the sample's report by link, each from OpenPage to its
// WriteIndexEntry, without the calls that only make text safe.
std::map<std::string, std::string> WritePages(const std::string& sample) {
    std::vector<std::string> files;
    for (const auto& entry : fs::directory_iterator(std::string(BRAIGRION_SOURCE_DIR) + "/samples/" + sample)) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    TGridLinesRecorder writer("html", PageMarks());
    // The example lookup files, so that documentation links show.
    TWriter::TLogLinkSettings links;
    links.fDataFolder = std::string(BRAIGRION_SOURCE_DIR) + "/data";
    writer.SetLogLinkSettings(links);
    // A KMC machine and a chassis inventory are read as the command's --kmc
    // and --vcx read them.
    std::map<std::string, NORVTKR20::TCIMValue> context;
    if (sample == "kmc-server") context["KMC"] = NORVTKR20::TCIMValue(std::string("TRUE"));
    if (StartsWith(sample, "vcx")) context["VCX"] = NORVTKR20::TCIMValue(std::string("TRUE"));
    TReport report(repository::LoadCollection(files).fNamespace, context, "out");
    report.Write(&writer, context);

    std::map<std::string, std::string> pages;
    std::string link, page;
    // A page whose index line comes before it (the Linux log pages) starts
    // with that line and ends where it closes.
    std::string indexFirst;
    for (const std::string& call : writer.Calls()) {
        if (StartsWith(call, "EscapeText(") || StartsWith(call, "GetSeparatorText(")) continue;
        if (link.empty() && StartsWith(call, "WriteIndexEntry(")) indexFirst = call;
        if (StartsWith(call, "OpenPage(")) {
            link = call.substr(call.find_last_of('/') + 1);
            link = link.substr(0, link.find('"'));
            page.clear();
            if (StartsWith(indexFirst, "WriteIndexEntry(\"" + link + "\"")) page = indexFirst + "\n";
            indexFirst.clear();
        }
        if (link.empty()) continue;
        page += call + "\n";
        const bool indexed = page.compare(0, 16, "WriteIndexEntry(") == 0;
        if (indexed ? StartsWith(call, "ClosePage(") : StartsWith(call, "WriteIndexEntry(")) {
            EXPECT_EQ(0u, pages.count(link)) << "two pages with the link " << link;
            pages[link] = page;
            link.clear();
        }
    }
    EXPECT_TRUE(link.empty()) << "the page " << link << " was left unfinished";
    return pages;
}

class SamplePages : public ::testing::TestWithParam<const char*> {};

TEST_P(SamplePages, AreWrittenAsExpected) {
    const std::map<std::string, std::string> pages = WritePages(GetParam());
    std::vector<std::string> expected, written;
    for (const auto& page : pages) {
        written.push_back(page.first);
        const std::string file = std::string(GetParam()) + "/" + page.first + ".txt";
        EXPECT_EQ(testing::ExpectedPage(file, page.second), page.second) << file;
    }
    for (const auto& entry : fs::directory_iterator(fs::path(BRAIGRION_SOURCE_DIR) / "tests/fixtures/pages" / GetParam())) {
        expected.push_back(entry.path().stem().string());
    }
    std::sort(expected.begin(), expected.end());
    EXPECT_EQ(expected, written) << "the pages with an expected file";
}

// Windows gets its components, fixes, drivers and services; Linux its
// packages, modules and configuration files; pre-boot data no operating
// system pages but the configuration files; a multi-node system has its
// nodes in a table of their own; a KMC machine has the KMC forms of the
// service processor pages, and a chassis inventory its VCX page; the KMC
// blade, written without the KMC flag, has its service processor's logs and
// its diagnostics linked to their documentation.
INSTANTIATE_TEST_SUITE_P(Samples, SamplePages,
                         ::testing::Values("windows-server", "linux-teaming", "linux-server", "preboot", "multinode",
                                           "kmc-server", "vcx-chassis", "kmc-blade"),
                         [](const ::testing::TestParamInfo<const char*>& info) {
                             std::string name = info.param;
                             std::replace(name.begin(), name.end(), '-', '_');
                             return name;
                         });

}  // namespace
}  // namespace braigrion
