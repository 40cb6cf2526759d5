// A user works in the views: picks a bone with the mouse, follows the figure.
#include "BonePairs.h"
#include "CFileConversion.h"
#include "CPerson.h"
#include "CPreviewWidget.h"
#include "CProfileEditorDialog.h"
#include "FaultWords.h"
#include "HTRPose.h"
#include "MeasureConversion.h"
#include "QtText.h"

#include <QAbstractButton>
#include <QLabel>
#include <QTest>
#include <algorithm>
#include <gtest/gtest.h>

namespace gw {
namespace {

CPreviewWidget& View(CPerson& person, const char* child)
{
    return *static_cast<CPreviewWidget*>(person.Child(child));
}

// Returns a place in a view at which a bone is drawn.
QPoint PlaceOf(CPreviewWidget& view, const std::string& bone)
{
    for (int y = 0; y < view.height(); y += 3)
    {
        for (int x = 0; x < view.width(); x += 3)
        {
            if (view.View()->BoneAt({double(x), double(y), double(view.width()), double(view.height())}) ==
                bone)
                return {x, y};
        }
    }
    ADD_FAILURE() << bone << " is not visible";
    return {};
}

TEST(Views, AClickOnABoneSelectsItInTheEditor)
{
    CPerson person;
    person.Drop(ExampleFile("walk.bvh"));
    person.Click("convert");
    const struct
    {
        const char* view;
        const char* bone;
    } rows[] = {{"#cnt1", "rThigh"}, {"#cnt2", "LCalf"}};
    for (const auto& row : rows)
    {
        CPreviewWidget& view = View(person, row.view);
        const QPoint at = PlaceOf(view, row.bone);
        QTest::mouseMove(&view, at);
        auto* const name = view.findChild<QLabel*>(QStringLiteral("boneName"));
        ASSERT_TRUE(WaitUntil([&] { return name->isVisible(); }));
        EXPECT_EQ(ToUtf8(name->text()), row.bone);
        QTest::mouseClick(&view, Qt::LeftButton, {}, at);
        QTest::mousePress(&view, Qt::LeftButton, {}, QPoint(5, 5)); // dragging selects nothing
        QTest::mouseMove(&view, at);
        QTest::mouseRelease(&view, Qt::LeftButton, {}, at);
    }
    EXPECT_EQ(person.Content().ProfileEditor()->SourceTree().SelectedText(), "rThigh");
    EXPECT_EQ(person.Content().ProfileEditor()->TargetTree().SelectedText(), "LCalf");
}

TEST(Views, FollowTheFigureAlsoAfterARestart)
{
    CPerson person;
    const auto follow = [&](const char* view) {
        return View(person, view).findChild<QAbstractButton*>(QStringLiteral("follow"));
    };
    EXPECT_FALSE(follow("#cnt1")->isChecked());
    person.Type(Qt::Key_T);
    EXPECT_TRUE(follow("#cnt1")->isChecked() && follow("#cnt2")->isChecked());
    person.Restart();
    EXPECT_TRUE(View(person, "#cnt2").View()->IsFollowing());
    QTest::mouseClick(follow("#cnt2"), Qt::LeftButton);
    EXPECT_FALSE(View(person, "#cnt1").View()->IsFollowing());
}

TEST(Views, NVisitsTheFramesThatACheckNames)
{
    CPerson person;
    person.Drop(ExampleFile("walk.bvh"));
    person.Click("convert");
    ASSERT_TRUE(WaitUntil([&] { return person.Content().Marks().frameCount > 0; }));
    CFileConversion check({}, {}, [](const Notice&) {});
    ASSERT_TRUE(check.LoadSource(ExampleFile("walk.bvh")) && check.LoadTarget() &&
                check.UseProfile(person.Content().ProfilePath()) && check.Convert(true));
    TakeWrittenPoses(check.Result());
    const SourceTiming timing = check.Timing();
    const MotionClip source{check.SourceRoot(), timing.frequency, static_cast<int>(timing.lastFrame) + 1};
    std::vector<BonePair> pairs;
    std::vector<MissingBone> missing;
    ReadBonePairs(check.ProfilePath(), source.root, check.Result().motionRoot.Get(), pairs, missing);
    ConversionDetail detail;
    const ConversionMeasures sums = MeasureConversion(source, ClipOf(check.Result()), pairs, &detail);
    std::vector<WorstFrame> worst = FindWorstFrames(sums, detail, kWorstFrames);
    std::ranges::sort(worst, {}, &WorstFrame::frame);
    auto* const note = person.Child("#cnt2")->findChild<QLabel*>(QStringLiteral("note"));
    for (const WorstFrame& frame : worst)
    {
        person.Type(Qt::Key_N);
        EXPECT_EQ(person.Place().section(QLatin1Char(' '), 0, 1),
                  QStringLiteral("frame %1").arg(frame.frame));
        EXPECT_EQ(ToUtf8(note->text()), "Check " + WorstFrameText(frame));
    }
    person.Type(Qt::Key_Left);
    EXPECT_FALSE(note->isVisible());
    QTest::mouseClick(person.Child("#marks"), Qt::LeftButton, {}, QPoint(0, 3));
    EXPECT_TRUE(person.Place().startsWith(QStringLiteral("frame 0 ")));
}

} // namespace
} // namespace gw
