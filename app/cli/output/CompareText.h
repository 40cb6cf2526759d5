#pragma once

#include <cstdint>

namespace gw {

class CJsonWriter;
struct ConversionMeasures;

/// The layout of a list of records in JSON.
enum class ERecordLayout : uint8_t
{
    Lines,   ///< one line per record, for people
    OneLine, ///< everything on one line, for documents that are one line each
};

/// Prints the figures of a conversion as a table on standard output.
void PrintMeasures(const ConversionMeasures& measures);
/// Prints the same without the table of bones, each line indented.
void PrintSums(const ConversionMeasures& measures, const char* indent);
/// Writes all figures as JSON on standard output; missing ones are null.
void WriteMeasures(const ConversionMeasures& measures);
/// Writes the same as members of an open JSON object.
void WriteMeasures(CJsonWriter& json, const ConversionMeasures& measures, ERecordLayout layout);

} // namespace gw
