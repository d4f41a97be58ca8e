#include "repository/RepositoryIndexes.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <cmath>
#include <functional>

#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"
#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

typedef NORVTKR20::TCIMValue::TCIMType TType;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;

namespace {

std::string Lower(const std::string& s) {
    std::string out = s;
    for (auto& c : out) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    return out;
}

void AppendPiece(char kind, const char* text, size_t size, std::string& out) {
    out += kind;
    out += std::to_string(size);
    out += ':';
    out.append(text, size);
}

void AppendPiece(char kind, const std::string& text, std::string& out) { AppendPiece(kind, text.data(), text.size(), out); }

void AppendInteger(bool negative, std::uint64_t magnitude, std::string& out) {
    char buf[24];
    char* p = buf;
    if (negative && magnitude != 0) *p++ = '-';
    p = std::to_chars(p, buf + sizeof buf, magnitude).ptr;
    AppendPiece('n', buf, static_cast<size_t>(p - buf), out);
}

// A real as it compares with integers: integral values as the integer.
void AppendReal(double d, std::string& out) {
    if (std::isfinite(d) && d == std::floor(d) && std::fabs(d) < 9.2e18) {
        const bool negative = d < 0;
        AppendInteger(negative, static_cast<std::uint64_t>(negative ? -d : d), out);
        return;
    }
    char buf[40];
    char* p = std::to_chars(buf, buf + sizeof buf, d).ptr;
    AppendPiece('n', buf, static_cast<size_t>(p - buf), out);
}

void AppendReference(const TCIMReference& ref, std::string& out);

// Text compares with text exactly, with booleans ignoring case and with
// numbers by the number it spells; a text that spells a path compares with
// a reference through the path's text.
void AppendText(const std::string& text, std::string& out) {
    if (text.size() == 4 || text.size() == 5) {
        const std::string lower = Lower(text);
        if (lower == "true" || lower == "false") {
            AppendPiece('n', lower == "true" ? "1" : "0", 1, out);
            return;
        }
    }
    if (text.find_first_of("0123456789") != std::string::npos) {
        bool negative = false;
        std::uint64_t magnitude = 0;
        double real = 0;
        if (TCIMValue::ParseIntegerText(text, negative, magnitude)) {
            AppendInteger(negative, magnitude, out);
            return;
        }
        if (TCIMValue::ParseRealText(text, real)) {
            AppendReal(real, out);
            return;
        }
    }
    if (text.find('=') != std::string::npos) {
        TCIMReference parsed;
        if (TCIMReference::ParsePath(text, parsed)) {
            AppendReference(parsed, out);
            return;
        }
    }
    AppendPiece('s', text, out);
}

void AppendReference(const TCIMReference& ref, std::string& out) {
    std::vector<std::pair<std::string, const TCIMValue*>> keys;
    for (const auto& kv : ref.GetKeyBindings()) keys.emplace_back(Lower(kv.first), &kv.second);
    std::sort(keys.begin(), keys.end(),
              [](const std::pair<std::string, const TCIMValue*>& a, const std::pair<std::string, const TCIMValue*>& b) {
                  return a.first < b.first;
              });
    std::string inner;
    AppendPiece('c', Lower(ref.GetClassName()), inner);
    for (const auto& key : keys) {
        AppendPiece('k', key.first, inner);
        AppendKeyIndexText(*key.second, inner);
    }
    AppendPiece('r', inner, out);
}

// The value an instance holds under a key name: a property, or a key binding
// that only its source path stated.
const TCIMValue* KeyValueOf(const TMemoryInstance& inst, const std::string& name) {
    if (const TMemoryInstance::TSlot* slot = inst.FindSlot(name)) return &slot->fValue;
    for (const auto& extra : inst.GetExtraKeys())
        if (NamesEqual(extra.first, name)) return &extra.second;
    return nullptr;
}

// Visits the live instances of a class and its subclasses, the class's own
// first, subclasses depth first in declaration order, until `visit` answers
// false. Iterative: a long superclass chain takes no stack.
template <typename F>
void ForFamily(TMemoryClass& cls, F&& visit) {
    std::vector<TMemoryClass*> pending(1, &cls);
    while (!pending.empty()) {
        TMemoryClass* next = pending.back();
        pending.pop_back();
        for (const auto& inst : next->GetInstanceList()) {
            if (!inst->IsDeleted() && !visit(inst.get())) return;
        }
        const auto& subs = next->GetSubClasses();
        pending.insert(pending.end(), subs.rbegin(), subs.rend());
    }
}

std::uint64_t Hash(const std::string& text) { return std::hash<std::string>()(text); }

}  // namespace

void AppendKeyIndexText(const TCIMValue& value, std::string& out) {
    if (value.IsNull()) {
        AppendPiece('0', "", 0, out);
        return;
    }
    if (value.IsArray()) {
        AppendPiece('a', value.ToString(10), out);
        return;
    }
    const int t = value.GetType();
    switch (t) {
        case TType::eBoolean:
            AppendPiece('n', static_cast<bool>(value) ? "1" : "0", 1, out);
            return;
        case TType::eUint8:
        case TType::eUint16:
        case TType::eUint32:
        case TType::eUint64:
            AppendInteger(false, value.AsUnsigned(), out);
            return;
        case TType::eSint8:
        case TType::eSint16:
        case TType::eSint32:
        case TType::eSint64: {
            const std::int64_t i = value.AsSigned();
            AppendInteger(i < 0, i < 0 ? 0 - static_cast<std::uint64_t>(i) : static_cast<std::uint64_t>(i), out);
            return;
        }
        case TType::eReal32:
        case TType::eReal64:
            AppendReal(value.AsReal(), out);
            return;
        case TType::eReference:
            AppendReference(*value.GetReference(), out);
            return;
        default:
            AppendText(value.ToString(10), out);
            return;
    }
}

std::string KeyIndexText(const TCIMValue& value) {
    std::string out;
    AppendKeyIndexText(value, out);
    return out;
}

TRepositoryIndexes::TPathIndex& TRepositoryIndexes::PathIndex(TMemoryClass& cls,
                                                              const std::vector<std::string>& names) {
    std::vector<TPathIndex>& indexes = fPathIndexes[&cls];
    for (TPathIndex& index : indexes)
        if (index.fNames == names) return index;
    indexes.emplace_back();
    TPathIndex& index = indexes.back();
    index.fNames = names;
    std::string text;
    std::uint32_t order = 0;
    ForFamily(cls, [&](TMemoryInstance* inst) {
        ++order;
        text.clear();
        for (const std::string& name : names) {
            const TCIMValue* v = KeyValueOf(*inst, name);
            if (!v) return true;  // cannot match a path that names this key
            AppendKeyIndexText(*v, text);
        }
        index.fByKey.emplace(Hash(text), TPathIndex::TEntry{inst, order});
        return true;
    });
    return index;
}

TMemoryInstance* TRepositoryIndexes::Resolve(const TCIMReference& path) {
    TMemoryClass* cls = fNamespace.FindClass(path.GetClassName());
    if (!cls) return nullptr;
    const auto& bindings = path.GetKeyBindings();
    if (bindings.empty()) {
        // A path without keys names a singleton.
        TMemoryInstance* first = nullptr;
        ForFamily(*cls, [&](TMemoryInstance* inst) {
            first = inst;
            return false;
        });
        return first;
    }
    fKeys.clear();
    for (const auto& kv : bindings) fKeys.emplace_back(Lower(kv.first), &kv.second);
    std::sort(fKeys.begin(), fKeys.end(),
              [](const std::pair<std::string, const TCIMValue*>& a, const std::pair<std::string, const TCIMValue*>& b) {
                  return a.first < b.first;
              });
    fNames.clear();
    fText.clear();
    for (const auto& key : fKeys) {
        fNames.push_back(key.first);
        AppendKeyIndexText(*key.second, fText);
    }
    const TPathIndex& index = PathIndex(*cls, fNames);
    auto range = index.fByKey.equal_range(Hash(fText));
    TMemoryInstance* found = nullptr;
    std::uint32_t foundOrder = 0;
    for (auto it = range.first; it != range.second; ++it) {
        TMemoryInstance* candidate = it->second.fInstance;
        if (candidate->IsDeleted() || (found && it->second.fOrder > foundOrder)) continue;
        bool all = true;
        for (const auto& key : fKeys) {
            const TCIMValue* v = KeyValueOf(*candidate, key.first);
            if (!v || !NORVTKR20::KeyValuesEqual(*v, *key.second)) {
                all = false;
                break;
            }
        }
        if (all) {
            found = candidate;
            foundOrder = it->second.fOrder;
        }
    }
    return found;
}

void TRepositoryIndexes::BuildLinks() {
    fLinksBuilt = true;
    for (TMemoryClass* cls : fNamespace.GetClasses()) {
        bool hasReferences = false;
        for (const auto& d : cls->GetProperties()) hasReferences = hasReferences || d->GetType() == TType::eReference;
        if (!hasReferences) continue;
        for (const auto& inst : cls->GetInstanceList()) {
            if (inst->IsDeleted()) continue;
            for (const auto& slot : inst->GetSlots()) {
                const TCIMReference* ref = slot.fValue.GetReference();
                if (!ref) continue;
                fLinks.push_back(TLink{inst.get(), slot.fDecl, Resolve(*ref)});
            }
        }
    }
    fLinksFrom.reserve(fLinks.size());
    fLinksTo.reserve(fLinks.size());
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
