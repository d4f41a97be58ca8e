#include "DefinitionDump.h"

#include <sstream>

namespace braigrion {
namespace testing {

namespace {

void DumpColumn(const TReportProperty& column, const std::string& indent, std::ostringstream& out) {
    out << indent << "column " << column.GetProperty();
    if (!column.GetColumnWidth().empty()) out << " " << column.GetColumnWidth();
    if (column.HasAssociationClass() || column.HasAssociationTarget()) {
        out << " via " << column.GetAssociationClass() << " to " << column.GetAssociationTarget();
    }
    if (column.HasSecondaryAssociationTarget()) out << " then " << column.GetSecondaryAssociationTarget();
    if (column.HasLabelOverride()) out << ", label \"" << column.GetLabelOverride() << "\"";
    if (!column.GetPropertyDefaultValue().empty()) out << ", default \"" << column.GetPropertyDefaultValue() << "\"";
    if (column.GetArrayValueSeparator() != 0) out << ", separator " << column.GetArrayValueSeparator();
    if (column.IsMonospaced()) out << ", monospaced";
    out << "\n";
}

void DumpClass(const TReportClass& cls, int depth, std::ostringstream& out) {
    const std::string head(2 * depth, ' ');
    const std::string indent = head + "  ";
    out << head << (depth > 0 ? "nested table " : "table ") << cls.GetClass() << "\n";
    if (cls.HasTitle()) {
        out << indent << "title \"" << cls.GetTitle() << "\"\n";
    } else {
        out << indent << "no title\n";
    }
    if (cls.SubTitleEnabled()) out << indent << "sub-title\n";
    if (cls.GetReportStyle() == TReportClass::ROW_REPORT) {
        out << indent << "row report, header width " << cls.GetRowReportHeaderWidth() << "\n";
    } else if (cls.GetReportStyle() != TReportClass::COLUMN_REPORT) {
        out << indent << "report style " << cls.GetReportStyle() << "\n";
    }
    if (cls.GetTableWidth() != "100%") out << indent << "table width " << cls.GetTableWidth() << "\n";
    if (cls.GetMaxInstancesPerTable() != TReportClass::kNoInstanceLimit) {
        out << indent << "instances per table: " << cls.GetMaxInstancesPerTable() << "\n";
    }
    if (cls.IsTableSortable()) out << indent << "sortable\n";
    if (!cls.GetUniqueIdProperty().empty()) out << indent << "unique id " << cls.GetUniqueIdProperty() << "\n";
    for (const TInstanceSorter::TPropertyInfo& key : cls.GetInstanceSorter().GetProperties()) {
        out << indent << "sorted by " << key.Property << (key.Ascending ? "" : " descending")
            << (key.Numeric ? " numeric" : "") << (key.IgnoreCase ? " ignore-case" : "") << "\n";
    }
    if (cls.HasAssociatedClass()) out << indent << "reached by association\n";
    if (!cls.GetAssocClass().empty() || !cls.GetResultClass().empty() || !cls.GetRole().empty() ||
        !cls.GetResultRole().empty()) {
        out << indent << "associators filter: association class " << cls.GetAssocClass() << ", result class "
            << cls.GetResultClass();
        if (!cls.GetRole().empty()) out << ", role " << cls.GetRole();
        if (!cls.GetResultRole().empty()) out << ", result role " << cls.GetResultRole();
        out << "\n";
    }
    for (const TReportClass::TPropertyFilter& filter : cls.GetPropertyFilters()) {
        out << indent << (filter.IsExclude() ? "drop when " : "keep when ") << filter.GetProperty() << " contains \""
            << filter.GetValue() << "\"\n";
    }
    if (cls.HasExcludeProps()) out << indent << "excludes properties\n";
    for (const TReportProperty& column : cls.GetProperties()) DumpColumn(column, indent, out);
    for (const TReportClass& nested : cls.GetAssociatedClasses()) DumpClass(nested, depth + 1, out);
}

}  // namespace

std::string DumpDefinition(const TReportParameters& params) {
    std::ostringstream out;
    out << "page " << params.GetLinkName() << " \"" << params.GetReportName() << "\"\n";
    out << "  report title: " << (params.ShowReportTitle() ? "shown" : "hidden") << "\n";
    out << "  link: " << (params.GetLinkSortable() ? "sortable" : "plain") << "\n";
    for (const TReportClass& cls : params.GetClasses()) DumpClass(cls, 0, out);
    return out.str();
}

}  // namespace testing
}  // namespace braigrion
