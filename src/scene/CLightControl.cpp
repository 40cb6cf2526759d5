#include "CLightControl.h"

#include "CLight.h"

namespace gw {

const CRTTI CLightControl::ms_kRTTI{"CLightControl", &CControl::ms_kRTTI};

bool CLightControl::Update(float time)
{
    CLight* light = RecordCast<CLight>(GetTarget());
    if (!m_bActive || !light)
        return false;
    light->m_kRGB = ValueAt(time, light->m_kRGB);
    ++light->m_uiChangeStamp;
    return false;
}

} // namespace gw
