#include "CNamedBody.h"
#include "ChooseProfile.h"
#include "FindBone.h"
#include "Paths.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <gtest/gtest.h>

namespace gw {
namespace {

// GAITWRIGHT_ASSETS is the folder of the stock profiles.
constexpr std::string_view kAssets = GAITWRIGHT_ASSETS;

// clang-format off
constexpr BodyChange kRightChanges[] = {
    {"as it is"},
    {"a prefix", "Model_"},
    {"a namespace", "Skeleton:"},
    {"capitals", "", BodyChange::Upper},
    {"small letters", "", BodyChange::Lower},
    {"no toes", "", BodyChange::AsTheyAre, false},
    {"fingers", "", BodyChange::AsTheyAre, true, true},
    {"fingers and a prefix", "m_avg_", BodyChange::Lower, true, true},
};

constexpr BodyChange kWrongChanges[] = {
    {"sides swapped", "", BodyChange::AsTheyAre, true, false, BodyChange::SidesSwapped},
    {"sides swapped, no toes", "", BodyChange::AsTheyAre, false, false, BodyChange::SidesSwapped},
    {"sides swapped, a prefix", "Model_", BodyChange::AsTheyAre, true, true, BodyChange::SidesSwapped},
    {"clavicle and arm exchanged", "", BodyChange::AsTheyAre, true, false, BodyChange::ArmsExchanged},
    {"clavicle names an arm", "", BodyChange::AsTheyAre, true, false, BodyChange::ArmsShifted},
};
// clang-format on

enum class EOutcome
{
    Right,
    Refused, // doubtful, or nothing fits
    Warned,  // used, with a doubt about a joint's role
    Silent,  // wrong without a warning
};
constexpr const char* kOutcomeNames[] = {"right", "refused", "warned", "silent"};

// The original stock profiles come before all others if they fit.
const ProfileChoice& Taken(const std::vector<ProfileChoice>& choices, bool& isOld)
{
    for (const char* old : {"PoserBVH.prf", "MaxBVH.prf"})
    {
        const auto found = std::ranges::find(choices, std::string(kAssets) + old, &ProfileChoice::path);
        isOld = found != choices.end() && found->match.IsWhole() && !found->adapted;
        if (isOld)
            return *found;
    }
    return choices.front();
}

bool SaysWhichIsWhich(const ProfileVerdict& verdict)
{
    return std::ranges::any_of(verdict.doubts,
                               [](const ProfileDoubt& doubt) { return IsOfRoles(doubt.kind); });
}

bool IsRight(const ProfileChoice& choice, const CNamedBody& body)
{
    const CMapRowTable& rows = choice.profile.rows;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const CNode* const joint = FindBone(&body.Root(), rows.Text(row, kSourceColumn));
        if (joint && !body.MayDrive(rows.Text(row, kTargetColumn), joint->NameView()))
            return false;
    }
    return true;
}

class NameTable : public testing::Test
{
protected:
    NameTable()
    {
        EXPECT_TRUE(m_kTarget.Load(std::string(kAssets) + "base.htr"));
        for (const std::string& file : FilesInFolder(std::string(kAssets), ".prf"))
            m_kPaths.push_back(std::string(kAssets) + file);
    }

    /// Matches all profiles with a skeleton and rates the chosen one.
    EOutcome Try(const Convention& convention, const BodyChange& change)
    {
        const CNamedBody body(convention, change);
        const std::vector<ProfileChoice> choices =
            ChooseProfile(m_kPaths, body.Root(), *m_kTarget.motionRoot);
        bool isOld = false;
        const ProfileChoice& taken = Taken(choices, isOld);
        const EOutcome outcome = Judge(taken, body, isOld);
        m_kTable += std::string(convention.what) + ';' + change.what + ';' +
                    kOutcomeNames[static_cast<size_t>(outcome)] + ';' + taken.profile.name + '\n';
        return outcome;
    }
    static EOutcome Judge(const ProfileChoice& taken, const CNamedBody& body, bool isOld)
    {
        if (!taken.match.IsWhole() || (!isOld && taken.verdict.sureness == ESureness::Doubtful))
            return EOutcome::Refused;
        if (IsRight(taken, body))
            return EOutcome::Right;
        return SaysWhichIsWhich(taken.verdict) ? EOutcome::Warned : EOutcome::Silent;
    }
    /// Prints the outcomes, one per line, on request.
    ~NameTable() override
    {
        if (std::getenv("GAITWRIGHT_NAME_TABLE"))
            std::fputs(m_kTable.c_str(), stdout);
    }

    CMotionFile m_kTarget;
    std::vector<std::string> m_kPaths;
    std::string m_kTable;
};

TEST_F(NameTable, NearlyEveryConventionIsTakenRightAndNoneWrongInSilence)
{
    size_t right = 0;
    size_t count = 0;
    for (const Convention& convention : Conventions())
    {
        for (const BodyChange& change : kRightChanges)
        {
            const EOutcome outcome = Try(convention, change);
            EXPECT_NE(outcome, EOutcome::Silent) << convention.what << ", " << change.what;
            right += outcome == EOutcome::Right ? 1 : 0;
            ++count;
        }
    }
    EXPECT_GE(right, 98 * count / 100) << "of " << count << '\n' << m_kTable;
}

TEST_F(NameTable, NamesThatLieWrongAreNeverTakenInSilence)
{
    for (const Convention& convention : Conventions())
    {
        for (const BodyChange& change : kWrongChanges)
        {
            const bool hasClavicle = convention.arm[0] != '-';
            if (!hasClavicle && change.names != BodyChange::SidesSwapped)
                continue;
            const EOutcome outcome = Try(convention, change);
            EXPECT_TRUE(outcome == EOutcome::Refused || outcome == EOutcome::Warned)
                << convention.what << ", " << change.what;
        }
    }
}

} // namespace
} // namespace gw
