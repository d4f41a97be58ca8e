// An instance of the in-memory repository and the property handles it gives out.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>

#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

class TMemoryClass;
class TMemoryPropertyDecl;

class TMemoryInstance : public NORVTKR20::ICIMInstance, public boost::enable_shared_from_this<TMemoryInstance> {
public:
    // One present property: the index of its declaration in the class and its value.
    struct TSlot {
        std::uint32_t fDecl;
        TCIMValue fValue;
    };

    explicit TMemoryInstance(TMemoryClass& cls);

    // --- the contract ---
    void Delete(const TCIMContext& context) override;
    TCIMReference GetPath(const TCIMContext& context) override;
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(const TCIMContext& context) override;
    void EnumerateAssociatedInstances(const NORVTKR20::TInstanceCallback& callback, const std::string& assocClass,
                                      const std::string& resultClass, const std::string& role,
                                      const std::string& resultRole, const TCIMContext& context) override;
    void EnumerateReferences(const NORVTKR20::TInstanceCallback& callback, const std::string& assocClass,
                             const std::string& role, const TCIMContext& context) override;
    boost::shared_ptr<NORVTKR20::ICIMProperty> GetProperty(const std::string& name, const TCIMContext& context) override;
    boost::shared_ptr<NORVTKR20::ICIMProperty> AddProperty(const std::string& name, const TCIMValue& value,
                                                           const TCIMContext& context) override;
    void EnumerateProperties(const NORVTKR20::TPropertyCallback& callback, const TCIMContext& context) override;

    // --- inspection ---
    TMemoryClass& GetMemoryClass() const { return *fClass; }
    const std::vector<TSlot>& GetSlots() const { return fSlots; }
    const TSlot* FindSlot(const std::string& name) const;
    bool IsDeleted() const { return fDeleted; }
    // Key bindings stated by the source's path that are not properties of the instance.
    const std::vector<std::pair<std::string, TCIMValue>>& GetExtraKeys() const { return fExtraKeys; }

    // Internal: writes through a property handle.
    void SetSlotValue(std::uint32_t slot, const TCIMValue& value);
    TSlot& SlotAt(std::uint32_t slot) { return fSlots[slot]; }

private:
    friend class TMemoryClass;
    friend class TMemoryNamespace;

    std::uint32_t InsertSlot(std::uint32_t decl, TCIMValue value);  // keeps declaration order

    TMemoryClass* fClass;
    std::vector<TSlot> fSlots;  // sorted by fDecl
    std::vector<std::pair<std::string, TCIMValue>> fExtraKeys;
    bool fDeleted;
};

}  // namespace repository
}  // namespace braigrion
