#include "HumanSize.h"

#include <cctype>
#include <cstdio>

namespace braigrion {
namespace backends {

namespace {

// Bytes in one of the declared unit, or 0 for a unit that is no size.
double BytesPerUnit(const std::string& unit) {
    std::string name;
    for (char c : unit) {
        if (!std::isspace(static_cast<unsigned char>(c))) name += static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    }
    if (name == "bytes" || name == "byte") return 1;
    if (name == "kilobytes" || name == "kilobyte" || name == "kbytes" || name == "byte*2^10") return 1024.0;
    if (name == "megabytes" || name == "megabyte" || name == "mbytes" || name == "byte*2^20") return 1048576.0;
    return 0;
}

// `bytes` in the largest unit of `base` it fills at least once.
std::string Scaled(double bytes, double base, const char* const units[]) {
    int i = 0;
    while (bytes >= base && units[i + 1] != nullptr) {
        bytes /= base;
        ++i;
    }
    char out[32];
    std::snprintf(out, sizeof out, "%.2f %s", bytes, units[i]);
    return out;
}

}  // namespace

std::string HumanSize(const std::string& text, const std::string& unit) {
    const double perUnit = BytesPerUnit(unit);
    size_t first = text.find_first_not_of(" \t");
    size_t last = text.find_last_not_of(" \t");
    if (perUnit == 0 || first == std::string::npos || last - first >= 20) return std::string();
    double count = 0;
    for (size_t i = first; i <= last; ++i) {
        if (!std::isdigit(static_cast<unsigned char>(text[i]))) return std::string();
        count = count * 10 + (text[i] - '0');
    }
    const double bytes = count * perUnit;
    if (bytes < 1024) return std::string();
    static const char* const kBinary[] = {"B", "KiB", "MiB", "GiB", "TiB", "PiB", "EiB", nullptr};
    static const char* const kDecimal[] = {"B", "KB", "MB", "GB", "TB", "PB", "EB", nullptr};
    return Scaled(bytes, 1024, kBinary) + " \u00b7 " + Scaled(bytes, 1000, kDecimal);
}

}  // namespace backends
}  // namespace braigrion
