// What the adapter sections written as blocks of property tables share: the
// guarded fetch of a vendor class, its instances, and one block of label and
// value rows per instance. Internal to the report library.
#pragma once

#include <string>
#include <vector>

#include "braigrion/ReportDefinition.h"
#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace sections {

typedef std::vector<TWriter::TInstancePtr> TInstances;

// LUZ mode: the service mode with an HTML writer, where raw-data pages exist.
inline bool IsLuzMode(const std::string& mode, const std::string& writerType) {
    return mode == "luz" && writerType == TKR_REPORT_DEFINITION::TKR_WRITER_TYPE_HTML;
}

// The class `name`, or null when the repository cannot give it. An absent
// class writes `notFoundLine` to the trace; any other repository failure is
// passed over without a word. Failures of other kinds go to the caller.
inline TWriter::TClassPtr GuardedVendorClass(const TWriter::TNamespacePtr& ns, const std::string& name,
                                             const std::string& notFoundLine) {
    try {
        return ns->GetClass(name, NORVTKR20::TCIMContext());
    } catch (const NORVTKR20::TTKRException& ex) {
        if (IsNotFound(ex)) Trace(notFoundLine);
    }
    return TWriter::TClassPtr();
}

// The instances of `cls` and of its subclasses, in repository order; none
// for a null class.
inline TInstances DeepInstances(const TWriter::TClassPtr& cls) {
    TInstances instances;
    if (cls) cls->EnumerateInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(instances), true,
                                     NORVTKR20::TCIMContext());
    return instances;
}

// A row of a block: the property and, when not empty, its label. Without a
// label the declaration's display name is shown.
struct TBlockRow {
    const char* property;
    const char* label;
};

inline TReportProperty BlockColumn(const std::string& property, const std::string& label = "") {
    return TReportProperty(property, "0%", "", "", label, "");
}

// One property table for one instance: a row per property, the label from
// the class and the value by the generic rendering.
inline void WritePropertyBlock(TWriter& writer, const TWriter::TClassPtr& cls, const TWriter::TInstancePtr& instance,
                               const std::string& title, const std::vector<TReportProperty>& rows,
                               const std::string& tableWidth, const std::string& headerWidth) {
    writer.StartPropertyTable(tableWidth, headerWidth, title);
    for (const TReportProperty& row : rows) {
        writer.StartRow(true);
        writer.WriteHeaderCell(cls, row);
        writer.WriteValueCell(instance, row, "");
        writer.EndRow();
    }
    writer.EndTable();
}

// The columns of a block whose rows need no label of their own.
inline std::vector<TReportProperty> BlockColumns(const std::vector<std::string>& properties) {
    std::vector<TReportProperty> columns;
    for (const std::string& property : properties) columns.push_back(BlockColumn(property));
    return columns;
}

// The text of an instance's property by its value, in decimal; "" when it
// cannot be read.
inline std::string ValueText(const TWriter::TInstancePtr& instance, const std::string& property) {
    try {
        return instance->GetProperty(property, NORVTKR20::TCIMContext())->GetValue().ToString(10);
    } catch (...) {
        return std::string();
    }
}

}  // namespace sections
}  // namespace braigrion
