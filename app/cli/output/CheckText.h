#pragma once

#include <string_view>

namespace gw {

class CJsonWriter;
struct MeasuredConversion;

/// Prints the measurements of a conversion as a compact block of lines on standard output.
void PrintCheck(const MeasuredConversion& measured, std::string_view title);
/// Writes the same as members of an open JSON object, with all values of a comparison, the parts of the body
/// and the worst frames.
void WriteCheck(CJsonWriter& json, const MeasuredConversion& measured);
/// Writes the key figures of a conversion as the member "figures": one number each, or null if the motion
/// does not have the feature that it measures.
void WriteKeyFigures(CJsonWriter& json, const MeasuredConversion& measured);

} // namespace gw
