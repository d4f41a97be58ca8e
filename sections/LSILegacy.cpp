// The page "LSI Controller" from the legacy collectors' classes: integrated
// RAID controllers (ORVSG_LSI*), their LSI 1030 form, and MegaRAID
// controllers (ORVSG_MegaLSI*). The 1030 report is also written from the
// Cardinal page, since that chip stays with the legacy collector.
#include "StorageSupport.h"
#include "braigrion/MarkupConstants.h"
#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

const char kName[] = "TWriter::WriteLSIReportWithLegacyProvider";
const char kLink[] = "lsi_mir";
const char kTitle[] = "LSI Controller";
const char kControllerClass[] = "ORVSG_LSISCSIProtocolController";
const char kMegaControllerClass[] = "ORVSG_MegaLSISCSIProtocolController";
const char kLogicalTitle[] = "Logical drive information";
const char kPhysicalTitle[] = "Physical device information";
const unsigned kHardDisk = 14;

// How the integrated RAID report and its 1030 form differ.
struct TIRLayout {
    bool only1030;             // controllers without "1030" in their type are passed over
    std::string name;          // qualified name for the trace lines
    bool readsType;            // LSIType read; otherwise taken as 0
    bool withFruRow;           // the physical table has the ORVFruCru row
    std::string statusCaption, logicalCaption, physicalCaption;  // after the controller title
};

bool HasProperty(const TWriter::TInstancePtr& instance, const std::string& name) {
    try {
        return static_cast<bool>(instance->GetProperty(name, TCIMContext()));
    } catch (...) {
        return false;
    }
}

unsigned char LSITypeOf(const TWriter::TInstancePtr& controller) {
    try {
        return static_cast<unsigned char>(controller->GetProperty("LSIType", TCIMContext())->GetValue(TCIMContext()));
    } catch (...) {
        return 0;
    }
}

}  // namespace

void TWriter::WriteLSIReportWithLegacyProvider(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(std::string("Entering ") + kName);
    bool noCard = true;
    bool rawLink = false;
    std::string rawPage;
    if (fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML &&
        ((isLSIRawDataPresent() && fMode == "luz") || isMRRawDataPresent())) {
        Trace("TWriter::WriteLSIReportWithCardinal -- Under LUZ mode, write LSI raw data first ");
        rawPage = RawDataLink(
            [&] {
                std::string link = kLink;
                return WriteLSIRawDataReport(link);
            },
            {std::string(kName) + " -- Exception was thrown from WriteLSIRawDataReport",
             std::string(kName) + " -- WriteLSIRawDataReport Failed",
             std::string(kName) + " -- WriteLSIRawDataReport Success"});
        if (!rawPage.empty()) {
            noCard = false;
            rawLink = true;
        }
    }

    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLink);
    WritePageHeader();
    if (rawLink) {
        WriteReportTitle(kTitle, TKR_REPORT_DEFINITION::kTKRShowRawData, rawPage);
    } else {
        WriteReportTitle(kTitle, "", "");
    }
    Trace(std::string(kName) + " -- Write LSI IR report, invoking WriteLSIIntegratedRaidReport ");
    WriteLSIIntegratedRaidReport(noCard);
    WriteMegaLSIReport(noCard);
    if (noCard && !rawLink) WriteNothingFound(*this, "No LSI RAID card detected\n", "");
    const bool warranty = WriteSSDWarrantyInfoReport();
    const bool pcieSSD = WriteLSIPCIeSSDReport();
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, (!noCard || rawLink || warranty) ? true : pcieSSD);
    Trace(std::string("Exiting ") + kName);
}

namespace {

// The tables of one integrated RAID controller: configuration, status,
// logical drives, hard disks (by channel) and, for LSIType 3, enclosures.
void WriteIRController(TWriter& writer, const TWriter::TNamespacePtr& ns, const TWriter::TInstancePtr& controller,
                       const TIRLayout& layout) {
    const unsigned char type = layout.readsType ? LSITypeOf(controller) : 0;
    const std::string title = layout.only1030 ? std::string("Controller Information")
                                              : "Controller #" + writer.GetPropertyValue(controller, "ControllerNum", ",") +
                                                    " Configuration";
    const std::string join = layout.only1030 ? "" : " -- ";
    writer.WriteTableTitle(title, false, false);
    WritePropertyTable(writer, controller, "50%", "40%", title,
                       {Row("ControllerType"),
                        Row("Version", "BIOS Version", "ORVSG_LSIControllerBIOSElement", "ORVSG_LSIBIOSElement"),
                        Row("Version", "Firmware Version", "ORVSG_LSIControllerFirmwareElement",
                            "ORVSG_LSIFirmwareElement"),
                        Row("SCSIChannelDescription"), Row("InitiatorIDs")});

    // The status table exists while the controller reports an operation;
    // the progress rows only while one is running.
    const std::string operation = writer.GetPropertyValue(controller, "CurrentOperation", ",");
    if (!operation.empty()) {
        std::vector<std::string> rows;
        if (type == 3) rows.push_back("VolumeID");
        for (const char* name : {"CurrentOperation", "LogicalDriveInProgress", "VolumeStatus", "VolumeState"})
            rows.push_back(name);
        if (operation.find("None") == std::string::npos) {
            for (const char* name : {"LogicalDriveSize", "NumRemainingSectors", "PercentComplete"})
                rows.push_back(name);
        }
        writer.WriteTableTitle("Controller Status", false, false);
        WritePropertyTable(writer, controller, "50%", "40%", title + join + layout.statusCaption, Rows(rows));
    }

    const TInstances logical =
        Associated(controller, "ORVSG_LSIProtocolControllerForUnit", "ORVSG_LSILogicalDisk");
    if (!logical.empty()) {
        std::vector<std::string> rows;
        if (type == 3) rows.push_back("VolumeID");
        for (const char* name : {"VolumeNumber", "VolumeStatus", "RAIDLevel", "BlockSize", "PhysicalHardDisks"})
            rows.push_back(name);
        writer.WriteTableTitle(kLogicalTitle, false, false);
        for (const TWriter::TInstancePtr& drive : logical)
            WritePropertyTable(writer, drive, "50%", "40%", title + join + layout.logicalCaption, Rows(rows));
    }

    const TInstances disks =
        Associated(controller, "ORVSG_LSIProtocolControllerForPhysicalDisk", "ORVSG_LSIDiskDrive");
    std::vector<std::string> diskRows = {"EnclosureNum", "TargetID", "SlotID", "DeviceType"};
    if (layout.withFruRow) diskRows.push_back("ORVFruCru");
    for (const char* name : {"State", "MaxMediaSize", "InquiryData", "ModelNumber", "FirmwareRevision", "SerialNo",
                             "DriveType"})
        diskRows.push_back(name);
    if (!disks.empty()) writer.WriteTableTitle(kPhysicalTitle, false, false);
    std::string bus;
    bool first = true;
    for (const TWriter::TInstancePtr& disk : disks) {
        try {
            const unsigned deviceType =
                static_cast<unsigned>(disk->GetProperty("DeviceType", TCIMContext())->GetValue(TCIMContext()));
            if (deviceType != kHardDisk) {
                Trace(layout.name + " -- Filter instance which type is not hard disk");
                continue;
            }
        } catch (...) {
            Trace(layout.name + " -- Exception when getting DeviceType");
            continue;
        }
        const std::string diskBus = writer.GetPropertyValue(disk, "Bus", ",");
        if (first) {
            if (type == 0) writer.WriteTableTitle("Channel #: " + diskBus, false, false);
            bus = diskBus;
            first = false;
        }
        writer.StartPropertyTable("50%", "40%", title + join + layout.physicalCaption);
        // A disk on another channel than the one before says so at the top
        // of its table, where the collector gave its channel number.
        if (bus != diskBus && HasProperty(disk, "ChannelNum")) {
            writer.WriteTableTitle("Channel #: " + diskBus, false, false);
            bus = diskBus;
        }
        for (const TReportProperty& row : Rows(diskRows)) WritePropertyRow(writer, disk, row);
        writer.EndTable();
    }

    if (type != 3) return;
    TInstances enclosures;
    try {
        enclosures = InstancesOf(ns, "ORVSG_LSIEnclosureInformation");
    } catch (...) {
        Log(1, "WriteLSIReport: Counldn't find class ORVSG_LSIEnclosureInformation");
        return;
    }
    if (enclosures.empty()) return;
    writer.WriteTableTitle("Enclosure Information", false, false);
    for (const TWriter::TInstancePtr& enclosure : enclosures) {
        WritePropertyTable(writer, enclosure, "50%", "40%", title + " -- Enclosure Information",
                           Rows({"EnclosureNum", "LogicalID", "Numslots", "StartSlot", "StartTargetID", "StartBus"}));
    }
}

// The controllers of the integrated RAID class; throws what the repository
// throws.
TInstances IRControllers(const TWriter::TNamespacePtr& ns) { return InstancesOf(ns, kControllerClass); }

void WriteIRControllers(TWriter& writer, const TWriter::TNamespacePtr& ns, const TInstances& controllers,
                        const TIRLayout& layout) {
    for (const TWriter::TInstancePtr& controller : controllers) {
        if (layout.only1030 &&
            writer.GetPropertyValue(controller, "ControllerType", ",").find("1030") == std::string::npos)
            continue;
        try {
            WriteIRController(writer, ns, controller, layout);
        } catch (...) {
            writer.EndTable();
            Trace(layout.name + " -- Exception when processing controller");
        }
    }
}

}  // namespace

void TWriter::WriteLSIIntegratedRaidReport(bool& noCard) {
    const std::string name = "TWriter::WriteLSIIntegratedRaidReport";
    TInstances controllers;
    try {
        controllers = IRControllers(fNamespace);
    } catch (const TTKRException& ex) {
        Trace(name + " -- Exception when getting class " + kControllerClass);
        if (IsNotFound(ex)) Trace(name + " --no class of ORVSG_LSISCSIProtocolController found");
        noCard = true;
        return;
    } catch (...) {
        Trace(name + " -- Exception when getting class " + kControllerClass);
        noCard = true;
        return;
    }
    if (controllers.empty()) {
        Trace(name + " --no instance of ORVSG_LSISCSIProtocolController found");
        noCard = true;
        return;
    }
    noCard = false;
    WriteIRControllers(*this, fNamespace, controllers,
                       {false, name, true, true, "Controller Status", kLogicalTitle, kPhysicalTitle});
}

void TWriter::WriteLSIIntegratedRaid1030Report() {
    const std::string name = "TWriter::WriteLSIIntegratedRaid1030Report";
    Trace("Entering " + name);
    TInstances controllers;
    try {
        controllers = IRControllers(fNamespace);
    } catch (...) {
        Trace("Exiting " + name + ", caught exception while getting class instances");
        return;
    }
    if (controllers.empty()) {
        Trace("Exiting " + name + ", no class instances for ORVSG_LSISCSIProtocolController found");
        return;
    }
    WriteIRControllers(*this, fNamespace, controllers,
                       {true, name, false, false, "status", "logical drive information", "physical drive information"});
    Trace("Exiting " + name);
}

void TWriter::WriteMegaLSIReport(bool& noCard) {
    const std::string name = "TWriter::WriteMegaLSIReport";
    TInstances controllers;
    try {
        controllers = InstancesOf(fNamespace, kMegaControllerClass);
    } catch (...) {
        Trace(name + " -- Exception when getting class " + kMegaControllerClass);
        return;
    }
    if (controllers.empty()) return;
    noCard = false;
    TInstances packages;
    try {
        packages = InstancesOf(fNamespace, "ORVSG_MegaLSIFWPackageBuildFirmwareElement");
    } catch (...) {
        packages.clear();
    }
    for (const TInstancePtr& controller : controllers) {
        try {
            WriteTableTitle("Controller Information", false, false);
            StartPropertyTable("50%", "40%", "Controller Information");
            WritePropertyRow(*this, controller, Row("ControllerType"));
            WritePropertyRow(*this, controller,
                             Row("Version", "BIOS Version", "ORVSG_MegaLSIControllerBIOS", "ORVSG_MegaLSIBIOSElement"));
            WritePropertyRow(*this, controller,
                             Row("Version", "Firmware Version", "ORVSG_MegaLSIControllerFirmware",
                                 "ORVSG_MegaLSIFirmwareElement"));
            // The package element names its controller inside its id; the
            // test is a plain substring test, so controller 1 also matches
            // an id holding "11".
            std::string number = GetPropertyValue(controller, "ControllerNum", ",");
            try {
                number = std::to_string(std::stoi(number));
            } catch (...) {
            }
            for (const TInstancePtr& package : packages) {
                if (GetPropertyValue(package, "SoftwareElementID", ",").find(number) == std::string::npos) continue;
                WriteMixedRow(*this, controller, Row("Version", "FW Package Build version"), package, Row("Version"));
            }
            EndTable();
            for (const TInstancePtr& disk :
                 Associated(controller, "ORVSG_MegaLSIProtocolControllerForPhysicalDisk", "ORVSG_MegaLSIDiskDrive")) {
                WriteTableTitle("Physical device information", false, false);
                WritePropertyTable(*this, disk, "50%", "40%", "Physical device information",
                                   {Row("ModelNumber"), Row("ORVFruCru"), Row("DriveType"), Row("State"),
                                    Row("InquiryData", "Manufacturer"), Row("FirmwareRevision")});
            }
        } catch (...) {
            EndTable();
            Trace(name + " -- Exception when processing controller");
        }
    }
}

}  // namespace braigrion
