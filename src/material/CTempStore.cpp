// Handles map to blocks of temporary files. Small blocks share paged files, large ones get a file each. The
// store deletes leftovers of killed runs when it creates its first file.

#include "CTempStore.h"

#include "CTempPagedFile.h"
#include "CTempSingleFile.h"
#include "Files.h"
#include "Paths.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kFileLimit = 0xffff; // index + 1 must fit into 16 bits

std::string DefaultFolder()
{
    return TemporaryFolder() + "TKTmp" + kPathSeparator;
}

uint32_t HandleOf(size_t file, uint32_t block)
{
    return static_cast<uint32_t>(file + 1) << 16 | (block + 1);
}

uint32_t BlockOf(uint32_t handle)
{
    return (handle & 0xffff) - 1; // a low half of 0 yields an index that no block has
}

// Created before main, so it outlives every picture.
[[maybe_unused]] const CTempStore& kBuiltAtStart = CTempStore::Instance();

} // namespace

CTempStore& CTempStore::Instance()
{
    static CTempStore store(DefaultFolder());
    return store;
}

CTempStore::~CTempStore()
{
    for (size_t i = 0; i < m_kFiles.size(); ++i)
        RemoveFile(i);
}

CTempFile* CTempStore::FileOf(uint32_t handle) const
{
    const size_t index = handle >> 16;
    return index == 0 || index > m_kFiles.size() ? nullptr : m_kFiles[index - 1].get();
}

uint32_t CTempStore::Allocate(uint64_t byteCount)
{
    const std::lock_guard lock(m_kMutex);
    for (size_t i = 0; byteCount <= CTempPagedFile::kFileBytes && i < m_kFiles.size(); ++i)
    {
        if (!m_kFiles[i] || !m_kFiles[i]->TakesBlocks())
            continue;
        if (const std::optional<uint32_t> block = m_kFiles[i]->Allocate(byteCount))
            return HandleOf(i, *block);
    }
    return AllocateInNewFile(byteCount);
}

uint32_t CTempStore::AllocateInNewFile(uint64_t byteCount)
{
    // Compared by subtraction, because a size can be any number.
    if (m_uiLimit != 0 && (byteCount > m_uiLimit || m_uiTotal > m_uiLimit - byteCount))
        return 0;
    // Deletes the leftovers of killed runs with the first file. A running program only loses the names of its
    // files, not the files.
    if (m_kFiles.empty())
        Purge(m_kFolder);
    const bool single = byteCount > CTempPagedFile::kFileBytes;
    const size_t index = single ? AddFile(std::make_unique<CTempSingleFile>(m_kFolder, byteCount))
                                : AddFile(std::make_unique<CTempPagedFile>(m_kFolder));
    if (index == kFileLimit)
    {
        RemoveEmptyFolder(m_kFolder);
        return 0;
    }
    if (const std::optional<uint32_t> block = m_kFiles[index]->Allocate(byteCount))
        return HandleOf(index, *block);
    RemoveFile(index);
    return 0;
}

// Returns the first null slot or the end of the list; kFileLimit if the file could not be created or there
// are too many.
size_t CTempStore::AddFile(std::unique_ptr<CTempFile> file)
{
    const auto slot = std::find(m_kFiles.begin(), m_kFiles.end(), nullptr);
    const auto index = static_cast<size_t>(slot - m_kFiles.begin());
    if (!file->IsOpen() || index == kFileLimit)
        return kFileLimit;
    if (slot == m_kFiles.end())
        m_kFiles.emplace_back();
    m_uiTotal += file->GetSize();
    m_kFiles[index] = std::move(file);
    return index;
}

void CTempStore::RemoveFile(size_t index)
{
    if (!m_kFiles[index])
        return;
    m_uiTotal -= m_kFiles[index]->GetSize();
    m_kFiles[index].reset();
    RemoveEmptyFolder(m_kFolder); // fails while the folder contains other files
}

void CTempStore::Free(uint32_t handle)
{
    const std::lock_guard lock(m_kMutex);
    CTempFile* file = FileOf(handle);
    if (file && file->Free(BlockOf(handle)))
        RemoveFile((handle >> 16) - 1);
}

std::byte* CTempStore::Map(uint32_t handle)
{
    const std::lock_guard lock(m_kMutex);
    CTempFile* file = FileOf(handle);
    return file ? file->Map(BlockOf(handle)) : nullptr;
}

void CTempStore::Unmap(uint32_t handle)
{
    const std::lock_guard lock(m_kMutex);
    if (CTempFile* file = FileOf(handle))
        file->Unmap(BlockOf(handle));
}

void CTempStore::Purge(const std::string& folder)
{
    if (!IsFolderItself(folder))
        return;
    for (const std::string& name : FilesInFolder(folder, ".tmp"))
        DeleteFile(WithSeparator(folder) + name);
    RemoveEmptyFolder(folder);
}

} // namespace gw
