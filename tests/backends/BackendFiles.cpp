#include "backends/BackendFiles.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <vector>

#include <gtest/gtest.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace braigrion {
namespace testing {

TScratchDir::TScratchDir() {
    std::string pattern = ::testing::TempDir() + "braigrion-backend-XXXXXX";
    std::vector<char> buffer(pattern.begin(), pattern.end());
    buffer.push_back('\0');
    if (::mkdtemp(buffer.data()) == nullptr) throw std::runtime_error("mkdtemp failed");
    fPath = buffer.data();
}

TScratchDir::~TScratchDir() {
    std::error_code ignored;
    fs::remove_all(fPath, ignored);
}

std::string ReadWholeFile(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

std::set<std::string> FilesUnder(const std::string& dir) {
    std::set<std::string> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(dir)) {
        if (entry.is_regular_file()) files.insert(fs::relative(entry.path(), dir).string());
    }
    return files;
}

std::string ExpectedText(const std::string& relativePath, const std::string& actual) {
    fs::path path = fs::path(BRAIGRION_SOURCE_DIR) / "tests/fixtures/backends" / relativePath;
    const char* update = std::getenv("BRAIGRION_UPDATE_EXPECTED");
    if (update && std::string(update) == "1") {
        fs::create_directories(path.parent_path());
        std::ofstream(path, std::ios::binary) << actual;
    }
    return ReadWholeFile(path.string());
}

}  // namespace testing
}  // namespace braigrion
