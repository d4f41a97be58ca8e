// What the chassis event log and the diagnostic log share: the lookup
// files that list the machine types the documentation covers, and the forms
// of a documentation link. Internal to the log sections.
#pragma once

#include <string>

namespace braigrion {
namespace loglinks {

// The lookup file of the chassis event log and the one of the diagnostics.
const char kEventsFile[] = "kmcEventsAtInfoC.txt";
const char kDiagnosticsFile[] = "tkrEventsAtInfoC.txt";

// The machine type whose events live on the internal help server.
const char kHelpServerMachineType[] = "7903";

// Whether `machineType` is one of the four-character entries of the lookup
// file `folder`/`file`. A file that cannot be opened logs `failureText` and
// answers false; a hit logs "Info Center link will be enabled".
bool IsMachineTypeListed(const std::string& folder, const std::string& file, const std::string& machineType,
                         const std::string& failureText);

// The page of an event code: on the internal help server for its one
// machine type, on the public documentation server for all others.
std::string EventLink(const std::string& docServer, const std::string& helpServer, const std::string& machineType,
                      const std::string& code);

// The page of a diagnostic code, always on the public server.
std::string DiagnosticLink(const std::string& docServer, const std::string& machineType, const std::string& code);

}  // namespace loglinks
}  // namespace braigrion
