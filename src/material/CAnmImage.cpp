// Films: frames in the container, or a link to an animated file whose frames are read when the scene is
// loaded.

#include "CAnmImage.h"

#include "CFieldArchive.h"
#include "CImage.h"
#include "PictureFile.h"

namespace gw {

const CRTTI CAnmImage::ms_kRTTI{"CAnmImage", &CObject::ms_kRTTI};

namespace {

// Three bytes that are stored as a word; the fourth is not kept.
void FlagField(CFieldArchive& archive, std::array<uint8_t, 3>& flags)
{
    uint32_t word = flags[0] | uint32_t{flags[1]} << 8 | uint32_t{flags[2]} << 16;
    archive.Unsigned("flags", word);
    for (uint8_t& flag : flags)
    {
        flag = static_cast<uint8_t>(word);
        word >>= 8;
    }
}

} // namespace

CAnmImage::CAnmImage() = default;
CAnmImage::CAnmImage(const CAnmImage& source) = default;
CAnmImage::~CAnmImage()
{
    if (!m_kLink.IsNull())
        CImageCache::Instance().Remove(m_kLink.View(), this);
}

CObject* CAnmImage::CreateClone() const
{
    return new CAnmImage(*this);
}

void CAnmImage::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    m_kLink.Field(archive);
    if (!m_kLink.IsNull())
        return;
    archive.Array("frames", m_kFrames, [](CFieldArchive& fields, FilmFrame& frame) {
        fields.Unsigned("timing", frame.m_uiTiming);
        fields.Unsigned("delay", frame.m_uiDelay);
        fields.Signed("left", frame.m_iLeft);
        fields.Signed("top", frame.m_iTop);
        FlagField(fields, frame.m_abyFlags);
        fields.Link("image", frame.m_spkImage);
    });
}

void CAnmImage::Load(COrrinStream& stream, CLinkRecord& record)
{
    CObject::Load(stream, record);
    FollowLink(*this, stream, record);
}

bool CAnmImage::Register(COrrinStream& stream)
{
    m_kLink.Settle(stream);
    return CObject::Register(stream);
}

// The frames of a linked film are not in the field list, because files do not contain them.
void CAnmImage::CloneHeld(CCloneMap& map, CObject& copy)
{
    CObject::CloneHeld(map, copy);
    std::vector<FilmFrame>& frames = static_cast<CAnmImage&>(copy).m_kFrames;
    for (size_t i = 0; i < m_kFrames.size(); ++i)
    {
        if (CImage* image = m_kFrames[i].m_spkImage.Get())
            frames[i].m_spkImage = static_cast<CImage*>(image->Clone(map));
    }
}

uint64_t CAnmImage::GetMemoryUsed() const
{
    constexpr uint64_t kFrameBytes = 24;
    return CObject::GetMemoryUsed() + 8 + m_kLink.MemoryUsed() + m_kFrames.size() * kFrameBytes;
}

bool CAnmImage::Load(const std::string& path, PictureMemory* memory)
{
    m_kFrames.clear();
    const auto take = [&](const PictureHead& head) -> CPixelBuffer& {
        FilmFrame& frame = m_kFrames.emplace_back();
        frame.m_uiDelay = head.delay;
        frame.m_iLeft = head.left;
        frame.m_iTop = head.top;
        frame.m_spkImage = new CImage;
        return frame.m_spkImage->Pixels();
    };
    const bool good = ReadFrames(path, take, memory);
    if (!good)
        m_kFrames.clear();
    return good;
}

const FilmFrame& CAnmImage::GetFrame(size_t index) const
{
    static const FilmFrame none;
    return index < m_kFrames.size() ? m_kFrames[index] : none;
}

} // namespace gw
