#pragma once

#include <cstdint>

namespace gw {

class CJsonWriter;
struct ConversionMeasures;

/// How a list of records stands in JSON.
enum class ERecordLayout : uint8_t
{
    Lines,   ///< a line for each, for people
    OneLine, ///< for documents of which each is one line
};

/// The figures of a conversion as a table on standard output.
void PrintMeasures(const ConversionMeasures& measures);
/// The same without the table of bones, each line behind an indent.
void PrintSums(const ConversionMeasures& measures, const char* indent);
/// All figures as JSON on standard output; null for those that are missing.
void WriteMeasures(const ConversionMeasures& measures);
/// The same as members of an object that is open.
void WriteMeasures(CJsonWriter& json, const ConversionMeasures& measures, ERecordLayout layout);

} // namespace gw
