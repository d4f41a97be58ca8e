// The braigrion command: turns a collection of CIM-XML files into a report.
#include <CLI/CLI.hpp>

#include <exception>
#include <iostream>

#include <unistd.h>

#include "CollectionLoader.h"
#include "Commands.h"

namespace {

const char kVersion[] = "braigrion 0.1.0";

}  // namespace

int main(int argc, char** argv) {
    CLI::App app{"braigrion: reports on a server's collected diagnostic and inventory data"};
    app.set_version_flag("--version", kVersion);
    app.require_subcommand(1);

    braigrion::cli::TInfoOptions info;
    braigrion::cli::TReportOptions report;
    braigrion::cli::TPageOptions page;
    CLI::App* infoCmd = braigrion::cli::AddInfoCommand(app, info);
    CLI::App* reportCmd = braigrion::cli::AddReportCommand(app, report);
    CLI::App* pageCmd = braigrion::cli::AddPageCommand(app, page);
    braigrion::cli::TCompareOptions compare;
    CLI::App* compareCmd = braigrion::cli::AddCompareCommand(app, compare);

    // CLI11 would call an unknown word a missing subcommand; name it instead.
    if (argc > 1 && argv[1][0] != '-' && app.get_subcommands([&](CLI::App* sub) { return sub->get_name() == argv[1]; }).empty()) {
        std::cerr << "braigrion: unknown command '" << braigrion::repository::PrintableText(argv[1])
                  << "' (see braigrion --help)\n";
        return 2;
    }
    try {
        app.parse(argc, argv);
    } catch (const CLI::CallForHelp& e) {
        return app.exit(e);
    } catch (const CLI::CallForAllHelp& e) {
        return app.exit(e);
    } catch (const CLI::CallForVersion& e) {
        return app.exit(e);
    } catch (const CLI::ParseError& e) {
        std::cerr << "braigrion: " << braigrion::repository::PrintableText(e.what()) << " (see braigrion --help)\n";
        return 2;
    }

    try {
        if (*infoCmd) return braigrion::cli::RunInfo(info, std::cout, std::cerr);
        if (*reportCmd) return braigrion::cli::RunReport(report, std::cout, std::cerr, isatty(STDERR_FILENO) != 0);
        if (*pageCmd) return braigrion::cli::RunPage(page, std::cout, std::cerr);
        if (*compareCmd) {
            return braigrion::cli::RunCompare(compare, std::cout, std::cerr, isatty(STDERR_FILENO) != 0);
        }
    } catch (const braigrion::cli::TInputError& e) {
        // One line, whatever names and values the message carries.
        std::cerr << "braigrion: " << braigrion::repository::PrintableText(e.what()) << '\n';
        return 2;
    } catch (const std::exception& e) {
        std::cerr << "braigrion: " << braigrion::repository::PrintableText(e.what()) << '\n';
        return 1;
    }
    return 1;
}
