// Loading the collection files named on the command line, with one clear
// error line when they cannot be read.
#pragma once

#include <stdexcept>
#include <string>
#include <vector>

#include "repository/CIMXMLReader.h"

namespace braigrion {
namespace cli {

// An error in what the user gave us: a missing file, malformed input, a bad
// option value. The command exits with status 2.
class TInputError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

// Loads every file into one collection; warnings go to `warnings`. Throws
// TInputError naming the file (and line and column for malformed XML).
repository::TLoadResult LoadFiles(const std::vector<std::string>& files);

}  // namespace cli
}  // namespace braigrion
