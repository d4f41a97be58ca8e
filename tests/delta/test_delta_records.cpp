// The comparison of collections into delta records: which instances match,
// what each kind of change records, and what the records say.
#include <sys/stat.h>

#include <algorithm>
#include <functional>
#include <sstream>

#include <gtest/gtest.h>

#include "delta/DeltaFixture.h"
#include "delta/TClassDelta.h"
#include "repository/CIMXMLReader.h"
#include "repository/CIMXMLWriter.h"
#include "repository/MemoryClass.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMValue;
using repository::TMemoryNamespace;
using testing::TCollection;
using testing::Val;

typedef boost::shared_ptr<TMemoryNamespace> TNs;

// Each record as "Class type Property InstanceName [indices]", sorted, as
// the report reads them: through each class's ORVSG_DeltaClass instance.
std::vector<std::string> Records(const TNs& records) {
    std::vector<std::string> lines;
    NORVTKR20::TCIMContext none;
    records->GetClass("ORVSG_DeltaClass", none)->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> deltaClass) {
            const std::string className = deltaClass->GetProperty("ClassName", none)->GetValueString();
            std::vector<boost::shared_ptr<ICIMInstance>> found;
            deltaClass->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(found),
                                                     "ORVSG_DeltaClassAssocToDelta", "ORVSG_Delta", "", "", none);
            for (const auto& record : found) {
                std::ostringstream line;
                line << className << " " << DeltaType(record) + 0 << " ";
                if (DeltaType(record) == kDeltaProperty) line << DeltaText(record, "Property") << " ";
                line << DeltaText(record, "InstanceName") << " [";
                std::vector<unsigned short> indices = DeltaIndices(record);
                for (size_t i = 0; i < indices.size(); ++i) line << (i ? "," : "") << indices[i];
                line << "]";
                lines.push_back(line.str());
            }
            return true;
        },
        false, none);
    std::sort(lines.begin(), lines.end());
    return lines;
}

// A machine with two disks (keys DeviceID and the host's SystemName) and a
// memory module.
TCollection Machine(const std::string& serial, const std::string& host) {
    TCollection c(serial, host, "20240311141531.000000-300");
    for (const char* disk : {"sda", "sdb"}) {
        c.Add(std::string("ORVSG_Disk.DeviceID=\"") + disk + "\",SystemName=\"" + host + "\"",
              {Val("Size", TCIMValue("480 GB")), Val("Model", TCIMValue("MZ7LH480")),
               Val("Firmware", TCIMValue::Array(TCIMValue::TCIMType::eString, {TCIMValue("HXT7"), TCIMValue("A")}))});
    }
    c.Add("ORVSG_PhysicalMemory.Tag=\"DIMM A1\"", {Val("Capacity", TCIMValue("32 GB"))});
    return c;
}

TEST(DeltaRecords, IdenticalCollectionsGiveNoRecord) {
    repository::TDeltaSummary summary;
    TNs records = repository::ComputeDeltaRecords({Machine("SN1", "alpha").Namespace(),
                                                   Machine("SN1", "alpha").Namespace()}, &summary);
    EXPECT_EQ(std::vector<std::string>{}, Records(records));
    EXPECT_EQ(0u, summary.fMissing + summary.fUnique + summary.fPropertyDeltas);
    EXPECT_EQ(6u, summary.fClasses) << "the facts' classes are compared as well";
}

TEST(DeltaRecords, EachKindOfChangeGivesTheRecordTheReportNeeds) {
    const std::string sda = "ORVSG_Disk.DeviceID=\"sda\"";
    TCollection before("SN1", "alpha", "20240311141531.000000-300");
    TCollection after("SN1", "alpha", "20240412093044.000000-240");
    auto disk = [](TCollection& c, const char* id, const char* size, std::vector<const char*> firmware) {
        std::vector<TCIMValue> elements;
        for (const char* f : firmware) elements.push_back(TCIMValue(f));
        c.Add(std::string("ORVSG_Disk.DeviceID=\"") + id + "\",SystemName=\"alpha\"",
              {Val("Size", TCIMValue(size)), Val("Firmware", TCIMValue::Array(TCIMValue::TCIMType::eString, elements))});
    };
    disk(before, "sda", "480 GB", {"HXT7", "A"});
    disk(after, "sda", "960 GB", {"HXT7", "B"});
    disk(before, "sdb", "480 GB", {"HXT7"});  // gone later
    disk(after, "sdc", "480 GB", {"HXT7"});   // new later
    disk(before, "sdd", "480 GB", {"HXT7"});
    after.Add("ORVSG_Disk.DeviceID=\"sdd\",SystemName=\"alpha\"", {Val("Size", TCIMValue("480 GB"))});
    EXPECT_EQ((std::vector<std::string>{
                  "ORVSG_Disk 1 " + std::string("ORVSG_Disk.DeviceID=\"sdb\" [1]"),
                  "ORVSG_Disk 2 ORVSG_Disk.DeviceID=\"sdc\" [1]",
                  "ORVSG_Disk 4 Firmware " + sda + " [0,1]",
                  "ORVSG_Disk 4 Firmware ORVSG_Disk.DeviceID=\"sdd\" [0,1]",
                  "ORVSG_Disk 4 Size " + sda + " [0,1]",
                  "ORVSG_TimeZone 4 LocalDateTime ORVSG_TimeZone.InstanceID=\"0\" [0,1]",
              }),
              Records(repository::ComputeDeltaRecords({before.Namespace(), after.Namespace()})))
        << "a property the later instance lacks differs as well";
}

TEST(DeltaRecords, KeysThatNameTheHostDoNotBreakMatching) {
    // Two machines: the disks' SystemName and the computer system's Name
    // name the host, yet the same slot matches.
    TCollection a = Machine("SN1", "alpha.example.net");
    TCollection b = Machine("SN2", "beta.example.net");
    b.Add("ORVSG_Slot.Tag=\"beta\",Number=1", {Val("Width", TCIMValue("x8"))});
    a.Add("ORVSG_Slot.Tag=\"alpha\",Number=1", {Val("Width", TCIMValue("x16"))});
    EXPECT_EQ((std::vector<std::string>{
                  "ORVSG_CollectionInfo 4 SerialNumber ORVSG_CollectionInfo.InstanceID=\"0\" [0,1]",
                  "ORVSG_IPService 4 HostName ORVSG_IPService.Name=\"IP\" [0,1]",
                  "ORVSG_Slot 4 Width ORVSG_Slot.Number=1 [0,1]",
              }),
              Records(repository::ComputeDeltaRecords({a.Namespace(), b.Namespace()})))
        << "a key whose value is the host's short name is left out too";
    EXPECT_TRUE(repository::IsHostKeyName("CSName"));
    EXPECT_TRUE(repository::IsHostKeyName("systemname"));
    EXPECT_TRUE(repository::IsHostKeyName("ParentSystemName"));
    EXPECT_FALSE(repository::IsHostKeyName("SystemCreationClassName"));
}

TEST(DeltaRecords, KeysThatCannotTellInstancesApartAreKept) {
    // Both modules name the host in their only distinguishing key; left
    // out, the two would be one, so the class is matched by all its keys.
    TCollection a("SN1", "alpha", "20240311141531.000000-300");
    TCollection b("SN1", "alpha", "20240311141531.000000-300");
    for (TCollection* c : {&a, &b}) {
        c->Add("ORVSG_Board.SystemName=\"alpha\",Slot=\"1\"", {Val("Model", TCIMValue("X"))});
        c->Add("ORVSG_Board.SystemName=\"other\",Slot=\"1\"", {Val("Model", TCIMValue(c == &a ? "Y" : "Z"))});
    }
    EXPECT_EQ(std::vector<std::string>{"ORVSG_Board 4 Model ORVSG_Board.Slot=\"1\",SystemName=\"other\" [0,1]"},
              Records(repository::ComputeDeltaRecords({a.Namespace(), b.Namespace()})));
}

TEST(DeltaRecords, InstancesWithoutTheirKeyMatchByTheirValues) {
    // A collector that leaves the key property out: the class keys on
    // InstanceID, its instances carry only a name, a version and, for some,
    // the host by name ("SystemName") or by value ("Node").
    struct TFirmware {
        const char* name;
        const char* version;
    };
    auto collection = [](const std::string& serial, const std::string& host, std::vector<TFirmware> firmware) {
        TCollection c(serial, host, "20240311141531.000000-300");
        c.Declare("ORVSG_AdapterFirmware", "InstanceID", {"Name", "Version", "SystemName", "Node"});
        for (const TFirmware& f : firmware) {
            c.AddUnnamed("ORVSG_AdapterFirmware", {Val("Name", TCIMValue(f.name)), Val("Version", TCIMValue(f.version)),
                                                   Val("SystemName", TCIMValue(host)), Val("Node", TCIMValue(host))});
        }
        return c.Namespace();
    };
    const std::string port0 = "ORVSG_AdapterFirmware.Name=\"port 0\",Version=";
    const struct {
        const char* what;
        TNs baseline, other;
        std::vector<std::string> records;
    } cases[] = {
        {"identical collections, a duplicate in each",
         collection("SN1", "alpha", {{"port 0", "11.4"}, {"port 1", "11.4"}, {"port 1", "11.4"}}),
         collection("SN1", "alpha", {{"port 1", "11.4"}, {"port 0", "11.4"}, {"port 1", "11.4"}}),
         {}},
        {"an updated version reads as the old missing and the new unique",
         collection("SN1", "alpha", {{"port 0", "11.4"}, {"port 1", "11.4"}}),
         collection("SN1", "alpha", {{"port 0", "11.5"}, {"port 1", "11.4"}}),
         {"ORVSG_AdapterFirmware 1 " + port0 + "\"11.4\" [1]", "ORVSG_AdapterFirmware 2 " + port0 + "\"11.5\" [1]"}},
        {"one of two identical instances gone",
         collection("SN1", "alpha", {{"port 0", "11.4"}, {"port 0", "11.4"}}),
         collection("SN1", "alpha", {{"port 0", "11.4"}}),
         {"ORVSG_AdapterFirmware 1 " + port0 + "\"11.4\" [1]"}},
        {"two machines: the values that name the host are left out",
         collection("SN1", "alpha", {{"port 0", "11.4"}, {"port 0", "11.4"}}),
         collection("SN2", "beta", {{"port 0", "11.4"}, {"port 0", "11.4"}}),
         {}},
    };
    for (const auto& c : cases) {
        repository::TDeltaSummary summary;
        std::vector<std::string> records;
        for (const std::string& line : Records(repository::ComputeDeltaRecords({c.baseline, c.other}, &summary))) {
            if (line.rfind("ORVSG_AdapterFirmware ", 0) == 0) records.push_back(line);
        }
        EXPECT_EQ(c.records, records) << c.what;
        EXPECT_EQ(std::vector<std::string>{"ORVSG_AdapterFirmware"}, summary.fNamedByValues) << c.what;
        // The report finds each record's instance by the values it names.
        for (const std::string& line : records) {
            const std::string path = line.substr(line.find("ORVSG_AdapterFirmware.Name"),
                                                 line.rfind(" [") - line.find("ORVSG_AdapterFirmware.Name"));
            const bool unique = line.find(" 2 ") != std::string::npos;
            NORVTKR20::TCIMReference reference((unique ? c.other : c.baseline), path, {});
            EXPECT_TRUE(reference.GetCIMElement(false)) << c.what << ": " << path;
        }
    }
}

TEST(DeltaRecords, ThreeCollectionsCompareWithTheFirst) {
    TCollection c0("SN1", "alpha", "20240311141531.000000-300");
    TCollection c1("SN1", "alpha", "20240311141531.000000-300");
    TCollection c2("SN1", "alpha", "20240311141531.000000-300");
    c0.Add("ORVSG_Disk.DeviceID=\"sda\"", {Val("Size", TCIMValue("1")), Val("Model", TCIMValue("m"))});
    c1.Add("ORVSG_Disk.DeviceID=\"sda\"", {Val("Size", TCIMValue("1")), Val("Model", TCIMValue("n"))});
    c2.Add("ORVSG_Disk.DeviceID=\"sda\"", {Val("Size", TCIMValue("2")), Val("Model", TCIMValue("n"))});
    c0.Add("ORVSG_Disk.DeviceID=\"sdb\"", {Val("Size", TCIMValue("1"))});
    c1.Add("ORVSG_Disk.DeviceID=\"sdb\"", {Val("Size", TCIMValue("1"))});
    c1.Add("ORVSG_Disk.DeviceID=\"sdc\"", {Val("Size", TCIMValue("1"))});
    c2.Add("ORVSG_Disk.DeviceID=\"sdc\"", {Val("Size", TCIMValue("1"))});
    c2.Add("ORVSG_Disk.DeviceID=\"sdd\"", {Val("Size", TCIMValue("1"))});
    EXPECT_EQ((std::vector<std::string>{
                  "ORVSG_Disk 1 ORVSG_Disk.DeviceID=\"sdb\" [2]",
                  "ORVSG_Disk 2 ORVSG_Disk.DeviceID=\"sdc\" [1,2]",
                  "ORVSG_Disk 2 ORVSG_Disk.DeviceID=\"sdd\" [2]",
                  "ORVSG_Disk 4 Model ORVSG_Disk.DeviceID=\"sda\" [0,1,2]",
                  "ORVSG_Disk 4 Size ORVSG_Disk.DeviceID=\"sda\" [0,2]",
              }),
              Records(repository::ComputeDeltaRecords({c0.Namespace(), c1.Namespace(), c2.Namespace()})));
}

TEST(DeltaRecords, SavedRecordsReadBackAlike) {
    TCollection later = Machine("SN1", "alpha");
    later.Add("ORVSG_PhysicalMemory.Tag=\"DIMM B1\"", {Val("Capacity", TCIMValue("32 GB"))});
    TNs records = repository::ComputeDeltaRecords({Machine("SN1", "alpha").Namespace(), later.Namespace()});
    std::ostringstream xml;
    repository::WriteCollection(*records, xml);
    TNs loaded = repository::LoadCollectionFromString(xml.str(), "records.xml").fNamespace;
    EXPECT_EQ(Records(records), Records(loaded));
    EXPECT_EQ(1u, Records(loaded).size());
}

// A storage array as its own WBEM server reported it, compared with itself
// and with a collection that lacks its fans: its keys name the array in
// SystemName, which the matching leaves out.
TEST(DeltaRecords, ARealStorageArrayCapture) {
    const std::string dir = BRAIGRION_SOURCE_DIR "/../shared/realcim/storage_array/";
    struct stat info {};
    if (stat(dir.c_str(), &info) != 0) GTEST_SKIP() << "real server captures not found at " << dir;
    std::vector<std::string> all, withoutFans;
    for (const char* name : {"ArrayChassis", "DiskDrive", "Fan", "PowerSupply", "StorageSystem"}) {
        all.push_back(dir + "EMC_" + name + ".xml");
        if (std::string(name) != "Fan") withoutFans.push_back(dir + "EMC_" + name + ".xml");
    }
    TNs array = repository::LoadCollection(all).fNamespace;
    EXPECT_EQ(std::vector<std::string>{},
              Records(repository::ComputeDeltaRecords({array, repository::LoadCollection(all).fNamespace})));

    const std::vector<std::string> records =
        Records(repository::ComputeDeltaRecords({array, repository::LoadCollection(withoutFans).fNamespace}));
    const repository::TMemoryClass* fans = array->FindClass("Symm_FanDevice");
    ASSERT_TRUE(fans);
    ASSERT_GT(fans->GetInstanceCount(), 0u);
    EXPECT_EQ(fans->GetInstanceCount(), records.size());
    for (const std::string& record : records) {
        EXPECT_EQ(0u, record.find("Symm_FanDevice 1 Symm_FanDevice.CreationClassName=")) << record;
        EXPECT_EQ(std::string::npos, record.find("SystemName=")) << record;
        EXPECT_EQ(record.size() - 4, record.find(" [1]")) << record;
    }
}

}  // namespace
}  // namespace braigrion
