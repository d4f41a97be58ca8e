// Page dispatch: what a generator does under the mode flags where a whole
// report run does not show it (pages asked for one at a time, inventory
// pages, delta views of other systems), and a failing page contained while
// the report goes on.
#include <cstdlib>
#include <stdexcept>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "report/EngineFixture.h"
#include "report/ExpectedPage.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TEngineRun;
using testing::TRepoBuilder;

const char kWindows[] = "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:73";
const char kLinux[] = "ORVSG_OperatingSystem ProductVendor=\"Red Hat\" OSType=uint16:36";
const char kPreboot[] = "ORVSG_CollectionInfo Build=\"4.0.1-preboot\"";
const char kVMware[] = "ORVSG_OperatingSystem ProductVendor=\"VMware, Inc.\" OSType=uint16:78";

struct TDispatchCase {
    const char* name;
    const char* pageID;
    const char* writerType;
    const char* mode;
    const char* repository;
    bool delta;
    bool kmc;
    const char* bios;  // TKR_BIOSPROVIDER, or null to leave it unset
};

// Each case as "## name", the lines the dispatch and the generator log (a
// page still without generator as its "Unknow PageID" line), the index
// entries of the pages written, and the number of back-end calls. Critical details are an inventory page
// only; a VMware host has the Linux configuration files page; the GPU log's delta
// line names the settings page; the BIOS settings page needs its switch; no
// page id reaches the Diablo generator, and an empty id reaches none.
TEST(Dispatch, GeneratorsDecideByTheModeFlags) {
    const TDispatchCase cases[] = {
        {"HighlightsHtml", "CriticalDetails", "html", "default", kWindows, false, false, nullptr},
        {"ConfigurationVMware", "OSConfiguration", "html", "default", kVMware, false, false, nullptr},
        {"ConfigurationLinuxDelta", "OSConfiguration", "html", "default", kLinux, true, false, nullptr},
        {"KMCConfiguration", "KMCConfig", "html", "default", kWindows, false, true, nullptr},
        {"HalcyonInventory", "Halcyon", "inventory", "default", kWindows, false, false, nullptr},
        {"LicenseWithoutKMC", "KMCLicenseKey", "html", "default", kWindows, false, false, nullptr},
        {"VCXDelta", "VCX", "html", "default", kWindows, true, true, nullptr},
        {"OSLogsUnknownSystem", "OSLogs", "html", "default", "", false, false, nullptr},
        {"OSLogsPreboot", "OSLogs", "html", "default", kPreboot, false, false, nullptr},
        {"ServProcLogsPrebootInventory", "SPLogs", "inventory", "default", kPreboot, false, false, nullptr},
        {"KMCLogsPrebootInventory", "KMCLogs", "inventory", "default", kPreboot, false, true, nullptr},
        {"ServiceModePageOutsideLuz", "CFTSetting", "html", "default", kWindows, false, false, nullptr},
        {"GpuLogDelta", "NVSMILog", "html", "luz", kWindows, true, false, nullptr},
        {"BiosUnset", "BIOSSettings", "html", "default", kWindows, false, false, nullptr},
        {"BiosNo", "BIOSSettings", "html", "default", kWindows, false, false, "no"},
        {"BiosYes", "BIOSSettings", "html", "default", kWindows, false, false, "YES"},
        {"BiosYesDelta", "BIOSSettings", "html", "default", kWindows, true, false, "yes"},
        {"Diablo", "Diablo", "html", "default", kWindows, false, false, nullptr},
        {"EmptyId", "", "html", "default", kWindows, false, false, nullptr},
    };
    std::string dump;
    for (const TDispatchCase& c : cases) {
        if (c.bios) {
            setenv("TKR_BIOSPROVIDER", c.bios, 1);
        } else {
            unsetenv("TKR_BIOSPROVIDER");
        }
        TRepoBuilder repo;
        repo.Parse(c.repository);
        boost::shared_ptr<NORVTKR20::ICIMNamespace> ns = c.delta ? repo.WithProviderType(1) : repo.Namespace();
        TEngineRun<> run(ns, c.writerType, c.mode, c.kmc);
        run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(ns, c.mode, c.kmc), c.pageID);
        dump += std::string("## ") + c.name + "\n";
        // What the builder and the page writer log is theirs to test.
        for (const std::string& line : run.log.Messages()) {
            if (line.compare(0, 24, "TWriter::WriteReportPage") == 0 || line.compare(0, 19, "TWriter::Generator_") == 0) {
                dump += line + "\n";
            }
        }
        for (const std::string& entry : run.writer.CallsStartingWith("WriteIndexEntry(")) dump += entry + "\n";
        dump += std::to_string(run.Calls().size()) + " back-end calls\n";
    }
    unsetenv("TKR_BIOSPROVIDER");
    EXPECT_EQ(testing::ExpectedPage("dispatch.txt", dump), dump);
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
              transcript.find("WriteIndexEntry(\"pci_info\", \"PCI Information\", true)\nOpenPage(\"out/servproc_config\")\n"));
    EXPECT_EQ(std::string::npos, transcript.find("page Firmware\n"));
    EXPECT_NE(std::string::npos,
              transcript.find("WriteIndexEntry(\"tkr_log\", \"TKR Error Log\", false)\nEndReport()\n"));
}

}  // namespace
}  // namespace braigrion
