// Plain descriptions of schema elements, as read from or written to CIM-XML.
#pragma once

#include <string>
#include <vector>

#include "tkrcore/TCIMValue.h"

namespace braigrion {
namespace repository {

struct TQualifierData {
    std::string fName;
    NORVTKR20::TCIMValue fValue;
    bool fPropagated = false;   // inherited from the superclass (as read or as linked)
    bool fToSubclass = true;    // flavor: passed on to subclasses and overriding properties
    bool fOverridable = true;
    bool fToInstance = false;
    bool fTranslatable = false;
};

struct TPropertyDeclData {
    std::string fName;
    NORVTKR20::TCIMValue::TCIMType::ECIMType fType = NORVTKR20::TCIMValue::TCIMType::eString;
    bool fIsArray = false;
    int fArraySize = -1;            // fixed array size, -1 when unbounded
    std::string fReferenceClass;    // for references
    std::string fClassOrigin;
    bool fPropagated = false;
    bool fEmbeddedObject = false;   // an embedded object kept as its string
    NORVTKR20::TCIMValue fDefault;  // null when none
    std::vector<TQualifierData> fQualifiers;
};

struct TClassData {
    std::string fName;
    std::string fSuperClass;
    std::vector<TQualifierData> fQualifiers;
    std::vector<TPropertyDeclData> fProperties;
};

struct TQualifierTypeData {
    std::string fName;
    NORVTKR20::TCIMValue::TCIMType::ECIMType fType = NORVTKR20::TCIMValue::TCIMType::eString;
    bool fIsArray = false;
    int fArraySize = -1;
    NORVTKR20::TCIMValue fDefault;
    std::vector<std::string> fScopes;  // "class", "property", "reference", ... or "any"
    bool fToSubclass = true;
    bool fOverridable = true;
    bool fToInstance = false;
    bool fTranslatable = false;
};

}  // namespace repository
}  // namespace braigrion
