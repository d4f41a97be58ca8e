// The CIM-XML reader: what a declaration document and a captured response
// become in the repository, leniency where real files need it, and one clear
// message for each kind of bad input.

#include <sys/stat.h>

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "repository/CIMXMLReader.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace {

using namespace braigrion::repository;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;
typedef NORVTKR20::TCIMValue::TCIMType T;
typedef std::vector<std::pair<std::string, TCIMValue>> TKeys;

const char kHead[] = "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">";

std::string Declaration(const std::string& body) {
    return std::string(kHead) + "<DECLARATION><DECLGROUP>\n" + body + "\n</DECLGROUP></DECLARATION></CIM>\n";
}

std::string Response(const std::string& body) {
    return std::string(kHead) +
           "<MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP><IMETHODRESPONSE NAME=\"EnumerateInstances\">\n" +
           body + "\n</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>\n";
}

const TMemoryInstance& Instance(const TLoadResult& loaded, const std::string& cls, size_t index = 0) {
    TMemoryClass* c = loaded.fNamespace->FindClass(cls);
    if (!c) throw std::runtime_error("no class " + cls);
    static std::vector<boost::shared_ptr<TMemoryInstance>> keep;
    keep = c->GetInstances();
    if (index >= keep.size()) throw std::runtime_error("no instance " + std::to_string(index) + " of " + cls);
    return *keep[index];
}

const TCIMValue& Value(const TMemoryInstance& instance, const std::string& property) {
    const TMemoryInstance::TSlot* slot = instance.FindSlot(property);
    if (!slot) throw std::runtime_error("no property " + property);
    return slot->fValue;
}

const TPropertyDeclData* FindDecl(const TClassData& cls, const std::string& name) {
    for (const auto& p : cls.fProperties) {
        if (p.fName == name) return &p;
    }
    return nullptr;
}

const char kInstances[] = R"(<IRETURNVALUE>
<VALUE.NAMEDINSTANCE>
 <INSTANCENAME CLASSNAME="X_Disk"><KEYBINDING NAME="DeviceID"><KEYVALUE VALUETYPE="string" TYPE="string">d1</KEYVALUE></KEYBINDING></INSTANCENAME>
 <INSTANCE CLASSNAME="X_Disk">
  <PROPERTY NAME="DeviceID" TYPE="string" CLASSORIGIN="CIM_LogicalDevice" PROPAGATED="true"><VALUE>d1</VALUE></PROPERTY>
  <PROPERTY NAME="Size" TYPE="uint64"><VALUE>0x10</VALUE></PROPERTY>
  <PROPERTY NAME="Offset" TYPE="sint8"><VALUE>-128</VALUE></PROPERTY>
  <PROPERTY NAME="Ratio" TYPE="real32"><VALUE>0.5</VALUE></PROPERTY>
  <PROPERTY NAME="Online" TYPE="boolean"><VALUE>true</VALUE></PROPERTY>
  <PROPERTY NAME="Letter" TYPE="char16"><VALUE>C</VALUE></PROPERTY>
  <PROPERTY NAME="Installed" TYPE="datetime"><VALUE>20130429103108.458642+060</VALUE></PROPERTY>
  <PROPERTY NAME="Uptime" TYPE="datetime"><VALUE>00000012030405.000006:000</VALUE></PROPERTY>
  <PROPERTY NAME="Coarse" TYPE="datetime"><VALUE>2013042910****.******+000</VALUE></PROPERTY>
  <PROPERTY NAME="Missing" TYPE="uint16"></PROPERTY>
  <PROPERTY.ARRAY NAME="Status" TYPE="uint16"><VALUE.ARRAY><VALUE>2</VALUE><VALUE.NULL/><VALUE>5</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>
  <PROPERTY.ARRAY NAME="Notes" TYPE="string"></PROPERTY.ARRAY>
 </INSTANCE>
</VALUE.NAMEDINSTANCE>
<VALUE.OBJECTWITHPATH>
 <INSTANCEPATH><NAMESPACEPATH><HOST>srv1</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="cimv2"/></LOCALNAMESPACEPATH></NAMESPACEPATH>
  <INSTANCENAME CLASSNAME="X_DiskOnSystem">
   <KEYBINDING NAME="Disk"><VALUE.REFERENCE><INSTANCENAME CLASSNAME="X_Disk"><KEYBINDING NAME="DeviceID"><KEYVALUE>d1</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></KEYBINDING>
   <KEYBINDING NAME="Slot"><KEYVALUE VALUETYPE="numeric">7</KEYVALUE></KEYBINDING>
  </INSTANCENAME></INSTANCEPATH>
 <INSTANCE CLASSNAME="X_DiskOnSystem">
  <PROPERTY.REFERENCE NAME="Disk" REFERENCECLASS="X_Disk"><VALUE.REFERENCE>
   <INSTANCEPATH><NAMESPACEPATH><HOST>srv1</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="cimv2"/></LOCALNAMESPACEPATH></NAMESPACEPATH>
    <INSTANCENAME CLASSNAME="X_Disk"><KEYBINDING NAME="DeviceID"><KEYVALUE VALUETYPE="string">d1</KEYVALUE></KEYBINDING></INSTANCENAME></INSTANCEPATH>
  </VALUE.REFERENCE></PROPERTY.REFERENCE>
  <PROPERTY.REFERENCE NAME="System"><VALUE.REFERENCE><LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="root"/></LOCALNAMESPACEPATH>
    <INSTANCENAME CLASSNAME="X_System"><KEYBINDING NAME="Name"><KEYVALUE>gone</KEYVALUE></KEYBINDING></INSTANCENAME></LOCALINSTANCEPATH>
  </VALUE.REFERENCE></PROPERTY.REFERENCE>
  <PROPERTY.REFERENCE NAME="Spare"></PROPERTY.REFERENCE>
 </INSTANCE>
</VALUE.OBJECTWITHPATH>
</IRETURNVALUE>)";

TEST(CIMXMLReader, ResponseValuesTakeTheirDeclaredTypes) {
    TLoadResult loaded = LoadCollectionFromString(Response(kInstances));
    const TMemoryInstance& disk = Instance(loaded, "X_Disk");
    auto dateTime = [](const char* text) {
        TCIMDateTime value;
        EXPECT_TRUE(TCIMDateTime::Parse(text, value)) << text;
        return TCIMValue(value);
    };
    const std::pair<const char*, TCIMValue> expected[] = {
        {"DeviceID", TCIMValue("d1")},
        {"Size", TCIMValue::Unsigned(T::eUint64, 16)},
        {"Offset", TCIMValue::Signed(T::eSint8, -128)},
        {"Ratio", TCIMValue::Real(T::eReal32, 0.5)},
        {"Online", TCIMValue::Boolean(true)},
        {"Letter", TCIMValue::Char16("C")},
        {"Installed", dateTime("20130429103108.458642+060")},
        {"Uptime", dateTime("00000012030405.000006:000")},
        {"Coarse", dateTime("2013042910****.******+000")},
        // A property without VALUE is present, null, and still typed.
        {"Missing", TCIMValue::Null(T::eUint16)},
        {"Status", TCIMValue::Array(T::eUint16, {TCIMValue::Unsigned(T::eUint16, 2), TCIMValue::Null(T::eUint16),
                                                 TCIMValue::Unsigned(T::eUint16, 5)})},
    };
    for (const auto& e : expected) EXPECT_EQ(Value(disk, e.first), e.second) << e.first;
    EXPECT_TRUE(Value(disk, "Notes").IsNull());
    EXPECT_TRUE(Value(disk, "Notes").IsArray());
}

TEST(CIMXMLReader, ReferencesKeepTheirPathAndResolveInTheCollection) {
    TLoadResult loaded = LoadCollectionFromString(Response(kInstances));
    const TMemoryInstance& link = Instance(loaded, "X_DiskOnSystem");

    const TCIMReference disk = Value(link, "Disk");
    EXPECT_EQ(disk.GetClassName(), "X_Disk");
    EXPECT_EQ(disk.GetHost(), "srv1");
    EXPECT_EQ(disk.GetNamespacePath(), "root/cimv2");
    boost::shared_ptr<NORVTKR20::ICIMElement> target = disk.GetCIMElement(false);
    ASSERT_TRUE(target);
    EXPECT_EQ(target.get(), static_cast<const NORVTKR20::ICIMElement*>(&Instance(loaded, "X_Disk")));

    // A target that no loaded file holds resolves to nothing; the load stands.
    const TCIMReference system = Value(link, "System");
    EXPECT_EQ(system.GetNamespacePath(), "root");
    EXPECT_FALSE(system.GetCIMElement(false));
    EXPECT_TRUE(Value(link, "Spare").IsNull());
    EXPECT_EQ(Value(link, "Spare").GetType(), T::eReference);

    // The instance path's keys (a reference, and a number without TYPE) became class keys.
    const TMemoryClass* cls = loaded.fNamespace->FindClass("X_DiskOnSystem");
    EXPECT_EQ(cls->GetKeyNames(), (std::vector<std::string>{"Disk", "Slot"}));
    EXPECT_EQ(link.GetExtraKeys(), (TKeys{{"Slot", TCIMValue::Unsigned(T::eUint64, 7)}}));
}

const char kSchema[] = R"(<VALUE.OBJECT><QUALIFIER.DECLARATION NAME="ValueMap" TYPE="string" ISARRAY="true" TOSUBCLASS="false">
 <SCOPE PROPERTY="true" METHOD="true"/></QUALIFIER.DECLARATION></VALUE.OBJECT>
<QUALIFIER.DECLARATION NAME="Key" TYPE="boolean" OVERRIDABLE="false">
 <SCOPE CLASS="true" ASSOCIATION="true" REFERENCE="true" PROPERTY="true" METHOD="true" PARAMETER="true" INDICATION="true"/>
 <VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>
<VALUE.OBJECT><CLASS NAME="X_Base"><PROPERTY NAME="Old" TYPE="string"/></CLASS></VALUE.OBJECT>
<VALUE.OBJECT><CLASS NAME="X_Disk" SUPERCLASS="X_Base">
 <QUALIFIER NAME="Description" TYPE="string" TRANSLATABLE="true"><VALUE>
     A disk.
   </VALUE></QUALIFIER>
 <PROPERTY NAME="DeviceID" TYPE="string" CLASSORIGIN="X_Disk">
  <QUALIFIER NAME="Key" TYPE="boolean" OVERRIDABLE="false"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>
 <PROPERTY.ARRAY NAME="Codes" TYPE="uint8" ARRAYSIZE="4"><QUALIFIER NAME="ValueMap" TYPE="string"><VALUE.ARRAY>
   <VALUE>
     0
   </VALUE><VALUE>&#10;1</VALUE></VALUE.ARRAY></QUALIFIER>
  <VALUE.ARRAY><VALUE>1</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>
 <PROPERTY NAME="Job" TYPE="string" EmbeddedObject="object"/>
 <PROPERTY NAME="Setting" TYPE="string"><QUALIFIER NAME="EmbeddedInstance" TYPE="string"><VALUE>X_Setting</VALUE></QUALIFIER></PROPERTY>
 <PROPERTY.REFERENCE NAME="Owner" REFERENCECLASS="X_System" PROPAGATED="true"/>
 <METHOD NAME="Reset" TYPE="uint32"><PARAMETER NAME="Force" TYPE="boolean"/></METHOD>
</CLASS></VALUE.OBJECT>
<VALUE.OBJECT><CLASS NAME="X_Base"><PROPERTY NAME="New" TYPE="uint32"><VALUE>5</VALUE></PROPERTY></CLASS></VALUE.OBJECT>)";

TEST(CIMXMLReader, DeclarationsBecomeQualifierTypesAndClasses) {
    TLoadResult loaded = LoadCollectionFromString(Declaration(kSchema));
    const auto& types = loaded.fNamespace->GetQualifierTypes();
    ASSERT_EQ(types.size(), 2u);
    EXPECT_EQ(types[0].fName, "ValueMap");
    EXPECT_TRUE(types[0].fIsArray);
    EXPECT_FALSE(types[0].fToSubclass);
    EXPECT_EQ(types[0].fScopes, (std::vector<std::string>{"property", "method"}));
    EXPECT_EQ(types[1].fScopes, (std::vector<std::string>{"any"}));
    EXPECT_FALSE(types[1].fOverridable);
    EXPECT_EQ(types[1].fDefault, TCIMValue::Boolean(false));

    const TMemoryClass* disk = loaded.fNamespace->FindClass("X_Disk");
    ASSERT_TRUE(disk);
    const TClassData& decl = disk->GetDeclaration();
    EXPECT_EQ(decl.fSuperClass, "X_Base");
    ASSERT_EQ(decl.fQualifiers.size(), 1u);
    EXPECT_TRUE(decl.fQualifiers[0].fTranslatable);
    // The indentation of a pretty-printed value is layout, not content.
    EXPECT_EQ(decl.fQualifiers[0].fValue, TCIMValue("A disk."));

    ASSERT_EQ(decl.fProperties.size(), 5u) << "the METHOD is left out";
    const TPropertyDeclData* id = FindDecl(decl, "DeviceID");
    EXPECT_EQ(id->fClassOrigin, "X_Disk");
    EXPECT_EQ(id->fQualifiers.at(0).fValue, TCIMValue::Boolean(true));
    const TPropertyDeclData* codes = FindDecl(decl, "Codes");
    EXPECT_TRUE(codes->fIsArray);
    EXPECT_EQ(codes->fArraySize, 4);
    EXPECT_EQ(codes->fType, T::eUint8);
    const std::vector<TCIMValue>& map = codes->fQualifiers.at(0).fValue;
    // A line break written as a character reference is content and stays.
    EXPECT_EQ(map, (std::vector<TCIMValue>{TCIMValue("0"), TCIMValue("\n1")}));
    EXPECT_EQ(codes->fDefault, TCIMValue::Array(T::eUint8, {TCIMValue::Unsigned(T::eUint8, 1)}));
    EXPECT_TRUE(FindDecl(decl, "Job")->fEmbeddedObject);
    EXPECT_TRUE(FindDecl(decl, "Setting")->fEmbeddedObject);
    const TPropertyDeclData* owner = FindDecl(decl, "Owner");
    EXPECT_EQ(owner->fType, T::eReference);
    EXPECT_EQ(owner->fReferenceClass, "X_System");
    EXPECT_TRUE(owner->fPropagated);

    // X_Base was declared twice: the later declaration wins.
    const TClassData& base = loaded.fNamespace->FindClass("X_Base")->GetDeclaration();
    ASSERT_EQ(base.fProperties.size(), 1u);
    EXPECT_EQ(base.fProperties[0].fName, "New");
    EXPECT_EQ(base.fProperties[0].fDefault, TCIMValue::Unsigned(T::eUint32, 5));
}

TEST(CIMXMLReader, ReadsLenientlyWhatRealFilesHold) {
    // A named instance inside a declaration group, keys without TYPE, an
    // instance of a class that no file declares, an empty VALUE for a number.
    const std::string xml = Declaration(R"(<VALUE.NAMEDINSTANCE>
 <INSTANCENAME CLASSNAME="X_Fan"><KEYBINDING NAME="Id"><KEYVALUE VALUETYPE="numeric">-3</KEYVALUE></KEYBINDING>
  <KEYBINDING NAME="On"><KEYVALUE VALUETYPE="boolean">TRUE</KEYVALUE></KEYBINDING>
  <KEYBINDING NAME="Speed"><KEYVALUE VALUETYPE="numeric">2.5</KEYVALUE></KEYBINDING></INSTANCENAME>
 <INSTANCE CLASSNAME="X_Fan"><PROPERTY NAME="Id" TYPE="sint32"><VALUE>-3</VALUE></PROPERTY>
  <PROPERTY NAME="Rpm" TYPE="uint32"><VALUE></VALUE></PROPERTY>
  <PROPERTY NAME="Label" TYPE="string"><VALUE></VALUE></PROPERTY></INSTANCE>
</VALUE.NAMEDINSTANCE>)");
    TLoadResult loaded = LoadCollectionFromString(xml);
    const TMemoryInstance& fan = Instance(loaded, "X_Fan");
    TMemoryClass* cls = loaded.fNamespace->FindClass("X_Fan");
    EXPECT_FALSE(cls->IsDeclared());
    EXPECT_EQ(cls->GetProperties().at(cls->FindProperty("Id"))->GetType(), T::eSint32) << "inferred from the XML";
    EXPECT_TRUE(Value(fan, "Rpm").IsNull());
    EXPECT_EQ(Value(fan, "Label"), TCIMValue(""));
    EXPECT_EQ(fan.GetExtraKeys(), (TKeys{{"On", TCIMValue::Boolean(true)}, {"Speed", TCIMValue::Real(T::eReal64, 2.5)}}));
}

TEST(CIMXMLReader, ServerErrorsAreWarningsAndEmptyResultsAreFine) {
    const std::string xml =
        std::string(kHead) +
        "<MESSAGE ID=\"7\" PROTOCOLVERSION=\"1.0\"><MULTIRSP>\n"
        "<SIMPLERSP><IMETHODRESPONSE NAME=\"EnumerateInstances\">\n"
        "<ERROR CODE=\"5\" DESCRIPTION=\"no such class\"><INSTANCE CLASSNAME=\"CIM_Error\"/></ERROR>\n"
        "</IMETHODRESPONSE></SIMPLERSP>\n"
        "<SIMPLERSP><IMETHODRESPONSE NAME=\"EnumerateInstances\"><IRETURNVALUE/></IMETHODRESPONSE></SIMPLERSP>\n"
        "<SIMPLERSP><IMETHODRESPONSE NAME=\"EnumerateInstanceNames\"><IRETURNVALUE>"
        "<INSTANCENAME CLASSNAME=\"X_A\"/></IRETURNVALUE></IMETHODRESPONSE></SIMPLERSP>\n"
        "</MULTIRSP></MESSAGE></CIM>";
    TLoadResult loaded = LoadCollectionFromString(xml, "capture.xml");
    EXPECT_EQ(loaded.fWarnings,
              (std::vector<std::string>{"capture.xml:4: server returned ERROR CODE=5 (no such class)"}));
    EXPECT_EQ(loaded.fNamespace->GetInstanceCount(), 0u);
    EXPECT_TRUE(loaded.fNamespace->GetClasses().empty()) << "names alone load nothing";
}

// The error loading `xml` fails with; loading it fails the test.
TLoadError FailureOf(const std::string& xml, const std::string& name = "bad.xml") {
    try {
        LoadCollectionFromString(xml, name);
    } catch (const TLoadError& error) {
        return error;
    }
    ADD_FAILURE() << "loaded: " << xml;
    return TLoadError("", 0, 0, "loaded");
}

// Each bad document: the body goes on line 3 of a declaration, '@' marks
// where the error is reported (it is removed before loading).
const struct {
    const char* fBody;
    const char* fMessage;
} kBadCases[] = {
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A">@<PROPERTY NAME="P" TYPE="int32"/></INSTANCE></VALUE.OBJECT>)",
     "unknown TYPE \"int32\" of PROPERTY P"},
    {R"(<VALUE.OBJECT><CLASS NAME="A">@<PROPERTY NAME="R" TYPE="reference"/></CLASS></VALUE.OBJECT>)",
     "unknown TYPE \"reference\" of PROPERTY R"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="Foo" TYPE="uint8">@<VALUE>300</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)",
     "VALUE \"300\" does not fit TYPE uint8 of property Foo (out of range)"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="T" TYPE="datetime">@<VALUE>2024-01-01 10:00</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)",
     "VALUE \"2024-01-01 10:00\" does not fit TYPE datetime of property T"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY.ARRAY NAME="L" TYPE="boolean"><VALUE.ARRAY><VALUE>TRUE</VALUE>@<VALUE>maybe</VALUE></VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE></VALUE.OBJECT>)",
     "VALUE \"maybe\" does not fit TYPE boolean of property L"},
    {R"(<VALUE.OBJECT>@<PROPERTY NAME="P" TYPE="string"/></VALUE.OBJECT>)",
     "element PROPERTY cannot stand inside VALUE.OBJECT"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="P" TYPE="string"><VALUE>a</VALUE>@<VALUE>b</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)",
     "PROPERTY P holds more than one value"},
    {R"(<VALUE.OBJECT>@<WIDGET/></VALUE.OBJECT>)", "unknown element WIDGET"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A">@oops</INSTANCE></VALUE.OBJECT>)",
     "text \"oops\" cannot stand inside INSTANCE"},
    {R"(<VALUE.OBJECT>@<INSTANCE><PROPERTY NAME="P" TYPE="string"/></INSTANCE></VALUE.OBJECT>)",
     "INSTANCE without CLASSNAME"},
    {R"(<VALUE.NAMEDINSTANCE>@<INSTANCE CLASSNAME="A"/><INSTANCENAME CLASSNAME="A"/></VALUE.NAMEDINSTANCE>)",
     "INSTANCE in VALUE.NAMEDINSTANCE must follow its instance path"},
    {R"(<VALUE.OBJECT><CLASS NAME="A">@<PROPERTY NAME="P" TYPE="string" PROPAGATED="yes"/></CLASS></VALUE.OBJECT>)",
     "attribute PROPAGATED must be true or false, not \"yes\""},
    {R"(<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME="A"><KEYBINDING NAME="K">@<KEYVALUE VALUETYPE="numeric">seven</KEYVALUE></KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME="A"/></VALUE.NAMEDINSTANCE>)",
     "KEYVALUE \"seven\" of key K is not a number"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"></@VALUE.OBJECT></INSTANCE>)",
     "closing tag does not match the open element INSTANCE"},
    // Values that do not fit, on classes as on instances.
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="C" TYPE="char16">@<VALUE>ab</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)",
     "VALUE \"ab\" does not fit TYPE char16 of property C"},
    {R"(<VALUE.OBJECT><CLASS NAME="A"><PROPERTY NAME="C" TYPE="char16">@<VALUE>&#xE9;&#xE9;</VALUE></PROPERTY></CLASS></VALUE.OBJECT>)",
     "VALUE \"\xC3\xA9\xC3\xA9\" does not fit TYPE char16 of property C"},
    {R"(<VALUE.OBJECT><CLASS NAME="A">@<PROPERTY.ARRAY NAME="L" TYPE="uint8" ARRAYSIZE="-1"/></CLASS></VALUE.OBJECT>)",
     "ARRAYSIZE \"-1\" is not a count"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A">@<PROPERTY.ARRAY NAME="L" TYPE="uint8" ARRAYSIZE="-1"/></INSTANCE></VALUE.OBJECT>)",
     "ARRAYSIZE \"-1\" is not a count"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A">@<PROPERTY.ARRAY NAME="L" TYPE="uint8" ARRAYSIZE="18446744073709551617"/></INSTANCE></VALUE.OBJECT>)",
     "ARRAYSIZE \"18446744073709551617\" is not a count"},
    {R"(<VALUE.OBJECT><CLASS NAME="A">@<PROPERTY.ARRAY NAME="L" TYPE="uint8" ARRAYSIZE="4294967296"/></CLASS></VALUE.OBJECT>)",
     "ARRAYSIZE \"4294967296\" is not a count"},
    // Names and values that would break the line are shown escaped.
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A">@<PROPERTY NAME="two&#10;lines" TYPE="int32"/></INSTANCE></VALUE.OBJECT>)",
     "unknown TYPE \"int32\" of PROPERTY two\\nlines"},
    {R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="N" TYPE="uint8">@<VALUE>1&#13;&#10;2&#9;</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)",
     "VALUE \"1\\r\\n2\\t\" does not fit TYPE uint8 of property N"},
};

TEST(CIMXMLReader, BadInputFailsWithFileLineColumnAndReason) {
    for (const auto& bad : kBadCases) {
        std::string body = bad.fBody;
        const size_t mark = body.find('@');
        body.erase(mark, 1);
        EXPECT_STREQ(FailureOf(Declaration(body)).what(),
                     ("bad.xml:3:" + std::to_string(mark + 1) + ": " + bad.fMessage).c_str());
    }
}

TEST(CIMXMLReader, FileNamesThatWouldBreakTheLineAreQuoted) {
    const std::string xml = Declaration(R"(<VALUE.OBJECT><WIDGET/></VALUE.OBJECT>)");
    EXPECT_STREQ("\"two\\nlines.xml\":3:15: unknown element WIDGET", FailureOf(xml, "two\nlines.xml").what());
    EXPECT_EQ("two\nlines.xml", FailureOf("<CIM>", "two\nlines.xml").File()) << "the name itself is kept";
}

TEST(CIMXMLReader, TruncatedDocumentNamesTheUnclosedElement) {
    const std::string whole = Declaration(R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="P" TYPE="string"><VALUE>abc</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)");
    const std::string cut = whole.substr(0, whole.find("abc") + 3);
    const TLoadError error = FailureOf(cut);
    EXPECT_EQ(error.Line(), 3u);
    EXPECT_EQ(error.Column(), cut.size() - cut.rfind('\n'));
    EXPECT_EQ(error.Message(), "unclosed element VALUE: the document ends before it is closed");
    EXPECT_EQ(FailureOf(whole.substr(0, whole.find("<PROPERTY") + 5)).Message(),
              "the document ends in the middle of a tag or character (unclosed element INSTANCE)");
}

TEST(CIMXMLReader, NeverLoadsEntitiesOrExternalDefinitions) {
    const TLoadError declared = FailureOf("<?xml version=\"1.0\"?>\n<!DOCTYPE CIM [<!ENTITY boom \"x\">]>\n<CIM/>");
    EXPECT_EQ(declared.Message(), "entity declarations are not accepted (entity boom)");
    EXPECT_EQ(declared.Line(), 2u);
    // A DOCTYPE naming an external DTD is harmless: it is never fetched.
    auto withDoctype = [](const std::string& body) {
        const std::string document = Declaration(body);
        return "<?xml version=\"1.0\"?>\n<!DOCTYPE CIM SYSTEM \"http://example.invalid/cim.dtd\">\n" +
               document.substr(document.find('\n') + 1);
    };
    EXPECT_NO_THROW(LoadCollectionFromString(withDoctype("")));
    EXPECT_EQ(FailureOf(withDoctype(R"(<VALUE.OBJECT><INSTANCE CLASSNAME="A"><PROPERTY NAME="P" TYPE="string"><VALUE>&ext;</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)")).Message(),
              "reference to undeclared entity &ext;");
}

// ---------------------------------------------------------------- files

std::string TempPath(const std::string& name) { return ::testing::TempDir() + "cimxml_reader_" + name; }

std::string TempFile(const std::string& name, const std::string& text) {
    std::ofstream(TempPath(name), std::ios::binary) << text;
    return TempPath(name);
}

TEST(CIMXMLFiles, SeveralFilesMakeOneCollectionAndAFailingFileAddsNothing) {
    const std::string schema = TempFile("schema.xml", Declaration(kSchema));
    TLoadResult loaded = LoadCollection({schema, TempFile("data.xml", Response(kInstances))});
    const TMemoryClass* disk = loaded.fNamespace->FindClass("X_Disk");
    ASSERT_TRUE(disk);
    EXPECT_TRUE(disk->IsDeclared());
    EXPECT_EQ(disk->GetInstanceCount(), 1u);
    EXPECT_TRUE(disk->IsA(loaded.fNamespace->FindClass("X_Base")));
    try {
        LoadCollection({schema, TempPath("absent.xml")});
        ADD_FAILURE() << "loaded";
    } catch (const TLoadError& error) {
        EXPECT_NE(error.Message().find("cannot open file: No such file or directory"), std::string::npos) << error.what();
        EXPECT_EQ(TempPath("absent.xml") + ": cannot open file: No such file or directory", error.what())
            << "no line or column where there is none";
    }

    boost::shared_ptr<TMemoryNamespace> ns = LoadCollection({TempPath("data.xml")}).fNamespace;
    const size_t before = ns->GetInstanceCount();
    const size_t classes = ns->GetClasses().size();
    // Valid objects first, then a bad value further down the same file.
    const std::string bad = TempFile("bad.xml", Declaration(std::string(kSchema) + "\n" +
                                                            R"(<VALUE.OBJECT><INSTANCE CLASSNAME="X_New"><PROPERTY NAME="N" TYPE="uint8"><VALUE>256</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>)"));
    std::vector<std::string> warnings;
    try {
        LoadFileInto(*ns, bad, warnings);
        ADD_FAILURE() << "loaded";
    } catch (const TLoadError& error) {
        EXPECT_EQ(error.File(), bad);
        const std::string text = kSchema;
        EXPECT_EQ(error.Line(), 4u + static_cast<unsigned>(std::count(text.begin(), text.end(), '\n')));
    }
    EXPECT_EQ(ns->GetInstanceCount(), before);
    EXPECT_EQ(ns->GetClasses().size(), classes);
    EXPECT_FALSE(ns->FindClass("X_Disk")->IsDeclared());
    LoadFileInto(*ns, schema, warnings);
    EXPECT_TRUE(ns->FindClass("X_Disk")->IsDeclared());
    for (const char* name : {"schema.xml", "data.xml", "bad.xml"}) std::remove(TempPath(name).c_str());
}

// ---------------------------------------------------------------- real captures

const std::string kRealDir = BRAIGRION_SOURCE_DIR "/../shared/realcim";

bool HaveRealCaptures() {
    struct stat info {};
    return stat(kRealDir.c_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

#define REQUIRE_REAL_CAPTURES()                                                                       \
    if (!HaveRealCaptures()) GTEST_SKIP() << "real server captures not found at " << kRealDir \
                                          << "; this test needs them"

TEST(CIMXMLRealCaptures, StorageArrayLoadsAcrossFiles) {
    REQUIRE_REAL_CAPTURES();
    const char* const names[] = {"ArrayChassis", "Battery", "ComponentCS", "ComputerSystemPackage", "DiskDrive",
                                 "DiskDriveView", "EthernetPort", "Fan", "FrontEndFCPort", "PowerSupply",
                                 "StorageProcessorSystem", "StorageSystem", "SystemPackaging"};
    std::vector<std::string> files;
    for (const char* name : names) files.push_back(kRealDir + "/storage_array/EMC_" + name + ".xml");
    TLoadResult loaded = LoadCollection(files);

    ASSERT_EQ(loaded.fWarnings.size(), 2u);
    EXPECT_EQ(loaded.fWarnings[0].rfind(files[5] + ":6: server returned ERROR CODE=5 (The specified class", 0), 0u)
        << loaded.fWarnings[0];
    EXPECT_EQ(loaded.fWarnings[1].rfind(files[12] + ":6: server returned ERROR CODE=5", 0), 0u) << loaded.fWarnings[1];
    EXPECT_EQ(loaded.fNamespace->FindClass("Symm_DiskDrive")->GetInstanceCount(), 18u);
    EXPECT_EQ(loaded.fNamespace->FindClass("Symm_StorageSystem")->GetInstanceCount(), 1u);
    EXPECT_EQ(loaded.fNamespace->GetInstanceCount(), 77u);

    // Association ends point into other files; those whose target no file
    // holds resolve to nothing.
    size_t resolved = 0, dangling = 0;
    for (const TMemoryClass* cls : loaded.fNamespace->GetClasses()) {
        for (const auto& instance : cls->GetInstances()) {
            for (const auto& slot : instance->GetSlots()) {
                if (slot.fValue.IsNull() || slot.fValue.GetType() != T::eReference) continue;
                const TCIMReference ref = slot.fValue;
                EXPECT_EQ(ref.GetNamespacePath(), "root/emc");
                (ref.GetCIMElement(false) ? resolved : dangling)++;
            }
        }
    }
    EXPECT_EQ(resolved, 29u);
    EXPECT_EQ(dangling, 13u);
}

TEST(CIMXMLRealCaptures, SchemasQualifiersAndEmbeddedObjectsLoad) {
    REQUIRE_REAL_CAPTURES();
    const struct {
        const char* file;
        size_t classes;
        size_t qualifierTypes;
    } declarations[] = {{"openpegasus_EnumerateClasses_assoc_classes.xml", 64, 0},
                        {"openpegasus_schema_declaration.xml", 19, 63},  // 23 declarations, some of one class
                        {"openpegasus_EnumerateQualifiers.xml", 0, 59},
                        {"sfcb_EnumerateQualifiers.xml", 0, 71},
                        {"pywbem_GetClass_CIM_ComputerSystem.xml", 1, 0}};
    for (const auto& d : declarations) {
        TLoadResult loaded = LoadCollection({kRealDir + "/" + d.file});
        EXPECT_EQ(loaded.fNamespace->GetClasses().size(), d.classes) << d.file;
        EXPECT_EQ(loaded.fNamespace->GetQualifierTypes().size(), d.qualifierTypes) << d.file;
    }
    TLoadResult assoc = LoadCollection({kRealDir + "/openpegasus_EnumerateClasses_assoc_classes.xml"});
    size_t references = 0;
    for (const TMemoryClass* cls : assoc.fNamespace->GetClasses()) {
        for (const auto& p : cls->GetDeclaration().fProperties) references += p.fType == T::eReference;
    }
    EXPECT_EQ(references, 122u);

    TLoadResult query = LoadCollection({kRealDir + "/pywbem_ExecQuery_PG_ComputerSystem.xml"});
    const TMemoryInstance& computer = Instance(query, "PG_ComputerSystem");
    EXPECT_EQ(Value(computer, "Name"), TCIMValue("sheldon"));
    EXPECT_EQ(Value(computer, "PowerManagementSupported"), TCIMValue::Boolean(false));

    TLoadResult nested = LoadCollection({kRealDir + "/sblim_OpenLMI_NestedEmbeddedInstance.xml"});
    const TMemoryInstance& modification = Instance(nested, "LMI_StorageInstModification");
    const std::string embedded = Value(modification, "SourceInstance");
    EXPECT_EQ(embedded.rfind("<INSTANCE CLASSNAME=\"LMI_StorageJob\">", 0), 0u);
    EXPECT_NE(embedded.find("&lt;INSTANCE CLASSNAME=&quot;CIM_ManagedElement&quot;&gt;"), std::string::npos)
        << "the second level stays escaped inside the first";
    const TMemoryClass& cls = modification.GetMemoryClass();
    EXPECT_TRUE(cls.GetProperties().at(cls.FindProperty("SourceInstance"))->GetData().fEmbeddedObject);
}

}  // namespace
