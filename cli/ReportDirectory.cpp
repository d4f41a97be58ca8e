#include "ReportDirectory.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <stdexcept>

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include "CollectionLoader.h"

namespace fs = std::filesystem;

namespace braigrion {
namespace cli {

const char* const TReportDirectory::kMarkerName = ".braigrion-report";

namespace {

// The work directory of the running report, for the signal handler. Only
// one report is written per process.
char gWorkPath[4096];
struct sigaction gPrevious[3];
const int kSignals[3] = {SIGINT, SIGTERM, SIGHUP};

// Removes the work directory and ends the process as the signal would have.
// Only async-signal-safe calls: the removal runs in a child process.
void OnSignal(int signal) {
    if (gWorkPath[0] != '\0') {
        pid_t child = fork();
        if (child == 0) {
            char rm[] = "/bin/rm";
            char flags[] = "-rf";
            char end[] = "--";
            char* argv[] = {rm, flags, end, gWorkPath, nullptr};
            execv(rm, argv);
            _exit(127);
        }
        if (child > 0) waitpid(child, nullptr, 0);
    }
    ::signal(signal, SIG_DFL);
    raise(signal);
}

void InstallHandlers(const std::string& work) {
    std::snprintf(gWorkPath, sizeof gWorkPath, "%s", work.c_str());
    struct sigaction action;
    std::memset(&action, 0, sizeof action);
    action.sa_handler = OnSignal;
    sigemptyset(&action.sa_mask);
    for (int i = 0; i < 3; ++i) sigaction(kSignals[i], &action, &gPrevious[i]);
}

void RemoveHandlers() {
    for (int i = 0; i < 3; ++i) sigaction(kSignals[i], &gPrevious[i], nullptr);
    gWorkPath[0] = '\0';
}

std::string Errno() {
    return std::strerror(errno);
}

// The prefix of the work directories of `target`: hidden, beside it, named
// after it and the process that writes them.
std::string WorkPrefix(const fs::path& target) {
    return "." + target.filename().string() + ".braigrion-";
}

// Removes work directories of earlier runs whose process is gone.
void RemoveStaleWork(const fs::path& target) {
    std::string prefix = WorkPrefix(target);
    std::error_code ec;
    for (const fs::directory_entry& entry : fs::directory_iterator(target.parent_path(), ec)) {
        std::string name = entry.path().filename().string();
        if (name.compare(0, prefix.size(), prefix) != 0) continue;
        long pid = std::strtol(name.c_str() + prefix.size(), nullptr, 10);
        if (pid <= 0 || pid == static_cast<long>(getpid())) continue;
        if (kill(static_cast<pid_t>(pid), 0) == 0 || errno != ESRCH) continue;
        std::error_code ignored;
        fs::remove_all(entry.path(), ignored);
    }
}

}  // namespace

TReportDirectory::TReportDirectory(const std::string& target, bool force) : fCommitted(false) {
    if (target.empty()) throw TInputError("no output directory given");
    fs::path path = fs::absolute(fs::path(target)).lexically_normal();
    if (path.filename().empty()) path = path.parent_path();  // a trailing "/"
    if (path == path.root_path()) throw TInputError(target + ": cannot write a report over the root directory");
    fTarget = path.string();

    struct stat st;
    if (::lstat(fTarget.c_str(), &st) == 0) {
        if (!S_ISDIR(st.st_mode)) throw TInputError(target + ": exists and is not a directory");
        std::error_code ec;
        bool empty = fs::is_empty(path, ec);
        bool report = fs::exists(path / kMarkerName, ec);
        if (!empty && !report && !force) {
            throw TInputError(target + ": exists and is not a braigrion report; use --force to replace it");
        }
    } else if (errno != ENOENT) {
        throw std::runtime_error(target + ": " + Errno());
    }

    RemoveStaleWork(path);
    std::string pattern = (path.parent_path() / (WorkPrefix(path) + std::to_string(getpid()) + "-XXXXXX")).string();
    std::vector<char> buffer(pattern.begin(), pattern.end());
    buffer.push_back('\0');
    if (::mkdtemp(buffer.data()) == nullptr) {
        throw std::runtime_error(target + ": cannot create the report beside it: " + Errno());
    }
    fWork = buffer.data();
    ::chmod(fWork.c_str(), 0755);  // mkdtemp makes it private; a report is not
    InstallHandlers(fWork);
}

TReportDirectory::~TReportDirectory() {
    if (!fCommitted) {
        std::error_code ignored;
        fs::remove_all(fWork, ignored);
    }
    RemoveHandlers();
}

void TReportDirectory::Commit(const std::string& format) {
    {
        std::ofstream marker((fs::path(fWork) / kMarkerName).string());
        marker << "braigrion report\nformat " << format << "\n";
        if (!marker) throw std::runtime_error(fWork + ": cannot write the report marker");
    }
    if (::rename(fWork.c_str(), fTarget.c_str()) == 0) {
        fCommitted = true;
        return;
    }
    if (errno != EEXIST && errno != ENOTEMPTY) {
        throw std::runtime_error(fTarget + ": cannot put the report in place: " + Errno());
    }
    // An earlier report stands there: swap the two in one step, then
    // remove the earlier one from the work directory's name.
    if (::renameat2(AT_FDCWD, fWork.c_str(), AT_FDCWD, fTarget.c_str(), RENAME_EXCHANGE) != 0) {
        if (errno != EINVAL && errno != ENOSYS) {
            throw std::runtime_error(fTarget + ": cannot put the report in place: " + Errno());
        }
        // A file system without exchange: two renames, the earlier report
        // under a name of its own in between.
        std::string old = fWork + "-old";
        if (::rename(fTarget.c_str(), old.c_str()) != 0) {
            throw std::runtime_error(fTarget + ": cannot move the earlier report aside: " + Errno());
        }
        if (::rename(fWork.c_str(), fTarget.c_str()) != 0) {
            int error = errno;
            ::rename(old.c_str(), fTarget.c_str());
            errno = error;
            throw std::runtime_error(fTarget + ": cannot put the report in place: " + Errno());
        }
        ::rename(old.c_str(), fWork.c_str());
    }
    fCommitted = true;
    std::error_code ignored;
    fs::remove_all(fWork, ignored);  // now the earlier report
}

}  // namespace cli
}  // namespace braigrion
