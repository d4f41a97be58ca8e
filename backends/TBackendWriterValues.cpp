// Reading the values of hand-written cells. The texts come from the report
// logic's own value rendering, so a cell written by a section reads the same
// as the cell of a declared table.
#include "TBackendWriter.h"

#include "braigrion/TWriterUtil.h"
#include "tkrcore/Callbacks.h"

namespace braigrion {
namespace backends {

using NORVTKR20::TCIMContext;

std::vector<TWriter::TPropertyPtr> TBackendWriter::ColumnProperties(TInstancePtr instance,
                                                                   const TReportProperty& property) {
    if (!instance) return std::vector<TPropertyPtr>();
    std::vector<TPropertyPtr> found = TWriterUtil::GetProperties(
        instance, property.GetProperty(), property.GetAssociationClass(), property.GetAssociationTarget());
    if (found.empty() && property.HasSecondaryAssociationTarget()) {
        found = TWriterUtil::GetProperties(instance, property.GetProperty(), "",
                                           property.GetSecondaryAssociationTarget());
    }
    return found;
}

std::string TBackendWriter::PropertyText(TPropertyPtr property, const std::string& separator) {
    if (!property) return std::string();
    try {
        return GetValueFromProperty(property, separator, false);
    } catch (...) {
        return std::string();
    }
}

std::string TBackendWriter::ColumnLabel(TClassPtr cls, const TReportProperty& property) {
    std::string label = property.HasLabelOverride() ? property.GetLabelOverride() : property.GetProperty();
    if (cls) {
        try {
            label = GetTableHeaderLabel(*cls, property, TContext());
        } catch (...) {
            // The column's own name stands.
        }
    }
    return EscapeText(label);
}

std::string TBackendWriter::DeclarationLabel(TPropertyDeclPtr declaration) {
    if (!declaration) return std::string();
    try {
        return EscapeText(TWriterUtil::GetDisplayName(declaration));
    } catch (...) {
        return std::string();
    }
}

std::string TBackendWriter::InstanceLabel(TInstancePtr instance) {
    if (!instance) return std::string();
    for (const char* name : {"ElementName", "Name", "DeviceID", "Caption"}) {
        std::string text = GetPropertyValue(instance, name, ", ");
        if (!text.empty()) return text;
    }
    try {
        TCIMContext context;
        return EscapeText(instance->GetClass(context)->GetClassName(context));
    } catch (...) {
        return std::string();
    }
}

std::vector<std::string> TBackendWriter::PropertyNames(TInstancePtr instance) {
    std::vector<std::string> names;
    if (!instance) return names;
    try {
        TCIMContext context;
        std::vector<TPropertyPtr> properties;
        instance->EnumerateProperties(NORVTKR20::TAddToVectorCallback<NORVTKR20::ICIMProperty>(properties), context);
        for (const TPropertyPtr& p : properties) {
            TPropertyDeclPtr declaration = p->GetDeclaration(context);
            if (declaration) names.push_back(declaration->GetName(context));
        }
    } catch (...) {
        // What was found so far stands.
    }
    return names;
}

}  // namespace backends
}  // namespace braigrion
