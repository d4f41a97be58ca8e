// Derived lookup structures of one collection: object paths to instances and
// references back from targets to the associations that name them. They are
// built on first use and dropped when a write could change them.
#pragma once

#include <cstdint>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "tkrcore/TCIMReference.h"

namespace braigrion {
namespace repository {

class TMemoryClass;
class TMemoryInstance;
class TMemoryNamespace;

struct TRepositoryIndexes {
    // One reference property of an association instance and what it resolves to.
    struct TLink {
        TMemoryInstance* fAssociation;
        std::uint32_t fDecl;
        TMemoryInstance* fTarget;  // null when the path names no loaded instance
    };

    explicit TRepositoryIndexes(TMemoryNamespace& ns) : fNamespace(ns), fLinksBuilt(false) {}

    // The live instance a path names, or null.
    TMemoryInstance* Resolve(const NORVTKR20::TCIMReference& path);
    // Links whose target is `target`, in load order.
    const std::vector<const TLink*>& LinksTo(TMemoryInstance* target);
    // The reference links of one association instance.
    const std::vector<const TLink*>& LinksFrom(TMemoryInstance* association);

private:
    typedef std::unordered_map<std::string, std::vector<TMemoryInstance*>> TValueIndex;

    void BuildLinks();
    const TValueIndex& ValueIndex(TMemoryClass& cls, const std::string& property);

    TMemoryNamespace& fNamespace;
    bool fLinksBuilt;
    std::vector<TLink> fLinks;
    std::unordered_map<TMemoryInstance*, std::vector<const TLink*>> fLinksTo;
    std::unordered_map<TMemoryInstance*, std::vector<const TLink*>> fLinksFrom;
    // (class, lower-case property name) -> value text -> instances of the class family
    std::unordered_map<std::string, TValueIndex> fValueIndexes;
    std::vector<const TLink*> fEmpty;
};

// The text under which a key value is indexed: equal for values that
// KeyValuesEqual treats as equal.
std::string KeyIndexText(const NORVTKR20::TCIMValue& value);

}  // namespace repository
}  // namespace braigrion
