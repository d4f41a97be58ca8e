// The storage pages inside whole reports: the sample server's pages in LUZ
// mode, and a collection whose storage classes hold data of the wrong
// shape, which must not cost the report any page.
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <map>
#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "report/ExpectedPage.h"
#include "repository/CIMXMLReader.h"
#include "sections/StorageFixture.h"

namespace braigrion {
namespace {

namespace fs = std::filesystem;
using testing::Link;
using testing::TRecordingWriter;
using testing::TRepoBuilder;

const std::set<std::string> kStorageLinks = {"Drive_Health", "lsi_mir", "lsiide", "pmc", "hc", "halcyonlogs"};

bool StartsWith(const std::string& text, const std::string& prefix) {
    return text.compare(0, prefix.size(), prefix) == 0;
}

// A whole report through a recording writer into a directory of its own.
class TReportRun {
public:
    TReportRun(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const std::string& mode) : writer("html") {
        const ::testing::TestInfo* test = ::testing::UnitTest::GetInstance()->current_test_info();
        fDir = fs::path(::testing::TempDir()) /
               ("braigrion_storage_" + std::string(test->name()) + "_" + std::to_string(getpid()));
        fs::remove_all(fDir);
        fs::create_directories(fDir);
        TWriter::TContext context;
        context["mode"] = NORVTKR20::TCIMValue(mode);
        TReport report(ns, context, fDir.string());
        report.Write(&writer, context);
    }
    ~TReportRun() { fs::remove_all(fDir); }

    // The pages by link, each from its OpenPage to its WriteIndexEntry, the
    // directory shown as "out"; raw-data pages, which have no index entry,
    // stand before the page that links to them.
    std::map<std::string, std::string> Pages() const {
        std::map<std::string, std::string> pages;
        std::string page;
        for (const std::string& call : writer.Calls()) {
            if (StartsWith(call, "EscapeText(") || StartsWith(call, "GetSeparatorText(")) continue;
            std::string line = call;
            for (size_t at = line.find(fDir.string()); at != std::string::npos; at = line.find(fDir.string()))
                line.replace(at, fDir.string().size(), "out");
            page += line + "\n";
            if (StartsWith(call, "WriteIndexEntry(\"")) {
                const std::string link = call.substr(17, call.find('"', 17) - 17);
                pages[link] = page.substr(std::min(page.find("OpenPage("), page.size()));
                page.clear();
            } else if (StartsWith(call, "WriteCategory(") || StartsWith(call, "EndCategory(")) {
                page.clear();
            }
        }
        return pages;
    }

    TRecordingWriter writer;

private:
    fs::path fDir;
};

boost::shared_ptr<NORVTKR20::ICIMNamespace> LoadSample(const std::string& sample) {
    std::vector<std::string> files;
    for (const auto& entry : fs::directory_iterator(std::string(BRAIGRION_SOURCE_DIR) + "/samples/" + sample)) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    return repository::LoadCollection(files).fNamespace;
}

// In LUZ mode the sample server's LSI and Halcyon pages link to their raw
// pages, the Halcyon logs page hands over the event logs and the drive
// health page shows the raw sense page. See storage/linux-server-luz/.
TEST(StorageReports, SampleServerInLuzMode) {
    TReportRun run(LoadSample("linux-server"), "luz");
    const std::map<std::string, std::string> pages = run.Pages();
    for (const std::string& link : kStorageLinks) {
        ASSERT_EQ(1u, pages.count(link)) << link;
        const std::string file = "storage/linux-server-luz/" + link + ".txt";
        EXPECT_EQ(testing::ExpectedPage(file, pages.at(link)), pages.at(link)) << file;
    }
}

// Storage classes with values of the wrong type, nulls where values belong
// and associations to instances that do not exist.
TRepoBuilder MisshapenStorage() {
    TRepoBuilder repo;
    repo.Parse(R"(
        class CIM_ComputerSystem
        class CIM_PhysicalPackage
        LSIESG_DiskDrive DeviceID=uint32:7 Name=null:string
        LSIESG_StorageVolume DeviceID="v0" Name=uint16:3 OperationalStatus="OK"
        LSIESG_DiskExtent DeviceID=null:string
        ORV_LSIRawData Command=null:string CommandResult=uint32:12
        LSIESG_ControllerFirmwareIdentity InstanceID="fw" VersionString=uint8[]:1,2
        LSIESG_ControllerBIOSIdentity InstanceID=null:string
        ORVSG_LSISCSIProtocolController DeviceID="c0" ControllerNum="zero" LSIType="three" CurrentOperation=uint32:5
        ORVSG_LSIDiskDrive DeviceID="d0" DeviceType="fourteen" Bus=null:uint32
        ORVSG_MegaLSISCSIProtocolController DeviceID="m0" ControllerNum=null:uint32
        ORVSG_MegaLSIFWPackageBuildFirmwareElement SoftwareElementID=uint32:1
        ORVSG_hcSCSIProtocolController DeviceID="hc0" ControllerNum=null:string ControllerType=uint32:8
        class ORVSG_hcLogicalDisk
        class ORVSG_hcDiskGroup
        ORVSG_LogRecord_RAIDMgrEvent Message=uint32:1 MessageTimestamp="yesterday"
        ORVSG_hcSCSIDeviceData ControllerNum="one" Channel=null:uint32
        ORVSG_LogRecord_HardEvent RecordID=null:string
        PMC_ControllerComputerSystem Name=null:string
        class PMC_ApplicationSoftwareIdentity
        ORVSG_LSIIDEProtocolController DeviceID="ide0" ControllerNum="x"
        OMC_ATADevice DeviceID=null:string
        ORVSG_TapeDriveSensePageData InstanceID="st0" cleanNow=uint32:1 timeToClean=null:string
        OMC_SCSISenseRawData InstanceID="sg0" rawData="not bytes"
        ORV_SSDWarrantyInfo SSDID=null:string
        ORV_PCIeSSDWrapDriveInfo Name=uint32:0
    )");
    for (const char* target : {"LSIESG_DiskDrive.DeviceID=\"gone\"", "ORVSG_LSIDiskDrive.DeviceID=\"gone\""}) {
        Link(repo, "ORVSG_LSIProtocolControllerForPhysicalDisk", "ORVSG_LSISCSIProtocolController.DeviceID=\"c0\"",
             target);
    }
    Link(repo, "ORVSG_hcProtocolControllerForUnit", "ORVSG_hcSCSIProtocolController.DeviceID=\"hc0\"",
         "ORVSG_hcLogicalDisk.DeviceID=\"gone\"");
    Link(repo, "ORVSG_hcStripeOrderForController", "ORVSG_hcSCSIProtocolController.DeviceID=\"hc0\"",
         "ORVSG_LogRecord_HardEvent.RecordID=\"gone\"");
    Link(repo, "OMC_IDESMARTElementStatisticalData", "OMC_ATADevice.DeviceID=\"gone\"",
         "OMC_IDESMARTAttrib.InstanceID=\"gone\"", "ManagedElement", "Stats");
    return repo;
}

std::vector<std::string> IndexEntries(const TRecordingWriter& writer) {
    std::vector<std::string> links;
    for (const std::string& call : writer.CallsStartingWith("WriteIndexEntry(\""))
        links.push_back(call.substr(17, call.find('"', 17) - 17));
    return links;
}

// Every page of a report over an empty collection is still there, in the
// same order, in both modes; the storage pages among them.
TEST(StorageReports, MisshapenStorageClassesCostNoPage) {
    for (const char* mode : {"default", "luz"}) {
        TRepoBuilder empty;
        TReportRun reference(empty.Namespace(), mode);
        TRepoBuilder misshapen = MisshapenStorage();
        TReportRun run(misshapen.Namespace(), mode);
        const std::vector<std::string> links = IndexEntries(run.writer);
        EXPECT_EQ(IndexEntries(reference.writer), links) << mode;
        for (const std::string& link : kStorageLinks)
            EXPECT_NE(links.end(), std::find(links.begin(), links.end(), link)) << mode << " " << link;
        EXPECT_FALSE(run.writer.CallsStartingWith("EndReport(").empty()) << mode;
    }
}

}  // namespace
}  // namespace braigrion
