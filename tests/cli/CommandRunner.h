// Runs the braigrion command in a child process and captures what it says.
#pragma once

#include <string>
#include <vector>

struct TCommandResult {
    int fStatus = -1;
    std::string fOut;
    std::string fErr;
};

TCommandResult RunBraigrion(const std::vector<std::string>& args);
