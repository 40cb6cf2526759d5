#pragma once

#include <string>

namespace gw {

class CNode;

/// A view of one scene with its playback clock, as the conversion sees it. Times are those of the scene: the
/// end is at frame step x last frame. Without a scene nothing moves.
class CMotionView
{
public:
    virtual ~CMotionView() = default;

    /// Stops, goes to time 0 and shows another scene, which the view keeps alive; null shows nothing.
    virtual void SetScene(CNode* root, float frameStep, float lastFrame) = 0;
    virtual void SeekStart() = 0;
    virtual void SeekEnd() = 0;
    virtual void Stop() = 0;
    /// One frame back or on, within the motion.
    virtual void StepBack() = 0;
    virtual void Play() = 0;
    virtual void StepForward() = 0;
    /// To the time position x end / range.
    virtual void Seek(int position, int range) = 0;
    /// One tick of the clock: a frame on while playing; past the end it stops at time 0.
    virtual void Advance() = 0;

    virtual bool IsPlaying() const = 0;
    virtual float GetTime() const = 0;
    virtual float GetFrameStep() const = 0;
    virtual float GetLastFrame() const = 0;
    /// The bone to be drawn in another colour, by its exact name; empty for none.
    virtual void SetHighlight(const std::string& boneName) = 0;
    virtual void Repaint() = 0;
};

} // namespace gw
