// Pixel memory. A block is on the heap, in the temp store, or owned by the caller; all three are accessed
// between Lock and Unlock only. Sizes come from files, so every size is checked before memory is allocated,
// and a failed operation changes nothing.

#include "CPixelBuffer.h"

#include "CFieldArchive.h"
#include "CTempStore.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <utility>

namespace gw {

namespace {

// The last pixel can be read as a word, whatever its size.
constexpr int64_t kWordBytes = 4;
constexpr int64_t kBlockLimit = std::numeric_limits<int32_t>::max();

// Returns the size of a picture's block, or 0 if the layout is invalid.
size_t BlockBytes(const CPixelLayout& layout)
{
    const int64_t stride = layout.Stride();
    if (stride < 1 || layout.m_iHeight < 1 || stride > kBlockLimit / layout.m_iHeight)
        return 0;
    return static_cast<size_t>(stride * layout.m_iHeight - BytesPerPixel(layout.m_iFormat) + kWordBytes);
}

// Fills a block with a pattern, its first `filled` bytes, by doubling the filled part.
void Repeat(uint8_t* bytes, size_t filled, size_t byteCount)
{
    while (filled < byteCount)
    {
        const size_t piece = std::min(filled, byteCount - filled);
        std::memcpy(bytes + filled, bytes, piece);
        filled += piece;
    }
}

} // namespace

CPixelBuffer::CPixelBuffer(const CPixelBuffer& source)
    : m_eStorage(source.m_eStorage == EPixelStorage::Foreign ? EPixelStorage::Heap : source.m_eStorage)
{
    if (source.IsEmpty())
        m_kLayout = source.m_kLayout;
    else
        Copy(source);
}

CPixelBuffer::~CPixelBuffer()
{
    Release();
}

void CPixelBuffer::Release()
{
    m_pbyHeap.reset();
    m_pbyForeign = nullptr;
    if (m_uiHandle >= kLeastTempHandle)
        CTempStore::Instance().Free(m_uiHandle);
    m_uiHandle = 0;
    m_uiBlockBytes = 0;
    m_kLayout.m_iWidth = m_kLayout.m_iHeight = m_kLayout.m_iFormat = 0;
    Touch();
}

bool CPixelBuffer::Free()
{
    if (m_iLocks > 0)
        return false;
    Release();
    return true;
}

bool CPixelBuffer::SetStorage(EPixelStorage storage)
{
    if (!IsEmpty())
        return storage == m_eStorage;
    m_eStorage = storage;
    return true;
}

bool CPixelBuffer::SetRowAlignment(bool aligned)
{
    if (!IsEmpty())
        return aligned == (m_kLayout.m_usRowAlignment != 0);
    m_kLayout.m_usRowAlignment = aligned ? 1 : 0;
    return true;
}

void CPixelBuffer::SetResolution(int32_t horizontal, int32_t vertical)
{
    m_kLayout.m_iHorizontalResolution = horizontal;
    m_kLayout.m_iVerticalResolution = vertical;
}

bool CPixelBuffer::IsSame(const CPixelLayout& layout) const
{
    return !IsEmpty() && layout.m_iWidth == m_kLayout.m_iWidth && layout.m_iHeight == m_kLayout.m_iHeight &&
           layout.m_iFormat == m_kLayout.m_iFormat && layout.Stride() == m_kLayout.Stride();
}

// A new heap block is zeroed; a block of the temp store can contain old data.
bool CPixelBuffer::Allocate(const CPixelLayout& layout)
{
    const size_t byteCount = BlockBytes(layout);
    if (byteCount == 0 || m_eStorage == EPixelStorage::Foreign || m_iLocks > 0)
        return false;
    std::unique_ptr<uint8_t, CFreer> heap;
    uint32_t handle = 0;
    if (m_eStorage == EPixelStorage::TempStore)
        handle = CTempStore::Instance().Allocate(byteCount);
    else
        heap.reset(static_cast<uint8_t*>(std::calloc(byteCount, 1)));
    if (!heap && handle == 0)
        return false;
    Release();
    m_pbyHeap = std::move(heap);
    m_uiHandle = handle;
    m_uiBlockBytes = byteCount;
    m_kLayout = layout;
    return true;
}

bool CPixelBuffer::Create(int32_t width, int32_t height, int32_t format, const uint8_t* fill)
{
    CPixelLayout layout = m_kLayout;
    layout.m_iWidth = width;
    layout.m_iHeight = height;
    layout.m_iFormat = format;
    const bool isNew = !IsSame(layout);
    if (isNew && !Allocate(layout))
        return false;
    if (fill || !isNew || m_uiHandle != 0)
        Fill(fill);
    return true;
}

void CPixelBuffer::Fill(const uint8_t* pixel)
{
    const CPixelLock lock(*this);
    const std::span<uint8_t> bytes = lock.Bytes();
    if (bytes.empty())
        return;
    const auto pixelBytes = static_cast<size_t>(GetBytesPerPixel());
    const size_t rowBytes = static_cast<size_t>(GetWidth()) * pixelBytes;
    if (!pixel || rowBytes != GetStride())
        std::ranges::fill(bytes, uint8_t{0});
    if (!pixel)
        return;
    std::memcpy(bytes.data(), pixel, pixelBytes);
    Repeat(bytes.data(), pixelBytes, rowBytes);
    Repeat(bytes.data(), GetStride(), bytes.size());
}

bool CPixelBuffer::Attach(uint8_t* pixels, int32_t width, int32_t height, int32_t format)
{
    CPixelLayout layout = m_kLayout;
    layout.m_iWidth = width;
    layout.m_iHeight = height;
    layout.m_iFormat = format;
    const size_t byteCount = BlockBytes(layout);
    if (!pixels || byteCount == 0 || !Free())
        return false;
    m_eStorage = EPixelStorage::Foreign;
    m_pbyForeign = pixels;
    m_uiBlockBytes = byteCount;
    m_kLayout = layout;
    return true;
}

bool CPixelBuffer::Copy(const CPixelBuffer& other)
{
    if (&other == this)
        return true;
    const CPixelView from(other);
    if (!from || (!IsSame(other.m_kLayout) && !Allocate(other.m_kLayout)))
        return false;
    m_kLayout = other.m_kLayout;
    const CPixelLock to(*this);
    for (int32_t y = 0; to && y < GetHeight(); ++y)
        std::memcpy(to.Row(y), from.Row(y), GetStride());
    return static_cast<bool>(to);
}

uint8_t* CPixelBuffer::Lock() const
{
    uint8_t* pixels = m_pbyHeap ? m_pbyHeap.get() : m_pbyForeign;
    if (m_uiHandle >= kLeastTempHandle)
        pixels = reinterpret_cast<uint8_t*>(CTempStore::Instance().Map(m_uiHandle));
    if (pixels)
        ++m_iLocks;
    return pixels;
}

void CPixelBuffer::Unlock() const
{
    if (m_uiHandle >= kLeastTempHandle)
        CTempStore::Instance().Unmap(m_uiHandle);
    --m_iLocks;
}

void CPixelBuffer::Fields(CFieldArchive& archive)
{
    if (archive.IsReading())
        return ReadPixels(archive);
    // Only read, but the archive interface takes non-const bytes.
    const CPixelAccess<const CPixelBuffer, uint8_t> view(*this);
    if (!view && !IsEmpty())
        archive.Refuse(EFailure::OutOfMemory);
    m_kLayout.Fields(archive);
    std::span<uint8_t> bytes = view.Bytes();
    if (archive.Presence("pixels", !bytes.empty()))
        archive.Row("pixels", bytes);
}

void CPixelBuffer::ReadPixels(CFieldArchive& archive)
{
    CPixelLayout layout;
    layout.Fields(archive);
    Release();
    const int32_t rows = archive.Presence("pixels", false) ? layout.RowsThatFollow(archive) : 0;
    if (rows > 0 && !Allocate(layout))
        archive.Refuse(EFailure::OutOfMemory);
    if (IsEmpty())
    {
        layout.m_iWidth = layout.m_iHeight = layout.m_iFormat = 0;
        m_kLayout = layout;
        return;
    }
    const CPixelLock lock(*this);
    if (!lock)
        archive.Refuse(EFailure::OutOfMemory);
    std::span<uint8_t> bytes = lock.Bytes();
    archive.Row("pixels", bytes);
}

} // namespace gw
