// Small files made to hurt: deep nesting, long superclass chains, long runs
// of referenced blanks. Each must load (or be refused with one clear line)
// in a moment, without taking the stack or the machine with it.

#include <algorithm>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "repository/CIMXMLParser.h"
#include "repository/CIMXMLReader.h"
#include "repository/MemoryClass.h"
#include "repository/MemoryInstance.h"

namespace {

using namespace braigrion::repository;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMReference;
using NORVTKR20::TCIMValue;

const char kHead[] = "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">";

std::string Declaration(const std::string& body) {
    return std::string(kHead) + "<DECLARATION><DECLGROUP>\n" + body + "\n</DECLGROUP></DECLARATION></CIM>\n";
}

// A reference property whose path has a key that is a path, `depth` levels.
std::string NestedReference(size_t depth) {
    std::string path = "<INSTANCENAME CLASSNAME=\"X_Leaf\"><KEYBINDING NAME=\"Id\"><KEYVALUE>0</KEYVALUE></KEYBINDING></INSTANCENAME>";
    for (size_t level = 1; level < depth; ++level) {
        path = "<INSTANCENAME CLASSNAME=\"X_Node\"><KEYBINDING NAME=\"Inner\"><VALUE.REFERENCE>" + path +
               "</VALUE.REFERENCE></KEYBINDING></INSTANCENAME>";
    }
    return Declaration("<VALUE.OBJECT><INSTANCE CLASSNAME=\"X_Assoc\"><PROPERTY.REFERENCE NAME=\"Target\"><VALUE.REFERENCE>" +
                       path + "</VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE></VALUE.OBJECT>");
}

std::string LoadFailure(const std::string& xml) {
    try {
        LoadCollectionFromString(xml, "hostile.xml");
    } catch (const TLoadError& error) {
        return error.what();
    }
    return "loaded";
}

TEST(HostileInput, ReferencesNestedPastTheLimitAreRefusedAndThoseWithinLoad) {
    const size_t limit = cimxml::TParser::kMaxReferenceDepth;
    TLoadResult loaded = LoadCollectionFromString(NestedReference(limit));
    const TMemoryClass* assoc = loaded.fNamespace->FindClass("X_Assoc");
    ASSERT_TRUE(assoc);
    const TCIMReference* path = assoc->GetInstanceList().at(0)->FindSlot("Target")->fValue.GetReference();
    ASSERT_TRUE(path);
    size_t depth = 1;
    for (; path->GetClassName() == "X_Node"; ++depth) path = path->GetKeyBindings().at("Inner").GetReference();
    EXPECT_EQ(limit, depth);

    // The 32 levels of the report that never finished.
    for (size_t deep : {limit + 1, size_t(32)}) {
        const std::string message = LoadFailure(NestedReference(deep));
        EXPECT_NE(std::string::npos, message.find("VALUE.REFERENCE nested more than " + std::to_string(limit) +
                                                  " levels deep"))
            << message;
        EXPECT_EQ(0, message.compare(0, 12, "hostile.xml:")) << message;
    }
}

// 15,000 classes, each the superclass of the next, declared root first and
// leaf first, and an instance of the leaf: one link, no recursion per level.
TEST(HostileInput, LongSuperclassChainsLinkInEitherOrder) {
    const int kClasses = 15000;
    for (bool leafFirst : {false, true}) {
        std::string body = "<VALUE.OBJECT><CLASS NAME=\"C0\"><PROPERTY NAME=\"Id\" TYPE=\"string\"/></CLASS></VALUE.OBJECT>\n";
        std::vector<std::string> classes;
        for (int i = 1; i < kClasses; ++i) {
            classes.push_back("<VALUE.OBJECT><CLASS NAME=\"C" + std::to_string(i) + "\" SUPERCLASS=\"C" +
                              std::to_string(i - 1) + "\"/></VALUE.OBJECT>\n");
        }
        if (leafFirst) std::reverse(classes.begin(), classes.end());
        for (const std::string& c : classes) body += c;
        const std::string leaf = "C" + std::to_string(kClasses - 1);
        body += "<VALUE.OBJECT><INSTANCE CLASSNAME=\"" + leaf +
                "\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>deep</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>";
        TLoadResult loaded = LoadCollectionFromString(Declaration(body));
        const TMemoryNamespace& ns = *loaded.fNamespace;
        EXPECT_TRUE(ns.FindClass(leaf)->IsA(ns.FindClass("C0"))) << "leaf first: " << leafFirst;
        EXPECT_EQ(0, ns.FindClass(leaf)->FindProperty("Id")) << "inherited from the root";

        std::vector<boost::shared_ptr<NORVTKR20::ICIMInstance>> found;
        loaded.fNamespace->GetClass("C0", TCIMContext())
            ->EnumerateInstances(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMInstance>(found), true, TCIMContext());
        ASSERT_EQ(1u, found.size());
        EXPECT_EQ("deep", found[0]->GetProperty("Id", TCIMContext())->GetValueString());
        size_t subclasses = 0;
        loaded.fNamespace->GetClass("C0", TCIMContext())
            ->EnumerateSubClasses([&](boost::shared_ptr<NORVTKR20::ICIMClass>) { return ++subclasses > 0; }, true,
                                  TCIMContext());
        EXPECT_EQ(static_cast<size_t>(kClasses - 1), subclasses);
    }
}

// A ring of classes each naming the next as superclass: the one whose
// superclass would close the ring stays at the root, whatever its size.
TEST(HostileInput, SuperclassCyclesLeaveOneClassAtTheRoot) {
    for (int size : {1, 2, 3, 20000}) {
        std::string body;
        for (int i = 0; i < size; ++i) {
            body += "<VALUE.OBJECT><CLASS NAME=\"R" + std::to_string(i) + "\" SUPERCLASS=\"R" +
                    std::to_string((i + 1) % size) + "\"/></VALUE.OBJECT>\n";
        }
        TLoadResult loaded = LoadCollectionFromString(Declaration(body));
        size_t roots = 0;
        for (const TMemoryClass* c : loaded.fNamespace->GetClasses()) roots += c->GetSuperClass() == nullptr;
        EXPECT_EQ(1u, roots) << size;
        EXPECT_EQ(nullptr, loaded.fNamespace->FindClass("R" + std::to_string(size - 1))->GetSuperClass())
            << "the last declared closes the ring";
    }
}

// 600,000 blanks written as character references are content; the
// layout around them goes. Trimming is one pass.
TEST(HostileInput, BlanksWrittenAsReferencesStayAndTrimInOnePass) {
    const size_t kBlanks = 600000;
    std::string blanks;
    blanks.reserve(kBlanks * 5);
    for (size_t i = 0; i < kBlanks; ++i) blanks += "&#32;";
    const std::string xml = Declaration(
        "<VALUE.OBJECT><INSTANCE CLASSNAME=\"X_Text\"><PROPERTY NAME=\"Blank\" TYPE=\"string\"><VALUE>\n      " + blanks +
        "x" + blanks + "\n    </VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>");
    TLoadResult loaded = LoadCollectionFromString(xml);
    const std::string value = loaded.fNamespace->FindClass("X_Text")->GetInstanceList().at(0)->FindSlot("Blank")->fValue.ToString(10);
    EXPECT_EQ(2 * kBlanks + 1, value.size());
    EXPECT_EQ(std::string(kBlanks, ' ') + "x" + std::string(kBlanks, ' '), value);
}

}  // namespace
