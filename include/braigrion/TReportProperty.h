// One column of a report table: the property it shows, its width, its label,
// and the association walked to reach the value when it is not on the
// table's own instance.
#pragma once

#include <string>

namespace braigrion {

class TReportProperty {
public:
    // Which separator joins the values of an array property. The back-end
    // turns the number into text (TWriter::GetSeparatorText).
    enum ArrayValueSeparator { SEPARATOR_0 = 0, SEPARATOR_1 = 1, SEPARATOR_2 = 2, SEPARATOR_3 = 3 };

    // Arguments: property, column width, association class, association
    // target, label override, default value. The builders pass "" for what a
    // column does not use.
    TReportProperty(std::string property, std::string columnWidth, std::string associationClass,
                    std::string associationTarget, std::string labelOverride, std::string defaultValue)
        : fProperty(property),
          fColumnWidth(columnWidth),
          fAssociationTarget(associationTarget),
          fAssociationClass(associationClass),
          fLabelOverride(labelOverride),
          fArrayValueSeparator(SEPARATOR_0),
          fMonospaced(false),
          fPropertyDefaultValue(defaultValue) {}

    void SetProperty(std::string value) { fProperty = value; }
    void SetColumnWidth(std::string value) { fColumnWidth = value; }
    void SetAssociationClass(std::string value) { fAssociationClass = value; }
    void SetAssociationTarget(std::string value) { fAssociationTarget = value; }
    void SetSecondaryAssociationTarget(std::string value) { fSecondaryAssociationTarget = value; }
    void SetLabelOverride(std::string value) { fLabelOverride = value; }
    void SetPropertyDefaultValue(std::string value) { fPropertyDefaultValue = value; }
    void SetArrayValueSeparator(ArrayValueSeparator value) { fArrayValueSeparator = value; }
    void SetMonospaced() { fMonospaced = true; }

    std::string GetProperty() const { return fProperty; }
    std::string GetColumnWidth() const { return fColumnWidth; }
    std::string GetAssociationClass() const { return fAssociationClass; }
    std::string GetAssociationTarget() const { return fAssociationTarget; }
    std::string GetSecondaryAssociationTarget() const { return fSecondaryAssociationTarget; }
    std::string GetLabelOverride() const { return fLabelOverride; }
    std::string GetPropertyDefaultValue() const { return fPropertyDefaultValue; }
    ArrayValueSeparator GetArrayValueSeparator() const { return fArrayValueSeparator; }
    bool IsMonospaced() const { return fMonospaced; }

    bool HasAssociationClass() const { return fAssociationClass != ""; }
    bool HasAssociationTarget() const { return fAssociationTarget != ""; }
    bool HasSecondaryAssociationTarget() const { return fSecondaryAssociationTarget != ""; }
    bool HasLabelOverride() const { return fLabelOverride != ""; }

private:
    std::string fProperty;                    // in the table's class, or in the association target
    std::string fColumnWidth;                 // percent text; "0%" or "" in row reports
    std::string fAssociationTarget;           // class at the far end of the association
    std::string fAssociationClass;            // association walked from the instance
    std::string fSecondaryAssociationTarget;  // a second step from the target
    std::string fLabelOverride;               // "" takes the label from the declaration
    ArrayValueSeparator fArrayValueSeparator;
    bool fMonospaced;
    std::string fPropertyDefaultValue;        // shown when the property yields no value
};

}  // namespace braigrion
