// The merged device page: every logical device of the machine in one table
// per device class. The pre-boot edition gets a short form and leaves out
// the network interface and system groups; the full form adds location,
// status and the kernel module that drives the device.
#include <algorithm>
#include <locale>
#include <map>
#include <sstream>

#include "MellanoxBlocks.h"
#include "braigrion/TInstanceSorter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "mergedDevices";
const char kStatusText[] = "Exiting TWriter::WriteMergedDevicesReport, ex.fStatusCode.fStatusCode=";
const char kStatusText2[] = "Exiting TWriter::WriteMergedDevicesReport(2), ex.fStatusCode.fStatusCode=";
const char kStatusText3[] = "Exiting TWriter::WriteMergedDevicesReport(3), ex.fStatusCode.fStatusCode=";
const char kStatusText4[] = "Exiting TWriter::WriteMergedDevicesReport(4), ex.fStatusCode.fStatusCode=";

// The failure line as it has always been written: the text from the
// character at the position of the status code on, nothing when the code
// lies outside the text.
std::string ShiftedStatusLine(const std::string& text, int statusCode) {
    if (statusCode < 0 || static_cast<size_t>(statusCode) > text.size()) return std::string();
    return text.substr(static_cast<size_t>(statusCode));
}

// The class, or null when the collection lacks it. Any other failure is
// logged and passed on with its status.
TWriter::TClassPtr DeviceClass(const TWriter::TNamespacePtr& ns, const std::string& name, const char* statusText) {
    try {
        return ns->GetClass(name, NORVTKR20::TCIMContext());
    } catch (const NORVTKR20::TTKRException& ex) {
        if (IsNotFound(ex)) return TWriter::TClassPtr();
        Trace(ShiftedStatusLine(statusText, ex.fStatusCode.fStatusCode));
        throw NORVTKR20::TTKRException(ex.fStatusCode);
    }
}

TInstances ShallowInstances(const TWriter::TClassPtr& cls) {
    TInstances instances;
    cls->EnumerateInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(instances), false,
                            NORVTKR20::TCIMContext());
    return instances;
}

// The group title of a device: its class with a capital first letter;
// "Unknown" is shown as "Uncategorized". False for a device whose class is
// null, which goes in no group.
bool GroupTitle(const TWriter::TInstancePtr& device, std::string& title) {
    NORVTKR20::TCIMValue value;
    try {
        value = device->GetProperty("DeviceClass", NORVTKR20::TCIMContext())->GetValue();
    } catch (const NORVTKR20::TTKRException& ex) {
        // A device without the property has no class either.
        if (IsNotFound(ex)) return false;
        throw;
    }
    if (value.IsNull()) return false;
    title = value.ToString(10);
    if (!title.empty()) title[0] = std::toupper(title[0], std::locale::classic());
    if (title == "Unknown") title = "Uncategorized";
    return true;
}

typedef std::multimap<std::string, TWriter::TInstancePtr> TGroups;

TGroups GroupByClass(const TInstances& devices) {
    TGroups groups;
    for (const TWriter::TInstancePtr& device : devices) {
        std::string title;
        if (GroupTitle(device, title)) groups.insert(std::make_pair(title, device));
    }
    return groups;
}

TInstanceSorter ByClassAndName() {
    TInstanceSorter sorter;
    sorter.AddProperty("DeviceClass", true, false);
    sorter.AddProperty("ElementName", true, false);
    return sorter;
}

std::vector<TReportProperty> Columns(bool preboot) {
    const std::string module = "ORVSG_LinuxKernelModule";
    const std::string software = "ORVSG_DeviceSoftware";
    if (preboot) {
        return {TReportProperty("ElementName", "25%", "", "", "", ""),
                TReportProperty("Manufacturer", "20%", "", "", "Vendor Info", "")};
    }
    return {TReportProperty("ElementName", "25%", "", "", "", ""),
            TReportProperty("Location", "20%", "", "", "", ""),
            TReportProperty("OperationalStatus", "5%", "", "", "", ""),
            TReportProperty("Name", "5%", software, module, "Module", ""),
            TReportProperty("SoftwareElementState", "5%", software, module, "State", ""),
            TReportProperty("Manufacturer", "20%", "", "", "Vendor Info", ""),
            TReportProperty("Version", "20%", software, module, "", "")};
}

}  // namespace

void TWriter::WriteMergedDevicesReport(TBuilderPtr /*builder*/, std::string reportName) {
    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    WriteReportTitle("Merged Devices", "", "");

    TClassPtr devices = DeviceClass(fNamespace, "ORVSG_LogicalDevice", kStatusText);
    // Where a device sits, by logical device: the board or the slot that
    // holds it. The identity walk below resolves the elements these would
    // be filled from; until a collector links them, both stay empty and the
    // device's own "Location" is shown.
    std::map<NORVTKR20::ICIMInstance*, TInstancePtr> boards;
    std::map<NORVTKR20::ICIMInstance*, TInstancePtr> slots;
    if (!fPreboot) {
        TClassPtr identities = DeviceClass(fNamespace, "ORVSG_DeviceIdentity", kStatusText2);
        TClassPtr bridges = DeviceClass(fNamespace, "ORVSG_PCIBridge", kStatusText3);
        TClassPtr pciDevices = DeviceClass(fNamespace, "ORVSG_PCIDevice", kStatusText4);
        if (identities && (bridges || pciDevices)) {
            for (const TInstancePtr& identity : ShallowInstances(identities)) {
                try {
                    NORVTKR20::TCIMContext context;
                    const NORVTKR20::TCIMReference system = identity->GetProperty("SystemElement", context)->GetValue();
                    const NORVTKR20::TCIMReference same = identity->GetProperty("SameElement", context)->GetValue();
                    fNamespace->GetInstance(system, context);
                    fNamespace->GetInstance(same, context);
                } catch (const NORVTKR20::TTKRException&) {
                    // An identity that cannot be followed places no device.
                }
            }
        }
    }

    bool wroteTable = false;
    if (devices) {
        TInstances sorted = ShallowInstances(devices);
        try {
            TWriterUtil::SortInstances(sorted, ByClassAndName(), true);
        } catch (const NORVTKR20::TTKRException& ex) {
            if (fPreboot) {
                Trace("Exiting TWriter::WriteMergedDevicesReport, sort failed");
            } else {
                Trace("Exiting TWriter::WriteMergedDevicesReport, sort failure");
                if (!IsNotFound(ex)) throw;
            }
        }
        const TGroups groups = GroupByClass(sorted);
        const std::vector<TReportProperty> columns = Columns(fPreboot);
        const TReportProperty slotColumn("SlotDesignation", "20%", "ORVSG_SystemBoard", "", "", "");
        const TReportProperty slotOfSlot("SlotDesignation", "20%", "ORVSG_SystemSlot", "", "", "");
        for (TGroups::const_iterator group = groups.begin(); group != groups.end();
             group = groups.upper_bound(group->first)) {
            const std::string& title = group->first;
            if (fPreboot && (title.find("Network interface") != std::string::npos ||
                             title.find("System") != std::string::npos))
                continue;
            WriteTableTitle(title, false, false);
            StartColumnTable("100%", title, false);
            StartRow(false);
            for (const TReportProperty& column : columns) WriteHeaderCell(devices, column);
            EndRow();
            EndTableHeader();
            for (TGroups::const_iterator row = group; row != groups.upper_bound(title); ++row) {
                const TInstancePtr& device = row->second;
                StartRow(true);
                for (const TReportProperty& column : columns) {
                    if (column.GetProperty() != "Location") {
                        WriteValueCell(device, column, "");
                    } else if (boards.count(device.get()) != 0) {
                        WriteValueCell(boards[device.get()], slotColumn, "");
                    } else if (slots.count(device.get()) != 0) {
                        WriteValueCell(slots[device.get()], slotOfSlot, "");
                    } else {
                        WriteValueCell(device, column, "");
                    }
                }
                EndRow();
            }
            EndTable();
            wroteTable = true;
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, reportName, wroteTable);
    Trace("Exiting TWriter::WriteMergedDevicesReport");
}

}  // namespace braigrion
