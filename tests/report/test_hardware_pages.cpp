// The hardware pages of the sample collections' reports, each as the
// back-end receives it (compared with its expected transcript), and the
// tables each platform's hardware inventory holds.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/SamplePages.h"

namespace braigrion {
namespace {

using testing::TSampleReport;
typedef std::vector<std::string> TTitles;

const std::vector<std::string> kHardwareLinks = {"hw_info", "pci_info", "vmware_esxi"};

struct THardwareCase {
    const char* sample;
    TTitles inventoryTables;  // the titles of the hardware inventory's tables that have rows
    TTitles pciTables;
};

void PrintTo(const THardwareCase& c, std::ostream* os) {
    *os << c.sample;
}

class HardwarePages : public ::testing::TestWithParam<THardwareCase> {};

TEST_P(HardwarePages, AreWrittenAsExpected) {
    const THardwareCase& c = GetParam();
    TSampleReport report(c.sample);
    for (const std::string& link : kHardwareLinks) report.ExpectPageAsRecorded(link);
    EXPECT_EQ(c.inventoryTables, report.TableTitles("hw_info"));
    EXPECT_EQ(c.pciTables, report.TableTitles("pci_info"));
    // No sample machine boots a hypervisor from a USB key: the page stands
    // without a table.
    EXPECT_TRUE(report.Grids("vmware_esxi").empty());
}

const TTitles kPci = {"Devices", "Bridges", "Slots"};

// Data source 1.1 and later show memory from the SPD data; pre-boot data
// have no video controller; a headless server has no monitor; the optical
// drive of a Windows machine is a system device too.
INSTANTIATE_TEST_SUITE_P(
    Samples, HardwarePages,
    ::testing::Values(
        THardwareCase{"windows-server",
                      {"Processor/Core", "Disk Information", "Volumes/Mount Points", "Video Controller", "Monitor",
                       "System Card Information", "System Devices", "USB Hub", "USB Devices",
                       "Optical Device Capabilities", "QPI Ports", "Other Devices", "Memory"},
                      kPci},
        THardwareCase{"linux-teaming",
                      {"Processor/Core", "Disk Information", "Volumes/Mount Points", "Video Controller",
                       "System Card Information", "System Devices", "USB Hub", "USB Devices", "QPI Ports",
                       "Other Devices", "Memory"},
                      kPci},
        THardwareCase{"linux-server",
                      {"Processor/Core", "Disk Information", "Volumes/Mount Points", "Memory"},
                      {"Devices"}},
        THardwareCase{"preboot",
                      {"Processor/Core", "Disk Information", "Volumes/Mount Points", "Monitor",
                       "System Card Information", "System Devices", "USB Hub", "USB Devices",
                       "Optical Device Capabilities", "QPI Ports", "Other Devices", "Memory"},
                      kPci},
        THardwareCase{"multinode",
                      {"Processor/Core", "Disk Information", "Volumes/Mount Points", "Intel MIC Info",
                       "Video Controller", "System Card Information", "System Devices", "USB Hub", "USB Devices",
                       "Optical Device Capabilities", "QVA Ports", "QPI Ports", "Other Devices", "Memory"},
                      kPci}),
    [](const ::testing::TestParamInfo<THardwareCase>& info) {
        std::string name = info.param.sample;
        for (char& ch : name) {
            if (ch == '-') ch = '_';
        }
        return name;
    });

}  // namespace
}  // namespace braigrion
