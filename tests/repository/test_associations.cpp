// Associations, references and object paths.
#include <gtest/gtest.h>

#include "RepoFixture.h"

using namespace testrepo;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;

namespace {

// Two network ports; port eth0 has two IP endpoints (one of a subclass), eth1
// one. A second association class derives from the first. One association
// points at an endpoint that no file holds.
struct TNetwork {
    boost::shared_ptr<TMemoryNamespace> ns = TMemoryNamespace::Create();
    boost::shared_ptr<TMemoryInstance> eth0, eth1;

    TNetwork() {
        ns->DeclareClass(C("ORVSG_NetworkPort", "", {P("DeviceID", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                                                     P("Name", T::eString)}));
        ns->DeclareClass(C("ORVSG_IPProtocolEndpoint", "", {P("Name", T::eString, {Q("Key", TCIMValue::Boolean(true))})}));
        ns->DeclareClass(C("ORVSG_IPv6ProtocolEndpoint", "ORVSG_IPProtocolEndpoint", {}));
        ns->DeclareClass(C("ORVSG_PortImplementsEndpoint", "",
                           {Ref("Antecedent", "ORVSG_NetworkPort"), Ref("Dependent", "ORVSG_IPProtocolEndpoint")},
                           {Q("Association", TCIMValue::Boolean(true))}));
        ns->DeclareClass(C("ORVSG_PortBindsEndpoint", "ORVSG_PortImplementsEndpoint", {}));
        eth0 = ns->AddInstance("ORVSG_NetworkPort", {V("DeviceID", TCIMValue("0000:3b:00.0")), V("Name", TCIMValue("eth0"))});
        eth1 = ns->AddInstance("ORVSG_NetworkPort", {V("DeviceID", TCIMValue("0000:3b:00.1")), V("Name", TCIMValue("eth1"))});
        ns->AddInstance("ORVSG_IPProtocolEndpoint", {V("Name", TCIMValue("10.20.30.41"))});
        ns->AddInstance("ORVSG_IPv6ProtocolEndpoint", {V("Name", TCIMValue("fe80::1"))});
        ns->AddInstance("ORVSG_IPProtocolEndpoint", {V("Name", TCIMValue("10.20.31.7"))});
        Link("ORVSG_PortImplementsEndpoint", "0000:3b:00.0", "10.20.30.41");
        Link("ORVSG_PortBindsEndpoint", "0000:3b:00.0", "fe80::1");
        Link("ORVSG_PortImplementsEndpoint", "0000:3b:00.1", "10.20.31.7");
        Link("ORVSG_PortImplementsEndpoint", "0000:3b:00.1", "192.0.2.99");  // no such endpoint
        ns->Link();
    }

    void Link(const std::string& assoc, const std::string& port, const std::string& ip) {
        ns->AddInstance(assoc, {V("Antecedent", RefTo(ns, "ORVSG_NetworkPort.DeviceID=\"" + port + "\"")),
                                V("Dependent", RefTo(ns, "ORVSG_IPProtocolEndpoint.Name=\"" + ip + "\""))});
    }

    std::vector<std::string> Associated(const boost::shared_ptr<ICIMInstance>& from, const std::string& assoc,
                                        const std::string& result, const std::string& role, const std::string& resultRole) {
        std::vector<boost::shared_ptr<ICIMInstance>> out;
        from->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(out), assoc, result, role,
                                           resultRole, TCIMContext());
        return Names(out);
    }
};

typedef std::vector<std::string> S;

}  // namespace

TEST(Associations, FiltersRestrictAndEmptyStringsDoNot) {
    TNetwork net;
    struct Case {
        const char* assoc;
        const char* result;
        const char* role;
        const char* resultRole;
        S expected;
    } cases[] = {
        {"", "", "", "", S{"10.20.30.41", "fe80::1"}},
        {"ORVSG_PortImplementsEndpoint", "", "", "", S{"10.20.30.41", "fe80::1"}},  // subclass association matches
        {"ORVSG_PortBindsEndpoint", "", "", "", S{"fe80::1"}},
        {"", "ORVSG_IPv6ProtocolEndpoint", "", "", S{"fe80::1"}},
        {"", "ORVSG_IPProtocolEndpoint", "", "", S{"10.20.30.41", "fe80::1"}},  // subclass result matches
        {"", "", "Antecedent", "Dependent", S{"10.20.30.41", "fe80::1"}},
        {"", "", "dependent", "", S{}},  // eth0 is never the Dependent
        {"", "", "", "Antecedent", S{}},
        {"ORVSG_NoSuchAssociation", "", "", "", S{}},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(std::string(c.assoc) + "|" + c.result + "|" + c.role + "|" + c.resultRole);
        EXPECT_EQ(c.expected, net.Associated(net.eth0, c.assoc, c.result, c.role, c.resultRole));
    }
}

TEST(Associations, WalkBothWaysAndToleratesDanglingReferences) {
    TNetwork net;
    EXPECT_EQ(S{"10.20.31.7"}, net.Associated(net.eth1, "", "", "", ""));
    auto v6 = All(*net.ns, "ORVSG_IPv6ProtocolEndpoint");
    ASSERT_EQ(1u, v6.size());
    EXPECT_EQ(S{"eth0"}, net.Associated(v6[0], "", "ORVSG_NetworkPort", "Dependent", "Antecedent"));

    std::vector<boost::shared_ptr<ICIMInstance>> refs;
    net.eth1->EnumerateReferences(NORVTKR20::TAddToVectorCallback<ICIMInstance>(refs), "", "Antecedent", TCIMContext());
    EXPECT_EQ(2u, refs.size()) << "both associations of eth1, the dangling one included";
    refs.clear();
    net.eth1->EnumerateReferences(NORVTKR20::TAddToVectorCallback<ICIMInstance>(refs), "", "Dependent", TCIMContext());
    EXPECT_TRUE(refs.empty());

    TCIMReference missing(net.ns, "ORVSG_IPProtocolEndpoint.Name=\"192.0.2.99\"", TCIMContext());
    EXPECT_FALSE(missing.GetCIMElement(false));
}

TEST(Associations, ChangesToReferencesAndNewLinksAreSeen) {
    TNetwork net;
    auto assocs = All(*net.ns, "ORVSG_PortBindsEndpoint");
    assocs[0]->GetProperty("Antecedent", TCIMContext())
        ->SetValue(RefTo(net.ns, "ORVSG_NetworkPort.DeviceID=\"0000:3b:00.1\""), TCIMContext());
    EXPECT_EQ(S{"10.20.30.41"}, net.Associated(net.eth0, "", "", "", ""));
    EXPECT_EQ(S({"10.20.31.7", "fe80::1"}), net.Associated(net.eth1, "", "", "", ""));
    net.ns->AddInstance("ORVSG_IPProtocolEndpoint", {V("Name", TCIMValue("192.0.2.99"))});
    // Association instances are walked class by class, each class in load order.
    EXPECT_EQ(S({"10.20.31.7", "192.0.2.99", "fe80::1"}), net.Associated(net.eth1, "", "", "", ""));
}

TEST(ObjectPaths, ResolveByKeysIgnoringCaseOfNamesAndTypeOfNumbers) {
    TNetwork net;
    TCIMContext none;
    EXPECT_EQ("ORVSG_NetworkPort.DeviceID=\"0000:3b:00.1\"", net.eth1->GetPath(none).GetPath());
    auto found = net.ns->GetInstance(net.eth1->GetPath(none), none);
    EXPECT_EQ(net.eth1.get(), found.get());
    TCIMReference lower(net.ns, "orvsg_networkport.deviceid=\"0000:3b:00.0\"", none);
    EXPECT_EQ(net.eth0.get(), dynamic_cast<ICIMInstance*>(lower.GetCIMElement(true).get()));
    EXPECT_THROW(net.ns->GetInstance(TCIMReference(net.ns, "ORVSG_NetworkPort.DeviceID=\"none\"", none), none),
                 NORVTKR20::TTKRException);

    net.ns->DeclareClass(C("ORVSG_Slot", "", {P("Number", T::eUint16, {Q("Key", TCIMValue::Boolean(true))})}));
    auto slot = net.ns->AddInstance("ORVSG_Slot", {V("Number", TCIMValue(static_cast<unsigned short>(9)))});
    EXPECT_EQ(slot.get(), net.ns->GetInstance(TCIMReference(net.ns, "ORVSG_Slot.Number=9", none), none).get());
    EXPECT_EQ(net.ns.get(), dynamic_cast<TMemoryNamespace*>(net.eth0->GetPath(none).GetNamespace().get()));
}

TEST(ObjectPaths, KeysStatedOnlyByTheSourcePathStillName) {
    auto ns = TMemoryNamespace::Create();
    TCIMReference path(ns, "EMC_DiskDrive.CreationClassName=\"EMC_DiskDrive\",DeviceID=\"0_0_3\",SystemName=\"APM001\"",
                       TCIMContext());
    ns->AddInstance("EMC_DiskDrive", {V("DeviceID", TCIMValue("0_0_3")), V("Caption", TCIMValue("Disk 3"))}, &path);
    ns->Link();
    auto disk = ns->GetInstance(path, TCIMContext());
    EXPECT_EQ("Disk 3", disk->GetProperty("Caption", TCIMContext())->GetValueString());
    EXPECT_EQ(path.GetPath(), disk->GetPath(TCIMContext()).GetPath());
    EXPECT_THROW(disk->GetProperty("SystemName", TCIMContext()), NORVTKR20::TTKRException)
        << "a key known only from the path is not a property";
}

// A path resolves on all its key bindings together, whatever key sorts first
// and however many instances share it; a value matches the ways
// KeyValuesEqual says it does.
TEST(ObjectPaths, ResolveOnAllKeysTogetherAndMatchValuesByMeaning) {
    auto ns = TMemoryNamespace::Create();
    ns->DeclareClass(C("X_Device", "", {P("CreationClassName", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                                        P("DeviceID", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                                        P("Slot", T::eUint16, {Q("Key", TCIMValue::Boolean(true))})}));
    ns->DeclareClass(C("X_Disk", "X_Device", {}));
    std::vector<boost::shared_ptr<TMemoryInstance>> devices;
    for (unsigned i = 0; i < 2000; ++i) {
        devices.push_back(ns->AddInstance(i % 2 ? "X_Disk" : "X_Device",
                                          {V("CreationClassName", TCIMValue("X_Device")),
                                           V("DeviceID", TCIMValue("dev" + std::to_string(i / 2))),
                                           V("Slot", TCIMValue(static_cast<unsigned short>(i % 2)))}));
    }
    ns->Link();
    TCIMContext none;
    for (unsigned i : {0u, 1u, 777u, 1998u, 1999u}) {
        TCIMReference path = devices[i]->GetPath(none);
        path.SetClassName("X_Device");  // a subclass instance through its superclass
        EXPECT_EQ(devices[i].get(), ns->GetInstance(path, none).get()) << path.GetPath();
    }

    struct {
        const char* path;
        int expected;  // index into devices, or -1 for no instance
    } cases[] = {
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=1", 11},
        {"x_device.creationclassname=\"X_Device\",DEVICEID=\"dev5\",slot=1", 11},  // names ignore case
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=\"1\"", 11},  // a number in text
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=\"0x1\"", 11},
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=1.0", 11},
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=TRUE", 11},  // a boolean is 1
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"DEV5\",Slot=1", -1},  // text keeps its case
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=2", -1},
        {"X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev5\"", 10},  // fewer keys: the first that fits
        {"X_Disk.CreationClassName=\"X_Device\",DeviceID=\"dev5\"", 11},
        {"X_Disk.CreationClassName=\"X_Device\",DeviceID=\"dev5\",Slot=0", -1},  // not of that class
        {"X_Device.DeviceID=\"dev5\",Unknown=\"x\"", -1},
        {"X_Disk", 1},  // no keys: the first of the class
    };
    for (const auto& c : cases) {
        TCIMReference path(ns, c.path, none);
        ASSERT_EQ(std::string(c.path).find('.') == std::string::npos, path.GetKeyBindings().empty()) << c.path;
        auto element = path.GetCIMElement(false);
        TMemoryInstance* found = element ? dynamic_cast<TMemoryInstance*>(element.get()) : nullptr;
        EXPECT_EQ(c.expected < 0 ? nullptr : devices[static_cast<size_t>(c.expected)].get(), found) << c.path;
    }

    // References as keys: class and key names ignore case, values by meaning.
    ns->DeclareClass(C("X_Link", "", {Ref("Antecedent", "X_Device"), Ref("Dependent", "X_Device")}));
    auto link = ns->AddInstance("X_Link", {V("Antecedent", RefTo(ns, "X_Device.CreationClassName=\"X_Device\",DeviceID=\"dev1\",Slot=0")),
                                           V("Dependent", RefTo(ns, "X_Disk.CreationClassName=\"X_Device\",DeviceID=\"dev1\",Slot=1"))});
    TCIMReference byReferences(ns, "X_Link", none);
    byReferences.AddKeyValue("antecedent", RefTo(ns, "x_device.deviceid=\"dev1\",slot=\"0\",creationclassname=\"X_Device\""));
    byReferences.AddKeyValue("Dependent", RefTo(ns, "X_Disk.CreationClassName=\"X_Device\",DeviceID=\"dev1\",Slot=1"));
    EXPECT_EQ(link.get(), ns->GetInstance(byReferences, none).get());
    std::vector<boost::shared_ptr<ICIMInstance>> associated;
    devices[2]->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(associated), "", "", "", "",
                                             none);
    ASSERT_EQ(1u, associated.size());
    EXPECT_EQ(devices[3].get(), associated[0].get());
}
