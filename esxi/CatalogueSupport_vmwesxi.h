// Short forms of the ESXi catalogue: its tables mostly carry an explicit
// table width and an instance limit, and many filter by a substring.
#pragma once

#include <string>

#include "definitions/CatalogueSupport.h"

namespace braigrion {
namespace catalogue {

// A column report of `className`; an empty title leaves the table untitled.
inline TReportClass Table(const std::string& className, const std::string& title, const std::string& tableWidth,
                          int perTable, const TColumns& columns) {
    TReportClass cls;
    cls.SetClass(className);
    if (!title.empty()) cls.SetTitle(title);
    cls.SetTableWidth(tableWidth);
    cls.SetMaxInstancesPerTable(perTable);
    cls.SetProperties(columns);
    return cls;
}

// A row report: one row per column, instances side by side.
inline TReportClass RowTable(const std::string& className, const std::string& title, const std::string& headerWidth,
                             const std::string& tableWidth, int perTable, const TColumns& columns) {
    TReportClass cls = Table(className, title, tableWidth, perTable, columns);
    RowReport(cls, headerWidth, tableWidth, perTable);
    return cls;
}

// Keeps only the instances whose `property` holds `text`.
inline TReportClass Keep(TReportClass cls, const std::string& property, const std::string& text) {
    cls.GetPropertyFilters().push_back(TReportClass::TPropertyFilter(text, property, false));
    return cls;
}

// Drops the instances whose `property` holds `text`.
inline TReportClass Drop(TReportClass cls, const std::string& property, const std::string& text) {
    cls.GetPropertyFilters().push_back(TReportClass::TPropertyFilter(text, property, true));
    return cls;
}

inline TReportClass SortedBy(TReportClass cls, const std::string& property, bool numeric = false) {
    cls.GetInstanceSorter().AddProperty(property, true, numeric);
    return cls;
}

inline TReportParameters PageOf(const std::string& linkName, const std::string& reportName, const TClasses& classes,
                                bool showTitle = true) {
    TReportParameters params = Page(linkName, reportName);
    params.SetShowReportTitle(showTitle);
    params.SetClasses(classes);
    return params;
}

// The placeholder table of a page whose data an ESXi host does not
// collect: the OEM extension data, by tag.
inline TReportClass TagTable(const std::string& title) {
    return Table("VMware_IPMIOEMExtensionData", title, "80%", 1000, {Column("Tag", "10%")});
}

}  // namespace catalogue
}  // namespace braigrion
