// The options that point the log pages at their lookup files and their
// documentation servers, as a user gives them to braigrion report.
#include <gtest/gtest.h>

#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <regex>
#include <sstream>

#include "CommandRunner.h"

namespace fs = std::filesystem;

namespace {

std::vector<std::string> KMCSample() {
    std::vector<std::string> files;
    for (const auto& entry : fs::directory_iterator(std::string(BRAIGRION_SOURCE_DIR) + "/samples/kmc-blade")) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string Slurp(const fs::path& path) {
    std::ifstream in(path);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

class LogLinkOptions : public ::testing::Test {
protected:
    void SetUp() override {
        fDir = fs::path(::testing::TempDir()) / ("braigrion_links_" + std::to_string(getpid()));
        fs::remove_all(fDir);
        fs::create_directories(fDir / "empty-data");
    }
    void TearDown() override { fs::remove_all(fDir); }

    TCommandResult Report(const std::vector<std::string>& options, const std::string& out) {
        std::vector<std::string> args = {"report", "-q", "-o", (fDir / out).string()};
        args.insert(args.end(), options.begin(), options.end());
        for (const std::string& file : KMCSample()) args.push_back(file);
        return RunBraigrion(args);
    }

    fs::path fDir;
};

TEST_F(LogLinkOptions, LinksPointAtTheConfiguredServers) {
    const std::string data = std::string(BRAIGRION_SOURCE_DIR) + "/data";
    TCommandResult r = Report({"--data-dir", data, "--doc-server", "https://docs.example.org/base/"}, "linked");
    ASSERT_EQ(0, r.fStatus) << r.fErr;
    const std::string chassis = Slurp(fDir / "linked/chassis_event.html");
    EXPECT_NE(std::string::npos,
              chassis.find("<a href=\"https://docs.example.org/base/infocenter/rackvane/information/topic/"
                           "com.orv.acc.4712.doc/80000123.html\">80000123</a>"))
        << chassis;
    EXPECT_NE(std::string::npos, Slurp(fDir / "linked/diags.html")
                                     .find("https://docs.example.org/base/infocenter/rackvane/information/topic/"
                                           "com.orv.acc.4712.doc/DGN-1B02-05.html"));

    // Without the lookup file the same pages have no links and lose nothing else.
    TCommandResult plain = Report({"--data-dir", (fDir / "empty-data").string()}, "plain");
    ASSERT_EQ(0, plain.fStatus) << plain.fErr;
    const std::string unlinked = Slurp(fDir / "plain/chassis_event.html");
    EXPECT_EQ(std::string::npos, unlinked.find("<a href=\"http"));
    EXPECT_NE(std::string::npos, unlinked.find("80000123"));
    EXPECT_EQ(std::count(chassis.begin(), chassis.end(), '\n'), std::count(unlinked.begin(), unlinked.end(), '\n'));
}

TEST_F(LogLinkOptions, RefusesWhatIsNoServerOrFolder) {
    struct Case {
        std::vector<std::string> options;
        std::string saying;
    } cases[] = {
        {{"--doc-server", "ftp://docs.example.org"}, "not an absolute http:// or https:// address"},
        {{"--doc-server", "docs.example.org"}, "not an absolute http:// or https:// address"},
        {{"--help-server", "http://"}, "not an absolute http:// or https:// address"},
        {{"--help-server", "http://host/\"onclick"}, "not an absolute http:// or https:// address"},
        {{"--data-dir", "/no/such/folder"}, "/no/such/folder"},
    };
    for (const Case& c : cases) {
        TCommandResult r = Report(c.options, "refused");
        EXPECT_EQ(2, r.fStatus) << c.saying;
        EXPECT_TRUE(std::regex_search(r.fErr, std::regex(c.saying))) << r.fErr;
        EXPECT_FALSE(fs::exists(fDir / "refused"));
    }
}

}  // namespace
