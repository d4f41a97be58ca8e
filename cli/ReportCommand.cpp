// braigrion report: the whole report of a collection, as HTML or text.
#include <CLI/CLI.hpp>

#include <ostream>
#include <stdexcept>
#include <string>

#include "CollectionLoader.h"
#include "Commands.h"
#include "Progress.h"
#include "ReportDirectory.h"
#include "RunContext.h"
#include "THtmlWriter_vmwesxi.h"
#include "TReport_vmwesxi.h"
#include "TTextWriter_vmwesxi.h"

namespace braigrion {
namespace cli {

CLI::App* AddReportCommand(CLI::App& app, TReportOptions& options) {
    CLI::App* command = app.add_subcommand("report", "Write the report of a collection into a directory");
    command->add_option("collection", options.fFiles,
                        "CIM-XML files that together form one collection; with --records, one argument per "
                        "collection (a directory or FILE[:FILE...])")
        ->required()
        ->type_name("FILE");
    command->add_option("-o,--output", options.fOutput, "Directory of the report (replaced when it holds one)")
        ->required()
        ->type_name("DIR");
    command->add_option("--format", options.fFormat, "Output format")
        ->check(CLI::IsMember({"html", "text"}))
        ->capture_default_str();
    command->add_option("--stack", options.fStack,
                        "Report for a base collection or an ESXi host; auto tells them apart by their classes")
        ->check(CLI::IsMember({"auto", "base", "esxi"}))
        ->capture_default_str();
    command->add_option("--records", options.fRecords,
                        "Delta records (as compare --save-records writes them): the delta report of the collections")
        ->type_name("FILE");
    command->add_flag("--force", options.fForce, "Write into DIR even when it is not an earlier report, among its files; nothing the report did not write is replaced");
    command->add_flag("-q,--quiet", options.fQuiet, "No progress on standard error");
    AddRunOptions(*command, options.fRun);
    command->footer(
        "The report is written beside DIR and moved into place when complete; an earlier report in DIR\n"
        "stays until then. The path of the report's index is printed on standard output.\n"
        "With --records FILE, each argument is a collection and the first is the baseline: the delta report\n"
        "of those collections from the records in FILE, the same report compare writes.\n"
        "Environment: TKR_BIOSPROVIDER=yes (in any case) adds the \"BIOS Settings\" page, for collections\n"
        "whose BIOS attribute collector was switched on.");
    return command;
}

namespace {

// The report of an ESXi host, written into `workPath`. A failure to write
// output is thrown, as for a base report.
template <class TBackend>
void WriteESXiReport(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const TContextMap& context,
                     const std::string& workPath) {
    TBackend writer;
    TReport_vmwesxi report(ns, context, workPath);
    report.Write(&writer, context);
    if (!writer.GetFailure().empty()) throw std::runtime_error(writer.GetFailure());
    if (!writer.IsEnded()) throw std::runtime_error("the ESXi report stopped before its last page (see --log)");
}

void RunESXiReport(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const TContextMap& context,
                   const std::string& format, const std::string& workPath) {
    if (format == "text") {
        WriteESXiReport<backends::TTextWriter_vmwesxi>(ns, context, workPath);
    } else {
        WriteESXiReport<backends::THtmlWriter_vmwesxi>(ns, context, workPath);
    }
}

}  // namespace

int RunReport(const TReportOptions& options, std::ostream& out, std::ostream& err, bool progressToErr) {
    // Everything the user gave is checked before anything is written.
    if (!options.fRecords.empty()) {
        // Collections plus their records are what compare writes from.
        if (options.fStack == "esxi") throw TInputError("--records makes a delta report, which has no ESXi form");
        TCompareOptions delta;
        delta.fCollections = options.fFiles;
        delta.fRecords = options.fRecords;
        delta.fOutput = options.fOutput;
        delta.fFormat = options.fFormat;
        delta.fForce = options.fForce;
        delta.fQuiet = options.fQuiet;
        delta.fRun = options.fRun;
        return RunCompare(delta, out, err, progressToErr);
    }
    SetUpLog(options.fRun);
    TProgressLine progress(err, progressToErr && !options.fQuiet);
    progress.Step("loading " + std::to_string(options.fFiles.size()) +
                  (options.fFiles.size() == 1 ? " file" : " files"));
    repository::TLoadResult loaded = LoadFiles(options.fFiles);
    progress.Finish();
    for (const std::string& warning : loaded.fWarnings) err << "braigrion: warning: " << warning << '\n';
    TReportDirectory directory(options.fOutput, options.fForce);

    TContextMap context = MakeContext(options.fRun);
    const std::string index = options.fFormat == "text" ? "index.txt" : "index.html";
    const bool esxi = options.fStack == "esxi" ||
                      (options.fStack == "auto" && TReport_vmwesxi::IsESXiCollection(loaded.fNamespace));
    if (esxi) {
        RunESXiReport(loaded.fNamespace, context, options.fFormat, directory.WorkPath());
        directory.Commit(options.fFormat);
        out << directory.TargetPath() << "/" << index << '\n';
        return 0;
    }

    WriteReport(loaded.fNamespace, context, options.fRun, options.fFormat, progressToErr && !options.fQuiet, directory,
                out, err);
    return 0;
}

}  // namespace cli
}  // namespace braigrion
