// Helpers for the delta tests: small collections built inline, a view over
// them with computed or hand-made records, and a recording writer whose
// grids print one row per line.
#pragma once

#include <string>
#include <vector>

#include <boost/make_shared.hpp>

#include "braigrion/TWriter.h"
#include "repository/DeltaRecords.h"
#include "repository/NamespaceView.h"
#include "support/RecordingWriter.h"

namespace braigrion {
namespace testing {

typedef repository::TPropertyValue TValue;

inline TValue Val(const std::string& name, const NORVTKR20::TCIMValue& value) {
    TValue v;
    v.fName = name;
    v.fValue = value;
    return v;
}

// One collection: its facts (serial number, host name, local time) and
// instances given by object path, whose keys become properties too.
class TCollection {
public:
    TCollection(const std::string& serial, const std::string& host, const std::string& localTime)
        : fNamespace(repository::TMemoryNamespace::Create()) {
        using NORVTKR20::TCIMValue;
        Add("ORVSG_CollectionInfo.InstanceID=\"0\"", {Val("SerialNumber", TCIMValue(serial))});
        Add("ORVSG_ComputerSystem.CreationClassName=\"ORVSG_ComputerSystem\",Name=\"" + host + "\"", {});
        Add("ORVSG_IPService.Name=\"IP\",SystemName=\"" + host + "\"", {Val("HostName", TCIMValue(host))});
        Add("ORVSG_TimeZone.InstanceID=\"0\"",
            {Val("LocalDateTime", TCIMValue::FromText(TCIMValue::TCIMType::eDateTime, localTime))});
    }

    TCollection& Add(const std::string& path, std::vector<TValue> values) {
        NORVTKR20::TCIMReference ref;
        if (!NORVTKR20::TCIMReference::ParsePath(path, ref)) throw std::invalid_argument("not a path: " + path);
        std::vector<TValue> all;
        for (const auto& key : ref.GetKeyBindings()) all.push_back(Val(key.first, key.second));
        for (TValue& v : values) all.push_back(std::move(v));
        fNamespace->AddInstance(ref.GetClassName(), std::move(all), &ref);
        return *this;
    }

    // Declares a class keyed on `key`, its other properties strings.
    TCollection& Declare(const std::string& className, const std::string& key, const std::vector<std::string>& others) {
        repository::TClassData data;
        data.fName = className;
        repository::TPropertyDeclData keyDecl;
        keyDecl.fName = key;
        repository::TQualifierData qualifier;
        qualifier.fName = "Key";
        qualifier.fValue = NORVTKR20::TCIMValue::Boolean(true);
        keyDecl.fQualifiers.push_back(qualifier);
        data.fProperties.push_back(keyDecl);
        for (const std::string& name : others) {
            repository::TPropertyDeclData decl;
            decl.fName = name;
            data.fProperties.push_back(decl);
        }
        fNamespace->DeclareClass(data);
        return *this;
    }

    // An instance without a path of its own, as a collector that names none
    // leaves it.
    TCollection& AddUnnamed(const std::string& className, std::vector<TValue> values) {
        fNamespace->AddInstance(className, std::move(values));
        return *this;
    }

    // An association instance of `assocClass` from one path to another.
    TCollection& Link(const std::string& assocClass, const std::string& from, const std::string& to) {
        NORVTKR20::TCIMReference a, b;
        NORVTKR20::TCIMReference::ParsePath(from, a);
        NORVTKR20::TCIMReference::ParsePath(to, b);
        fNamespace->AddInstance(assocClass, {Val("Antecedent", NORVTKR20::TCIMValue(a)),
                                             Val("Dependent", NORVTKR20::TCIMValue(b))});
        return *this;
    }

    boost::shared_ptr<repository::TMemoryNamespace> Namespace() {
        fNamespace->Link();
        return fNamespace;
    }

private:
    boost::shared_ptr<repository::TMemoryNamespace> fNamespace;
};

// A recording writer whose grids show one row per line; a cell flagged as
// agreeing with the baseline is marked with "=".
class TGridRecorder : public TGridLinesRecorder {
public:
    explicit TGridRecorder(const std::string& writerType = "html") : TGridLinesRecorder(writerType, Marks()) {}

private:
    static TMarks Marks() {
        TMarks marks;
        marks.monospaced = true;
        marks.agreement = true;
        return marks;
    }
};

// A delta run over collections: the writer set up as a report would set it
// up for a view of them.
class TDeltaRun {
public:
    TDeltaRun(std::vector<boost::shared_ptr<repository::TMemoryNamespace>> collections,
              boost::shared_ptr<repository::TMemoryNamespace> records)
        : view(boost::make_shared<repository::TNamespaceView>(collections, records)), writer("html") {
        std::map<std::string, NORVTKR20::TCIMValue> context = view->MakeContext();
        context["mode"] = NORVTKR20::TCIMValue("default");
        writer.BaseInitialize(view, context, boost::make_shared<TReportParametersBuilder>(view, "default", false));
        writer.Initialize(view, context, "out");
        writer.Clear();
    }
    ~TDeltaRun() { writer.BaseDispose(); }

    // The page's back-end calls without those that only make text safe.
    std::string Page(const TReportParameters& params) {
        writer.Clear();
        writer.WriteGenericDeltaReport(params);
        std::string text;
        for (const std::string& call : writer.Calls()) {
            if (call.compare(0, 11, "EscapeText(") == 0 || call.compare(0, 17, "GetSeparatorText(") == 0) continue;
            text += call + "\n";
        }
        return text;
    }

    boost::shared_ptr<repository::TNamespaceView> view;
    TGridRecorder writer;
};

// Hand-made records, as another tool might leave them.
inline boost::shared_ptr<repository::TMemoryNamespace> EmptyRecords() {
    auto records = repository::TMemoryNamespace::Create();
    repository::DeclareDeltaClasses(*records);
    return records;
}

inline TReportProperty Col(const std::string& property, const std::string& width) {
    return TReportProperty(property, width, "", "", "", "");
}

inline TReportClass Table(const std::string& className, const std::string& title, std::vector<TReportProperty> columns) {
    TReportClass table;
    table.SetClass(className);
    if (!title.empty()) table.SetTitle(title);
    table.SetProperties(columns);
    return table;
}

inline TReportParameters Page(std::vector<TReportClass> classes) {
    TReportParameters page;
    page.SetLinkName("delta");
    page.SetReportName("Delta Page");
    page.SetShowReportTitle(true);
    page.SetClasses(classes);
    return page;
}

}  // namespace testing
}  // namespace braigrion
