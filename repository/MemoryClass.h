// A class of the in-memory repository: its declaration, its effective
// properties after inheritance, and its instances.
#pragma once

#include <string>
#include <unordered_map>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "repository/MemoryRepository.h"
#include "repository/SchemaData.h"

namespace braigrion {
namespace repository {

class TMemoryQualifier : public NORVTKR20::ICIMQualifier {
public:
    explicit TMemoryQualifier(const TQualifierData& data) : fData(data) {}
    const TCIMValue& GetValue(const TCIMContext&) const override { return fData.fValue; }
    const TQualifierData& GetData() const { return fData; }

private:
    TQualifierData fData;
};

// A property declaration as a class sees it: its own qualifiers plus those
// its overridden declaration passes on.
class TMemoryPropertyDecl : public NORVTKR20::ICIMPropertyDecl {
public:
    explicit TMemoryPropertyDecl(const TPropertyDeclData& data);

    boost::shared_ptr<const NORVTKR20::ICIMQualifier> GetQualifier(const std::string& name, bool& propagated,
                                                                  const TCIMContext& context) const override;
    const std::string& GetName(const TCIMContext&) const override { return fData.fName; }

    const TPropertyDeclData& GetData() const { return fData; }
    const std::string& GetName() const { return fData.fName; }
    NORVTKR20::TCIMValue::TCIMType::ECIMType GetType() const { return fData.fType; }
    bool IsArray() const { return fData.fIsArray; }
    bool IsKey() const { return fKey; }
    bool IsRowMerge() const { return fRowMerge; }
    bool IsInferred() const { return fInferred; }
    void SetInferred(bool inferred) { fInferred = inferred; }
    // Display text of one scalar value after ValueMap/Values; the value's own
    // text when the qualifiers do not map it.
    std::string MapValue(const TCIMValue& scalar) const;
    bool HasValueMap() const { return !fValueMap.empty() || !fValues.empty(); }

private:
    TPropertyDeclData fData;
    std::vector<boost::shared_ptr<TMemoryQualifier>> fQualifiers;
    std::vector<std::string> fValueMap;
    std::vector<std::string> fValues;
    bool fKey;
    bool fRowMerge;
    bool fInferred;
};

class TMemoryClass : public NORVTKR20::ICIMClass {
public:
    TMemoryClass(TMemoryNamespace& ns, const std::string& name);

    // --- the contract ---
    void EnumerateAssociatorClasses(const NORVTKR20::TInstanceCallback& callback, bool deep,
                                    const TCIMContext& context) override;
    const std::string& GetClassName(const TCIMContext&) override { return fName; }
    std::vector<std::string> GetPropertyList(const std::string& name, const TCIMContext& context) override;
    void EnumerateSubClasses(const NORVTKR20::TClassCallback& callback, bool deep, const TCIMContext& context) override;
    boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> GetPropertyDecl(const std::string& name,
                                                                         const TCIMContext& context) override;
    boost::shared_ptr<NORVTKR20::ICIMInstance> CreateInstance(const TCIMContext& context) override;
    void EnumerateInstances(const NORVTKR20::TInstanceCallback& callback, bool deep,
                            const TCIMContext& context) override;

    // --- inspection ---
    const std::string& GetName() const { return fName; }
    bool IsDeclared() const { return fDeclared; }
    // The declaration as the source gave it (own properties and qualifiers only).
    const TClassData& GetDeclaration() const { return fDeclaration; }
    TMemoryClass* GetSuperClass() const { return fSuper; }
    const std::vector<TMemoryClass*>& GetSubClasses() const { return fSubClasses; }
    bool IsA(const TMemoryClass* ancestor) const;  // this class or a subclass of it
    bool IsAssociation() const;
    // Effective declarations: inherited first, then own, then inferred from instances.
    const std::vector<boost::shared_ptr<TMemoryPropertyDecl>>& GetProperties() const { return fProperties; }
    int FindProperty(const std::string& name) const;  // index, or -1
    // Effective class qualifiers (own, then propagated from the superclass).
    const std::vector<TQualifierData>& GetQualifiers() const { return fQualifiers; }
    // Key property names: Key-qualified declarations and the keys stated by instance paths.
    const std::vector<std::string>& GetKeyNames() const { return fKeyNames; }
    // The live instances of this class alone, in the order they were added.
    std::vector<boost::shared_ptr<TMemoryInstance>> GetInstances() const;
    size_t GetInstanceCount() const { return fLiveCount; }
    // The instances of this class alone without a copy, deleted ones that
    // are not yet compacted included (test IsDeleted()).
    const std::vector<boost::shared_ptr<TMemoryInstance>>& GetInstanceList() const { return fInstances; }
    TMemoryNamespace& GetNamespace() const { return fNamespace; }

private:
    friend class TMemoryNamespace;
    friend class TMemoryInstance;

    // Index of `name`, adding an inferred declaration when the class lacks it.
    unsigned EnsureProperty(const TPropertyValue& value);
    void AddKeyName(const std::string& name);
    void Compact();
    bool Walk(const NORVTKR20::TInstanceCallback& callback, bool deep);

    TMemoryNamespace& fNamespace;
    std::string fName;
    bool fDeclared;
    TClassData fDeclaration;
    TMemoryClass* fSuper;
    std::vector<TMemoryClass*> fSubClasses;
    std::vector<boost::shared_ptr<TMemoryPropertyDecl>> fProperties;
    std::unordered_map<std::string, unsigned, TNameHash, TNameEqual> fPropertyIndex;
    std::vector<TQualifierData> fQualifiers;
    std::vector<std::string> fKeyNames;
    std::vector<boost::shared_ptr<TMemoryInstance>> fInstances;  // may hold deleted ones until compacted
    size_t fLiveCount;
    size_t fDeletedCount;
    unsigned fWalking;
};

}  // namespace repository
}  // namespace braigrion
