// Images: embedded as a JPEG or as plain pixels, or linked to a file. A JPEG is decoded when its pixels are
// first needed and encoded when the image is measured or saved, so an image that is only copied is never
// decoded.

#include "CImage.h"

#include "CFieldArchive.h"
#include "PictureFile.h"

namespace gw {

const CRTTI CImage::ms_kRTTI{"CImage", &CObject::ms_kRTTI};

namespace {

constexpr int32_t kEmbeddedQuality = 100;

} // namespace

CImage::CImage() = default;
CImage::CImage(const CImage& source)
    : CObject(source), m_bJPEG(source.m_bJPEG), m_kLink(source.m_kLink), m_kPixels(source.m_kPixels),
      m_bDecoded(source.m_bDecoded)
{
    if (!source.IsJPEGCurrent())
        return;
    m_kJPEG = source.m_kJPEG;
    m_uiJPEGRevision = m_kPixels.GetRevision();
    m_bMadeForSave = source.m_bMadeForSave;
}

CImage::~CImage()
{
    if (!m_kLink.IsNull())
        CImageCache::Instance().RemoveAll(m_kLink.View());
}

CObject* CImage::CreateClone() const
{
    return new CImage(*this);
}

void CImage::Fields(CFieldArchive& archive)
{
    CObject::Fields(archive);
    m_kLink.Field(archive);
    uint16_t storage = static_cast<uint16_t>(m_kPixels.GetStorage());
    archive.Word("storage kind", storage);
    if (archive.IsReading())
        m_kPixels.SetStorage(storage == static_cast<uint16_t>(EPixelStorage::TempStore)
                                 ? EPixelStorage::TempStore
                                 : EPixelStorage::Heap);
    if (!m_kLink.IsNull())
        return;
    archive.Bool("m_bJPEG", m_bJPEG);
    if (!m_bJPEG)
        return m_kPixels.Fields(archive);
    if (!archive.IsReading() && !IsJPEGCurrent())
        m_kJPEG.clear();
    archive.SignedBlock("JPEG", m_kJPEG);
}

void CImage::Load(COrrinStream& stream, CLinkRecord& record)
{
    CObject::Load(stream, record);
    m_bDecoded = m_kJPEG.empty();
    m_uiJPEGRevision = m_kPixels.GetRevision();
    FollowLink(*this, stream, record);
}

bool CImage::Register(COrrinStream& stream)
{
    m_kLink.Settle(stream);
    return CObject::Register(stream);
}

void CImage::Save(COrrinStream& stream)
{
    CObject::Save(stream);
    if (m_bMadeForSave)
        m_kJPEG = {};
    m_bMadeForSave = false;
}

uint64_t CImage::GetMemoryUsed() const
{
    constexpr uint64_t kMembers = 60;
    return CObject::GetMemoryUsed() + kMembers + m_kLink.MemoryUsed() + m_kPixels.GetBlockBytes() +
           m_kJPEG.size();
}

uint64_t CImage::GetDiskUsed() const
{
    const_cast<CImage*>(this)->MakeJPEG(); // the stored size is unknown until the JPEG is encoded
    return CObject::GetDiskUsed();
}

void CImage::MakeJPEG()
{
    if (!m_kLink.IsNull() || !m_bJPEG || IsJPEGCurrent() || m_kPixels.IsEmpty())
        return;
    m_bMadeForSave = EncodePicture(m_kPixels, "jpg", kEmbeddedQuality, m_kJPEG);
    m_bJPEG = m_bMadeForSave;
    m_uiJPEGRevision = m_kPixels.GetRevision();
}

bool CImage::Load(const std::string& path, PictureMemory* memory)
{
    m_bDecoded = true;
    return ReadPicture(path, m_kPixels, memory);
}

bool CImage::Save(const std::string& path, int32_t quality)
{
    return WritePicture(path, Pixels(), quality);
}

CPixelBuffer& CImage::Pixels()
{
    if (!m_bDecoded)
    {
        m_bDecoded = true;
        DecodeJPEG(m_kJPEG, m_kPixels);
        m_uiJPEGRevision = m_kPixels.GetRevision();
    }
    return m_kPixels;
}

} // namespace gw
