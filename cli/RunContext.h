// What the report and page commands share: the context map a report is
// written under, the options that set it, and the log.
#pragma once

#include <map>
#include <string>

#include "Commands.h"
#include "tkrcore/TCIMValue.h"

namespace CLI {
class App;
}

namespace braigrion {
class TWriter;
namespace backends {
class TBackendWriter;
}
}

namespace braigrion {
namespace cli {

typedef std::map<std::string, NORVTKR20::TCIMValue> TContextMap;

// Adds --mode, --kmc, --vcx, --log and --log-level.
void AddRunOptions(CLI::App& command, TRunOptions& options);

// "mode" is "luz" or "default"; "KMC" is "TRUE" or "FALSE"; "VCX" stands
// only when --vcx is given ("TRUE"), because the report lets "VCX" overrule
// "KMC" whenever both are present.
TContextMap MakeContext(const TRunOptions& options);

// Gives the writer the data folder and documentation servers of the log
// pages that the options name; the others keep their defaults.
void ApplyLogLinkOptions(const TRunOptions& options, TWriter& writer);

// Points the core log at the file of --log, at the level of --log-level;
// without a file, a level sends the log to standard error, and without
// either the log is off. Throws TInputError when the file cannot be opened.
void SetUpLog(const TRunOptions& options);

// The run's last line: the pages the index lists, those of them without
// data, and the page ids that this version cannot write yet.
std::string ReportSummary(const backends::TBackendWriter& writer);

}  // namespace cli
}  // namespace braigrion
