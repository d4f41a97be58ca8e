// The page "Drive Health": SMART data of ATA drives, tape drive sense data
// and raw SCSI sense data.
#include <string>

#include <gtest/gtest.h>

#include "report/ExpectedPage.h"
#include "sections/StorageFixture.h"

namespace braigrion {
namespace {

using testing::Has;
using testing::LinesStartingWith;
using testing::Link;
using testing::TRawDataRun;
using testing::TRepoBuilder;

const char kDrive[] = "OMC_ATADevice.DeviceID=\"/dev/sdd\"";

std::string WritePage(TRawDataRun& run) {
    run.writer.WriteDriveHealthReport(nullptr, "DriveHealth");
    return run.Transcript();
}

// One ATA drive with its status, attributes 12, 5 and 194 in that order,
// and two errors, the first with the command before it.
void AddATADrive(TRepoBuilder& repo) {
    repo.Parse(R"(
        OMC_ATADevice DeviceID="/dev/sdd" VendorID="ATA" ProductID="ST1000NX0423"
        OMC_IDESMARTErrorLog InstanceID="log" smartStatus="FAILED!"
        OMC_IDESMARTAttrib InstanceID="a12" attribID=uint8:12 attribName="Power_Cycle_Count" rawVal=uint8[]:49,0
        OMC_IDESMARTAttrib InstanceID="a5" attribID=uint8:5 attribName="Reallocated_Sector_Ct" value=uint8:3 threshold=uint8:10
        OMC_IDESMARTAttrib InstanceID="a194" attribID=uint8:194 attribName="Temperature_Celsius"
        OMC_IDESMARTError InstanceID="e11" RecordID=11 errorReg="40"
        OMC_IDESMARTError InstanceID="e12" RecordID=12 errorReg="40"
        OMC_IDESMARTErrorCmdData InstanceID="c1" commandId=1 commandReg="60"
    )");
    Link(repo, "OMC_IDESMARTUseOfMessageLog", "OMC_IDESMARTErrorLog.InstanceID=\"log\"", kDrive);
    for (const char* attribute : {"a12", "a5", "a194"})
        Link(repo, "OMC_IDESMARTElementStatisticalData", kDrive,
             std::string("OMC_IDESMARTAttrib.InstanceID=\"") + attribute + "\"", "ManagedElement", "Stats");
    for (const char* error : {"e11", "e12"})
        Link(repo, "OMC_IDESMARTRecordInLog", kDrive, std::string("OMC_IDESMARTError.InstanceID=\"") + error + "\"");
    Link(repo, "OMC_IDESMARTLogCmdData", "OMC_IDESMARTError.InstanceID=\"e11\"",
         "OMC_IDESMARTErrorCmdData.InstanceID=\"c1\"");
}

// The four SMART tables of a drive: attributes by number (5 before 12),
// the newest error first with the commands before it nested under it. In
// LUZ mode the raw sense page follows. See storage/drive-health-luz.txt.
TEST(DriveHealth, SmartTablesAndSenseData) {
    TRepoBuilder repo;
    AddATADrive(repo);
    repo.Parse("OMC_SCSISenseRawData InstanceID=\"/dev/sg3\" pageNumber=uint8:46 rawData=uint8[]:46,0,0,64");
    TRawDataRun run(repo.Namespace(), "html", "luz");
    const std::string page = WritePage(run);
    EXPECT_EQ(testing::ExpectedPage("storage/drive-health-luz.txt", page), page);
    const size_t five = page.find("| \"5\" \"Reallocated_Sector_Ct\"");
    const size_t twelve = page.find("| \"12\" \"Power_Cycle_Count\"");
    ASSERT_NE(std::string::npos, twelve);
    EXPECT_LT(five, twelve);
}

// A tape drive shows every property but the two cleaning ones, and the time
// to clean only while the drive asks for cleaning.
TEST(DriveHealth, TapeCleaningRows) {
    struct TCase {
        const char* cleanNow;
        bool timeToClean;
    } cases[] = {{"true", true}, {"false", false}};
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(std::string("ORVSG_TapeDriveSensePageData InstanceID=\"/dev/st0\" vendor=\"QUANTUM\" cleanNow=") +
                   c.cleanNow + " timeToClean=\"Cleaning required now\" lifetimeMediaLoads=1843");
        TRawDataRun run(repo.Namespace(), "html", "default");
        const std::string page = WritePage(run);
        EXPECT_EQ(3u + c.timeToClean, LinesStartingWith(page, "WriteDeclarationHeader(").size()) << c.cleanNow;
        EXPECT_EQ(c.timeToClean, Has(page, "WriteDeclarationHeader(<decl timeToClean>)")) << c.cleanNow;
        EXPECT_FALSE(Has(page, "WriteDeclarationHeader(<decl cleanNow>)")) << c.cleanNow;
        EXPECT_TRUE(Has(page, "WriteIndexEntry(\"Drive_Health\", \"Drive Health\", true)")) << c.cleanNow;
    }
}

// Without any source the page says so; raw sense data counts only in LUZ
// mode.
TEST(DriveHealth, NothingToShow) {
    struct TCase {
        const char* repository;
        const char* mode;
        bool message;
    } cases[] = {
        {"", "default", true},
        {"class OMC_ATADevice\nclass ORVSG_TapeDriveSensePageData", "luz", true},
        {"OMC_SCSISenseRawData InstanceID=\"sg0\" pageNumber=uint8:46", "default", true},
        {"OMC_SCSISenseRawData InstanceID=\"sg0\" pageNumber=uint8:46", "luz", false},
    };
    for (const TCase& c : cases) {
        TRepoBuilder repo;
        repo.Parse(c.repository);
        TRawDataRun run(repo.Namespace(), "html", c.mode);
        const std::string page = WritePage(run);
        const std::string what = std::string(c.repository) + " " + c.mode;
        EXPECT_EQ(c.message, Has(page, "WriteMessageCell({No Supported IDE or Tape Drive\n width=\"100%\"}, "
                                       "\"No Supported IDE or Tape Drive found\\n\")"))
            << what << "\n" << page;
        EXPECT_EQ(!c.message, Has(page, "WriteIndexEntry(\"Drive_Health\", \"Drive Health\", true)")) << what;
    }
}

}  // namespace
}  // namespace braigrion
