// The diagnostics log: the completion records of the diagnostics the tool
// ran, its own diagnostic log and the memory diagnostics. Where the
// documentation covers this machine type, each diagnostic code links to its
// page there.
#include <vector>

#include "LogLinks.h"
#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;

namespace {

const char kDiagsLink[] = "diags";
const char kDiagsTitle[] = "Diagnostics Log";
const char kLinkColumn[] = "InfoCenterLink";
// A subclass the deep enumeration reaches, whose records are the disk
// provider's defaults rather than diagnostics that ran.
const char kDiskDefaultRecord[] = "LSIESG_DiskDefaultCompletionRecord";

// The three tables of the page. `textProperty` is the column whose text
// carries the diagnostic code; "" for the table without codes.
struct TDiagnosticTable {
    const char* title;
    const char* className;
    std::vector<std::pair<const char*, const char*>> columns;  // property, width
    const char* textProperty;
    bool countsForData;
};

const TDiagnosticTable kTables[] = {
    {"Diagnostics Completion Log",
     "CIM_DiagnosticCompletionRecord",
     {{"ServiceName", "15%"},
      {"ManagedElementName", "20%"},
      {"RecordData", "40%"},
      {kLinkColumn, "10%"},
      {"CreationTimeStamp", "15%"}},
     "RecordData",
     true},
    {"TKR Diagnostic Log",
     "ORVSG_TKRDiagnosticLogRecord",
     {{"MessageTimestamp", "20%"}, {"LogName", "15%"}, {"RecordID", "15%"}, {"Message", "50%"}},
     "",
     true},
    {"Memory Diagnostics Log",
     "ORVSG_MemoryDiagLogRecord",
     {{"Type", "20%"}, {"Message", "65%"}, {kLinkColumn, "15%"}},
     "Message",
     false},
};

}  // namespace

void TWriter::ProcessDiagnosticErrorCode(std::string& text) {
    if (text.size() > 10) text = text.substr(0, 11);
}

void TWriter::WriteCustomDiagnosticLog(TBuilderPtr /*builder*/, std::string /*reportName*/) {
    Trace("TWriter::WriteCustomDiagnosticLog -- Entering");
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kDiagsLink);
    WriteSortScript();
    WritePageHeader();
    WriteReportTitle(kDiagsTitle, "", "");

    const std::string machineType = GetMTFromRepository();
    const bool links = loglinks::IsMachineTypeListed(fLogLinks.fDataFolder, loglinks::kDiagnosticsFile,
                                                     machineType, "open tkrEventsAtInfoC.txt failed");

    bool hasData = false;
    for (const TDiagnosticTable& table : kTables) {
        std::vector<TReportProperty> columns;
        for (const auto& column : table.columns) {
            if (column.first == std::string(kLinkColumn) && !links) continue;
            columns.push_back(TReportProperty(column.first, column.second, "", "", "", ""));
        }

        TClassPtr cls;
        try {
            cls = fNamespace->GetClass(table.className, TCIMContext());
        } catch (...) {
            Trace(std::string("Exception when getting class of ") + table.className);
            continue;
        }
        std::vector<TInstancePtr> records;
        try {
            cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(records), true, TCIMContext());
        } catch (...) {
            Trace(std::string("Exception when enumerating instances of ") + table.className);
            continue;
        }
        if (records.empty()) continue;

        try {
            WriteTableTitle(table.title, false, false);
            StartColumnTable("100%", table.title, true);
            StartRow(false);
            for (const TReportProperty& column : columns) WriteHeaderCell(cls, column);
            EndRow();
            EndTableHeader();
        } catch (...) {
            Trace("Exception when writting table label");
        }

        const bool withCodes = table.textProperty[0] != '\0';
        for (const TInstancePtr& record : records) {
            try {
                if (table.className == std::string("CIM_DiagnosticCompletionRecord") &&
                    record->GetClass(TCIMContext())->GetClassName(TCIMContext()) == kDiskDefaultRecord) {
                    continue;
                }
                std::string shown;
                std::string code;
                std::string link;
                if (withCodes) {
                    try {
                        shown = static_cast<std::string>(
                            record->GetProperty(table.textProperty, TCIMContext())->GetValue(TCIMContext()));
                        code = shown;
                        ProcessDiagnosticErrorCode(code);
                        Trace("Diagnostic eventID = " + code);
                    } catch (...) {
                        shown.clear();
                        code.clear();
                    }
                    link = loglinks::DiagnosticLink(fLogLinks.fDocServer, machineType, code);
                }

                StartRow(true);
                for (const TReportProperty& column : columns) {
                    const std::string property = column.GetProperty();
                    if (property == kLinkColumn) {
                        WriteTextCell(column, code, link);
                    } else if (withCodes && property == table.textProperty) {
                        WriteTextCell(column, EscapeText(shown), "");
                    } else {
                        WriteValueCell(record, column, "");
                    }
                }
                EndRow();
            } catch (...) {
                Trace("Exception when writting table content");
            }
        }
        EndTable();
        if (table.countsForData) hasData = true;
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kDiagsLink, kDiagsTitle, hasData);
    Trace("TWriter::WriteCustomDiagnosticLog -- Exiting");
}

}  // namespace braigrion
