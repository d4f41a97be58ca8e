// The probes of the collected data: their answers, the lines they log, and
// how they treat an absent class (a "no") against any other failure of the
// repository (passed on).
#include <functional>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TReportParametersBuilder.h"
#include "support/LogCapture.h"
#include "support/RepoBuilder.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::INamespaceProvider;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TTKRException;
using testing::TLogCapture;
using testing::TRepoBuilder;

typedef std::function<bool(const TReportParametersBuilder&)> TProbe;

const TProbe kIsLookout = [](const TReportParametersBuilder& b) { return b.IsLookout(); };
const TProbe kIsMultiNode = [](const TReportParametersBuilder& b) { return b.IsMultiNode(); };
const TProbe kHasTeamInfo = [](const TReportParametersBuilder& b) { return b.HasTeamInfo(); };
const TProbe kIsSupportKMCKey = [](const TReportParametersBuilder& b) { return b.IsSupportKMCKey(); };
const TProbe kIsRedHat = [](const TReportParametersBuilder& b) { return b.IsRedHat(); };

// A collection in which the probed class is not declared at all.
const char kOtherClassesOnly[] = "ORVSG_CollectionInfo Build=\"2.4.1\"\n";

TEST(Probes, AnswerAndLog) {
    const struct {
        const char* name;
        TProbe probe;
        const char* repository;
        bool expected;
        std::vector<std::string> log;  // every line the probe logs, in order
    } cases[] = {
        {"LookoutPresent", kIsLookout, "ORVSG_SP_LookoutSystem LookoutPresent=true", true, {}},
        {"LookoutAbsentFlag", kIsLookout, "ORVSG_SP_LookoutSystem LookoutPresent=false", false, {}},
        {"LookoutNullFlag", kIsLookout, "ORVSG_SP_LookoutSystem LookoutPresent=null:boolean", false, {}},
        {"LookoutWithoutFlag", kIsLookout, "ORVSG_SP_LookoutSystem Name=\"sp\"", false, {}},
        {"LookoutNoInstance", kIsLookout, "class ORVSG_SP_LookoutSystem", false, {}},
        {"LookoutNoClass", kIsLookout, kOtherClassesOnly, false, {}},

        {"OneNode", kIsMultiNode, "ORVSG_ComputerSystem Name=\"a\" SystemNodes=uint8:1", false,
            {"TReportParametersBuilder::IsMultiNode() SystemNodes=1"}},
        {"TwoNodes", kIsMultiNode, "ORVSG_ComputerSystem Name=\"a\" SystemNodes=uint8:2", true,
            {"TReportParametersBuilder::IsMultiNode() SystemNodes=2"}},
        {"FourNodesOnTheFirstSystem", kIsMultiNode,
            "ORVSG_ComputerSystem Name=\"a\" SystemNodes=uint8:4\n"
            "ORVSG_ComputerSystem Name=\"b\" SystemNodes=uint8:1",
            true, {"TReportParametersBuilder::IsMultiNode() SystemNodes=4"}},
        {"NodesNotCounted", kIsMultiNode, "ORVSG_ComputerSystem Name=\"a\"", false, {}},
        {"NoComputerSystem", kIsMultiNode, "class ORVSG_ComputerSystem", false, {}},
        {"NoComputerSystemClass", kIsMultiNode, kOtherClassesOnly, false, {}},

        {"PortInTeam", kHasTeamInfo,
            "ORVSG_PhysicalNetworkPort DeviceID=\"eth0\"\n"
            "ORVSG_PhysicalNetworkPort DeviceID=\"eth1\" TeamName=\"bond0\" TeamID=\"0\"",
            true, {"Report - HasTeamInfo: Enter", "Report - HasTeamInfo: True"}},
        {"TeamNameWithoutID", kHasTeamInfo,
            "ORVSG_PhysicalNetworkPort DeviceID=\"eth0\" TeamName=\"bond0\" TeamID=null:string", false,
            {"Report - HasTeamInfo: Enter"}},
        {"TeamIDWithoutName", kHasTeamInfo, "ORVSG_PhysicalNetworkPort DeviceID=\"eth0\" TeamID=\"0\"",
            false, {"Report - HasTeamInfo: Enter"}},
        {"NoPorts", kHasTeamInfo, "class ORVSG_PhysicalNetworkPort", false,
            {"Report - HasTeamInfo: Enter"}},
        {"NoPortClass", kHasTeamInfo, kOtherClassesOnly, false,
            {"Report - HasTeamInfo: Enter", "Report - HasTeamInfo: Unknown"}},

        {"HardwareKey", kIsSupportKMCKey,
            "ORV_ActivationKey ActivationKeyDescription=\"KMC Hardware Activation Key (Advanced)\"", true,
            {"Report - IsSupportKMCKey: True"}},
        {"FeatureKey", kIsSupportKMCKey, "ORV_ActivationKey ActivationKeyDescription=\"Remote Console\"",
            false, {}},
        {"KeyWithoutDescription", kIsSupportKMCKey, "ORV_ActivationKey KeyID=\"7\"", false, {}},
        {"NoKeys", kIsSupportKMCKey, "class ORV_ActivationKey", false,
            {"Report - IsSupportKMCKey: Unknown"}},
        {"NoKeyClass", kIsSupportKMCKey, kOtherClassesOnly, false, {"Report - IsSupportKMCKey: Unknown"}},

        {"RedHat", kIsRedHat, "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\" OSType=uint16:36",
            true, {"Report - IsRedHat: True"}},
        {"OtherLinux", kIsRedHat, "ORVSG_OperatingSystem ProductVendor=\"SUSE\" OSType=uint16:36", false,
            {}},
        {"TwoRedHatSystems", kIsRedHat,
            "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\"\n"
            "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\"",
            false, {"Report - IsRedHat: Unknown"}},
        {"NoOperatingSystem", kIsRedHat, "class ORVSG_OperatingSystem", false,
            {"Report - IsRedHat: Unknown"}},
        {"NoOperatingSystemClass", kIsRedHat, kOtherClassesOnly, false, {"Report - IsRedHat: Unknown"}}
    };
    for (const auto& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TReportParametersBuilder builder(repo.Namespace(), "default", false);
        TLogCapture log;
        EXPECT_EQ(c.expected, c.probe(builder)) << c.name;
        EXPECT_EQ(c.log, log.Messages()) << c.name;
    }
}

TEST(Probes, DataSourceVersionFormsMajorDotFirstMinorDigit) {
    const struct {
        const char* name;
        const char* repository;
        int providerType;
        const char* expected;
    } cases[] = {
        {"Plain", "ORVSG_CollectionInfo Build=\"2.4.1\" MajorVersion=\"1\" MinorVersion=\"3\"", 0, "1.3"},
        {"MinorCutToOneDigit", "ORVSG_CollectionInfo MajorVersion=\"1\" MinorVersion=\"25\"", 0, "1.2"},
        {"NumbersAsValues", "ORVSG_CollectionInfo MajorVersion=uint8:2 MinorVersion=uint8:0", 0, "2.0"},
        {"NoMinor", "ORVSG_CollectionInfo MajorVersion=\"1\"", 0, "1."},
        {"NoCollectionFacts", "ORVSG_ComputerSystem Name=\"a\"", 0, "."},
        {"PrebootRaisedToThree",
            "ORVSG_CollectionInfo Build=\"3.0.4-preboot\" MajorVersion=\"1\" MinorVersion=\"1\"", 0, "3.1"},
        {"PrebootAlreadyNewer",
            "ORVSG_CollectionInfo Build=\"3.0.4-preboot\" MajorVersion=\"4\" MinorVersion=\"0\"", 0, "4.0"},
        // Majors compare as text: "10" is below "3".
        {"PrebootComparesAsText",
            "ORVSG_CollectionInfo Build=\"preboot\" MajorVersion=\"10\" MinorVersion=\"2\"", 0, "3.2"},
        // A delta view reads no build, so no pre-boot raise.
        {"DeltaIgnoresBuild",
            "ORVSG_CollectionInfo Build=\"3.0.4-preboot\" MajorVersion=\"1\" MinorVersion=\"1\"", 1,
            "1.1"}
    };
    for (const auto& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TReportParametersBuilder builder(repo.WithProviderType(c.providerType), "default", false);
        TLogCapture log;
        EXPECT_EQ(c.expected, builder.GetDataSourceVersion()) << c.name;
        EXPECT_TRUE(log.Contains(std::string("Report - GetDataSourceVersion: ") + c.expected)) << c.name;
    }
}

// A repository that fails every class lookup with a status other than "not found".
class TFailingNamespace : public ICIMNamespace, public INamespaceProvider {
public:
    explicit TFailingNamespace(int providerType) : fProviderType(providerType) {}
    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(const TCIMContext&) override {
        return boost::shared_ptr<INamespaceProvider>(this, [](INamespaceProvider*) {});
    }
    int GetProviderType(const TCIMContext&) override { return fProviderType; }
    boost::shared_ptr<ICIMClass> GetClass(const std::string&, const TCIMContext&) override {
        throw TTKRException(NORVTKR20::kFailed);
    }
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference&, const TCIMContext&) override {
        throw TTKRException(NORVTKR20::kFailed);
    }

private:
    int fProviderType;
};

TEST(Probes, PassOnFailuresOtherThanAnAbsentClass) {
    TReportParametersBuilder builder(boost::make_shared<TFailingNamespace>(0), "default", false);
    for (const TProbe& probe : {kIsLookout, kIsMultiNode, kHasTeamInfo, kIsSupportKMCKey, kIsRedHat}) {
        try {
            probe(builder);
            ADD_FAILURE() << "a failing repository must fail the probe";
        } catch (const TTKRException& ex) {
            EXPECT_EQ(NORVTKR20::kFailed, ex.fStatusCode.fStatusCode);
        }
    }
}

TEST(Probes, DataSourceVersionKeepsWhatItHasWhenTheVersionReadsFail) {
    // In a delta view the build is not read; the failing version reads leave
    // both parts empty.
    TReportParametersBuilder builder(boost::make_shared<TFailingNamespace>(1), "default", false);
    EXPECT_EQ(".", builder.GetDataSourceVersion());
}

}  // namespace
}  // namespace braigrion
