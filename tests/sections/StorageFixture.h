// What the storage page tests share: associations in inline repositories,
// classes declared under a parent, and a run of one section writer whose
// transcript (without the calls that only make text safe) a test compares.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TWriter.h"
#include "report/RawDataRun.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace testing {

// An association instance of `assoc` from the instance at `from` to the one
// at `to` (object paths such as ORVSG_Disk.DeviceID="0").
inline void Link(TRepoBuilder& repo, const std::string& assoc, const std::string& from, const std::string& to,
                 const std::string& fromRole = "Antecedent", const std::string& toRole = "Dependent") {
    repo.Add(assoc, {testrepo::V(fromRole, testrepo::RefTo(repo.Namespace(), from)),
                     testrepo::V(toRole, testrepo::RefTo(repo.Namespace(), to))});
}

// Declares `className` under `parent`, with no properties of its own.
inline void Subclass(TRepoBuilder& repo, const std::string& className, const std::string& parent) {
    repo.Namespace()->DeclareClass(testrepo::C(className, parent, {}));
}

// The lines of a transcript that start with `prefix`.
inline std::vector<std::string> LinesStartingWith(const std::string& transcript, const std::string& prefix) {
    std::vector<std::string> lines;
    size_t start = 0;
    while (start < transcript.size()) {
        size_t end = transcript.find('\n', start);
        if (end == std::string::npos) end = transcript.size();
        const std::string line = transcript.substr(start, end - start);
        if (line.compare(0, prefix.size(), prefix) == 0) lines.push_back(line);
        start = end + 1;
    }
    return lines;
}

inline bool Has(const std::string& transcript, const std::string& text) {
    return transcript.find(text) != std::string::npos;
}

}  // namespace testing
}  // namespace braigrion
