// The streaming CIM-XML parser behind the loader: expat events turned into
// qualifier types, classes and instances handed to a sink. Internal to the
// reader; the public entry points are in CIMXMLReader.h.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>
#include <expat.h>

#include "repository/CIMXMLElements.h"
#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {
namespace cimxml {

using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType::ECIMType ECIMType;

// Receives what the parser has read, one object at a time. `offset` is the
// byte offset of the object's start tag, for messages.
class TSink {
public:
    virtual ~TSink() {}
    virtual void QualifierType(TQualifierTypeData&& data, std::int64_t offset) = 0;
    virtual void Class(TClassData&& data, std::int64_t offset) = 0;
    virtual void Instance(const std::string& className, std::vector<TPropertyValue>&& properties,
                          const TCIMReference* path, std::int64_t offset) = 0;
};

// A failure found while parsing: where (byte offset, or a line and column
// already known) and what.
struct TParseFailure {
    bool fFailed = false;
    bool fHavePosition = false;  // fLine/fColumn set; otherwise derive them from fOffset
    std::int64_t fOffset = 0;
    unsigned fLine = 0;
    unsigned fColumn = 0;
    std::string fMessage;
};

class TParser {
public:
    // How deep references may nest inside the key bindings of references.
    static const size_t kMaxReferenceDepth = 8;

    // References read are bound to `ns` so that they resolve in the collection
    // they are loaded into. Warnings are "LINE: text"; the caller adds the file.
    TParser(TSink& sink, const boost::shared_ptr<NORVTKR20::ICIMNamespace>& ns);
    ~TParser();
    TParser(const TParser&) = delete;
    TParser& operator=(const TParser&) = delete;

    // Feeds the next piece of the document; `last` for the final one (which
    // may be empty). False once the document has failed; see Failure().
    bool Feed(const char* data, size_t size, bool last);
    // Expat's own buffer, to read a file into without a copy, then ParseBuffer.
    void* GetBuffer(size_t size);
    bool ParseBuffer(size_t size, bool last);

    const TParseFailure& Failure() const { return fFailure; }
    const std::vector<std::pair<unsigned, std::string>>& Warnings() const { return fWarnings; }

private:
    struct TFrame {
        EElement fKind;
        std::uint8_t fSeen;   // which children were seen (kSeen* bits)
        std::int64_t fOffset; // byte offset of the start tag
    };
    // An object path being read: the outer path of an object, or a reference.
    struct TPath {
        TCIMReference fRef;
        std::string fNamespace;  // NAMESPACE names joined with '/'
        std::string fKeyName;    // NAME of the KEYBINDING being read
        std::int64_t fOffset = 0;
    };
    // Where a VALUE or VALUE.ARRAY being read goes.
    struct TValueTarget {
        ECIMType fType;
        TCIMValue* fDest;
        const char* fWhat;           // "property", "qualifier"
        const std::string* fName;
    };

    static void XMLCALL OnStart(void* self, const XML_Char* name, const XML_Char** atts);
    static void XMLCALL OnEnd(void* self, const XML_Char* name);
    static void XMLCALL OnText(void* self, const XML_Char* text, int len);
    static void XMLCALL OnEntityDecl(void* self, const XML_Char* name, int isParameter, const XML_Char* value,
                                     int valueLength, const XML_Char* base, const XML_Char* systemId,
                                     const XML_Char* publicId, const XML_Char* notation);
    static void XMLCALL OnSkippedEntity(void* self, const XML_Char* name, int isParameter);
    static int XMLCALL OnExternalEntity(XML_Parser parser, const XML_Char* context, const XML_Char* base,
                                        const XML_Char* systemId, const XML_Char* publicId);

    template <typename F>
    void Guard(F&& body);
    void Start(const char* name, const char** atts);
    void End();
    void Text(const char* text, int len);
    bool Check(enum XML_Status status);

    // --- element handlers ---
    void StartQualifierDeclaration(const char** atts);
    void StartScope(const char** atts);
    void StartClass(const char** atts);
    void StartInstance(const char** atts);
    void StartProperty(EElement kind, const char** atts);
    void StartQualifier(const char** atts);
    void StartValue(EElement kind);
    void StartPathElement(EElement kind, const char** atts);
    void StartError(const char** atts);
    void EndValue();
    void EndValueArray();
    void EndValueNull();
    void EndValueReference();
    void EndKeyValue();
    void EndPathElement(EElement kind);
    void EndProperty();
    void EndQualifier();
    void EndClass();
    void EndInstance();
    void EndWrapper();

    // --- helpers ---
    TValueTarget TargetFor(EElement parent);
    TCIMValue Convert(ECIMType type, const std::string& text, const char* element, const char* what,
                      const std::string& name, std::int64_t offset);
    ECIMType RequireType(const char** atts, const char* element, const char* name);
    bool BoolAttr(const char** atts, const char* attr, bool fallback);
    int ArraySize(const char* text);
    const std::string& TakeText();
    TPath& TopPath();
    [[noreturn]] void Fail(std::int64_t offset, std::string message);
    [[noreturn]] void FailHere(std::string message);
    void FailFromExpat();
    std::int64_t Here() const;
    EElement Parent() const { return fStack.back().fKind; }
    TFrame& Current() { return fStack.back(); }

    XML_Parser fParser;
    TSink& fSink;
    boost::shared_ptr<NORVTKR20::ICIMNamespace> fNamespace;
    TParseFailure fFailure;
    std::vector<std::pair<unsigned, std::string>> fWarnings;

    std::vector<TFrame> fStack;
    int fSkipDepth;  // >0 while reading past an ignored subtree

    // Text of the VALUE, KEYVALUE or HOST being read, and the positions in it
    // of white space that came from character references (kept when the
    // layout around a value is trimmed).
    std::string fText;
    std::vector<std::uint32_t> fProtected;
    std::string fTrimmed;

    // The object being read.
    bool fInClass;
    TClassData fClass;
    TPropertyDeclData fDecl;          // property of the class
    std::string fInstanceClass;
    std::vector<TPropertyValue> fProperties;
    size_t fLastPropertyCount;
    TPropertyValue fProperty;         // property of the instance
    TQualifierData fQualifier;
    ECIMType fQualifierType;
    TQualifierTypeData fQualifierDecl;
    std::vector<TCIMValue> fArray;
    TValueTarget fArrayTarget;
    ECIMType fKeyType;                // TYPE of the KEYVALUE being read, eUnknown when absent
    char fKeyKind;                    // its VALUETYPE: 's'tring, 'b'oolean or 'n'umeric

    // Object paths: the stack of paths being read, and the finished path of
    // the object wrapper being read.
    std::vector<TPath> fPaths;
    bool fHaveObjectPath;
    TCIMReference fObjectPath;
};

}  // namespace cimxml
}  // namespace repository
}  // namespace braigrion
