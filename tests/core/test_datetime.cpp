// CIM date-time text: timestamps, intervals and reduced precision.
#include <gtest/gtest.h>

#include "tkrcore/tkrcore.h"

using namespace NORVTKR20;

TEST(CIMDateTime, ParsesTheCIMFormsAndShowsThemForReaders) {
    struct Case {
        const char* cim;
        const char* ui;
        bool interval;
    } cases[] = {
        {"20120105000000.000000+000", "2012-01-05 00:00:00", false},
        {"20231130174502.123456-300", "2023-11-30 17:45:02", false},
        {"00000012034500.000000:000", "12 days 03:45:00", true},
        {"2012010512****.******+000", "2012-01-05 12:00:00", false},
        {"********101010.******:000", "0 days 10:10:10", true},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.cim);
        TCIMDateTime dt;
        ASSERT_TRUE(TCIMDateTime::Parse(c.cim, dt));
        EXPECT_EQ(c.ui, dt.ToUIString());
        EXPECT_EQ(c.interval, dt.IsInterval());
        EXPECT_EQ(c.cim, dt.ToCIMString()) << "the CIM form must survive a round trip";
    }
}

TEST(CIMDateTime, RejectsMalformedText) {
    const char* bad[] = {
        "",
        "2012-01-05 00:00:00",
        "20121305000000.000000+000",  // month 13
        "20120105250000.000000+000",  // hour 25
        "20120105000000.000000*000",  // bad sign
        "0000001203450.000000:000",   // too short
        "00000012034500.000000:001",  // interval must end in :000
        "2012*105000000.000000+000",  // a digit after a star
    };
    for (const char* text : bad) {
        TCIMDateTime dt;
        EXPECT_FALSE(TCIMDateTime::Parse(text, dt)) << text;
    }
}

TEST(CIMDateTime, ConstructorKeepsItsFieldsAndOffset) {
    TCIMDateTime dt(1999, 12, 31, 23, 59, 58, 5, -60);
    EXPECT_EQ("1999-12-31 23:59:58", dt.ToUIString());
    EXPECT_EQ("19991231235958.000005-060", dt.ToCIMString());
}
