// What the storage controller pages share: fetching classes, instances and
// associated instances, the row of a property table, and the guarded call of
// a raw-data writer whose link goes into a page title. Internal to the
// report library.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TReportProperty.h"
#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"

namespace braigrion {
namespace storage {

typedef std::vector<TWriter::TInstancePtr> TInstances;

// The class of this name; throws what the repository throws (status 15 for
// a class the collection lacks).
TWriter::TClassPtr ClassNamed(const TWriter::TNamespacePtr& ns, const std::string& className);
// The instances of the class and, with `deep`, of its subclasses.
TInstances InstancesOf(const TWriter::TNamespacePtr& ns, const std::string& className, bool deep = true);
// The instances of `resultClass` reached from `instance` through
// `assocClass`; throws what the repository throws.
TInstances Associated(const TWriter::TInstancePtr& instance, const std::string& assocClass,
                      const std::string& resultClass);
// The instances ordered by one property, ascending, ties kept in order.
// A sort that fails leaves them as they were.
void SortByProperty(TInstances& instances, const std::string& property, bool ascending);

TWriter::TClassPtr ClassOf(const TWriter::TInstancePtr& instance);
std::string ClassNameOf(const TWriter::TInstancePtr& instance);

// A row of a property table: the property itself, or with an association
// the property of what it reaches. Rows have no width of their own.
TReportProperty Row(const std::string& property, const std::string& label = "", const std::string& assocClass = "",
                    const std::string& assocTarget = "", const std::string& defaultValue = "");

// Rows of the properties named, in order.
std::vector<TReportProperty> Rows(const std::vector<std::string>& names);

// One row of a property table: the label of `property` as declared in the
// class of `instance`, then its value on `instance`.
void WritePropertyRow(TWriter& writer, const TWriter::TInstancePtr& instance, const TReportProperty& property);
// The same with the label taken from `labelInstance`'s class and `label`,
// and the value from `valueInstance` and `value`.
void WriteMixedRow(TWriter& writer, const TWriter::TInstancePtr& labelInstance, const TReportProperty& label,
                   const TWriter::TInstancePtr& valueInstance, const TReportProperty& value);
// A table of label and value rows, one for each property named.
void WritePropertyTable(TWriter& writer, const TWriter::TInstancePtr& instance, const std::string& tableWidth,
                        const std::string& headerWidth, const std::string& caption,
                        const std::vector<TReportProperty>& rows);

// The message row of a page that found nothing to show.
void WriteNothingFound(TWriter& writer, const std::string& message, const std::string& label);

// The lines a caller of a raw-data writer traces: on an exception, when the
// writer gave a link ("Failed", as the trace has always read) and when it
// gave none ("Success").
struct TRawLinkTrace {
    std::string exception;
    std::string gaveLink;
    std::string gaveNone;
};
// Runs `write` (a raw-data writer) and returns the link it gave; an
// exception gives "" and the exception line.
template <typename TWrite>
std::string RawDataLink(TWrite write, const TRawLinkTrace& trace) {
    std::string link;
    try {
        link = write();
    } catch (...) {
        Trace(trace.exception);
        link.clear();
    }
    Trace(link.empty() ? trace.gaveNone : trace.gaveLink);
    return link;
}

}  // namespace storage
}  // namespace braigrion
