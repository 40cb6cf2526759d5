#pragma once

#include "CReport.h"

#include <string>
#include <string_view>

namespace gw {

struct Finding;
struct MotionFacts;

/// The short fixed word for a finding.
std::string_view FindingCode(const Finding& finding);
/// What can be done about it; empty where nothing is known.
std::string_view FindingRemedy(const Finding& finding);
/// What was found, in words without the remedy: what is wrong, the name concerned, how often.
std::string FindingWords(const std::string& path, const Finding& finding);
/// The finding as one line: "walk.bvh:12: blank-in-name: a name with ... (put an ...)".
std::string FindingLine(const std::string& path, const Finding& finding);

/// What is known of a motion, as one line without the file's name.
std::string FactsLine(const MotionFacts& facts);

} // namespace gw
