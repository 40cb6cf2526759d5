#pragma once

#include "Chart.h"
#include "ConvertedMotion.h"

#include <span>

namespace gw {

class CMarkup;

/// Appends a player that shows both figures of a conversion side by side, with the contacts of their feet and
/// the given frames on its bar. Its data and its script are part of the page. The trees are posed. A long
/// motion is stored with fewer frames, so the data never exceed about two megabytes.
void AppendPlayer(CMarkup& page, const ConvertedMotion& motion, std::span<const ChartMark> marks);

} // namespace gw
