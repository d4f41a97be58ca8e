// TCIMValue: typed parsing, conversions between types, text, equality.
#include <gtest/gtest.h>

#include <limits>

#include "tkrcore/tkrcore.h"

using namespace NORVTKR20;
typedef TCIMValue::TCIMType T;

namespace {

int StatusOf(const std::function<void()>& f) {
    try {
        f();
    } catch (const TTKRException& ex) {
        return ex.fStatusCode.fStatusCode;
    }
    return kSuccess;
}

}  // namespace

TEST(CIMValue, DefaultIsNullAndDistinctFromEmptyString) {
    TCIMValue null;
    TCIMValue empty("");
    EXPECT_TRUE(null.IsNull());
    EXPECT_FALSE(empty.IsNull());
    EXPECT_FALSE(null == empty);
    EXPECT_EQ("", null.ToString(10));
    EXPECT_EQ(kNullValue, StatusOf([&] { (void)static_cast<unsigned int>(null); }));
}

TEST(CIMValue, FromTextAcceptsWhatFitsTheType) {
    struct Case {
        T::ECIMType type;
        const char* text;
        const char* shown;
    } cases[] = {
        {T::eUint8, "255", "255"},       {T::eUint8, "0x1F", "31"},       {T::eSint8, "-128", "-128"},
        {T::eUint16, " 42 ", "42"},      {T::eSint32, "-2147483648", "-2147483648"},
        {T::eUint64, "18446744073709551615", "18446744073709551615"},     {T::eSint64, "+7", "7"},
        {T::eBoolean, "TRUE", "true"},   {T::eBoolean, "false", "false"}, {T::eReal64, "2.5", "2.5"},
        {T::eReal32, "0.1", "0.1"},      {T::eString, "  kept as is ", "  kept as is "},
        {T::eUint8, "101b", "5"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        TCIMValue v = TCIMValue::FromText(c.type, c.text);
        EXPECT_EQ(c.type, static_cast<T::ECIMType>(v.GetType()));
        EXPECT_EQ(c.shown, v.ToString(10));
    }
}

TEST(CIMValue, FromTextRejectsWhatDoesNotFit) {
    struct Case {
        T::ECIMType type;
        const char* text;
        int status;
    } cases[] = {
        {T::eUint8, "300", kOutOfRange},   {T::eUint8, "-1", kOutOfRange},      {T::eSint8, "128", kOutOfRange},
        {T::eUint32, "12ab", kTypeMismatch}, {T::eUint16, "", kTypeMismatch},   {T::eBoolean, "yes", kTypeMismatch},
        {T::eReal64, "1.2.3", kTypeMismatch}, {T::eDateTime, "2012-01-05", kTypeMismatch},
        {T::eSint64, "9223372036854775808", kOutOfRange},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        EXPECT_EQ(c.status, StatusOf([&] { TCIMValue::FromText(c.type, c.text); }));
    }
}

TEST(CIMValue, IntegerConversionsWidenAndCheckRange) {
    TCIMValue small = TCIMValue::Unsigned(T::eUint8, 200);
    EXPECT_EQ(200, static_cast<int>(small));
    EXPECT_EQ(200u, static_cast<unsigned short>(small));
    EXPECT_EQ(200ul, static_cast<unsigned long>(small));

    TCIMValue negative = TCIMValue::Signed(T::eSint32, -5);
    EXPECT_EQ(-5, static_cast<int>(negative));
    EXPECT_EQ(kOutOfRange, StatusOf([&] { (void)static_cast<unsigned int>(negative); }));

    TCIMValue big = TCIMValue::Unsigned(T::eUint32, 70000);
    EXPECT_EQ(kOutOfRange, StatusOf([&] { (void)static_cast<unsigned short>(big); }));

    // Text that spells a number converts, as collectors often store numbers as strings.
    EXPECT_EQ(2375, static_cast<int>(TCIMValue("2375")));
    EXPECT_EQ(kTypeMismatch, StatusOf([&] { (void)static_cast<int>(TCIMValue("N/A")); }));
    EXPECT_TRUE(static_cast<bool>(TCIMValue::Unsigned(T::eUint16, 3)));
}

TEST(CIMValue, ContractConstructorsCarryTheirTypes) {
    EXPECT_EQ(T::eUint16, static_cast<T::ECIMType>(TCIMValue(static_cast<unsigned short>(4)).GetType()));
    EXPECT_EQ(T::eUint32, static_cast<T::ECIMType>(TCIMValue(4u).GetType()));
    EXPECT_EQ(T::eString, static_cast<T::ECIMType>(TCIMValue("x").GetType()));
    EXPECT_EQ(T::eDateTime, static_cast<T::ECIMType>(TCIMValue(TCIMDateTime()).GetType()));
}

TEST(CIMValue, ArraysConvertToTheirElementVector) {
    TCIMValue arr = TCIMValue::Array(T::eUint16, {TCIMValue::Unsigned(T::eUint16, 2), TCIMValue::Unsigned(T::eUint16, 3)});
    ASSERT_TRUE(arr.IsArray());
    std::vector<TCIMValue>& elems = arr;
    ASSERT_EQ(2u, elems.size());
    EXPECT_EQ(3, static_cast<int>(elems[1]));
    EXPECT_EQ("2,3", arr.ToString(10));
    EXPECT_EQ(kTypeMismatch, StatusOf([&] { (void)static_cast<int>(arr); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([&] { std::vector<TCIMValue>& v = TCIMValue("x"); (void)v; }));

    TCIMValue copy = arr;
    static_cast<std::vector<TCIMValue>&>(copy).clear();
    EXPECT_EQ(2u, static_cast<std::vector<TCIMValue>&>(arr).size()) << "copies must not share elements";
}

TEST(CIMValue, EqualityComparesTypeAndContent) {
    EXPECT_TRUE(TCIMValue(5u) == TCIMValue(5u));
    EXPECT_FALSE(TCIMValue(5u) == TCIMValue(static_cast<unsigned short>(5)));
    EXPECT_FALSE(TCIMValue("a") == TCIMValue("A"));
    EXPECT_TRUE(TCIMValue::Null(T::eString) == TCIMValue::Null(T::eString));
}

TEST(CIMValue, ToStringHonoursRadix) {
    TCIMValue v = TCIMValue::Unsigned(T::eUint32, 255);
    EXPECT_EQ("255", v.ToString(10));
    EXPECT_EQ("ff", v.ToString(16));
    EXPECT_EQ("-10", TCIMValue::Signed(T::eSint16, -16).ToString(16));
}
