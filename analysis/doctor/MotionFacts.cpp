#include "MotionFacts.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

struct UnitRow
{
    std::string_view name;
    double shortest; // leg of a child
    double longest;  // leg of a tall adult
    double meters;
};

constexpr UnitRow kUnits[] = {
    {"metres",          0.4,   1.1,    1.0   },
    {"decimetres",      5.0,   11.0,   0.1   },
    {"units of 5.6 cm", 12.0,  18.0,   0.0564}, // used in a large university's archive
    {"inches",          20.0,  42.0,   0.0254},
    {"centimetres",     45.0,  110.0,  0.01  },
    {"millimetres",     450.0, 1100.0, 0.001 },
};

constexpr std::string_view kBodySourceNames[] = {"none", "names", "shape"};

constexpr double kAdultLeg = 0.85; // meters

const UnitRow* RowOfLeg(double leg)
{
    const auto fits = [=](const UnitRow& row) { return leg >= row.shortest && leg <= row.longest; };
    const auto* const row = std::ranges::find_if(kUnits, fits);
    return row == std::end(kUnits) ? nullptr : row;
}

} // namespace

std::string_view UnitOfLeg(double leg)
{
    const UnitRow* const row = RowOfLeg(leg);
    return row ? row->name : std::string_view();
}

std::string_view UnitOfMeters(double meters)
{
    const auto isUnit = [=](const UnitRow& row) { return std::fabs(row.meters - meters) < 0.001 * meters; };
    const auto* const row = std::ranges::find_if(kUnits, isUnit);
    return row == std::end(kUnits) ? std::string_view() : row->name;
}

double MetersOfUnit(double leg)
{
    if (const UnitRow* const row = RowOfLeg(leg))
        return row->meters;
    return leg > 0.0 ? kAdultLeg / leg : 1.0;
}

std::string_view BodySourceName(EBodySource source)
{
    return kBodySourceNames[static_cast<size_t>(source)];
}

} // namespace gw
