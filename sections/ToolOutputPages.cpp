// The pages of what the service mode's external tools printed: the GPU
// tools and the settings tool. Each command the tool ran is shown as it
// was issued, with its output under it in a grid of one column.
#include "MellanoxBlocks.h"
#include "braigrion/TTable.h"
#include "tkrcore/TOSSpecific.h"

namespace braigrion {

using namespace sections;

namespace {

// One command and the property that holds its output. A block without a
// title stands directly under the page title.
struct TToolBlock {
    const char* title;
    const char* command;
    const char* property;
};

struct TToolPage {
    const char* function;  // the name in the trace lines
    const char* exitName;  // the name of the closing trace line
    const char* linkName;
    const char* title;
    const char* cimClass;
    std::vector<TToolBlock> blocks;
};

// The output of one command: the property's display text, "N/A" when the
// instance does not hold it.
std::string ToolOutput(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        return instance->GetProperty(property, NORVTKR20::TCIMContext())->GetValueString();
    } catch (...) {
        return "N/A";
    }
}

}  // namespace

// The scheme of the three pages. A page whose class is missing or holds no
// instance is listed in the index as holding no data and is not written.
static void WriteToolOutputPage(TWriter& writer, const TWriter::TNamespacePtr& ns, const std::string& outputPath,
                                const TToolPage& page) {
    Trace(std::string("Entering TWriter::") + page.function);
    TInstances instances;
    try {
        instances = DeepInstances(ns->GetClass(page.cimClass, NORVTKR20::TCIMContext()));
    } catch (const NORVTKR20::TTKRException&) {
        instances.clear();
    }
    if (instances.empty()) {
        writer.WriteIndexEntry(page.linkName, page.title, false);
        return;
    }
    const TWriter::TInstancePtr& output = instances.front();
    writer.OpenPage(outputPath + NORVTKR20::TOSSpecific::kFileSeparator + page.linkName);
    writer.WritePageHeader();
    writer.WriteReportTitle(page.title, "", "");
    for (const TToolBlock& block : page.blocks) {
        if (block.title[0] != '\0') writer.WriteTableTitle(block.title, false, false);
        TTable table(2, 1, false);
        table.fTableWidth = 100;
        table.fColumnWidths[0] = 100;
        table.Cell(0, 0).text = writer.EscapeText(block.command);
        table.Cell(0, 0).monospaced = true;
        table.Cell(1, 0).text = writer.EscapeText(ToolOutput(output, block.property));
        table.Cell(1, 0).monospaced = true;
        writer.WriteTableGrid(table);
        writer.WriteTableBreak();
    }
    writer.WritePageFooter();
    writer.ClosePage();
    writer.WriteIndexEntry(page.linkName, page.title, true);
    Trace(std::string("Exiting TWriter::") + page.exitName);
}

void TWriter::WriteAMDAticonfigLogReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    // The closing line names the NVIDIA page, as it always has.
    static const TToolPage page = {
        "WriteAMDAticonfigLogReport",
        "WriteNVSMILogReport",
        "amdaticonfiglog",
        "AMD GPU Info",
        "ORVSG_AMDAtiConfigLog",
        {{"List Adapters", "aticonfig --lsa", "AMDAticonfiglsaRawData"},
         {"Temperature", "aticonfig --odgt", "AMDAticonfigodgtRawData"},
         {"Clock", "aticonfig --odgc", "AMDAticonfigodgcRawData"},
         {"TV info", "aticonfig --tv-info", "AMDAticonfigtvRawData"},
         {"Timing config", "aticonfig --glsync-getconfig", "AMDAticonfigglsyncconfigRawData"},
         {"Basic Firmware", "atiflash -i", "AMDAtifirmwareBasicRawData"},
         {"Detailed Firmware", "atiflash -ai", "AMDAtifirmwareDetailedRawData"}}};
    WriteToolOutputPage(*this, fNamespace, fOutputPath, page);
}

void TWriter::WriteNVSMILogReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    static const TToolPage page = {"WriteNVSMILogReport", "WriteNVSMILogReport", "nvsmilog", "NVIDIA GPU Info",
                                   "ORVSG_NVSMILog", {{"", "nvidia-smi -q", "NVSMILogRawData"}}};
    WriteToolOutputPage(*this, fNamespace, fOutputPath, page);
}

void TWriter::WriteCFTSettingReport(TBuilderPtr /*builder*/, std::string /*pageID*/) {
    static const TToolPage page = {
        "WriteCFTSettingData",
        "WriteCFTSettingData",
        "cft_setting",
        "CFT Settings",
        "ORVSG_CFTSetting",
        {{"All available CFT setting data ", "cft show all", "CftRawShowAll"},
         {"All default CFT setting data ", "cft showdefault all", "CftRawShowDefault"},
         {"All possible values for CFT setting", "cft showvalues", "CftRawShowValues"}}};
    WriteToolOutputPage(*this, fNamespace, fOutputPath, page);
}

}  // namespace braigrion
