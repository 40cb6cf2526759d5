#pragma once

#include <string_view>

namespace gw {

class CJsonWriter;
struct MeasuredConversion;

/// What was measured of a conversion, as a compact block of lines that stands under it on standard output.
void PrintCheck(const MeasuredConversion& measured, std::string_view title);
/// The same as members of a JSON object that is open: all that a comparison has, the parts of the body and
/// the worst frames.
void WriteCheck(CJsonWriter& json, const MeasuredConversion& measured);
/// The figures by which a conversion is judged at a glance, as the member "figures": one number each, or null
/// where the motion does not have what it tells of.
void WriteKeyFigures(CJsonWriter& json, const MeasuredConversion& measured);

} // namespace gw
