#include "RunContext.h"

#include <CLI/CLI.hpp>

#include <cerrno>
#include <cstring>

#include "CollectionLoader.h"
#include "tkrcore/TRootObject.h"

namespace braigrion {
namespace cli {

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

}  // namespace cli
}  // namespace braigrion
