#include "RunContext.h"

#include <CLI/CLI.hpp>

#include <cerrno>
#include <cstring>

#include <memory>
#include <ostream>
#include <stdexcept>

#include "CollectionLoader.h"
#include "Progress.h"
#include "ReportDirectory.h"
#include "THtmlWriter.h"
#include "TTextWriter.h"
#include "braigrion/TReport.h"
#include "braigrion/TWriter.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {
namespace cli {

namespace {

// A documentation server is an absolute http or https address with a host.
const CLI::Validator WebAddress(
    [](std::string& value) -> std::string {
        for (const char* scheme : {"http://", "https://"}) {
            const std::string prefix(scheme);
            if (value.compare(0, prefix.size(), prefix) == 0 && value.size() > prefix.size() &&
                value[prefix.size()] != '/' && value.find_first_of(" \"'<>") == std::string::npos)
                return std::string();
        }
        return "not an absolute http:// or https:// address: " + value;
    },
    "URL");

}  // namespace

void AddRunOptions(CLI::App& command, TRunOptions& options) {
    command.add_option("--mode", options.fMode, "Generation mode: default, or luz for the service pages")
        ->check(CLI::IsMember({"default", "luz"}))
        ->capture_default_str();
    command.add_flag("--kmc", options.fKMC, "The machine has a KMC service processor (context key KMC=TRUE)");
    command.add_flag("--vcx", options.fVCX, "The collection is a VCX chassis inventory (context key VCX=TRUE)");
    command.add_option("--log", options.fLogFile, "Append the report's log to FILE")->type_name("FILE");
    command.add_option("--log-level", options.fLogLevel, "Log lines up to this level: 0 errors ... 3 trace")
        ->check(CLI::Range(0, 3))
        ->type_name("N");
    const TWriter::TLogLinkSettings defaults;
    command.add_option("--data-dir", options.fDataFolder, "Folder of the log pages' lookup files (default " +
                                                              defaults.fDataFolder + ", from the working directory)")
        ->check(CLI::ExistingDirectory)
        ->type_name("DIR");
    command.add_option("--doc-server", options.fDocServer,
                       "Documentation server of event and diagnostic links (default " + defaults.fDocServer + ")")
        ->check(WebAddress)
        ->type_name("URL");
    command.add_option("--help-server", options.fHelpServer,
                       "Internal help server of the one machine type it serves (default " + defaults.fHelpServer +
                           ")")
        ->check(WebAddress)
        ->type_name("URL");
}

void ApplyLogLinkOptions(const TRunOptions& options, TWriter& writer) {
    TWriter::TLogLinkSettings settings = writer.GetLogLinkSettings();
    if (!options.fDataFolder.empty()) settings.fDataFolder = options.fDataFolder;
    if (!options.fDocServer.empty()) settings.fDocServer = options.fDocServer;
    if (!options.fHelpServer.empty()) settings.fHelpServer = options.fHelpServer;
    writer.SetLogLinkSettings(settings);
}

TContextMap MakeContext(const TRunOptions& options) {
    TContextMap context;
    context["mode"] = NORVTKR20::TCIMValue(options.fMode);
    context["KMC"] = NORVTKR20::TCIMValue(std::string(options.fKMC ? "TRUE" : "FALSE"));
    if (options.fVCX) context["VCX"] = NORVTKR20::TCIMValue(std::string("TRUE"));
    return context;
}

void SetUpLog(const TRunOptions& options) {
    NORVTKR20::TCoreLogger& log = NORVTKR20::TRootObject::GetDefaultLogger();
    if (!options.fLogFile.empty()) {
        errno = 0;
        if (!log.SetLogFile(options.fLogFile)) {
            const int error = errno;
            throw TInputError(repository::ShownFileName(options.fLogFile) + ": cannot open the log file" +
                              (error ? std::string(": ") + std::strerror(error) : std::string()));
        }
        log.SetLevel(options.fLogLevel < 0 ? 0 : options.fLogLevel);
    } else {
        log.SetLogToStderr();
        log.SetLevel(options.fLogLevel);
    }
}

namespace {

// The run's last line: the pages the index lists, those of them without
// data, and the page ids that this version cannot write yet.
std::string ReportSummary(const backends::TBackendWriter& writer) {
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

void WriteReport(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const TContextMap& context, const TRunOptions& run,
                 const std::string& format, bool showProgress, TReportDirectory& directory, std::ostream& out,
                 std::ostream& err) {
    std::unique_ptr<backends::TBackendWriter> writer;
    if (format == "text") {
        writer.reset(new backends::TTextWriter());
    } else {
        writer.reset(new backends::THtmlWriter());
    }
    ApplyLogLinkOptions(run, *writer);
    TReport report(ns, context, directory.WorkPath());
    {
        TProgressLine progress(err, showProgress);
        report.SetPageObserver([&progress](size_t number, size_t total, const std::string& page) {
            progress.Page(number, total, page);
        });
        report.Write(writer.get(), context);
    }
    if (!writer->GetFailure().empty()) throw std::runtime_error(writer->GetFailure());

    directory.Commit(format);
    err << ReportSummary(*writer) << '\n';
    out << directory.TargetPath() << "/" << (format == "text" ? "index.txt" : "index.html") << '\n';
}

}  // namespace cli
}  // namespace braigrion
