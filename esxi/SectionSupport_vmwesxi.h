// What the ESXi sections share: fetching instances without letting a
// missing class or association stop a page, and the property grid (a label
// column and a value column) of hand-made tables.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "TWriter_vmwesxi.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {
namespace sections_vmwesxi {

typedef TWriter_vmwesxi::TInstancePtr TInstancePtr;
typedef std::vector<TInstancePtr> TInstances;

// The instances of a class and its subclasses; none when the collection
// lacks the class.
inline TInstances InstancesOf(const TReportParametersBuilder_vmwesxi& builder, const std::string& className) {
    TInstances instances;
    try {
        builder.GetClass(className)->EnumerateInstances(
            NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(instances), true, NORVTKR20::TCIMContext());
    } catch (const NORVTKR20::TTKRException& ex) {
        if (!IsNotFound(ex)) Trace("Exception when getting class " + className);
        instances.clear();
    }
    return instances;
}

// The instances of `resultClass` associated to `instance` through
// `assocClass`; none when the association cannot be walked.
inline TInstances Associated(const TInstancePtr& instance, const std::string& assocClass,
                             const std::string& resultClass) {
    TInstances found;
    try {
        instance->EnumerateAssociatedInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(found),
                                               assocClass, resultClass, "", "", NORVTKR20::TCIMContext());
    } catch (const NORVTKR20::TTKRException&) {
        found.clear();
    }
    return found;
}

inline std::string ClassNameOf(const TInstancePtr& instance) {
    NORVTKR20::TCIMContext context;
    return instance->GetClass(context)->GetClassName(context);
}

// A table of rows (label, value), labels in the first column.
inline TTable PropertyGrid(const std::vector<std::pair<std::string, std::string>>& rows,
                           const std::string& tableWidth, const std::string& headerWidth) {
    TTable table(static_cast<int>(rows.size()), 2, false);
    table.fRowHeaders = true;
    table.fColumnHeaders = false;
    table.fTableWidth = TReportParameters::ConvertPercent(tableWidth);
    table.fColumnWidths[0] = TReportParameters::ConvertPercent(headerWidth);
    table.fColumnWidths[1] = 100 - table.fColumnWidths[0];
    for (size_t i = 0; i < rows.size(); ++i) {
        table.Cell(static_cast<int>(i), 0).text = rows[i].first;
        table.Cell(static_cast<int>(i), 1).text = rows[i].second;
    }
    return table;
}

}  // namespace sections_vmwesxi
}  // namespace braigrion
