// The ESXi table engine and value rendering: a declared table and its
// instances become cell grids for the back-end, by the rules of the base
// engine (same row selection, grid shapes and cell texts). The quirks the
// base engine keeps for classes of the base collectors (process figures,
// sensor readings in hundredths, install dates) have no ESXi page and are
// not repeated here, and no ESXi definition nests tables.
#include <algorithm>

#include "TWriter_vmwesxi.h"
#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/TOSSpecific.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TTKRException;

namespace {

typedef std::vector<std::string> TTexts;

bool IsRowReport(const TReportClass& reportClass) {
    return reportClass.GetReportStyle() == TReportClass::ROW_REPORT;
}

// An empty grid for `count` instances (see the base engine): a row report
// has a row per column and the labels in its first column; a column report
// a header row and the declared widths.
TTable LayOutGrid(const TReportClass& reportClass, int count) {
    const int columns = static_cast<int>(reportClass.GetProperties().size());
    const bool sortable = reportClass.IsTableSortable();
    if (IsRowReport(reportClass)) {
        TTable table(columns, count + 1, sortable);
        const int labelWidth = TReportParameters::ConvertPercent(reportClass.GetRowReportHeaderWidth());
        table.fColumnWidths[0] = labelWidth;
        for (int i = 1; i <= count; ++i) table.fColumnWidths[static_cast<size_t>(i)] = (100 - labelWidth) / count;
        table.fTableWidth = TReportParameters::ConvertPercent(reportClass.GetTableWidth());
        table.fRowHeaders = true;
        table.fColumnHeaders = true;
        table.fSortable = sortable;
        return table;
    }
    TTable table(count + 1, columns, sortable);
    for (int j = 0; j < columns; ++j) {
        table.fColumnWidths[static_cast<size_t>(j)] =
            TReportParameters::ConvertPercent(reportClass.GetProperties()[static_cast<size_t>(j)].GetColumnWidth());
    }
    table.fTableWidth = TReportParameters::ConvertPercent(reportClass.GetTableWidth());
    table.fSortable = sortable;
    table.fColumnHeaders = true;
    return table;
}

TTable::TCell& CellOf(TTable& table, bool rowReport, int index, int column) {
    return rowReport ? table.Cell(column, index + 1) : table.Cell(index + 1, column);
}

}  // namespace

bool TWriter_vmwesxi::HasNoTimePrecision(ICIMProperty& property) {
    TCIMContext context;
    boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> declaration = property.GetDeclaration(context);
    if (fCachingDates) {
        for (const auto& known : fDateQualifiers) {
            if (known.first == declaration) return known.second;
        }
    }
    bool found = true;
    try {
        bool propagated = false;
        declaration->GetQualifier("NOTIMEPRECISION", propagated, context);
    } catch (const TTKRException& ex) {
        // Its absence is an answer; any other failure is passed on.
        if (!IsNotFound(ex)) throw TTKRException(ex.fStatusCode);
        found = false;
    }
    if (fCachingDates) fDateQualifiers.push_back(std::make_pair(declaration, found));
    return found;
}

std::string TWriter_vmwesxi::GetValueFromProperty(TPropertyPtr property, std::string separator, bool useMappedText) {
    try {
        TCIMContext context;
        if (property->GetType(context) == TCIMValue::TCIMType::eDateTime) {
            const bool noTimePrecision = HasNoTimePrecision(*property);
            const TCIMValue& value = useMappedText ? property->GetValue() : property->GetValue(context);
            return TWriterUtil::GetDateTime(value, noTimePrecision);
        }
        if (property->IsArray(context)) {
            std::string text;
            std::vector<std::string> elements = property->GetValueStrings();
            for (size_t i = 0; i < elements.size(); ++i) {
                if (i > 0) text += separator;
                text += EscapeText(elements[i]);
            }
            return text;
        }
        if (useMappedText) return property->GetValueMapString();
        return EscapeText(property->GetValueString());
    } catch (const TTKRException&) {
        return std::string();
    }
}

std::string TWriter_vmwesxi::GetPropertyValue(TInstancePtr instance, std::string propertyName, std::string separator) {
    try {
        TPropertyPtr property = instance->GetProperty(propertyName, TCIMContext());
        if (!property) return std::string();
        return GetValueFromProperty(property, separator, false);
    } catch (const TTKRException&) {
        return std::string();
    }
}

std::string TWriter_vmwesxi::GetValuesFromProperties(std::vector<TPropertyPtr> properties,
                                                     const std::string& separator, bool useMappedText) {
    std::string text;
    for (size_t i = 0; i < properties.size(); ++i) {
        text += GetValueFromProperty(properties[i], separator, useMappedText);
        // No separator before an empty value, so empty values add no doubled separators.
        if (i + 1 < properties.size() && !properties[i + 1]->GetValueString().empty()) text += separator;
    }
    return text;
}

std::string TWriter_vmwesxi::GetTableHeaderLabel(ICIMClass& cls, TReportProperty property, TContext /*context*/) {
    if (property.HasLabelOverride()) return property.GetLabelOverride();
    TCIMContext empty;
    try {
        if (property.HasAssociationTarget()) {
            boost::shared_ptr<ICIMClass> target = fNamespace->GetClass(property.GetAssociationTarget(), empty);
            return TWriterUtil::GetDisplayName(target->GetPropertyDecl(property.GetProperty(), empty));
        }
        return TWriterUtil::GetDisplayName(cls.GetPropertyDecl(property.GetProperty(), empty));
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw TTKRException(ex.fStatusCode);
    }
    return property.GetProperty();
}

void TWriter_vmwesxi::WriteTable(TReportClass reportClass, std::vector<TInstancePtr> instances, bool /*isTopLevel*/,
                                 bool /*isAssociated*/, TContext context) {
    Trace("TWriter_vmwesxi::WriteTable -- Entering");
    Trace("TWriter_vmwesxi::WriteTable -- Current table title = " + reportClass.GetTitle());
    reportClass.Validate();
    // The declarations cannot change while one table is written.
    struct TDateCache {
        explicit TDateCache(TWriter_vmwesxi& writer) : fWriter(writer) { fWriter.fCachingDates = true; }
        ~TDateCache() {
            fWriter.fCachingDates = false;
            fWriter.fDateQualifiers.clear();
        }
        TWriter_vmwesxi& fWriter;
    } dateCache(*this);
    const std::vector<TReportProperty>& columns = reportClass.GetProperties();
    std::vector<std::string> separators;
    for (const TReportProperty& column : columns) separators.push_back(GetSeparatorText(column.GetArrayValueSeparator()));

    // The display and mapped texts of every column of one instance.
    auto read = [&](const TInstancePtr& instance, TTexts& a, TTexts& b) {
        a.assign(columns.size(), std::string());
        b.assign(columns.size(), std::string());
        for (size_t j = 0; j < columns.size(); ++j) {
            const TReportProperty& column = columns[j];
            std::vector<TPropertyPtr> properties = TWriterUtil::GetProperties(
                instance, column.GetProperty(), column.GetAssociationClass(), column.GetAssociationTarget());
            if (properties.empty() && column.HasSecondaryAssociationTarget()) {
                properties = TWriterUtil::GetProperties(instance, column.GetProperty(), "",
                                                        column.GetSecondaryAssociationTarget());
            }
            a[j] = GetValuesFromProperties(properties, separators[j], false);
            if (a[j].empty()) a[j] = column.GetPropertyDefaultValue();
            b[j] = GetValuesFromProperties(properties, separators[j], true);
        }
    };

    // Row selection: where a column's property asks for it, a row equal to
    // the one before it is shown once (a later duplicate with a mapped text
    // takes the place of a first row without one).
    bool merge = false;
    for (size_t i = 0; i < instances.size() && !merge; ++i) {
        for (const TReportProperty& column : columns) {
            for (const TPropertyPtr& property : TWriterUtil::GetProperties(
                     instances[i], column.GetProperty(), column.GetAssociationClass(), column.GetAssociationTarget())) {
                merge = merge || property->IsRowMergeProperty();
            }
        }
    }
    if (merge) {
        std::vector<TInstancePtr> kept;
        TTexts previousA, firstB, rowA, rowB;
        for (const TInstancePtr& instance : instances) {
            read(instance, rowA, rowB);
            if (kept.empty()) {
                previousA = rowA;
                firstB = rowB;
            } else if (rowA == previousA) {
                if (!rowB.empty() && !rowB[0].empty() && firstB[0].empty()) kept.back() = instance;
                continue;
            } else {
                previousA = rowA;
            }
            kept.push_back(instance);
        }
        instances.swap(kept);
    }

    if (reportClass.HasTitle()) WriteTableTitle(reportClass.GetTitle(), reportClass.SubTitleEnabled(), false);

    size_t perTable = instances.size();
    const int limit = reportClass.GetMaxInstancesPerTable();
    if (limit >= 1 && static_cast<size_t>(limit) < perTable) perTable = static_cast<size_t>(limit);
    const bool rowReport = IsRowReport(reportClass);
    TCIMContext empty;

    if (instances.empty()) {
        // Only a table that must stand without instances comes here: its
        // headings alone, labelled on the class when the collection has it.
        if (rowReport) {
            Trace("TWriter_vmwesxi::WriteTable -- Exiting");
            return;
        }
        TTable table = LayOutGrid(reportClass, 0);
        boost::shared_ptr<ICIMClass> cls;
        try {
            cls = fNamespace->GetClass(reportClass.GetClass(), empty);
        } catch (const TTKRException&) {
        }
        for (size_t j = 0; j < columns.size(); ++j) {
            table.Cell(0, static_cast<int>(j)).text =
                cls ? GetTableHeaderLabel(*cls, columns[j], context) : columns[j].GetProperty();
        }
        WriteTableGrid(table);
        WriteTableBreak();
        Trace("TWriter_vmwesxi::WriteTable -- Exiting");
        return;
    }

    TTexts a, b;
    for (size_t start = 0; start < instances.size(); start += perTable) {
        const size_t count = std::min(perTable, instances.size() - start);
        TTable table = LayOutGrid(reportClass, static_cast<int>(count));
        boost::shared_ptr<ICIMClass> cls = instances[start]->GetClass(empty);
        for (size_t j = 0; j < columns.size(); ++j) {
            CellOf(table, rowReport, -1, static_cast<int>(j)).text = GetTableHeaderLabel(*cls, columns[j], context);
        }
        for (size_t i = 0; i < count; ++i) {
            read(instances[start + i], a, b);
            for (size_t j = 0; j < columns.size(); ++j) {
                if (j == 0 && a[j].empty()) a[j] = "N/A";
                if (b[j] == a[j]) b[j].clear();
                TTable::TCell& cell = CellOf(table, rowReport, static_cast<int>(i), static_cast<int>(j));
                cell.monospaced = columns[j].IsMonospaced();
                cell.text.swap(a[j]);
                cell.rawText.swap(b[j]);
            }
        }
        if (rowReport) {
            table.fColumnHeaders = false;
            WriteTableGrid(table);
            table.fColumnHeaders = true;
        } else {
            WriteTableGrid(table);
        }
        WriteTableBreak();
    }
    Trace("TWriter_vmwesxi::WriteTable -- Exiting");
}

void TWriter_vmwesxi::WriteFirmwareTableHeader(TClassPtr cls) {
    const std::vector<TReportProperty> columns = {
        TReportProperty("ElementName", "25%", "", "", "Name", ""),
        TReportProperty("Manufacturer", "25%", "", "", "Manufacturer", ""),
        TReportProperty("VersionString", "25%", "", "", "VersionString", ""),
        TReportProperty("BuildNumber", "25%", "", "", "BuildNumber", ""),
    };
    WriteTableTitle("Firmware", false, false);
    StartTable("100%", "Firmware", true);
    StartRow(false);
    for (const TReportProperty& column : columns) WriteHeaderCell(cls, column);
    EndRow();
    EndTableHeader();
}

}  // namespace braigrion
