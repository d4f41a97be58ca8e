// Helpers for the tests of the table engine and the generic pages: a
// recording writer set up over a repository as a report run would set it up,
// and its transcript without the calls that only make text safe.
#pragma once

#include <cctype>
#include <map>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>

#include "braigrion/TWriter.h"
#include "support/LogCapture.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace testing {

// A recording writer whose EscapeText upper-cases, so that a test can tell
// escaped text (a cell's text) from text left as it is (its raw text).
class TUpperCaseWriter : public TRecordingWriter {
public:
    using TRecordingWriter::TRecordingWriter;
    std::string EscapeText(std::string text) override {
        for (char& c : text) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
        return text;
    }
};

template <typename TWriterType = TRecordingWriter>
class TEngineRun {
public:
    // `mode` goes into the context as "mode"; `kmc` is the builder's flag.
    explicit TEngineRun(boost::shared_ptr<NORVTKR20::ICIMNamespace> ns, const std::string& writerType = "html",
                        const std::string& mode = "default", bool kmc = false)
        : writer(writerType) {
        std::map<std::string, NORVTKR20::TCIMValue> context;
        context["mode"] = NORVTKR20::TCIMValue(mode);
        writer.BaseInitialize(ns, context, boost::make_shared<TReportParametersBuilder>(ns, mode, kmc));
        writer.Initialize(ns, context, "out");
        writer.Clear();
        log.Clear();
    }

    // The back-end calls, leaving out EscapeText and GetSeparatorText.
    std::vector<std::string> Calls() const {
        std::vector<std::string> calls;
        for (const std::string& call : writer.Calls()) {
            if (call.compare(0, 11, "EscapeText(") == 0 || call.compare(0, 17, "GetSeparatorText(") == 0) continue;
            calls.push_back(call);
        }
        return calls;
    }
    std::string Transcript() const {
        std::string text;
        for (const std::string& call : Calls()) text += call + "\n";
        return text;
    }
    std::vector<std::string> Grids() const { return writer.CallsStartingWith("WriteTableGrid("); }

    TLogCapture log;
    TWriterType writer;
};

}  // namespace testing
}  // namespace braigrion
