// Expected transcripts kept as files under tests/fixtures/pages/. Run a test
// with BRAIGRION_UPDATE_PAGES=1 to write the files from what was written
// instead (then read every changed file before keeping it).
#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

namespace braigrion {
namespace testing {

inline std::string ExpectedPage(const std::string& relativePath, const std::string& actual) {
    const std::filesystem::path path =
        std::filesystem::path(BRAIGRION_SOURCE_DIR) / "tests/fixtures/pages" / relativePath;
    const char* update = std::getenv("BRAIGRION_UPDATE_PAGES");
    if (update != nullptr && std::string(update) == "1") {
        std::filesystem::create_directories(path.parent_path());
        std::ofstream(path, std::ios::binary) << actual;
    }
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return in ? text.str() : "(no expected file " + path.string() + ")";
}

}  // namespace testing
}  // namespace braigrion
