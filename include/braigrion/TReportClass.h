// One table of a report page: the CIM class whose instances it shows, how the
// table is laid out, how its instances are filtered and sorted, its columns,
// and the tables nested under each of its instances.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TReportProperty.h"

namespace braigrion {

class TReportClass {
public:
    enum ReportStyle {
        COLUMN_REPORT = 0,  // one row per instance, one column per property
        ROW_REPORT = 1      // one row per property, instances side by side
    };

    // Keeps or drops an instance by a substring of one property's text.
    class TPropertyFilter {
    public:
        TPropertyFilter(std::string value, std::string property, bool exclude)
            : fProperty(property), fExclude(exclude), fValue(value) {}
        std::string GetProperty() const { return fProperty; }
        bool IsExclude() const { return fExclude; }
        std::string GetValue() const { return fValue; }

    private:
        std::string fProperty;
        bool fExclude;  // true: a match drops the instance; false: a miss does
        std::string fValue;
    };

    static const int kNoInstanceLimit = 2147483647;

    TReportClass();

    void SetClass(std::string value) { fClass = value; }
    void SetTableWidth(std::string value) { fTableWidth = value; }
    void SetRowReportHeaderWidth(std::string value) { fRowReportHeaderWidth = value; }
    void SetUniqueIdProperty(std::string value) { fUniqueIdProperty = value; }
    void SetReportStyle(ReportStyle value) { fReportStyle = value; }
    void SetMaxInstancesPerTable(int value) { fMaxInstancesPerTable = value; }
    void SetProperties(std::vector<TReportProperty> value) { fProperties = value; }
    void SetAssociatedClasses(std::vector<TReportClass> value) { fAssociatedClasses = value; }
    void SetAssociatorsFilter(std::string assocClass, std::string resultClass, std::string role,
                              std::string resultRole);

    // The title text outlives ClearTitle; only the flag goes.
    void SetTitle(std::string value) {
        fTitle = value;
        fHasTitle = true;
    }
    void ClearTitle() { fHasTitle = false; }
    bool HasTitle() const { return fHasTitle; }
    void EnableSubTitle() { fSubTitleEnabled = true; }
    bool SubTitleEnabled() const { return fSubTitleEnabled; }

    // Flags that can only be switched on (Reset clears them).
    void SetAssociatedClass() { fHasAssociatedClass = true; }
    bool HasAssociatedClass() const { return fHasAssociatedClass; }
    void SetTableSortable() { fTableSortable = true; }
    bool IsTableSortable() const { return fTableSortable; }
    void ExcludeProps() { fHasExcludeProps = true; }
    bool HasExcludeProps() const { return fHasExcludeProps; }

    std::string GetClass() const { return fClass; }
    std::string GetTitle() const { return fTitle; }
    std::string GetTableWidth() const { return fTableWidth; }
    std::string GetRowReportHeaderWidth() const { return fRowReportHeaderWidth; }
    std::string GetUniqueIdProperty() const { return fUniqueIdProperty; }
    std::string GetAssocClass() const { return fAssocClass; }
    std::string GetResultClass() const { return fResultClass; }
    std::string GetRole() const { return fRole; }
    std::string GetResultRole() const { return fResultRole; }
    ReportStyle GetReportStyle() const { return fReportStyle; }
    int GetMaxInstancesPerTable() const { return fMaxInstancesPerTable; }

    std::vector<TReportProperty>& GetProperties() { return fProperties; }
    const std::vector<TReportProperty>& GetProperties() const { return fProperties; }
    std::vector<TReportClass>& GetAssociatedClasses() { return fAssociatedClasses; }
    const std::vector<TReportClass>& GetAssociatedClasses() const { return fAssociatedClasses; }
    TInstanceSorter& GetInstanceSorter() { return fInstanceSorter; }
    const TInstanceSorter& GetInstanceSorter() const { return fInstanceSorter; }
    // The builders append filters to this list directly.
    std::vector<TPropertyFilter>& GetPropertyFilters() { return fPropertyFilters; }
    const std::vector<TPropertyFilter>& GetPropertyFilters() const { return fPropertyFilters; }

    // Prepares the object for the next table of a page. The class name, the
    // title text, the row header width, the columns and the nested classes
    // stay: a builder sets what it needs anew.
    void Reset();
    // Prints one line on standard output for each width that cannot be
    // right; changes nothing and never fails.
    void Validate() const;

private:
    std::string fClass;
    std::string fTitle;
    bool fHasTitle;
    bool fSubTitleEnabled;
    std::string fTableWidth;
    ReportStyle fReportStyle;
    std::string fRowReportHeaderWidth;
    std::vector<TReportProperty> fProperties;
    std::string fUniqueIdProperty;  // stored and returned; no writer consults it
    bool fHasAssociatedClass;
    std::string fAssocClass;
    std::string fResultClass;
    std::string fRole;
    std::string fResultRole;
    bool fHasExcludeProps;
    TInstanceSorter fInstanceSorter;
    bool fTableSortable;
    std::vector<TReportClass> fAssociatedClasses;
    int fMaxInstancesPerTable;
    std::vector<TPropertyFilter> fPropertyFilters;
};

}  // namespace braigrion
