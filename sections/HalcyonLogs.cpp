// The page "Halcyon Logs": the events of the RAID manager application, the
// defunct drive log and the device event table, column tables written by
// the table engine; in LUZ mode also the controller's hard and soft event
// logs, which the back-end writes as it sees fit.
#include "StorageSupport.h"
#include "braigrion/MarkupConstants.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace storage;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

namespace {

const char kName[] = "TWriter::WriteHalcyonLogsReport";
const char kLink[] = "halcyonlogs";
const char kTitle[] = "Halcyon Logs";
const char kNotInstalled[] = "RAID Manager is not installed.";

TReportClass Table(const std::string& className, const std::string& title,
                   const std::vector<std::pair<const char*, const char*>>& columns) {
    TReportClass table;
    table.SetClass(className);
    table.SetTitle(title);
    std::vector<TReportProperty> properties;
    for (const auto& column : columns) properties.push_back(TReportProperty(column.first, column.second, "", "", "", ""));
    table.SetProperties(properties);
    return table;
}

// The instances of a table's class. A class the collection lacks is traced
// under the table's number and gives none; any other failure ends the page.
TInstances LogInstances(const TWriter::TNamespacePtr& ns, const std::string& className, int number) {
    try {
        return InstancesOf(ns, className);
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw TTKRException(ex.fStatusCode.fStatusCode);
        Trace(std::string("Exiting ") + kName + "(" + std::to_string(number) +
              "), ex.fStatusCode.fStatusCode=" + std::to_string(ex.fStatusCode.fStatusCode));
        return TInstances();
    }
}

}  // namespace

void TWriter::WriteHalcyonLogsReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace(std::string(kName) + " -- Entering");
    try {
        ClassNamed(fNamespace, "ORVSG_LogRecord_RAIDMgrEvent");
    } catch (...) {
        Trace(std::string(kName) + " -- Exception when getting class ORVSG_LogRecord_RAIDMgrEvent");
        WriteIndexEntry(kLink, kTitle, false);
        return;
    }
    const bool luz = fMode == "luz";
    std::string rawPage;
    if (luz) {
        Trace(std::string(kName) + " -- Under LUZ mode, write halcyon Manager raw data first");
        rawPage = RawDataLink([&] { return WriteHalcyonManagerRawDataReport(kLink); },
                              {std::string(kName) + " -- Exception was thrown from WriteHalcyonManagerRawDataReport",
                               std::string(kName) + " -- WriteHalcyonManagerRawDataReport Failed",
                               std::string(kName) + " -- WriteHalcyonManagerRawDataReport Success"});
    }
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kLink);
    WriteSortScript();
    WritePageHeader();
    if (!rawPage.empty()) {
        WriteReportTitle(kTitle, TKR_REPORT_DEFINITION::kTKRShowRawData, rawPage);
    } else {
        WriteReportTitle(kTitle, "", "");
    }
    const TContext context;
    bool hasData = false;

    // A collector that found no RAID manager leaves one event saying so;
    // that is no event of the controller.
    TReportClass events = Table("ORVSG_LogRecord_RAIDMgrEvent", "Halcyon Manager Events",
                                {{"MessageTimestamp", "18%"}, {"Severity", "17%"}, {"Message", "65%"}});
    TInstances managerEvents = TWriterUtil::GetInstances(fNamespace, events);
    if (!managerEvents.empty() && GetPropertyValue(managerEvents.front(), "Message", ",") != kNotInstalled) {
        SortByProperty(managerEvents, "MessageTimestamp", true);
        WriteTable(events, managerEvents, true, false, context);
        hasData = true;
    }

    TReportClass defunct = Table("ORVSG_LogRecord_hcDDD", "Halcyon Defunct Drive Log",
                                 {{"Controller", "5%"},
                                  {"Date", "10%"},
                                  {"Time", "10%"},
                                  {"Channel", "5%"},
                                  {"ID", "5%"},
                                  {"Reason", "20%"},
                                  {"Descrip", "45%"}});
    defunct.SetTableSortable();
    const TInstances defunctDrives = LogInstances(fNamespace, defunct.GetClass(), 2);
    if (!defunctDrives.empty()) {
        WriteTable(defunct, defunctDrives, true, false, context);
        hasData = true;
    }

    TReportClass devices = Table("ORVSG_hcSCSIDeviceData", "Device Event Table",
                                 {{"ControllerNum", "13%"},
                                  {"Channel", "12%"},
                                  {"ScsiId", "12%"},
                                  {"NumParityErrors", "13%"},
                                  {"NumSoftErrors", "13%"},
                                  {"NumHardErrors", "13%"},
                                  {"PFA", "12%"},
                                  {"Misc", "12%"}});
    devices.SetTableWidth("80%");
    TInstances deviceData = LogInstances(fNamespace, devices.GetClass(), 3);
    if (!deviceData.empty()) {
        TInstanceSorter sorter;
        for (const char* key : {"ControllerNum", "Channel", "ScsiId"}) sorter.AddProperty(key, true, false);
        try {
            TWriterUtil::SortInstances(deviceData, sorter, true);
        } catch (const std::exception& ex) {
            Log(0, std::string("Error sorting: ") + ex.what());
        }
        WriteTable(devices, deviceData, true, false, context);
        hasData = true;
    }

    if (luz) {
        const TInstances hard = LogInstances(fNamespace, "ORVSG_LogRecord_HardEvent", 4);
        if (!hard.empty()) {
            WriteHalcyonEventLog(hard, "hcHardEventLog", "Halcyon Hard Event Log");
            hasData = true;
        }
        const TInstances soft = LogInstances(fNamespace, "ORVSG_LogRecord_SoftEvent", 5);
        if (!soft.empty()) {
            WriteHalcyonEventLog(soft, "hcSoftEventLog", "Halcyon Soft Event Log");
            hasData = true;
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kLink, kTitle, hasData || !rawPage.empty());
    Trace(std::string(kName) + " -- Exiting");
}

}  // namespace braigrion
