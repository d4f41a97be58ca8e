// The parts of the report command that a child process cannot show well:
// what an interrupted run leaves, and progress that keeps pace with the
// pages the report asks for.
#include <gtest/gtest.h>

#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <sstream>

#include "Progress.h"
#include "ReportDirectory.h"
#include "braigrion/TReport.h"
#include "braigrion/TReportParametersBuilder.h"
#include "support/RecordingWriter.h"
#include "support/RepoBuilder.h"

namespace fs = std::filesystem;

namespace braigrion {
namespace cli {
namespace {

class ReportDirectoryTest : public ::testing::Test {
protected:
    void SetUp() override {
        fDir = fs::path(::testing::TempDir()) / ("braigrion_dir_" + std::to_string(getpid()));
        fs::remove_all(fDir);
        fs::create_directories(fDir / "report");
        std::ofstream((fDir / "report" / TReportDirectory::kMarkerName).string())
            << "braigrion report\nformat html\nfile index.html\n";
        std::ofstream((fDir / "report" / "index.html").string()) << "earlier";
    }
    void TearDown() override { fs::remove_all(fDir); }

    std::vector<std::string> Entries() const {
        std::vector<std::string> names;
        for (const auto& entry : fs::directory_iterator(fDir)) names.push_back(entry.path().filename().string());
        std::sort(names.begin(), names.end());
        return names;
    }
    std::string Earlier() const {
        std::ifstream in((fDir / "report" / "index.html").string());
        std::string text;
        std::getline(in, text);
        return text;
    }

    fs::path fDir;
};

TEST_F(ReportDirectoryTest, AFailedOrInterruptedRunLeavesTheEarlierReport) {
    // A run that ends without committing: an exception, say.
    {
        TReportDirectory directory((fDir / "report").string(), false);
        std::ofstream(directory.WorkPath() + "/index.html") << "half written";
        EXPECT_EQ(fDir.string(), fs::path(directory.WorkPath()).parent_path().string()) << "written beside the target";
    }
    EXPECT_EQ(std::vector<std::string>{"report"}, Entries());
    EXPECT_EQ("earlier", Earlier());

    // A run stopped by a signal in the middle of writing.
    pid_t child = fork();
    if (child == 0) {
        TReportDirectory directory((fDir / "report").string(), false);
        std::ofstream(directory.WorkPath() + "/index.html") << "half written";
        raise(SIGTERM);
        _exit(0);
    }
    int status = 0;
    waitpid(child, &status, 0);
    ASSERT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == SIGTERM) << "the signal still ends the process";
    EXPECT_EQ(std::vector<std::string>{"report"}, Entries());
    EXPECT_EQ("earlier", Earlier());

    // A run killed outright leaves its work directory; the next run clears it.
    pid_t dead = fork();
    if (dead == 0) _exit(0);
    waitpid(dead, nullptr, 0);
    fs::create_directories(fDir / (".report.braigrion-" + std::to_string(dead) + "-abcdef"));
    fs::create_directories(fDir / (".report.braigrion-" + std::to_string(getppid()) + "-alive"));
    // Only directories named as the program names them go: not a file, not a link.
    std::ofstream((fDir / (".report.braigrion-" + std::to_string(dead) + "-notdir")).string()) << "mine";
    fs::create_symlink(fDir / "report", fDir / (".report.braigrion-" + std::to_string(dead) + "-linked"));
    {
        TReportDirectory directory((fDir / "report").string(), false);
        std::ofstream(directory.WorkPath() + "/index.html") << "new";
        directory.Commit("html");
    }
    std::vector<std::string> staying = {".report.braigrion-" + std::to_string(getppid()) + "-alive",
                                        ".report.braigrion-" + std::to_string(dead) + "-linked",
                                        ".report.braigrion-" + std::to_string(dead) + "-notdir", "report"};
    std::sort(staying.begin(), staying.end());
    EXPECT_EQ(staying, Entries())
        << "the work of a live process stays";
    EXPECT_EQ("new", Earlier());
    EXPECT_TRUE(fs::exists(fDir / "report" / TReportDirectory::kMarkerName));
}

// The report tells its observer of every page it asks for, numbered against
// the total it planned, in each mode that changes the sequence; the progress
// line shows the last of them.
TEST(Progress, FollowsThePagesTheReportWalks) {
    testing::TRepoBuilder windows;
    windows.Parse(R"(
        ORVSG_OperatingSystem ProductVendor="Microsoft Corporation" OSType=uint16:18
    )");
    testing::TRepoBuilder preboot;
    preboot.Parse(R"(
        ORVSG_CollectionInfo Build="4.2.0-preboot"
    )");
    testing::TRepoBuilder unknown;
    unknown.Declare("ORVSG_Nothing");
    struct Case {
        const char* name;
        boost::shared_ptr<NORVTKR20::ICIMNamespace> ns;
        std::string mode;
        std::string kmc;
        bool osLogs;
    } cases[] = {
        {"windows default", windows.Namespace(), "default", "FALSE", true},
        {"windows luz kmc", windows.Namespace(), "luz", "TRUE", true},
        {"preboot", preboot.Namespace(), "default", "FALSE", false},
        {"unknown os", unknown.Namespace(), "luz", "FALSE", false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.name);
        std::map<std::string, NORVTKR20::TCIMValue> context;
        context["mode"] = NORVTKR20::TCIMValue(c.mode);
        context["KMC"] = NORVTKR20::TCIMValue(c.kmc);
        TReport report(c.ns, context, ::testing::TempDir());
        TReportParametersBuilder builder(c.ns, report.GetMode(), report.IsKMC());
        std::vector<std::string> planned = report.PlannedPages(builder);
        std::vector<std::string> told;
        std::ostringstream out;
        {
            TProgressLine progress(out, true);
            report.SetPageObserver([&](size_t number, size_t total, const std::string& page) {
                told.push_back(page);
                EXPECT_EQ(told.size(), number);
                EXPECT_EQ(planned.size(), total);
                progress.Page(number, total, page);
            });
            testing::TRecordingWriter writer;
            report.Write(&writer, context);
        }
        EXPECT_EQ(planned, told);
        EXPECT_EQ(c.osLogs, std::count(told.begin(), told.end(), std::string("OSLogs")) == 1);
        EXPECT_EQ(c.mode == "luz", std::count(told.begin(), told.end(), std::string("SPINTLog")) == 1);
        std::string last = "page " + std::to_string(planned.size()) + " of " + std::to_string(planned.size()) + ": " +
                           planned.back();
        EXPECT_NE(std::string::npos, out.str().find(last)) << out.str();
    }
}

}  // namespace
}  // namespace cli
}  // namespace braigrion
