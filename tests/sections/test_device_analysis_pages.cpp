// The merged device page, the service mode's tool output and chipset
// register pages, and the Melody device analysis page as the back-end
// receives them.
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
#include "report/RawDataRun.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TRawDataRun;
using testing::TRepoBuilder;
typedef std::vector<std::string> TLines;

struct TRun {
    explicit TRun(const std::string& text, const std::string& mode = "default") {
        repo.Parse(text);
        run.reset(new TRawDataRun(repo.Namespace(), "html", mode));
        builder = boost::make_shared<TReportParametersBuilder>(repo.Namespace(), mode, false);
    }
    void Page(const std::string& pageID) { run->writer.WriteReportPage(builder, pageID); }
    // The calls starting with `prefix`, the report's directory shown as "out".
    TLines Calls(const std::string& prefix) const {
        TLines calls;
        std::istringstream lines(run->Transcript());
        for (std::string line; std::getline(lines, line);)
            if (line.compare(0, prefix.size(), prefix) == 0) calls.push_back(line);
        return calls;
    }

    // How many calls start with `prefix` and hold `part`.
    size_t Count(const std::string& prefix, const std::string& part) const {
        size_t n = 0;
        for (const std::string& call : Calls(prefix)) n += call.find(part) != std::string::npos;
        return n;
    }

    TRepoBuilder repo;
    std::unique_ptr<TRawDataRun> run;
    boost::shared_ptr<TReportParametersBuilder> builder;
};

const char kWindows[] = "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:74\n";
const char kRedHat[] = "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\" OSType=uint16:36\n";
const char kPreboot[] = "ORVSG_CollectionInfo Build=\"3.0.4-21.preboot\" MajorVersion=\"1\" MinorVersion=\"2\"\n";
const char kDevices[] =
    "ORVSG_LogicalDevice DeviceID=\"d1\" DeviceClass=\"storage\" ElementName=\"NVMe disk\"\n"
    "ORVSG_LogicalDevice DeviceID=\"d2\" DeviceClass=\"unknown\" ElementName=\"Coprocessor\"\n"
    "ORVSG_LogicalDevice DeviceID=\"d3\" DeviceClass=\"System\" ElementName=\"IPMI device\"\n"
    "ORVSG_LogicalDevice DeviceID=\"d4\" DeviceClass=\"Network interface\" ElementName=\"eth0\"\n"
    "ORVSG_LogicalDevice DeviceID=\"d5\" DeviceClass=null:string ElementName=\"Ghost\"\n"
    "ORVSG_LogicalDevice DeviceID=\"d6\" DeviceClass=\"\" ElementName=\"Nameless\"\n"
    "ORVSG_LogicalDevice DeviceID=\"d7\" DeviceClass=\"storage\" ElementName=\"Boot disk\"\n";

// Group titles: the class with a capital first letter, "Unknown" shown as
// "Uncategorized", an empty class an empty title, a null class no row at
// all; pre-boot data leave out network interfaces and system devices.
TEST(MergedDevices, GroupsDevicesByClass) {
    struct TCase {
        const char* name;
        std::string repository;
        TLines summaries;
        size_t columns;
    } cases[] = {
        {"full", std::string(kWindows) + kDevices,
         {"\"\"", "\"Network interface\"", "\"Storage\"", "\"System\"", "\"Uncategorized\""}, 7},
        {"pre-boot", std::string(kPreboot) + kDevices, {"\"\"", "\"Storage\"", "\"Uncategorized\""}, 2},
    };
    for (const TCase& c : cases) {
        SCOPED_TRACE(c.name);
        TRun run(c.repository);
        run.Page(TKR_REPORT_DEFINITION::PAGE_MERGED_DEVICE);
        TLines summaries;
        for (const std::string& call : run.Calls("StartColumnTable(\"100%\", "))
            summaries.push_back(call.substr(25, call.rfind(',') - 25));
        EXPECT_EQ(c.summaries, summaries);
        EXPECT_EQ(c.columns * summaries.size(), run.Calls("WriteHeaderCell(").size());
        EXPECT_EQ(0u, run.Count("WriteValueCell(", "DeviceID=\"d5\""));
        // The storage group in name order.
        const TLines names = run.Calls("WriteValueCell(<instance ORVSG_LogicalDevice.DeviceClass=\"storage\"");
        ASSERT_LE(2u, names.size());
        EXPECT_NE(std::string::npos, names.front().find("Boot disk"));
        EXPECT_NE(std::string::npos, names.back().find("NVMe disk"));
        EXPECT_EQ(TLines{"WriteIndexEntry(\"mergedDevices\", \"MergedDevice\", true)"}, run.Calls("WriteIndexEntry("));
        EXPECT_EQ(1u, run.Calls("ClosePage(").size());
    }
}

// The full form's module columns come from the kernel module that drives
// the device; a location without a board or slot is the device's own.
TEST(MergedDevices, FullFormReadsModuleThroughItsAssociation) {
    TRun run(std::string(kWindows) + "ORVSG_LogicalDevice DeviceID=\"d1\" DeviceClass=\"storage\" ElementName=\"disk\"\n");
    run.Page(TKR_REPORT_DEFINITION::PAGE_MERGED_DEVICE);
    EXPECT_EQ((TLines{"WriteHeaderCell(<class ORVSG_LogicalDevice>, {ElementName width=\"25%\"})",
                      "WriteHeaderCell(<class ORVSG_LogicalDevice>, {Location width=\"20%\"})",
                      "WriteHeaderCell(<class ORVSG_LogicalDevice>, {OperationalStatus width=\"5%\"})",
                      "WriteHeaderCell(<class ORVSG_LogicalDevice>, {Name width=\"5%\" assoc=\"ORVSG_DeviceSoftware\" "
                      "target=\"ORVSG_LinuxKernelModule\" label=\"Module\"})",
                      "WriteHeaderCell(<class ORVSG_LogicalDevice>, {SoftwareElementState width=\"5%\" "
                      "assoc=\"ORVSG_DeviceSoftware\" target=\"ORVSG_LinuxKernelModule\" label=\"State\"})",
                      "WriteHeaderCell(<class ORVSG_LogicalDevice>, {Manufacturer width=\"20%\" label=\"Vendor Info\"})",
                      "WriteHeaderCell(<class ORVSG_LogicalDevice>, {Version width=\"20%\" assoc=\"ORVSG_DeviceSoftware\" "
                      "target=\"ORVSG_LinuxKernelModule\"})"}),
              run.Calls("WriteHeaderCell("));
    EXPECT_EQ(1u, run.Count("WriteValueCell(<instance ORVSG_LogicalDevice.", ">, {Location width=\"20%\"}"));
}

// No page on Red Hat, for the report and for the inventory's analysis page;
// an empty page indexed without data when there are no devices.
TEST(MergedDevices, RedHatAndMissingDevices) {
    for (const std::string& page : {TKR_REPORT_DEFINITION::PAGE_MERGED_DEVICE, TKR_REPORT_DEFINITION::PAGE_INVENTORY_ANALYSIS}) {
        TRun redHat(std::string(kRedHat) + kDevices);
        redHat.Page(page);
        EXPECT_EQ(TLines{}, redHat.run->writer.Calls()) << page;
        EXPECT_TRUE(redHat.run->log.Contains(
            "TWriter::Generator_MergedDevice -- Do not write Merged Devices under RedHat platform"));
    }
    TRun empty(kWindows);
    empty.Page(TKR_REPORT_DEFINITION::PAGE_MERGED_DEVICE);
    EXPECT_EQ(TLines{"WriteIndexEntry(\"mergedDevices\", \"MergedDevice\", false)"}, empty.Calls("WriteIndexEntry("));
    EXPECT_EQ(TLines{}, empty.Calls("WriteTableTitle("));
}

// A namespace that fails with `status` when asked for one class.
class TFailingNamespace : public NORVTKR20::ICIMNamespace {
public:
    TFailingNamespace(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, std::string failing, int status)
        : fNamespace(ns), fFailing(failing), fStatus(status) {}
    boost::shared_ptr<NORVTKR20::INamespaceProvider> GetNamespaceProvider(const NORVTKR20::TCIMContext& c) override {
        return fNamespace->GetNamespaceProvider(c);
    }
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(const std::string& name, const NORVTKR20::TCIMContext& c) override {
        if (name == fFailing) throw NORVTKR20::TTKRException(fStatus);
        return fNamespace->GetClass(name, c);
    }
    boost::shared_ptr<NORVTKR20::ICIMInstance> GetInstance(const NORVTKR20::TCIMReference& path,
                                                           const NORVTKR20::TCIMContext& c) override {
        return fNamespace->GetInstance(path, c);
    }

private:
    boost::shared_ptr<NORVTKR20::ICIMNamespace> fNamespace;
    std::string fFailing;
    int fStatus;
};

// A repository failure other than an absent class is logged from the
// character at the position of its status on (nothing when the status lies
// beyond the text) and abandons the page.
TEST(MergedDevices, LogsAndPassesOnOtherFailures) {
    struct TCase {
        const char* cls;
        int status;
        const char* line;
    } cases[] = {
        {"ORVSG_LogicalDevice", 27, "dDevicesReport, ex.fStatusCode.fStatusCode="},
        {"ORVSG_PCIBridge", 8, "TWriter::WriteMergedDevicesReport(3), ex.fStatusCode.fStatusCode="},
        {"ORVSG_PCIDevice", 500, ""},
    };
    for (const TCase& c : cases) {
        SCOPED_TRACE(c.cls);
        TRepoBuilder repo;
        repo.Parse(std::string(kWindows) + kDevices);
        auto ns = boost::make_shared<TFailingNamespace>(repo.Namespace(), c.cls, c.status);
        TRawDataRun run(ns);
        run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(ns, "default", false),
                                   TKR_REPORT_DEFINITION::PAGE_MERGED_DEVICE);
        EXPECT_TRUE(run.log.Contains(c.line));
        EXPECT_EQ(TLines{}, run.writer.CallsStartingWith("WriteIndexEntry("));
        EXPECT_EQ(TLines{}, run.writer.CallsStartingWith("WriteTableTitle("));
    }
}

// Each command with its output in a grid of one column; an output the
// instance lacks shows "N/A"; a class without instances only an index line.
// The pages exist in LUZ mode only.
TEST(ToolOutput, ShowsEachCommandWithItsOutput) {
    const std::string repository = "ORVSG_CFTSetting InstanceID=\"c\" CftRawShowAll=\"A=1\" CftRawShowValues=\"A=<1>,0\"\n"
                                   "class ORVSG_NVSMILog\n";
    TRun luz(repository, "luz");
    luz.Page(TKR_REPORT_DEFINITION::PAGE_CFT_SETTING);
    EXPECT_EQ((TLines{"WriteTableGrid(grid 2x1 width=100 widths=[100] | #\"cft show all\" | #\"A=1\")",
                      "WriteTableGrid(grid 2x1 width=100 widths=[100] | #\"cft showdefault all\" | #\"N/A\")",
                      "WriteTableGrid(grid 2x1 width=100 widths=[100] | #\"cft showvalues\" | #\"A=&lt;1&gt;,0\")"}),
              luz.Calls("WriteTableGrid("));
    EXPECT_EQ(3u, luz.Calls("WriteTableBreak(").size());
    EXPECT_EQ(TLines{"WriteIndexEntry(\"cft_setting\", \"CFT Settings\", true)"}, luz.Calls("WriteIndexEntry("));
    EXPECT_TRUE(luz.run->log.Contains("Entering TWriter::WriteCFTSettingData"));

    luz.run->writer.Clear();
    luz.Page(TKR_REPORT_DEFINITION::PAGE_NVSMI_LOG);
    luz.Page(TKR_REPORT_DEFINITION::PAGE_AMDATICONFIG_LOG);
    EXPECT_EQ((TLines{"WriteIndexEntry(\"nvsmilog\", \"NVIDIA GPU Info\", false)",
                      "WriteIndexEntry(\"amdaticonfiglog\", \"AMD GPU Info\", false)"}),
              luz.run->writer.Calls());

    TRun plain(repository);
    for (const std::string& page : {TKR_REPORT_DEFINITION::PAGE_CFT_SETTING, TKR_REPORT_DEFINITION::PAGE_NVSMI_LOG,
                                    TKR_REPORT_DEFINITION::PAGE_AMDATICONFIG_LOG,
                                    TKR_REPORT_DEFINITION::PAGE_QVA_CHIPSET_REGISTER})
        plain.Page(page);
    EXPECT_EQ(TLines{}, plain.run->writer.Calls());
}

// One table per register block, blocks and registers in natural order; the
// other properties of a block are not registers.
TEST(ChipsetRegisters, WritesOneTablePerBlockInNaturalOrder) {
    TRun run("ORVSG_QVAChipsetErrorData InstanceID=\"b10\" ElementName=\"Link 10\" RegisterERRCNT10=\"0x0\" "
             "RegisterERRCNT2=\"0x2\" Node=uint16:0 RegisterFERR=\"0x4\"\n"
             "ORVSG_QVAChipsetErrorData InstanceID=\"b2\" ElementName=\"Link 2\" RegisterERRSTS=uint32:260\n"
             "ORVSG_QVAChipsetErrorData InstanceID=\"empty\" ElementName=\"Link 1\" Node=uint16:1\n",
             "luz");
    run.Page(TKR_REPORT_DEFINITION::PAGE_QVA_CHIPSET_REGISTER);
    EXPECT_EQ((TLines{"WriteTableTitle(\"Link 2\", false, false)", "WriteTableTitle(\"Link 10\", false, false)"}),
              run.Calls("WriteTableTitle("));
    EXPECT_EQ((TLines{"WriteDeclarationHeader(<decl RegisterERRSTS>)", "WriteDeclarationHeader(<decl RegisterERRCNT2>)",
                      "WriteDeclarationHeader(<decl RegisterERRCNT10>)", "WriteDeclarationHeader(<decl RegisterFERR>)"}),
              run.Calls("WriteDeclarationHeader("));
    EXPECT_EQ(4u, run.Calls("WriteRegisterValue(").size());
    EXPECT_EQ(TLines{"OpenPage(\"out/qva_reg\")"}, run.Calls("OpenPage("));
    EXPECT_EQ(TLines{"WriteReportTitle(\"QVA Chipset Registers\", \"\", \"\")"}, run.Calls("WriteReportTitle("));
    EXPECT_EQ(TLines{"WriteIndexEntry(\"qva_reg\", \"QVAChipsetRegister\", true)"}, run.Calls("WriteIndexEntry("));

    TRun none("class ORVSG_QVAChipsetErrorData", "luz");
    none.Page(TKR_REPORT_DEFINITION::PAGE_QVA_CHIPSET_REGISTER);
    EXPECT_EQ(TLines{"WriteIndexEntry(\"qva_reg\", \"QVAChipsetRegister\", false)"}, none.Calls("WriteIndexEntry("));
}

// A recording writer whose second path, where the heading file is looked
// for, the test chooses.
class TMelodyWriter : public testing::TEscapingWriter {
public:
    TMelodyWriter() : testing::TEscapingWriter("html") {}
    void SetReportPath(const std::string& path) { fReportPath = path; }
};

// Highest score first; the heading file's lines reach the back-end before
// the page opens, and a missing file gives an empty heading.
TEST(Melody, SortsByScoreAndReadsTheHeadingFile) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_MelodyDevices InstanceID=\"a\" MelodyScore=\"45\" MelodyValue=\"24.21\" "
               "MelodyCommonFrequencies=uint32:71\n"
               "ORVSG_MelodyDevices InstanceID=\"b\" MelodyScore=\"97\" MelodyValue=\"8.08\"\n");
    const std::filesystem::path dir =
        std::filesystem::path(::testing::TempDir()) / ("braigrion_melody_" + std::to_string(getpid()));
    for (bool withFile : {false, true}) {
        SCOPED_TRACE(withFile ? "heading file" : "no heading file");
        std::filesystem::remove_all(dir);
        std::filesystem::create_directories(dir / "data");
        if (withFile) std::ofstream(dir / "data" / "melodydeviceheader.txt") << "Unusual devices.\r\nScores of 0 to 100.\n";
        TMelodyWriter writer;
        auto builder = boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "default", false);
        writer.BaseInitialize(repo.Namespace(), {}, builder);
        writer.Initialize(repo.Namespace(), {}, "out");
        writer.SetReportPath(dir.string());
        writer.Clear();
        writer.WriteReportPage(builder, TKR_REPORT_DEFINITION::PAGE_MELODY_DEVICE);
        const TLines calls = writer.Calls();
        ASSERT_LE(2u, calls.size());
        EXPECT_EQ(withFile ? "WriteMelodyPrologue(\"Unusual devices.\\nScores of 0 to 100.\")" : "WriteMelodyPrologue(\"\")",
                  calls[0]);
        EXPECT_EQ("OpenPage(\"out/melodydevices\")", calls[1]);
        const TLines rows = writer.CallsStartingWith("WriteMelodyDeviceRow(");
        ASSERT_EQ(2u, rows.size());
        EXPECT_NE(std::string::npos, rows[0].find("InstanceID=\"b\""));
        EXPECT_NE(std::string::npos, rows[0].find(">, \"97\", "));
        EXPECT_NE(std::string::npos, rows[1].find("\"24.21\", \"\", \"\", 71)"));
        EXPECT_EQ(8u, writer.CallsStartingWith("WriteHeaderCell(<class ORVSG_MelodyDevices>").size());
        EXPECT_EQ(TLines{"WriteIndexEntry(\"melodydevices\", \"MelodyDeviceAnalysis\", true)"},
                  writer.CallsStartingWith("WriteIndexEntry("));
    }
    std::filesystem::remove_all(dir);
}

}  // namespace
}  // namespace braigrion
