// What the tests of the log sections share: a recording writer whose value
// cells show the value they stand for, a run of it over a small repository,
// classes with a key so that rows can be told apart, and a data folder of
// lookup files that lives as long as the test.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "report/EngineFixture.h"
#include "repository/RepoFixture.h"
#include "support/RepoBuilder.h"

namespace braigrion {
namespace testing {

class TValueWriter : public TRecordingWriter {
public:
    using TRecordingWriter::TRecordingWriter;
    void WriteValueCell(TInstancePtr instance, TReportProperty property, std::string /*text*/) override {
        Note("WriteValueCell(" + property.GetProperty() + " = " +
             Quote(GetPropertyValue(instance, property.GetProperty(), ", ")) + ")");
    }
    std::string EscapeText(std::string text) override { return text; }
};

typedef TEngineRun<TValueWriter> TLogRun;

// Declares `className` (under `superclass`, if any) with a string key "Id"
// and the other properties as strings.
inline void DeclareKeyed(TRepoBuilder& repo, const std::string& className, const std::string& superclass,
                         const std::vector<std::string>& properties) {
    using namespace testrepo;
    std::vector<TPropertyDeclData> declarations;
    if (superclass.empty()) declarations.push_back(P("Id", T::eString, {Q("Key", TCIMValue::Boolean(true))}));
    for (const std::string& property : properties) declarations.push_back(P(property, T::eString));
    repo.Namespace()->DeclareClass(C(className, superclass, declarations));
}

// A folder of lookup files, removed with the object.
class TDataFolder {
public:
    TDataFolder() {
        char pattern[] = "/tmp/braigrion-data-XXXXXX";
        fPath = ::mkdtemp(pattern);
    }
    ~TDataFolder() { std::filesystem::remove_all(fPath); }
    void Write(const std::string& file, const std::string& text) const {
        std::ofstream(fPath + "/" + file, std::ios::binary) << text;
    }
    const std::string& Path() const { return fPath; }

private:
    std::string fPath;
};

// Link settings whose servers a test can recognise.
inline TWriter::TLogLinkSettings LinkSettings(const std::string& folder) {
    TWriter::TLogLinkSettings settings;
    settings.fDataFolder = folder;
    settings.fDocServer = "https://docs.test";
    settings.fHelpServer = "http://help.test:8040";
    return settings;
}

}  // namespace testing
}  // namespace braigrion
