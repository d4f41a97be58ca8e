// The delta reports of the sample collections as the back-end receives
// them, page by page (expected transcripts under
// tests/fixtures/pages/delta-*/), and the compare command over the same
// samples: saved records give the same report, bad input a clear error.
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "Commands.h"
#include "CollectionLoader.h"
#include "braigrion/TReport.h"
#include "delta/DeltaFixture.h"
#include "report/ExpectedPage.h"
#include "repository/CIMXMLReader.h"

namespace braigrion {
namespace {

namespace fs = std::filesystem;

const std::string kSamples = std::string(BRAIGRION_SOURCE_DIR) + "/samples/";

boost::shared_ptr<repository::TMemoryNamespace> Sample(const std::string& name) {
    return repository::LoadCollection(cli::CollectionFiles(kSamples + name)).fNamespace;
}

// The delta report's pages by link, each from OpenPage to WriteIndexEntry.
std::map<std::string, std::string> DeltaPages(const std::vector<std::string>& samples) {
    std::vector<boost::shared_ptr<repository::TMemoryNamespace>> collections;
    for (const std::string& sample : samples) collections.push_back(Sample(sample));
    auto view = boost::make_shared<repository::TNamespaceView>(collections,
                                                               repository::ComputeDeltaRecords(collections));
    testing::TGridRecorder writer("html");
    std::map<std::string, NORVTKR20::TCIMValue> context = view->MakeContext();
    TReport report(view, context, "out");
    report.Write(&writer, context);

    std::map<std::string, std::string> pages;
    std::string link, page;
    for (const std::string& call : writer.Calls()) {
        if (call.rfind("EscapeText(", 0) == 0 || call.rfind("GetSeparatorText(", 0) == 0) continue;
        if (call.rfind("OpenPage(", 0) == 0) {
            link = call.substr(call.find_last_of('/') + 1);
            link = link.substr(0, link.find('"'));
            page.clear();
        }
        if (link.empty()) continue;
        page += call + "\n";
        if (call.rfind("WriteIndexEntry(", 0) == 0) {
            pages[link] = page;
            link.clear();
        }
    }
    EXPECT_TRUE(link.empty()) << "the page " << link << " was left unfinished";
    return pages;
}

TEST(DeltaSamplePages, TheReportsOfTheSamplesReadAsExpected) {
    const struct {
        const char* fixture;
        std::vector<std::string> samples;
    } runs[] = {
        {"delta-later", {"linux-server", "linux-server-later"}},
        {"delta-peer", {"linux-server", "linux-server-peer"}},
        {"delta-three", {"linux-server", "linux-server-later", "linux-server-peer"}},
    };
    for (const auto& run : runs) {
        std::map<std::string, std::string> pages = DeltaPages(run.samples);
        EXPECT_GE(pages.size(), 12u) << run.fixture << ": every compared page is written";
        for (const auto& page : pages) {
            EXPECT_EQ(testing::ExpectedPage(std::string(run.fixture) + "/" + page.first + ".txt", page.second),
                      page.second)
                << run.fixture << "/" << page.first;
        }
    }
}

std::string ReadTree(const fs::path& dir) {
    std::vector<fs::path> files;
    for (const auto& entry : fs::directory_iterator(dir)) files.push_back(entry.path());
    std::sort(files.begin(), files.end());
    std::string text;
    for (const fs::path& file : files) {
        std::ifstream in(file);
        std::ostringstream content;
        content << in.rdbuf();
        text += "== " + file.filename().string() + "\n" + content.str();
    }
    return text;
}

TEST(CompareCommand, SavedRecordsGiveTheSameReport) {
    const fs::path work = fs::temp_directory_path() / ("braigrion-compare-" + std::to_string(::getpid()));
    fs::remove_all(work);
    fs::create_directories(work);
    cli::TCompareOptions options;
    options.fCollections = {kSamples + "linux-server", kSamples + "linux-server-peer/schema.xml:" + kSamples +
                                                           "linux-server-peer/inventory.xml"};
    options.fFormat = "text";
    options.fQuiet = true;
    options.fOutput = (work / "computed").string();
    options.fSaveRecords = (work / "records.xml").string();
    std::ostringstream out, err;
    ASSERT_EQ(0, cli::RunCompare(options, out, err, false)) << err.str();
    EXPECT_EQ(options.fOutput + "/index.txt\n", out.str());

    options.fOutput = (work / "from-file").string();
    options.fSaveRecords.clear();
    options.fRecords = (work / "records.xml").string();
    ASSERT_EQ(0, cli::RunCompare(options, out, err, false)) << err.str();
    const std::string computed = ReadTree(work / "computed");
    EXPECT_NE(std::string::npos, computed.find("Differences"));
    EXPECT_EQ(computed, ReadTree(work / "from-file"));

    // The report command over the same collections and the saved records.
    cli::TReportOptions report;
    report.fFiles = options.fCollections;
    report.fRecords = options.fRecords;
    report.fFormat = "text";
    report.fQuiet = true;
    report.fOutput = (work / "by-report").string();
    ASSERT_EQ(0, cli::RunReport(report, out, err, false)) << err.str();
    EXPECT_EQ(computed, ReadTree(work / "by-report"));

    // Records made for other collections: a collection beyond the last, a
    // type the report does not know.
    auto recordsFile = [&work](const std::string& name, const std::string& type, const std::string& index) {
        const fs::path file = work / name;
        std::ofstream(file) << R"(<?xml version="1.0"?><CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP>
<VALUE.OBJECT><CLASS NAME="ORVSG_DeltaClass"><PROPERTY NAME="ClassName" TYPE="string"/></CLASS></VALUE.OBJECT>
<VALUE.OBJECT><INSTANCE CLASSNAME="ORVSG_Delta"><PROPERTY NAME="InstanceID" TYPE="string"><VALUE>Delta:9</VALUE></PROPERTY>
<PROPERTY NAME="Type" TYPE="uint8"><VALUE>)" << type << R"(</VALUE></PROPERTY>
<PROPERTY.ARRAY NAME="NamespaceIndices" TYPE="uint16"><VALUE.ARRAY><VALUE>)" << index << R"(</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>
</INSTANCE></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>)";
        return file.string();
    };

    // Input errors name what is wrong.
    const struct {
        std::vector<std::string> collections;
        std::string records;
        std::string message;
    } bad[] = {
        {{kSamples + "linux-server"}, "", "at least two collections"},
        {{kSamples + "linux-server", kSamples + "none.xml"}, "", "none.xml: no such file"},
        {{kSamples + "linux-server", kSamples + "linux-server-peer"}, kSamples + "linux-server/schema.xml",
         "holds no delta records"},
        {{kSamples + "linux-server", "a.xml::b.xml"}, "", "an empty file name"},
        {{kSamples + "linux-server", kSamples + "linux-server-peer"}, recordsFile("far.xml", "1", "2"),
         "far.xml: record \"Delta:9\" names collection \"2\", but 2 collections were given"},
        {{kSamples + "linux-server", kSamples + "linux-server-peer"}, recordsFile("type.xml", "3", "1"),
         "type.xml: record \"Delta:9\" has Type \"3\""},
    };
    for (const auto& b : bad) {
        cli::TCompareOptions wrong;
        wrong.fCollections = b.collections;
        wrong.fRecords = b.records;
        wrong.fOutput = (work / "never").string();
        try {
            cli::RunCompare(wrong, out, err, false);
            ADD_FAILURE() << "accepted: " << b.message;
        } catch (const cli::TInputError& ex) {
            EXPECT_NE(std::string::npos, std::string(ex.what()).find(b.message)) << ex.what();
        }
        EXPECT_FALSE(fs::exists(work / "never"));
    }
    fs::remove_all(work);
}

TEST(CompareCommand, ShowsWhatItLoadsAndComparesBeforeThePages) {
    const fs::path work = fs::temp_directory_path() / ("braigrion-compare-progress-" + std::to_string(::getpid()));
    fs::remove_all(work);
    fs::create_directories(work);
    cli::TCompareOptions options;
    options.fCollections = {kSamples + "linux-server", kSamples + "linux-server-later"};
    options.fFormat = "text";
    options.fOutput = (work / "report").string();
    std::ostringstream out, err;
    ASSERT_EQ(0, cli::RunCompare(options, out, err, true)) << err.str();
    // Each step replaces the one before on the same line, in this order.
    const std::string progress = err.str();
    size_t at = 0;
    for (const std::string& step : {"\r\033[Kbraigrion: loading collection 1 of 2: " + kSamples + "linux-server",
                                    "\r\033[Kbraigrion: loading collection 2 of 2: " + kSamples + "linux-server-later",
                                    std::string("\r\033[Kbraigrion: comparing 2 collections"),
                                    std::string("\r\033[Kbraigrion: page 1 of ")}) {
        at = progress.find(step, at);
        ASSERT_NE(std::string::npos, at) << step << " in\n" << progress;
    }
    // The line is cleared before the summary, which ends the run.
    EXPECT_NE(std::string::npos, progress.find("\r\033[Kbraigrion: 12 pages written")) << progress;
    EXPECT_EQ(options.fOutput + "/index.txt\n", out.str());
    fs::remove_all(work);
}

TEST(CompareCommand, TheHtmlReportMarksDifferencesAndAgreement) {
    const fs::path work = fs::temp_directory_path() / ("braigrion-compare-html-" + std::to_string(::getpid()));
    fs::remove_all(work);
    fs::create_directories(work);
    cli::TCompareOptions options;
    options.fCollections = {kSamples + "linux-server", kSamples + "linux-server-later", kSamples + "linux-server-peer"};
    options.fQuiet = true;
    options.fOutput = (work / "report").string();
    std::ostringstream out, err;
    ASSERT_EQ(0, cli::RunCompare(options, out, err, false)) << err.str();
    std::ifstream in(work / "report" / "net.html");
    std::ostringstream html;
    html << in.rdbuf();
    const std::string page = html.str();
    // The MTU of the later collection differs; the peer agrees with the baseline.
    EXPECT_NE(std::string::npos, page.find("<td class=\"differs\">1500</td>")) << page;
    // The agreeing cell's text, whatever spans keep its tokens whole.
    const size_t same = page.find("<td class=\"same\">");
    ASSERT_NE(std::string::npos, same) << page;
    std::string sameText;
    bool inTag = false;
    for (size_t i = same + 17; i < page.size() && page.compare(i, 5, "</td>") != 0; ++i) {
        if (page[i] == '<') inTag = true;
        if (!inTag) sameText += page[i];
        if (page[i] == '>') inTag = false;
    }
    EXPECT_EQ("--- SAME ---", sameText);
    EXPECT_EQ(std::string::npos, page.find("<td class=\"differs\">9000</td>")) << "the baseline row is plain";
    EXPECT_EQ(std::string::npos, page.find(">--- SAME ---</th>")) << "an agreeing cell is no label";
    fs::remove_all(work);
}

}  // namespace
}  // namespace braigrion
