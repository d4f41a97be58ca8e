// Computing the delta records of several collections: what the delta report
// reads to learn which instances differ between them.
//
// Instances of different collections are the same instance when their
// object paths agree on the key properties that do not name the host (see
// IsHostKeyName and ComputeDeltaRecords). Collection 0 is the baseline.
// For each class with instances, records of ORVSG_Delta are made:
//   Type 1  the instance is in the baseline but missing from the listed
//           collections;
//   Type 2  the instance is not in the baseline; the listed collections are
//           those that hold it;
//   Type 4  one property ("Property") differs from the baseline in some
//           collection; the listed collections are the baseline (0) and each
//           collection whose value differs.
// "InstanceName" is the instance's object path reduced to its matching keys.
// The records of one class hang under its ORVSG_DeltaClass instance through
// ORVSG_DeltaClassAssocToDelta.
#pragma once

#include <cstddef>
#include <set>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "repository/MemoryRepository.h"

namespace braigrion {
namespace repository {

struct TDeltaSummary {
    size_t fClasses = 0;         // classes compared
    size_t fInstances = 0;       // instances seen, over all collections
    size_t fMissing = 0;         // type 1 records
    size_t fUnique = 0;          // type 2 records
    size_t fPropertyDeltas = 0;  // type 4 records
    // Classes whose keys could not tell instances apart, so that their
    // instances were matched by their values.
    std::vector<std::string> fNamedByValues;
};

// Key names that name the host rather than the instance: "SystemName",
// "CSName", "HostName" and any name ending in "SystemName", in any case.
bool IsHostKeyName(const std::string& name);

// Declares ORVSG_DeltaClass, ORVSG_Delta and ORVSG_DeltaClassAssocToDelta.
void DeclareDeltaClasses(TMemoryNamespace& records);

// Adds records to a collection that holds the declarations: each record
// under the ORVSG_DeltaClass instance of its class, made on first use.
class TDeltaRecordWriter {
public:
    explicit TDeltaRecordWriter(boost::shared_ptr<TMemoryNamespace> records);
    // Adds one record and returns its "InstanceID". "Property" is written
    // for type 4 only.
    std::string Add(const std::string& className, unsigned type, const std::string& property,
                    const std::string& instanceName, const std::vector<unsigned short>& indices);
    // Hangs an existing record under the class `className` as well.
    void Attach(const std::string& className, const std::string& recordID);

private:
    TCIMReference ClassPath(const std::string& className);

    boost::shared_ptr<TMemoryNamespace> fRecords;
    std::set<std::string> fClassNames;
    size_t fCount = 0;
};

// Compares the collections (at least two) and returns a new collection
// holding the declarations and the records. Association classes, which the
// report follows itself, and reference properties are not compared.
// A key is left out of the matching when its name names the host, or when
// its value is one of its collection's host names (the "Name" of
// ORVSG_ComputerSystem, the "HostName" of ORVSG_IPService and of
// ORVSG_CollectionInfo, each also without its domain). Should the keys left
// fail to tell the instances of one collection apart, the class is matched
// by all its keys; should those fail too (a collector that left a key
// property out), its instances are named by every scalar value that does
// not name the host, and identical instances of one collection are paired
// in order with those of the others.
boost::shared_ptr<TMemoryNamespace> ComputeDeltaRecords(
    const std::vector<boost::shared_ptr<TMemoryNamespace>>& collections, TDeltaSummary* summary = nullptr);

}  // namespace repository
}  // namespace braigrion
