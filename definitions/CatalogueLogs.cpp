// Definitions of the log pages: the tool's own error log, the merged log,
// the three Windows event logs, the chassis event log, the service
// processor's logs (DLM, ZEPH, IPMI), the report highlights, the
// diagnostics log, the DCAP log and the file loader results. One builder
// operation per page; a definition varies only with the probes of the
// collection and the run's mode.
#include "CatalogueSupport.h"
#include "braigrion/TReportParametersBuilder.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {

using namespace catalogue;

namespace {

const char kLuzMode[] = "luz";

// A page whose link in the navigation sorts with the other logs.
TReportParameters SortableLogPage(const std::string& linkName, const std::string& reportName) {
    TReportParameters params = Page(linkName, reportName);
    params.SetLinkSortable();
    return params;
}

// The three Windows event logs share one table layout.
TReportParameters WindowsEventPage(const std::string& linkName, const std::string& reportName,
                                   const std::string& recordClass) {
    TReportParameters params = SortableLogPage(linkName, reportName);
    TReportClass cls;
    cls.SetClass(recordClass);
    cls.GetInstanceSorter().AddProperty("RecordID", true, false);
    cls.SetProperties({Column("Type", "5%"), Column("MessageTimestamp", "16%"), Column("Source", "14%"),
                       Column("Category", "3%"), Column("Message", "39%"), Column("EventID", "5%"),
                       Column("User", "8%"), Column("Computer", "10%")});
    params.SetClasses({cls});
    return params;
}

// A table of raw record bytes, one element a line.
TReportClass RawHexTable(const std::string& recordClass, const std::string& title) {
    TReportClass cls;
    cls.SetClass(recordClass);
    cls.SetTitle(title);
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("RecordID", true, true);
    cls.SetProperties({Column("RecordID", "5%"), Column("MessageTimestamp", "15%"),
                       Separated("RawData", "80%", TReportProperty::SEPARATOR_1)});
    return cls;
}

// The IPMI page's name says where the records came from: the BMC read over
// the LAN, or the local one.
std::string IPMIReportName() {
    NORVTKR20::IIPMILan* lan = NORVTKR20::TRootObject::GetipmiLanIns();
    if (lan != nullptr && lan->getipmiLanStatus() != 0) {
        char address[40] = {0};
        lan->getIPMIAddress(address, sizeof(address));
        address[sizeof(address) - 1] = '\0';
        return std::string("IPMI Event - Remote BMC/KMC ") + address;
    }
    return "IPMI Event";
}

}  // namespace

TReportParameters TReportParametersBuilder::BuildTKRLogParams() const {
    TTrace trace("TReportParametersBuilder::BuildTKRLogParams");
    TReportParameters params = SortableLogPage("tkr_log", "TKR Error Log");
    TReportClass cls;
    cls.SetClass("ORVSG_TKRLogRecord");
    cls.SetTitle("TKR Error Log");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("RecordID", true, true);
    cls.SetProperties({Column("MessageTimestamp", "11%"), Column("Source", "13%"), Column("Type", "7%"),
                       Column("Message", "69%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildMergeLogParams() const {
    TTrace trace("TReportParametersBuilder::BuildMergeLogParams");
    TReportParameters params = SortableLogPage("merged_log", "Merged Log");
    TReportClass cls;
    cls.SetClass("ORVSG_LogRecord");
    cls.SetTitle("Merged Log");
    cls.GetInstanceSorter().AddProperty("MessageTimestamp", true, false);
    if (IsMultiNode()) {
        cls.SetProperties({Column("MessageTimestamp", "15%"), Column("LogName", "7%"), Column("SourceNode", "8%"),
                           Column("Message", "70%")});
    } else {
        cls.SetProperties({Column("MessageTimestamp", "15%"), Column("LogName", "7%"), Column("Message", "70%")});
    }
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildWinSysEventParams() const {
    TTrace trace("TReportParametersBuilder::BuildWinSysEventParams");
    return WindowsEventPage("event_system", "System Event", "ORVSG_WindowsSystemEventLogRecord");
}

TReportParameters TReportParametersBuilder::BuildWinSecEventParams() const {
    TTrace trace("TReportParametersBuilder::BuildWinSecEventParams");
    return WindowsEventPage("event_security", "Security Event", "ORVSG_WindowsSecurityEventLogRecord");
}

TReportParameters TReportParametersBuilder::BuildWinAppEventParams() const {
    TTrace trace("TReportParametersBuilder::BuildWinAppEventParams");
    return WindowsEventPage("event_application", "Application Event", "ORVSG_WindowsApplicationEventLogRecord");
}

TReportParameters TReportParametersBuilder::BuildCELLogParams() const {
    TTrace trace("TReportParametersBuilder::BuildCELLogParams");
    TReportParameters params = SortableLogPage("chassis_event", "Chassis Event Log");
    TReportClass cls;
    cls.SetClass("ORV_StandardMessageLogEntry");
    cls.SetTitle("Chassis Event Log");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("CreationTimeStamp", true, false);
    if (IsMultiNode()) {
        cls.SetProperties({Column("NodeID", "10%"), Column("LogName", "10%"), Column("CreationTimeStamp", "30%"),
                           Column("MessageID", "10%"), Column("Message", "30%"),
                           Column("PerceivedSeverity", "10%")});
    } else {
        cls.SetProperties({Column("LogName", "15%"), Column("CreationTimeStamp", "30%"), Column("MessageID", "10%"),
                           Column("Message", "35%"), Column("PerceivedSeverity", "10%")});
    }
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildZEPHLogParams() const {
    TTrace trace("TReportParametersBuilder::BuildZEPHLogParams");
    TReportParameters params = SortableLogPage("zeph_event", "ZEPH Event");
    TReportClass cls;
    cls.SetClass("ORVSG_ZEPHLog");
    cls.SetTitle("ZEPH Event");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("MessageTimestamp", true, false);
    cls.SetProperties({Column("MessageTimestamp", "15%"), Column("Message", "85%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildDLMLogParams() const {
    TTrace trace("TReportParametersBuilder::BuildDLMLogParams");
    TReportParameters params = SortableLogPage("dlm_event", "DLM Event");
    TReportClass cls;
    cls.SetClass("ORVSG_DLMLog");
    cls.SetTitle("DLM Event");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("MessageTimestamp", true, false);
    cls.SetProperties({Column("MessageTimestamp", "15%"), Column("Type", "2%"), Column("LoggingSource", "14%"),
                       Column("Message", "69%")});
    params.SetClasses({cls});
    return params;
}

// In LUZ mode the page carries the parser's view of each record first and
// the raw record bytes last; other modes show the events alone.
TReportParameters TReportParametersBuilder::BuildIPMILogParams() const {
    TTrace trace("TReportParametersBuilder::BuildIPMILogParams");
    const bool luz = fMode == kLuzMode;
    const bool multiNode = IsMultiNode();

    TReportParameters params = SortableLogPage("ipmi_event", IPMIReportName());
    TClasses classes;
    TReportClass cls;

    if (luz) {
        cls.SetClass("ORVSG_IPMILogRecord");
        cls.SetTitle("IPMI SEL Parser Output");
        cls.SetTableSortable();
        cls.GetInstanceSorter().AddProperty("RecordID", true, true);
        cls.SetProperties({Column("Caption", "5%"), Column("DataFormat", "5%"), Column("RecordID", "5%"),
                           Column("Description", "15%"), Column("EventData", "70%")});
        classes.push_back(cls);
    }

    cls.Reset();
    cls.SetClass("ORVSG_IPMILogRecord");
    cls.SetTitle("IPMI Event");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("RecordID", true, true);
    if (multiNode) {
        cls.SetProperties({Column("RecordID", "5%"), Column("SourceNode", "5%"), Column("MessageTimestamp", "10%"),
                           Column("Message", "50%"), Column("AuxLog", "30%")});
    } else {
        cls.SetProperties({Column("RecordID", "5%"), Column("MessageTimestamp", "10%"), Column("Message", "55%"),
                           Column("AuxLog", "30%")});
    }
    classes.push_back(cls);

    if (luz) {
        classes.push_back(RawHexTable("ORVSG_IPMILogRecord", "Raw Hex Data"));
        classes.push_back(RawHexTable("ORVSG_KMCAuxDebugRecord", "KMC Auxiliary Debugging Raw Data"));
    }
    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildIPMILogKMCParams() const {
    TTrace trace("TReportParametersBuilder::BuildIPMILogKMCParams");
    TReportParameters params = Page("ipmi_event", "IPMI Event");
    TClasses classes;
    TReportClass cls;
    cls.SetClass("ORVSG_IPMILogRecord");
    cls.SetTitle("IPMI Event");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("RecordID", true, true);
    if (IsMultiNode()) {
        cls.SetProperties({Column("RecordID", "5%"), Column("SourceNode", "5%"), Column("MessageTimestamp", "15%"),
                           Column("Message", "75%")});
    } else {
        cls.SetProperties({Column("RecordID", "5%"), Column("MessageTimestamp", "15%"), Column("Message", "75%")});
    }
    classes.push_back(cls);
    if (fMode == kLuzMode) classes.push_back(RawHexTable("ORVSG_IPMILogRecord", "Raw Hex Data"));
    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildCriticalDetailsParams() const {
    TTrace trace("TReportParametersBuilder::BuildCriticalDetailsParams");
    TReportParameters params = Page("critical_details", "Report Highlights");
    TReportClass cls;
    cls.SetClass("ORVSG_HeavyHittersLogRecord");
    cls.SetTableWidth("60%");
    cls.SetProperties({Column("Message", "100%")});
    params.SetClasses({cls});
    return params;
}

// One class object serves all three tables without a reset, so each table
// keeps the sort keys of the tables before it and adds its own.
TReportParameters TReportParametersBuilder::BuildDiagsParams() const {
    TTrace trace("TReportParametersBuilder::BuildDiagsParams");
    TReportParameters params = SortableLogPage("diags", "Diagnostics Log");
    TClasses classes;
    TReportClass cls;

    cls.SetClass("CIM_DiagnosticCompletionRecord");
    cls.SetTitle("Diagnostics Completion Log");
    cls.SetTableSortable();
    cls.GetInstanceSorter().AddProperty("ServiceName", true, false);
    cls.GetInstanceSorter().AddProperty("CreationTimeStamp", true, true);
    cls.SetProperties({Column("ServiceName", "16%"), Column("ManagedElementName", "15%"),
                       Column("RecordData", "55%"), Column("CreationTimeStamp", "14%")});
    classes.push_back(cls);
    params.SetClasses(classes);

    cls.SetClass("ORVSG_TKRDiagnosticLogRecord");
    cls.SetTitle("TKR Diagnostic Log");
    cls.GetInstanceSorter().AddProperty("RecordID", true, true);
    cls.GetInstanceSorter().AddProperty("MessageTimestamp", true, true);
    cls.SetProperties({Column("MessageTimestamp", "20%"), Column("LogName", "15%"), Column("RecordID", "15%"),
                       Column("Message", "50%")});
    classes.push_back(cls);
    params.SetClasses(classes);

    cls.SetClass("ORVSG_MemoryDiagLogRecord");
    cls.SetTitle("Memory Diagnostics Log");
    cls.SetProperties({Column("Type", "25%"), Column("Message", "75%")});
    classes.push_back(cls);
    params.SetClasses(classes);
    return params;
}

TReportParameters TReportParametersBuilder::BuildSPINTParams() const {
    TTrace trace("TReportParametersBuilder::BuildSPINTParams");
    TReportParameters params = SortableLogPage("SPINTlog_system", "DCAP Log");
    TReportClass cls;
    cls.SetClass("ORVSG_DCAPFile");
    cls.SetProperties({Column("SourceNode", "5%"), Column("MessageTimestamp", "15%"), Column("FileName", "10%"),
                       Column("ErrRawData", "70%")});
    params.SetClasses({cls});
    return params;
}

TReportParameters TReportParametersBuilder::BuildFileLoaderParams() const {
    TTrace trace("TReportParametersBuilder::BuildFileLoaderParams");
    // The link name carries its extension, as it always has.
    TReportParameters params = Page("fileloader.html", "File Loader Results");
    TReportClass cls;
    cls.SetClass("ORVSG_LogRecord_FileLoader");
    cls.SetTitle("File Loader");
    RowReport(cls, "30%", "75%", 1);
    cls.SetProperties({Column("FileName"), Monospaced("Message")});
    params.SetClasses({cls});
    return params;
}

}  // namespace braigrion
