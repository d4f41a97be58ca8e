// The shape of a report run: categories, pages and their conditions, as the
// back-end sees them, and the driver's modes as read from the context.
#include <cstdlib>
#include <ostream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
#include "braigrion/TReport.h"
#include "report/RunTranscript.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::TCIMValue;
using testing::TContextMap;
using testing::TRepoBuilder;
using testing::TReportRun;

const char kWindows[] = "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:73\n";

// A whole run over a Windows collection in the default mode. A page written
// stands as its index entry; a "page" line stands for each page a generator
// will write once its section is part of the library. The installation page
// of Windows has five parts, the service processor logs three; the license
// key page is left out without KMC, the BIOS settings page without its
// switch.
const char kDefaultRun[] = R"(Initialize("out", mode="default")
StartReport()
WriteCategory("Software")
WriteIndexEntry("system_overview", "System Overview", true)
WriteIndexEntry("installedapps", "Installed Applications", true)
WriteIndexEntry("win_components", "Windows Components", true)
WriteIndexEntry("installedfixes", "Installed Hotfixes", true)
WriteIndexEntry("devicedriver", "Device Drivers", true)
WriteIndexEntry("systemservice", "System Services", true)
WriteIndexEntry("net", "Network Settings", true)
WriteIndexEntry("resource", "Resource Utilization", true)
WriteIndexEntry("processes", "Processes", true)
WriteIndexEntry("os_config", "OS Configuration", true)
EndCategory()
WriteCategory("Hardware")
WriteIndexEntry("hw_info", "Hardware Inventory", true)
WriteIndexEntry("pci_info", "PCI Information", true)
page Firmware
page ServProcConfig
page Environmentals
page DriveHealth
page LSI
page LSIIDE
page Mellanox
page Solarflare
page FusionIO
page PMC
page Halcyon
page HalcyonLogs
page Qlogic
page Emulex
page Broadcom
page Brocade
WriteIndexEntry("vmware_esxi", "VMware ESXi", true)
page GlowTrace
page BIST
EndCategory()
WriteCategory("Windows Logs")
page OSLogs
EndCategory()
WriteCategory("SP Logs")
page SPLogs
page SPLogs
page SPLogs
EndCategory()
WriteCategory("Analysis")
page MergedLog
page MergedDevice
page MelodyDeviceAnalysis
WriteIndexEntry("pb", "PatchBeacon", true)
page FileLoaderResult
page DiagsFull
EndCategory()
page TKRLog
EndReport()
)";

// A delta view: only the comparing generators have pages; the others say
// that they do nothing.
const char kDeltaRun[] = R"(Initialize("out", mode="default")
StartReport()
WriteCategory("Software")
page SystemConfig
page OSInstallations
page OSInstallations
page OSInstallations
page OSInstallations
page OSInstallations
page NetworkWithTeaming
page ResourceUtilization
page Processes
page OSConfiguration
EndCategory()
WriteCategory("Hardware")
page HardwareInfo
page PCIInfo
page Firmware
EndCategory()
WriteCategory("Windows Logs")
EndCategory()
WriteCategory("SP Logs")
EndCategory()
WriteCategory("Analysis")
EndCategory()
EndReport()
)";

#define INDEX_ENTRY(link, name) "WriteIndexEntry(\"" link "\", \"" name "\", true)\n"

const char kInstalledApps[] = INDEX_ENTRY("installedapps", "Installed Applications");
const char kWindowsInstallation[] = INDEX_ENTRY("installedapps", "Installed Applications")
    INDEX_ENTRY("win_components", "Windows Components") INDEX_ENTRY("installedfixes", "Installed Hotfixes")
        INDEX_ENTRY("devicedriver", "Device Drivers") INDEX_ENTRY("systemservice", "System Services");
const char kLinuxInstallation[] = INDEX_ENTRY("installedapps", "Installed Applications")
    INDEX_ENTRY("installed_packages", "Installed Packages") INDEX_ENTRY("kernelmodules", "Kernel Modules");
const char kOSConfiguration[] = INDEX_ENTRY("os_config", "OS Configuration");
const char kLinuxConfiguration[] = INDEX_ENTRY("linux_config", "Linux Config Files");
const char kResourcesAndProcesses[] =
    INDEX_ENTRY("resource", "Resource Utilization") INDEX_ENTRY("processes", "Processes");

// Replaces the one occurrence of `from`; fails the test when there is none.
std::string Edit(std::string text, const std::string& from, const std::string& to) {
    std::string::size_type at = text.find(from);
    if (at == std::string::npos) {
        ADD_FAILURE() << "expected transcript lacks: " << from;
        return text;
    }
    return text.replace(at, from.size(), to);
}

const char kOSLogs[] = "EndCategory()\nWriteCategory(\"Windows Logs\")\npage OSLogs\n";

struct TRunCase {
    const char* name;
    const char* repository;
    TContextMap context;
    std::vector<std::pair<std::string, std::string>> edits;  // applied to kDefaultRun
    std::vector<std::string> logged;                         // lines that must be in the log
};

void PrintTo(const TRunCase& c, std::ostream* os) {
    *os << c.name;
}

class ReportRunTest : public ::testing::TestWithParam<TRunCase> {};

TEST_P(ReportRunTest, WritesTheCategoriesAndPagesOfItsMode) {
    const TRunCase& c = GetParam();
    unsetenv("TKR_BIOSPROVIDER");  // the BIOS settings page stays switched off
    TRepoBuilder repo;
    repo.Parse(c.repository);
    TReportRun run;
    TReport report(repo.Namespace(), c.context, "out");
    report.Write(&run.writer, c.context);

    std::string expected = kDefaultRun;
    for (const auto& edit : c.edits) expected = Edit(expected, edit.first, edit.second);
    EXPECT_EQ(expected, run.Transcript());
    for (const std::string& line : c.logged) EXPECT_TRUE(run.log.Contains(line)) << line;
}

INSTANTIATE_TEST_SUITE_P(
    Modes, ReportRunTest,
    ::testing::Values(
        TRunCase{"Default", kWindows, {}, {},
                 {"TReport::Write -- Under Non-LUZ (default) mode, no ORV Service information needed"}},
        TRunCase{"Luz",
                 kWindows,
                 {{"mode", TCIMValue("luz")}},
                 {{"mode=\"default\"", "mode=\"luz\""},
                  {"page SPLogs\nEndCategory()\n",
                   "page SPLogs\nEndCategory()\nWriteCategory(\"ORV Service\")\npage QVAChipsetRegister\n"
                   "page CFTSetting\npage NVSMILog\npage AMDAticonfigLog\npage SPINTLog\nEndCategory()\n"}},
                 {}},
        // Only the exact word "luz" selects the mode.
        TRunCase{"LuzIsCaseSensitive", kWindows, {{"mode", TCIMValue("LUZ")}}, {{"mode=\"default\"", "mode=\"LUZ\""}}, {}},
        TRunCase{"Linux",
                 "ORVSG_OperatingSystem ProductVendor=\"Red Hat\" OSType=uint16:36",
                 {},
                 {{"Windows Logs", "Linux Logs"},
                  {kWindowsInstallation, kLinuxInstallation},
                  {kOSConfiguration, std::string(kOSConfiguration) + kLinuxConfiguration}},
                 {"TWriter::Generator_OSConfiguration -- Under Linux, write Linux Config Files"}},
        // Pre-boot: no OS Logs category and no EndCategory for it, so the
        // service processor category's EndCategory closes "Hardware".
        TRunCase{"Preboot",
                 "ORVSG_CollectionInfo Build=\"4.0.1-preboot\"\n",
                 {},
                 {{kOSLogs, ""},
                  {kWindowsInstallation, ""},
                  {kResourcesAndProcesses, ""},
                  // Pre-boot data have the configuration files of Linux only.
                  {kOSConfiguration, kLinuxConfiguration}},
                 {"TReport::TReport -- TKR type is Preboot ",
                  "TReport::Write -- Under pTKR, no OS Logs information needed",
                  "TWriter::Generator_OSInstallation -- Under pTKR, no OS installation information needed",
                  "TWriter::Generator_ResourceUtilization -- Under pTKR, no Resource Utilization information needed",
                  "TWriter::Generator_Processes -- Under pTKR, no Process information needed"}},
        // An unknown system: the category is closed but gets no heading and no page.
        TRunCase{"UnknownOSType",
                 "ORVSG_OperatingSystem ProductVendor=\"Sun\" OSType=uint16:29",
                 {},
                 {{kOSLogs, "EndCategory()\n"}, {kWindowsInstallation, kInstalledApps}},
                 {"TReport::Write -- Unknow OS type]"}},
        TRunCase{"KMC",
                 kWindows,
                 {{"KMC", TCIMValue("true")}},
                 {{"page BIST\n", "page BIST\npage KMCLicenseKey\npage VCX\n"},
                  {"SP Logs", "KMC Logs"},
                  {"page SPLogs\npage SPLogs\npage SPLogs\n", "page SPLogs\n"}},
                 {}},
        TRunCase{"VCXOverridesKMC", kWindows, {{"KMC", TCIMValue("TRUE")}, {"VCX", TCIMValue("FALSE")}}, {}, {}},
        TRunCase{"VCXAlone",
                 kWindows,
                 {{"VCX", TCIMValue("True")}},
                 {{"page BIST\n", "page BIST\npage KMCLicenseKey\npage VCX\n"},
                  {"SP Logs", "KMC Logs"},
                  {"page SPLogs\npage SPLogs\npage SPLogs\n", "page SPLogs\n"}},
                 {"TReport::TReport -- Can not detected KMC from TCIMContext, set fKMC to FALSE "}}),
    [](const ::testing::TestParamInfo<TRunCase>& info) { return std::string(info.param.name); });

const std::vector<std::string> kFixupTraces = {
    "TReport::fixCriticalDetailforRaidDiskRemoval -- Entering", "TReport::fixProductNameofComputerSystem -- Entering",
    "TReport::fixRedundantMonitorInfo -- Entering", "TReport::AddManufacturerForMem -- Entering",
    "TReport::ConvertEmulexKoSTypeIDToHex -- Entering"};

// The entry traces of the repairs, in the order they ran.
std::vector<std::string> FixupsRun(const testing::TLogCapture& log) {
    std::vector<std::string> run;
    for (const std::string& line : log.Messages()) {
        if (line.compare(0, 9, "TReport::") == 0 && line.find(" -- Entering") != std::string::npos &&
            (line.find("::fix") != std::string::npos || line.find("::AddManufacturerForMem") != std::string::npos ||
             line.find("::ConvertEmulex") != std::string::npos)) {
            run.push_back(line);
        }
    }
    return run;
}

TEST(ReportRun, RepairsRunBeforeTheFirstPageOutsideDelta) {
    TRepoBuilder repo;
    repo.Parse(kWindows);
    TReportRun run;
    TReport report(repo.Namespace(), {}, "out");
    report.Write(&run.writer, {});

    EXPECT_EQ(kFixupTraces, FixupsRun(run.log));
    int lastRepair = run.log.IndexOf("TReport::ConvertEmulexKoSTypeIDToHex -- Exiting");
    int firstInit = run.log.IndexOf("TWriter::BaseInitialize -- Entering ");
    EXPECT_GE(lastRepair, 0);
    EXPECT_LT(lastRepair, firstInit);
    EXPECT_LT(run.log.IndexOf("TReport::Write -- Under Non-DELTA mode, invoking fixing functions"),
              run.log.IndexOf(kFixupTraces[0]));
    // The run ends by releasing the writer's state.
    std::vector<std::string> lines = run.log.Messages();
    ASSERT_GE(lines.size(), 4u);
    EXPECT_EQ("TReport::Write -- End of generating TKR output report", lines[lines.size() - 4]);
    EXPECT_EQ("TWriter::BaseDispose -- Entering ", lines[lines.size() - 3]);
    EXPECT_EQ("TReport::Write -- Exiting", lines.back());
}

TEST(ReportRun, DeltaViewSkipsRepairsAndThePrebootTest) {
    TRepoBuilder repo;
    repo.Parse(kWindows);
    repo.Parse("ORVSG_CollectionInfo Build=\"4.0.1-preboot\"");
    TReportRun run;
    TReport report(repo.WithProviderType(1), {}, "out");
    EXPECT_TRUE(report.IsDelta());
    EXPECT_FALSE(report.IsPreboot());
    report.Write(&run.writer, {});

    // Not pre-boot, so the OS Logs category stands as in an ordinary run.
    EXPECT_EQ(kDeltaRun, run.Transcript());
    EXPECT_TRUE(run.log.Contains("TWriter::Generator_Environmentals -- Under DELTA mode [Do nothing]"));
    EXPECT_TRUE(run.log.Contains("TWriter::Generator_OSLogs -- Under DELTA mode [Do Nothing]"));
    EXPECT_TRUE(FixupsRun(run.log).empty());
    EXPECT_TRUE(run.log.Contains("TReport::TReport -- Generation mode is DELTA "));
    EXPECT_TRUE(run.log.Contains("TReport::Write -- Under DELTA mode, don't invok fixing functions"));
    EXPECT_FALSE(run.log.Contains("TReport::TReport -- TKR type is Preboot "));
    EXPECT_FALSE(run.log.Contains("TReport::TReport -- TKR type is not Preboot "));
    EXPECT_EQ(1, run.writer.ProviderType());
}

TEST(ReportRun, UnknownOperatingSystemIsLoggedAsAnError) {
    TRepoBuilder repo;
    TReportRun run;
    TReport report(repo.Namespace(), {}, "out");
    report.Write(&run.writer, {});
    EXPECT_EQ(0, run.log.LevelOf("TReport::Write -- Unknow OS type]"));
    EXPECT_TRUE(run.writer.CallsStartingWith("WriteCategory(\"Windows").empty());
    EXPECT_TRUE(run.writer.CallsStartingWith("WriteCategory(\"Linux").empty());
}

TEST(ReportRun, NullWriterIsRefused) {
    TRepoBuilder repo;
    testing::TLogCapture log;
    TReport report(repo.Namespace(), {}, "out");
    log.Clear();
    report.Write(nullptr, {});
    EXPECT_EQ(0, log.LevelOf("TReport::Write -- Null-Pointor exception: Parameter (TWriter *writer == NULL)"));
    EXPECT_TRUE(FixupsRun(log).empty());

    EXPECT_EQ("", report.GetPage(nullptr, {}));
    EXPECT_EQ(0, log.LevelOf("TReport::GetPage -- Null-Pointor exception: Parameter (TWriter *writer == NULL)"));
}

TEST(ReportRun, ContextDecidesModeAndKMC) {
    struct TCase {
        TContextMap context;
        bool kmc;
    };
    const std::vector<TCase> cases = {
        {{}, false},
        {{{"KMC", TCIMValue("true")}}, true},
        {{{"KMC", TCIMValue("TRUE")}}, true},
        {{{"KMC", TCIMValue("yes")}}, false},
        {{{"KMC", TCIMValue("TRUE")}, {"VCX", TCIMValue("FALSE")}}, false},
        {{{"KMC", TCIMValue("false")}, {"VCX", TCIMValue("tRuE")}}, true},
        {{{"VCX", TCIMValue("1")}}, false},
    };
    TRepoBuilder repo;
    for (size_t i = 0; i < cases.size(); ++i) {
        TReport report(repo.Namespace(), cases[i].context, "out");
        EXPECT_EQ(cases[i].kmc, report.IsKMC()) << "case " << i;
    }

    testing::TLogCapture log;
    TReport report(repo.Namespace(),
                   {{"mode", TCIMValue("luz")}, {"pageID", TCIMValue("LSI")}, {"viewID", TCIMValue("v")},
                    {"dataID", TCIMValue("d")}, {"testID", TCIMValue("t")}},
                   "out");
    EXPECT_EQ("luz", report.GetMode());
    EXPECT_EQ("LSI", report.GetPageID());
    EXPECT_EQ("v", report.GetViewID());
    EXPECT_EQ("d", report.GetDataID());
    EXPECT_EQ("t", report.GetTestID());
    EXPECT_FALSE(report.IsPreboot());
    EXPECT_EQ((std::vector<std::string>{"TReport::TReport -- Entering", "TReport::TReport -- TKR mode = luz",
                                        "TReport::TReport -- Can not detected KMC from TCIMContext, set fKMC to FALSE ",
                                        "TReport::TReport -- Can not detected VCX from TCIMContext, set fKMC to FALSE ",
                                        "TReport::TReport -- Generation mode is not DELTA ",
                                        "TReport::TReport -- TKR type is not Preboot "}),
              log.Messages());

    TReport plain(repo.Namespace(), {}, "out");
    EXPECT_EQ("default", plain.GetMode());
    EXPECT_EQ("", plain.GetPageID());
}

TEST(ReportRun, DetermineKMCReadsTheFirmwareNames) {
    testing::TLogCapture log;
    TRepoBuilder none;
    TReport absent(none.Namespace(), {}, "out");
    absent.DetermineKMC();
    EXPECT_FALSE(absent.IsKMC());
    EXPECT_TRUE(log.Contains("TReport::DetermineKMC -- Exception when determining is KMC or not"));

    TRepoBuilder empty;
    empty.Declare("ORVSG_IPMIFirmwareElement", {"Name"});
    TReport noInstance(empty.Namespace(), {}, "out");
    noInstance.DetermineKMC();
    EXPECT_FALSE(noInstance.IsKMC());
    EXPECT_TRUE(log.Contains("TReport::DetermineKMC -- There is no instance of ORVSG_IPMIFirmwareElement"));

    TRepoBuilder kmc;
    kmc.Parse(R"(
        ORVSG_IPMIFirmwareElement Name="BMC Firmware"
        ORVSG_IPMIFirmwareElement Name="Kinetic Management Core Firmware"
    )");
    TReport found(kmc.Namespace(), {}, "out");
    EXPECT_FALSE(found.IsKMC());
    found.DetermineKMC();
    EXPECT_TRUE(found.IsKMC());
}

TEST(ReportPage, NonInventoryWriterGetsNothing) {
    TRepoBuilder repo;
    repo.Parse(kWindows);
    TReportRun run("html");
    run.writer.SetInventoryPage("never asked for");
    TContextMap context = {{"pageID", TCIMValue("SystemConfig")}};
    TReport report(repo.Namespace(), context, "out");
    EXPECT_EQ("", report.GetPage(&run.writer, context));

    EXPECT_EQ("Initialize(\"out\", mode=\"default\")\n", run.writer.Transcript());
    EXPECT_TRUE(run.log.Contains("TReport::GetPage -- Writer type is not inventory, just return void string"));
    EXPECT_TRUE(FixupsRun(run.log).empty());
    EXPECT_TRUE(run.log.Contains("TWriter::BaseDispose -- Entering "));
    EXPECT_EQ("TReport::GetPage -- Exiting", run.log.Messages().back());
}

TEST(ReportPage, InventoryWriterGetsThePageWithItsRepairs) {
    struct TCase {
        std::string pageID;
        std::vector<std::string> repairs;
        std::string page;  // the page's line in the transcript
    };
    const std::vector<TCase> cases = {
        {"Analysis", {"TReport::AddManufacturerForMem -- Entering"}, "page Analysis\n"},
        {"HardwareInfo",
         {"TReport::AddManufacturerForMem -- Entering", "TReport::fixRedundantMonitorInfo -- Entering"},
         INDEX_ENTRY("hw_info", "Hardware Inventory")},
        {"CriticalDetails", {"TReport::fixCriticalDetailforRaidDiskRemoval -- Entering"}, "page CriticalDetails\n"},
        {"SystemConfig",
         {"TReport::fixCriticalDetailforRaidDiskRemoval -- Entering",
          "TReport::fixProductNameofComputerSystem -- Entering"},
         INDEX_ENTRY("system_overview", "System Overview")},
        {"Emulex", {"TReport::ConvertEmulexKoSTypeIDToHex -- Entering"}, "page Emulex\n"},
        {"LSI", {}, "page LSI\n"},
    };
    TRepoBuilder repo;
    repo.Parse(kWindows);
    for (const TCase& c : cases) {
        TReportRun run(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY);
        run.writer.SetInventoryPage("<page " + c.pageID + ">");
        TContextMap context = {{"pageID", TCIMValue(c.pageID)}};
        TReport report(repo.Namespace(), context, "inv");
        EXPECT_EQ("<page " + c.pageID + ">", report.GetPage(&run.writer, context));
        EXPECT_EQ("Initialize(\"inv\", mode=\"default\")\n" + c.page + "GetInventoryPage()\n", run.Transcript());
        EXPECT_EQ(c.repairs, FixupsRun(run.log)) << c.pageID;
        EXPECT_TRUE(run.log.Contains("TReport::GetPage -- Start generating TKR inventory page, ID = [" + c.pageID + "]"));
        EXPECT_EQ(c.pageID == "Analysis",
                  run.log.Contains("TReport::GetPage -- Invoking memory manufacture fixing function for Analysis page"));
    }
}

}  // namespace
}  // namespace braigrion
