#include "tkrcore/TCIMReference.h"

#include <cctype>
#include <charconv>
#include <strings.h>

#include "tkrcore/CIMInterfaces.h"
#include "tkrcore/TTKRException.h"

namespace NORVTKR20 {

namespace {

typedef TCIMValue::TCIMType TType;

bool IEquals(const std::string& a, const std::string& b) {
    return a.size() == b.size() && strncasecmp(a.c_str(), b.c_str(), a.size()) == 0;
}

bool IsQuotedKind(int t) {
    return t == TType::eString || t == TType::eChar16 || t == TType::eDateTime || t == TType::eReference;
}

void AppendQuoted(std::string& out, const std::string& text) {
    out += '"';
    for (char c : text) {
        if (c == '"' || c == '\\') out += '\\';
        out += c;
    }
    out += '"';
}

// A key value read from a path text has no declared type: quoted text is a
// string, TRUE/FALSE a boolean, a number an integer or a real. Anything else
// unquoted is not a key value.
bool KeyFromBareToken(const std::string& token, TCIMValue& out) {
    if (IEquals(token, "true") || IEquals(token, "false")) {
        out = TCIMValue::Boolean(IEquals(token, "true"));
        return true;
    }
    try {
        out = (!token.empty() && token[0] == '-') ? TCIMValue::FromText(TType::eSint64, token)
                                                  : TCIMValue::FromText(TType::eUint64, token);
        return true;
    } catch (const TTKRException&) {
    }
    try {
        out = TCIMValue::FromText(TType::eReal64, token);
        return true;
    } catch (const TTKRException&) {
    }
    return false;
}

}  // namespace

TCIMReference::TCIMReference() {}

TCIMReference::TCIMReference(boost::shared_ptr<ICIMNamespace> ns, const std::string& className,
                             std::map<std::string, TCIMValue> context)
    : fNamespace(ns), fContext(std::move(context)) {
    TCIMReference parsed;
    if (className.find_first_of(".:=") != std::string::npos && ParsePath(className, parsed)) {
        fClassName = parsed.fClassName;
        fKeys = parsed.fKeys;
        fHost = parsed.fHost;
        fNamespacePath = parsed.fNamespacePath;
    } else {
        fClassName = className;
    }
}

TCIMReference::TCIMReference(boost::shared_ptr<ICIMNamespace> ns, std::map<std::string, TCIMValue> context)
    : fNamespace(ns), fContext(std::move(context)) {}

void TCIMReference::AddKeyValue(const std::string& name, const TCIMValue& value) { fKeys[name] = value; }

void TCIMReference::AddKeyValue(const std::string& name, TCIMValue&& value) { fKeys[name] = std::move(value); }

void TCIMReference::EnumerateKeyBindings(
    boost::function<bool(std::pair<std::string, TCIMValue>)> const& callback) const {
    for (const auto& kv : fKeys) {
        if (!callback(std::pair<std::string, TCIMValue>(kv.first, kv.second))) break;
    }
}

boost::shared_ptr<ICIMElement> TCIMReference::GetCIMElement(bool throwIfMissing) const {
    boost::shared_ptr<ICIMNamespace> ns = fNamespace.lock();
    if (!ns) {
        if (throwIfMissing) throw TTKRException(kNotFound);
        return boost::shared_ptr<ICIMElement>();
    }
    try {
        return ns->GetInstance(*this, fContext);
    } catch (const TTKRException& ex) {
        if (ex.fStatusCode.fStatusCode != kNotFound || throwIfMissing) throw;
    }
    return boost::shared_ptr<ICIMElement>();
}

boost::shared_ptr<ICIMClass> TCIMReference::GetClass() const {
    boost::shared_ptr<ICIMNamespace> ns = fNamespace.lock();
    if (!ns) throw TTKRException(kNotFound);
    return ns->GetClass(fClassName, fContext);
}

std::string TCIMReference::GetPath() const {
    std::string out = fClassName;
    bool first = true;
    for (const auto& kv : fKeys) {
        out += first ? '.' : ',';
        first = false;
        out += kv.first;
        out += '=';
        const TCIMValue& v = kv.second;
        if (v.IsNull()) {
            AppendQuoted(out, std::string());
        } else if (IsQuotedKind(v.GetType())) {
            AppendQuoted(out, v.ToString(10));
        } else if (v.GetType() == TType::eBoolean) {
            out += static_cast<bool>(v) ? "TRUE" : "FALSE";
        } else {
            out += v.ToString(10);
        }
    }
    return out;
}

bool TCIMReference::ParsePath(const std::string& text, TCIMReference& out) {
    TCIMReference ref;
    size_t pos = 0;
    const size_t n = text.size();
    while (pos < n && std::isspace(static_cast<unsigned char>(text[pos]))) ++pos;
    if (text.compare(pos, 2, "//") == 0) {
        size_t slash = text.find('/', pos + 2);
        if (slash == std::string::npos) return false;
        ref.fHost = text.substr(pos + 2, slash - pos - 2);
        pos = slash + 1;
    }
    // The class part ends at the first '.', or at the end; a ':' before it
    // closes a namespace path.
    size_t dot = text.find('.', pos);
    size_t colon = text.find(':', pos);
    if (colon != std::string::npos && (dot == std::string::npos || colon < dot)) {
        ref.fNamespacePath = text.substr(pos, colon - pos);
        pos = colon + 1;
        dot = text.find('.', pos);
    }
    size_t classEnd = dot == std::string::npos ? n : dot;
    ref.fClassName = text.substr(pos, classEnd - pos);
    while (!ref.fClassName.empty() && std::isspace(static_cast<unsigned char>(ref.fClassName.back())))
        ref.fClassName.pop_back();
    if (ref.fClassName.empty()) return false;
    for (char c : ref.fClassName) {
        if (!(std::isalnum(static_cast<unsigned char>(c)) || c == '_')) return false;
    }
    pos = classEnd;
    if (pos < n) {
        ++pos;  // the '.'
        while (pos < n) {
            size_t eq = text.find('=', pos);
            if (eq == std::string::npos || eq == pos) return false;
            std::string name = text.substr(pos, eq - pos);
            pos = eq + 1;
            TCIMValue value;
            if (pos < n && text[pos] == '"') {
                std::string s;
                ++pos;
                bool closed = false;
                while (pos < n) {
                    char c = text[pos++];
                    if (c == '\\' && pos < n) {
                        s += text[pos++];
                    } else if (c == '"') {
                        closed = true;
                        break;
                    } else {
                        s += c;
                    }
                }
                if (!closed) return false;
                value = TCIMValue(s);
            } else {
                size_t comma = text.find(',', pos);
                size_t end = comma == std::string::npos ? n : comma;
                std::string token = text.substr(pos, end - pos);
                if (!KeyFromBareToken(token, value)) return false;
                pos = end;
            }
            ref.fKeys[name] = value;
            if (pos < n) {
                if (text[pos] != ',') return false;
                ++pos;
            }
        }
    }
    out.fClassName = ref.fClassName;
    out.fKeys = ref.fKeys;
    out.fHost = ref.fHost;
    out.fNamespacePath = ref.fNamespacePath;
    return true;
}

bool TCIMReference::operator==(const TCIMReference& other) const {
    if (!IEquals(fClassName, other.fClassName) || fKeys.size() != other.fKeys.size()) return false;
    for (const auto& kv : fKeys) {
        bool matched = false;
        for (const auto& okv : other.fKeys) {
            if (IEquals(kv.first, okv.first)) {
                matched = KeyValuesEqual(kv.second, okv.second);
                break;
            }
        }
        if (!matched) return false;
    }
    return true;
}

bool KeyValuesEqual(const TCIMValue& a, const TCIMValue& b) {
    if (a.IsNull() || b.IsNull()) return a.IsNull() && b.IsNull();
    if (a.IsArray() || b.IsArray()) return a == b;
    const int ta = a.GetType(), tb = b.GetType();
    auto numeric = [](int t) { return t >= TType::eUint8 && t <= TType::eReal64; };
    if (numeric(ta) || numeric(tb)) {
        try {
            if (ta == TType::eReal32 || ta == TType::eReal64 || tb == TType::eReal32 || tb == TType::eReal64)
                return a.AsReal() == b.AsReal();
            return a.AsSigned() == b.AsSigned();
        } catch (const TTKRException&) {
        }
        try {
            return a.AsUnsigned() == b.AsUnsigned();
        } catch (const TTKRException&) {
            return false;
        }
    }
    if (ta == TType::eBoolean || tb == TType::eBoolean) return IEquals(a.ToString(10), b.ToString(10));
    if (ta == TType::eReference && tb == TType::eReference)
        return static_cast<TCIMReference>(a) == static_cast<TCIMReference>(b);
    return a.ToString(10) == b.ToString(10);
}

}  // namespace NORVTKR20
