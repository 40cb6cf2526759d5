#pragma once

#include "CObject.h"
#include "CPictureLink.h"

#include <array>
#include <string>
#include <vector>

namespace gw {

class CImage;

/// One picture of a film.
struct FilmFrame
{
    uint32_t m_uiTiming = 0; ///< stored and copied only
    uint32_t m_uiDelay = 0;  ///< hundredths of a second until the next frame
    int32_t m_iLeft = 0;     ///< where the picture lies
    int32_t m_iTop = 0;
    std::array<uint8_t, 3> m_abyFlags{}; ///< stored and copied only
    Held<CImage> m_spkImage;             ///< may be null
};

/// A film: a list of frames that lie at their places on the screen, or a link to an animated picture file.
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
    /// Besides follows a link as an image does.
    void Load(COrrinStream& stream, CLinkRecord& record) override;
    /// Besides settles the name under which a link is stored in the stream's folder.
    bool Register(COrrinStream& stream) override;
    uint64_t GetMemoryUsed() const override;

    /// Reads all frames of an animated file, each into its own image. False, with an empty film, if it cannot
    /// be read or there is no room for it.
    bool Load(const std::string& path, PictureMemory* memory = nullptr);

    size_t GetFrameCount() const { return m_kFrames.size(); }
    /// The frame; out of range one without an image.
    const FilmFrame& GetFrame(size_t index) const;
    /// Takes a frame over with its image.
    void AddFrame(FilmFrame&& frame) { m_kFrames.push_back(std::move(frame)); }

    /// The file that the film stands for, or null for an embedded one.
    const char* GetLinkFileName() const { return m_kLink.GetFileName(); }
    CPictureLink& PictureLink() { return m_kLink; }
    /// Null or an empty text make the film an embedded one. Nothing is read.
    void SetLinkFileName(const char* name) { m_kLink.Set(name, *this); }

protected:
    void CloneHeld(CCloneMap& map, CObject& copy) override;

private:
    CPictureLink m_kLink;
    std::vector<FilmFrame> m_kFrames;
};

} // namespace gw
