#include "repository/RepositoryIndexes.h"

#include <cctype>

#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"
#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

typedef NORVTKR20::TCIMValue::TCIMType TType;
using NORVTKR20::TCIMValue;

std::string KeyIndexText(const TCIMValue& value) {
    if (value.IsNull()) return std::string("\x01", 1);
    if (value.IsArray()) return value.ToString(10);
    const int t = value.GetType();
    try {
        if (t >= TType::eUint8 && t <= TType::eSint64) {
            if (t == TType::eUint64) return std::to_string(value.AsUnsigned());
            return std::to_string(value.AsSigned());
        }
    } catch (const NORVTKR20::TTKRException&) {
    }
    if (t == TType::eReference) {
        std::string path = static_cast<NORVTKR20::TCIMReference>(value).GetPath();
        for (auto& c : path) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
        return path;
    }
    return value.ToString(10);
}

namespace {

std::string Lower(const std::string& s) {
    std::string out = s;
    for (auto& c : out) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return out;
}

// The value an instance holds under a key name: a property, or a key binding
// that only its source path stated.
const TCIMValue* KeyValueOf(const TMemoryInstance& inst, const std::string& name) {
    if (const TMemoryInstance::TSlot* slot = inst.FindSlot(name)) return &slot->fValue;
    for (const auto& extra : inst.GetExtraKeys())
        if (NamesEqual(extra.first, name)) return &extra.second;
    return nullptr;
}

template <typename F>
void ForFamily(TMemoryClass& cls, F&& visit) {
    for (const auto& inst : cls.GetInstances()) visit(inst.get());
    for (TMemoryClass* sub : cls.GetSubClasses()) ForFamily(*sub, visit);
}

}  // namespace

const TRepositoryIndexes::TValueIndex& TRepositoryIndexes::ValueIndex(TMemoryClass& cls,
                                                                      const std::string& property) {
    std::string key = Lower(cls.GetName());
    key += '\0';
    key += Lower(property);
    auto it = fValueIndexes.find(key);
    if (it != fValueIndexes.end()) return it->second;
    TValueIndex& index = fValueIndexes[key];
    ForFamily(cls, [&](TMemoryInstance* inst) {
        if (const TCIMValue* v = KeyValueOf(*inst, property)) index[KeyIndexText(*v)].push_back(inst);
    });
    return index;
}

TMemoryInstance* TRepositoryIndexes::Resolve(const NORVTKR20::TCIMReference& path) {
    TMemoryClass* cls = fNamespace.FindClass(path.GetClassName());
    if (!cls) return nullptr;
    const auto& keys = path.GetKeyBindings();
    if (keys.empty()) {
        // A path without keys names a singleton.
        TMemoryInstance* first = nullptr;
        ForFamily(*cls, [&](TMemoryInstance* inst) {
            if (!first) first = inst;
        });
        return first;
    }
    const auto& index = ValueIndex(*cls, keys.begin()->first);
    auto it = index.find(KeyIndexText(keys.begin()->second));
    if (it == index.end()) return nullptr;
    for (TMemoryInstance* candidate : it->second) {
        if (candidate->IsDeleted()) continue;
        bool all = true;
        for (const auto& kv : keys) {
            const TCIMValue* v = KeyValueOf(*candidate, kv.first);
            if (!v || !NORVTKR20::KeyValuesEqual(*v, kv.second)) {
                all = false;
                break;
            }
        }
        if (all) return candidate;
    }
    return nullptr;
}

void TRepositoryIndexes::BuildLinks() {
    fLinksBuilt = true;
    for (TMemoryClass* cls : fNamespace.GetClasses()) {
        bool hasReferences = false;
        for (const auto& d : cls->GetProperties()) hasReferences = hasReferences || d->GetType() == TType::eReference;
        if (!hasReferences) continue;
        for (const auto& inst : cls->GetInstances()) {
            for (const auto& slot : inst->GetSlots()) {
                const TCIMValue& v = slot.fValue;
                if (v.IsNull() || v.IsArray() || v.GetType() != TType::eReference) continue;
                TMemoryInstance* target = Resolve(static_cast<NORVTKR20::TCIMReference>(v));
                fLinks.push_back(TLink{inst.get(), slot.fDecl, target});
            }
        }
    }
    for (const TLink& link : fLinks) {
        fLinksFrom[link.fAssociation].push_back(&link);
        if (link.fTarget) fLinksTo[link.fTarget].push_back(&link);
    }
}

const std::vector<const TRepositoryIndexes::TLink*>& TRepositoryIndexes::LinksTo(TMemoryInstance* target) {
    if (!fLinksBuilt) BuildLinks();
    auto it = fLinksTo.find(target);
    return it == fLinksTo.end() ? fEmpty : it->second;
}

const std::vector<const TRepositoryIndexes::TLink*>& TRepositoryIndexes::LinksFrom(TMemoryInstance* association) {
    if (!fLinksBuilt) BuildLinks();
    auto it = fLinksFrom.find(association);
    return it == fLinksFrom.end() ? fEmpty : it->second;
}

}  // namespace repository
}  // namespace braigrion
