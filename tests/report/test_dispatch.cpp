// Page dispatch: which generator a page id reaches, what each generator does
// under the mode flags, and a failing page contained while the report goes
// on.
#include <cstdlib>
#include <stdexcept>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "report/EngineFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TEngineRun;
using testing::TRepoBuilder;
typedef std::vector<std::string> TLines;

const char kWindows[] = "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:73";
const char kLinux[] = "ORVSG_OperatingSystem ProductVendor=\"Red Hat\" OSType=uint16:36";
const char kPreboot[] = "ORVSG_CollectionInfo Build=\"4.0.1-preboot\"";
const char kVMware[] = "ORVSG_OperatingSystem ProductVendor=\"VMware, Inc.\" OSType=uint16:78";
const char kNoSystem[] = "";

std::string Page(const std::string& id) {
    return "TWriter::WriteReportPage -- Unknow PageID = " + id;
}

std::string Gen(const std::string& name, const std::string& line) {
    return "TWriter::Generator_" + name + " -- " + line;
}

// The lines of a generator that writes `pages` pages with nothing else to say.
TLines Writes(const std::string& name, const std::string& id, int pages = 1) {
    TLines lines = {Gen(name, "Entering")};
    for (int i = 0; i < pages; ++i) lines.push_back(Page(id));
    lines.push_back(Gen(name, "Exiting"));
    return lines;
}

TLines Says(const std::string& name, const std::string& what) {
    return {Gen(name, "Entering"), Gen(name, what), Gen(name, "Exiting")};
}

TLines Join(TLines a, const TLines& b) {
    a.insert(a.end(), b.begin(), b.end());
    return a;
}

struct TDispatchCase {
    std::string name;
    std::string pageID;
    std::string writerType;
    std::string mode;
    const char* repository;
    bool delta;
    bool kmc;
    TLines lines;  // what the dispatch and the generator log between the page's entry lines and its exit
    TLines written = {};  // the index entries of the pages written
};

// The index entry of a declared page that was written.
std::string Entry(const std::string& link, const std::string& name) {
    return "WriteIndexEntry(\"" + link + "\", \"" + name + "\", true)";
}

void PrintTo(const TDispatchCase& c, std::ostream* os) {
    *os << c.name;
}

class DispatchTest : public ::testing::TestWithParam<TDispatchCase> {};

TEST_P(DispatchTest, GeneratorDecidesByTheModeFlags) {
    const TDispatchCase& c = GetParam();
    TRepoBuilder repo;
    repo.Parse(c.repository);
    boost::shared_ptr<NORVTKR20::ICIMNamespace> ns = c.delta ? repo.WithProviderType(1) : repo.Namespace();
    TEngineRun<> run(ns, c.writerType, c.mode, c.kmc);
    run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(ns, c.mode, c.kmc), c.pageID);

    TLines expected = {"TWriter::WriteReportPage -- Entering ",
                       "TWriter::WriteReportPage -- WriterType = [" + c.writerType + "] PageID = [" + c.pageID + "]"};
    expected = Join(expected, c.lines);
    expected.push_back("TWriter::WriteReportPage -- Exiting ");
    // What the builder and the page writer log is theirs to test.
    TLines dispatched;
    for (const std::string& line : run.log.Messages()) {
        if (line.compare(0, 24, "TWriter::WriteReportPage") == 0 || line.compare(0, 19, "TWriter::Generator_") == 0) {
            dispatched.push_back(line);
        }
    }
    EXPECT_EQ(expected, dispatched);
    EXPECT_EQ(c.written, run.writer.CallsStartingWith("WriteIndexEntry("));
    if (c.written.empty()) {
        EXPECT_TRUE(run.writer.Calls().empty());
    }
}

const char kDoNothing[] = "Under DELTA mode [Do Nothing]";
const char kCompare[] = "Under DELTA mode [Do Comparison]";

INSTANTIATE_TEST_SUITE_P(
    Pages, DispatchTest,
    ::testing::Values(
        TDispatchCase{"Overview", "SystemConfig", "html", "default", kWindows, false, false,
                      Writes("SystemOverview", "SystemConfig", 0), {Entry("system_overview", "System Overview")}},
        TDispatchCase{"OverviewDelta", "SystemConfig", "html", "default", kWindows, true, false,
                      {Gen("SystemOverview", "Entering"), Gen("SystemOverview", kCompare), Page("SystemConfig"),
                       Gen("SystemOverview", "Exiting")}},
        TDispatchCase{"HighlightsHtml", "CriticalDetails", "html", "default", kWindows, false, false,
                      {Gen("CriticalDetails", "Entering"), Gen("CriticalDetails", "Exiting")}},
        TDispatchCase{"HighlightsInventory", "CriticalDetails", "inventory", "default", kWindows, false, false,
                      Writes("CriticalDetails", "CriticalDetails")},
        TDispatchCase{"InstallationsLinux", "OSInstallations", "html", "default", kLinux, false, false,
                      Writes("OSInstallation", "OSInstallations", 0),
                      {Entry("installedapps", "Installed Applications"), Entry("installed_packages", "Installed Packages"),
                       Entry("kernelmodules", "Kernel Modules")}},
        TDispatchCase{"InstallationsWindows", "OSInstallations", "html", "default", kWindows, false, false,
                      Writes("OSInstallation", "OSInstallations", 0),
                      {Entry("installedapps", "Installed Applications"), Entry("win_components", "Windows Components"),
                       Entry("installedfixes", "Installed Hotfixes"), Entry("devicedriver", "Device Drivers"),
                       Entry("systemservice", "System Services")}},
        TDispatchCase{"InstallationsDelta", "OSInstallations", "html", "default", kLinux, true, false,
                      {Gen("OSInstallation", "Entering"), Gen("OSInstallation", kCompare), Page("OSInstallations"),
                       Page("OSInstallations"), Page("OSInstallations"), Gen("OSInstallation", "Exiting")}},
        TDispatchCase{"InstallationsPreboot", "OSInstallations", "html", "default", kPreboot, false, false,
                      Says("OSInstallation", "Under pTKR, no OS installation information needed")},
        TDispatchCase{"ConfigurationPreboot", "OSConfiguration", "html", "default", kPreboot, false, false,
                      {Gen("OSConfiguration", "Entering"), Gen("OSConfiguration", "Under Linux, write Linux Config Files"),
                       Gen("OSConfiguration", "Exiting")},
                      {Entry("linux_config", "Linux Config Files")}},
        TDispatchCase{"ConfigurationLinux", "OSConfiguration", "html", "default", kLinux, false, false,
                      {Gen("OSConfiguration", "Entering"), Gen("OSConfiguration", "Under Linux, write Linux Config Files"),
                       Gen("OSConfiguration", "Exiting")},
                      {Entry("os_config", "OS Configuration"), Entry("linux_config", "Linux Config Files")}},
        // A VMware host has no configuration files page.
        TDispatchCase{"ConfigurationVMware", "OSConfiguration", "html", "default", kVMware, false, false,
                      Writes("OSConfiguration", "OSConfiguration", 0), {Entry("os_config", "OS Configuration")}},
        TDispatchCase{"ConfigurationLinuxDelta", "OSConfiguration", "html", "default", kLinux, true, false,
                      {Gen("OSConfiguration", "Entering"), Gen("OSConfiguration", kCompare), Page("OSConfiguration"),
                       Gen("OSConfiguration", "Under Linux, write Linux Config Files"),
                       Gen("OSConfiguration", kCompare), Page("OSConfiguration"), Gen("OSConfiguration", "Exiting")}},
        // Without raw data the page has no link to a raw-data page.
        TDispatchCase{"PciWithRawData", "PCIInfo", "html", "luz", kWindows, false, false,
                      Writes("PCIInformation", "PCIInfo", 0), {Entry("pci_info", "PCI Information")}},
        TDispatchCase{"Pci", "PCIInfo", "text", "luz", kWindows, false, false, Writes("PCIInformation", "PCIInfo", 0),
                      {Entry("pci_info", "PCI Information")}},
        TDispatchCase{"PciDelta", "PCIInfo", "html", "default", kWindows, true, false,
                      {Gen("PCIInformation", "Entering"), Gen("PCIInformation", kCompare), Page("PCIInfo"),
                       Gen("PCIInformation", "Exiting")}},
        TDispatchCase{"HardwareInventory", "HardwareInfo", "html", "default", kWindows, false, false,
                      Writes("HardwareInventory", "HardwareInfo", 0), {Entry("hw_info", "Hardware Inventory")}},
        TDispatchCase{"Network", "NetworkWithTeaming", "html", "default", kWindows, false, false,
                      Writes("NetworkSettings", "NetworkWithTeaming", 0), {Entry("net", "Network Settings")}},
        TDispatchCase{"ResourcesPreboot", "ResourceUtilization", "html", "default", kPreboot, false, false,
                      Says("ResourceUtilization", "Under pTKR, no Resource Utilization information needed")},
        TDispatchCase{"Processes", "Processes", "html", "default", kLinux, false, false,
                      Writes("Processes", "Processes", 0), {Entry("processes", "Processes")}},
        TDispatchCase{"VMwareESXi", "Vmware3i", "html", "default", kWindows, false, false,
                      Writes("VMwareESXi", "Vmware3i", 0), {Entry("vmware_esxi", "VMware ESXi")}},
        TDispatchCase{"VMwareESXiDelta", "Vmware3i", "html", "default", kWindows, true, false,
                      Says("VMwareESXi", kDoNothing)},
        TDispatchCase{"PatchBeacon", "PatchBeacon", "html", "default", kWindows, false, false,
                      Writes("PatchBeacon", "PatchBeacon", 0), {Entry("pb", "PatchBeacon")}},
        TDispatchCase{"KMCConfiguration", "KMCConfig", "html", "default", kWindows, false, true,
                      Writes("ServProcConfiguration", "KMCConfig")},
        TDispatchCase{"ServProcConfigurationDelta", "ServProcConfig", "html", "default", kWindows, true, false,
                      Says("ServProcConfiguration", kDoNothing)},
        TDispatchCase{"EnvironmentalsDelta", "Environmentals", "html", "default", kWindows, true, false,
                      Says("Environmentals", "Under DELTA mode [Do nothing]")},
        TDispatchCase{"FirmwareDelta", "Firmware", "html", "default", kWindows, true, false,
                      {Gen("FirmwareVPD", "Entering"), Gen("FirmwareVPD", kCompare), Page("Firmware"),
                       Gen("FirmwareVPD", "Exiting")}},
        TDispatchCase{"HalcyonInventory", "Halcyon", "inventory", "default", kWindows, false, false,
                      Join(Writes("Halcyon", "Halcyon"), Writes("HalcyonLogs", "Halcyon"))},
        TDispatchCase{"HalcyonHtml", "Halcyon", "html", "default", kWindows, false, false, Writes("Halcyon", "Halcyon")},
        TDispatchCase{"LicenseWithoutKMC", "KMCLicenseKey", "html", "default", kWindows, false, false,
                      Says("KMCLicenseKey", "Under Non-KMC system, No KMC License Key")},
        TDispatchCase{"LicenseOfKMC", "KMCLicenseKey", "html", "default", kWindows, false, true,
                      Writes("KMCLicenseKey", "KMCLicenseKey")},
        TDispatchCase{"VCXDelta", "VCX", "html", "default", kWindows, true, true,
                      Says("VCX", "Under DELTA mode [Do Nothing, Not Support]")},
        TDispatchCase{"OSLogsUnknownSystem", "OSLogs", "html", "default", kNoSystem, false, false,
                      Says("OSLogs", "Unkown OS Type")},
        TDispatchCase{"OSLogsPreboot", "OSLogs", "html", "default", kPreboot, false, false,
                      Says("OSLogs", "Under pTKR, no OS Logs Information needed")},
        TDispatchCase{"ServProcLogs", "SPLogs", "html", "default", kWindows, false, false,
                      Writes("ServProcEvent", "SPLogs", 3)},
        TDispatchCase{"KMCLogs", "KMCLogs", "html", "default", kWindows, false, true, Writes("ServProcEvent", "KMCLogs")},
        TDispatchCase{"ServProcLogsPrebootInventory", "SPLogs", "inventory", "default", kPreboot, false, false,
                      {Gen("ServProcEvent", "Entering"), Gen("ServProcEvent", "Under pTKR GUI System Inventory mode"),
                       Page("SPLogs"), Page("SPLogs"), Page("SPLogs"), Page("SPLogs"), Gen("ServProcEvent", "Exiting")}},
        TDispatchCase{"KMCLogsPrebootInventory", "KMCLogs", "inventory", "default", kPreboot, false, true,
                      {Gen("ServProcEvent", "Entering"), Gen("ServProcEvent", "Under pTKR GUI System Inventory mode"),
                       Page("KMCLogs"), Page("KMCLogs"), Gen("ServProcEvent", "Exiting")}},
        TDispatchCase{"ServiceModePageOutsideLuz", "CFTSetting", "html", "default", kWindows, false, false,
                      {Gen("CFTSetting", "Entering"), Gen("CFTSetting", "Exiting")}},
        TDispatchCase{"ServiceModePage", "SPINTLog", "html", "luz", kWindows, false, false, Writes("SPINTLog", "SPINTLog")},
        // This generator's delta line names the settings page.
        TDispatchCase{"GpuLogDelta", "NVSMILog", "html", "luz", kWindows, true, false,
                      {Gen("NVSMILog", "Entering"), Gen("CFTSetting", kDoNothing), Gen("NVSMILog", "Exiting")}},
        TDispatchCase{"InventoryAnalysis", "Analysis", "inventory", "default", kWindows, false, false,
                      Writes("MergedDevice", "Analysis")},
        // No page id reaches the Diablo generator; an empty id reaches none.
        TDispatchCase{"Diablo", "Diablo", "html", "default", kWindows, false, false, {Page("Diablo")}},
        TDispatchCase{"EmptyId", "", "html", "default", kWindows, false, false, {Page("")}}),
    [](const ::testing::TestParamInfo<TDispatchCase>& info) { return info.param.name; });

TEST(Dispatch, BiosSettingsPageNeedsItsSwitch) {
    TRepoBuilder repo;
    repo.Parse(kWindows);
    struct TCase {
        const char* value;  // null: not set
        bool delta;
        TLines lines;
    } cases[] = {
        {nullptr, false, {Gen("BIOSSettings", "Entering"), Gen("BIOSSettings", "Exiting")}},
        {"no", false, {Gen("BIOSSettings", "Entering"), Gen("BIOSSettings", "Exiting")}},
        {"YES", false, Writes("BIOSSettings", "BIOSSettings")},
        {"yes", true, Says("BIOSSettings", "Uder DELTA mode [Do Nothing]")},
    };
    for (const TCase& c : cases) {
        if (c.value) {
            setenv("TKR_BIOSPROVIDER", c.value, 1);
        } else {
            unsetenv("TKR_BIOSPROVIDER");
        }
        boost::shared_ptr<NORVTKR20::ICIMNamespace> ns = c.delta ? repo.WithProviderType(1) : repo.Namespace();
        TEngineRun<> run(ns);
        run.writer.Generator_BIOSSettings(boost::make_shared<TReportParametersBuilder>(ns, "default", false),
                                          "BIOSSettings");
        EXPECT_EQ(c.lines, run.log.Messages()) << (c.value ? c.value : "unset");
    }
    unsetenv("TKR_BIOSPROVIDER");
}

// A logger that fails on one line, to make a generator fail half-way.
class TFailingLog : public testing::TLogCapture {
public:
    explicit TFailingLog(const std::string& trigger) : fTrigger(trigger) {}
    void Log(int level, const std::string& message) override {
        testing::TLogCapture::Log(level, message);
        if (message == fTrigger) throw std::runtime_error("failed on purpose");
    }

private:
    std::string fTrigger;
};

TEST(Dispatch, AFailingPageIsContainedAndTheNextPageRuns) {
    TRepoBuilder repo;
    repo.Parse(kWindows);
    TFailingLog log("TWriter::Generator_FirmwareVPD -- Entering");
    testing::TRecordingWriter writer;
    log.SetListener([&writer](int, const std::string& line) {
        const std::string unknown = "TWriter::WriteReportPage -- Unknow PageID = ";
        if (line.compare(0, unknown.size(), unknown) == 0) writer.Note("page " + line.substr(unknown.size()));
    });
    TReport report(repo.Namespace(), {}, "out");
    report.Write(&writer, {});

    const std::string transcript = writer.Transcript();
    EXPECT_NE(std::string::npos,
              transcript.find("WriteIndexEntry(\"pci_info\", \"PCI Information\", true)\npage ServProcConfig\n"));
    EXPECT_EQ(std::string::npos, transcript.find("page Firmware\n"));
    EXPECT_NE(std::string::npos, transcript.find("page TKRLog\nEndReport()\n"));

    const int failed = log.IndexOf("TWriter::Generator_FirmwareVPD -- Entering");
    ASSERT_GE(failed, 0);
    EXPECT_EQ("TWriter::WriteReportPage -- Exiting ", log.Messages()[static_cast<size_t>(failed) + 1]);
    EXPECT_FALSE(log.Contains("TWriter::Generator_FirmwareVPD -- Exiting"));
}

}  // namespace
}  // namespace braigrion
