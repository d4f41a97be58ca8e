// Helpers for the tests of the table engine and the generic pages: a
// recording writer set up over a repository as a report run would set it up,
// its transcript without the calls that only make text safe, and a small
// repository of adapters and their ports.
#pragma once

#include <cctype>
#include <map>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>

#include "braigrion/TWriter.h"
#include "repository/RepoFixture.h"
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

// Adapters a1, a2 and a3, each with the ports that `links` give it as
// (adapter, port name, speed), the ports reached through an association.
typedef std::vector<std::vector<std::string>> TPortLinks;
inline boost::shared_ptr<repository::TMemoryNamespace> AdaptersWithPorts(const TPortLinks& links) {
    using namespace testrepo;
    using NORVTKR20::TCIMValue;
    auto ns = repository::TMemoryNamespace::Create();
    ns->DeclareClass(C("ORVSG_Adapter", "", {P("DeviceID", T::eString, {Q("Key", TCIMValue::Boolean(true))})}));
    ns->DeclareClass(C("ORVSG_Port", "", {P("Name", T::eString, {Q("Key", TCIMValue::Boolean(true))}),
                                          P("Speed", T::eString)}));
    ns->DeclareClass(C("ORVSG_AdapterPort", "", {Ref("Antecedent", "ORVSG_Adapter"), Ref("Dependent", "ORVSG_Port")},
                       {Q("Association", TCIMValue::Boolean(true))}));
    for (const char* adapter : {"a1", "a2", "a3"}) ns->AddInstance("ORVSG_Adapter", {V("DeviceID", TCIMValue(adapter))});
    for (const auto& link : links) {
        ns->AddInstance("ORVSG_Port", {V("Name", TCIMValue(link[1])), V("Speed", TCIMValue(link[2]))});
        ns->AddInstance("ORVSG_AdapterPort",
                        {V("Antecedent", RefTo(ns, std::string("ORVSG_Adapter.DeviceID=\"") + link[0] + "\"")),
                         V("Dependent", RefTo(ns, std::string("ORVSG_Port.Name=\"") + link[1] + "\""))});
    }
    ns->Link();
    return ns;
}

// Adapters a1 (ports eth1 10G, eth0 1G, eth9 1G), a2 (eth2 25G) and a3 (no
// port).
inline boost::shared_ptr<repository::TMemoryNamespace> AdaptersWithPorts() {
    return AdaptersWithPorts({{"a1", "eth1", "10G"}, {"a1", "eth0", "1G"}, {"a1", "eth9", "1G"}, {"a2", "eth2", "25G"}});
}

}  // namespace testing
}  // namespace braigrion
