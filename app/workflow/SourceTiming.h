#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace gw {

class CFailureRecord;
class CKeyframeControl;
class CMotionFile;
class CNode;
class CObject;
class COrrinStream;

/// The length of a motion and the spacing of its frames. Frame f is reached at time f / frequency.
struct SourceTiming
{
    float lastFrame = 0.0f; ///< number of the last frame
    float frequency = 0.0f; ///< as in the tracks: the frame time in seconds

    /// Returns the scene's time between two frames; 0 for a motion without frames.
    float FrameStep() const { return frequency != 0.0f ? 1.0f / frequency : 0.0f; }
};

SourceTiming TimingOf(const CMotionFile& motion);
/// Returns a timing without frames for null.
SourceTiming TimingOf(const CKeyframeControl* track);

/// The extension of a source that is a container.
inline constexpr std::string_view kSceneExtension = ".orn";

/// Whether the files of linked pictures are read.
enum class EPictures : uint8_t
{
    Read,
    Named, ///< only their names are kept
};

/// Reads a container with keys for a conversion. If it is damaged or has none, records the failure, leaves
/// the scene unchanged and returns false. `progress` is called with the number of bytes read and the total;
/// it may throw to end the reading, which leaves the scene unchanged too.
bool LoadSourceScene(const std::string& path, COrrinStream& scene, CFailureRecord& record,
                     std::function<void(size_t, size_t)> progress = {}, EPictures pictures = EPictures::Read);

/// Returns the first plain node under a container's root, or null.
CNode* FirstNode(CObject* root);
/// Returns the track that drives a container's preview, the first one of its class, or null.
CKeyframeControl* PreviewTrack(CNode* root);
/// Returns the track that drives a container's conversion: the object with a fixed name, otherwise the
/// preview's.
CKeyframeControl* ConversionTrack(CNode* root);

/// Returns a source's rate in whole frames per second, with which a profile's results are as long as the
/// source; 30 if the source has no usable rate.
int SourceRateOf(CNode* root);
/// Returns the rate for a profile made for a source: its own, or the closest allowed one.
int ProfileRateOf(CNode* root);

} // namespace gw
