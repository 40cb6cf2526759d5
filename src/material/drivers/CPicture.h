#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace gw {

/// A pixel of four bytes, in memory red first.
struct PixelRGBA
{
    uint8_t r;
    uint8_t g;
    uint8_t b;
    uint8_t a;

    friend bool operator==(const PixelRGBA&, const PixelRGBA&) = default;
};

/// The brightness of a pixel, for pictures of one channel.
inline uint8_t Brightness(const PixelRGBA& pixel)
{
    return static_cast<uint8_t>((77 * pixel.r + 150 * pixel.g + 29 * pixel.b) >> 8);
}

/// Where a picture has pixels: columns from x on, rows from y on.
struct PictureBox
{
    int x = 0;
    int y = 0;
    int width = 0;
    int height = 0;
};

/// A picture file that is open, read or written row by row. Rows are counts of pixels from a first column on;
/// a row that is not inside the box, or that this picture cannot do, answers false and leaves the buffer
/// alone. A single channel is the palette's index where there is a palette, else the brightness.
class CPicture
{
public:
    explicit CPicture(std::string name) : m_kName(std::move(name)) {}
    virtual ~CPicture() = default;
    CPicture(const CPicture&) = delete;
    CPicture& operator=(const CPicture&) = delete;

    const std::string& Name() const { return m_kName; }
    /// What messages of this picture's driver begin with.
    virtual const char* MessageName() const = 0;
    /// Ends writing; false where not all rows have come or not all bytes could be written.
    virtual bool Close() { return true; }

    virtual int ChannelCount() const = 0;
    virtual PictureBox Box() const = 0;
    /// Whether row 0 is the bottom of the picture.
    virtual bool IsBottomFirst() const { return false; }
    virtual bool ReadRow(int y, int x, int count, uint8_t* pixels) = 0;
    virtual bool ReadRowRGBA(int y, int x, int count, PixelRGBA* pixels) = 0;
    /// Goes on to the next picture in the file; false where there is none.
    virtual bool NextPicture() { return false; }

    virtual bool SetChannelCount(int) { return false; }
    virtual bool SetSize(const PictureBox&) { return false; }
    virtual bool WriteRow(int, int, int, const uint8_t*) { return false; }
    virtual bool WriteRowRGBA(int, int, int, const PixelRGBA*) { return false; }

protected:
    /// Whether a row's pixels lie inside a picture of this size.
    static bool IsInside(int y, int x, int count, const PictureBox& box)
    {
        return y >= 0 && y < box.height && x >= 0 && count >= 0 && x <= box.width - count;
    }

private:
    std::string m_kName;
};

/// Opens a picture by the driver of its file type. The mode begins with "r" or "w"; "-.bmp" and "-.gif" are
/// the standard streams. Null where there is no driver or the driver refuses, which it tells on standard
/// error.
std::unique_ptr<CPicture> OpenPicture(const std::string& fileName, const char* mode);

} // namespace gw
