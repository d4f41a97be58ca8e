// A CIM object path: a class name and key bindings, resolved against a namespace.
#pragma once

#include <map>
#include <string>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>

#include "tkrcore/TCIMValue.h"

namespace NORVTKR20 {

class ICIMNamespace;
class ICIMElement;
class ICIMClass;

typedef std::map<std::string, TCIMValue> TCIMContext;

class TCIMReference {
public:
    // `className` is a class name or a whole model path such as
    // `CIM_Fan.CreationClassName="CIM_Fan",DeviceID="FAN 1"`; a path's key
    // bindings are taken over. `context` is the call context under which the
    // path is later resolved (its "nsIndex" picks the collection of a view).
    TCIMReference(boost::shared_ptr<ICIMNamespace> ns, const std::string& className,
                  std::map<std::string, TCIMValue> context);
    TCIMReference(boost::shared_ptr<ICIMNamespace> ns, std::map<std::string, TCIMValue> context);
    TCIMReference();
    TCIMReference(const TCIMReference&) = default;
    TCIMReference(TCIMReference&&) noexcept = default;
    TCIMReference& operator=(const TCIMReference&) = default;
    TCIMReference& operator=(TCIMReference&&) noexcept = default;

    const std::string& GetClassName() const { return fClassName; }
    void SetClassName(const std::string& name) { fClassName = name; }
    void AddKeyValue(const std::string& name, const TCIMValue& value);
    void AddKeyValue(const std::string& name, TCIMValue&& value);
    // Walks the key bindings in name order; stops when the callback answers false.
    void EnumerateKeyBindings(
        boost::function<bool(std::pair<std::string, TCIMValue>)> const& callback) const;

    // Resolves the path in its namespace. With `throwIfMissing` false a path
    // that names no instance gives an empty pointer; with true it throws
    // TTKRException(kNotFound).
    boost::shared_ptr<ICIMElement> GetCIMElement(bool throwIfMissing) const;
    // The class the path names, from its namespace; throws kNotFound.
    boost::shared_ptr<ICIMClass> GetClass() const;
    // The model path: `Class.Key1="text",Key2=5`, keys in name order.
    std::string GetPath() const;

    // Host and namespace parts, kept for writing the path back out.
    const std::string& GetHost() const { return fHost; }
    const std::string& GetNamespacePath() const { return fNamespacePath; }
    void SetHost(const std::string& host) { fHost = host; }
    void SetNamespacePath(const std::string& path) { fNamespacePath = path; }
    const std::map<std::string, TCIMValue>& GetKeyBindings() const { return fKeys; }
    const std::map<std::string, TCIMValue>& GetContext() const { return fContext; }
    boost::shared_ptr<ICIMNamespace> GetNamespace() const { return fNamespace.lock(); }
    void SetNamespace(const boost::shared_ptr<ICIMNamespace>& ns) { fNamespace = ns; }

    // Parses a path text (`//host/ns:Class.k="v",n=1`, `ns:Class.k=1`,
    // `Class.k=1`, `Class`); false when it is not a path.
    static bool ParsePath(const std::string& text, TCIMReference& out);

    // Same class (ignoring case) and same key values (names ignoring case).
    bool operator==(const TCIMReference& other) const;

private:
    // Held weakly: references stored in a repository must not keep it alive.
    boost::weak_ptr<ICIMNamespace> fNamespace;
    std::string fClassName;
    std::map<std::string, TCIMValue> fKeys;
    std::map<std::string, TCIMValue> fContext;
    std::string fHost;
    std::string fNamespacePath;
};

// Key values compare by meaning: a number read from a path text equals the
// same number of any integer type, and a boolean equals its text.
bool KeyValuesEqual(const TCIMValue& a, const TCIMValue& b);

}  // namespace NORVTKR20
