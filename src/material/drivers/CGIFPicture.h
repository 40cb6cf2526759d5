#pragma once

#include "CGIFReader.h"
#include "CPicInput.h"
#include "CPicture.h"

#include <string>

namespace gw {

/// A GIF file, read only, image by image. Rows count from the top, columns from the image's own left edge.
class CGIFPicture : public CPicture
{
public:
    /// Opens a file; returns null if it is not a GIF file and, with a message on standard error, for writing.
    static CPicture* Open(const char* fileName, const char* mode);
    explicit CGIFPicture(std::string name) : CPicture(std::move(name)), m_kReader(m_kInput) {}

    const char* MessageName() const override { return "gif"; }
    int ChannelCount() const override { return 3; }
    PictureBox Box() const override { return {0, 0, m_kImage.box.width, m_kImage.box.height}; }
    bool ReadRow(int y, int x, int count, uint8_t* pixels) override;
    bool ReadRowRGBA(int y, int x, int count, PixelRGBA* pixels) override;
    bool NextPicture() override;
    /// Returns the image that rows are read from.
    const GIFImage& Image() const { return m_kImage; }

private:
    CPicInput m_kInput;
    CGIFReader m_kReader;
    GIFImage m_kImage;
};

} // namespace gw
