// A writer set up as a report run sets it up, writing into a directory of
// the test's own, for the raw-data pages: their back-end calls with the
// directory shown as "out", and the result files they leave.
#pragma once

#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "braigrion/TWriter.h"
#include "support/LogCapture.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace testing {

// A recording writer whose EscapeText makes mark-up characters entities, so
// that a transcript shows which texts were escaped.
class TEscapingWriter : public TRecordingWriter {
public:
    using TRecordingWriter::TRecordingWriter;
    std::string EscapeText(std::string text) override {
        std::string out;
        for (char c : text) {
            switch (c) {
                case '<': out += "&lt;"; break;
                case '>': out += "&gt;"; break;
                case '&': out += "&amp;"; break;
                case '"': out += "&quot;"; break;
                default: out += c;
            }
        }
        return out;
    }
};

template <typename TWriterType = TEscapingWriter>
class TBasicRawDataRun {
public:
    explicit TBasicRawDataRun(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const std::string& writerType = "html",
                         const std::string& mode = "luz")
        : writer(writerType) {
        const ::testing::TestInfo* test = ::testing::UnitTest::GetInstance()->current_test_info();
        std::string name = std::string(test->test_suite_name()) + "_" + test->name();
        std::replace(name.begin(), name.end(), '/', '_');
        fRoot = std::filesystem::path(::testing::TempDir()) / ("braigrion_raw_" + name + "_" + std::to_string(getpid()));
        std::filesystem::remove_all(fRoot);
        std::filesystem::create_directories(fRoot / "report");
        std::map<std::string, NORVTKR20::TCIMValue> context;
        context["mode"] = NORVTKR20::TCIMValue(mode);
        writer.BaseInitialize(ns, context, boost::make_shared<TReportParametersBuilder>(ns, mode, false));
        writer.Initialize(ns, context, Dir());
        writer.Clear();
        log.Clear();
    }
    ~TBasicRawDataRun() { std::filesystem::remove_all(fRoot); }

    // The report's directory; its parent holds nothing else.
    std::string Dir() const { return (fRoot / "report").string(); }

    // The back-end calls without EscapeText and GetSeparatorText, the
    // directory shown as "out".
    std::string Transcript() const {
        std::string text;
        for (const std::string& call : writer.Calls()) {
            if (call.compare(0, 11, "EscapeText(") == 0 || call.compare(0, 17, "GetSeparatorText(") == 0) continue;
            std::string line = call;
            for (size_t at = line.find(Dir()); at != std::string::npos; at = line.find(Dir()))
                line.replace(at, Dir().size(), "out");
            text += line + "\n";
        }
        return text;
    }

    // The link a writer answered, its transcript, then every entry of the
    // report's directory with its size and text; anything written beside
    // the directory is listed as well.
    std::string Dump(const std::string& link) const {
        std::string text = "link \"" + link + "\"\n" + Transcript();
        for (const auto& entry : std::filesystem::directory_iterator(fRoot)) {
            if (entry.path().filename() != "report") text += "== OUTSIDE THE REPORT: " + entry.path().filename().string() + "\n";
        }
        std::vector<std::string> names = Files();
        for (const std::string& name : names) {
            if (std::filesystem::is_directory(Dir() + "/" + name)) {
                text += "== " + name + "/\n";
                continue;
            }
            const std::string content = Read(name);
            text += "== " + name + " (" + std::to_string(content.size()) + " bytes)\n" + content;
        }
        return text;
    }

    // Names of the entries of the report's directory, sorted.
    std::vector<std::string> Files() const {
        std::vector<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(Dir())) names.push_back(entry.path().filename().string());
        std::sort(names.begin(), names.end());
        return names;
    }

    std::string Read(const std::string& name) const {
        std::ifstream in(Dir() + "/" + name, std::ios::binary);
        std::ostringstream text;
        text << in.rdbuf();
        return text.str();
    }
    // Puts a directory where a result file would go, so that it cannot be
    // opened for writing.
    void Block(const std::string& name) const { std::filesystem::create_directory(Dir() + "/" + name); }

    TLogCapture log;
    TWriterType writer;

private:
    std::filesystem::path fRoot;
};

typedef TBasicRawDataRun<> TRawDataRun;

}  // namespace testing
}  // namespace braigrion
