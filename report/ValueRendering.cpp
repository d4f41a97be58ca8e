// The rendering of property values shared by the value readers of TWriter
// and the table engine.
#include "ValueRendering.h"

#include <sstream>

#include "braigrion/TWriterUtil.h"
#include "tkrcore/TTKRException.h"

namespace braigrion {

using NORVTKR20::ICIMProperty;
using NORVTKR20::TCIMContext;
using NORVTKR20::TCIMValue;
using NORVTKR20::TTKRException;

namespace rendering {

int TDateQualifierCache::StatusOf(const TWriter::TPropertyDeclPtr& declaration) {
    for (const std::pair<TWriter::TPropertyDeclPtr, int>& known : fStatuses) {
        if (known.first == declaration) return known.second;
    }
    int status = 0;
    try {
        bool propagated = false;
        TCIMContext context;
        declaration->GetQualifier("NOTIMEPRECISION", propagated, context);
    } catch (const TTKRException& ex) {
        status = ex.fStatusCode.fStatusCode;
    }
    fStatuses.push_back(std::make_pair(declaration, status));
    return status;
}

namespace {

// Whether the property's declaration carries "NOTIMEPRECISION". Its absence
// (status 15) is an answer; any other failure is passed on.
bool HasNoTimePrecision(ICIMProperty& property, TDateQualifierCache* cache) {
    TCIMContext context;
    TWriter::TPropertyDeclPtr declaration = property.GetDeclaration(context);
    int status = 0;
    if (cache != nullptr) {
        status = cache->StatusOf(declaration);
    } else {
        try {
            bool propagated = false;
            declaration->GetQualifier("NOTIMEPRECISION", propagated, context);
        } catch (const TTKRException& ex) {
            status = ex.fStatusCode.fStatusCode;
        }
    }
    if (status != 0 && status != NORVTKR20::kNotFound) throw TTKRException(status);
    return status == 0;
}

}  // namespace

// A date in its display form, an array by its elements joined with
// `separator`, anything else by its display text or, with `useMappedText`,
// by its mapped text.
std::string RenderProperty(TWriter& writer, ICIMProperty& property, const std::string& separator,
                           bool useMappedText, TDateQualifierCache* cache) {
    TCIMContext context;
    if (property.GetType(context) == TCIMValue::TCIMType::eDateTime) {
        bool noTimePrecision = HasNoTimePrecision(property, cache);
        const TCIMValue& value = useMappedText ? property.GetValue() : property.GetValue(context);
        return TWriterUtil::GetDateTime(value, noTimePrecision);
    }
    if (property.IsArray(context)) {
        std::ostringstream text;
        std::vector<std::string> elements = property.GetValueStrings();
        for (std::vector<std::string>::size_type i = 0; i < elements.size(); ++i) {
            if (i > 0) text << separator;
            text << writer.EscapeText(elements[i]);
        }
        return text.str();
    }
    // The mapped text is the second text of a cell and stays as the
    // repository gives it; the display text is made safe for the format.
    if (useMappedText) return property.GetValueMapString();
    return writer.EscapeText(property.GetValueString());
}

std::string ValuesFromProperties(TWriter& writer, const std::vector<TWriter::TPropertyPtr>& properties,
                                 const std::string& separator, bool useMappedText, TDateQualifierCache* cache) {
    std::string text;
    for (std::vector<TWriter::TPropertyPtr>::size_type i = 0; i < properties.size(); ++i) {
        try {
            text += RenderProperty(writer, *properties[i], separator, useMappedText, cache);
        } catch (const TTKRException&) {
            // A value that cannot be read adds nothing.
        }
        // No separator before an empty value, so empty values add no
        // doubled separators.
        if (i + 1 < properties.size() && !properties[i + 1]->GetValueString().empty()) text += separator;
    }
    return text;
}

}  // namespace rendering

}  // namespace braigrion
