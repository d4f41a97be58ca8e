#include "repository/MemoryClass.h"

#include <algorithm>
#include <unordered_set>

#include <boost/make_shared.hpp>

#include "repository/MemoryInstance.h"
#include "repository/RepositoryIndexes.h"

namespace braigrion {
namespace repository {

using NORVTKR20::TTKRException;
typedef NORVTKR20::TCIMValue::TCIMType TType;

// ---------------------------------------------------------------------------
// Property declarations

namespace {

std::vector<std::string> StringArray(const TCIMValue& v) {
    std::vector<std::string> out;
    if (v.IsNull()) return out;
    if (!v.IsArray()) {
        out.push_back(v.ToString(10));
        return out;
    }
    const std::vector<TCIMValue>& elems = v;
    for (const TCIMValue& e : elems) out.push_back(e.ToString(10));
    return out;
}

bool IsTrue(const TCIMValue& v) {
    if (v.IsNull() || v.IsArray()) return false;
    try {
        return static_cast<bool>(v);
    } catch (const TTKRException&) {
        return false;
    }
}

// A ValueMap entry matches a value exactly, or as a range "lo..hi", "..hi",
// "lo.." of integers.
bool ValueMapEntryMatches(const std::string& entry, const TCIMValue& value, const std::string& text) {
    if (entry == text) return true;
    size_t dots = entry.find("..");
    if (dots == std::string::npos || entry == "..") return false;
    try {
        std::int64_t v = value.AsSigned();
        std::string lo = entry.substr(0, dots), hi = entry.substr(dots + 2);
        if (!lo.empty() && v < TCIMValue::FromText(TType::eSint64, lo).AsSigned()) return false;
        if (!hi.empty() && v > TCIMValue::FromText(TType::eSint64, hi).AsSigned()) return false;
        return true;
    } catch (const TTKRException&) {
        return false;
    }
}

}  // namespace

TMemoryPropertyDecl::TMemoryPropertyDecl(const TPropertyDeclData& data)
    : fData(data), fKey(false), fRowMerge(false), fInferred(false) {
    for (const TQualifierData& q : fData.fQualifiers) {
        fQualifiers.push_back(boost::make_shared<TMemoryQualifier>(q));
        if (NamesEqual(q.fName, "Key")) fKey = IsTrue(q.fValue);
        else if (NamesEqual(q.fName, "RowMerge")) fRowMerge = IsTrue(q.fValue);
        else if (NamesEqual(q.fName, "ValueMap")) fValueMap = StringArray(q.fValue);
        else if (NamesEqual(q.fName, "Values")) fValues = StringArray(q.fValue);
    }
}

boost::shared_ptr<const NORVTKR20::ICIMQualifier> TMemoryPropertyDecl::GetQualifier(const std::string& name,
                                                                                    bool& propagated,
                                                                                    const TCIMContext&) const {
    for (const auto& q : fQualifiers) {
        if (NamesEqual(q->GetData().fName, name)) {
            propagated = q->GetData().fPropagated;
            return q;
        }
    }
    throw TTKRException(NORVTKR20::kNotFound);
}

std::string TMemoryPropertyDecl::MapValue(const TCIMValue& scalar) const {
    std::string text;
    const int type = scalar.GetType();
    if (type == TType::eDateTime) {
        text = static_cast<NORVTKR20::TCIMDateTime>(scalar).ToUIString();
    } else if (type == TType::eReference) {
        text = static_cast<NORVTKR20::TCIMReference>(scalar).GetPath();
    } else {
        text = scalar.ToString(10);
    }
    if (fValues.empty()) return text;
    if (fValueMap.empty()) {
        // Values alone are indexed by the integer value.
        try {
            std::uint64_t index = scalar.AsUnsigned();
            if (index < fValues.size()) return fValues[index];
        } catch (const TTKRException&) {
        }
        return text;
    }
    const size_t n = std::min(fValueMap.size(), fValues.size());
    for (size_t i = 0; i < n; ++i) {
        if (ValueMapEntryMatches(fValueMap[i], scalar, text)) return fValues[i];
    }
    // ".." claims every value the other entries leave.
    for (size_t i = 0; i < n; ++i) {
        if (fValueMap[i] == "..") return fValues[i];
    }
    return text;
}

// ---------------------------------------------------------------------------
// Classes

TMemoryClass::TMemoryClass(TMemoryNamespace& ns, const std::string& name)
    : fNamespace(ns), fName(name), fDeclared(false), fSuper(nullptr), fLiveCount(0), fDeletedCount(0), fWalking(0) {
    fDeclaration.fName = name;
}

bool TMemoryClass::IsA(const TMemoryClass* ancestor) const {
    for (const TMemoryClass* c = this; c; c = c->fSuper)
        if (c == ancestor) return true;
    return false;
}

bool TMemoryClass::IsAssociation() const {
    for (const TQualifierData& q : fQualifiers)
        if (NamesEqual(q.fName, "Association")) return IsTrue(q.fValue);
    for (const auto& d : fProperties)
        if (d->GetType() == TType::eReference) return true;
    return false;
}

int TMemoryClass::FindProperty(const std::string& name) const {
    auto it = fPropertyIndex.find(name);
    return it == fPropertyIndex.end() ? -1 : static_cast<int>(it->second);
}

std::vector<boost::shared_ptr<TMemoryInstance>> TMemoryClass::GetInstances() const {
    std::vector<boost::shared_ptr<TMemoryInstance>> out;
    out.reserve(fLiveCount);
    for (const auto& i : fInstances)
        if (!i->IsDeleted()) out.push_back(i);
    return out;
}

unsigned TMemoryClass::EnsureProperty(const TPropertyValue& value) {
    auto it = fPropertyIndex.find(value.fName);
    if (it != fPropertyIndex.end()) return it->second;
    TPropertyDeclData data;
    data.fName = value.fName;
    if (!value.fValue.IsNull() || value.fType == TType::eUnknown) {
        data.fType = value.fValue.GetType();
        data.fIsArray = value.fValue.IsArray();
    } else {
        data.fType = value.fType;
        data.fIsArray = value.fIsArray;
    }
    if (data.fType == TType::eUnknown) data.fType = TType::eString;
    data.fReferenceClass = value.fReferenceClass;
    data.fEmbeddedObject = value.fEmbeddedObject;
    data.fClassOrigin = fName;
    auto decl = boost::make_shared<TMemoryPropertyDecl>(data);
    decl->SetInferred(true);
    unsigned index = static_cast<unsigned>(fProperties.size());
    fProperties.push_back(decl);
    fPropertyIndex.emplace(value.fName, index);
    return index;
}

void TMemoryClass::AddKeyName(const std::string& name) {
    for (const auto& k : fKeyNames)
        if (NamesEqual(k, name)) return;
    fKeyNames.push_back(name);
}

void TMemoryClass::Compact() {
    if (fDeletedCount == 0) return;
    fInstances.erase(std::remove_if(fInstances.begin(), fInstances.end(),
                                    [](const boost::shared_ptr<TMemoryInstance>& i) { return i->IsDeleted(); }),
                     fInstances.end());
    fDeletedCount = 0;
}

// Indices are read afresh on each step, so a callback that adds instances
// does not invalidate the walk; instances added during the walk are not
// visited. Deleted instances are dropped from the list only when no walk of
// this class is under way. Subclasses are walked depth first in declaration
// order, from a list rather than by recursion, so that a long chain of
// subclasses takes no stack.
bool TMemoryClass::Walk(const NORVTKR20::TInstanceCallback& callback, bool deep) {
    std::vector<TMemoryClass*> pending(1, this);
    std::vector<TMemoryClass*> walking;
    struct TGuard {
        std::vector<TMemoryClass*>& fClasses;
        ~TGuard() {
            for (TMemoryClass* c : fClasses) --c->fWalking;
        }
    } guard{walking};
    while (!pending.empty()) {
        TMemoryClass* cls = pending.back();
        pending.pop_back();
        if (cls->fWalking == 0) cls->Compact();
        ++cls->fWalking;
        walking.push_back(cls);
        const size_t n = cls->fInstances.size();
        for (size_t i = 0; i < n; ++i) {
            boost::shared_ptr<TMemoryInstance> inst = cls->fInstances[i];
            if (inst->IsDeleted()) continue;
            if (!callback(inst)) return false;
        }
        if (deep) pending.insert(pending.end(), cls->fSubClasses.rbegin(), cls->fSubClasses.rend());
    }
    return true;
}

void TMemoryClass::EnumerateInstances(const NORVTKR20::TInstanceCallback& callback, bool deep, const TCIMContext&) {
    fNamespace.Link();
    if (callback) Walk(callback, deep);
}

void TMemoryClass::EnumerateSubClasses(const NORVTKR20::TClassCallback& callback, bool deep, const TCIMContext&) {
    fNamespace.Link();
    if (!callback) return;
    boost::shared_ptr<TMemoryNamespace> owner = fNamespace.Self();
    // Depth first in declaration order, from a list rather than by recursion.
    std::vector<TMemoryClass*> pending(fSubClasses.rbegin(), fSubClasses.rend());
    while (!pending.empty()) {
        TMemoryClass* sub = pending.back();
        pending.pop_back();
        if (!callback(boost::shared_ptr<NORVTKR20::ICIMClass>(owner, sub))) return;
        if (deep) pending.insert(pending.end(), sub->fSubClasses.rbegin(), sub->fSubClasses.rend());
    }
}

void TMemoryClass::EnumerateAssociatorClasses(const NORVTKR20::TInstanceCallback& callback, bool deep,
                                              const TCIMContext& context) {
    // The association instances that reference any instance of this class
    // (and, when deep, of its subclasses), each once.
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> instances;
    EnumerateInstances(
        [&](boost::shared_ptr<NORVTKR20::ICIMInstance> i) {
            instances.push_back(i);
            return true;
        },
        deep, context);
    std::unordered_set<TMemoryInstance*> seen;
    TRepositoryIndexes& indexes = fNamespace.Indexes();
    for (const auto& i : instances) {
        TMemoryInstance* mi = static_cast<TMemoryInstance*>(i.get());
        for (const auto* link : indexes.LinksTo(mi)) {
            if (link->fAssociation->IsDeleted() || !seen.insert(link->fAssociation).second) continue;
            if (!callback(link->fAssociation->shared_from_this())) return;
        }
    }
}

std::vector<std::string> TMemoryClass::GetPropertyList(const std::string&, const TCIMContext&) {
    fNamespace.Link();
    std::vector<std::string> names;
    for (const auto& d : fProperties) names.push_back(d->GetName());
    return names;
}

boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> TMemoryClass::GetPropertyDecl(const std::string& name,
                                                                                   const TCIMContext&) {
    fNamespace.Link();
    int index = FindProperty(name);
    if (index < 0) throw TTKRException(NORVTKR20::kNotFound);
    return fProperties[static_cast<size_t>(index)];
}

boost::shared_ptr<NORVTKR20::ICIMInstance> TMemoryClass::CreateInstance(const TCIMContext&) {
    fNamespace.Link();
    boost::shared_ptr<TMemoryInstance> inst = boost::make_shared<TMemoryInstance>(*this);
    fInstances.push_back(inst);
    ++fLiveCount;
    fNamespace.Invalidate();
    return inst;
}

}  // namespace repository
}  // namespace braigrion
