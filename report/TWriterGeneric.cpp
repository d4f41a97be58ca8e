// The generic page writers: a whole page from a declared definition, one
// table per class, and the ordering of patch results.
#include <algorithm>

#include "braigrion/ReportDefinition.h"
#include "braigrion/Trace.h"
#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;

namespace {

const char kErrorLogName[] = "TKR Error Log";
// Memory modules have pages of their own; the FRU table leaves them out.
const char kDimm[] = "DIMM";
const std::vector<TWriter::TInstancePtr>::size_type kSPDGroup = 8;

std::string TextOf(const boost::shared_ptr<ICIMInstance>& instance, const std::string& property) {
    TCIMContext context;
    return static_cast<std::string>(instance->GetProperty(property, context)->GetValue(context));
}

bool IsDimm(const TWriter::TInstancePtr& instance) {
    try {
        TCIMContext context;
        return instance->GetProperty("Name", context)->GetValue(context).ToString(10).find(kDimm) !=
               std::string::npos;
    } catch (const TTKRException&) {
        return false;  // a unit without a name is no memory module that we know of
    }
}

}  // namespace

bool pb_comp_type(boost::shared_ptr<ICIMInstance> a, boost::shared_ptr<ICIMInstance> b) {
    try {
        return TextOf(a, "Type") < TextOf(b, "Type");
    } catch (const TTKRException&) {
        return false;
    }
}

bool pb_comp_name(boost::shared_ptr<ICIMInstance> a, boost::shared_ptr<ICIMInstance> b) {
    try {
        return TextOf(a, "Name") < TextOf(b, "Name");
    } catch (const TTKRException&) {
        return false;
    }
}

std::vector<boost::shared_ptr<ICIMInstance>> PBResultSort(std::vector<boost::shared_ptr<ICIMInstance>>& results) {
    std::vector<boost::shared_ptr<ICIMInstance>> sorted(results);
    // By name first, then stably by type: the types lead, names within.
    std::stable_sort(sorted.begin(), sorted.end(), pb_comp_name);
    std::stable_sort(sorted.begin(), sorted.end(), pb_comp_type);
    return sorted;
}

void TWriter::WriteGenericReport(TReportParameters params) {
    Trace("TWriter::WriteGenericReport -- Enter");
    Trace("TWriter::WriteGenericReport -- Current report name is " + params.GetReportName());
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WriteSortScript();
    WritePageHeader();
    if (params.ShowReportTitle()) WriteReportTitle(params.GetReportName(), "", "");

    // In the default mode a text report's error log page stays open and
    // empty, with neither foot nor index line.
    const bool errorLog = params.GetReportName() == kErrorLogName;
    if (fMode == "default" && GetWriterType() == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_TEXT && errorLog) return;

    for (const TReportClass& reportClass : params.GetClasses()) {
        std::vector<TInstancePtr> instances = TWriterUtil::GetInstances(fNamespace, reportClass);
        const std::string className = reportClass.GetClass();
        if (className == "ORVSG_PBResult") instances = PBResultSort(instances);

        if (className == "ORVSG_SPDData" && instances.size() >= kSPDGroup + 1) {
            // Memory module data come in tables of eight modules.
            for (size_t start = 0; start < instances.size(); start += kSPDGroup) {
                size_t end = std::min(start + kSPDGroup, instances.size());
                WriteTable(reportClass, std::vector<TInstancePtr>(instances.begin() + static_cast<long>(start),
                                                                  instances.begin() + static_cast<long>(end)),
                           true, false, TContext());
            }
        } else if (className == "ORVSG_FRU") {
            instances.erase(std::remove_if(instances.begin(), instances.end(), IsDimm), instances.end());
            WriteTable(reportClass, instances, true, false, TContext());
        } else if (!instances.empty()) {
            WriteTable(reportClass, instances, true, false, TContext());
        }
    }

    WritePageFooter();
    ClosePage();
    const bool hasData = !(fMode == "default" && errorLog);
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter::WriteGenericReport -- Exiting ");
}

void TWriter::WriteGenericReportWithLink(TReportParameters params, const std::string& link) {
    // The frame of WriteGenericReport, and its opening lines; only the
    // closing line is this writer's own.
    Trace("TWriter::WriteGenericReport -- Enter");
    Trace("TWriter::WriteGenericReport -- Current report name is " + params.GetReportName());
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + params.GetLinkName());
    WritePageHeader();
    if (fWriterType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML) {
        WriteReportTitle(params.GetReportName(), link, TKR_REPORT_DEFINITION::kTKRShowRawData);
    } else {
        WriteReportTitle(params.GetReportName(), "", "");
    }

    const bool errorLog = params.GetReportName() == kErrorLogName;
    if (fMode == "default" && GetWriterType() == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_TEXT && errorLog) return;

    for (const TReportClass& reportClass : params.GetClasses()) {
        std::vector<TInstancePtr> instances = TWriterUtil::GetInstances(fNamespace, reportClass);
        if (!instances.empty()) WriteTable(reportClass, instances, true, false, TContext());
    }

    WritePageFooter();
    ClosePage();
    const bool hasData = !(fMode == "default" && errorLog);
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("Exiting TWriter::WriteGenericReportWithLink");
}

}  // namespace braigrion
