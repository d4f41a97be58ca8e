#include "repository/MemoryInstance.h"

#include <algorithm>
#include <unordered_set>

#include <boost/make_shared.hpp>

#include "repository/MemoryClass.h"
#include "repository/RepositoryIndexes.h"

namespace braigrion {
namespace repository {

using NORVTKR20::TTKRException;
typedef NORVTKR20::TCIMValue::TCIMType TType;

namespace {

// A handle on one present property of an instance. It names the property by
// its declaration, so it stays right when other properties are added.
class TMemoryProperty : public NORVTKR20::ICIMProperty {
public:
    TMemoryProperty(boost::shared_ptr<TMemoryInstance> instance, std::uint32_t decl)
        : fInstance(std::move(instance)), fDecl(decl) {}

    TType GetType(const TCIMContext&) override { return Decl().GetType(); }
    bool IsArray(const TCIMContext&) override { return Decl().IsArray(); }
    const TCIMValue& GetValue(const TCIMContext&) override { return Slot().fValue; }
    const TCIMValue& GetValue() override { return Slot().fValue; }
    void SetValue(const TCIMValue& value, const TCIMContext&) override { fInstance->SetSlotValue(fDecl, value); }
    boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> GetDeclaration(const TCIMContext&) override {
        return fInstance->GetMemoryClass().GetProperties()[fDecl];
    }
    bool IsRowMergeProperty() override { return Decl().IsRowMerge(); }

    std::string GetValueString() override {
        const TCIMValue& v = Slot().fValue;
        if (v.IsNull()) return std::string();
        if (!v.IsArray()) return Decl().MapValue(v);
        std::string out;
        for (const std::string& s : GetValueStrings()) {
            if (!out.empty()) out += ", ";
            out += s;
        }
        return out;
    }
    std::string GetValueMapString() override { return GetValueString(); }
    std::vector<std::string> GetValueStrings() override {
        std::vector<std::string> out;
        const TCIMValue& v = Slot().fValue;
        if (v.IsNull()) return out;
        if (!v.IsArray()) {
            out.push_back(Decl().MapValue(v));
            return out;
        }
        const std::vector<TCIMValue>& elems = v;
        out.reserve(elems.size());
        for (const TCIMValue& e : elems) out.push_back(e.IsNull() ? std::string() : Decl().MapValue(e));
        return out;
    }

private:
    const TMemoryPropertyDecl& Decl() const { return *fInstance->GetMemoryClass().GetProperties()[fDecl]; }
    TMemoryInstance::TSlot& Slot() {
        for (const auto& s : fInstance->GetSlots()) {
            if (s.fDecl == fDecl) return const_cast<TMemoryInstance::TSlot&>(s);
        }
        // Properties are never removed, so a handle always finds its slot.
        throw TTKRException(NORVTKR20::kNotFound);
    }

    boost::shared_ptr<TMemoryInstance> fInstance;
    std::uint32_t fDecl;
};

bool MatchesClass(TMemoryNamespace& ns, const TMemoryClass& cls, const std::string& name) {
    if (name.empty()) return true;
    TMemoryClass* wanted = ns.FindClass(name);
    return wanted && cls.IsA(wanted);
}

}  // namespace

TMemoryInstance::TMemoryInstance(TMemoryClass& cls) : fClass(&cls), fDeleted(false) {}

void TMemoryInstance::Delete(const TCIMContext&) {
    if (fDeleted) return;
    fDeleted = true;
    --fClass->fLiveCount;
    ++fClass->fDeletedCount;
    fClass->GetNamespace().Invalidate();
}

TCIMReference TMemoryInstance::GetPath(const TCIMContext&) {
    TMemoryNamespace& ns = fClass->GetNamespace();
    ns.Link();
    TCIMReference path(ns.Self(), fClass->GetName(), TCIMContext());
    const auto& decls = fClass->GetProperties();
    const auto& keys = fClass->GetKeyNames();
    if (!keys.empty()) {
        for (const std::string& key : keys) {
            if (const TSlot* slot = FindSlot(key)) path.AddKeyValue(decls[slot->fDecl]->GetName(), slot->fValue);
        }
    } else {
        // No key is known for the class: every present scalar names the instance.
        for (const TSlot& slot : fSlots) {
            if (!slot.fValue.IsNull() && !slot.fValue.IsArray())
                path.AddKeyValue(decls[slot.fDecl]->GetName(), slot.fValue);
        }
    }
    for (const auto& extra : fExtraKeys) path.AddKeyValue(extra.first, extra.second);
    return path;
}

boost::shared_ptr<NORVTKR20::ICIMClass> TMemoryInstance::GetClass(const TCIMContext&) {
    return boost::shared_ptr<NORVTKR20::ICIMClass>(fClass->GetNamespace().Self(), fClass);
}

void TMemoryInstance::EnumerateAssociatedInstances(const NORVTKR20::TInstanceCallback& callback,
                                                   const std::string& assocClass, const std::string& resultClass,
                                                   const std::string& role, const std::string& resultRole,
                                                   const TCIMContext&) {
    TMemoryNamespace& ns = fClass->GetNamespace();
    ns.Link();
    if (!callback) return;
    TRepositoryIndexes& indexes = ns.Indexes();
    // Copy the links: the callback may write and so drop the indexes.
    std::vector<const TRepositoryIndexes::TLink*> links = indexes.LinksTo(this);
    std::vector<TMemoryInstance*> results;
    std::unordered_set<TMemoryInstance*> seen;
    for (const auto* link : links) {
        TMemoryInstance* assoc = link->fAssociation;
        if (assoc->fDeleted || !MatchesClass(ns, *assoc->fClass, assocClass)) continue;
        const auto& decls = assoc->fClass->GetProperties();
        if (!role.empty() && !NamesEqual(decls[link->fDecl]->GetName(), role)) continue;
        for (const auto* far : indexes.LinksFrom(assoc)) {
            if (far->fDecl == link->fDecl || !far->fTarget || far->fTarget->fDeleted) continue;
            if (!resultRole.empty() && !NamesEqual(decls[far->fDecl]->GetName(), resultRole)) continue;
            if (!MatchesClass(ns, *far->fTarget->fClass, resultClass)) continue;
            if (seen.insert(far->fTarget).second) results.push_back(far->fTarget);
        }
    }
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> handles;
    handles.reserve(results.size());
    for (TMemoryInstance* r : results) handles.push_back(r->shared_from_this());
    for (const auto& h : handles)
        if (!callback(h)) return;
}

void TMemoryInstance::EnumerateReferences(const NORVTKR20::TInstanceCallback& callback, const std::string& assocClass,
                                          const std::string& role, const TCIMContext&) {
    TMemoryNamespace& ns = fClass->GetNamespace();
    ns.Link();
    if (!callback) return;
    std::vector<const TRepositoryIndexes::TLink*> links = ns.Indexes().LinksTo(this);
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> handles;
    std::unordered_set<TMemoryInstance*> seen;
    for (const auto* link : links) {
        TMemoryInstance* assoc = link->fAssociation;
        if (assoc->fDeleted || !MatchesClass(ns, *assoc->fClass, assocClass)) continue;
        if (!role.empty() && !NamesEqual(assoc->fClass->GetProperties()[link->fDecl]->GetName(), role)) continue;
        if (seen.insert(assoc).second) handles.push_back(assoc->shared_from_this());
    }
    for (const auto& h : handles)
        if (!callback(h)) return;
}

const TMemoryInstance::TSlot* TMemoryInstance::FindSlot(const std::string& name) const {
    int decl = fClass->FindProperty(name);
    if (decl < 0) return nullptr;
    for (const TSlot& s : fSlots)
        if (s.fDecl == static_cast<std::uint32_t>(decl)) return &s;
    return nullptr;
}

boost::shared_ptr<NORVTKR20::ICIMProperty> TMemoryInstance::GetProperty(const std::string& name, const TCIMContext&) {
    fClass->GetNamespace().Link();
    const TSlot* slot = FindSlot(name);
    if (!slot) throw TTKRException(NORVTKR20::kNotFound);
    return boost::make_shared<TMemoryProperty>(shared_from_this(), slot->fDecl);
}

boost::shared_ptr<NORVTKR20::ICIMProperty> TMemoryInstance::AddProperty(const std::string& name,
                                                                        const TCIMValue& value, const TCIMContext&) {
    fClass->GetNamespace().Link();
    TPropertyValue pv;
    pv.fName = name;
    pv.fValue = value;
    std::uint32_t decl = fClass->EnsureProperty(pv);
    bool present = false;
    for (const TSlot& s : fSlots) present = present || s.fDecl == decl;
    if (present) {
        SetSlotValue(decl, value);
    } else {
        InsertSlot(decl, value);
        const TMemoryPropertyDecl& d = *fClass->GetProperties()[decl];
        if (d.IsKey() || d.GetType() == TType::eReference) fClass->GetNamespace().Invalidate();
    }
    return boost::make_shared<TMemoryProperty>(shared_from_this(), decl);
}

void TMemoryInstance::EnumerateProperties(const NORVTKR20::TPropertyCallback& callback, const TCIMContext&) {
    fClass->GetNamespace().Link();
    if (!callback) return;
    std::vector<std::uint32_t> decls;
    decls.reserve(fSlots.size());
    for (const TSlot& s : fSlots) decls.push_back(s.fDecl);
    boost::shared_ptr<TMemoryInstance> self = shared_from_this();
    for (std::uint32_t d : decls)
        if (!callback(boost::make_shared<TMemoryProperty>(self, d))) return;
}

void TMemoryInstance::SetSlotValue(std::uint32_t decl, const TCIMValue& value) {
    for (TSlot& s : fSlots) {
        if (s.fDecl == decl) {
            s.fValue = value;
            const TMemoryPropertyDecl& d = *fClass->GetProperties()[decl];
            if (d.IsKey() || d.GetType() == TType::eReference || value.GetType() == TType::eReference)
                fClass->GetNamespace().Invalidate();
            return;
        }
    }
}

std::uint32_t TMemoryInstance::InsertSlot(std::uint32_t decl, TCIMValue value) {
    if (fSlots.empty() || fSlots.back().fDecl < decl) {
        fSlots.push_back(TSlot{decl, std::move(value)});
        return static_cast<std::uint32_t>(fSlots.size() - 1);
    }
    auto it = std::lower_bound(fSlots.begin(), fSlots.end(), decl,
                               [](const TSlot& s, std::uint32_t d) { return s.fDecl < d; });
    if (it != fSlots.end() && it->fDecl == decl) {
        it->fValue = std::move(value);  // a property given twice: the later value stands
    } else {
        it = fSlots.insert(it, TSlot{decl, std::move(value)});
    }
    return static_cast<std::uint32_t>(it - fSlots.begin());
}

}  // namespace repository
}  // namespace braigrion
