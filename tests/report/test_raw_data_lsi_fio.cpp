// The LSI raw-data page's Base64 results and the presence tests of its
// callers, and the Fusion-io page whose result files are named by collected
// command texts.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "report/ExpectedPage.h"
#include "report/RawDataRun.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace {

using testing::Str;
using testing::TRawDataRun;
using testing::TRepoBuilder;
using NORVTKR20::TCIMValue;

// The result of the utility tool is decoded when its declaration says so,
// and ends at its first zero byte.
TEST(LSIRawData, Base64ResultsAreDecodedWhereDeclared) {
    struct TCase {
        const char* name;
        int qualifier;  // -1: none, 0: false, 1: true
        std::string stored;
        std::string written;
    } cases[] = {
        {"encoded", 1, "Q29udHJvbGxlciAwOiBTQVMzMTA4ClN0YXR1czogT3B0aW1hbA==",
         "Controller 0: SAS3108\nStatus: Optimal\n"},
        {"zero byte", 1, "YWJjAGRlZg==", "abc\n"},
        {"no qualifier", -1, "YWJjAGRlZg==", "YWJjAGRlZg==\n"},
        {"qualifier false", 0, "YWJjAGRlZg==", "YWJjAGRlZg==\n"},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        std::vector<repository::TQualifierData> qualifiers;
        if (c.qualifier >= 0) qualifiers.push_back(testrepo::Q("Base64Encode", TCIMValue::Boolean(c.qualifier == 1)));
        repo.Namespace()->DeclareClass(testrepo::C("ORV_LSIRawData", "",
                                                   {testrepo::P("Command", testrepo::T::eString),
                                                    testrepo::P("CommandResult", testrepo::T::eString, qualifiers)}));
        repo.Add("ORV_LSIRawData", {Str("Command", "storcli /c0 show"), Str("CommandResult", c.stored)});
        TRawDataRun run(repo.Namespace());
        std::string link = "lsi_info";
        EXPECT_EQ("lsi_rawData", run.writer.WriteLSIRawDataReport(link)) << c.name;
        EXPECT_EQ(c.written, run.Read("LSI_RawData_Rresults_0.txt")) << c.name;
    }
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
        TRawDataRun run(repo.Namespace());
        EXPECT_EQ(c.lsi, run.writer.isLSIRawDataPresent()) << c.repository;
        EXPECT_EQ(c.megaRaid, run.writer.isMRRawDataPresent()) << c.repository;
        EXPECT_EQ(c.vendor, run.writer.isMRVendorProviderPresent()) << c.repository;
    }
}

// A command names its result file whenever it is a safe name in the
// report's directory, whatever bytes it holds (its link percent-encoded, the
// command shown escaped); a path, ".", "..", an empty or over-long name, a
// name of the report's own kind of file and a name an earlier row took are
// written under a numbered name, and the link follows the file. A command
// that cannot be read repeats the row before it, its result in a file of
// its own. See raw/fio.txt.
TEST(FIORawData, CommandTextsNameTheirFilesOnlyInsideTheReport) {
    const std::vector<std::string> commands = {
        "fio-status -a", "../escaped.txt", "/tmp/absolute.txt", "sub/dir.txt", "back\\slash.txt", "bell\x07name",
        "<img src=x onerror=alert(1)>", "index.html", "..", "", "javascript:alert(1)", ".", std::string(256, 'x'),
        "fio-status -a", "fio-pci-check"};
    TRepoBuilder repo;
    for (size_t i = 0; i < commands.size(); ++i) {
        repo.Add("ORV_FIORawData", {Str("Command", commands[i]), Str("CommandResult", "result " + std::to_string(i))});
    }
    repo.Add("ORV_FIORawData", {Str("CommandResult", "result without command")});
    TRawDataRun run(repo.Namespace());
    const std::string dump = run.Dump(run.writer.WriteFIORawDataReport("fio_info"));
    EXPECT_EQ(testing::ExpectedPage("raw/fio.txt", dump), dump);
}

}  // namespace
}  // namespace braigrion
