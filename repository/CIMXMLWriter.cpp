#include "repository/CIMXMLWriter.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <map>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>
#include <unordered_set>

#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace braigrion {
namespace repository {

namespace {

using NORVTKR20::TCIMDateTime;
typedef TCIMValue::TCIMType TType;
typedef TType::ECIMType ECIMType;

const char kReplacement[] = "\xEF\xBF\xBD";  // U+FFFD
const char kDefaultNamespace[] = "root/cimv2";

bool IsSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

// Length of the well-formed UTF-8 sequence at `s`, or 0.
size_t Utf8Length(const unsigned char* s, size_t left) {
    const unsigned char c = s[0];
    size_t n = 0;
    unsigned char lo = 0x80, hi = 0xBF;  // range of the second byte
    if (c >= 0xC2 && c <= 0xDF) n = 2;
    else if (c >= 0xE0 && c <= 0xEF) {
        n = 3;
        if (c == 0xE0) lo = 0xA0;
        if (c == 0xED) hi = 0x9F;  // no surrogates
    } else if (c >= 0xF0 && c <= 0xF4) {
        n = 4;
        if (c == 0xF0) lo = 0x90;
        if (c == 0xF4) hi = 0x8F;
    }
    if (n == 0 || n > left || s[1] < lo || s[1] > hi) return 0;
    for (size_t k = 2; k < n; ++k) {
        if ((s[k] & 0xC0) != 0x80) return 0;
    }
    return n;
}

// U+FFFE and U+FFFF: well-formed, but no XML character.
bool IsNonCharacter(const unsigned char* s, size_t len) {
    return len == 3 && s[0] == 0xEF && s[1] == 0xBF && (s[2] == 0xBE || s[2] == 0xBF);
}

// Appends `text` escaped for element content (`attribute` false) or for a
// double-quoted attribute value.
void AppendEscaped(std::string& out, const std::string& text, bool attribute) {
    const size_t n = text.size();
    size_t lead = 0;  // end of the white space at the start
    while (lead < n && IsSpace(text[lead])) ++lead;
    size_t trail = n;  // start of the white space at the end
    while (trail > lead && IsSpace(text[trail - 1])) --trail;
    const unsigned char* s = reinterpret_cast<const unsigned char*>(text.data());
    for (size_t k = 0; k < n;) {
        const unsigned char c = s[k];
        if (c >= 0x80) {
            const size_t len = Utf8Length(s + k, n - k);
            if (len == 0) {  // each stray byte stands for one character
                out += kReplacement;
                ++k;
            } else if (IsNonCharacter(s + k, len)) {
                out += kReplacement;
                k += len;
            } else {
                out.append(text, k, len);
                k += len;
            }
            continue;
        }
        switch (c) {
            case '&': out += "&amp;"; break;
            case '<': out += "&lt;"; break;
            case '>': out += "&gt;"; break;
            case '"':
                if (attribute) out += "&quot;";
                else out += '"';
                break;
            case '\r': out += "&#13;"; break;
            case '\n':
                if (attribute || k < lead || k >= trail) out += "&#10;";
                else out += '\n';
                break;
            case '\t':
                if (attribute) out += "&#9;";
                else out += '\t';
                break;
            default:
                if (c < 0x20) out += kReplacement;
                else out += static_cast<char>(c);
                break;
        }
        ++k;
    }
}

// Text of a scalar value in CIM-XML.
std::string ValueText(const TCIMValue& value) {
    switch (value.GetType()) {
        case TType::eBoolean: return static_cast<bool>(value) ? "TRUE" : "FALSE";
        case TType::eDateTime: return static_cast<TCIMDateTime>(value).ToCIMString();
        case TType::eReference: return static_cast<TCIMReference>(value).GetPath();
        default: return value.ToString(10);
    }
}

const char* TypeName(ECIMType type) {
    if (type == TType::eUnknown || type == TType::eReference) return "string";
    return TType(type).GetName();
}

// Buffers the document and hands it to the stream in large pieces.
class TDocument {
public:
    explicit TDocument(std::ostream& out) : fOut(out) { fBuffer.reserve(kFlushAt + 4096); }

    TDocument& operator<<(const char* text) {
        fBuffer += text;
        return *this;
    }
    TDocument& operator<<(const std::string& text) {
        fBuffer += text;
        return *this;
    }
    // ` NAME="value"`
    void Attr(const char* name, const std::string& value) {
        fBuffer += ' ';
        fBuffer += name;
        fBuffer += "=\"";
        AppendEscaped(fBuffer, value, true);
        fBuffer += '"';
    }
    void Text(const std::string& text) { AppendEscaped(fBuffer, text, false); }
    // Ends a line; the buffer goes out when it has grown large.
    void Line() {
        fBuffer += '\n';
        if (fBuffer.size() >= kFlushAt) Flush();
    }
    void Flush() {
        fOut.write(fBuffer.data(), static_cast<std::streamsize>(fBuffer.size()));
        fBuffer.clear();
    }

private:
    static const size_t kFlushAt = 1 << 20;
    std::ostream& fOut;
    std::string fBuffer;
};

class TWriter {
public:
    TWriter(const TMemoryNamespace& ns, std::ostream& out, EWriteForm form) : fNamespace(ns), fDoc(out), fForm(form) {}

    void Write() {
        fDoc << "<?xml version=\"1.0\" encoding=\"utf-8\"?>";
        fDoc.Line();
        fDoc << "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">";
        fDoc.Line();
        fDoc << "<DECLARATION>";
        fDoc.Line();
        if (fForm == EWriteForm::kWithName) {
            fDoc << "<DECLGROUP.WITHNAME>";
            fDoc.Line();
            WriteQualifierTypes();
            WriteClasses();
            WriteInstances();
            fDoc << "</DECLGROUP.WITHNAME>";
        } else {
            // Qualifier declarations have no place in DECLGROUP.WITHPATH.
            if (!fNamespace.GetQualifierTypes().empty()) {
                fDoc << "<DECLGROUP>";
                fDoc.Line();
                WriteQualifierTypes();
                fDoc << "</DECLGROUP>";
                fDoc.Line();
            }
            fDoc << "<DECLGROUP.WITHPATH>";
            fDoc.Line();
            WriteClasses();
            WriteInstances();
            fDoc << "</DECLGROUP.WITHPATH>";
        }
        fDoc.Line();
        fDoc << "</DECLARATION>";
        fDoc.Line();
        fDoc << "</CIM>";
        fDoc.Line();
        fDoc.Flush();
    }

private:
    // ------------------------------------------------------------ schema

    void WriteQualifierTypes() {
        for (const TQualifierTypeData& q : fNamespace.GetQualifierTypes()) {
            fDoc << "<QUALIFIER.DECLARATION";
            fDoc.Attr("NAME", q.fName);
            fDoc.Attr("TYPE", TypeName(q.fType));
            if (q.fIsArray) fDoc << " ISARRAY=\"true\"";
            if (q.fArraySize >= 0) fDoc.Attr("ARRAYSIZE", std::to_string(q.fArraySize));
            WriteFlavors(q.fOverridable, q.fToSubclass, q.fToInstance, q.fTranslatable);
            fDoc << ">";
            fDoc.Line();
            WriteScope(q.fScopes);
            if (!q.fDefault.IsNull()) WriteValue(q.fDefault);
            fDoc << "</QUALIFIER.DECLARATION>";
            fDoc.Line();
        }
    }

    void WriteScope(const std::vector<std::string>& scopes) {
        static const char* const kScopes[][2] = {{"CLASS", "class"},         {"ASSOCIATION", "association"},
                                                 {"REFERENCE", "reference"}, {"PROPERTY", "property"},
                                                 {"METHOD", "method"},       {"PARAMETER", "parameter"},
                                                 {"INDICATION", "indication"}};
        if (scopes.empty()) return;
        const bool any = std::find(scopes.begin(), scopes.end(), "any") != scopes.end();
        fDoc << "<SCOPE";
        for (const auto& scope : kScopes) {
            if (any || std::find(scopes.begin(), scopes.end(), scope[1]) != scopes.end()) {
                fDoc << " " << scope[0] << "=\"true\"";
            }
        }
        fDoc << "/>";
        fDoc.Line();
    }

    void WriteFlavors(bool overridable, bool toSubclass, bool toInstance, bool translatable) {
        if (!overridable) fDoc << " OVERRIDABLE=\"false\"";
        if (!toSubclass) fDoc << " TOSUBCLASS=\"false\"";
        if (toInstance) fDoc << " TOINSTANCE=\"true\"";
        if (translatable) fDoc << " TRANSLATABLE=\"true\"";
    }

    void WriteQualifiers(const std::vector<TQualifierData>& qualifiers) {
        for (const TQualifierData& q : qualifiers) {
            fDoc << "<QUALIFIER";
            fDoc.Attr("NAME", q.fName);
            fDoc.Attr("TYPE", TypeName(q.fValue.GetType()));
            if (q.fPropagated) fDoc << " PROPAGATED=\"true\"";
            WriteFlavors(q.fOverridable, q.fToSubclass, q.fToInstance, q.fTranslatable);
            fDoc << ">";
            if (!q.fValue.IsNull()) WriteValue(q.fValue);
            fDoc << "</QUALIFIER>";
            fDoc.Line();
        }
    }

    // Declared classes, each after its superclass when that is declared too.
    void WriteClasses() {
        std::unordered_set<const TMemoryClass*> done;
        for (const TMemoryClass* cls : fNamespace.GetClasses()) WriteClassAfterSuper(cls, done);
    }

    void WriteClassAfterSuper(const TMemoryClass* cls, std::unordered_set<const TMemoryClass*>& done) {
        if (!cls->IsDeclared() || !done.insert(cls).second) return;
        const std::string& super = cls->GetDeclaration().fSuperClass;
        if (!super.empty()) {
            if (const TMemoryClass* superClass = fNamespace.FindClass(super)) WriteClassAfterSuper(superClass, done);
        }
        if (fForm == EWriteForm::kWithName) {
            fDoc << "<VALUE.NAMEDOBJECT>";
            fDoc.Line();
            WriteClass(cls->GetDeclaration());
            fDoc << "</VALUE.NAMEDOBJECT>";
        } else {
            fDoc << "<VALUE.OBJECTWITHLOCALPATH>";
            fDoc.Line();
            fDoc << "<LOCALCLASSPATH>";
            WriteLocalNamespacePath(kDefaultNamespace);
            fDoc << "<CLASSNAME";
            fDoc.Attr("NAME", cls->GetName());
            fDoc << "/></LOCALCLASSPATH>";
            fDoc.Line();
            WriteClass(cls->GetDeclaration());
            fDoc << "</VALUE.OBJECTWITHLOCALPATH>";
        }
        fDoc.Line();
    }

    void WriteClass(const TClassData& cls) {
        fDoc << "<CLASS";
        fDoc.Attr("NAME", cls.fName);
        if (!cls.fSuperClass.empty()) fDoc.Attr("SUPERCLASS", cls.fSuperClass);
        fDoc << ">";
        fDoc.Line();
        WriteQualifiers(cls.fQualifiers);
        for (const TPropertyDeclData& p : cls.fProperties) {
            const char* element = p.fType == TType::eReference ? "PROPERTY.REFERENCE"
                                  : p.fIsArray                 ? "PROPERTY.ARRAY"
                                                               : "PROPERTY";
            fDoc << "<" << element;
            fDoc.Attr("NAME", p.fName);
            if (p.fType == TType::eReference) {
                if (!p.fReferenceClass.empty()) fDoc.Attr("REFERENCECLASS", p.fReferenceClass);
            } else {
                fDoc.Attr("TYPE", TypeName(p.fType));
                if (p.fIsArray && p.fArraySize >= 0) fDoc.Attr("ARRAYSIZE", std::to_string(p.fArraySize));
            }
            if (!p.fClassOrigin.empty()) fDoc.Attr("CLASSORIGIN", p.fClassOrigin);
            if (p.fPropagated) fDoc << " PROPAGATED=\"true\"";
            if (p.fEmbeddedObject && p.fType != TType::eReference) fDoc << " EmbeddedObject=\"object\"";
            fDoc << ">";
            fDoc.Line();
            WriteQualifiers(p.fQualifiers);
            if (!p.fDefault.IsNull()) WriteValue(p.fDefault);
            fDoc << "</" << element << ">";
            fDoc.Line();
        }
        fDoc << "</CLASS>";
        fDoc.Line();
    }

    // ------------------------------------------------------------ instances

    void WriteInstances() {
        for (const TMemoryClass* cls : fNamespace.GetClasses()) {
            for (const auto& instance : cls->GetInstances()) WriteInstance(*cls, *instance);
        }
    }

    void WriteInstance(const TMemoryClass& cls, TMemoryInstance& instance) {
        // A class without keys is written with an empty instance name, so that
        // reading back does not make keys of its properties.
        TCIMReference path = instance.GetPath(TCIMContext());
        const bool keyed = !cls.GetKeyNames().empty() || !instance.GetExtraKeys().empty();
        if (fForm == EWriteForm::kWithName) {
            fDoc << "<VALUE.NAMEDOBJECT>";
            fDoc.Line();
            WriteInstanceName(cls.GetName(), keyed ? path.GetKeyBindings() : TKeys());
        } else {
            fDoc << "<VALUE.OBJECTWITHLOCALPATH>";
            fDoc.Line();
            fDoc << "<LOCALINSTANCEPATH>";
            WriteLocalNamespacePath(kDefaultNamespace);
            WriteInstanceName(cls.GetName(), keyed ? path.GetKeyBindings() : TKeys());
            fDoc << "</LOCALINSTANCEPATH>";
        }
        fDoc.Line();
        fDoc << "<INSTANCE";
        fDoc.Attr("CLASSNAME", cls.GetName());
        fDoc << ">";
        fDoc.Line();
        const auto& decls = cls.GetProperties();
        for (const TMemoryInstance::TSlot& slot : instance.GetSlots()) WriteInstanceProperty(*decls[slot.fDecl], slot.fValue);
        fDoc << "</INSTANCE>";
        fDoc.Line();
        fDoc << (fForm == EWriteForm::kWithName ? "</VALUE.NAMEDOBJECT>" : "</VALUE.OBJECTWITHLOCALPATH>");
        fDoc.Line();
    }

    // A property typed by its declaration; a value that does not fit the
    // declared type (a later write may have stored one) keeps its own type.
    void WriteInstanceProperty(const TMemoryPropertyDecl& decl, const TCIMValue& value) {
        ECIMType type = decl.GetType();
        bool isArray = decl.IsArray();
        if (!value.IsNull() && (value.GetType() != type || value.IsArray() != isArray) && !Fits(value, type, isArray)) {
            type = value.GetType();
            isArray = value.IsArray();
        }
        if (type == TType::eReference && !isArray) {
            fDoc << "<PROPERTY.REFERENCE";
            fDoc.Attr("NAME", decl.GetName());
            if (!decl.GetData().fReferenceClass.empty()) fDoc.Attr("REFERENCECLASS", decl.GetData().fReferenceClass);
            fDoc << ">";
            if (!value.IsNull()) WriteReference(static_cast<TCIMReference>(value));
            fDoc << "</PROPERTY.REFERENCE>";
            fDoc.Line();
            return;
        }
        const char* element = isArray ? "PROPERTY.ARRAY" : "PROPERTY";
        fDoc << "<" << element;
        fDoc.Attr("NAME", decl.GetName());
        fDoc.Attr("TYPE", TypeName(type));
        if (decl.GetData().fEmbeddedObject) fDoc << " EmbeddedObject=\"object\"";
        fDoc << ">";
        if (!value.IsNull()) WriteValue(value);
        fDoc << "</" << element << ">";
        fDoc.Line();
    }

    // True when the value's text reads back as the declared type.
    static bool Fits(const TCIMValue& value, ECIMType type, bool isArray) {
        if (value.IsArray() != isArray || type == TType::eUnknown || type == TType::eReference) return false;
        try {
            if (!isArray) return !TCIMValue::FromText(type, ValueText(value)).IsNull();
            for (const TCIMValue& element : static_cast<std::vector<TCIMValue>&>(value)) {
                if (!element.IsNull()) TCIMValue::FromText(type, ValueText(element));
            }
            return true;
        } catch (const NORVTKR20::TTKRException&) {
            return false;
        }
    }

    // ------------------------------------------------------------ values and paths

    void WriteValue(const TCIMValue& value) {
        if (value.IsArray()) {
            fDoc << "<VALUE.ARRAY>";
            for (const TCIMValue& element : static_cast<std::vector<TCIMValue>&>(value)) {
                if (element.IsNull()) {
                    fDoc << "<VALUE.NULL/>";
                } else {
                    fDoc << "<VALUE>";
                    fDoc.Text(ValueText(element));
                    fDoc << "</VALUE>";
                }
            }
            fDoc << "</VALUE.ARRAY>";
            return;
        }
        fDoc << "<VALUE>";
        fDoc.Text(ValueText(value));
        fDoc << "</VALUE>";
    }

    typedef std::map<std::string, TCIMValue> TKeys;

    // The fullest path form the reference can fill: with host and namespace,
    // with namespace, or the instance name alone.
    void WriteReference(const TCIMReference& ref) {
        fDoc << "<VALUE.REFERENCE>";
        const std::string& host = ref.GetHost();
        const std::string& ns = ref.GetNamespacePath();
        if (!ns.empty() && !host.empty()) {
            fDoc << "<INSTANCEPATH><NAMESPACEPATH><HOST>";
            fDoc.Text(host);
            fDoc << "</HOST>";
            WriteLocalNamespacePath(ns);
            fDoc << "</NAMESPACEPATH>";
            WriteInstanceName(ref.GetClassName(), ref.GetKeyBindings());
            fDoc << "</INSTANCEPATH>";
        } else if (!ns.empty()) {
            fDoc << "<LOCALINSTANCEPATH>";
            WriteLocalNamespacePath(ns);
            WriteInstanceName(ref.GetClassName(), ref.GetKeyBindings());
            fDoc << "</LOCALINSTANCEPATH>";
        } else {
            WriteInstanceName(ref.GetClassName(), ref.GetKeyBindings());
        }
        fDoc << "</VALUE.REFERENCE>";
    }

    void WriteLocalNamespacePath(const std::string& ns) {
        fDoc << "<LOCALNAMESPACEPATH>";
        size_t begin = 0;
        bool any = false;
        while (begin <= ns.size()) {
            size_t end = ns.find('/', begin);
            if (end == std::string::npos) end = ns.size();
            if (end > begin) {
                fDoc << "<NAMESPACE";
                fDoc.Attr("NAME", ns.substr(begin, end - begin));
                fDoc << "/>";
                any = true;
            }
            begin = end + 1;
        }
        if (!any) fDoc << "<NAMESPACE NAME=\"root\"/>";
        fDoc << "</LOCALNAMESPACEPATH>";
    }

    void WriteInstanceName(const std::string& className, const TKeys& keys) {
        fDoc << "<INSTANCENAME";
        fDoc.Attr("CLASSNAME", className);
        fDoc << ">";
        // A single key without a name stands alone in the instance name.
        if (keys.size() == 1 && keys.begin()->first.empty()) {
            WriteKeyValue(keys.begin()->second);
        } else {
            for (const auto& key : keys) {
                if (key.second.IsNull()) continue;  // a null key has no KEYVALUE form
                fDoc << "<KEYBINDING";
                fDoc.Attr("NAME", key.first);
                fDoc << ">";
                WriteKeyValue(key.second);
                fDoc << "</KEYBINDING>";
            }
        }
        fDoc << "</INSTANCENAME>";
    }

    void WriteKeyValue(const TCIMValue& value) {
        if (value.IsNull()) return;
        if (value.GetType() == TType::eReference && !value.IsArray()) {
            WriteReference(static_cast<TCIMReference>(value));
            return;
        }
        const ECIMType type = value.IsArray() ? TType::eString : static_cast<ECIMType>(value.GetType());
        const char* valueType = "string";
        if (type == TType::eBoolean) valueType = "boolean";
        else if (type >= TType::eUint8 && type <= TType::eReal64) valueType = "numeric";
        fDoc << "<KEYVALUE VALUETYPE=\"" << valueType << "\"";
        fDoc.Attr("TYPE", TypeName(type));
        fDoc << ">";
        fDoc.Text(value.IsArray() ? value.ToString(10) : ValueText(value));
        fDoc << "</KEYVALUE>";
    }

    const TMemoryNamespace& fNamespace;
    TDocument fDoc;
    EWriteForm fForm;
};

}  // namespace

void WriteCollection(const TMemoryNamespace& ns, std::ostream& out, EWriteForm form) {
    // Keys and effective declarations are derived when the collection is
    // linked; linking changes no content.
    const_cast<TMemoryNamespace&>(ns).Link();
    TWriter(ns, out, form).Write();
}

void WriteCollectionFile(const TMemoryNamespace& ns, const std::string& path, EWriteForm form) {
    std::string temp = path + ".XXXXXX";
    const int fd = mkstemp(&temp[0]);
    if (fd < 0) throw std::runtime_error("cannot write " + path + ": " + std::strerror(errno));
    ::fchmod(fd, 0644);
    ::close(fd);
    try {
        std::ofstream out(temp, std::ios::binary | std::ios::trunc);
        if (!out) throw std::runtime_error("cannot write " + path + ": cannot open " + temp);
        WriteCollection(ns, out, form);
        out.flush();
        if (!out) throw std::runtime_error("cannot write " + path + ": " + std::strerror(errno));
        out.close();
        if (std::rename(temp.c_str(), path.c_str()) != 0)
            throw std::runtime_error("cannot write " + path + ": " + std::strerror(errno));
    } catch (...) {
        std::remove(temp.c_str());
        throw;
    }
}

}  // namespace repository
}  // namespace braigrion
