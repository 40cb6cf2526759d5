#pragma once

#include <string>
#include <string_view>

namespace gw {

class CFailureRecord;
class CKeyframeControl;
class CMotionFile;
class CNode;
class CObject;
class COrrinStream;

/// How long a motion is and how its frames are spaced. Frame f is reached at time f / frequency.
struct SourceTiming
{
    float lastFrame = 0.0f; ///< number of the last frame
    float frequency = 0.0f; ///< as the tracks have it: the frame time in seconds

    /// The scene's time between two frames; 0 for a motion without frames.
    float FrameStep() const { return frequency != 0.0f ? 1.0f / frequency : 0.0f; }
};

SourceTiming TimingOf(const CMotionFile& motion);
/// No frames for null.
SourceTiming TimingOf(const CKeyframeControl* track);

/// The extension of a source that is a container.
inline constexpr std::string_view kSceneExtension = ".orn";

/// Reads a container whose keys can be converted. False, with the failure recorded and the scene left as it
/// is, for one that is damaged or has none.
bool LoadSourceScene(const std::string& path, COrrinStream& scene, CFailureRecord& record);

/// The first plain node under a container's root, or null.
CNode* FirstNode(CObject* root);
/// The track that a container's preview runs by, the first one of its class; null where there is none.
CKeyframeControl* PreviewTrack(CNode* root);
/// The track that a container's conversion runs by: an object of a fixed name, else the one of the preview.
CKeyframeControl* ConversionTrack(CNode* root);

/// The frame rate of a source in whole frames per second, with which a profile's results last as long as the
/// source does; 30 if the source has no usable rate.
int SourceRateOf(CNode* root);
/// The rate for a profile made for a source: its own, or the nearest one that a profile may have.
int ProfileRateOf(CNode* root);

} // namespace gw
