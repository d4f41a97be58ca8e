#include "tkrcore/TCIMDateTime.h"

#include <cstdio>

namespace NORVTKR20 {

TCIMDateTime::TCIMDateTime()
    : fDay(1), fMicroseconds(0), fYear(1970), fMonth(1), fHour(0), fMinute(0), fSecond(0), fUtcOffset(0),
      fInterval(false), fWildcards(kNone) {}

TCIMDateTime::TCIMDateTime(unsigned short year, unsigned short month, unsigned int day, unsigned short hour,
                           unsigned short minute, unsigned short second, unsigned int microseconds,
                           short utcOffset)
    : fDay(day), fMicroseconds(microseconds), fYear(year), fMonth(month), fHour(hour), fMinute(minute),
      fSecond(second), fUtcOffset(utcOffset), fInterval(false), fWildcards(kNone) {}

TCIMDateTime TCIMDateTime::Interval(unsigned int days, unsigned short hours, unsigned short minutes,
                                    unsigned short seconds, unsigned int microseconds) {
    TCIMDateTime dt(0, 0, days, hours, minutes, seconds, microseconds, 0);
    dt.fInterval = true;
    return dt;
}

namespace {

// Reads `width` digits at `pos`; all '*' marks a wildcard field. Mixed digits
// and '*' are accepted when the stars trail (reduced precision), and read as 0.
bool ReadField(const std::string& s, size_t pos, size_t width, unsigned long& value, bool& wild) {
    value = 0;
    wild = false;
    bool seenStar = false;
    for (size_t k = 0; k < width; ++k) {
        char c = s[pos + k];
        if (c == '*') {
            seenStar = true;
            value *= 10;
        } else if (c >= '0' && c <= '9') {
            if (seenStar) return false;
            value = value * 10 + static_cast<unsigned long>(c - '0');
        } else {
            return false;
        }
    }
    wild = seenStar;
    return true;
}

}  // namespace

bool TCIMDateTime::Parse(const std::string& s, TCIMDateTime& out) {
    if (s.size() != 25 || s[14] != '.') return false;
    const char sign = s[21];
    TCIMDateTime dt;
    bool wild = false;
    std::uint8_t mask = kNone;
    if (sign == ':') {
        // ddddddddhhmmss.mmmmmm:000
        if (s.compare(22, 3, "000") != 0) return false;
        unsigned long days = 0, h = 0, m = 0, sec = 0, us = 0;
        if (!ReadField(s, 0, 8, days, wild)) return false;
        if (wild) mask |= kYearOrDays;
        if (!ReadField(s, 8, 2, h, wild)) return false;
        if (wild) mask |= kMonthOrHours;
        if (!ReadField(s, 10, 2, m, wild)) return false;
        if (wild) mask |= kDayOrMinutes;
        if (!ReadField(s, 12, 2, sec, wild)) return false;
        if (wild) mask |= kSecond;
        if (!ReadField(s, 15, 6, us, wild)) return false;
        if (wild) mask |= kMicroseconds;
        if (h > 23 || m > 59 || sec > 59) return false;
        dt = Interval(static_cast<unsigned int>(days), static_cast<unsigned short>(h),
                      static_cast<unsigned short>(m), static_cast<unsigned short>(sec),
                      static_cast<unsigned int>(us));
        dt.fWildcards = mask;
        out = dt;
        return true;
    }
    if (sign != '+' && sign != '-') return false;
    unsigned long year = 0, month = 0, day = 0, h = 0, m = 0, sec = 0, us = 0, off = 0;
    struct {
        size_t pos, width;
        unsigned long* target;
        std::uint8_t bit;
    } fields[] = {{0, 4, &year, kYearOrDays},  {4, 2, &month, kMonthOrHours}, {6, 2, &day, kDayOrMinutes},
                  {8, 2, &h, kHour},           {10, 2, &m, kMinute},          {12, 2, &sec, kSecond},
                  {15, 6, &us, kMicroseconds}, {22, 3, &off, kUtcOffset}};
    for (auto& f : fields) {
        if (!ReadField(s, f.pos, f.width, *f.target, wild)) return false;
        if (wild) mask |= f.bit;
    }
    if (!(mask & kMonthOrHours) && (month < 1 || month > 12)) return false;
    if (!(mask & kDayOrMinutes) && (day < 1 || day > 31)) return false;
    if (h > 23 || m > 59 || sec > 60) return false;
    dt = TCIMDateTime(static_cast<unsigned short>(year), static_cast<unsigned short>(month),
                      static_cast<unsigned int>(day), static_cast<unsigned short>(h), static_cast<unsigned short>(m),
                      static_cast<unsigned short>(sec), static_cast<unsigned int>(us),
                      static_cast<short>(sign == '-' ? -static_cast<long>(off) : static_cast<long>(off)));
    dt.fWildcards = mask;
    out = dt;
    return true;
}

std::string TCIMDateTime::ToUIString() const {
    char buf[64];
    if (fInterval) {
        std::snprintf(buf, sizeof buf, "%u days %02u:%02u:%02u", fDay, static_cast<unsigned>(fHour),
                      static_cast<unsigned>(fMinute), static_cast<unsigned>(fSecond));
    } else {
        std::snprintf(buf, sizeof buf, "%04u-%02u-%02u %02u:%02u:%02u", static_cast<unsigned>(fYear),
                      static_cast<unsigned>(fMonth), fDay, static_cast<unsigned>(fHour),
                      static_cast<unsigned>(fMinute), static_cast<unsigned>(fSecond));
    }
    return buf;
}

namespace {

void PutField(std::string& out, unsigned long value, int width, bool wild) {
    char buf[16];
    if (wild) {
        out.append(static_cast<size_t>(width), '*');
        return;
    }
    std::snprintf(buf, sizeof buf, "%0*lu", width, value);
    out += buf;
}

}  // namespace

std::string TCIMDateTime::ToCIMString() const {
    std::string out;
    out.reserve(25);
    if (fInterval) {
        PutField(out, fDay, 8, fWildcards & kYearOrDays);
        PutField(out, fHour, 2, fWildcards & kMonthOrHours);
        PutField(out, fMinute, 2, fWildcards & kDayOrMinutes);
        PutField(out, fSecond, 2, fWildcards & kSecond);
        out += '.';
        PutField(out, fMicroseconds, 6, fWildcards & kMicroseconds);
        out += ":000";
        return out;
    }
    PutField(out, fYear, 4, fWildcards & kYearOrDays);
    PutField(out, fMonth, 2, fWildcards & kMonthOrHours);
    PutField(out, fDay, 2, fWildcards & kDayOrMinutes);
    PutField(out, fHour, 2, fWildcards & kHour);
    PutField(out, fMinute, 2, fWildcards & kMinute);
    PutField(out, fSecond, 2, fWildcards & kSecond);
    out += '.';
    PutField(out, fMicroseconds, 6, fWildcards & kMicroseconds);
    out += fUtcOffset < 0 ? '-' : '+';
    PutField(out, static_cast<unsigned long>(fUtcOffset < 0 ? -fUtcOffset : fUtcOffset), 3,
             fWildcards & kUtcOffset);
    return out;
}

bool TCIMDateTime::operator==(const TCIMDateTime& o) const {
    return fInterval == o.fInterval && fYear == o.fYear && fMonth == o.fMonth && fDay == o.fDay &&
           fHour == o.fHour && fMinute == o.fMinute && fSecond == o.fSecond && fMicroseconds == o.fMicroseconds &&
           fUtcOffset == o.fUtcOffset && fWildcards == o.fWildcards;
}

}  // namespace NORVTKR20
