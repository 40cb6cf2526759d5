// Writes binary glTF. Its matrices are for column vectors and are stored column by column, which gives the
// same sixteen numbers as this project's row vectors stored row by row. Quaternions are stored as x, y, z, w.
//
// A skinned mesh is placed by its joints alone, so its node is next to the skeleton. The nodes contain the
// rest pose; viewers that ignore animations show that.

#include "GlbFile.h"

#include "BodyTree.h"
#include "BoneBoxes.h"
#include "BoneMeshQueries.h"
#include "CGlbBuffer.h"
#include "CMotionFile.h"
#include "CMotionSampler.h"
#include "CSafeFile.h"
#include "Directions.h"
#include "Quat.h"
#include "Skeleton.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cmath>
#include <limits>
#include <unordered_map>

namespace gw {

namespace {

using Json = nlohmann::ordered_json;

constexpr uint32_t kMagic = 0x46546C67; // "glTF"
constexpr uint32_t kVersion = 2;
constexpr uint32_t kJsonChunk = 0x4E4F534A;
constexpr uint32_t kBinaryChunk = 0x004E4942;
constexpr size_t kHeaderBytes = 12 + 2 * 8; // of the file and of both chunks
constexpr size_t kChunkAlignment = 4;

constexpr float kWidestShare = 0.5f; // of the longest bone: the width of a box

std::span<const std::byte> BytesOf(const uint32_t& number)
{
    return std::as_bytes(std::span(&number, 1));
}

void Append(std::vector<float>& values, const Vec3& v, float scale = 1.0f)
{
    values.insert(values.end(), {v.x * scale, v.y * scale, v.z * scale});
}

// Appends a unit quaternion. Viewers interpolate between the numbers, so each is on the side of the last one.
void Append(std::vector<float>& values, const Mat4& matrix)
{
    Quat q = QuatFromMat3(NormalizedRows(matrix));
    const double length = std::sqrt(static_cast<double>(q.w) * q.w + static_cast<double>(q.x) * q.x +
                                    static_cast<double>(q.y) * q.y + static_cast<double>(q.z) * q.z);
    float scale = length > 0.0 ? static_cast<float>(1.0 / length) : 1.0f;
    if (values.size() >= 4)
    {
        const float* const last = &values[values.size() - 4];
        if (last[0] * q.x + last[1] * q.y + last[2] * q.z + last[3] * q.w < 0.0f)
            scale = -scale;
    }
    values.insert(values.end(), {q.x * scale, q.y * scale, q.z * scale, q.w * scale});
}

class CGlbWriter
{
public:
    CGlbWriter(const CMotionFile& motion, double metersPerUnit, const Vec3& up)
        : motion_(motion), m_fScale(static_cast<float>(metersPerUnit)),
          m_kUpright(Mat4Compose(LeastSwing(up, kVec3UnitY), kVec3Zero)),
          m_kNodes(NodesOf(*motion.motionRoot))
    {
        for (size_t i = 0; i < m_kNodes.size(); ++i)
            m_kIndexOfNode.emplace(m_kNodes[i], i);
    }

    bool Write(const CByteSink& sink);

private:
    void AddNodes();
    void AddSkin();
    void AddMesh();
    void AddAnimation();
    void AddChannel(Json& animation, size_t node, const char* path, size_t times, size_t keys);
    std::vector<BoneBox> Boxes() const;
    // Returns where a joint is at rest in the file.
    Mat4 RestOf(const CNode& node) const { return node.m_kWorldMatrix * m_kUpright; }

    const CMotionFile& motion_;
    const float m_fScale;
    const Mat4 m_kUpright; // from the motion's world to the file's
    const std::vector<CNode*> m_kNodes;
    std::unordered_map<const CNode*, size_t> m_kIndexOfNode;
    CGlbBuffer m_kBuffer;
    Json m_kFile = {
        {"asset", {{"version", "2.0"}, {"generator", "Gaitwright"}}},
    };
};

bool CGlbWriter::Write(const CByteSink& sink)
{
    SwitchControls(*motion_.motionRoot, false);
    motion_.motionRoot->UpdateScene(0.0f, true);
    AddNodes();
    AddSkin();
    AddMesh();
    SwitchControls(*motion_.motionRoot, true);
    AddAnimation();
    m_kFile["bufferViews"] = m_kBuffer.Views();
    m_kFile["accessors"] = m_kBuffer.Accessors();
    std::vector<std::byte> binary = m_kBuffer.Bytes();
    binary.resize((binary.size() + kChunkAlignment - 1) / kChunkAlignment * kChunkAlignment);
    m_kFile["buffers"] = {{{"byteLength", binary.size()}}};
    std::string text = m_kFile.dump(-1, ' ', false, Json::error_handler_t::replace);
    text.resize((text.size() + kChunkAlignment - 1) / kChunkAlignment * kChunkAlignment, ' ');
    const size_t byteCount = kHeaderBytes + text.size() + binary.size();
    if (byteCount > std::numeric_limits<uint32_t>::max())
        return false;
    for (const uint32_t number :
         {kMagic, kVersion, static_cast<uint32_t>(byteCount), static_cast<uint32_t>(text.size()), kJsonChunk})
    {
        if (!sink(BytesOf(number)))
            return false;
    }
    return sink(std::as_bytes(std::span(text))) && sink(BytesOf(static_cast<uint32_t>(binary.size()))) &&
           sink(BytesOf(kBinaryChunk)) && sink(binary);
}

void CGlbWriter::AddNodes()
{
    Json nodes = Json::array();
    for (const CNode* node : m_kNodes)
    {
        std::vector<float> translation, rotation;
        Append(translation, node->m_kMatrix.Translation(), m_fScale);
        Append(rotation, node->m_kMatrix);
        Json entry = {
            {"name",        std::string(node->NameView())},
            {"translation", translation                  },
            {"rotation",    rotation                     },
        };
        for (const CNode* child : ChildNodes(*node))
            entry["children"].push_back(m_kIndexOfNode.at(child));
        nodes.push_back(std::move(entry));
    }
    nodes.push_back({
        {"name", "Body"},
        {"mesh", 0     },
        {"skin", 0     },
    });
    size_t root = 0;
    if (m_kUpright != kMat4Identity)
    {
        std::vector<float> rotation;
        Append(rotation, m_kUpright);
        root = nodes.size();
        nodes.push_back({
            {"name",     "Armature"},
            {"rotation", rotation  },
            {"children", {0}       },
        });
    }
    m_kFile["scene"] = 0;
    m_kFile["scenes"] = {{{"nodes", {root, m_kNodes.size()}}}};
    m_kFile["nodes"] = std::move(nodes);
}

void CGlbWriter::AddSkin()
{
    std::vector<float> inverses;
    Json joints = Json::array();
    for (size_t i = 0; i < m_kNodes.size(); ++i)
    {
        Mat4 rest = RestOf(*m_kNodes[i]);
        const Mat3 rotation = NormalizedRows(rest);
        const Mat4 inverse = Mat4InverseOrIdentity(Mat4Compose(rotation, rest.Translation() * m_fScale));
        inverses.insert(inverses.end(), std::begin(inverse.m), std::end(inverse.m));
        joints.push_back(i);
    }
    m_kFile["skins"] = {
        {{"inverseBindMatrices", m_kBuffer.Add(std::span<const float>(inverses), "MAT4", 16)},
         {"skeleton", 0},
         {"joints", std::move(joints)}}
    };
}

// A bone reaches to each child; a bone without children to its mesh's end.
std::vector<BoneBox> CGlbWriter::Boxes() const
{
    std::vector<BoneBox> boxes;
    for (size_t i = 0; i < m_kNodes.size(); ++i)
    {
        const Mat4 world = RestOf(*m_kNodes[i]);
        const Vec3 from = world.Translation() * m_fScale;
        const std::vector<CNode*> children = ChildNodes(*m_kNodes[i]);
        for (const CNode* child : children)
            boxes.push_back({static_cast<uint16_t>(i), from, RestOf(*child).Translation() * m_fScale});
        if (children.empty())
            boxes.push_back({static_cast<uint16_t>(i), from,
                             TransformCoord(NodeBoneEnd(*m_kNodes[i]), world) * m_fScale});
    }
    return boxes;
}

void CGlbWriter::AddMesh()
{
    const std::vector<BoneBox> boxes = Boxes();
    float longest = 0.0f;
    for (const BoneBox& box : boxes)
        longest = std::max(longest, static_cast<float>(Vec3Length(box.to - box.from)));
    BoxMesh mesh = MakeBoneBoxes(boxes, kWidestShare * longest);
    if (mesh.indices.empty()) // a mesh must have a triangle
        mesh = MakeBoneBoxes(
            {
                {0, kVec3Zero, {0.0f, 0.1f, 0.0f}}
        },
            0.1f);
    using enum EGlbTarget;
    const Json attributes = {
        {"POSITION", m_kBuffer.Add(std::span<const float>(mesh.positions), "VEC3",    3,                                                          Vertices, true)},
        {"NORMAL",          m_kBuffer.Add(std::span<const float>(mesh.normals),                                                       "VEC3",     3,   Vertices)     },
        {"JOINTS_0",          m_kBuffer.Add(std::span<const uint16_t>(mesh.joints),                                                     "VEC4", 4, Vertices)  },
        {"WEIGHTS_0",          m_kBuffer.Add(std::span<const float>(mesh.weights),                                                    "VEC4",  4,   Vertices)      },
    };
    const size_t indices = m_kBuffer.Add(std::span<const uint32_t>(mesh.indices), "SCALAR", 1, Indices);
    m_kFile["materials"] = {
        {{"name", "Body"},
         {"pbrMetallicRoughness",
          {{"baseColorFactor", {0.75, 0.77, 0.8, 1.0}}, {"metallicFactor", 0.0}, {"roughnessFactor", 0.8}}}}
    };
    m_kFile["meshes"] = {
        {{"name", "Body"},
         {"primitives", {{{"attributes", attributes}, {"indices", indices}, {"material", 0}}}}}
    };
}

void CGlbWriter::AddChannel(Json& animation, size_t node, const char* path, size_t times, size_t keys)
{
    animation["channels"].push_back({
        {"sampler", animation["samplers"].size()    },
        {"target",  {{"node", node}, {"path", path}}},
    });
    animation["samplers"].push_back({
        {"input",         times   },
        {"output",        keys    },
        {"interpolation", "LINEAR"},
    });
}

// Only the root and joints that move against their parents have translations.
void CGlbWriter::AddAnimation()
{
    const int frameCount = std::max(motion_.GetKeyCount(), 1);
    const float frameTime = motion_.GetFrequency();
    std::vector<float> times;
    times.reserve(static_cast<size_t>(frameCount));
    for (int frame = 0; frame < frameCount; ++frame)
        times.push_back(static_cast<float>(frame) * frameTime);
    CMotionSampler sampler(*motion_.motionRoot);
    std::vector<std::vector<float>> rotations(m_kNodes.size()), translations(m_kNodes.size());
    for (int frame = 0; frame < frameCount; ++frame)
    {
        sampler.PoseTree(TimeOfFrame(frame, frameTime));
        for (size_t i = 0; i < m_kNodes.size(); ++i)
        {
            Append(rotations[i], m_kNodes[i]->m_kMatrix);
            Append(translations[i], m_kNodes[i]->m_kMatrix.Translation(), m_fScale);
        }
    }
    Json animation = {
        {"name",     "Motion"     },
        {"channels", Json::array()},
        {"samplers", Json::array()},
    };
    const size_t input = m_kBuffer.Add(std::span<const float>(times), "SCALAR", 1, EGlbTarget::None, true);
    for (size_t i = 0; i < m_kNodes.size(); ++i)
    {
        const size_t keys = m_kBuffer.Add(std::span<const float>(rotations[i]), "VEC4", 4);
        AddChannel(animation, i, "rotation", input, keys);
        std::vector<float>& places = translations[i];
        const bool isStill = std::equal(places.begin() + 3, places.end(), places.begin());
        const bool isAtRest = std::ranges::equal(
            std::span(places).first(3), m_kFile["nodes"][i]["translation"].get<std::vector<float>>());
        if (!isStill || !isAtRest)
            AddChannel(animation, i, "translation", input,
                       m_kBuffer.Add(std::span<const float>(places), "VEC3", 3));
    }
    m_kFile["animations"] = {std::move(animation)};
}

} // namespace

bool WriteGlb(const CMotionFile& motion, double metersPerUnit, const CByteSink& sink, CFailureRecord& record,
              const Vec3& up)
{
    if (!motion.motionRoot)
        return record.Fail(EFailure::NoRoot);
    if (NodesOf(*motion.motionRoot).size() > std::numeric_limits<uint16_t>::max())
        return record.Fail(EFailure::TooLarge);
    return CGlbWriter(motion, metersPerUnit, up).Write(sink) || record.Fail(EFailure::WriteError);
}

bool SaveGlb(const CMotionFile& motion, double metersPerUnit, const std::string& path, CFailureRecord& record,
             const Vec3& up)
{
    CSafeFile file;
    if (!file.Open(path))
        return record.Fail(file.Failure());
    const CByteSink sink = [&](std::span<const std::byte> bytes) { return file.Write(bytes); };
    return WriteGlb(motion, metersPerUnit, sink, record, up) &&
           (file.Commit() || record.Fail(file.Failure()));
}

} // namespace gw
