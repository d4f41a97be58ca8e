// The report library's lines to the core logger. Level 3 traces entries,
// exits and caught failures; level 0 is for errors.
#pragma once

#include <string>

#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

inline void Log(int level, const std::string& line) { NORVTKR20::TRootObject::GetCoreLogger()->Log(level, line); }

inline void Trace(const std::string& line) { Log(3, line); }

// Status 15, the one failure the report tells apart: what was asked for is not there.
inline bool IsNotFound(const NORVTKR20::TTKRException& ex) {
    return ex.fStatusCode.fStatusCode == NORVTKR20::kNotFound;
}

}  // namespace braigrion
