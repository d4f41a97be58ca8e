#include "CollectionLoader.h"

#include <sys/stat.h>

namespace braigrion {
namespace cli {

repository::TLoadResult LoadFiles(const std::vector<std::string>& files) {
    if (files.empty()) throw TInputError("no collection file given");
    for (const std::string& file : files) {
        struct stat st;
        if (::stat(file.c_str(), &st) != 0) throw TInputError(file + ": no such file");
        if (!S_ISREG(st.st_mode)) throw TInputError(file + ": not a regular file");
    }
    try {
        return repository::LoadCollection(files);
    } catch (const repository::TLoadError& ex) {
        throw TInputError(ex.what());
    }
}

}  // namespace cli
}  // namespace braigrion
