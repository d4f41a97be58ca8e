// Loads collections from CIM-XML files: declaration documents and captured
// operation responses, into the in-memory repository.
#pragma once

#include <stdexcept>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

// A file that cannot be loaded. what() is "FILE:LINE:COLUMN: MESSAGE", or
// "FILE: MESSAGE" when the failure has no position in the file (line 0);
// line and column count from 1, a column in characters. what() is always one
// line: the file name and message are shown as PrintableText/ShownFileName
// make them; File() and Message() keep them as they were.
class TLoadError : public std::runtime_error {
public:
    TLoadError(std::string file, unsigned line, unsigned column, std::string message);

    const std::string& File() const { return fFile; }
    unsigned Line() const { return fLine; }
    unsigned Column() const { return fColumn; }
    const std::string& Message() const { return fMessage; }

private:
    std::string fFile;
    unsigned fLine;
    unsigned fColumn;
    std::string fMessage;
};

// The text with every control character written as an escape (\n, \t,
// \x1b...), so that a message made of collected values stays one line.
std::string PrintableText(const std::string& text);
// A file name for a message: as it is, or quoted and escaped when it holds a
// control character or a '"', or is empty.
std::string ShownFileName(const std::string& name);

struct TLoadResult {
    boost::shared_ptr<TMemoryNamespace> fNamespace;
    // Things worth telling that did not stop the load, each "FILE:LINE: text"
    // (a server's ERROR response, for one).
    std::vector<std::string> fWarnings;
};

// Loads all files into one new collection, then Link()s it. Throws TLoadError
// for the first file that fails; nothing half-loaded escapes.
TLoadResult LoadCollection(const std::vector<std::string>& files);

// Same from an in-memory document (tests and inline fixtures); `name` stands
// for the file in messages.
TLoadResult LoadCollectionFromString(const std::string& xml, const std::string& name = "<string>");

// Adds one file to an existing collection (no Link()); warnings are appended.
// The file is read completely before anything is added, so a malformed file
// leaves the collection as it was. (Should the collection itself refuse an
// object of a well-formed file, the objects before it stay added.)
void LoadFileInto(TMemoryNamespace& ns, const std::string& file, std::vector<std::string>& warnings);

}  // namespace repository
}  // namespace braigrion
