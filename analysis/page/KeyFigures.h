#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CMarkup;
struct ConversionDetail;
struct ConversionMeasures;

/// How a figure stands against its mark.
enum class EVerdict : uint8_t
{
    Good,
    Fair,
    Poor,
    None, ///< the motion does not have what the figure tells of
};

/// One of the figures by which a conversion is judged at a glance.
struct KeyFigure
{
    std::string_view key; ///< among the members of a record
    std::string_view label;
    std::string_view unit; ///< "°", " mm" or nothing
    int decimals = 0;
    std::optional<double> value;
    EVerdict verdict = EVerdict::None;
    std::string mark;         ///< what is good and what is fair, in words
    std::string_view meaning; ///< a sentence
};

/// How many there are.
size_t KeyFigureCount();
/// All of them, always as many and in the same order.
std::vector<KeyFigure> KeyFiguresOf(const ConversionMeasures& measures, const ConversionDetail& detail);

/// How bad a conversion is beside others: larger is worse. Poor figures weigh more than any number of fair
/// ones, and these more than the first figure's value.
double BadnessOf(const std::vector<KeyFigure>& figures);

/// "Good", and a sign before it whose shape says the same: not by colour alone.
std::string_view VerdictWord(EVerdict verdict);
std::string_view VerdictSign(EVerdict verdict);
/// The verdict's class in the page's style.
std::string_view VerdictClass(EVerdict verdict);

/// The number with its unit, or "none".
void AppendFigure(CMarkup& page, const KeyFigure& figure);

} // namespace gw
