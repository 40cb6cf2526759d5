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
};

/// What reading a linked picture ends with: the stored name becomes the path that it means, and the file is
/// read. A picture of the same class that has this path already takes the new one's place in the stream, and
/// the new one lives no longer. A file that cannot be read leaves a note beside the container. In a stream
/// without a folder the name stays as it is.
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
        return stream.Substitute(record, *known);
    picture.SetLinkFileName(path.c_str());
    cache.Enter(path, picture);
    if (!picture.Load(path))
        NoteFailedLink(stream.GetBaseDirectory(), picture.NameView(), path);
}

} // namespace gw
