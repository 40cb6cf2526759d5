#pragma once

#include "Access.h"
#include "CChoosingConversion.h"
#include "Failures.h"
#include "MotionContent.h"
#include "ProfileRows.h"

#include <string>
#include <vector>

namespace gaitwright {

/// What the handles of a bone map share.
struct BoneMap::Content
{
    std::string path;
    gw::ProfileRows profile;
    std::vector<MapRow> rows;
};

BoneMap MapOf(const std::string& path, gw::ProfileRows profile);

/// A conversion of a motion that was loaded, with its target. It notes what happens, and can draft a map. The
/// motion must be locked while the object is used.
class CMotionConversion : public gw::CChoosingConversion
{
public:
    CMotionConversion(const std::string& dataFolder, const std::string& mapName,
                      const gw::ConversionChoices& choices, bool mayDraft);

    /// Uses a motion and loads the target. Returns false if the target cannot be loaded.
    bool Open(const Motion& motion);
    /// Selects the wanted map, or the best one. Returns false if there is none.
    bool ChooseMap();
    /// Uses a map that was loaded.
    void UseMap(const BoneMap& map);
    /// Returns the map in use, as it fits the motion.
    MapChoice Choice();
    bool IsDrafted() const { return m_bDrafted; }
    const CNotices& Notices() const { return m_kNotices; }

protected:
    bool UseDraft() override;
    void NotifyOfNone(const gw::Notice& notice) const override;

private:
    CNotices m_kNotices;
    std::string m_kWhyNoDraft; ///< empty if no draft was tried
    bool m_bMayDraft;
    bool m_bDrafted = false;
};

/// Returns a match of a map as its users see it.
MapChoice ChoiceOf(const gw::ProfileChoice& choice);

} // namespace gaitwright
