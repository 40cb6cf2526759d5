#pragma once

#include "Notice.h"

#include <optional>

namespace gw {

class CFileConversion;
struct ConversionJob;

/// Returns why the result of a conversion cannot fit into its file, before any work is done: a .Kinetra holds
/// less than 2 GiB. Nothing if it may fit; the writer checks the actual size.
std::optional<Notice> WhyTooLarge(const CFileConversion& conversion, const ConversionJob& job);

} // namespace gw
