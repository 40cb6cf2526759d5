#pragma once

#include <map>
#include <mutex>
#include <string>
#include <string_view>

namespace gw {

class CObject;

/// The living linked images and films by file path, so that each file is read once. One per process; it keeps
/// nothing alive. Threads may use it at the same time, but objects with shared images belong to one thread;
/// a stream that reads no pictures (COrrinStream::SetPictureLimit) shares none.
class CImageCache
{
public:
    static CImageCache& Instance();

    /// Returns the first object of a class with exactly this path, or null.
    template <class T>
    T* Find(std::string_view path) const
    {
        const std::lock_guard lock(m_kMutex);
        const auto [first, last] = m_kImages.equal_range(path);
        for (auto entry = first; entry != last; ++entry)
        {
            if (T* image = dynamic_cast<T*>(entry->second))
                return image;
        }
        return nullptr;
    }
    /// Adds an object; a path can have several.
    void Enter(std::string_view path, CObject& image);
    /// Removes one object of a path.
    void Remove(std::string_view path, const CObject* image);
    /// Removes all objects of a path.
    void RemoveAll(std::string_view path);

private:
    mutable std::mutex m_kMutex;
    std::multimap<std::string, CObject*, std::less<>> m_kImages;
};

} // namespace gw
