#include "repository/CIMXMLReader.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <functional>
#include <memory>

#include "repository/CIMXMLParser.h"

namespace braigrion {
namespace repository {

using cimxml::TParseFailure;
using cimxml::TParser;
using cimxml::TSink;

std::string PrintableText(const std::string& text) {
    std::string out;
    out.reserve(text.size());
    for (unsigned char c : text) {
        if (c >= 0x20 && c != 0x7F) {
            out += static_cast<char>(c);
            continue;
        }
        switch (c) {
            case '\n': out += "\\n"; break;
            case '\r': out += "\\r"; break;
            case '\t': out += "\\t"; break;
            default: {
                static const char kHex[] = "0123456789abcdef";
                out += "\\x";
                out += kHex[c >> 4];
                out += kHex[c & 15];
            }
        }
    }
    return out;
}

std::string ShownFileName(const std::string& name) {
    bool plain = !name.empty();
    for (unsigned char c : name) plain = plain && c >= 0x20 && c != 0x7F && c != '"';
    if (plain) return name;
    std::string out = "\"";
    for (char c : PrintableText(name)) {
        if (c == '"') out += '\\';
        out += c;
    }
    return out + '"';
}

namespace {

std::string LoadErrorText(const std::string& file, unsigned line, unsigned column, const std::string& message) {
    std::string out = ShownFileName(file) + ":";
    if (line > 0) out += std::to_string(line) + ":" + std::to_string(column) + ":";
    return out + " " + PrintableText(message);
}

}  // namespace

TLoadError::TLoadError(std::string file, unsigned line, unsigned column, std::string message)
    : std::runtime_error(LoadErrorText(file, line, column, message)),
      fFile(std::move(file)),
      fLine(line),
      fColumn(column),
      fMessage(std::move(message)) {}

namespace {

const size_t kChunk = 1 << 20;  // bytes handed to expat at a time

// ---------------------------------------------------------------- sinks

// Adds what is read straight to a collection (one that is discarded if the
// load fails).
class TDirectSink : public TSink {
public:
    explicit TDirectSink(TMemoryNamespace& ns) : fNamespace(ns) {}
    void QualifierType(TQualifierTypeData&& data, std::int64_t) override { fNamespace.DeclareQualifierType(data); }
    void Class(TClassData&& data, std::int64_t) override { fNamespace.DeclareClass(data); }
    void Instance(const std::string& className, std::vector<TPropertyValue>&& properties, const TCIMReference* path,
                  std::int64_t) override {
        fNamespace.AddInstance(className, std::move(properties), path);
    }

private:
    TMemoryNamespace& fNamespace;
};

// Keeps what is read until the whole file has parsed, then adds it, so that
// a malformed file leaves an existing collection untouched.
class TStagingSink : public TSink {
public:
    void QualifierType(TQualifierTypeData&& data, std::int64_t offset) override {
        fOrder.push_back(TOp{'q', fQualifierTypes.size(), offset});
        fQualifierTypes.push_back(std::move(data));
    }
    void Class(TClassData&& data, std::int64_t offset) override {
        fOrder.push_back(TOp{'c', fClasses.size(), offset});
        fClasses.push_back(std::move(data));
    }
    void Instance(const std::string& className, std::vector<TPropertyValue>&& properties, const TCIMReference* path,
                  std::int64_t offset) override {
        fOrder.push_back(TOp{'i', fInstances.size(), offset});
        fInstances.push_back(TInstance{className, std::move(properties), path != nullptr,
                                       path ? *path : TCIMReference()});
    }

    // Adds everything in the order read. A failure is reported at the
    // offset of the object that caused it.
    void Apply(TMemoryNamespace& ns, const std::function<void(std::int64_t, const std::string&)>& fail) {
        for (const TOp& op : fOrder) {
            try {
                switch (op.fKind) {
                    case 'q':
                        ns.DeclareQualifierType(fQualifierTypes[op.fIndex]);
                        break;
                    case 'c':
                        ns.DeclareClass(fClasses[op.fIndex]);
                        break;
                    default: {
                        TInstance& instance = fInstances[op.fIndex];
                        ns.AddInstance(instance.fClassName, std::move(instance.fProperties),
                                       instance.fHasPath ? &instance.fPath : nullptr);
                        break;
                    }
                }
            } catch (const NORVTKR20::TTKRException& ex) {
                fail(op.fOffset, std::string("cannot add this object to the collection: ") + ex.what());
            }
        }
    }

private:
    struct TOp {
        char fKind;
        size_t fIndex;
        std::int64_t fOffset;
    };
    struct TInstance {
        std::string fClassName;
        std::vector<TPropertyValue> fProperties;
        bool fHasPath;
        TCIMReference fPath;
    };
    std::vector<TOp> fOrder;
    std::vector<TQualifierTypeData> fQualifierTypes;
    std::vector<TClassData> fClasses;
    std::vector<TInstance> fInstances;
};

// ---------------------------------------------------------------- positions

// Counts lines and columns the way expat does: a line ends at LF, CR or CRLF;
// a column is a character, so UTF-8 continuation bytes do not count.
class TPositionCounter {
public:
    void Feed(const char* data, size_t size) {
        for (size_t k = 0; k < size; ++k) {
            const unsigned char c = static_cast<unsigned char>(data[k]);
            if (c == '\n') {
                if (!fAfterCR) NewLine();
                fAfterCR = false;
                continue;
            }
            fAfterCR = c == '\r';
            if (fAfterCR) NewLine();
            else if ((c & 0xC0) != 0x80) ++fColumn;
        }
    }
    unsigned Line() const { return fLine; }
    unsigned Column() const { return fColumn + 1; }

private:
    void NewLine() {
        ++fLine;
        fColumn = 0;
    }
    unsigned fLine = 1;
    unsigned fColumn = 0;
    bool fAfterCR = false;
};

// Where the document comes from, so that a byte offset can be turned into a
// line and column after the fact (positions are only worked out for errors).
struct TSource {
    std::string fName;
    const std::string* fText = nullptr;  // an in-memory document, or
    std::string fPath;                   // a file read again on demand

    TPositionCounter PositionOf(std::int64_t offset) const {
        TPositionCounter counter;
        if (offset <= 0) return counter;
        const size_t want = static_cast<size_t>(offset);
        if (fText) {
            counter.Feed(fText->data(), std::min(want, fText->size()));
            return counter;
        }
        std::FILE* file = std::fopen(fPath.c_str(), "rb");
        if (!file) return counter;
        std::unique_ptr<char[]> buffer(new char[kChunk]);
        size_t done = 0;
        while (done < want) {
            const size_t n = std::fread(buffer.get(), 1, std::min(kChunk, want - done), file);
            if (n == 0) break;
            counter.Feed(buffer.get(), n);
            done += n;
        }
        std::fclose(file);
        return counter;
    }

    TLoadError ErrorAt(std::int64_t offset, const std::string& message) const {
        TPositionCounter at = PositionOf(offset);
        return TLoadError(fName, at.Line(), at.Column(), message);
    }

    TLoadError ErrorFor(const TParseFailure& failure) const {
        if (failure.fHavePosition) return TLoadError(fName, failure.fLine, failure.fColumn, failure.fMessage);
        return ErrorAt(failure.fOffset, failure.fMessage);
    }
};

// Parses one document from `source` into `sink`; throws TLoadError.
void Parse(const TSource& source, TSink& sink, const boost::shared_ptr<TMemoryNamespace>& ns,
           std::vector<std::string>& warnings) {
    TParser parser(sink, ns);
    if (source.fText) {
        parser.Feed(source.fText->data(), source.fText->size(), true);
    } else {
        std::FILE* file = std::fopen(source.fPath.c_str(), "rb");
        if (!file) throw TLoadError(source.fName, 0, 0, std::string("cannot open file: ") + std::strerror(errno));
        std::unique_ptr<std::FILE, int (*)(std::FILE*)> closer(file, &std::fclose);
        for (;;) {
            void* buffer = parser.GetBuffer(kChunk);
            const size_t n = std::fread(buffer, 1, kChunk, file);
            if (std::ferror(file))
                throw TLoadError(source.fName, 0, 0, std::string("cannot read file: ") + std::strerror(errno));
            const bool last = n == 0;
            if (!parser.ParseBuffer(n, last) || last) break;
        }
    }
    if (parser.Failure().fFailed) throw source.ErrorFor(parser.Failure());
    for (const auto& warning : parser.Warnings())
        warnings.push_back(ShownFileName(source.fName) + ":" + std::to_string(warning.first) + ": " +
                           PrintableText(warning.second));
}

TSource FileSource(const std::string& file) {
    TSource source;
    source.fName = file;
    source.fPath = file;
    return source;
}

TLoadResult LoadFromSources(const std::vector<TSource>& sources, const std::string& name) {
    TLoadResult result;
    result.fNamespace = TMemoryNamespace::Create();
    result.fNamespace->SetName(name);
    TDirectSink sink(*result.fNamespace);
    for (const TSource& source : sources) Parse(source, sink, result.fNamespace, result.fWarnings);
    try {
        result.fNamespace->Link();
    } catch (const NORVTKR20::TTKRException& ex) {
        throw TLoadError(sources.empty() ? name : sources.back().fName, 0, 0,
                         std::string("cannot link the collection: ") + ex.what());
    }
    return result;
}

}  // namespace

TLoadResult LoadCollection(const std::vector<std::string>& files) {
    std::vector<TSource> sources;
    std::string name;
    for (const std::string& file : files) {
        sources.push_back(FileSource(file));
        name += (name.empty() ? "" : ", ") + file;
    }
    return LoadFromSources(sources, name);
}

TLoadResult LoadCollectionFromString(const std::string& xml, const std::string& name) {
    TSource source;
    source.fName = name;
    source.fText = &xml;
    return LoadFromSources(std::vector<TSource>(1, source), name);
}

void LoadFileInto(TMemoryNamespace& ns, const std::string& file, std::vector<std::string>& warnings) {
    const TSource source = FileSource(file);
    TStagingSink staged;
    std::vector<std::string> found;
    Parse(source, staged, ns.Self(), found);
    staged.Apply(ns, [&](std::int64_t offset, const std::string& message) { throw source.ErrorAt(offset, message); });
    warnings.insert(warnings.end(), found.begin(), found.end());
}

}  // namespace repository
}  // namespace braigrion
