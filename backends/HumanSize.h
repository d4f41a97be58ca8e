// A size in bytes as a person reads it, for the tooltip of a cell whose
// property declares a byte unit.
#pragma once

#include <string>

namespace braigrion {
namespace backends {

// "19.56 GiB · 21.00 GB" for the text "20512304" of a property in
// "KiloBytes": binary units first, decimal ones after. "" when the unit is
// not a byte unit, the text is not a whole number of them, or the size is
// under 1024 bytes (its text reads well as it is).
std::string HumanSize(const std::string& text, const std::string& unit);

}  // namespace backends
}  // namespace braigrion
