// The HTML back-end: a report directory that a browser opens. index.html
// shows the navigation (navbar.html) on the left and the pages in the frame
// "data_frame" on the right; each page is a file named by its link name,
// styled by global.css, its sortable tables sorted by tkr_sort.js.
#pragma once

#include <string>

#include "TBackendWriter.h"

namespace braigrion {
namespace backends {

class THtmlWriter : public TBackendWriter {
public:
    THtmlWriter();

    void WritePageHeader() override;
    // Closes the page; a page that printed no table says that no
    // information is available.
    void WritePageFooter() override;
    // With a link, the title carries the switch to the linked page (a raw
    // data page and its standard page link to each other this way). The
    // switch text and the link name may come in either order.
    void WriteReportTitle(const std::string& title, const std::string& link, const std::string& linkText) override;
    void WriteReportTitleWithLink(const std::string& title, const std::string& link,
                                  const std::string& linkText) override;
    void WriteTableBreak() override;
    // `subTitle` prints the title as a sub-title of the table before.
    void WriteTableTitle(const std::string& title, const bool& subTitle, const bool& unused) override;
    void WriteTableGrid(TTable& table) override;
    std::string EscapeText(std::string text) override;
    // 0: ", "; 1: a line break; 2: "; "; 3: a comma and a line break; any
    // other number: ", ".
    std::string GetSeparatorText(int separator) override;

    // The file name of a page's stem.
    static std::string PageFileName(const std::string& stem) { return stem + ".html"; }

protected:
    explicit THtmlWriter(const std::string& writerType);

    std::string LinkedText(const std::string& text, const std::string& link) override;
    std::string MonospacedBlock(const std::string& text) override;
    void SavePage(const std::string& stem, const std::string& text) override;
    void WriteReportFiles() override;
    void FinishAbandonedPage() override;

    // The head of a page; the inventory back-end has its own.
    virtual std::string PageHeader(bool sortHeader) const;

private:
    // The title with the switch to `target`, a page's link name or a web
    // address, shown as `text`.
    void WriteTitle(const std::string& title, const std::string& target, const std::string& text);
    std::string NavigationPage() const;
    std::string IndexPage() const;

    bool fPageHasSortable;
    // Where the last footer of the page stands and what it says.
    size_t fFooterAt = 0;
    std::string fFooterText;
};

}  // namespace backends
}  // namespace braigrion
