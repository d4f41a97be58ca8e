// The two tables after the controllers on the page "LSI Controller": the
// wear and warranty figures of SSDs, and the PCIe flash adapters. Both are
// written whichever provider fed the page.
#include "StorageSupport.h"
#include "braigrion/TWriter.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TTKRException;

namespace {

struct TSSDTable {
    const char* function;
    const char* className;
    const char* title;
    std::vector<std::string> rows;
};

// One property table per instance under one title. A class the collection
// lacks, or one without instances, writes nothing and answers false.
bool WriteSSDTable(TWriter& writer, const TWriter::TNamespacePtr& ns, const TSSDTable& table) {
    Trace(std::string("Entering ") + table.function);
    TInstances instances;
    try {
        instances = InstancesOf(ns, table.className);
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) Trace(std::string(table.function) + " -- Exception when getting class " + table.className);
    } catch (...) {
        Trace(std::string(table.function) + " -- Exception when getting class " + table.className);
    }
    if (instances.empty()) {
        Trace(std::string("Exiting ") + table.function);
        return false;
    }
    writer.WriteTableTitle(table.title, false, false);
    for (const TWriter::TInstancePtr& instance : instances) {
        writer.StartPropertyTable("50%", "40%", table.title);
        for (const std::string& row : table.rows) WritePropertyRow(writer, instance, Row(row));
        writer.EndTable();
    }
    // The page's own footer follows; this one closes the block of tables.
    writer.WritePageFooter();
    Trace(std::string("Exiting ") + table.function);
    return true;
}

}  // namespace

bool TWriter::WriteSSDWarrantyInfoReport() {
    return WriteSSDTable(*this, fNamespace,
                         {"TWriter::WriteSSDWarrantyInfoReport",
                          "ORV_SSDWarrantyInfo",
                          "SSD Warranty Information",
                          {"SSDID", "SSDPercentOfCycleRe", "SSDPercentOfSpareRe", "SSDPercentOfLifeRe", "SSDPartNumber",
                           "SSDSerialNumber", "SSDFirmware"}});
}

bool TWriter::WriteLSIPCIeSSDReport() {
    return WriteSSDTable(*this, fNamespace,
                         {"TWriter::WriteLSIPCIeSSDReport",
                          "ORV_PCIeSSDWrapDriveInfo",
                          "LSI PCIe SLC/MLC Adapter Information",
                          {"Name",
                           "BackupRailMonitor",
                           "BoardAssemblyNumber",
                           "BoardName",
                           "BoardTracerNumber",
                           "ChipName",
                           "FirmwareVersion",
                           "LegacyBIOSVersion",
                           "OverallHealth",
                           "PackageVersion",
                           "PCIAddress",
                           "PCISlotNumber",
                           "PCISubSystemDeviceId",
                           "PCISubSystemVendorId",
                           "RAIDSupport",
                           "RequestedState",
                           "SASAddress",
                           "Temperature",
                           "UEFIBSDVersion",
                           "WarpDriveID",
                           "WarpDriveName",
                           "WarrantyRemaining"}});
}

}  // namespace braigrion
