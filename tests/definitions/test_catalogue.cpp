// Every page definition of the software, network and hardware catalogues,
// built over collections that differ in the probes the definitions depend
// on, against the expected definitions in tests/fixtures/catalogue/.
//
// A fixture file holds, for one builder operation, each distinct definition
// once, headed by "== " and the collections that yield it. Run with
// BRAIGRION_UPDATE_FIXTURES=1 to rewrite the files from the code; review the
// difference before keeping it.
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "DefinitionDump.h"
#include "braigrion/TReportParametersBuilder.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::DumpDefinition;
using testing::TRepoBuilder;

// A collection named for what the probes find in it: platform, data source
// version and nodes.
struct TEnvironment {
    const char* name;
    const char* repository;
};

#define WINDOWS_OS "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:18\n"
#define WINDOWS_SERVER_OS "ORVSG_OperatingSystem ProductVendor=\"Microsoft Corporation\" OSType=uint16:74\n"
#define REDHAT_OS "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\" OSType=uint16:36\n"
#define ESX_OS "ORVSG_OperatingSystem ProductVendor=\"VMware, Inc.\" OSType=uint16:78\n"
#define ESXI_OS "ORVSG_OperatingSystem ProductVendor=\"VMware, Inc.\" OSType=uint16:81\n"
#define SOLARIS_OS "ORVSG_OperatingSystem ProductVendor=\"Oracle Corporation\" OSType=uint16:29\n"
#define ONE_NODE "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:1\n"
#define TWO_NODES "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:2\n"
#define COLLECTOR(major, minor) \
    "ORVSG_CollectionInfo Build=\"2.4.1-118\" MajorVersion=\"" major "\" MinorVersion=\"" minor "\"\n"

const TEnvironment kEnvironments[] = {
    {"windows-1.0", COLLECTOR("1", "0") WINDOWS_OS ONE_NODE},
    {"windows-1.1", COLLECTOR("1", "1") WINDOWS_OS ONE_NODE},
    {"windows-1.2", COLLECTOR("1", "2") WINDOWS_SERVER_OS ONE_NODE},
    {"windows-1.3", COLLECTOR("1", "30") WINDOWS_SERVER_OS ONE_NODE},
    {"linux-1.0", COLLECTOR("1", "0") REDHAT_OS ONE_NODE},
    {"linux-1.1", COLLECTOR("1", "1") REDHAT_OS ONE_NODE},
    {"linux-1.2", COLLECTOR("1", "2") REDHAT_OS ONE_NODE},
    {"linux-1.3", COLLECTOR("1", "3") REDHAT_OS ONE_NODE},
    // No collection facts at all: the version is "." and below every threshold.
    {"linux-unversioned", REDHAT_OS},
    {"vmware-1.0", COLLECTOR("1", "0") ESX_OS ONE_NODE},
    {"vmware-1.3", COLLECTOR("1", "3") ESXI_OS ONE_NODE},
    {"unknown-1.0", COLLECTOR("1", "0") SOLARIS_OS ONE_NODE},
    {"unknown-1.3", COLLECTOR("1", "3") SOLARIS_OS ONE_NODE},
    // The pre-boot edition reports data layout 1.2 and counts as 3.2.
    {"preboot", "ORVSG_CollectionInfo Build=\"3.0.4-21.preboot\" MajorVersion=\"1\" MinorVersion=\"2\"\n" ONE_NODE},
    {"multinode-windows-1.3", COLLECTOR("1", "3") WINDOWS_SERVER_OS TWO_NODES},
    {"multinode-linux-1.1", COLLECTOR("1", "1") REDHAT_OS TWO_NODES},
};

typedef TReportParameters (TReportParametersBuilder::*TBuildOperation)() const;

struct TOperation {
    const char* name;
    TBuildOperation build;
};

void PrintTo(const TOperation& operation, std::ostream* os) {
    *os << operation.name;
}

#define OPERATION(name) TOperation{#name, &TReportParametersBuilder::name}

const TOperation kOperations[] = {
    OPERATION(BuildSystemConfigParams),        OPERATION(BuildOSConfigParams),
    OPERATION(BuildSysConfigParams),           OPERATION(BuildInstalledAppsParams),
    OPERATION(BuildInstalledFixesParams),      OPERATION(BuildInstalledRPMParams),
    OPERATION(BuildWindowsComponentsParams),   OPERATION(BuildSystemServiceParams),
    OPERATION(BuildDeviceDriverParams),        OPERATION(BuildKernelModuleParams),
    OPERATION(BuildProcessesParams),           OPERATION(BuildResourceUtilizationParams),
    OPERATION(BuildVmware3iParams),            OPERATION(BuildPBParams),
    OPERATION(BuildNetworkWithTeamingParams),  OPERATION(BuildNetworkWithoutTeamingParams),
    OPERATION(BuildHardwareInfoParams),        OPERATION(BuildPCIInfoParams),
    OPERATION(BuildFirmwareParams),
    OPERATION(BuildBroadcomParams),            OPERATION(BuildQlogicParams),
    OPERATION(BuildEmulexParams),              OPERATION(BuildBrocadeParams),
};

TReportParametersBuilder BuilderFor(const TEnvironment& environment) {
    TRepoBuilder repo;
    repo.Parse(environment.repository);
    return TReportParametersBuilder(repo.Namespace(), "default", false);
}

std::string FixturePath(const std::string& operation) {
    return std::string(BRAIGRION_SOURCE_DIR) + "/tests/fixtures/catalogue/" + operation + ".txt";
}

std::string ReadFile(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// The definitions of one operation over every collection, each distinct
// definition once, in the order of the collections.
std::string CatalogueText(const TOperation& operation) {
    std::vector<std::pair<std::string, std::string>> groups;  // names, definition
    for (const TEnvironment& environment : kEnvironments) {
        std::string dump = DumpDefinition((BuilderFor(environment).*operation.build)());
        bool grouped = false;
        for (auto& group : groups) {
            if (group.second == dump) {
                group.first += std::string(" ") + environment.name;
                grouped = true;
                break;
            }
        }
        if (!grouped) groups.push_back(std::make_pair(std::string(environment.name), dump));
    }
    std::string text = std::string("# ") + operation.name + "\n";
    for (const auto& group : groups) text += "\n== " + group.first + "\n" + group.second;
    return text;
}

// The first line where two texts part, with its number, for a readable failure.
std::string FirstDifference(const std::string& expected, const std::string& actual) {
    std::istringstream e(expected);
    std::istringstream a(actual);
    std::string le;
    std::string la;
    for (int line = 1;; ++line) {
        bool moreE = static_cast<bool>(std::getline(e, le));
        bool moreA = static_cast<bool>(std::getline(a, la));
        if (!moreE && !moreA) return "no difference";
        if (!moreE || !moreA || le != la) {
            return "line " + std::to_string(line) + "\n  expected: " + (moreE ? le : "<end>") +
                   "\n  actual:   " + (moreA ? la : "<end>");
        }
    }
}

class CatalogueTest : public ::testing::TestWithParam<TOperation> {};

TEST_P(CatalogueTest, BuildsTheExpectedDefinitionForEveryCollection) {
    const TOperation& operation = GetParam();
    std::string actual = CatalogueText(operation);
    const std::string path = FixturePath(operation.name);
    if (std::getenv("BRAIGRION_UPDATE_FIXTURES") != nullptr) {
        std::ofstream(path, std::ios::binary) << actual;
    }
    std::string expected = ReadFile(path);
    ASSERT_FALSE(expected.empty()) << "missing fixture " << path;
    EXPECT_TRUE(expected == actual) << operation.name << " differs from " << path << " at "
                                    << FirstDifference(expected, actual);
}

// A definition whose widths cannot be right makes the table writer complain
// on standard output; no catalogue definition may.
TEST_P(CatalogueTest, DefinitionsPassValidation) {
    for (const TEnvironment& environment : kEnvironments) {
        TReportParameters params = (BuilderFor(environment).*GetParam().build)();
        ::testing::internal::CaptureStdout();
        for (const TReportClass& cls : params.GetClasses()) {
            cls.Validate();
            for (const TReportClass& nested : cls.GetAssociatedClasses()) nested.Validate();
        }
        EXPECT_EQ("", ::testing::internal::GetCapturedStdout()) << environment.name;
    }
}

INSTANTIATE_TEST_SUITE_P(Catalogue, CatalogueTest, ::testing::ValuesIn(kOperations),
                         [](const ::testing::TestParamInfo<TOperation>& info) {
                             return std::string(info.param.name);
                         });

}  // namespace
}  // namespace braigrion
