// The text back-end: the report as plain UTF-8 text, one file per page
// (its link name with ".txt") and index.txt listing the pages by category.
// Tables are printed as aligned columns within kLineWidth characters.
#pragma once

#include <string>

#include "TBackendWriter.h"

namespace braigrion {
namespace backends {

class TTextWriter : public TBackendWriter {
public:
    static const size_t kLineWidth = 120;

    TTextWriter();

    void WritePageHeader() override;
    void WritePageFooter() override;
    void WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) override;
    void WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                  const std::string& linkText) override;
    void WriteTableBreak() override;
    void WriteTableTitle(const std::string& title, const bool& subTitle, const bool& unused) override;
    void WriteTableGrid(TTable& table) override;
    // Keeps UTF-8; drops control characters other than line feed, turns a
    // tab into a blank and replaces bytes that are not UTF-8 by U+FFFD.
    std::string EscapeText(std::string text) override;
    // 0: ", "; 1: a line feed; 2: "; "; 3: a comma and a line feed; any
    // other number: ", ".
    std::string GetSeparatorText(int separator) override;

    static std::string PageFileName(const std::string& stem) { return stem + ".txt"; }

protected:
    std::string LinkedText(const std::string& text, const std::string& link) override;
    std::string MonospacedBlock(const std::string& text) override;
    void SavePage(const std::string& stem, const std::string& text) override;
    void WriteReportFiles() override;
    void FinishAbandonedPage() override;

private:
    // "file.txt" for a page's link name, a web address as it is, "" for
    // anything else.
    std::string LinkTarget(const std::string& link) const;

    size_t fGridEnd = 0;  // the page's length after its last grid
};

}  // namespace backends
}  // namespace braigrion
