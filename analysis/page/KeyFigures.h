#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CMarkup;
struct ConversionDetail;
struct ConversionMeasures;

/// How a figure compares with its limits.
enum class EVerdict : uint8_t
{
    Good,
    Fair,
    Poor,
    None, ///< the motion does not have the feature that is measured
};

/// One of the figures that summarize the quality of a conversion.
struct KeyFigure
{
    std::string_view key; ///< member name in a record
    std::string_view label;
    std::string_view unit; ///< "°", " mm" or empty
    int decimals = 0;
    std::optional<double> value;
    EVerdict verdict = EVerdict::None;
    std::string mark;         ///< text of the limits for good and fair
    std::string_view meaning; ///< explanation, one sentence
};

/// Returns the number of key figures.
size_t KeyFigureCount();
/// Returns all key figures, always the same ones in the same order.
std::vector<KeyFigure> KeyFiguresOf(const ConversionMeasures& measures, const ConversionDetail& detail);

/// Returns the same with given values, in their order; missing ones have no value.
std::vector<KeyFigure> KeyFiguresFrom(std::span<const std::optional<double>> values);

/// Returns a score for ranking conversions: larger is worse. One poor figure outweighs any number of fair
/// ones, and one fair figure outweighs the value of the first figure.
double BadnessOf(const std::vector<KeyFigure>& figures);

/// Returns the verdict as text ("Good") after a sign whose shape shows it too, so that it does not depend on
/// color alone.
std::string_view VerdictWord(EVerdict verdict);
std::string_view VerdictSign(EVerdict verdict);
/// Returns the verdict's class in the style sheet.
std::string_view VerdictClass(EVerdict verdict);

/// Appends the number with its unit, or "none".
void AppendFigure(CMarkup& page, const KeyFigure& figure);

} // namespace gw
