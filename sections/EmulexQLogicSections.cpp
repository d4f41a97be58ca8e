// The Emulex and QLogic adapter pages: declared pages (firmware, boot code,
// driver) that in LUZ mode put the page of the vendor tool's raw output in
// front and link to it from their title.
#include "MellanoxBlocks.h"

namespace braigrion {

using sections::IsLuzMode;

// The one scheme of both pages. `vendor` names the vendor in the trace lines,
// `writeRaw` writes the raw page and gives its link name ("" for none).
template <typename TWriteRaw>
static void WriteAdapterWithRawData(TWriter& writer, bool luz, TReportParameters params, const std::string& vendor,
                                    TWriteRaw writeRaw) {
    const std::string name = "TWriter::Write" + vendor + "Report";
    if (!luz) {
        Trace(name + " -- Writing generic " + vendor + " report");
        writer.WriteGenericReport(params);
        return;
    }
    Trace(name + " -- Under LUZ mode, write RawData first");
    std::string link;
    try {
        link = writeRaw(params.GetLinkName());
    } catch (...) {
        Trace(name + " -- Exception when generating " + vendor + " Raw Data");
        link.clear();
    }
    if (link.empty()) {
        Trace(name + " -- Write" + vendor + "RawDataReport Faild");
        writer.WriteGenericReport(params);
    } else {
        Trace(name + " -- Write" + vendor + "RawDataReport Success");
        writer.WriteGenericReportWithLink(params, link);
    }
}

void TWriter::WriteEmulexReport(TBuilderPtr builder, std::string /*pageID*/) {
    WriteAdapterWithRawData(*this, IsLuzMode(fMode, fWriterType), builder->BuildEmulexParams(), "Emulex",
                            [this](const std::string& link) { return WriteEmulexRawDataReport(link); });
}

void TWriter::WriteQLogicReport(TBuilderPtr builder, std::string /*pageID*/) {
    WriteAdapterWithRawData(*this, IsLuzMode(fMode, fWriterType), builder->BuildQlogicParams(), "QLogic",
                            [this](const std::string& link) { return WriteQLogicRawDataReport(link); });
}

}  // namespace braigrion
