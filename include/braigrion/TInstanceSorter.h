// The sort keys of a report table and the comparison by which its instances
// are put in order. Values compare in natural order: runs of digits compare
// as numbers, the text between them without regard to case, so that
// "Slot 9" comes before "Slot 10".
#pragma once

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TInstanceSorter {
public:
    // One sort key.
    struct TPropertyInfo {
        std::string Property;  // property that gives the key
        bool Ascending;        // false: descending
        bool Numeric;          // kept with the key; the comparison does not consult it
        bool IgnoreCase;       // kept with the key; every comparison ignores case anyway
    };

    // A token of a split value: a run of digits or a run of other bytes.
    enum _type { kNumberToken = 0, kTextToken = 1 };
    struct _value {
        std::uint64_t number;  // 0 for a text token
        std::string text;      // empty for a number token
    };
    typedef std::pair<_type, _value> TToken;

    TInstanceSorter() {}

    // Appends a key. The three-argument form leaves IgnoreCase false.
    void AddProperty(std::string property, bool ascending, bool numeric);
    void AddProperty(std::string property, bool ascending, bool numeric, bool ignoreCase);
    bool IsEmpty() const { return fProperties.empty(); }
    void Reset() { fProperties.clear(); }
    const std::vector<TPropertyInfo>& GetProperties() const { return fProperties; }

    // Strict ordering: true when `a` goes before `b`. Keys are tried in the
    // order of their addition; a key on which both tie hands over to the next.
    bool operator()(boost::shared_ptr<NORVTKR20::ICIMInstance> a,
                    boost::shared_ptr<NORVTKR20::ICIMInstance> b) const;
    // -1, 0 or 1 for one key; any failure counts as a tie.
    int Compare(const TPropertyInfo& key, boost::shared_ptr<NORVTKR20::ICIMInstance> a,
                boost::shared_ptr<NORVTKR20::ICIMInstance> b) const;

    // Text of a property for sorting: array elements joined without a
    // separator; "" for a missing instance, a missing property or a failure.
    static std::string GetFinalPropertyValue(const std::string& property,
                                             boost::shared_ptr<NORVTKR20::ICIMInstance> instance);
    // Negative, zero or positive as `a` sorts before, with or after `b`.
    static int PropertyCompare(const std::string& a, const std::string& b, bool lower);
    static void PropertySplit(const std::string& value, std::vector<TToken>& tokens, bool lower);
    // PropertyCompare on values already split.
    static int CompareTokens(const std::vector<TToken>& a, const std::vector<TToken>& b);

    // Helpers kept for callers outside the report.
    static bool IsNumber(const std::string& text);            // no byte outside '0'-'9'; true for ""
    static bool ThereisNumberic(const std::string& text);     // some byte is a digit
    static std::string uppercaseString(std::string& text);    // upper-cased copy
    static void TokenizeEmbeddedNumeric(std::string& text, std::vector<int>& numbers);

private:
    std::vector<TPropertyInfo> fProperties;
};

}  // namespace braigrion
