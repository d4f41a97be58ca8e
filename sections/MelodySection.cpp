// The Melody device analysis page: device properties scored by how unusual
// their values are among comparable machines, highest score first. The
// heading text comes from a file beside the tool; the rows are the
// back-end's to lay out.
#include <algorithm>
#include <fstream>

#include "MellanoxBlocks.h"
#include "braigrion/TInstanceSorter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "melodydevices";
const char kTitle[] = "Melody Device Analysis";

// The heading text: the lines of the file joined by line feeds; "" when the
// file cannot be read.
std::string ReadHeading(const std::string& path) {
    std::ifstream in(path.c_str());
    std::string text;
    std::string line;
    bool first = true;
    while (std::getline(in, line)) {
        if (!line.empty() && line[line.size() - 1] == '\r') line.erase(line.size() - 1);
        if (!first) text += "\n";
        text += line;
        first = false;
    }
    if (!in.eof()) Trace("TWriter::WriteMelodyReport -- No heading file at " + path);
    return text;
}

// The display text of a property; "" when the instance does not hold it.
std::string DisplayText(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        return instance->GetProperty(property, NORVTKR20::TCIMContext())->GetValueString();
    } catch (...) {
        return std::string();
    }
}

// The number of a count property; 0 when it is missing or not a number.
int CountOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        const NORVTKR20::TCIMValue& value = instance->GetProperty(property, NORVTKR20::TCIMContext())->GetValue();
        if (value.IsNull()) return 0;
        return static_cast<int>(value);
    } catch (...) {
        return 0;
    }
}

}  // namespace

void TWriter::WriteMelodyReport(TBuilderPtr /*builder*/, std::string reportName) {
    Trace("Entering TWriter::WriteMelodyReport");
    WriteMelodyPrologue(ReadHeading(fReportPath + "//data//melodydeviceheader.txt"));

    // The message log is read with the devices; the page shows the devices.
    GuardedVendorClass(fNamespace, "ORVSG_MelodyMessageLog", "TWriter::WriteMelodyReport -- No ORVSG_MelodyMessageLog");
    TClassPtr devices =
        GuardedVendorClass(fNamespace, "ORVSG_MelodyDevices", "TWriter::WriteMelodyReport -- No ORVSG_MelodyDevices");
    TInstances instances = DeepInstances(devices);

    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");
    WriteMelodyTableStart();

    static const char* const kColumns[] = {"MelodyScore",        "MelodyType",  "MelodyCimType",
                                           "MelodyPropertyName", "MelodyValue", "MelodyFrequency",
                                           "MelodyCommonValues", "MelodyCommonFrequencies"};
    StartColumnTable("100%", kTitle, false);
    StartRow(false);
    for (const char* column : kColumns) WriteHeaderCell(devices, TReportProperty(column, "", "", "", "", ""));
    EndRow();
    EndTableHeader();

    TInstanceSorter byScore;
    byScore.AddProperty("MelodyScore", false, false);
    TWriterUtil::SortInstances(instances, byScore, true);
    for (const TInstancePtr& device : instances) {
        StartRow(true);
        WriteMelodyDeviceRow(device, DisplayText(device, kColumns[0]), DisplayText(device, kColumns[1]),
                             DisplayText(device, kColumns[2]), DisplayText(device, kColumns[3]),
                             DisplayText(device, kColumns[4]), DisplayText(device, kColumns[5]),
                             DisplayText(device, kColumns[6]), CountOf(device, kColumns[7]));
        EndRow();
    }
    EndTable();
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, reportName, !instances.empty());
    Trace("Exiting TWriter::WriteMelodyReport");
}

}  // namespace braigrion
