#pragma once

#include <string>
#include <vector>

namespace gw {

struct Notice;
struct ProfileChoice;
struct ProfileDoubt;
struct ProfileVerdict;
enum class EDoubt : unsigned char;
enum class ESureness : unsigned char;

/// Returns the fixed short code of a doubt: "odd-length".
const char* DoubtCode(EDoubt doubt);
/// Returns the doubt as a phrase about a joint that was just named: "its bones are out of proportion". Null
/// for OtherName, SpineCut and Turned.
const char* DoubtPhrase(EDoubt doubt);
/// Returns the doubt as a sentence that names the joints.
std::string DoubtSentence(const ProfileDoubt& doubt);
/// Returns "sure", "likely" or "doubtful".
const char* SurenessName(ESureness sureness);
/// Returns the doubts about a profile: one sentence per kind, with the joints concerned.
std::vector<std::string> DoubtWords(const ProfileVerdict& verdict);
/// Returns the doubts as warnings about a conversion with the profile.
std::vector<Notice> DoubtWarnings(const std::string& source, const ProfileChoice& choice);
/// Returns the message that the best-fitting profile is used only if it is named; its code is "doubtful".
Notice DoubtfulNotice(const std::string& source, const ProfileChoice& choice);

} // namespace gw
