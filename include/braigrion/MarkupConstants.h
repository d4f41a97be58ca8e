// Fragments of mark-up from which the HTML back-end and a few section
// writers build their pages: page heads, the index, table frames and the
// standard texts of a page without data. Like the page names, each
// translation unit that includes this header gets its own set, initialised
// in the order written here when it is loaded.
#pragma once

#include <string>

namespace TKR_REPORT_DEFINITION {

// Style sheets; the quotes belong to the values.
const std::string kHtmlCSSFile = "\"global.css\"";
const std::string kHtmlCSSFile_Inventory = "\"global_GUI.css\"";

// The navigation index.
const std::string kHtmlIndexLine = "";
const std::string kHtmlIndexCatBeg = "<TR><TH>&nbsp;";
const std::string kHtmlIndexCatEnd = "</TH></TR>\n";
const std::string kHtmlIndexFooter = "</TBODY>\n</TABLE>\n</BODY>\n</HTML>\n";

const std::string kHtmlSortScript = "<script src=\"tkr_sort.js\"></script>\n";
const std::string kHtmlFooter = "</html>\n";
const std::string kReporTitleBeg = "<div class=\"pageheader\">";
const std::string kReporTitleEnd = "</div>";

// The navigation bar.
const std::string kNavBarName = "navbar.html";
const std::string kNavBegin = "<TR><TD><FONT face=Arial color=#707070 size=-1>&nbsp;&nbsp;&nbsp;";
const std::string kNavEnd = "</FONT></TD></TR>";
const std::string kNavLinkBegin = "<a href=";
const std::string kNavLinkMid = " target=\"data_frame\">";
const std::string kNavLinkEnd = "</a>";

// Tables.
const std::string kTableTitleBeg = "<br><div class=\"tabletitle\">";
const std::string kTableSubTitleBeg = "<div class=\"tablesubtitle\">";
const std::string kRowTableHeaderBeg = "<table class=\"rowtable";
const std::string kColTableHeaderBeg = "<table class=\"coltable";
const std::string kTableHeaderWidth = "\" width=\"";
const std::string kTableHeaderMid = "\" id=\"";
const std::string kTableHeaderSort = " sortable";
const std::string kTableHeaderEnd = "\" border=\"0\" cellspacing=\"1\" cellpadding=\"1\">\n";
const std::string kTableRowBeg = "<tr";
const std::string kTableRowMid = ">";
const std::string kTableRowEnd = "</tr>";
const std::string kTableFooter = "</table>";
const std::string kTableHeaderElementBegin = "<th class=\"tableheader\" width=\"";
const std::string kDeltaTableHeaderElementBegin = "<th class=\"deltatableheader\" width=\"";
const std::string kTableHeaderElementMid = "\">";
const std::string kTableHeaderElementEnd = "</th>";

// What a page without data or without critical details says.
const std::string kNoInfoText1 = "<br><p>No information is available for this section.";
const std::string kNoInfoText2 =
    "You may not have the applicable hardware or a problem may have occurred while gathering the data.";
const std::string kNoInfoText3 =
    "If you suspect this is due to an error, click the TKR Error Log button on the left for more details.</p><br>";
const std::string kNoCriticalDetailsText = "<br><p >No critical error messages were found.</p><br>";

// Links between a standard page and its raw-data page.
const std::string kTKRShowRawData = " - [Show Rawdata Report]";
const std::string kTKRShowStandard = " - [Show Standard Report]";

// Pieces of the page heads. The saved-from comment keeps its length field
// as it is and, unlike every other piece, ends in a carriage return and a
// line feed.
namespace markup_pieces {
const std::string kHtml = "<html>\n";
const std::string kHead = "<head>\n";
const std::string kHeadEnd = "</head>\n";
const std::string kMeta = "<meta content=\"text/html; charset=utf-8\" http-equiv=\"Content-Type\">\n";
const std::string kSavedFrom = "<!-- saved from url=(0024)https://www.example.com/ -->\r\n";
const std::string kBody = "<body bgcolor=\"#ffffff\">\n";
const std::string kBodyInventory = "<body bgcolor=\"#ffffff\" oncontextmenu=\"return false;\" >\n";
const std::string kLink = "<link href=" + kHtmlCSSFile + " rel=\"stylesheet\" type=\"text/css\">\n";
const std::string kLinkInventory = "<link href=" + kHtmlCSSFile_Inventory + " rel=\"stylesheet\" type=\"text/css\">\n";
}  // namespace markup_pieces

// Page heads. The body line stands ahead of "</head>" and the style sheet
// link behind it in every form; the sorting heads of the inventory writer
// use the plain body line.
const std::string kHtmlHeader = markup_pieces::kHtml + markup_pieces::kHead + markup_pieces::kBody +
                                markup_pieces::kHeadEnd + markup_pieces::kLink;
const std::string kHtmlHeader_Inventory = markup_pieces::kHtml + markup_pieces::kHead +
                                          markup_pieces::kBodyInventory + markup_pieces::kHeadEnd +
                                          markup_pieces::kLinkInventory;
const std::string kHtmlHeaderUTF8 = markup_pieces::kHtml + markup_pieces::kHead + markup_pieces::kBody +
                                    markup_pieces::kMeta + markup_pieces::kHeadEnd + markup_pieces::kLink;
const std::string kHtmlHeaderUTF8_Inventory = markup_pieces::kHtml + markup_pieces::kHead +
                                              markup_pieces::kBodyInventory + markup_pieces::kMeta +
                                              markup_pieces::kHeadEnd + markup_pieces::kLinkInventory;
const std::string kHtmlSortHeader = markup_pieces::kHtml + markup_pieces::kHead + markup_pieces::kSavedFrom +
                                    markup_pieces::kBody + markup_pieces::kHeadEnd + markup_pieces::kLink;
const std::string kHtmlSortHeader_Inventory = markup_pieces::kHtml + markup_pieces::kHead +
                                              markup_pieces::kSavedFrom + markup_pieces::kBody +
                                              markup_pieces::kHeadEnd + markup_pieces::kLinkInventory;
const std::string kHtmlSortHeaderUTF8 = markup_pieces::kHtml + markup_pieces::kHead + markup_pieces::kMeta +
                                        markup_pieces::kSavedFrom + markup_pieces::kBody + markup_pieces::kHeadEnd +
                                        markup_pieces::kLink;
const std::string kHtmlSortHeaderUTF8_Inventory = markup_pieces::kHtml + markup_pieces::kHead +
                                                  markup_pieces::kMeta + markup_pieces::kSavedFrom +
                                                  markup_pieces::kBody + markup_pieces::kHeadEnd +
                                                  markup_pieces::kLinkInventory;

// The head of the navigation index; here the link line closes with "</link>".
const std::string kHtmlIndexHeader = "<html>\n<head>\n<BODY bgColor=#ffffff leftMargin=1 topMargin=0>\n<link href=" +
                                     kHtmlCSSFile + " rel=\"stylesheet\" type=\"text/css\"></link>\n" +
                                     "<TABLE id=\"navbar\" cellSpacing=0 cellPadding=2 border=0>\n<TBODY>\n";
const std::string kHtmlIndexHeader_Inventory =
    "<html>\n<head>\n<BODY bgColor=#ffffff leftMargin=1 topMargin=0>\n<link href=" + kHtmlCSSFile_Inventory +
    " rel=\"stylesheet\" type=\"text/css\"></link>\n" + "<TABLE id=\"navbar\" cellSpacing=0 cellPadding=2 border=0>\n" +
    "<TBODY>\n";

}  // namespace TKR_REPORT_DEFINITION
