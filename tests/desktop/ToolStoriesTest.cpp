// The map tool on a small screen, and typing into its dialogs.
#include "CDialogAnswers.h"
#include "CGaitToolWindow.h"
#include "CLeftKeys.h"
#include "CMapLineDialog.h"
#include "ContentFixture.h"

#include <QLineEdit>

namespace gw {

TEST(MapLines, OpenWithTheirFirstFieldSelected)
{
    const struct
    {
        EMapLine kind;
        const char* selected;
    } rows[] = {
        {EMapLine::Mapping, "7"},
        {EMapLine::Position, "7"},
        {EMapLine::FrameRate, "60"},
        {EMapLine::Text, "text"},
    };
    for (const auto& row : rows)
    {
        MapLine line;
        line.kind = row.kind;
        line.text = "text";
        line.numbers = {7, 8, 9};
        line.frameRate = 60;
        CMapLineDialog dialog(line, nullptr);
        dialog.show();
        Activate(dialog);
        EXPECT_EQ(dialog.findChild<QLineEdit*>()->selectedText(), QLatin1String(row.selected));
        EXPECT_TRUE(dialog.focusWidget()->inherits(row.kind == EMapLine::Text ? "QLineEdit" : "QSpinBox"));
    }
}

TEST(MapToolWindow, FitsASmallScreen)
{
    CTempFolder folder;
    const CScriptedPlatform platform(folder);
    const CLeftKeys keys;
    const CGaitToolWindow tool(platform, keys);
    const QSize least = tool.minimumSizeHint();
    EXPECT_TRUE(least.width() <= 1024 - 12 && least.height() <= 768 - 40)
        << least.width() << 'x' << least.height();
}

} // namespace gw
