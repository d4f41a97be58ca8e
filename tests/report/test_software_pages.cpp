// The software and network pages of the sample collections' reports: which
// pages each platform gets, each page as the back-end receives it (compared
// with its expected transcript), and the system overview's tables by
// platform.
#include <algorithm>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/SamplePages.h"

namespace braigrion {
namespace {

using testing::TSampleReport;
typedef std::vector<std::string> TLinks;

// The links of the software category's pages and of the patch page, in the
// order of the report.
const TLinks kSoftwareLinks = {"system_overview", "installedapps", "win_components", "installedfixes",
                               "devicedriver",    "systemservice", "installed_packages", "kernelmodules",
                               "net",             "resource",      "processes",          "os_config",
                               "linux_config",    "pb"};

const TLinks kLinuxPages = {"system_overview", "installedapps", "installed_packages", "kernelmodules", "net",
                            "resource",        "processes",     "os_config",          "linux_config",  "pb"};

struct TSoftwareCase {
    const char* sample;
    TLinks pages;           // the software pages it gets, in order
    TLinks overviewTables;  // the titles of the overview's tables that have rows
};

void PrintTo(const TSoftwareCase& c, std::ostream* os) {
    *os << c.sample;
}

class SoftwarePages : public ::testing::TestWithParam<TSoftwareCase> {};

// The pages of `links` that the report wrote, in the order written.
TLinks Written(const TSampleReport& report, const TLinks& links) {
    TLinks written;
    for (const std::string& link : report.Links()) {
        for (const std::string& candidate : links) {
            if (link == candidate) written.push_back(link);
        }
    }
    return written;
}

TEST_P(SoftwarePages, AreWrittenAsExpected) {
    const TSoftwareCase& c = GetParam();
    TSampleReport report(c.sample);
    ASSERT_EQ(c.pages, Written(report, kSoftwareLinks));
    for (const std::string& link : c.pages) report.ExpectPageAsRecorded(link);
    EXPECT_EQ(c.overviewTables, report.TableTitles("system_overview"));
}

// Windows gets its components, fixes, drivers and services; Linux its
// packages, modules and configuration files. Pre-boot data have no
// operating system pages but the configuration files. Data source 1.3 adds
// the time zone and the current user to the overview; a multi-node system
// has its nodes in a table of their own.
INSTANTIATE_TEST_SUITE_P(
    Samples, SoftwarePages,
    ::testing::Values(
        TSoftwareCase{"windows-server",
                      {"system_overview", "installedapps", "win_components", "installedfixes", "devicedriver",
                       "systemservice", "net", "resource", "processes", "os_config", "pb"},
                      {"Computer System", "Operating System", "TimeZone", "Current User", "Report Highlights",
                       "Data Source"}},
        TSoftwareCase{"linux-teaming", kLinuxPages,
                      {"Computer System", "Operating System", "TimeZone", "Current User", "Report Highlights",
                       "Data Source"}},
        // No account is linked to the system: the current user shows "N/A".
        TSoftwareCase{"linux-server", kLinuxPages,
                      {"Computer System", "Operating System", "TimeZone", "Current User", "Report Highlights",
                       "Data Source"}},
        TSoftwareCase{"preboot", {"system_overview", "net", "linux_config", "pb"},
                      {"Computer System", "Report Highlights", "Data Source"}},
        TSoftwareCase{"multinode", kLinuxPages,
                      {"Computer System", "Computer System Nodes", "Operating System", "Report Highlights",
                       "Data Source"}}),
    [](const ::testing::TestParamInfo<TSoftwareCase>& info) {
        std::string name = info.param.sample;
        for (char& ch : name) {
            if (ch == '-') ch = '_';
        }
        return name;
    });

// On a multi-node system the serial number and the name belong to each
// node: the computer system's table leaves them out, and the nodes' table
// holds them, one table per node.
TEST(SystemOverview, MultiNodeMovesSerialNumberAndNameIntoTheNodesTable) {
    const TLinks single = {"Manufacturer", "Model", "Product Name", "Serial Number", "System Name"};
    EXPECT_EQ(single, TSampleReport("linux-teaming").Grid("system_overview", "Computer System").RowLabels());

    TSampleReport multi("multinode");
    EXPECT_EQ((TLinks{"Manufacturer", "Model", "Product Name"}),
              multi.Grid("system_overview", "Computer System").RowLabels());
    std::vector<std::vector<std::string>> nodes;
    for (const testing::TRecordedGrid& grid : multi.Grids("system_overview")) {
        if (grid.title != "Computer System Nodes") continue;
        EXPECT_EQ((TLinks{"Node ID", "Node Serial Number", "Node Name"}), grid.RowLabels());
        for (const std::vector<std::string>& row : grid.rows) nodes.push_back(row);
    }
    ASSERT_EQ(6u, nodes.size()) << "two nodes, three rows each";
    EXPECT_EQ((TLinks{"Node Serial Number", "NVS5X1N0D6-N1"}), nodes[1]);
    EXPECT_EQ((TLinks{"Node Name", "Node 2"}), nodes[5]);
}

// Pre-boot data come from no operating system: the overview has neither
// its table nor the time zone and the current user, which a Linux
// collection of the same data source version has.
TEST(SystemOverview, PrebootLeavesOutTheOperatingSystemTables) {
    const TLinks osTables = {"Operating System", "TimeZone", "Current User"};
    const TLinks preboot = TSampleReport("preboot").TableTitles("system_overview");
    const TLinks linux = TSampleReport("linux-teaming").TableTitles("system_overview");
    for (const std::string& title : osTables) {
        EXPECT_EQ(preboot.end(), std::find(preboot.begin(), preboot.end(), title)) << title;
        EXPECT_NE(linux.end(), std::find(linux.begin(), linux.end(), title)) << title;
    }
}

}  // namespace
}  // namespace braigrion
