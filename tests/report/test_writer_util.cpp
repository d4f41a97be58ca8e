// The text, duration and base64 helpers.
#include <cstdlib>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/TWriterUtil.h"

namespace braigrion {
namespace {

typedef std::vector<std::string> TWords;

TEST(TextHelpers, TidyCutAndPad) {
    const std::string s54(54, 'x');
    struct TCase {
        std::string got;
        std::string expected;
    } cases[] = {
        {TWriterUtil::EscapeString("a\\b\"c\nd\r"), "a\\\\b\\\"cd"},
        {TWriterUtil::BankTrimString("  a \n"), "a \n"},  // LF and CR at the end stay
        {TWriterUtil::BankTrimString("\t\r\n x \t"), "x"},
        {TWriterUtil::TruncString(s54), s54},
        {TWriterUtil::TruncString(s54 + "yz"), s54 + "..."},
        {TWriterUtil::TruncString("abcdef", 3), "abc..."},
        {TWriterUtil::TruncString("abcdef", 6), "abcdef"},  // only lengths up to size - 1 cut
        {TWriterUtil::TruncString("abcdef", -1), "abcdef"},
        {TWriterUtil::PadString("ab\tc", 5, false), "abc  "},
        {TWriterUtil::PadString("  a\nb", 4, true), "ab  "},
        {TWriterUtil::PadString("abcdef", 3, false), "abc..."},  // three longer than the width
        {TWriterUtil::IntToStr(255, 16), "FF"},
        {TWriterUtil::IntToStr(0, 10), "0"},
        {TWriterUtil::IntToStr(-1, 10), ""},
        {TWriterUtil::IntToStr(5, 17), ""},
        {TWriterUtil::IntToStr(5, 1), ""},
    };
    for (size_t i = 0; i < sizeof cases / sizeof cases[0]; ++i) EXPECT_EQ(cases[i].expected, cases[i].got) << "case " << i;
}

TEST(TextHelpers, WordsAndNumbers) {
    TWords words{"left over"};
    TWriterUtil::DivideStrToWords("  12  hour 3\tx ", words);
    EXPECT_EQ((TWords{"12", "hour", "3\tx"}), words);

    struct TNumber {
        std::string text;
        int value;
    } numbers[] = {{"abc123def45", 123}, {"-7 apples", 7}, {"none", 0}};
    for (TNumber& n : numbers) EXPECT_EQ(n.value, TWriterUtil::GetNumberInString(n.text)) << n.text;

    struct TLength {
        int value;
        int base;
        int digits;
    } lengths[] = {{255, 16, 2}, {256, 16, 3}, {0, 10, 1}, {8, 2, 4}, {-5, 10, -1}, {7, 20, -1}};
    for (const TLength& l : lengths) EXPECT_EQ(l.digits, TWriterUtil::GetLenOfInt(l.value, l.base)) << l.value;
}

TEST(Durations, CarryForwardAndTotalInMilliseconds) {
    struct TCase {
        std::string text;
        TWords carried;  // hours, minutes, seconds, milliseconds
        unsigned int total;
    } cases[] = {
        {"1 hour 2 minute 3 second 4 millisecond", {"1", "2", "3", "4"}, 3723004u},
        {"90 minute", {"1", "30", "0", "0"}, 5400000u},
        {"1500 milliseconds 59 seconds", {"0", "1", "0", "500"}, 60500u},
        {"5 fortnights", {"0", "0", "0", "0"}, 0u},  // an unknown unit is passed over
    };
    for (const TCase& c : cases) {
        TWords words;
        TWriterUtil::DivideStrToWords(c.text, words);
        RunDuration duration;
        duration.SetValue(words);
        duration.ForwardCarry();
        EXPECT_EQ(c.carried, (TWords{duration.fHours, duration.fMinutes, duration.fSeconds, duration.fMilliseconds}))
            << c.text;
        EXPECT_EQ(c.total, duration.Calculate()) << c.text;
    }
}

TEST(Durations, ProcessFiguresBecomePlainNumbers) {
    struct TCase {
        std::string value;
        std::string property;
        std::string expected;
    } cases[] = {
        {"0 hour 0 minute 1 second 250 millisecond", "KernelModeTime", "1250"},
        {"2 minute 0 second", "UserModeTime", "120000"},
        {"2048 Kilobytes", "WorkingSetSize", "2048"},
        {"12.5 Megabytes", "WorkingSetSize", "12500"},
        {"3 Megabytes", "WorkingSetSize", "3000"},
        {"1.23456 Megabytes", "WorkingSetSize", "1234.56"},
        {"0.5 Megabytes", "WorkingSetSize", "500"},
        {"7 Gigabytes", "WorkingSetSize", "0"},
        {"12.5 Megabytes", "Name", "12.5 Megabytes"},
    };
    for (const TCase& c : cases) {
        EXPECT_EQ(c.expected, TWriterUtil::ConvertStrToNumType(c.value, c.property)) << c.property << ": " << c.value;
    }
}

std::string Encode(const std::string& data, int& length) {
    char* out = nullptr;
    EXPECT_NE(0, base64_encode(data.data(), static_cast<int>(data.size()), &out, &length));
    std::string text(out);
    std::free(out);
    return text;
}

std::string Decode(const std::string& text, int& length) {
    char* out = nullptr;
    EXPECT_NE(0, base64_decode(text.data(), static_cast<int>(text.size()), &out, length));
    EXPECT_EQ('\0', out[length]);
    std::string data(out, static_cast<size_t>(length));
    std::free(out);
    return data;
}

TEST(Base64, EncodesAndDecodesWithTheStandardAlphabet) {
    struct TCase {
        std::string data;
        std::string text;
    } cases[] = {
        {"", ""}, {"M", "TQ=="}, {"Ma", "TWE="}, {"Man", "TWFu"}, {std::string("\0\xff\xfe?", 4), "AP/+Pw=="},
    };
    for (const TCase& c : cases) {
        int length = 0;
        EXPECT_EQ(c.text, Encode(c.data, length));
        EXPECT_EQ(static_cast<int>(c.text.size()) + 1, length);  // the terminator counts
        EXPECT_EQ(c.data, Decode(c.text, length));
        EXPECT_EQ(static_cast<int>(c.data.size()), length);  // it does not here
    }
    // Line breaks in encoded text are stepped over.
    int length = 0;
    EXPECT_EQ("Man Man", Decode("TWFu\r\nIE1h\nbg==", length));
}

}  // namespace
}  // namespace braigrion
