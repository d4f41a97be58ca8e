// The Brocade adapter page: for each port controller its own table, its
// Fibre Channel ports and its Ethernet ports, reached through the vendor's
// associations; then the adapter's boot code and firmware versions.
#include <set>
#include <sstream>

#include "MellanoxBlocks.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "brocade";
const char kFunction[] = "TWriter::WriteBrocadeReport";

TReportProperty BrocadeColumn(const std::string& property, const std::string& width, const std::string& label = "") {
    return TReportProperty(property, width, "", "", label, "");
}

const std::vector<TReportProperty>& ControllerColumns() {
    static const std::vector<TReportProperty> columns = {
        BrocadeColumn("DeviceID", "20%", "Device ID"), BrocadeColumn("Description", "20%"),
        BrocadeColumn("Manufacturer", "10%"),          BrocadeColumn("Model", "20%"),
        BrocadeColumn("SerialNumber", "20%", "Serial Number"),
        BrocadeColumn("TotalPhysicalPort", "10%", "Total Physical Port")};
    return columns;
}

const std::vector<TReportProperty>& FCPortColumns() {
    static const std::vector<TReportProperty> columns = {
        BrocadeColumn("PortNumber", "5%", "Port Number"),
        BrocadeColumn("WWNN", "5%"),
        BrocadeColumn("WWPN", "5%"),
        BrocadeColumn("LinkTechnology", "5%", "Link Technology"),
        BrocadeColumn("OperationalStatus", "10%", "Operational Status"),
        BrocadeColumn("Caption", "10%"),
        BrocadeColumn("MaxSpeed", "10%", "Max Speed"),
        BrocadeColumn("Speed", "10%"),
        BrocadeColumn("EnabledState", "10%", "Enabled State"),
        BrocadeColumn("PortAvailability", "10%", "Port Availability"),
        BrocadeColumn("RequestedState", "10%", "Requested State"),
        BrocadeColumn("TransitioningToState", "10%", "Transitioning To State")};
    return columns;
}

// The port's identity and state as on the Fibre Channel table, then its
// addresses.
const std::vector<TReportProperty>& EthernetPortColumns() {
    static const std::vector<TReportProperty> columns = {
        BrocadeColumn("PortNumber", "5%", "Port Number"),
        BrocadeColumn("DeviceID", "10%", "Device ID"),
        BrocadeColumn("LinkTechnology", "5%", "Link Technology"),
        BrocadeColumn("OperationalStatus", "10%", "Operational Status"),
        BrocadeColumn("Speed", "10%"),
        BrocadeColumn("EnabledState", "10%", "Enabled State"),
        BrocadeColumn("PermanentAddress", "20%", "Permanent Mac Address"),
        BrocadeColumn("NetworkAddresses", "20%", "Network Mac Address"),
        BrocadeColumn("RequestedState", "10%", "Requested State")};
    return columns;
}

const std::vector<TReportProperty>& SoftwareColumns() {
    static const std::vector<TReportProperty> columns = {BrocadeColumn("Description", "50%"),
                                                         BrocadeColumn("VersionString", "50%", "Version String")};
    return columns;
}

// The instances reached through an association; an association or class
// that the collection lacks reaches none.
TInstances Associated(const TWriter::TInstancePtr& instance, const std::string& assocClass,
                      const std::string& resultClass) {
    TInstances found;
    try {
        instance->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(found),
                                               assocClass, resultClass, "", "", NORVTKR20::TCIMContext());
    } catch (const NORVTKR20::TTKRException&) {
        found.clear();
    }
    return found;
}

// The node and port names of a port, collected as one text "WWNN:WWPN".
// Without a colon the whole text is the node name.
std::pair<std::string, std::string> WorldWideNames(const TWriter::TInstancePtr& port) {
    const std::string text = ValueText(port, "ElementName");
    const std::string::size_type colon = text.find(':');
    if (colon == std::string::npos) return std::make_pair(text, std::string());
    return std::make_pair(text.substr(0, colon), text.substr(colon + 1));
}

}  // namespace

// A column table: its title and header row, then one row per instance
// written by `writeRow`. Returns whether the table was written.
template <typename TWriteRow>
static bool WriteBrocadeTable(TWriter& writer, const std::string& title, const TWriter::TClassPtr& cls,
                              const std::vector<TReportProperty>& columns, const TInstances& rows,
                              TWriteRow writeRow) {
    try {
        writer.WriteTableTitle(title, false, false);
        writer.StartColumnTable("100%", title, true);
        writer.StartRow(false);
        for (const TReportProperty& column : columns) writer.WriteHeaderCell(cls, column);
        writer.EndRow();
        writer.EndTableHeader();
    } catch (...) {
        Trace("Exception when writting table label");
        return false;
    }
    for (const TWriter::TInstancePtr& row : rows) {
        writer.StartRow(true);
        writeRow(row);
        writer.EndRow();
    }
    writer.EndTable();
    return true;
}

void TWriter::WriteBrocadeReport(TBuilderPtr /*builder*/, std::string reportName) {
    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle("Brocade Adapter", "", "");

    auto fetch = [this](const std::string& name) -> TClassPtr {
        try {
            return fNamespace->GetClass(name, NORVTKR20::TCIMContext());
        } catch (const NORVTKR20::TTKRException& ex) {
            std::ostringstream line;
            line << "Exiting " << kFunction << ", ex.fStatusCode.fStatusCode=" << ex.fStatusCode.fStatusCode;
            Trace(line.str());
        }
        return TClassPtr();
    };
    TClassPtr controller = fetch("BROCADE_PortController");
    fetch("BROCADE_ProfileSoftwareIdentity");
    TClassPtr fcPort = fetch("BROCADE_FCPort");
    TClassPtr ethernetPort = fetch("BROCADE_EthernetPort");
    TClassPtr software = fetch("BROCADE_AdapterSoftwareIdentity");
    TClassPtr package = fetch("Brocade_PhysicalPackage");

    const TInstances controllers = DeepInstances(controller);
    const TInstances packages = DeepInstances(package);
    bool stop = false;
    if (controllers.empty() && packages.empty()) {
        Trace(std::string("Exiting ") + kFunction + ", No Class Instances Found ******");
        stop = true;
    } else if (!controller && !fcPort) {
        Trace(std::string("Exiting ") + kFunction + ". There is no Port Controller or FCPort.");
        stop = true;
    }

    bool hasData = false;
    if (!stop) {
        for (const TInstancePtr& each : controllers) {
            const TInstances fcPorts = Associated(each, "BROCADE_ControlledBy", "BROCADE_FCPort");
            hasData |= WriteBrocadeTable(*this, "Port Controller", controller, ControllerColumns(), {each},
                                         [&](const TInstancePtr& row) {
                                             const std::vector<TReportProperty>& columns = ControllerColumns();
                                             for (size_t c = 0; c + 1 < columns.size(); ++c)
                                                 WriteValueCell(row, columns[c], "");
                                             WriteTextCell(columns.back(), std::to_string(fcPorts.size()), "");
                                         });
            if (fcPort) hasData |= WriteBrocadeTable(*this, "FC Port", fcPort, FCPortColumns(), fcPorts,
                                         [&](const TInstancePtr& row) {
                                             const std::vector<TReportProperty>& columns = FCPortColumns();
                                             const std::pair<std::string, std::string> names = WorldWideNames(row);
                                             WriteValueCell(row, columns[0], "");
                                             WriteTextCell(columns[1], EscapeText(names.first), "");
                                             WriteTextCell(columns[2], EscapeText(names.second), "");
                                             for (size_t c = 3; c < columns.size(); ++c)
                                                 WriteValueCell(row, columns[c], "");
                                         });
            if (ethernetPort) {
                const TInstances ports =
                    Associated(each, "BROCADE_EthernetPortControlledBy", "BROCADE_EthernetPort");
                hasData |= WriteBrocadeTable(*this, "Ethernet Port", ethernetPort, EthernetPortColumns(), ports,
                                             [&](const TInstancePtr& row) {
                                                 for (const TReportProperty& column : EthernetPortColumns())
                                                     WriteValueCell(row, column, "");
                                             });
            }
        }

        // The versions may hang on a controller or on the card; each is
        // shown once.
        if (software) {
            TInstances versions;
            std::set<std::string> seen;
            TInstances holders = controllers;
            holders.insert(holders.end(), packages.begin(), packages.end());
            for (const TInstancePtr& holder : holders) {
                for (const TInstancePtr& version :
                     Associated(holder, "BROCADE_AdapterElementSoftwareIdentity", "BROCADE_AdapterSoftwareIdentity")) {
                    if (seen.insert(version->GetPath(NORVTKR20::TCIMContext()).GetPath()).second)
                        versions.push_back(version);
                }
            }
            hasData |= WriteBrocadeTable(*this, "Adapter BIOS/FW Version", software, SoftwareColumns(), versions,
                                         [&](const TInstancePtr& row) {
                                             for (const TReportProperty& column : SoftwareColumns())
                                                 WriteValueCell(row, column, "");
                                         });
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, reportName, hasData);
}

}  // namespace braigrion
