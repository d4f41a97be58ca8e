// gen_collection: writes a synthetic collection for load benchmarks.
//
//   gen_collection N OUT.xml [--seed S] [--disks]
//
// The file is one CIM-XML declaration document: a schema group (qualifier
// types and the classes used) followed by N named instances shaped like what
// a collector gathers on a busy Linux server: system log lines (about two
// thirds), PCI devices with arrays, datetimes and booleans, and association
// instances that tie a log line to the device it talks about. Association
// references always point at instances written earlier in the same file.
// The output depends only on N, the seed and --disks.
//
// With --disks the collection is one the whole report shows, associations
// walked on every device: the operating system is named (Linux), and in
// place of the PCI devices come disks, each with a partition and the logical
// disk on it, tied together by two association instances (five instances a
// disk), as the report's disk page reads them.

#include <cerrno>
#include <cinttypes>
#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

namespace {

// splitmix64: tiny, fast, and the same sequence on every platform (the
// standard distributions are not specified bit for bit).
class TRandom {
public:
    explicit TRandom(std::uint64_t seed) : fState(seed) {}
    std::uint64_t Next() {
        std::uint64_t z = (fState += 0x9E3779B97F4A7C15ull);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        return z ^ (z >> 31);
    }
    // Uniform in [0, n).
    std::uint32_t Below(std::uint32_t n) { return static_cast<std::uint32_t>(Next() % n); }
    template <typename T, size_t N>
    const T& Pick(const T (&items)[N]) { return items[Below(N)]; }

private:
    std::uint64_t fState;
};

// Buffered output with the few formatting helpers the writer needs.
class TOutput {
public:
    TOutput(std::FILE* file, const std::string& path) : fFile(file), fPath(path) { fBuffer.reserve(kFlushAt + 65536); }
    ~TOutput() { Flush(); }

    TOutput& operator<<(const char* text) { fBuffer += text; return Check(); }
    TOutput& operator<<(const std::string& text) { fBuffer += text; return Check(); }
    TOutput& operator<<(std::uint64_t value) {
        char digits[24];
        std::snprintf(digits, sizeof digits, "%" PRIu64, value);
        fBuffer += digits;
        return Check();
    }
    // Character data: escapes the three characters that matter in content.
    TOutput& Escaped(const std::string& text) {
        for (char c : text) {
            switch (c) {
            case '&': fBuffer += "&amp;"; break;
            case '<': fBuffer += "&lt;"; break;
            case '>': fBuffer += "&gt;"; break;
            default: fBuffer += c;
            }
        }
        return Check();
    }
    void Flush() {
        if (fBuffer.empty() || !fFile) return;
        if (std::fwrite(fBuffer.data(), 1, fBuffer.size(), fFile) != fBuffer.size()) {
            std::fprintf(stderr, "gen_collection: cannot write %s: %s\n", fPath.c_str(), std::strerror(errno));
            std::exit(1);
        }
        fBuffer.clear();
    }

private:
    static constexpr size_t kFlushAt = 1u << 20;
    TOutput& Check() {
        if (fBuffer.size() >= kFlushAt) Flush();
        return *this;
    }
    std::FILE* fFile;
    std::string fPath;
    std::string fBuffer;
};

std::string Format(const char* format, ...) __attribute__((format(printf, 1, 2)));
std::string Format(const char* format, ...) {
    char text[512];
    va_list args;
    va_start(args, format);
    std::vsnprintf(text, sizeof text, format, args);
    va_end(args);
    return text;
}

const char kHost[] = "dbnode07.corp.example.net";

// ----------------------------------------------------------------- schema

const char kSchema[] = R"(<DECLGROUP>
<QUALIFIER.DECLARATION NAME="Abstract" TYPE="boolean" TOSUBCLASS="false"><SCOPE CLASS="true" ASSOCIATION="true"/><VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="Association" TYPE="boolean" OVERRIDABLE="false"><SCOPE ASSOCIATION="true"/><VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="Key" TYPE="boolean" OVERRIDABLE="false"><SCOPE PROPERTY="true" REFERENCE="true"/><VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="DisplayName" TYPE="string" TRANSLATABLE="true"><SCOPE CLASS="true" PROPERTY="true" REFERENCE="true"/></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="RowMerge" TYPE="boolean"><SCOPE PROPERTY="true"/><VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="ValueMap" TYPE="string" ISARRAY="true"><SCOPE PROPERTY="true"/></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="Values" TYPE="string" ISARRAY="true" TRANSLATABLE="true"><SCOPE PROPERTY="true"/></QUALIFIER.DECLARATION>
<VALUE.OBJECT>
<CLASS NAME="CIM_ManagedElement">
  <QUALIFIER NAME="Abstract" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>
  <PROPERTY NAME="Caption" TYPE="string"/>
  <PROPERTY NAME="Description" TYPE="string"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Description</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="ElementName" TYPE="string"/>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="CIM_LogRecord" SUPERCLASS="CIM_ManagedElement">
  <PROPERTY NAME="LogCreationClassName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="LogName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Log</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="CreationClassName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="RecordID" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Record ID</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="MessageTimestamp" TYPE="datetime"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Time</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="PerceivedSeverity" TYPE="uint16">
    <QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Severity</VALUE></QUALIFIER>
    <QUALIFIER NAME="ValueMap" TYPE="string"><VALUE.ARRAY><VALUE>0</VALUE><VALUE>1</VALUE><VALUE>2</VALUE><VALUE>3</VALUE><VALUE>4</VALUE><VALUE>5</VALUE><VALUE>6</VALUE><VALUE>7</VALUE></VALUE.ARRAY></QUALIFIER>
    <QUALIFIER NAME="Values" TYPE="string"><VALUE.ARRAY><VALUE>Unknown</VALUE><VALUE>Other</VALUE><VALUE>Information</VALUE><VALUE>Degraded/Warning</VALUE><VALUE>Minor</VALUE><VALUE>Major</VALUE><VALUE>Critical</VALUE><VALUE>Fatal/NonRecoverable</VALUE></VALUE.ARRAY></QUALIFIER>
  </PROPERTY>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_LinuxEventLogRecord" SUPERCLASS="CIM_LogRecord">
  <PROPERTY NAME="Source" TYPE="string"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Source</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="Message" TYPE="string"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Message</VALUE></QUALIFIER><QUALIFIER NAME="RowMerge" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="Facility" TYPE="string"/>
  <PROPERTY NAME="Priority" TYPE="uint8"/>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="CIM_LogicalDevice" SUPERCLASS="CIM_ManagedElement">
  <QUALIFIER NAME="Abstract" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>
  <PROPERTY NAME="SystemCreationClassName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="SystemName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="CreationClassName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="DeviceID" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Device ID</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="Name" TYPE="string"/>
  <PROPERTY NAME="InstallDate" TYPE="datetime"/>
  <PROPERTY.ARRAY NAME="OperationalStatus" TYPE="uint16">
    <QUALIFIER NAME="ValueMap" TYPE="string"><VALUE.ARRAY><VALUE>0</VALUE><VALUE>2</VALUE><VALUE>3</VALUE><VALUE>5</VALUE><VALUE>6</VALUE><VALUE>10</VALUE></VALUE.ARRAY></QUALIFIER>
    <QUALIFIER NAME="Values" TYPE="string"><VALUE.ARRAY><VALUE>Unknown</VALUE><VALUE>OK</VALUE><VALUE>Degraded</VALUE><VALUE>Predictive Failure</VALUE><VALUE>Error</VALUE><VALUE>Stopped</VALUE></VALUE.ARRAY></QUALIFIER>
  </PROPERTY.ARRAY>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_PCIDevice" SUPERCLASS="CIM_LogicalDevice">
  <PROPERTY NAME="ClassCode" TYPE="uint8"/>
  <PROPERTY NAME="VendorID" TYPE="string"/>
  <PROPERTY NAME="PciDeviceID" TYPE="string"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>DeviceID</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="IRQ" TYPE="uint32"/>
  <PROPERTY.ARRAY NAME="IOAddress" TYPE="string"/>
  <PROPERTY NAME="PowerManagementSupported" TYPE="boolean"/>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_LogEntryOfDevice">
  <QUALIFIER NAME="Association" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>
  <PROPERTY.REFERENCE NAME="Device" REFERENCECLASS="ORVSG_PCIDevice"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
  <PROPERTY.REFERENCE NAME="Record" REFERENCECLASS="ORVSG_LinuxEventLogRecord"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
</CLASS>
</VALUE.OBJECT>
</DECLGROUP>
)";

const char kDiskSchema[] = R"(<DECLGROUP>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_OperatingSystem" SUPERCLASS="CIM_ManagedElement">
  <PROPERTY NAME="CSCreationClassName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="CSName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="CreationClassName" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="Name" TYPE="string"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="OSType" TYPE="uint16"/>
  <PROPERTY NAME="Version" TYPE="string"/>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_MediaAccessDevice" SUPERCLASS="CIM_LogicalDevice">
  <PROPERTY NAME="Size" TYPE="uint64"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Size</VALUE></QUALIFIER></PROPERTY>
  <PROPERTY NAME="NoOfPartitions" TYPE="uint32"><QUALIFIER NAME="DisplayName" TYPE="string"><VALUE>Partitions</VALUE></QUALIFIER></PROPERTY>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_DiskPartition" SUPERCLASS="CIM_LogicalDevice">
  <PROPERTY NAME="PartitionType" TYPE="string"/>
  <PROPERTY NAME="PartitionSubType" TYPE="string"/>
  <PROPERTY NAME="Size" TYPE="uint64"/>
  <PROPERTY NAME="StartingOffset" TYPE="uint64"/>
  <PROPERTY NAME="FaultTolerant" TYPE="boolean"/>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_LogicalDisk" SUPERCLASS="CIM_LogicalDevice">
  <PROPERTY NAME="FileSystemName" TYPE="string"/>
  <PROPERTY NAME="Size" TYPE="uint64"/>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_PartitionPresent">
  <QUALIFIER NAME="Association" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>
  <PROPERTY.REFERENCE NAME="Antecedent" REFERENCECLASS="ORVSG_MediaAccessDevice"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
  <PROPERTY.REFERENCE NAME="Dependent" REFERENCECLASS="ORVSG_DiskPartition"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
</CLASS>
</VALUE.OBJECT>
<VALUE.OBJECT>
<CLASS NAME="ORVSG_LogicalDiskBasedOnPartition">
  <QUALIFIER NAME="Association" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER>
  <PROPERTY.REFERENCE NAME="Antecedent" REFERENCECLASS="ORVSG_DiskPartition"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
  <PROPERTY.REFERENCE NAME="Dependent" REFERENCECLASS="ORVSG_LogicalDisk"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
</CLASS>
</VALUE.OBJECT>
</DECLGROUP>
)";

// ----------------------------------------------------------------- values

const char* const kLogNames[] = {"/var/log/messages", "/var/log/secure", "/var/log/cron", "/var/log/boot.log",
                                 "dmesg"};
const char* const kUsers[] = {"oracle", "grid", "root", "backup", "nagios", "jsmith", "akumar"};
const char* const kServices[] = {"postfix", "rsyslog", "chronyd", "sshd", "crond", "tuned", "kdump"};
const char* const kUnits[] = {"Postfix Mail Transport Agent", "System Logging Service", "NTP client/server",
                              "OpenSSH server daemon", "Command Scheduler", "Dynamic System Tuning Daemon",
                              "Crash recovery kernel arming", "Login Service", "LSB: Oracle ASM library driver"};

// A CIM timestamp "yyyymmddhhmmss.mmmmmm-300" for `seconds` after
// 2024-01-01 00:00:00 local time (days of 2024, a leap year).
std::string Timestamp(std::uint64_t seconds, std::uint32_t micros) {
    static const int kMonthDays[] = {31, 29, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    std::uint64_t days = seconds / 86400;
    const unsigned secondOfDay = static_cast<unsigned>(seconds % 86400);
    unsigned year = 2024;
    for (;;) {
        const unsigned yearDays = (year % 4 == 0 && (year % 100 != 0 || year % 400 == 0)) ? 366 : 365;
        if (days < yearDays) break;
        days -= yearDays;
        ++year;
    }
    const bool leap = (year % 4 == 0 && (year % 100 != 0 || year % 400 == 0));
    unsigned month = 0;
    for (; month < 12; ++month) {
        const unsigned length = kMonthDays[month] - (month == 1 && !leap ? 1 : 0);
        if (days < length) break;
        days -= length;
    }
    return Format("%04u%02u%02u%02u%02u%02u.%06u-300", year, month + 1, static_cast<unsigned>(days) + 1,
                  secondOfDay / 3600, secondOfDay / 60 % 60, secondOfDay % 60, micros % 1000000);
}

std::string Base64Ish(TRandom& rng, int length) {
    static const char kAlphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string text;
    for (int i = 0; i < length; ++i) text += kAlphabet[rng.Below(64)];
    return text;
}

struct TLogLine {
    std::string fSource;
    std::string fMessage;
    const char* fFacility;
    unsigned fPriority;  // syslog priority, 0 emergency .. 7 debug
    unsigned fSeverity;  // PerceivedSeverity
};

// Which kinds of line each log holds, by index into kLogNames.
const unsigned kSecureKinds[] = {7, 10, 11};
const unsigned kKernelKinds[] = {0, 1, 5, 6};

unsigned LineKind(TRandom& rng, unsigned logIndex) {
    switch (logIndex) {
    case 0: return rng.Below(10);
    case 1: return rng.Pick(kSecureKinds);
    case 2: return 12;
    case 3: return 13;
    default: return rng.Pick(kKernelKinds);
    }
}

TLogLine MakeLogLine(TRandom& rng, unsigned logIndex) {
    const char* user = rng.Pick(kUsers);
    const unsigned pid = 1000 + rng.Below(60000);
    switch (LineKind(rng, logIndex)) {
    case 0:
        return {"kernel", Format("i40e 0000:1a:00.%u ens1f%u: NIC Link is %s", rng.Below(2), rng.Below(2),
                                 rng.Below(2) ? "Up, 10 Gbps Full Duplex, Flow Control: None" : "Down"),
                "kern", 6, 2};
    case 1:
        return {"kernel", Format("EDAC MC%u: 1 CE memory read error on CPU_SrcID#%u_Ha#0_Chan#%u_DIMM#0 "
                                 "(channel:%u slot:0 page:0x%x offset:0x0 grain:32 syndrome:0x0)",
                                 rng.Below(2), rng.Below(2), rng.Below(4), rng.Below(4), rng.Below(0x7fffff)),
                "kern", 4, 3};
    case 2:
        return {"systemd", Format("Started Session %u of user %s.", rng.Below(90000), user), "daemon", 6, 2};
    case 3:
        return {Format("NetworkManager[%u]", pid),
                Format("<info>  [%u.%04u] device (ens1f%u): carrier: link connected", 1704067200 + rng.Below(6000000),
                       rng.Below(10000), rng.Below(2)),
                "daemon", 6, 2};
    case 4:
        return {Format("smartd[%u]", pid),
                Format("Device: /dev/sd%c [SAT], SMART Usage Attribute: 194 Temperature_Celsius changed from %u to %u",
                       'a' + rng.Below(8), 30 + rng.Below(10), 30 + rng.Below(10)),
                "daemon", 6, 2};
    case 5:
        return {"kernel", Format("sd 0:2:%u:0: [sd%c] tag#%u FAILED Result: hostbyte=DID_OK driverbyte=DRIVER_SENSE",
                                 rng.Below(8), 'a' + rng.Below(8), rng.Below(1024)),
                "kern", 3, 5};
    case 6:
        return {"kernel", Format("nfs: server 10.40.%u.%u not responding, still trying", rng.Below(256), rng.Below(256)),
                "kern", 4, 3};
    case 7:
        return {Format("sudo[%u]", pid),
                Format("%s : TTY=pts/%u ; PWD=/home/%s ; USER=root ; COMMAND=/bin/systemctl restart %s", user,
                       rng.Below(8), user, rng.Pick(kServices)),
                "authpriv", 5, 2};
    case 8:
        return {"kernel", Format("Out of memory: Kill process %u (%s) score %u or sacrifice child", pid,
                                 rng.Below(2) ? "java" : "oracle", 500 + rng.Below(500)),
                "kern", 3, 6};
    case 9:
        return {"rsyslogd", "action 'action 0' resumed (module 'builtin:omfwd') [v8.24.0-57.el7_9]", "syslog", 6, 2};
    case 10:
        return {Format("sshd[%u]", pid),
                Format("Accepted publickey for %s from 10.40.%u.%u port %u ssh2: RSA SHA256:%s", user, rng.Below(256),
                       rng.Below(256), 1024 + rng.Below(64000), Base64Ish(rng, 43).c_str()),
                "authpriv", 6, 2};
    case 11:
        return {Format("sshd[%u]", pid), Format("pam_unix(sshd:session): session opened for user %s by (uid=0)", user),
                "authpriv", 6, 2};
    case 12:
        return {Format("CROND[%u]", pid), Format("(%s) CMD (/opt/backup/bin/rotate.sh --keep 7 > /dev/null 2>&1)", user),
                "cron", 6, 2};
    default:
        return {"systemd", Format("Started %s.", rng.Pick(kUnits)), "daemon", 6, 2};
    }
}

struct TPciKind {
    unsigned fClassCode;
    const char* fVendor;
    const char* fDevice;
    const char* fName;
};

const TPciKind kPciKinds[] = {
    {2, "8086", "1572", "Ethernet controller: Intel Corporation Ethernet Controller X710 for 10GbE SFP+ (rev 02)"},
    {2, "15b3", "1017", "Ethernet controller: Mellanox Technologies MT27800 Family [ConnectX-5]"},
    {1, "1000", "0016", "RAID bus controller: NVS RAID 930-8i SAS3 controller (rev 02)"},
    {1, "144d", "a808", "Non-Volatile memory controller: NVMe SSD Controller SM981/PM981/PM983"},
    {3, "102b", "0536", "VGA compatible controller: Integrated Matrox G200eW3 Graphics Controller (rev 04)"},
    {6, "8086", "2030", "PCI bridge: Intel Corporation Sky Lake-E PCI Express Root Port A (rev 07)"},
    {12, "8086", "a1af", "USB controller: Intel Corporation C620 Series Chipset Family USB 3.0 xHCI Controller"},
};

// The device with ordinal `n` has a unique PCI address derived from n, so
// that association instances can rebuild its path without a table.
std::string DeviceId(std::uint64_t n) {
    return Format("%04x:%02x:%02x.%u", static_cast<unsigned>(n >> 16), static_cast<unsigned>((n >> 8) & 0xff),
                  static_cast<unsigned>((n >> 3) & 0x1f), static_cast<unsigned>(n & 7));
}

// ----------------------------------------------------------------- writing

void KeyBinding(TOutput& out, const char* indent, const char* name, const std::string& value) {
    out << indent << "<KEYBINDING NAME=\"" << name << "\"><KEYVALUE VALUETYPE=\"string\">";
    out.Escaped(value) << "</KEYVALUE></KEYBINDING>\n";
}

void LogRecordName(TOutput& out, const char* indent, unsigned logIndex, std::uint64_t recordId) {
    const std::string inner = std::string(indent) + "  ";
    out << indent << "<INSTANCENAME CLASSNAME=\"ORVSG_LinuxEventLogRecord\">\n";
    KeyBinding(out, inner.c_str(), "LogCreationClassName", "ORVSG_LinuxEventLog");
    KeyBinding(out, inner.c_str(), "LogName", kLogNames[logIndex]);
    KeyBinding(out, inner.c_str(), "CreationClassName", "ORVSG_LinuxEventLogRecord");
    KeyBinding(out, inner.c_str(), "RecordID", Format("%" PRIu64, recordId));
    out << indent << "</INSTANCENAME>\n";
}

void LogicalDeviceName(TOutput& out, const char* indent, const char* className, const std::string& id) {
    const std::string inner = std::string(indent) + "  ";
    out << indent << "<INSTANCENAME CLASSNAME=\"" << className << "\">\n";
    KeyBinding(out, inner.c_str(), "SystemCreationClassName", "ORVSG_ComputerSystem");
    KeyBinding(out, inner.c_str(), "SystemName", kHost);
    KeyBinding(out, inner.c_str(), "CreationClassName", className);
    KeyBinding(out, inner.c_str(), "DeviceID", id);
    out << indent << "</INSTANCENAME>\n";
}

void DeviceName(TOutput& out, const char* indent, std::uint64_t device) {
    LogicalDeviceName(out, indent, "ORVSG_PCIDevice", DeviceId(device));
}

void Property(TOutput& out, const char* name, const char* type, const std::string& value) {
    out << "    <PROPERTY NAME=\"" << name << "\" TYPE=\"" << type << "\"><VALUE>";
    out.Escaped(value) << "</VALUE></PROPERTY>\n";
}

void Property(TOutput& out, const char* name, const char* type, std::uint64_t value) {
    out << "    <PROPERTY NAME=\"" << name << "\" TYPE=\"" << type << "\"><VALUE>" << value << "</VALUE></PROPERTY>\n";
}

struct TState {
    std::uint64_t fClock = 0;                 // seconds since 2024-01-01
    std::uint64_t fRecordIds[5] = {};         // last RecordID per log
    std::vector<std::uint64_t> fRecords;      // (log index << 56) | RecordID of every record written
    std::uint64_t fDevices = 0;               // devices written so far
};

void WriteLogRecord(TOutput& out, TRandom& rng, TState& state) {
    const unsigned logIndex = rng.Below(100) < 55 ? 0 : 1 + rng.Below(4);
    const std::uint64_t recordId = ++state.fRecordIds[logIndex];
    state.fRecords.push_back((static_cast<std::uint64_t>(logIndex) << 56) | recordId);
    state.fClock += rng.Below(20);
    const TLogLine line = MakeLogLine(rng, logIndex);

    out << "<VALUE.NAMEDOBJECT>\n";
    LogRecordName(out, "  ", logIndex, recordId);
    out << "  <INSTANCE CLASSNAME=\"ORVSG_LinuxEventLogRecord\">\n";
    Property(out, "LogCreationClassName", "string", std::string("ORVSG_LinuxEventLog"));
    Property(out, "LogName", "string", std::string(kLogNames[logIndex]));
    Property(out, "CreationClassName", "string", std::string("ORVSG_LinuxEventLogRecord"));
    Property(out, "RecordID", "string", Format("%" PRIu64, recordId));
    Property(out, "MessageTimestamp", "datetime", Timestamp(state.fClock, rng.Below(1000000)));
    Property(out, "PerceivedSeverity", "uint16", line.fSeverity);
    Property(out, "Source", "string", line.fSource);
    Property(out, "Message", "string", line.fMessage);
    Property(out, "Facility", "string", std::string(line.fFacility));
    Property(out, "Priority", "uint8", line.fPriority);
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";
}

void WriteDevice(TOutput& out, TRandom& rng, TState& state) {
    const std::uint64_t device = state.fDevices++;
    const TPciKind& kind = rng.Pick(kPciKinds);
    const std::string id = DeviceId(device);

    out << "<VALUE.NAMEDOBJECT>\n";
    DeviceName(out, "  ", device);
    out << "  <INSTANCE CLASSNAME=\"ORVSG_PCIDevice\">\n";
    Property(out, "SystemCreationClassName", "string", std::string("ORVSG_ComputerSystem"));
    Property(out, "SystemName", "string", std::string(kHost));
    Property(out, "CreationClassName", "string", std::string("ORVSG_PCIDevice"));
    Property(out, "DeviceID", "string", id);
    Property(out, "Name", "string", std::string(kind.fName));
    Property(out, "Description", "string", std::string(kind.fName) + " at " + id);
    Property(out, "InstallDate", "datetime", Timestamp(rng.Below(86400 * 30), 0));
    out << "    <PROPERTY.ARRAY NAME=\"OperationalStatus\" TYPE=\"uint16\"><VALUE.ARRAY><VALUE>"
        << (rng.Below(50) ? "2" : "3") << "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>\n";
    Property(out, "ClassCode", "uint8", kind.fClassCode);
    Property(out, "VendorID", "string", std::string(kind.fVendor));
    Property(out, "PciDeviceID", "string", std::string(kind.fDevice));
    Property(out, "IRQ", "uint32", 16 + rng.Below(200));
    out << "    <PROPERTY.ARRAY NAME=\"IOAddress\" TYPE=\"string\"><VALUE.ARRAY>";
    for (unsigned i = 0, n = 1 + rng.Below(3); i < n; ++i)
        out << "<VALUE>" << Format("0x%08x", 0x90000000u + rng.Below(0x10000000) * 16) << "</VALUE>";
    out << "</VALUE.ARRAY></PROPERTY.ARRAY>\n";
    out << "    <PROPERTY NAME=\"PowerManagementSupported\" TYPE=\"boolean\"><VALUE>"
        << (rng.Below(3) ? "TRUE" : "FALSE") << "</VALUE></PROPERTY>\n";
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";
}

void WriteAssociation(TOutput& out, TRandom& rng, TState& state) {
    const std::uint64_t device = rng.Next() % state.fDevices;
    const std::uint64_t record = state.fRecords[rng.Next() % state.fRecords.size()];
    const unsigned logIndex = static_cast<unsigned>(record >> 56);
    const std::uint64_t recordId = record & ((1ull << 56) - 1);

    out << "<VALUE.NAMEDOBJECT>\n";
    out << "  <INSTANCENAME CLASSNAME=\"ORVSG_LogEntryOfDevice\">\n";
    out << "    <KEYBINDING NAME=\"Device\"><VALUE.REFERENCE>\n";
    DeviceName(out, "      ", device);
    out << "    </VALUE.REFERENCE></KEYBINDING>\n";
    out << "    <KEYBINDING NAME=\"Record\"><VALUE.REFERENCE>\n";
    LogRecordName(out, "      ", logIndex, recordId);
    out << "    </VALUE.REFERENCE></KEYBINDING>\n";
    out << "  </INSTANCENAME>\n";
    out << "  <INSTANCE CLASSNAME=\"ORVSG_LogEntryOfDevice\">\n";
    out << "    <PROPERTY.REFERENCE NAME=\"Device\" REFERENCECLASS=\"ORVSG_PCIDevice\"><VALUE.REFERENCE>\n";
    DeviceName(out, "      ", device);
    out << "    </VALUE.REFERENCE></PROPERTY.REFERENCE>\n";
    out << "    <PROPERTY.REFERENCE NAME=\"Record\" REFERENCECLASS=\"ORVSG_LinuxEventLogRecord\"><VALUE.REFERENCE>\n";
    LogRecordName(out, "      ", logIndex, recordId);
    out << "    </VALUE.REFERENCE></PROPERTY.REFERENCE>\n";
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";
}

void LogicalDeviceKeys(TOutput& out, const char* className, const std::string& id) {
    Property(out, "SystemCreationClassName", "string", std::string("ORVSG_ComputerSystem"));
    Property(out, "SystemName", "string", std::string(kHost));
    Property(out, "CreationClassName", "string", std::string(className));
    Property(out, "DeviceID", "string", id);
}

void WriteOperatingSystem(TOutput& out) {
    out << "<VALUE.NAMEDOBJECT>\n  <INSTANCENAME CLASSNAME=\"ORVSG_OperatingSystem\">\n";
    KeyBinding(out, "    ", "CSCreationClassName", "ORVSG_ComputerSystem");
    KeyBinding(out, "    ", "CSName", kHost);
    KeyBinding(out, "    ", "CreationClassName", "ORVSG_OperatingSystem");
    KeyBinding(out, "    ", "Name", "Red Hat Enterprise Linux Server");
    out << "  </INSTANCENAME>\n  <INSTANCE CLASSNAME=\"ORVSG_OperatingSystem\">\n";
    Property(out, "CSCreationClassName", "string", std::string("ORVSG_ComputerSystem"));
    Property(out, "CSName", "string", std::string(kHost));
    Property(out, "CreationClassName", "string", std::string("ORVSG_OperatingSystem"));
    Property(out, "Name", "string", std::string("Red Hat Enterprise Linux Server"));
    Property(out, "OSType", "uint16", 36);
    Property(out, "Version", "string", std::string("7.9"));
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";
}

// One association instance between two logical devices, named by its path.
void WriteDeviceLink(TOutput& out, const char* assoc, const char* fromClass, const std::string& from,
                     const char* toClass, const std::string& to) {
    out << "<VALUE.NAMEDOBJECT>\n  <INSTANCENAME CLASSNAME=\"" << assoc << "\">\n";
    out << "    <KEYBINDING NAME=\"Antecedent\"><VALUE.REFERENCE>\n";
    LogicalDeviceName(out, "      ", fromClass, from);
    out << "    </VALUE.REFERENCE></KEYBINDING>\n    <KEYBINDING NAME=\"Dependent\"><VALUE.REFERENCE>\n";
    LogicalDeviceName(out, "      ", toClass, to);
    out << "    </VALUE.REFERENCE></KEYBINDING>\n  </INSTANCENAME>\n  <INSTANCE CLASSNAME=\"" << assoc << "\">\n";
    out << "    <PROPERTY.REFERENCE NAME=\"Antecedent\" REFERENCECLASS=\"" << fromClass << "\"><VALUE.REFERENCE>\n";
    LogicalDeviceName(out, "      ", fromClass, from);
    out << "    </VALUE.REFERENCE></PROPERTY.REFERENCE>\n";
    out << "    <PROPERTY.REFERENCE NAME=\"Dependent\" REFERENCECLASS=\"" << toClass << "\"><VALUE.REFERENCE>\n";
    LogicalDeviceName(out, "      ", toClass, to);
    out << "    </VALUE.REFERENCE></PROPERTY.REFERENCE>\n  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";
}

// A disk, its partition, the logical disk on it and the two associations.
void WriteDisk(TOutput& out, TRandom& rng, TState& state) {
    const std::uint64_t disk = state.fDevices++;
    const std::string diskId = Format("/dev/disk%" PRIu64, disk);
    const std::string partId = diskId + "p1";
    const std::string volumeId = Format("/mnt/vol%" PRIu64, disk);
    const std::uint64_t size = (1ull << 30) * (64 + rng.Below(4000));

    out << "<VALUE.NAMEDOBJECT>\n";
    LogicalDeviceName(out, "  ", "ORVSG_MediaAccessDevice", diskId);
    out << "  <INSTANCE CLASSNAME=\"ORVSG_MediaAccessDevice\">\n";
    LogicalDeviceKeys(out, "ORVSG_MediaAccessDevice", diskId);
    Property(out, "Name", "string", diskId);
    Property(out, "Size", "uint64", size);
    Property(out, "NoOfPartitions", "uint32", 1);
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";

    out << "<VALUE.NAMEDOBJECT>\n";
    LogicalDeviceName(out, "  ", "ORVSG_DiskPartition", partId);
    out << "  <INSTANCE CLASSNAME=\"ORVSG_DiskPartition\">\n";
    LogicalDeviceKeys(out, "ORVSG_DiskPartition", partId);
    Property(out, "PartitionType", "string", std::string(rng.Below(2) ? "Primary" : "Logical"));
    Property(out, "PartitionSubType", "string", std::string("Linux LVM"));
    Property(out, "Size", "uint64", size - (1u << 20));
    Property(out, "StartingOffset", "uint64", 1u << 20);
    Property(out, "FaultTolerant", "boolean", std::string(rng.Below(4) ? "FALSE" : "TRUE"));
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";

    out << "<VALUE.NAMEDOBJECT>\n";
    LogicalDeviceName(out, "  ", "ORVSG_LogicalDisk", volumeId);
    out << "  <INSTANCE CLASSNAME=\"ORVSG_LogicalDisk\">\n";
    LogicalDeviceKeys(out, "ORVSG_LogicalDisk", volumeId);
    Property(out, "FileSystemName", "string", std::string(rng.Below(3) ? "xfs" : "ext4"));
    Property(out, "Size", "uint64", size - (1u << 20));
    out << "  </INSTANCE>\n</VALUE.NAMEDOBJECT>\n";

    WriteDeviceLink(out, "ORVSG_PartitionPresent", "ORVSG_MediaAccessDevice", diskId, "ORVSG_DiskPartition", partId);
    WriteDeviceLink(out, "ORVSG_LogicalDiskBasedOnPartition", "ORVSG_DiskPartition", partId, "ORVSG_LogicalDisk",
                    volumeId);
}

int Usage() {
    std::fprintf(stderr, "usage: gen_collection N OUT.xml [--seed S] [--disks]\n");
    return 2;
}

bool ParseCount(const char* text, std::uint64_t& out) {
    char* end = nullptr;
    errno = 0;
    const unsigned long long value = std::strtoull(text, &end, 10);
    if (errno != 0 || end == text || *end != '\0' || text[0] == '-') return false;
    out = value;
    return true;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 3) return Usage();
    std::uint64_t count = 0;
    std::uint64_t seed = 20240311;
    bool disks = false;
    if (!ParseCount(argv[1], count)) {
        std::fprintf(stderr, "gen_collection: N must be a non-negative integer, not \"%s\"\n", argv[1]);
        return 2;
    }
    for (int i = 3; i < argc; ++i) {
        if (std::strcmp(argv[i], "--disks") == 0) disks = true;
        else if (std::strcmp(argv[i], "--seed") == 0 && i + 1 < argc && ParseCount(argv[i + 1], seed)) ++i;
        else return Usage();
    }

    const std::string path = argv[2];
    std::FILE* file = std::fopen(path.c_str(), "wb");
    if (!file) {
        std::fprintf(stderr, "gen_collection: cannot create %s: %s\n", path.c_str(), std::strerror(errno));
        return 1;
    }
    TRandom rng(seed);
    TState state;
    state.fRecords.reserve(count);
    std::uint64_t written[3] = {};
    {
        TOutput out(file, path);
        out << "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n"
            << "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">\n<DECLARATION>\n" << kSchema
            << (disks ? kDiskSchema : "") << "<DECLGROUP.WITHNAME>\n";
        std::uint64_t i = 0;
        if (disks && count > 0) {
            WriteOperatingSystem(out);
            ++i;
        }
        for (; i < count; ++i) {
            const unsigned roll = rng.Below(100);
            if (disks && roll >= 65 && i + 5 <= count) {
                WriteDisk(out, rng, state);
                written[1] += 3;
                written[2] += 2;
                i += 4;
            } else if (disks && roll >= 65) {
                WriteLogRecord(out, rng, state);
                ++written[0];
            } else if (roll >= 85 && state.fDevices > 0 && !state.fRecords.empty()) {
                WriteAssociation(out, rng, state);
                ++written[2];
            } else if (roll >= 65) {
                WriteDevice(out, rng, state);
                ++written[1];
            } else {
                WriteLogRecord(out, rng, state);
                ++written[0];
            }
        }
        out << "</DECLGROUP.WITHNAME>\n</DECLARATION>\n</CIM>\n";
    }
    if (std::fclose(file) != 0) {
        std::fprintf(stderr, "gen_collection: cannot write %s: %s\n", path.c_str(), std::strerror(errno));
        return 1;
    }
    std::printf("%s: %" PRIu64 " instances (%" PRIu64 " log records, %" PRIu64 " devices, %" PRIu64
                " associations), seed %" PRIu64 "\n",
                path.c_str(), count, written[0], written[1], written[2], seed);
    return 0;
}
