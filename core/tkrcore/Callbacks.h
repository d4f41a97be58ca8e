// Function objects that collect what an enumeration delivers.
#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "tkrcore/TCIMValue.h"

namespace NORVTKR20 {

template <typename T>
class TAddToVectorCallback {
public:
    explicit TAddToVectorCallback(std::vector<boost::shared_ptr<T>>& target) : fTarget(&target) {}
    bool operator()(boost::shared_ptr<T> element) const {
        fTarget->push_back(element);
        return true;
    }

private:
    std::vector<boost::shared_ptr<T>>* fTarget;
};

class TAddKeyBindingsToMapCallback {
public:
    explicit TAddKeyBindingsToMapCallback(std::map<std::string, TCIMValue>& target) : fTarget(&target) {}
    bool operator()(std::pair<std::string, TCIMValue> binding) const {
        (*fTarget)[binding.first] = binding.second;
        return true;
    }

private:
    std::map<std::string, TCIMValue>* fTarget;
};

}  // namespace NORVTKR20
