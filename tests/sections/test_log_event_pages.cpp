// The chassis event log and the diagnostics log: their tables, the switch of
// documentation links by machine type and lookup file, the forms of a link,
// and the helpers that read event ids, UEFI codes, diagnostic codes and the
// machine type.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "LogSectionsFixture.h"
#include "report/ExpectedPage.h"

namespace braigrion {
namespace {

using testing::DeclareKeyed;
using testing::LinkSettings;
using testing::TDataFolder;
using testing::TLogRun;
using testing::TRepoBuilder;

struct TTextCase {
    const char* input;
    const char* expected;
};

TEST(LogHelpers, EventIdsLoseTheirPrefixAndSeparators) {
    const TTextCase cases[] = {
        {"0X 8000-0123", "80000123"}, {"", ""},          {"8000 0123\r\n", "80000123"},
        {"ab0Xcd0X-1", "cd0X1"},      {"\t12-34 ", "1234"}, {"0x8000", "0x8000"},  // only "0X" is a prefix
    };
    TLogRun run(TRepoBuilder().Namespace());
    for (const TTextCase& c : cases) {
        std::string id = c.input;
        run.writer.ProcessKMCEventID(id);
        EXPECT_EQ(c.expected, id) << c.input;
    }
}

TEST(LogHelpers, UefiCodeStandsInLeadingBrackets) {
    const TTextCase cases[] = {
        {"[UEFI:DXE:x] text", "UEFI:DXE:x"}, {" [x]", ""}, {"[open", ""}, {"[]", ""}, {"[a]b]", "a"}, {"", ""},
    };
    TLogRun run(TRepoBuilder().Namespace());
    for (const TTextCase& c : cases) EXPECT_EQ(c.expected, run.writer.ProcessUefiDiagCodeFromAD(c.input)) << c.input;
}

TEST(LogHelpers, DiagnosticCodeIsTheFirstElevenCharacters) {
    const TTextCase cases[] = {
        {"0123456789", "0123456789"},          // 10: its own code
        {"0123456789A", "0123456789A"},        // 11
        {"DGN-1B02-05 Failed", "DGN-1B02-05"}, {"", ""},
    };
    TLogRun run(TRepoBuilder().Namespace());
    for (const TTextCase& c : cases) {
        std::string text = c.input;
        run.writer.ProcessDiagnosticErrorCode(text);
        EXPECT_EQ(c.expected, text) << c.input;
    }
}

TEST(LogHelpers, ExtractLinkCutsAtTheFirstDesc) {
    TLogRun run(TRepoBuilder().Namespace());
    std::string left, right;
    run.writer.ExtractLink("http://tool_desc_a*b_desc_c", left, right);
    EXPECT_EQ("http://tool", left);
    EXPECT_EQ("a*b_desc_c", right);
    run.writer.ExtractLink("no separator", left, right);
    EXPECT_EQ("no separator", left);
    EXPECT_EQ("", right);
}

// The machine type is four characters inside "-[...]": the bracket must
// close after them. "-[12]-" is no machine type, although a bare search for
// the two marks finds both.
TEST(MachineType, IsTheFourCharactersInsideTheBrackets) {
    const TTextCase cases[] = {
        {"Example Server -[1234AC1]-", "1234"}, {"Example Server -[1234]-", "1234"},
        {"Example Server -[12]-", ""},          {"Example Server -[123]-", ""},
        {"Example Server 1234", ""},            {"Example] Server -[1234", ""},
        {"A -[1234AC1]", "1234"},
    };
    for (const TTextCase& c : cases) {
        TRepoBuilder repo;
        repo.Add("ORVSG_ComputerSystem", {testing::Str("ProductName", c.input)});
        TLogRun run(repo.Namespace());
        EXPECT_EQ(c.expected, run.writer.GetMTFromRepository()) << c.input;
        EXPECT_TRUE(run.log.Contains(std::string("TWriter::GetMTFromRepository -- Exiting with ") + c.expected));
    }
}

TEST(MachineType, MissingDataGivesNoMachineType) {
    TRepoBuilder none;
    TLogRun noClass(none.Namespace());
    EXPECT_EQ("", noClass.writer.GetMTFromRepository());
    EXPECT_TRUE(noClass.log.Contains("Exception when getting class ORVSG_ComputerSystem"));

    TRepoBuilder unnamed;
    unnamed.Parse("ORVSG_ComputerSystem Name=\"srv\"");
    TLogRun noProperty(unnamed.Namespace());
    EXPECT_EQ("", noProperty.writer.GetMTFromRepository());
    EXPECT_TRUE(noProperty.log.Contains("Exception when getting property ProductName from ORVSG_ComputerSystem"));
}

// Each record in turn decides; a record without "Action" answers false.
TEST(MachineType, MultitoolIsDecidedByTheLastRecord) {
    struct TCase {
        const char* records;
        bool expected;
        const char* out;
    } cases[] = {
        {"class ORVSG_IPMILogRecord", false, ""},
        {"ORVSG_IPMILogRecord Action=\"a_desc_b\"", true, "a_desc_b"},
        {"ORVSG_IPMILogRecord Action=\"a_desc_b\"\nORVSG_IPMILogRecord Action=\"\"", false, ""},
        {"ORVSG_IPMILogRecord Action=\"\"\nORVSG_IPMILogRecord Action=\"x\"", true, "x"},
        {"ORVSG_IPMILogRecord Action=\"x\"\nORVSG_IPMILogRecord Message=\"m\"", false, "x"},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.records);
        TLogRun run(repo.Namespace());
        std::string out;
        EXPECT_EQ(c.expected, run.writer.IsMultitool(out)) << c.records;
        EXPECT_EQ(c.out, out) << c.records;
    }
    TLogRun noClass(TRepoBuilder().Namespace());
    std::string out;
    EXPECT_FALSE(noClass.writer.IsMultitool(out));
}

// Chassis events of machine type 1234 on one node: a hidden one, one whose
// "Hidden" is not exactly "true", one without an event id, one with a UEFI
// code, one whose code follows a blank, and two with the same time.
TRepoBuilder ChassisEvents(const std::string& product, const std::string& nodes = "1") {
    TRepoBuilder repo;
    DeclareKeyed(repo, "ORV_StandardMessageLogEntry", "",
                 {"NodeID", "LogName", "CreationTimeStamp", "EventID", "MessageID", "Message", "PerceivedSeverity",
                  "AuxiliaryData", "Hidden"});
    repo.Parse("ORVSG_ComputerSystem ProductName=\"" + product + "\" SystemNodes=uint8:" + nodes + R"(
        ORV_StandardMessageLogEntry Id="e5" NodeID="2" LogName="CEL" CreationTimeStamp="2025-03-02 03:20" EventID="0X 8008-0117" MessageID="M5" Message="memory" PerceivedSeverity="3" AuxiliaryData="[UEFI:DXE:MEM7] DIMM 7"
        ORV_StandardMessageLogEntry Id="e1" NodeID="1" LogName="CEL" CreationTimeStamp="2025-03-02 03:12" EventID="0X 8000-0123" MessageID="M1" Message="power" PerceivedSeverity="2"
        ORV_StandardMessageLogEntry Id="e2" NodeID="1" LogName="CEL" CreationTimeStamp="2025-03-02 03:12" EventID="0X 8000-0124" MessageID="M2" Message="same time, later in enumeration" PerceivedSeverity="2" Hidden="TRUE"
        ORV_StandardMessageLogEntry Id="e3" NodeID="2" LogName="CEL" CreationTimeStamp="2025-03-02 03:13" EventID="0X 8000-0125" MessageID="M3" Message="hidden" Hidden="true"
        ORV_StandardMessageLogEntry Id="e4" NodeID="1" LogName="CEL" CreationTimeStamp="2025-03-02 03:15" MessageID="M4" Message="no event id" AuxiliaryData=" [UEFI:PEI:x] blank first"
    )");
    return repo;
}

struct TChassisCase {
    const char* name;  // also the fixture file
    const char* product;
    const char* nodes;
    const char* lookup;  // "" for no lookup file
};

TEST(ChassisEventLog, WritesItsPageAsExpected) {
    const TChassisCase cases[] = {
        {"links", "Example Server -[1234AC1]-", "1", "1234,whatever\n4321\n"},
        {"help-server", "Example Server -[7903AC1]-", "1", "7903,internal\n"},
        {"not-listed", "Example Server -[9999AC1]-", "1", "1234\n"},
        {"no-lookup-file", "Example Server -[1234AC1]-", "1", ""},
        {"multinode", "Example Server -[1234AC1]-", "2", "1234\n"},
    };
    for (const TChassisCase& c : cases) {
        TRepoBuilder repo = ChassisEvents(c.product, c.nodes);
        TDataFolder data;
        if (*c.lookup) data.Write("kmcEventsAtInfoC.txt", c.lookup);
        TLogRun run(repo.Namespace());
        run.writer.SetLogLinkSettings(LinkSettings(data.Path()));
        run.writer.WriteCustomChassisEventLog(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "default", false),
                                              "SPLogs");
        const std::string file = std::string("logs/chassis-") + c.name + ".txt";
        EXPECT_EQ(testing::ExpectedPage(file, run.Transcript()), run.Transcript()) << file;
        EXPECT_EQ(*c.lookup == '\0', run.log.Contains("open kmcEventsAtInfoC.txt failed")) << c.name;
    }
}

TEST(ChassisEventLog, WithoutEntriesHasOnlyItsTitle) {
    for (bool declared : {false, true}) {
        TRepoBuilder repo;
        if (declared) repo.Declare("ORV_StandardMessageLogEntry", {"Message"});
        TLogRun run(repo.Namespace());
        run.writer.WriteCustomChassisEventLog(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "default", false),
                                              "SPLogs");
        EXPECT_EQ(
            "OpenPage(\"out/chassis_event\")\nWriteSortScript()\nWritePageHeader()\n"
            "WriteReportTitle(\"Chassis Event Log\", \"\", \"\")\nWritePageFooter()\nClosePage()\n"
            "WriteIndexEntry(\"chassis_event\", \"Chassis Event Log\", false)\n",
            run.Transcript());
        EXPECT_EQ(!declared, run.log.Contains("Exception when getting class of ORV_StandardMessageLogEntry"));
    }
}

// Completion records, one of the disk provider's default subclass, the
// tool's diagnostic log and the memory diagnostics, each table when asked.
TRepoBuilder Diagnostics(bool completion, bool defaultRecord, bool tool, bool memory) {
    TRepoBuilder repo;
    repo.Parse("ORVSG_ComputerSystem ProductName=\"Example Server -[1234AC1]\"");
    DeclareKeyed(repo, "CIM_DiagnosticCompletionRecord", "",
                 {"ServiceName", "ManagedElementName", "RecordData", "CreationTimeStamp"});
    DeclareKeyed(repo, "LSIESG_DiskDefaultCompletionRecord", "CIM_DiagnosticCompletionRecord", {});
    DeclareKeyed(repo, "ORVSG_TKRDiagnosticLogRecord", "", {"MessageTimestamp", "LogName", "RecordID", "Message"});
    DeclareKeyed(repo, "ORVSG_MemoryDiagLogRecord", "", {"Type", "Message"});
    if (completion) {
        repo.Parse(R"(
            CIM_DiagnosticCompletionRecord Id="d1" ServiceName="Drive Self Test" ManagedElementName="bay 5" RecordData="DGN-1B02-05 Failed <no drive>" CreationTimeStamp="2025-03-02"
            CIM_DiagnosticCompletionRecord Id="d2" ServiceName="Link Check" ManagedElementName="slot 3" RecordData="Aborted" CreationTimeStamp="2025-03-02"
        )");
    }
    if (defaultRecord) repo.Parse(R"(LSIESG_DiskDefaultCompletionRecord Id="d3" ServiceName="Default" RecordData="no test run")");
    if (tool) repo.Parse(R"(ORVSG_TKRDiagnosticLogRecord Id="t1" MessageTimestamp="2025-03-02" LogName="diags.log" RecordID="1" Message="started")");
    if (memory) repo.Parse(R"(ORVSG_MemoryDiagLogRecord Id="m1" Type="Correctable" Message="MEM-0007-CE DIMM 7: 12 errors")");
    return repo;
}

TEST(DiagnosticLog, WritesItsPageAsExpected) {
    struct TCase {
        const char* name;
        bool completion, defaultRecord, tool, memory;
        const char* lookup;
    } cases[] = {
        {"links", true, true, true, true, "1234\n"},
        {"no-links", true, true, true, true, ""},
        // The default record alone still brings the table and its heading.
        {"default-record-only", false, true, false, false, "1234\n"},
        // The memory table does not count as data for the index.
        {"memory-only", false, false, false, true, "9999\n"},
    };
    for (const auto& c : cases) {
        TRepoBuilder repo = Diagnostics(c.completion, c.defaultRecord, c.tool, c.memory);
        TDataFolder data;
        if (*c.lookup) data.Write("tkrEventsAtInfoC.txt", c.lookup);
        TLogRun run(repo.Namespace());
        run.writer.SetLogLinkSettings(LinkSettings(data.Path()));
        run.writer.WriteCustomDiagnosticLog(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "default", false),
                                            "DiagsFull");
        const std::string file = std::string("logs/diags-") + c.name + ".txt";
        EXPECT_EQ(testing::ExpectedPage(file, run.Transcript()), run.Transcript()) << file;
        EXPECT_EQ(*c.lookup == '\0', run.log.Contains("open tkrEventsAtInfoC.txt failed")) << c.name;
    }
}

// A code from the data cannot leave its place in the link.
TEST(DiagnosticLog, CodesAreEscapedInLinks) {
    TRepoBuilder repo;
    repo.Parse(R"(
        ORVSG_ComputerSystem ProductName="Example Server -[1234AC1]"
        CIM_DiagnosticCompletionRecord ServiceName="x" RecordData="../../a b?#c"
    )");
    TDataFolder data;
    data.Write("tkrEventsAtInfoC.txt", "1234\n");
    TLogRun run(repo.Namespace());
    run.writer.SetLogLinkSettings(LinkSettings(data.Path()));
    run.writer.WriteCustomDiagnosticLog(boost::make_shared<TReportParametersBuilder>(repo.Namespace(), "default", false),
                                        "DiagsFull");
    const std::vector<std::string> links = run.writer.CallsStartingWith("WriteTextCell({InfoCenterLink");
    ASSERT_EQ(1u, links.size());
    EXPECT_NE(std::string::npos,
              links[0].find("\"https://docs.test/infocenter/rackvane/information/topic/com.orv.acc.1234.doc/"
                            "%2E%2E%2F%2E%2E%2Fa%20b%3F%23.html\""))
        << links[0];
}

}  // namespace
}  // namespace braigrion
