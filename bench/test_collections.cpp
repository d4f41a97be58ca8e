// The bundled sample collection and the synthetic generator: both must load,
// hang together, and give the report what it looks for.

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "repository/CIMXMLReader.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"
#include "repository/MemoryRepository.h"
#include "tkrcore/tkrcore.h"

namespace {

using braigrion::repository::LoadCollection;
using braigrion::repository::TMemoryClass;
using braigrion::repository::TMemoryInstance;
using braigrion::repository::TMemoryNamespace;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
typedef TCIMValue::TCIMType TType;

const std::string kSample = std::string(BRAIGRION_SOURCE_DIR) + "/samples/linux-server/";

boost::shared_ptr<TMemoryNamespace> LoadSample() {
    auto result = LoadCollection({kSample + "schema.xml", kSample + "inventory.xml", kSample + "logs.xml"});
    EXPECT_TRUE(result.fWarnings.empty()) << result.fWarnings.front();
    return result.fNamespace;
}

std::vector<boost::shared_ptr<ICIMInstance>> Instances(TMemoryNamespace& ns, const std::string& cls) {
    std::vector<boost::shared_ptr<ICIMInstance>> out;
    ns.GetClass(cls, TCIMContext())
        ->EnumerateInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(out), true, TCIMContext());
    return out;
}

std::string Text(const boost::shared_ptr<ICIMInstance>& instance, const std::string& property) {
    return instance->GetProperty(property, TCIMContext())->GetValueString();
}

// Every reference held by an instance of `ns` names an instance of `ns`;
// returns the paths that do not, and counts the references seen.
std::vector<std::string> DanglingReferences(TMemoryNamespace& ns, size_t& seen) {
    std::vector<std::string> dangling;
    seen = 0;
    for (TMemoryClass* cls : ns.GetClasses()) {
        for (const auto& instance : cls->GetInstances()) {
            for (const TMemoryInstance::TSlot& slot : instance->GetSlots()) {
                if (slot.fValue.IsNull() || slot.fValue.GetType() != TType::eReference) continue;
                ++seen;
                const TCIMReference path = slot.fValue;
                try {
                    ns.GetInstance(path, TCIMContext());
                } catch (const NORVTKR20::TTKRException&) {
                    dangling.push_back(cls->GetName() + " -> " + path.GetPath());
                }
            }
        }
    }
    return dangling;
}

TEST(SampleCollection, EveryAssociationReferenceNamesALoadedInstance) {
    auto ns = LoadSample();
    size_t seen = 0;
    const std::vector<std::string> dangling = DanglingReferences(*ns, seen);
    EXPECT_GT(seen, 0u);
    EXPECT_TRUE(dangling.empty()) << dangling.size() << " dangling, first: " << dangling.front();
}

TEST(SampleCollection, AssociationsReachTheirTargets) {
    auto ns = LoadSample();
    struct TCase {
        const char* fSource;
        const char* fAssociation;
        const char* fTarget;
        const char* fCountProperty;  // property of the source that states the count, or null for exactly one
    };
    const TCase cases[] = {
        {"ORVSG_PhysicalNetworkPort", "ORVSG_PortImplementsEndpoint", "ORVSG_IPProtocolEndpoint", nullptr},
        {"ORVSG_PhysicalNetworkPort", "ORVSG_NetworkPortStatistics", "ORVSG_NetworkStatisticalData", nullptr},
        {"ORVSG_MediaAccessDevice", "ORVSG_PartitionPresent", "ORVSG_DiskPartition", "NoOfPartitions"},
    };
    for (const TCase& c : cases) {
        const auto sources = Instances(*ns, c.fSource);
        ASSERT_FALSE(sources.empty()) << c.fSource;
        for (const auto& source : sources) {
            std::vector<boost::shared_ptr<ICIMInstance>> targets;
            source->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(targets),
                                                 c.fAssociation, c.fTarget, "", "", TCIMContext());
            const unsigned expected =
                c.fCountProperty ? static_cast<unsigned>(source->GetProperty(c.fCountProperty, TCIMContext())->GetValue())
                                 : 1u;
            EXPECT_EQ(targets.size(), expected) << c.fSource << " " << Text(source, "DeviceID") << " via "
                                                << c.fAssociation;
        }
    }
}

TEST(SampleCollection, CollectionFactsDescribeALinuxServerTakenUnderItsOperatingSystem) {
    auto ns = LoadSample();
    const TCIMContext none;
    const std::string build = NORVTKR20::TCIMSchemaHelper::GetDataSourceBuild(ns, none);
    EXPECT_FALSE(build.empty());
    EXPECT_EQ(build.find("preboot"), std::string::npos);
    EXPECT_FALSE(NORVTKR20::TCIMSchemaHelper::GetDataSourceMajorVersion(ns, none).empty());
    EXPECT_FALSE(NORVTKR20::TCIMSchemaHelper::GetDataSourceMinorVersion(ns, none).empty());
    EXPECT_FALSE(NORVTKR20::TCIMSchemaHelper::GetOperatingSystemVersion(ns).empty());

    ASSERT_EQ(Instances(*ns, "ORVSG_CollectionInfo").size(), 1u);
    const auto systems = Instances(*ns, "ORVSG_ComputerSystem");
    ASSERT_EQ(systems.size(), 1u);
    EXPECT_EQ(NORVTKR20::TCIMSchemaHelper::GetRawSerialNumberString(ns, none), Text(systems[0], "SerialNumber"));

    const auto operatingSystems = Instances(*ns, "ORVSG_OperatingSystem");
    ASSERT_EQ(operatingSystems.size(), 1u);
    const TCIMValue& osType = operatingSystems[0]->GetProperty("OSType", none)->GetValue();
    EXPECT_EQ(static_cast<unsigned>(osType), 36u);
    EXPECT_EQ(Text(operatingSystems[0], "OSType"), "LINUX");
    EXPECT_NE(Text(operatingSystems[0], "ProductVendor").find("Red Hat"), std::string::npos);
}

// The headings of the report come from DisplayName; a property the sample
// declares without one would print its raw name.
TEST(SampleCollection, EveryPropertyOfTheReportedClassesHasADisplayName) {
    auto ns = LoadSample();
    std::vector<std::string> missing;
    for (TMemoryClass* cls : ns->GetClasses()) {
        if (cls->GetName().compare(0, 6, "ORVSG_") != 0) continue;
        for (const auto& decl : cls->GetProperties()) {
            bool propagated = false;
            try {
                decl->GetQualifier("DisplayName", propagated, TCIMContext());
            } catch (const NORVTKR20::TTKRException&) {
                missing.push_back(cls->GetName() + "." + decl->GetName());
            }
        }
    }
    EXPECT_TRUE(missing.empty()) << missing.size() << " without DisplayName, first: " << missing.front();
}

// An enumerated value outside its ValueMap would print as a bare number.
TEST(SampleCollection, EveryEnumeratedValueIsInItsValueMap) {
    auto ns = LoadSample();
    size_t mapped = 0;
    for (TMemoryClass* cls : ns->GetClasses()) {
        for (const auto& instance : cls->GetInstances()) {
            for (const TMemoryInstance::TSlot& slot : instance->GetSlots()) {
                const auto& decl = cls->GetProperties()[slot.fDecl];
                if (!decl->HasValueMap() || slot.fValue.IsNull()) continue;
                std::vector<TCIMValue> scalars;
                if (slot.fValue.IsArray())
                    scalars = static_cast<std::vector<TCIMValue>&>(slot.fValue);
                else
                    scalars.push_back(slot.fValue);
                for (const TCIMValue& scalar : scalars) {
                    ++mapped;
                    EXPECT_NE(decl->MapValue(scalar), scalar.ToString(10))
                        << cls->GetName() << "." << decl->GetName() << " = " << scalar.ToString(10);
                }
            }
        }
    }
    EXPECT_GT(mapped, 20u);
}

// Only the collector's own messages merge identical neighbouring rows, and
// the sample holds such a pair so that the path is exercised.
TEST(SampleCollection, OnlyCollectorMessagesMergeRowsAndTheSampleHasARepeat) {
    auto ns = LoadSample();
    for (TMemoryClass* cls : ns->GetClasses()) {
        for (const auto& decl : cls->GetProperties()) {
            const bool expected = decl->GetName() == "Message" && cls->IsA(ns->FindClass("ORVSG_TKRLogRecord"));
            EXPECT_EQ(decl->IsRowMerge(), expected) << cls->GetName() << "." << decl->GetName();
        }
    }
    const auto records = Instances(*ns, "ORVSG_TKRLogRecord");
    bool repeated = false;
    for (size_t i = 1; i < records.size(); ++i) {
        if (Text(records[i], "Message") == Text(records[i - 1], "Message") &&
            Text(records[i], "MessageTimestamp") == Text(records[i - 1], "MessageTimestamp"))
            repeated = true;
    }
    EXPECT_TRUE(repeated);
}

// The sample is what people copy when they write a collection by hand, so it
// must be valid CIM-XML and not merely loadable by our lenient reader.
TEST(SampleCollection, FilesAreValidAgainstTheDeclarationDtd) {
    const std::string dtd = std::string(BRAIGRION_SOURCE_DIR) + "/tests/fixtures/cimxml/cim-declaration-subset.dtd";
    if (std::system("xmllint --version > /dev/null 2>&1") != 0 || !std::ifstream(dtd))
        GTEST_SKIP() << "xmllint or the declaration DTD is not available";
    for (const char* file : {"schema.xml", "inventory.xml", "logs.xml"}) {
        const std::string command = "xmllint --noout --dtdvalid " + dtd + " " + kSample + file;
        EXPECT_EQ(std::system(command.c_str()), 0) << command;
    }
}

// ------------------------------------------------------------------ generator

std::string Generate(unsigned count, const std::string& name, const std::string& seed = "", bool disks = false) {
    const std::string path = testing::TempDir() + name;
    std::string command = std::string(GEN_COLLECTION_PATH) + " " + std::to_string(count) + " " + path;
    if (!seed.empty()) command += " --seed " + seed;
    if (disks) command += " --disks";
    command += " > /dev/null";
    EXPECT_EQ(std::system(command.c_str()), 0) << command;
    return path;
}

std::string Contents(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

TEST(GeneratedCollection, LoadsEveryInstanceWithEveryReferenceResolved) {
    const unsigned count = 600;
    for (bool disks : {false, true}) {
        SCOPED_TRACE(disks ? "--disks" : "default");
        const std::string path = Generate(count, disks ? "gen-600-disks.xml" : "gen-600.xml", "", disks);
        auto result = LoadCollection({path});
        EXPECT_TRUE(result.fWarnings.empty());
        TMemoryNamespace& ns = *result.fNamespace;
        EXPECT_EQ(ns.GetInstanceCount(), count);

        size_t seen = 0;
        const std::vector<std::string> dangling = DanglingReferences(ns, seen);
        EXPECT_GT(seen, count / 20);
        EXPECT_TRUE(dangling.empty()) << dangling.size() << " dangling, first: " << dangling.front();

        // The mix holds every kind the generator writes, with typed values.
        const std::vector<const char*> kinds =
            disks ? std::vector<const char*>{"ORVSG_LinuxEventLogRecord", "ORVSG_OperatingSystem",
                                             "ORVSG_MediaAccessDevice", "ORVSG_DiskPartition", "ORVSG_LogicalDisk",
                                             "ORVSG_PartitionPresent", "ORVSG_LogicalDiskBasedOnPartition"}
                  : std::vector<const char*>{"ORVSG_LinuxEventLogRecord", "ORVSG_PCIDevice", "ORVSG_LogEntryOfDevice"};
        for (const char* cls : kinds) EXPECT_FALSE(Instances(ns, cls).empty()) << cls;
        if (disks) {
            // Every disk reaches the file system on it through its partition.
            for (const auto& disk : Instances(ns, "ORVSG_MediaAccessDevice")) {
                std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> parts, volumes;
                disk->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(parts),
                                                   "ORVSG_PartitionPresent", "", "", "", TCIMContext());
                ASSERT_EQ(1u, parts.size()) << Text(disk, "DeviceID");
                parts[0]->EnumerateAssociatedInstances(
                    NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(volumes),
                    "ORVSG_LogicalDiskBasedOnPartition", "ORVSG_LogicalDisk", "", "", TCIMContext());
                ASSERT_EQ(1u, volumes.size()) << Text(disk, "DeviceID");
                EXPECT_FALSE(Text(volumes[0], "FileSystemName").empty());
            }
            continue;
        }
        const auto device = Instances(ns, "ORVSG_PCIDevice").front();
        EXPECT_EQ(device->GetProperty("InstallDate", TCIMContext())->GetType(TCIMContext()), TType::eDateTime);
        EXPECT_TRUE(device->GetProperty("IOAddress", TCIMContext())->IsArray(TCIMContext()));
        EXPECT_EQ(device->GetProperty("PowerManagementSupported", TCIMContext())->GetType(TCIMContext()),
                  TType::eBoolean);
    }
}

TEST(GeneratedCollection, OutputDependsOnlyOnCountAndSeed) {
    const std::string first = Contents(Generate(300, "gen-a.xml"));
    const std::string again = Contents(Generate(300, "gen-b.xml"));
    const std::string reseeded = Contents(Generate(300, "gen-c.xml", "7"));
    ASSERT_FALSE(first.empty());
    EXPECT_TRUE(first == again);
    EXPECT_FALSE(first == reseeded);
}

}  // namespace
