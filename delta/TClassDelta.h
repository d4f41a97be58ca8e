// The differences of one report class across the collections of a delta
// view. The comparison of plain properties is made before the report runs
// and stands in the repository as ORVSG_Delta records, gathered under one
// ORVSG_DeltaClass instance per compared class; a TClassDelta reads those
// records for its table, groups them per instance (TInstanceDelta), compares
// the columns reached through an association itself, and links instances
// along the page's associations so that a dependent's difference is written
// under its parent.
//
// All collections stand behind one namespace: the context key "nsIndex"
// selects the one a call sees, "nNamespaces" holds their number. Index 0 is
// the baseline of every comparison.
#pragma once

#include <cstdint>
#include <map>
#include <set>
#include <string>
#include <vector>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>

#include "braigrion/TReportClass.h"
#include "braigrion/TWriter.h"
#include "tkrcore/CIMInterfaces.h"

namespace braigrion {

class TInstanceDelta;

// Bits of the "Type" property of a delta record.
enum EDeltaType : std::uint8_t {
    kDeltaMissing = 1,   // the instance is missing from the listed sources
    kDeltaUnique = 2,    // the instance exists only in the listed sources
    kDeltaProperty = 4,  // a property differs; the listed sources show their value
};

class TClassDelta : public boost::enable_shared_from_this<TClassDelta> {
public:
    typedef std::map<std::string, NORVTKR20::TCIMValue> TContext;
    typedef boost::shared_ptr<NORVTKR20::ICIMNamespace> TNamespacePtr;
    typedef boost::shared_ptr<NORVTKR20::ICIMInstance> TInstancePtr;
    typedef std::vector<TInstancePtr> TInstances;

    // `reportClass` is not owned and must outlive this object.
    TClassDelta(TNamespacePtr ns, TContext context, boost::shared_ptr<TClassDelta> backAssociatedClass,
                TReportClass* reportClass);

    // --- run-wide state, from the writer's set-up to its disposal ---

    // Maps each compared class to its ORVSG_DeltaClass instance and labels
    // the data sources: by host name when the collections come from
    // different machines (different serial numbers), by collection time when
    // they are one machine at several times.
    static void Init(TNamespacePtr ns, TContext context);
    // Forgets the class map; the labels stay.
    static void Uninit();
    // The records of `className` and its subclasses, each once.
    static void FindDeltas(TNamespacePtr ns, const std::string& className, TInstances& result);
    static const std::vector<std::string>& GetDeltaContainerNames() { return fDeltaContainerNames; }
    // The context the run was set up with ("nNamespaces" among its keys).
    static const TContext& GetRunContext() { return fRunContext; }

    // --- the tree of one report class ---

    // Reads and groups the records of this class, compares its association
    // columns, links it to its parent and builds its dependent classes.
    void CreateDeltaInstances(TWriter* writer);
    void CreateDeltaAssocProperties(TWriter* writer);
    void CreateDeltaAssocProperties(TWriter* writer, const TReportProperty& property,
                                    const std::string& associationTarget, const std::string& associationClass,
                                    const std::string& propertyName);
    // The reference reduced to the key properties the records of this class
    // name their instances by, so that the same instance of two collections
    // gives the same path.
    NORVTKR20::TCIMReference ConvertReference(const NORVTKR20::TCIMReference& reference, const TContext& context);
    // Links each instance of this class to its dependents, and to its parent.
    void CreateDeltaAssocDependencies();
    void CreateDeltaBackAssocDependencies();
    // A debugging print of the tree on standard output.
    void DumpDeltas();
    // Breaks the links of the tree (owners, parents, dependents), which
    // point both ways, so that it is freed when the last handle goes.
    void Release();

    const std::map<std::string, boost::shared_ptr<TInstanceDelta>>& GetInstanceDeltas() const {
        return fInstanceDeltas;
    }
    const std::vector<boost::shared_ptr<TClassDelta>>& GetChildClassDeltas() const { return fChildClassDeltas; }
    boost::shared_ptr<TClassDelta> GetBackAssociatedClass() const { return fBackAssociatedClass; }
    TReportClass& GetReportClass() const { return *fReportClass; }
    const TNamespacePtr& GetNamespace() const { return fNamespace; }
    const TContext& GetContext() const { return fContext; }
    size_t NamespaceCount() const { return fDeltaContainerNames.size(); }

private:
    // The entry of `name`, made (with one slot per collection) when absent.
    boost::shared_ptr<TInstanceDelta> Entry(const std::string& name);
    // Links through the association of `childClass` (forward: from this
    // class's instances to `far`'s) or of this class (backward: to the
    // parent's instances).
    void LinkAlong(TClassDelta& far, const TReportClass& relation, bool forward);
    TInstancePtr Resolve(const std::string& name, unsigned short index) const;
    // The records of this class; none when the class is absent.
    void FindRecords(TInstances& records) const;
    TContext At(unsigned short index) const;

    static std::map<std::string, TInstancePtr> fClassName2DeltaClass;
    static std::vector<std::string> fDeltaContainerNames;
    static TContext fRunContext;

    std::map<std::string, boost::shared_ptr<TInstanceDelta>> fInstanceDeltas;
    TNamespacePtr fNamespace;
    boost::shared_ptr<TClassDelta> fBackAssociatedClass;
    TContext fContext;
    TReportClass* fReportClass;
    bool fKeyNamesKnown;
    std::vector<std::string> fKeyNames;
    std::vector<boost::shared_ptr<TClassDelta>> fChildClassDeltas;
};

class TInstanceDelta : public boost::enable_shared_from_this<TInstanceDelta> {
public:
    typedef TClassDelta::TInstancePtr TInstancePtr;
    // Entries already written in one pass over a page, so that an instance
    // linked under two parents, or along a cycle, is written once.
    typedef std::set<const TInstanceDelta*> TWritten;

    TInstanceDelta(boost::shared_ptr<TClassDelta> classDelta, const std::string& name);

    // This entry when one of its own records has `type`, else the first
    // dependent that has one, else empty.
    boost::shared_ptr<TInstanceDelta> FindDeltaInstanceWithDeltas(std::uint8_t type);
    // Whether this entry or a dependent carries a difference of `type`
    // (a record or a compared association column).
    bool HasDeltaTypeBelow(std::uint8_t type) const;

    // The instance's identification, then its differences as tables of the
    // data sources against the baseline, then its dependents'.
    void WritePropertyDeltaTable(TWriter* writer);
    void WritePropertyDeltaTable(TWriter* writer, TWritten& written);
    // "Missing from ..." (`missing`) or "Unique to ..." and the instance.
    void WriteMissingOrExtraDeltaTable(TWriter* writer, bool missing);
    void WriteMissingOrExtraDeltaTable(TWriter* writer, bool missing, bool parentShown, TWritten& written);

    boost::shared_ptr<TClassDelta> fClassDelta;
    std::string fName;
    std::vector<boost::shared_ptr<TInstanceDelta>> fChildren;
    std::map<std::string, std::vector<std::string>> fAssocDeltas;
    std::vector<TInstancePtr> fInstances;
    std::vector<TInstancePtr> fDeltas;
    std::uint8_t fDeltaTypes;

    // Adds a dependent once.
    void AddChild(const boost::shared_ptr<TInstanceDelta>& child);

private:
    // The first collection index holding the instance, or -1.
    int FirstSlot() const;
    void WriteIdentification(TWriter* writer, TInstancePtr instance, unsigned short index);
};

// Reads a delta record's "NamespaceIndices" (absent or null: none).
std::vector<unsigned short> DeltaIndices(const TClassDelta::TInstancePtr& record);
// Reads a delta record's "Type" (0 when unreadable) and its other texts.
std::uint8_t DeltaType(const TClassDelta::TInstancePtr& record);
std::string DeltaText(const TClassDelta::TInstancePtr& record, const std::string& property);

}  // namespace braigrion
