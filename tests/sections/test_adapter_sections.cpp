// The adapter sections as the back-end receives them: which blocks a page
// shows, the index flag of each, the raw-data switch in LUZ mode, and the
// delta and mode conditions of their generators.
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
using testing::TProp;
using testing::TRepoBuilder;
typedef std::vector<std::string> TLines;

// A writer over the collection the text describes, set up as a report run
// sets it up, in `mode`.
struct TRun {
    explicit TRun(const std::string& text, const std::string& mode = "default", const std::string& writerType = "html") {
        repo.Parse(text);
        run.reset(new TRawDataRun(repo.Namespace(), writerType, mode));
        builder = boost::make_shared<TReportParametersBuilder>(repo.Namespace(), mode, false);
    }
    // Writes the page through the page dispatch and returns the calls.
    TLines Page(const std::string& pageID) {
        run->writer.WriteReportPage(builder, pageID);
        return run->writer.Calls();
    }
    // The calls starting with `prefix`, the report's directory shown as "out".
    TLines Calls(const std::string& prefix) const {
        TLines calls;
        std::istringstream lines(run->Transcript());
        for (std::string line; std::getline(lines, line);)
            if (line.compare(0, prefix.size(), prefix) == 0) calls.push_back(line);
        return calls;
    }
    size_t Count(const std::string& prefix) const { return Calls(prefix).size(); }

    TRepoBuilder repo;
    std::unique_ptr<TRawDataRun> run;
    boost::shared_ptr<TReportParametersBuilder> builder;
};

TLines Titles(const TRun& run) {
    TLines titles;
    for (const std::string& call : run.Calls("WriteTableTitle(")) titles.push_back(call.substr(17, call.find('"', 17) - 17));
    return titles;
}

const char kFirmware[] = "MLNX_FirmwareIdentity InstanceID=\"fw0\" VersionString=\"2.42.5000\"\n";

// The driver table shows three driver names only, one title over all
// blocks; only the firmware identity makes the page count as holding data,
// and the page is left open.
TEST(Mellanox, ShowsListedDriversAndIndexesByFirmwareAlone) {
    struct TCase {
        const char* name;
        std::string repository;
        TLines titles;
        size_t blocks;
        bool hasData;
    } cases[] = {
        {"nothing", "ORVSG_ComputerSystem Name=\"srv\"", {}, 0, false},
        {"other driver only", "MLNX_SoftwareIdentity InstanceID=\"mlx4_en.ko\"", {}, 0, false},
        {"two drivers", "MLNX_SoftwareIdentity InstanceID=\"mlx4_core.ko\"\nMLNX_SoftwareIdentity InstanceID=\"mlx4_en.ko\"\n"
                        "MLNX_SoftwareIdentity InstanceID=\"MLNX_EN\"\nMLNX_IBPort DeviceID=\"ib0\"",
         {"Driver", "IB Port"}, 3, false},
        {"firmware", std::string(kFirmware) + "MLNX_PCIDevice DeviceID=\"0000:3b:00.0\"", {"Firmware Identity", "PCI Device"}, 2,
         true},
        {"firmware without its links", std::string(kFirmware) + "class MLNX_ElementFirmwareIdentity",
         {"Firmware Identity"}, 1, true},
    };
    for (const TCase& c : cases) {
        SCOPED_TRACE(c.name);
        TRun run(c.repository);
        run.Page(TKR_REPORT_DEFINITION::PAGE_MELLANOX);
        EXPECT_EQ(c.titles, Titles(run));
        EXPECT_EQ(c.blocks, run.Count("StartPropertyTable(\"40%\", \"50%\""));
        EXPECT_EQ(TLines{std::string("WriteIndexEntry(\"Mellanox\", \"Mellanox\", ") + (c.hasData ? "true" : "false") + ")"},
                  run.Calls("WriteIndexEntry("));
        EXPECT_EQ(TLines{"WriteReportTitle(\"Mellanox Adapter\", \"\", \"\")"}, run.Calls("WriteReportTitle("));
        EXPECT_EQ(0u, run.Count("ClosePage(") + run.Count("WritePageFooter("));
    }
}

// The rows of a block are the listed properties, in order, labelled by the
// class; a missing class is traced and left out.
TEST(Mellanox, WritesEachInstanceAsLabelAndValueRows) {
    TRun run(kFirmware);
    run.Page(TKR_REPORT_DEFINITION::PAGE_MELLANOX);
    const TLines headers = run.Calls("WriteHeaderCell(");
    ASSERT_EQ(11u, headers.size());
    EXPECT_EQ("WriteHeaderCell(<class MLNX_FirmwareIdentity>, {Caption width=\"0%\"})", headers.front());
    EXPECT_EQ("WriteHeaderCell(<class MLNX_FirmwareIdentity>, {VersionString width=\"0%\"})", headers.back());
    EXPECT_TRUE(run.run->log.Contains("FirmwareIdentity_Class exists"));
    EXPECT_EQ(5u, run.run->log.Count("::WriteMellanoxReport, ex.fStatusCode.fStatusCode="));
}

// The first table takes driver and firmware identities only; only firmware
// counts for the index.
TEST(Solarflare, FiltersSoftwareByInstanceIdAndIndexesByFirmware) {
    struct TCase {
        const char* ids;
        size_t softwareBlocks;
        bool hasData;
    } cases[] = {
        {"SF:Driver:sfc", 1, false},
        {"SF:Firmware:MC:0", 1, true},
        {"SF:BootROM:0", 0, false},
    };
    for (const TCase& c : cases) {
        SCOPED_TRACE(c.ids);
        TRun run(std::string("SF_SoftwareIdentity InstanceID=\"") + c.ids + "\"\nSF_NICCard InstanceID=\"card\"\n");
        run.Page(TKR_REPORT_DEFINITION::PAGE_SOLARFLARE);
        TLines expected;
        if (c.softwareBlocks) expected.push_back("Driver and Firmware");
        expected.push_back("NIC Card");
        EXPECT_EQ(expected, Titles(run));
        EXPECT_EQ(c.softwareBlocks + 1, run.Count("StartPropertyTable("));
        EXPECT_EQ(std::string("WriteIndexEntry(\"Solarflare\", \"Solarflare\", ") + (c.hasData ? "true" : "false") + ")",
                  run.Calls("WriteIndexEntry(").at(0));
        EXPECT_EQ(0u, run.Count("ClosePage("));
    }
}

// In LUZ mode with an HTML writer the vendor tool's page comes first and the
// title links to it; without raw data, in another mode or with another
// writer the page is the plain declared page.
TEST(EmulexAndQLogic, LinkTheirRawPageOnlyInLuzModeWithRawData) {
    const std::string firmware = "EMXCNA_FirmwareVersion Name=\"OCe14102 port 0\" Version=\"11.4.204.25\"\n"
                                 "ORVSG_QLogicFibreChannelBIOSElement Name=\"QLE2692 BIOS\" Version=\"3.63\"\n";
    const std::string raw = "EMXCNA_RawData InstanceID=\"listhba\" RawData=\"Port WWN: 10:00\"\n"
                            "ORVSG_QLogicFibreChannelRawData Command=\"qaucli -g\" RawResults=string[]:\"HBA 0\"\n"
                            "class ORVSG_QLogicIScsiRawData\n";
    struct TCase {
        const char* name;
        std::string repository;
        const char* mode;
        const char* writerType;
        bool linked;
    } cases[] = {
        {"default mode", firmware + raw, "default", "html", false},
        {"luz without raw data", firmware, "luz", "html", false},
        {"luz text report", firmware + raw, "luz", "text", false},
        {"luz with raw data", firmware + raw, "luz", "html", true},
    };
    for (const TCase& c : cases) {
        for (const char* vendor : {"Emulex", "QLogic"}) {
            SCOPED_TRACE(std::string(c.name) + " " + vendor);
            const bool emulex = std::string(vendor) == "Emulex";
            TRun run(c.repository, c.mode, c.writerType);
            run.Page(emulex ? TKR_REPORT_DEFINITION::PAGE_EMULEX : TKR_REPORT_DEFINITION::PAGE_QLOGIC);
            const std::string page = emulex ? "Emulex" : "Qlogic";
            const std::string rawLink = emulex ? "emulex_rawData" : "QLogic_RawData";
            const std::string title = "WriteReportTitle(\"" + page + "\", ";
            EXPECT_EQ(TLines{title + (c.linked ? "\"" + rawLink + "\", \" - [Show Rawdata Report]\")" : "\"\", \"\")")},
                      run.Calls(title));
            EXPECT_EQ(c.linked ? 1u : 0u, run.Count("OpenPage(\"out/" + rawLink + "\")"));
            const std::string name = std::string("TWriter::Write") + vendor + "Report -- ";
            if (std::string(c.mode) != "luz" || std::string(c.writerType) != "html") {
                EXPECT_TRUE(run.run->log.Contains(name + "Writing generic " + vendor + " report"));
            } else {
                EXPECT_TRUE(run.run->log.Contains(name + "Write" + vendor + "RawDataReport " +
                                                  (c.linked ? "Success" : "Faild")));
            }
        }
    }
}

const char kFusion[] =
    "FIO_PhysicalPackage Tag=\"fct0\" Name=\"ioDrive2\"\n"
    "FIO_SoftwareIdentity InstanceID=\"drv\" Name=\"iomemory-vsl\"\n"
    "FIO_TemperatureSensor DeviceID=\"t0\" Name=\"fct0 controller\"\n"
    "FIO_SSDStatistics InstanceID=\"s1\" DeviceID=\"fct1\" ReadOperations=uint64:11\n"
    "FIO_SSDStatistics InstanceID=\"s0\" DeviceID=\"fct0\" ReadOperations=uint64:10\n";

// Blocks in page order; without logical drives their block is left out; a
// drive's statistics are those that name it.
TEST(FusionIO, WritesItsBlocksAndPairsDrivesWithTheirStatistics) {
    TRun without(std::string(kFusion) + "class FIO_LogicalSSD");
    without.Page(TKR_REPORT_DEFINITION::PAGE_FUSIONIO);
    EXPECT_EQ((TLines{"Adapter Information", "Software Information", "Temperature Information"}), Titles(without));
    EXPECT_TRUE(without.run->log.Contains("TWriter::WriteFusionIOReport set logicReport to false"));
    EXPECT_EQ(TLines{"WriteIndexEntry(\"FusionIO\", \"FusionIO\", true)"}, without.Calls("WriteIndexEntry("));
    EXPECT_EQ(1u, without.Count("ClosePage("));

    TRun with(std::string(kFusion) + "FIO_LogicalSSD DeviceID=\"fct0\" Name=\"/dev/fioa\"\n");
    with.Page(TKR_REPORT_DEFINITION::PAGE_FUSIONIO);
    EXPECT_EQ("Logical Drive Information", Titles(with).at(2));
    EXPECT_EQ(1u, with.Count("WriteValueCell(<instance FIO_SSDStatistics.DeviceID=\"fct0\",InstanceID=\"s0\",ReadOperations=10>, "
                             "{ReadOperations"));
    EXPECT_EQ(0u, with.Count("WriteValueCell(<instance FIO_SSDStatistics.DeviceID=\"fct1\""));
    EXPECT_EQ(1u, with.Count("WriteValueCell(<instance FIO_LogicalSSD.DeviceID=\"fct0\",Name=\"/dev/fioa\">, "
                             "{DeviceID width=\"0%\" label=\"Name\"}"));
}

// The raw page's link stands in the title in LUZ mode only.
TEST(FusionIO, LinksItsRawPageInLuzMode) {
    const std::string raw = std::string(kFusion) + "ORV_FIORawData InstanceID=\"r0\" Command=\"fio-status -a\" CommandResult=\"ok\"\n";
    for (const char* mode : {"default", "luz"}) {
        SCOPED_TRACE(mode);
        TRun run(raw, mode);
        run.Page(TKR_REPORT_DEFINITION::PAGE_FUSIONIO);
        const bool luz = std::string(mode) == "luz";
        EXPECT_EQ(TLines{luz ? "WriteReportTitle(\"ORV High IOPS Adapter\", \" - [Show Rawdata Report]\", \"fio_rawData\")"
                             : "WriteReportTitle(\"ORV High IOPS Adapter\", \"\", \"\")"},
                  run.Calls("WriteReportTitle(\"ORV"));
        // The trace line of a raw page written reads "Failed", as support scripts expect.
        EXPECT_EQ(luz, run.run->log.Contains("TWriter::WriteFIOReport -- WriteFIORawDataReport Failed"));
    }
}

// A controller without ports counts none; the port names come from the
// element name, node before the first colon and port after it.
TEST(Brocade, CountsPortsAndSplitsTheWorldWideNames) {
    TRun lonely("BROCADE_PortController DeviceID=\"bfa0\" Model=\"Brocade-1860\"\nclass BROCADE_FCPort\n");
    lonely.Page(TKR_REPORT_DEFINITION::PAGE_BROCADE_ADAPTER);
    EXPECT_EQ((TLines{"Port Controller", "FC Port"}), Titles(lonely));
    EXPECT_EQ(TLines{"WriteTextCell({TotalPhysicalPort width=\"10%\" label=\"Total Physical Port\"}, \"0\", \"\")"},
              lonely.Calls("WriteTextCell("));
    EXPECT_EQ(TLines{"WriteIndexEntry(\"brocade\", \"Brocade\", true)"}, lonely.Calls("WriteIndexEntry("));

    TRun none("ORVSG_ComputerSystem Name=\"srv\"");
    none.Page(TKR_REPORT_DEFINITION::PAGE_BROCADE_ADAPTER);
    EXPECT_TRUE(none.run->log.Contains("Exiting TWriter::WriteBrocadeReport, No Class Instances Found ******"));
    EXPECT_EQ(TLines{}, Titles(none));
    EXPECT_EQ(1u, none.Count("ClosePage("));
    EXPECT_EQ(TLines{"WriteIndexEntry(\"brocade\", \"Brocade\", false)"}, none.Calls("WriteIndexEntry("));

    TRun card("Brocade_PhysicalPackage Tag=\"card\"");
    card.Page(TKR_REPORT_DEFINITION::PAGE_BROCADE_ADAPTER);
    EXPECT_TRUE(card.run->log.Contains("Exiting TWriter::WriteBrocadeReport. There is no Port Controller or FCPort."));
}

// The ports a controller reaches through the association: counted, and
// their node and port names cut from the element name at its first colon;
// a name without a colon is all node name.
TEST(Brocade, WritesTheControllersPorts) {
    TRun run("BROCADE_PortController DeviceID=\"bfa0\"\n"
             "BROCADE_FCPort DeviceID=\"bfa0/0\" ElementName=\"20000005331a2b3c:10000005331a2b3c\"\n"
             "BROCADE_FCPort DeviceID=\"bfa0/1\" ElementName=\"unnamed\"\n");
    for (const char* port : {"bfa0/0", "bfa0/1"}) {
        using NORVTKR20::TCIMReference;
        using NORVTKR20::TCIMValue;
        TProp controller;
        controller.fName = "Antecedent";
        controller.fValue = TCIMValue(TCIMReference(run.repo.Namespace(), "BROCADE_PortController.DeviceID=\"bfa0\"", {}));
        TProp fcPort;
        fcPort.fName = "Dependent";
        fcPort.fValue =
            TCIMValue(TCIMReference(run.repo.Namespace(), std::string("BROCADE_FCPort.DeviceID=\"") + port + "\"", {}));
        run.repo.Add("BROCADE_ControlledBy", {controller, fcPort});
    }
    run.Page(TKR_REPORT_DEFINITION::PAGE_BROCADE_ADAPTER);
    EXPECT_EQ((TLines{"WriteTextCell({TotalPhysicalPort width=\"10%\" label=\"Total Physical Port\"}, \"2\", \"\")",
                      "WriteTextCell({WWNN width=\"5%\"}, \"20000005331a2b3c\", \"\")",
                      "WriteTextCell({WWPN width=\"5%\"}, \"10000005331a2b3c\", \"\")",
                      "WriteTextCell({WWNN width=\"5%\"}, \"unnamed\", \"\")", "WriteTextCell({WWPN width=\"5%\"}, \"\", \"\")"}),
              run.Calls("WriteTextCell("));
}

// The adapter pages write nothing in delta mode.
TEST(AdapterGenerators, DoNothingInDeltaMode) {
    TRepoBuilder repo;
    repo.Parse(std::string(kFirmware) + kFusion);
    for (const std::string& page :
         {TKR_REPORT_DEFINITION::PAGE_MELLANOX, TKR_REPORT_DEFINITION::PAGE_SOLARFLARE, TKR_REPORT_DEFINITION::PAGE_FUSIONIO,
          TKR_REPORT_DEFINITION::PAGE_QLOGIC, TKR_REPORT_DEFINITION::PAGE_EMULEX, TKR_REPORT_DEFINITION::PAGE_BROADCOM,
          TKR_REPORT_DEFINITION::PAGE_BROCADE_ADAPTER}) {
        SCOPED_TRACE(page);
        TRawDataRun run(repo.WithProviderType(1));
        run.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(repo.WithProviderType(1), "default", false),
                                   page);
        EXPECT_EQ(TLines{}, run.writer.Calls());
    }
}

}  // namespace
}  // namespace braigrion
