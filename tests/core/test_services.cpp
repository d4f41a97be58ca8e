// Exceptions, the root object's logger, file checks.
#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

#include "tkrcore/tkrcore.h"

using namespace NORVTKR20;

TEST(TKRException, WhatGivesATextForEveryStatus) {
    for (int status : {int(kNotFound), int(kSectionPrecondition), int(kSectionBadData), 12345, -1}) {
        TTKRException ex(status);
        ASSERT_NE(nullptr, ex.what());
        EXPECT_STRNE("", ex.what()) << status;
        EXPECT_EQ(ex.what(), ex.fStatusCode.TranslateStatusCode());
    }
    EXPECT_STRNE(TTKRException(kNotFound).what(), TTKRException(999).what());
}

namespace {

struct TCapture : TLogger {
    std::vector<std::pair<int, std::string>> lines;
    void Log(int level, const std::string& message) override { lines.emplace_back(level, message); }
};

}  // namespace

TEST(RootObject, LoggerCanBeReplacedAndRestored) {
    TLogger* original = TRootObject::GetCoreLogger();
    ASSERT_NE(nullptr, original);
    TCapture capture;
    TRootObject::SetCoreLogger(&capture);
    TRootObject::GetCoreLogger()->Log(3, "TReport::Write -- Entering");
    TRootObject::SetCoreLogger(nullptr);
    EXPECT_EQ(original, TRootObject::GetCoreLogger());
    ASSERT_EQ(1u, capture.lines.size());
    EXPECT_EQ(3, capture.lines[0].first);
}

TEST(RootObject, DefaultLoggerFiltersByLevelIntoAFile) {
    std::string path = ::testing::TempDir() + "braigrion_log_test.txt";
    std::remove(path.c_str());
    TCoreLogger logger;
    ASSERT_TRUE(logger.SetLogFile(path));
    logger.SetLevel(1);
    logger.Log(0, "an error");
    logger.Log(1, "a warning");
    logger.Log(0, "a value\nthat breaks\x1b the line");
    logger.Log(3, "a trace line");
    logger.SetLogToStderr();
    std::ifstream in(path);
    std::stringstream text;
    text << in.rdbuf();
    EXPECT_NE(std::string::npos, text.str().find("an error"));
    EXPECT_NE(std::string::npos, text.str().find("a warning"));
    EXPECT_EQ(std::string::npos, text.str().find("a trace line"));
    EXPECT_NE(std::string::npos, text.str().find("[0] a value\\nthat breaks\\x1b the line\n")) << "one line a message";
    EXPECT_FALSE(logger.SetLogFile("/nonexistent-dir/x/log.txt"));
}

TEST(OSSpecific, FileExistsOnlyForRegularFiles) {
    std::string path = ::testing::TempDir() + "braigrion_exists.txt";
    std::ofstream(path) << "x";
    EXPECT_TRUE(TOSSpecific::FileExists(path));
    EXPECT_FALSE(TOSSpecific::FileExists(::testing::TempDir()));
    EXPECT_FALSE(TOSSpecific::FileExists(path + ".missing"));
    std::remove(path.c_str());
}
