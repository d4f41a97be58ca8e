// The tables of one instance that differs: the property differences as a
// grid of data sources against columns, and the "Missing from" and "Unique
// to" tables. A dependent instance is written under its parent.
#include <algorithm>

#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "delta/TClassDelta.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;

namespace {

const char kSame[] = "--- SAME ---";
const int kDataSourceWidth = 18;

TClassDelta::TContext AtIndex(const TClassDelta& owner, size_t index) {
    TClassDelta::TContext context = owner.GetContext();
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(index));
    return context;
}

// A cell of a source that agrees with the baseline: the literal text and
// all three display flags, which the back-ends show as agreement.
void MarkSame(TTable::TCell& cell) {
    cell.text = kSame;
    cell.flags[0] = cell.flags[1] = cell.flags[2] = true;
}

// One column of the differences: fed by a record or by a compared
// association column.
struct TDeltaColumn {
    const TReportProperty* column;
    TClassDelta::TInstancePtr record;          // empty for an association column
    const std::vector<std::string>* assocTexts;  // null for a record column
    int width;
};

// The width of a column on the page's scale: its declared width, or for a
// row report what the label column leaves, times the table's share.
int ColumnWidth(const TReportClass& reportClass, const TReportProperty& column) {
    const double factor = TReportParameters::ConvertPercent(reportClass.GetTableWidth()) / 100.0;
    const int declared = reportClass.GetReportStyle() == TReportClass::ROW_REPORT
                             ? 100 - TReportParameters::ConvertPercent(reportClass.GetRowReportHeaderWidth())
                             : TReportParameters::ConvertPercent(column.GetColumnWidth());
    return static_cast<int>(declared * factor);
}

// Splits the columns into tables that fit beside the data source column;
// each table takes at least one column.
std::vector<std::vector<TDeltaColumn>> SplitByWidth(const std::vector<TDeltaColumn>& columns) {
    std::vector<std::vector<TDeltaColumn>> tables;
    int sum = 0;
    for (const TDeltaColumn& column : columns) {
        if (tables.empty() || (!tables.back().empty() && sum + column.width > 100)) {
            tables.emplace_back();
            sum = kDataSourceWidth;
        }
        tables.back().push_back(column);
        sum += column.width;
    }
    return tables;
}

}  // namespace

TInstanceDelta::TInstanceDelta(boost::shared_ptr<TClassDelta> classDelta, const std::string& name)
    : fClassDelta(classDelta), fName(name), fDeltaTypes(0) {}

void TInstanceDelta::AddChild(const boost::shared_ptr<TInstanceDelta>& child) {
    if (child.get() == this) return;
    if (std::find(fChildren.begin(), fChildren.end(), child) == fChildren.end()) fChildren.push_back(child);
}

int TInstanceDelta::FirstSlot() const {
    for (size_t index = 0; index < fInstances.size(); ++index) {
        if (fInstances[index]) return static_cast<int>(index);
    }
    return -1;
}

boost::shared_ptr<TInstanceDelta> TInstanceDelta::FindDeltaInstanceWithDeltas(std::uint8_t type) {
    for (const TInstancePtr& record : fDeltas) {
        if (DeltaType(record) == type) return shared_from_this();
    }
    for (const boost::shared_ptr<TInstanceDelta>& child : fChildren) {
        boost::shared_ptr<TInstanceDelta> found = child->FindDeltaInstanceWithDeltas(type);
        if (found) return found;
    }
    return boost::shared_ptr<TInstanceDelta>();
}

bool TInstanceDelta::HasDeltaTypeBelow(std::uint8_t type) const {
    std::vector<const TInstanceDelta*> pending{this};
    TWritten seen;
    while (!pending.empty()) {
        const TInstanceDelta* entry = pending.back();
        pending.pop_back();
        if (!seen.insert(entry).second) continue;
        if (entry->fDeltaTypes & type) return true;
        for (const boost::shared_ptr<TInstanceDelta>& child : entry->fChildren) pending.push_back(child.get());
    }
    return false;
}

void TInstanceDelta::WriteIdentification(TWriter* writer, TInstancePtr instance, unsigned short index) {
    TReportClass reportClass = fClassDelta->GetReportClass();
    reportClass.ClearTitle();
    writer->WriteTable(reportClass, std::vector<TInstancePtr>{instance}, false, true, AtIndex(*fClassDelta, index));
}

void TInstanceDelta::WritePropertyDeltaTable(TWriter* writer) {
    TWritten written;
    WritePropertyDeltaTable(writer, written);
}

void TInstanceDelta::WritePropertyDeltaTable(TWriter* writer, TWritten& written) {
    if (!written.insert(this).second) return;
    TClassDelta& owner = *fClassDelta;
    TReportClass& reportClass = owner.GetReportClass();
    reportClass.ClearTitle();

    std::vector<TInstancePtr> records;
    for (const TInstancePtr& record : fDeltas) {
        if (DeltaType(record) == kDeltaProperty) records.push_back(record);
    }
    if (records.empty() && fAssocDeltas.empty()) {
        // Nothing of its own: the instance stands here to identify its dependents.
        const int slot = FirstSlot();
        if (slot >= 0) WriteIdentification(writer, fInstances[static_cast<size_t>(slot)], 0);
    } else {
        const size_t count = owner.NamespaceCount();
        TCIMReference baselinePath(owner.GetNamespace(), fName, AtIndex(owner, 0));
        TInstancePtr baseline = boost::dynamic_pointer_cast<ICIMInstance>(baselinePath.GetCIMElement(false));
        if (baseline && !fInstances.empty()) fInstances[0] = baseline;
        const int slot = FirstSlot();
        if (baseline) {
            WriteIdentification(writer, baseline, 0);
        } else if (slot >= 0) {
            WriteIdentification(writer, fInstances[static_cast<size_t>(slot)], static_cast<unsigned short>(slot));
        }
        writer->WriteTableTitle("Differences", true, true);

        // The sources to show. The baseline always has the first row; each
        // other marked source a row of its own after it, in index order.
        std::vector<bool> marked(count, false);
        for (const TInstancePtr& record : records) {
            for (unsigned short index : DeltaIndices(record)) {
                if (index < count) marked[index] = true;
            }
        }
        for (const auto& assoc : fAssocDeltas) {
            for (size_t index = 1; index < assoc.second.size() && index < count; ++index) {
                if (!assoc.second[index].empty()) marked[index] = true;
            }
        }
        std::vector<int> rowOf(count, 0);
        int rows = 2;
        if (count > 0) rowOf[0] = 1;
        for (size_t index = 1; index < count; ++index) {
            if (marked[index]) rowOf[index] = rows++;
        }

        std::vector<TDeltaColumn> columns;
        for (const TReportProperty& column : reportClass.GetProperties()) {
            TDeltaColumn entry{&column, TInstancePtr(), nullptr, ColumnWidth(reportClass, column)};
            for (const TInstancePtr& record : records) {
                if (DeltaText(record, "Property") == column.GetProperty()) {
                    entry.record = record;
                    break;
                }
            }
            if (!entry.record) {
                auto assoc = fAssocDeltas.find(column.GetProperty());
                if (assoc == fAssocDeltas.end()) continue;
                entry.assocTexts = &assoc->second;
            }
            columns.push_back(entry);
        }

        TInstancePtr labelled = baseline ? baseline : (slot >= 0 ? fInstances[static_cast<size_t>(slot)] : TInstancePtr());
        boost::shared_ptr<ICIMClass> cls;
        if (labelled) cls = labelled->GetClass(AtIndex(owner, 0));
        const std::vector<std::string>& labels = TClassDelta::GetDeltaContainerNames();
        for (const std::vector<TDeltaColumn>& part : SplitByWidth(columns)) {
            TTable table(rows, static_cast<int>(part.size()) + 1, true);
            table.fColumnHeaders = true;
            table.fFlagB = true;  // a grid of differences: row 1 is the baseline
            table.fTableWidth = TReportParameters::ConvertPercent(reportClass.GetTableWidth());
            int sum = kDataSourceWidth;
            for (const TDeltaColumn& column : part) sum += column.width;
            if (sum <= 0) sum = 1;
            table.fColumnWidths[0] = kDataSourceWidth * 100 / sum;
            table.Cell(0, 0).text = "Data Source";
            for (size_t index = 0; index < count; ++index) {
                if (index == 0 || marked[index]) {
                    table.Cell(rowOf[index], 0).text = writer->EscapeText(index < labels.size() ? labels[index] : "");
                }
            }
            for (size_t c = 0; c < part.size(); ++c) {
                const TDeltaColumn& column = part[c];
                const int col = static_cast<int>(c) + 1;
                table.fColumnWidths[static_cast<size_t>(col)] = column.width * 100 / sum;
                if (cls) table.Cell(0, col).text = writer->GetTableHeaderLabel(*cls, *column.column, AtIndex(owner, 0));
                const bool mono = column.column->IsMonospaced();
                if (column.assocTexts) {
                    const std::vector<std::string>& texts = *column.assocTexts;
                    for (size_t index = 0; index < texts.size() && index < count; ++index) {
                        if (index > 0 && texts[index].empty()) continue;
                        TTable::TCell& cell = table.Cell(rowOf[index], col);
                        cell.monospaced = mono;
                        if (index > 0 && texts[index] == texts[0]) {
                            MarkSame(cell);
                        } else {
                            cell.text = texts[index];
                        }
                    }
                    continue;
                }
                const std::string separator = writer->GetSeparatorText(column.column->GetArrayValueSeparator());
                std::vector<unsigned short> listed = DeltaIndices(column.record);
                // The baseline row shows the baseline's value even when a
                // record leaves it out.
                if (std::find(listed.begin(), listed.end(), 0) == listed.end()) listed.insert(listed.begin(), 0);
                for (unsigned short index : listed) {
                    if (index >= count || index >= fInstances.size() || !fInstances[index]) continue;
                    TTable::TCell& cell = table.Cell(rowOf[index], col);
                    cell.text = writer->GetValuesFromProperties(
                        TWriterUtil::GetProperties(fInstances[index], column.column->GetProperty(),
                                                   column.column->GetAssociationClass(),
                                                   column.column->GetAssociationTarget()),
                        separator, false);
                    // Process figures read as the process table shows them.
                    if (reportClass.GetClass() == "ORVSG_Process") {
                        cell.text = TWriterUtil::ConvertStrToNumType(cell.text, column.column->GetProperty());
                    }
                    cell.monospaced = mono;
                }
                for (size_t index = 1; index < count; ++index) {
                    if (!marked[index] || std::find(listed.begin(), listed.end(), index) != listed.end()) continue;
                    TTable::TCell& cell = table.Cell(rowOf[index], col);
                    cell.monospaced = mono;
                    MarkSame(cell);
                }
            }
            writer->WriteTableGrid(table);
        }
        writer->WriteTableBreak();
    }
    // Only dependents that differ themselves, or have dependents that do.
    for (const boost::shared_ptr<TInstanceDelta>& child : fChildren) {
        if (child->HasDeltaTypeBelow(kDeltaProperty)) child->WritePropertyDeltaTable(writer, written);
    }
}

void TInstanceDelta::WriteMissingOrExtraDeltaTable(TWriter* writer, bool missing) {
    TWritten written;
    WriteMissingOrExtraDeltaTable(writer, missing, false, written);
}

void TInstanceDelta::WriteMissingOrExtraDeltaTable(TWriter* writer, bool missing, bool parentShown,
                                                   TWritten& written) {
    if (!written.insert(this).second) return;
    const std::uint8_t type = missing ? kDeltaMissing : kDeltaUnique;
    TClassDelta& owner = *fClassDelta;
    // A dependent of a parent that is itself missing (or unique) goes with
    // it; one whose parent is shown only to place it gets its own table.
    const bool own = (fDeltaTypes & type) != 0 && (!owner.GetBackAssociatedClass() || !parentShown);
    const int slot = FirstSlot();
    if (own) {
        std::string title = missing ? "Missing from " : "Unique to ";
        boost::shared_ptr<TInstanceDelta> holder = FindDeltaInstanceWithDeltas(type);
        if (holder) {
            for (const TInstancePtr& record : holder->fDeltas) {
                if (DeltaType(record) != type) continue;
                const std::vector<std::string>& labels = TClassDelta::GetDeltaContainerNames();
                std::vector<unsigned short> indices = DeltaIndices(record);
                for (size_t i = 0; i < indices.size(); ++i) {
                    if (i > 0) title += ", ";
                    if (indices[i] < labels.size()) title += labels[indices[i]];
                }
                break;
            }
        }
        writer->WriteTableTitle(title, true, true);
        if (slot >= 0) {
            TReportClass reportClass = owner.GetReportClass();
            reportClass.ClearTitle();
            writer->WriteTable(reportClass, std::vector<TInstancePtr>{fInstances[static_cast<size_t>(slot)]}, false,
                               true, AtIndex(owner, static_cast<size_t>(slot)));
        }
    } else if ((fDeltaTypes & type) == 0 && !parentShown && slot >= 0) {
        // A parent that is present everywhere, shown above its dependents.
        WriteIdentification(writer, fInstances[static_cast<size_t>(slot)], static_cast<unsigned short>(slot));
    }
    const bool shown = (fDeltaTypes & type) != 0 || parentShown;
    for (const boost::shared_ptr<TInstanceDelta>& child : fChildren) {
        if (child->HasDeltaTypeBelow(type)) child->WriteMissingOrExtraDeltaTable(writer, missing, shown, written);
    }
    writer->WriteTableBreak();
}

}  // namespace braigrion
