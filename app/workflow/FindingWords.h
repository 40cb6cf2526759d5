#pragma once

#include "Finding.h"
#include "Notice.h"

#include <string>
#include <string_view>

namespace gw {

struct MotionFacts;

/// Returns the fixed short code of a finding.
std::string_view FindingCode(const Finding& finding);
/// Returns what the user can do about it; empty if unknown.
std::string_view FindingRemedy(const Finding& finding);
/// Returns "error", "warning" or "note".
std::string_view SeverityName(ESeverity severity);
/// Returns the finding without the remedy: what is wrong, the name concerned unless that is the path, and how
/// often it occurs. Names are made safe to print.
std::string FindingWords(const std::string& path, const Finding& finding);
/// Returns the finding as a notice, with the remedy.
Notice MakeNotice(const std::string& path, const Finding& finding);
/// Returns the finding as one line with its code: "walk.bvh:12: blank-in-name: a name with ... (put an ...)".
std::string FindingLine(const std::string& path, const Finding& finding);

/// Returns the facts about a motion as one line, without the file name.
std::string FactsLine(const MotionFacts& facts);

} // namespace gw
