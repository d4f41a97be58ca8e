// Value rendering: the text of a cell from a property, a chain of
// association or a numeric sensor, and the label of a column.
#include <cmath>
#include <sstream>

#include <boost/lexical_cast.hpp>

#include "braigrion/TWriter.h"
#include "braigrion/Trace.h"
#include "braigrion/TWriterUtil.h"
#include "ValueRendering.h"
#include "tkrcore/Callbacks.h"
#include "tkrcore/TRootObject.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMClass;
using NORVTKR20::ICIMInstance;
using NORVTKR20::ICIMProperty;
using NORVTKR20::TAddToVectorCallback;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TRootObject;
using NORVTKR20::TTKRException;


using rendering::RenderProperty;

std::string TWriter::GetPropertyValue(TInstancePtr instance, std::string propertyName, std::string separator) {
    try {
        TPropertyPtr property = instance->GetProperty(propertyName, TCIMContext());
        return RenderProperty(*this, *property, separator, false, nullptr);
    } catch (const TTKRException&) {
        return std::string();
    }
}

std::string TWriter::GetValueFromProperty(TPropertyPtr property, std::string separator, bool useMappedText) {
    try {
        return RenderProperty(*this, *property, separator, useMappedText, nullptr);
    } catch (const TTKRException&) {
        return std::string();
    }
}

std::string TWriter::GetValuesFromProperties(std::vector<TPropertyPtr> properties, const std::string& separator,
                                             bool useMappedText) {
    return rendering::ValuesFromProperties(*this, properties, separator, useMappedText, nullptr);
}

std::string TWriter::GetPropertyValueFromAssociation(TInstancePtr instance, std::string assocClass,
                                                     std::string resultClass, std::string role, std::string property) {
    try {
        std::vector<TInstancePtr> results;
        instance->EnumerateAssociatedInstances(TAddToVectorCallback<ICIMInstance>(results), assocClass, resultClass,
                                               role, "", TCIMContext());
        std::ostringstream text;
        for (std::vector<TInstancePtr>::size_type i = 0; i < results.size(); ++i) {
            if (i > 0) text << " ";
            text << GetPropertyValue(results[i], property, " ");
        }
        return text.str();
    } catch (const std::exception& ex) {
        Trace(std::string("Error navigation association: ") + ex.what());
    }
    return std::string();
}

std::string TWriter::GetUniqueId(TInstancePtr instance, std::string propertyName) {
    std::string id;
    TCIMContext context;
    try {
        id = EscapeText(instance->GetClass(context)->GetClassName(context));
        if (!propertyName.empty()) id += "_" + instance->GetProperty(propertyName, context)->GetValueString();
    } catch (const TTKRException&) {
        // The id stays what was made of it so far.
    }
    return id;
}

std::string TWriter::GetNumericSensorValue(TInstancePtr instance, bool /*asReading*/) {
    Trace("Entering TWriter::GetNumericSensorValue");
    std::string text;
    try {
        TCIMContext context;
        int reading = static_cast<int>(instance->GetProperty("CurrentReading", context)->GetValue(context));
        int modifier = static_cast<int>(instance->GetProperty("UnitModifier", context)->GetValue(context));
        double value = reading * std::pow(10.0, modifier);
        text = boost::lexical_cast<std::string, double>(value);
    } catch (...) {
        Trace("Report: Error calculating numeric sensor value.");
        text = "N/A";
    }
    Trace("Exiting TWriter::GetNumericSensorValue, value=" + text);
    return text;
}

namespace {

// Labels that replace the declared ones for a few properties.
struct TFixedLabel {
    const char* className;
    const char* property;
    const char* label;
};

const TFixedLabel kFixedLabels[] = {
    {"ORVSG_Process", "KernelModeTime", "Kernel Mode Time (millisecond)"},
    {"ORVSG_Process", "UserModeTime", "User Mode Time (millisecond)"},
    {"ORVSG_Process", "WorkingSetSize", "Memory Usage (KB)"},
    {"ORVSG_IPMILogRecord", "Caption", "#D"},
    {"ORVSG_IPMILogRecord", "DataFormat", "#H"},
    {"ORVSG_IPMILogRecord", "EventData", "Original Line / Action Plan(s)"},
};

}  // namespace

std::string TWriter::GetTableHeaderLabel(ICIMClass& cls, TReportProperty property, TContext context) {
    TCIMContext empty;
    const std::string& className = cls.GetClassName(empty);
    for (const TFixedLabel& fixed : kFixedLabels) {
        if (className == fixed.className && property.GetProperty() == fixed.property) return fixed.label;
    }
    if (property.HasLabelOverride()) return property.GetLabelOverride();
    try {
        if (property.HasAssociationTarget()) {
            boost::shared_ptr<ICIMClass> target = fNamespace->GetClass(property.GetAssociationTarget(), empty);
            return TWriterUtil::GetDisplayName(target->GetPropertyDecl(property.GetProperty(), context));
        }
        return TWriterUtil::GetDisplayName(cls.GetPropertyDecl(property.GetProperty(), context));
    } catch (const TTKRException& ex) {
        if (!IsNotFound(ex)) throw TTKRException(ex.fStatusCode);
    }
    return property.GetProperty();
}

}  // namespace braigrion
