#pragma once

#include "CPicInput.h"
#include "CPicture.h"

#include <array>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

namespace gw {

/// The start of a BMP file: 14 bytes without gaps.
struct BMPFileHeader
{
    uint16_t type = 0;
    uint32_t size = 0; ///< of the file
    uint16_t reserved1 = 0;
    uint16_t reserved2 = 0;
    uint32_t offset = 0; ///< of the pixels
};

/// The 40 bytes that follow, as stored.
struct BMPInfoHeader
{
    uint32_t size = 0; ///< of this header; larger ones have additional fields
    int32_t width = 0;
    int32_t height = 0; ///< negative if rows are stored from top to bottom
    uint16_t planes = 0;
    uint16_t bitCount = 0;
    uint32_t compression = 0;
    uint32_t imageSize = 0;
    int32_t xPixelsPerMeter = 0;
    int32_t yPixelsPerMeter = 0;
    uint32_t colorsUsed = 0;
    uint32_t colorsImportant = 0;
};

/// A BMP file, read or written row by row. Uncompressed files of all depths and both directions can be read:
/// in a bottom-up file row 0 is the bottom row, except from a stream, where row 0 is the top. A stream
/// without seeking returns rows in file order only; the last row can be read again, whole or in pieces. Files
/// are written with one channel or three, top down.
class CBMPPicture : public CPicture
{
public:
    /// Opens a file; returns null, with a message on standard error, if it cannot be read or written.
    static CPicture* Open(const char* fileName, const char* mode);
    explicit CBMPPicture(std::string name) : CPicture(std::move(name)) {}
    ~CBMPPicture() override { CloseFile(); }

    const char* MessageName() const override { return "picbmp"; }
    bool Close() override;
    int ChannelCount() const override { return m_iChannels; }
    PictureBox Box() const override { return {0, 0, m_iWidth, m_iHeight}; }
    bool IsBottomFirst() const override { return m_bReading && !m_bTopDown && !m_kInput.IsStream(); }
    bool ReadRow(int y, int x, int count, uint8_t* pixels) override;
    bool ReadRowRGBA(int y, int x, int count, PixelRGBA* pixels) override;
    bool SetChannelCount(int count) override;
    bool SetSize(const PictureBox& box) override;
    bool WriteRow(int y, int x, int count, const uint8_t* pixels) override;
    bool WriteRowRGBA(int y, int x, int count, const PixelRGBA* pixels) override;

private:
    bool OpenToRead();
    bool OpenToWrite();

    bool ReadHeader();
    bool ReadFileHeader();
    bool ReadInfoHeader();
    bool TakeSize();
    bool ReadPalette();
    bool ReadRowBytes(int y, int x, int count);
    uint8_t IndexAt(int x) const;
    PixelRGBA PixelAt(int x) const;

    bool HasBegun() const { return m_iRow > 0; }
    bool BeginRow(int y, int x, int count);
    bool FinishRow();
    bool WriteHeader();
    uint8_t* ChannelsAt(int x);
    void CloseFile();

    BMPFileHeader m_kFileHeader;
    BMPInfoHeader m_kInfoHeader;
    std::array<PixelRGBA, 256> m_kPalette{};
    bool m_bReading = false;
    bool m_bTopDown = false;
    bool m_bFailed = false; // a write has failed
    int m_iWidth = 0;
    int m_iHeight = 0;
    int m_iChannels = 3;
    int m_iRow = 0;               // next row to write
    uint32_t m_uiRowSize = 0;     // bytes of a row in the file
    int m_iHeldRow = -1;          // the file row in m_kRow while reading, or -1
    std::vector<uint8_t> m_kRow;  // current row, as in the file
    CPicInput m_kInput;           // the picture being read
    std::FILE* m_pkOut = nullptr; // the picture being written
};

} // namespace gw
