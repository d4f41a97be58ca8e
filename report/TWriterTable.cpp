// The generic table engine: a declared table and its instances become one
// or more cell grids for the back-end, with nested tables for associated
// classes.
#include <algorithm>
#include <sstream>

#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "ValueRendering.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::ICIMQualifier;
using NORVTKR20::TCIMValue;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;

namespace {

typedef std::vector<std::string> TTexts;

// Completion records of the default disk diagnostics are never shown.
bool IsLeftOut(const TWriter::TInstancePtr& instance) {
    TCIMContext context;
    return instance->GetClass(context)->GetClassName(context) == "LSIESG_DiskDefaultCompletionRecord";
}

// Whether some property behind some column asks for identical neighbouring
// rows to be shown once.
bool HasRowMergeProperty(const std::vector<TWriter::TInstancePtr>& instances,
                         const std::vector<TReportProperty>& columns) {
    for (const TWriter::TInstancePtr& instance : instances) {
        for (const TReportProperty& column : columns) {
            for (const TWriter::TPropertyPtr& property : TWriterUtil::GetProperties(
                     instance, column.GetProperty(), column.GetAssociationClass(), column.GetAssociationTarget())) {
                if (property->IsRowMergeProperty()) return true;
            }
        }
    }
    return false;
}

// The two texts of every column of one instance: `a` is the display text
// (or the column's default when empty), `b` the mapped text.
class TColumnReader {
public:
    TColumnReader(TWriter& writer, const std::vector<TReportProperty>& columns) : fWriter(writer), fColumns(columns) {
        for (const TReportProperty& column : columns) {
            fSeparators.push_back(writer.GetSeparatorText(column.GetArrayValueSeparator()));
        }
    }

    void Read(const TWriter::TInstancePtr& instance, TTexts& a, TTexts& b) {
        a.resize(fColumns.size());
        b.resize(fColumns.size());
        for (std::vector<TReportProperty>::size_type j = 0; j < fColumns.size(); ++j) {
            const TReportProperty& column = fColumns[j];
            std::vector<TWriter::TPropertyPtr> properties = TWriterUtil::GetProperties(
                instance, column.GetProperty(), column.GetAssociationClass(), column.GetAssociationTarget());
            if (properties.empty() && column.HasSecondaryAssociationTarget()) {
                properties = TWriterUtil::GetProperties(instance, column.GetProperty(), "",
                                                        column.GetSecondaryAssociationTarget());
            }
            a[j] = rendering::ValuesFromProperties(fWriter, properties, fSeparators[j], false, &fDates);
            if (a[j].empty()) a[j] = column.GetPropertyDefaultValue();
            b[j] = rendering::ValuesFromProperties(fWriter, properties, fSeparators[j], true, &fDates);
        }
    }

private:
    TWriter& fWriter;
    const std::vector<TReportProperty>& fColumns;
    TTexts fSeparators;
    rendering::TDateQualifierCache fDates;
};

// The rows a table shows: the instances, and on the duplicate-row path the
// texts already read for each of them.
struct TRows {
    std::vector<TWriter::TInstancePtr> instances;
    std::vector<TTexts> a;
    std::vector<TTexts> b;
    bool HasTexts() const { return !a.empty(); }
};

// Drops an instance whose texts equal those of the row before it. The first
// row's mapped texts are kept: when they begin empty, a duplicate whose
// first mapped text is not empty takes the place of the row it repeats.
TRows SelectDistinctRows(const std::vector<TWriter::TInstancePtr>& instances, TColumnReader& reader) {
    TRows rows;
    TTexts previousA;
    TTexts firstB;
    for (const TWriter::TInstancePtr& instance : instances) {
        if (IsLeftOut(instance)) continue;
        TTexts rowA;
        TTexts rowB;
        reader.Read(instance, rowA, rowB);
        if (rows.instances.empty()) {
            previousA = rowA;
            firstB = rowB;
        } else if (rowA == previousA) {
            if (!rowB.empty() && !rowB[0].empty() && firstB[0].empty()) {
                rows.instances.back() = instance;
                rows.a.back().swap(rowA);
                rows.b.back().swap(rowB);
            }
            continue;
        } else {
            previousA = rowA;
        }
        rows.instances.push_back(instance);
        rows.a.push_back(std::move(rowA));
        rows.b.push_back(std::move(rowB));
    }
    return rows;
}

TRows SelectAllRows(const std::vector<TWriter::TInstancePtr>& instances) {
    TRows rows;
    rows.instances.reserve(instances.size());
    for (const TWriter::TInstancePtr& instance : instances) {
        if (!IsLeftOut(instance)) rows.instances.push_back(instance);
    }
    return rows;
}

// A sensor reading stored in hundredths ("2375") as its value ("23.75"):
// the digits of the text, in order, make the number.
std::string ScaledReading(const std::string& text) {
    float number = 0;
    for (char c : text) {
        if (c != '\0' && std::string("1234567890").find(c) != std::string::npos) number = number * 10 + (c - '0');
    }
    std::ostringstream out;
    out << number / 100.0;
    return out.str();
}

// The last steps of a value cell, after its texts were read.
void FinishCell(TTable::TCell& cell, std::string a, std::string b, bool firstColumn, const TReportProperty& column,
                const std::string& className) {
    const std::string& property = column.GetProperty();
    if (a.empty()) a = column.GetPropertyDefaultValue();
    if (firstColumn && a.empty()) a = "N/A";
    if (b == a) b.clear();
    if (className == "ORVSG_Process") a = TWriterUtil::ConvertStrToNumType(a, property);
    if (property == "ProductInstallDate") {
        Trace("Property name = " + property);
        Trace("Property value = " + a);
        std::string::size_type midnight = a.find("00:00:00");
        if (midnight != std::string::npos) a.erase(midnight);
    }
    if (className == "CIM_NumericSensor" && property == "CurrentReading") a = ScaledReading(a);
    cell.monospaced = column.IsMonospaced();
    cell.text.swap(a);
    cell.rawText.swap(b);
}

bool IsRowReport(const TReportClass& reportClass) {
    return reportClass.GetReportStyle() == TReportClass::ROW_REPORT;
}

// An empty grid for `count` instances. A row report has a row per column
// with the labels in its first column, which keeps its declared width while
// the instances share the rest; a column report has a header row and the
// declared column widths. Every grid of a table is laid out alike, the
// last and shorter one at its own size.
TTable LayOutGrid(const TReportClass& reportClass, int count) {
    const int columns = static_cast<int>(reportClass.GetProperties().size());
    const bool sortable = reportClass.IsTableSortable();
    if (IsRowReport(reportClass)) {
        TTable table(columns, count + 1, sortable);
        const int labelWidth = TReportParameters::ConvertPercent(reportClass.GetRowReportHeaderWidth());
        table.fColumnWidths[0] = labelWidth;
        for (int i = 1; i <= count; ++i) table.fColumnWidths[static_cast<size_t>(i)] = (100 - labelWidth) / count;
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

// The cell of column `column` for instance `index` of the grid, or of its
// label when `index` is -1.
TTable::TCell& CellOf(TTable& table, bool rowReport, int index, int column) {
    return rowReport ? table.Cell(column, index + 1) : table.Cell(index + 1, column);
}

// The "Units" qualifier of a column's property, so that a back-end may show
// a size in bytes as a person reads it; "" when the property declares none.
std::string DeclaredUnit(ICIMNamespace& ns, ICIMClass& cls, const TReportProperty& column) {
    TCIMContext empty;
    try {
        TWriterUtil::TPropertyDeclPtr declaration =
            column.HasAssociationTarget()
                ? ns.GetClass(column.GetAssociationTarget(), empty)->GetPropertyDecl(column.GetProperty(), empty)
                : cls.GetPropertyDecl(column.GetProperty(), empty);
        bool propagated = false;
        boost::shared_ptr<const ICIMQualifier> units = declaration->GetQualifier("Units", propagated, empty);
        const TCIMValue& value = units->GetValue(empty);
        return value.IsNull() ? std::string() : static_cast<std::string>(value);
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return std::string();
}

}  // namespace

void TWriter::WriteTable(TReportClass reportClass, std::vector<TInstancePtr> instances, bool isTopLevel,
                         bool /*isAssociated*/, TContext context) {
    Trace("TWriter::WriteTable -- Entering");
    Trace("TWriter::WriteTable -- Current table title = " + reportClass.GetTitle());
    reportClass.Validate();

    const std::vector<TReportProperty>& columns = reportClass.GetProperties();
    TColumnReader reader(*this, columns);
    TRows rows = HasRowMergeProperty(instances, columns) ? SelectDistinctRows(instances, reader)
                                                          : SelectAllRows(instances);
    instances.clear();

    if (reportClass.HasTitle()) {
        const bool plain = false;
        WriteTableTitle(reportClass.GetTitle(), reportClass.SubTitleEnabled(), plain);
    }

    // A top-level table with nested tables shows one instance at a time,
    // each followed by its nested tables.
    const bool nested = reportClass.HasAssociatedClass() && isTopLevel;
    size_t perTable = rows.instances.size();
    const int limit = reportClass.GetMaxInstancesPerTable();
    if (nested) {
        perTable = 1;
    } else if (limit >= 1 && static_cast<size_t>(limit) < perTable) {
        perTable = static_cast<size_t>(limit);
    }

    const bool rowReport = IsRowReport(reportClass);
    const std::string className = reportClass.GetClass();
    TTexts a;
    TTexts b;
    TCIMContext empty;
    for (size_t start = 0; start < rows.instances.size(); start += perTable) {
        const size_t count = std::min(perTable, rows.instances.size() - start);
        TTable table = LayOutGrid(reportClass, static_cast<int>(count));

        boost::shared_ptr<ICIMClass> cls = rows.instances[start]->GetClass(empty);
        for (size_t j = 0; j < columns.size(); ++j) {
            CellOf(table, rowReport, -1, static_cast<int>(j)).text = GetTableHeaderLabel(*cls, columns[j], context);
            table.fUnits.push_back(fNamespace ? DeclaredUnit(*fNamespace, *cls, columns[j]) : std::string());
        }
        for (size_t i = 0; i < count; ++i) {
            const size_t row = start + i;
            if (rows.HasTexts()) {
                a.swap(rows.a[row]);
                b.swap(rows.b[row]);
            } else {
                reader.Read(rows.instances[row], a, b);
            }
            for (size_t j = 0; j < columns.size(); ++j) {
                FinishCell(CellOf(table, rowReport, static_cast<int>(i), static_cast<int>(j)), std::move(a[j]),
                           std::move(b[j]), j == 0, columns[j], className);
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

        if (!nested) continue;
        for (size_t i = 0; i < count; ++i) {
            for (const TReportClass& associated : reportClass.GetAssociatedClasses()) {
                std::vector<TInstancePtr> found;
                rows.instances[start + i]->EnumerateAssociatedInstances(
                    TAddToVectorCallback<ICIMInstance>(found), associated.GetAssocClass(),
                    associated.GetResultClass(), associated.GetRole(), associated.GetResultRole(), empty);
                try {
                    TWriterUtil::SortInstances(found, associated.GetInstanceSorter(), true);
                } catch (const std::exception& ex) {
                    TRootObject::GetCoreLogger()->Log(0, std::string("Error sorting: ") + ex.what());
                }
                WriteTable(associated, found, true, false, context);
            }
        }
    }
    Trace("TWriter::WriteTable -- Exiting");
}

TWriter::TClassIterator TWriter::ClassFilter(TClassIterator first, TClassIterator last) {
    return std::remove_if(first, last, [this](const TReportClass& reportClass) {
        TCIMContext empty;
        boost::shared_ptr<ICIMClass> cls;
        try {
            if (!fNamespace) return true;
            cls = fNamespace->GetClass(reportClass.GetClass(), empty);
        } catch (const std::exception&) {
            return true;
        }
        bool found = false;
        cls->EnumerateInstances(
            [&found, &reportClass](TInstancePtr instance) {
                found = TWriterUtil::PassesFilters(instance, reportClass);
                return !found;  // one passing instance is enough
            },
            true, empty);
        return !found;
    });
}

}  // namespace braigrion
