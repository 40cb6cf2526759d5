// The lines drawn for a scene.

#include "PreviewScene.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <tuple>

namespace gw {
namespace {

constexpr size_t kAxisEnds = 6;

// Returns the lines of a scene without updating it.
std::vector<LineEnd> LinesOf(CNode& scene, const char* highlight = "")
{
    CGLView view;
    view.SetScene(&scene, 1.0f, 1.0f);
    view.SetHighlight(highlight);
    const std::span<const LineEnd> ends = view.DrawScene().Ends();
    return {ends.begin(), ends.end()};
}

void ExpectLine(const std::vector<LineEnd>& lines, size_t first, const Vec3& from, const Vec3& to,
                LineColor color)
{
    ASSERT_LE(first + 2, lines.size());
    EXPECT_EQ(lines[first].point, from);
    EXPECT_EQ(lines[first + 1].point, to);
    EXPECT_EQ(lines[first].color, color);
    EXPECT_EQ(lines[first + 1].color, color);
}

TEST(DrawList, LastSixthOfTheTrianglesIsLeftOut)
{
    const std::tuple<int32_t, size_t> rows[] = {
        {0, 0}, {1, 1}, {2, 2}, {3, 3}, {4, 4}, {5, 4}, {6, 5}, {8, 7}, {12, 10}, {72, 60},
    };
    for (const auto& [triangles, drawn] : rows)
    {
        SCOPED_TRACE(triangles);
        const Ref<CNode> scene = MakeScene({});
        AttachBone(*scene, "bone", triangles);
        scene->UpdateScene(0.0f, true);
        const std::vector<LineEnd> lines = LinesOf(*scene);
        EXPECT_EQ(lines.size(), kAxisEnds + 6 * drawn);
        if (drawn > 0)
        {
            EXPECT_EQ(lines.back().point.z, static_cast<float>(drawn - 1)) << "the first ones are drawn";
        }
    }
}

TEST(DrawList, TriangleIsAClosedOutlineInTheWorld)
{
    const Ref<CNode> scene = MakeScene({});
    AttachBone(*scene, "bone", 1, {100, 0, 0});
    scene->UpdateScene(0.0f, true);
    const std::vector<LineEnd> lines = LinesOf(*scene);
    const Vec3 corners[] = {{90, -10, 0}, {110, -10, 0}, {100, 10, 0}};
    for (size_t side = 0; side < 3; ++side)
        ExpectLine(lines, kAxisEnds + 2 * side, corners[side], corners[(side + 1) % 3], kBoneColor);
}

// The mesh is rotated by a quarter turn about Z and scaled.
TEST(DrawList, AxesFollowTheMeshWithItsScale)
{
    const Ref<CNode> scene = MakeScene({kVec3Zero, 50});
    AttachBone(*scene, "bone", 0).m_kWorldMatrix = {{0, 2, 0, 0, -1, 0, 0, 0, 0, 0, 0.5f, 0, 7, 8, 9, 1}};
    const std::vector<LineEnd> lines = LinesOf(*scene);
    const Vec3 tips[] = {{7, 18, 9}, {2, 8, 9}, {7, 8, 11.5f}};
    ASSERT_EQ(lines.size(), kAxisEnds);
    for (size_t axis = 0; axis < 3; ++axis)
        ExpectLine(lines, 2 * axis, {7, 8, 9}, tips[axis], kAxisColors[axis]);
}

TEST(DrawList, HighlightIsExactlyTheParentsName)
{
    const Ref<CNode> scene = MakeScene({});
    scene->SetName("scene");
    const char* const nameless = nullptr;
    for (const char* name : {"Hips", "other", "", nameless})
        AttachBone(*scene, name, 1).SetName("mesh");
    for (const std::string highlight : {"Hips", "hips", "Hip", "Hips2", "mesh", "scene", ""})
    {
        const std::vector<LineEnd> lines = LinesOf(*scene, highlight.c_str());
        ASSERT_EQ(lines.size(), 4 * (kAxisEnds + 6));
        const bool shines = highlight == "Hips";
        EXPECT_EQ(lines[kAxisEnds].color, shines ? kHighlightColor : kBoneColor) << highlight;
        EXPECT_EQ(std::ranges::count(lines, kHighlightColor, &LineEnd::color), shines ? 6 : 0) << highlight;
    }
}

TEST(DrawList, FilesMayNameWhatThereIsNot)
{
    const Ref<CNode> scene = MakeScene({});
    CTriMesh& odd = AttachBone(*scene, "a point that there is not", 3);
    odd.XYZTriIndexBuffer()[4] = 9;
    auto* const bare = new CTriMesh;
    bare->SetTriangleQuantity(1'000'000); // without points there is no list
    scene->AttachChild(bare);
    EXPECT_EQ(LinesOf(*scene).size(), 2 * (kAxisEnds + 6));
}

TEST(DrawList, FollowsATreeThatChangesUnderIt)
{
    const Ref<CNode> scene = MakeScene({});
    AttachBone(*scene, "first", 1);
    CGLView view;
    view.SetScene(scene.Get(), 1.0f, 1.0f);
    const auto meshes = [&] { return view.DrawScene().Ends().size() / (kAxisEnds + 6); };
    EXPECT_EQ(meshes(), 1u);
    CSpatial* const second = AttachBone(*scene, "second", 1).GetParent();
    EXPECT_EQ(meshes(), 2u);
    scene->DetachChild(second); // deletes it
    EXPECT_EQ(meshes(), 1u);

    auto& first = static_cast<CNode&>(*scene->ChildAt(0));
    const Ref<CSpatial> mesh = first.SetChildAt(0, nullptr);
    EXPECT_EQ(meshes(), 0u);
    scene->AttachChild(mesh.Get());
    EXPECT_EQ(meshes(), 1u);
}

} // namespace
} // namespace gw
