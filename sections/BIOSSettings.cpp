// The "BIOS Settings" page: the attributes of the system firmware, as their
// collector (switched on through the environment) left them.
#include <string>
#include <vector>

#include "braigrion/TWriter.h"
#include "braigrion/TWriterUtil.h"
#include "braigrion/Trace.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::TCIMContext;
using NORVTKR20::TOSSpecific;
using NORVTKR20::TTKRException;

void TWriter::WriteBIOSEnumeration(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    Trace("Entering TWriter::WriteBIOSEnumeration");
    OpenPage(fOutputPath + TOSSpecific::kFileSeparator + "biosenumeration");
    WritePageHeader();
    WriteReportTitle("BIOS Settings", "", "");

    // An absent class leaves the page with its title only; any other failure
    // of the repository abandons the page.
    try {
        fNamespace->GetClass("ORVSG_BIOSEnumeration", TCIMContext());
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }

    TReportClass reportClass;
    reportClass.SetClass("ORVSG_BIOSEnumeration");
    reportClass.SetProperties({TReportProperty("AttributeName", "15%", "", "", "", ""),
                               TReportProperty("CurrentValue", "25%", "", "", "", ""),
                               TReportProperty("DefaultValue", "25%", "", "", "", ""),
                               TReportProperty("PendingValue", "35%", "", "", "", "")});
    std::vector<TInstancePtr> instances = TWriterUtil::GetInstances(fNamespace, reportClass);
    TInstanceSorter sorter;
    sorter.AddProperty("AttributeName", true, false);
    TWriterUtil::SortInstances(instances, sorter, true);
    const bool hasData = !instances.empty();
    WriteTable(reportClass, instances, true, false, TContext());

    WritePageFooter();
    ClosePage();
    WriteIndexEntry("biosenumeration", "BIOS Settings", hasData);
    Trace("Exiting TWriter::WriteBIOSEnumeration");
}

}  // namespace braigrion
