#pragma once

#include "CObject.h"
#include "CPictureLink.h"
#include "CPixelBuffer.h"

#include <string>
#include <vector>

namespace gw {

/// A raster in memory, stored in the container as the bytes of a JPEG file or plainly, or a link to a picture
/// file, of which the container holds the name only.
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
    /// Besides follows a link: to an image that has the same file already, which then takes this one's place,
    /// else to the file. A file that cannot be read leaves an empty image and a note beside the container.
    void Load(COrrinStream& stream, CLinkRecord& record) override;
    /// Besides settles the name under which a link is stored in the stream's folder.
    bool Register(COrrinStream& stream) override;
    /// Without a GetDiskUsed before it, a JPEG that is not there yet is written as none.
    void Save(COrrinStream& stream) override;
    uint64_t GetMemoryUsed() const override;
    /// Makes the JPEG that Save writes. A picture that can be none is stored plainly from then on.
    uint64_t GetDiskUsed() const override;

    /// Reads a picture file into the pixels. False, with an empty image, if it cannot be read or there is no
    /// room for it.
    bool Load(const std::string& path, PictureMemory* memory = nullptr);
    /// Writes a picture file of the format that its extension tells; quality goes from 1 to 100.
    bool Save(const std::string& path, int32_t quality);

    /// The file that the image stands for, or null for an embedded one.
    const char* GetLinkFileName() const { return m_kLink.GetFileName(); }
    CPictureLink& PictureLink() { return m_kLink; }
    /// Null or an empty text make the image an embedded one. Nothing is read.
    void SetLinkFileName(const char* name) { m_kLink.Set(name, *this); }

    /// The pixels; those of a JPEG are decoded at the first call.
    CPixelBuffer& Pixels();

    bool m_bJPEG = true; ///< whether an embedded image is stored as JPEG, which keeps no alpha

private:
    bool IsJPEGCurrent() const { return !m_kJPEG.empty() && m_uiJPEGRevision == m_kPixels.GetRevision(); }
    void MakeJPEG();

    CPictureLink m_kLink;
    CPixelBuffer m_kPixels;
    std::vector<uint8_t> m_kJPEG;  // as read, or made for one Save
    uint32_t m_uiJPEGRevision = 0; // the pixels that the bytes belong to
    bool m_bDecoded = true;
    bool m_bMadeForSave = false;
};

} // namespace gw
