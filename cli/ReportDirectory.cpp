#include "ReportDirectory.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <set>
#include <stdexcept>

#include <fcntl.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include "CollectionLoader.h"
#include "repository/CIMXMLReader.h"

namespace fs = std::filesystem;

namespace braigrion {
namespace cli {

using repository::ShownFileName;

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

// True for the name mkdtemp gave a work directory of `target`: the prefix,
// a process id, '-' and six letters or digits.
bool IsWorkName(const std::string& name, const std::string& prefix, long& pid) {
    if (name.compare(0, prefix.size(), prefix) != 0) return false;
    const char* digits = name.c_str() + prefix.size();
    char* end = nullptr;
    pid = std::strtol(digits, &end, 10);
    if (end == digits || pid <= 0 || *end != '-') return false;
    const std::string suffix(end + 1);
    if (suffix.size() != 6) return false;
    for (char c : suffix)
        if (!std::isalnum(static_cast<unsigned char>(c))) return false;
    return true;
}

// Removes work directories of earlier runs whose process is gone. Only real
// directories named as this program names them: never a file or a link.
void RemoveStaleWork(const fs::path& target) {
    std::string prefix = WorkPrefix(target);
    std::error_code ec;
    for (const fs::directory_entry& entry : fs::directory_iterator(target.parent_path(), ec)) {
        std::string name = entry.path().filename().string();
        long pid = 0;
        if (!IsWorkName(name, prefix, pid) || pid == static_cast<long>(getpid())) continue;
        struct stat st;
        if (::lstat(entry.path().c_str(), &st) != 0 || !S_ISDIR(st.st_mode)) continue;
        if (kill(static_cast<pid_t>(pid), 0) == 0 || errno != ESRCH) continue;
        std::error_code ignored;
        fs::remove_all(entry.path(), ignored);
    }
}

const char kMarkerFirstLine[] = "braigrion report";

// A path that names a file inside the report: relative, without empty, "."
// or ".." steps.
bool IsInsidePath(const std::string& rel) {
    if (rel.empty() || rel[0] == '/') return false;
    size_t start = 0;
    while (start <= rel.size()) {
        size_t end = rel.find('/', start);
        if (end == std::string::npos) end = rel.size();
        const std::string step = rel.substr(start, end - start);
        if (step.empty() || step == "." || step == "..") return false;
        start = end + 1;
    }
    return true;
}

// Reads the marker of `dir`: false when there is none or it is not one this
// program wrote (an empty file, say); otherwise the files it lists.
bool ReadMarker(const fs::path& dir, std::set<std::string>& files) {
    const fs::path marker = dir / TReportDirectory::kMarkerName;
    struct stat st;
    if (::lstat(marker.c_str(), &st) != 0 || !S_ISREG(st.st_mode)) return false;
    std::ifstream in(marker.string());
    std::string line;
    if (!std::getline(in, line) || line != kMarkerFirstLine) return false;
    while (std::getline(in, line)) {
        if (line.compare(0, 7, "format ") == 0) continue;
        if (line.compare(0, 5, "file ") != 0 || !IsInsidePath(line.substr(5))) return false;
        files.insert(line.substr(5));
    }
    return true;
}

// The files under `dir` (links count as files), relative, sorted, the marker left out.
std::vector<std::string> FilesUnder(const fs::path& dir) {
    std::vector<std::string> files;
    for (const fs::directory_entry& entry : fs::recursive_directory_iterator(dir)) {
        if (entry.is_directory() && !entry.is_symlink()) continue;
        const std::string rel = entry.path().lexically_relative(dir).string();
        if (rel != TReportDirectory::kMarkerName) files.push_back(rel);
    }
    std::sort(files.begin(), files.end());
    return files;
}

// True when everything in `dir` is the marker, a listed file, or a directory
// on the way to one: a directory that only an earlier report fills.
bool OnlyReportFiles(const fs::path& dir, const std::set<std::string>& listed) {
    std::set<std::string> ways;
    for (const std::string& file : listed) {
        for (size_t slash = file.find('/'); slash != std::string::npos; slash = file.find('/', slash + 1))
            ways.insert(file.substr(0, slash));
    }
    std::error_code ec;
    for (fs::recursive_directory_iterator it(dir, ec), end; !ec && it != end; it.increment(ec)) {
        const std::string rel = it->path().lexically_relative(dir).string();
        if (rel == TReportDirectory::kMarkerName) continue;
        const bool isDirectory = it->is_directory() && !it->is_symlink();
        if (isDirectory ? ways.count(rel) == 0 : listed.count(rel) == 0) return false;
    }
    return !ec;
}

}  // namespace

void TReportDirectory::MoveInAmong(const std::vector<std::string>& files) {
    const fs::path target(fTarget), work(fWork);
    std::set<std::string> earlier;
    ReadMarker(target, earlier);
    const std::set<std::string> now(files.begin(), files.end());
    // First make sure that nothing of someone else's would be replaced, and
    // that no directory on the way is a link leading out of the target.
    for (const std::string& file : files) {
        std::string way;
        for (size_t slash = file.find('/'); slash != std::string::npos; slash = file.find('/', slash + 1)) {
            way = file.substr(0, slash);
            struct stat st;
            if (::lstat((target / way).c_str(), &st) == 0 && !S_ISDIR(st.st_mode)) {
                throw std::runtime_error(ShownFileName(fTarget) + ": holds " + ShownFileName(way) +
                                         " where the report puts a directory; nothing was replaced");
            }
        }
        struct stat st;
        if (::lstat((target / file).c_str(), &st) == 0 && (earlier.count(file) == 0 || S_ISDIR(st.st_mode))) {
            throw std::runtime_error(ShownFileName(fTarget) + ": holds " + ShownFileName(file) +
                                     ", which the report did not write; nothing was replaced");
        }
    }
    struct stat marker;
    if (::lstat((target / kMarkerName).c_str(), &marker) == 0 && S_ISDIR(marker.st_mode)) {
        throw std::runtime_error(ShownFileName(fTarget) + ": holds a directory " + kMarkerName +
                                 " where the report puts its marker; nothing was replaced");
    }
    // The files of the earlier report that this one does not write go.
    for (const std::string& file : earlier) {
        struct stat st;
        if (now.count(file) || ::lstat((target / file).c_str(), &st) != 0) continue;
        if (S_ISREG(st.st_mode) || S_ISLNK(st.st_mode)) ::unlink((target / file).c_str());
    }
    for (const std::string& file : files) {
        fs::create_directories((target / file).parent_path());
        if (::rename((work / file).c_str(), (target / file).c_str()) != 0) {
            throw std::runtime_error(ShownFileName(fTarget) + ": cannot put " + ShownFileName(file) +
                                     " in place: " + Errno());
        }
    }
    // The marker last: until it stands, the directory is no complete report.
    if (::rename((work / kMarkerName).c_str(), (target / kMarkerName).c_str()) != 0) {
        throw std::runtime_error(ShownFileName(fTarget) + ": cannot put the report marker in place: " + Errno());
    }
    fCommitted = true;
    std::error_code ignored;
    fs::remove_all(work, ignored);
}

TReportDirectory::TReportDirectory(const std::string& target, bool force) : fCommitted(false) {
    if (target.empty()) throw TInputError("no output directory given");
    const std::string shown = ShownFileName(target);
    fs::path path = fs::absolute(fs::path(target)).lexically_normal();
    if (path.filename().empty()) path = path.parent_path();  // a trailing "/"
    if (path == path.root_path()) throw TInputError(shown + ": cannot write a report over the root directory");
    fTarget = path.string();

    struct stat st;
    if (::lstat(fTarget.c_str(), &st) == 0) {
        if (!S_ISDIR(st.st_mode)) throw TInputError(shown + ": exists and is not a directory");
        std::error_code ec;
        bool empty = fs::is_empty(path, ec);
        std::set<std::string> listed;
        bool report = ReadMarker(path, listed);
        if (!empty && !report && !force) {
            throw TInputError(shown +
                              ": exists and is not a braigrion report; use --force to write the report among its "
                              "files (none of them is removed or replaced)");
        }
    } else if (errno != ENOENT) {
        throw std::runtime_error(shown + ": " + Errno());
    }

    RemoveStaleWork(path);
    std::string pattern = (path.parent_path() / (WorkPrefix(path) + std::to_string(getpid()) + "-XXXXXX")).string();
    std::vector<char> buffer(pattern.begin(), pattern.end());
    buffer.push_back('\0');
    if (::mkdtemp(buffer.data()) == nullptr) {
        throw std::runtime_error(shown + ": cannot create the report beside it: " + Errno());
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
    const std::vector<std::string> files = FilesUnder(fWork);
    {
        std::ofstream marker((fs::path(fWork) / kMarkerName).string());
        marker << kMarkerFirstLine << "\nformat " << format << "\n";
        for (const std::string& file : files) marker << "file " << file << "\n";
        if (!marker) throw std::runtime_error(fWork + ": cannot write the report marker");
    }
    if (::rename(fWork.c_str(), fTarget.c_str()) == 0) {
        fCommitted = true;
        return;
    }
    if (errno != EEXIST && errno != ENOTEMPTY) {
        throw std::runtime_error(ShownFileName(fTarget) + ": cannot put the report in place: " + Errno());
    }
    std::set<std::string> earlier;
    if (!ReadMarker(fTarget, earlier) || !OnlyReportFiles(fTarget, earlier)) {
        // Files of someone else's stand there: they stay.
        MoveInAmong(files);
        return;
    }
    // An earlier report, and nothing else, stands there: swap the two in one
    // step, then remove the earlier one from the work directory's name.
    if (::renameat2(AT_FDCWD, fWork.c_str(), AT_FDCWD, fTarget.c_str(), RENAME_EXCHANGE) != 0) {
        if (errno != EINVAL && errno != ENOSYS) {
            throw std::runtime_error(ShownFileName(fTarget) + ": cannot put the report in place: " + Errno());
        }
        // A file system without exchange: the files one by one.
        MoveInAmong(files);
        return;
    }
    fCommitted = true;
    std::error_code ignored;
    fs::remove_all(fWork, ignored);  // now the earlier report
}

}  // namespace cli
}  // namespace braigrion
