#include "GLScene.h"

#include "CGLView.h"

namespace gw {

GLScene SceneOf(CGLView& view)
{
    const CCamera& camera = view.m_kCamera;
    return {view.DrawScene().Ends(), view.ShownPan(), camera.m_kEye, camera.m_kLookAt, camera.m_kUp};
}

} // namespace gw
