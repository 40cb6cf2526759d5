#pragma once

#include <QIcon>
#include <QRect>
#include <QSize>
#include <QString>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// One child of the window's face, as the skin places it.
struct SkinChild
{
    std::string kind;
    std::string name; ///< "#" begins displays, "|" scroll bars, "%" two-state buttons
    QRect place;      ///< in pixels at scale 1
    std::string icon; ///< a picture's name, or empty
    std::string secondIcon;
};

/// The skin of the main window: a folder with the face's layout (bvh.cnt), its texts (bvh.ini), the style of
/// all windows (bvh.qss) and the pictures (icons/).
class CSkin
{
public:
    /// False, with words on what is missing or wrong, when the folder holds no whole skin.
    bool Load(const std::string& folder, std::string& problem);

    QSize Size() const { return m_kSize; }
    const std::vector<SkinChild>& Children() const { return m_kChildren; }
    const QString& StyleSheet() const { return m_kStyleSheet; }
    /// The text of a child: what it shows, or with ".name" or ".tip" behind the child's name how it is called
    /// and what its tool tip says. Empty where the skin has none.
    QString Text(std::string_view child, std::string_view aspect = {}) const;
    /// Crisp at every scale, dimmed where it is disabled; empty for an empty name.
    QIcon Icon(const std::string& name) const;

private:
    bool ReadFile(const char* name, std::string& text, std::string& problem) const;
    bool ReadLayout(std::string_view text, std::string& problem);
    bool HasAllParts(std::string& problem) const;
    std::string IconPath(const std::string& name) const;

    std::string m_kFolder;
    std::string m_kTexts;
    QString m_kStyleSheet;
    QSize m_kSize;
    std::vector<SkinChild> m_kChildren;
};

} // namespace gw
