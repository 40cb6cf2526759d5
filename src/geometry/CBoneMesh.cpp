// The two bone shapes. Their points, triangles and order are fixed, since containers store them.

#include "CBoneMesh.h"

#include <algorithm>
#include <array>
#include <new>

namespace gw {

const CRTTI CBoneMesh::ms_kRTTI{"CBoneMesh", &CTriMesh::ms_kRTTI};
const CRTTI CBoneNodeMesh::ms_kRTTI{"CBoneNodeMesh", &CBoneMesh::ms_kRTTI};
const CRTTI CBoneShapeMesh::ms_kRTTI{"CBoneShapeMesh", &CBoneMesh::ms_kRTTI};
const CRTTI CBoneObjMesh::ms_kRTTI{"CBoneObjMesh", &CBoneMesh::ms_kRTTI};

namespace {

using Triangle = std::array<uint32_t, 3>;

// The tapered bone, of length 1: root, four points near it, tip.
constexpr float kA = 0.098558f;
constexpr float kH = 0.099397f;
constexpr Vec3 kShapePoints[] = {
    {0.0f, 0.0f, 0.0f},
    {-kA,  kH,   kA  },
    {-kA,  kH,   -kA },
    {0.0f, 1.0f, 0.0f},
    {kA,   kH,   kA  },
    {kA,   kH,   -kA },
};
constexpr Triangle kShapeTriangles[] = {
    {0, 5, 4},
    {4, 5, 3},
    {1, 2, 0},
    {1, 3, 2},
    {3, 1, 4},
    {1, 0, 4},
    {0, 2, 5},
    {2, 3, 5},
};

// The ball: an icosahedron standing on a corner, with each edge split once and its middle pushed out to the
// sphere. Corner 0 is the top, 1 to 5 the upper ring, 6 to 10 the lower ring (half a step further round), 11
// the bottom.
constexpr float kRadius = 0.125f;
constexpr uint32_t kCornerCount = 12;
constexpr Vec3 kCorners[kCornerCount] = {
    {0.0f,         0.0f,         1.0f       },
    {0.894427191f, 0.0f,         0.44721360f},
    {0.27639320f,  0.85065081f,  0.44721360f},
    {-0.72360680f, 0.52573111f,  0.44721360f},
    {-0.72360680f, -0.52573111f, 0.44721360f},
    {0.27639320f,  -0.85065081f, 0.44721360f},
    {0.72360680f,  0.52573111f,  -0.4472136f},
    {-0.27639320f, 0.85065081f,  -0.4472136f},
    {-0.89442719f, 0.0f,         -0.4472136f},
    {-0.27639320f, -0.85065081f, -0.4472136f},
    {0.72360680f,  -0.52573111f, -0.4472136f},
    {0.0f,         0.0f,         -1.0f      },
};
// The corners of each edge. The middle of edge i is point 12 + i.
constexpr std::array<uint32_t, 2> kEdges[] = {
    {0,  1 },
    {0,  2 },
    {0,  3 },
    {0,  4 },
    {0,  5 },
    {1,  2 },
    {2,  3 },
    {3,  4 },
    {4,  5 },
    {1,  5 },
    {1,  6 },
    {2,  6 },
    {2,  7 },
    {3,  7 },
    {3,  8 },
    {4,  8 },
    {4,  9 },
    {5,  9 },
    {5,  10},
    {1,  10},
    {6,  7 },
    {7,  8 },
    {8,  9 },
    {9,  10},
    {6,  10},
    {6,  11},
    {7,  11},
    {8,  11},
    {9,  11},
    {10, 11},
};
constexpr Triangle kFaces[] = {
    {0,  1,  2 },
    {0,  2,  3 },
    {0,  3,  4 },
    {0,  4,  5 },
    {0,  5,  1 },
    {1,  6,  2 },
    {2,  6,  7 },
    {2,  7,  3 },
    {3,  7,  8 },
    {3,  8,  4 },
    {4,  8,  9 },
    {4,  9,  5 },
    {5,  9,  10},
    {5,  10, 1 },
    {1,  10, 6 },
    {11, 7,  6 },
    {11, 8,  7 },
    {11, 9,  8 },
    {11, 10, 9 },
    {11, 6,  10},
};

struct Shape
{
    std::vector<Vec3> points;
    std::vector<Triangle> triangles;
};

uint32_t MiddleOf(uint32_t a, uint32_t b)
{
    const std::array<uint32_t, 2> edge{std::min(a, b), std::max(a, b)};
    return kCornerCount + static_cast<uint32_t>(std::ranges::find(kEdges, edge) - kEdges);
}

Shape MakeBall()
{
    Shape ball;
    for (const Vec3& corner : kCorners)
        ball.points.push_back(corner * kRadius);
    for (const auto& [a, b] : kEdges)
        ball.points.push_back(Vec3Normalized(kCorners[a] + kCorners[b]) * kRadius);
    for (const auto& [a, b, c] : kFaces)
    {
        const uint32_t ab = MiddleOf(a, b);
        const uint32_t bc = MiddleOf(b, c);
        const uint32_t ca = MiddleOf(c, a);
        ball.triangles.insert(ball.triangles.end(), {
                                                        {a,  ab, ca},
                                                        {ab, b,  bc},
                                                        {ab, bc, ca},
                                                        {ca, bc, c }
        });
    }
    return ball;
}

bool BuildShape(CBoneMesh& mesh, float length, std::span<const Vec3> points,
                std::span<const Triangle> triangles)
{
    if (!(length > 0.0f))
        return false;
    if (!mesh.SetPointCount(static_cast<int32_t>(points.size())) ||
        !mesh.SetTriangleQuantity(static_cast<int32_t>(triangles.size())))
        // like any part of a skeleton: without its length, it would be converted wrongly
        throw std::bad_alloc();
    mesh.m_fLength = length;
    std::ranges::transform(points, mesh.XYZBuffer().begin(),
                           [=](const Vec3& point) { return point * length; });
    auto index = mesh.XYZTriIndexBuffer().begin();
    for (const Triangle& triangle : triangles)
        index = std::ranges::copy(triangle, index).out;
    mesh.BuildVertexTable();
    return true;
}

} // namespace

bool CBoneNodeMesh::Build(float length)
{
    static const Shape ball = MakeBall();
    return BuildShape(*this, length, ball.points, ball.triangles);
}

bool CBoneShapeMesh::Build(float length)
{
    return BuildShape(*this, length, kShapePoints, kShapeTriangles);
}

} // namespace gw
