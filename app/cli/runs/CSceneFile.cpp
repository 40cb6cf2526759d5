// Reads any supported file and presents it as roots, nodes and a clock. The extension decides; if it is
// unknown, the file is tested for a container header.

#include "CSceneFile.h"

#include "CKeyframeControl.h"
#include "EditMotion.h"
#include "PackageBlocks.h"
#include "PackagedMotion.h"
#include "Paths.h"
#include "Words.h"

#include <algorithm>
#include <unordered_set>

namespace gw {

namespace {

bool HasContainerName(const std::string& path)
{
    return HasExtension(path, ".orn") || HasExtension(path, ".Kinetra");
}

bool IsUnreachable(EFailure reason)
{
    return reason == EFailure::NotFound || reason == EFailure::NotRegular || reason == EFailure::ReadError;
}

} // namespace

void CSceneFile::SelectSource(const std::string& clip, float rate)
{
    m_kMotion.importChoice = {clip, rate};
    m_fRate = rate;
}

bool CSceneFile::Load(const std::string& path)
{
    m_kStreamFailure = {};
    if (!m_kSource.Open(path))
    {
        m_kStreamFailure = m_kSource.Failure();
        return false;
    }
    const bool isLoaded = LoadFile(m_kSource.Path());
    if (isLoaded && !m_bContainer && m_fRate > 0.0f)
        SetFrameTime(*m_kMotion.motionRoot, 1.0f / m_fRate);
    return isLoaded;
}

void CSceneFile::ShowInside(const ShellOptions& options, const std::string& path)
{
    const PackageBlocks blocks = m_bContainer ? FindPackage(m_kScene) : PackageBlocks();
    if (!blocks.info)
        return;
    std::optional<Notice> failure = WhyNotUnpacked(path, m_kScene, m_kMotion);
    m_bInside = !failure;
    if (failure)
    {
        failure->severity = ESeverity::Warning;
        failure->words = "the motion inside cannot be read: " + failure->words;
        SayNotice(options, *failure);
    }
    else if (m_fRate > 0.0f)
        SetFrameTime(*m_kMotion.motionRoot, 1.0f / m_fRate);
}

bool CSceneFile::LoadFile(const std::string& path)
{
    m_bContainer = HasContainerName(path);
    if (!m_bContainer && (m_kMotion.Load(path) || Record().Failure().reason != EFailure::UnknownFormat))
        return !Record().Failure();
    const bool isContainer = m_kScene.LoadFile(path, false);
    // A file that cannot be opened should not be reported as an unknown format.
    m_bContainer = m_bContainer || isContainer || IsUnreachable(m_kScene.Record().Failure().reason);
    return isContainer;
}

bool CSceneFile::LoadWhole(const std::string& path)
{
    if (!Load(path))
        SayFailure(path);
    else if (IsDamaged())
        SayDamage(path, Failure());
    return m_kStreamFailure.words.empty() && !Failure();
}

void CSceneFile::SayFailure(const std::string& path) const
{
    if (m_kStreamFailure.words.empty())
        gw::SayFailure(path, Failure());
    else
        SayError(path, m_kStreamFailure.code.c_str(), m_kStreamFailure.words);
}

std::vector<CObject*> CSceneFile::Roots() const
{
    if (!IsScene())
        return {m_kMotion.motionRoot.Get()};
    std::vector<CObject*> roots;
    for (size_t i = 0; i < m_kScene.GetRootCount(); ++i)
        roots.push_back(m_kScene.GetRoot(i));
    return roots;
}

// FindObjects is not used here, because it lists a shared node once per position.
std::vector<FoundNode> CSceneFile::Nodes() const
{
    std::vector<FoundNode> found;
    std::vector<FoundNode> open;
    std::unordered_set<const CNode*> seen;
    const std::vector<CObject*> roots = Roots();
    for (auto root = roots.rbegin(); root != roots.rend(); ++root)
    {
        if (CNode* node = RecordCast<CNode>(*root))
            open.push_back({node, nullptr, 0});
    }
    while (!open.empty())
    {
        const FoundNode next = open.back();
        open.pop_back();
        if (!seen.insert(next.node).second)
            continue;
        found.push_back(next);
        for (size_t i = next.node->GetChildCount(); i-- > 0;)
        {
            if (CNode* child = RecordCast<CNode>(next.node->ChildAt(i)))
                open.push_back({child, next.node, next.depth + 1});
        }
    }
    return found;
}

// The save list contains every object once, in the order of FindObject.
const CKeyframeControl* CSceneFile::FirstTrack()
{
    const std::vector<CObject*> objects = Objects();
    const auto isTrack = [](const CObject* object) {
        return IsDerivedFrom(*object, &CKeyframeControl::ms_kRTTI);
    };
    const auto track = std::ranges::find_if(objects, isTrack);
    return track == objects.end() ? nullptr : static_cast<const CKeyframeControl*>(*track);
}

std::vector<CObject*> CSceneFile::Objects()
{
    if (IsScene())
        return m_kScene.ObjectsInSaveOrder();
    COrrinStream motion;
    motion.AddRoot(m_kMotion.motionRoot.Get());
    return motion.ObjectsInSaveOrder();
}

float CSceneFile::TimeOf(int64_t frame)
{
    const CKeyframeControl* track = FirstTrack();
    return track ? static_cast<float>(frame) / track->m_fFrequency : 0.0f;
}

// A root can be below other roots. Their bounds are updated once at the end instead of after every root: in a
// chain of thousands of roots, updating all ancestors each time would be far too slow.
void CSceneFile::Update(float time)
{
    std::unordered_set<CSpatial*> above;
    std::vector<CSpatial*> tops;
    for (CObject* root : Roots())
    {
        CSpatial* spatial = RecordCast<CSpatial>(root);
        if (!spatial)
            continue;
        spatial->UpdateScene(time, false);
        CSpatial* ancestor = spatial->GetParent();
        while (ancestor && above.insert(ancestor).second)
        {
            if (!ancestor->GetParent())
                tops.push_back(ancestor);
            ancestor = ancestor->GetParent();
        }
    }
    for (CSpatial* top : tops)
        top->UpdateBound();
}

} // namespace gw
