#include "repository/MemoryRepository.h"

#include <algorithm>
#include <cctype>
#include <functional>
#include <strings.h>
#include <unordered_set>

#include <boost/make_shared.hpp>

#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"
#include "repository/RepositoryIndexes.h"

namespace braigrion {
namespace repository {

using NORVTKR20::TTKRException;

size_t TNameHash::operator()(const std::string& s) const {
    size_t h = 1469598103934665603ull;
    for (unsigned char c : s) {
        h ^= static_cast<size_t>(std::tolower(c));
        h *= 1099511628211ull;
    }
    return h;
}

bool TNameEqual::operator()(const std::string& a, const std::string& b) const { return NamesEqual(a, b); }

bool NamesEqual(const std::string& a, const std::string& b) {
    return a.size() == b.size() && strncasecmp(a.data(), b.data(), a.size()) == 0;
}

namespace {

class TProvider : public NORVTKR20::INamespaceProvider {
public:
    explicit TProvider(int type) : fType(type) {}
    int GetProviderType(const TCIMContext&) override { return fType; }

private:
    int fType;
};

}  // namespace

TMemoryNamespace::TMemoryNamespace() : fLinked(true), fGeneration(0) {}

TMemoryNamespace::~TMemoryNamespace() = default;

boost::shared_ptr<TMemoryNamespace> TMemoryNamespace::Create() {
    return boost::shared_ptr<TMemoryNamespace>(new TMemoryNamespace());
}

boost::shared_ptr<NORVTKR20::INamespaceProvider> TMemoryNamespace::GetNamespaceProvider(const TCIMContext&) {
    return boost::make_shared<TProvider>(0);
}

boost::shared_ptr<NORVTKR20::ICIMClass> TMemoryNamespace::GetClass(const std::string& name, const TCIMContext&) {
    Link();
    TMemoryClass* cls = FindClass(name);
    if (!cls) throw TTKRException(NORVTKR20::kNotFound);
    // The handle shares ownership of the namespace, so the class outlives
    // nothing it depends on.
    return boost::shared_ptr<NORVTKR20::ICIMClass>(shared_from_this(), cls);
}

boost::shared_ptr<NORVTKR20::ICIMInstance> TMemoryNamespace::GetInstance(const TCIMReference& path,
                                                                         const TCIMContext&) {
    Link();
    TMemoryInstance* found = Indexes().Resolve(path);
    if (!found) throw TTKRException(NORVTKR20::kNotFound);
    return found->shared_from_this();
}

TMemoryClass* TMemoryNamespace::FindClass(const std::string& name) const {
    auto it = fClassByName.find(name);
    return it == fClassByName.end() ? nullptr : it->second;
}

std::vector<TMemoryClass*> TMemoryNamespace::GetClasses() const {
    std::vector<TMemoryClass*> out;
    out.reserve(fClasses.size());
    for (const auto& c : fClasses) out.push_back(c.get());
    return out;
}

size_t TMemoryNamespace::GetInstanceCount() const {
    size_t n = 0;
    for (const auto& c : fClasses) n += c->GetInstanceCount();
    return n;
}

TMemoryClass& TMemoryNamespace::EnsureClass(const std::string& name) {
    TMemoryClass* cls = FindClass(name);
    if (cls) return *cls;
    fClasses.emplace_back(new TMemoryClass(*this, name));
    cls = fClasses.back().get();
    fClassByName.emplace(name, cls);
    return *cls;
}

void TMemoryNamespace::DeclareClass(const TClassData& data) {
    TMemoryClass& cls = EnsureClass(data.fName);
    cls.fDeclared = true;
    cls.fDeclaration = data;
    fLinked = false;
    Invalidate();
}

void TMemoryNamespace::DeclareQualifierType(const TQualifierTypeData& data) {
    for (auto& q : fQualifierTypes) {
        if (NamesEqual(q.fName, data.fName)) {
            q = data;
            return;
        }
    }
    fQualifierTypes.push_back(data);
}

boost::shared_ptr<TMemoryInstance> TMemoryNamespace::AddInstance(const std::string& className,
                                                                 std::vector<TPropertyValue> properties,
                                                                 const TCIMReference* path) {
    TMemoryClass& cls = EnsureClass(className);
    boost::shared_ptr<TMemoryInstance> inst = boost::make_shared<TMemoryInstance>(cls);
    inst->fSlots.reserve(properties.size());
    for (TPropertyValue& pv : properties) {
        std::uint32_t decl = cls.EnsureProperty(pv);
        inst->InsertSlot(decl, std::move(pv.fValue));
    }
    if (path) {
        for (const auto& kv : path->GetKeyBindings()) {
            cls.AddKeyName(kv.first);
            if (!inst->FindSlot(kv.first)) inst->fExtraKeys.emplace_back(kv.first, kv.second);
        }
    }
    cls.fInstances.push_back(inst);
    ++cls.fLiveCount;
    Invalidate();
    return inst;
}

TRepositoryIndexes& TMemoryNamespace::Indexes() {
    if (!fIndexes) fIndexes.reset(new TRepositoryIndexes(*this));
    return *fIndexes;
}

void TMemoryNamespace::Invalidate() {
    if (fIndexes) fIndexes.reset();
    ++fGeneration;
}

namespace {

// Effective qualifiers: the own ones, then those of `inherited` that pass to
// subclasses and are not overridden, marked as propagated.
std::vector<TQualifierData> MergeQualifiers(const std::vector<TQualifierData>& own,
                                            const std::vector<TQualifierData>& inherited,
                                            const std::vector<TQualifierTypeData>& types) {
    std::vector<TQualifierData> out = own;
    for (const TQualifierData& q : inherited) {
        if (!q.fToSubclass) continue;
        bool restricted = false;
        for (const auto& t : types) {
            if (NamesEqual(t.fName, q.fName)) restricted = !t.fToSubclass;
        }
        if (restricted) continue;
        bool overridden = std::any_of(out.begin(), out.end(),
                                      [&](const TQualifierData& o) { return NamesEqual(o.fName, q.fName); });
        if (overridden) continue;
        TQualifierData copy = q;
        copy.fPropagated = true;
        out.push_back(copy);
    }
    return out;
}

}  // namespace

void TMemoryNamespace::Link() {
    if (fLinked) return;
    // Superclasses; a cycle or an unknown superclass leaves a class at the
    // root. Classes take their superclass in declaration order, and the one
    // whose superclass would close a cycle stays at the root. The top of each
    // chain is kept in a union-find, so that the cycle check costs nearly
    // nothing per class however long the chains are.
    const size_t count = fClasses.size();
    std::unordered_map<const TMemoryClass*, size_t> indexOf;
    indexOf.reserve(count);
    std::vector<size_t> top(count);
    for (size_t i = 0; i < count; ++i) {
        fClasses[i]->fSuper = nullptr;
        fClasses[i]->fSubClasses.clear();
        indexOf.emplace(fClasses[i].get(), i);
        top[i] = i;
    }
    auto topOf = [&top](size_t x) {
        size_t r = x;
        while (top[r] != r) r = top[r];
        while (top[x] != r) {
            const size_t next = top[x];
            top[x] = r;
            x = next;
        }
        return r;
    };
    for (size_t i = 0; i < count; ++i) {
        TMemoryClass* c = fClasses[i].get();
        if (!c->fDeclared || c->fDeclaration.fSuperClass.empty()) continue;
        TMemoryClass* super = FindClass(c->fDeclaration.fSuperClass);
        if (!super) continue;
        const size_t s = indexOf[super];
        if (topOf(s) == i) continue;  // the superclass descends from this class
        c->fSuper = super;
        super->fSubClasses.push_back(c);
        top[i] = s;
    }
    // Effective properties, superclasses first: roots in declaration order,
    // then their subclasses level by level.
    std::vector<TMemoryClass*> order;
    order.reserve(count);
    for (auto& c : fClasses)
        if (!c->fSuper) order.push_back(c.get());
    for (size_t k = 0; k < order.size(); ++k)
        order.insert(order.end(), order[k]->fSubClasses.begin(), order[k]->fSubClasses.end());
    auto linkOne = [&](TMemoryClass* cls) {
        std::vector<TPropertyDeclData> decls;
        std::vector<bool> inferred;
        auto findDecl = [&](const std::string& name) -> int {
            for (size_t i = 0; i < decls.size(); ++i)
                if (NamesEqual(decls[i].fName, name)) return static_cast<int>(i);
            return -1;
        };
        if (cls->fSuper) {
            for (const auto& d : cls->fSuper->fProperties) {
                TPropertyDeclData data = d->GetData();
                data.fPropagated = true;
                if (data.fClassOrigin.empty()) data.fClassOrigin = cls->fSuper->fName;
                std::vector<TQualifierData> quals;
                for (TQualifierData q : data.fQualifiers) {
                    if (!q.fToSubclass) continue;
                    q.fPropagated = true;
                    quals.push_back(q);
                }
                data.fQualifiers = quals;
                decls.push_back(data);
                inferred.push_back(d->IsInferred());
            }
        }
        if (cls->fDeclared) {
            for (const TPropertyDeclData& own : cls->fDeclaration.fProperties) {
                int at = findDecl(own.fName);
                TPropertyDeclData data = own;
                if (data.fClassOrigin.empty()) data.fClassOrigin = cls->fName;
                if (at >= 0) {
                    data.fQualifiers = MergeQualifiers(own.fQualifiers, decls[at].fQualifiers, fQualifierTypes);
                    decls[at] = data;
                    inferred[at] = false;
                } else {
                    decls.push_back(data);
                    inferred.push_back(false);
                }
            }
        }
        // Properties that instances hold and no declaration names stay, as
        // undeclared ones without qualifiers.
        std::vector<bool> used(cls->fProperties.size(), false);
        for (const auto& inst : cls->fInstances)
            for (const auto& slot : inst->fSlots) used[slot.fDecl] = true;
        std::vector<std::uint32_t> remap(cls->fProperties.size(), 0);
        for (size_t i = 0; i < cls->fProperties.size(); ++i) {
            const auto& old = cls->fProperties[i];
            int at = findDecl(old->GetName());
            if (at < 0) {
                if (!used[i]) continue;
                TPropertyDeclData data = old->GetData();
                data.fQualifiers.clear();
                data.fPropagated = false;
                decls.push_back(data);
                inferred.push_back(true);
                at = static_cast<int>(decls.size() - 1);
            }
            remap[i] = static_cast<std::uint32_t>(at);
        }
        cls->fProperties.clear();
        cls->fPropertyIndex.clear();
        for (size_t i = 0; i < decls.size(); ++i) {
            auto decl = boost::make_shared<TMemoryPropertyDecl>(decls[i]);
            decl->SetInferred(inferred[i]);
            cls->fPropertyIndex.emplace(decls[i].fName, static_cast<unsigned>(i));
            cls->fProperties.push_back(decl);
        }
        for (auto& inst : cls->fInstances) {
            for (auto& slot : inst->fSlots) slot.fDecl = remap[slot.fDecl];
            std::stable_sort(inst->fSlots.begin(), inst->fSlots.end(),
                             [](const TMemoryInstance::TSlot& a, const TMemoryInstance::TSlot& b) {
                                 return a.fDecl < b.fDecl;
                             });
        }
        cls->fQualifiers = MergeQualifiers(cls->fDeclared ? cls->fDeclaration.fQualifiers : std::vector<TQualifierData>(),
                                           cls->fSuper ? cls->fSuper->fQualifiers : std::vector<TQualifierData>(),
                                           fQualifierTypes);
        std::vector<std::string> keys;
        for (const auto& d : cls->fProperties)
            if (d->IsKey()) keys.push_back(d->GetName());
        for (const auto& k : cls->fKeyNames) {
            if (std::none_of(keys.begin(), keys.end(), [&](const std::string& n) { return NamesEqual(n, k); }))
                keys.push_back(k);
        }
        cls->fKeyNames = keys;
    };
    for (TMemoryClass* c : order) linkOne(c);
    fLinked = true;
    Invalidate();
}

}  // namespace repository
}  // namespace braigrion
