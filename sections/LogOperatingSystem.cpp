// The operating system's logs. Windows event logs and the merged log are
// declared pages that the back-end writes whole; on Linux one class holds
// the records of every log file, and this section gives each file a page
// of its own ("syslog_" and the file's name).
#include <algorithm>
#include <map>
#include <vector>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

void TWriter::WriteWindowsEventReport(TBuilderPtr builder, std::string /*pageID*/) {
    Trace("TWriter::WriteWindowsEventReport -- Entering");
    WriteEventLogReport(builder->BuildWinAppEventParams());
    WriteEventLogReport(builder->BuildWinSysEventParams());
    WriteEventLogReport(builder->BuildWinSecEventParams());
    Trace("TWriter::WriteWindowsEventReport -- Exiting");
}

void TWriter::WriteMergedLogReport(TBuilderPtr builder, std::string /*pageID*/) {
    Trace("TWriter::WriteMergedLogReport -- Entering");
    WriteMergedLogPage(builder->BuildMergeLogParams());
    Trace("TWriter::WriteMergedLogReport -- Exiting");
}

void TWriter::WriteLinuxLogReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace("TWriter::WriteLinuxLogReport -- Entering");
    TClassPtr cls;
    try {
        cls = fNamespace->GetClass("ORVSG_LinuxEventLogRecord", TCIMContext());
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw TTKRException(ex);
        WriteIndexEntry("Event Logs", "", false);
        Trace("TWriter::WriteLinuxLogReport -- Exiting");
        return;
    }

    std::vector<TInstancePtr> records;
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(records), true, TCIMContext());
    TInstanceSorter sorter;
    sorter.AddProperty("RecordID", true, false);
    try {
        TWriterUtil::SortInstances(records, sorter, true);
    } catch (...) {
        Trace("TWriter::WriteLinuxLogReport -- Exception when sorting, records left in their order");
    }

    // Each log keeps its records in the order of their ids.
    std::multimap<std::string, TInstancePtr> logs;
    for (const TInstancePtr& record : records) {
        try {
            const NORVTKR20::TCIMValue& name = record->GetProperty("LogName", TCIMContext())->GetValue(TCIMContext());
            if (name.IsNull()) continue;
            logs.insert(std::make_pair(static_cast<std::string>(name), record));
        } catch (const TTKRException&) {
            // A record without a log name stands on no page.
        }
    }

    const std::vector<TReportProperty> fullColumns = {TReportProperty("MessageTimestamp", "15%", "", "", "", ""),
                                                      TReportProperty("Source", "15%", "", "", "", ""),
                                                      TReportProperty("Message", "70%", "", "", "", "")};
    const std::vector<TReportProperty> messageColumns = {TReportProperty("Message", "100%", "", "", "", "")};

    for (auto log = logs.begin(); log != logs.end(); log = logs.upper_bound(log->first)) {
        const std::string& logName = log->first;
        std::string::size_type slash = logName.rfind('/');
        const std::string shortName = slash == std::string::npos ? logName : logName.substr(slash + 1);
        const std::string linkName = "syslog_" + shortName;
        // boot.msg and the kernel ring buffer carry no time stamps.
        const bool messageOnly = shortName == "boot.msg" || shortName.find("dmesg") != std::string::npos;
        const std::vector<TReportProperty>& columns = messageOnly ? messageColumns : fullColumns;

        WriteIndexEntry(linkName, shortName, true);
        OpenPage(fOutputPath + TOSSpecific::kFileSeparator + linkName);
        WriteSortScript();
        WritePageHeader();
        WriteReportTitle(logName, "", "");
        StartColumnTable("100%", shortName, true);
        StartRow(false);
        for (const TReportProperty& column : columns) WriteHeaderCell(cls, column);
        EndRow();
        EndTableHeader();
        for (auto record = log; record != logs.end() && record->first == logName; ++record) {
            StartRow(true);
            for (const TReportProperty& column : columns) WriteValueCell(record->second, column, "");
            EndRow();
        }
        EndTable();
        WritePageFooter();
        ClosePage();
    }
    Trace("TWriter::WriteLinuxLogReport -- Exiting");
}

}  // namespace braigrion
