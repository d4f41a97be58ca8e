// The columns reached through an association, which no record covers:
// compared here, collection by collection, as the table shows them, for
// the instances the records name and those the baseline shows.
#include <set>

#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "delta/TClassDelta.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
using NORVTKR20::TTKRException;

void TClassDelta::CreateDeltaAssocProperties(TWriter* writer) {
    Trace("Entering TClassDelta::CreateDeltaAssocProperties");
    for (const TReportProperty& column : fReportClass->GetProperties()) {
        if (column.HasAssociationTarget() && column.HasAssociationClass()) {
            CreateDeltaAssocProperties(writer, column, column.GetAssociationTarget(), column.GetAssociationClass(),
                                       column.GetProperty());
        }
    }
    Trace("Exiting TClassDelta::CreateDeltaAssocProperties");
}

void TClassDelta::CreateDeltaAssocProperties(TWriter* writer, const TReportProperty& property,
                                             const std::string& associationTarget,
                                             const std::string& associationClass, const std::string& propertyName) {
    Trace("Entering TClassDelta::CreateDeltaAssocProperties(2), propertyName=" + propertyName +
          ", assocClass=" + associationClass);
    // The instances that differ somewhere: every name the records give.
    TInstances records;
    FindRecords(records);
    std::set<std::string> names;
    for (const TInstancePtr& record : records) names.insert(DeltaText(record, "InstanceName"));
    // And every instance the baseline shows in this table: a difference
    // that only an association column holds has no record to point at it.
    const TContext baseline = At(0);
    for (const TInstancePtr& instance : TWriterUtil::GetInstances(fNamespace, *fReportClass)) {
        names.insert(ConvertReference(instance->GetPath(baseline), baseline).GetPath());
    }

    const size_t count = NamespaceCount();
    const std::string separator = writer->GetSeparatorText(property.GetArrayValueSeparator());
    for (const std::string& name : names) {
        // The column's text in each collection that holds the instance, as
        // the table writes it: every associated instance's value together.
        std::vector<std::string> texts(count);
        std::vector<bool> present(count, false);
        for (size_t index = 0; index < count; ++index) {
            TInstancePtr instance = Resolve(name, static_cast<unsigned short>(index));
            if (!instance) continue;
            try {
                texts[index] = writer->GetValuesFromProperties(
                    TWriterUtil::GetProperties(instance, propertyName, associationClass, associationTarget),
                    separator, false);
                present[index] = true;
            } catch (const TTKRException& ex) {
                if (!IsNotFound(ex)) throw;
            }
        }
        bool differs = false;
        for (size_t index = 1; index < count; ++index) differs = differs || (present[index] && texts[index] != texts[0]);
        if (!differs) continue;
        boost::shared_ptr<TInstanceDelta> entry = Entry(name);
        if (entry->fInstances.size() < count) entry->fInstances.resize(count);
        for (size_t index = 0; index < count; ++index) {
            if (!entry->fInstances[index]) entry->fInstances[index] = Resolve(name, static_cast<unsigned short>(index));
        }
        entry->fDeltaTypes |= kDeltaProperty;
        entry->fAssocDeltas[propertyName] = texts;
    }
    Trace("Exiting TClassDelta::CreateDeltaAssocProperties(2)");
}

}  // namespace braigrion
