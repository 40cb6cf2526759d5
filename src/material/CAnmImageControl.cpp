#include "CAnmImageControl.h"

#include "Blit.h"
#include "CAnmImage.h"
#include "CFieldArchive.h"
#include "CImage.h"

namespace gw {

const CRTTI CAnmImageControl::ms_kRTTI{"CAnmImageControl", &CControl::ms_kRTTI};

namespace {

constexpr float kDelayUnit = 10.0f; // hundredths to thousandths of a second

// Returns the start time of each frame. A frame waits for its own delay, not for that of the previous frame.
std::vector<float> FrameTimes(const CAnmImage& film)
{
    std::vector<float> times(film.GetFrameCount());
    for (size_t k = 1; k < times.size(); ++k)
        times[k] = times[k - 1] + static_cast<float>(film.GetFrame(k).m_uiDelay) * kDelayUnit;
    return times;
}

void Draw(const FilmFrame& frame, CImage& target)
{
    if (!frame.m_spkImage)
        return;
    const CPixelBuffer& picture = frame.m_spkImage->Pixels();
    Blit(target.Pixels(), frame.m_iLeft, frame.m_iTop, picture, 0, 0, picture.GetWidth(), picture.GetHeight(),
         kOpaque);
}

} // namespace

CAnmImageControl::CAnmImageControl() = default;
CAnmImageControl::CAnmImageControl(const CAnmImageControl& source) = default;
CAnmImageControl::~CAnmImageControl() = default;

CObject* CAnmImageControl::CreateClone() const
{
    return new CAnmImageControl(*this);
}

void CAnmImageControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Link("m_spkAnmImage", m_spkAnmImage);
}

uint64_t CAnmImageControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 8;
}

void CAnmImageControl::SetFilm(CAnmImage* film)
{
    m_spkAnmImage = film;
}

bool CAnmImageControl::Update(float time)
{
    CImage* target = RecordCast<CImage>(GetTarget());
    if (!m_bActive || !target || !m_spkAnmImage || m_spkAnmImage->GetFrameCount() == 0)
        return false;
    const KeySpan span = FindKeys(MapTime(time), FrameTimes(*m_spkAnmImage), m_uiCursor);
    Draw(m_spkAnmImage->GetFrame(span.a), *target);
    ++target->m_uiChangeStamp;
    return true;
}

} // namespace gw
