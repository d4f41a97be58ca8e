// Writes the back-end tests' fixture report as an HTML report directory, for
// the browser tests:  write_fixture_report DIR
#include <filesystem>
#include <iostream>

#include "THtmlWriter.h"
#include "backends/FixtureReport.h"

int main(int argc, char** argv) {
    if (argc != 2) {
        std::cerr << "usage: write_fixture_report DIR\n";
        return 2;
    }
    std::filesystem::remove_all(argv[1]);
    std::filesystem::create_directories(argv[1]);
    braigrion::backends::THtmlWriter writer;
    braigrion::testing::WriteFixtureReport(writer, argv[1]);
    if (!writer.GetFailure().empty()) {
        std::cerr << "write_fixture_report: " << writer.GetFailure() << '\n';
        return 1;
    }
    return 0;
}
