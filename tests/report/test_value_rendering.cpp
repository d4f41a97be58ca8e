// Value rendering: the texts of properties, associations, sensors and
// labels, and the instances of a table, filtered and sorted.
#include <algorithm>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TWriterUtil.h"
#include "report/EngineFixture.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMValue;
using testing::TEngineRun;
using testing::TRepoBuilder;
using testing::TUpperCaseWriter;
using testrepo::C;
using testrepo::P;
using testrepo::Q;
using testrepo::T;
using testrepo::V;

typedef boost::shared_ptr<ICIMInstance> TInstancePtr;
typedef std::vector<std::string> TTexts;

TCIMValue Date(unsigned short hour) {
    return TCIMValue(TCIMDateTime(2012, 1, 5, hour, 30, 0, 0, 0));
}

// One firmware element with dates (one declared NOTIMEPRECISION), arrays
// and a labelled name.
struct TFirmware {
    boost::shared_ptr<repository::TMemoryNamespace> ns = repository::TMemoryNamespace::Create();
    TInstancePtr bios;

    TFirmware() {
        ns->DeclareClass(C("ORVSG_Firmware", "",
                           {P("Name", T::eString, {Q("DisplayName", TCIMValue("Firmware Name"))}),
                            P("ReleaseDate", T::eDateTime, {Q("NOTIMEPRECISION", TCIMValue::Boolean(true))}),
                            P("InstallDate", T::eDateTime), P("Versions", T::eString, {}, true),
                            P("Dates", T::eDateTime, {}, true), P("Empty", T::eString, {}, true),
                            P("Missing", T::eDateTime), P("Note", T::eString)}));
        bios = ns->AddInstance(
            "ORVSG_Firmware",
            {V("Name", TCIMValue("bios")), V("ReleaseDate", Date(10)), V("InstallDate", Date(10)),
             V("Versions", testrepo::Strings({"a", "b", "c"})),
             V("Dates", TCIMValue::Array(T::eDateTime, {Date(1), Date(2)})),
             V("Empty", TCIMValue::Array(T::eString, {})), V("Missing", TCIMValue::Null(T::eDateTime)),
             V("Note", TCIMValue(""))});
        ns->Link();
    }
};

TEST(PropertyValue, DatesShowTheirWholeDisplayText) {
    TFirmware fw;
    TEngineRun<> run(fw.ns);
    // The qualifier is looked for, and the text is the same either way.
    EXPECT_EQ("2012-01-05 10:30:00", run.writer.GetPropertyValue(fw.bios, "ReleaseDate", ", "));
    EXPECT_EQ("2012-01-05 10:30:00", run.writer.GetPropertyValue(fw.bios, "InstallDate", ", "));
    EXPECT_EQ("2012-01-05 01:30:00 2012-01-05 02:30:00", run.writer.GetPropertyValue(fw.bios, "Dates", ", "));
    EXPECT_EQ("", run.writer.GetPropertyValue(fw.bios, "Missing", ", "));
    EXPECT_EQ("", TWriterUtil::GetDateTime(TCIMValue(), true));
}

TEST(PropertyValue, TextsAreEscapedAndArraysJoined) {
    TFirmware fw;
    TEngineRun<TUpperCaseWriter> run(fw.ns);
    struct TCase {
        std::string property;
        std::string separator;
        std::string expected;
    } cases[] = {
        {"Name", ", ", "BIOS"},
        {"Versions", ", ", "A, B, C"},
        {"Versions", " and ", "A and B and C"},  // the separator is not escaped
        {"Empty", ", ", ""},
        {"NoSuchProperty", ", ", ""},
    };
    for (const TCase& c : cases) {
        EXPECT_EQ(c.expected, run.writer.GetPropertyValue(fw.bios, c.property, c.separator)) << c.property;
    }

    TCIMContext context;
    TWriter::TPropertyPtr name = fw.bios->GetProperty("Name", context);
    EXPECT_EQ("BIOS", run.writer.GetValueFromProperty(name, ", ", false));
    EXPECT_EQ("bios", run.writer.GetValueFromProperty(name, ", ", true));  // mapped text as it is
    EXPECT_EQ("A; B; C", run.writer.GetValueFromProperty(fw.bios->GetProperty("Versions", context), "; ", true));
}

TEST(PropertyValue, SeveralPropertiesGetNoSeparatorBeforeAnEmptyValue) {
    TFirmware fw;
    TEngineRun<> run(fw.ns);
    TCIMContext context;
    TWriter::TPropertyPtr name = fw.bios->GetProperty("Name", context);
    TWriter::TPropertyPtr empty = fw.bios->GetProperty("Note", context);
    struct TCase {
        std::vector<TWriter::TPropertyPtr> properties;
        std::string expected;
    } cases[] = {
        {{}, ""},
        {{name, empty, name}, "bios | bios"},
        {{empty, name}, " | bios"},  // the separator stands before a value, after an empty one too
    };
    for (size_t i = 0; i < sizeof cases / sizeof cases[0]; ++i) {
        EXPECT_EQ(cases[i].expected, run.writer.GetValuesFromProperties(cases[i].properties, " | ", false)) << i;
    }
}

TEST(PropertyValue, AssociatedValuesAreJoinedByBlanks) {
    auto ns = testing::AdaptersWithPorts();
    std::vector<TInstancePtr> adapters = testrepo::All(*ns, "ORVSG_Adapter");
    TEngineRun<> run(ns);
    struct TCase {
        size_t adapter;
        std::string role;
        std::string expected;
    } cases[] = {{0, "Antecedent", "eth1 eth0 eth9"}, {2, "Antecedent", ""}, {0, "Dependent", ""}};
    for (const TCase& c : cases) {
        EXPECT_EQ(c.expected, run.writer.GetPropertyValueFromAssociation(adapters[c.adapter], "ORVSG_AdapterPort",
                                                                         "ORVSG_Port", c.role, "Name"));
    }
    EXPECT_EQ("ORVSG_Adapter", run.writer.GetUniqueId(adapters[0], ""));
    EXPECT_EQ("ORVSG_Adapter_a2", run.writer.GetUniqueId(adapters[1], "DeviceID"));
    EXPECT_EQ("ORVSG_Adapter", run.writer.GetUniqueId(adapters[1], "Speed"));
}

TEST(PropertyValue, NumericSensorReadingIsScaledByItsModifier) {
    TRepoBuilder repo;
    repo.Parse(R"(
        CIM_NumericSensor Name="a" CurrentReading=sint32:2375 UnitModifier=sint32:-2
        CIM_NumericSensor Name="b" CurrentReading=5 UnitModifier=sint32:3
        CIM_NumericSensor Name="c" CurrentReading=5
        CIM_NumericSensor Name="d" CurrentReading=null:sint32 UnitModifier=sint32:0
    )");
    TEngineRun<> run(repo.Namespace());
    std::vector<TInstancePtr> sensors = testrepo::All(*repo.Namespace(), "CIM_NumericSensor");
    ASSERT_EQ(4u, sensors.size());
    const TTexts expected = {"23.75", "5000", "N/A", "N/A"};
    for (size_t i = 0; i < sensors.size(); ++i) EXPECT_EQ(expected[i], run.writer.GetNumericSensorValue(sensors[i], true));
}

TEST(HeaderLabel, FixedLabelsOverridesDisplayNamesAndNames) {
    TFirmware fw;
    fw.ns->DeclareClass(C("ORVSG_Process", "", {P("KernelModeTime", T::eString), P("Caption", T::eString)}));
    fw.ns->DeclareClass(C("ORVSG_IPMILogRecord", "", {P("EventData", T::eString), P("KernelModeTime", T::eString)}));
    fw.ns->Link();
    TEngineRun<> run(fw.ns);
    TCIMContext context;
    struct TCase {
        std::string className;
        TReportProperty property;
        std::string label;
    } cases[] = {
        {"ORVSG_Process", TReportProperty("KernelModeTime", "", "", "", "Ignored", ""), "Kernel Mode Time (millisecond)"},
        {"ORVSG_IPMILogRecord", TReportProperty("EventData", "", "", "", "", ""), "Original Line / Action Plan(s)"},
        {"ORVSG_IPMILogRecord", TReportProperty("KernelModeTime", "", "", "", "", ""), "KernelModeTime"},
        {"ORVSG_Process", TReportProperty("Caption", "", "", "", "Process", ""), "Process"},
        {"ORVSG_Firmware", TReportProperty("Name", "", "", "", "", ""), "Firmware Name"},
        {"ORVSG_Firmware", TReportProperty("versions", "", "", "", "", ""), "Versions"},  // the declared name
        {"ORVSG_Firmware", TReportProperty("NoSuchProperty", "", "", "", "", ""), "NoSuchProperty"},
        // With an association target the label comes from the target class.
        {"ORVSG_Process", TReportProperty("Name", "", "A", "ORVSG_Firmware", "", ""), "Firmware Name"},
        {"ORVSG_Process", TReportProperty("Name", "", "A", "ORVSG_NoSuchClass", "", ""), "Name"},
    };
    for (const TCase& c : cases) {
        boost::shared_ptr<ICIMClass> cls = fw.ns->GetClass(c.className, context);
        EXPECT_EQ(c.label, run.writer.GetTableHeaderLabel(*cls, c.property, {})) << c.className << "." << c.label;
    }

    EXPECT_TRUE(TWriterUtil::IsPropertyNull(fw.bios, "Missing"));
    EXPECT_TRUE(TWriterUtil::IsPropertyNull(fw.bios, "NoSuchProperty"));
    EXPECT_FALSE(TWriterUtil::IsPropertyNull(fw.bios, "Note"));
}

const char kDisks[] = R"(
    ORVSG_Disk Name="Slot 10" Model="ST1000" Serial="A1"
    ORVSG_Disk Name="Slot 9" Model="WD20" Serial=null:string
    ORVSG_Disk Name="slot 2" Model="ST-X"
    ORVSG_Disk Name="Slot 3" Model="HGST"
    ORVSG_Disk Name="SLOT 3" Model=null:string Serial="B2"
)";

TTexts Names(const std::vector<TInstancePtr>& instances) {
    TTexts names;
    for (const TInstancePtr& instance : instances) {
        names.push_back(TInstanceSorter::GetFinalPropertyValue("Name", instance));
    }
    return names;
}

TEST(Instances, FiltersKeepOrDropByTheTextOfAProperty) {
    TRepoBuilder repo;
    repo.Parse(kDisks);
    struct TFilter {
        std::string value;
        std::string property;
        bool exclude;
    };
    struct TCase {
        std::vector<TFilter> filters;
        TTexts names;
    } cases[] = {
        {{}, {"Slot 10", "Slot 9", "slot 2", "Slot 3", "SLOT 3"}},
        {{{"ST", "Model", false}}, {"Slot 10", "slot 2", "Slot 3"}},
        {{{"ST", "Model", false}, {"-X", "Model", true}}, {"Slot 10", "Slot 3"}},
        // A null or missing filter property drops the instance either way.
        {{{"zzz", "Serial", true}}, {"Slot 10", "SLOT 3"}},
        {{{"", "Model", false}}, {"Slot 10", "Slot 9", "slot 2", "Slot 3"}},
    };
    for (const TCase& c : cases) {
        TReportClass table;
        table.SetClass("ORVSG_Disk");
        for (const TFilter& f : c.filters) table.GetPropertyFilters().push_back(TReportClass::TPropertyFilter(f.value, f.property, f.exclude));
        EXPECT_EQ(c.names, Names(TWriterUtil::GetInstances(repo.Namespace(), table)));
    }

    TReportClass absent;
    absent.SetClass("ORVSG_NoSuchClass");
    EXPECT_TRUE(TWriterUtil::GetInstances(repo.Namespace(), absent).empty());
}

// Ascending natural order is the shared list's (see the back-end tests).
TEST(Instances, DescendingKeysReverseAndLongNumbersOrderAsTheSorterOrders) {
    TRepoBuilder repo;
    repo.Parse(kDisks);
    TReportClass table;
    table.SetClass("ORVSG_Disk");
    table.GetPropertyFilters().push_back(TReportClass::TPropertyFilter("3", "Name", true));
    table.GetInstanceSorter().AddProperty("Name", false, false);
    EXPECT_EQ((TTexts{"Slot 10", "Slot 9", "slot 2"}), Names(TWriterUtil::GetInstances(repo.Namespace(), table)));

    // Numbers compare by their difference taken as signed, as the sorter
    // compares them: the largest 64-bit number is 2 short of 1.
    TRepoBuilder big;
    big.Parse(R"(
        ORVSG_Disk Name="Disk 18446744073709551615"
        ORVSG_Disk Name="Disk 1"
    )");
    table.GetPropertyFilters().clear();
    table.GetInstanceSorter().Reset();
    table.GetInstanceSorter().AddProperty("Name", true, false);
    EXPECT_EQ((TTexts{"Disk 18446744073709551615", "Disk 1"}), Names(TWriterUtil::GetInstances(big.Namespace(), table)));
}

// Reading each sort text once must give the very order that sorting with
// the sorter itself gives, ties included.
TEST(Instances, SortingByReadKeysMatchesSortingWithTheSorter) {
    TRepoBuilder repo;
    const char* const bays[] = {"Bay 1", "bay 01", "Bay 10", "", "Bay 2b", "BAY 2a"};
    for (unsigned int i = 0; i < 300; ++i) {
        repo.Add("ORVSG_Disk", {testing::Str("Bay", bays[(i * 7) % 6]), testing::U32("Index", (i * 13) % 17),
                                testing::Str("Name", "disk " + std::to_string(i))});
    }
    std::vector<TInstancePtr> all = testrepo::All(*repo.Namespace(), "ORVSG_Disk");
    TInstanceSorter sorter;
    sorter.AddProperty("Bay", true, false);
    sorter.AddProperty("Index", false, true);

    std::vector<TInstancePtr> expected = all;
    std::sort(expected.begin(), expected.end(), sorter);
    TReportClass table;
    table.SetClass("ORVSG_Disk");
    table.GetInstanceSorter() = sorter;
    EXPECT_EQ(Names(expected), Names(TWriterUtil::GetInstances(repo.Namespace(), table)));

    std::vector<TInstancePtr> stable = all;
    std::stable_sort(stable.begin(), stable.end(), sorter);
    std::vector<TInstancePtr> sorted = all;
    TWriterUtil::SortInstances(sorted, sorter, true);
    EXPECT_EQ(Names(stable), Names(sorted));
}

}  // namespace
}  // namespace braigrion
