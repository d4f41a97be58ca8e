// The inventory back-end: pages kept in memory, in the inventory style
// (global_GUI.css and the inventory page heads), for a caller that shows
// one page at a time. Nothing is written to disk.
#pragma once

#include <string>

#include "THtmlWriter.h"

namespace braigrion {
namespace backends {

class TInventoryWriter : public THtmlWriter {
public:
    TInventoryWriter();

    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override;
    // The text of what was written since the last call (or since
    // Initialize): the page, and any page the page wrote beside it.
    std::string GetInventoryPage() override;

protected:
    std::string PageHeader(bool sortHeader) const override;
    bool WritesDocuments() const override { return false; }
    void SavePage(const std::string& stem, const std::string& text) override;
    void WriteReportFiles() override;
    bool WritesListedPages() const override { return false; }

private:
    std::string fText;
};

}  // namespace backends
}  // namespace braigrion
