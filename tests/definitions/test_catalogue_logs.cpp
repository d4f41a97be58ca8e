// Every page definition of the log catalogue, built under each combination
// of the probes and run settings a log definition depends on (nodes, LUZ
// mode, a BMC read over the LAN), against the expected definitions in
// tests/fixtures/catalogue/, in the same form as the other catalogues.
// BRAIGRION_UPDATE_FIXTURES=1 rewrites the files from the code.
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
#include "tkrcore/TRootObject.h"

namespace braigrion {
namespace {

using testing::DumpDefinition;
using testing::TRepoBuilder;

// A BMC read over the LAN, or one that says it was read locally.
class TFakeLan : public NORVTKR20::IIPMILan {
public:
    TFakeLan(int status, std::string address) : fStatus(status), fAddress(std::move(address)) {}
    int getipmiLanStatus() override { return fStatus; }
    void getIPMIAddress(char* buffer, int length) override {
        fAddress.copy(buffer, static_cast<size_t>(length) - 1);
        buffer[std::min(fAddress.size(), static_cast<size_t>(length) - 1)] = '\0';
    }

private:
    int fStatus;
    std::string fAddress;
};

// Installs a LAN object for the lifetime of the guard.
class TLanGuard {
public:
    explicit TLanGuard(NORVTKR20::IIPMILan* lan) { NORVTKR20::TRootObject::SetipmiLanIns(lan); }
    ~TLanGuard() { NORVTKR20::TRootObject::SetipmiLanIns(nullptr); }
};

struct TEnvironment {
    const char* name;
    const char* repository;
    const char* mode;
    int lanStatus;  // -1: no LAN object at all
};

#define ONE_NODE "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:1\n"
#define TWO_NODES "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:2\n"

const TEnvironment kEnvironments[] = {
    {"single", ONE_NODE, "default", -1},
    {"multinode", TWO_NODES, "default", -1},
    {"single-luz", ONE_NODE, "luz", -1},
    {"multinode-luz", TWO_NODES, "luz", -1},
    {"single-local-bmc", ONE_NODE, "default", 0},
    {"single-remote-bmc", ONE_NODE, "default", 1},
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
    OPERATION(BuildTKRLogParams),      OPERATION(BuildMergeLogParams),     OPERATION(BuildWinSysEventParams),
    OPERATION(BuildWinSecEventParams), OPERATION(BuildWinAppEventParams),  OPERATION(BuildCELLogParams),
    OPERATION(BuildZEPHLogParams),     OPERATION(BuildDLMLogParams),       OPERATION(BuildIPMILogParams),
    OPERATION(BuildIPMILogKMCParams),  OPERATION(BuildCriticalDetailsParams), OPERATION(BuildDiagsParams),
    OPERATION(BuildSPINTParams),       OPERATION(BuildFileLoaderParams),
};

TReportParameters Build(const TEnvironment& environment, const TOperation& operation) {
    TRepoBuilder repo;
    repo.Parse(environment.repository);
    TFakeLan lan(environment.lanStatus, "192.0.2.17");
    TLanGuard guard(environment.lanStatus < 0 ? nullptr : &lan);
    TReportParametersBuilder builder(repo.Namespace(), environment.mode, false);
    return (builder.*operation.build)();
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

// Each distinct definition once, headed by the environments that yield it.
std::string CatalogueText(const TOperation& operation) {
    std::vector<std::pair<std::string, std::string>> groups;
    for (const TEnvironment& environment : kEnvironments) {
        std::string dump = DumpDefinition(Build(environment, operation));
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

class LogCatalogueTest : public ::testing::TestWithParam<TOperation> {};

TEST_P(LogCatalogueTest, BuildsTheExpectedDefinitionForEveryEnvironment) {
    const TOperation& operation = GetParam();
    std::string actual = CatalogueText(operation);
    const std::string path = FixturePath(operation.name);
    if (std::getenv("BRAIGRION_UPDATE_FIXTURES") != nullptr) std::ofstream(path, std::ios::binary) << actual;
    std::string expected = ReadFile(path);
    ASSERT_FALSE(expected.empty()) << "missing fixture " << path;
    EXPECT_EQ(expected, actual) << operation.name << " differs from " << path;
}

TEST_P(LogCatalogueTest, DefinitionsPassValidation) {
    for (const TEnvironment& environment : kEnvironments) {
        TReportParameters params = Build(environment, GetParam());
        ::testing::internal::CaptureStdout();
        for (const TReportClass& cls : params.GetClasses()) cls.Validate();
        EXPECT_EQ("", ::testing::internal::GetCapturedStdout()) << environment.name;
    }
}

INSTANTIATE_TEST_SUITE_P(LogCatalogue, LogCatalogueTest, ::testing::ValuesIn(kOperations),
                         [](const ::testing::TestParamInfo<TOperation>& info) {
                             return std::string(info.param.name);
                         });

// The address of a remote BMC is read into a buffer of 40 characters: a
// longer one is cut, never overrun.
TEST(LogCatalogue, RemoteBMCAddressIsCutToItsBuffer) {
    TRepoBuilder repo;
    repo.Parse(ONE_NODE);
    TFakeLan lan(1, std::string(60, '9'));
    TLanGuard guard(&lan);
    TReportParametersBuilder builder(repo.Namespace(), "default", false);
    EXPECT_EQ("IPMI Event - Remote BMC/KMC " + std::string(39, '9'), builder.BuildIPMILogParams().GetReportName());
}

}  // namespace
}  // namespace braigrion
