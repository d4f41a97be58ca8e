// The sample collections against the page definitions they are meant to
// fill: the probes see the platform each stands for, and every table of the
// software, network and hardware pages that the platform has finds instances
// with a value in every column. The few tables and columns a platform has no
// data for are listed with the sample.
#include <algorithm>
#include <filesystem>
#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TReportParametersBuilder.h"
#include "braigrion/TWriterUtil.h"
#include "repository/CIMXMLReader.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;

typedef boost::shared_ptr<ICIMInstance> TInstancePtr;
typedef std::vector<TInstancePtr> TInstances;

struct TSample {
    const char* directory;
    int osType;
    bool preboot;
    const char* version;
    bool multiNode;
    bool teaming;
    bool redHat;
    // Tables ("link:title", or "link:class" for an untitled one; a nested
    // table adds ">class") and columns ("table/property") this platform has
    // no data for.
    std::set<std::string> emptyTables;
    std::set<std::string> emptyColumns;
};

void PrintTo(const TSample& sample, std::ostream* os) {
    *os << sample.directory;
}

// Tables that no sample platform has: a hypervisor on a USB key, a chassis
// scalability interconnect, coprocessor cards, the adapter firmware of one
// vendor, and the service processor images of older machines.
const std::set<std::string> kRareTables = {"vmware_esxi:VMware ESXi", "hw_info:QVA Ports", "hw_info:Intel MIC Info",
                                           "firmware:Emulex Firmware", "firmware:Post BIOS VPD",
                                           "firmware:Diagnostic VPD", "firmware:SP Firmware Main VPD",
                                           "firmware:SP Firmware BootROM VPD", "firmware:SP Hardware Revision"};

std::set<std::string> Without(std::set<std::string> tables, const std::set<std::string>& present) {
    for (const std::string& table : present) tables.erase(table);
    return tables;
}

std::set<std::string> With(std::set<std::string> tables, const std::set<std::string>& more) {
    tables.insert(more.begin(), more.end());
    return tables;
}

// Columns that stay empty wherever the table is filled: the post BIOS VPD
// table repeats the BIOS columns ahead of its own, and VPD images carry no
// release date or (on a single node) node.
const std::set<std::string> kCarriedColumns = {"firmware:Post BIOS VPD/ReleaseDate", "firmware:Post BIOS VPD/Name"};

const TSample kSamples[] = {
    {"windows-server", 1, false, "1.3", false, false, false,
     kRareTables,
     {"net:Physical Network Ports/PrimaryWinsServer", "net:Physical Network Ports/SecondaryWinsServer",
      "net:Physical Network Ports/DhcpServer", "net:Virtual Network Ports/PrimaryWinsServer",
      "net:Virtual Network Ports/SecondaryWinsServer", "net:Virtual Network Ports/DhcpServer",
      "net:Virtual Network Ports/GatewayList", "net:Virtual Network Ports/DnsServers"}},
    {"linux-teaming", 2, false, "1.3", false, true, true,
     Without(With(kRareTables, {"hw_info:Monitor", "hw_info:Optical Device Capabilities"}),
             {"firmware:Emulex Firmware"}),
     // The adapter of the converged network ports is no bus device with a product name.
     {"net:Physical Network Ports/DhcpServer", "net:Virtual Network Ports/DhcpServer",
      "firmware:Emulex Firmware/ProductID"}},
    {"preboot", 2, true, "3.2", false, false, false,
     Without(With(kRareTables, {"linux_config:ORVSG_SysConfigSettingData", "net:Virtual Network Ports"}),
             {"firmware:Post BIOS VPD", "firmware:Diagnostic VPD", "firmware:SP Firmware Main VPD",
              "firmware:SP Firmware BootROM VPD", "firmware:SP Hardware Revision"}),
     With(kCarriedColumns, {"net:Physical Network Ports/IPv6Address"})},
    {"multinode", 2, false, "1.2", true, false, false,
     Without(With(kRareTables, {"hw_info:Monitor"}),
             {"hw_info:QVA Ports", "hw_info:Intel MIC Info", "firmware:Post BIOS VPD", "firmware:Diagnostic VPD",
              "firmware:SP Firmware Main VPD", "firmware:SP Firmware BootROM VPD", "firmware:SP Hardware Revision"}),
     With(kCarriedColumns, {"net:Physical Network Ports/IPv6Address", "net:Physical Network Ports/DhcpServer",
                            "net:Virtual Network Ports/DhcpServer", "net:Virtual Network Ports/VLANName",
                            "net:Virtual Network Ports/speedDuplex", "net:Virtual Network Ports/GatewayList",
                            "net:Virtual Network Ports/DnsServers"})},
};

boost::shared_ptr<repository::TMemoryNamespace> Load(const std::string& directory) {
    std::vector<std::string> files;
    for (const auto& entry : std::filesystem::directory_iterator(std::string(BRAIGRION_SOURCE_DIR) + "/samples/" +
                                                                 directory)) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    return repository::LoadCollection(files).fNamespace;
}

// The pages of the software, network and hardware categories this collection
// gets, chosen as the page writers choose them.
std::vector<TReportParameters> PagesOf(const TReportParametersBuilder& builder) {
    const int os = builder.GetOSType();
    const bool preboot = builder.IsPreboot();
    std::vector<TReportParameters> pages = {builder.BuildSystemConfigParams()};
    if (!preboot) {
        pages.push_back(builder.BuildInstalledAppsParams());
        if (os == 0 || os == 1) {
            pages.push_back(builder.BuildWindowsComponentsParams());
            pages.push_back(builder.BuildInstalledFixesParams());
            pages.push_back(builder.BuildDeviceDriverParams());
            pages.push_back(builder.BuildSystemServiceParams());
        } else if (os == 2 || os == 3) {
            pages.push_back(builder.BuildInstalledRPMParams());
            pages.push_back(builder.BuildKernelModuleParams());
        }
    }
    pages.push_back(builder.HasTeamInfo() ? builder.BuildNetworkWithTeamingParams()
                                          : builder.BuildNetworkWithoutTeamingParams());
    if (!preboot) {
        pages.push_back(builder.BuildResourceUtilizationParams());
        pages.push_back(builder.BuildProcessesParams());
        pages.push_back(builder.BuildOSConfigParams());
    }
    if (os == 2) pages.push_back(builder.BuildSysConfigParams());
    pages.push_back(builder.BuildHardwareInfoParams());
    pages.push_back(builder.BuildPCIInfoParams());
    pages.push_back(builder.BuildFirmwareParams());
    pages.push_back(builder.BuildVmware3iParams());
    pages.push_back(builder.BuildPBParams());
    return pages;
}

// The property holds something to show: not null, not an empty text, not an
// empty array.
bool HasValue(const boost::shared_ptr<NORVTKR20::ICIMProperty>& property) {
    const TCIMValue& value = property->GetValue(TCIMContext());
    if (value.IsNull()) return false;
    if (value.IsArray()) return !static_cast<std::vector<TCIMValue>&>(value).empty();
    return !value.ToString(10).empty();
}

// Some property behind the column, as the table writer finds them, has a value.
bool ColumnHasValue(const TInstancePtr& instance, const TReportProperty& column) {
    auto properties = TWriterUtil::GetProperties(instance, column.GetProperty(), column.GetAssociationClass(),
                                                 column.GetAssociationTarget());
    if (column.HasSecondaryAssociationTarget()) {
        auto more = TWriterUtil::GetProperties(instance, column.GetProperty(), "",
                                               column.GetSecondaryAssociationTarget());
        properties.insert(properties.end(), more.begin(), more.end());
    }
    return std::any_of(properties.begin(), properties.end(), HasValue);
}

void CheckTable(const TSample& sample, const std::string& table, const TReportClass& cls, const TInstances& instances,
                std::set<std::string>& seen) {
    seen.insert(table);
    const bool expectEmpty = sample.emptyTables.count(table) > 0;
    EXPECT_EQ(expectEmpty, instances.empty()) << sample.directory << ": table " << table
                                              << (expectEmpty ? " was expected empty" : " has no instances");
    if (instances.empty()) return;
    for (const TReportProperty& column : cls.GetProperties()) {
        const std::string key = table + "/" + column.GetProperty();
        seen.insert(key);
        bool filled = std::any_of(instances.begin(), instances.end(),
                                  [&](const TInstancePtr& i) { return ColumnHasValue(i, column); });
        EXPECT_EQ(sample.emptyColumns.count(key) == 0, filled) << sample.directory << ": column " << key;
    }
}

class SampleTest : public ::testing::TestWithParam<TSample> {};

TEST_P(SampleTest, ProbesSeeThePlatform) {
    const TSample& sample = GetParam();
    TReportParametersBuilder builder(Load(sample.directory), "default", false);
    EXPECT_EQ(sample.osType, builder.GetOSType());
    EXPECT_EQ(sample.preboot, builder.IsPreboot());
    EXPECT_EQ(sample.version, builder.GetDataSourceVersion());
    EXPECT_EQ(sample.multiNode, builder.IsMultiNode());
    EXPECT_EQ(sample.teaming, builder.HasTeamInfo());
    EXPECT_EQ(sample.redHat, builder.IsRedHat());
}

TEST_P(SampleTest, FillsEveryTableItsPlatformHas) {
    const TSample& sample = GetParam();
    boost::shared_ptr<ICIMNamespace> ns = Load(sample.directory);
    TReportParametersBuilder builder(ns, "default", false);
    std::set<std::string> seen;
    for (const TReportParameters& page : PagesOf(builder)) {
        for (const TReportClass& cls : page.GetClasses()) {
            const std::string table = page.GetLinkName() + ":" + (cls.HasTitle() ? cls.GetTitle() : cls.GetClass());
            TInstances instances = TWriterUtil::GetInstances(ns, cls);
            CheckTable(sample, table, cls, instances, seen);
            if (!cls.HasAssociatedClass() || instances.empty()) continue;
            for (const TReportClass& nested : cls.GetAssociatedClasses()) {
                TInstances reached;
                for (const TInstancePtr& instance : instances) {
                    instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(reached),
                                                           nested.GetAssocClass(), nested.GetResultClass(), "", "",
                                                           TCIMContext());
                }
                CheckTable(sample, table + ">" + nested.GetClass(), nested, reached, seen);
            }
        }
    }
    // An exception that names nothing on these pages is a stale entry.
    for (const std::string& entry : sample.emptyTables) EXPECT_EQ(1u, seen.count(entry)) << "unknown table " << entry;
    for (const std::string& entry : sample.emptyColumns) EXPECT_EQ(1u, seen.count(entry)) << "unknown column " << entry;
}

// An enumerated value outside its value map would print as a bare number.
TEST_P(SampleTest, EnumeratedValuesAreInTheirValueMaps) {
    boost::shared_ptr<repository::TMemoryNamespace> ns = Load(GetParam().directory);
    size_t mapped = 0;
    for (repository::TMemoryClass* cls : ns->GetClasses()) {
        for (const auto& instance : cls->GetInstances()) {
            for (const repository::TMemoryInstance::TSlot& slot : instance->GetSlots()) {
                const auto& decl = cls->GetProperties()[slot.fDecl];
                if (!decl->HasValueMap() || slot.fValue.IsNull()) continue;
                std::vector<TCIMValue> scalars = {slot.fValue};
                if (slot.fValue.IsArray()) scalars = static_cast<std::vector<TCIMValue>&>(slot.fValue);
                for (const TCIMValue& scalar : scalars) {
                    ++mapped;
                    EXPECT_NE(scalar.ToString(10), decl->MapValue(scalar))
                        << GetParam().directory << ": " << cls->GetName() << "." << decl->GetName();
                }
            }
        }
    }
    EXPECT_GT(mapped, 20u);
}

INSTANTIATE_TEST_SUITE_P(Samples, SampleTest, ::testing::ValuesIn(kSamples),
                         [](const ::testing::TestParamInfo<TSample>& info) {
                             std::string name = info.param.directory;
                             std::replace(name.begin(), name.end(), '-', '_');
                             return name;
                         });

}  // namespace
}  // namespace braigrion
