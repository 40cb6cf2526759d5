#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace gw {

/// A pixel of four bytes, red first in memory.
struct PixelRGBA
{
    uint8_t r;
    uint8_t g;
    uint8_t b;
    uint8_t a;

    friend bool operator==(const PixelRGBA&, const PixelRGBA&) = default;
};

/// Returns the brightness of a pixel, for single-channel pictures.
inline uint8_t Brightness(const PixelRGBA& pixel)
{
    return static_cast<uint8_t>((77 * pixel.r + 150 * pixel.g + 29 * pixel.b) >> 8);
}

/// The area of a picture: columns starting at x, rows starting at y.
struct PictureBox
{
    int x = 0;
    int y = 0;
    int width = 0;
    int height = 0;
};

/// An open picture file, read or written row by row. A row is a number of pixels starting at a column. If it
/// is not inside the box, or not supported, the call returns false and leaves the buffer unchanged. A single
/// channel is the palette index if there is a palette, otherwise the brightness.
class CPicture
{
public:
    explicit CPicture(std::string name) : m_kName(std::move(name)) {}
    virtual ~CPicture() = default;
    CPicture(const CPicture&) = delete;
    CPicture& operator=(const CPicture&) = delete;

    const std::string& Name() const { return m_kName; }
    /// Returns the prefix of this driver's messages.
    virtual const char* MessageName() const = 0;
    /// Ends writing. Returns false if rows are missing or bytes could not be written.
    virtual bool Close() { return true; }

    virtual int ChannelCount() const = 0;
    virtual PictureBox Box() const = 0;
    /// Returns whether row 0 is the bottom row.
    virtual bool IsBottomFirst() const { return false; }
    virtual bool ReadRow(int y, int x, int count, uint8_t* pixels) = 0;
    virtual bool ReadRowRGBA(int y, int x, int count, PixelRGBA* pixels) = 0;
    /// Moves to the next picture in the file; false if there is none.
    virtual bool NextPicture() { return false; }

    virtual bool SetChannelCount(int) { return false; }
    virtual bool SetSize(const PictureBox&) { return false; }
    virtual bool WriteRow(int, int, int, const uint8_t*) { return false; }
    virtual bool WriteRowRGBA(int, int, int, const PixelRGBA*) { return false; }

protected:
    /// Returns whether a row's pixels are inside a picture of this size.
    static bool IsInside(int y, int x, int count, const PictureBox& box)
    {
        return y >= 0 && y < box.height && x >= 0 && count >= 0 && x <= box.width - count;
    }

private:
    std::string m_kName;
};

/// Opens a picture with the driver of its file type. The mode starts with "r" or "w"; "-.bmp" and "-.gif" are
/// the standard streams. Returns null without a driver or, with a message on standard error, if the driver
/// refuses.
std::unique_ptr<CPicture> OpenPicture(const std::string& fileName, const char* mode);

} // namespace gw
