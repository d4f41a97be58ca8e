#include "repository/CIMXMLParser.h"

#include "repository/CIMXMLReader.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <new>
#include <strings.h>

namespace braigrion {
namespace repository {
namespace cimxml {

using NORVTKR20::TTKRException;
typedef TCIMValue::TCIMType TType;
typedef EElement E;

namespace {

// Thrown inside a handler after the failure is recorded, to leave the
// handler; caught before control goes back into expat.
struct TAbort {};

enum : std::uint8_t { kSeenValue = 1, kSeenPath = 2, kSeenObject = 4 };

const char* Attr(const char** atts, const char* name) {
    for (; *atts; atts += 2) {
        if (std::strcmp(atts[0], name) == 0) return atts[1];
    }
    return nullptr;
}

bool IsSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

// A text for a message: quoted, cut when long, control characters escaped
// so that the message stays one line.
std::string Quote(const std::string& text) {
    const size_t kMax = 60;
    if (text.size() <= kMax) return '"' + PrintableText(text) + '"';
    return '"' + PrintableText(text.substr(0, kMax)) + "...\"";
}

const char* TypeName(ECIMType type) { return TType(type).GetName(); }

// Digits only, at most 19 of them (so that no overflow is possible).
bool ParsePlainDecimal(const std::string& text, std::uint64_t& out) {
    const size_t n = text.size();
    if (n == 0 || n > 19) return false;
    std::uint64_t value = 0;
    for (char c : text) {
        if (c < '0' || c > '9') return false;
        value = value * 10 + static_cast<std::uint64_t>(c - '0');
    }
    out = value;
    return true;
}

std::uint64_t MaxUnsigned(ECIMType type) {
    switch (type) {
        case TType::eUint8: return 0xFFu;
        case TType::eUint16: return 0xFFFFu;
        case TType::eUint32: return 0xFFFFFFFFu;
        default: return ~std::uint64_t(0);
    }
}

bool IsWrapper(E kind) {
    switch (kind) {
        case E::kVALUE_OBJECT:
        case E::kVALUE_NAMEDINSTANCE:
        case E::kVALUE_NAMEDOBJECT:
        case E::kVALUE_OBJECTWITHPATH:
        case E::kVALUE_OBJECTWITHLOCALPATH:
        case E::kVALUE_INSTANCEWITHPATH:
            return true;
        default:
            return false;
    }
}

// Wrappers whose INSTANCE must be preceded by its path.
bool InstanceNeedsPath(E wrapper) {
    return wrapper == E::kVALUE_NAMEDINSTANCE || wrapper == E::kVALUE_NAMEDOBJECT ||
           wrapper == E::kVALUE_OBJECTWITHPATH || wrapper == E::kVALUE_OBJECTWITHLOCALPATH ||
           wrapper == E::kVALUE_INSTANCEWITHPATH;
}

bool IsProperty(E kind) {
    return kind == E::kPROPERTY || kind == E::kPROPERTY_ARRAY || kind == E::kPROPERTY_REFERENCE;
}

// An embedded object is announced by the EmbeddedObject qualifier (true) or
// by EmbeddedInstance (naming the class).
bool AnnouncesEmbeddedObject(const TQualifierData& q) {
    if (q.fValue.IsNull() || q.fValue.IsArray()) return false;
    if (strcasecmp(q.fName.c_str(), "EmbeddedInstance") == 0) return true;
    if (strcasecmp(q.fName.c_str(), "EmbeddedObject") != 0) return false;
    return q.fValue.GetType() == TType::eBoolean && static_cast<bool>(q.fValue);
}

}  // namespace

TParser::TParser(TSink& sink, const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns)
    : fParser(XML_ParserCreate(nullptr)),
      fSink(sink),
      fNamespace(ns),
      fSkipDepth(0),
      fInClass(false),
      fLastPropertyCount(8),
      fQualifierType(TType::eString),
      fArrayTarget{TType::eString, nullptr, "", nullptr},
      fKeyType(TType::eUnknown),
      fKeyKind('s'),
      fHaveObjectPath(false) {
    if (!fParser) throw std::bad_alloc();
    XML_SetUserData(fParser, this);
    XML_SetElementHandler(fParser, &TParser::OnStart, &TParser::OnEnd);
    XML_SetCharacterDataHandler(fParser, &TParser::OnText);
    XML_SetEntityDeclHandler(fParser, &TParser::OnEntityDecl);
    XML_SetSkippedEntityHandler(fParser, &TParser::OnSkippedEntity);
    XML_SetExternalEntityRefHandler(fParser, &TParser::OnExternalEntity);
    // Never read an external DTD or parameter entity: a DOCTYPE is harmless.
    XML_SetParamEntityParsing(fParser, XML_PARAM_ENTITY_PARSING_NEVER);
    fStack.reserve(32);
    fStack.push_back(TFrame{E::kDocument, 0, 0});
    fPaths.reserve(4);
    fText.reserve(256);
}

TParser::~TParser() { XML_ParserFree(fParser); }

// ---------------------------------------------------------------- feeding

bool TParser::Feed(const char* data, size_t size, bool last) {
    // Expat takes an int length: hand a large document over in slices.
    const size_t kSlice = size_t(1) << 26;
    do {
        if (fFailure.fFailed) return false;
        const size_t n = std::min(size, kSlice);
        const bool final = last && n == size;
        if (!Check(XML_Parse(fParser, data, static_cast<int>(n), final ? 1 : 0))) return false;
        data += n;
        size -= n;
    } while (size > 0);
    return true;
}

void* TParser::GetBuffer(size_t size) {
    void* buffer = XML_GetBuffer(fParser, static_cast<int>(size));
    if (!buffer) throw std::bad_alloc();
    return buffer;
}

bool TParser::ParseBuffer(size_t size, bool last) {
    if (fFailure.fFailed) return false;
    return Check(XML_ParseBuffer(fParser, static_cast<int>(size), last ? 1 : 0));
}

bool TParser::Check(enum XML_Status status) {
    if (status == XML_STATUS_OK) return true;
    if (!fFailure.fFailed) FailFromExpat();
    return false;
}

// Expat's own errors, reworded where the usual wording says little.
void TParser::FailFromExpat() {
    const enum XML_Error code = XML_GetErrorCode(fParser);
    std::string open = fStack.size() > 1 ? ElementName(fStack.back().fKind) : "";
    std::string message;
    switch (code) {
        case XML_ERROR_NO_ELEMENTS:
            message = open.empty() ? "the document holds no element"
                                   : "unclosed element " + open + ": the document ends before it is closed";
            break;
        case XML_ERROR_UNCLOSED_TOKEN:
        case XML_ERROR_PARTIAL_CHAR:
            message = "the document ends in the middle of a tag or character";
            if (!open.empty()) message += " (unclosed element " + open + ")";
            break;
        case XML_ERROR_TAG_MISMATCH:
            message = open.empty() || fSkipDepth > 0 ? "closing tag does not match the open element"
                                                     : "closing tag does not match the open element " + open;
            break;
        case XML_ERROR_EXTERNAL_ENTITY_HANDLING:
            message = "external entities are not loaded";
            break;
        default:
            message = XML_ErrorString(code);
            break;
    }
    fFailure.fFailed = true;
    fFailure.fHavePosition = true;
    fFailure.fLine = static_cast<unsigned>(XML_GetCurrentLineNumber(fParser));
    fFailure.fColumn = static_cast<unsigned>(XML_GetCurrentColumnNumber(fParser)) + 1;
    fFailure.fMessage = message;
}

// ---------------------------------------------------------------- expat callbacks

// Runs a handler body; exceptions never travel through expat's C frames.
template <typename F>
void TParser::Guard(F&& body) {
    if (fFailure.fFailed) return;
    try {
        body();
    } catch (const TAbort&) {
    } catch (const std::bad_alloc&) {
        fFailure = TParseFailure{true, false, Here(), 0, 0, "out of memory"};
        XML_StopParser(fParser, XML_FALSE);
    } catch (const std::exception& ex) {
        fFailure = TParseFailure{true, false, Here(), 0, 0, ex.what()};
        XML_StopParser(fParser, XML_FALSE);
    }
}

void XMLCALL TParser::OnStart(void* self, const XML_Char* name, const XML_Char** atts) {
    TParser* p = static_cast<TParser*>(self);
    p->Guard([&] { p->Start(name, atts); });
}

void XMLCALL TParser::OnEnd(void* self, const XML_Char*) {
    TParser* p = static_cast<TParser*>(self);
    p->Guard([&] { p->End(); });
}

void XMLCALL TParser::OnText(void* self, const XML_Char* text, int len) {
    TParser* p = static_cast<TParser*>(self);
    p->Guard([&] { p->Text(text, len); });
}

void XMLCALL TParser::OnEntityDecl(void* self, const XML_Char* name, int, const XML_Char*, int, const XML_Char*,
                                   const XML_Char*, const XML_Char*, const XML_Char*) {
    TParser* p = static_cast<TParser*>(self);
    p->Guard([&] { p->FailHere(std::string("entity declarations are not accepted (entity ") + name + ")"); });
}

void XMLCALL TParser::OnSkippedEntity(void* self, const XML_Char* name, int) {
    TParser* p = static_cast<TParser*>(self);
    p->Guard([&] { p->FailHere(std::string("reference to undeclared entity &") + name + ";"); });
}

int XMLCALL TParser::OnExternalEntity(XML_Parser, const XML_Char*, const XML_Char*, const XML_Char*,
                                      const XML_Char*) {
    return XML_STATUS_ERROR;  // never fetched
}

// ---------------------------------------------------------------- dispatch

void TParser::Start(const char* name, const char** atts) {
    if (fSkipDepth > 0) {
        ++fSkipDepth;
        return;
    }
    const E kind = LookupElement(name);
    const E parent = Parent();
    if (kind == E::kUnknown) FailHere(std::string("unknown element ") + name);
    if (!MayContain(parent, kind)) {
        if (parent == E::kDocument) FailHere(std::string("the document element must be CIM, not ") + name);
        FailHere(std::string("element ") + name + " cannot stand inside " + ElementName(parent));
    }
    fStack.push_back(TFrame{kind, 0, Here()});
    if (parent == E::kIRETURNVALUE && IsNameOnlyResult(kind)) {
        fSkipDepth = 1;
        return;
    }
    switch (kind) {
        case E::kMETHOD:
        case E::kRETURNVALUE:
        case E::kPARAMVALUE:
            fSkipDepth = 1;
            break;
        case E::kERROR:
            StartError(atts);
            fSkipDepth = 1;
            break;
        case E::kVALUE_OBJECT:
        case E::kVALUE_NAMEDINSTANCE:
        case E::kVALUE_NAMEDOBJECT:
        case E::kVALUE_OBJECTWITHPATH:
        case E::kVALUE_OBJECTWITHLOCALPATH:
        case E::kVALUE_INSTANCEWITHPATH:
            fHaveObjectPath = false;
            break;
        case E::kQUALIFIER_DECLARATION:
            StartQualifierDeclaration(atts);
            break;
        case E::kSCOPE:
            StartScope(atts);
            break;
        case E::kCLASS:
            StartClass(atts);
            break;
        case E::kINSTANCE:
            StartInstance(atts);
            break;
        case E::kPROPERTY:
        case E::kPROPERTY_ARRAY:
        case E::kPROPERTY_REFERENCE:
            StartProperty(kind, atts);
            break;
        case E::kQUALIFIER:
            StartQualifier(atts);
            break;
        case E::kVALUE:
        case E::kVALUE_ARRAY:
        case E::kVALUE_NULL:
        case E::kVALUE_REFERENCE:
            StartValue(kind);
            break;
        default:
            if (IsPathPart(kind)) StartPathElement(kind, atts);
            break;
    }
}

void TParser::End() {
    if (fSkipDepth > 0) {
        if (--fSkipDepth == 0) fStack.pop_back();
        return;
    }
    const E kind = Current().fKind;
    switch (kind) {
        case E::kVALUE:
            EndValue();
            break;
        case E::kVALUE_ARRAY:
            EndValueArray();
            break;
        case E::kVALUE_NULL:
            EndValueNull();
            break;
        case E::kVALUE_REFERENCE:
            EndValueReference();
            break;
        case E::kPROPERTY:
        case E::kPROPERTY_ARRAY:
        case E::kPROPERTY_REFERENCE:
            EndProperty();
            break;
        case E::kQUALIFIER:
            EndQualifier();
            break;
        case E::kQUALIFIER_DECLARATION: {
            const std::string name = fQualifierDecl.fName;
            try {
                fSink.QualifierType(std::move(fQualifierDecl), Current().fOffset);
            } catch (const TTKRException& ex) {
                Fail(Current().fOffset, "cannot declare qualifier " + name + ": " + ex.what());
            }
            break;
        }
        case E::kCLASS:
            EndClass();
            break;
        case E::kINSTANCE:
            EndInstance();
            break;
        default:
            if (IsWrapper(kind)) EndWrapper();
            else if (IsPathPart(kind)) EndPathElement(kind);
            break;
    }
    fStack.pop_back();
}

void TParser::Text(const char* text, int len) {
    if (fSkipDepth > 0) return;
    const E kind = Current().fKind;
    if (HoldsText(kind)) {
        // A lone white-space character that took more bytes than itself came
        // from a character reference: it is content, never layout.
        if (len == 1 && IsSpace(text[0]) && XML_GetCurrentByteCount(fParser) >= 4)
            fProtected.push_back(static_cast<std::uint32_t>(fText.size()));
        fText.append(text, static_cast<size_t>(len));
        return;
    }
    for (int k = 0; k < len; ++k) {
        if (!IsSpace(text[k]))
            FailHere("text " + Quote(std::string(text + k, static_cast<size_t>(len - k))) + " cannot stand inside " +
                     ElementName(kind));
    }
}

// ---------------------------------------------------------------- declarations

void TParser::StartQualifierDeclaration(const char** atts) {
    const char* name = Attr(atts, "NAME");
    if (!name) FailHere("QUALIFIER.DECLARATION without NAME");
    TFrame& wrapper = fStack[fStack.size() - 2];
    if (wrapper.fKind == E::kVALUE_OBJECT) {
        if (wrapper.fSeen & kSeenObject) FailHere("VALUE.OBJECT holds more than one object");
        wrapper.fSeen |= kSeenObject;
    }
    fQualifierDecl = TQualifierTypeData();
    fQualifierDecl.fName = name;
    fQualifierDecl.fType = RequireType(atts, "QUALIFIER.DECLARATION", name);
    fQualifierDecl.fIsArray = BoolAttr(atts, "ISARRAY", false);
    if (const char* size = Attr(atts, "ARRAYSIZE")) {
        fQualifierDecl.fArraySize = ArraySize(size);
        fQualifierDecl.fIsArray = true;
    }
    fQualifierDecl.fOverridable = BoolAttr(atts, "OVERRIDABLE", true);
    fQualifierDecl.fToSubclass = BoolAttr(atts, "TOSUBCLASS", true);
    fQualifierDecl.fToInstance = BoolAttr(atts, "TOINSTANCE", false);
    fQualifierDecl.fTranslatable = BoolAttr(atts, "TRANSLATABLE", false);
    fQualifierDecl.fDefault = TCIMValue::Null(fQualifierDecl.fType, fQualifierDecl.fIsArray);
}

void TParser::StartScope(const char** atts) {
    static const char* const kScopes[][2] = {{"CLASS", "class"},         {"ASSOCIATION", "association"},
                                             {"REFERENCE", "reference"}, {"PROPERTY", "property"},
                                             {"METHOD", "method"},       {"PARAMETER", "parameter"},
                                             {"INDICATION", "indication"}};
    std::vector<std::string>& scopes = fQualifierDecl.fScopes;
    scopes.clear();
    for (const auto& scope : kScopes) {
        if (BoolAttr(atts, scope[0], false)) scopes.push_back(scope[1]);
    }
    if (scopes.size() == sizeof(kScopes) / sizeof(kScopes[0])) scopes.assign(1, "any");
}

void TParser::StartClass(const char** atts) {
    const char* name = Attr(atts, "NAME");
    if (!name) FailHere("CLASS without NAME");
    TFrame& wrapper = fStack[fStack.size() - 2];
    if (IsWrapper(wrapper.fKind)) {
        if (wrapper.fSeen & kSeenObject) FailHere(std::string(ElementName(wrapper.fKind)) + " holds more than one object");
        wrapper.fSeen |= kSeenObject;
    }
    fInClass = true;
    fClass = TClassData();
    fClass.fName = name;
    if (const char* super = Attr(atts, "SUPERCLASS")) fClass.fSuperClass = super;
}

void TParser::EndClass() {
    fInClass = false;
    fHaveObjectPath = false;
    const std::string name = fClass.fName;
    try {
        fSink.Class(std::move(fClass), Current().fOffset);
    } catch (const TTKRException& ex) {
        Fail(Current().fOffset, "cannot declare class " + name + ": " + ex.what());
    }
}

// ---------------------------------------------------------------- instances

void TParser::StartInstance(const char** atts) {
    const char* name = Attr(atts, "CLASSNAME");
    if (!name) FailHere("INSTANCE without CLASSNAME");
    TFrame& wrapper = fStack[fStack.size() - 2];
    if (IsWrapper(wrapper.fKind)) {
        const char* wrapperName = ElementName(wrapper.fKind);
        if (wrapper.fSeen & kSeenObject) FailHere(std::string(wrapperName) + " holds more than one object");
        if (InstanceNeedsPath(wrapper.fKind) && !(wrapper.fSeen & kSeenPath))
            FailHere(std::string("INSTANCE in ") + wrapperName + " must follow its instance path");
        wrapper.fSeen |= kSeenObject;
    }
    fInstanceClass = name;
    fProperties.clear();
    fProperties.reserve(fLastPropertyCount);
}

void TParser::EndInstance() {
    fLastPropertyCount = std::max<size_t>(fProperties.size(), 4);
    const TCIMReference* path = fHaveObjectPath ? &fObjectPath : nullptr;
    try {
        fSink.Instance(fInstanceClass, std::move(fProperties), path, Current().fOffset);
    } catch (const TTKRException& ex) {
        Fail(Current().fOffset, "cannot add instance of " + fInstanceClass + ": " + ex.what());
    }
    fProperties.clear();
    fHaveObjectPath = false;
}

void TParser::EndWrapper() {
    const TFrame& frame = Current();
    if (!(frame.fSeen & kSeenObject))
        Fail(frame.fOffset, std::string(ElementName(frame.fKind)) + " holds no CLASS or INSTANCE");
    fHaveObjectPath = false;
}

// ---------------------------------------------------------------- properties and qualifiers

void TParser::StartProperty(E kind, const char** atts) {
    const char* element = ElementName(kind);
    const char* name = Attr(atts, "NAME");
    if (!name) FailHere(std::string(element) + " without NAME");
    const ECIMType type = kind == E::kPROPERTY_REFERENCE ? TType::eReference : RequireType(atts, element, name);
    const bool isArray = kind == E::kPROPERTY_ARRAY;
    const char* embedded = Attr(atts, "EmbeddedObject");
    if (!embedded) embedded = Attr(atts, "EMBEDDEDOBJECT");
    const char* referenceClass = Attr(atts, "REFERENCECLASS");
    if (fInClass) {
        fDecl = TPropertyDeclData();
        fDecl.fName = name;
        fDecl.fType = type;
        fDecl.fIsArray = isArray;
        if (const char* size = Attr(atts, "ARRAYSIZE")) fDecl.fArraySize = ArraySize(size);
        if (referenceClass) fDecl.fReferenceClass = referenceClass;
        if (const char* origin = Attr(atts, "CLASSORIGIN")) fDecl.fClassOrigin = origin;
        fDecl.fPropagated = BoolAttr(atts, "PROPAGATED", false);
        fDecl.fEmbeddedObject = embedded != nullptr;
        fDecl.fDefault = TCIMValue::Null(type, isArray);
    } else {
        // An instance keeps no array size, but a wrong one is still wrong.
        if (const char* size = Attr(atts, "ARRAYSIZE")) ArraySize(size);
        fProperty.fName = name;
        fProperty.fType = type;
        fProperty.fIsArray = isArray;
        fProperty.fReferenceClass = referenceClass ? referenceClass : "";
        fProperty.fEmbeddedObject = embedded != nullptr;
        fProperty.fValue = TCIMValue::Null(type, isArray);
    }
}

void TParser::EndProperty() {
    if (fInClass) fClass.fProperties.push_back(std::move(fDecl));
    else fProperties.push_back(std::move(fProperty));
}

void TParser::StartQualifier(const char** atts) {
    const char* name = Attr(atts, "NAME");
    if (!name) FailHere("QUALIFIER without NAME");
    fQualifier = TQualifierData();
    fQualifier.fName = name;
    fQualifierType = RequireType(atts, "QUALIFIER", name);
    fQualifier.fPropagated = BoolAttr(atts, "PROPAGATED", false);
    fQualifier.fOverridable = BoolAttr(atts, "OVERRIDABLE", true);
    fQualifier.fToSubclass = BoolAttr(atts, "TOSUBCLASS", true);
    fQualifier.fToInstance = BoolAttr(atts, "TOINSTANCE", false);
    fQualifier.fTranslatable = BoolAttr(atts, "TRANSLATABLE", false);
    fQualifier.fValue = TCIMValue::Null(fQualifierType);
}

void TParser::EndQualifier() {
    const E owner = fStack[fStack.size() - 2].fKind;
    const bool embedded = AnnouncesEmbeddedObject(fQualifier);
    if (owner == E::kCLASS) {
        fClass.fQualifiers.push_back(std::move(fQualifier));
    } else if (IsProperty(owner) && fInClass) {
        if (embedded) fDecl.fEmbeddedObject = true;
        fDecl.fQualifiers.push_back(std::move(fQualifier));
    } else if (IsProperty(owner)) {
        // Instances keep no qualifiers; only the embedded-object mark matters.
        if (embedded) fProperty.fEmbeddedObject = true;
    }
}

// ---------------------------------------------------------------- values

TParser::TValueTarget TParser::TargetFor(E parent) {
    switch (parent) {
        case E::kPROPERTY:
        case E::kPROPERTY_ARRAY:
        case E::kPROPERTY_REFERENCE:
            if (fInClass) return TValueTarget{fDecl.fType, &fDecl.fDefault, "property", &fDecl.fName};
            return TValueTarget{fProperty.fType, &fProperty.fValue, "property", &fProperty.fName};
        case E::kQUALIFIER:
            return TValueTarget{fQualifierType, &fQualifier.fValue, "qualifier", &fQualifier.fName};
        case E::kQUALIFIER_DECLARATION:
            return TValueTarget{fQualifierDecl.fType, &fQualifierDecl.fDefault, "qualifier", &fQualifierDecl.fName};
        default:
            return fArrayTarget;  // elements of a VALUE.ARRAY
    }
}

void TParser::StartValue(E kind) {
    TFrame& parent = fStack[fStack.size() - 2];
    if (kind != E::kVALUE_NULL && parent.fKind != E::kVALUE_ARRAY) {
        if (parent.fSeen & kSeenValue) {
            std::string owner = ElementName(parent.fKind);
            if (parent.fKind == E::kKEYBINDING) owner += " " + TopPath().fKeyName;
            else if (parent.fKind != E::kINSTANCENAME) owner += " " + *TargetFor(parent.fKind).fName;
            FailHere(owner + " holds more than one value");
        }
        parent.fSeen |= kSeenValue;
    }
    switch (kind) {
        case E::kVALUE:
            fText.clear();
            fProtected.clear();
            break;
        case E::kVALUE_ARRAY:
            fArrayTarget = TargetFor(parent.fKind);
            fArray.clear();
            break;
        case E::kVALUE_REFERENCE:
            // Each level of a path whose key is a path doubles the escaping
            // of its text; past a few levels it is no path a collector writes.
            if (fPaths.size() >= kMaxReferenceDepth)
                FailHere("VALUE.REFERENCE nested more than " + std::to_string(kMaxReferenceDepth) +
                         " levels deep (a reference whose key is a reference)");
            fPaths.emplace_back();
            fPaths.back().fOffset = Here();
            break;
        default:
            break;
    }
}

void TParser::EndValue() {
    const E parent = fStack[fStack.size() - 2].fKind;
    const std::string& text = TakeText();
    const TValueTarget target = TargetFor(parent);
    TCIMValue value = Convert(target.fType, text, "VALUE", target.fWhat, *target.fName, Current().fOffset);
    if (parent == E::kVALUE_ARRAY) {
        fArray.push_back(std::move(value));
    } else if (parent == E::kQUALIFIER_DECLARATION && fQualifierDecl.fIsArray && !value.IsNull()) {
        std::vector<TCIMValue> one(1, std::move(value));
        *target.fDest = TCIMValue::Array(target.fType, std::move(one));
    } else {
        *target.fDest = std::move(value);
    }
}

void TParser::EndValueArray() {
    const E parent = fStack[fStack.size() - 2].fKind;
    if (parent == E::kQUALIFIER_DECLARATION) fQualifierDecl.fIsArray = true;
    *fArrayTarget.fDest = TCIMValue::Array(fArrayTarget.fType, std::move(fArray));
    fArray.clear();
}

void TParser::EndValueNull() { fArray.push_back(TCIMValue::Null(fArrayTarget.fType)); }

void TParser::EndValueReference() {
    TPath path = std::move(fPaths.back());
    fPaths.pop_back();
    if (path.fRef.GetClassName().empty()) Fail(Current().fOffset, "VALUE.REFERENCE holds no object path");
    path.fRef.SetNamespace(fNamespace);
    TCIMValue value(std::move(path.fRef));
    const E parent = fStack[fStack.size() - 2].fKind;
    if (parent == E::kPROPERTY_REFERENCE) {
        *TargetFor(parent).fDest = std::move(value);
    } else {
        TPath& outer = TopPath();
        outer.fRef.AddKeyValue(parent == E::kKEYBINDING ? outer.fKeyName : std::string(), std::move(value));
    }
}

TCIMValue TParser::Convert(ECIMType type, const std::string& text, const char* element, const char* what,
                           const std::string& name, std::int64_t offset) {
    // Some servers write an absent value as an empty VALUE: for a type that
    // no empty text can spell, that is a null.
    if (text.empty() && type != TType::eString) return TCIMValue::Null(type);
    // The common plain forms are read here; everything else (hex, binary,
    // white space, errors) goes the general way.
    switch (type) {
        case TType::eString:
            return TCIMValue(text);
        case TType::eUint8:
        case TType::eUint16:
        case TType::eUint32:
        case TType::eUint64: {
            std::uint64_t n = 0;
            if (ParsePlainDecimal(text, n) && n <= MaxUnsigned(type)) return TCIMValue::Unsigned(type, n);
            break;
        }
        case TType::eDateTime: {
            NORVTKR20::TCIMDateTime dt;
            if (NORVTKR20::TCIMDateTime::Parse(text, dt)) return TCIMValue(dt);
            break;
        }
        default:
            break;
    }
    try {
        return TCIMValue::FromText(type, text);
    } catch (const TTKRException& ex) {
        std::string message = std::string(element) + " " + Quote(text) + " does not fit TYPE " + TypeName(type) +
                              " of " + what + " " + name;
        if (ex.fStatusCode.fStatusCode == NORVTKR20::kOutOfRange) message += " (out of range)";
        Fail(offset, message);
    }
}

// ---------------------------------------------------------------- object paths

void TParser::StartPathElement(E kind, const char** atts) {
    TFrame& parent = fStack[fStack.size() - 2];
    if (!IsPathPart(parent.fKind) && parent.fKind != E::kVALUE_REFERENCE) {
        // The outermost element of a path: it starts a path of its own.
        if (IsWrapper(parent.fKind)) {
            const char* wrapperName = ElementName(parent.fKind);
            if (parent.fSeen & kSeenPath) FailHere(std::string(wrapperName) + " holds more than one path");
            if (parent.fSeen & kSeenObject) FailHere(std::string(wrapperName) + ": the path must come before the object");
            parent.fSeen |= kSeenPath;
        }
        fPaths.emplace_back();
        fPaths.back().fOffset = Here();
    } else if (parent.fKind == E::kVALUE_REFERENCE) {
        if (parent.fSeen & kSeenPath) FailHere("VALUE.REFERENCE holds more than one path");
        parent.fSeen |= kSeenPath;
    }
    TPath& path = TopPath();
    switch (kind) {
        case E::kINSTANCENAME: {
            const char* name = Attr(atts, "CLASSNAME");
            if (!name) FailHere("INSTANCENAME without CLASSNAME");
            path.fRef.SetClassName(name);
            break;
        }
        case E::kCLASSNAME: {
            const char* name = Attr(atts, "NAME");
            if (!name) FailHere("CLASSNAME without NAME");
            path.fRef.SetClassName(name);
            break;
        }
        case E::kNAMESPACE: {
            const char* name = Attr(atts, "NAME");
            if (!name) FailHere("NAMESPACE without NAME");
            if (!path.fNamespace.empty()) path.fNamespace += '/';
            path.fNamespace += name;
            break;
        }
        case E::kKEYBINDING: {
            const char* name = Attr(atts, "NAME");
            if (!name) FailHere("KEYBINDING without NAME");
            path.fKeyName = name;
            break;
        }
        case E::kKEYVALUE: {
            if (parent.fSeen & kSeenValue) {
                FailHere(parent.fKind == E::kKEYBINDING ? "KEYBINDING " + path.fKeyName + " holds more than one value"
                                                        : std::string("INSTANCENAME holds more than one value"));
            }
            parent.fSeen |= kSeenValue;
            const char* valueType = Attr(atts, "VALUETYPE");
            if (!valueType || std::strcmp(valueType, "string") == 0) fKeyKind = 's';
            else if (std::strcmp(valueType, "boolean") == 0) fKeyKind = 'b';
            else if (std::strcmp(valueType, "numeric") == 0) fKeyKind = 'n';
            else FailHere("unknown VALUETYPE " + Quote(valueType) + " of KEYVALUE");
            fKeyType = TType::eUnknown;
            if (Attr(atts, "TYPE")) fKeyType = RequireType(atts, "KEYVALUE of key", path.fKeyName.c_str());
            fText.clear();
            fProtected.clear();
            break;
        }
        case E::kHOST:
            fText.clear();
            fProtected.clear();
            break;
        default:
            break;
    }
}

void TParser::EndKeyValue() {
    TPath& path = TopPath();
    const std::string& text = TakeText();
    const std::int64_t offset = Current().fOffset;
    const std::string& key = fStack[fStack.size() - 2].fKind == E::kKEYBINDING ? path.fKeyName : std::string();
    TCIMValue value;
    if (fKeyType != TType::eUnknown) {
        value = Convert(fKeyType, text, "KEYVALUE", "key", key, offset);
    } else if (fKeyKind == 's') {
        value = TCIMValue(text);
    } else if (fKeyKind == 'b') {
        value = Convert(TType::eBoolean, text, "KEYVALUE", "key", key, offset);
    } else {
        // A number without a declared type: the widest integer, else a real.
        const bool negative = text.find('-') != std::string::npos;
        try {
            value = TCIMValue::FromText(negative ? TType::eSint64 : TType::eUint64, text);
        } catch (const TTKRException&) {
            try {
                value = TCIMValue::FromText(TType::eReal64, text);
            } catch (const TTKRException&) {
                Fail(offset, "KEYVALUE " + Quote(text) + " of key " + key + " is not a number");
            }
        }
    }
    path.fRef.AddKeyValue(key, std::move(value));
}

void TParser::EndPathElement(E kind) {
    const TFrame& frame = Current();
    switch (kind) {
        case E::kKEYVALUE:
            EndKeyValue();
            break;
        case E::kHOST:
            TopPath().fRef.SetHost(TakeText());
            break;
        case E::kLOCALNAMESPACEPATH:
            TopPath().fRef.SetNamespacePath(TopPath().fNamespace);
            break;
        case E::kKEYBINDING:
            if (!(frame.fSeen & kSeenValue))
                Fail(frame.fOffset, "KEYBINDING " + TopPath().fKeyName + " holds no KEYVALUE or VALUE.REFERENCE");
            break;
        default:
            break;
    }
    const E parent = fStack[fStack.size() - 2].fKind;
    if (IsPathPart(parent) || parent == E::kVALUE_REFERENCE) return;
    // The outermost element of a path: the path is complete.
    TPath path = std::move(fPaths.back());
    fPaths.pop_back();
    if (IsWrapper(parent)) {
        fObjectPath = std::move(path.fRef);
        fObjectPath.SetNamespace(fNamespace);
        fHaveObjectPath = true;
    }
}

TParser::TPath& TParser::TopPath() { return fPaths.back(); }

// ---------------------------------------------------------------- responses

void TParser::StartError(const char** atts) {
    const char* code = Attr(atts, "CODE");
    const char* description = Attr(atts, "DESCRIPTION");
    std::string text = std::string("server returned ERROR CODE=") + (code ? code : "?");
    if (description && *description) text += std::string(" (") + description + ")";
    fWarnings.emplace_back(static_cast<unsigned>(XML_GetCurrentLineNumber(fParser)), text);
}

// ---------------------------------------------------------------- helpers

ECIMType TParser::RequireType(const char** atts, const char* element, const char* name) {
    const char* type = Attr(atts, "TYPE");
    if (!type) FailHere(std::string(element) + " " + name + " has no TYPE");
    ECIMType out = TType::eUnknown;
    if (!LookupType(type, out)) FailHere("unknown TYPE " + Quote(type) + " of " + element + " " + name);
    return out;
}

int TParser::ArraySize(const char* text) {
    // Digits only, and a count that an int holds: no sign, no blanks, no
    // number too large to mean anything.
    const size_t n = std::strlen(text);
    bool digits = n > 0 && n <= 10;
    long long value = 0;
    for (size_t k = 0; digits && k < n; ++k) {
        digits = text[k] >= '0' && text[k] <= '9';
        value = value * 10 + (text[k] - '0');
    }
    if (!digits || value > 0x7FFFFFFF) FailHere("ARRAYSIZE " + Quote(text) + " is not a count");
    return static_cast<int>(value);
}

bool TParser::BoolAttr(const char** atts, const char* attr, bool fallback) {
    const char* value = Attr(atts, attr);
    if (!value) return fallback;
    if (strcasecmp(value, "true") == 0) return true;
    if (strcasecmp(value, "false") == 0) return false;
    FailHere(std::string("attribute ") + attr + " must be true or false, not " + Quote(value));
}

// The text just read, without the layout around it: a run of literal white
// space at either end is dropped when it holds a line break (the indentation
// of a pretty-printed file); white space written as character references stays.
const std::string& TParser::TakeText() {
    const size_t n = fText.size();
    if (n == 0 || (!IsSpace(fText[0]) && !IsSpace(fText[n - 1]))) return fText;
    // fProtected is in ascending order: the layout at the start ends at the
    // first protected position, the layout at the end begins after the last.
    const size_t firstProtected = fProtected.empty() ? n : fProtected.front();
    const size_t lastProtected = fProtected.empty() ? 0 : fProtected.back();
    size_t begin = 0;
    bool lineBreak = false;
    while (begin < n && begin < firstProtected && IsSpace(fText[begin])) {
        lineBreak = lineBreak || fText[begin] == '\n' || fText[begin] == '\r';
        ++begin;
    }
    if (!lineBreak) begin = 0;
    size_t end = n;
    lineBreak = false;
    while (end > begin && IsSpace(fText[end - 1]) && (fProtected.empty() || end - 1 > lastProtected)) {
        lineBreak = lineBreak || fText[end - 1] == '\n' || fText[end - 1] == '\r';
        --end;
    }
    if (!lineBreak) end = n;
    if (begin == 0 && end == n) return fText;
    fTrimmed.assign(fText, begin, end - begin);
    return fTrimmed;
}

std::int64_t TParser::Here() const { return static_cast<std::int64_t>(XML_GetCurrentByteIndex(fParser)); }

void TParser::Fail(std::int64_t offset, std::string message) {
    fFailure = TParseFailure{true, false, offset, 0, 0, std::move(message)};
    XML_StopParser(fParser, XML_FALSE);
    throw TAbort();
}

void TParser::FailHere(std::string message) { Fail(Here(), std::move(message)); }

}  // namespace cimxml
}  // namespace repository
}  // namespace braigrion
