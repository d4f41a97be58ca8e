#include "tkrcore/TRootObject.h"

#include <iostream>

namespace NORVTKR20 {

TCoreLogger::TCoreLogger() : fThreshold(0) {}

void TCoreLogger::Log(int level, const std::string& message) {
    if (level > fThreshold) return;
    std::ostream& out = fFile ? static_cast<std::ostream&>(*fFile) : std::cerr;
    // One line a message, whatever collected text it quotes.
    std::string line;
    line.reserve(message.size());
    for (unsigned char c : message) {
        if (c >= 0x20 && c != 0x7F) {
            line += static_cast<char>(c);
        } else if (c == '\n') {
            line += "\\n";
        } else if (c == '\r') {
            line += "\\r";
        } else if (c == '\t') {
            line += "\\t";
        } else {
            static const char kHex[] = "0123456789abcdef";
            line += "\\x";
            line += kHex[c >> 4];
            line += kHex[c & 15];
        }
    }
    out << '[' << level << "] " << line << '\n';
    if (level == 0) out.flush();
}

bool TCoreLogger::SetLogFile(const std::string& path) {
    std::unique_ptr<std::ofstream> file(new std::ofstream(path, std::ios::app));
    if (!*file) return false;
    fFile = std::move(file);
    return true;
}

void TCoreLogger::SetLogToStderr() { fFile.reset(); }

namespace {
TLogger* gLogger = nullptr;
IIPMILan* gIpmiLan = nullptr;
}  // namespace

TCoreLogger& TRootObject::GetDefaultLogger() {
    static TCoreLogger logger;
    return logger;
}

TLogger* TRootObject::GetCoreLogger() { return gLogger ? gLogger : &GetDefaultLogger(); }

void TRootObject::SetCoreLogger(TLogger* logger) { gLogger = logger; }

IIPMILan* TRootObject::GetipmiLanIns() { return gIpmiLan; }

void TRootObject::SetipmiLanIns(IIPMILan* lan) { gIpmiLan = lan; }

}  // namespace NORVTKR20
