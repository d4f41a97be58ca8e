// The order in which the report sorts its tables. The sort script of the
// HTML report (tkr_sort.js) is checked against the same list by the browser
// tests, so that a table sorted in the browser reads as the report sorted it.
#include <gtest/gtest.h>

#include <fstream>
#include <string>
#include <vector>

#include "braigrion/TInstanceSorter.h"

namespace braigrion {
namespace {

TEST(NaturalOrder, TheSharedListIsInTheReportsOrder) {
    std::ifstream in(std::string(BRAIGRION_SOURCE_DIR) + "/tests/fixtures/backends/natural-order.txt");
    std::vector<std::string> values;
    for (std::string line; std::getline(in, line);) values.push_back(line);
    ASSERT_GT(values.size(), 10u);
    for (size_t i = 0; i + 1 < values.size(); ++i) {
        EXPECT_LT(TInstanceSorter::PropertyCompare(values[i], values[i + 1], true), 0)
            << '"' << values[i] << "\" before \"" << values[i + 1] << '"';
        EXPECT_GT(TInstanceSorter::PropertyCompare(values[i + 1], values[i], true), 0);
    }
}

}  // namespace
}  // namespace braigrion
