#pragma once

#include "CReport.h"

#include <string>
#include <string_view>

namespace gw {

struct Finding;
struct MotionFacts;

/// Returns the short fixed word for a finding.
std::string_view FindingCode(const Finding& finding);
/// Returns what can be done about it; empty if unknown.
std::string_view FindingRemedy(const Finding& finding);
/// Returns the finding without the remedy: what is wrong, the name concerned, how often.
std::string FindingWords(const std::string& path, const Finding& finding);
/// Returns the finding as one line: "walk.bvh:12: blank-in-name: a name with ... (put an ...)".
std::string FindingLine(const std::string& path, const Finding& finding);

/// Returns the facts about a motion as one line, without the file name.
std::string FactsLine(const MotionFacts& facts);

} // namespace gw
