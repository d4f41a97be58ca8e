// The subcommands of the braigrion command. Each has its options, a function
// that adds it to the command line, and a function that runs it and returns
// the exit status: 0 on success, 2 for a usage or input error, 1 for any
// other failure (errors are thrown; main turns them into one line).
#pragma once

#include <iosfwd>
#include <string>
#include <vector>

namespace CLI {
class App;
}

namespace braigrion {
namespace cli {

// What a report or a page is written under: the context keys and the log.
struct TRunOptions {
    std::string fMode = "default";  // "default" or "luz"
    bool fKMC = false;
    bool fVCX = false;
    std::string fLogFile;  // "" logs nowhere unless a level is given
    int fLogLevel = -1;    // -1: 0 with a log file, no log without one
    // The log pages' lookup files and documentation servers; "" keeps the
    // writer's default.
    std::string fDataFolder;
    std::string fDocServer;
    std::string fHelpServer;
};

struct TInfoOptions {
    std::vector<std::string> fFiles;
};

struct TReportOptions {
    // The files of one collection; with fRecords, one collection argument
    // each (a directory or FILE[:FILE...]), as compare takes them.
    std::vector<std::string> fFiles;
    std::string fRecords;  // delta records: makes the report a delta report
    std::string fOutput;
    std::string fFormat = "html";  // "html" or "text"
    std::string fStack = "auto";   // "auto", "base" or "esxi": which report the collection gets
    bool fForce = false;           // replace a directory that is not a report
    bool fQuiet = false;           // no progress
    TRunOptions fRun;
};

struct TPageOptions {
    std::string fPageID;
    std::vector<std::string> fFiles;
    TRunOptions fRun;
};

// Two or more collections compared: the first is the baseline.
struct TCompareOptions {
    std::vector<std::string> fCollections;  // each a directory or FILE[:FILE...]
    std::string fOutput;
    std::string fFormat = "html";
    std::string fRecords;      // read the delta records from this file
    std::string fSaveRecords;  // save the computed records to this file
    bool fForce = false;
    bool fQuiet = false;
    TRunOptions fRun;
};

CLI::App* AddInfoCommand(CLI::App& app, TInfoOptions& options);
CLI::App* AddReportCommand(CLI::App& app, TReportOptions& options);
CLI::App* AddPageCommand(CLI::App& app, TPageOptions& options);
CLI::App* AddCompareCommand(CLI::App& app, TCompareOptions& options);

// Prints what a collection holds: its data source facts, its operating
// system and its classes with their instance counts.
int RunInfo(const TInfoOptions& options, std::ostream& out, std::ostream& err);
// Writes the report of a collection into a directory and prints the path of
// its index; with delta records, the delta report of the collections.
// Progress goes to `err` when `progressToErr`; a one-line summary (pages
// written, pages without data, page ids not available in this version) goes
// to `err` in any case.
int RunReport(const TReportOptions& options, std::ostream& out, std::ostream& err, bool progressToErr);
// Writes the delta report of several collections into a directory and
// prints the path of its index.
int RunCompare(const TCompareOptions& options, std::ostream& out, std::ostream& err, bool progressToErr);
// The files of one collection argument of compare: a directory's .xml
// files sorted by name, or the files of FILE[:FILE...].
std::vector<std::string> CollectionFiles(const std::string& argument);
// Prints one page through the inventory back-end.
int RunPage(const TPageOptions& options, std::ostream& out, std::ostream& err);

}  // namespace cli
}  // namespace braigrion
