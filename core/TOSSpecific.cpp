#include "tkrcore/TOSSpecific.h"

#include <sys/stat.h>

namespace NORVTKR20 {

const std::string TOSSpecific::kFileSeparator = "/";

bool TOSSpecific::FileExists(std::string path) {
    struct stat st;
    return ::stat(path.c_str(), &st) == 0 && S_ISREG(st.st_mode);
}

}  // namespace NORVTKR20
