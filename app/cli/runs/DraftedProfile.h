#pragma once

#include "BodyJoints.h"
#include "Notice.h"

#include <optional>
#include <string>

namespace gw {

class CNode;
struct SuggestedProfile;

/// Returns the name of a joint's role: "left upper arm".
std::string PlaceWords(BodyPlace place);

/// Returns the text of a drafted profile, with the frame rate of its source. `stem` is the source's name.
std::string DraftText(const SuggestedProfile& draft, const std::string& stem, CNode* sourceRoot);
/// Returns what makes a draft unfit for use unless somebody checks it: main joints that were not found, or
/// that are not sure. Empty if every main row is sure.
std::string WhyNotSure(const SuggestedProfile& draft);
/// Returns a warning about a draft whose rate cannot be the source's, so that results play faster or slower.
std::optional<Notice> RateWarning(const std::string& path, CNode* sourceRoot);

/// Returns a hash of a skeleton: names, tree, and rest pose relative to its root, and the frame rate that a
/// draft has. Sources of one skeleton can share a draft.
std::string SkeletonDigits(CNode& root);

} // namespace gw
