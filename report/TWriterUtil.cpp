// The text helpers of TWriterUtil, RunDuration and the number forms of
// process figures.
#include "braigrion/TWriterUtil.h"

#include <cstdlib>
#include <limits>

namespace braigrion {

namespace {

const std::string::size_type kTruncLength = 54;

void RemoveAll(std::string& text, char c) {
    std::string kept;
    kept.reserve(text.size());
    for (char ch : text) {
        if (ch != c) kept += ch;
    }
    text.swap(kept);
}

long ToLong(const std::string& text) {
    return std::strtol(text.c_str(), nullptr, 10);
}

// Integer addition that stops at the limits of long long instead of
// overflowing, for durations read from arbitrary text.
long long AddClamped(long long a, long long b) {
    long long sum = 0;
    if (__builtin_add_overflow(a, b, &sum)) {
        return b > 0 ? std::numeric_limits<long long>::max() : std::numeric_limits<long long>::min();
    }
    return sum;
}

std::string LongToStr(long long value) {
    if (value > std::numeric_limits<int>::max() || value < 0) return std::string();
    return TWriterUtil::IntToStr(static_cast<int>(value), 10);
}

// "12.5" megabytes in kilobytes: the decimal point moves three places to
// the right ("12500"); without a point three zeros are appended. Zeros that
// the move leaves in front ("0.5" gives "0500") are dropped.
std::string MegabytesToKilobytes(const std::string& number) {
    std::string::size_type point = number.find('.');
    std::string moved;
    if (point == std::string::npos) {
        moved = number + "000";
    } else {
        std::string whole = number.substr(0, point);
        std::string fraction = number.substr(point + 1);
        if (fraction.size() <= 3) {
            moved = whole + fraction + std::string(3 - fraction.size(), '0');
        } else {
            moved = whole + fraction.substr(0, 3) + "." + fraction.substr(3);
        }
    }
    std::string::size_type start = 0;
    while (start + 1 < moved.size() && moved[start] == '0' && moved[start + 1] >= '0' && moved[start + 1] <= '9') {
        ++start;
    }
    return moved.substr(start);
}

}  // namespace

std::string TWriterUtil::EscapeString(std::string text) {
    std::string escaped;
    escaped.reserve(text.size());
    for (char c : text) {
        if (c == '\\') {
            escaped += "\\\\";
        } else if (c == '"') {
            escaped += "\\\"";
        } else if (c != '\n' && c != '\r') {
            escaped += c;
        }
    }
    return escaped;
}

std::string TWriterUtil::BankTrimString(std::string text) {
    while (!text.empty()) {
        char first = text.front();
        char last = text.back();
        if (first == ' ' || first == '\t' || first == '\n' || first == '\r') {
            text.erase(0, 1);
        } else if (last == ' ' || last == '\t') {
            text.erase(text.size() - 1);
        } else {
            break;
        }
    }
    return text;
}

std::string TWriterUtil::TruncString(std::string text) {
    if (text.size() > kTruncLength) return text.substr(0, kTruncLength) + "...";
    return text;
}

std::string TWriterUtil::TruncString(std::string text, int length) {
    if (length >= 0 && static_cast<std::string::size_type>(length) + 1 <= text.size()) {
        return text.substr(0, static_cast<std::string::size_type>(length)) + "...";
    }
    return text;
}

std::string TWriterUtil::PadString(std::string text, int width, bool trimLeft) {
    RemoveAll(text, '\n');
    RemoveAll(text, '\t');
    if (trimLeft) {
        std::string::size_type first = text.find_first_not_of(' ');
        text.erase(0, first == std::string::npos ? text.size() : first);
    }
    if (width < 0 || text.size() > static_cast<std::string::size_type>(width)) return TruncString(text, width);
    text.append(static_cast<std::string::size_type>(width) - text.size(), ' ');
    return text;
}

void TWriterUtil::DivideStrToWords(std::string text, std::vector<std::string>& words) {
    words.clear();
    std::string word;
    for (char c : text) {
        if (c == ' ') {
            if (!word.empty()) words.push_back(word);
            word.clear();
        } else {
            word += c;
        }
    }
    if (!word.empty()) words.push_back(word);
}

int TWriterUtil::GetNumberInString(std::string& text) {
    std::string::size_type digit = text.find_first_of("0123456789");
    const char* start = digit == std::string::npos ? text.c_str() : text.c_str() + digit;
    return static_cast<int>(std::strtol(start, nullptr, 10));
}

std::string TWriterUtil::IntToStr(int value, int base) {
    if (value < 0 || base < 2 || base > 16) return std::string();
    static const char kDigits[] = "0123456789ABCDEF";
    if (value == 0) return "0";
    std::string reversed;
    while (value > 0) {
        reversed += kDigits[value % base];
        value /= base;
    }
    return std::string(reversed.rbegin(), reversed.rend());
}

int TWriterUtil::GetLenOfInt(int value, int base) {
    if (value < 0 || base < 2 || base > 16) return -1;
    int digits = 1;
    while (value >= base) {
        value /= base;
        ++digits;
    }
    return digits;
}

std::string TWriterUtil::ConvertStrToNumType(std::string value, std::string property) {
    if (property == "KernelModeTime" || property == "UserModeTime") {
        std::vector<std::string> words;
        DivideStrToWords(value, words);
        RunDuration duration;
        duration.SetValue(words);
        duration.ForwardCarry();
        unsigned int total = duration.Calculate();
        return IntToStr(static_cast<int>(total), 10);
    }
    if (property == "WorkingSetSize") {
        std::vector<std::string> words;
        DivideStrToWords(value, words);
        std::string unit = words.size() > 1 ? words[1] : std::string();
        if (unit == "Kilobytes") return words[0];
        if (unit == "Megabytes") return MegabytesToKilobytes(words[0]);
        return "0";
    }
    return value;
}

void RunDuration::SetValue(std::vector<std::string>& words) {
    if (words.empty()) return;
    fHours.clear();
    fMinutes.clear();
    fSeconds.clear();
    fMilliseconds.clear();
    for (std::vector<std::string>::size_type i = 0; i + 1 < words.size(); i += 2) {
        const std::string& number = words[i];
        const std::string& unit = words[i + 1];
        // "millisecond" holds "second", so it is looked for first.
        if (unit.find("millisecond") != std::string::npos) {
            fMilliseconds = number;
        } else if (unit.find("second") != std::string::npos) {
            fSeconds = number;
        } else if (unit.find("minute") != std::string::npos) {
            fMinutes = number;
        } else if (unit.find("hour") != std::string::npos) {
            fHours = number;
        }
    }
    for (std::string* member : {&fHours, &fMinutes, &fSeconds, &fMilliseconds}) {
        if (member->empty()) *member = "0";
    }
}

void RunDuration::ForwardCarry() {
    long long hours = ToLong(fHours);
    long long minutes = ToLong(fMinutes);
    long long seconds = ToLong(fSeconds);
    long long milliseconds = ToLong(fMilliseconds);
    seconds = AddClamped(seconds, milliseconds / 1000);
    minutes = AddClamped(minutes, seconds / 60);
    hours = AddClamped(hours, minutes / 60);
    minutes %= 60;
    seconds %= 60;
    milliseconds %= 1000;
    fHours = LongToStr(hours);
    fMinutes = LongToStr(minutes);
    fSeconds = LongToStr(seconds);
    fMilliseconds = LongToStr(milliseconds);
}

unsigned int RunDuration::Calculate() {
    // Unsigned arithmetic: a total beyond 32 bits wraps rather than failing.
    unsigned int hours = static_cast<unsigned int>(ToLong(fHours));
    unsigned int minutes = static_cast<unsigned int>(ToLong(fMinutes));
    unsigned int seconds = static_cast<unsigned int>(ToLong(fSeconds));
    unsigned int milliseconds = static_cast<unsigned int>(ToLong(fMilliseconds));
    return hours * 3600000u + minutes * 60000u + seconds * 1000u + milliseconds;
}

}  // namespace braigrion
