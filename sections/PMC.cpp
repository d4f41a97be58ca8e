// The page "PMC RAID" from the classes of the PMC CIM provider: the
// management application, then per controller its card, driver, BIOS and
// firmware, and its logical disks with, nested under each, the physical
// disks, their drives and the drives' packages.
#include "StorageSupport.h"
#include "braigrion/TWriter.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TOSSpecific;

namespace {

const char kName[] = "TWriter::WritePMCReport";
const char kLink[] = "pmc";
const char kTitle[] = "PMC RAID";

std::string Said(const std::string& line) { return std::string(kName) + " -- " + line; }

// One property table per instance reached from `from`; the title line, when
// there is one, stands above the first.
TInstances WriteAssociatedTables(TWriter& writer, const TWriter::TInstancePtr& from, const std::string& assocClass,
                                 const std::string& resultClass, const std::string& title, const std::string& caption,
                                 const std::vector<TReportProperty>& rows) {
    const TInstances found = Associated(from, assocClass, resultClass);
    if (!found.empty() && !title.empty()) writer.WriteTableTitle(title, false, false);
    for (const TWriter::TInstancePtr& instance : found) WritePropertyTable(writer, instance, "50%", "40%", caption, rows);
    return found;
}

void WriteController(TWriter& writer, const TWriter::TInstancePtr& controller) {
    WriteAssociatedTables(writer, controller, "PMC_SystemPackaging", "PMC_Card", "Controller", "Controller",
                          {Row("Model"), Row("Manufacturer"), Row("ElementName"), Row("PartNumber"),
                           Row("SerialNumber")});
    WriteAssociatedTables(writer, controller, "PMC_DriverElementSoftwareIdentity", "PMC_DriverSoftwareIdentity", "",
                          "Driver", {Row("VersionString", "Driver Version")});
    WriteAssociatedTables(writer, controller, "PMC_BiosElementSoftwareIdentity", "PMC_BiosSoftwareIdentity", "",
                          "BIOS", {Row("VersionString", "BIOS Version")});
    WriteAssociatedTables(writer, controller, "PMC_FirmwareElementSoftwareIdentity", "PMC_FirmwareSoftwareIdentity",
                          "", "Firmware", {Row("VersionString", "Firmware Version")});

    const TInstances volumes = Associated(controller, "PMC_StorageVolumeSystemDevice", "PMC_StorageVolume");
    if (volumes.empty()) {
        Trace(Said("No PMC_StorageVolume instances found"));
        return;
    }
    // Each volume stands under its own title, since the tables of its
    // physical disks come between two volumes.
    for (const TWriter::TInstancePtr& volume : volumes) {
        writer.WriteTableTitle("Logical Disk", false, false);
        WritePropertyTable(writer, volume, "50%", "40%", "Logical Disk",
                           {Row("DeviceID"), Row("ControllerId"), Row("VolumeSetId"), Row("RAIDLevel"),
                            Row("OperationalStatus"), Row("State"), Row("Size"), Row("StripeUnitSize")});
        const TInstances extents = Associated(volume, "PMC_StorageVolumeConcreteDependency", "PMC_StorageExtent");
        if (!extents.empty()) writer.WriteTableTitle("Physical Disk", false, false);
        for (const TWriter::TInstancePtr& extent : extents) {
            WritePropertyTable(writer, extent, "50%", "40%", "Physical Disk",
                               {Row("DeviceID"), Row("ArrayID"), Row("Capacity"), Row("Type"), Row("InterfaceType"),
                                Row("DriveType"), Row("OperationalStatus")});
            for (const TWriter::TInstancePtr& drive : Associated(extent, "PMC_MediaPresent", "PMC_DiskDrive")) {
                WritePropertyTable(writer, drive, "50%", "40%", "Disk Drive", {Row("ProductName"), Row("WWN")});
                WriteAssociatedTables(writer, drive, "PMC_DiskDriveRealizes", "PMC_DiskDrivePhysicalPackage", "",
                                      "Disk Drive Physical Package",
                                      {Row("Manufacturer"), Row("Model"), Row("SerialNumber"), Row("Version")});
            }
        }
    }
}

}  // namespace

void TWriter::WritePMCReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(Said("Entering"));
    // The page is opened before anything is known of the data; the early
    // exits below leave it to the back-end to finish.
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLink);
    WritePageHeader();
    WriteReportTitle(kTitle, "", "");

    try {
        ClassNamed(fNamespace, "PMC_ControllerComputerSystem");
        ClassNamed(fNamespace, "PMC_ApplicationSoftwareIdentity");
    } catch (...) {
        Trace(Said("Exiting due to exception when getting class"));
        WriteIndexEntry(kLink, kTitle, false);
        return;
    }

    TInstances applications;
    try {
        applications = InstancesOf(fNamespace, "PMC_ApplicationSoftwareIdentity");
    } catch (...) {
        applications.clear();
        Trace(Said("Exiting due to exception when enumerating AS instance"));
    }
    TInstances controllers;
    try {
        controllers = InstancesOf(fNamespace, "PMC_ControllerComputerSystem");
    } catch (...) {
        Trace(Said("Exiting due to exception when enumerating CS instance"));
        WriteIndexEntry(kLink, kTitle, false);
        return;
    }
    if (controllers.empty()) {
        Trace(Said("Exiting due to empty vector"));
        WriteIndexEntry(kLink, kTitle, false);
        return;
    }

    if (!applications.empty()) {
        WriteTableTitle("Application Software", false, false);
        WritePropertyTable(*this, applications.front(), "50%", "40%", "Application Software",
                           {Row("Name"), Row("VersionString")});
    } else {
        Trace(Said("No PMC_ApplicationSoftwareIdentity instance found"));
    }
    for (const TInstancePtr& controller : controllers) {
        try {
            WriteController(*this, controller);
        } catch (...) {
            EndTable();
            Trace(Said("Exception when processing controller"));
        }
    }
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, true);
    Trace(Said("Exiting"));
}

}  // namespace braigrion
