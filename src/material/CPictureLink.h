#pragma once

#include "CImageCache.h"
#include "COrrinStream.h"
#include "CText.h"
#include "LinkNames.h"

#include <string>

namespace gw {

/// The picture file that an object refers to instead of storing pixels in the container.
class CPictureLink
{
public:
    CPictureLink() = default;
    CPictureLink(const CPictureLink& source) : m_pcFileName(source.m_pcFileName) {}
    CPictureLink& operator=(const CPictureLink&) = delete;

    bool IsNull() const { return m_pcFileName.IsNull(); }
    /// Returns whether the load that found the link did not read the file. Setting a name clears this.
    bool IsUnread() const { return m_bUnread; }
    void SetUnread(bool unread) { m_bUnread = unread; }
    const char* GetFileName() const { return m_pcFileName.Get(); }
    std::string_view View() const { return m_pcFileName.View(); }
    size_t MemoryUsed() const { return m_pcFileName.MemoryUsed(); }
    /// Sets the file name; null or empty removes the link. The owner's cache entry for the old name is
    /// removed.
    void Set(const char* name, const CObject& owner);

    /// The name as a stored field: the settled one if there is one, otherwise as it is.
    void Field(CFieldArchive& archive);
    /// Determines the name under which a container in the stream's folder stores the link.
    void Settle(const COrrinStream& stream);

private:
    CText m_pcFileName;
    CText m_pcStoredName; // null until a stream's folder is known
    bool m_bUnread = false;
};

/// Reads the file of a linked picture, unless an earlier load has. If the scene's pictures take too much
/// memory, the picture is not read and a warning is recorded. If the file cannot be read, a note is written
/// next to the container.
template <class T>
void ReadLinkedFile(T& picture, COrrinStream& stream)
{
    PictureMemory& memory = stream.LinkedPictures();
    if (!picture.PictureLink().IsUnread() || memory.m_uiByteLimit == 0)
        return;
    const std::string path = picture.GetLinkFileName();
    const bool isRead = !memory.m_bFull && picture.Load(path, &memory);
    if (memory.m_bFull)
        return stream.Warn(EFailure::SkippedPicture, path);
    picture.PictureLink().SetUnread(false);
    if (!isRead)
        NoteFailedLink(stream.GetBaseDirectory(), picture.NameView(), path);
}

/// The last step of loading a linked picture: resolves the stored name to a path and reads the file. If a
/// picture of the same class already has this path, it replaces the new one in the stream, and the new one is
/// destroyed. If the stream has no folder, the name is not changed.
template <class T>
void FollowLink(T& picture, COrrinStream& stream, CLinkRecord& record)
{
    const char* stored = picture.GetLinkFileName();
    const std::string name(stored ? stored : "");
    picture.SetLinkFileName(nullptr); // a stored name can start with a zero byte, which makes it empty
    if (name.empty() || stream.Record().Failure())
        return;
    if (!stream.HasBaseDirectory())
        return picture.SetLinkFileName(name.c_str());
    const std::string path = ResolveLinkName(stream.GetBaseDirectory(), name);
    if (stream.LinkedPictures().m_uiByteLimit == 0)
    {
        picture.SetLinkFileName(path.c_str());
        return picture.PictureLink().SetUnread(true);
    }
    CImageCache& cache = CImageCache::Instance();
    if (T* known = cache.Find<T>(path))
    {
        stream.Substitute(record, *known);
        return ReadLinkedFile(*known, stream);
    }
    picture.SetLinkFileName(path.c_str());
    picture.PictureLink().SetUnread(true);
    cache.Enter(path, picture);
    ReadLinkedFile(picture, stream);
}

} // namespace gw
