#include "braigrion/TInstanceSorter.h"

#include <cctype>
#include <climits>
#include <cstdlib>

#include "tkrcore/TRootObject.h"

namespace braigrion {

using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TCIMContext;
using NORVTKR20::TRootObject;

void TInstanceSorter::AddProperty(std::string property, bool ascending, bool numeric) {
    AddProperty(property, ascending, numeric, false);
}

void TInstanceSorter::AddProperty(std::string property, bool ascending, bool numeric, bool ignoreCase) {
    TPropertyInfo key;
    key.Property = property;
    key.Ascending = ascending;
    key.Numeric = numeric;
    key.IgnoreCase = ignoreCase;
    fProperties.push_back(key);
}

bool TInstanceSorter::operator()(boost::shared_ptr<ICIMInstance> a, boost::shared_ptr<ICIMInstance> b) const {
    for (const TPropertyInfo& key : fProperties) {
        int r = Compare(key, a, b);
        if (r == 0) continue;
        // A descending key flips the sign of the comparison; ties still fall
        // through to the next key.
        return key.Ascending ? (r == -1) : (r == 1);
    }
    return false;
}

int TInstanceSorter::Compare(const TPropertyInfo& key, boost::shared_ptr<ICIMInstance> a,
                             boost::shared_ptr<ICIMInstance> b) const {
    try {
        std::string va = GetFinalPropertyValue(key.Property, a);
        std::string vb = GetFinalPropertyValue(key.Property, b);
        // Always case-insensitive, whatever the key declares.
        int r = PropertyCompare(va, vb, true);
        return r < 0 ? -1 : (r > 0 ? 1 : 0);
    } catch (...) {
        TRootObject::GetCoreLogger()->Log(3, "TReportParameters::TInstanceSorter::Compare -- Exception ");
    }
    return 0;
}

std::string TInstanceSorter::GetFinalPropertyValue(const std::string& property,
                                                   boost::shared_ptr<ICIMInstance> instance) {
    std::string result;
    if (!instance) return result;
    try {
        TCIMContext context;
        boost::shared_ptr<ICIMProperty> prop = instance->GetProperty(property, context);
        if (!prop) return result;
        if (prop->IsArray(context)) {
            for (const std::string& element : prop->GetValueStrings()) result += element;
        } else {
            result = prop->GetValueString();
        }
    } catch (...) {
        result.clear();
    }
    return result;
}

void TInstanceSorter::PropertySplit(const std::string& value, std::vector<TToken>& tokens, bool lower) {
    tokens.clear();
    size_t i = 0;
    while (i < value.size()) {
        unsigned char c = static_cast<unsigned char>(value[i]);
        TToken token;
        token.second.number = 0;
        if (c >= '0' && c <= '9') {
            token.first = kNumberToken;
            std::uint64_t n = 0;  // an over-long run wraps around
            while (i < value.size() && value[i] >= '0' && value[i] <= '9') {
                n = n * 10 + static_cast<std::uint64_t>(value[i] - '0');
                ++i;
            }
            token.second.number = n;
        } else {
            token.first = kTextToken;
            while (i < value.size() && !(value[i] >= '0' && value[i] <= '9')) {
                unsigned char t = static_cast<unsigned char>(value[i]);
                token.second.text += lower ? static_cast<char>(std::tolower(t)) : static_cast<char>(t);
                ++i;
            }
        }
        tokens.push_back(token);
    }
}

namespace {

int CountDifference(size_t a, size_t b) {
    return static_cast<int>(a) - static_cast<int>(b);
}

// Byte-wise, unsigned, over the common length; then the longer text is the greater.
int CompareText(const std::string& a, const std::string& b) {
    size_t common = a.size() < b.size() ? a.size() : b.size();
    for (size_t i = 0; i < common; ++i) {
        unsigned char ca = static_cast<unsigned char>(a[i]);
        unsigned char cb = static_cast<unsigned char>(b[i]);
        if (ca != cb) return ca < cb ? -1 : 1;
    }
    long long diff = static_cast<long long>(a.size()) - static_cast<long long>(b.size());
    if (diff > INT_MAX) return INT_MAX;
    if (diff < INT_MIN) return INT_MIN;
    return static_cast<int>(diff);
}

}  // namespace

int TInstanceSorter::PropertyCompare(const std::string& a, const std::string& b, bool lower) {
    std::vector<TToken> ta;
    std::vector<TToken> tb;
    PropertySplit(a, ta, lower);
    PropertySplit(b, tb, lower);
    return CompareTokens(ta, tb);
}

int TInstanceSorter::CompareTokens(const std::vector<TToken>& ta, const std::vector<TToken>& tb) {
    if (ta.empty() || tb.empty()) return CountDifference(ta.size(), tb.size());

    for (size_t i = 0; i < ta.size() && i < tb.size(); ++i) {
        const TToken& x = ta[i];
        const TToken& y = tb[i];
        if (x.first != y.first) return x.first == kTextToken ? 1 : -1;  // numbers before text
        if (x.first == kNumberToken) {
            if (x.second.number != y.second.number) {
                // The difference taken as a signed number: two numbers more
                // than 2^63 apart compare the other way round.
                std::int64_t diff = static_cast<std::int64_t>(x.second.number - y.second.number);
                return diff < 1 ? -1 : 1;
            }
        } else {
            int r = CompareText(x.second.text, y.second.text);
            if (r != 0) return r;
        }
    }
    return CountDifference(ta.size(), tb.size());
}

bool TInstanceSorter::IsNumber(const std::string& text) {
    return text.find_first_not_of("0123456789") == std::string::npos;
}

bool TInstanceSorter::ThereisNumberic(const std::string& text) {
    for (char c : text) {
        if (std::isdigit(static_cast<unsigned char>(c))) return true;
    }
    return false;
}

std::string TInstanceSorter::uppercaseString(std::string& text) {
    std::string result(text);
    for (char& c : result) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
    return result;
}

void TInstanceSorter::TokenizeEmbeddedNumeric(std::string& text, std::vector<int>& numbers) {
    size_t i = 0;
    while (i < text.size()) {
        if (!std::isdigit(static_cast<unsigned char>(text[i]))) {
            ++i;
            continue;
        }
        size_t start = i;
        while (i < text.size() && std::isdigit(static_cast<unsigned char>(text[i]))) ++i;
        numbers.push_back(static_cast<int>(std::strtol(text.substr(start, i - start).c_str(), nullptr, 10)));
    }
}

}  // namespace braigrion
