// The page "LSI Controller" through the Cardinal provider (LSI's own CIM
// classes, LSIESG_*), the choice between it and the legacy provider, and the
// probes that tell the controller kinds apart.
//
// Each controller chip gets a "Controller Information" table; each
// controller system, after its first chip, the tables of its logical drives
// (volumes with their member extents) and of its physical drives. A table
// that fails is logged and the page goes on.
#include <exception>

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

const char kName[] = "TWriter::WriteLSIReportWithCardinal";
const char kIRName[] = "TWriter::WriteLSIIntegratedRaidReport";
const char kLink[] = "lsi_mir";
const char kTitle[] = "LSI Controller";
const char kNoCard[] = "No LSI RAID card detected\n";
const char kControllerInformation[] = "Controller Information";
const char kMegaRAIDClass[] = "LSIESG_MegaRAIDHBA";

std::string Said(const std::string& name, const std::string& line) { return name + " -- " + line; }

// The classes of one group are fetched in order; the first that fails ends
// the group with its line. Returns whether all were there.
bool FetchGroup(const TWriter::TNamespacePtr& ns, const std::vector<std::string>& classes, const std::string& group) {
    try {
        for (const std::string& name : classes) ClassNamed(ns, name);
        return true;
    } catch (...) {
        Trace(Said(kName, "One or more " + group + " classes are missing "));
        return false;
    }
}

// The text of a property, "" when it cannot be read.
std::string TextOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        const TCIMValue& value = instance->GetProperty(property, TCIMContext())->GetValue(TCIMContext());
        return value.IsNull() ? std::string() : value.ToString(10);
    } catch (...) {
        return std::string();
    }
}

// The board of a PCIe flash adapter whose name the package's part number
// holds; "" when none does. The last board that matches wins.
std::string BoardNameFor(const TWriter::TNamespacePtr& ns, const TWriter::TInstancePtr& package) {
    const std::string partNumber = TextOf(package, "PartNumber");
    std::string board;
    TInstances adapters;
    try {
        adapters = InstancesOf(ns, "ORV_PCIeSSDWrapDriveInfo");
    } catch (...) {
        return board;
    }
    for (const TWriter::TInstancePtr& adapter : adapters) {
        const std::string name = TextOf(adapter, "BoardName");
        if (!name.empty() && partNumber.find(name) != std::string::npos) board = name;
    }
    return board;
}

// The product that an integrated chip is sold as, when the provider names one.
TWriter::TInstancePtr ProductOf(const TWriter::TInstancePtr& package, const std::string& productClass) {
    TInstances products = Associated(package, "LSIESG_ProductPhysicalComponent", productClass);
    return products.empty() ? TWriter::TInstancePtr() : products.front();
}

// The "Model" row: the product's name where the chip is sold under one,
// the package's own model otherwise, no value for another kind of package.
void WriteModelRow(TWriter& writer, const TWriter::TNamespacePtr& ns, const TWriter::TInstancePtr& package) {
    const std::string packageClass = ClassNameOf(package);
    const TReportProperty model = Row("Model");
    writer.StartRow(true);
    writer.WriteHeaderCell(ClassOf(package), model);
    TWriter::TInstancePtr product;
    if (packageClass.find("LSIESG_IntegratedRaidChip") != std::string::npos) {
        const std::string text = TextOf(package, "Model");
        if (text.find("SAS2004") != std::string::npos) {
            product = ProductOf(package, "LSIESG_IntegratedRaidProduct");
        } else if (text == "UNKNOWN") {
            // The provider could not name a flash adapter's chip; its board
            // name is kept in the repository so later pages show it too.
            const std::string board = BoardNameFor(ns, package);
            if (!board.empty()) package->AddProperty("Model", TCIMValue(board), TCIMContext());
        }
        if (product) {
            writer.WriteValueCell(product, Row("Name"), "");
        } else {
            writer.WriteValueCell(package, model, "");
        }
    } else if (packageClass.find("LSIESG_InitiatorTargetChip") != std::string::npos) {
        product = ProductOf(package, "LSIESG_InitiatorTargetProduct");
        if (product) {
            writer.WriteValueCell(product, Row("Name"), "");
        } else {
            writer.WriteValueCell(package, model, "");
        }
    }
    writer.EndRow();
}

void WriteControllerTable(TWriter& writer, const TWriter::TNamespacePtr& ns, const TWriter::TInstancePtr& system,
                          const TWriter::TInstancePtr& package) {
    writer.WriteTableTitle(kControllerInformation, false, false);
    writer.StartPropertyTable("50%", "40%", kControllerInformation);
    WriteModelRow(writer, ns, package);
    WritePropertyRow(writer, system, Row("ElementName"));
    WritePropertyRow(writer, system,
                     Row("VersionString", "BIOS Version", "LSIESG_ElementSoftwareIdentity",
                         "LSIESG_ControllerBIOSIdentity"));
    WritePropertyRow(writer, system,
                     Row("VersionString", "Firmware Version", "LSIESG_ElementSoftwareIdentity",
                         "LSIESG_ControllerFirmwareIdentity", "N/A"));
    try {
        if (ClassNameOf(system) == kMegaRAIDClass) {
            Trace(Said(kName, "Current card is an MR controller, write Package Build vesrion "));
            WritePropertyRow(writer, system,
                             Row("VersionString", "FW Package Build version", "LSIESG_ElementSoftwareIdentity",
                                 "LSIESG_FirmwarePackageIdentity", "N/A"));
        } else {
            Trace(Said(kName, "Current card is an IR controller, no Package Build vesrion "));
        }
    } catch (...) {
        Trace(Said(kName, "Exception when processing MR Package Build vesrion"));
    }
    writer.EndTable();
}

// The instances of `resultClass` reached through `assocClass`, ordered by
// name; a failure is traced with `what` and gives none.
TInstances SortedByName(const TWriter::TInstancePtr& from, const std::string& assocClass,
                        const std::string& resultClass, const std::string& what) {
    TInstances found;
    try {
        found = Associated(from, assocClass, resultClass);
    } catch (...) {
        Trace(Said(kName, "Exception when EnumerateAssociatedInstances to " + what));
        return TInstances();
    }
    SortByProperty(found, "Name", true);
    return found;
}

void WriteLogicalDriveTable(TWriter& writer, const TWriter::TInstancePtr& system) {
    const TInstances volumes =
        SortedByName(system, "LSIESG_SystemDevice", "LSIESG_StorageVolume", "contVolInstances");
    if (volumes.empty()) return;
    const std::string title = "Logical drive information";
    writer.WriteTableTitle(title, false, false);
    writer.StartPropertyTable("50%", "40%", std::string(kControllerInformation) + " -- " + title);
    for (const TWriter::TInstancePtr& volume : volumes) {
        WriteMixedRow(writer, volume, Row("VolumeName"), volume, Row("Name"));
        WritePropertyRow(writer, volume, Row("OperationalStatus"));
        WritePropertyRow(writer, volume,
                         Row("ElementName", "RAIDLevel", "LSIESG_ElementSettingData", "LSIESG_StorageVolumeSetting"));
        const TInstances extents =
            SortedByName(volume, "LSIESG_ConcreteDependency", "LSIESG_DiskExtent", "contVolDiskInstances");
        for (const TWriter::TInstancePtr& extent : extents) {
            writer.WriteRowBreak(1);
            WriteMixedRow(writer, extent, Row("DriveName"), extent,
                          Row("Name", "Name", "LSIESG_MediaPresent", "LSIESG_DiskDrive"));
            WritePropertyRow(writer, extent, Row("OperationalStatus"));
        }
    }
    writer.EndTable();
}

// The legacy collector's drives, read once for a drive table and only when
// a drive needs them.
class TLegacyDrives {
public:
    explicit TLegacyDrives(const TWriter::TNamespacePtr& ns) : fNamespace(ns), fRead(false) {}
    // The drive at `position`; none beyond the list or without the class.
    TWriter::TInstancePtr At(size_t position) {
        if (!fRead) {
            fRead = true;
            try {
                fDrives = InstancesOf(fNamespace, "ORVSG_MegaLSIDiskDrive");
            } catch (...) {
                fDrives.clear();
            }
        }
        return position < fDrives.size() ? fDrives[position] : TWriter::TInstancePtr();
    }

private:
    TWriter::TNamespacePtr fNamespace;
    bool fRead;
    TInstances fDrives;
};

// The FRU number and manufacturer rows of a drive: from the physical drive
// the provider published, else from the legacy provider's drive at the same
// position, else the association cell, which stays empty.
void WriteDriveOrigin(TWriter& writer, TLegacyDrives& legacyDrives, const TWriter::TInstancePtr& drive,
                      size_t position, bool manufacturer) {
    const TReportProperty label =
        manufacturer ? Row("Manufacturer", "Manufacturer") : Row("FRUNumber", "FRU Number");
    TReportProperty value = manufacturer
                                ? Row("Manufacturer", "Manufacturer", "LSIESG_Realizes", "LSIESG_PhysicalDrive")
                                : Row("FRUNumber", "FRU Number", "LSIESG_Realizes", "LSIESG_PhysicalDrive");
    TInstances physical;
    try {
        physical = Associated(drive, "LSIESG_Realizes", "LSIESG_PhysicalDrive");
    } catch (...) {
        physical.clear();
    }
    if (!physical.empty()) {
        if (manufacturer && !TextOf(physical.front(), "Vendor").empty()) value.SetProperty("Vendor");
        WriteMixedRow(writer, drive, label, drive, value);
        return;
    }
    // A drive beyond the legacy list has no counterpart there.
    const TWriter::TInstancePtr legacy = legacyDrives.At(position);
    if (legacy) {
        WriteMixedRow(writer, drive, label, legacy, Row(manufacturer ? "InquiryData" : "ORVFruCru"));
    } else {
        WriteMixedRow(writer, drive, label, drive, value);
    }
}

void WritePhysicalDriveTable(TWriter& writer, const TWriter::TNamespacePtr& ns, const TWriter::TInstancePtr& system) {
    const TInstances drives = SortedByName(system, "LSIESG_SystemDevice", "LSIESG_DiskDrive", "contDriveInstances");
    if (drives.empty()) return;
    const std::string title = "Physical drive information";
    writer.WriteTableTitle(title, false, false);
    writer.StartPropertyTable("50%", "40%", std::string(kControllerInformation) + " -- " + title);
    TLegacyDrives legacyDrives(ns);
    for (size_t i = 0; i < drives.size(); ++i) {
        const TWriter::TInstancePtr& drive = drives[i];
        if (i > 0) writer.WriteRowBreak(1);
        WritePropertyRow(writer, drive, Row("Name"));
        WritePropertyRow(writer, drive, Row("ElementName"));
        WritePropertyRow(writer, drive, Row("OperationalStatus"));
        WriteDriveOrigin(writer, legacyDrives, drive, i, false);
        WriteMixedRow(writer, drive, Row("BlockSize"), drive,
                      Row("BlockSize", "", "LSIESG_MediaPresent", "LSIESG_DiskExtent"));
        WriteMixedRow(writer, drive, Row("NumberOfBlocks"), drive,
                      Row("NumberOfBlocks", "", "LSIESG_MediaPresent", "LSIESG_DiskExtent"));
        WriteDriveOrigin(writer, legacyDrives, drive, i, true);
        WritePropertyRow(writer, drive,
                         Row("VersionString", "Firmware version", "LSIESG_ElementSoftwareIdentity",
                             "LSIESG_DriveFirmwareIdentity"));
    }
    writer.EndTable();
}

}  // namespace

void TWriter::WriteLSIReport(TBuilderPtr builder, std::string pageID) {
    if (isCardinalSupport()) {
        Trace("TWriter::WriteLSIReport -- Cardinal support is ok, invoke WriteLSIReportWithCardinal");
        WriteLSIReportWithCardinal(builder, pageID);
    } else {
        Trace("TWriter::WriteLSIReport -- Cardinal support is NOT ok, invoke WriteLSIReportWithLegacyProvider ");
        WriteLSIReportWithLegacyProvider(builder, pageID);
    }
}

bool TWriter::isCardinalSupport() {
    const std::vector<std::string> required = {"CIM_ComputerSystem",       "CIM_PhysicalPackage",
                                               "LSIESG_DiskDrive",         "LSIESG_StorageVolume",
                                               "LSIESG_DiskExtent",        "ORV_LSIRawData",
                                               "LSIESG_ControllerFirmwareIdentity", "LSIESG_ControllerBIOSIdentity"};
    const std::vector<std::string> populated = {"LSIESG_DiskDrive",
                                                "LSIESG_StorageVolume",
                                                "LSIESG_DiskExtent",
                                                "LSIESG_ControllerFirmwareIdentity",
                                                "LSIESG_ControllerBIOSIdentity",
                                                "ORV_LSIRawData"};
    try {
        for (const std::string& name : required) ClassNamed(fNamespace, name);
        for (const std::string& name : populated) {
            if (!InstancesOf(fNamespace, name).empty()) return true;
        }
        return false;
    } catch (const TTKRException& ex) {
        if (IsNotFound(ex)) {
            Trace("Exiting TWriter::WriteLSIIntegratedRaidReport, ex.fStatusCode.fStatusCode=" +
                  std::to_string(ex.fStatusCode.fStatusCode));
        }
        return false;
    } catch (...) {
        return false;
    }
}

bool TWriter::isLSIIntegratedRaid1030Exsited() {
    try {
        for (const TInstancePtr& controller : InstancesOf(fNamespace, "ORVSG_LSISCSIProtocolController")) {
            if (GetPropertyValue(controller, "ControllerType", ",").find("1030") != std::string::npos) return true;
        }
    } catch (...) {
    }
    return false;
}

void TWriter::WriteLSIReportWithCardinal(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(std::string("Entering ") + kName);
    bool noCard = true;
    bool rawLink = false;
    std::string rawPage;
    if (isLSIRawDataPresent() && fMode == "luz" && fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML) {
        Trace(Said(kName, "Under LUZ mode, write LSI raw data first "));
        rawPage = RawDataLink(
            [&] {
                std::string link = kLink;
                return WriteLSIRawDataReport(link);
            },
            {Said(kName, "Exception was thrown from WriteLSIRawDataReport"), Said(kName, "WriteLSIRawDataReport Failed"),
             Said(kName, "WriteLSIRawDataReport Success")});
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

    const bool major = FetchGroup(fNamespace, {"CIM_ComputerSystem", "CIM_PhysicalPackage"}, "major");
    FetchGroup(fNamespace,
               {"LSIESG_ControllerBIOSIdentity", "LSIESG_ControllerFirmwareIdentity", "LSIESG_FirmwarePackageIdentity"},
               "firmware");
    FetchGroup(fNamespace, {"LSIESG_StorageVolume", "LSIESG_StorageVolumeSetting"}, "volume");
    FetchGroup(fNamespace,
               {"LSIESG_DiskDrive", "LSIESG_DiskExtent", "LSIESG_PhysicalDrive", "LSIESG_DriveFirmwareIdentity"},
               "disk");

    if (isLSIIntegratedRaid1030Exsited()) {
        Trace(Said(kName, "LSI 1030 card detected, invoke  WriteLSIIntegratedRaid1030Report"));
        WriteLSIIntegratedRaid1030Report();
        noCard = false;
    }

    if (!major) {
        noCard = true;
        Trace(Said(kIRName, "No major class found"));
    } else {
        try {
            const TInstances systems = InstancesOf(fNamespace, "CIM_ComputerSystem");
            if (systems.empty()) {
                noCard = true;
                Trace(Said(kIRName, "No instances of class CIM_ComputerSystem"));
            } else {
                Trace(Said(kName, "Write LSI information tables "));
            }
            for (const TInstancePtr& system : systems) {
                TInstances packages;
                try {
                    packages = Associated(system, "LSIESG_SystemPackaging", "CIM_PhysicalPackage");
                } catch (...) {
                    Trace(Said(kName, "Exception when getting raidControllerInstances"));
                }
                // The drives belong to the system, not to one of its chips:
                // a system of two chips lists them once, after the first.
                bool drivesWritten = false;
                for (const TInstancePtr& package : packages) {
                    try {
                        if (ClassNameOf(package).find("LSIESG_EnclosureChassis") != std::string::npos) continue;
                        noCard = false;
                        WriteControllerTable(*this, fNamespace, system, package);
                        if (drivesWritten) continue;
                        drivesWritten = true;
                        WriteLogicalDriveTable(*this, system);
                        WritePhysicalDriveTable(*this, fNamespace, system);
                    } catch (...) {
                        // A table left open by the failure is closed so that
                        // the next controller starts its own.
                        EndTable();
                        Trace(Said(kIRName, "Exception when process "));
                    }
                }
            }
        } catch (...) {
            Trace(Said(kIRName, "Exception when process generic data"));
        }
    }

    if (noCard && !rawLink) WriteNothingFound(*this, kNoCard, "");
    const bool warranty = WriteSSDWarrantyInfoReport();
    const bool pcieSSD = WriteLSIPCIeSSDReport();
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, (!noCard || rawLink || warranty) ? true : pcieSSD);
    Trace(std::string("Exiting ") + kName);
}

}  // namespace braigrion
