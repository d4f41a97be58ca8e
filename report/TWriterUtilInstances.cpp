// The repository helpers of TWriterUtil: the properties behind a column,
// dates, display names, and the instances of a table, filtered and sorted.
#include <algorithm>
#include <cstdint>
#include <numeric>

#include "braigrion/TWriterUtil.h"
#include "braigrion/Trace.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TCIMDateTime.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::ICIMQualifier;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMDateTime;
using NORVTKR20::TCIMValue;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;

namespace {

// The sort keys of all instances, read and split once:
// tokens[row * keyCount + key]. Rows compare as the sorter compares their
// instances (TInstanceSorter::operator()), without reading them again.
class TSortKeys {
public:
    TSortKeys(const std::vector<boost::shared_ptr<ICIMInstance>>& instances, const TInstanceSorter& sorter)
        : fKeyCount(sorter.GetProperties().size()), fConsistent(true) {
        for (const TInstanceSorter::TPropertyInfo& key : sorter.GetProperties()) fAscending.push_back(key.Ascending);
        fTokens.resize(instances.size() * fKeyCount);
        std::uint64_t lowest = UINT64_MAX;
        std::uint64_t highest = 0;
        std::size_t slot = 0;
        for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
            for (const TInstanceSorter::TPropertyInfo& key : sorter.GetProperties()) {
                std::vector<TInstanceSorter::TToken>& tokens = fTokens[slot++];
                TInstanceSorter::PropertySplit(TInstanceSorter::GetFinalPropertyValue(key.Property, instance), tokens,
                                               true);
                for (const TInstanceSorter::TToken& token : tokens) {
                    if (token.first != TInstanceSorter::kNumberToken) continue;
                    lowest = std::min(lowest, token.second.number);
                    highest = std::max(highest, token.second.number);
                }
            }
        }
        // Numbers compare by their signed difference, which orders them
        // truly only while no two lie 2^63 or more apart.
        fConsistent = highest < lowest || highest - lowest <= static_cast<std::uint64_t>(INT64_MAX);
    }

    // The sorter's order: the first key on which two rows differ decides,
    // reversed for a descending key; rows equal on every key tie.
    bool Less(std::size_t a, std::size_t b) const {
        for (std::size_t k = 0; k < fKeyCount; ++k) {
            int r = TInstanceSorter::CompareTokens(fTokens[a * fKeyCount + k], fTokens[b * fKeyCount + k]);
            if (r == 0) continue;
            return fAscending[k] ? r < 0 : r > 0;
        }
        return false;
    }

    // Whether Less is a strict weak ordering over these rows. It is not when
    // numbers 2^63 or more apart meet: their comparison can then go round
    // in a circle, which only a merging sort survives.
    bool IsConsistent() const { return fConsistent; }

    // The comparison as the sort algorithms take it: by value, so it only
    // refers to the tokens.
    struct TLess {
        const TSortKeys* keys;
        bool operator()(std::size_t a, std::size_t b) const { return keys->Less(a, b); }
    };

private:
    std::size_t fKeyCount;
    bool fConsistent;
    std::vector<bool> fAscending;
    std::vector<std::vector<TInstanceSorter::TToken>> fTokens;
};

}  // namespace

std::vector<TWriterUtil::TPropertyPtr> TWriterUtil::GetProperties(TInstancePtr instance, const std::string& property,
                                                                 const std::string& assocClass,
                                                                 const std::string& assocTarget) {
    std::vector<TPropertyPtr> properties;
    TCIMContext context;
    try {
        if (assocClass.empty() && assocTarget.empty()) {
            properties.push_back(instance->GetProperty(property, context));
            return properties;
        }
        std::vector<TInstancePtr> associated;
        instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(associated), assocClass, assocTarget,
                                               "", "", context);
        for (const TInstancePtr& target : associated) {
            try {
                properties.push_back(target->GetProperty(property, context));
            } catch (const TTKRException& ex) {
                if (!IsNotFound(ex)) throw;
            }
        }
    } catch (const std::exception&) {
        // A missing class or property, or any other failure of the
        // repository, leaves what was found: the column shows less.
    }
    return properties;
}

std::string TWriterUtil::GetDateTime(const TCIMValue& value, bool /*noTimePrecision*/) {
    if (value.IsNull()) return std::string();
    if (!value.IsArray()) return static_cast<TCIMDateTime>(value).ToUIString();
    const std::vector<TCIMValue>& elements = value;
    std::string text;
    for (std::vector<TCIMValue>::size_type i = 0; i < elements.size(); ++i) {
        if (i > 0) text += " ";
        text += static_cast<TCIMDateTime>(elements[i]).ToUIString();
    }
    return text;
}

std::string TWriterUtil::GetDisplayName(TPropertyDeclPtr declaration) {
    TCIMContext context;
    try {
        bool propagated = false;
        boost::shared_ptr<const ICIMQualifier> qualifier =
            declaration->GetQualifier("DisplayName", propagated, context);
        return static_cast<std::string>(qualifier->GetValue(context));
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw TTKRException(ex.fStatusCode);
    }
    return declaration->GetName(context);
}

bool TWriterUtil::IsPropertyNull(TInstancePtr instance, std::string property) {
    TCIMContext context;
    try {
        return instance->GetProperty(property, context)->GetValue(context).IsNull();
    } catch (const TTKRException&) {
        return true;
    }
}

bool TWriterUtil::PassesFilters(TInstancePtr instance, const TReportClass& reportClass) {
    TCIMContext context;
    for (const TReportClass::TPropertyFilter& filter : reportClass.GetPropertyFilters()) {
        try {
            const TCIMValue& value = instance->GetProperty(filter.GetProperty(), context)->GetValue(context);
            if (value.IsNull()) return false;
            bool holds = value.ToString(10).find(filter.GetValue()) != std::string::npos;
            if (holds == filter.IsExclude()) return false;
        } catch (const TTKRException&) {
            return false;  // an instance without the property has nothing to match
        }
    }
    return true;
}

void TWriterUtil::SortInstances(std::vector<TInstancePtr>& instances, const TInstanceSorter& sorter, bool stable) {
    if (sorter.IsEmpty() || instances.size() < 2) return;
    TSortKeys keys(instances, sorter);
    std::vector<std::size_t> order(instances.size());
    std::iota(order.begin(), order.end(), 0);
    // Sorting positions with the same comparison puts the instances in the
    // very order that sorting them directly would.
    const TSortKeys::TLess less = {&keys};
    if (stable || !keys.IsConsistent()) {
        std::stable_sort(order.begin(), order.end(), less);
    } else {
        std::sort(order.begin(), order.end(), less);
    }
    std::vector<TInstancePtr> sorted;
    sorted.reserve(instances.size());
    for (std::size_t position : order) sorted.push_back(instances[position]);
    instances.swap(sorted);
}

std::vector<TWriterUtil::TInstancePtr> TWriterUtil::GetInstances(TNamespacePtr ns, TReportClass reportClass) {
    std::vector<TInstancePtr> instances;
    TCIMContext context;
    boost::shared_ptr<ICIMClass> cls;
    try {
        if (!ns) return instances;
        cls = ns->GetClass(reportClass.GetClass(), context);
    } catch (const std::exception&) {
        return instances;
    }
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(instances), true, context);

    // One pass: the instances that pass move forward over those that don't.
    std::vector<TInstancePtr>::size_type kept = 0;
    for (std::vector<TInstancePtr>::size_type i = 0; i < instances.size(); ++i) {
        TRootObject::GetCoreLogger()->Log(3, "handle an instance");
        if (!PassesFilters(instances[i], reportClass)) continue;
        if (kept != i) instances[kept] = std::move(instances[i]);
        ++kept;
    }
    instances.resize(kept);

    if (!reportClass.GetInstanceSorter().IsEmpty()) {
        try {
            SortInstances(instances, reportClass.GetInstanceSorter(), false);
        } catch (const std::exception& ex) {
            TRootObject::GetCoreLogger()->Log(0, std::string("Error sorting: ") + ex.what());
        }
    }
    return instances;
}

}  // namespace braigrion
