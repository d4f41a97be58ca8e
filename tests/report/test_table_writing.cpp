// The table engine: which rows a declared table shows, the text of each
// cell, how instances are grouped into grids in both report styles, and the
// tables nested under an instance. Each case writes tables through the
// engine; its transcript is compared with engine/tables.txt under the
// case's name.
#include <algorithm>
#include <functional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TWriterUtil.h"
#include "report/EngineFixture.h"
#include "report/ExpectedPage.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMNamespace;
using NORVTKR20::TCIMValue;
using testing::TEngineRun;
using testing::TRepoBuilder;
using testrepo::C;
using testrepo::P;
using testrepo::Q;
using testrepo::T;
using testrepo::V;

TReportClass Table(const std::string& className, const std::vector<TReportProperty>& columns,
                   const std::string& title = "") {
    TReportClass table;
    table.SetClass(className);
    table.SetProperties(columns);
    if (!title.empty()) table.SetTitle(title);
    return table;
}

TReportProperty Column(const std::string& property, const std::string& width, const std::string& defaultValue = "") {
    return TReportProperty(property, width, "", "", "", defaultValue);
}

// Writes the table over every instance of its class, as a page writes it.
template <typename TWriterType = testing::TRecordingWriter>
std::string Write(boost::shared_ptr<ICIMNamespace> ns, const TReportClass& table, bool topLevel = true) {
    TEngineRun<TWriterType> run(ns);
    run.writer.SetSeparatorText(1, " / ");
    run.writer.WriteTable(table, testrepo::All(*ns, table.GetClass()), topLevel, !topLevel, {});
    return run.Transcript();
}

boost::shared_ptr<ICIMNamespace> Parsed(const std::string& text) {
    TRepoBuilder repo;
    repo.Parse(text);
    return repo.Namespace();
}

// Log records whose name asks identical neighbouring rows to be shown once
// (unless `rowMerge` is false); a row is a name and a note.
boost::shared_ptr<ICIMNamespace> LogRecords(const std::vector<std::vector<std::string>>& rows, bool rowMerge = true) {
    auto ns = repository::TMemoryNamespace::Create();
    std::vector<repository::TQualifierData> merge;
    if (rowMerge) merge.push_back(Q("RowMerge", TCIMValue::Boolean(true)));
    ns->DeclareClass(C("ORVSG_TKRLogRecord", "", {P("Name", T::eString, merge), P("Note", T::eString)}));
    for (const std::vector<std::string>& row : rows) {
        ns->AddInstance("ORVSG_TKRLogRecord", {V("Name", TCIMValue(row[0])), V("Note", TCIMValue(row[1]))});
    }
    ns->Link();
    return ns;
}

// Completion records, one of them a disk's default record; the records'
// code may ask for repeated rows to be merged.
boost::shared_ptr<ICIMNamespace> CompletionRecords(bool rowMerge) {
    auto ns = repository::TMemoryNamespace::Create();
    std::vector<repository::TQualifierData> merge;
    if (rowMerge) merge.push_back(Q("RowMerge", TCIMValue::Boolean(true)));
    ns->DeclareClass(C("LSIESG_CompletionRecord", "", {P("Code", T::eString, merge)}));
    ns->DeclareClass(C("LSIESG_DiskDefaultCompletionRecord", "LSIESG_CompletionRecord", {}));
    for (const char* code : {"1", "2", "3"}) {
        ns->AddInstance(code[0] == '2' ? "LSIESG_DiskDefaultCompletionRecord" : "LSIESG_CompletionRecord",
                        {V("Code", TCIMValue(code))});
    }
    ns->Link();
    return ns;
}

boost::shared_ptr<ICIMNamespace> NineModules() {
    TRepoBuilder repo;
    for (int i = 1; i <= 9; ++i) {
        repo.Add("ORVSG_Memory", {testing::Str("Name", "m" + std::to_string(i)), testing::Str("Size", std::to_string(i))});
    }
    return repo.Namespace();
}

TReportClass ModuleColumns() {
    TReportClass table = Table("ORVSG_Memory", {Column("Name", "60%"), Column("Size", "40%")});
    table.SetMaxInstancesPerTable(8);
    table.SetTableWidth("80%");
    table.SetTableSortable();
    return table;
}

TReportClass ModuleRows() {
    TReportClass table = Table("ORVSG_Memory", {Column("Name", "0%"), Column("Size", "0%")});
    table.SetReportStyle(TReportClass::ROW_REPORT);
    table.SetRowReportHeaderWidth("20%");
    table.SetMaxInstancesPerTable(8);
    return table;
}

// Adapters with a sub-title, each followed by its ports sorted by speed
// (eth0 and eth9 tie and keep their order).
TReportClass AdaptersAndPorts() {
    TReportClass ports = Table("ORVSG_Port", {Column("Name", "50%"), Column("Speed", "50%")}, "Ports");
    ports.SetAssociatorsFilter("ORVSG_AdapterPort", "ORVSG_Port", "Antecedent", "Dependent");
    ports.GetInstanceSorter().AddProperty("Speed", true, false);
    TReportClass adapters = Table("ORVSG_Adapter", {Column("DeviceID", "100%")}, "Adapters");
    adapters.EnableSubTitle();
    adapters.SetAssociatedClass();
    adapters.SetAssociatedClasses({ports});
    return adapters;
}

// A column through an association: nothing answers on the first step of
// the names, whose second step goes to any associated port.
TReportClass PortColumns() {
    TReportProperty names("Name", "50%", "ORVSG_NoSuchAssociation", "ORVSG_Port", "", "");
    names.SetSecondaryAssociationTarget("ORVSG_Port");
    return Table("ORVSG_Adapter", {names, TReportProperty("Speed", "50%", "ORVSG_AdapterPort", "ORVSG_Port", "Port Speeds", "none")});
}

TEST(TableEngine, WritesTheTablesAsExpected) {
    TReportProperty ports = Column("Ports", "50%");
    ports.SetArrayValueSeparator(TReportProperty::SEPARATOR_1);
    ports.SetMonospaced();
    const std::vector<std::pair<std::string, std::function<std::string()>>> cases = {
        // An empty first column says "N/A", the others their default.
        {"defaults", [] {
             return Write(Parsed("ORVSG_Card Name=\"\" Vendor=\"\" Serial=\"\"\nORVSG_Card Name=\"X\" Vendor=\"V\" "
                                 "Serial=\"S\"\nORVSG_Card Other=1"),
                          Table("ORVSG_Card", {Column("Name", "40%"), Column("Vendor", "30%", "Unknown"),
                                               Column("Serial", "30%")}));
         }},
        // A numeric sensor's reading is scaled, another class's is not; an
        // installation date at midnight loses its time; process figures
        // become plain numbers under labels of their own.
        {"rewritten values", [] {
             std::string text;
             for (const char* instance : {"CIM_NumericSensor CurrentReading=\"2375\"",
                                          "CIM_NumericSensor CurrentReading=sint32:-150",
                                          "ORVSG_Sensor CurrentReading=\"2375\""}) {
                 const std::string cls = std::string(instance).substr(0, std::string(instance).find(' '));
                 text += Write(Parsed(instance), Table(cls, {Column("CurrentReading", "100%")}));
             }
             for (const char* date : {"2012-01-05 00:00:00", "2012-01-05 10:00:00"}) {
                 text += Write(Parsed(std::string("ORVSG_Software ProductInstallDate=\"") + date + "\""),
                               Table("ORVSG_Software", {Column("ProductInstallDate", "100%")}));
             }
             return text + Write(Parsed("ORVSG_Process WorkingSetSize=\"2 Megabytes\""),
                                 Table("ORVSG_Process", {Column("WorkingSetSize", "100%")}));
         }},
        // Arrays take the column's separator; a monospaced column is marked.
        {"arrays", [ports] {
             return Write(Parsed("ORVSG_Card Name=\"c\" Ports=string[]:\"p1\",\"p2\""),
                          Table("ORVSG_Card", {Column("Name", "50%"), ports}));
         }},
        // Only neighbours are compared: X Y X, then X Y Y X X, stand as X Y X;
        // without the property every row stands.
        {"merged rows", [] {
             const TReportClass table = Table("ORVSG_TKRLogRecord", {Column("Name", "100%")});
             return Write(LogRecords({{"X", ""}, {"Y", ""}, {"X", ""}}), table) +
                    Write(LogRecords({{"X", ""}, {"Y", ""}, {"Y", ""}, {"X", ""}, {"X", ""}}), table) +
                    Write(LogRecords({{"X", ""}, {"X", ""}}, false), table);
         }},
        // The writer upper-cases, so a cell's text and its mapped (raw) text
        // can differ while the texts compared are equal. When the first row's
        // name is empty (its text the default "-"), each repeat with a name
        // takes the place of the row kept before it; when the first row has a
        // name it stays.
        {"merged rows with mapped texts", [] {
             const TReportClass table = Table("ORVSG_TKRLogRecord", {Column("Name", "50%", "-"), Column("Note", "50%")});
             return Write<testing::TUpperCaseWriter>(LogRecords({{"", "abc"}, {"-", "ABC"}, {"", "abc"}, {"-", "Abc"}}), table) +
                    Write<testing::TUpperCaseWriter>(LogRecords({{"", "abc"}, {"", "aBC"}}), table) +
                    Write<testing::TUpperCaseWriter>(LogRecords({{"-", "abc"}, {"-", "ABC"}}), table);
         }},
        // A disk's default completion record never shows, merged or not; a
        // table of such records alone has its title and no grid.
        {"default completion records", [] {
             const TReportClass all = Table("LSIESG_CompletionRecord", {Column("Code", "100%")}, "Completion");
             const TReportClass defaults = Table("LSIESG_DiskDefaultCompletionRecord", {Column("Code", "100%")}, "Completion");
             return Write(CompletionRecords(false), all) + Write(CompletionRecords(true), all) +
                    Write(CompletionRecords(false), defaults);
         }},
        // Nine instances with a limit of eight make two grids in both styles;
        // a row report has the labels in a first column of their own width.
        {"groups of eight", [] { return Write(NineModules(), ModuleColumns()) + Write(NineModules(), ModuleRows()); }},
        // Below the top level, nested tables are not written.
        {"nested tables", [] {
             return Write(testing::AdaptersWithPorts(), AdaptersAndPorts()) + "-- below the top level\n" +
                    Write(testing::AdaptersWithPorts(), AdaptersAndPorts(), false);
         }},
        {"columns through an association", [] { return Write(testing::AdaptersWithPorts(), PortColumns()); }},
    };
    std::string dump;
    for (const auto& c : cases) dump += "## " + c.first + "\n" + c.second();
    EXPECT_EQ(testing::ExpectedPage("engine/tables.txt", dump), dump);
}

// Tables are ordered by the sorter's own comparison, which takes the
// difference of two numbers as a signed 64-bit number: a 19-digit number
// above 2^63 therefore goes before 1. Both the nested tables that WriteTable
// sorts and the top-level instances that GetInstances sorts follow it, and
// so does a run where numbers so far apart could make the order go round in
// a circle.
TEST(TableEngine, OrdersRowsByTheSortersComparisonEvenForTwentyDigitNumbers) {
    const std::string huge = "9300000000000000000";
    ASSERT_LT(TInstanceSorter::PropertyCompare(huge, "1", true), 0);
    auto ns = testing::AdaptersWithPorts({{"a1", "p1", "1"}, {"a1", "p2", huge}, {"a1", "p3", "5"}});

    TEngineRun<> run(ns);
    const TReportClass adapters = AdaptersAndPorts();
    run.writer.WriteTable(adapters, testrepo::All(*ns, "ORVSG_Adapter"), true, false, {});
    const std::string expected = "| \"p2\" \"" + huge + "\" | \"p1\" \"1\" | \"p3\" \"5\")";
    bool found = false;
    for (const std::string& grid : run.Grids()) found = found || grid.find(expected) != std::string::npos;
    EXPECT_TRUE(found) << run.Transcript();

    TReportClass ports = Table("ORVSG_Port", {Column("Name", "50%")});
    ports.GetInstanceSorter().AddProperty("Speed", true, false);
    std::vector<std::string> names;
    for (const auto& port : TWriterUtil::GetInstances(ns, ports))
        names.push_back(TInstanceSorter::GetFinalPropertyValue("Name", port));
    EXPECT_EQ((std::vector<std::string>{"p2", "p1", "p3"}), names);

    // 0, 6e18 and 1.2e19 each go before the next, and the last before the
    // first: whatever order comes out, every port is there once.
    std::vector<std::vector<std::string>> circle;
    for (int i = 0; i < 40; ++i) {
        const char* const values[] = {"0", "6000000000000000000", "12000000000000000000"};
        circle.push_back({"a1", "c" + std::to_string(i), values[i % 3]});
    }
    auto round = testing::AdaptersWithPorts(circle);
    std::vector<std::string> seen;
    for (const auto& port : TWriterUtil::GetInstances(round, ports))
        seen.push_back(TInstanceSorter::GetFinalPropertyValue("Name", port));
    std::sort(seen.begin(), seen.end());
    std::vector<std::string> all;
    for (int i = 0; i < 40; ++i) all.push_back("c" + std::to_string(i));
    std::sort(all.begin(), all.end());
    EXPECT_EQ(all, seen);
}

TEST(TableFilter, ClassesWithoutPassingInstancesAreRemoved) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Disk Name="d1" Model="ST"
        ORVSG_Fan Name="f1"
        class ORVSG_Empty
    )");
    TEngineRun<> run(repo.Namespace());
    std::vector<TReportClass> classes = {Table("ORVSG_Fan", {}), Table("ORVSG_Empty", {}), Table("ORVSG_Disk", {}),
                                         Table("ORVSG_NoSuchClass", {}), Table("ORVSG_Disk", {}, "kept")};
    classes[2].GetPropertyFilters().push_back(TReportClass::TPropertyFilter("WD", "Model", false));
    classes.erase(run.writer.ClassFilter(classes.begin(), classes.end()), classes.end());
    ASSERT_EQ(2u, classes.size());
    EXPECT_EQ("ORVSG_Fan", classes[0].GetClass());
    EXPECT_EQ("kept", classes[1].GetTitle());
}

}  // namespace
}  // namespace braigrion

namespace braigrion {
namespace {

// Keeps the declared units of every grid the engine writes.
class TUnitsWriter : public testing::TRecordingWriter {
public:
    using TRecordingWriter::TRecordingWriter;
    void WriteTableGrid(TTable& table) override {
        units.push_back(table.fUnits);
        TRecordingWriter::WriteTableGrid(table);
    }
    std::vector<std::vector<std::string>> units;
};

// Each grid carries the "Units" of its properties, one per column (per row
// in a row report), inherited declarations and association targets
// included; a property without the qualifier, or not declared, has "".
TEST(TableEngine, GridsCarryTheDeclaredUnits) {
    TRepoBuilder repo;
    auto ns = repo.Namespace();
    ns->DeclareClass(C("CIM_Extent", "", {P("Capacity", T::eUint64, {Q("Units", TCIMValue("KiloBytes"))})}));
    ns->DeclareClass(C("ORVSG_Disk", "CIM_Extent",
                       {P("Name", T::eString), P("Size", T::eUint64, {Q("Units", TCIMValue("Bytes"))})}));
    repo.Add("ORVSG_Disk", {testing::Str("Name", "sda"), testrepo::V("Size", TCIMValue::Unsigned(T::eUint64, 4096)),
                            testrepo::V("Capacity", TCIMValue::Unsigned(T::eUint64, 4))});
    repo.Add("ORVSG_Disk", {testing::Str("Name", "sdb")});
    TReportClass columns =
        Table("ORVSG_Disk", {Column("Name", "25%"), Column("Size", "25%"), Column("Capacity", "25%"), Column("Nothing", "25%")});
    const std::vector<std::string> expected = {"", "Bytes", "KiloBytes", ""};
    for (auto style : {TReportClass::COLUMN_REPORT, TReportClass::ROW_REPORT}) {
        columns.SetReportStyle(style);
        TEngineRun<TUnitsWriter> run(ns);
        run.writer.WriteTable(columns, testrepo::All(*ns, "ORVSG_Disk"), true, false, {});
        ASSERT_EQ(1u, run.writer.units.size());
        EXPECT_EQ(expected, run.writer.units[0]);
    }
}

}  // namespace
}  // namespace braigrion
