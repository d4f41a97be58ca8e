// braigrion report and braigrion page as a user meets them: the report
// directory, its replacement, and every way the commands refuse.
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <fstream>
#include <functional>
#include <regex>
#include <sstream>

#include "CommandRunner.h"

namespace fs = std::filesystem;

namespace {

std::vector<std::string> SampleFiles() {
    std::string dir = std::string(BRAIGRION_SOURCE_DIR) + "/samples/linux-server/";
    return {dir + "schema.xml", dir + "inventory.xml", dir + "logs.xml"};
}

std::vector<std::string> Args(std::vector<std::string> head, const std::vector<std::string>& tail) {
    head.insert(head.end(), tail.begin(), tail.end());
    return head;
}

// A directory of its own for each test, removed afterwards.
class ReportCommand : public ::testing::Test {
protected:
    void SetUp() override {
        fDir = fs::path(::testing::TempDir()) / ("braigrion_report_" + std::to_string(getpid()));
        fs::remove_all(fDir);
        fs::create_directories(fDir);
    }
    void TearDown() override { fs::remove_all(fDir); }

    std::string Path(const std::string& name) const { return (fDir / name).string(); }
    std::string Write(const std::string& name, const std::string& text) const {
        std::ofstream(Path(name)) << text;
        return Path(name);
    }
    // What lies beside the report: nothing but what the test put there.
    std::vector<std::string> Entries() const {
        std::vector<std::string> names;
        for (const auto& entry : fs::directory_iterator(fDir)) names.push_back(entry.path().filename().string());
        std::sort(names.begin(), names.end());
        return names;
    }

    fs::path fDir;
};

std::string Slurp(const std::string& path) {
    std::ifstream in(path);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

int Lines(const std::string& text) {
    return static_cast<int>(std::count(text.begin(), text.end(), '\n'));
}

TEST_F(ReportCommand, WritesAnHtmlReportAndPrintsItsIndex) {
    TCommandResult r = RunBraigrion(Args({"report", "-o", Path("report")}, SampleFiles()));
    ASSERT_EQ(0, r.fStatus) << r.fErr;
    EXPECT_EQ(Path("report") + "/index.html\n", r.fOut);
    for (const char* file : {"index.html", "navbar.html", "global.css", "tkr_sort.js", ".braigrion-report"}) {
        EXPECT_TRUE(fs::is_regular_file(Path("report") + "/" + file)) << file;
    }
    // No progress when standard error is not a terminal; only the summary,
    // whose counts are those of the navigation.
    std::smatch summary;
    ASSERT_TRUE(std::regex_match(r.fErr, summary,
                                 std::regex("braigrion: ([0-9]+) pages written, ([0-9]+) without data; "
                                            "not available in this version: ([A-Za-z0-9 ]+)\n")))
        << r.fErr;
    const std::string navigation = Slurp(Path("report/navbar.html"));
    auto count = [&navigation](const std::string& text) {
        size_t n = 0;
        for (size_t at = navigation.find(text); at != std::string::npos; at = navigation.find(text, at + 1)) ++n;
        return std::to_string(n);
    };
    EXPECT_EQ(count("<a href="), summary[1].str());
    EXPECT_EQ(count("(no data)</span>"), summary[2].str());

    // A page listed as not available says so when asked for alone (the
    // first few of them; none once every page is built).
    std::istringstream missing(summary[3].str() == "none" ? "" : summary[3].str());
    std::string page;
    for (int asked = 0; asked < 3 && missing >> page; ++asked) {
        TCommandResult alone = RunBraigrion(Args({"page", page}, SampleFiles()));
        if (alone.fStatus == 0) continue;  // a page written in part shows that part
        EXPECT_EQ("braigrion: page " + page + " is not available in this version\n", alone.fErr);
    }
    EXPECT_EQ(std::vector<std::string>{"report"}, Entries()) << "no work directory is left beside it";
}

TEST_F(ReportCommand, ReplacesAnEarlierReportAndOnlyThat) {
    // The files of an earlier report are replaced or removed; a file someone
    // put beside them stays.
    ASSERT_EQ(0, RunBraigrion(Args({"report", "-o", Path("report")}, SampleFiles())).fStatus);
    Write("report/notes.txt", "mine");
    TCommandResult text = RunBraigrion(Args({"report", "--format", "text", "-o", Path("report")}, SampleFiles()));
    ASSERT_EQ(0, text.fStatus) << text.fErr;
    EXPECT_EQ(Path("report") + "/index.txt\n", text.fOut);
    EXPECT_FALSE(fs::exists(Path("report/index.html")));
    EXPECT_FALSE(fs::exists(Path("report/navbar.html")));
    EXPECT_TRUE(fs::exists(Path("report/index.txt")));
    EXPECT_EQ("mine", Slurp(Path("report/notes.txt")));
    ASSERT_EQ(0, RunBraigrion(Args({"report", "--format", "text", "-o", Path("report")}, SampleFiles())).fStatus);
    EXPECT_EQ("mine", Slurp(Path("report/notes.txt")));

    // A directory of something else is refused, untouched; forced, the
    // report goes among its files and none of them is removed.
    fs::create_directories(Path("photos"));
    Write("photos/holiday.jpg", "not a report");
    TCommandResult refused = RunBraigrion(Args({"report", "-o", Path("photos")}, SampleFiles()));
    EXPECT_EQ(2, refused.fStatus);
    EXPECT_NE(std::string::npos, refused.fErr.find("is not a braigrion report; use --force")) << refused.fErr;
    EXPECT_EQ("not a report", Slurp(Path("photos/holiday.jpg")));
    TCommandResult forced = RunBraigrion(Args({"report", "--force", "-o", Path("photos")}, SampleFiles()));
    EXPECT_EQ(0, forced.fStatus) << forced.fErr;
    EXPECT_EQ("not a report", Slurp(Path("photos/holiday.jpg")));
    EXPECT_TRUE(fs::exists(Path("photos/index.html")));

    // An empty directory is taken as it is.
    fs::create_directories(Path("empty"));
    EXPECT_EQ(0, RunBraigrion(Args({"report", "-o", Path("empty/")}, SampleFiles())).fStatus);
    EXPECT_TRUE(fs::exists(Path("empty/index.html")));
    EXPECT_EQ((std::vector<std::string>{"empty", "photos", "report"}), Entries());
}

// Mark-up in what the collectors gathered, in the labels (DisplayName
// qualifiers) and in every string value and array element, with the link
// tricks that a browser decodes: the whole report shows it as text, and no
// tag of any page carries it.
TEST_F(ReportCommand, CollectedMarkupNeverBecomesLive) {
    const std::vector<std::string> payloads = {
        "<a href=\"java&#115;cript&#58;alert(61)\">a</a>",
        "<a href=\"java&amp;#115;cript&amp;#58;alert(62)\">b</a>",
        "<a href=\"&#106;avascript&colon;alert(63)\">c</a>",
        "<a href=\"jav&#x09;ascript:alert(64)\">d</a>",
        "<a href=\"javascript:alert(65)\">e</a>",
        "<script>alert(66)</script>",
        "<img src=x onerror=alert(67)>",
        "<br><font face=\"Courier\"><a href=\"x.html\" onclick=\"alert(68)\">f</a>",
    };
    auto xmlText = [](const std::string& text) {
        std::string out;
        for (char c : text) out += c == '<' ? "&lt;" : c == '>' ? "&gt;" : c == '&' ? "&amp;" : std::string(1, c);
        return out;
    };
    size_t next = 0;
    auto payload = [&] { return xmlText(payloads[next++ % payloads.size()]); };
    std::vector<std::string> files;
    const std::regex label(R"((<QUALIFIER NAME="DisplayName"[^>]*>\s*<VALUE>)([^<]*)(</VALUE>))");
    const std::regex value(R"((<PROPERTY NAME="[^"]*" TYPE="string"[^>]*>\s*<VALUE>)([^<]*)(</VALUE>))");
    const std::regex array(R"(<PROPERTY.ARRAY NAME="[^"]*" TYPE="string"[^>]*>\s*<VALUE.ARRAY>[\s\S]*?</VALUE.ARRAY>)");
    const std::regex element(R"((<VALUE>)([^<]*)(</VALUE>))");
    // Each match of `re` in `text` through `change`.
    auto replace = [](const std::string& text, const std::regex& re, const std::function<std::string(const std::smatch&)>& change) {
        std::string out;
        auto last = text.cbegin();
        for (std::sregex_iterator it(text.begin(), text.end(), re), end; it != end; ++it) {
            out.append(last, (*it)[0].first);
            out += change(*it);
            last = (*it)[0].second;
        }
        out.append(last, text.cend());
        return out;
    };
    auto plant = [&](const std::smatch& m) { return m[1].str() + m[2].str() + payload() + m[3].str(); };
    for (const std::string& sample : SampleFiles()) {
        std::string text = replace(replace(Slurp(sample), label, plant), value, plant);
        text = replace(text, array, [&](const std::smatch& m) { return replace(m[0].str(), element, plant); });
        files.push_back(Write(fs::path(sample).filename().string(), text));
    }
    TCommandResult r = RunBraigrion(Args({"report", "-o", Path("report")}, files));
    ASSERT_EQ(0, r.fStatus) << r.fErr;

    size_t shown = 0;
    for (const auto& entry : fs::recursive_directory_iterator(Path("report"))) {
        if (entry.path().extension() != ".html") continue;
        const std::string page = Slurp(entry.path().string());
        for (size_t open = page.find('<'); open != std::string::npos; open = page.find('<', open + 1)) {
            const size_t close = page.find('>', open);
            ASSERT_NE(std::string::npos, close) << entry.path();
            std::string tag = page.substr(open, close + 1 - open);
            for (auto& c : tag) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
            // A tooltip is text (escaped, no quote can end it early); the rest of the tag is mark-up.
            for (size_t title = tag.find(" title=\""); title != std::string::npos; title = tag.find(" title=\"")) {
                const size_t end = tag.find('"', title + 8);
                ASSERT_NE(std::string::npos, end) << tag;
                tag.erase(title, end + 1 - title);
            }
            EXPECT_EQ(std::string::npos, tag.find("alert(")) << entry.path() << ": " << tag;
            EXPECT_EQ(std::string::npos, tag.find("javascript")) << entry.path() << ": " << tag;
            const size_t href = tag.find("href=\"");
            if (href != std::string::npos) {
                const std::string target = tag.substr(href + 6, tag.find('"', href + 6) - href - 6);
                const bool web = target.compare(0, 7, "http://") == 0 || target.compare(0, 8, "https://") == 0;
                EXPECT_EQ(std::string::npos, target.find('&')) << entry.path() << ": " << tag;
                EXPECT_TRUE(web || target.find(':') == std::string::npos) << entry.path() << ": " << tag;
            }
        }
        for (size_t at = page.find("alert(6"); at != std::string::npos; at = page.find("alert(6", at + 1)) ++shown;
    }
    EXPECT_GT(next, 100u) << "payloads were planted";
    EXPECT_GT(shown, next / 2) << "and reached the pages as text";
}

// --force on the directory that holds the collection, or on one that only
// looks like a report: the report never deletes nor overwrites a file it did
// not write.
TEST_F(ReportCommand, ForceNeverTouchesFilesTheReportDidNotWrite) {
    fs::create_directories(Path("data"));
    std::vector<std::string> inputs;
    for (const std::string& file : SampleFiles()) {
        const std::string copy = Path("data/" + fs::path(file).filename().string());
        fs::copy_file(file, copy);
        inputs.push_back(copy);
    }
    std::vector<std::string> before;
    for (const std::string& input : inputs) before.push_back(Slurp(input));
    for (int run = 0; run < 2; ++run) {
        TCommandResult r = RunBraigrion(Args({"report", "--force", "-o", Path("data")}, inputs));
        ASSERT_EQ(0, r.fStatus) << r.fErr;
        for (size_t i = 0; i < inputs.size(); ++i) EXPECT_EQ(before[i], Slurp(inputs[i])) << inputs[i];
        EXPECT_TRUE(fs::exists(Path("data/index.html")));
    }

    // A marker that is only an empty file makes no report of a directory.
    fs::create_directories(Path("fake"));
    Write("fake/.braigrion-report", "");
    Write("fake/keep.txt", "keep");
    EXPECT_EQ(2, RunBraigrion(Args({"report", "-o", Path("fake")}, SampleFiles())).fStatus);
    ASSERT_EQ(0, RunBraigrion(Args({"report", "--force", "-o", Path("fake")}, SampleFiles())).fStatus);
    EXPECT_EQ("keep", Slurp(Path("fake/keep.txt")));

    // A file of someone else's where the report puts one of its own: nothing
    // is replaced, and the line says which file.
    fs::create_directories(Path("taken"));
    Write("taken/index.html", "someone's page");
    TCommandResult taken = RunBraigrion(Args({"report", "--force", "-o", Path("taken")}, SampleFiles()));
    EXPECT_EQ(1, taken.fStatus);
    EXPECT_NE(std::string::npos, taken.fErr.find("holds index.html, which the report did not write")) << taken.fErr;
    EXPECT_EQ(1, Lines(taken.fErr)) << taken.fErr;
    EXPECT_EQ("someone's page", Slurp(Path("taken/index.html")));
    EXPECT_EQ((std::vector<std::string>{"index.html"}), [&] {
        std::vector<std::string> names;
        for (const auto& entry : fs::directory_iterator(Path("taken"))) names.push_back(entry.path().filename().string());
        return names;
    }()) << "nothing added either";
    EXPECT_EQ((std::vector<std::string>{"data", "fake", "taken"}), Entries()) << "no work directory left";
}

TEST_F(ReportCommand, RefusesWithOneLineAndTheRightStatus) {
    ASSERT_EQ(0, RunBraigrion(Args({"report", "-o", Path("earlier")}, SampleFiles())).fStatus);
    std::string earlierIndex = Slurp(Path("earlier/index.html"));
    std::string malformed = Write("broken.xml",
                                  "<?xml version=\"1.0\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">\n"
                                  "<DECLARATION><DECLGROUP>\n  <VALUE.OBJECT><INSTANCE CLASSNAME=\"X\">\n"
                                  "  </DECLGROUP>\n</CIM>\n");
    Write("a-file", "a file where a directory should be");
    // A name that would break the line, and a file that exists but cannot be read.
    std::string newline = Write("broken\nname.xml", Slurp(malformed));
    fs::create_symlink(Path("loop-b"), Path("loop-a"));
    fs::create_symlink(Path("loop-a"), Path("loop-b"));
    struct Case {
        std::vector<std::string> args;
        int status;
        std::string saying;  // a regular expression the one line must contain
    } cases[] = {
        {{}, 2, "subcommand"},
        {{"frobnicate"}, 2, "frobnicate"},
        {{"info"}, 2, "collection"},
        {{"info", malformed}, 2, "broken\\.xml:[0-9]+:[0-9]+: "},
        {{"info", Path("missing.xml")}, 2, "missing\\.xml: no such file"},
        {Args({"report"}, SampleFiles()), 2, "--output is required"},
        {Args({"report", "-o", Path("x"), "--format", "pdf"}, SampleFiles()), 2, "pdf"},
        {Args({"report", "-o", Path("x"), "--mode", "fast"}, SampleFiles()), 2, "fast"},
        {Args({"report", "-o", Path("x"), "--log-level", "9"}, SampleFiles()), 2, "9"},
        {Args({"report", "-o", Path("earlier")}, {malformed}), 2, "broken\\.xml:[0-9]+:[0-9]+: "},
        {Args({"report", "-o", Path("new")}, {malformed}), 2, "broken\\.xml:[0-9]+:[0-9]+: "},
        {Args({"report", "-o", Path("new")}, {Path("missing.xml")}), 2, "missing\\.xml: no such file"},
        {{"info", newline}, 2, "\"[^\"]*broken\\\\nname\\.xml\":[0-9]+:[0-9]+: "},
        {{"info", Path("missing\n.xml")}, 2, "missing\\\\n\\.xml\": no such file"},
        {{"info", Path("loop-a")}, 2, "loop-a: Too many levels of symbolic links\n"},
        {Args({"report", "-o", Path("a-file")}, SampleFiles()), 2, "a-file: exists and is not a directory"},
        {Args({"report", "-o", Path("a-file/report")}, SampleFiles()), 1, "a-file/report: "},
        {Args({"report", "-o", "/proc/braigrion-report"}, SampleFiles()), 1, "cannot create the report"},
        {Args({"report", "-o", Path("new"), "--log", Path("no/such/dir/log")}, SampleFiles()), 2,
         "cannot open the log file"},
        {Args({"page", "NoSuchPage"}, SampleFiles()), 2, "unknown page id 'NoSuchPage'"},
        // A page of the service mode writes nothing in the default mode.
        {Args({"page", "CFTSetting"}, SampleFiles()), 1, "page CFTSetting has nothing to show .* in default mode"},
        // The inventory's analysis page is a known id, whose merged devices
        // this Linux sample has none of.
        {Args({"page", "Analysis"}, SampleFiles()), 1, "page Analysis has nothing to show"},
        // Delta records need collections to compare.
        {Args({"report", "-o", Path("delta"), "--records", Path("none.xml")}, {SampleFiles()[0]}), 2,
         "a delta report needs at least two collections"},
        {Args({"page", "SystemConfig"}, {malformed}), 2, "broken\\.xml:[0-9]+:[0-9]+: "},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.saying);
        TCommandResult r = RunBraigrion(c.args);
        EXPECT_EQ(c.status, r.fStatus);
        EXPECT_TRUE(std::regex_search(r.fErr, std::regex(c.saying))) << r.fErr;
        EXPECT_EQ(1, Lines(r.fErr)) << "one line on stderr:\n" << r.fErr;
        EXPECT_EQ("", r.fOut);
    }
    // Nothing was created, and the earlier report stands as it was.
    EXPECT_EQ((std::vector<std::string>{"a-file", "broken\nname.xml", "broken.xml", "earlier", "loop-a", "loop-b"}),
              Entries());
    EXPECT_EQ(earlierIndex, Slurp(Path("earlier/index.html")));
}

// Every long number in a table cell of a sample's HTML report (a token of
// digits, perhaps with ". , : -", of 6 to 40 characters) stands whole in
// the same sample's text report: the text back-end widens a column, or
// makes a line longer, rather than cut a token.
TEST_F(ReportCommand, TheTextReportHoldsEveryLongNumberOfTheHtmlReportWhole) {
    // The texts of an HTML page's table cells, tags made blanks.
    auto cellTexts = [](const std::string& html) {
        std::vector<std::string> cells;
        for (size_t at = html.find("<t"); at != std::string::npos; at = html.find("<t", at + 1)) {
            if (at + 3 >= html.size() || (html[at + 2] != 'd' && html[at + 2] != 'h')) continue;
            const size_t open = html.find('>', at);
            const size_t close = html.find("</t", open);
            if (open == std::string::npos || close == std::string::npos) break;
            std::string text;
            bool inTag = false;
            for (size_t i = open + 1; i < close; ++i) {
                if (html[i] == '<') inTag = true;
                text += inTag ? ' ' : html[i];
                if (html[i] == '>') inTag = false;
            }
            cells.push_back(text);
            at = close;
        }
        return cells;
    };
    auto isNumber = [](const std::string& token) {
        if (token.size() < 6 || token.size() > 40 || !std::isdigit(static_cast<unsigned char>(token[0]))) return false;
        size_t digits = 0;
        for (char c : token) {
            if (std::isdigit(static_cast<unsigned char>(c))) {
                ++digits;
            } else if (std::string(".,:-").find(c) == std::string::npos) {
                return false;
            }
        }
        return digits >= 6;
    };
    size_t checked = 0;
    for (const auto& sample : fs::directory_iterator(std::string(BRAIGRION_SOURCE_DIR) + "/samples")) {
        if (!sample.is_directory()) continue;
        const std::string name = sample.path().filename().string();
        SCOPED_TRACE(name);
        std::vector<std::string> files;
        for (const auto& file : fs::directory_iterator(sample.path()))
            if (file.path().extension() == ".xml") files.push_back(file.path().string());
        std::sort(files.begin(), files.end());
        ASSERT_EQ(0, RunBraigrion(Args({"report", "-q", "-o", Path(name + "-html")}, files)).fStatus);
        ASSERT_EQ(0, RunBraigrion(Args({"report", "-q", "--format", "text", "-o", Path(name + "-text")}, files)).fStatus);

        std::string text;
        for (const auto& page : fs::directory_iterator(Path(name + "-text"))) text += Slurp(page.path().string());
        for (const auto& page : fs::directory_iterator(Path(name + "-html"))) {
            if (page.path().extension() != ".html") continue;
            // In the default mode the text report leaves its error log page
            // empty on purpose.
            if (page.path().filename() == "tkr_log.html") continue;
            for (const std::string& cell : cellTexts(Slurp(page.path().string()))) {
                std::istringstream tokens(cell);
                for (std::string token; tokens >> token;) {
                    if (!isNumber(token)) continue;
                    ++checked;
                    EXPECT_NE(std::string::npos, text.find(token)) << token << " of " << page.path().filename();
                }
            }
        }
    }
    EXPECT_GT(checked, 100u) << "the samples hold long numbers";
}

// One page on standard output, as an inventory page: its title, its tables
// with the collection's values, and nothing written anywhere else.
TEST_F(ReportCommand, PagePrintsOnePageOfTheCollection) {
    struct Case {
        const char* pageID;
        std::vector<std::string> showing;  // texts the page must hold
    } cases[] = {
        {"SystemConfig",
         {"<title>System Overview</title>", "<div class=\"tabletitle\">Operating System</div>",
          "<td>Norvane Stratus NS2480 M4</td>", "<td>Red Hat Enterprise Linux Server release 7.9 (Maipo)</td>"}},
        {"HardwareInfo",
         {"<title>Hardware Inventory</title>", "<div class=\"tabletitle\">Processor/Core</div>",
          "<td>Intel(R) Xeon(R) Gold 6248R CPU @ 3.00GHz</td>"}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.pageID);
        TCommandResult r = RunBraigrion(Args({"page", c.pageID}, SampleFiles()));
        ASSERT_EQ(0, r.fStatus) << r.fErr;
        EXPECT_EQ("", r.fErr);
        EXPECT_EQ(0u, r.fOut.find("<html>")) << r.fOut.substr(0, 200);
        EXPECT_NE(std::string::npos, r.fOut.find("global_GUI.css")) << "the inventory style";
        for (const std::string& text : c.showing) EXPECT_NE(std::string::npos, r.fOut.find(text)) << text;
        // One page only: a single title.
        EXPECT_EQ(std::string::npos, r.fOut.find("<title>", r.fOut.find("<title>") + 1));
    }
    EXPECT_TRUE(Entries().empty()) << "the page command writes no files";
}

// A chassis inventory read with --vcx gets its "VCX Information" page, and
// TKR_BIOSPROVIDER=yes adds the BIOS settings of a collection that has them.
TEST_F(ReportCommand, VCXInventoryAndBIOSSettingsPages) {
    const std::string samples = std::string(BRAIGRION_SOURCE_DIR) + "/samples/";
    TCommandResult r = RunBraigrion({"report", "--vcx", "-o", Path("vcx"), samples + "vcx-chassis/inventory.xml"});
    ASSERT_EQ(0, r.fStatus) << r.fErr;
    const std::string vcx = Slurp(Path("vcx") + "/vcx.html");
    for (const char* text : {"VCX Information", "Chassis VPD", "<td>9N40</td>", "<td>Y030BG79G01H</td>",
                             "<td>Chassis Controller Module</td>", "<td>CCM Firmware (Backup)</td>"}) {
        EXPECT_NE(std::string::npos, vcx.find(text)) << text;
    }

    std::vector<std::string> files;
    for (const char* file : {"schema.xml", "inventory.xml", "platform.xml"}) files.push_back(samples + "linux-server/" + file);
    setenv("TKR_BIOSPROVIDER", "Yes", 1);
    r = RunBraigrion(Args({"report", "-o", Path("bios")}, files));
    unsetenv("TKR_BIOSPROVIDER");
    ASSERT_EQ(0, r.fStatus) << r.fErr;
    const std::string bios = Slurp(Path("bios") + "/biosenumeration.html");
    EXPECT_NE(std::string::npos, bios.find("<td>Processors.HyperThreading</td>")) << bios.substr(0, 400);
    r = RunBraigrion(Args({"report", "-o", Path("plain")}, files));
    ASSERT_EQ(0, r.fStatus) << r.fErr;
    EXPECT_FALSE(fs::exists(Path("plain") + "/biosenumeration.html"));
    EXPECT_EQ(std::string::npos, Slurp(Path("plain") + "/navbar.html").find("BIOS Settings"));
}

}  // namespace
