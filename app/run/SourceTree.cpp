// Walks a folder tree in a fixed order. Links are followed only if they lead out of the walked tree, and each
// folder is visited once, whatever its name, so cycles of links end.

#include "SourceTree.h"

#include "Paths.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <system_error>
#include <utility>

#include <sys/stat.h>

namespace fs = std::filesystem;

namespace gw {

namespace {

using Identity = std::pair<dev_t, ino_t>;

bool Identify(const std::string& path, Identity& identity)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0)
        return false;
    identity = {status.st_dev, status.st_ino};
    return true;
}

class CWalk
{
public:
    CWalk(const std::string& folder, std::span<const std::string_view> extensions)
        : m_kFolder(WithSeparator(folder)), m_kExtensions(extensions)
    {
        std::error_code error;
        m_kRealRoot = fs::canonical(folder, error);
        LeaveOut(folder);
    }

    void LeaveOut(const std::string& folder)
    {
        Identity identity;
        if (!folder.empty() && Identify(folder, identity))
            m_kSeen.insert(identity);
    }

    // Adds the files of a folder below the root (with trailing separator), or of the root itself.
    void Take(const std::string& below);

    SourceFolder tree;

private:
    bool MayEnter(const fs::directory_entry& entry);
    bool LeadsBack(const fs::path& link) const;

    std::string m_kFolder;
    fs::path m_kRealRoot;
    std::span<const std::string_view> m_kExtensions;
    std::set<Identity> m_kSeen;
};

void CWalk::Take(const std::string& below)
{
    std::vector<std::string> folders;
    std::error_code error;
    fs::directory_iterator entry(m_kFolder + below, error);
    for (; !error && entry != fs::directory_iterator(); entry.increment(error))
    {
        if (MayEnter(*entry))
            folders.push_back(entry->path().filename().string());
    }
    if (error)
        tree.unreadable.push_back(m_kFolder + below);
    for (const std::string_view extension : m_kExtensions)
    {
        for (const std::string& name : FilesInFolder(m_kFolder + below, extension))
            tree.files.push_back(below + name);
    }
    std::ranges::sort(folders);
    for (const std::string& name : folders)
    {
        Identity identity;
        if (Identify(m_kFolder + below + name, identity) && m_kSeen.insert(identity).second)
            Take(std::string(below).append(name) + kPathSeparator);
    }
}

// A link into the tree leads to a folder that is visited anyway, and one to a parent would add files that
// nobody asked for.
bool CWalk::MayEnter(const fs::directory_entry& entry)
{
    std::error_code error;
    return entry.is_directory(error) && !(entry.is_symlink(error) && LeadsBack(entry.path()));
}

bool CWalk::LeadsBack(const fs::path& link) const
{
    std::error_code error;
    const fs::path target = fs::canonical(link, error);
    const auto [root, end] = std::ranges::mismatch(m_kRealRoot, target);
    return root == m_kRealRoot.end() || end == target.end();
}

} // namespace

SourceFolder WalkFolder(const std::string& folder, std::span<const std::string_view> extensions,
                        const std::string& leftOut)
{
    CWalk walk(folder, extensions);
    walk.LeaveOut(leftOut);
    walk.Take({});
    return std::move(walk.tree);
}

} // namespace gw
