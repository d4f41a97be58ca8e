// The repository interfaces through which the report reads and mends the data.
// The virtual operations the report calls come first, in slot order.
#pragma once

#include <string>
#include <vector>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "tkrcore/TCIMReference.h"
#include "tkrcore/TCIMValue.h"

namespace NORVTKR20 {

class ICIMClass;
class ICIMInstance;
class ICIMProperty;
class ICIMPropertyDecl;
class ICIMQualifier;
class INamespaceProvider;

typedef boost::function<bool(boost::shared_ptr<ICIMInstance>)> TInstanceCallback;
typedef boost::function<bool(boost::shared_ptr<ICIMClass>)> TClassCallback;
typedef boost::function<bool(boost::shared_ptr<ICIMProperty>)> TPropertyCallback;

class ICIMElement {
public:
    virtual ~ICIMElement() {}
};

class ICIMNamespace {
public:
    virtual ~ICIMNamespace() {}
    virtual boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(const TCIMContext& context) = 0;
    virtual boost::shared_ptr<ICIMClass> GetClass(const std::string& name, const TCIMContext& context) = 0;
    virtual boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, const TCIMContext& context) = 0;
};

class INamespaceProvider {
public:
    virtual ~INamespaceProvider() {}
    // 1 for a delta view over several collections; anything else is a single collection.
    virtual int GetProviderType(const TCIMContext& context) = 0;
};

class ICIMClass {
public:
    virtual ~ICIMClass() {}
    // Enumerates the association instances that reference instances of this class.
    virtual void EnumerateAssociatorClasses(const TInstanceCallback& callback, bool deep, const TCIMContext& context) = 0;
    virtual const std::string& GetClassName(const TCIMContext& context) = 0;
    // Names of the properties declared on this class, in declaration order.
    virtual std::vector<std::string> GetPropertyList(const std::string& name, const TCIMContext& context) = 0;
    virtual void EnumerateSubClasses(const TClassCallback& callback, bool deep, const TCIMContext& context) = 0;
    virtual boost::shared_ptr<const ICIMPropertyDecl> GetPropertyDecl(const std::string& name, const TCIMContext& context) = 0;
    virtual boost::shared_ptr<ICIMInstance> CreateInstance(const TCIMContext& context) = 0;
    virtual void EnumerateInstances(const TInstanceCallback& callback, bool deep, const TCIMContext& context) = 0;
};

class ICIMInstance : public ICIMElement {
public:
    virtual void Delete(const TCIMContext& context) = 0;
    virtual TCIMReference GetPath(const TCIMContext& context) = 0;
    virtual boost::shared_ptr<ICIMClass> GetClass(const TCIMContext& context) = 0;
    virtual void EnumerateAssociatedInstances(const TInstanceCallback& callback, const std::string& assocClass,
                                              const std::string& resultClass, const std::string& role,
                                              const std::string& resultRole, const TCIMContext& context) = 0;
    virtual void EnumerateReferences(const TInstanceCallback& callback, const std::string& assocClass,
                                     const std::string& role, const TCIMContext& context) = 0;
    virtual boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, const TCIMContext& context) = 0;
    virtual boost::shared_ptr<ICIMProperty> AddProperty(const std::string& name, const TCIMValue& value,
                                                        const TCIMContext& context) = 0;
    virtual void EnumerateProperties(const TPropertyCallback& callback, const TCIMContext& context) = 0;
};

class ICIMProperty {
public:
    virtual ~ICIMProperty() {}
    virtual TCIMValue::TCIMType GetType(const TCIMContext& context) = 0;
    virtual bool IsArray(const TCIMContext& context) = 0;
    virtual const TCIMValue& GetValue(const TCIMContext& context) = 0;
    virtual void SetValue(const TCIMValue& value, const TCIMContext& context) = 0;
    virtual boost::shared_ptr<const ICIMPropertyDecl> GetDeclaration(const TCIMContext& context) = 0;
    virtual const TCIMValue& GetValue() = 0;
    virtual bool IsRowMergeProperty() = 0;
    virtual std::string GetValueString() = 0;
    virtual std::string GetValueMapString() = 0;
    virtual std::vector<std::string> GetValueStrings() = 0;
};

class ICIMPropertyDecl {
public:
    virtual ~ICIMPropertyDecl() {}
    virtual boost::shared_ptr<const ICIMQualifier> GetQualifier(const std::string& name, bool& propagated,
                                                                const TCIMContext& context) const = 0;
    virtual const std::string& GetName(const TCIMContext& context) const = 0;
};

class ICIMQualifier {
public:
    virtual ~ICIMQualifier() {}
    virtual const TCIMValue& GetValue(const TCIMContext& context) const = 0;
};

}  // namespace NORVTKR20
