// Short forms for writing page definitions as data. A catalogue entry reads
// as a list of columns and class settings; these helpers spell the column
// constructor's six arguments so that an entry shows only what it uses.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TReportParameters.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {
namespace catalogue {

typedef std::vector<TReportProperty> TColumns;
typedef std::vector<TReportClass> TClasses;

// Logs "<function> -- Entering" on construction and "-- Exiting" on the way out.
class TTrace {
public:
    explicit TTrace(const std::string& function) : fFunction(function) {
        NORVTKR20::TRootObject::GetCoreLogger()->Log(3, fFunction + " -- Entering");
    }
    ~TTrace() { NORVTKR20::TRootObject::GetCoreLogger()->Log(3, fFunction + " -- Exiting"); }
    TTrace(const TTrace&) = delete;
    TTrace& operator=(const TTrace&) = delete;

private:
    std::string fFunction;
};

// A page whose report name is written as its title, with a plain link.
inline TReportParameters Page(const std::string& linkName, const std::string& reportName) {
    TReportParameters params;
    params.SetShowReportTitle(true);
    params.SetLinkName(linkName);
    params.SetReportName(reportName);
    return params;
}

// A column of the table's own class. Row reports leave the width empty: the
// label column has the width and the values share the rest.
inline TReportProperty Column(const std::string& property, const std::string& width = "") {
    return TReportProperty(property, width, "", "", "", "");
}

inline TReportProperty Labelled(const std::string& property, const std::string& width, const std::string& label) {
    return TReportProperty(property, width, "", "", label, "");
}

// A column read from the instance reached through `assocClass`.
inline TReportProperty Via(const std::string& property, const std::string& width, const std::string& assocClass,
                           const std::string& target, const std::string& label = "") {
    return TReportProperty(property, width, assocClass, target, label, "");
}

// A column two steps away: through `assocClass` to `target`, then on to `secondTarget`.
inline TReportProperty ViaThen(const std::string& property, const std::string& width, const std::string& assocClass,
                               const std::string& target, const std::string& secondTarget) {
    TReportProperty column(property, width, assocClass, target, "", "");
    column.SetSecondaryAssociationTarget(secondTarget);
    return column;
}

// An array column whose values are joined by the given separator.
inline TReportProperty Separated(const std::string& property, const std::string& width,
                                 TReportProperty::ArrayValueSeparator separator) {
    TReportProperty column = Column(property, width);
    column.SetArrayValueSeparator(separator);
    return column;
}

// A column written in a fixed-pitch font: file contents, logs.
inline TReportProperty Monospaced(const std::string& property, const std::string& width = "") {
    TReportProperty column = Column(property, width);
    column.SetMonospaced();
    return column;
}

// Appends `more` to `columns`: the shared part of a column list and the part
// that depends on the collection are written as separate lists.
inline void Append(TColumns& columns, const TColumns& more) {
    columns.insert(columns.end(), more.begin(), more.end());
}

// The settings a row report table shares: label column width, table width,
// instances side by side per table.
inline void RowReport(TReportClass& cls, const std::string& headerWidth, const std::string& tableWidth,
                      int perTable) {
    cls.SetReportStyle(TReportClass::ROW_REPORT);
    cls.SetRowReportHeaderWidth(headerWidth);
    cls.SetTableWidth(tableWidth);
    cls.SetMaxInstancesPerTable(perTable);
}

}  // namespace catalogue
}  // namespace braigrion
