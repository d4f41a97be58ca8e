// Every ESXi page definition against the expected definitions in
// tests/fixtures/catalogue_vmwesxi/ (one file per builder operation, in the
// notation of the base catalogue's fixtures), built over a single-node and
// a multi-node host; and the one probe the ESXi builder has.
//
// Run with BRAIGRION_UPDATE_FIXTURES=1 to rewrite the files from the code;
// review the difference before keeping it.
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>

#include <gtest/gtest.h>

#include "TReportParametersBuilder_vmwesxi.h"
#include "definitions/DefinitionDump.h"
#include "support/LogCapture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::DumpDefinition;
using testing::TRepoBuilder;

typedef TReportParameters (TReportParametersBuilder_vmwesxi::*TBuildOperation)() const;

struct TOperation {
    const char* name;
    TBuildOperation build;
};

void PrintTo(const TOperation& operation, std::ostream* os) {
    *os << operation.name;
}

#define OPERATION(name) TOperation{#name, &TReportParametersBuilder_vmwesxi::name}

const TOperation kOperations[] = {
    OPERATION(BuildSystemOverviewParams),
    OPERATION(BuildInstalledAppsParams),
    OPERATION(BuildKernelModuleParams),
    OPERATION(BuildNetworkingParams),
    OPERATION(BuildResourceUtilizationParams),
    OPERATION(BuildProcessesParams),
    OPERATION(BuildOSConfigParams),
    OPERATION(BuildSysConfigParams),
    OPERATION(BuildMergedLogParams),
    OPERATION(BuildMergedDevicesParams),
    OPERATION(BuildPBParams),
    OPERATION(BuildIPMIEventParams),
    OPERATION(BuildChassisEventLogParams),
    OPERATION(BuildVMwarePrivilegeLogParams),
    OPERATION(BuildTKRLogParams),
    OPERATION(BuildHealthStatusParams),
    OPERATION(BuildRegisteredProfileParams),
    OPERATION(BuildHardwareInventoryParams),
    OPERATION(BuildHardwareInventoryMemorySlotsParams),
    OPERATION(BuildHardwareInventoryCPUSlotsParams),
    OPERATION(BuildPCIInfoParams),
    OPERATION(BuildFirmwareParams),
    OPERATION(BuildKMCConfigurationParams),
    OPERATION(BuildEnvironmentalsParams),
    OPERATION(BuildDriveHealthParams),
    OPERATION(BuildLsiControllerParams),
    OPERATION(BuildLSIIDEParams),
    OPERATION(BuildPMCRAIDParams),
    OPERATION(BuildHalcyonParams),
    OPERATION(BuildHalcyonLogsParams),
    OPERATION(BuildQlogicParams),
    OPERATION(BuildEmulexParams),
    OPERATION(BuildBroadcomParams),
    OPERATION(BuildBrocadeAdapterParams),
    OPERATION(BuildGlowTraceParams),
    OPERATION(BuildKMCBuiltinSelfTestParams),
};

TReportParametersBuilder_vmwesxi BuilderFor(const std::string& repository) {
    TRepoBuilder repo;
    repo.Parse(repository);
    return TReportParametersBuilder_vmwesxi(repo.Namespace(), "default");
}

std::string ReadFile(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// The definition over a single-node host, and over a multi-node one when
// that differs.
std::string CatalogueText(const TOperation& operation) {
    const std::string single = DumpDefinition((BuilderFor("OMC_Chassis IpmiNodeCount=uint16:1").*operation.build)());
    const std::string multi = DumpDefinition((BuilderFor("OMC_Chassis IpmiNodeCount=uint16:2").*operation.build)());
    std::string text = std::string("# ") + operation.name + "\n";
    if (single == multi) return text + "\n== single-node multi-node\n" + single;
    return text + "\n== single-node\n" + single + "\n== multi-node\n" + multi;
}

class CatalogueTest_vmwesxi : public ::testing::TestWithParam<TOperation> {};

TEST_P(CatalogueTest_vmwesxi, BuildsTheExpectedDefinition) {
    const TOperation& operation = GetParam();
    const std::string actual = CatalogueText(operation);
    const std::string path =
        std::string(BRAIGRION_SOURCE_DIR) + "/tests/fixtures/catalogue_vmwesxi/" + operation.name + ".txt";
    if (std::getenv("BRAIGRION_UPDATE_FIXTURES") != nullptr) std::ofstream(path, std::ios::binary) << actual;
    const std::string expected = ReadFile(path);
    ASSERT_FALSE(expected.empty()) << "missing fixture " << path;
    EXPECT_EQ(expected, actual);
}

// No definition may make the table writer complain about its widths.
TEST_P(CatalogueTest_vmwesxi, DefinitionsPassValidation) {
    TReportParameters params = (BuilderFor("OMC_Chassis IpmiNodeCount=uint16:2").*GetParam().build)();
    ::testing::internal::CaptureStdout();
    for (const TReportClass& cls : params.GetClasses()) cls.Validate();
    EXPECT_EQ("", ::testing::internal::GetCapturedStdout());
}

INSTANTIATE_TEST_SUITE_P(CatalogueVmwesxi, CatalogueTest_vmwesxi, ::testing::ValuesIn(kOperations),
                         [](const ::testing::TestParamInfo<TOperation>& info) {
                             return std::string(info.param.name);
                         });

// The node count is the low byte of the first chassis's IpmiNodeCount.
TEST(BuilderVmwesxi, IsMultiNodeReadsTheLowByteOfTheFirstChassisNodeCount) {
    struct TCase {
        const char* repository;
        bool multiNode;
    } const cases[] = {
        {"class OMC_Chassis", false},
        {"OMC_Chassis Tag=\"1\"", false},
        {"OMC_Chassis IpmiNodeCount=uint16:1", false},
        {"OMC_Chassis IpmiNodeCount=uint16:2", true},
        {"OMC_Chassis IpmiNodeCount=uint16:4", true},
        {"OMC_Chassis IpmiNodeCount=uint16:258", true},
        {"OMC_Chassis IpmiNodeCount=uint16:256", false},
        {"OMC_Chassis IpmiNodeCount=null:uint16", false},
        {"OMC_Chassis IpmiNodeCount=uint16:1\nOMC_Chassis IpmiNodeCount=uint16:2", false},
        {"OMC_UnitaryComputerSystem Name=\"esx\"", false},
    };
    for (const TCase& c : cases) {
        EXPECT_EQ(c.multiNode, BuilderFor(c.repository).IsMultiNode()) << c.repository;
    }
    testing::TLogCapture log;
    BuilderFor("OMC_Chassis IpmiNodeCount=uint16:258").IsMultiNode();
    EXPECT_TRUE(log.Contains("TReportParametersBuilder_vmwesxi::IsMultiNode() IpmiNodeCount=2"));
}

}  // namespace
}  // namespace braigrion
