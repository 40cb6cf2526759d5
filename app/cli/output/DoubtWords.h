#pragma once

#include <string>
#include <vector>

namespace gw {

class CJsonWriter;
struct CReport;
struct ProfileChoice;
struct ProfileDoubt;
struct ProfileVerdict;
enum class ESureness : unsigned char;

/// Returns "sure", "likely" or "doubtful".
const char* SurenessName(ESureness sureness);
/// Returns the doubts about a profile: one sentence per kind of flaw, with the joints that show it.
std::vector<std::string> DoubtWords(const ProfileVerdict& verdict);
/// Returns the doubts as warnings about a conversion with the profile.
std::vector<CReport> DoubtWarnings(const std::string& source, const ProfileChoice& choice);
/// Returns the message that the best-fitting profile is used only if it is named; its code is "doubtful".
CReport DoubtfulReport(const std::string& source, const ProfileChoice& choice);
/// Writes confidence and doubts as members of a JSON object.
void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict);

} // namespace gw
