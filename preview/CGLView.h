#pragma once

#include "CCamera.h"
#include "CDrawList.h"
#include "CMeshList.h"
#include "CMotionView.h"
#include "CNode.h"

#include <cstdint>
#include <functional>
#include <string>

namespace gw {

/// The two keys that tell what dragging does.
struct DragKeys
{
    bool leftCtrl = false;
    bool leftShift = false;
};

/// A view of one scene without a window: its clock, its camera, what the mouse does to it and the lines to be
/// drawn. A window forwards to it, learns by the repaint callback when to draw, and draws what DrawScene
/// answers.
class CGLView : public CMotionView
{
public:
    CGLView();
    ~CGLView() override;
    CGLView(const CGLView&) = delete;
    CGLView& operator=(const CGLView&) = delete;

    /// The scene's bound, as it stands, places the camera; nothing is evaluated. With null it stays.
    void SetScene(CNode* root, float frameStep, float lastFrame) override;
    void SeekStart() override;
    void SeekEnd() override;
    void Stop() override;
    void StepBack() override;
    void Play() override;
    void StepForward() override;
    /// A range of 0 or below is no place in the motion: nothing moves.
    void Seek(int position, int range) override;
    void Advance() override;

    bool IsPlaying() const override { return m_bPlaying; }
    float GetTime() const override { return m_fTime; }
    float GetFrameStep() const override { return m_fFrameStep; }
    float GetLastFrame() const override { return m_fLastFrame; }
    void SetHighlight(const std::string& boneName) override { m_kHighlight = boneName; }
    void Repaint() override;

    /// What Repaint calls; the window asks its toolkit there to be drawn soon.
    void SetRepaint(std::function<void()> repaint) { repaint_ = std::move(repaint); }
    /// Camera and pan as SetScene would give them for the scene as it stands now.
    void FrameAll();

    /// The left button goes down, at a position in the view, and up. The window captures the mouse between.
    void MouseDown(int x, int y);
    void MouseUp();
    /// Dragging pans; with the left Ctrl key it moves the eye along Z, never below 0; with the left Shift key
    /// nothing moves.
    void MouseMove(int x, int y, DragKeys keys);
    bool IsDragging() const { return m_bDragging; }

    /// Chooses and sets the format of the surface that the view is drawn on, before there is one. False,
    /// after saying so, if there is no such format. A view without a surface needs none.
    virtual bool SetupPixelFormat() { return true; }
    /// Sets up a new, current GL context for drawing.
    virtual void InitGL() {}
    /// The lines of the scene as it was evaluated last; valid until the next call.
    virtual const CDrawList& DrawScene();

    uint32_t m_uiTimer = 0;   ///< a window's timer; Stop zeroes it
    CCamera m_kCamera;        ///< m_kEye, m_kUp and m_kLookAt drive the view
    Vec3 m_kPan = kVec3Zero;  ///< extra translation of the camera's space
    std::string m_kHighlight; ///< name of the bone that is drawn in another colour

private:
    float End() const { return m_fFrameStep * m_fLastFrame; }
    void GoTo(float time);

    Ref<CNode> m_spkScene;
    CMeshList m_kMeshes;
    CDrawList m_kDrawList;
    std::function<void()> repaint_;
    float m_fTime = 0.0f;
    float m_fFrameStep = 0.0f;
    float m_fLastFrame = 0.0f;
    int m_iLastX = 0; // the mouse at the last event of a drag
    int m_iLastY = 0;
    bool m_bDragging = false;
    bool m_bPlaying = false;
};

} // namespace gw
