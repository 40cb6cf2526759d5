// Walks a folder tree in a fixed order. Links are followed only if they lead out of the walked tree, and each
// folder is visited once, whatever its name, so cycles of links end.

#include "SourceTree.h"

#include "Files.h"
#include "NativePath.h"
#include "Paths.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <system_error>
#include <utility>

namespace fs = std::filesystem;

namespace gw {

namespace {

using Identity = std::pair<uint64_t, uint64_t>; // device, inode

bool Identify(const std::string& path, Identity& identity)
{
    FileStatus status;
    if (!StatusOf(path, status))
        return false;
    identity = {status.device, status.inode};
    return true;
}

class CWalk
{
public:
    CWalk(const std::string& folder, std::span<const std::string_view> extensions)
        : m_kFolder(WithSeparator(folder)), m_kExtensions(extensions)
    {
        std::error_code error;
        m_kRealRoot = fs::canonical(NativePath(folder), error);
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
    void TakeEntry(const fs::directory_entry& entry);
    void TakeFile(const fs::directory_entry& entry, const std::string& name);
    bool MayEnter(const fs::directory_entry& entry);
    bool LeadsBack(const fs::path& link) const;

    std::string m_kFolder;
    fs::path m_kRealRoot;
    std::span<const std::string_view> m_kExtensions;
    std::set<Identity> m_kSeen;
    // of the folder that is being read
    std::vector<std::string> m_kFolders;
    std::vector<std::vector<std::string>> m_kFiles; // by extension
    std::vector<std::string> m_kDead;
};

void CWalk::Take(const std::string& below)
{
    m_kFolders.clear();
    m_kFiles.assign(m_kExtensions.size(), {});
    m_kDead.clear();
    std::error_code error;
    fs::directory_iterator entry(NativePath(m_kFolder + below), error);
    for (; !error && entry != fs::directory_iterator(); entry.increment(error))
        TakeEntry(*entry);
    if (error)
        tree.unreadable.push_back(m_kFolder + below);
    const auto add = [&](std::vector<std::string>& names, std::vector<std::string>& list) {
        std::ranges::sort(names);
        for (const std::string& name : names)
            list.push_back(below + name);
    };
    for (std::vector<std::string>& names : m_kFiles)
        add(names, tree.files);
    add(m_kDead, tree.deadLinks);
    std::vector<std::string> folders = std::move(m_kFolders);
    std::ranges::sort(folders);
    for (const std::string& name : folders)
    {
        Identity identity;
        std::string folder = below;
        folder.append(name).push_back(kPathSeparator);
        if (Identify(m_kFolder + folder, identity) && m_kSeen.insert(identity).second)
            Take(folder);
    }
}

void CWalk::TakeEntry(const fs::directory_entry& entry)
{
    std::error_code error;
    const std::string name = PathText(entry.path().filename());
    if (name.starts_with('.'))
        return;
    if (entry.is_directory(error))
    {
        if (MayEnter(entry))
            m_kFolders.push_back(name);
        return;
    }
    TakeFile(entry, name);
}

// Most file systems list the type of each entry, so only links and sources cost a look.
void CWalk::TakeFile(const fs::directory_entry& entry, const std::string& name)
{
    std::error_code error;
    const auto found = std::ranges::find_if(
        m_kExtensions, [&](std::string_view extension) { return HasExtension(name, extension); });
    const bool isSource = found != m_kExtensions.end();
    if (isSource && entry.is_regular_file(error))
        m_kFiles[static_cast<size_t>(found - m_kExtensions.begin())].push_back(name);
    else if ((isSource || name.find('.') == name.npos) && entry.is_symlink(error) && !entry.exists(error))
        m_kDead.push_back(name);
}

// A link into the tree leads to a folder that is visited anyway, and one to a parent would add files that
// nobody asked for.
bool CWalk::MayEnter(const fs::directory_entry& entry)
{
    std::error_code error;
    return !(entry.is_symlink(error) && LeadsBack(entry.path()));
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
