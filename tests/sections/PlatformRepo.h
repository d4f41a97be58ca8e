// Repositories for the platform page tests: instances from a few lines of
// text, classes with a superclass and an "Id" key so that instances can be
// linked, and associations between them.
#pragma once

#include <set>
#include <string>
#include <vector>

#include <boost/make_shared.hpp>

#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {
namespace testing {

class TPlatformRepo {
public:
    // Declares `name` below `super` ("" for none) with the key "Id".
    TPlatformRepo& Keyed(const std::string& name, const std::string& super = "") {
        using namespace testrepo;
        fRepo.Namespace()->DeclareClass(
            C(name, super, {P("Id", T::eString, {Q("Key", TCIMValue::Boolean(true))})}));
        return *this;
    }
    TPlatformRepo& Parse(const std::string& text) {
        fRepo.Parse(text);
        return *this;
    }
    // An instance of `assoc` from the instance `Class.Id="a"` to `Class.Id="b"`,
    // declaring the association the first time.
    TPlatformRepo& Link(const std::string& assoc, const std::string& from, const std::string& to,
                        const std::string& fromRole = "Antecedent", const std::string& toRole = "Dependent",
                        std::vector<repository::TPropertyValue> more = {}) {
        using namespace testrepo;
        auto ns = fRepo.Namespace();
        if (fAssociations.insert(assoc).second) {
            ns->DeclareClass(
                C(assoc, "", {Ref(fromRole, ""), Ref(toRole, "")}, {Q("Association", TCIMValue::Boolean(true))}));
        }
        more.push_back(V(fromRole, RefTo(ns, Path(from))));
        more.push_back(V(toRole, RefTo(ns, Path(to))));
        ns->AddInstance(assoc, more);
        return *this;
    }
    boost::shared_ptr<repository::TMemoryNamespace> Namespace() {
        fRepo.Namespace()->Link();
        return fRepo.Namespace();
    }

    // "Class:a" as the path Class.Id="a".
    static std::string Path(const std::string& shortPath) {
        const std::string::size_type colon = shortPath.find(':');
        return shortPath.substr(0, colon) + ".Id=\"" + shortPath.substr(colon + 1) + "\"";
    }

private:
    TRepoBuilder fRepo;
    std::set<std::string> fAssociations;
};

// A namespace whose one class cannot be read: asking for it fails with a
// status other than "not found".
class TBrokenClassNamespace : public NORVTKR20::ICIMNamespace {
public:
    TBrokenClassNamespace(boost::shared_ptr<NORVTKR20::ICIMNamespace> inner, const std::string& broken)
        : fInner(inner), fBroken(broken) {}
    boost::shared_ptr<NORVTKR20::INamespaceProvider> GetNamespaceProvider(
        const NORVTKR20::TCIMContext& context) override {
        return fInner->GetNamespaceProvider(context);
    }
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(const std::string& name,
                                                     const NORVTKR20::TCIMContext& context) override {
        if (name == fBroken) throw NORVTKR20::TTKRException(kFailure);
        return fInner->GetClass(name, context);
    }
    boost::shared_ptr<NORVTKR20::ICIMInstance> GetInstance(const NORVTKR20::TCIMReference& path,
                                                           const NORVTKR20::TCIMContext& context) override {
        return fInner->GetInstance(path, context);
    }
    static const int kFailure = 5;

private:
    boost::shared_ptr<NORVTKR20::ICIMNamespace> fInner;
    std::string fBroken;
};

}  // namespace testing
}  // namespace braigrion
