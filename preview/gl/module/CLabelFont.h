#pragma once

#include "PicturePanel.h"
#include "RgbPicture.h"

#include <string_view>
#include <vector>

struct FT_LibraryRec_;
struct FT_FaceRec_;

namespace gw {

/// The system's default sans-serif font, for labels. Characters that it lacks are shown as boxes.
class CLabelFont
{
public:
    CLabelFont();
    ~CLabelFont();
    CLabelFont(const CLabelFont&) = delete;
    CLabelFont& operator=(const CLabelFont&) = delete;

    /// Draws a label; nothing on a machine without fonts.
    void Draw(RgbPicture& picture, const PictureLabel& label);

private:
    int Advance(char32_t character);
    std::vector<char32_t> Fitting(const PictureLabel& label);
    void DrawGlyph(RgbPicture& picture, int left, int baseline, LineColor color) const;

    FT_LibraryRec_* m_pkLibrary = nullptr;
    FT_FaceRec_* m_pkFace = nullptr; ///< null without a font
};

} // namespace gw
