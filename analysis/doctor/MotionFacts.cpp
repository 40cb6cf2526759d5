#include "MotionFacts.h"

#include <algorithm>
#include <iterator>

namespace gw {

namespace {

struct UnitRow
{
    std::string_view name;
    double shortest; // leg of a child
    double longest;  // leg of a tall adult
};

constexpr UnitRow kUnits[] = {
    {"metres",          0.4,   1.1   },
    {"decimetres",      5.0,   11.0  },
    {"units of 5.6 cm", 12.0,  18.0  }, // used in a large university's archive
    {"inches",          20.0,  42.0  },
    {"centimetres",     45.0,  110.0 },
    {"millimetres",     450.0, 1100.0},
};

constexpr std::string_view kBodySourceNames[] = {"none", "names", "shape"};

} // namespace

std::string_view UnitOfLeg(double leg)
{
    const auto fits = [=](const UnitRow& row) { return leg >= row.shortest && leg <= row.longest; };
    const auto* const row = std::ranges::find_if(kUnits, fits);
    return row == std::end(kUnits) ? std::string_view() : row->name;
}

std::string_view BodySourceName(EBodySource source)
{
    return kBodySourceNames[static_cast<size_t>(source)];
}

} // namespace gw
