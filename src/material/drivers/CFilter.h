#pragma once

#include <memory>
#include <span>
#include <string_view>

namespace gw {

/// A reconstruction filter: the weight of a sample by its distance x, in source pixels. The weight is zero at
/// the support and beyond, whatever the function returns; a support of 0 means nearest sample.
struct CFilter
{
    std::string_view name;
    double (*function)(double x, const void* clientData);
    double support;
    double blur;         ///< scale on the argument
    bool m_bNeedsWindow; ///< an infinite kernel, to be multiplied by a window
    bool m_bCardinal;    ///< 1 at 0 and 0 at the other integers: it interpolates
    bool m_bUnitRange;   ///< values lie from 0 to 1
    /// Sets the client data from two parameters. Null if the function has no parameters.
    void (*init)(CFilter& filter, double first, double second);
    void (*print)(const CFilter& filter);   ///< null
    std::shared_ptr<const void> clientData; ///< second argument of the function; shared by copies

    double operator()(double x) const { return function(x, clientData.get()); }
};

/// Returns all filters. Copy "mitchell" (b and c) and "kaiser" (a) and set their parameters before use; until
/// then they are 0.
std::span<const CFilter> Filters();
/// Returns the filter with a name, or null.
const CFilter* FindFilter(std::string_view name);

/// Returns the modified Bessel function of the first kind, order 0, to seven decimals.
double BesselI0(double x);

} // namespace gw
