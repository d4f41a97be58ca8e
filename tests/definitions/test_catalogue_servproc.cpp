// The service processor pages' definitions over collections that differ in
// what their probes see: data source version, nodes, a lookout, the kind of
// activation key. Compared with tests/fixtures/catalogue/ as the other
// catalogues are (BRAIGRION_UPDATE_FIXTURES=1 rewrites the files).
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

#define COLLECTOR(minor) "ORVSG_CollectionInfo Build=\"2.4.1-118\" MajorVersion=\"1\" MinorVersion=\"" minor "\"\n"
#define NODES(n) "ORVSG_ComputerSystem Name=\"srv\" SystemNodes=uint8:" n "\n"
#define LOOKOUT "ORVSG_SP_LookoutSystem LookoutPresent=true\n"
#define KEY(description) "ORV_ActivationKey ActivationKeyDescription=\"" description "\"\n"

const std::pair<const char*, const char*> kEnvironments[] = {
    {"single-1.1", COLLECTOR("1") NODES("1")},
    {"single-1.2", COLLECTOR("2") NODES("1")},
    {"multinode-1.1", COLLECTOR("1") NODES("2")},
    {"multinode-1.2", COLLECTOR("2") NODES("2")},
    {"lookout-single", COLLECTOR("3") NODES("1") LOOKOUT},
    {"lookout-multinode", COLLECTOR("3") NODES("4") LOOKOUT},
    {"hardware-key", COLLECTOR("3") NODES("1") KEY("Hardware Activation Key")},
    {"feature-key", COLLECTOR("3") NODES("1") KEY("Feature key: Fabric Port Upgrade")},
};

typedef TReportParameters (TReportParametersBuilder::*TBuildOperation)() const;

const std::pair<const char*, TBuildOperation> kOperations[] = {
    {"BuildServProcConfigParams", &TReportParametersBuilder::BuildServProcConfigParams},
    {"BuildBISTParams", &TReportParametersBuilder::BuildBISTParams},
    {"BuildGlowTraceParams", &TReportParametersBuilder::BuildGlowTraceParams},
    {"BuildKMCLicenseKeyParams", &TReportParametersBuilder::BuildKMCLicenseKeyParams},
};

// Each distinct definition once, headed by the collections that yield it.
std::string CatalogueText(const char* name, TBuildOperation build) {
    std::vector<std::pair<std::string, std::string>> groups;
    for (const auto& environment : kEnvironments) {
        TRepoBuilder repo;
        repo.Parse(environment.second);
        const TReportParameters params = (TReportParametersBuilder(repo.Namespace(), "default", false).*build)();
        // A definition whose widths cannot be right complains on standard output.
        ::testing::internal::CaptureStdout();
        for (const TReportClass& cls : params.GetClasses()) cls.Validate();
        EXPECT_EQ("", ::testing::internal::GetCapturedStdout()) << name << " " << environment.first;

        const std::string dump = DumpDefinition(params);
        bool grouped = false;
        for (auto& group : groups) {
            if (group.second == dump) {
                group.first += std::string(" ") + environment.first;
                grouped = true;
                break;
            }
        }
        if (!grouped) groups.emplace_back(environment.first, dump);
    }
    std::string text = std::string("# ") + name + "\n";
    for (const auto& group : groups) text += "\n== " + group.first + "\n" + group.second;
    return text;
}

TEST(ServiceProcessorCatalogue, BuildsTheExpectedDefinitionForEveryCollection) {
    for (const auto& operation : kOperations) {
        const std::string actual = CatalogueText(operation.first, operation.second);
        const std::string path =
            std::string(BRAIGRION_SOURCE_DIR) + "/tests/fixtures/catalogue/" + operation.first + ".txt";
        if (std::getenv("BRAIGRION_UPDATE_FIXTURES") != nullptr) std::ofstream(path, std::ios::binary) << actual;
        std::ifstream in(path, std::ios::binary);
        std::ostringstream expected;
        expected << in.rdbuf();
        EXPECT_EQ(expected.str(), actual) << operation.first << " differs from " << path;
    }
}

}  // namespace
}  // namespace braigrion
