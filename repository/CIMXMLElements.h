// The CIM-XML element vocabulary as the reader sees it: a cheap lookup from
// an element name to its kind, and which kinds may stand inside which.
#pragma once

#include <cstdint>

#include "tkrcore/TCIMValue.h"

namespace braigrion {
namespace repository {
namespace cimxml {

enum class EElement : std::uint8_t {
    kDocument,  // pseudo-element: the parent of the root
    kCIM,
    kDECLARATION,
    kDECLGROUP,
    kDECLGROUP_WITHNAME,
    kDECLGROUP_WITHPATH,
    kQUALIFIER_DECLARATION,
    kSCOPE,
    kVALUE,
    kVALUE_ARRAY,
    kVALUE_NULL,
    kVALUE_REFERENCE,
    kVALUE_OBJECT,
    kVALUE_NAMEDINSTANCE,
    kVALUE_NAMEDOBJECT,
    kVALUE_OBJECTWITHPATH,
    kVALUE_OBJECTWITHLOCALPATH,
    kVALUE_INSTANCEWITHPATH,
    kNAMESPACEPATH,
    kLOCALNAMESPACEPATH,
    kHOST,
    kNAMESPACE,
    kCLASSPATH,
    kLOCALCLASSPATH,
    kCLASSNAME,
    kINSTANCEPATH,
    kLOCALINSTANCEPATH,
    kINSTANCENAME,
    kOBJECTPATH,
    kKEYBINDING,
    kKEYVALUE,
    kCLASS,
    kINSTANCE,
    kQUALIFIER,
    kPROPERTY,
    kPROPERTY_ARRAY,
    kPROPERTY_REFERENCE,
    kMETHOD,
    kMESSAGE,
    kMULTIRSP,
    kSIMPLERSP,
    kMETHODRESPONSE,
    kIMETHODRESPONSE,
    kERROR,
    kRETURNVALUE,
    kIRETURNVALUE,
    kPARAMVALUE,
    kOtherCim,  // a CIM-XML element that a collection never holds (requests, parameters...)
    kUnknown,   // not a CIM-XML element at all
    kCount
};

// Kind of the element called `name` (kOtherCim or kUnknown when it is none
// of the kinds above). Dispatches on the length first, so it costs a couple
// of compares per element.
EElement LookupElement(const char* name);

// The element's name as written in a document.
const char* ElementName(EElement kind);

// True when `child` may stand directly inside `parent`. The table is lenient
// where real captures are (object wrappers straight inside any declaration
// group, qualifier declarations inside VALUE.OBJECT) and strict elsewhere.
bool MayContain(EElement parent, EElement child);

// Children of IRETURNVALUE that name objects without carrying their data
// (the answers of name-only operations): read past, not loaded.
bool IsNameOnlyResult(EElement child);

// Elements whose content is text: VALUE, KEYVALUE and HOST.
inline bool HoldsText(EElement kind) {
    return kind == EElement::kVALUE || kind == EElement::kKEYVALUE || kind == EElement::kHOST;
}

// Parts of an object path (the elements that fill a path being read).
bool IsPathPart(EElement kind);

// Looks up the value of a TYPE attribute. There is no TYPE "reference":
// references are PROPERTY.REFERENCE and VALUE.REFERENCE.
bool LookupType(const char* name, NORVTKR20::TCIMValue::TCIMType::ECIMType& out);

}  // namespace cimxml
}  // namespace repository
}  // namespace braigrion
