#include "PicturePromises.h"

#include "FuzzTarget.h"

#include <algorithm>
#include <vector>

namespace gw {

namespace {

using Row = std::vector<PixelRGBA>;

// In larger pictures, only the first and last rows are read: a BMP file can claim rows of a gigabyte, and
// reading them all takes too long.
constexpr int64_t kMostPixels = 1 << 20;

Row RowOf(CPicture& picture, int y)
{
    const PictureBox box = picture.Box();
    Row row(static_cast<size_t>(box.width));
    return picture.ReadRowRGBA(y, 0, box.width, row.data()) ? row : Row();
}

bool HaveOneColor(const PixelRGBA& a, const PixelRGBA& b)
{
    return a.r == b.r && a.g == b.g && a.b == b.b;
}

void RequireRefusal(CPicture& picture)
{
    const PictureBox box = picture.Box();
    PixelRGBA pixel[2] = {};
    Require(!picture.ReadRowRGBA(box.height, 0, 1, pixel), "no row below the last can be read");
    Require(!picture.ReadRowRGBA(-1, 0, 1, pixel), "no row above the first can be read");
    Require(!picture.ReadRowRGBA(0, box.width - 1, 2, pixel), "no column behind the last can be read");
}

} // namespace

bool ReadsWhole(CPicture& picture)
{
    const PictureBox box = picture.Box();
    Require(box.width > 0 && box.height > 0, "a picture has pixels");
    RequireRefusal(picture);
    if (int64_t{box.width} * box.height > kMostPixels)
        return false;
    std::vector<uint8_t> bytes(static_cast<size_t>(box.width) * static_cast<size_t>(picture.ChannelCount()));
    for (int y = 0; y < box.height; ++y)
    {
        const bool whole = picture.ReadRow(y, 0, box.width, bytes.data());
        if (!whole || RowOf(picture, y).empty())
            return false;
    }
    return true;
}

void RequireSameCopy(CPicture& picture, const std::string& path)
{
    const PictureBox box = picture.Box();
    const auto copy = OpenPicture(path, "w");
    Require(copy && copy->SetChannelCount(3) && copy->SetSize(box), "a copy can be begun");
    // Written from the top.
    const auto rowFromTop = [&](int y) { return picture.IsBottomFirst() ? box.height - 1 - y : y; };
    for (int y = 0; y < box.height; ++y)
        Require(copy->WriteRowRGBA(y, 0, box.width, RowOf(picture, rowFromTop(y)).data()),
                "a row can be written");
    Require(copy->Close(), "a copy can be ended");
    const auto again = OpenPicture(path, "r");
    Require(again && again->Box().width == box.width && again->Box().height == box.height,
            "a copy has the same size");
    for (int y = 0; y < box.height; ++y)
    {
        const int from = again->IsBottomFirst() ? box.height - 1 - y : y;
        Require(std::ranges::equal(RowOf(*again, from), RowOf(picture, rowFromTop(y)), HaveOneColor),
                "a copy has the same colours");
    }
}

} // namespace gw
