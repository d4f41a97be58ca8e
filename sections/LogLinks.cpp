// The lookup files and documentation links of the log sections.
#include "LogLinks.h"

#include <fstream>
#include <set>

#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"

namespace braigrion {

TWriter::TLogLinkSettings::TLogLinkSettings()
    : fDataFolder("./data"),
      fDocServer("https://docs.norvane.example"),
      fHelpServer("http://localhost:8040") {}

namespace loglinks {

namespace {

const char kTopicPath[] = "/infocenter/rackvane/information/topic";
const char kHelpTopicPath[] = "/help/topic";
const char kPlugin[] = "com.orv.acc.";

// A code comes from the collected data: anything that could leave its path
// segment (a "/", a "?", a "#", a blank, "..") is written as a %XX escape.
std::string PathSegment(const std::string& code) {
    static const char kHex[] = "0123456789ABCDEF";
    std::string out;
    for (unsigned char c : code) {
        bool plain = (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '-' ||
                     c == '_' || c == '~' || c == ':';
        if (plain) {
            out += static_cast<char>(c);
        } else {
            out += '%';
            out += kHex[c >> 4];
            out += kHex[c & 15];
        }
    }
    return out;
}

std::string WithoutTrailingSlash(std::string server) {
    while (!server.empty() && server[server.size() - 1] == '/') server.erase(server.size() - 1);
    return server;
}

}  // namespace

bool IsMachineTypeListed(const std::string& folder, const std::string& file, const std::string& machineType,
                         const std::string& failureText) {
    std::ifstream in(folder + "/" + file);
    if (!in) {
        Trace(failureText);
        return false;
    }
    std::set<std::string> listed;
    std::string line;
    while (std::getline(in, line)) listed.insert(line.substr(0, 4));
    // No machine type is no entry, even where the file has an empty line.
    if (machineType.empty() || listed.count(machineType) == 0) return false;
    Trace("Info Center link will be enabled");
    return true;
}

std::string EventLink(const std::string& docServer, const std::string& helpServer, const std::string& machineType,
                      const std::string& code) {
    const std::string topic = std::string("/") + kPlugin + PathSegment(machineType) + ".doc" + "/" +
                              PathSegment(code) + ".html";
    if (machineType == kHelpServerMachineType) return WithoutTrailingSlash(helpServer) + kHelpTopicPath + topic;
    return WithoutTrailingSlash(docServer) + kTopicPath + topic;
}

std::string DiagnosticLink(const std::string& docServer, const std::string& machineType, const std::string& code) {
    return WithoutTrailingSlash(docServer) + kTopicPath + "/" + kPlugin + PathSegment(machineType) + ".doc/" +
           PathSegment(code) + ".html";
}

}  // namespace loglinks
}  // namespace braigrion
