// The chassis event log: the service processor's standard message log
// entries, each event and each UEFI diagnostic code linked to its page on the
// documentation site when the site covers this machine type. Also the frame
// of the IPMI page and the small text helpers of event ids and codes.
#include <algorithm>
#include <vector>

#include <boost/algorithm/string/replace.hpp>

#include "LogLinks.h"
#include "braigrion/ReportDefinition.h"
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

namespace {

const char kChassisClass[] = "ORV_StandardMessageLogEntry";
const char kChassisLink[] = "chassis_event";
const char kChassisTitle[] = "Chassis Event Log";

TReportProperty ChassisColumn(const std::string& property, const std::string& width,
                              const std::string& defaultValue = "") {
    return TReportProperty(property, width, "", "", "", defaultValue);
}

// The text of a property; throws when the instance lacks it.
std::string TextOf(const TWriter::TInstancePtr& instance, const std::string& property) {
    return static_cast<std::string>(instance->GetProperty(property, TCIMContext())->GetValue(TCIMContext()));
}

}  // namespace

void TWriter::ProcessKMCEventID(std::string& id) {
    if (id.empty()) return;
    std::string::size_type prefix = id.find("0X");
    if (prefix != std::string::npos) id.erase(0, prefix + 2);
    id.erase(std::remove_if(id.begin(), id.end(),
                            [](char c) { return c == ' ' || c == '\n' || c == '\r' || c == '\t' || c == '-'; }),
             id.end());
}

std::string TWriter::ProcessUefiDiagCodeFromAD(std::string text) {
    if (text.empty() || text[0] != '[') return std::string();
    std::string::size_type close = text.find(']', 1);
    if (close == std::string::npos) return std::string();
    return text.substr(1, close - 1);
}

void TWriter::ExtractLink(const std::string& line, std::string& left, std::string& right) {
    const std::string separator = "_desc_";
    std::string::size_type at = line.find(separator);
    if (at == std::string::npos) {
        left = line;
        right.clear();
        return;
    }
    left = line.substr(0, at);
    right = line.substr(at + separator.size());
}

void TWriter::WriteCustomChassisEventLog(TBuilderPtr builder, std::string /*pageID*/) {
    Trace("TWriter::WriteCustomChassisEventLog -- Entering");
    const bool multiNode = builder->IsMultiNode();
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + kChassisLink);
    WriteSortScript();
    WritePageHeader();
    WriteReportTitle(kChassisTitle, "", "");

    std::vector<TReportProperty> columns;
    if (multiNode) columns.push_back(ChassisColumn("NodeID", "10%"));
    columns.push_back(ChassisColumn("LogName", "10%"));
    columns.push_back(ChassisColumn("CreationTimeStamp", "20%"));
    const TReportProperty eventID = ChassisColumn("EventID", "10%", "N/A");
    columns.push_back(eventID);
    columns.push_back(ChassisColumn("MessageID", "10%"));
    columns.push_back(ChassisColumn("Message", "20%"));
    columns.push_back(ChassisColumn("PerceivedSeverity", "10%"));
    const TReportProperty auxiliary = ChassisColumn("AuxiliaryData", "10%");
    columns.push_back(auxiliary);

    TClassPtr cls;
    std::vector<TInstancePtr> entries;
    try {
        cls = fNamespace->GetClass(kChassisClass, TCIMContext());
    } catch (...) {
        Trace(std::string("Exception when getting class of ") + kChassisClass);
    }
    if (cls) {
        try {
            cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(entries), true, TCIMContext());
        } catch (...) {
            Trace(std::string("Exception when enumerating instances of ") + kChassisClass);
            entries.clear();
        }
    }

    bool written = false;
    if (!entries.empty()) {
        try {
            WriteTableTitle(kChassisTitle, false, false);
            StartColumnTable("100%", "ChassisEventLog", true);
            StartRow(false);
            for (const TReportProperty& column : columns) WriteHeaderCell(cls, column);
            EndRow();
            EndTableHeader();
        } catch (...) {
            Trace("Exception when writting table label");
        }

        TInstanceSorter sorter;
        if (multiNode) sorter.AddProperty("NodeID", true, false);
        sorter.AddProperty("CreationTimeStamp", true, false);
        try {
            TWriterUtil::SortInstances(entries, sorter, true);
        } catch (...) {
            Trace("TWriter::WriteCustomChassisEventLog -- Exception when sorting, entries left in their order");
        }

        const std::string machineType = GetMTFromRepository();
        const bool links = loglinks::IsMachineTypeListed(fLogLinks.fDataFolder, loglinks::kEventsFile, machineType,
                                                         "open kmcEventsAtInfoC.txt failed");

        for (const TInstancePtr& entry : entries) {
            try {
                std::string hidden;
                try {
                    hidden = TextOf(entry, "Hidden");
                } catch (...) {
                    hidden.clear();  // an unreadable flag hides nothing
                }
                if (hidden == "true") continue;

                std::string id;
                try {
                    id = TextOf(entry, "EventID");
                    ProcessKMCEventID(id);
                } catch (...) {
                    id.clear();
                }
                std::string eventLink;
                if (id.empty()) {
                    id = "N/A";
                } else {
                    eventLink = loglinks::EventLink(fLogLinks.fDocServer, fLogLinks.fHelpServer, machineType, id);
                    Trace("Hyperlink for current CEL is " + eventLink);
                }

                std::string auxiliaryText;
                std::string uefiLink;
                try {
                    auxiliaryText = TextOf(entry, "AuxiliaryData");
                    std::string uefiCode = ProcessUefiDiagCodeFromAD(auxiliaryText);
                    if (!uefiCode.empty()) {
                        uefiLink =
                            loglinks::EventLink(fLogLinks.fDocServer, fLogLinks.fHelpServer, machineType, uefiCode);
                        Trace("Hyperlink for current uefi Diag code CEL is " + uefiLink);
                    }
                } catch (...) {
                    auxiliaryText.clear();
                    uefiLink.clear();
                }

                StartRow(true);
                for (const TReportProperty& column : columns) {
                    if (column.GetProperty() == eventID.GetProperty()) {
                        WriteTextCell(eventID, id, links ? eventLink : std::string());
                    } else if (column.GetProperty() == auxiliary.GetProperty() && links && !uefiLink.empty()) {
                        WriteTextCell(auxiliary, auxiliaryText, uefiLink);
                    } else {
                        WriteValueCell(entry, column, "");
                    }
                }
                EndRow();
            } catch (...) {
                Trace("Exception when writting table content");
            }
        }
        EndTable();
        written = true;
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(kChassisLink, kChassisTitle, written);
    Trace("TWriter::WriteCustomChassisEventLog -- Exiting");
}

void TWriter::WriteIPMIReport(TReportParameters params) {
    Trace("TWriter::WriteIPMIReport -- Entering");
    std::string multitoolLink;
    if (IsMultitool(multitoolLink)) {
        WriteIPMIEventReportWithLink(params, multitoolLink);
    } else {
        WriteGenericReport(params);
    }
    Trace("TWriter::WriteIPMIReport -- Exiting");
}

// The frame of a generic page whose title carries the multi-tool's link,
// given as "target_desc_text" with "*" for each "/" of the text.
void TWriter::WriteIPMIEventReportWithLink(TReportParameters params, std::string link) {
    Trace("Entering TWriter::WriteIPMIEventReportWithLink");
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    if (fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML) {
        std::string first;
        std::string second;
        ExtractLink(link, first, second);
        boost::algorithm::replace_all(second, "*", "/");
        WriteReportTitleWithLink(params.GetReportName(), first, second);
    } else {
        WriteReportTitleWithLink(params.GetReportName(), "", "");
    }
    for (const TReportClass& reportClass : params.GetClasses()) {
        std::vector<TInstancePtr> instances = TWriterUtil::GetInstances(fNamespace, reportClass);
        if (!instances.empty()) WriteTable(reportClass, instances, true, false, TContext());
    }
    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), true);
    Trace("Exiting TWriter::WriteGenericReport");
}

}  // namespace braigrion
