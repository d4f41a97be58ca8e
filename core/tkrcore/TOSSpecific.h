// Operating-system helpers.
#pragma once

#include <string>

namespace NORVTKR20 {

class TOSSpecific {
public:
    static const std::string kFileSeparator;
    static bool FileExists(std::string path);
};

}  // namespace NORVTKR20
