// The delta page of one definition over inline collections and hand-made
// records: labels of the data sources, which records count, the three kinds
// of table, the width rule, and dependents under their parents.
#include <sstream>

#include <gtest/gtest.h>

#include "delta/DeltaFixture.h"
#include "delta/TClassDelta.h"

namespace braigrion {
namespace {

using NORVTKR20::TCIMValue;
using repository::TDeltaRecordWriter;
using repository::TMemoryNamespace;
using testing::Col;
using testing::Page;
using testing::TCollection;
using testing::TDeltaRun;
using testing::Table;
using testing::Val;

typedef boost::shared_ptr<TMemoryNamespace> TNs;

const char kMarch[] = "20240311141531.000000-300";
const char kApril[] = "20240412093044.000000-240";

// The lines of a page that show what a reader sees: titles, grids and rows,
// and the index entry.
std::string Digest(const std::string& transcript) {
    std::string out;
    std::istringstream lines(transcript);
    for (std::string line; std::getline(lines, line);) {
        if (line.rfind("WriteTableTitle(", 0) == 0 || line.rfind("WriteTableGrid(", 0) == 0 ||
            line.rfind("  |", 0) == 0 || line.rfind("WriteIndexEntry(", 0) == 0) {
            out += line + "\n";
        }
    }
    return out;
}

TCollection Disks(const std::string& serial, const std::string& host, const char* time,
                  std::vector<std::pair<std::string, std::string>> sizes) {
    TCollection c(serial, host, time);
    for (const auto& disk : sizes) {
        c.Add("ORVSG_Disk.DeviceID=\"" + disk.first + "\"",
              {Val("Size", TCIMValue(disk.second)), Val("Model", TCIMValue("MZ7LH480"))});
    }
    return c;
}

TEST(DeltaLabels, SameSerialIsLabelledByTimeDifferentByHost) {
    auto labels = [](const std::string& serial2) {
        TDeltaRun run({Disks("SN1", "alpha", kMarch, {}).Namespace(), Disks(serial2, "beta", kApril, {}).Namespace()},
                      testing::EmptyRecords());
        return TClassDelta::GetDeltaContainerNames();
    };
    const std::vector<std::string> byTime = labels("SN1");
    ASSERT_EQ(2u, byTime.size());
    EXPECT_NE(std::string::npos, byTime[0].find("2024")) << byTime[0];
    EXPECT_NE(byTime[0], byTime[1]);
    EXPECT_EQ((std::vector<std::string>{"alpha", "beta"}), labels("SN2"));

    // One machine twice beside another: the host name is shared, the time tells.
    TDeltaRun three({Disks("SN1", "alpha", kMarch, {}).Namespace(), Disks("SN1", "alpha", kApril, {}).Namespace(),
                     Disks("SN2", "beta", kApril, {}).Namespace()},
                    testing::EmptyRecords());
    EXPECT_EQ((std::vector<std::string>{"alpha (" + byTime[0] + ")", "alpha (" + byTime[1] + ")", "beta"}),
              TClassDelta::GetDeltaContainerNames());
}

TEST(DeltaPage, RecordsForColumnsThePageDoesNotShowCountForNothing) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter add(records);
    add.Add("ORVSG_Disk", 4, "Model", "ORVSG_Disk.DeviceID=\"sda\"", {0, 1});
    TDeltaRun run({Disks("SN1", "alpha", kMarch, {{"sda", "1"}}).Namespace(),
                   Disks("SN1", "alpha", kApril, {{"sda", "1"}}).Namespace()},
                  records);
    TReportClass disks = Table("ORVSG_Disk", "Disks", {Col("DeviceID", "50%"), Col("Size", "50%")});
    EXPECT_EQ("WriteTableTitle(\"Disks\", false, false)\n"
              "WriteIndexEntry(\"delta\", \"Delta Page\", false)\n",
              Digest(run.Page(Page({disks}))));
}

TEST(DeltaPage, TwoSourcesOnePropertyGiveBaselineAndOtherRows) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter add(records);
    add.Add("ORVSG_Disk", 4, "Size", "ORVSG_Disk.DeviceID=\"sda\"", {0, 1});
    add.Add("ORVSG_Disk", 1, "", "ORVSG_Disk.DeviceID=\"sda\"", {2});  // also gone from the third
    TDeltaRun run({Disks("SN1", "alpha", kMarch, {{"sda", "480"}}).Namespace(),
                   Disks("SN2", "beta", kMarch, {{"sda", "960"}}).Namespace(),
                   Disks("SN3", "gamma", kMarch, {}).Namespace()},
                  records);
    const std::string page =
        Digest(run.Page(Page({Table("ORVSG_Disk", "Disks", {Col("DeviceID", "40%"), Col("Size", "40%")})})));
    EXPECT_EQ("WriteTableTitle(\"Disks\", false, false)\n"
              "WriteTableGrid(grid 2x2 width=100 widths=[40,40] colheaders)\n"
              "  | \"DeviceID\" \"Size\"\n"
              "  | \"sda\" \"480\"\n"
              "WriteTableTitle(\"Differences\", true, true)\n"
              "WriteTableGrid(grid 3x2 width=100 widths=[31,68] colheaders marked)\n"
              "  | \"Data Source\" \"Size\"\n"
              "  | \"alpha\" \"480\"\n"
              "  | \"beta\" \"960\"\n"
              "WriteTableTitle(\"Missing from gamma\", true, true)\n"
              "WriteTableGrid(grid 2x2 width=100 widths=[40,40] colheaders)\n"
              "  | \"DeviceID\" \"Size\"\n"
              "  | \"sda\" \"480\"\n"
              "WriteIndexEntry(\"delta\", \"Delta Page\", true)\n",
              page);
}

TEST(DeltaPage, SameShowsOnlyForSourcesMarkedByAnotherColumn) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter add(records);
    const std::string sda = "ORVSG_Disk.DeviceID=\"sda\"";
    add.Add("ORVSG_Disk", 4, "Size", sda, {0, 1});
    add.Add("ORVSG_Disk", 4, "Model", sda, {0, 1, 2});
    TCollection c0 = Disks("SN1", "alpha", kMarch, {});
    TCollection c1 = Disks("SN2", "beta", kMarch, {});
    TCollection c2 = Disks("SN3", "gamma", kMarch, {});
    c0.Add(sda, {Val("Size", TCIMValue("480")), Val("Model", TCIMValue("A"))});
    c1.Add(sda, {Val("Size", TCIMValue("960")), Val("Model", TCIMValue("B"))});
    c2.Add(sda, {Val("Size", TCIMValue("480")), Val("Model", TCIMValue("C"))});
    TDeltaRun run({c0.Namespace(), c1.Namespace(), c2.Namespace()}, records);
    const std::string page = Digest(run.Page(
        Page({Table("ORVSG_Disk", "", {Col("DeviceID", "20%"), Col("Size", "20%"), Col("Model", "20%")})})));
    EXPECT_NE(std::string::npos, page.find("  | \"Data Source\" \"Size\" \"Model\"\n"
                                           "  | \"alpha\" \"480\" \"A\"\n"
                                           "  | \"beta\" \"960\" \"B\"\n"
                                           "  | \"gamma\" =\"--- SAME ---\" \"C\"\n"))
        << page;

    // Without the column that marks it, the third source has no row.
    TNs fewer = testing::EmptyRecords();
    TDeltaRecordWriter(fewer).Add("ORVSG_Disk", 4, "Size", sda, {0, 1});
    TDeltaRun alone({c0.Namespace(), c1.Namespace(), c2.Namespace()}, fewer);
    const std::string single = Digest(alone.Page(Page({Table("ORVSG_Disk", "", {Col("Size", "20%")})})));
    EXPECT_EQ(std::string::npos, single.find("gamma")) << single;
}

TEST(DeltaPage, BaselineKeepsItsRowWhenARecordLeavesItOut) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter(records).Add("ORVSG_Disk", 4, "Size", "ORVSG_Disk.DeviceID=\"sda\"", {1});
    TDeltaRun run({Disks("SN1", "alpha", kMarch, {{"sda", "480"}}).Namespace(),
                   Disks("SN2", "beta", kMarch, {{"sda", "960"}}).Namespace()},
                  records);
    const std::string page = Digest(run.Page(Page({Table("ORVSG_Disk", "", {Col("Size", "50%")})})));
    EXPECT_NE(std::string::npos, page.find("  | \"Data Source\" \"Size\"\n"
                                           "  | \"alpha\" \"480\"\n"
                                           "  | \"beta\" \"960\"\n"))
        << page;
}

TEST(DeltaPage, WideColumnsSplitIntoTablesBesideTheDataSource) {
    struct TCase {
        std::vector<std::string> widths;
        std::vector<size_t> columnsPerTable;
    } cases[] = {
        {{"40%", "40%"}, {2}},          // 18 + 80 fits
        {{"40%", "45%"}, {1, 1}},       // 18 + 85 does not
        {{"83%", "10%", "5%"}, {1, 2}},  // wider than 82 stands alone
        {{"10%", "90%", "10%"}, {1, 1, 1}},
    };
    for (const TCase& test : cases) {
        TNs records = testing::EmptyRecords();
        TDeltaRecordWriter add(records);
        std::vector<TReportProperty> columns;
        TCollection c0 = Disks("SN1", "alpha", kMarch, {});
        TCollection c1 = Disks("SN1", "alpha", kApril, {});
        std::vector<testing::TValue> v0, v1;
        for (size_t i = 0; i < test.widths.size(); ++i) {
            const std::string name = "P" + std::to_string(i);
            columns.push_back(Col(name, test.widths[i]));
            add.Add("ORVSG_Board", 4, name, "ORVSG_Board.Slot=\"1\"", {0, 1});
            v0.push_back(Val(name, TCIMValue("a")));
            v1.push_back(Val(name, TCIMValue("b")));
        }
        c0.Add("ORVSG_Board.Slot=\"1\"", v0);
        c1.Add("ORVSG_Board.Slot=\"1\"", v1);
        TDeltaRun run({c0.Namespace(), c1.Namespace()}, records);
        const std::string page = Digest(run.Page(Page({Table("ORVSG_Board", "", columns)})));
        std::vector<size_t> got;
        std::istringstream lines(page);
        bool differences = false;
        for (std::string line; std::getline(lines, line);) {
            if (line.find("\"Differences\"") != std::string::npos) differences = true;
            if (differences && line.rfind("WriteTableGrid(grid 3x", 0) == 0) {
                got.push_back(static_cast<size_t>(std::stoi(line.substr(line.find('x') + 1))) - 1);
            }
        }
        EXPECT_EQ(test.columnsPerTable, got) << page;
    }
}

TEST(DeltaPage, RecordsOfSubclassesAreFoundThroughTheBaseClassOnce) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter add(records);
    const std::string id = add.Add("ORVSG_NVMeDisk", 4, "Size", "ORVSG_NVMeDisk.DeviceID=\"nvme0\"", {0, 1});
    add.Attach("ORVSG_SATADisk", id);  // the same record reached through a second subclass
    auto collection = [](const char* time, const char* size) {
        TCollection c("SN1", "alpha", time);
        c.Namespace()->DeclareClass(repository::TClassData{"ORVSG_Disk", "", {}, {}});
        c.Namespace()->DeclareClass(repository::TClassData{"ORVSG_NVMeDisk", "ORVSG_Disk", {}, {}});
        c.Namespace()->DeclareClass(repository::TClassData{"ORVSG_SATADisk", "ORVSG_Disk", {}, {}});
        c.Add("ORVSG_NVMeDisk.DeviceID=\"nvme0\"", {Val("Size", TCIMValue(size))});
        return c.Namespace();
    };
    TDeltaRun run({collection(kMarch, "1"), collection(kApril, "2")}, records);
    TReportClass disks = Table("ORVSG_Disk", "", {Col("Size", "50%")});
    TClassDelta::TInstances found;
    TClassDelta::FindDeltas(run.view, "ORVSG_Disk", found);
    EXPECT_EQ(1u, found.size());
    const std::string page = Digest(run.Page(Page({disks})));
    EXPECT_NE(std::string::npos, page.find("\"Differences\"")) << page;
    EXPECT_EQ(page.find("\"Differences\""), page.rfind("\"Differences\"")) << page;
}

// Cards hold ports through ORVSG_CardPort; only a port differs.
struct TCardsAndPorts {
    TNs c0, c1;
    TNs records;
    TReportClass cards;
    TCardsAndPorts() {
        auto collection = [](const char* time, const char* speed) {
            TCollection c("SN1", "alpha", time);
            c.Add("ORVSG_Card.Tag=\"slot1\"", {Val("Model", TCIMValue("X710"))});
            c.Add("ORVSG_Port.DeviceID=\"p0\"", {Val("Speed", TCIMValue("10G"))});
            c.Add("ORVSG_Port.DeviceID=\"p1\"", {Val("Speed", TCIMValue(speed))});
            c.Link("ORVSG_CardPort", "ORVSG_Card.Tag=\"slot1\"", "ORVSG_Port.DeviceID=\"p0\"");
            c.Link("ORVSG_CardPort", "ORVSG_Card.Tag=\"slot1\"", "ORVSG_Port.DeviceID=\"p1\"");
            return c.Namespace();
        };
        c0 = collection(kMarch, "10G");
        c1 = collection(kApril, "1G");
        records = testing::EmptyRecords();
        TDeltaRecordWriter(records).Add("ORVSG_Port", 4, "Speed", "ORVSG_Port.DeviceID=\"p1\"", {0, 1});
        cards = Table("ORVSG_Card", "Cards", {Col("Tag", "50%"), Col("Model", "50%")});
        TReportClass ports = Table("ORVSG_Port", "", {Col("DeviceID", "50%"), Col("Speed", "50%")});
        ports.SetAssociatorsFilter("ORVSG_CardPort", "ORVSG_Port", "", "");
        cards.SetAssociatedClass();
        cards.SetAssociatedClasses({ports});
    }
};

TEST(DeltaPage, ADependentThatDiffersStandsUnderItsParentOnce) {
    TCardsAndPorts data;
    TDeltaRun run({data.c0, data.c1}, data.records);
    const std::string page = Digest(run.Page(Page({data.cards})));
    EXPECT_EQ("WriteTableTitle(\"Cards\", false, false)\n"
              "WriteTableGrid(grid 2x2 width=100 widths=[50,50] colheaders)\n"
              "  | \"Tag\" \"Model\"\n"
              "  | \"slot1\" \"X710\"\n"
              "WriteTableGrid(grid 2x2 width=100 widths=[50,50] colheaders)\n"
              "  | \"DeviceID\" \"Speed\"\n"
              "  | \"p1\" \"10G\"\n"
              "WriteTableTitle(\"Differences\", true, true)\n"
              "WriteTableGrid(grid 3x2 width=100 widths=[26,73] colheaders marked)\n"
              "  | \"Data Source\" \"Speed\"\n"
              "  | \"" + TClassDelta::GetDeltaContainerNames()[0] + "\" \"10G\"\n"
              "  | \"" + TClassDelta::GetDeltaContainerNames()[1] + "\" \"1G\"\n"
              "WriteIndexEntry(\"delta\", \"Delta Page\", true)\n",
              page);
}

TEST(DeltaPage, LinksRunFromParentToDependentOnly) {
    TCardsAndPorts data;
    TDeltaRun run({data.c0, data.c1}, data.records);
    auto tree = boost::make_shared<TClassDelta>(run.view, TClassDelta::GetRunContext(),
                                                boost::shared_ptr<TClassDelta>(), &data.cards);
    tree->CreateDeltaInstances(&run.writer);
    ASSERT_EQ(1u, tree->GetInstanceDeltas().size());
    const TInstanceDelta& card = *tree->GetInstanceDeltas().begin()->second;
    EXPECT_EQ(0, card.fDeltaTypes) << "the card is there only to hold its port";
    ASSERT_EQ(2u, card.fChildren.size()) << "each port once, though two collections link it";
    for (const auto& port : card.fChildren) EXPECT_TRUE(port->fChildren.empty());
    EXPECT_TRUE(card.HasDeltaTypeBelow(kDeltaProperty));
    tree->Release();
}

TEST(DeltaPage, AssociationColumnsAreComparedHere) {
    // A disk's file system comes from its volume through ORVSG_DiskVolume.
    auto collection = [](const char* time, const char* fsA, const char* fsB) {
        TCollection c("SN1", "alpha", time);
        c.Add("ORVSG_Disk.DeviceID=\"sda\"", {Val("Size", TCIMValue("1"))});
        c.Add("ORVSG_Volume.DeviceID=\"v1\"", {Val("FileSystem", TCIMValue(fsA))});
        c.Add("ORVSG_Volume.DeviceID=\"v2\"", {Val("FileSystem", TCIMValue(fsB))});
        c.Link("ORVSG_DiskVolume", "ORVSG_Disk.DeviceID=\"sda\"", "ORVSG_Volume.DeviceID=\"v1\"");
        return c.Namespace();
    };
    TReportClass disks = Table("ORVSG_Disk", "", {Col("Size", "30%"),
                                                  TReportProperty("FileSystem", "30%", "ORVSG_DiskVolume",
                                                                  "ORVSG_Volume", "", "")});
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter(records).Add("ORVSG_Disk", 4, "Size", "ORVSG_Disk.DeviceID=\"sda\"", {0, 1});
    struct TCase {
        const char* fs1;
        const char* fs2;
        bool stored;
    } cases[] = {{"xfs", "xfs", false}, {"xfs", "ext4", true}, {"ext4", "ext4", true}};
    for (const TCase& test : cases) {
        TDeltaRun run({collection(kMarch, "xfs", "x"), collection(kApril, test.fs1, "y"),
                       collection(kApril, test.fs2, "z")},
                      records);
        auto tree = boost::make_shared<TClassDelta>(run.view, TClassDelta::GetRunContext(),
                                                    boost::shared_ptr<TClassDelta>(), &disks);
        tree->CreateDeltaInstances(&run.writer);
        ASSERT_EQ(1u, tree->GetInstanceDeltas().size());
        const TInstanceDelta& disk = *tree->GetInstanceDeltas().begin()->second;
        EXPECT_EQ(test.stored ? 1u : 0u, disk.fAssocDeltas.size()) << test.fs1 << " " << test.fs2;
        if (test.stored) {
            EXPECT_EQ((std::vector<std::string>{"xfs", test.fs1, test.fs2}), disk.fAssocDeltas.at("FileSystem"));
        }
        EXPECT_EQ(kDeltaProperty, disk.fDeltaTypes);
        tree->Release();
    }
}

TEST(DeltaPage, MissingAndPropertyRecordsPutAnInstanceInBothTables) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter add(records);
    add.Add("ORVSG_Disk", 4, "Size", "ORVSG_Disk.DeviceID=\"sda\"", {0, 1});
    add.Add("ORVSG_Disk", 1, "", "ORVSG_Disk.DeviceID=\"sda\"", {2});
    add.Add("ORVSG_Disk", 2, "", "ORVSG_Disk.DeviceID=\"sdz\"", {1, 2});
    TDeltaRun run({Disks("SN1", "alpha", kMarch, {{"sda", "1"}}).Namespace(),
                   Disks("SN2", "beta", kMarch, {{"sda", "2"}, {"sdz", "9"}}).Namespace(),
                   Disks("SN3", "gamma", kMarch, {{"sdz", "9"}}).Namespace()},
                  records);
    TReportClass disks = Table("ORVSG_Disk", "", {Col("DeviceID", "50%"), Col("Size", "50%")});
    auto tree = boost::make_shared<TClassDelta>(run.view, TClassDelta::GetRunContext(),
                                                boost::shared_ptr<TClassDelta>(), &disks);
    tree->CreateDeltaInstances(&run.writer);
    EXPECT_EQ(5, tree->GetInstanceDeltas().at("ORVSG_Disk.DeviceID=\"sda\"")->fDeltaTypes);
    tree->Release();
    const std::string page = Digest(run.Page(Page({disks})));
    EXPECT_NE(std::string::npos, page.find("\"Missing from gamma\"")) << page;
    EXPECT_NE(std::string::npos, page.find("\"Unique to beta, gamma\"")) << page;
    EXPECT_LT(page.find("\"Differences\""), page.find("\"Missing from gamma\""));
    EXPECT_LT(page.find("\"Missing from gamma\""), page.find("\"Unique to beta, gamma\""));
}

TEST(DeltaPage, AClassOnlyALaterSourceHoldsShowsAsUnique) {
    TNs records = testing::EmptyRecords();
    TDeltaRecordWriter(records).Add("ORVSG_Agent", 2, "", "ORVSG_Agent.Name=\"updater\"", {1});
    TCollection later("SN1", "alpha", kApril);
    later.Add("ORVSG_Agent.Name=\"updater\"", {Val("Version", TCIMValue("3.2"))});
    TDeltaRun run({Disks("SN1", "alpha", kMarch, {}).Namespace(), later.Namespace()}, records);
    const std::string page = Digest(run.Page(Page({Table("ORVSG_Agent", "", {Col("Name", "50%"), Col("Version", "50%")})})));
    EXPECT_NE(std::string::npos, page.find("  | \"updater\" \"3.2\"\n")) << page;
    EXPECT_NE(std::string::npos, page.find("\"Unique to " + TClassDelta::GetDeltaContainerNames()[1] + "\"")) << page;
}

}  // namespace
}  // namespace braigrion
