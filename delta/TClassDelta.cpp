// The run-wide delta state and the tree of one report class: reading the
// records, grouping them per instance, matching instances of several
// collections by their key properties, and linking parents and dependents.
#include "delta/TClassDelta.h"

#include <algorithm>
#include <iomanip>
#include <iostream>

#include <boost/make_shared.hpp>

#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMSchemaHelper.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
using NORVTKR20::TTKRException;

std::map<std::string, TClassDelta::TInstancePtr> TClassDelta::fClassName2DeltaClass;
std::vector<std::string> TClassDelta::fDeltaContainerNames;
TClassDelta::TContext TClassDelta::fRunContext;

namespace {

const char kDeltaClass[] = "ORVSG_DeltaClass";
const char kDelta[] = "ORVSG_Delta";
const char kDeltaAssoc[] = "ORVSG_DeltaClassAssocToDelta";

// The first instance of `className` in the collection `context` selects;
// empty when there is none, or when the class is absent.
TClassDelta::TInstancePtr FirstInstance(const TClassDelta::TNamespacePtr& ns, const std::string& className,
                                        const TClassDelta::TContext& context) {
    TClassDelta::TInstancePtr first;
    try {
        ns->GetClass(className, context)->EnumerateInstances(
            [&first](TClassDelta::TInstancePtr instance) {
                first = instance;
                return false;
            },
            true, context);
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return first;
}

}  // namespace

std::vector<unsigned short> DeltaIndices(const TClassDelta::TInstancePtr& record) {
    std::vector<unsigned short> indices;
    TClassDelta::TContext context;
    try {
        const TCIMValue& value = record->GetProperty("NamespaceIndices", context)->GetValue(context);
        if (value.IsNull()) return indices;
        if (!value.IsArray()) {
            indices.push_back(static_cast<unsigned short>(value));
            return indices;
        }
        for (const TCIMValue& element : static_cast<std::vector<TCIMValue>&>(value)) {
            if (!element.IsNull()) indices.push_back(static_cast<unsigned short>(element));
        }
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw;
    }
    return indices;
}

std::uint8_t DeltaType(const TClassDelta::TInstancePtr& record) {
    TClassDelta::TContext context;
    const TCIMValue& value = record->GetProperty("Type", context)->GetValue(context);
    return value.IsNull() ? 0 : static_cast<unsigned char>(value);
}

std::string DeltaText(const TClassDelta::TInstancePtr& record, const std::string& property) {
    TClassDelta::TContext context;
    return static_cast<std::string>(record->GetProperty(property, context)->GetValue(context));
}

TClassDelta::TClassDelta(TNamespacePtr ns, TContext context, boost::shared_ptr<TClassDelta> backAssociatedClass,
                         TReportClass* reportClass)
    : fNamespace(ns),
      fBackAssociatedClass(backAssociatedClass),
      fContext(context),
      fReportClass(reportClass),
      fKeyNamesKnown(false) {}

void TClassDelta::Init(TNamespacePtr ns, TContext context) {
    Trace("TWriter::BaseInitialize -- Under DELTA mode, construct a mapping from class name to ORVSG_DeltaClass "
          "instance");
    fClassName2DeltaClass.clear();
    fDeltaContainerNames.clear();
    fRunContext = context;
    TContext empty;
    try {
        ns->GetClass(kDeltaClass, empty)->EnumerateInstances(
            [](TInstancePtr deltaClass) {
                TContext none;
                const std::string name = static_cast<std::string>(
                    deltaClass->GetProperty("ClassName", none)->GetValue(none));
                fClassName2DeltaClass.insert(std::make_pair(name, deltaClass));  // an existing entry stays
                return true;
            },
            false, empty);
    } catch (const TTKRException& ex) {
        // A view without records compares nothing; its pages stay empty.
        if (!IsNotFound(ex)) throw;
    }

    unsigned short count = 1;
    auto it = context.find("nNamespaces");
    if (it != context.end() && !it->second.IsNull()) count = static_cast<unsigned short>(it->second);
    bool sameMachine = true;
    for (unsigned short index = 0; index < count; ++index) {
        context["nsIndex"] = TCIMValue(index);
        fDeltaContainerNames.push_back(NORVTKR20::TCIMSchemaHelper::GetRawSerialNumberString(ns, context));
        sameMachine = sameMachine && fDeltaContainerNames.back() == fDeltaContainerNames.front();
    }
    std::vector<std::string> times(count);
    for (unsigned short index = 0; index < count; ++index) {
        context["nsIndex"] = TCIMValue(index);
        TContext at = context;
        TInstancePtr zone = FirstInstance(ns, "ORVSG_TimeZone", at);
        if (zone) {
            try {
                times[index] = TWriterUtil::GetDateTime(zone->GetProperty("LocalDateTime", at)->GetValue(at), false);
            } catch (const TTKRException& ex) {
                if (!IsNotFound(ex)) throw;
            }
        }
        if (!sameMachine) {
            TInstancePtr service = FirstInstance(ns, "ORVSG_IPService", at);
            if (!service) continue;
            try {
                fDeltaContainerNames[index] = service->GetProperty("HostName", at)->GetValue(at).ToString(10);
            } catch (const TTKRException& ex) {
                if (!IsNotFound(ex)) throw;
            }
        } else if (zone) {
            fDeltaContainerNames[index] = times[index];
        }
    }
    // Two collections of one machine among several machines share a host
    // name; their collection times tell them apart.
    for (unsigned short index = 0; index < count; ++index) {
        const std::string label = fDeltaContainerNames[index];
        if (times[index].empty() || label == times[index]) continue;
        if (std::count(fDeltaContainerNames.begin(), fDeltaContainerNames.end(), label) > 1) {
            for (unsigned short other = index; other < count; ++other) {
                if (fDeltaContainerNames[other] == label && !times[other].empty()) {
                    fDeltaContainerNames[other] = label + " (" + times[other] + ")";
                }
            }
        }
    }
}

void TClassDelta::Uninit() {
    fClassName2DeltaClass.clear();
    fRunContext.clear();
}

void TClassDelta::FindDeltas(TNamespacePtr ns, const std::string& className, TInstances& result) {
    Trace("Entering TClassDelta::FindDeltas");
    TContext context;
    boost::shared_ptr<ICIMClass> cls;
    // The class as the baseline has it; a class that only later collections
    // hold is looked up there, so that its instances unique to them show.
    const size_t count = std::max<size_t>(1, fDeltaContainerNames.size());
    for (size_t index = 0; !cls; ++index) {
        context["nsIndex"] = TCIMValue(static_cast<unsigned short>(index));
        try {
            cls = ns->GetClass(className, context);
        } catch (const TTKRException& ex) {
            if (!IsNotFound(ex) || index + 1 >= count) throw TTKRException(ex.fStatusCode);
        }
    }
    std::vector<boost::shared_ptr<ICIMClass>> family{cls};
    cls->EnumerateSubClasses(TAddToVectorCallback<ICIMClass>(family), true, context);

    std::set<const ICIMInstance*> seen;
    for (const TInstancePtr& record : result) seen.insert(record.get());
    for (const boost::shared_ptr<ICIMClass>& member : family) {
        auto found = fClassName2DeltaClass.find(member->GetClassName(context));
        if (found == fClassName2DeltaClass.end()) continue;
        TInstances records;
        found->second->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(records), kDeltaAssoc, kDelta,
                                                    "", "", context);
        for (const TInstancePtr& record : records) {
            if (seen.insert(record.get()).second) result.push_back(record);  // a record reached twice counts once
        }
    }
}

void TClassDelta::FindRecords(TInstances& records) const {
    try {
        FindDeltas(fNamespace, fReportClass->GetClass(), records);
    } catch (const TTKRException& ex) {
        // A class that the collections lack has no differences to show.
        if (!IsNotFound(ex)) throw;
        Trace("TClassDelta::CreateDeltaInstances -- No class " + fReportClass->GetClass());
    }
}

TClassDelta::TContext TClassDelta::At(unsigned short index) const {
    TContext context = fContext;
    context["nsIndex"] = TCIMValue(index);
    return context;
}

TClassDelta::TInstancePtr TClassDelta::Resolve(const std::string& name, unsigned short index) const {
    TCIMReference reference(fNamespace, name, At(index));
    return boost::dynamic_pointer_cast<ICIMInstance>(reference.GetCIMElement(false));
}

boost::shared_ptr<TInstanceDelta> TClassDelta::Entry(const std::string& name) {
    boost::shared_ptr<TInstanceDelta>& entry = fInstanceDeltas[name];
    if (!entry) entry = boost::make_shared<TInstanceDelta>(shared_from_this(), name);
    return entry;
}

void TClassDelta::CreateDeltaInstances(TWriter* writer) {
    Trace("Entering TClassDelta::CreateDeltaInstances");
    TInstances records;
    FindRecords(records);
    for (const TInstancePtr& record : records) {
        const std::uint8_t type = DeltaType(record);
        if (type == kDeltaProperty) {
            // What the page does not show counts as no difference.
            const std::string property = DeltaText(record, "Property");
            bool shown = false;
            for (const TReportProperty& column : fReportClass->GetProperties()) {
                shown = shown || column.GetProperty() == property;
            }
            if (!shown) continue;
        }
        boost::shared_ptr<TInstanceDelta> entry = Entry(DeltaText(record, "InstanceName"));
        entry->fDeltas.push_back(record);
        entry->fDeltaTypes |= type;
    }

    const size_t count = NamespaceCount();
    for (auto& named : fInstanceDeltas) {
        TInstanceDelta& entry = *named.second;
        if (entry.fDeltas.empty()) continue;
        const std::string name = DeltaText(entry.fDeltas.front(), "InstanceName");
        for (const TInstancePtr& record : entry.fDeltas) {
            if (DeltaType(record) != kDeltaMissing) {
                if (entry.fInstances.size() < count) entry.fInstances.resize(count);
                for (unsigned short index : DeltaIndices(record)) {
                    if (index < entry.fInstances.size() && !entry.fInstances[index]) {
                        entry.fInstances[index] = Resolve(name, index);
                    }
                }
            } else {
                // A missing instance is shown as the baseline has it.
                if (entry.fInstances.empty()) entry.fInstances.resize(1);
                if (!entry.fInstances[0]) entry.fInstances[0] = Resolve(name, 0);
            }
        }
    }

    CreateDeltaAssocProperties(writer);
    CreateDeltaBackAssocDependencies();
    if (!fReportClass->GetAssociatedClasses().empty()) {
        for (TReportClass& associated : fReportClass->GetAssociatedClasses()) {
            boost::shared_ptr<TClassDelta> child =
                boost::make_shared<TClassDelta>(fNamespace, fContext, shared_from_this(), &associated);
            fChildClassDeltas.push_back(child);
            child->CreateDeltaInstances(writer);
        }
        CreateDeltaAssocDependencies();
    }
    Trace("Exiting TClassDelta::CreateDeltaInstances");
}

TCIMReference TClassDelta::ConvertReference(const TCIMReference& reference, const TContext& context) {
    if (!fKeyNamesKnown) {
        for (const auto& named : fInstanceDeltas) {
            if (named.second->fDeltas.empty()) continue;
            TCIMReference known(fNamespace, named.first, fContext);
            known.EnumerateKeyBindings([this](std::pair<std::string, TCIMValue> binding) {
                fKeyNames.push_back(binding.first);
                return true;
            });
            break;
        }
        // The records are all placed before the first path is converted:
        // a class without any keeps the paths as they come, and need not
        // look again.
        fKeyNamesKnown = true;
    }
    if (fKeyNames.empty()) return reference;
    std::map<std::string, TCIMValue> keys;
    reference.EnumerateKeyBindings(NORVTKR20::TAddKeyBindingsToMapCallback(keys));
    TCIMReference converted(fNamespace, context);
    converted.SetClassName(reference.GetClassName());
    for (const std::string& name : fKeyNames) {
        auto found = keys.find(name);
        if (found != keys.end()) converted.AddKeyValue(name, found->second);
    }
    return converted;
}

void TClassDelta::LinkAlong(TClassDelta& far, const TReportClass& relation, bool forward) {
    const size_t count = NamespaceCount();
    // A snapshot: linking may add entries to this class when `far` is this one.
    std::vector<boost::shared_ptr<TInstanceDelta>> entries;
    for (const auto& named : fInstanceDeltas) entries.push_back(named.second);
    for (const boost::shared_ptr<TInstanceDelta>& near : entries) {
        // Each collection's instance is linked to that collection's
        // associated instances, each of which lands in its own slot.
        for (size_t index = 0; index < near->fInstances.size() && index < count; ++index) {
            const TInstancePtr& instance = near->fInstances[index];
            if (!instance) continue;
            const TContext at = At(static_cast<unsigned short>(index));
            TInstances associated;
            try {
                if (forward) {
                    instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(associated),
                                                           relation.GetAssocClass(), relation.GetResultClass(),
                                                           relation.GetRole(), relation.GetResultRole(), at);
                } else {
                    instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(associated),
                                                           relation.GetAssocClass(),
                                                           far.GetReportClass().GetClass(), relation.GetResultRole(),
                                                           relation.GetRole(), at);
                }
            } catch (const TTKRException& ex) {
                if (!IsNotFound(ex)) throw;
                continue;
            }
            for (const TInstancePtr& other : associated) {
                const std::string path = far.ConvertReference(other->GetPath(at), at).GetPath();
                boost::shared_ptr<TInstanceDelta> farEntry = far.Entry(path);
                if (farEntry->fInstances.size() < count) farEntry->fInstances.resize(count);
                if (!farEntry->fInstances[index]) farEntry->fInstances[index] = other;
                // Links run from parent to dependent only, so that walking
                // the dependents always ends.
                if (forward) {
                    near->AddChild(farEntry);
                } else {
                    farEntry->AddChild(near);
                }
            }
        }
    }
}

void TClassDelta::CreateDeltaAssocDependencies() {
    Trace("Entering TClassDelta::CreateDeltaBackAssocDependencies");
    for (const boost::shared_ptr<TClassDelta>& child : fChildClassDeltas) {
        LinkAlong(*child, child->GetReportClass(), true);
    }
}

void TClassDelta::CreateDeltaBackAssocDependencies() {
    Trace("Entering TClassDelta::CreateDeltaBackAssocDependencies");
    if (!fBackAssociatedClass) {
        Trace("Exiting TClassDelta::CreateDeltaBackAssocDependencies, !fBackAssociatedClass");
        return;
    }
    LinkAlong(*fBackAssociatedClass, *fReportClass, false);
    fBackAssociatedClass->CreateDeltaBackAssocDependencies();
}

void TClassDelta::DumpDeltas() {
    TContext context;
    std::cout << "=== class " << fReportClass->GetClass() << " ===\n";
    std::cout << fInstanceDeltas.size() << " instances\n";
    for (const auto& named : fInstanceDeltas) {
        const TInstanceDelta& entry = *named.second;
        std::cout << std::string(60, '-') << "\n";
        std::cout << "op = " << named.first << "\n";
        std::cout << "delta type = " << std::hex << static_cast<unsigned>(entry.fDeltaTypes) << std::dec << "\n";
        std::cout << entry.fDeltas.size() << " deltas\n";
        std::cout << entry.fAssocDeltas.size() << " associations\n";
    }
    for (const boost::shared_ptr<TClassDelta>& child : fChildClassDeltas) child->DumpDeltas();
}

void TClassDelta::Release() {
    for (auto& named : fInstanceDeltas) {
        named.second->fChildren.clear();
        named.second->fClassDelta.reset();
    }
    fInstanceDeltas.clear();
    for (const boost::shared_ptr<TClassDelta>& child : fChildClassDeltas) child->Release();
    fChildClassDeltas.clear();
    fBackAssociatedClass.reset();
}

}  // namespace braigrion
