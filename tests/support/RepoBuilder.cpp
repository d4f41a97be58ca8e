#include "support/RepoBuilder.h"

#include <cctype>
#include <stdexcept>

#include <boost/make_shared.hpp>

namespace braigrion {
namespace testing {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMNamespace;
using NORVTKR20::INamespaceProvider;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
typedef TCIMValue::TCIMType TType;

namespace {

TProp Make(const std::string& name, const TCIMValue& value, TType::ECIMType type, bool isArray = false) {
    TProp p;
    p.fName = name;
    p.fValue = value;
    p.fType = type;
    p.fIsArray = isArray;
    return p;
}

}  // namespace

TProp Str(const std::string& name, const std::string& text) { return Make(name, TCIMValue(text), TType::eString); }

TProp U32(const std::string& name, unsigned int value) { return Make(name, TCIMValue(value), TType::eUint32); }

TProp StrArray(const std::string& name, const std::vector<std::string>& texts) {
    std::vector<TCIMValue> elements;
    for (const std::string& text : texts) elements.push_back(TCIMValue(text));
    return Make(name, TCIMValue::Array(TType::eString, elements), TType::eString, true);
}

namespace {

// A namespace that shows another one under a provider of a chosen type.
class TProviderTypeView : public ICIMNamespace {
public:
    class TProvider : public INamespaceProvider {
    public:
        explicit TProvider(int type) : fType(type) {}
        int GetProviderType(const TCIMContext&) override { return fType; }

    private:
        int fType;
    };

    TProviderTypeView(boost::shared_ptr<ICIMNamespace> inner, int type)
        : fInner(inner), fProvider(boost::make_shared<TProvider>(type)) {}

    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(const TCIMContext&) override { return fProvider; }
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, const TCIMContext& context) override {
        return fInner->GetClass(name, context);
    }
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, const TCIMContext& context) override {
        return fInner->GetInstance(path, context);
    }

private:
    boost::shared_ptr<ICIMNamespace> fInner;
    boost::shared_ptr<INamespaceProvider> fProvider;
};

// Reads the text of a CIM-ish line piece by piece.
class TLineReader {
public:
    TLineReader(const std::string& line, int lineNumber) : fLine(line), fLineNumber(lineNumber), fPos(0) {}

    [[noreturn]] void Fail(const std::string& what) const {
        throw std::invalid_argument("repository text, line " + std::to_string(fLineNumber) + ": " + what);
    }
    void SkipBlanks() {
        while (fPos < fLine.size() && std::isspace(static_cast<unsigned char>(fLine[fPos]))) ++fPos;
    }
    bool AtEnd() {
        SkipBlanks();
        return fPos >= fLine.size();
    }
    bool Peek(char c) const { return fPos < fLine.size() && fLine[fPos] == c; }
    void Expect(char c) {
        if (!Peek(c)) Fail(std::string("expected '") + c + "' at column " + std::to_string(fPos + 1));
        ++fPos;
    }
    // A name: letters, digits and '_'.
    std::string Name() {
        size_t start = fPos;
        while (fPos < fLine.size() && (std::isalnum(static_cast<unsigned char>(fLine[fPos])) || fLine[fPos] == '_')) {
            ++fPos;
        }
        if (start == fPos) Fail("expected a name at column " + std::to_string(fPos + 1));
        return fLine.substr(start, fPos - start);
    }
    // A bare word up to a blank, ',', ':' or '['.
    std::string Head() {
        size_t start = fPos;
        while (fPos < fLine.size() && !std::isspace(static_cast<unsigned char>(fLine[fPos])) &&
               std::string(",:[").find(fLine[fPos]) == std::string::npos) {
            ++fPos;
        }
        return fLine.substr(start, fPos - start);
    }
    // A quoted string with \" and \\ escapes, or a bare word up to a blank or a comma.
    std::string Word(bool& quoted) {
        quoted = Peek('"');
        std::string text;
        if (quoted) {
            ++fPos;
            while (fPos < fLine.size() && fLine[fPos] != '"') {
                if (fLine[fPos] == '\\' && fPos + 1 < fLine.size()) ++fPos;
                text += fLine[fPos++];
            }
            if (fPos >= fLine.size()) Fail("unterminated string");
            ++fPos;
            return text;
        }
        while (fPos < fLine.size() && !std::isspace(static_cast<unsigned char>(fLine[fPos])) && fLine[fPos] != ',') {
            text += fLine[fPos++];
        }
        return text;
    }

private:
    const std::string& fLine;
    int fLineNumber;
    size_t fPos;
};

TType::ECIMType TypeNamed(TLineReader& reader, const std::string& name) {
    TType::ECIMType type;
    if (!TType::FromName(name, type)) reader.Fail("unknown CIM type \"" + name + "\"");
    return type;
}

TCIMValue Scalar(TLineReader& reader, TType::ECIMType type, const std::string& text) {
    try {
        return type == TType::eString ? TCIMValue(text) : TCIMValue::FromText(type, text);
    } catch (const std::exception& ex) {
        reader.Fail("\"" + text + "\" is no " + TType(type).GetName() + " (" + ex.what() + ")");
    }
}

TProp ReadValue(TLineReader& reader, const std::string& name) {
    bool quoted = false;
    if (reader.Peek('"')) return Make(name, TCIMValue(reader.Word(quoted)), TType::eString);
    // A bare word, or a type name before ':' or '[]:'.
    std::string head = reader.Head();
    if (reader.Peek('[')) {
        reader.Expect('[');
        reader.Expect(']');
        reader.Expect(':');
        TType::ECIMType type = TypeNamed(reader, head);
        std::vector<TCIMValue> elements;
        do {
            if (!elements.empty()) reader.Expect(',');
            elements.push_back(Scalar(reader, type, reader.Word(quoted)));
        } while (reader.Peek(','));
        return Make(name, TCIMValue::Array(type, elements), type, true);
    }
    if (reader.Peek(':')) {
        reader.Expect(':');
        std::string text = reader.Word(quoted);
        if (head == "null") {
            TType::ECIMType type = TypeNamed(reader, text);
            return Make(name, TCIMValue::Null(type), type);
        }
        TType::ECIMType type = TypeNamed(reader, head);
        return Make(name, Scalar(reader, type, text), type);
    }
    if (head == "true" || head == "false") return Make(name, TCIMValue::Boolean(head == "true"), TType::eBoolean);
    if (!head.empty() && head.find_first_not_of("0123456789") == std::string::npos) {
        return Make(name, Scalar(reader, TType::eUint32, head), TType::eUint32);
    }
    reader.Fail("cannot read the value of " + name + ": \"" + head + "\"");
}

}  // namespace

TRepoBuilder::TRepoBuilder() : fNamespace(repository::TMemoryNamespace::Create()) {}

TRepoBuilder& TRepoBuilder::Add(const std::string& className, std::vector<TProp> properties) {
    fNamespace->AddInstance(className, properties);
    return *this;
}

TRepoBuilder& TRepoBuilder::Declare(const std::string& className, const std::vector<std::string>& properties) {
    repository::TClassData data;
    data.fName = className;
    for (const std::string& name : properties) {
        repository::TPropertyDeclData declaration;
        declaration.fName = name;
        data.fProperties.push_back(declaration);
    }
    fNamespace->DeclareClass(data);
    return *this;
}

TRepoBuilder& TRepoBuilder::Parse(const std::string& text) {
    size_t start = 0;
    int lineNumber = 0;
    while (start <= text.size()) {
        size_t end = text.find('\n', start);
        if (end == std::string::npos) end = text.size();
        ParseLine(text.substr(start, end - start), ++lineNumber);
        start = end + 1;
    }
    return *this;
}

void TRepoBuilder::ParseLine(const std::string& line, int lineNumber) {
    TLineReader reader(line, lineNumber);
    if (reader.AtEnd() || reader.Peek('#')) return;
    std::string className = reader.Name();
    if (className == "class") {
        reader.SkipBlanks();
        std::string declared = reader.Name();
        if (!reader.AtEnd()) reader.Fail("a class line holds only the class name");
        Declare(declared);
        return;
    }
    std::vector<TProp> properties;
    while (!reader.AtEnd()) {
        std::string name = reader.Name();
        reader.Expect('=');
        properties.push_back(ReadValue(reader, name));
    }
    Add(className, properties);
}

boost::shared_ptr<ICIMNamespace> TRepoBuilder::WithProviderType(int providerType) const {
    return boost::make_shared<TProviderTypeView>(fNamespace, providerType);
}

}  // namespace testing
}  // namespace braigrion
