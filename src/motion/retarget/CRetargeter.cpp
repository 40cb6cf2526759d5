#include "CRetargeter.h"

#include "CMappedFile.h"
#include "Numbers.h"
#include "Paths.h"
#include "Skeleton.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kShareLineLimit = 1023;
constexpr std::string_view kShareDelimiters = " ,:\n";

// Reads one line of the share file: a bone's name, "Share" with two numbers, "Type" with one, in any order.
// Values missing in a line keep those of earlier lines.
class CShareLine
{
public:
    explicit CShareLine(BoneShares& shares) : shares_(shares) {}

    void Read(std::string_view line)
    {
        for (std::string_view token = NextToken(line, kShareDelimiters); !token.empty();
             token = NextToken(line, kShareDelimiters))
        {
            if (token[0] >= '0' && token[0] <= '9')
                TakeNumber(static_cast<float>(ParseDouble(token)));
            else if (EqualNoCase(token, "Share") || EqualNoCase(token, "Type"))
                Begin(EqualNoCase(token, "Type"));
            else
                m_kName = token;
        }
    }
    bool HasNumbers() const { return m_iCount > 0; }
    const std::string& Name() const { return m_kName; }

private:
    void Begin(bool type)
    {
        m_bType = type;
        m_iIndex = 0;
    }
    void TakeNumber(float value)
    {
        float* const places[] = {&shares_.m_fShare1, &shares_.m_fShare2};
        float* place = m_bType ? (m_iIndex == 0 ? &shares_.m_fType : nullptr)
                               : (m_iIndex < 2 ? places[m_iIndex] : nullptr);
        ++m_iIndex;
        if (!place)
            return;
        *place = value;
        ++m_iCount;
    }

    BoneShares& shares_;
    std::string m_kName;
    bool m_bType = false;
    int m_iIndex = 0;
    int m_iCount = 0;
};

// The first node with exactly this name, otherwise the first one that matches ignoring case.
CNode* NodeOfName(const std::vector<CNode*>& nodes, std::string_view name)
{
    const auto has = [=](const CNode* node) { return node->GetName() && node->NameView() == name; };
    const auto hasAnyCase = [=](const CNode* node) {
        return node->GetName() && EqualNoCase(node->NameView(), name);
    };
    auto found = std::ranges::find_if(nodes, has);
    if (found == nodes.end())
        found = std::ranges::find_if(nodes, hasAnyCase);
    return found == nodes.end() ? nullptr : *found;
}

template <class T>
const T* Find(const std::map<const CNode*, T>& table, const CNode* node)
{
    const auto entry = node ? table.find(node) : table.end();
    return entry == table.end() ? nullptr : &entry->second;
}

} // namespace

CRetargeter::CRetargeter() = default;
CRetargeter::~CRetargeter() = default;

void CRetargeter::SetScenes(CNode* sourceRoot, CNode* targetRoot)
{
    m_pkSourceRoot = sourceRoot;
    m_pkTargetRoot = targetRoot;
    ClearMaps();
}

void CRetargeter::ClearMaps()
{
    m_kSourceOf.clear();
    m_kOffsetAngles.clear();
    m_kFixedBones.clear();
    m_kOffsetMatrices.clear();
}

bool CRetargeter::LoadShares(const std::string& path)
{
    CMappedFile file;
    const EFailure failure = file.Open(path);
    // The file is optional, but one that exists and cannot be read must be reported: its shares would be
    // missing.
    if (failure != EFailure::None && FileExists(path))
        return m_kRecord.Fail(failure, 0, path);
    if (failure != EFailure::None)
        return false;
    std::string_view rest = SkipByteOrderMark(file.Text());
    const std::vector<CNode*> nodes = m_pkTargetRoot ? NodesOf(*m_pkTargetRoot) : std::vector<CNode*>();
    BoneShares shares;
    for (std::string_view line; NextLine(rest, line);)
    {
        do
        {
            CShareLine reader(shares);
            reader.Read(line.substr(0, kShareLineLimit));
            line.remove_prefix(std::min(line.size(), kShareLineLimit));
            if (!reader.HasNumbers())
                continue;
            SetShares(NodeOfName(nodes, reader.Name().c_str()), shares);
        } while (!line.empty());
    }
    return true;
}

bool CRetargeter::SetSourceOf(CNode* target, CNode* source)
{
    m_kSourceOf[target] = source;
    return true;
}

bool CRetargeter::SetOffsetAngles(CNode* target, const Vec3& degrees)
{
    m_kOffsetAngles[target] = degrees;
    return true;
}

bool CRetargeter::SetOffsetMatrix(CNode* target, const Mat3& matrix)
{
    m_kOffsetMatrices[target] = matrix;
    return true;
}

bool CRetargeter::SetFixed(CNode* target, bool fixed)
{
    m_kFixedBones[target] = fixed;
    return true;
}

bool CRetargeter::SetShares(CNode* target, const BoneShares& shares)
{
    m_kBoneShares[target] = shares;
    return true;
}

CNode* CRetargeter::SourceOf(const CNode* node) const
{
    CNode* const* source = Find(m_kSourceOf, node);
    return source ? *source : nullptr;
}

const Vec3& CRetargeter::OffsetAngles(const CNode* node) const
{
    const Vec3* angles = Find(m_kOffsetAngles, node);
    return angles ? *angles : kVec3Zero;
}

const Mat3& CRetargeter::OffsetMatrix(const CNode* node) const
{
    const Mat3* matrix = Find(m_kOffsetMatrices, node);
    return matrix ? *matrix : kMat3Identity;
}

bool CRetargeter::IsFixed(const CNode* node, bool& fixed) const
{
    const bool* entry = Find(m_kFixedBones, node);
    fixed = entry && *entry;
    return entry != nullptr;
}

bool CRetargeter::Shares(const CNode* node, const BoneShares*& shares) const
{
    shares = Find(m_kBoneShares, node);
    return shares != nullptr;
}

} // namespace gw
