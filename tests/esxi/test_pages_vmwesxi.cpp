// The ESXi sample's report: its pages as the back-end receives them,
// against the transcripts under tests/fixtures/pages/esxi-host/ (run with
// BRAIGRION_UPDATE_PAGES=1 to rewrite them, then read the difference); the
// files the HTML and text back-ends write; and the command's choice of the
// ESXi report.
#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include <unistd.h>

#include <gtest/gtest.h>

#include "RecordingWriter_vmwesxi.h"
#include "THtmlWriter_vmwesxi.h"
#include "TReport_vmwesxi.h"
#include "TTextWriter_vmwesxi.h"
#include "report/ExpectedPage.h"
#include "repository/CIMXMLReader.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

namespace fs = std::filesystem;
using testing::TRecordingWriter_vmwesxi;
typedef TReport_vmwesxi::TContext TContext;

const char kSample[] = "esxi-host";

std::vector<std::string> SampleFiles() {
    std::vector<std::string> files;
    const fs::path dir = fs::path(BRAIGRION_SOURCE_DIR) / "samples" / kSample;
    for (const auto& entry : fs::directory_iterator(dir)) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string ReadFile(const fs::path& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// The sample's pages by link name, each from OpenPage to its index entry.
std::map<std::string, std::string> SamplePages() {
    TRecordingWriter_vmwesxi writer;
    TReport_vmwesxi report(repository::LoadCollection(SampleFiles()).fNamespace, TContext(), "out");
    report.Write(&writer, TContext());
    std::map<std::string, std::string> pages;
    std::string link, page;
    for (const std::string& call : writer.Calls()) {
        if (call.compare(0, 9, "OpenPage(") == 0) {
            link = call.substr(call.find_last_of('/') + 1);
            link = link.substr(0, link.find('"'));
            page.clear();
        }
        if (link.empty()) continue;
        page += call + "\n";
        if (call.compare(0, 16, "WriteIndexEntry(") == 0) {
            EXPECT_EQ(0u, pages.count(link)) << "two pages with the link " << link;
            pages[link] = page;
            link.clear();
        }
    }
    EXPECT_TRUE(link.empty()) << "the page " << link << " was left unfinished";
    EXPECT_EQ(1u, writer.CallsStartingWith("EndReport(").size());
    return pages;
}

TEST(SamplePagesVmwesxi, EveryPageReadsAsItsTranscriptAndShowsData) {
    const std::map<std::string, std::string> pages = SamplePages();
    EXPECT_EQ(32u, pages.size());
    for (const auto& page : pages) {
        const std::string expected = testing::ExpectedPage(std::string(kSample) + "/" + page.first + ".txt", page.second);
        EXPECT_EQ(expected, page.second) << page.first;
        // The error log is indexed without data in the default mode, whatever it holds.
        const bool hasData = page.second.find(", true)\n", page.second.rfind("WriteIndexEntry(")) != std::string::npos;
        EXPECT_EQ(page.first != "tkr_log", hasData) << page.first;
        EXPECT_NE(std::string::npos, page.second.find("WriteTableGrid(")) << page.first << " shows no table";
    }
    // No transcript is left without its page.
    for (const auto& entry : fs::directory_iterator(fs::path(BRAIGRION_SOURCE_DIR) / "tests/fixtures/pages" / kSample)) {
        EXPECT_EQ(1u, pages.count(entry.path().stem().string())) << entry.path();
    }
}

// A fresh directory under the test's temporary directory.
fs::path TempDir(const std::string& name) {
    const fs::path dir = fs::path(::testing::TempDir()) / ("braigrion_esxi_" + name + "_" + std::to_string(::getpid()));
    fs::remove_all(dir);
    fs::create_directories(dir);
    return dir;
}

TEST(BackendsVmwesxi, HtmlReportHasTheIndexAssetsAndEveryPage) {
    const fs::path dir = TempDir("html");
    backends::THtmlWriter_vmwesxi writer;
    TReport_vmwesxi(repository::LoadCollection(SampleFiles()).fNamespace, TContext(), dir.string())
        .Write(&writer, TContext());
    ASSERT_EQ("", writer.GetFailure());
    ASSERT_TRUE(writer.IsEnded());
    for (const char* file : {"index.html", "navbar.html", "global.css", "tkr_sort.js", "system_overview.html",
                             "hardware_inventory.html", "firmware.html", "SPConfig.html", "environmentals.html",
                             "lsi_mir.html", "vmware_privilege_log.html", "tkr_log.html"}) {
        EXPECT_TRUE(fs::exists(dir / file)) << file;
    }
    const std::string navigation = ReadFile(dir / "navbar.html");
    for (const char* name : {"System Overview", "KMC Configuration", "LSI Controller", "VMware Privilege Log"}) {
        EXPECT_NE(std::string::npos, navigation.find(name)) << name;
    }
    EXPECT_NE(std::string::npos, ReadFile(dir / "system_overview.html").find("NVS7M3X2P8"));
    fs::remove_all(dir);
}

// Collected values are text in both formats, never mark-up.
TEST(BackendsVmwesxi, CollectedValuesAreEscaped) {
    testing::TRepoBuilder repo;
    repo.Parse("OMC_Card Name=\"<script>alert(1)</script>\" Caption=\"a & b\"\n"
               "OMC_MCFirmwareIdentity Name=\"<b>SP</b>\" VersionString=\"1\"");
    const fs::path html = TempDir("escape_html");
    backends::THtmlWriter_vmwesxi htmlWriter;
    TReport_vmwesxi(repo.Namespace(), TContext(), html.string()).Write(&htmlWriter, TContext());
    const std::string inventory = ReadFile(html / "hardware_inventory.html");
    EXPECT_EQ(std::string::npos, inventory.find("<script>alert")) << inventory;
    EXPECT_NE(std::string::npos, inventory.find("&lt;script&gt;alert(1)&lt;/script&gt;")) << inventory;
    EXPECT_NE(std::string::npos, inventory.find("a &amp; b")) << inventory;
    const std::string firmware = ReadFile(html / "firmware.html");
    EXPECT_EQ(std::string::npos, firmware.find("<b>SP")) << firmware;

    const fs::path text = TempDir("escape_text");
    backends::TTextWriter_vmwesxi textWriter;
    TReport_vmwesxi(repo.Namespace(), TContext(), text.string()).Write(&textWriter, TContext());
    EXPECT_NE(std::string::npos, ReadFile(text / "hardware_inventory.txt").find("<script>alert(1)</script>"));
    EXPECT_NE(std::string::npos, ReadFile(text / "index.txt").find("Hardware Inventory"));
    fs::remove_all(html);
    fs::remove_all(text);
}

// A page that fails ends the sequence before the index is written; the
// back-end tells the command so, and the command refuses the report.
class TFailingHtmlWriter : public backends::THtmlWriter_vmwesxi {
public:
    void WriteEmulex(TReportParameters) override { throw std::runtime_error("page failed"); }
};

TEST(BackendsVmwesxi, AReportStoppedByAFailingPageIsNotEnded) {
    const fs::path dir = TempDir("stopped");
    TFailingHtmlWriter writer;
    TReport_vmwesxi(repository::LoadCollection(SampleFiles()).fNamespace, TContext(), dir.string())
        .Write(&writer, TContext());
    EXPECT_FALSE(writer.IsEnded());
    EXPECT_TRUE(fs::exists(dir / "qlogic.html"));
    EXPECT_FALSE(fs::exists(dir / "index.html"));
    fs::remove_all(dir);
}

// The command: run it and capture its standard output.
std::string RunCommand(const std::string& arguments, int& status) {
    const fs::path out = TempDir("cli") / "out.txt";
    status = std::system((std::string(BRAIGRION_EXE) + " " + arguments + " > " + out.string() + " 2>&1").c_str());
    return ReadFile(out);
}

std::string SampleArguments() {
    std::string arguments;
    for (const std::string& file : SampleFiles()) arguments += " " + file;
    return arguments;
}

TEST(CommandVmwesxi, RecognisesTheHostAndLetsTheOptionDecide) {
    int status = -1;
    const std::string info = RunCommand("info" + SampleArguments(), status);
    EXPECT_EQ(0, status) << info;
    EXPECT_NE(std::string::npos, info.find("Report                ESXi host")) << info;

    struct TCase {
        const char* option;
        const char* present;
        const char* absent;
    } const cases[] = {
        {"", "hardware_inventory.html", "hw_info.html"},
        {" --stack esxi", "hardware_inventory.html", "hw_info.html"},
        {" --stack base", "hw_info.html", "hardware_inventory.html"},
        {" --stack base --format text", "hw_info.txt", "hardware_inventory.txt"},
        {" --format text", "hardware_inventory.txt", "hw_info.txt"},
    };
    for (const TCase& c : cases) {
        const fs::path dir = TempDir("report") / "report";
        const std::string said =
            RunCommand("report -q -o " + dir.string() + c.option + SampleArguments(), status);
        EXPECT_EQ(0, status) << c.option << ": " << said;
        EXPECT_TRUE(fs::exists(dir / c.present)) << c.option;
        EXPECT_FALSE(fs::exists(dir / c.absent)) << c.option;
        fs::remove_all(dir.parent_path());
    }
    // A base collection stays with the base report.
    const std::string base = RunCommand(
        "info " + std::string(BRAIGRION_SOURCE_DIR) + "/samples/linux-server/schema.xml " +
            std::string(BRAIGRION_SOURCE_DIR) + "/samples/linux-server/inventory.xml",
        status);
    EXPECT_NE(std::string::npos, base.find("Report                base")) << base;
}

}  // namespace
}  // namespace braigrion
