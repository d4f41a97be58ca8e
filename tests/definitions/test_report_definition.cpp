// The page definition model: value semantics, Reset and Validate. (Its
// defaults and constructors show in every catalogue definition.)
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "DefinitionDump.h"
#include "braigrion/TReportParameters.h"

namespace braigrion {
namespace {

typedef TReportParameters::TReportClass TReportClass;
typedef TReportParameters::TReportProperty TReportProperty;

// What `Validate` prints on standard output.
std::string ValidateOutput(const TReportClass& cls) {
    std::ostringstream captured;
    std::streambuf* saved = std::cout.rdbuf(captured.rdbuf());
    cls.Validate();
    std::cout.rdbuf(saved);
    return captured.str();
}

TReportProperty Column(const std::string& name, const std::string& width) {
    return TReportProperty(name, width, "", "", "", "");
}

TEST(ReportDefinition, ConvertPercentReadsLeadingDigits) {
    const std::pair<const char*, int> cases[] = {{"25%", 25}, {"100%", 100}, {"7", 7},   {"", 0},      {"x", 0},
                                                 {"%", 0},    {"12%3", 12},  {" 5%", 5}, {"-3%", -3}, {"0%", 0}};
    for (const auto& c : cases) EXPECT_EQ(c.second, TReportParameters::ConvertPercent(c.first)) << c.first;
}

TEST(ReportDefinition, ResetPreparesTheNextTableAndKeepsWhatBuildersReuse) {
    TReportClass cls;
    cls.SetClass("ORVSG_Processor");
    cls.SetTitle("Processors");
    cls.EnableSubTitle();
    cls.SetTableWidth("80%");
    cls.SetReportStyle(TReportClass::ROW_REPORT);
    cls.SetRowReportHeaderWidth("30%");
    cls.SetProperties({Column("Name", "50%")});
    cls.SetUniqueIdProperty("DeviceID");
    cls.SetAssociatedClass();
    cls.SetAssociatorsFilter("A", "R", "Ro", "RR");
    cls.ExcludeProps();
    cls.GetInstanceSorter().AddProperty("Name", true, false);
    cls.SetTableSortable();
    cls.SetAssociatedClasses(std::vector<TReportClass>(1));
    cls.SetMaxInstancesPerTable(1);
    cls.GetPropertyFilters().push_back(TReportClass::TPropertyFilter("Intel", "Manufacturer", false));

    cls.Reset();

    // Everything the dump shows went back to its default, except the class,
    // the columns and the nested tables, left for the builder to carry over
    // or set anew; so are the title text and the row header width.
    TReportParameters page;
    page.SetClasses({cls});
    EXPECT_EQ("page  \"\"\n  report title: hidden\n  link: plain\n"
              "table ORVSG_Processor\n  no title\n  column Name 50%\n  nested table \n    no title\n",
              testing::DumpDefinition(page));
    EXPECT_EQ("Processors", cls.GetTitle());
    EXPECT_EQ("30%", cls.GetRowReportHeaderWidth());
}

TEST(ReportDefinition, CopiesAreIndependent) {
    TReportParameters params;
    params.SetClasses(std::vector<TReportClass>(1));
    TReportParameters copy = params;
    params.GetClasses()[0].SetClass("changed");
    EXPECT_EQ("", copy.GetClasses()[0].GetClass());
}

TEST(ReportDefinition, ValidateReportsNarrowColumnsAndChangesNothing) {
    TReportClass cls;
    cls.SetClass("ORVSG_Fan");
    cls.SetTitle("Fans");
    cls.SetProperties({Column("Name", "1%"), Column("Speed", "2%"), Column("State", ""), Column("Bad", "x")});
    EXPECT_EQ("Report: column 'Name' width is less than 2% for the Fans report definition (CIM class ORVSG_Fan)\n"
              "Report: column 'State' width is less than 2% for the Fans report definition (CIM class ORVSG_Fan)\n"
              "Report: column 'Bad' width is less than 2% for the Fans report definition (CIM class ORVSG_Fan)\n",
              ValidateOutput(cls));
    EXPECT_EQ("1%", cls.GetProperties()[0].GetColumnWidth());

    // Widths are not summed.
    cls.SetProperties({Column("Name", "90%"), Column("Speed", "90%")});
    EXPECT_EQ("", ValidateOutput(cls));
}

TEST(ReportDefinition, ValidateRowReportLooksAtTheHeaderWidthOnly) {
    TReportClass cls;
    cls.SetClass("ORVSG_BIOS");
    cls.SetReportStyle(TReportClass::ROW_REPORT);
    cls.SetProperties({Column("Version", "0%"), Column("Vendor", "")});
    // No title set: the message keeps the two blanks around it.
    EXPECT_EQ("Report: Row report header width is 0% for the  report definition (CIM class ORVSG_BIOS)\n",
              ValidateOutput(cls));
    cls.SetRowReportHeaderWidth("40%");
    EXPECT_EQ("", ValidateOutput(cls));

    // A cleared title is still printed: only the flag went.
    cls.SetTitle("BIOS");
    cls.ClearTitle();
    cls.SetRowReportHeaderWidth("0%");
    EXPECT_EQ("Report: Row report header width is 0% for the BIOS report definition (CIM class ORVSG_BIOS)\n",
              ValidateOutput(cls));
}

}  // namespace
}  // namespace braigrion
