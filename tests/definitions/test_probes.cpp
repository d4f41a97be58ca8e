// The probes of the collected data: their answers, the lines they log, and
// how they treat an absent class (a "no") against any other failure of the
// repository (passed on).
#include <functional>
#include <ostream>
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

struct TProbeCase {
    const char* name;
    TProbe probe;
    const char* repository;
    bool expected;
    std::vector<std::string> log;  // every line the probe logs, in order
};

void PrintTo(const TProbeCase& c, std::ostream* os) {
    *os << c.name;
}

const TProbe kIsLookout = [](const TReportParametersBuilder& b) { return b.IsLookout(); };
const TProbe kIsMultiNode = [](const TReportParametersBuilder& b) { return b.IsMultiNode(); };
const TProbe kHasTeamInfo = [](const TReportParametersBuilder& b) { return b.HasTeamInfo(); };
const TProbe kIsSupportKMCKey = [](const TReportParametersBuilder& b) { return b.IsSupportKMCKey(); };
const TProbe kIsRedHat = [](const TReportParametersBuilder& b) { return b.IsRedHat(); };

class ProbeTest : public ::testing::TestWithParam<TProbeCase> {};

TEST_P(ProbeTest, AnswersAndLogs) {
    TRepoBuilder repo;
    repo.Parse(GetParam().repository);
    TReportParametersBuilder builder(repo.Namespace(), "default", false);
    TLogCapture log;
    EXPECT_EQ(GetParam().expected, GetParam().probe(builder));
    EXPECT_EQ(GetParam().log, log.Messages());
}

// A collection in which the probed class is not declared at all.
const char kOtherClassesOnly[] = "ORVSG_CollectionInfo Build=\"2.4.1\"\n";

INSTANTIATE_TEST_SUITE_P(
    Table, ProbeTest,
    ::testing::Values(
        TProbeCase{"LookoutPresent", kIsLookout, "ORVSG_SP_LookoutSystem LookoutPresent=true", true, {}},
        TProbeCase{"LookoutAbsentFlag", kIsLookout, "ORVSG_SP_LookoutSystem LookoutPresent=false", false, {}},
        TProbeCase{"LookoutNullFlag", kIsLookout, "ORVSG_SP_LookoutSystem LookoutPresent=null:boolean", false, {}},
        TProbeCase{"LookoutWithoutFlag", kIsLookout, "ORVSG_SP_LookoutSystem Name=\"sp\"", false, {}},
        TProbeCase{"LookoutNoInstance", kIsLookout, "class ORVSG_SP_LookoutSystem", false, {}},
        TProbeCase{"LookoutNoClass", kIsLookout, kOtherClassesOnly, false, {}},

        TProbeCase{"OneNode", kIsMultiNode, "ORVSG_ComputerSystem Name=\"a\" SystemNodes=uint8:1", false,
                   {"TReportParametersBuilder::IsMultiNode() SystemNodes=1"}},
        TProbeCase{"TwoNodes", kIsMultiNode, "ORVSG_ComputerSystem Name=\"a\" SystemNodes=uint8:2", true,
                   {"TReportParametersBuilder::IsMultiNode() SystemNodes=2"}},
        TProbeCase{"FourNodesOnTheFirstSystem", kIsMultiNode,
                   "ORVSG_ComputerSystem Name=\"a\" SystemNodes=uint8:4\n"
                   "ORVSG_ComputerSystem Name=\"b\" SystemNodes=uint8:1",
                   true, {"TReportParametersBuilder::IsMultiNode() SystemNodes=4"}},
        TProbeCase{"NodesNotCounted", kIsMultiNode, "ORVSG_ComputerSystem Name=\"a\"", false, {}},
        TProbeCase{"NoComputerSystem", kIsMultiNode, "class ORVSG_ComputerSystem", false, {}},
        TProbeCase{"NoComputerSystemClass", kIsMultiNode, kOtherClassesOnly, false, {}},

        TProbeCase{"PortInTeam", kHasTeamInfo,
                   "ORVSG_PhysicalNetworkPort DeviceID=\"eth0\"\n"
                   "ORVSG_PhysicalNetworkPort DeviceID=\"eth1\" TeamName=\"bond0\" TeamID=\"0\"",
                   true, {"Report - HasTeamInfo: Enter", "Report - HasTeamInfo: True"}},
        TProbeCase{"TeamNameWithoutID", kHasTeamInfo,
                   "ORVSG_PhysicalNetworkPort DeviceID=\"eth0\" TeamName=\"bond0\" TeamID=null:string", false,
                   {"Report - HasTeamInfo: Enter"}},
        TProbeCase{"TeamIDWithoutName", kHasTeamInfo, "ORVSG_PhysicalNetworkPort DeviceID=\"eth0\" TeamID=\"0\"",
                   false, {"Report - HasTeamInfo: Enter"}},
        TProbeCase{"NoPorts", kHasTeamInfo, "class ORVSG_PhysicalNetworkPort", false,
                   {"Report - HasTeamInfo: Enter"}},
        TProbeCase{"NoPortClass", kHasTeamInfo, kOtherClassesOnly, false,
                   {"Report - HasTeamInfo: Enter", "Report - HasTeamInfo: Unknown"}},

        TProbeCase{"HardwareKey", kIsSupportKMCKey,
                   "ORV_ActivationKey ActivationKeyDescription=\"KMC Hardware Activation Key (Advanced)\"", true,
                   {"Report - IsSupportKMCKey: True"}},
        TProbeCase{"FeatureKey", kIsSupportKMCKey, "ORV_ActivationKey ActivationKeyDescription=\"Remote Console\"",
                   false, {}},
        TProbeCase{"KeyWithoutDescription", kIsSupportKMCKey, "ORV_ActivationKey KeyID=\"7\"", false, {}},
        TProbeCase{"NoKeys", kIsSupportKMCKey, "class ORV_ActivationKey", false,
                   {"Report - IsSupportKMCKey: Unknown"}},
        TProbeCase{"NoKeyClass", kIsSupportKMCKey, kOtherClassesOnly, false, {"Report - IsSupportKMCKey: Unknown"}},

        TProbeCase{"RedHat", kIsRedHat, "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\" OSType=uint16:36",
                   true, {"Report - IsRedHat: True"}},
        TProbeCase{"OtherLinux", kIsRedHat, "ORVSG_OperatingSystem ProductVendor=\"SUSE\" OSType=uint16:36", false,
                   {}},
        TProbeCase{"TwoRedHatSystems", kIsRedHat,
                   "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\"\n"
                   "ORVSG_OperatingSystem ProductVendor=\"Red Hat, Inc.\"",
                   false, {"Report - IsRedHat: Unknown"}},
        TProbeCase{"NoOperatingSystem", kIsRedHat, "class ORVSG_OperatingSystem", false,
                   {"Report - IsRedHat: Unknown"}},
        TProbeCase{"NoOperatingSystemClass", kIsRedHat, kOtherClassesOnly, false, {"Report - IsRedHat: Unknown"}}),
    [](const ::testing::TestParamInfo<TProbeCase>& info) { return std::string(info.param.name); });

struct TVersionCase {
    const char* name;
    const char* repository;
    int providerType;
    const char* expected;
};

void PrintTo(const TVersionCase& c, std::ostream* os) {
    *os << c.name;
}

class DataSourceVersionTest : public ::testing::TestWithParam<TVersionCase> {};

TEST_P(DataSourceVersionTest, FormsMajorDotFirstMinorDigit) {
    TRepoBuilder repo;
    repo.Parse(GetParam().repository);
    TReportParametersBuilder builder(repo.WithProviderType(GetParam().providerType), "default", false);
    TLogCapture log;
    EXPECT_EQ(GetParam().expected, builder.GetDataSourceVersion());
    EXPECT_TRUE(log.Contains(std::string("Report - GetDataSourceVersion: ") + GetParam().expected));
}

INSTANTIATE_TEST_SUITE_P(
    Table, DataSourceVersionTest,
    ::testing::Values(
        TVersionCase{"Plain", "ORVSG_CollectionInfo Build=\"2.4.1\" MajorVersion=\"1\" MinorVersion=\"3\"", 0, "1.3"},
        TVersionCase{"MinorCutToOneDigit", "ORVSG_CollectionInfo MajorVersion=\"1\" MinorVersion=\"25\"", 0, "1.2"},
        TVersionCase{"NumbersAsValues", "ORVSG_CollectionInfo MajorVersion=uint8:2 MinorVersion=uint8:0", 0, "2.0"},
        TVersionCase{"NoMinor", "ORVSG_CollectionInfo MajorVersion=\"1\"", 0, "1."},
        TVersionCase{"NoCollectionFacts", "ORVSG_ComputerSystem Name=\"a\"", 0, "."},
        TVersionCase{"PrebootRaisedToThree",
                     "ORVSG_CollectionInfo Build=\"3.0.4-preboot\" MajorVersion=\"1\" MinorVersion=\"1\"", 0, "3.1"},
        TVersionCase{"PrebootAlreadyNewer",
                     "ORVSG_CollectionInfo Build=\"3.0.4-preboot\" MajorVersion=\"4\" MinorVersion=\"0\"", 0, "4.0"},
        // Majors compare as text: "10" is below "3".
        TVersionCase{"PrebootComparesAsText",
                     "ORVSG_CollectionInfo Build=\"preboot\" MajorVersion=\"10\" MinorVersion=\"2\"", 0, "3.2"},
        // A delta view reads no build, so no pre-boot raise.
        TVersionCase{"DeltaIgnoresBuild",
                     "ORVSG_CollectionInfo Build=\"3.0.4-preboot\" MajorVersion=\"1\" MinorVersion=\"1\"", 1,
                     "1.1"}),
    [](const ::testing::TestParamInfo<TVersionCase>& info) { return std::string(info.param.name); });

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
