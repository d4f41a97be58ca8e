// The adapter, device analysis and service pages of the sample server's
// "luz" report as the back-end receives them, raw-data pages included: each
// page from its OpenPage to its index entry (or to the next page), compared
// with tests/fixtures/pages/linux-server-luz/<link>.txt. Run with
// BRAIGRION_UPDATE_PAGES=1 to rewrite the files; read the difference first.
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <map>
#include <set>
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

// Grids one row per line, monospaced cells marked.
testing::TGridLinesRecorder::TMarks PageMarks() {
    testing::TGridLinesRecorder::TMarks marks;
    marks.monospaced = true;
    return marks;
}

bool StartsWith(const std::string& text, const std::string& prefix) {
    return text.compare(0, prefix.size(), prefix) == 0;
}

const std::set<std::string> kPages = {"Mellanox", "emulex",   "emulex_rawData", "Qlogic",      "QLogic_RawData",
                                      "FusionIO", "fio_rawData", "brocade",     "qva_reg",     "cft_setting",
                                      "nvsmilog", "amdaticonfiglog", "melodydevices"};

TEST(AdapterSamplePages, LuzReportOfTheSampleServer) {
    const fs::path out = fs::path(::testing::TempDir()) / ("braigrion_adapter_luz_" + std::to_string(getpid()));
    fs::remove_all(out);
    fs::create_directories(out);
    std::vector<std::string> files;
    for (const auto& entry : fs::directory_iterator(fs::path(BRAIGRION_SOURCE_DIR) / "samples/linux-server")) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    testing::TGridLinesRecorder writer("html", PageMarks());
    std::map<std::string, NORVTKR20::TCIMValue> context;
    context["mode"] = NORVTKR20::TCIMValue(std::string("luz"));
    TReport report(repository::LoadCollection(files).fNamespace, context, out.string());
    report.Write(&writer, context);

    std::map<std::string, std::string> pages;
    std::string link, page;
    auto store = [&]() {
        if (kPages.count(link) != 0) pages[link] = page;
        link.clear();
        page.clear();
    };
    for (std::string call : writer.Calls()) {
        if (StartsWith(call, "EscapeText(") || StartsWith(call, "GetSeparatorText(")) continue;
        for (size_t at = call.find(out.string()); at != std::string::npos; at = call.find(out.string()))
            call.replace(at, out.string().size(), "out");
        if (StartsWith(call, "OpenPage(")) {
            store();
            link = call.substr(call.find_last_of('/') + 1);
            link = link.substr(0, link.find('"'));
        }
        if (link.empty()) continue;
        page += call + "\n";
        if (StartsWith(call, "WriteIndexEntry(")) store();
    }
    store();
    fs::remove_all(out);

    std::vector<std::string> written;
    for (const auto& each : pages) {
        written.push_back(each.first);
        const std::string file = "linux-server-luz/" + each.first + ".txt";
        EXPECT_EQ(testing::ExpectedPage(file, each.second), each.second) << file;
    }
    EXPECT_EQ(std::vector<std::string>(kPages.begin(), kPages.end()), written) << "pages of the sample with data";
}

}  // namespace
}  // namespace braigrion
