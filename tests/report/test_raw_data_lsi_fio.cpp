// The LSI raw-data page (three tables, the ordering by controller, Base64
// results), the presence tests of its callers, and the Fusion-io page whose
// result files are named by collected command texts.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/RawDataRun.h"
#include "repository/CIMXMLReader.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::Str;
using testing::StrArray;
using testing::TEscapingWriter;
using testing::TRawDataRun;
using testing::TRepoBuilder;
using testing::U32;
using NORVTKR20::TCIMValue;
typedef std::vector<std::string> TNames;

std::string WriteLSI(TWriter& writer) {
    std::string link = "lsi_info";
    return writer.WriteLSIRawDataReport(link);
}

TEST(LSIRawData, ThreeTablesOnOnePageTheUtilityCommandsByController) {
    TRepoBuilder repo;
    // Ordered by the text of controller and utility: "10" before "1s" before
    // "2"; equal keys keep their order.
    auto utility = [&](unsigned int controller, const std::string& command) {
        repo.Add("ORV_LSIRawData", {U32("ControllerNumber", controller), Str("Utility", "storcli"),
                                    Str("Command", command), Str("CommandResult", command + " output")});
    };
    utility(2, "storcli /c2 show");
    utility(10, "storcli /c10 show");
    utility(1, "storcli /c1 show");
    utility(1, "storcli /c1 show all");
    repo.Add("ORVSG_MegaLSIRawData", {Str("Command", "MegaCli -AdpAllInfo -aALL"),
                                      StrArray("RawResults", {"Adapter #0", "Product Name : RAID 930-8i"})})
        .Add("ORVSG_lsiRawData", {Str("Command", "lsiutil -p1 -a 1"), StrArray("RawResults", {"SAS3 Port 1"})});
    TRawDataRun<> run(repo.Namespace());

    EXPECT_EQ("lsi_rawData", WriteLSI(run.writer));
    auto row = [](const std::string& command, const std::string& file) {
        return " | \"<font face=\\\"Courier\\\">" + command + "</font>\" \"<a href=\\\"" + file +
               "\\\">View Results</a>\"";
    };
    EXPECT_EQ("OpenPage(\"out/lsi_rawData\")\nWritePageHeader()\n"
              "WriteReportTitle(\"LSI Raw Data Information\", \" - [Show Standard Report]\", \"lsi_info\")\n"
              "WriteTableBreak()\n"
              "WriteTableTitle(\"Commands Issued\", false, false)\n"
              "WriteTableGrid(grid 5x2 width=75 widths=[80,20] colheaders | \"Command\" \"Raw Result\"" +
                  row("storcli /c10 show", "LSI_RawData_Rresults_0.txt") +
                  row("storcli /c1 show", "LSI_RawData_Rresults_1.txt") +
                  row("storcli /c1 show all", "LSI_RawData_Rresults_2.txt") +
                  row("storcli /c2 show", "LSI_RawData_Rresults_3.txt") +
                  ")\n"
                  "WriteTableTitle(\"Commands Issued\", false, false)\n"
                  "WriteTableGrid(grid 2x2 width=75 widths=[80,20] colheaders | \"Command\" \"Raw Result\"" +
                  row("MegaCli -AdpAllInfo -aALL", "MegaLSI_RawData_Rresults_0.txt") +
                  ")\n"
                  "WriteTableTitle(\"Commands Issued\", false, false)\n"
                  "WriteTableGrid(grid 2x2 width=75 widths=[80,20] colheaders | \"Command\" \"Result\"" +
                  row("lsiutil -p1 -a 1", "LSI_RawData_Results_0.txt") + ")\nWritePageFooter()\nClosePage()\n",
              run.Transcript());
    EXPECT_EQ("storcli /c10 show output\n", run.Read("LSI_RawData_Rresults_0.txt"));
    EXPECT_EQ("storcli /c2 show output\n", run.Read("LSI_RawData_Rresults_3.txt"));
    EXPECT_EQ("Adapter #0\nProduct Name : RAID 930-8i\n", run.Read("MegaLSI_RawData_Rresults_0.txt"));
    EXPECT_EQ("SAS3 Port 1\n", run.Read("LSI_RawData_Results_0.txt"));
}

TEST(LSIRawData, AFailingTableIsLeftOutAndThePageGoesOn) {
    TRepoBuilder repo;
    repo.Add("ORVSG_MegaLSIRawData", {Str("Command", "MegaCli -v"), StrArray("RawResults", {"8.07"})})
        .Add("ORVSG_lsiRawData", {Str("Command", "lsiutil -v"), StrArray("RawResults", {"1.72"})})
        .Add("ORV_LSIRawData", {Str("CommandResult", "no command")});
    TRawDataRun<> run(repo.Namespace());
    run.Block("MegaLSI_RawData_Rresults_0.txt");
    EXPECT_EQ("lsi_rawData", WriteLSI(run.writer));
    // The utility table stands with an empty command, the MegaRAID table is
    // gone, the IR table follows.
    EXPECT_EQ(2u, run.writer.CallsStartingWith("WriteTableGrid(").size());
    EXPECT_NE(std::string::npos, run.Transcript().find("\"<font face=\\\"Courier\\\"></font>\""));
    EXPECT_NE(std::string::npos, run.Transcript().find("LSI_RawData_Results_0.txt"));
    EXPECT_EQ("ClosePage()\n", run.Transcript().substr(run.Transcript().size() - 12));
    EXPECT_TRUE(run.log.Contains("TWriter::WriteLSIRawDataReport -- Exception when writing LSI MR raw data table "));
    EXPECT_TRUE(run.log.Contains(
        "TWriter::WriteLSIRawDataReport -- Exception when getting the command sent to LSI utility tool"));
}

struct TBase64Case {
    const char* name;
    int qualifier;  // -1: none, 0: false, 1: true
    std::string stored;
    std::string written;
};

// The result of the utility tool is decoded when its declaration says so,
// and ends at its first zero byte.
TEST(LSIRawData, Base64ResultsAreDecodedWhereDeclared) {
    const TBase64Case cases[] = {
        {"encoded", 1, "Q29udHJvbGxlciAwOiBTQVMzMTA4ClN0YXR1czogT3B0aW1hbA==",
         "Controller 0: SAS3108\nStatus: Optimal\n"},
        {"zero byte", 1, "YWJjAGRlZg==", "abc\n"},
        {"no qualifier", -1, "YWJjAGRlZg==", "YWJjAGRlZg==\n"},
        {"qualifier false", 0, "YWJjAGRlZg==", "YWJjAGRlZg==\n"},
    };
    for (const TBase64Case& c : cases) {
        TRepoBuilder repo;
        std::vector<repository::TQualifierData> qualifiers;
        if (c.qualifier >= 0) qualifiers.push_back(testrepo::Q("Base64Encode", TCIMValue::Boolean(c.qualifier == 1)));
        repo.Namespace()->DeclareClass(testrepo::C("ORV_LSIRawData", "",
                                                   {testrepo::P("Command", testrepo::T::eString),
                                                    testrepo::P("CommandResult", testrepo::T::eString, qualifiers)}));
        repo.Add("ORV_LSIRawData", {Str("Command", "storcli /c0 show"), Str("CommandResult", c.stored)});
        TRawDataRun<> run(repo.Namespace());
        EXPECT_EQ("lsi_rawData", WriteLSI(run.writer)) << c.name;
        EXPECT_EQ(c.written, run.Read("LSI_RawData_Rresults_0.txt")) << c.name;
    }
}

// The sample's utility results decode to the tool's text; the one the tool
// padded with zero bytes ends before them.
TEST(LSIRawData, TheSampleResultsDecode) {
    repository::TLoadResult loaded =
        repository::LoadCollection({std::string(BRAIGRION_SOURCE_DIR) + "/samples/linux-server/lsi-rawdata.xml"});
    TRawDataRun<> run(loaded.fNamespace);
    EXPECT_EQ("lsi_rawData", WriteLSI(run.writer));
    for (const char* file : {"LSI_RawData_Rresults_0.txt", "LSI_RawData_Rresults_1.txt"}) {
        const std::string text = run.Read(file);
        EXPECT_EQ(std::string::npos, text.find('\0')) << file;
        EXPECT_EQ("Controller = 0\n", text.substr(text.find("Controller = "), 15)) << file;
    }
    const std::string padded = run.Read("LSI_RawData_Rresults_1.txt");
    EXPECT_EQ("Physical Drives = 5\n\n", padded.substr(padded.size() - 21));
}

TEST(LSIRawData, PresenceTestsAskTheirOwnClasses) {
    struct TCase {
        const char* repository;
        bool lsi, megaRaid, vendor;
    } cases[] = {
        {"", false, false, false},
        {"ORV_LSIRawData Command=\"storcli\"", true, false, false},
        {"ORVSG_lsiRawData Command=\"lsiutil\"", true, false, false},
        {"ORVSG_MegaLSIRawData Command=\"MegaCli\"", true, true, false},
        {"class ORVSG_MegaLSIRawData", false, false, false},
        {"LSIESG_MegaRAIDHBA Name=\"RAID 930-8i\"", false, false, true},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TRawDataRun<> run(repo.Namespace());
        EXPECT_EQ(c.lsi, run.writer.isLSIRawDataPresent()) << c.repository;
        EXPECT_EQ(c.megaRaid, run.writer.isMRRawDataPresent()) << c.repository;
        EXPECT_EQ(c.vendor, run.writer.isMRVendorProviderPresent()) << c.repository;
    }
    TRepoBuilder empty;
    TRawDataRun<> run(empty.Namespace());
    run.writer.isLSIRawDataPresent();
    EXPECT_EQ((TNames{"TWriter::isLSIRawDataPresent -- Exception when getting class ORV_LSIRawData",
                      "TWriter::isLSIRawDataPresent -- Exception when getting class ORVSG_lsiRawData",
                      "TWriter::isLSIRawDataPresent -- Exception when getting class ORVSG_MegaLSIRawData"}),
              run.log.Messages());
}

// A command names its result file only when it is a plain name inside the
// report's directory; any other is written under a numbered name, the link
// follows the file, and the command is shown escaped.
TEST(FIORawData, CommandTextsNeverWriteOutsideTheReport) {
    struct TCase {
        std::string command;
        std::string file;
    } cases[] = {
        {"fio-status -a", "fio-status -a"},
        {"../escaped.txt", "FIO_RawData_Results_1.txt"},
        {"../../escaped.txt", "FIO_RawData_Results_2.txt"},
        {"/tmp/absolute.txt", "FIO_RawData_Results_3.txt"},
        {"sub/dir.txt", "FIO_RawData_Results_4.txt"},
        {"back\\slash.txt", "FIO_RawData_Results_5.txt"},
        {"bell\x07name", "FIO_RawData_Results_6.txt"},
        {"<img src=x onerror=alert(1)>", "FIO_RawData_Results_7.txt"},
        {"index.html", "FIO_RawData_Results_8.txt"},
        {"..", "FIO_RawData_Results_9.txt"},
        {"", "FIO_RawData_Results_10.txt"},
        {"javascript:alert(1)", "FIO_RawData_Results_11.txt"},
        {"fio-pci-check", "fio-pci-check"},
    };
    TRepoBuilder repo;
    int n = 0;
    for (const TCase& c : cases) {
        repo.Add("ORV_FIORawData", {Str("Command", c.command), Str("CommandResult", "result " + std::to_string(n++))});
    }
    // A command that cannot be read repeats the row before it.
    repo.Add("ORV_FIORawData", {Str("CommandResult", "result without command")});
    TRawDataRun<TEscapingWriter> run(repo.Namespace());

    EXPECT_EQ("fio_rawData", run.writer.WriteFIORawDataReport("fio_info"));
    EXPECT_EQ(TNames{"report"}, run.Entries(run.Root()));
    TNames expectedFiles;
    for (const TCase& c : cases) expectedFiles.push_back(c.file);
    std::sort(expectedFiles.begin(), expectedFiles.end());
    EXPECT_EQ(expectedFiles, run.Files());

    std::vector<std::string> grids = run.writer.CallsStartingWith("WriteTableGrid(");
    ASSERT_EQ(1u, grids.size());
    for (size_t i = 0; i < sizeof(cases) / sizeof(cases[0]); ++i) {
        const std::string link = "\"<a href=\\\"" + cases[i].file + "\\\">View Results</a>\"";
        EXPECT_NE(std::string::npos, grids[0].find(link)) << cases[i].file;
        if (cases[i].file != "fio-pci-check") {
            EXPECT_EQ("result " + std::to_string(i) + "\n", run.Read(cases[i].file));
        }
    }
    EXPECT_NE(std::string::npos, grids[0].find("&lt;img src=x onerror=alert(1)&gt;"));
    EXPECT_EQ(std::string::npos, grids[0].find("<img"));
    EXPECT_EQ("result without command\n", run.Read("fio-pci-check"));
    EXPECT_TRUE(run.log.Contains("TWriter::WriteFIORawDataReport -- Exception when getting the command"));
}

}  // namespace
}  // namespace braigrion
