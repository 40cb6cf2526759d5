#pragma once

#include <map>
#include <string>
#include <string_view>

namespace gw {

class CObject;

/// The linked images and films that are alive, by the path of their file, so that each file is read once. One
/// for the process; it keeps nothing alive.
class CImageCache
{
public:
    static CImageCache& Instance();

    /// The first object of a class under exactly this path, or null.
    template <class T>
    T* Find(std::string_view path) const
    {
        const auto [first, last] = m_kImages.equal_range(path);
        for (auto entry = first; entry != last; ++entry)
        {
            if (T* image = dynamic_cast<T*>(entry->second))
                return image;
        }
        return nullptr;
    }
    /// Several objects may stand under one path.
    void Enter(std::string_view path, CObject& image) { m_kImages.emplace(path, &image); }
    /// Removes an object from under a path.
    void Remove(std::string_view path, const CObject* image);
    /// Removes all that stand under a path.
    void RemoveAll(std::string_view path);

private:
    std::multimap<std::string, CObject*, std::less<>> m_kImages;
};

} // namespace gw
