// A view's clock and camera. The camera is placed so that the scene's bounding sphere fits; dragging then
// moves it in steps proportional to the sphere's radius.

#include "CGLView.h"

#include "FindHip.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr float kEyeDistance = 2.5f;  // radii between eye and center: the whole sphere fits into 45 degrees
constexpr float kDragStep = 0.005f;   // radii per pixel of mouse movement
constexpr double kDollyShare = 0.1;   // of the distance, per notch of the mouse wheel
constexpr float kFarthestEye = 50.0f; // radii; the wheel does not go beyond

} // namespace

CGLView::CGLView() = default;
CGLView::~CGLView() = default;

void CGLView::SetScene(CNode* root, float frameStep, float lastFrame)
{
    Stop();
    m_fTime = 0.0f;
    m_fFrameStep = frameStep;
    m_fLastFrame = lastFrame;
    if (!(m_spkScene == root))
    {
        m_kMeshes.Clear();
        m_spkScene = root;
        m_spkHip = root ? FindHip(*root) : nullptr;
    }
    FrameAll();
    Repaint();
}

void CGLView::FrameAll()
{
    if (!m_spkScene)
        return;
    const BoundSphere& bound = m_spkScene->m_kBound;
    // Near plane, far plane and angle of view, which are stored but not used.
    m_kCamera.m_afParameter[0] = 1.0f;
    m_kCamera.m_afParameter[1] = 90'000.0f;
    m_kCamera.m_afParameter[2] = 45.0f;
    m_kCamera.m_kLookAt = bound.m_kCentre;
    m_kCamera.m_kEye = bound.m_kCentre;
    m_kCamera.m_kEye.z += kEyeDistance * bound.m_fRadius;
    m_kCamera.m_kUp = kVec3UnitY;
    m_kPan = kVec3Zero;
}

void CGLView::SeekStart()
{
    GoTo(0.0f);
}

void CGLView::SeekEnd()
{
    GoTo(End());
}

void CGLView::Stop()
{
    if (!m_spkScene)
        return;
    m_uiTimer = 0;
    m_bPlaying = false;
}

void CGLView::StepBack()
{
    GoTo(std::max(m_fTime - m_fFrameStep, 0.0f));
}

void CGLView::Play()
{
    m_bPlaying = m_spkScene.Get() != nullptr;
}

void CGLView::StepForward()
{
    GoTo(std::min(m_fTime + m_fFrameStep, End()));
}

void CGLView::Seek(int position, int range)
{
    if (range > 0)
        GoTo(std::min(static_cast<float>(position) * End() / static_cast<float>(range), End()));
}

void CGLView::Advance()
{
    if (!m_bPlaying)
        return;
    const float next = m_fTime + m_fFrameStep;
    m_bPlaying = next < End();
    GoTo(m_bPlaying ? next : 0.0f);
}

void CGLView::GoTo(float time)
{
    if (!m_spkScene)
        return;
    m_fTime = time;
    m_spkScene->UpdateScene(time, true);
    Repaint();
}

void CGLView::Repaint()
{
    if (repaint_)
        repaint_();
}

void CGLView::MouseDown(int x, int y)
{
    m_iLastX = x;
    m_iLastY = y;
    m_bDragging = true;
}

void CGLView::MouseUp()
{
    m_bDragging = false;
}

void CGLView::MouseMove(int x, int y, DragKeys keys)
{
    if (!m_bDragging || !m_spkScene)
        return;
    const float unit = m_spkScene->m_kBound.m_fRadius * kDragStep;
    const float dx = unit * static_cast<float>(m_iLastX - x);
    const float dy = unit * static_cast<float>(m_iLastY - y);
    m_iLastX = x;
    m_iLastY = y;
    if (keys.leftCtrl && !keys.leftShift)
        m_kCamera.m_kEye.z = std::max(m_kCamera.m_kEye.z + dy, 0.0f);
    else if (!keys.leftShift)
        m_kPan = m_kPan + Vec3{-dx, dy, 0.0f};
    Repaint();
}

void CGLView::Dolly(double notches)
{
    if (!m_spkScene)
        return;
    Vec3& eye = m_kCamera.m_kEye;
    const float distance = eye.z - m_kCamera.m_kLookAt.z;
    const float farthest = kFarthestEye * m_spkScene->m_kBound.m_fRadius;
    const auto scaled = static_cast<float>(distance * std::pow(1.0 - kDollyShare, notches));
    eye.z = std::max(m_kCamera.m_kLookAt.z + std::min(scaled, std::max(distance, farthest)), 0.0f);
    Repaint();
}

std::string CGLView::BoneAt(const ViewPosition& at)
{
    if (!m_spkScene)
        return {};
    return PickBone(m_kMeshes.Of(*m_spkScene), CEyeSpace(m_kCamera, ShownPan()), at);
}

// The figure's depth is kept as well: a figure that walks toward the viewer keeps its size.
Vec3 CGLView::ShownPan() const
{
    if (!m_bFollowing || !m_spkHip)
        return m_kPan;
    const CEyeSpace space(m_kCamera);
    const Vec3 middle = space.PlaceOf(m_kCamera.m_kLookAt);
    return m_kPan + middle - space.PlaceOf(m_spkHip->m_kWorldMatrix.Translation());
}

void CGLView::SetFollow(bool on)
{
    if (on == m_bFollowing)
        return;
    m_kPan = on ? kVec3Zero : ShownPan();
    m_bFollowing = on;
    Repaint();
}

const CDrawList& CGLView::DrawScene()
{
    m_kDrawList.Clear();
    if (m_spkScene)
        BuildDrawList(m_kDrawList, m_kMeshes.Of(*m_spkScene), m_spkScene->m_kBound.m_fRadius, m_kHighlight);
    return m_kDrawList;
}

} // namespace gw
