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

/// Where pixels are kept, as stored in files.
enum class EPixelStorage : uint16_t
{
    Heap,
    TempStore, ///< in the process's temp store, mapped only while locked
    Foreign,   ///< owned by the caller; never freed or resized here
};

/// A raster of pixels, accessed only through CPixelLock and CPixelView. Operations do not throw; if one
/// returns false, nothing has changed.
class CPixelBuffer
{
public:
    CPixelBuffer() = default;
    /// Copies to the heap or the temp store; empty if there is not enough memory.
    CPixelBuffer(const CPixelBuffer& source);
    CPixelBuffer& operator=(const CPixelBuffer&) = delete;
    ~CPixelBuffer();

    /// Creates a picture of one color: `fill` points to one pixel, null means zeros. Returns false for a size
    /// below 1, an unknown format, too little memory, a new size for foreign pixels, and while a lock is
    /// held.
    bool Create(int32_t width, int32_t height, int32_t format, const uint8_t* fill = nullptr);
    /// Refers to stride x height bytes owned by the caller, which must stay valid until this is freed or
    /// destroyed.
    bool Attach(uint8_t* pixels, int32_t width, int32_t height, int32_t format);
    /// Frees the pixels; foreign ones are only forgotten. Returns false while a lock is held.
    bool Free();
    /// Copies size, format, alignment, resolution and all bytes of another picture.
    bool Copy(const CPixelBuffer& other);

    /// Selects the storage for the next Create. Returns false while there are pixels.
    bool SetStorage(EPixelStorage storage);
    /// Sets whether rows start at multiples of 4 bytes. Returns false while there are pixels.
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
    uint32_t GetHandle() const { return m_uiHandle; } ///< of the temp store's block, or 0
    /// Returns stride x height - bytes per pixel + 4, or 0 without pixels.
    size_t GetBlockBytes() const { return m_uiBlockBytes; }
    int32_t GetLockCount() const { return m_iLocks; }
    /// Returns a number that changes whenever pixels may have changed.
    uint32_t GetRevision() const { return m_uiRevision; }

    /// Returns the first byte of the pixels, valid until Unlock. Returns null, and needs no Unlock, if there
    /// are no pixels or they cannot be mapped. Several locks can be held, from any threads.
    uint8_t* Lock() const;
    void Unlock() const;
    void Touch() { ++m_uiRevision; } ///< call before changing pixels

    /// The stored fields, in file order. Without pixels, the size is written as 0.
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

/// Holds a lock on a picture. Row(y) returns the start of row y, Bytes() all rows. Converts to false if there
/// are no pixels or they cannot be mapped.
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
    std::span<TByte> Bytes() const&& = delete; // the lock of a temporary would end before a loop starts
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
