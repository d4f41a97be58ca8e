// Builds small repositories inline in a test, either call by call or from a
// few lines of text:
//
//   TRepoBuilder repo;
//   repo.Parse(R"(
//       # one instance per line: class, then name=value pairs
//       ORVSG_OperatingSystem ProductVendor="Microsoft Corporation" OSType=uint16:73
//       ORVSG_CollectionInfo Build="4.2.0-preboot"
//       ORVSG_Disk Names=string[]:"a","b" Size=null:uint64 Online=true Count=3
//       # a class with no instances
//       class ORVSG_DesktopMonitor
//   )");
//
// A value is a quoted string, true or false, a bare unsigned number (uint32),
// type:value with a CIM type name (uint16:73, sint32:-1, datetime:"2023..."),
// type[]:v1,v2 for an array, or null:type. A malformed line throws
// std::invalid_argument naming the line and what is wrong.
#pragma once

#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "repository/MemoryRepository.h"

namespace braigrion {
namespace testing {

typedef repository::TPropertyValue TProp;

// Property values by type.
TProp Str(const std::string& name, const std::string& text);
TProp U32(const std::string& name, unsigned int value);
TProp StrArray(const std::string& name, const std::vector<std::string>& texts);

class TRepoBuilder {
public:
    TRepoBuilder();

    // Adds one instance of `className`.
    TRepoBuilder& Add(const std::string& className, std::vector<TProp> properties);
    // Declares a class with string properties of these names and no instances.
    TRepoBuilder& Declare(const std::string& className, const std::vector<std::string>& properties = {});
    // Adds what the text describes (see above).
    TRepoBuilder& Parse(const std::string& text);

    boost::shared_ptr<repository::TMemoryNamespace> Namespace() const { return fNamespace; }
    // The same collection behind a namespace whose provider answers
    // `providerType` (1: a delta view over several collections).
    boost::shared_ptr<NORVTKR20::ICIMNamespace> WithProviderType(int providerType) const;

private:
    void ParseLine(const std::string& line, int lineNumber);

    boost::shared_ptr<repository::TMemoryNamespace> fNamespace;
};

}  // namespace testing
}  // namespace braigrion
