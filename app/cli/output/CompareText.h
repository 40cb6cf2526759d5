#pragma once

namespace gw {

class CJsonWriter;
struct ConversionMeasures;

/// Prints the figures of a conversion to standard output as a table.
void PrintMeasures(const ConversionMeasures& measures);
/// Prints the same without the table of bones, each line indented.
void PrintSums(const ConversionMeasures& measures, const char* indent);
/// Writes all figures to standard output as JSON; missing ones are null.
void WriteMeasures(const ConversionMeasures& measures);
/// Writes the same as members of an open JSON object.
void WriteMeasures(CJsonWriter& json, const ConversionMeasures& measures);

} // namespace gw
