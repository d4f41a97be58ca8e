// The page "Halcyon": per Halcyon RAID controller its configuration, its
// logical drives, the stripe order of its disk groups and its physical
// devices, each a property table in which a property the collector left
// without a value has no row. In LUZ mode the page links to the raw tool
// output and ends with the transfer rates of the disks.
#include "StorageSupport.h"
#include "braigrion/MarkupConstants.h"
#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

const char kName[] = "TWriter::WriteHalcyonReport";
const char kLink[] = "hc";
const char kTitle[] = "Halcyon";

// The rows of a table of the page, each left out where the instance holds
// no value for it. Rows reached through an association are always written.
void WriteNonNullRows(TWriter& writer, const TWriter::TInstancePtr& instance, const std::vector<TReportProperty>& rows) {
    for (const TReportProperty& row : rows) {
        if (!row.HasAssociationClass() && TWriterUtil::IsPropertyNull(instance, row.GetProperty())) continue;
        WritePropertyRow(writer, instance, row);
    }
}

std::vector<TReportProperty> ControllerRows() {
    std::vector<TReportProperty> rows = Rows({"ControllerType", "ControllerStatus", "ChannelDescription", "SerialNum",
                                              "ControllerSlotInfo", "InstalledMemory", "PartNum"});
    rows.push_back(Row("Version", "BIOS Version", "ORVSG_hcBiosOnController", "ORVSG_hcBiosVersion"));
    rows.push_back(Row("Version", "Firmware Version", "ORVSG_hcFirmwareOnController", "ORVSG_hcFirmwareVersion"));
    rows.push_back(Row("Version", "Boot Block Version", "ORVSG_hcBootBlockOnController", "ORVSG_hcBootBlockVersion"));
    for (const TReportProperty& row :
         Rows({"DeviceDriverVersion", "ClusterSolutionVersion", "ControllerName", "CopyBackEnabled",
               "ScsiChannelDescr", "InitiatorChannelScsiId", "MaxPhysicalDevices", "DefunctDiskDriveCnt",
               "LogicalDriveStatusCnt", "ReadAhead", "StripeUnitSize", "RebuildRate", "HotSwapRebuild",
               "DataScrubbing", "HotSpareCopyBack", "PartOfCluster", "UnattendedMode", "ConcurrentCommandsSupported",
               "ConfigurationUpdateCount", "Current_MostRecentOperation", "Logical_Drive",
               "BackgroundOperationActive", "LastCmdStatus", "LogicalDriveSizeInStripes", "NumberOfRemainingStripes",
               "VPD", "ECVersion", "ControllerFRU", "ControllerTemp", "ControllerBatteryStatus",
               "ControllerBatteryOverTemp", "ControllerBatteryCapacity", "ControllerBatteryFRU",
               "BatteryTimeRemaining"}))
        rows.push_back(row);
    return rows;
}

// The bad stripes of a logical drive, a text such as "3 stripes": a row
// only when the count before the last blank is neither "0" nor missing.
void WriteBadStripeRow(TWriter& writer, const TWriter::TInstancePtr& drive) {
    const TReportProperty row = Row("NumBadStripes", "", "ORVSG_ElementBadStripeData", "ORVSG_BadStripeData");
    std::string text = writer.GetValuesFromProperties(
        TWriterUtil::GetProperties(drive, "NumBadStripes", "ORVSG_ElementBadStripeData", "ORVSG_BadStripeData"),
        writer.GetSeparatorText(row.GetArrayValueSeparator()), false);
    const size_t blank = text.rfind(' ');
    if (blank != std::string::npos) text = text.substr(0, blank);
    if (text == "0" || text.empty()) return;
    WritePropertyRow(writer, drive, row);
}

void WriteLogicalDrives(TWriter& writer, const TInstances& drives, const std::string& title) {
    if (drives.empty()) return;
    writer.WriteTableTitle("Logical Drive Information", false, false);
    const std::vector<TReportProperty> rows =
        Rows({"ControllerNum", "LogicalDriveNum", "LogicalDriveName", "RaidLevel", "LogicalDriveStatus", "Size",
              "ReadCacheStatus", "WriteCacheStatus", "WriteCacheSetting", "Partitioned", "NumOfSegments",
              "StripeUnitSize", "DriveList", "StripeOrder", "DefunctSegments"});
    for (const TWriter::TInstancePtr& drive : drives) {
        writer.StartPropertyTable("60%", "40%", title + " logical drive information");
        WriteNonNullRows(writer, drive, rows);
        WriteBadStripeRow(writer, drive);
        writer.EndTable();
    }
}

// Controllers numbered above 6 show each disk group by the logical drive it
// holds (the drive at the same position), older ones by their array.
void WriteStripeOrder(TWriter& writer, const TWriter::TInstancePtr& controller, const TInstances& drives,
                      const std::string& title) {
    const TInstances groups = Associated(controller, "ORVSG_hcStripeOrderForController", "ORVSG_hcDiskGroup");
    std::string type = writer.GetPropertyValue(controller, "ControllerType", ",");
    const bool byDrive = TWriterUtil::GetNumberInString(type) > 6;
    if (groups.empty()) return;
    writer.WriteTableTitle("Stripe Order", false, false);
    for (size_t i = 0; i < groups.size(); ++i) {
        const TWriter::TInstancePtr& group = groups[i];
        if (byDrive && i < drives.size()) {
            try {
                const std::string name = writer.GetPropertyValue(drives[i], "LogicalDriveName", ",") + " " +
                                         writer.GetPropertyValue(drives[i], "LogicalDriveNum", ",");
                group->AddProperty("LogicalDrive", TCIMValue(name), TCIMContext());
            } catch (const TTKRException&) {
            }
        }
        writer.StartPropertyTable("60%", "25%", title + " stripe order");
        std::vector<TReportProperty> rows;
        for (const char* name : {"Array", "LogicalDrive", "ControllerNum", "StripeOrder"}) {
            if (std::string(name) == (byDrive ? "Array" : "LogicalDrive")) continue;
            rows.push_back(Row(name));
        }
        WriteNonNullRows(writer, group, rows);
        writer.EndTable();
    }
}

void WritePhysicalDevices(TWriter& writer, const TWriter::TInstancePtr& controller, const std::string& title) {
    const TInstances devices =
        Associated(controller, "ORVSG_hcProtocolControllerForPhysicalDisk", "ORVSG_hcDiskDrive");
    if (devices.empty()) return;
    writer.WriteTableTitle("Physical Device Information", false, false);
    const std::vector<TReportProperty> rows =
        Rows({"ControllerNum", "DeviceNumber", "DeviceType", "Channel", "ScsiId", "DeviceCode", "State", "Supported",
              "TransferSpeed", "ReportedChannel", "ReportedLocation", "ReportedESD", "EnclosureId", "Type", "Vendor",
              "Model", "Firmware", "DeviceSerialNum", "WorldWideName", "Size", "WriteCache", "FRU", "PFA",
              "Enclosure"});
    for (const TWriter::TInstancePtr& device : devices) {
        writer.StartPropertyTable("60%", "40%", title + " physical drive information");
        WriteNonNullRows(writer, device, rows);
        writer.EndTable();
    }
}

void WriteController(TWriter& writer, const TWriter::TInstancePtr& controller) {
    const std::string title = "Controller " + writer.GetPropertyValue(controller, "ControllerNum", ",");
    writer.WriteTableTitle(title, false, false);
    writer.StartPropertyTable("60%", "40%", title);
    WriteNonNullRows(writer, controller, ControllerRows());
    writer.EndTable();
    const TInstances drives = Associated(controller, "ORVSG_hcProtocolControllerForUnit", "ORVSG_hcLogicalDisk");
    WriteLogicalDrives(writer, drives, title);
    WriteStripeOrder(writer, controller, drives, title);
    WritePhysicalDevices(writer, controller, title);
}

}  // namespace

void TWriter::WriteHalcyonReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(std::string(kName) + " -- Entering");
    TInstances controllers;
    try {
        controllers = InstancesOf(fNamespace, "ORVSG_hcSCSIProtocolController");
        ClassNamed(fNamespace, "ORVSG_hcLogicalDisk");
        ClassNamed(fNamespace, "ORVSG_hcDiskGroup");
    } catch (...) {
        controllers.clear();
    }
    if (controllers.empty()) {
        WriteIndexEntry(kLink, kTitle, false);
        Trace(std::string(kName) + " -- Exiting");
        return;
    }

    std::string rawPage;
    if (fMode == "luz" && fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML) {
        Trace(std::string(kName) + " -- Under LUZ mode, write halcyon raw data first ");
        rawPage = RawDataLink([&] { return WriteHalcyonRawDataReport(kLink); },
                              {"TWriter::WriteHalcyonRReport -- Exception was thrown from WriteHalcyonRawDataReport",
                               "TWriter::WriteHalcyonRReport -- WriteHalcyonRawDataReport Failed",
                               "TWriter::WriteHalcyonRReport -- WriteHalcyonRawDataReport Success"});
    }
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLink);
    WritePageHeader();
    if (!rawPage.empty()) {
        WriteReportTitle(kTitle, TKR_REPORT_DEFINITION::kTKRShowRawData, rawPage);
    } else {
        WriteReportTitle(kTitle, "", "");
    }
    WriteTableBreak();

    for (const TInstancePtr& controller : controllers) {
        try {
            WriteController(*this, controller);
        } catch (...) {
            EndTable();
            Trace(std::string(kName) + " -- Exception when processing controller");
        }
    }

    if (fMode == "luz") {
        TReportClass rates;
        rates.SetClass("ORVSG_hcSCSISubStatData");
        rates.SetTitle("Operating Data Rate of Disk");
        rates.SetTableWidth("75%");
        std::vector<TReportProperty> columns;
        for (const char* name : {"ControllerNum", "Channel", "ScsiId", "Params", "Req_Off"})
            columns.push_back(TReportProperty(name, "14%", "", "", "", ""));
        for (const char* name : {"Max_Txer_P", "Cur_Txer_P"})
            columns.push_back(TReportProperty(name, "15%", "", "", "", ""));
        rates.SetProperties(columns);
        try {
            const TInstances instances = InstancesOf(fNamespace, rates.GetClass());
            if (!instances.empty()) WriteTable(rates, instances, true, false, TContext());
        } catch (const TTKRException& ex) {
            if (!IsNotFound(ex)) {
                Trace(std::string(kName) +
                      " -- Exception when getting class [ORVSG_hcSCSISubStatData] under LUZ mode");
            }
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, true);
    Trace(std::string(kName) + " -- Exiting");
}

}  // namespace braigrion
