// Stateless helpers of the report logic: text tidying, durations, the number
// forms of process figures, the fetching of a table's instances and of the
// properties behind a column, and base64. Every operation is static and uses
// no member data, so a caller may use the class name or a local object.
#pragma once

#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TReportClass.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TWriterUtil {
public:
    typedef boost::shared_ptr<NORVTKR20::ICIMNamespace> TNamespacePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMInstance> TInstancePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMProperty> TPropertyPtr;
    typedef boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> TPropertyDeclPtr;

    TWriterUtil() {}

    // --- Text ---

    // Doubles each backslash, puts a backslash before each double quote,
    // then removes every line feed and carriage return.
    static std::string EscapeString(std::string text);
    // Removes blanks, tabs, LF and CR at the front, blanks and tabs at the
    // end; a LF or CR at the end stays.
    static std::string BankTrimString(std::string text);
    // More than 54 characters: the first 54 and "...".
    static std::string TruncString(std::string text);
    // `length` from 0 to size - 1: the first `length` characters and "...";
    // any other length leaves the text alone.
    static std::string TruncString(std::string text, int length);
    // Without LF and tabs (and leading blanks with `trimLeft`); a longer text
    // is cut by TruncString(text, width), a shorter one filled with blanks.
    static std::string PadString(std::string text, int width, bool trimLeft);
    // The blank-separated words of `text`; runs of blanks give no empty word.
    static void DivideStrToWords(std::string text, std::vector<std::string>& words);
    // The first run of digits as a number; 0 when there is none.
    static int GetNumberInString(std::string& text);
    // Digits of a non-negative value in base 2 to 16 ("A" to "F" above 9);
    // "" for a negative value or another base.
    static std::string IntToStr(int value, int base);
    // Number of digits of IntToStr(value, base); -1 where that gives "".
    static int GetLenOfInt(int value, int base);
    // The figures of a process as plain numbers: "KernelModeTime" and
    // "UserModeTime" ("1 hour 2 minute ...") in milliseconds,
    // "WorkingSetSize" ("12.5 Megabytes") in kilobytes. Other properties'
    // values are returned as they are.
    static std::string ConvertStrToNumType(std::string value, std::string property);

    // --- Repository ---

    // The properties behind a column: the instance's own property, or with
    // an association that property on each associated instance of
    // `assocTarget` that has it. A missing property or class gives nothing.
    static std::vector<TPropertyPtr> GetProperties(TInstancePtr instance, const std::string& property,
                                                   const std::string& assocClass, const std::string& assocTarget);
    // Display text of a date-time value, or of each element of an array of
    // them joined by " "; "" for a null value. `noTimePrecision` has no
    // effect on the text.
    static std::string GetDateTime(const NORVTKR20::TCIMValue& value, bool noTimePrecision);
    // The declaration's "DisplayName" qualifier, or its name without one.
    static std::string GetDisplayName(TPropertyDeclPtr declaration);
    // True when the property holds no value or the instance lacks it.
    static bool IsPropertyNull(TInstancePtr instance, std::string property);
    // The instances of a table's class that pass its filters, in the order of
    // its sort keys (repository order without keys). A class the collection
    // lacks gives no instance.
    static std::vector<TInstancePtr> GetInstances(TNamespacePtr ns, TReportClass reportClass);
    // Whether an instance passes every filter of a table: its filter
    // property must exist, hold a value, and hold the filter text (or, for
    // an excluding filter, not hold it).
    static bool PassesFilters(TInstancePtr instance, const TReportClass& reportClass);
    // Puts instances in the order of the sorter's keys, reading each sort
    // text once. `stable` keeps ties in their order; otherwise their order
    // is the unstable sort's. Throws what the sort throws and then leaves
    // `instances` as it was.
    static void SortInstances(std::vector<TInstancePtr>& instances, const TInstanceSorter& sorter, bool stable);
};

// A duration given as words ("1 hour 2 minute 3 second 4 millisecond"),
// kept as decimal texts.
class RunDuration {
public:
    RunDuration() : fHours("0"), fMinutes("0"), fSeconds("0"), fMilliseconds("0") {}

    // Takes pairs of number and unit. An empty list changes nothing;
    // otherwise a unit not given becomes "0".
    void SetValue(std::vector<std::string>& words);
    // Carries milliseconds into seconds, seconds into minutes, minutes into
    // hours.
    void ForwardCarry();
    // The whole duration in milliseconds.
    unsigned int Calculate();

    std::string fHours;
    std::string fMinutes;
    std::string fSeconds;
    std::string fMilliseconds;
};

// Base64 with the standard alphabet and "=" padding. The result is
// allocated with malloc, zero-terminated and owned by the caller, who frees
// it with free. Both return 0, with nothing allocated, when memory runs out.
// `outputLength` of the encoder counts the terminator; that of the decoder
// does not.
int base64_encode(const char* input, int length, char** output, int* outputLength);
int base64_decode(const char* input, int length, char** output, int& outputLength);

}  // namespace braigrion
