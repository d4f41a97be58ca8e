#include "repository/NamespaceView.h"

#include <boost/make_shared.hpp>

namespace braigrion {
namespace repository {

using NORVTKR20::ICIMClass;
using NORVTKR20::TTKRException;

namespace {

class TViewProvider : public NORVTKR20::INamespaceProvider {
public:
    int GetProviderType(const TCIMContext&) override { return 1; }
};

// A class that both the selected collection and the view's records hold.
class TUnionClass : public ICIMClass {
public:
    TUnionClass(boost::shared_ptr<ICIMClass> primary, boost::shared_ptr<ICIMClass> records)
        : fPrimary(std::move(primary)), fRecords(std::move(records)) {}

    void EnumerateAssociatorClasses(const NORVTKR20::TInstanceCallback& callback, bool deep,
                                    const TCIMContext& context) override {
        bool go = true;
        auto guard = [&](boost::shared_ptr<NORVTKR20::ICIMInstance> i) { return go = callback(i); };
        fPrimary->EnumerateAssociatorClasses(guard, deep, context);
        if (go) fRecords->EnumerateAssociatorClasses(guard, deep, context);
    }
    const std::string& GetClassName(const TCIMContext& context) override { return fPrimary->GetClassName(context); }
    std::vector<std::string> GetPropertyList(const std::string& name, const TCIMContext& context) override {
        return fPrimary->GetPropertyList(name, context);
    }
    void EnumerateSubClasses(const NORVTKR20::TClassCallback& callback, bool deep, const TCIMContext& context) override {
        fPrimary->EnumerateSubClasses(callback, deep, context);
    }
    boost::shared_ptr<const NORVTKR20::ICIMPropertyDecl> GetPropertyDecl(const std::string& name,
                                                                         const TCIMContext& context) override {
        try {
            return fPrimary->GetPropertyDecl(name, context);
        } catch (const TTKRException& ex) {
            if (ex.fStatusCode.fStatusCode != NORVTKR20::kNotFound) throw;
        }
        return fRecords->GetPropertyDecl(name, context);
    }
    boost::shared_ptr<NORVTKR20::ICIMInstance> CreateInstance(const TCIMContext& context) override {
        return fPrimary->CreateInstance(context);
    }
    void EnumerateInstances(const NORVTKR20::TInstanceCallback& callback, bool deep,
                            const TCIMContext& context) override {
        bool go = true;
        auto guard = [&](boost::shared_ptr<NORVTKR20::ICIMInstance> i) { return go = callback(i); };
        fPrimary->EnumerateInstances(guard, deep, context);
        if (go) fRecords->EnumerateInstances(guard, deep, context);
    }

private:
    boost::shared_ptr<ICIMClass> fPrimary;
    boost::shared_ptr<ICIMClass> fRecords;
};

boost::shared_ptr<ICIMClass> TryClass(TMemoryNamespace& ns, const std::string& name, const TCIMContext& context) {
    if (!ns.FindClass(name)) return boost::shared_ptr<ICIMClass>();
    return ns.GetClass(name, context);
}

}  // namespace

unsigned short SelectedIndex(const TCIMContext& context) {
    auto it = context.find("nsIndex");
    if (it == context.end() || it->second.IsNull()) return 0;
    return static_cast<unsigned short>(it->second);
}

TNamespaceView::TNamespaceView(std::vector<boost::shared_ptr<TMemoryNamespace>> collections,
                               boost::shared_ptr<TMemoryNamespace> records)
    : fCollections(std::move(collections)), fRecords(records ? records : TMemoryNamespace::Create()) {}

boost::shared_ptr<NORVTKR20::INamespaceProvider> TNamespaceView::GetNamespaceProvider(const TCIMContext&) {
    return boost::make_shared<TViewProvider>();
}

TMemoryNamespace& TNamespaceView::Selected(const TCIMContext& context) const {
    unsigned short index = SelectedIndex(context);
    if (index >= fCollections.size()) throw TTKRException(NORVTKR20::kInvalidParameter);
    return *fCollections[index];
}

boost::shared_ptr<ICIMClass> TNamespaceView::GetClass(const std::string& name, const TCIMContext& context) {
    boost::shared_ptr<ICIMClass> primary = TryClass(Selected(context), name, context);
    boost::shared_ptr<ICIMClass> records = TryClass(*fRecords, name, context);
    if (primary && records) return boost::make_shared<TUnionClass>(primary, records);
    if (primary) return primary;
    if (records) return records;
    throw TTKRException(NORVTKR20::kNotFound);
}

boost::shared_ptr<NORVTKR20::ICIMInstance> TNamespaceView::GetInstance(const TCIMReference& path,
                                                                       const TCIMContext& context) {
    try {
        return Selected(context).GetInstance(path, context);
    } catch (const TTKRException& ex) {
        if (ex.fStatusCode.fStatusCode != NORVTKR20::kNotFound) throw;
    }
    return fRecords->GetInstance(path, context);
}

TCIMContext TNamespaceView::MakeContext() const {
    TCIMContext context;
    context["nNamespaces"] = TCIMValue(GetNamespaceCount());
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));
    return context;
}

}  // namespace repository
}  // namespace braigrion
