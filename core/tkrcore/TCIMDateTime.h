// CIM date-time values: timestamps and intervals, with reduced precision.
#pragma once

#include <cstdint>
#include <string>

namespace NORVTKR20 {

class TCIMDateTime {
public:
    // Fields of a reduced-precision value that were given as '*'.
    enum EWildcard : std::uint8_t {
        kNone = 0,
        kYearOrDays = 1 << 0,
        kMonthOrHours = 1 << 1,
        kDayOrMinutes = 1 << 2,
        kHour = 1 << 3,
        kMinute = 1 << 4,
        kSecond = 1 << 5,
        kMicroseconds = 1 << 6,
        kUtcOffset = 1 << 7
    };

    TCIMDateTime();
    TCIMDateTime(unsigned short year, unsigned short month, unsigned int day, unsigned short hour,
                 unsigned short minute, unsigned short second, unsigned int microseconds,
                 short utcOffset);
    TCIMDateTime(const TCIMDateTime&) = default;
    TCIMDateTime& operator=(const TCIMDateTime&) = default;

    // An interval of days, hours, minutes, seconds and microseconds.
    static TCIMDateTime Interval(unsigned int days, unsigned short hours, unsigned short minutes,
                                 unsigned short seconds, unsigned int microseconds);

    // Parses the 25-character CIM form: "yyyymmddhhmmss.mmmmmmsutc" for a
    // timestamp, "ddddddddhhmmss.mmmmmm:000" for an interval, with '*' for
    // fields of reduced precision. Returns false on anything else.
    static bool Parse(const std::string& text, TCIMDateTime& out);

    // "YYYY-MM-DD HH:MM:SS" for a timestamp, "D days HH:MM:SS" for an interval.
    // Fields given as '*' read as zero.
    std::string ToUIString() const;
    // The 25-character CIM form, wildcards kept.
    std::string ToCIMString() const;

    bool IsInterval() const { return fInterval; }
    unsigned short GetYear() const { return fYear; }
    unsigned short GetMonth() const { return fMonth; }
    unsigned int GetDay() const { return fDay; }
    unsigned short GetHour() const { return fHour; }
    unsigned short GetMinute() const { return fMinute; }
    unsigned short GetSecond() const { return fSecond; }
    unsigned int GetMicroseconds() const { return fMicroseconds; }
    short GetUtcOffset() const { return fUtcOffset; }
    std::uint8_t GetWildcards() const { return fWildcards; }

    bool operator==(const TCIMDateTime& other) const;
    bool operator!=(const TCIMDateTime& other) const { return !(*this == other); }

private:
    unsigned int fDay;  // day of month, or the day count of an interval
    unsigned int fMicroseconds;
    unsigned short fYear;
    unsigned short fMonth;
    unsigned short fHour;
    unsigned short fMinute;
    unsigned short fSecond;
    short fUtcOffset;  // minutes east of UTC
    bool fInterval;
    std::uint8_t fWildcards;
};

}  // namespace NORVTKR20
