// The page definition model: defaults, value semantics, Reset and Validate.
#include <iostream>
#include <sstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

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
    struct TCase {
        const char* text;
        int expected;
    };
    const TCase cases[] = {{"25%", 25}, {"100%", 100}, {"7", 7},   {"", 0},      {"x", 0},
                           {"%", 0},    {"12%3", 12},  {" 5%", 5}, {"-3%", -3}, {"0%", 0}};
    for (const TCase& c : cases) EXPECT_EQ(c.expected, TReportParameters::ConvertPercent(c.text)) << c.text;
}

TEST(ReportDefinition, DefaultsOfAFreshDefinition) {
    TReportParameters params;
    EXPECT_FALSE(params.ShowReportTitle());
    EXPECT_EQ("", params.GetLinkName());
    EXPECT_FALSE(params.GetLinkSortable());
    EXPECT_TRUE(params.GetClasses().empty());

    TReportClass cls;
    EXPECT_EQ("100%", cls.GetTableWidth());
    EXPECT_EQ(TReportClass::COLUMN_REPORT, cls.GetReportStyle());
    EXPECT_EQ(2147483647, cls.GetMaxInstancesPerTable());
    EXPECT_FALSE(cls.HasTitle());
    EXPECT_TRUE(cls.GetInstanceSorter().IsEmpty());
}

TEST(ReportDefinition, PropertyConstructorTakesAssociationClassBeforeTarget) {
    TReportProperty p("SlotDesignation", "20%", "ORVSG_DeviceInSlot", "ORVSG_SystemSlot", "Slot", "n/a");
    EXPECT_EQ("SlotDesignation", p.GetProperty());
    EXPECT_EQ("20%", p.GetColumnWidth());
    EXPECT_EQ("ORVSG_DeviceInSlot", p.GetAssociationClass());
    EXPECT_EQ("ORVSG_SystemSlot", p.GetAssociationTarget());
    EXPECT_EQ("Slot", p.GetLabelOverride());
    EXPECT_EQ("n/a", p.GetPropertyDefaultValue());
    EXPECT_EQ("", p.GetSecondaryAssociationTarget());
    EXPECT_EQ(0, p.GetArrayValueSeparator());
    EXPECT_FALSE(p.IsMonospaced());
    EXPECT_TRUE(p.HasAssociationClass());
    EXPECT_TRUE(p.HasAssociationTarget());
    EXPECT_TRUE(p.HasLabelOverride());
    EXPECT_FALSE(p.HasSecondaryAssociationTarget());

    TReportProperty plain = Column("Name", "30%");
    EXPECT_FALSE(plain.HasAssociationClass());
    EXPECT_FALSE(plain.HasAssociationTarget());
    EXPECT_FALSE(plain.HasLabelOverride());

    // The filter takes its value before its property.
    TReportClass::TPropertyFilter filter("Microsoft", "ProductVendor", true);
    EXPECT_EQ("ProductVendor", filter.GetProperty());
    EXPECT_EQ("Microsoft", filter.GetValue());
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
    std::vector<TReportClass> nested(1);
    cls.SetAssociatedClasses(nested);
    cls.SetMaxInstancesPerTable(1);
    cls.GetPropertyFilters().push_back(TReportClass::TPropertyFilter("Intel", "Manufacturer", false));

    cls.Reset();

    EXPECT_FALSE(cls.HasTitle());
    EXPECT_EQ("Processors", cls.GetTitle());
    EXPECT_FALSE(cls.SubTitleEnabled());
    EXPECT_EQ("100%", cls.GetTableWidth());
    EXPECT_EQ(TReportClass::COLUMN_REPORT, cls.GetReportStyle());
    EXPECT_EQ("", cls.GetUniqueIdProperty());
    EXPECT_FALSE(cls.HasAssociatedClass());
    EXPECT_EQ("", cls.GetAssocClass());
    EXPECT_EQ("", cls.GetResultClass());
    EXPECT_EQ("", cls.GetRole());
    EXPECT_EQ("", cls.GetResultRole());
    EXPECT_FALSE(cls.HasExcludeProps());
    EXPECT_TRUE(cls.GetInstanceSorter().IsEmpty());
    EXPECT_FALSE(cls.IsTableSortable());
    EXPECT_EQ(2147483647, cls.GetMaxInstancesPerTable());
    EXPECT_TRUE(cls.GetPropertyFilters().empty());
    // Left for the builder to carry over or set anew.
    EXPECT_EQ("ORVSG_Processor", cls.GetClass());
    EXPECT_EQ("30%", cls.GetRowReportHeaderWidth());
    EXPECT_EQ(1u, cls.GetProperties().size());
    EXPECT_EQ(1u, cls.GetAssociatedClasses().size());
}

TEST(ReportDefinition, ListsHoldCopies) {
    TReportParameters params;
    TReportClass cls;
    std::vector<TReportClass> classes;

    cls.SetClass("A");
    classes.push_back(cls);
    params.SetClasses(classes);
    cls.SetClass("B");
    cls.SetTitle("changed after the push");
    classes.push_back(cls);
    params.SetClasses(classes);
    cls.SetClass("C");
    classes.push_back(cls);
    params.SetClasses(classes);

    // The last assignment wins and holds all three; later changes to the
    // local object did not reach the copies.
    ASSERT_EQ(3u, params.GetClasses().size());
    EXPECT_EQ("A", params.GetClasses()[0].GetClass());
    EXPECT_FALSE(params.GetClasses()[0].HasTitle());
    EXPECT_EQ("B", params.GetClasses()[1].GetClass());
    EXPECT_EQ("C", params.GetClasses()[2].GetClass());

    params.SetClasses(std::vector<TReportClass>(1));
    EXPECT_EQ(1u, params.GetClasses().size());

    // A definition returned by value is independent of the one it came from.
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
    EXPECT_EQ(4u, cls.GetProperties().size());
    EXPECT_EQ("1%", cls.GetProperties()[0].GetColumnWidth());

    // Widths are not summed.
    TReportClass wide;
    wide.SetClass("ORVSG_Fan");
    wide.SetProperties({Column("Name", "90%"), Column("Speed", "90%")});
    EXPECT_EQ("", ValidateOutput(wide));
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
