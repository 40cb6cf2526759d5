#pragma once

#include "BodyJoints.h"
#include "Notice.h"
#include "SuggestProfile.h"

#include <optional>
#include <string>

namespace gw {

class CNode;

/// Returns the name of a joint's role: "left upper arm".
std::string PlaceWords(BodyPlace place);

/// Returns "turned", "neutral", "fixed", "no-source" or "no-name".
const char* RowKindCode(ESuggestedRow kind);
/// Returns "sure", "likely" or "unsure".
const char* RowSurenessName(ERowSureness sureness);
/// Returns "none", "shape", "shape-against-name", "name" or "name-and-shape".
const char* EvidenceCode(EBodyEvidence evidence);

/// Returns the text of a drafted profile, with the frame rate of its source. `stem` is the source's name.
std::string DraftText(const SuggestedProfile& draft, const std::string& stem, CNode* sourceRoot);
/// Returns what makes a draft unfit for use unless somebody checks it: main joints that were not found, or
/// that are not sure. Empty if every main row is sure.
std::string WhyNotSure(const SuggestedProfile& draft);
/// Returns a warning about a draft whose rate cannot be the source's, so that results play faster or slower.
std::optional<Notice> RateWarning(const std::string& path, CNode* sourceRoot);

} // namespace gw
