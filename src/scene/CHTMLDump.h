#pragma once

#include "COrnHTMLPage.h"

#include <string>
#include <unordered_set>
#include <vector>

namespace gw {

class CObject;

/// Writes the pages of one dump: one for every object, however often it is linked. Objects wait in a list for
/// their page, so no graph is too deep or endless.
class CHTMLDump
{
public:
    /// Tree entries in all sites of a dump after which a node that an earlier tree expands is not expanded
    /// again: many roots that share many nodes would fill the disk.
    static constexpr size_t kEntryLimit = 1'000'000;

    /// File names follow `folder` directly, so it ends in a separator.
    explicit CHTMLDump(std::string folder) : m_kFolder(std::move(folder)) {}

    /// Adds an object's tables to a page. The pages of everything it links to are left to the dump that is
    /// running, or saved in the folder if none is.
    static void AddObject(const std::string& folder, COrnHTMLWriter& page, CObject& object);
    /// Writes the frames, the tree of the nodes below a root (the root alone if it is not a node), and the
    /// pages. A node has an entry in the tree at each of its places and is expanded at the first. Several
    /// roots share the folder and the pages. Returns the name of the frames' page: Index.htm, Index2.htm and
    /// so on.
    std::string WriteSite(CObject& root);

    size_t PageCount() const { return m_uiPages; }
    /// Entries of all trees but the roots' own.
    size_t EntryCount() const { return m_uiEntries; }
    /// Pages whose file could not be written.
    size_t FailedCount() const { return m_uiFailed; }

private:
    // A node of a tree with the one above it, null at the root.
    struct TreeEntry
    {
        CObject* object;
        CObject* parent;
        bool isFirst; // place of the node in this tree
    };

    std::vector<TreeEntry> TreeOf(CObject& root);
    static std::string TreeScript(const std::vector<TreeEntry>& entries);
    static COrnHTMLWriter TreePage(const std::vector<TreeEntry>& entries);
    void Save(const COrnHTMLPage& page, const std::string& fileName);
    void AddTables(COrnHTMLWriter& page, CObject& object);
    void SavePageOf(CObject& object);
    void SaveWaiting();

    static CHTMLDump* ms_pkRunning; // the one that collects what pages link to; pages are made on one thread
    std::string m_kFolder;
    std::unordered_set<const CObject*> m_kKnown;    // those with a page
    std::unordered_set<const CObject*> m_kExpanded; // nodes whose children some tree lists
    std::vector<CObject*> m_kWaiting;
    size_t m_uiEntries = 0;
    size_t m_uiSites = 0;
    size_t m_uiPages = 0;
    size_t m_uiFailed = 0;
};

} // namespace gw
