// The KMC sample machine written the way its service processor's logs are
// read on a KMC system: with the KMC flag and in LUZ mode, where the IPMI
// page carries the parser's output and the raw records, and the DCAP log
// exists (tests/fixtures/pages/kmc-blade-luz/); and the pre-boot sample's
// system inventory of the same logs (tests/fixtures/pages/preboot-inventory/).
#include <algorithm>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
#include "braigrion/TReport.h"
#include "report/ExpectedPage.h"
#include "repository/CIMXMLReader.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace {

namespace fs = std::filesystem;

// Grids one row a line, as in the other page transcripts.
using TGridRecorder = testing::TGridLinesRecorder;

std::vector<std::string> SampleFiles(const std::string& sample) {
    std::vector<std::string> files;
    const fs::path directory = fs::path(BRAIGRION_SOURCE_DIR) / "samples" / sample;
    for (const auto& entry : fs::directory_iterator(directory)) {
        if (entry.path().extension() == ".xml") files.push_back(entry.path().string());
    }
    std::sort(files.begin(), files.end());
    return files;
}

// The calls from the page's OpenPage to its index line.
std::string PageOf(const std::vector<std::string>& calls, const std::string& link) {
    std::string page;
    bool inside = false;
    for (const std::string& call : calls) {
        if (call.compare(0, 11, "EscapeText(") == 0 || call.compare(0, 17, "GetSeparatorText(") == 0) continue;
        if (call == "OpenPage(\"out/" + link + "\")") inside = true;
        if (!inside) continue;
        page += call + "\n";
        const std::string index = "WriteIndexEntry(\"" + link + "\"";
        if (call.compare(0, index.size(), index) == 0) break;
    }
    return page;
}

TEST(KMCSample, ServiceProcessorPagesInLuzMode) {
    std::map<std::string, NORVTKR20::TCIMValue> context;
    context["mode"] = NORVTKR20::TCIMValue(std::string("luz"));
    context["KMC"] = NORVTKR20::TCIMValue(std::string("TRUE"));
    TGridRecorder writer("html");
    TReport report(repository::LoadCollection(SampleFiles("kmc-blade")).fNamespace, context, "out");
    report.Write(&writer, context);
    for (const char* link : {"ipmi_event", "SPINTlog_system"}) {
        const std::string page = PageOf(writer.Calls(), link);
        const std::string file = std::string("kmc-blade-luz/") + link + ".txt";
        EXPECT_EQ(testing::ExpectedPage(file, page), page) << file;
    }
    // The KMC road has no chassis event log page of its own.
    EXPECT_EQ("", PageOf(writer.Calls(), "chassis_event"));
}

// The sample's drive removal and product name are mended before its pages.
TEST(KMCSample, IsRepairedBeforeItsPages) {
    TGridRecorder writer(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY);
    std::map<std::string, NORVTKR20::TCIMValue> context;
    context["pageID"] = NORVTKR20::TCIMValue(std::string("CriticalDetails"));
    boost::shared_ptr<NORVTKR20::ICIMNamespace> ns = repository::LoadCollection(SampleFiles("kmc-blade")).fNamespace;
    TReport report(ns, context, "out");
    report.GetPage(&writer, context);
    const std::string page = PageOf(writer.Calls(), "critical_details");
    EXPECT_NE(std::string::npos,
              page.find("\"GPA: Hard drive (possibly RAID drive) removal detected on bay 5 at 2025-03-02 03:16:50. "
                        "Check Halcyon or DLM Event or IPMI Event  for more infomation.\""))
        << page;
    EXPECT_EQ("4712", writer.GetMTFromRepository());
}

// The pre-boot edition's system inventory shows the service processor's
// logs in their inventory form: with the KMC flag the IPMI events without
// their auxiliary log, then the chassis event log.
TEST(PrebootSample, InventoryShowsTheKMCFormOfTheIPMIPage) {
    TGridRecorder writer(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY);
    std::map<std::string, NORVTKR20::TCIMValue> context;
    context["pageID"] = NORVTKR20::TCIMValue(std::string("KMCLogs"));
    context["KMC"] = NORVTKR20::TCIMValue(std::string("TRUE"));
    TReport report(repository::LoadCollection(SampleFiles("preboot")).fNamespace, context, "out");
    report.GetPage(&writer, context);
    const std::string page = PageOf(writer.Calls(), "ipmi_event");
    EXPECT_EQ(testing::ExpectedPage("preboot-inventory/ipmi_event.txt", page), page);
    EXPECT_NE("", PageOf(writer.Calls(), "chassis_event"));
}

}  // namespace
}  // namespace braigrion
