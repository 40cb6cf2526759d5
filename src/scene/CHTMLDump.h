#pragma once

#include "COrnHTMLPage.h"

#include <string>
#include <unordered_set>
#include <vector>

namespace gw {

class CObject;

/// Writes the pages of one dump: one page per object, however often it is linked. Objects wait for their page
/// in a queue, so deep or cyclic graphs are not a problem.
class CHTMLDump
{
public:
    /// The total of tree entries after which a node that an earlier tree expands is not expanded again.
    /// Otherwise, many roots that share many nodes would fill the disk.
    static constexpr size_t kEntryLimit = 1'000'000;

    /// File names are appended to `folder`, so it must end with a separator.
    explicit CHTMLDump(std::string folder) : m_kFolder(std::move(folder)) {}
    virtual ~CHTMLDump() = default;
    CHTMLDump(const CHTMLDump&) = delete;
    CHTMLDump& operator=(const CHTMLDump&) = delete;

    /// Adds an object's tables to a page. The pages of everything it links to are left to the running dump,
    /// or saved in the folder if no dump is running.
    static void AddObject(const std::string& folder, COrnHTMLWriter& page, CObject& object);
    /// Writes the frames, the tree of nodes below a root (only the root itself if it is not a node), and the
    /// pages. A node has an entry at each of its places in the tree and is expanded at the first. Several
    /// roots share the folder and the pages. Returns the name of the frame page: Index.htm, Index2.htm and so
    /// on.
    std::string WriteSite(CObject& root);

    size_t PageCount() const { return m_uiPages; }
    /// Returns the number of entries of all trees, without the roots themselves.
    size_t EntryCount() const { return m_uiEntries; }
    /// Returns the number of pages that could not be written.
    size_t FailedCount() const { return m_uiFailed; }
    /// Returns the file name of the first page that could not be written; empty if all were.
    const std::string& FirstFailed() const { return m_kFirstFailed; }

protected:
    /// Writes a finished page into the folder. Returns false if that fails.
    virtual bool Write(const COrnHTMLPage& page, const std::string& fileName);

private:
    // A node of a tree and its parent entry, null at the root.
    struct TreeEntry
    {
        CObject* object;
        CObject* parent;
        bool isFirst; // the node's first place in this tree
    };

    std::vector<TreeEntry> TreeOf(CObject& root);
    static std::string TreeScript(const std::vector<TreeEntry>& entries);
    static COrnHTMLWriter TreePage(const std::vector<TreeEntry>& entries);
    void Save(const COrnHTMLPage& page, const std::string& fileName);
    void AddTables(COrnHTMLWriter& page, CObject& object);
    void SavePageOf(CObject& object);
    void SaveWaiting();

    static thread_local CHTMLDump* ms_pkRunning; // collects linked objects
    std::string m_kFolder;
    std::unordered_set<const CObject*> m_kKnown;    // objects with a page
    std::unordered_set<const CObject*> m_kExpanded; // nodes whose children are listed in some tree
    std::vector<CObject*> m_kWaiting;
    size_t m_uiEntries = 0;
    size_t m_uiSites = 0;
    size_t m_uiPages = 0;
    size_t m_uiFailed = 0;
    std::string m_kFirstFailed;
};

} // namespace gw
