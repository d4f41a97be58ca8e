// File helpers of the back-end tests: a scratch directory, reading files,
// listing a tree, and comparing a rendered file with its expected file under
// tests/fixtures/backends/ (BRAIGRION_UPDATE_EXPECTED=1 rewrites the expected
// files from what was rendered, for review).
#pragma once

#include <set>
#include <string>

namespace braigrion {
namespace testing {

class TScratchDir {
public:
    TScratchDir();
    ~TScratchDir();
    const std::string& Path() const { return fPath; }

private:
    std::string fPath;
};

std::string ReadWholeFile(const std::string& path);
// Every file under `dir`, as paths relative to it.
std::set<std::string> FilesUnder(const std::string& dir);
// The expected file's text, or (when updating) writes `actual` there first.
std::string ExpectedText(const std::string& relativePath, const std::string& actual);

}  // namespace testing
}  // namespace braigrion
