// Shared steps of the storage controller pages; see StorageSupport.h.
#include "StorageSupport.h"

#include <exception>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace storage {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;

TWriter::TClassPtr ClassNamed(const TWriter::TNamespacePtr& ns, const std::string& className) {
    return ns->GetClass(className, TCIMContext());
}

TInstances InstancesOf(const TWriter::TNamespacePtr& ns, const std::string& className, bool deep) {
    TCIMContext context;
    TInstances instances;
    ns->GetClass(className, context)->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), deep, context);
    return instances;
}

TInstances Associated(const TWriter::TInstancePtr& instance, const std::string& assocClass,
                      const std::string& resultClass) {
    TInstances found;
    instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(found), assocClass, resultClass, "", "",
                                           TCIMContext());
    return found;
}

void SortByProperty(TInstances& instances, const std::string& property, bool ascending) {
    TInstanceSorter sorter;
    sorter.AddProperty(property, ascending, false);
    try {
        TWriterUtil::SortInstances(instances, sorter, true);
    } catch (const std::exception& ex) {
        Log(0, std::string("Error sorting: ") + ex.what());
    }
}

TWriter::TClassPtr ClassOf(const TWriter::TInstancePtr& instance) {
    return instance->GetClass(TCIMContext());
}

std::string ClassNameOf(const TWriter::TInstancePtr& instance) {
    TCIMContext context;
    return instance->GetClass(context)->GetClassName(context);
}

TReportProperty Row(const std::string& property, const std::string& label, const std::string& assocClass,
                    const std::string& assocTarget, const std::string& defaultValue) {
    return TReportProperty(property, "0%", assocClass, assocTarget, label, defaultValue);
}

std::vector<TReportProperty> Rows(const std::vector<std::string>& names) {
    std::vector<TReportProperty> rows;
    for (const std::string& name : names) rows.push_back(Row(name));
    return rows;
}

void WritePropertyRow(TWriter& writer, const TWriter::TInstancePtr& instance, const TReportProperty& property) {
    WriteMixedRow(writer, instance, property, instance, property);
}

void WriteMixedRow(TWriter& writer, const TWriter::TInstancePtr& labelInstance, const TReportProperty& label,
                   const TWriter::TInstancePtr& valueInstance, const TReportProperty& value) {
    writer.StartRow(true);
    writer.WriteHeaderCell(ClassOf(labelInstance), label);
    writer.WriteValueCell(valueInstance, value, "");
    writer.EndRow();
}

void WritePropertyTable(TWriter& writer, const TWriter::TInstancePtr& instance, const std::string& tableWidth,
                        const std::string& headerWidth, const std::string& caption,
                        const std::vector<TReportProperty>& rows) {
    writer.StartPropertyTable(tableWidth, headerWidth, caption);
    for (const TReportProperty& row : rows) WritePropertyRow(writer, instance, row);
    writer.EndTable();
}

void WriteNothingFound(TWriter& writer, const std::string& message, const std::string& label) {
    writer.StartPropertyTable("100%", "20%", "");
    writer.StartRow(true);
    writer.WriteMessageCell(TReportProperty(label, "100%", "", "", "", ""), message);
    writer.EndRow();
    writer.EndTable();
}

}  // namespace storage
}  // namespace braigrion
