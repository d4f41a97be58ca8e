// The BIOS settings, KMC configuration and VCX inventory pages, and the
// generators that choose between the declared and the hand-written form of
// the service processor pages.
#include <cstdlib>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
#include "report/EngineFixture.h"
#include "report/ExpectedPage.h"
#include "sections/PlatformRepo.h"

namespace braigrion {
namespace {

using namespace TKR_REPORT_DEFINITION;
using testing::TEngineRun;
using testing::TPlatformRepo;
using testing::TRepoBuilder;

boost::shared_ptr<repository::TMemoryNamespace> Repo(const std::string& text) {
    TRepoBuilder repo;
    repo.Parse(text);
    return repo.Namespace();
}

// Sets an environment variable for the life of the object.
class TEnvironmentVariable {
public:
    TEnvironmentVariable(const char* name, const char* value) : fName(name) {
        if (value != nullptr) {
            setenv(name, value, 1);
        } else {
            unsetenv(name);
        }
    }
    ~TEnvironmentVariable() { unsetenv(fName); }

private:
    const char* fName;
};

// One page through its generator, as the report's dispatch would call it.
std::string WritePage(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const std::string& pageID, bool kmc = false,
                      TEngineRun<>* run = nullptr) {
    TEngineRun<> own(ns, "html", "default", kmc);
    TEngineRun<>& used = run != nullptr ? *run : own;
    used.writer.WriteReportPage(boost::make_shared<TReportParametersBuilder>(ns, "default", kmc), pageID);
    return used.Transcript();
}

const char kBIOSAttributes[] = R"(
    ORVSG_BIOSEnumeration AttributeName="OperatingModes.ChooseOperatingMode" CurrentValue="Maximum Performance" DefaultValue="Efficiency" PendingValue=""
    ORVSG_BIOSEnumeration AttributeName="BootModes.SystemBootMode" CurrentValue="UEFI Mode" DefaultValue="UEFI Mode" PendingValue="Legacy Mode"
    ORVSG_BIOSEnumeration AttributeName="Memory.MemorySpeed" CurrentValue="Max Performance" DefaultValue="Max Performance"
)";

// The page exists only when TKR_BIOSPROVIDER reads "yes" in any case; its
// attributes are sorted by name.
TEST(BIOSSettings, WrittenOnlyWhenTheProviderIsSwitchedOn) {
    const std::string page = PAGE_BIOS_SETTINGS;
    {
        TEnvironmentVariable provider("TKR_BIOSPROVIDER", "YES");
        const std::string written = WritePage(Repo(kBIOSAttributes), page);
        EXPECT_EQ(testing::ExpectedPage("platform/bios-settings.txt", written), written);
    }
    for (const char* value : {static_cast<const char*>(nullptr), "no", "yes please"}) {
        TEnvironmentVariable provider("TKR_BIOSPROVIDER", value);
        const std::string written = WritePage(Repo(kBIOSAttributes), page);
        EXPECT_EQ(std::string::npos, written.find("WriteIndexEntry")) << (value ? value : "(unset)");
    }
}

// Endpoints go to the list of their address origin; a static one (3) to
// none. A static IPv6 setting shows only when its link to the service
// processor's LAN endpoint says it is current. The vendor's community
// strings stand before the standard ones.
TPlatformRepo KMCNetwork(const std::string& nodes) {
    TPlatformRepo repo;
    repo.Keyed("CIM_ExtendedStaticIPAssignmentSettingData").Keyed("CIM_IPProtocolEndpoint");
    repo.Parse(nodes + R"(
        CIM_DNSSettingData InstanceID="KMC:DNS:1" RequestedHostname="kmc-rack4" DNSServerAddresses=string[]:"10.1.0.2","10.1.0.3" ElementName="DNS" NodeID="1"
        CIM_IPProtocolEndpoint Id="v4" AddressOrigin=uint16:4 IPv4Address="10.1.4.20" SubnetMask="255.255.255.0" SystemName="KMC" Name="sp-lanendpoint-1"
        CIM_IPProtocolEndpoint Id="static" AddressOrigin=uint16:3 IPv4Address="10.1.4.21" Name="sp-lanendpoint-2"
        CIM_IPProtocolEndpoint Id="v6" AddressOrigin=uint16:7 IPv6Address="fd00::20" IPv6SubnetPrefixLength=uint8:64 SystemName="KMC"
        CIM_IPProtocolEndpoint Id="slaac" AddressOrigin=uint16:9 IPv6Address="fd00::a:1" PrefixLength=uint8:64 SystemName="KMC"
        CIM_IPProtocolEndpoint Id="ll" AddressOrigin=uint16:10 IPv6Address="fe80::a:1" PrefixLength=uint8:64 SystemName="KMC"
        CIM_IPProtocolEndpoint Id="host" AddressOrigin=uint16:4 IPv4Address="10.1.9.9" Name="host-nic"
        CIM_StaticIPAssignmentSettingData InstanceID="KMC:IPv4:1" IPv4Address="10.1.4.30" SubnetMask="255.255.255.0" GatewayIPv4Address="10.1.4.1"
        CIM_ExtendedStaticIPAssignmentSettingData Id="current" InstanceID="KMC:IPv6:1" IPAddresses=string[]:"fd00::30" IPv6SubnetPrefixLengths=string[]:"64" GatewayAddresses=string[]:"fd00::1"
        CIM_ExtendedStaticIPAssignmentSettingData Id="pending" InstanceID="KMC:IPv6:2" IPAddresses=string[]:"fd00::31"
        CIM_ExtendedStaticIPAssignmentSettingData Id="elsewhere" InstanceID="KMC:IPv6:3" IPAddresses=string[]:"fd00::32"
        ORV_SNMPCommunityString Name="public" CommunityString="public" SystemName="KMC"
        CIM_SNMPCommunityString Name="standard" CommunityString="private" SystemName="KMC"
    )");
    auto link = [&](const char* setting, const char* endpoint, unsigned short current) {
        repo.Link("CIM_ElementSettingData", std::string("CIM_ExtendedStaticIPAssignmentSettingData:") + setting,
                  std::string("CIM_IPProtocolEndpoint:") + endpoint, "SettingData", "ManagedElement",
                  {testrepo::V("IsCurrent", NORVTKR20::TCIMValue(current))});
    };
    link("current", "v4", 1);
    link("pending", "v4", 2);
    link("elsewhere", "host", 1);
    return repo;
}

// On a multi-node system every table starts with the node.
TEST(KMCConfiguration, ShowsTheSettingsInForce) {
    const std::string single = WritePage(KMCNetwork("").Namespace(), PAGE_KMC_CONFIGURATION, true);
    const std::string multi =
        WritePage(KMCNetwork("ORVSG_ComputerSystem Name=\"kmc\" SystemNodes=uint8:2\n").Namespace(),
                  PAGE_KMC_CONFIGURATION, true);
    const std::string both = single + "-- multi-node --\n" + multi;
    EXPECT_EQ(testing::ExpectedPage("platform/kmc-configuration.txt", both), both);
}

// Outside KMC the same page id is the declared configuration page; the
// standard community strings serve when the vendor's class is empty.
TEST(KMCConfiguration, DeclaredPageOutsideKMCAndStandardCommunities) {
    TPlatformRepo repo = KMCNetwork("");
    auto ns = repo.Namespace();
    for (auto& community : testrepo::All(*ns, "ORV_SNMPCommunityString")) community->Delete(NORVTKR20::TCIMContext());
    TEngineRun<> run(ns, "html", "default", true);
    const std::string kmc = WritePage(ns, PAGE_KMC_CONFIGURATION, true, &run);
    EXPECT_NE(std::string::npos, kmc.find("{CommunityString width=\"0%\"}, \"\")")) << kmc;
    EXPECT_NE(std::string::npos, kmc.find("CIM_SNMPCommunityString")) << kmc;

    const std::string declared = WritePage(ns, PAGE_SERV_PROC_CONFIGURATION, false);
    EXPECT_NE(std::string::npos, declared.find("OpenPage(\"out/servproc_config\")")) << declared;
    EXPECT_EQ(std::string::npos, declared.find("KMCConfig")) << declared;
}

const char kChassis[] = R"(
    ORVSD_ModularComputerSystem OtherIdentifyingInfo="{4F2C8A10-77D1-11E9-9B4C-0A94EF5C1D20, 9N40HC1:Y030BG79G01H,}"
    ORVx_PhysicalPackage ProductName="Chassis Controller Module" Manufacturer="Norvane" PartNumber="00FJ669" SKU="00FJ670" SerialNumber="Y011UN61F0KB" UUID="B3B2E71A5E6011E7"
    ORVx_PhysicalPackage ProductName="" Manufacturer="Norvane" PartNumber="00FJ671"
    ORVx_PhysicalPackage ProductName="Fan Control Board" Manufacturer="Norvane" PartNumber="00FJ673" SKU="00FJ674" SerialNumber="Y011UN61F0PQ" UUID="C1D2"
    ORVSD_VCXFirmwareIdentity ElementName="CCM Firmware" VersionString="2.5.0" BuildNumber="1AON24A" ReleaseDate=datetime:"20190607000000.000000+000"
)";

// The chassis fields are cut out of the modular system's identifying text;
// a device without a product name gives no row.
TEST(VCXInventory, ReportsTheChassisAndItsDevices) {
    const std::string page = WritePage(Repo(kChassis), PAGE_VCX);
    EXPECT_EQ(testing::ExpectedPage("platform/vcx.txt", page), page);
}

// An identifying text too short for its fields, or without the "," they are
// found by, abandons the page before it opens; without the inventory classes
// there is no page at all.
TEST(VCXInventory, ShortOrMissingInventoryWritesNoPage) {
    for (const char* info : {"{ab}, 87", "{4F2C8A10-77D1-11E9} 9N40HC1:Y030BG79G01H"}) {
        const std::string broken =
            WritePage(Repo(std::string("ORVSD_ModularComputerSystem OtherIdentifyingInfo=\"") + info + "\"\n" +
                           "class ORVSD_VCXFirmwareIdentity\nclass ORVx_PhysicalPackage\n"),
                      PAGE_VCX);
        EXPECT_EQ(std::string::npos, broken.find("OpenPage")) << info << "\n" << broken;
    }
    const std::string missing = WritePage(Repo("class ORVSD_ModularComputerSystem\n"), PAGE_VCX);
    EXPECT_EQ("", missing);
}

}  // namespace
}  // namespace braigrion
