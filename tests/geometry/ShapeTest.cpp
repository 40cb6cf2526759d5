#include "CNode.h"
#include "CShape.h"
#include "SceneBytes.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <tuple>

namespace gw {
namespace {

template <class T>
Ref<T> Shape(const std::vector<Vec3>& points)
{
    Ref<T> shape = new T;
    EXPECT_EQ(shape->XYZBuffer().size(), points.size());
    std::ranges::copy(points, shape->XYZBuffer().begin());
    shape->m_kMatrix = Mat4Compose(kMat3Identity, {0, 0, 100});
    shape->UpdateScene(0.0f, false);
    return shape;
}

} // namespace

TEST(Shapes, AreHitWhereTheyStandInTheWorld)
{
    const Ref<CLine> line = Shape<CLine>({{0, 0, 0}, {10, 0, 0}});
    const Ref<CLine> dot = Shape<CLine>({kVec3Zero, kVec3Zero});
    const Ref<CCircle> circle = Shape<CCircle>({kVec3UnitX});
    circle->m_fRadius = 2.0f;
    const Ref<CRectangle> square = Shape<CRectangle>({{0, 0, 0}, {2, 0, 0}, {2, 2, 0}, {0, 2, 0}});
    const Ref<CRectangle> clockwise = Shape<CRectangle>({{0, 2, 0}, {2, 2, 0}, {2, 0, 0}, {0, 0, 0}});
    const std::tuple<const char*, CShape*, Vec3, bool> rows[] = {
        {"beside the line", line.Get(), {5, 4.9f, 100}, true},
        {"at the tolerance", line.Get(), {5, 5, 100}, false},
        {"beside its first end", line.Get(), {0, 1, 100}, false},
        {"beyond its second end", line.Get(), {10.1f, 1, 100}, false},
        {"on its first end", line.Get(), {0, 0, 100}, false},
        {"in the model's place", line.Get(), {5, 0, 0}, false},
        {"both ends equal", dot.Get(), {0, 0, 101}, false},
        {"at the radius", circle.Get(), {3, 0, 100}, true},
        {"outside the circle", circle.Get(), {3.01f, 0, 100}, false},
        {"inside, seen along Z", square.Get(), {1, 1, -7}, true},
        {"on an edge", square.Get(), {2, 1, 100}, false},
        {"outside", square.Get(), {3, 1, 100}, false},
        {"the other way round", clockwise.Get(), {1, 1, 100}, true},
    };
    for (const auto& [what, shape, place, hit] : rows)
        EXPECT_EQ(shape->HitTest(place), hit) << what;
    Vec3 center;
    line->GetCenter(center);
    EXPECT_EQ(center, (Vec3{5, 0, 0}));
    line->GetWorldCenter(center);
    EXPECT_EQ(center, (Vec3{5, 0, 100}));
}

TEST(Shapes, WithoutTheirPointsAreNeverHit)
{
    for (const char* className : {"CLine", "CCircle", "CRectangle"})
    {
        SCOPED_TRACE(className);
        CSceneBytes bytes = Scene();
        bytes.Root().Object(className, 1).Spatial().Words({0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}).Byte(0);
        if (std::string_view(className) == "CCircle")
            bytes.Float(5.0f);
        COrrinStream stream;
        ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
        EXPECT_EQ(SaveBytes(stream), bytes.Bytes());
        CShape& shape = static_cast<CShape&>(*stream.GetRoot(0));
        shape.UpdateScene(0.0f, true);
        EXPECT_FALSE(shape.HitTest(kVec3Zero));
        Vec3 center = kVec3One;
        shape.GetWorldCenter(center);
        EXPECT_EQ(center, kVec3Zero);
    }
}

} // namespace gw
