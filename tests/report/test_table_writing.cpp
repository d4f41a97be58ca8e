// The table engine: which rows a declared table shows, the text of each
// cell, how instances are grouped into grids in both report styles, and the
// tables nested under an instance.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TWriterUtil.h"
#include "report/EngineFixture.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using NORVTKR20::ICIMInstance;
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
typedef std::vector<std::string> TLines;

TReportClass Table(const std::string& className, const std::vector<TReportProperty>& columns) {
    TReportClass table;
    table.SetClass(className);
    table.SetProperties(columns);
    return table;
}

TReportProperty Column(const std::string& property, const std::string& width, const std::string& defaultValue = "") {
    return TReportProperty(property, width, "", "", "", defaultValue);
}

template <typename TRun>
void Write(TRun& run, const TReportClass& table, const std::vector<TInstancePtr>& instances) {
    run.writer.WriteTable(table, instances, true, false, {});
}

TEST(TableCells, FirstColumnSaysNAOthersTheirDefault) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_Card Name="" Vendor="" Serial=""
        ORVSG_Card Name="X" Vendor="V" Serial="S"
        ORVSG_Card Other=1
    )");
    TEngineRun<> run(repo.Namespace());
    TReportClass table = Table("ORVSG_Card", {Column("Name", "40%"), Column("Vendor", "30%", "Unknown"),
                                              Column("Serial", "30%")});
    Write(run, table, testrepo::All(*repo.Namespace(), "ORVSG_Card"));
    EXPECT_EQ(
        "WriteTableGrid(grid 4x3 width=100 widths=[40,30,30] colheaders | \"Name\" \"Vendor\" \"Serial\" | \"N/A\" "
        "\"Unknown\" \"\" | \"X\" \"V\" \"S\" | \"N/A\" \"Unknown\" \"\")\nWriteTableBreak()\n",
        run.Transcript());
}

TEST(TableCells, ReadingsDatesAndProcessFiguresAreRewritten) {
    struct TCase {
        std::string instance;  // repository text of one instance
        std::string property;
        std::string cell;      // header and value row of the grid
    } cases[] = {
        {"CIM_NumericSensor CurrentReading=\"2375\"", "CurrentReading", "\"CurrentReading\" | \"23.75\""},
        {"CIM_NumericSensor CurrentReading=sint32:-150", "CurrentReading", "\"CurrentReading\" | \"1.5\""},
        {"ORVSG_Sensor CurrentReading=\"2375\"", "CurrentReading", "\"CurrentReading\" | \"2375\""},
        {"ORVSG_Software ProductInstallDate=\"2012-01-05 00:00:00\"", "ProductInstallDate",
         "\"ProductInstallDate\" | \"2012-01-05 \""},
        {"ORVSG_Software ProductInstallDate=\"2012-01-05 10:00:00\"", "ProductInstallDate",
         "\"ProductInstallDate\" | \"2012-01-05 10:00:00\""},
        {"ORVSG_Process KernelModeTime=\"1 second 5 millisecond\"", "KernelModeTime",
         "\"Kernel Mode Time (millisecond)\" | \"1005\""},
        {"ORVSG_Process WorkingSetSize=\"2 Megabytes\"", "WorkingSetSize", "\"Memory Usage (KB)\" | \"2000\""},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.instance);
        const std::string className = c.instance.substr(0, c.instance.find(' '));
        TEngineRun<> run(repo.Namespace());
        Write(run, Table(className, {Column(c.property, "100%")}), testrepo::All(*repo.Namespace(), className));
        EXPECT_EQ("WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | " + c.cell + ")\nWriteTableBreak()\n", run.Transcript())
            << c.instance;
        if (c.property == "ProductInstallDate") {
            EXPECT_TRUE(run.log.Contains("Property name = ProductInstallDate"));
            EXPECT_TRUE(run.log.Contains("Property value = " + c.instance.substr(c.instance.find('"') + 1, 19)));
        }
    }
}

// Log records whose message asks identical neighbouring rows to be shown once.
boost::shared_ptr<repository::TMemoryNamespace> MergingLog(const std::vector<std::vector<std::string>>& rows,
                                                           bool rowMerge = true) {
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

std::string Rows(const std::vector<std::string>& names) {
    std::string text;
    for (const std::string& name : names) text += " | \"" + name + "\"";
    return text;
}

TEST(TableRows, RepeatedNeighboursShowOnceWhenAPropertyAsksForIt) {
    struct TCase {
        std::vector<std::string> names;
        bool rowMerge;
        std::vector<std::string> shown;
    } cases[] = {
        {{"X", "Y", "X"}, true, {"X", "Y", "X"}},  // only neighbours are compared
        {{"X", "X", "Y"}, true, {"X", "Y"}},
        {{"X", "Y", "Y", "X", "X"}, true, {"X", "Y", "X"}},
        {{"X", "X", "X"}, true, {"X"}},
        {{"X", "X"}, false, {"X", "X"}},  // no such property: every row stands
    };
    for (const TCase& c : cases) {
        std::vector<std::vector<std::string>> rows;
        for (const std::string& name : c.names) rows.push_back({name, ""});
        auto ns = MergingLog(rows, c.rowMerge);
        TEngineRun<> run(ns);
        Write(run, Table("ORVSG_TKRLogRecord", {Column("Name", "100%")}), testrepo::All(*ns, "ORVSG_TKRLogRecord"));
        EXPECT_EQ("WriteTableGrid(grid " + std::to_string(c.shown.size() + 1) +
                      "x1 width=100 widths=[100] colheaders | \"Name\"" + Rows(c.shown) + ")\nWriteTableBreak()\n",
                  run.Transcript());
    }
}

// The escaping writer upper-cases, so a cell's text and its mapped (raw)
// text can differ while the texts compared are equal.
TEST(TableRows, RepeatTakesTheFirstRowsPlaceWhenOnlyItHasAFirstMappedText) {
    struct TCase {
        std::vector<std::vector<std::string>> rows;  // Name, Note
        std::string shown;
    } cases[] = {
        // The first row's name is empty (its text is the default "-"); each
        // repeat with a name takes the place of the row kept before it.
        {{{"", "abc"}, {"-", "ABC"}, {"", "abc"}, {"-", "Abc"}}, "\"-\" \"ABC\"~\"Abc\""},
        {{{"", "abc"}, {"", "aBC"}}, "\"-\" \"ABC\"~\"abc\""},
        // The first row has a name: the first row stays.
        {{{"-", "abc"}, {"-", "ABC"}}, "\"-\" \"ABC\"~\"abc\""},
    };
    for (const TCase& c : cases) {
        auto ns = MergingLog(c.rows);
        TEngineRun<TUpperCaseWriter> run(ns);
        Write(run, Table("ORVSG_TKRLogRecord", {Column("Name", "50%", "-"), Column("Note", "50%")}),
              testrepo::All(*ns, "ORVSG_TKRLogRecord"));
        EXPECT_EQ("WriteTableGrid(grid 2x2 width=100 widths=[50,50] colheaders | \"Name\" \"Note\" | " + c.shown +
                      ")\nWriteTableBreak()\n",
                  run.Transcript());
    }
}

TEST(TableRows, DefaultDiskCompletionRecordsNeverShow) {
    for (bool rowMerge : {false, true}) {
        auto ns = repository::TMemoryNamespace::Create();
        std::vector<repository::TQualifierData> merge;
        if (rowMerge) merge.push_back(Q("RowMerge", TCIMValue::Boolean(true)));
        ns->DeclareClass(C("LSIESG_CompletionRecord", "", {P("Code", T::eString, merge)}));
        ns->DeclareClass(C("LSIESG_DiskDefaultCompletionRecord", "LSIESG_CompletionRecord", {}));
        ns->AddInstance("LSIESG_CompletionRecord", {V("Code", TCIMValue("1"))});
        ns->AddInstance("LSIESG_DiskDefaultCompletionRecord", {V("Code", TCIMValue("2"))});
        ns->AddInstance("LSIESG_CompletionRecord", {V("Code", TCIMValue("3"))});
        ns->Link();
        TEngineRun<> run(ns);
        TReportClass table = Table("LSIESG_CompletionRecord", {Column("Code", "100%")});
        table.SetTitle("Completion");
        Write(run, table, testrepo::All(*ns, "LSIESG_CompletionRecord"));
        EXPECT_EQ("WriteTableTitle(\"Completion\", false, false)\n"
                  "WriteTableGrid(grid 3x1 width=100 widths=[100] colheaders | \"Code\" | \"1\" | \"3\")\nWriteTableBreak()\n",
                  run.Transcript());

        // A table of such records alone has its title and no grid.
        run.writer.Clear();
        Write(run, table, testrepo::All(*ns, "LSIESG_DiskDefaultCompletionRecord"));
        EXPECT_EQ("WriteTableTitle(\"Completion\", false, false)\n", run.Transcript());
    }
}

TEST(TableGroups, NineInstancesWithALimitOfEightMakeTwoGridsInBothStyles) {
    TRepoBuilder repo;
    for (int i = 1; i <= 9; ++i) {
        repo.Add("ORVSG_Memory", {testing::Str("Name", "m" + std::to_string(i)), testing::Str("Size", std::to_string(i))});
    }
    std::vector<TInstancePtr> modules = testrepo::All(*repo.Namespace(), "ORVSG_Memory");

    TReportClass columns = Table("ORVSG_Memory", {Column("Name", "60%"), Column("Size", "40%")});
    columns.SetMaxInstancesPerTable(8);
    columns.SetTableWidth("80%");
    columns.SetTableSortable();
    TEngineRun<> byColumn(repo.Namespace());
    Write(byColumn, columns, modules);
    std::string first = "WriteTableGrid(grid 9x2 width=80 widths=[60,40] colheaders sortable marked | \"Name\" \"Size\"";
    for (int i = 1; i <= 8; ++i) first += " | \"m" + std::to_string(i) + "\" \"" + std::to_string(i) + "\"";
    EXPECT_EQ((TLines{first + ")",
                      "WriteTableGrid(grid 2x2 width=80 widths=[60,40] colheaders sortable marked | \"Name\" \"Size\" | "
                      "\"m9\" \"9\")"}),
              byColumn.Grids());

    // A row report: a row per property, the labels in a first column of
    // their own width, the instances sharing the rest.
    TReportClass rows = Table("ORVSG_Memory", {Column("Name", "0%"), Column("Size", "0%")});
    rows.SetReportStyle(TReportClass::ROW_REPORT);
    rows.SetRowReportHeaderWidth("20%");
    rows.SetMaxInstancesPerTable(8);
    TEngineRun<> byRow(repo.Namespace());
    Write(byRow, rows, modules);
    std::string names = " | \"Name\"";
    std::string sizes = " | \"Size\"";
    for (int i = 1; i <= 8; ++i) {
        names += " \"m" + std::to_string(i) + "\"";
        sizes += " \"" + std::to_string(i) + "\"";
    }
    EXPECT_EQ((TLines{"WriteTableGrid(grid 2x9 width=100 widths=[20,10,10,10,10,10,10,10,10] rowheaders" + names + sizes +
                          ")",
                      "WriteTableGrid(grid 2x2 width=100 widths=[20,80] rowheaders | \"Name\" \"m9\" | \"Size\" \"9\")"}),
              byRow.Grids());
}

TEST(TableCells, ArraysUseTheColumnsSeparatorAndMonospacedFlag) {
    TRepoBuilder repo;
    repo.Parse(R"(ORVSG_Card Name="c" Ports=string[]:"p1","p2")");
    TEngineRun<> run(repo.Namespace());
    run.writer.SetSeparatorText(1, " / ");
    TReportProperty ports = Column("Ports", "50%");
    ports.SetArrayValueSeparator(TReportProperty::SEPARATOR_1);
    ports.SetMonospaced();
    Write(run, Table("ORVSG_Card", {Column("Name", "50%"), ports}), testrepo::All(*repo.Namespace(), "ORVSG_Card"));
    EXPECT_EQ("WriteTableGrid(grid 2x2 width=100 widths=[50,50] colheaders | \"Name\" \"Ports\" | \"c\" #\"p1 / p2\")\nWriteTableBreak()\n",
              run.Transcript());
}

// Adapters with their ports, reached through an association.
boost::shared_ptr<repository::TMemoryNamespace> AdaptersWithPorts() {
    auto ns = repository::TMemoryNamespace::Create();
    ns->DeclareClass(C("ORVSG_Adapter", "", {P("DeviceID", T::eString, {Q("Key", TCIMValue::Boolean(true))})}));
    ns->DeclareClass(C("ORVSG_Port", "", {P("Name", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                                          P("Speed", T::eString)}));
    ns->DeclareClass(C("ORVSG_AdapterPort", "",
                       {testrepo::Ref("Antecedent", "ORVSG_Adapter"), testrepo::Ref("Dependent", "ORVSG_Port")},
                       {Q("Association", TCIMValue::Boolean(true))}));
    const char* const links[][3] = {{"a1", "eth1", "10G"}, {"a1", "eth0", "1G"}, {"a1", "eth9", "1G"},
                                    {"a2", "eth2", "25G"}};
    for (const char* adapter : {"a1", "a2", "a3"}) ns->AddInstance("ORVSG_Adapter", {V("DeviceID", TCIMValue(adapter))});
    for (const auto& link : links) {
        ns->AddInstance("ORVSG_Port", {V("Name", TCIMValue(link[1])), V("Speed", TCIMValue(link[2]))});
        ns->AddInstance("ORVSG_AdapterPort",
                        {V("Antecedent", testrepo::RefTo(ns, std::string("ORVSG_Adapter.DeviceID=\"") + link[0] + "\"")),
                         V("Dependent", testrepo::RefTo(ns, std::string("ORVSG_Port.Name=\"") + link[1] + "\""))});
    }
    ns->Link();
    return ns;
}

TEST(TableNesting, AssociatedTablesFollowEachInstanceSortedStably) {
    auto ns = AdaptersWithPorts();
    TReportClass ports = Table("ORVSG_Port", {Column("Name", "50%"), Column("Speed", "50%")});
    ports.SetTitle("Ports");
    ports.SetAssociatorsFilter("ORVSG_AdapterPort", "ORVSG_Port", "Antecedent", "Dependent");
    ports.GetInstanceSorter().AddProperty("Speed", true, false);  // eth0 and eth9 tie and keep their order
    TReportClass adapters = Table("ORVSG_Adapter", {Column("DeviceID", "100%")});
    adapters.SetTitle("Adapters");
    adapters.EnableSubTitle();
    adapters.SetAssociatedClass();
    adapters.SetAssociatedClasses({ports});

    TEngineRun<> run(ns);
    Write(run, adapters, testrepo::All(*ns, "ORVSG_Adapter"));
    EXPECT_EQ("WriteTableTitle(\"Adapters\", true, false)\n"
              "WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | \"DeviceID\" | \"a1\")\nWriteTableBreak()\n"
              "WriteTableTitle(\"Ports\", false, false)\n"
              "WriteTableGrid(grid 4x2 width=100 widths=[50,50] colheaders | \"Name\" \"Speed\" | \"eth0\" \"1G\" | "
              "\"eth9\" \"1G\" | \"eth1\" \"10G\")\nWriteTableBreak()\n"
              "WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | \"DeviceID\" | \"a2\")\nWriteTableBreak()\n"
              "WriteTableTitle(\"Ports\", false, false)\n"
              "WriteTableGrid(grid 2x2 width=100 widths=[50,50] colheaders | \"Name\" \"Speed\" | \"eth2\" \"25G\")\nWriteTableBreak()\n"
              "WriteTableGrid(grid 2x1 width=100 widths=[100] colheaders | \"DeviceID\" | \"a3\")\nWriteTableBreak()\n"
              "WriteTableTitle(\"Ports\", false, false)\n",
              run.Transcript());

    // Below the top level, nested tables are not written.
    run.writer.Clear();
    run.writer.WriteTable(adapters, testrepo::All(*ns, "ORVSG_Adapter"), false, true, {});
    EXPECT_EQ(1u, run.Grids().size());
}

TEST(TableColumns, AColumnReachesItsValueThroughAnAssociation) {
    auto ns = AdaptersWithPorts();
    TEngineRun<> run(ns);
    TReportProperty speeds("Speed", "50%", "ORVSG_AdapterPort", "ORVSG_Port", "Port Speeds", "none");
    // Nothing answers on the first step; the second step goes to any
    // associated port.
    TReportProperty names("Name", "50%", "ORVSG_NoSuchAssociation", "ORVSG_Port", "", "");
    names.SetSecondaryAssociationTarget("ORVSG_Port");
    Write(run, Table("ORVSG_Adapter", {names, speeds}), testrepo::All(*ns, "ORVSG_Adapter"));
    EXPECT_EQ("WriteTableGrid(grid 4x2 width=100 widths=[50,50] colheaders | \"Name\" \"Port Speeds\" | "
              "\"eth1, eth0, eth9\" \"10G, 1G, 1G\" | \"eth2\" \"25G\" | \"N/A\" \"none\")\nWriteTableBreak()\n",
              run.Transcript());
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
                                         Table("ORVSG_NoSuchClass", {}), Table("ORVSG_Disk", {})};
    classes[2].GetPropertyFilters().push_back(TReportClass::TPropertyFilter("WD", "Model", false));
    classes[4].SetTitle("kept");
    classes.erase(run.writer.ClassFilter(classes.begin(), classes.end()), classes.end());
    ASSERT_EQ(2u, classes.size());
    EXPECT_EQ("ORVSG_Fan", classes[0].GetClass());
    EXPECT_EQ("kept", classes[1].GetTitle());
}

}  // namespace
}  // namespace braigrion
