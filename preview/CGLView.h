#pragma once

#include "CCamera.h"
#include "CDrawList.h"
#include "CMeshList.h"
#include "CMotionView.h"
#include "CNode.h"
#include "PickBone.h"

#include <cstdint>
#include <functional>
#include <string>

namespace gw {

/// The two keys that determine what dragging does.
struct DragKeys
{
    bool leftCtrl = false;
    bool leftShift = false;
};

/// A view of one scene without a window: its clock, its camera, its reaction to the mouse, and the lines to
/// draw. A window forwards events to it, is told by the repaint callback when to draw, and draws the result
/// of DrawScene.
class CGLView : public CMotionView
{
public:
    CGLView();
    ~CGLView() override;
    CGLView(const CGLView&) = delete;
    CGLView& operator=(const CGLView&) = delete;

    /// Positions the camera by the scene's current bound, without updating the scene. With null, the camera
    /// stays.
    void SetScene(CNode* root, float frameStep, float lastFrame) override;
    void SeekStart() override;
    void SeekEnd() override;
    void Stop() override;
    void StepBack() override;
    void Play() override;
    void StepForward() override;
    /// Ignored if the range is 0 or below.
    void Seek(int position, int range) override;
    void Advance() override;

    bool IsPlaying() const override { return m_bPlaying; }
    float GetTime() const override { return m_fTime; }
    float GetFrameStep() const override { return m_fFrameStep; }
    float GetLastFrame() const override { return m_fLastFrame; }
    void SetHighlight(const std::string& boneName) override { m_kHighlight = boneName; }
    void Repaint() override;
    void SetFollow(bool on) override;
    bool IsFollowing() const { return m_bFollowing; }

    /// Sets the function that Repaint calls, which should schedule a redraw.
    void SetRepaint(std::function<void()> repaint) { repaint_ = std::move(repaint); }
    /// Resets camera and pan as SetScene would for the current scene.
    void FrameAll();

    /// Handles the left button going down, at a position in the view, and up. The window captures the mouse
    /// in between.
    void MouseDown(int x, int y);
    void MouseUp();
    /// Dragging pans. With the left Ctrl key it moves the eye along Z, never below 0; with the left Shift key
    /// nothing moves.
    void MouseMove(int x, int y, DragKeys keys);
    bool IsDragging() const { return m_bDragging; }
    /// Moves the eye toward the point that it looks at, by a tenth of the distance per notch of the wheel;
    /// negative numbers move it away. The eye's Z never falls below 0.
    void Dolly(double notches);
    /// Returns the bone that is drawn at a position, or empty.
    std::string BoneAt(const ViewPosition& at);
    /// Returns the pan with which the scene is drawn: m_kPan, and what keeps a followed figure in the middle.
    Vec3 ShownPan() const;

    /// Chooses and sets the format of the surface, before it exists. Returns false, after reporting it, if
    /// there is no such format. A view without a surface does not need one.
    virtual bool SetupPixelFormat() { return true; }
    /// Sets up a new GL context, which must be current.
    virtual void InitGL() {}
    /// Returns the lines of the scene in its current state; valid until the next call.
    virtual const CDrawList& DrawScene();

    uint32_t m_uiTimer = 0;   ///< a window's timer; Stop sets it to 0
    CCamera m_kCamera;        ///< m_kEye, m_kUp and m_kLookAt drive the view
    Vec3 m_kPan = kVec3Zero;  ///< additional translation in camera space
    std::string m_kHighlight; ///< name of the bone that is drawn in another color

private:
    float End() const { return m_fFrameStep * m_fLastFrame; }
    void GoTo(float time);

    Ref<CNode> m_spkScene;
    Ref<CNode> m_spkHip; // of the scene
    CMeshList m_kMeshes;
    CDrawList m_kDrawList;
    std::function<void()> repaint_;
    float m_fTime = 0.0f;
    float m_fFrameStep = 0.0f;
    float m_fLastFrame = 0.0f;
    int m_iLastX = 0; // mouse position at the last event of a drag
    int m_iLastY = 0;
    bool m_bDragging = false;
    bool m_bPlaying = false;
    bool m_bFollowing = false;
};

} // namespace gw
