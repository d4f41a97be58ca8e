// The operating system logs (one page per Linux log file), the frame of the
// IPMI page, and which log pages each generator writes in each mode (the
// Windows event logs and the merged log go to the back-end whole).
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "LogSectionsFixture.h"
#include "braigrion/ReportDefinition.h"
#include "report/ExpectedPage.h"

namespace braigrion {
namespace {

using testing::DeclareKeyed;
using testing::TLogRun;
using testing::TRepoBuilder;

boost::shared_ptr<TReportParametersBuilder> BuilderOf(TRepoBuilder& repo, const std::string& mode = "default",
                                                      bool kmc = false) {
    return boost::make_shared<TReportParametersBuilder>(repo.Namespace(), mode, kmc);
}

// Records of three files, out of order; one without a log name.
TEST(LinuxLogs, GiveOnePagePerFile) {
    TRepoBuilder repo;
    DeclareKeyed(repo, "ORVSG_LinuxEventLogRecord", "", {"LogName", "RecordID", "MessageTimestamp", "Source", "Message"});
    repo.Parse(R"(
        ORVSG_LinuxEventLogRecord Id="m2" LogName="/var/log/messages" RecordID="2" MessageTimestamp="03:02" Source="kernel" Message="second"
        ORVSG_LinuxEventLogRecord Id="b1" LogName="/var/log/boot.msg" RecordID="3" Message="boot line"
        ORVSG_LinuxEventLogRecord Id="m1" LogName="/var/log/messages" RecordID="1" MessageTimestamp="03:01" Source="kernel" Message="first"
        ORVSG_LinuxEventLogRecord Id="d1" LogName="/var/log/dmesg.0" RecordID="4" Message="[0.0] Linux version"
        ORVSG_LinuxEventLogRecord Id="n1" LogName="audit" RecordID="5" MessageTimestamp="03:03" Source="auditd" Message="bare name"
        ORVSG_LinuxEventLogRecord Id="x1" LogName=null:string RecordID="6" Message="on no page"
    )");
    TLogRun run(repo.Namespace());
    run.writer.WriteLinuxLogReport(BuilderOf(repo), "OSLogs");
    EXPECT_EQ(testing::ExpectedPage("logs/linux-logs.txt", run.Transcript()), run.Transcript());
    EXPECT_EQ(std::string::npos, run.Transcript().find("on no page"));
}

TEST(LinuxLogs, WithoutTheClassLeaveAnIndexLineOnly) {
    TRepoBuilder repo;
    TLogRun run(repo.Namespace());
    run.writer.WriteLinuxLogReport(BuilderOf(repo), "OSLogs");
    EXPECT_EQ("WriteIndexEntry(\"Event Logs\", \"\", false)\n", run.Transcript());
}

// Without a multi-tool's link the IPMI page is a generic page; with one its
// title carries the link, "*" standing for "/", on an HTML writer only.
TEST(IPMIPage, TitleCarriesTheMultitoolLink) {
    struct TCase {
        const char* writerType;
        const char* action;
        const char* title;
    } cases[] = {
        {"html", "", "WriteReportTitle(\"IPMI Event\", \"\", \"\")"},
        {"html", "http://tool.test/sel_desc_reports*sel*1.html",
         "WriteReportTitleWithLink(\"IPMI Event\", \"http://tool.test/sel\", \"reports/sel/1.html\")"},
        {"text", "http://tool.test/sel_desc_x", "WriteReportTitleWithLink(\"IPMI Event\", \"\", \"\")"},
    };
    for (const auto& c : cases) {
        TRepoBuilder repo;
        repo.Add("ORVSG_IPMILogRecord", {testing::Str("RecordID", "1"), testing::Str("Message", "boot"),
                                         testing::Str("Action", c.action)});
        TLogRun run(repo.Namespace(), c.writerType);
        run.writer.WriteIPMIReport(BuilderOf(repo)->BuildIPMILogParams());
        const std::vector<std::string> calls = run.Calls();
        ASSERT_GE(calls.size(), 3u);
        EXPECT_TRUE(std::find(calls.begin(), calls.end(), c.title) != calls.end()) << c.writerType << " " << c.action;
        EXPECT_EQ("WriteIndexEntry(\"ipmi_event\", \"IPMI Event\", true)", calls.back());
    }
}

// The pages each generator opens, by mode: "kmc" and "luz" are the run's
// flags, "preboot-inventory" a pre-boot collection through an inventory
// writer, "delta" a delta view.
std::string PagesOf(const std::vector<std::string>& calls) {
    std::string pages;
    for (const std::string& call : calls) {
        if (call.compare(0, 9, "OpenPage(") == 0) pages += call.substr(call.rfind('/') + 1, call.size() - call.rfind('/') - 3) + " ";
        if (call.compare(0, 20, "WriteEventLogReport(") == 0) pages += "(event log) ";
        if (call.compare(0, 19, "WriteMergedLogPage(") == 0) pages += "(merged log) ";
    }
    return pages;
}

TEST(LogGenerators, WriteTheirPagesByMode) {
    struct TCase {
        const char* page;
        const char* setting;
        const char* expected;
    } cases[] = {
        {"SPLogs", "default", "dlm_event zeph_event chassis_event "},
        {"KMCLogs", "kmc", "ipmi_event "},
        {"SPLogs", "preboot-inventory", "dlm_event zeph_event ipmi_event merged_log "},
        {"KMCLogs", "preboot-inventory-kmc", "ipmi_event chassis_event "},
        {"SPLogs", "delta", ""},
        {"TKRLog", "default", "tkr_log "},
        {"TKRLog", "delta", ""},
        {"DiagsFull", "default", "diags "},
        {"MergedLog", "default", "(merged log) "},
        {"FileLoaderResult", "default", "fileloader.html "},
        {"SPINTLog", "default", ""},
        {"SPINTLog", "luz", "SPINTlog_system "},
        {"CriticalDetails", "default", ""},
        {"CriticalDetails", "inventory", "critical_details "},
        {"OSLogs", "windows", "(event log) (event log) (event log) "},
        {"OSLogs", "linux", "syslog_messages "},
        {"OSLogs", "preboot-inventory", ""},
    };
    for (const auto& c : cases) {
        const std::string setting = c.setting;
        TRepoBuilder repo;
        if (setting.find("preboot") != std::string::npos) {
            repo.Parse("ORVSG_CollectionInfo Build=\"3.0.4-21.preboot\" MajorVersion=\"1\" MinorVersion=\"2\"");
        }
        if (setting == "windows") {
            repo.Parse("ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:74");
        }
        if (setting == "linux") {
            repo.Parse(R"(
                ORVSG_OperatingSystem ProductVendor="Red Hat, Inc." OSType=uint16:36
                ORVSG_LinuxEventLogRecord LogName="/var/log/messages" RecordID="1" Message="m"
            )");
        }
        const bool kmc = setting == "kmc" || setting == "preboot-inventory-kmc";
        const std::string mode = setting == "luz" ? "luz" : "default";
        const std::string writerType =
            setting.find("inventory") != std::string::npos ? TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY : "html";
        boost::shared_ptr<NORVTKR20::ICIMNamespace> ns =
            setting == "delta" ? repo.WithProviderType(1) : boost::shared_ptr<NORVTKR20::ICIMNamespace>(repo.Namespace());
        testing::TEngineRun<testing::TRecordingWriter> run(ns, writerType, mode, kmc);
        run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(ns, mode, kmc), c.page);
        EXPECT_EQ(c.expected, PagesOf(run.Calls())) << c.page << " " << c.setting;
        EXPECT_FALSE(run.log.Contains(std::string("TWriter::WriteReportPage -- Unknow PageID = ") + c.page));
    }
}

}  // namespace
}  // namespace braigrion
