// Object paths: parsing, text form, key bindings and matching.
#include <gtest/gtest.h>

#include <map>

#include "tkrcore/tkrcore.h"

using namespace NORVTKR20;

TEST(CIMReference, ParsesPathFormsAndWritesKeysInNameOrder) {
    struct Case {
        const char* text;
        const char* host;
        const char* ns;
        const char* path;
    } cases[] = {
        {"CIM_Fan.DeviceID=\"FAN 1\",CreationClassName=\"CIM_Fan\"", "", "",
         "CIM_Fan.CreationClassName=\"CIM_Fan\",DeviceID=\"FAN 1\""},
        {"//srv01/root/cimv2:CIM_Slot.Number=9", "srv01", "root/cimv2", "CIM_Slot.Number=9"},
        {"root/emc:EMC_Disk.Tag=\"a,b=\\\"c\\\"\"", "", "root/emc", "EMC_Disk.Tag=\"a,b=\\\"c\\\"\""},
        {"ORVSG_CollectionInfo", "", "", "ORVSG_CollectionInfo"},
        {"X.Flag=TRUE,Neg=-3", "", "", "X.Flag=TRUE,Neg=-3"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.text);
        TCIMReference ref;
        ASSERT_TRUE(TCIMReference::ParsePath(c.text, ref));
        EXPECT_EQ(c.host, ref.GetHost());
        EXPECT_EQ(c.ns, ref.GetNamespacePath());
        EXPECT_EQ(c.path, ref.GetPath());
        TCIMReference again;
        ASSERT_TRUE(TCIMReference::ParsePath(ref.GetPath(), again));
        EXPECT_TRUE(again == ref);
    }
    for (const char* bad : {"", ".Key=1", "Class.Key", "Class.Key=\"open", "Cl ass.K=1", "Class.K=1;"}) {
        TCIMReference ref;
        EXPECT_FALSE(TCIMReference::ParsePath(bad, ref)) << bad;
    }
}

TEST(CIMReference, KeyBindingsEnumerateIntoAMapAndCanStopEarly) {
    TCIMReference ref(boost::shared_ptr<ICIMNamespace>(), "CIM_Fan", TCIMContext());
    ref.AddKeyValue("DeviceID", TCIMValue("FAN 1"));
    ref.AddKeyValue("SystemName", TCIMValue("srv01"));
    std::map<std::string, TCIMValue> keys;
    ref.EnumerateKeyBindings(TAddKeyBindingsToMapCallback(keys));
    EXPECT_EQ(2u, keys.size());
    EXPECT_EQ("srv01", keys["SystemName"].ToString(10));

    int seen = 0;
    ref.EnumerateKeyBindings([&](std::pair<std::string, TCIMValue>) { return ++seen < 1; });
    EXPECT_EQ(1, seen);
}

TEST(CIMReference, ConstructorTakesAWholePathAsWellAsAClassName) {
    TCIMContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(2));
    TCIMReference ref(boost::shared_ptr<ICIMNamespace>(), "CIM_Slot.Number=10", context);
    EXPECT_EQ("CIM_Slot", ref.GetClassName());
    EXPECT_EQ("CIM_Slot.Number=10", ref.GetPath());
    EXPECT_EQ(2, static_cast<int>(ref.GetContext().at("nsIndex")));
    // Without a namespace nothing resolves; asking leniently gives nothing.
    EXPECT_FALSE(ref.GetCIMElement(false));
    EXPECT_THROW(ref.GetCIMElement(true), TTKRException);
}

TEST(CIMReference, KeyValuesCompareByMeaning) {
    typedef TCIMValue::TCIMType T;
    EXPECT_TRUE(KeyValuesEqual(TCIMValue::Unsigned(T::eUint64, 9), TCIMValue::Unsigned(T::eUint16, 9)));
    EXPECT_TRUE(KeyValuesEqual(TCIMValue("9"), TCIMValue::Unsigned(T::eUint8, 9)));
    EXPECT_TRUE(KeyValuesEqual(TCIMValue::Boolean(true), TCIMValue("TRUE")));
    EXPECT_FALSE(KeyValuesEqual(TCIMValue("Slot 9"), TCIMValue("slot 9")));
    EXPECT_FALSE(KeyValuesEqual(TCIMValue("x"), TCIMValue()));
}
