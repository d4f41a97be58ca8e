// The shape of a report run: categories, pages and their conditions, as the
// back-end sees them, and the driver's modes as read from the context.
#include <algorithm>
#include <cstdlib>
#include <ostream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "report/ExpectedPage.h"
#include "report/RunTranscript.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::TCIMValue;
using testing::TContextMap;
using testing::TRepoBuilder;
using testing::TReportRun;

const char kWindows[] = "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:73\n";

struct TRunCase {
    const char* name;  // the expected transcript is runs/<name>.txt
    const char* repository;
    TContextMap context;
};

void PrintTo(const TRunCase& c, std::ostream* os) {
    *os << c.name;
}

class ReportRunTest : public ::testing::TestWithParam<TRunCase> {};

// A page written stands as its index entry; a "page" line stands for each
// page a generator will write once its section is part of the library.
TEST_P(ReportRunTest, WritesTheCategoriesAndPagesOfItsMode) {
    const TRunCase& c = GetParam();
    unsetenv("TKR_BIOSPROVIDER");  // the BIOS settings page stays switched off
    TRepoBuilder repo;
    repo.Parse(c.repository);
    TReportRun run;
    TReport report(repo.Namespace(), c.context, "out");
    report.Write(&run.writer, c.context);
    EXPECT_EQ(testing::ExpectedPage(std::string("runs/") + c.name + ".txt", run.Transcript()), run.Transcript());
}

// The installation page of Windows has five parts, the service processor
// logs three; the license key page is left out without KMC, the BIOS
// settings page without its switch. Only the exact word "luz" selects the
// service mode. Pre-boot data have no OS Logs category and no EndCategory
// for it, so the service processor category's EndCategory closes
// "Hardware"; of the operating system pages they have the Linux
// configuration files only. An unknown system's log category is closed but
// gets no heading and no page.
INSTANTIATE_TEST_SUITE_P(
    Modes, ReportRunTest,
    ::testing::Values(TRunCase{"windows-default", kWindows, {}},
                      TRunCase{"windows-luz", kWindows, {{"mode", TCIMValue("luz")}}},
                      TRunCase{"windows-LUZ", kWindows, {{"mode", TCIMValue("LUZ")}}},
                      TRunCase{"windows-kmc", kWindows, {{"KMC", TCIMValue("true")}}},
                      TRunCase{"linux", "ORVSG_OperatingSystem ProductVendor=\"Red Hat\" OSType=uint16:36", {}},
                      TRunCase{"preboot", "ORVSG_CollectionInfo Build=\"4.0.1-preboot\"", {}},
                      TRunCase{"unknown-os", "ORVSG_OperatingSystem ProductVendor=\"Sun\" OSType=uint16:29", {}}),
    [](const ::testing::TestParamInfo<TRunCase>& info) {
        std::string name = info.param.name;
        std::replace(name.begin(), name.end(), '-', '_');
        return name;
    });

// The OS type is asked when the walk reaches the OS Logs category, so what
// finding it logs stands inside that category; the only earlier asking is
// the writer's own set-up. A VMware host counts as Linux for its logs.
TEST(ReportRun, TheOSTypeIsAskedInsideTheOSLogsCategory) {
    const std::string asked = "TReportParametersBuilder::GetOSType -- Entering";
    for (const char* os : {"OSType=uint16:36", "OSType=uint16:78"}) {
        SCOPED_TRACE(os);
        TRepoBuilder repo;
        repo.Parse(std::string("ORVSG_OperatingSystem ProductVendor=\"Norvane\" ") + os);
        TReportRun run;
        TReport report(repo.Namespace(), {}, "out");
        report.Write(&run.writer, {});
        const std::vector<std::string> lines = run.log.Messages();
        const int setUp = run.log.IndexOf("TWriter::BaseInitialize -- Exiting ");
        const int software = run.log.IndexOf("TReport::Write -- Start generating category [Software]");
        const int osLogs = run.log.IndexOf("TReport::Write -- Start generating category [OS Logs]");
        const int servProc = run.log.IndexOf("TReport::Write -- Start generating category [ServProc Logs]");
        ASSERT_TRUE(setUp >= 0 && setUp < software && software < osLogs && osLogs < servProc);
        EXPECT_EQ(lines.begin() + software, std::find(lines.begin() + setUp, lines.begin() + software, asked));
        EXPECT_NE(lines.begin() + servProc, std::find(lines.begin() + osLogs, lines.begin() + servProc, asked));
        EXPECT_EQ(1u, run.writer.CallsStartingWith("WriteCategory(\"Linux Logs\")").size());
    }
}

// Which repairs run: all of them, before the writer is first set up, for a
// whole run outside delta; none in delta or for a page a non-inventory
// writer asks for; for each inventory page the ones its data need. Each
// case shows as "## name", the page's answer, the entry traces of the
// repairs and of the writer's first set-up, and the page's transcript.
TEST(ReportRun, RepairsRunWhereTheirDataAreShown) {
    struct TCase {
        const char* name;
        const char* writerType;
        const char* pageID;  // null: a whole run
        bool delta;
    } cases[] = {
        {"whole run", "html", nullptr, false},   {"delta run", "html", nullptr, true},
        {"html page", "html", "SystemConfig", false}, {"Analysis", "inventory", "Analysis", false},
        {"HardwareInfo", "inventory", "HardwareInfo", false}, {"CriticalDetails", "inventory", "CriticalDetails", false},
        {"SystemConfig", "inventory", "SystemConfig", false}, {"Emulex", "inventory", "Emulex", false},
        {"LSI", "inventory", "LSI", false},
    };
    TRepoBuilder repo;
    repo.Parse(kWindows);
    std::string dump;
    for (const TCase& c : cases) {
        TReportRun run(c.writerType);
        run.writer.SetInventoryPage("<the page>");
        TContextMap context;
        if (c.pageID) context["pageID"] = TCIMValue(c.pageID);
        TReport report(c.delta ? repo.WithProviderType(1) : repo.Namespace(), context, "out");
        dump += std::string("## ") + c.name + "\n";
        if (c.pageID) {
            dump += "answer \"" + report.GetPage(&run.writer, context) + "\"\n";
        } else {
            report.Write(&run.writer, context);
        }
        bool setUp = false;
        for (const std::string& line : run.log.Messages()) {
            const bool repair = line.compare(0, 9, "TReport::") == 0 && line.find(" -- Entering") != std::string::npos &&
                                (line.find("::fix") != std::string::npos || line.find("::AddManufacturer") != std::string::npos ||
                                 line.find("::ConvertEmulex") != std::string::npos);
            if (repair || (!setUp && line == "TWriter::BaseInitialize -- Entering ")) dump += line + "\n";
            setUp = setUp || line == "TWriter::BaseInitialize -- Entering ";
        }
        if (c.pageID) dump += run.Transcript();
    }
    EXPECT_EQ(testing::ExpectedPage("runs/repairs.txt", dump), dump);
}

// A delta view: only the comparing generators have pages, and the data are
// never taken for pre-boot data.
TEST(ReportRun, DeltaViewComparesAndIsNeverPreboot) {
    TRepoBuilder repo;
    repo.Parse(kWindows);
    repo.Parse("ORVSG_CollectionInfo Build=\"4.0.1-preboot\"");
    TReportRun run;
    TReport report(repo.WithProviderType(1), {}, "out");
    EXPECT_TRUE(report.IsDelta());
    EXPECT_FALSE(report.IsPreboot());
    report.Write(&run.writer, {});

    EXPECT_EQ(testing::ExpectedPage("runs/windows-delta.txt", run.Transcript()), run.Transcript());
    EXPECT_TRUE(run.log.Contains("TWriter::Generator_Environmentals -- Under DELTA mode [Do nothing]"));
    EXPECT_EQ(1, run.writer.ProviderType());
}

TEST(ReportRun, RefusalsAreLoggedAsErrors) {
    TRepoBuilder repo;
    TReportRun run;
    TReport report(repo.Namespace(), {}, "out");
    report.Write(&run.writer, {});
    EXPECT_EQ(0, run.log.LevelOf("TReport::Write -- Unknow OS type]"));

    run.log.Clear();
    report.Write(nullptr, {});
    EXPECT_EQ(0, run.log.LevelOf("TReport::Write -- Null-Pointor exception: Parameter (TWriter *writer == NULL)"));
    EXPECT_FALSE(run.log.Contains("TReport::fixCriticalDetailforRaidDiskRemoval -- Entering"));
    EXPECT_EQ("", report.GetPage(nullptr, {}));
    EXPECT_EQ(0, run.log.LevelOf("TReport::GetPage -- Null-Pointor exception: Parameter (TWriter *writer == NULL)"));
}

// "VCX" is read after "KMC" and decides when both are given; only "true",
// in any case, sets the flag.
TEST(ReportRun, ContextDecidesKMC) {
    struct TCase {
        TContextMap context;
        bool kmc;
    } cases[] = {
        {{}, false},
        {{{"KMC", TCIMValue("TRUE")}}, true},
        {{{"KMC", TCIMValue("yes")}}, false},
        {{{"KMC", TCIMValue("TRUE")}, {"VCX", TCIMValue("FALSE")}}, false},
        {{{"KMC", TCIMValue("false")}, {"VCX", TCIMValue("tRuE")}}, true},
    };
    TRepoBuilder repo;
    for (size_t i = 0; i < sizeof cases / sizeof cases[0]; ++i) {
        EXPECT_EQ(cases[i].kmc, TReport(repo.Namespace(), cases[i].context, "out").IsKMC()) << "case " << i;
    }
}

TEST(ReportRun, DetermineKMCReadsTheFirmwareNames) {
    struct TCase {
        const char* repository;
        bool kmc;
        const char* logged;
    } cases[] = {
        {"", false, "TReport::DetermineKMC -- Exception when determining is KMC or not"},
        {"class ORVSG_IPMIFirmwareElement", false,
         "TReport::DetermineKMC -- There is no instance of ORVSG_IPMIFirmwareElement"},
        {"ORVSG_IPMIFirmwareElement Name=\"BMC Firmware\"\n"
         "ORVSG_IPMIFirmwareElement Name=\"Kinetic Management Core Firmware\"",
         true, nullptr},
    };
    for (const TCase& c : cases) {
        testing::TLogCapture log;
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TReport report(repo.Namespace(), {}, "out");
        report.DetermineKMC();
        EXPECT_EQ(c.kmc, report.IsKMC()) << c.repository;
        EXPECT_TRUE(c.logged == nullptr || log.Contains(c.logged)) << c.repository;
    }
}

}  // namespace
}  // namespace braigrion
