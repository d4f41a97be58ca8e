#include "repository/DeltaRecords.h"

#include <algorithm>
#include <cctype>
#include <set>
#include <unordered_map>
#include <unordered_set>

#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace braigrion {
namespace repository {

typedef TCIMValue::TCIMType TType;

namespace {

const char kDeltaClass[] = "ORVSG_DeltaClass";
const char kDelta[] = "ORVSG_Delta";
const char kDeltaAssoc[] = "ORVSG_DeltaClassAssocToDelta";

std::string Lower(std::string text) {
    for (char& c : text) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return text;
}

bool EndsWith(const std::string& text, const std::string& tail) {
    return text.size() >= tail.size() && text.compare(text.size() - tail.size(), tail.size(), tail) == 0;
}

TQualifierData Qualifier(const std::string& name, const TCIMValue& value) {
    TQualifierData q;
    q.fName = name;
    q.fValue = value;
    return q;
}

TPropertyDeclData Decl(const std::string& name, TType::ECIMType type, bool key = false, bool array = false,
                       const std::string& referenceClass = "") {
    TPropertyDeclData d;
    d.fName = name;
    d.fType = type;
    d.fIsArray = array;
    d.fReferenceClass = referenceClass;
    if (key) d.fQualifiers.push_back(Qualifier("Key", TCIMValue::Boolean(true)));
    return d;
}

// The names by which a collection knows its own host, in lower case: full
// and without the domain.
std::unordered_set<std::string> HostNames(const TMemoryNamespace& ns) {
    std::unordered_set<std::string> names;
    auto add = [&names, &ns](const std::string& className, const std::string& property) {
        TMemoryClass* cls = ns.FindClass(className);
        if (!cls) return;
        for (const auto& instance : cls->GetInstances()) {
            const TMemoryInstance::TSlot* slot = instance->FindSlot(property);
            if (!slot || slot->fValue.IsNull() || slot->fValue.IsArray()) continue;
            const std::string name = Lower(slot->fValue.ToString(10));
            if (name.empty()) continue;
            names.insert(name);
            names.insert(name.substr(0, name.find('.')));
        }
    };
    add("ORVSG_ComputerSystem", "Name");
    add("ORVSG_IPService", "HostName");
    add("ORVSG_CollectionInfo", "HostName");
    return names;
}

// One value as the comparison sees it: absent and null read alike, arrays
// element by element.
std::string ValueText(const TMemoryInstance::TSlot* slot) {
    if (!slot || slot->fValue.IsNull()) return std::string("\x01", 1);
    if (!slot->fValue.IsArray()) return slot->fValue.ToString(10);
    std::string text = "[";
    for (const TCIMValue& element : static_cast<std::vector<TCIMValue>&>(slot->fValue)) {
        text += element.IsNull() ? std::string("\x01", 1) : element.ToString(10);
        text += '\x1f';
    }
    return text;
}

bool SameValue(const TMemoryInstance::TSlot* a, const TMemoryInstance::TSlot* b) {
    if (a && b && a->fValue == b->fValue) return true;
    return ValueText(a) == ValueText(b);
}

// One instance identity of a class, and its instance in each collection.
struct TEntry {
    std::string fName;
    std::vector<TMemoryInstance*> fSlots;
};

// How the instances of a class are named for matching.
enum class TNaming {
    eKeys,           // the key bindings of their paths, less the keys left out
    eAllProperties,  // every present scalar property, less the names left out
};

class TClassComparison {
public:
    TClassComparison(const std::string& name, const std::vector<TMemoryClass*>& classes,
                     const std::vector<std::unordered_set<std::string>>& hosts)
        : fName(name), fClasses(classes), fHosts(hosts) {}

    // Matches the instances of every collection; false when some collection
    // holds two instances of one name. With `pairDuplicates` it always
    // succeeds: the k-th instance of a name in one collection matches the
    // k-th of that name in each other collection.
    bool Match(const std::set<std::string>& leftOut, TNaming naming, bool pairDuplicates) {
        fEntries.clear();
        fIndex.clear();
        fDuplicates.clear();
        fHostValues = naming == TNaming::eAllProperties ? leftOut : std::set<std::string>();
        for (size_t c = 0; c < fClasses.size(); ++c) {
            if (!fClasses[c]) continue;
            for (const auto& instance : fClasses[c]->GetInstances()) {
                std::string name = naming == TNaming::eKeys ? ReducedPath(*instance, leftOut)
                                                            : PropertyPath(*instance, leftOut);
                auto found = fIndex.emplace(name, fEntries.size());
                if (found.second) {
                    fEntries.push_back(TEntry{std::move(name), std::vector<TMemoryInstance*>(fClasses.size())});
                }
                size_t at = found.first->second;
                if (fEntries[at].fSlots[c] || (pairDuplicates && fDuplicates.count(at))) {
                    if (!pairDuplicates) return false;
                    at = NextDuplicate(at, c);
                }
                fEntries[at].fSlots[c] = instance.get();
            }
        }
        return true;
    }

    // Names that name the host, by name or by value: of the keys, or with
    // `everyProperty` of every property, as instances named by all their
    // values need.
    std::set<std::string> HostKeys(bool everyProperty) const {
        std::set<std::string> keys;
        for (size_t c = 0; c < fClasses.size(); ++c) {
            if (!fClasses[c]) continue;
            const auto& decls = fClasses[c]->GetProperties();
            for (const std::string& key : fClasses[c]->GetKeyNames()) {
                if (IsHostKeyName(key)) keys.insert(Lower(key));
            }
            if (everyProperty) {
                for (const auto& decl : decls) {
                    if (IsHostKeyName(decl->GetName())) keys.insert(Lower(decl->GetName()));
                }
            }
            if (fHosts[c].empty()) continue;
            for (const auto& instance : fClasses[c]->GetInstances()) {
                auto check = [&](const std::string& key, const TCIMValue& value) {
                    if (!value.IsNull() && !value.IsArray() && fHosts[c].count(Lower(value.ToString(10)))) {
                        keys.insert(Lower(key));
                    }
                };
                if (everyProperty) {
                    for (const TMemoryInstance::TSlot& slot : instance->GetSlots()) {
                        check(decls[slot.fDecl]->GetName(), slot.fValue);
                    }
                } else {
                    for (const std::string& key : fClasses[c]->GetKeyNames()) {
                        if (const TMemoryInstance::TSlot* slot = instance->FindSlot(key)) check(key, slot->fValue);
                    }
                }
                for (const auto& extra : instance->GetExtraKeys()) check(extra.first, extra.second);
            }
        }
        return keys;
    }

    const std::vector<TEntry>& Entries() const { return fEntries; }

    // The properties compared: every non-key, non-reference property that
    // some collection's class has, in the order they are first met.
    std::vector<std::string> ComparedProperties() const {
        std::vector<std::string> names;
        std::set<std::string> seen;
        for (TMemoryClass* cls : fClasses) {
            if (!cls) continue;
            std::set<std::string> keys;
            for (const std::string& key : cls->GetKeyNames()) keys.insert(Lower(key));
            for (const auto& decl : cls->GetProperties()) {
                if (decl->GetType() == TType::eReference || keys.count(Lower(decl->GetName()))) continue;
                if (seen.insert(Lower(decl->GetName())).second) names.push_back(decl->GetName());
            }
        }
        // A key of any collection's class is a key of the comparison.
        std::set<std::string> allKeys;
        for (TMemoryClass* cls : fClasses) {
            if (cls) for (const std::string& key : cls->GetKeyNames()) allKeys.insert(Lower(key));
        }
        // Nor are values that name the host, where they name the instances.
        names.erase(std::remove_if(names.begin(), names.end(),
                                   [&](const std::string& n) {
                                       return allKeys.count(Lower(n)) > 0 || fHostValues.count(Lower(n)) > 0;
                                   }),
                    names.end());
        return names;
    }

private:
    // Instances that share the name of entry `head`: the entries, in the
    // order made, and how many of them each collection has taken.
    struct TDuplicates {
        std::vector<size_t> fEntries;
        std::vector<size_t> fTaken;
    };

    // The entry for collection `c`'s next instance named as entry `head`,
    // made when every earlier one is taken. Constant time per instance, so
    // that a class of many identical instances stays linear.
    size_t NextDuplicate(size_t head, size_t c) {
        TDuplicates& dups = fDuplicates[head];
        if (dups.fEntries.empty()) {
            dups.fEntries.push_back(head);
            dups.fTaken.assign(fClasses.size(), 1);
            // Collections met before the first clash each took the head.
            for (size_t other = 0; other < fClasses.size(); ++other) {
                if (!fEntries[head].fSlots[other]) dups.fTaken[other] = 0;
            }
        }
        // Each collection takes the entries of a name in order.
        const size_t k = dups.fTaken[c]++;
        if (k < dups.fEntries.size()) return dups.fEntries[k];
        fEntries.push_back(TEntry{fEntries[head].fName, std::vector<TMemoryInstance*>(fClasses.size())});
        dups.fEntries.push_back(fEntries.size() - 1);
        return fEntries.size() - 1;
    }

    // The path that names an instance by every present scalar property
    // that is not a reference, as a class without keys names its
    // instances; the repository resolves such a path by those values.
    std::string PropertyPath(TMemoryInstance& instance, const std::set<std::string>& leftOut) const {
        TCIMReference path;
        path.SetClassName(instance.GetMemoryClass().GetName());
        const auto& decls = instance.GetMemoryClass().GetProperties();
        for (const TMemoryInstance::TSlot& slot : instance.GetSlots()) {
            const auto& decl = decls[slot.fDecl];
            if (slot.fValue.IsNull() || slot.fValue.IsArray() || decl->GetType() == TType::eReference) continue;
            if (!leftOut.count(Lower(decl->GetName()))) path.AddKeyValue(decl->GetName(), slot.fValue);
        }
        for (const auto& extra : instance.GetExtraKeys()) {
            if (!leftOut.count(Lower(extra.first))) path.AddKeyValue(extra.first, extra.second);
        }
        return path.GetPath();
    }

    // The instance's object path with only the matching keys, as the
    // report's paths print it.
    std::string ReducedPath(TMemoryInstance& instance, const std::set<std::string>& leftOut) const {
        TCIMReference full = instance.GetPath(TCIMContext());
        TCIMReference reduced;
        reduced.SetClassName(full.GetClassName());
        for (const auto& binding : full.GetKeyBindings()) {
            if (!leftOut.count(Lower(binding.first))) reduced.AddKeyValue(binding.first, binding.second);
        }
        return reduced.GetPath();
    }

    std::string fName;
    std::vector<TMemoryClass*> fClasses;
    const std::vector<std::unordered_set<std::string>>& fHosts;
    std::vector<TEntry> fEntries;
    std::unordered_map<std::string, size_t> fIndex;
    std::unordered_map<size_t, TDuplicates> fDuplicates;
    std::set<std::string> fHostValues;  // names left out of instances named by their values
};

TPropertyValue Value(const std::string& name, const TCIMValue& value) {
    TPropertyValue v;
    v.fName = name;
    v.fValue = value;
    return v;
}

TCIMReference Path(const std::string& className, const std::string& key, const std::string& value) {
    TCIMReference path;
    path.SetClassName(className);
    path.AddKeyValue(key, TCIMValue(value));
    return path;
}

}  // namespace

bool IsHostKeyName(const std::string& name) {
    const std::string lower = Lower(name);
    return lower == "csname" || lower == "hostname" || EndsWith(lower, "systemname");
}

TDeltaRecordWriter::TDeltaRecordWriter(boost::shared_ptr<TMemoryNamespace> records) : fRecords(records) {}

TCIMReference TDeltaRecordWriter::ClassPath(const std::string& className) {
    if (fClassNames.insert(className).second) {
        fRecords->AddInstance(kDeltaClass, {Value("ClassName", TCIMValue(className))});
    }
    return Path(kDeltaClass, "ClassName", className);
}

std::string TDeltaRecordWriter::Add(const std::string& className, unsigned type, const std::string& property,
                                    const std::string& instanceName, const std::vector<unsigned short>& indices) {
    const std::string id = "Delta:" + std::to_string(++fCount);
    std::vector<TCIMValue> elements;
    for (unsigned short index : indices) elements.push_back(TCIMValue::Unsigned(TType::eUint16, index));
    std::vector<TPropertyValue> values{Value("InstanceID", TCIMValue(id)),
                                       Value("Type", TCIMValue::Unsigned(TType::eUint8, type)),
                                       Value("InstanceName", TCIMValue(instanceName)),
                                       Value("NamespaceIndices", TCIMValue::Array(TType::eUint16, elements))};
    if (type == 4) values.push_back(Value("Property", TCIMValue(property)));
    fRecords->AddInstance(kDelta, std::move(values));
    Attach(className, id);
    return id;
}

void TDeltaRecordWriter::Attach(const std::string& className, const std::string& recordID) {
    fRecords->AddInstance(kDeltaAssoc, {Value("DeltaClass", TCIMValue(ClassPath(className))),
                                        Value("Delta", TCIMValue(Path(kDelta, "InstanceID", recordID)))});
}

void DeclareDeltaClasses(TMemoryNamespace& records) {
    TClassData deltaClass;
    deltaClass.fName = kDeltaClass;
    deltaClass.fProperties = {Decl("ClassName", TType::eString, true)};
    records.DeclareClass(deltaClass);

    TClassData delta;
    delta.fName = kDelta;
    delta.fProperties = {Decl("InstanceID", TType::eString, true), Decl("Type", TType::eUint8),
                         Decl("Property", TType::eString), Decl("InstanceName", TType::eString),
                         Decl("NamespaceIndices", TType::eUint16, false, true)};
    records.DeclareClass(delta);

    TClassData assoc;
    assoc.fName = kDeltaAssoc;
    assoc.fQualifiers.push_back(Qualifier("Association", TCIMValue::Boolean(true)));
    assoc.fProperties = {Decl("DeltaClass", TType::eReference, true, false, kDeltaClass),
                         Decl("Delta", TType::eReference, true, false, kDelta)};
    records.DeclareClass(assoc);
}

boost::shared_ptr<TMemoryNamespace> ComputeDeltaRecords(
    const std::vector<boost::shared_ptr<TMemoryNamespace>>& collections, TDeltaSummary* summary) {
    TDeltaSummary counts;
    boost::shared_ptr<TMemoryNamespace> records = TMemoryNamespace::Create();
    records->SetName("delta records");
    DeclareDeltaClasses(*records);
    TDeltaRecordWriter writer(records);
    const size_t n = collections.size();

    std::vector<std::unordered_set<std::string>> hosts;
    for (const auto& ns : collections) {
        ns->Link();
        hosts.push_back(HostNames(*ns));
    }
    // Every class with instances of its own, in the order first met.
    std::vector<std::string> classNames;
    std::set<std::string> seen;
    for (const auto& ns : collections) {
        for (TMemoryClass* cls : ns->GetClasses()) {
            if (cls->GetInstanceCount() == 0 || cls->IsAssociation()) continue;
            const std::string lower = Lower(cls->GetName());
            if (lower == Lower(kDeltaClass) || lower == Lower(kDelta)) continue;
            if (seen.insert(lower).second) classNames.push_back(cls->GetName());
        }
    }

    for (const std::string& className : classNames) {
        std::vector<TMemoryClass*> classes;
        for (const auto& ns : collections) classes.push_back(ns->FindClass(className));
        TClassComparison comparison(className, classes, hosts);
        // The keys less the host's; else all keys; else, for instances the
        // keys cannot tell apart (a collector that left its key out), every
        // value but the host's, identical instances paired in order.
        if (!comparison.Match(comparison.HostKeys(false), TNaming::eKeys, false) &&
            !comparison.Match(std::set<std::string>(), TNaming::eKeys, false)) {
            comparison.Match(comparison.HostKeys(true), TNaming::eAllProperties, true);
            counts.fNamedByValues.push_back(className);
        }
        ++counts.fClasses;
        const std::vector<std::string> properties = comparison.ComparedProperties();
        for (const TEntry& entry : comparison.Entries()) {
            std::vector<unsigned short> present, absent;
            for (size_t c = 0; c < n; ++c) (entry.fSlots[c] ? present : absent).push_back(static_cast<unsigned short>(c));
            counts.fInstances += present.size();
            if (!absent.empty()) {
                if (entry.fSlots[0]) {
                    writer.Add(className, 1, "", entry.fName, absent);
                    ++counts.fMissing;
                } else {
                    writer.Add(className, 2, "", entry.fName, present);
                    ++counts.fUnique;
                    continue;
                }
            }
            if (present.size() < 2) continue;
            const TMemoryInstance& baseline = *entry.fSlots[0];
            for (const std::string& property : properties) {
                const TMemoryInstance::TSlot* base = baseline.FindSlot(property);
                std::vector<unsigned short> shown{0};
                for (size_t c = 1; c < n; ++c) {
                    if (entry.fSlots[c] && !SameValue(base, entry.fSlots[c]->FindSlot(property))) {
                        shown.push_back(static_cast<unsigned short>(c));
                    }
                }
                if (shown.size() == 1) continue;
                writer.Add(className, 4, property, entry.fName, shown);
                ++counts.fPropertyDeltas;
            }
        }
    }
    records->Link();
    if (summary) *summary = counts;
    return records;
}

}  // namespace repository
}  // namespace braigrion
