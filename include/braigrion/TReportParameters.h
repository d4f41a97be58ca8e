// The declaration of one report page: its link name, its name, and its
// tables in writing order. A plain value, returned by value and copied freely.
#pragma once

#include <string>
#include <vector>

#include "braigrion/TInstanceSorter.h"
#include "braigrion/TReportClass.h"
#include "braigrion/TReportProperty.h"

namespace braigrion {

class TReportParameters {
public:
    typedef ::braigrion::TReportClass TReportClass;
    typedef ::braigrion::TReportProperty TReportProperty;
    typedef ::braigrion::TInstanceSorter TInstanceSorter;

    TReportParameters() : fShowReportTitle(false), fLinkSortable(false) {}

    void SetShowReportTitle(bool value) { fShowReportTitle = value; }
    bool ShowReportTitle() const { return fShowReportTitle; }
    void SetLinkName(std::string value) { fLinkName = value; }
    std::string GetLinkName() const { return fLinkName; }
    void SetReportName(std::string value) { fReportName = value; }
    std::string GetReportName() const { return fReportName; }
    void SetLinkSortable() { fLinkSortable = true; }
    bool GetLinkSortable() const { return fLinkSortable; }
    // Replaces the whole list.
    void SetClasses(std::vector<TReportClass> value) { fClasses = value; }
    std::vector<TReportClass>& GetClasses() { return fClasses; }
    const std::vector<TReportClass>& GetClasses() const { return fClasses; }

    // The number in a percent text such as "25%": the text up to the first
    // "%" read in base 10; 0 when it has no leading digits.
    static int ConvertPercent(std::string text);

private:
    bool fShowReportTitle;
    std::string fLinkName;    // file and link stem of the page
    std::string fReportName;  // page title and its name in the navigation
    std::vector<TReportClass> fClasses;
    bool fLinkSortable;
};

}  // namespace braigrion
