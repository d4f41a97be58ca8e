// The raw-data pages of the Halcyon controller and of its manager: the
// commands the collectors sent, each with its output in a text file. A
// result file that cannot be written ends the page with the exception of
// the file; the caller then shows its page without the raw-data link.
#include "RawDataSupport.h"
#include "braigrion/TWriter.h"

namespace braigrion {

using namespace rawdata;

namespace {

struct THalcyonPage {
    const char* name;        // qualified name for the trace lines
    const char* className;
    const char* link;
    const char* title;
    const char* filePrefix;
    int missingClassLevel;   // level of the line that says the class is missing
};

const THalcyonPage kController = {"TWriter::WriteHalcyonRawDataReport", "ORVSG_hcRawData", "hc_rawData_index",
                                  "Halcyon Raw Data Information", "hc_RawData_Results_", 3};
const THalcyonPage kManager = {"TWriter::WriteHalcyonManagerRawDataReport", "ORVSG_hcManagerRawData",
                               "hcmanager_rawData_index", "Halcyon Manager Raw Data Infomation",
                               "hc_Manager_RawData_Results_", 2};

std::string WriteHalcyonPage(TWriter& writer, const TWriter::TNamespacePtr& ns, const std::string& outputPath,
                             const THalcyonPage& page, const std::string& standardLink) {
    const std::string name = page.name;
    Trace(name + " -- Entering");
    TInstances instances;
    try {
        instances = InstancesOf(ns, page.className);
    } catch (...) {
        Log(page.missingClassLevel, name + " -- Exception when getting class " + page.className);
        return std::string();
    }
    if (instances.empty()) {
        Trace(name + " -- No instance of class " + page.className);
        return std::string();
    }

    OpenRawPage(writer, outputPath, page.link, page.title, standardLink);
    writer.WriteTableTitle(kCommandsIssued, false, false);
    TTable table = FillCommandsTable(writer, outputPath, instances,
                                     {"Command", "Result", page.filePrefix, "Command", "RawResults"});
    writer.WriteTableGrid(table);
    writer.WritePageFooter();
    writer.ClosePage();
    Trace(name + " -- Exiting");
    return page.link;
}

}  // namespace

std::string TWriter::WriteHalcyonRawDataReport(std::string linkName) {
    return WriteHalcyonPage(*this, fNamespace, fOutputPath, kController, linkName);
}

std::string TWriter::WriteHalcyonManagerRawDataReport(std::string linkName) {
    return WriteHalcyonPage(*this, fNamespace, fOutputPath, kManager, linkName);
}

}  // namespace braigrion
