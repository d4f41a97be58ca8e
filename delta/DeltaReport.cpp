// The delta page: for each class of a page's definition, the instances that
// differ between the collections of the view, property differences first,
// then those missing from some sources, then those unique to some.
#include "braigrion/ReportDefinition.h"
#include "braigrion/Trace.h"
#include "braigrion/TWriter.h"
#include "delta/TClassDelta.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

namespace {

// Frees the tree of one class when the page is done with it, written or not.
struct TReleaseOnExit {
    boost::shared_ptr<TClassDelta> fTree;
    ~TReleaseOnExit() { fTree->Release(); }
};

}  // namespace

void TWriter::WriteGenericDeltaReport(TReportParameters params) {
    Trace("Entering TWriter::WriteGenericDeltaReport");
    TContext empty;
    fNamespace->GetClass("ORVSG_DeltaClass", empty);
    OpenPage(fOutputPath + NORVTKR20::TOSSpecific::kFileSeparator + params.GetLinkName());
    WriteSortScript();
    WritePageHeader();
    if (params.ShowReportTitle()) WriteReportTitle(params.GetReportName(), "", "");

    const TContext& context = TClassDelta::GetRunContext();
    bool hasData = false;
    for (TReportClass& reportClass : params.GetClasses()) {
        TReleaseOnExit tree{boost::shared_ptr<TClassDelta>(
            new TClassDelta(fNamespace, context, boost::shared_ptr<TClassDelta>(), &reportClass))};
        tree.fTree->CreateDeltaInstances(this);
        const auto& entries = tree.fTree->GetInstanceDeltas();
        hasData = hasData || !entries.empty();
        if (reportClass.HasTitle()) {
            WriteTableTitle(reportClass.GetTitle(), reportClass.SubTitleEnabled(), false);
            reportClass.ClearTitle();
        }
        // Each instance is written once per kind of difference, under its
        // parent when it has one on the page.
        TInstanceDelta::TWritten written;
        for (const auto& named : entries) {
            if (named.second->HasDeltaTypeBelow(kDeltaProperty)) named.second->WritePropertyDeltaTable(this, written);
        }
        for (bool missing : {true, false}) {
            const std::uint8_t type = missing ? kDeltaMissing : kDeltaUnique;
            written.clear();
            for (const auto& named : entries) {
                if (named.second->HasDeltaTypeBelow(type)) {
                    named.second->WriteMissingOrExtraDeltaTable(this, missing, false, written);
                }
            }
        }
    }

    WritePageFooter();
    ClosePage();
    WriteIndexEntry(params.GetLinkName(), params.GetReportName(), hasData);
    Trace("TWriter::WriteGenericDeltaReport -- Exiting ");
}

}  // namespace braigrion
