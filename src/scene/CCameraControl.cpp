#include "CCameraControl.h"

#include "CCamera.h"

namespace gw {

const CRTTI CCameraControl::ms_kRTTI{"CCameraControl", &CControl::ms_kRTTI};

bool CCameraControl::Update(float time)
{
    CCamera* camera = RecordCast<CCamera>(GetTarget());
    if (!m_bActive || !camera)
        return false;
    camera->m_kControlVector = ValueAt(time, kVec3UnitZ);
    ++camera->m_uiChangeStamp;
    return false;
}

} // namespace gw
