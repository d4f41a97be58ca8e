#include "repository/CIMXMLElements.h"

#include <cstring>

namespace braigrion {
namespace repository {
namespace cimxml {

namespace {

typedef EElement E;

const char* const kNames[] = {
    "",                      "CIM",
    "DECLARATION",           "DECLGROUP",
    "DECLGROUP.WITHNAME",    "DECLGROUP.WITHPATH",
    "QUALIFIER.DECLARATION", "SCOPE",
    "VALUE",                 "VALUE.ARRAY",
    "VALUE.NULL",            "VALUE.REFERENCE",
    "VALUE.OBJECT",          "VALUE.NAMEDINSTANCE",
    "VALUE.NAMEDOBJECT",     "VALUE.OBJECTWITHPATH",
    "VALUE.OBJECTWITHLOCALPATH", "VALUE.INSTANCEWITHPATH",
    "NAMESPACEPATH",         "LOCALNAMESPACEPATH",
    "HOST",                  "NAMESPACE",
    "CLASSPATH",             "LOCALCLASSPATH",
    "CLASSNAME",             "INSTANCEPATH",
    "LOCALINSTANCEPATH",     "INSTANCENAME",
    "OBJECTPATH",            "KEYBINDING",
    "KEYVALUE",              "CLASS",
    "INSTANCE",              "QUALIFIER",
    "PROPERTY",              "PROPERTY.ARRAY",
    "PROPERTY.REFERENCE",    "METHOD",
    "MESSAGE",               "MULTIRSP",
    "SIMPLERSP",             "METHODRESPONSE",
    "IMETHODRESPONSE",       "ERROR",
    "RETURNVALUE",           "IRETURNVALUE",
    "PARAMVALUE",            "",
    ""};
static_assert(sizeof(kNames) / sizeof(kNames[0]) == static_cast<int>(E::kCount), "one name per kind");

// CIM-XML elements that a collection file never holds; they are named as
// misplaced rather than unknown.
const char* const kOtherNames[] = {
    "MULTIREQ",        "SIMPLEREQ",       "METHODCALL",        "IMETHODCALL",      "IPARAMVALUE",
    "PARAMETER",       "PARAMETER.REFERENCE", "PARAMETER.ARRAY", "PARAMETER.REFARRAY", "VALUE.REFARRAY",
    "MULTIEXPREQ",     "SIMPLEEXPREQ",    "EXPMETHODCALL",     "MULTIEXPRSP",      "SIMPLEEXPRSP",
    "EXPMETHODRESPONSE", "EXPPARAMVALUE", "ENUMERATIONCONTEXT", "CORRELATOR",      "SIMPLEREQACK",
    "KEYVALUE.REFERENCE", "VALUE.NAMEDOBJECT.LIST"};

constexpr std::uint64_t Bit(E e) { return std::uint64_t(1) << static_cast<unsigned>(e); }

constexpr std::uint64_t kDeclGroups = Bit(E::kDECLGROUP) | Bit(E::kDECLGROUP_WITHNAME) | Bit(E::kDECLGROUP_WITHPATH);
constexpr std::uint64_t kObjectHolders = kDeclGroups | Bit(E::kIRETURNVALUE);
constexpr std::uint64_t kProperties = Bit(E::kPROPERTY) | Bit(E::kPROPERTY_ARRAY) | Bit(E::kPROPERTY_REFERENCE);
constexpr std::uint64_t kObjects = Bit(E::kCLASS) | Bit(E::kINSTANCE);

struct TParentTable {
    std::uint64_t fParents[static_cast<int>(E::kCount)];

    void Allow(E child, std::uint64_t parents) { fParents[static_cast<int>(child)] = parents; }

    TParentTable() : fParents() {
        Allow(E::kCIM, Bit(E::kDocument));
        Allow(E::kDECLARATION, Bit(E::kCIM));
        Allow(E::kMESSAGE, Bit(E::kCIM));
        Allow(E::kDECLGROUP, Bit(E::kDECLARATION));
        Allow(E::kDECLGROUP_WITHNAME, Bit(E::kDECLARATION));
        Allow(E::kDECLGROUP_WITHPATH, Bit(E::kDECLARATION));
        Allow(E::kQUALIFIER_DECLARATION, kObjectHolders | Bit(E::kVALUE_OBJECT));
        Allow(E::kSCOPE, Bit(E::kQUALIFIER_DECLARATION));

        Allow(E::kVALUE, Bit(E::kPROPERTY) | Bit(E::kQUALIFIER) | Bit(E::kQUALIFIER_DECLARATION) |
                             Bit(E::kVALUE_ARRAY) | Bit(E::kIRETURNVALUE));
        Allow(E::kVALUE_ARRAY, Bit(E::kPROPERTY_ARRAY) | Bit(E::kQUALIFIER) | Bit(E::kQUALIFIER_DECLARATION) |
                                   Bit(E::kIRETURNVALUE));
        Allow(E::kVALUE_NULL, Bit(E::kVALUE_ARRAY));
        Allow(E::kVALUE_REFERENCE, Bit(E::kPROPERTY_REFERENCE) | Bit(E::kKEYBINDING) | Bit(E::kINSTANCENAME) |
                                       Bit(E::kIRETURNVALUE));

        Allow(E::kVALUE_OBJECT, kObjectHolders);
        Allow(E::kVALUE_NAMEDINSTANCE, kObjectHolders);
        Allow(E::kVALUE_NAMEDOBJECT, kObjectHolders);
        Allow(E::kVALUE_OBJECTWITHPATH, kObjectHolders);
        Allow(E::kVALUE_OBJECTWITHLOCALPATH, kObjectHolders);
        Allow(E::kVALUE_INSTANCEWITHPATH, kObjectHolders);

        Allow(E::kNAMESPACEPATH, Bit(E::kINSTANCEPATH) | Bit(E::kCLASSPATH) | Bit(E::kDECLGROUP) |
                                     Bit(E::kDECLGROUP_WITHNAME));
        Allow(E::kLOCALNAMESPACEPATH, Bit(E::kNAMESPACEPATH) | Bit(E::kLOCALINSTANCEPATH) | Bit(E::kLOCALCLASSPATH) |
                                          Bit(E::kDECLGROUP) | Bit(E::kDECLGROUP_WITHNAME));
        Allow(E::kHOST, Bit(E::kNAMESPACEPATH));
        Allow(E::kNAMESPACE, Bit(E::kLOCALNAMESPACEPATH));
        Allow(E::kCLASSPATH, Bit(E::kVALUE_REFERENCE) | Bit(E::kVALUE_OBJECTWITHPATH) | Bit(E::kOBJECTPATH));
        Allow(E::kLOCALCLASSPATH, Bit(E::kVALUE_REFERENCE) | Bit(E::kVALUE_OBJECTWITHLOCALPATH));
        Allow(E::kCLASSNAME, Bit(E::kVALUE_REFERENCE) | Bit(E::kCLASSPATH) | Bit(E::kLOCALCLASSPATH) |
                                 Bit(E::kIRETURNVALUE));
        Allow(E::kINSTANCEPATH, Bit(E::kVALUE_REFERENCE) | Bit(E::kVALUE_OBJECTWITHPATH) |
                                    Bit(E::kVALUE_INSTANCEWITHPATH) | Bit(E::kOBJECTPATH));
        Allow(E::kLOCALINSTANCEPATH, Bit(E::kVALUE_REFERENCE) | Bit(E::kVALUE_OBJECTWITHLOCALPATH));
        Allow(E::kINSTANCENAME, Bit(E::kINSTANCEPATH) | Bit(E::kLOCALINSTANCEPATH) | Bit(E::kVALUE_REFERENCE) |
                                    Bit(E::kVALUE_NAMEDINSTANCE) | Bit(E::kVALUE_NAMEDOBJECT) |
                                    Bit(E::kIRETURNVALUE));
        Allow(E::kOBJECTPATH, Bit(E::kIRETURNVALUE));
        Allow(E::kKEYBINDING, Bit(E::kINSTANCENAME));
        Allow(E::kKEYVALUE, Bit(E::kKEYBINDING) | Bit(E::kINSTANCENAME));

        const std::uint64_t wrappers = Bit(E::kVALUE_OBJECT) | Bit(E::kVALUE_NAMEDOBJECT) |
                                       Bit(E::kVALUE_OBJECTWITHPATH) | Bit(E::kVALUE_OBJECTWITHLOCALPATH);
        Allow(E::kCLASS, wrappers | kObjectHolders);
        Allow(E::kINSTANCE, wrappers | kObjectHolders | Bit(E::kVALUE_NAMEDINSTANCE) | Bit(E::kVALUE_INSTANCEWITHPATH));
        Allow(E::kQUALIFIER, kObjects | kProperties);
        Allow(E::kPROPERTY, kObjects);
        Allow(E::kPROPERTY_ARRAY, kObjects);
        Allow(E::kPROPERTY_REFERENCE, kObjects);
        Allow(E::kMETHOD, Bit(E::kCLASS));

        Allow(E::kMULTIRSP, Bit(E::kMESSAGE));
        Allow(E::kSIMPLERSP, Bit(E::kMESSAGE) | Bit(E::kMULTIRSP));
        Allow(E::kMETHODRESPONSE, Bit(E::kSIMPLERSP));
        Allow(E::kIMETHODRESPONSE, Bit(E::kSIMPLERSP));
        Allow(E::kERROR, Bit(E::kIMETHODRESPONSE) | Bit(E::kMETHODRESPONSE));
        Allow(E::kRETURNVALUE, Bit(E::kMETHODRESPONSE));
        Allow(E::kIRETURNVALUE, Bit(E::kIMETHODRESPONSE));
        Allow(E::kPARAMVALUE, Bit(E::kIMETHODRESPONSE) | Bit(E::kMETHODRESPONSE));
    }
};

const TParentTable kTable;

bool Is(const char* name, size_t len, E kind) {
    const char* candidate = kNames[static_cast<int>(kind)];
    return name[0] == candidate[0] && name[len - 1] == candidate[len - 1] && std::memcmp(name, candidate, len) == 0;
}

// Names grouped by length, so that a lookup compares against a handful.
struct TLengthIndex {
    static const int kMaxLength = 32;
    static const int kPerLength = 6;
    E fByLength[kMaxLength][kPerLength];
    int fCount[kMaxLength];

    TLengthIndex() : fByLength(), fCount() {
        for (int k = 1; k < static_cast<int>(E::kOtherCim); ++k) {
            const size_t len = std::strlen(kNames[k]);
            fByLength[len][fCount[len]++] = static_cast<E>(k);
        }
    }
};

const TLengthIndex kIndex;

}  // namespace

EElement LookupElement(const char* name) {
    const size_t len = std::strlen(name);
    if (len < static_cast<size_t>(TLengthIndex::kMaxLength)) {
        for (int k = 0; k < kIndex.fCount[len]; ++k) {
            if (Is(name, len, kIndex.fByLength[len][k])) return kIndex.fByLength[len][k];
        }
    }
    for (const char* other : kOtherNames) {
        if (std::strcmp(name, other) == 0) return E::kOtherCim;
    }
    return E::kUnknown;
}

const char* ElementName(EElement kind) { return kNames[static_cast<int>(kind)]; }

bool MayContain(EElement parent, EElement child) {
    return (kTable.fParents[static_cast<int>(child)] & Bit(parent)) != 0;
}

bool IsNameOnlyResult(EElement child) {
    switch (child) {
        case E::kINSTANCENAME:
        case E::kCLASSNAME:
        case E::kOBJECTPATH:
        case E::kVALUE:
        case E::kVALUE_ARRAY:
        case E::kVALUE_REFERENCE:
            return true;
        default:
            return false;
    }
}

bool IsPathPart(EElement kind) {
    switch (kind) {
        case E::kNAMESPACEPATH:
        case E::kLOCALNAMESPACEPATH:
        case E::kHOST:
        case E::kNAMESPACE:
        case E::kCLASSPATH:
        case E::kLOCALCLASSPATH:
        case E::kCLASSNAME:
        case E::kINSTANCEPATH:
        case E::kLOCALINSTANCEPATH:
        case E::kINSTANCENAME:
        case E::kKEYBINDING:
        case E::kKEYVALUE:
            return true;
        default:
            return false;
    }
}

bool LookupType(const char* name, NORVTKR20::TCIMValue::TCIMType::ECIMType& out) {
    typedef NORVTKR20::TCIMValue::TCIMType T;
    static const struct {
        const char* fName;
        T::ECIMType fType;
    } kTypes[] = {{"string", T::eString},   {"uint16", T::eUint16},  {"uint32", T::eUint32},   {"uint64", T::eUint64},
                  {"uint8", T::eUint8},     {"boolean", T::eBoolean}, {"datetime", T::eDateTime}, {"sint32", T::eSint32},
                  {"sint64", T::eSint64},   {"sint16", T::eSint16},  {"sint8", T::eSint8},     {"real64", T::eReal64},
                  {"real32", T::eReal32},   {"char16", T::eChar16}};
    for (const auto& type : kTypes) {
        if (name[0] == type.fName[0] && std::strcmp(name, type.fName) == 0) {
            out = type.fType;
            return true;
        }
    }
    return false;
}

}  // namespace cimxml
}  // namespace repository
}  // namespace braigrion
