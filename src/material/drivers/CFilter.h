#pragma once

#include <memory>
#include <span>
#include <string_view>

namespace gw {

/// A reconstruction filter: the weight of a sample by its distance x, in source pixels. It counts as zero at
/// its support and beyond, whatever the function says there; a support of 0 means the nearest sample.
struct CFilter
{
    std::string_view name;
    double (*function)(double x, const void* clientData);
    double support;
    double blur;         ///< scale on the argument
    bool m_bNeedsWindow; ///< an endless kernel, to be multiplied with a window
    bool m_bCardinal;    ///< 1 at 0 and 0 at the other integers: it interpolates
    bool m_bUnitRange;   ///< values lie from 0 to 1
    /// Replaces the client data by that of two parameters. Null where the function takes none.
    void (*init)(CFilter& filter, double first, double second);
    void (*print)(const CFilter& filter); ///< null
    std::shared_ptr<const void>
        clientData; ///< what the function takes as its second argument; copies share it

    double operator()(double x) const { return function(x, clientData.get()); }
};

/// All filters. "mitchell" (b and c) and "kaiser" (a) must be copied and given parameters before they are
/// used; until then they are 0.
std::span<const CFilter> Filters();
/// The filter of a name, or null.
const CFilter* FindFilter(std::string_view name);

/// The modified Bessel function of the first kind and order 0, to seven decimals.
double BesselI0(double x);

} // namespace gw
