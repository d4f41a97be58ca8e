// The subcommands of the braigrion command.
#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace braigrion {
namespace cli {

struct TInfoOptions {
    std::vector<std::string> fFiles;
};

// Prints what a collection holds: its data source facts and its classes with
// their instance counts. Returns the exit status.
int RunInfo(const TInfoOptions& options, std::ostream& out, std::ostream& err);

}  // namespace cli
}  // namespace braigrion
