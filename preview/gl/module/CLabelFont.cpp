#include "CLabelFont.h"

#include <algorithm>
#include <numeric>
#include <string>

#include <fontconfig/fontconfig.h>
#include <ft2build.h>
#include FT_FREETYPE_H

namespace gw {

namespace {

constexpr char32_t kEllipsis = 0x2026;

// Returns the file of the default sans-serif font; empty without fonts.
std::string FontFile()
{
    std::string file;
    FcPattern* const wanted = FcNameParse(reinterpret_cast<const FcChar8*>("sans-serif"));
    FcConfigSubstitute(nullptr, wanted, FcMatchPattern);
    FcDefaultSubstitute(wanted);
    FcResult result = FcResultNoMatch;
    FcPattern* const found = FcFontMatch(nullptr, wanted, &result);
    FcChar8* name = nullptr;
    if (found && FcPatternGetString(found, FC_FILE, 0, &name) == FcResultMatch)
        file = reinterpret_cast<const char*>(name);
    if (found)
        FcPatternDestroy(found);
    FcPatternDestroy(wanted);
    return file;
}

std::vector<char32_t> CharactersOf(const std::string& text)
{
    std::vector<char32_t> characters;
    const auto* next = reinterpret_cast<const FcChar8*>(text.data());
    auto left = static_cast<int>(text.size());
    while (left > 0)
    {
        FcChar32 character = 0;
        const int size = FcUtf8ToUcs4(next, &character, left);
        if (size <= 0) // not UTF-8
            return characters;
        characters.push_back(character);
        next += size;
        left -= size;
    }
    return characters;
}

} // namespace

CLabelFont::CLabelFont()
{
    if (FT_Init_FreeType(&m_pkLibrary) != 0)
    {
        m_pkLibrary = nullptr;
        return;
    }
    if (FT_New_Face(m_pkLibrary, FontFile().c_str(), 0, &m_pkFace) != 0)
        m_pkFace = nullptr;
}

CLabelFont::~CLabelFont()
{
    if (m_pkLibrary)
        FT_Done_FreeType(m_pkLibrary); // the face too
}

int CLabelFont::Advance(char32_t character)
{
    return FT_Load_Char(m_pkFace, character, FT_LOAD_RENDER) == 0
               ? static_cast<int>(m_pkFace->glyph->advance.x >> 6)
               : 0;
}

std::vector<char32_t> CLabelFont::Fitting(const PictureLabel& label)
{
    std::vector<char32_t> characters = CharactersOf(label.text);
    std::vector<int> widths;
    widths.reserve(characters.size());
    for (const char32_t character : characters)
        widths.push_back(Advance(character));
    int width = std::accumulate(widths.begin(), widths.end(), 0);
    if (width <= label.maxWidth)
        return characters;
    width += Advance(kEllipsis);
    for (; width > label.maxWidth && !characters.empty(); characters.pop_back())
        width -= widths[characters.size() - 1];
    characters.push_back(kEllipsis);
    return characters;
}

void CLabelFont::Draw(RgbPicture& picture, const PictureLabel& label)
{
    if (!m_pkFace || FT_Set_Pixel_Sizes(m_pkFace, 0, static_cast<FT_UInt>(label.size)) != 0)
        return;
    int left = label.left;
    for (const char32_t character : Fitting(label))
    {
        const int advance = Advance(character);
        DrawGlyph(picture, left, label.baseline, label.color);
        left += advance;
    }
}

// Mixes the glyph that was loaded last with the picture.
void CLabelFont::DrawGlyph(RgbPicture& picture, int left, int baseline, LineColor color) const
{
    const FT_GlyphSlot glyph = m_pkFace->glyph;
    const FT_Bitmap& bitmap = glyph->bitmap;
    if (bitmap.pixel_mode != FT_PIXEL_MODE_GRAY)
        return;
    const uint8_t channels[] = {color.red, color.green, color.blue};
    for (int row = 0; row < static_cast<int>(bitmap.rows); ++row)
    {
        for (int column = 0; column < static_cast<int>(bitmap.width); ++column)
        {
            const int x = left + glyph->bitmap_left + column;
            const int y = baseline - glyph->bitmap_top + row;
            if (x < 0 || y < 0 || x >= picture.width || y >= picture.height)
                continue;
            const int cover = bitmap.buffer[row * bitmap.pitch + column];
            uint8_t* const pixel = picture.Pixel(x, y);
            for (int i = 0; i < 3; ++i)
                pixel[i] = static_cast<uint8_t>((pixel[i] * (255 - cover) + channels[i] * cover + 127) / 255);
        }
    }
}

} // namespace gw
