// A view over several collections behind one namespace, as a delta report
// reads them: the context key "nsIndex" selects the collection a call sees,
// and the view's own records (the delta records) are seen at every index.
#pragma once

#include <vector>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>

#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

class TNamespaceView : public NORVTKR20::ICIMNamespace {
public:
    // `records` holds the view's own classes and instances; it may be empty.
    TNamespaceView(std::vector<boost::shared_ptr<TMemoryNamespace>> collections,
                   boost::shared_ptr<TMemoryNamespace> records);

    // Answers 1: a delta view.
    boost::shared_ptr<NORVTKR20::INamespaceProvider> GetNamespaceProvider(const TCIMContext& context) override;
    // The class of the selected collection; when the view's records declare
    // it too, one class whose enumeration yields both.
    boost::shared_ptr<NORVTKR20::ICIMClass> GetClass(const std::string& name, const TCIMContext& context) override;
    boost::shared_ptr<NORVTKR20::ICIMInstance> GetInstance(const TCIMReference& path,
                                                           const TCIMContext& context) override;

    unsigned short GetNamespaceCount() const { return static_cast<unsigned short>(fCollections.size()); }
    const boost::shared_ptr<TMemoryNamespace>& GetCollection(size_t index) const { return fCollections.at(index); }
    const boost::shared_ptr<TMemoryNamespace>& GetRecords() const { return fRecords; }
    // A context with "nNamespaces" set, and "nsIndex" 0.
    TCIMContext MakeContext() const;

private:
    TMemoryNamespace& Selected(const TCIMContext& context) const;

    std::vector<boost::shared_ptr<TMemoryNamespace>> fCollections;
    boost::shared_ptr<TMemoryNamespace> fRecords;
};

// The collection index a context selects: "nsIndex", 0 when absent.
unsigned short SelectedIndex(const TCIMContext& context);

}  // namespace repository
}  // namespace braigrion
