#pragma once

#include "CImageCache.h"
#include "COrrinStream.h"
#include "CText.h"
#include "LinkNames.h"

#include <string>

namespace gw {

/// The picture file that an object stands for instead of having pixels of its own in the container.
class CPictureLink
{
public:
    CPictureLink() = default;
    CPictureLink(const CPictureLink& source) : m_pcFileName(source.m_pcFileName) {}
    CPictureLink& operator=(const CPictureLink&) = delete;

    bool IsNull() const { return m_pcFileName.IsNull(); }
    /// Whether the file was left unread by the load that found the link. Setting a name clears it.
    bool IsUnread() const { return m_bUnread; }
    void SetUnread(bool unread) { m_bUnread = unread; }
    const char* GetFileName() const { return m_pcFileName.Get(); }
    std::string_view View() const { return m_pcFileName.View(); }
    size_t MemoryUsed() const { return m_pcFileName.MemoryUsed(); }
    /// Null and an empty text mean no link. The owner no longer stands in the cache under its old name.
    void Set(const char* name, const CObject& owner);

    /// The name as a stored field: what Settle made of it, else as it is.
    void Field(CFieldArchive& archive);
    /// Finds the name under which a container in the stream's folder stores the link.
    void Settle(const COrrinStream& stream);

private:
    CText m_pcFileName;
    CText m_pcStoredName; // null until a stream has told its folder
    bool m_bUnread = false;
};

/// Reads the file of a linked picture, unless an earlier load has. If the scene's pictures take too much
/// memory, this one stays unread, with a warning. A file that cannot be read leaves a note beside the
/// container.
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
/// destroyed. In a stream without a folder the name stays as it is.
template <class T>
void FollowLink(T& picture, COrrinStream& stream, CLinkRecord& record)
{
    const char* stored = picture.GetLinkFileName();
    const std::string name(stored ? stored : "");
    picture.SetLinkFileName(nullptr); // a name may begin with the zero byte that ends it
    if (name.empty() || stream.Record().Failure())
        return;
    if (!stream.HasBaseDirectory())
        return picture.SetLinkFileName(name.c_str());
    const std::string path = ResolveLinkName(stream.GetBaseDirectory(), name);
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
