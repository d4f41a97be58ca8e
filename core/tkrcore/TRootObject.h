// The core library's static access point: the logger and the IPMI-over-LAN handle.
#pragma once

#include <fstream>
#include <memory>
#include <mutex>
#include <string>

namespace NORVTKR20 {

// Base of every logger; the first two slots belong to it.
class TLoggerBase {
public:
    virtual ~TLoggerBase() {}
    virtual const char* GetLoggerName() const { return "logger"; }
};

class TLogger : public TLoggerBase {
public:
    virtual void Log(int level, const std::string& message) = 0;
};

// The default logger: lines at or below a level threshold go to stderr or a file.
class TCoreLogger : public TLogger {
public:
    TCoreLogger();
    void Log(int level, const std::string& message) override;

    void SetLevel(int threshold) { fThreshold = threshold; }
    int GetLevel() const { return fThreshold; }
    // Appends to `path` from now on; false when the file cannot be opened.
    bool SetLogFile(const std::string& path);
    void SetLogToStderr();

private:
    int fThreshold;
    std::unique_ptr<std::ofstream> fFile;
};

class IIPMILan {
public:
    virtual ~IIPMILan() {}
    virtual int getipmiLanStatus() = 0;
    virtual void getIPMIAddress(char* buffer, int length) = 0;
};

class TRootObject {
public:
    // Never null. Replaced by SetCoreLogger, for instance by a test that
    // records lines; a null argument restores the default logger.
    static TLogger* GetCoreLogger();
    static void SetCoreLogger(TLogger* logger);
    static TCoreLogger& GetDefaultLogger();

    // May be null: the IPMI data were read locally.
    static IIPMILan* GetipmiLanIns();
    static void SetipmiLanIns(IIPMILan* lan);
};

}  // namespace NORVTKR20
