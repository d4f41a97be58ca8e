// The page "LSI IDE Controller": per controller its configuration, its
// logical disks and its physical disks, each in a property table.
#include "StorageSupport.h"
#include "braigrion/TWriter.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

const char kName[] = "TWriter::WriteLSIIDEReport";
const char kLink[] = "lsiide";
const char kTitle[] = "LSI IDE Controller";

std::vector<TReportProperty> PhysicalRows() {
    std::vector<TReportProperty> rows = {Row("DriveStatus"), Row("Bus"), Row("TargetID"),
                                         Row("Version", "Firmware version", "ORVSG_LSIIDEControllerFirmwareElement",
                                             "ORVSG_LSIIDEFirmwareElement")};
    for (const char* name : {"MaxMediaSize", "ModelString", "SerialNumber", "MaxAddSector", "MaxPIOModeSupport",
                             "MaxMDMAModeSupport", "MaxUDMAModeSupport", "MDMAModeProgrammed", "UDMAModeProgrammed",
                             "SMARTFeatureSupport", "HOSTFeatureSupport", "PwrFeatureSupport", "SMARTFeatureEnable",
                             "HOSTFeatureEnabled", "PwrFeatureEnable"})
        rows.push_back(Row(name));
    return rows;
}

// The unsigned text of a number property; "" when it cannot be read as one.
std::string UnsignedText(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        return std::to_string(instance->GetProperty(property, TCIMContext())->GetValue(TCIMContext()).AsUnsigned());
    } catch (...) {
        return std::string();
    }
}

void WriteController(TWriter& writer, const TWriter::TInstancePtr& controller) {
    const std::string title =
        "Controller #" + writer.GetPropertyValue(controller, "ControllerNum", ",") + " Configuration";
    writer.WriteTableTitle(title, false, false);
    WritePropertyTable(writer, controller, "50%", "40%", title,
                       {Row("ControllerType"),
                        Row("Version", "BIOS version", "ORVSG_LSIIDEControllerBIOSElement", "ORVSG_LSIIDEBIOSElement"),
                        Row("ControllerDevNum")});

    for (const TWriter::TInstancePtr& disk :
         Associated(controller, "ORVSG_LSIIDEProtocolControllerForUnit", "ORVSG_LSIIDELogicalDisk")) {
        writer.WriteTableTitle("Logical drive information", false, false);
        WritePropertyTable(writer, disk, "50%", "40%", title + " logical drive information",
                           {Row("VolumeNumber"), Row("RAIDLevel"), Row("BlockSize"), Row("TotalStripe"),
                            Row("PhysicalHardDisks")});
    }

    for (const TWriter::TInstancePtr& disk :
         Associated(controller, "ORVSG_LSIIDEProtocolControllerForPhysicalDisk", "ORVSG_LSIIDEDiskDrive")) {
        writer.WriteTableTitle("Physical drive information", false, false);
        writer.WriteTableTitle("Channel #: " + UnsignedText(disk, "Bus"), false, false);
        writer.StartPropertyTable("50%", "40%", title + " physical drive information");
        for (const TReportProperty& row : PhysicalRows()) WritePropertyRow(writer, disk, row);
        writer.EndTable();
    }
}

}  // namespace

void TWriter::WriteLSIIDEReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(std::string("Entering ") + kName);
    TInstances controllers;
    try {
        ClassNamed(fNamespace, "ORVSG_LSIIDEProtocolController");
    } catch (const TTKRException& ex) {
        Trace(std::string("Exiting ") + kName +
              ", ex.fStatusCode.fStatusCode=" + std::to_string(ex.fStatusCode.fStatusCode));
        WriteIndexEntry(kLink, kTitle, false);
        return;
    }
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLink);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");
    try {
        controllers = InstancesOf(fNamespace, "ORVSG_LSIIDEProtocolController");
    } catch (...) {
        controllers.clear();
    }
    bool hasData = false;
    for (const TInstancePtr& controller : controllers) {
        try {
            WriteController(*this, controller);
            hasData = true;
        } catch (...) {
            EndTable();
            Trace(std::string(kName) + " -- Exception when processing controller");
        }
    }
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, hasData);
    Trace(std::string("Exiting ") + kName);
}

}  // namespace braigrion
