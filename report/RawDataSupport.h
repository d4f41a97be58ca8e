// What the raw-data pages share: fetching a class's instances, the page
// frame and the two-column table of commands, the cells of a row, the result
// files beside the report and the names they are written under. Internal to
// the report library.
//
// A raw-data page lists the commands a collector issued to an external tool;
// each row links to a text file, written beside the page, that holds what
// the tool printed.
#pragma once

#include <fstream>
#include <set>
#include <string>
#include <vector>

#include "braigrion/TTable.h"
#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"

namespace braigrion {
namespace rawdata {

typedef std::vector<TWriter::TInstancePtr> TInstances;


// The statuses of a result file that cannot be opened for writing: access
// denied, and any other failure.
const int kResultFileDenied = 27;
const int kResultFileFailed = 11;

// Table title of most raw-data tables.
extern const char kCommandsIssued[];
// Cell mark-up around a command and around the link to its result file.
extern const char kCommandOpen[];
extern const char kCommandClose[];
extern const char kResultLinkOpen[];
extern const char kResultLinkClose[];

// The instances of `className` and its subclasses, in repository order.
// Throws what the repository throws (a missing class among them).
TInstances InstancesOf(const TWriter::TNamespacePtr& ns, const std::string& className);

// The instances a raw-data page lists. A class that cannot be read gives
// none; that, and an empty result, are traced under the page's `function`.
TInstances RawDataInstances(const TWriter::TNamespacePtr& ns, const std::string& function,
                            const std::string& className);

// Opens a raw-data page: the page file `link` under `outputPath`, its head,
// and the title with the switch back to the standard page `standardLink`.
void OpenRawPage(TWriter& writer, const std::string& outputPath, const std::string& link, const std::string& title,
                 const std::string& standardLink);

// The grid of one table of commands: a heading row and one row per
// instance, two columns of 80% and 20%, the table 75% wide.
TTable CommandsTable(size_t instances, const std::string& commandHeading, const std::string& resultHeading);

// "prefix" + index + ".txt".
std::string NumberedFileName(const std::string& prefix, int index);

// Whether `name` is a safe name for a file of its own in the report's
// directory: not empty, no "/" and no NUL byte, neither "." nor "..", at
// most 255 bytes (what a file system holds in one name), and not of a kind
// the report writes itself (".html", ".htm", ".css", ".js", in any case), so
// that a result never takes the place of a page. Any other byte is allowed:
// the name is percent-encoded in the link (ResultLinkCell) and escaped
// wherever it is shown.
bool IsSafeFileName(const std::string& name);

// The file name under which a result named by collected text is written:
// the text itself when IsSafeFileName holds and no earlier result of the
// page took that name (`used`), else `fallback`. The name chosen is added
// to `used`, so two results never share a file.
std::string ResultFileName(const std::string& name, const std::string& fallback, std::set<std::string>& used);

// A result file opened for writing, truncating an earlier one. The
// constructor throws TTKRException with kResultFileDenied when access to
// the path is denied and kResultFileFailed for any other failure.
class TResultFile {
public:
    explicit TResultFile(const std::string& path);
    // Writes the text and a line feed, and flushes.
    void WriteLine(const std::string& text);
    void Close() { fFile.close(); }

private:
    std::ofstream fFile;
};

// The lines of a result value: each element of an array, or the one text of
// a scalar. A null value gives no line.
std::vector<std::string> ResultLines(const NORVTKR20::TCIMValue& value);

// The value of an instance's property; throws what the repository throws.
const NORVTKR20::TCIMValue& ValueOf(const TWriter::TInstancePtr& instance, const std::string& property);

// How one table of a raw-data page reads its instances.
struct TCommandTable {
    std::string commandHeading;
    std::string resultHeading;
    std::string filePrefix;       // results are named prefix + index + ".txt"
    std::string commandProperty;  // read as text; a failure escapes
    std::string resultProperty;   // written line by line; a failure escapes
};

// Fills the table of these instances and writes their result files, in the
// common order: for each instance the file name, the command in column 0,
// the link in column 1, then the file. A file that cannot be opened ends the
// table with the exception of TResultFile; so does a property that cannot
// be read. The grid is not handed to the writer.
TTable FillCommandsTable(TWriter& writer, const std::string& outputPath, const TInstances& instances,
                         const TCommandTable& layout);

// Cell texts of one row: the command made safe by the writer, and the
// relative link to the result file, its name percent-encoded (every byte
// but ASCII letters, digits and "-._~"), so that any safe file name links
// to itself and nothing in it reads as mark-up, a scheme or a query.
std::string CommandCell(TWriter& writer, const std::string& command, const std::string& opening = kCommandOpen);
std::string ResultLinkCell(const std::string& fileName, const std::string& opening = kResultLinkOpen);

}  // namespace rawdata
}  // namespace braigrion
