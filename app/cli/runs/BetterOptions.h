#pragma once

#include <string>

namespace gw {

struct MeasuredConversion;
struct ShellOptions;

/// Returns whether a conversion should be measured with --align --faithful too: one of them was not used, and
/// directions, feet or floor are far off.
bool MayBeBetter(const ShellOptions& options, const MeasuredConversion& measured);
/// Returns whether --align --faithful improves at least one of the figures that are far off.
bool IsBetter(const MeasuredConversion& measured, const MeasuredConversion& better);
/// Returns what --align --faithful would give: "--align --faithful would give (measured): direction error 1.9
/// instead of 14.2 deg".
std::string BetterWords(const MeasuredConversion& measured, const MeasuredConversion& better);

} // namespace gw
