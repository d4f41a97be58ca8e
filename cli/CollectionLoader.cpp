#include "CollectionLoader.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace braigrion {
namespace cli {

repository::TLoadResult LoadFiles(const std::vector<std::string>& files) {
    if (files.empty()) throw TInputError("no collection file given");
    for (const std::string& file : files) {
        const std::string shown = repository::ShownFileName(file);
        struct stat st;
        if (::stat(file.c_str(), &st) != 0) {
            // Say why: a missing file, a symbolic link loop, a directory on
            // the way that may not be searched...
            throw TInputError(shown + (errno == ENOENT ? std::string(": no such file") : ": " + std::string(std::strerror(errno))));
        }
        if (!S_ISREG(st.st_mode)) throw TInputError(shown + ": not a regular file");
        if (::access(file.c_str(), R_OK) != 0) throw TInputError(shown + ": cannot read: " + std::strerror(errno));
    }
    try {
        return repository::LoadCollection(files);
    } catch (const repository::TLoadError& ex) {
        throw TInputError(ex.what());
    }
}

}  // namespace cli
}  // namespace braigrion
