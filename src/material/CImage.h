#pragma once

#include "CObject.h"
#include "CPictureLink.h"
#include "CPixelBuffer.h"

#include <string>
#include <vector>

namespace gw {

/// A raster image, stored in the container as a JPEG or as plain pixels, or a link to a picture file, of
/// which the container stores only the name.
class CImage : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    CImage();
    CImage(const CImage& source);
    ~CImage() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    /// Also resolves a link: to an existing image of the same file, which then replaces this one, otherwise
    /// to the file. If the file cannot be read, the image is empty and a note is written next to the
    /// container.
    void Load(COrrinStream& stream, CLinkRecord& record) override;
    /// Also determines the name under which the stream's folder stores the link.
    bool Register(COrrinStream& stream) override;
    /// Call GetDiskUsed first; otherwise a JPEG that is not encoded yet is written empty.
    void Save(COrrinStream& stream) override;
    uint64_t GetMemoryUsed() const override;
    /// Encodes the JPEG that Save writes. If that is not possible, the image is stored as plain pixels from
    /// then on.
    uint64_t GetDiskUsed() const override;

    /// Reads a picture file into the pixels. Returns false, with an empty image, if it cannot be read or
    /// there is not enough memory.
    bool Load(const std::string& path, PictureMemory* memory = nullptr);
    /// Writes a picture file in the format of its extension; quality is 1 to 100.
    bool Save(const std::string& path, int32_t quality);

    /// Returns the linked file, or null for an embedded image.
    const char* GetLinkFileName() const { return m_kLink.GetFileName(); }
    CPictureLink& PictureLink() { return m_kLink; }
    /// Sets the linked file without reading it. Null or empty text embeds the image.
    void SetLinkFileName(const char* name) { m_kLink.Set(name, *this); }

    /// Returns the pixels; a JPEG is decoded at the first call.
    CPixelBuffer& Pixels();

    bool m_bJPEG = true; ///< store an embedded image as JPEG, which loses alpha

private:
    bool IsJPEGCurrent() const { return !m_kJPEG.empty() && m_uiJPEGRevision == m_kPixels.GetRevision(); }
    void MakeJPEG();

    CPictureLink m_kLink;
    CPixelBuffer m_kPixels;
    std::vector<uint8_t> m_kJPEG;  // as read, or encoded for one Save
    uint32_t m_uiJPEGRevision = 0; // revision of the pixels that these bytes encode
    bool m_bDecoded = true;
    bool m_bMadeForSave = false;
};

} // namespace gw
