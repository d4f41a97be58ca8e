// What the report, compare and page commands share: the context map a report
// is written under, the options that set it, the log, and the writing of a
// report into its directory.
#pragma once

#include <iosfwd>
#include <map>
#include <string>

#include <boost/shared_ptr.hpp>

#include "Commands.h"
#include "tkrcore/TCIMValue.h"

namespace CLI {
class App;
}

namespace NORVTKR20 {
class ICIMNamespace;
}

namespace braigrion {
class TWriter;
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

class TReportDirectory;

// Writes the report of `ns` (a collection, or a view of several with their
// delta records) through the back-end of `format` into the directory's work
// path, with progress on `err` when `showProgress`, and puts it in place.
// Then prints the run's last line to `err` (pages written, those without
// data, page ids not available in this version) and the index's path to
// `out`. A back-end's failure to write is thrown.
void WriteReport(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const TContextMap& context, const TRunOptions& run,
                 const std::string& format, bool showProgress, TReportDirectory& directory, std::ostream& out,
                 std::ostream& err);

}  // namespace cli
}  // namespace braigrion
