// The braigrion command as a user meets it: exit statuses, messages, --help.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <fstream>
#include <sstream>

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

std::string TempFile(const std::string& name, const std::string& content) {
    std::string path = ::testing::TempDir() + std::to_string(getpid()) + "_" + name;
    std::ofstream(path) << content;
    return path;
}

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

TEST(Cli, ExitStatusTellsUsageAndInputErrorsApart) {
    struct Case {
        std::vector<std::string> args;
        int status;
        const char* saying;
    } cases[] = {
        {{}, 2, "subcommand"},
        {{"info"}, 2, "collection"},
        {{"frobnicate"}, 2, "frobnicate"},
        {{"info", "/nonexistent/collection.xml"}, 2, "/nonexistent/collection.xml: no such file"},
        {{"info", TempFile("truncated.xml", "<?xml version=\"1.0\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">\n<DECLARATION>\n")},
         2, "truncated.xml:"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.saying);
        TCommandResult r = RunBraigrion(c.args);
        EXPECT_EQ(c.status, r.fStatus);
        EXPECT_NE(std::string::npos, r.fErr.find(c.saying)) << r.fErr;
        EXPECT_EQ(1, std::count(r.fErr.begin(), r.fErr.end(), '\n')) << "one line on stderr:\n" << r.fErr;
        EXPECT_TRUE(r.fOut.empty()) << r.fOut;
    }
}

TEST(Cli, HelpAndVersionSucceed) {
    for (const auto& args : std::vector<std::vector<std::string>>{{"--help"}, {"info", "--help"}, {"--version"}}) {
        TCommandResult r = RunBraigrion(args);
        EXPECT_EQ(0, r.fStatus) << args[0];
        EXPECT_NE(std::string::npos, r.fOut.find(args[0] == "--version" ? "braigrion" : "Usage")) << r.fOut;
    }
}
