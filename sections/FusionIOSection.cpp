// The Fusion-io flash adapter page ("ORV High IOPS Adapter"): adapter,
// software, logical drive and temperature blocks of label and value rows,
// with the page of the vendor tool's raw output in front in LUZ mode.
#include <sstream>

#include "MellanoxBlocks.h"
#include "braigrion/MarkupConstants.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

const char kLinkName[] = "FusionIO";
const char kFunction[] = "TWriter::WriteFusionIOReport";

std::string StatusLine(const NORVTKR20::TTKRException& ex) {
    std::ostringstream line;
    line << "Exiting " << kFunction << ", ex.fStatusCode.fStatusCode=" << ex.fStatusCode.fStatusCode;
    return line.str();
}

// Each class in its own guard: a repository failure leaves it out.
TWriter::TClassPtr FusionClass(const TWriter::TNamespacePtr& ns, const std::string& name) {
    try {
        return ns->GetClass(name, NORVTKR20::TCIMContext());
    } catch (const NORVTKR20::TTKRException& ex) {
        Trace(StatusLine(ex));
    }
    return TWriter::TClassPtr();
}

TInstances FusionInstances(const TWriter::TClassPtr& cls) {
    try {
        return DeepInstances(cls);
    } catch (const NORVTKR20::TTKRException& ex) {
        Trace(StatusLine(ex));
    }
    return TInstances();
}

// The statistics of a logical drive: the statistics instance that names the
// drive's "DeviceID" in its own "DeviceID" or "Name"; failing that, the one
// at the drive's position when both classes hold as many instances; else none.
TWriter::TInstancePtr StatisticsOf(const TInstances& drives, size_t index, const TInstances& statistics) {
    const std::string device = ValueText(drives[index], "DeviceID");
    if (!device.empty()) {
        for (const TWriter::TInstancePtr& candidate : statistics) {
            if (ValueText(candidate, "DeviceID") == device || ValueText(candidate, "Name") == device) return candidate;
        }
    }
    if (drives.size() == statistics.size()) return statistics[index];
    return TWriter::TInstancePtr();
}

// Writes one block for one instance. A row whose property is of `other`
// (the statistics of a logical drive) reads `otherInstance` when there is one.
void WriteFusionBlock(TWriter& writer, const std::string& title, const TWriter::TClassPtr& cls,
                      const TWriter::TInstancePtr& instance, const std::vector<TReportProperty>& rows,
                      size_t firstOtherRow = 0, const TWriter::TClassPtr& other = TWriter::TClassPtr(),
                      const TWriter::TInstancePtr& otherInstance = TWriter::TInstancePtr()) {
    writer.WriteTableTitle(title, false, false);
    writer.StartPropertyTable("50%", "40%", title);
    for (size_t row = 0; row < rows.size(); ++row) {
        const bool fromOther = other && row >= firstOtherRow;
        writer.StartRow(true);
        writer.WriteHeaderCell(fromOther ? other : cls, rows[row]);
        writer.WriteValueCell(fromOther && otherInstance ? otherInstance : instance, rows[row], "");
        writer.EndRow();
    }
    writer.EndTable();
}

}  // namespace

void TWriter::WriteFusionIOReport(TBuilderPtr /*builder*/, std::string reportName) {
    // The trace lines of the raw-data step read the other way round from
    // what happened; support scripts look for them as they stand.
    std::string rawLink;
    if (sections::IsLuzMode(fMode, fWriterType)) {
        Trace("TWriter::WriteFIOReport -- Under LUZ mode, write FIO raw data first ");
        try {
            rawLink = WriteFIORawDataReport(kLinkName);
            if (!rawLink.empty()) {
                Trace("TWriter::WriteFIOReport -- WriteFIORawDataReport Failed");
            } else {
                Trace("TWriter::WriteFIOReport -- WriteFIORawDataReport Success");
            }
        } catch (...) {
            Trace("TWriter::WriteFIOReport -- Exception was thrown from WriteFIORawDataReport");
            rawLink.clear();
        }
    }

    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + kLinkName);
    WritePageHeader();
    if (rawLink.empty()) {
        WriteReportTitle("ORV High IOPS Adapter", "", "");
    } else {
        WriteReportTitle("ORV High IOPS Adapter", TKR_REPORT_DEFINITION::kTKRShowRawData, rawLink);
    }

    TClassPtr package = FusionClass(fNamespace, "FIO_PhysicalPackage");
    TClassPtr software = FusionClass(fNamespace, "FIO_SoftwareIdentity");
    TClassPtr statistics = FusionClass(fNamespace, "FIO_SSDStatistics");
    TClassPtr sensor = FusionClass(fNamespace, "FIO_TemperatureSensor");
    // The card's memory port: read with the others, shown in no block.
    TClassPtr port = FusionClass(fNamespace, "FIO_IoMemoryPort");
    TClassPtr drive = FusionClass(fNamespace, "FIO_LogicalSSD");

    const TInstances packages = FusionInstances(package);
    const TInstances softwares = FusionInstances(software);
    const TInstances statisticsInstances = FusionInstances(statistics);
    const TInstances sensors = FusionInstances(sensor);
    FusionInstances(port);
    const TInstances drives = FusionInstances(drive);
    const bool logicReport = !drives.empty();
    if (!logicReport) Trace("TWriter::WriteFusionIOReport set logicReport to false");

    bool hasData = false;
    if (!packages.empty()) Trace("PCIDevice_Class exists");
    const std::vector<TReportProperty> packageRows = {
        BlockColumn("Name"), BlockColumn("Manufacturer"), BlockColumn("Model"), BlockColumn("SKU"),
        BlockColumn("SerialNumber", "Serial Number"), BlockColumn("PartNumber", "Product Number"),
        BlockColumn("SparePartNumber", "Alt PN"), BlockColumn("PoweredOn", "Powered On"),
        BlockColumn("AssemblyNumber", "Assembly Number")};
    for (const TInstancePtr& instance : packages) {
        WriteFusionBlock(*this, "Adapter Information", package, instance, packageRows);
        hasData = true;
    }

    if (!softwares.empty()) Trace("SoftwareIdentity_Class exists");
    const std::vector<TReportProperty> softwareRows = {BlockColumn("Name"), BlockColumn("VersionString", "Version"),
                                                       BlockColumn("BuildNumber", "Build Number"),
                                                       BlockColumn("Manufacturer")};
    for (const TInstancePtr& instance : softwares) {
        WriteFusionBlock(*this, "Software Information", software, instance, softwareRows);
        hasData = true;
    }

    if (!statisticsInstances.empty()) Trace("SSDStatistics_Class exists");
    // The first seven rows describe the drive, the rest are its statistics.
    const size_t kFirstStatisticsRow = 7;
    const std::vector<TReportProperty> driveRows = {
        BlockColumn("DeviceID", "Name"),
        BlockColumn("Name", "Device Name"),
        BlockColumn("Availability"),
        BlockColumn("UUID"),
        BlockColumn("LocationIndicator", "Location Indicator"),
        BlockColumn("HealthLevel", "Health Status"),
        BlockColumn("FlashbackAvailability", "Flashback Availability"),
        BlockColumn("TotalDataMByteCapacity", "Total Data Capacity (MBytes)"),
        BlockColumn("UsableDataMByteCapacity", "Usable Data Capacity (MBytes)"),
        BlockColumn("TotalLogicalMByteCapacity", "Total Logical Capacity (MBytes)"),
        BlockColumn("PhysicalMBytesRead", "Physical Read (MBytes)"),
        BlockColumn("PhysicalMBytesWritten", "Physical Written (MBytes)"),
        BlockColumn("ReadOperations", "Read Operations"),
        BlockColumn("WriteOperations", "Write Operations"),
        BlockColumn("CurrentMByteRAMUsage", "Current RAM Usage (MBytes)"),
        BlockColumn("PeakMByteRAMUsage", "Peak RAM Usage (MBytes)")};
    if (logicReport) {
        for (size_t index = 0; index < drives.size(); ++index) {
            WriteFusionBlock(*this, "Logical Drive Information", drive, drives[index], driveRows, kFirstStatisticsRow,
                             statistics, StatisticsOf(drives, index, statisticsInstances));
            hasData = true;
        }
    }

    if (!sensors.empty()) Trace("TemperatureSensor_Class exists");
    const std::vector<TReportProperty> sensorRows = {
        BlockColumn("Name"), BlockColumn("CurrentState", "Current State"),
        BlockColumn("CurrentReading", "Current Reading (degC)"),
        BlockColumn("UpperThresholdCritical", "Upper Threshold Critical (degC)")};
    for (const TInstancePtr& instance : sensors) {
        WriteFusionBlock(*this, "Temperature Information", sensor, instance, sensorRows);
        hasData = true;
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLinkName, reportName, hasData);
}

}  // namespace braigrion
