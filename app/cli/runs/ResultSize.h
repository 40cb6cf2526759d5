#pragma once

#include "Notice.h"

#include <optional>

namespace gw {

class CFileConversion;
struct ConversionJob;

/// Returns why the result of a conversion cannot fit into its file: a .Kinetra holds less than 2 GiB. Call it
/// before any work is done. No value if the result may fit; the writer checks the actual size.
std::optional<Notice> WhyTooLarge(const CFileConversion& conversion, const ConversionJob& job);

} // namespace gw
