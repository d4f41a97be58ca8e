// The braigrion command as a user meets it: the info command, --help and
// --version; the runner shared by the command tests.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <string>
#include <vector>

#include "CommandRunner.h"

namespace {

std::string Slurp(int fd) {
    std::string out;
    char buf[4096];
    ssize_t n;
    while ((n = read(fd, buf, sizeof buf)) > 0) out.append(buf, static_cast<size_t>(n));
    return out;
}

std::string Sample(const std::string& file) { return std::string(BRAIGRION_SOURCE_DIR) + "/samples/linux-server/" + file; }


}  // namespace

TCommandResult RunBraigrion(const std::vector<std::string>& args) {
    // CTest runs test cases in parallel processes: keep their files apart.
    static int calls = 0;
    std::string stem = ::testing::TempDir() + "braigrion_cli_" + std::to_string(getpid()) + "_" + std::to_string(++calls);
    std::string outPath = stem + ".out";
    std::string errPath = stem + ".err";
    pid_t pid = fork();
    if (pid == 0) {
        int out = open(outPath.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
        int err = open(errPath.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
        dup2(out, 1);
        dup2(err, 2);
        std::vector<char*> argv;
        argv.push_back(const_cast<char*>(BRAIGRION_EXE));
        for (const auto& a : args) argv.push_back(const_cast<char*>(a.c_str()));
        argv.push_back(nullptr);
        execv(BRAIGRION_EXE, argv.data());
        _exit(127);
    }
    int status = 0;
    waitpid(pid, &status, 0);
    TCommandResult r;
    r.fStatus = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
    int o = open(outPath.c_str(), O_RDONLY), e = open(errPath.c_str(), O_RDONLY);
    r.fOut = Slurp(o);
    r.fErr = Slurp(e);
    close(o);
    close(e);
    return r;
}

TEST(Cli, InfoSummarisesTheSampleCollection) {
    TCommandResult r = RunBraigrion({"info", Sample("schema.xml"), Sample("inventory.xml"), Sample("logs.xml")});
    ASSERT_EQ(0, r.fStatus) << r.fErr;
    EXPECT_NE(std::string::npos, r.fOut.find("ORVSG_ComputerSystem")) << r.fOut;
    EXPECT_NE(std::string::npos, r.fOut.find("Serial number")) << r.fOut;
    EXPECT_EQ(std::string::npos, r.fOut.find("(not recorded)")) << "the sample records all its facts\n" << r.fOut;
}

// Every command has help; the page command's lists the page ids.
TEST(Cli, HelpAndVersionSucceed) {
    struct Case {
        std::vector<std::string> args;
        const char* saying;
    } cases[] = {{{"--help"}, "Usage"}, {{"info", "--help"}, "Usage"}, {{"report", "--help"}, "Usage"},
                 {{"page", "--help"}, "SystemConfig"}, {{"--version"}, "braigrion"}};
    for (const Case& c : cases) {
        TCommandResult r = RunBraigrion(c.args);
        EXPECT_EQ(0, r.fStatus) << c.args[0];
        EXPECT_NE(std::string::npos, r.fOut.find(c.saying)) << r.fOut;
    }
}
