#include "TInventoryWriter.h"

#include "braigrion/ReportDefinition.h"

namespace braigrion {
namespace backends {

using namespace TKR_REPORT_DEFINITION;

TInventoryWriter::TInventoryWriter() : THtmlWriter(TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_INVENTORY) {}

void TInventoryWriter::Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) {
    THtmlWriter::Initialize(ns, context, outputPath);
    fText.clear();
}

std::string TInventoryWriter::GetInventoryPage() {
    if (fPageOpen) ClosePage();
    std::string text;
    text.swap(fText);
    return text;
}

std::string TInventoryWriter::PageHeader(bool sortHeader) const {
    return sortHeader ? kHtmlSortHeaderUTF8_Inventory + kHtmlSortScript : kHtmlHeaderUTF8_Inventory;
}

void TInventoryWriter::SavePage(const std::string& /*stem*/, const std::string& text) {
    fText += text;
}

void TInventoryWriter::WriteReportFiles() {}

}  // namespace backends
}  // namespace braigrion
