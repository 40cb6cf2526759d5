#pragma once

#include <string_view>

namespace gw {

class CJsonWriter;
struct MeasuredConversion;

/// Prints the measurements of a conversion to standard output as a compact block of lines.
void PrintCheck(const MeasuredConversion& measured, std::string_view title);
/// Writes the same as members of an open JSON object, including all values of a comparison, the parts of the
/// body and the worst frames.
void WriteCheck(CJsonWriter& json, const MeasuredConversion& measured);
/// Writes the key figures of a conversion as a member with a key: one number each, or null if the motion
/// does not have the feature that is measured.
void WriteKeyFigures(CJsonWriter& json, const MeasuredConversion& measured, const char* key);

} // namespace gw
