// An in-memory CIM repository behind the core contract: one collection of
// classes, qualifiers and instances, built by the CIM-XML reader or by code.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>

#include "repository/SchemaData.h"
#include "tkrcore/tkrcore.h"

namespace braigrion {
namespace repository {

class TMemoryClass;
class TMemoryInstance;
struct TRepositoryIndexes;

using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;

// Case-insensitive hashing and comparison for CIM names.
struct TNameHash {
    size_t operator()(const std::string& s) const;
};
struct TNameEqual {
    bool operator()(const std::string& a, const std::string& b) const;
};
bool NamesEqual(const std::string& a, const std::string& b);

// One named property value of an instance being added.
struct TPropertyValue {
    std::string fName;
    TCIMValue fValue;
    // For a null value the type cannot be read off the value; say it here.
    TCIMValue::TCIMType::ECIMType fType = TCIMValue::TCIMType::eUnknown;
    bool fIsArray = false;
    std::string fReferenceClass;  // for a reference property, when known
    bool fEmbeddedObject = false;
};

class TMemoryNamespace : public NORVTKR20::ICIMNamespace,
                         public boost::enable_shared_from_this<TMemoryNamespace> {
public:
    static boost::shared_ptr<TMemoryNamespace> Create();
    ~TMemoryNamespace() override;

    // --- the contract ---
    boost::shared_ptr<NORVTKR20::INamespaceProvider> GetNamespaceProvider(const TCIMContext& context) override;
    // Throws kNotFound for a class that was never declared nor instantiated.
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(const std::string& name, const TCIMContext& context) override;
    // Throws kNotFound when no instance matches the path.
    boost::shared_ptr<NORVTKR20::ICIMInstance> GetInstance(const TCIMReference& path,
                                                           const TCIMContext& context) override;

    // --- building ---
    // Declares a class; a later declaration of the same name replaces the
    // earlier one. Instances already added keep their values.
    void DeclareClass(const TClassData& data);
    void DeclareQualifierType(const TQualifierTypeData& data);
    // Adds an instance of `className`, creating the class when it was never
    // declared (its properties' types are taken from the values). `path`,
    // when given, is the instance's object path as the source stated it; its
    // key names become keys of the class.
    boost::shared_ptr<TMemoryInstance> AddInstance(const std::string& className, std::vector<TPropertyValue> properties,
                                                   const TCIMReference* path = nullptr);
    // Resolves superclasses and computes every class's effective properties
    // and qualifiers. Called by the loader when all files are read; queries
    // call it themselves when the schema changed since.
    void Link();

    // --- inspection ---
    TMemoryClass* FindClass(const std::string& name) const;  // null when absent
    std::vector<TMemoryClass*> GetClasses() const;           // in declaration order
    const std::vector<TQualifierTypeData>& GetQualifierTypes() const { return fQualifierTypes; }
    size_t GetInstanceCount() const;
    // The collection's name (often the file it came from), for messages.
    const std::string& GetName() const { return fName; }
    void SetName(const std::string& name) { fName = name; }

    // Internal: the indexes of associations and object paths, rebuilt after writes.
    TRepositoryIndexes& Indexes();
    void Invalidate();  // drops derived indexes after a structural write
    boost::shared_ptr<TMemoryNamespace> Self() { return shared_from_this(); }

private:
    TMemoryNamespace();
    TMemoryClass& EnsureClass(const std::string& name);

    friend class TMemoryClass;
    friend class TMemoryInstance;

    std::string fName;
    std::vector<std::unique_ptr<TMemoryClass>> fClasses;
    std::unordered_map<std::string, TMemoryClass*, TNameHash, TNameEqual> fClassByName;
    std::vector<TQualifierTypeData> fQualifierTypes;
    std::unique_ptr<TRepositoryIndexes> fIndexes;
    bool fLinked;
    std::uint64_t fGeneration;
};

}  // namespace repository
}  // namespace braigrion
