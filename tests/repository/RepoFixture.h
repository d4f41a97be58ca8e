// Small builders for repository tests: declare a class or add an instance in one line.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "repository/MemoryRepository.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace testrepo {

using namespace braigrion::repository;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType T;

inline TQualifierData Q(const std::string& name, const TCIMValue& value) {
    TQualifierData q;
    q.fName = name;
    q.fValue = value;
    return q;
}

inline TCIMValue Strings(std::vector<std::string> items) {
    std::vector<TCIMValue> values;
    for (auto& s : items) values.push_back(TCIMValue(s));
    return TCIMValue::Array(T::eString, values);
}

inline TPropertyDeclData P(const std::string& name, T::ECIMType type, std::vector<TQualifierData> qualifiers = {},
                           bool isArray = false) {
    TPropertyDeclData d;
    d.fName = name;
    d.fType = type;
    d.fIsArray = isArray;
    d.fQualifiers = std::move(qualifiers);
    return d;
}

inline TPropertyDeclData Ref(const std::string& name, const std::string& refClass) {
    TPropertyDeclData d = P(name, T::eReference, {Q("Key", TCIMValue::Boolean(true))});
    d.fReferenceClass = refClass;
    return d;
}

inline TClassData C(const std::string& name, const std::string& super, std::vector<TPropertyDeclData> props,
                    std::vector<TQualifierData> qualifiers = {}) {
    return TClassData{name, super, std::move(qualifiers), std::move(props)};
}

inline TPropertyValue V(const std::string& name, const TCIMValue& value) {
    TPropertyValue p;
    p.fName = name;
    p.fValue = value;
    return p;
}

inline TCIMValue RefTo(const boost::shared_ptr<TMemoryNamespace>& ns, const std::string& path) {
    NORVTKR20::TCIMReference ref(ns, path, NORVTKR20::TCIMContext());
    return TCIMValue(ref);
}

inline std::vector<std::string> Names(const std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>>& instances,
                                      const std::string& property = "Name") {
    std::vector<std::string> out;
    for (const auto& i : instances) out.push_back(i->GetProperty(property, NORVTKR20::TCIMContext())->GetValue().ToString(10));
    return out;
}

inline std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> All(NORVTKR20::ICIMNamespace& ns, const std::string& cls,
                                                                    const NORVTKR20::TCIMContext& context = {}) {
    std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> out;
    ns.GetClass(cls, context)->EnumerateInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(out), true, context);
    return out;
}

}  // namespace testrepo
