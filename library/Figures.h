#pragma once

#include "gaitwright/gaitwright.h"

namespace gw {
struct MeasuredConversion;
}

namespace gaitwright {

/// Returns the measures of a conversion as its users see them.
Figures FiguresOf(const gw::MeasuredConversion& measured);

} // namespace gaitwright
