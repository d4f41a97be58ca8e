// braigrion report: the whole report of a collection, as HTML or text.
#include <CLI/CLI.hpp>

#include <memory>
#include <ostream>
#include <stdexcept>
#include <string>

#include "CollectionLoader.h"
#include "Commands.h"
#include "Progress.h"
#include "ReportDirectory.h"
#include "RunContext.h"
#include "THtmlWriter.h"
#include "TTextWriter.h"
#include "braigrion/TReport.h"

namespace braigrion {
namespace cli {

namespace {

// The run's last line: the pages the index lists, those of them without
// data, and the page ids that this version cannot write yet.
std::string Summary(const backends::TBackendWriter& writer) {
    size_t written = 0;
    size_t withoutData = 0;
    for (const backends::TBackendWriter::TCategory& category : writer.GetIndex()) {
        for (const backends::TBackendWriter::TIndexEntry& entry : category.fEntries) {
            ++written;
            withoutData += entry.fHasData ? 0 : 1;
        }
    }
    std::string missing;
    for (const std::string& page : writer.GetUnavailablePages()) missing += (missing.empty() ? "" : " ") + page;
    return "braigrion: " + std::to_string(written) + " pages written, " + std::to_string(withoutData) +
           " without data; not available in this version: " + (missing.empty() ? "none" : missing);
}

}  // namespace

CLI::App* AddReportCommand(CLI::App& app, TReportOptions& options) {
    CLI::App* command = app.add_subcommand("report", "Write the report of a collection into a directory");
    command->add_option("collection", options.fFiles, "CIM-XML files that together form one collection")
        ->required()
        ->type_name("FILE");
    command->add_option("-o,--output", options.fOutput, "Directory of the report (replaced when it holds one)")
        ->required()
        ->type_name("DIR");
    command->add_option("--format", options.fFormat, "Output format")
        ->check(CLI::IsMember({"html", "text"}))
        ->capture_default_str();
    command->add_flag("--force", options.fForce, "Replace DIR even when it is not an earlier report");
    command->add_flag("-q,--quiet", options.fQuiet, "No progress on standard error");
    AddRunOptions(*command, options.fRun);
    command->footer(
        "The report is written beside DIR and moved into place when complete; an earlier report in DIR\n"
        "stays until then. The path of the report's index is printed on standard output.\n"
        "Environment: TKR_BIOSPROVIDER=yes (in any case) adds the \"BIOS Settings\" page, for collections\n"
        "whose BIOS attribute collector was switched on.");
    return command;
}

int RunReport(const TReportOptions& options, std::ostream& out, std::ostream& err, bool progressToErr) {
    // Everything the user gave is checked before anything is written.
    SetUpLog(options.fRun);
    repository::TLoadResult loaded = LoadFiles(options.fFiles);
    for (const std::string& warning : loaded.fWarnings) err << "braigrion: warning: " << warning << '\n';
    TReportDirectory directory(options.fOutput, options.fForce);

    std::unique_ptr<backends::TBackendWriter> writer;
    std::string index;
    if (options.fFormat == "text") {
        writer.reset(new backends::TTextWriter());
        index = "index.txt";
    } else {
        writer.reset(new backends::THtmlWriter());
        index = "index.html";
    }

    ApplyLogLinkOptions(options.fRun, *writer);
    TContextMap context = MakeContext(options.fRun);
    TReport report(loaded.fNamespace, context, directory.WorkPath());
    {
        TProgressLine progress(err, progressToErr && !options.fQuiet);
        report.SetPageObserver([&progress](size_t number, size_t total, const std::string& page) {
            progress.Page(number, total, page);
        });
        report.Write(writer.get(), context);
    }
    if (!writer->GetFailure().empty()) throw std::runtime_error(writer->GetFailure());

    directory.Commit(options.fFormat);
    err << Summary(*writer) << '\n';
    out << directory.TargetPath() << "/" << index << '\n';
    return 0;
}

}  // namespace cli
}  // namespace braigrion
