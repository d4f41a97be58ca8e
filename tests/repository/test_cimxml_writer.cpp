// The CIM-XML writer: what it saves reads back as the same collection, in
// both document forms, and the documents follow the CIM-XML declarations.

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <tuple>
#include <vector>

#include <gtest/gtest.h>

#include "repository/CIMXMLReader.h"
#include "repository/CIMXMLWriter.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace {

using namespace braigrion::repository;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType T;

const char kCollection[] = R"(<?xml version="1.0" encoding="utf-8"?>
<CIM CIMVERSION="2.0" DTDVERSION="2.0"><DECLARATION><DECLGROUP>
<QUALIFIER.DECLARATION NAME="Key" TYPE="boolean" OVERRIDABLE="false"><SCOPE PROPERTY="true" REFERENCE="true"/><VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>
<QUALIFIER.DECLARATION NAME="ValueMap" TYPE="string" ISARRAY="true" ARRAYSIZE="8" TOSUBCLASS="false" TRANSLATABLE="true"><SCOPE CLASS="true" ASSOCIATION="true" REFERENCE="true" PROPERTY="true" METHOD="true" PARAMETER="true" INDICATION="true"/></QUALIFIER.DECLARATION>
<VALUE.OBJECT><CLASS NAME="X_Device" SUPERCLASS="X_Element">
 <QUALIFIER NAME="Description" TYPE="string" TOINSTANCE="true"><VALUE>A device &lt;of sorts&gt; &amp; more</VALUE></QUALIFIER>
 <PROPERTY NAME="DeviceID" TYPE="string" CLASSORIGIN="X_Device"><QUALIFIER NAME="Key" TYPE="boolean" OVERRIDABLE="false"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
 <PROPERTY.ARRAY NAME="Codes" TYPE="uint16" ARRAYSIZE="3"><QUALIFIER NAME="ValueMap" TYPE="string"><VALUE.ARRAY><VALUE>1</VALUE><VALUE>2</VALUE></VALUE.ARRAY></QUALIFIER><VALUE.ARRAY><VALUE>1</VALUE><VALUE.NULL/></VALUE.ARRAY></PROPERTY.ARRAY>
 <PROPERTY NAME="Job" TYPE="string" EmbeddedObject="object" PROPAGATED="true"/>
 <PROPERTY NAME="Seen" TYPE="datetime"><VALUE>20240102030405.123456-300</VALUE></PROPERTY>
</CLASS></VALUE.OBJECT>
<VALUE.OBJECT><CLASS NAME="X_Element"><PROPERTY NAME="Caption" TYPE="string"/></CLASS></VALUE.OBJECT>
<VALUE.OBJECT><CLASS NAME="X_InSystem"><PROPERTY.REFERENCE NAME="Device" REFERENCECLASS="X_Device"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE>
 <PROPERTY.REFERENCE NAME="System" REFERENCECLASS="X_System"><QUALIFIER NAME="Key" TYPE="boolean"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE></CLASS></VALUE.OBJECT>
<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="X_Device"><KEYBINDING NAME="DeviceID"><KEYVALUE>dev 1</KEYVALUE></KEYBINDING></INSTANCENAME>
 <INSTANCE CLASSNAME="X_Device"><PROPERTY NAME="Caption" TYPE="string"><VALUE>first</VALUE></PROPERTY>
  <PROPERTY NAME="DeviceID" TYPE="string"><VALUE>dev 1</VALUE></PROPERTY>
  <PROPERTY.ARRAY NAME="Codes" TYPE="uint16"><VALUE.ARRAY><VALUE>7</VALUE><VALUE.NULL/><VALUE>9</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>
  <PROPERTY NAME="Job" TYPE="string" EmbeddedObject="object"><VALUE>&lt;INSTANCE CLASSNAME="X_Job"&gt;&lt;/INSTANCE&gt;</VALUE></PROPERTY>
  <PROPERTY NAME="Seen" TYPE="datetime"><VALUE>00000001020304.000005:000</VALUE></PROPERTY></INSTANCE>
</VALUE.NAMEDINSTANCE>
<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="X_Device"><KEYBINDING NAME="DeviceID"><KEYVALUE>dev 2</KEYVALUE></KEYBINDING></INSTANCENAME>
 <INSTANCE CLASSNAME="X_Device"><PROPERTY NAME="DeviceID" TYPE="string"><VALUE>dev 2</VALUE></PROPERTY><PROPERTY NAME="Seen" TYPE="datetime"/></INSTANCE>
</VALUE.NAMEDINSTANCE>
<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="X_InSystem">
  <KEYBINDING NAME="Device"><VALUE.REFERENCE><INSTANCENAME CLASSNAME="X_Device"><KEYBINDING NAME="DeviceID"><KEYVALUE>dev 1</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></KEYBINDING>
  <KEYBINDING NAME="System"><VALUE.REFERENCE><INSTANCEPATH><NAMESPACEPATH><HOST>h1</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="x"/></LOCALNAMESPACEPATH></NAMESPACEPATH><INSTANCENAME CLASSNAME="X_System"><KEYBINDING NAME="Name"><KEYVALUE>s</KEYVALUE></KEYBINDING><KEYBINDING NAME="Slot"><KEYVALUE VALUETYPE="numeric" TYPE="uint8">3</KEYVALUE></KEYBINDING></INSTANCENAME></INSTANCEPATH></VALUE.REFERENCE></KEYBINDING></INSTANCENAME>
 <INSTANCE CLASSNAME="X_InSystem">
  <PROPERTY.REFERENCE NAME="Device"><VALUE.REFERENCE><LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/></LOCALNAMESPACEPATH><INSTANCENAME CLASSNAME="X_Device"><KEYBINDING NAME="DeviceID"><KEYVALUE>dev 1</KEYVALUE></KEYBINDING></INSTANCENAME></LOCALINSTANCEPATH></VALUE.REFERENCE></PROPERTY.REFERENCE>
  <PROPERTY.REFERENCE NAME="System"><VALUE.REFERENCE><INSTANCEPATH><NAMESPACEPATH><HOST>h1</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="x"/></LOCALNAMESPACEPATH></NAMESPACEPATH><INSTANCENAME CLASSNAME="X_System"><KEYBINDING NAME="Name"><KEYVALUE>s</KEYVALUE></KEYBINDING><KEYBINDING NAME="Slot"><KEYVALUE VALUETYPE="numeric" TYPE="uint8">3</KEYVALUE></KEYBINDING></INSTANCENAME></INSTANCEPATH></VALUE.REFERENCE></PROPERTY.REFERENCE>
 </INSTANCE></VALUE.NAMEDINSTANCE>
<VALUE.OBJECT><INSTANCE CLASSNAME="X_Loose"><PROPERTY NAME="N" TYPE="sint16"><VALUE>-5</VALUE></PROPERTY><PROPERTY NAME="R" TYPE="real64"><VALUE>0.1</VALUE></PROPERTY>
 <PROPERTY NAME="B" TYPE="boolean"><VALUE>FALSE</VALUE></PROPERTY><PROPERTY NAME="C" TYPE="char16"><VALUE>é</VALUE></PROPERTY>
 <PROPERTY NAME="F" TYPE="real32"><VALUE>3.25</VALUE></PROPERTY><PROPERTY NAME="Big" TYPE="uint64"><VALUE>18446744073709551615</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>
</DECLGROUP></DECLARATION></CIM>
)";

// Text that takes every escaping path: markup characters, quotes, a carriage
// return, line breaks inside and at the ends, tabs, non-ASCII.
const std::string kAwkward = "\n <a href=\"x\">&amp;</a>\r\n\tline two ]]> \xC3\xA9\xE2\x82\xAC\xF0\x9F\x99\x82\t\n";

TPropertyValue Prop(const std::string& name, const TCIMValue& value) {
    TPropertyValue p;
    p.fName = name;
    p.fValue = value;
    p.fType = static_cast<T::ECIMType>(value.GetType());
    return p;
}

boost::shared_ptr<TMemoryNamespace> Collection() {
    boost::shared_ptr<TMemoryNamespace> ns = LoadCollectionFromString(kCollection, "collection.xml").fNamespace;
    ns->AddInstance("X_Loose", {Prop("Text", TCIMValue(kAwkward)), Prop("Nothing", TCIMValue::Null(T::eSint64))});
    ns->Link();
    return ns;
}

std::string Write(const TMemoryNamespace& ns, EWriteForm form) {
    std::ostringstream out;
    WriteCollection(ns, out, form);
    return out.str();
}

// Every field of a schema element, for comparing two of them whole.
auto Fields(const TQualifierData& q) {
    return std::tie(q.fName, q.fValue, q.fPropagated, q.fToSubclass, q.fOverridable, q.fToInstance, q.fTranslatable);
}
auto Fields(const TQualifierTypeData& q) {
    return std::tie(q.fName, q.fType, q.fIsArray, q.fArraySize, q.fDefault, q.fScopes, q.fToSubclass, q.fOverridable,
                    q.fToInstance, q.fTranslatable);
}
auto Fields(const TPropertyDeclData& p) {
    return std::tie(p.fName, p.fType, p.fIsArray, p.fArraySize, p.fReferenceClass, p.fClassOrigin, p.fPropagated,
                    p.fEmbeddedObject, p.fDefault);
}
template <typename TData>
bool Same(const std::vector<TData>& a, const std::vector<TData>& b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [](const TData& x, const TData& y) { return Fields(x) == Fields(y); });
}

void ExpectSameCollection(TMemoryNamespace& a, TMemoryNamespace& b) {
    EXPECT_TRUE(Same(a.GetQualifierTypes(), b.GetQualifierTypes()));
    ASSERT_EQ(a.GetClasses().size(), b.GetClasses().size());
    for (const TMemoryClass* ca : a.GetClasses()) {
        const std::string& name = ca->GetName();
        const TMemoryClass* cb = b.FindClass(name);
        ASSERT_TRUE(cb) << name;
        EXPECT_EQ(ca->IsDeclared(), cb->IsDeclared()) << name;
        EXPECT_EQ(ca->GetKeyNames(), cb->GetKeyNames()) << name;
        const TClassData& da = ca->GetDeclaration();
        const TClassData& db = cb->GetDeclaration();
        EXPECT_EQ(da.fSuperClass, db.fSuperClass) << name;
        EXPECT_TRUE(Same(da.fQualifiers, db.fQualifiers)) << name;
        ASSERT_TRUE(Same(da.fProperties, db.fProperties)) << name;
        for (size_t k = 0; k < da.fProperties.size(); ++k) {
            EXPECT_TRUE(Same(da.fProperties[k].fQualifiers, db.fProperties[k].fQualifiers)) << name << k;
        }
        const auto ia = ca->GetInstances();
        const auto ib = cb->GetInstances();
        ASSERT_EQ(ia.size(), ib.size()) << name;
        for (size_t k = 0; k < ia.size(); ++k) {
            const auto& sa = ia[k]->GetSlots();
            const auto& sb = ib[k]->GetSlots();
            ASSERT_EQ(sa.size(), sb.size()) << name << " #" << k;
            for (size_t s = 0; s < sa.size(); ++s) {
                const std::string& prop = ca->GetProperties()[sa[s].fDecl]->GetName();
                EXPECT_EQ(prop, cb->GetProperties()[sb[s].fDecl]->GetName());
                EXPECT_EQ(sa[s].fValue, sb[s].fValue) << name << " #" << k << " " << prop;
                // References compare by class and keys: host and namespace apart.
                if (!sa[s].fValue.IsNull() && !sa[s].fValue.IsArray() && sa[s].fValue.GetType() == T::eReference) {
                    const TCIMReference ra = sa[s].fValue, rb = sb[s].fValue;
                    EXPECT_EQ(ra.GetHost() + " " + ra.GetNamespacePath(), rb.GetHost() + " " + rb.GetNamespacePath());
                }
            }
            EXPECT_EQ(ia[k]->GetPath({}), ib[k]->GetPath({})) << name << " #" << k;
        }
    }
}

TEST(CIMXMLWriter, ReadingBackGivesTheSameCollectionInBothForms) {
    boost::shared_ptr<TMemoryNamespace> original = Collection();
    for (EWriteForm form : {EWriteForm::kWithName, EWriteForm::kWithPath}) {
        SCOPED_TRACE(form == EWriteForm::kWithName ? "with name" : "with path");
        const std::string written = Write(*original, form);
        TLoadResult again = LoadCollectionFromString(written, "written.xml");
        EXPECT_TRUE(again.fWarnings.empty());
        EXPECT_NE(written.find("&#13;"), std::string::npos) << "a carriage return is a reference";
        ExpectSameCollection(*original, *again.fNamespace);
        // Writing what was read gives the very same document.
        EXPECT_EQ(Write(*again.fNamespace, form), written);

        // References still resolve in the collection read back.
        TMemoryClass* link = again.fNamespace->FindClass("X_InSystem");
        const TCIMReference device = link->GetInstances().at(0)->FindSlot("Device")->fValue;
        EXPECT_TRUE(device.GetCIMElement(false));
    }
}

// The awkward text itself survives the round trip above.
TEST(CIMXMLWriter, WhatXMLCannotCarryIsReplacedAndBlanksStay) {
    boost::shared_ptr<TMemoryNamespace> ns = TMemoryNamespace::Create();
    const std::string controls = std::string("a\x01") + "b\x1F" + "c\xFF" + "d\xEF\xBF\xBF" + "e\xED\xA0\x80";
    ns->AddInstance("X_Text", {Prop("Bad", TCIMValue(controls)), Prop("Padded", TCIMValue("  spaced  "))});
    TLoadResult again = LoadCollectionFromString(Write(*ns, EWriteForm::kWithName));
    const TMemoryInstance& read = *again.fNamespace->FindClass("X_Text")->GetInstances().at(0);
    const std::string r = "\xEF\xBF\xBD";
    EXPECT_EQ(read.FindSlot("Bad")->fValue, TCIMValue("a" + r + "b" + r + "c" + r + "d" + r + "e" + r + r + r));
    EXPECT_EQ(read.FindSlot("Padded")->fValue, TCIMValue("  spaced  "));
}

TEST(CIMXMLWriter, ValuesThatNoLongerFitTheirDeclarationKeepTheirOwnType) {
    boost::shared_ptr<TMemoryNamespace> ns = Collection();
    TMemoryInstance& device = *ns->FindClass("X_Device")->GetInstances().at(1);
    // A later write stored text where the class declares a datetime, and a
    // number as text where it declares a string.
    device.AddProperty("Seen", TCIMValue("not yet"), {});
    device.AddProperty("Caption", TCIMValue::Unsigned(T::eUint32, 12), {});
    TLoadResult again = LoadCollectionFromString(Write(*ns, EWriteForm::kWithName));
    const TMemoryInstance& read = *again.fNamespace->FindClass("X_Device")->GetInstances().at(1);
    EXPECT_EQ(read.FindSlot("Seen")->fValue, TCIMValue("not yet"));
    EXPECT_EQ(read.FindSlot("Caption")->fValue, TCIMValue("12"));
}

TEST(CIMXMLWriter, DocumentsFollowTheCIMXMLDeclarations) {
    if (std::system("command -v xmllint >/dev/null 2>&1") != 0) GTEST_SKIP() << "xmllint is not installed";
    const std::string path = ::testing::TempDir() + "cimxml_writer_valid.xml";
    auto validates = [&](const char* output) {
        return std::system(("xmllint --noout --dtdvalid '" BRAIGRION_SOURCE_DIR
                            "/tests/fixtures/cimxml/cim-declaration-subset.dtd' '" + path + "' " + output).c_str()) == 0;
    };
    for (EWriteForm form : {EWriteForm::kWithName, EWriteForm::kWithPath}) {
        WriteCollectionFile(*Collection(), path, form);
        EXPECT_TRUE(validates("2>&1")) << static_cast<int>(form);
    }
    // The check has teeth: a document out of order is refused.
    std::ofstream(path) << "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP.WITHNAME>"
                           "<VALUE.NAMEDOBJECT><INSTANCE CLASSNAME=\"A\"/><INSTANCENAME CLASSNAME=\"A\"/>"
                           "</VALUE.NAMEDOBJECT></DECLGROUP.WITHNAME></DECLARATION></CIM>";
    EXPECT_FALSE(validates(">/dev/null 2>&1"));
    std::remove(path.c_str());
}

TEST(CIMXMLWriter, FileIsReplacedWholeOrNotAtAll) {
    boost::shared_ptr<TMemoryNamespace> ns = Collection();
    const std::string path = ::testing::TempDir() + "cimxml_writer_file.xml";
    std::ofstream(path) << "old";
    WriteCollectionFile(*ns, path);
    EXPECT_EQ(LoadCollection({path}).fNamespace->GetInstanceCount(), ns->GetInstanceCount());
    std::remove(path.c_str());

    const std::string unwritable = ::testing::TempDir() + "cimxml_no_such_dir/out.xml";
    try {
        WriteCollectionFile(*ns, unwritable);
        FAIL() << "written";
    } catch (const std::runtime_error& error) {
        EXPECT_NE(std::string(error.what()).find(unwritable), std::string::npos) << error.what();
    }
}

}  // namespace
