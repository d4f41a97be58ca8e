// Runs a report against the recording writer and gives its transcript, with
// a "page <id>" line wherever the driver asked for a page that has no
// generator yet, and one line, its index entry, for each page written.
#pragma once

#include <map>
#include <string>

#include "braigrion/TReport.h"
#include "support/LogCapture.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace testing {

class TReportRun {
public:
    explicit TReportRun(const std::string& writerType = "html") : writer(writerType) {
        log.SetListener([this](int, const std::string& line) {
            static const std::string kUnknownPage = "TWriter::WriteReportPage -- Unknow PageID = ";
            if (line.compare(0, kUnknownPage.size(), kUnknownPage) == 0) {
                writer.Note("page " + line.substr(kUnknownPage.size()));
            }
        });
    }

    // The writer's transcript with each written page folded into its
    // WriteIndexEntry line: the calls from OpenPage to ClosePage are left out.
    // A page left without ClosePage ends at its index entry.
    std::string Transcript() const {
        std::string text;
        bool inPage = false;
        for (const std::string& call : writer.Calls()) {
            if (call.compare(0, 9, "OpenPage(") == 0) inPage = true;
            if (call.compare(0, 16, "WriteIndexEntry(") == 0) inPage = false;
            if (!inPage) text += call + "\n";
            if (call == "ClosePage()") inPage = false;
        }
        return text;
    }

    TLogCapture log;
    TRecordingWriter writer;
};

typedef std::map<std::string, NORVTKR20::TCIMValue> TContextMap;

}  // namespace testing
}  // namespace braigrion
