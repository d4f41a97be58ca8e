// The text, duration and base64 helpers, and the composition of the page
// heads from their pieces.
#include <cstdlib>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "braigrion/ReportDefinition.h"
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
        {TWriterUtil::TruncString("abcdef", 0), "..."},
        {TWriterUtil::TruncString("abcdef", 6), "abcdef"},  // only lengths up to size - 1 cut
        {TWriterUtil::TruncString("abcdef", -1), "abcdef"},
        {TWriterUtil::TruncString("", 0), ""},
        {TWriterUtil::PadString("ab\tc", 5, false), "abc  "},
        {TWriterUtil::PadString("  a\nb", 4, true), "ab  "},
        {TWriterUtil::PadString("  ab", 4, false), "  ab"},
        {TWriterUtil::PadString("abcdef", 3, false), "abc..."},  // three longer than the width
        {TWriterUtil::IntToStr(255, 16), "FF"},
        {TWriterUtil::IntToStr(0, 10), "0"},
        {TWriterUtil::IntToStr(-1, 10), ""},
        {TWriterUtil::IntToStr(5, 17), ""},
        {TWriterUtil::IntToStr(5, 1), ""},
    };
    for (size_t i = 0; i < sizeof cases / sizeof cases[0]; ++i) EXPECT_EQ(cases[i].expected, cases[i].got) << "case " << i;
    EXPECT_EQ(57u, TWriterUtil::TruncString(std::string(55, 'x')).size());
}

TEST(TextHelpers, WordsAndNumbers) {
    TWords words{"left over"};
    TWriterUtil::DivideStrToWords("  12  hour 3\tx ", words);
    EXPECT_EQ((TWords{"12", "hour", "3\tx"}), words);
    TWriterUtil::DivideStrToWords("", words);
    EXPECT_TRUE(words.empty());

    struct TNumber {
        std::string text;
        int value;
    } numbers[] = {{"abc123def45", 123}, {"-7 apples", 7}, {"none", 0}, {"", 0}, {"0042", 42}};
    for (TNumber& n : numbers) EXPECT_EQ(n.value, TWriterUtil::GetNumberInString(n.text)) << n.text;

    struct TLength {
        int value;
        int base;
        int digits;
    } lengths[] = {{255, 16, 2}, {256, 16, 3}, {0, 10, 1}, {99, 10, 2}, {100, 10, 3}, {8, 2, 4}, {-5, 10, -1}, {7, 20, -1}};
    for (const TLength& l : lengths) {
        EXPECT_EQ(l.digits, TWriterUtil::GetLenOfInt(l.value, l.base)) << l.value << " base " << l.base;
        if (l.digits > 0) {
            EXPECT_EQ(static_cast<size_t>(l.digits), TWriterUtil::IntToStr(l.value, l.base).size());
        }
    }
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
        {"2 hours 61 minutes", {"3", "1", "0", "0"}, 10860000u},
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

    RunDuration kept;
    kept.fMinutes = "7";
    TWords none;
    kept.SetValue(none);
    EXPECT_EQ("7", kept.fMinutes);  // an empty list changes nothing
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
        {"7", "WorkingSetSize", "0"},
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
        {"", ""},
        {"M", "TQ=="},
        {"Ma", "TWE="},
        {"Man", "TWFu"},
        {std::string("\0\xff\xfe?", 4), "AP/+Pw=="},
        {"any carnal pleasure.", "YW55IGNhcm5hbCBwbGVhc3VyZS4="},
    };
    for (const TCase& c : cases) {
        int length = 0;
        EXPECT_EQ(c.text, Encode(c.data, length));
        EXPECT_EQ(static_cast<int>(c.text.size()) + 1, length);  // the terminator counts
        EXPECT_EQ(c.data, Decode(c.text, length));
        EXPECT_EQ(static_cast<int>(c.data.size()), length);  // it does not here
    }
    int length = 0;
    EXPECT_EQ("Ma", Decode("TWE=", length));
    EXPECT_EQ(2, length);
    // Line breaks in encoded text are stepped over.
    EXPECT_EQ("Man Man", Decode("TWFu\r\nIE1h\nbg==", length));
}

TEST(MarkupConstants, PageHeadsAreComposedInTheirOrder) {
    using namespace TKR_REPORT_DEFINITION;
    const std::string comment = "<!-- saved from url=(0024)https://www.example.com/ -->\r\n";
    const std::string meta = "<meta content=\"text/html; charset=utf-8\" http-equiv=\"Content-Type\">\n";
    const std::string body = "<body bgcolor=\"#ffffff\">\n";

    // The sorting head differs from the plain one by the comment alone.
    std::string sortHeader = kHtmlSortHeader;
    ASSERT_NE(std::string::npos, sortHeader.find(comment));
    EXPECT_EQ(kHtmlHeader, sortHeader.erase(sortHeader.find(comment), comment.size()));

    // The UTF-8 heads: the sorting one puts the meta line ahead of the
    // comment, the plain one behind the body line.
    EXPECT_LT(kHtmlSortHeaderUTF8.find(meta), kHtmlSortHeaderUTF8.find(comment));
    EXPECT_GT(kHtmlHeaderUTF8.find(meta), kHtmlHeaderUTF8.find(body));
    EXPECT_EQ("<html>\n<head>\n" + body + meta + "</head>\n<link href=\"global.css\" rel=\"stylesheet\" type=\"text/css\">\n",
              kHtmlHeaderUTF8);

    // The inventory writer's sorting heads keep the plain body line.
    EXPECT_EQ(std::string::npos, kHtmlSortHeader_Inventory.find("oncontextmenu"));
    EXPECT_NE(std::string::npos, kHtmlHeader_Inventory.find("oncontextmenu"));
    EXPECT_NE(std::string::npos, kHtmlSortHeaderUTF8_Inventory.find("\"global_GUI.css\""));
    EXPECT_NE(std::string::npos, kHtmlIndexHeader_Inventory.find("\"global_GUI.css\" rel=\"stylesheet\" type=\"text/css\"></link>\n"));
    EXPECT_EQ("", kHtmlIndexLine);
}

}  // namespace
}  // namespace braigrion
