// Classes, instances and properties of the in-memory repository.
#include <gtest/gtest.h>

#include "RepoFixture.h"

using namespace testrepo;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TCIMContext;
using NORVTKR20::TTKRException;

namespace {

int StatusOf(const std::function<void()>& f) {
    try {
        f();
    } catch (const TTKRException& ex) {
        return ex.fStatusCode.fStatusCode;
    }
    return 0;
}

// CIM_ManagedElement <- CIM_LogicalDevice <- ORVSG_Processor, ORVSG_Fan
boost::shared_ptr<TMemoryNamespace> Devices() {
    auto ns = TMemoryNamespace::Create();
    ns->DeclareClass(C("CIM_ManagedElement", "",
                       {P("Caption", T::eString, {Q("DisplayName", TCIMValue("Caption")), Q("MaxLen", TCIMValue(64u))}),
                        P("Name", T::eString)}));
    ns->DeclareClass(C("CIM_LogicalDevice", "CIM_ManagedElement",
                       {P("DeviceID", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                        P("Availability", T::eUint16,
                          {Q("ValueMap", Strings({"2", "3", "4..5", ".."})),
                           Q("Values", Strings({"Unknown", "Running/Full Power", "Warning or Testing", "DMTF Reserved"}))})}));
    ns->DeclareClass(C("ORVSG_Processor", "CIM_LogicalDevice",
                       {P("Caption", T::eString, {Q("DisplayName", TCIMValue("Processor"))}),
                        P("MaxClockSpeed", T::eUint32, {Q("RowMerge", TCIMValue::Boolean(true))})}));
    ns->DeclareClass(C("ORVSG_Fan", "CIM_LogicalDevice", {P("Speeds", T::eUint32, {}, true)}));
    ns->AddInstance("ORVSG_Processor", {V("DeviceID", TCIMValue("CPU0")), V("Name", TCIMValue("cpu0")),
                                        V("MaxClockSpeed", TCIMValue(3200u))});
    ns->AddInstance("ORVSG_Processor", {V("DeviceID", TCIMValue("CPU1")), V("Name", TCIMValue("cpu1")),
                                        V("MaxClockSpeed", TCIMValue::Null(T::eUint32))});
    ns->AddInstance("ORVSG_Fan", {V("DeviceID", TCIMValue("FAN1")), V("Name", TCIMValue("fan1"))});
    ns->AddInstance("CIM_LogicalDevice", {V("DeviceID", TCIMValue("DEV")), V("Name", TCIMValue("generic"))});
    ns->Link();
    return ns;
}

}  // namespace

TEST(Repository, UnknownClassThrowsNotFoundAndNamesCompareWithoutCase) {
    auto ns = Devices();
    EXPECT_EQ(NORVTKR20::kNotFound, StatusOf([&] { ns->GetClass("ORVSG_NoSuchClass", TCIMContext()); }));
    auto cls = ns->GetClass("orvsg_processor", TCIMContext());
    EXPECT_EQ("ORVSG_Processor", cls->GetClassName(TCIMContext()));
    EXPECT_EQ(0, ns->GetNamespaceProvider(TCIMContext())->GetProviderType(TCIMContext()));
}

TEST(Repository, AbsentPropertyThrowsWhileNullPropertyIsPresent) {
    auto ns = Devices();
    auto cpus = All(*ns, "ORVSG_Processor");
    ASSERT_EQ(2u, cpus.size());
    auto nullSpeed = cpus[1]->GetProperty("MaxClockSpeed", TCIMContext());
    EXPECT_TRUE(nullSpeed->GetValue().IsNull());
    EXPECT_EQ("", nullSpeed->GetValueString());
    EXPECT_EQ(NORVTKR20::kNotFound, StatusOf([&] { cpus[1]->GetProperty("Caption", TCIMContext()); }));
    EXPECT_EQ(NORVTKR20::kNotFound, StatusOf([&] { cpus[1]->GetProperty("NotDeclaredAnywhere", TCIMContext()); }));
}

TEST(Repository, EnumerationIsDeepOrShallowAndEmptyClassesCallNothing) {
    auto ns = Devices();
    TCIMContext none;
    std::vector<boost::shared_ptr<ICIMInstance>> shallow;
    ns->GetClass("CIM_LogicalDevice", none)->EnumerateInstances(NORVTKR20::TAddToVectorCallback<ICIMInstance>(shallow), false, none);
    EXPECT_EQ(std::vector<std::string>({"generic"}), Names(shallow));
    EXPECT_EQ(std::vector<std::string>({"generic", "cpu0", "cpu1", "fan1"}), Names(All(*ns, "CIM_LogicalDevice")));
    EXPECT_TRUE(All(*ns, "CIM_ManagedElement").size() == 4u);

    std::vector<boost::shared_ptr<ICIMInstance>> stopped;
    ns->GetClass("CIM_LogicalDevice", none)->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> i) { stopped.push_back(i); return stopped.size() < 2; }, true, none);
    EXPECT_EQ(2u, stopped.size()) << "a callback answering false ends the walk, subclasses included";

    ns->DeclareClass(C("ORVSG_Empty", "", {}));
    EXPECT_TRUE(All(*ns, "ORVSG_Empty").empty());

    std::vector<std::string> subs;
    ns->GetClass("CIM_ManagedElement", none)->EnumerateSubClasses(
        [&](boost::shared_ptr<NORVTKR20::ICIMClass> c) { subs.push_back(c->GetClassName(none)); return true; }, true, none);
    EXPECT_EQ(std::vector<std::string>({"CIM_LogicalDevice", "ORVSG_Processor", "ORVSG_Fan"}), subs);
    subs.clear();
    ns->GetClass("CIM_ManagedElement", none)->EnumerateSubClasses(
        [&](boost::shared_ptr<NORVTKR20::ICIMClass> c) { subs.push_back(c->GetClassName(none)); return true; }, false, none);
    EXPECT_EQ(std::vector<std::string>({"CIM_LogicalDevice"}), subs);
}

TEST(Repository, WritesAreSeenByLaterReads) {
    auto ns = Devices();
    TCIMContext none;
    auto cpus = All(*ns, "ORVSG_Processor");
    cpus[0]->GetProperty("Name", none)->SetValue(TCIMValue("renamed"), none);
    cpus[1]->AddProperty("Caption", TCIMValue("added later"), none);
    cpus[1]->AddProperty("OSType", TCIMValue(static_cast<unsigned short>(36)), none);  // undeclared: inferred
    auto created = ns->GetClass("ORVSG_Processor", none)->CreateInstance(none);
    created->AddProperty("Name", TCIMValue("cpu2"), none);
    All(*ns, "ORVSG_Fan")[0]->Delete(none);

    auto again = All(*ns, "ORVSG_Processor");
    EXPECT_EQ(std::vector<std::string>({"renamed", "cpu1", "cpu2"}), Names(again));
    EXPECT_EQ("added later", again[1]->GetProperty("Caption", none)->GetValueString());
    EXPECT_EQ(36, static_cast<int>(again[1]->GetProperty("OSType", none)->GetValue()));
    EXPECT_EQ(std::vector<std::string>({"generic", "renamed", "cpu1", "cpu2"}), Names(All(*ns, "CIM_LogicalDevice")));
}

TEST(Repository, InstancesCreatedDuringAWalkDoNotDisturbIt) {
    auto ns = Devices();
    TCIMContext none;
    auto cls = ns->GetClass("ORVSG_Processor", none);
    int visited = 0;
    cls->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> i) {
            ++visited;
            cls->CreateInstance(none)->AddProperty("Name", TCIMValue("copy"), none);
            i->Delete(none);
            return true;
        },
        true, none);
    EXPECT_EQ(2, visited);
    EXPECT_EQ(std::vector<std::string>({"copy", "copy"}), Names(All(*ns, "ORVSG_Processor")));
}

TEST(Repository, PropertiesEnumerateInDeclarationOrderWithInheritedFirst) {
    auto ns = Devices();
    TCIMContext none;
    auto cpu = ns->AddInstance("ORVSG_Processor", {V("MaxClockSpeed", TCIMValue(1u)), V("Name", TCIMValue("n")),
                                                   V("DeviceID", TCIMValue("CPU9")), V("Caption", TCIMValue("c"))});
    std::vector<std::string> names;
    cpu->EnumerateProperties([&](boost::shared_ptr<ICIMProperty> p) {
        names.push_back(p->GetDeclaration(none)->GetName(none));
        return true;
    }, none);
    EXPECT_EQ(std::vector<std::string>({"Caption", "Name", "DeviceID", "MaxClockSpeed"}), names);
    EXPECT_EQ(std::vector<std::string>({"Caption", "Name", "DeviceID", "Availability", "MaxClockSpeed"}),
              ns->GetClass("ORVSG_Processor", none)->GetPropertyList("", none));
}

TEST(Repository, QualifiersPropagateToSubclassesUnlessOverridden) {
    auto ns = Devices();
    TCIMContext none;
    bool propagated = true;
    auto cpuCaption = ns->GetClass("ORVSG_Processor", none)->GetPropertyDecl("caption", none);
    EXPECT_EQ("Processor", cpuCaption->GetQualifier("DisplayName", propagated, none)->GetValue(none).ToString(10));
    EXPECT_FALSE(propagated);
    EXPECT_EQ(64, static_cast<int>(cpuCaption->GetQualifier("MaxLen", propagated, none)->GetValue(none)));
    EXPECT_TRUE(propagated) << "MaxLen comes from the overridden declaration";
    auto fanCaption = ns->GetClass("ORVSG_Fan", none)->GetPropertyDecl("Caption", none);
    EXPECT_EQ("Caption", fanCaption->GetQualifier("DisplayName", propagated, none)->GetValue(none).ToString(10));
    EXPECT_TRUE(propagated);
    EXPECT_EQ(NORVTKR20::kNotFound, StatusOf([&] { fanCaption->GetQualifier("NOTIMEPRECISION", propagated, none); }));
    EXPECT_EQ(NORVTKR20::kNotFound, StatusOf([&] { ns->GetClass("ORVSG_Fan", none)->GetPropertyDecl("Nope", none); }));
}

TEST(Repository, ValueMapsTurnCodesIntoTheirTexts) {
    auto ns = Devices();
    TCIMContext none;
    struct Case {
        unsigned short code;
        const char* text;
    } cases[] = {{2, "Unknown"}, {3, "Running/Full Power"}, {4, "Warning or Testing"}, {5, "Warning or Testing"},
                 {17, "DMTF Reserved"}};
    for (const Case& c : cases) {
        auto dev = ns->AddInstance("CIM_LogicalDevice", {V("DeviceID", TCIMValue("X")), V("Availability", TCIMValue(c.code))});
        auto prop = dev->GetProperty("Availability", none);
        EXPECT_EQ(c.text, prop->GetValueString()) << c.code;
        EXPECT_EQ(c.text, prop->GetValueMapString()) << c.code;
        EXPECT_EQ(c.code, static_cast<unsigned short>(prop->GetValue())) << "the raw value stays";
    }
}

TEST(Repository, ArraysGiveOneDisplayTextPerElement) {
    auto ns = Devices();
    TCIMContext none;
    auto fan = ns->AddInstance(
        "ORVSG_Fan", {V("DeviceID", TCIMValue("F2")),
                      V("Speeds", TCIMValue::Array(T::eUint32, {TCIMValue(1200u), TCIMValue::Null(T::eUint32), TCIMValue(4800u)}))});
    auto speeds = fan->GetProperty("Speeds", none);
    EXPECT_TRUE(speeds->IsArray(none));
    EXPECT_EQ(std::vector<std::string>({"1200", "", "4800"}), speeds->GetValueStrings());
    auto empty = ns->AddInstance("ORVSG_Fan", {V("DeviceID", TCIMValue("F3")), V("Speeds", TCIMValue::Array(T::eUint32, {}))});
    EXPECT_TRUE(empty->GetProperty("Speeds", none)->GetValueStrings().empty());
    EXPECT_EQ("", empty->GetProperty("Speeds", none)->GetValueString());
}

TEST(Repository, RowMergeAndDateTimeDisplay) {
    auto ns = Devices();
    TCIMContext none;
    auto cpu = All(*ns, "ORVSG_Processor")[0];
    EXPECT_TRUE(cpu->GetProperty("MaxClockSpeed", none)->IsRowMergeProperty());
    EXPECT_FALSE(cpu->GetProperty("Name", none)->IsRowMergeProperty());
    cpu->AddProperty("InstallDate", TCIMValue(NORVTKR20::TCIMDateTime(2012, 1, 5, 0, 0, 0, 0, 0)), none);
    auto date = cpu->GetProperty("InstallDate", none);
    EXPECT_EQ(14, static_cast<int>(static_cast<T::ECIMType>(date->GetType(none))));
    EXPECT_EQ("2012-01-05 00:00:00", date->GetValueString());
}

TEST(Repository, SchemaLoadedAfterInstancesTakesOverTheirProperties) {
    auto ns = TMemoryNamespace::Create();
    ns->AddInstance("ORVSG_Memory", {V("Capacity", TCIMValue::Unsigned(T::eUint64, 17179869184ull)), V("Tag", TCIMValue("DIMM A1")),
                                     V("Vendor", TCIMValue("Kestrel"))});
    ns->DeclareClass(C("ORVSG_Memory", "", {P("Tag", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                                            P("Capacity", T::eUint64, {Q("DisplayName", TCIMValue("Capacity (bytes)"))})}));
    TCIMContext none;
    auto mem = All(*ns, "ORVSG_Memory");
    ASSERT_EQ(1u, mem.size());
    EXPECT_EQ("17179869184", mem[0]->GetProperty("Capacity", none)->GetValueString());
    EXPECT_EQ("Kestrel", mem[0]->GetProperty("Vendor", none)->GetValueString()) << "undeclared properties stay";
    bool propagated = false;
    EXPECT_EQ("Capacity (bytes)", mem[0]->GetProperty("Capacity", none)->GetDeclaration(none)
                                      ->GetQualifier("DisplayName", propagated, none)->GetValue(none).ToString(10));
    EXPECT_EQ("ORVSG_Memory.Tag=\"DIMM A1\"", mem[0]->GetPath(none).GetPath());

    // A later declaration of the same class replaces the earlier one.
    ns->DeclareClass(C("ORVSG_Memory", "", {P("Tag", T::eString)}));
    EXPECT_EQ(NORVTKR20::kNotFound, StatusOf([&] {
        ns->GetClass("ORVSG_Memory", none)->GetPropertyDecl("Capacity", none)->GetQualifier("DisplayName", propagated, none);
    }));
}
