#include "CTexture.h"

namespace gw {

const CRTTI CTexture::ms_kRTTI{"CTexture", &CMaterialBase::ms_kRTTI};
const CRTTI CMultiTex::ms_kRTTI{"CMultiTex", &CTexture::ms_kRTTI};
const CRTTI CBlendTex::ms_kRTTI{"CBlendTex", &CTexture::ms_kRTTI};

} // namespace gw
