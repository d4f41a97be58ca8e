// Saves a collection as a CIM-XML declaration document that the reader
// loads back to the same classes, qualifiers, instances and references.
#pragma once

#include <ostream>
#include <string>

#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

enum class EWriteForm {
    // DECLGROUP.WITHNAME: qualifier declarations, then VALUE.NAMEDOBJECT for
    // each class and for each instance (INSTANCENAME + INSTANCE).
    kWithName,
    // A DECLGROUP with the qualifier declarations, then DECLGROUP.WITHPATH:
    // VALUE.OBJECTWITHLOCALPATH for each class (LOCALCLASSPATH + CLASS) and
    // each instance (LOCALINSTANCEPATH + INSTANCE).
    kWithPath
};

// Writes the collection: declared classes only (superclasses first, each as
// it was declared), then every live instance with its key bindings.
//
// Text is written as UTF-8. Characters that XML 1.0 cannot carry (control
// characters other than tab, line feed and carriage return, U+FFFE, U+FFFF,
// and bytes that are not UTF-8) are written as U+FFFD REPLACEMENT CHARACTER.
// A carriage return is written as a character reference, and so is a line
// feed in the white space at either end of a value (the reader drops literal
// line breaks there as layout), so that reading back gives the same text.
void WriteCollection(const TMemoryNamespace& ns, std::ostream& out, EWriteForm form = EWriteForm::kWithName);

// Writes to a temporary file beside `path` and renames it into place; throws
// std::runtime_error naming the path on failure.
void WriteCollectionFile(const TMemoryNamespace& ns, const std::string& path, EWriteForm form = EWriteForm::kWithName);

}  // namespace repository
}  // namespace braigrion
