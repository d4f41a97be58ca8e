// The repairs made to the collected data before a report: what each one
// changes in the repository, and that none of them stops on missing data.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TReport.h"
#include "repository/RepoFixture.h"
#include "support/LogCapture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::TLogCapture;
using testing::TRepoBuilder;

std::vector<std::string> Texts(TRepoBuilder& repo, const std::string& cls, const std::string& property) {
    std::vector<std::string> texts;
    for (const auto& instance : testrepo::All(*repo.Namespace(), cls)) {
        try {
            texts.push_back(instance->GetProperty(property, {})->GetValue().ToString(10));
        } catch (const NORVTKR20::TTKRException&) {
            texts.push_back("(none)");
        }
    }
    return texts;
}

TEST(Repairs, ProductNameLosesOneTrailingHyphen) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_ComputerSystem ProductName="Server -[1234AC1]-"
        ORVSG_ComputerSystem ProductName="Server --"
        ORVSG_ComputerSystem ProductName="-"
        ORVSG_ComputerSystem ProductName="Server"
        ORVSG_ComputerSystem ProductName=""
        ORVSG_ComputerSystem Name="no product name"
    )");
    TReport(repo.Namespace(), {}, "out").fixProductNameofComputerSystem();
    EXPECT_EQ((std::vector<std::string>{"Server -[1234AC1]", "Server -", "", "Server", "", "(none)"}),
              Texts(repo, "ORVSG_ComputerSystem", "ProductName"));
}

TEST(Repairs, RedundantMonitorsAreRemoved) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_DesktopMonitor Name="ORV GPA2 remote video"
        ORVSG_DesktopMonitor Name="PHL 243V7"
        ORVSG_DesktopMonitor Caption="no name"
    )");
    TReport(repo.Namespace(), {}, "out").fixRedundantMonitorInfo({});
    EXPECT_EQ((std::vector<std::string>{"PHL 243V7", "(none)"}), Texts(repo, "ORVSG_DesktopMonitor", "Name"));

    TRepoBuilder empty;
    TReport report(empty.Namespace(), {}, "out");
    TLogCapture log;
    report.fixRedundantMonitorInfo({});
    EXPECT_EQ((std::vector<std::string>{"TReport::fixRedundantMonitorInfo -- Entering",
                                        "TReport::fixRedundantMonitorInfo -- Exiting"}),
              log.Messages());
}

TEST(Repairs, MemoryGetsTheMakersOfItsModules) {
    struct TCase {
        const char* modules;
        const char* expected;
    } cases[] = {
        {"ORVSG_SPDData Manufacturer=\"Samsung\"\nORVSG_SPDData Manufacturer=\"Samsung\"", "Samsung"},
        {"ORVSG_SPDData Manufacturer=\"Samsung\"\nORVSG_SPDData Manufacturer=\"Micron\"", "Samsung   Micron"},
        {"ORVSG_SPDData Manufacturer=\"Samsung\"\nORVSG_SPDData Name=\"no maker\"\nORVSG_SPDData Manufacturer=\"Samsung\"",
         "Samsung"},
    };
    for (const auto& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.modules);
        repo.Parse(R"(
            ORVSG_LogicalDevice DeviceClass="memory" Manufacturer=""
            ORVSG_LogicalDevice DeviceClass="disk" Manufacturer="Seagate"
        )");
        TReport(repo.Namespace(), {}, "out").AddManufacturerForMem();
        EXPECT_EQ((std::vector<std::string>{c.expected, "Seagate"}),
                  Texts(repo, "ORVSG_LogicalDevice", "Manufacturer"))
            << c.modules;
    }
}

// The type's hexadecimal digits read as a decimal number, as the Emulex
// page has always printed it.
TEST(Repairs, EmulexTypeIsReadBackFromItsHexDigits) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ELXUCNA_KoSIDData KoSType=16
        ELXUCNA_KoSIDData KoSType=32
        ELXUCNA_KoSIDData KoSType=31
        ELXUCNA_KoSIDData KoSType=9
        ELXUCNA_KoSIDData KoSType="text"
    )");
    TLogCapture log;
    TReport(repo.Namespace(), {}, "out").ConvertEmulexKoSTypeIDToHex();
    EXPECT_EQ((std::vector<std::string>{"10", "20", "1", "9", "text"}), Texts(repo, "ELXUCNA_KoSIDData", "KoSType"));
    EXPECT_EQ(1u, log.Count("TReport::ConvertEmulexKoSTypeIDToHex -- TTKRException caught during convertion"));
}

const char kPatched[] =
    "GPA: Hard drive (possibly RAID drive) removal detected on bay 5. Check Halcyon or DLM Event or IPMI Event  for "
    "more infomation.";
const char kCreated[] =
    "Hard drive (possibly RAID drive) removal detected. Check Halcyon or DLM Event or IPMI Event  for more infomation.";

TEST(Repairs, DriveRemovalHighlightIsRebuiltOrCreated) {
    struct TCase {
        const char* name;
        std::string repository;
        std::vector<std::string> expected;
        int runs;  // a repair run again over its own result adds nothing
    } cases[] = {
        {"message patched",
         "ORVSG_HeavyHittersLogRecord Message=\"GPA: Hard drive removal detected on bay 5.\"\n"
         "ORVSG_HeavyHittersLogRecord Message=\"GPA: Hard drive removal detected on bay 6.\"\n"
         "ORVSG_DLMLog Message=\"Hard drive 5 removal detected.\"",
         // only the first, and no record is created beside it
         {kPatched, "GPA: Hard drive removal detected on bay 6."},
         1},
        {"already patched", std::string("ORVSG_HeavyHittersLogRecord Message=\"") + kPatched +
                                "\"\nORVSG_DLMLog Message=\"Hard drive removal detected\"",
         {kPatched},
         2},
        {"created from the DLM log",
         "ORVSG_HeavyHittersLogRecord Message=\"Fan 2 failed\"\nORVSG_DLMLog Message=\"Hard drive 5 removal detected.\"",
         {"Fan 2 failed", kCreated},
         2},
        {"created from the IPMI log",
         "class ORVSG_HeavyHittersLogRecord\n"
         "ORVSG_IPMILogRecord Message=\"Disk or disk bay: Drive 5 - Deassertion: Drive Slot Present\"",
         {kCreated},
         2},
        {"no evidence",
         "ORVSG_HeavyHittersLogRecord Message=\"Fan 2 failed\"\n"
         "ORVSG_IPMILogRecord Message=\"Disk or disk bay: Drive 5 - In Critical Array\"",
         {"Fan 2 failed"},
         1},
        {"no highlight class", "ORVSG_DLMLog Message=\"Hard drive 5 removal detected.\"", {}, 1},
    };
    for (const auto& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TReport report(repo.Namespace(), {}, "out");
        for (int run = 0; run < c.runs; ++run) report.fixCriticalDetailforRaidDiskRemoval();
        std::vector<std::string> messages;
        try {
            messages = Texts(repo, "ORVSG_HeavyHittersLogRecord", "Message");
        } catch (const NORVTKR20::TTKRException&) {
        }
        EXPECT_EQ(c.expected, messages) << c.name;
    }
}

// Not part of a run: fills what a module's SPD left empty from the FRU of
// the same node and slot.
TEST(Repairs, MemoryInfoIsFilledFromTheMatchingFRU) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_SPDData MemoryType="DDR5" Tag="Node1/DIMM3" Manufacturer="" PartNumber="M321R8GA0BB0" SerialNumber=""
        ORVSG_SPDData MemoryType="DDR5" Tag="Node2/DIMM3" Manufacturer="Samsung" PartNumber="" SerialNumber=""
        ORVSG_SPDData Tag="Node1/DIMM4" Manufacturer=""
        ORVSG_IPMIFRU Name="Node 2 DIMM 3" Vendor="Hynix" PartNumber="HMCG94AEBRA" SerialNumber="S2"
        ORVSG_IPMIFRU Name="Node 1 DIMM 3" Manufacturer="Micron" PartNumber="other" SerialNumber="S1"
        ORVSG_IPMIFRU Name="Node 1 DIMM 4" Manufacturer="Kingston"
    )");
    TReport(repo.Namespace(), {}, "out").fixMemInfo();
    EXPECT_EQ((std::vector<std::string>{"Micron", "Samsung", ""}), Texts(repo, "ORVSG_SPDData", "Manufacturer"));
    EXPECT_EQ((std::vector<std::string>{"M321R8GA0BB0", "HMCG94AEBRA", "(none)"}),
              Texts(repo, "ORVSG_SPDData", "PartNumber"));
    EXPECT_EQ((std::vector<std::string>{"S1", "S2", "(none)"}), Texts(repo, "ORVSG_SPDData", "SerialNumber"));
}

TEST(Repairs, NoneStopsOnAnEmptyRepository) {
    TRepoBuilder repo;
    TReport report(repo.Namespace(), {}, "out");
    EXPECT_NO_THROW({
        report.fixCriticalDetailforRaidDiskRemoval();
        report.fixProductNameofComputerSystem();
        report.fixRedundantMonitorInfo({});
        report.AddManufacturerForMem();
        report.ConvertEmulexKoSTypeIDToHex();
        report.fixMemInfo();
    });
}

}  // namespace
}  // namespace braigrion
