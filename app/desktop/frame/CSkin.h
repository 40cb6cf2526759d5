#pragma once

#include <QIcon>
#include <QRect>
#include <QSize>
#include <QString>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// One child of the window's face, placed by the skin.
struct SkinChild
{
    std::string kind;
    std::string name; ///< starts with "#" for displays, "|" for scroll bars, "%" for two-state buttons
    QRect place;      ///< pixels, already shrunk
    std::string icon; ///< name of a picture, or empty
    std::string secondIcon;
};

/// The skin of the main window: a folder with the layout (bvh.cnt), the texts (bvh.ini), the style of all
/// windows (bvh.qss) and the pictures (icons/).
class CSkin
{
public:
    /// Loads a skin. Returns false, with a description of the problem, if the folder has no complete skin.
    bool Load(const std::string& folder, std::string& problem);

    /// Makes everything smaller if the window would not fit on a screen with this size, but at most by half.
    void ShrinkTo(const QSize& screen);

    QSize Size() const { return m_kSize; }
    const std::vector<SkinChild>& Children() const { return m_kChildren; }
    const QString& StyleSheet() const { return m_kStyleSheet; }
    /// Returns the text that a child shows, or with the aspect "name" or "tip" its accessible name or tool
    /// tip. Empty if the skin has none.
    QString Text(std::string_view child, std::string_view aspect = {}) const;
    /// Returns an icon, sharp at every scale and dimmed if disabled; empty for an empty name.
    QIcon Icon(const std::string& name) const;
    /// Returns the side of the icons in buttons.
    int IconSide() const;

private:
    bool ReadFile(const char* name, std::string& text, std::string& problem) const;
    bool ReadLayout(std::string_view text, std::string& problem);
    bool HasAllParts(std::string& problem) const;
    std::string IconPath(const std::string& name) const;

    std::string m_kFolder;
    std::string m_kTexts;
    QString m_kStyleSheet;
    QSize m_kSize;
    double m_dScale = 1.0;
    std::vector<SkinChild> m_kChildren;
};

} // namespace gw
