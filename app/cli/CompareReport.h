#pragma once

namespace gw {

struct ConversionMeasures;

/// The figures of a conversion as a table on standard output.
void PrintMeasures(const ConversionMeasures& measures);
/// All figures as JSON on standard output; null for those that are missing.
void WriteMeasures(const ConversionMeasures& measures);

} // namespace gw
