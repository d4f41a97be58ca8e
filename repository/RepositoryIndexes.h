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

    // The live instance a path names, or null. Constant time once the index
    // of the path's class and key names is built (one pass over the class).
    TMemoryInstance* Resolve(const NORVTKR20::TCIMReference& path);
    // Links whose target is `target`, in load order.
    const std::vector<const TLink*>& LinksTo(TMemoryInstance* target);
    // The reference links of one association instance.
    const std::vector<const TLink*>& LinksFrom(TMemoryInstance* association);
    // Builds the links now (they are otherwise built by the first query).
    void BuildLinksNow() {
        if (!fLinksBuilt) BuildLinks();
    }

private:
    // The instances of a class family by all the key bindings a path names
    // together: the hash of their normalised values -> candidates. Equal
    // values always hash alike; candidates are checked value by value.
    struct TPathIndex {
        std::vector<std::string> fNames;  // the key names, lower case, sorted
        struct TEntry {
            TMemoryInstance* fInstance;
            std::uint32_t fOrder;  // place in the family's walk: the first match wins
        };
        std::unordered_multimap<std::uint64_t, TEntry> fByKey;
    };

    void BuildLinks();
    TPathIndex& PathIndex(TMemoryClass& cls, const std::vector<std::string>& names);

    TMemoryNamespace& fNamespace;
    bool fLinksBuilt;
    std::vector<TLink> fLinks;
    std::unordered_map<TMemoryInstance*, std::vector<const TLink*>> fLinksTo;
    std::unordered_map<TMemoryInstance*, std::vector<const TLink*>> fLinksFrom;
    std::unordered_map<TMemoryClass*, std::vector<TPathIndex>> fPathIndexes;
    std::vector<const TLink*> fEmpty;
    // Scratch space of Resolve, kept to spare an allocation per path.
    std::vector<std::pair<std::string, const NORVTKR20::TCIMValue*>> fKeys;
    std::vector<std::string> fNames;
    std::string fText;
};

// Appends to `out` the text under which a key value is indexed: the same for
// any two values that KeyValuesEqual treats as equal (numbers by value
// whatever their type or spelling, booleans as 1 and 0, references by class
// and keys ignoring the case of names), length-prefixed so that texts of
// several keys never run into each other. Different values may share a text.
void AppendKeyIndexText(const NORVTKR20::TCIMValue& value, std::string& out);
std::string KeyIndexText(const NORVTKR20::TCIMValue& value);

}  // namespace repository
}  // namespace braigrion
