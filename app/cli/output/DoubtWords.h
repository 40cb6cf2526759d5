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

/// "sure", "likely" or "doubtful".
const char* SurenessName(ESureness sureness);
/// What speaks against a profile, a sentence for each kind of flaw with the joints that show it.
std::vector<std::string> DoubtWords(const ProfileVerdict& verdict);
/// The doubts as warnings about a conversion by the profile.
std::vector<CReport> DoubtWarnings(const std::string& source, const ProfileChoice& choice);
/// Why the profile that fits best is not taken unasked: its code is "doubtful".
CReport DoubtfulReport(const std::string& source, const ProfileChoice& choice);
/// Sureness and doubts as members of a JSON object.
void WriteVerdict(CJsonWriter& json, const ProfileVerdict& verdict);

} // namespace gw
