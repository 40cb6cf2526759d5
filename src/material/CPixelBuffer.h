#pragma once

#include "CPixelLayout.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <span>
#include <type_traits>

namespace gw {

class CFieldArchive;

/// Where pixels are kept, as files have it.
enum class EPixelStorage : uint16_t
{
    Heap,
    TempStore, ///< in the process's temp store, mapped only while locked
    Foreign,   ///< somebody else owns them; never freed nor resized here
};

/// A raster of pixels. Its bytes are reached through CPixelLock and CPixelView only. No operation throws; one
/// that answers false leaves everything as it was.
class CPixelBuffer
{
public:
    CPixelBuffer() = default;
    /// A copy on the heap or in the temp store, empty where there is no room for it.
    CPixelBuffer(const CPixelBuffer& source);
    CPixelBuffer& operator=(const CPixelBuffer&) = delete;
    ~CPixelBuffer();

    /// Makes a picture of one colour: `fill` points at one pixel, null means zeros. False for a size below 1,
    /// a format that there is not, no room, a new size for foreign pixels, and while somebody holds a lock.
    bool Create(int32_t width, int32_t height, int32_t format, const uint8_t* fill = nullptr);
    /// Shows pixels of somebody else, stride x height bytes, who keeps them until this is freed or dies.
    bool Attach(uint8_t* pixels, int32_t width, int32_t height, int32_t format);
    /// Lets go of the pixels; foreign ones are only forgotten. False while somebody holds a lock.
    bool Free();
    /// Takes over size, format, alignment, resolution and all bytes of another picture.
    bool Copy(const CPixelBuffer& other);

    /// For the next Create. False while there are pixels.
    bool SetStorage(EPixelStorage storage);
    /// Whether rows begin at multiples of 4 bytes. False while there are pixels.
    bool SetRowAlignment(bool aligned);
    void SetResolution(int32_t horizontal, int32_t vertical);

    bool IsEmpty() const { return m_uiBlockBytes == 0; }
    int32_t GetWidth() const { return m_kLayout.m_iWidth; }
    int32_t GetHeight() const { return m_kLayout.m_iHeight; }
    int32_t GetFormat() const { return m_kLayout.m_iFormat; } ///< 0 to 5
    int32_t GetBytesPerPixel() const { return IsEmpty() ? 0 : BytesPerPixel(m_kLayout.m_iFormat); }
    size_t GetStride() const { return IsEmpty() ? 0 : static_cast<size_t>(m_kLayout.Stride()); }
    const CPixelLayout& Layout() const { return m_kLayout; }
    EPixelStorage GetStorage() const { return m_eStorage; }
    uint32_t GetHandle() const { return m_uiHandle; } ///< of the temp store's block, 0 for none
    /// stride x height - bytes per pixel + 4, or 0 without pixels.
    size_t GetBlockBytes() const { return m_uiBlockBytes; }
    int32_t GetLockCount() const { return m_iLocks; }
    /// Another number whenever pixels may have changed.
    uint32_t GetRevision() const { return m_uiRevision; }

    /// The first byte of the pixels, which stay where they are until Unlock; null where they cannot be mapped
    /// and where there are none, and then no Unlock is due. Several may hold locks, in any threads.
    uint8_t* Lock() const;
    void Unlock() const;
    void Touch() { ++m_uiRevision; } ///< says that pixels are about to be changed

    /// The stored fields, in file order. Without pixels the size is written as none.
    void Fields(CFieldArchive& archive);

private:
    struct CFreer
    {
        void operator()(uint8_t* bytes) const { std::free(bytes); }
    };

    bool IsSame(const CPixelLayout& layout) const;
    bool Allocate(const CPixelLayout& layout);
    void Release();
    void Fill(const uint8_t* pixel);
    void ReadPixels(CFieldArchive& archive);

    CPixelLayout m_kLayout;
    EPixelStorage m_eStorage = EPixelStorage::Heap;
    std::unique_ptr<uint8_t, CFreer> m_pbyHeap;
    uint8_t* m_pbyForeign = nullptr;
    uint32_t m_uiHandle = 0;
    size_t m_uiBlockBytes = 0;
    uint32_t m_uiRevision = 0;
    mutable std::atomic<int32_t> m_iLocks = 0;
};

/// Holds a lock on a picture. Row y begins at Row(y); all rows together are Bytes(). Without pixels, and
/// where they cannot be mapped, it is false.
template <class TBuffer, class TByte>
class CPixelAccess
{
public:
    explicit CPixelAccess(TBuffer& buffer)
        : buffer_(buffer), m_uiStride(buffer.GetStride()), m_pbyPixels(buffer.Lock())
    {
        if constexpr (!std::is_const_v<TBuffer>)
            buffer.Touch();
    }
    ~CPixelAccess()
    {
        if (m_pbyPixels)
            buffer_.Unlock();
    }
    CPixelAccess(const CPixelAccess&) = delete;
    CPixelAccess& operator=(const CPixelAccess&) = delete;

    explicit operator bool() const { return m_pbyPixels != nullptr; }
    TByte* Row(int32_t y) const { return m_pbyPixels + static_cast<size_t>(y) * m_uiStride; }
    std::span<TByte> Bytes() const&& = delete; // such a lock is gone before a loop over them begins
    std::span<TByte> Bytes() const&
    {
        return {m_pbyPixels, m_pbyPixels ? m_uiStride * static_cast<size_t>(buffer_.GetHeight()) : 0};
    }

private:
    TBuffer& buffer_;
    size_t m_uiStride;
    TByte* m_pbyPixels;
};

using CPixelLock = CPixelAccess<CPixelBuffer, uint8_t>;             ///< for writing
using CPixelView = CPixelAccess<const CPixelBuffer, const uint8_t>; ///< for reading only

} // namespace gw
