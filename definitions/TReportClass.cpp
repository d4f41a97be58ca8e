#include "braigrion/TReportClass.h"

#include <iostream>

#include "braigrion/TReportParameters.h"

namespace braigrion {

TReportClass::TReportClass()
    : fHasTitle(false),
      fSubTitleEnabled(false),
      fTableWidth("100%"),
      fReportStyle(COLUMN_REPORT),
      fHasAssociatedClass(false),
      fHasExcludeProps(false),
      fTableSortable(false),
      fMaxInstancesPerTable(kNoInstanceLimit) {}

void TReportClass::SetAssociatorsFilter(std::string assocClass, std::string resultClass, std::string role,
                                        std::string resultRole) {
    fAssocClass = assocClass;
    fResultClass = resultClass;
    fRole = role;
    fResultRole = resultRole;
}

void TReportClass::Reset() {
    fHasTitle = false;
    fSubTitleEnabled = false;
    fTableWidth = "100%";
    fAssocClass.clear();
    fResultClass.clear();
    fRole.clear();
    fResultRole.clear();
    fHasAssociatedClass = false;
    fHasExcludeProps = false;
    fReportStyle = COLUMN_REPORT;
    fInstanceSorter.Reset();
    fUniqueIdProperty.clear();
    fTableSortable = false;
    fMaxInstancesPerTable = kNoInstanceLimit;
    fPropertyFilters.clear();
}

void TReportClass::Validate() const {
    // Widths are not summed: only a column too narrow to show anything, or a
    // row report without room for its labels, is worth a line.
    if (fReportStyle != ROW_REPORT) {
        for (const TReportProperty& column : fProperties) {
            if (TReportParameters::ConvertPercent(column.GetColumnWidth()) < 2) {
                std::cout << "Report: column '" << column.GetProperty() << "' width is less than 2% for the "
                          << fTitle << " report definition (CIM class " << fClass << ")" << std::endl;
            }
        }
    } else if (TReportParameters::ConvertPercent(fRowReportHeaderWidth) == 0) {
        std::cout << "Report: Row report header width is 0% for the " << fTitle
                  << " report definition (CIM class " << fClass << ")" << std::endl;
    }
}

}  // namespace braigrion
