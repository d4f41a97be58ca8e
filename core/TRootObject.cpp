#include "tkrcore/TRootObject.h"

#include <iostream>

namespace NORVTKR20 {

TCoreLogger::TCoreLogger() : fThreshold(0) {}

void TCoreLogger::Log(int level, const std::string& message) {
    if (level > fThreshold) return;
    std::ostream& out = fFile ? static_cast<std::ostream&>(*fFile) : std::cerr;
    out << '[' << level << "] " << message << '\n';
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
