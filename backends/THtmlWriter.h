// The HTML back-end: a report directory that a browser opens. index.html
// shows the navigation (navbar.html) on the left and the pages in the frame
// "data_frame" on the right; each page is a file named by its link name,
// styled by global.css, its sortable tables sorted by tkr_sort.js.
#pragma once

#include <string>

#include "ReportIdentity.h"
#include "TBackendWriter.h"

namespace braigrion {
namespace backends {

class THtmlWriter : public TBackendWriter {
public:
    THtmlWriter();

    // Also reads what names the machine, for the window titles and the
    // navigation's heading.
    void Initialize(TNamespacePtr ns, TContext context, const std::string& outputPath) override;
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

    // A sortable table of more body rows than this comes with its rows as
    // data and shows them a page at a time; a smaller one stands whole in
    // the page, where the browser's own find sees every row.
    static const int kWholeTableRows = 10000;
    // A table of more body rows than this takes its column widths from its
    // header, not from measuring every cell.
    static const int kFixedLayoutRows = 1000;

protected:
    explicit THtmlWriter(const std::string& writerType);

    std::string LinkedText(const std::string& text, const std::string& link) override;
    std::string MonospacedBlock(const std::string& text) override;
    void SavePage(const std::string& stem, const std::string& text) override;
    void WriteReportFiles() override;
    void FinishAbandonedPage() override;

    // What closes a page: its body and document.
    std::string PageEnd() const;
    // The head of a page; the inventory back-end has its own.
    virtual std::string PageHeader(bool sortHeader) const;
    // Whether pages are documents of their own: a doctype, a language, a
    // head with the title, the report's script and the way back to the
    // index. The inventory back-end's pages are parts of another program's
    // page and keep their plain form.
    virtual bool WritesDocuments() const { return true; }

private:
    // The title with the switch to `target`, a page's link name or a web
    // address, shown as `text`.
    void WriteTitle(const std::string& title, const std::string& target, const std::string& text);
    std::string NavigationPage() const;
    std::string IndexPage() const;
    // The id of a table title on the open page: its words in lower case
    // joined by "-", made unique on the page.
    std::string TitleAnchor(const std::string& title);
    // The rows of a big table as the data its script shows.
    void WriteTableData(const TTable& table, int firstBodyRow);

    bool fPageHasSortable;
    // Where the last footer of the page stands and what it says.
    size_t fFooterAt = 0;
    std::string fFooterText;
    TReportIdentity fIdentity;
    std::string fHighlightsPage;  // stem of the page with the report highlights table, "" while none
    std::string fHighlightsAnchor;
    std::vector<std::string> fPageAnchors;
};

}  // namespace backends
}  // namespace braigrion
