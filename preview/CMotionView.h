#pragma once

#include <string>

namespace gw {

class CNode;

/// A view of one scene with its playback clock, as seen by the conversion. Times are the scene's; it ends at
/// frame step x last frame. Without a scene, nothing moves.
class CMotionView
{
public:
    virtual ~CMotionView() = default;

    /// Stops, rewinds to time 0 and shows another scene, which the view keeps alive. Null shows nothing.
    virtual void SetScene(CNode* root, float frameStep, float lastFrame) = 0;
    virtual void SeekStart() = 0;
    virtual void SeekEnd() = 0;
    virtual void Stop() = 0;
    /// Moves one frame back or forward, within the motion.
    virtual void StepBack() = 0;
    virtual void Play() = 0;
    virtual void StepForward() = 0;
    /// Moves to the time position x end / range.
    virtual void Seek(int position, int range) = 0;
    /// Handles one tick of the clock: moves one frame forward while playing; past the end, stops at time 0.
    virtual void Advance() = 0;

    virtual bool IsPlaying() const = 0;
    /// Returns the current scene time.
    virtual float GetTime() const = 0;
    /// Returns the scene time between two frames.
    virtual float GetFrameStep() const = 0;
    /// Returns the index of the last frame.
    virtual float GetLastFrame() const = 0;
    /// Sets the bone to draw in another color by its exact name; empty for none.
    virtual void SetHighlight(const std::string& boneName) = 0;
    virtual void Repaint() = 0;
    /// Keeps the figure's hip in the middle of the view, or stops doing so where the figure is.
    virtual void SetFollow(bool on) = 0;
    /// Shows a short text in a corner of the view; empty for none.
    virtual void SetNote(const std::string&) {}
};

} // namespace gw
