// The "Firmware/VPD" page: every firmware, BIOS and vital product data
// source of the server on one page. The firmware elements of the repository
// fill the "Firmware" and "BIOS/uEFI" tables; the vendor providers that
// publish their firmware in classes of their own (Brocade, Emulex, the LSI
// Cardinal provider, Mellanox, Fusion-io, PMC) are merged into those two
// tables row by row, which is why the page is written by hand.
#include <algorithm>
#include <stdexcept>
#include <string>
#include <vector>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

typedef std::vector<TWriter::TInstancePtr> TInstances;
typedef std::vector<TReportProperty> TColumns;

const char kSection[] = "TWriter::WriteCustomFirmwareReport";
// The vendor steps log with two blanks before the dashes.
const char kVendor[] = "TWriter::WriteCustomFirmwareReport  -- ";

bool Contains(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

TReportProperty Col(const std::string& property, const std::string& width, const std::string& assoc = "",
                    const std::string& target = "", const std::string& label = "") {
    return TReportProperty(property, width, assoc, target, label, "");
}

TInstances InstancesOf(const boost::shared_ptr<ICIMClass>& cls) {
    TInstances instances;
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, TCIMContext());
    return instances;
}

TInstances Associated(const TWriter::TInstancePtr& instance, const std::string& assoc, const std::string& result) {
    TInstances found;
    instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(found), assoc, result, "", "",
                                           TCIMContext());
    return found;
}

std::string ClassNameOf(const TWriter::TInstancePtr& instance) {
    TCIMContext context;
    return instance->GetClass(context)->GetClassName(context);
}

// The text of a property; throws when the instance lacks it.
std::string TextOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    TCIMContext context;
    return instance->GetProperty(property, context)->GetValue(context).ToString(10);
}

// The property of every instance reached through the association, joined by
// `separator`; "" when the association cannot be walked.
std::string ValueThroughAssociation(TWriter& writer, const TWriter::TInstancePtr& instance,
                                    const std::string& property, const std::string& assoc,
                                    const std::string& result, const std::string& separator) {
    try {
        std::string text;
        const TInstances found = Associated(instance, assoc, result);
        for (TInstances::size_type i = 0; i < found.size(); ++i) {
            if (i > 0) text += separator;
            text += writer.GetPropertyValue(found[i], property, " ");
        }
        return text;
    } catch (const std::exception& ex) {
        Trace(std::string(ex.what()) + "Error navigation association: ");
    }
    return std::string();
}

// The LSI controllers that the Cardinal provider reports. Any failure counts as no.
bool CardinalProviderPresent(const TWriter::TNamespacePtr& ns) {
    const char* const required[] = {"CIM_ComputerSystem",     "CIM_PhysicalPackage",
                                    "LSIESG_DiskDrive",       "LSIESG_StorageVolume",
                                    "LSIESG_DiskExtent",      "ORV_LSIRawData",
                                    "LSIESG_ControllerFirmwareIdentity", "LSIESG_ControllerBIOSIdentity"};
    const char* const populated[] = {"LSIESG_DiskDrive",  "LSIESG_StorageVolume",
                                     "LSIESG_DiskExtent", "LSIESG_ControllerFirmwareIdentity",
                                     "LSIESG_ControllerBIOSIdentity", "ORV_LSIRawData"};
    try {
        TCIMContext context;
        for (const char* name : required) ns->GetClass(name, context);
        for (const char* name : populated) {
            if (!InstancesOf(ns->GetClass(name, context)).empty()) return true;
        }
    } catch (...) {
    }
    return false;
}

// Under the Cardinal provider a legacy LSI element is kept only for an LSI
// 1030 controller: every other LSI controller is listed again from the
// provider's own classes. `bios` chooses the BIOS element's association
// and log texts.
bool KeepLegacyLSIRow(TWriter& writer, const TWriter::TInstancePtr& instance, bool bios) {
    const std::string kind = bios ? "BIOS" : "Firmware";
    try {
        const std::string cn = ClassNameOf(instance);
        if (!Contains(cn, "LSI") || !Contains(cn, kind)) return true;
        std::string type;
        if (!bios && Contains(cn, "ORVSG_LSIDiskFirmwareElement")) {
            for (const TWriter::TInstancePtr& drive :
                 Associated(instance, "ORVSG_LSIDiskFirmware", "ORVSG_LSIDiskDrive")) {
                type = ValueThroughAssociation(writer, drive, "ControllerType",
                                               "ORVSG_LSIProtocolControllerForPhysicalDisk",
                                               "ORVSG_LSISCSIProtocolController", " ");
            }
        } else {
            type = ValueThroughAssociation(
                writer, instance, "ControllerType",
                bios ? "ORVSG_LSIControllerBIOSElement" : "ORVSG_LSIControllerFirmwareElement",
                "ORVSG_LSISCSIProtocolController", " ");
        }
        if (Contains(type, "1030")) {
            Trace(std::string(kVendor) + "Do not skip current LSI " + kind +
                  " instance with controller type = " + type);
            return true;
        }
        Trace(std::string(kVendor) + "Skip current LSI IR/MR " + kind + " instsance with controller type = " + type);
        return false;
    } catch (...) {
        Trace(std::string(kVendor) + "Exception when determine whether to ship current " + (bios ? "BIOS " : "") +
              "instance");
    }
    return true;
}

// The instances of a class, or none when the class is absent or empty.
TInstances TableInstances(const TWriter::TNamespacePtr& ns, const std::string& className,
                          boost::shared_ptr<ICIMClass>& cls, const std::string& failureLog) {
    try {
        cls = ns->GetClass(className, TCIMContext());
    } catch (const TTKRException&) {
        if (!failureLog.empty()) Trace(failureLog);
        return TInstances();
    }
    return InstancesOf(cls);
}

// A vendor class of the merged rows, or null when it is absent. The
// Mellanox and Fusion-io steps say so in the log when the class is not found.
boost::shared_ptr<ICIMClass> VendorClass(const TWriter::TNamespacePtr& ns, const std::string& className,
                                         bool logNotFound) {
    try {
        return ns->GetClass(className, TCIMContext());
    } catch (const TTKRException& ex) {
        if (logNotFound && IsNotFound(ex)) Trace(std::string(kVendor) + "Get Class error=" + ex.what());
    }
    return boost::shared_ptr<ICIMClass>();
}

// One run of the page: the writer, what was read first, and whether a table
// was started.
class TFirmwarePage {
public:
    TFirmwarePage(TWriter& writer, const TWriter::TNamespacePtr& ns, bool multiNode, bool cardinal)
        : w(writer), fNamespace(ns), fMultiNode(multiNode), fCardinal(cardinal), fHasData(false) {}

    bool HasData() const { return fHasData; }

    void WriteFirmwareTable();
    void WriteBIOSTable();
    // One of the VPD tables: opened only when its class has instances.
    // `sorted` orders the rows by name first.
    void WriteVPDTable(const std::string& title, const std::string& className, const TColumns& columns,
                       bool sorted);

private:
    // Title and header row of a column table of the whole page width.
    void StartTable(const std::string& title, const TColumns& columns);
    void ValueRow(const TWriter::TInstancePtr& instance, const TColumns& columns);
    void Blank(const std::string& width) { w.WriteTextCell(Col("", width), "", ""); }
    void Text(const std::string& text, const std::string& width) { w.WriteTextCell(Col("", width), text, ""); }
    void Value(const TWriter::TInstancePtr& instance, const TReportProperty& column) {
        w.WriteValueCell(instance, column, "");
    }

    // Brocade software identities: the BIOS ones for the BIOS table, the
    // others for the firmware table.
    void BrocadeRows(bool bios);
    void EmulexRows();
    void CardinalFirmwareRows();
    void CardinalBIOSRows();
    // Mellanox and Fusion-io publish standard software identities; Fusion-io's
    // count only when their element name says firmware.
    void IdentityRows(const std::string& className, const std::string& nameFilter);
    void PMCRows(bool bios);
    // "PMC(<InstanceID>)", or "PMC" when the id cannot be read.
    std::string PMCName(const TWriter::TInstancePtr& instance);

    TWriter& w;
    TWriter::TNamespacePtr fNamespace;
    const bool fMultiNode;
    const bool fCardinal;
    bool fHasData;
    TInstanceSorter fSorter;  // one for the page: the last table adds to the first one's keys
    boost::shared_ptr<ICIMClass> fClass;
};

void TFirmwarePage::StartTable(const std::string& title, const TColumns& columns) {
    fHasData = true;
    w.WriteTableTitle(title, false, false);
    w.StartColumnTable("100%", title, true);
    w.StartRow(false);
    for (const TReportProperty& column : columns) w.WriteHeaderCell(fClass, column);
    w.EndRow();
    w.EndTableHeader();
}

void TFirmwarePage::ValueRow(const TWriter::TInstancePtr& instance, const TColumns& columns) {
    w.StartRow(true);
    for (const TReportProperty& column : columns) Value(instance, column);
    w.EndRow();
}

void TFirmwarePage::WriteFirmwareTable() {
    fSorter.Reset();
    TInstances instances = TableInstances(fNamespace, "ORVSG_FirmwareElement", fClass,
                                          std::string(kSection) +
                                              " -- Exception when getting class ORVSG_FirmwareElement");
    // Without a firmware element there is no table, and no vendor rows either.
    if (instances.empty()) return;
    const TColumns columns = {
        Col("Name", "15%"),
        Col("Manufacturer", "15%"),
        Col("ProductID", "15%", "ORVSG_DeviceFirmware", "ORVSG_SysBusDevice"),
        Col("OtherIdentifyingInfo", "20%", "ORVSG_DeviceFirmware", "CIM_LogicalDevice", "Device"),
        Col("Version", "10%"),
        Col("BuildNumber", "10%"),
        Col("BuildDate", "15%")};
    StartTable("Firmware", columns);
    fSorter.AddProperty("Name", true, false);
    TWriterUtil::SortInstances(instances, fSorter, true);
    for (const TWriter::TInstancePtr& instance : instances) {
        if (fCardinal && !KeepLegacyLSIRow(w, instance, false)) continue;
        ValueRow(instance, columns);
    }
    BrocadeRows(false);
    EmulexRows();
    if (fCardinal) CardinalFirmwareRows();
    IdentityRows("MLNX_FirmwareIdentity", "");
    IdentityRows("FIO_SoftwareIdentity", "Firmware");
    PMCRows(false);
    w.EndTable();
}

void TFirmwarePage::WriteBIOSTable() {
    TInstances instances = TableInstances(fNamespace, "CIM_BIOSElement", fClass, "");
    if (instances.empty()) return;
    TColumns columns = {Col("Name", "20%")};
    if (fMultiNode) columns.push_back(Col("SourceNode", "20%"));
    columns.push_back(Col("BuildNumber", "20%"));
    columns.push_back(Col("Version", "20%"));
    columns.push_back(Col("ReleaseDate", "20%"));
    StartTable("BIOS/uEFI", columns);
    for (const TWriter::TInstancePtr& instance : instances) {
        // The converged adapter's BIOS is listed on the adapter's own page.
        if (ClassNameOf(instance) == "EMXCNA_BIOSVersion") continue;
        if (fCardinal && !KeepLegacyLSIRow(w, instance, true)) continue;
        ValueRow(instance, columns);
    }
    BrocadeRows(true);
    if (fCardinal) CardinalBIOSRows();
    PMCRows(true);
    w.EndTable();
}

void TFirmwarePage::WriteVPDTable(const std::string& title, const std::string& className, const TColumns& columns,
                                  bool sorted) {
    TInstances instances = TableInstances(fNamespace, className, fClass, "");
    if (instances.empty()) return;
    StartTable(title, columns);
    if (sorted) {
        fSorter.AddProperty("Name", true, false);
        try {
            TWriterUtil::SortInstances(instances, fSorter, true);
        } catch (const std::exception& ex) {
            Trace(std::string(ex.what()) + "Error sorting: ");
        }
    }
    for (const TWriter::TInstancePtr& instance : instances) ValueRow(instance, columns);
    w.EndTable();
}

void TFirmwarePage::BrocadeRows(bool bios) {
    boost::shared_ptr<ICIMClass> ports = VendorClass(fNamespace, "BROCADE_PortController", false);
    if (!ports) return;
    for (const TWriter::TInstancePtr& port : InstancesOf(ports)) {
        for (const TWriter::TInstancePtr& identity :
             Associated(port, "BROCADE_AdapterElementSoftwareIdentity", "BROCADE_AdapterSoftwareIdentity")) {
            std::string description;
            try {
                description = TextOf(identity, "Description");
            } catch (const TTKRException&) {
            }
            if (Contains(description, "BIOS") != bios) continue;
            w.StartRow(true);
            if (bios) {
                Value(identity, Col("Description", "20%", "", "", "Name"));
                if (fMultiNode) Blank("20%");
                Value(identity, Col("BuildNumber", "20%"));
                Value(identity, Col("VersionString", "20%", "", "", "Version"));
                Value(identity, Col("ReleaseDate", "20%"));
            } else {
                Value(identity, Col("Description", "15%"));
                Value(identity, Col("Manufacturer", "15%"));
                Blank("15%");
                Blank("20%");
                Value(identity, Col("VersionString", "10%"));
                Blank("10%");
                Blank("15%");
            }
            w.EndRow();
        }
    }
}

void TFirmwarePage::EmulexRows() {
    boost::shared_ptr<ICIMClass> versions = VendorClass(fNamespace, "EMXCNA_FirmwareVersion", false);
    if (!versions) return;
    for (const TWriter::TInstancePtr& version : InstancesOf(versions)) {
        w.StartRow(true);
        Value(version, Col("Name", "15%"));
        Text("Emulex", "15%");
        Blank("15%");
        Blank("20%");
        Value(version, Col("Version", "10%"));
        Blank("10%");
        Blank("15%");
        w.EndRow();
    }
}

void TFirmwarePage::IdentityRows(const std::string& className, const std::string& nameFilter) {
    const bool mellanox = nameFilter.empty();
    if (mellanox) Trace(std::string(kVendor) + "Start write Mellanox firmware in Firmware/VPD");
    boost::shared_ptr<ICIMClass> identities = VendorClass(fNamespace, className, true);
    if (identities) {
        for (const TWriter::TInstancePtr& identity : InstancesOf(identities)) {
            if (!mellanox) {
                std::string element;
                try {
                    element = TextOf(identity, "ElementName");
                } catch (const TTKRException&) {
                }
                if (!Contains(element, nameFilter)) continue;
            }
            w.StartRow(true);
            Value(identity, Col("Name", "0%"));
            Value(identity, Col("Manufacturer", "0%"));
            Blank("15%");
            Value(identity, Col("InstanceID", "0%"));
            Value(identity, Col("VersionString", "0%"));
            Value(identity, Col("BuildNumber", "0%"));
            Value(identity, Col("ReleaseDate", "0%"));
            w.EndRow();
        }
    }
    Trace(std::string(kVendor) + "Write Mellanox firmware in Firmware/VPD end");
}

std::string TFirmwarePage::PMCName(const TWriter::TInstancePtr& instance) {
    std::string name = "PMC";
    try {
        name += "(" + TextOf(instance, "InstanceID") + ")";
    } catch (...) {
    }
    return name;
}

void TFirmwarePage::PMCRows(bool bios) {
    boost::shared_ptr<ICIMClass> identities =
        VendorClass(fNamespace, bios ? "PMC_BiosSoftwareIdentity" : "PMC_FirmwareSoftwareIdentity", false);
    if (!identities) return;
    try {
        for (const TWriter::TInstancePtr& identity : InstancesOf(identities)) {
            w.StartRow(true);
            if (bios) {
                // Four cells, whether or not the node column is there.
                Text(PMCName(identity), "20%");
                Blank("20%");
                Value(identity, Col("VersionString", "20%"));
                Blank("20%");
            } else {
                // Eight cells against seven headers, as the rows always were.
                Text(PMCName(identity), "15%");
                Blank("15%");
                Blank("15%");
                Blank("20%");
                Value(identity, Col("VersionString", "10%"));
                Blank("10%");
                Blank("10%");
                Blank("15%");
            }
            w.EndRow();
        }
    } catch (...) {
        // The PMC rows end here; the table is still closed by the caller.
    }
}

void TFirmwarePage::CardinalFirmwareRows() {
    Trace(std::string(kVendor) + "Start to process LSI IR/MR controller firmware in Firmware/VPD");
    boost::shared_ptr<ICIMClass> systems;
    boost::shared_ptr<ICIMClass> packages;
    try {
        systems = fNamespace->GetClass("CIM_ComputerSystem", TCIMContext());
        packages = fNamespace->GetClass("CIM_PhysicalPackage", TCIMContext());
    } catch (...) {
        Trace(std::string(kVendor) + "Exception When Find Class CIM_ComputerSystem & CIM_PhysicalPackage ");
    }
    if (systems && packages) {
        for (const TWriter::TInstancePtr& system : InstancesOf(systems)) {
            try {
                TInstances found;
                try {
                    found = Associated(system, "LSIESG_SystemPackaging", "CIM_PhysicalPackage");
                } catch (...) {
                    Trace(std::string(kVendor) +
                          "Enumerate Associated Instances Exception for CIM_PhysicalPackage");
                }
                const std::string systemClass = ClassNameOf(system);
                if (found.empty()) {
                    Trace(std::string(kVendor) + "No Associated Instances of " + systemClass);
                    continue;
                }
                const bool isMR = Contains(systemClass, "LSIESG_MegaRAIDHBA");
                for (const TWriter::TInstancePtr& package : found) {
                    if (Contains(ClassNameOf(package), "LSIESG_EnclosureChassis")) {
                        Trace(std::string(kVendor) + "Skip Current Raid Controller Instances -- " +
                              w.GetPropertyValue(package, "Name", " "));
                        continue;
                    }
                    std::string model = TextOf(package, "Model");
                    if (!model.empty() && model == "UNKNOWN") {
                        // The board's own name, when the part number holds one we know.
                        const std::string partNumber = TextOf(package, "PartNumber");
                        try {
                            boost::shared_ptr<ICIMClass> boards =
                                fNamespace->GetClass("ORV_PCIeSSDWrapDriveInfo", TCIMContext());
                            for (const TWriter::TInstancePtr& board : InstancesOf(boards)) {
                                const std::string boardName = TextOf(board, "BoardName");
                                if (Contains(partNumber, boardName)) model = boardName;
                            }
                        } catch (...) {
                        }
                    }
                    std::string firmwareName;
                    std::string deviceName;
                    if (!model.empty()) {
                        firmwareName = isMR ? model + " Firmware" : "LSI " + model + " Controller Firmware";
                        deviceName = isMR ? model + " Physical Device" : "LSI " + model + " Controller Physical Device";
                    }
                    auto controllerRow = [&](const std::string& name, const std::string& target) {
                        w.StartRow(true);
                        Text(name, "15%");
                        Value(system, Col("Manufacturer", "15%", "LSIESG_ElementSoftwareIdentity", target));
                        Blank("15%");
                        Value(system, Col("ElementName", "20%"));
                        Value(system, Col("VersionString", "10%", "LSIESG_ElementSoftwareIdentity", target));
                        Value(system, Col("BuildNumber", "10%", "LSIESG_ElementSoftwareIdentity", target));
                        Blank("15%");
                        w.EndRow();
                    };
                    controllerRow(firmwareName, "LSIESG_ControllerFirmwareIdentity");
                    if (isMR) {
                        Trace(std::string(kVendor) +
                              "Current Controller Is MR Type, Process Build Pakage Infomation");
                        try {
                            boost::shared_ptr<ICIMClass> builds =
                                fNamespace->GetClass("LSIESG_FirmwarePackageIdentity", TCIMContext());
                            if (!InstancesOf(builds).empty()) {
                                controllerRow(firmwareName + " Package Build", "LSIESG_FirmwarePackageIdentity");
                            } else {
                                Trace(std::string(kVendor) +
                                      "Cannot Retrieve Current MR Controller Package Build Information");
                            }
                        } catch (const std::exception& ex) {
                            Trace(std::string(kVendor) +
                                  "Exception When Find Class LSIESG_FirmwarePackageIdentity -- " + ex.what());
                        } catch (...) {
                            Trace(std::string(kVendor) +
                                  "Unkown Exception When Find Class LSIESG_FirmwarePackageIdentity ");
                        }
                    } else {
                        Trace(std::string(kVendor) + "Current Controller Is IR Type, No Build Pakage Infomation");
                    }
                    const TInstances drives = Associated(system, "LSIESG_SystemDevice", "LSIESG_DiskDrive");
                    if (drives.empty()) {
                        Trace(std::string(kVendor) + "Current Controller Is Not Connected To Disk Dirve");
                    }
                    for (const TWriter::TInstancePtr& drive : drives) {
                        w.StartRow(true);
                        Text(deviceName, "15%");
                        Value(drive, Col("Manufacturer", "15%", "LSIESG_ElementSoftwareIdentity",
                                         "LSIESG_DriveFirmwareIdentity"));
                        Blank("15%");
                        Value(drive, Col("Name", "20%"));
                        Value(drive, Col("VersionString", "10%", "LSIESG_ElementSoftwareIdentity",
                                         "LSIESG_DriveFirmwareIdentity"));
                        Value(drive, Col("BuildNumber", "10%", "LSIESG_ElementSoftwareIdentity",
                                         "LSIESG_DriveFirmwareIdentity"));
                        Blank("15%");
                        w.EndRow();
                    }
                }
            } catch (...) {
                Trace(std::string(kVendor) + "Exception when processing current controller");
            }
        }
    }
    Trace(std::string(kVendor) + "End of processing LSI IR/MR controller firmware in Firmware/VPD");
}

void TFirmwarePage::CardinalBIOSRows() {
    const std::string prefix = std::string(kSection) + " -- ";
    Trace(prefix + "Start to process LSI IR/MR controller bios in BOIS/uEFI");
    boost::shared_ptr<ICIMClass> systems;
    boost::shared_ptr<ICIMClass> packages;
    try {
        systems = fNamespace->GetClass("CIM_ComputerSystem", TCIMContext());
        packages = fNamespace->GetClass("CIM_PhysicalPackage", TCIMContext());
    } catch (...) {
        Trace(prefix + "Find Class CIM_ComputerSystem | CIM_PhysicalPackage ");
    }
    if (systems && packages) {
        for (const TWriter::TInstancePtr& system : InstancesOf(systems)) {
            try {
                TInstances found;
                try {
                    found = Associated(system, "LSIESG_SystemPackaging", "CIM_PhysicalPackage");
                } catch (...) {
                    Trace(prefix + "Enumerate Associated Instances Exception for CIM_PhysicalPackage");
                }
                const std::string systemClass = ClassNameOf(system);
                if (found.empty()) {
                    Trace(prefix + "No Associated Instances of " + systemClass);
                    continue;
                }
                const bool isMR = Contains(systemClass, "LSIESG_MegaRAIDHBA");
                for (const TWriter::TInstancePtr& package : found) {
                    if (Contains(ClassNameOf(package), "LSIESG_EnclosureChassis")) {
                        Trace(prefix + "Skip Current Raid Controller Instances -- " +
                              w.GetPropertyValue(package, "Name", " "));
                        continue;
                    }
                    // The row is open before the model is read: a model that
                    // cannot be read leaves it unfinished.
                    w.StartRow(true);
                    const std::string model = TextOf(package, "Model");
                    std::string name;
                    if (!model.empty()) name = isMR ? model + " BIOS" : "LSI " + model + " Controller BIOS";
                    Text(name, "20%");
                    if (fMultiNode) Blank("20%");
                    for (const char* property : {"BuildNumber", "VersionString", "ReleaseDate"}) {
                        Value(system, Col(property, "20%", "LSIESG_ElementSoftwareIdentity",
                                          "LSIESG_ControllerBIOSIdentity"));
                    }
                    w.EndRow();
                }
            } catch (...) {
                Trace(prefix + "Exception when processing current controller");
            }
        }
    }
    Trace(prefix + "End of processing LSI IR/MR controller bios in BIOS/uEFI");
}

}  // namespace

void TWriter::WriteCustomFirmwareReport(TBuilderPtr builder, std::string /*pageID*/) {
    Trace(std::string(kSection) + " -- Entering");
    const bool multiNode = builder->IsMultiNode();
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + "firmware");
    WritePageHeader();
    WriteReportTitle("Firmware/VPD", "", "");

    bool cardinal = false;
    try {
        cardinal = CardinalProviderPresent(fNamespace);
    } catch (...) {
        Trace(std::string(kSection) +
              " -- Exception when determining if cardinal provider is supported for LSI information");
    }

    TFirmwarePage page(*this, fNamespace, multiNode, cardinal);
    page.WriteFirmwareTable();
    page.WriteBIOSTable();
    page.WriteVPDTable("Post BIOS VPD", "ORVSG_PostBIOSVPD",
                       {Col("BuildNumber", "15%"), Col("BuildDate", "20%"), Col("Version", "20%"),
                        Col("Filename", "15%"), Col("UniqueID", "25%")},
                       false);
    if (multiNode) {
        page.WriteVPDTable("Diagnostic VPD", "ORVSG_DiagnosticVPD",
                           {Col("BuildNumber", "50%"), Col("SourceNode", "50%")}, false);
    } else {
        page.WriteVPDTable("Diagnostic VPD", "ORVSG_DiagnosticVPD", {Col("BuildNumber", "100%")}, false);
    }
    page.WriteVPDTable("SP Firmware Main VPD", "ORVSG_SPROMFirmwareVPDMain",
                       {Col("Name", "20%"), Col("BuildNumber", "20%"), Col("BuildDate", "20%"),
                        Col("Version", "20%"), Col("Filename", "20%")},
                       false);
    page.WriteVPDTable("SP Firmware BootROM VPD", "ORVSG_SPROMFirmwareVPDBootROM",
                       {Col("BuildNumber", "25%"), Col("BuildDate", "25%"), Col("Version", "25%"),
                        Col("Filename", "25%")},
                       false);
    page.WriteVPDTable("SP Hardware Revision", "ORVSG_HardwareRevisionLevel", {Col("Hardwarelevel", "100%")},
                       false);
    page.WriteVPDTable("Other VPD", "ORVSG_FRU",
                       {Col("Name", "20%"), Col("Vendor", "20%"), Col("FRUNumber", "20%"),
                        Col("PartNumber", "20%"), Col("SerialNumber", "20%")},
                       true);

    WritePageFooter();
    ClosePage();
    WriteIndexEntry("firmware", "Firmware/VPD", page.HasData());
    Trace(std::string(kSection) + " -- Exiting");
}

}  // namespace braigrion
