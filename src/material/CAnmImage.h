#pragma once

#include "CObject.h"
#include "CPictureLink.h"

#include <array>
#include <string>
#include <vector>

namespace gw {

class CImage;

/// One frame of a film.
struct FilmFrame
{
    uint32_t m_uiTiming = 0; ///< stored and copied only
    uint32_t m_uiDelay = 0;  ///< hundredths of a second until the next frame
    int32_t m_iLeft = 0;     ///< position of the picture
    int32_t m_iTop = 0;
    std::array<uint8_t, 3> m_abyFlags{}; ///< stored and copied only
    Held<CImage> m_spkImage;             ///< may be null
};

/// A film: a list of frames with positions on the screen, or a link to an animated picture file.
class CAnmImage : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    CAnmImage();
    CAnmImage(const CAnmImage& source);
    ~CAnmImage() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    /// Also resolves a link, like CImage.
    void Load(COrrinStream& stream, CLinkRecord& record) override;
    /// Also determines the name under which the stream's folder stores the link.
    bool Register(COrrinStream& stream) override;
    uint64_t GetMemoryUsed() const override;

    /// Reads all frames of an animated file, each into its own image. Returns false, with an empty film, if
    /// it cannot be read or there is not enough memory.
    bool Load(const std::string& path, PictureMemory* memory = nullptr);

    size_t GetFrameCount() const { return m_kFrames.size(); }
    /// Returns a frame; out of range, one without an image.
    const FilmFrame& GetFrame(size_t index) const;
    /// Appends a frame with its image.
    void AddFrame(FilmFrame&& frame) { m_kFrames.push_back(std::move(frame)); }

    /// Returns the linked file, or null for an embedded film.
    const char* GetLinkFileName() const { return m_kLink.GetFileName(); }
    CPictureLink& PictureLink() { return m_kLink; }
    /// Sets the linked file without reading it. Null or empty text embeds the film.
    void SetLinkFileName(const char* name) { m_kLink.Set(name, *this); }

protected:
    void CloneHeld(CCloneMap& map, CObject& copy) override;

private:
    CPictureLink m_kLink;
    std::vector<FilmFrame> m_kFrames;
};

} // namespace gw
