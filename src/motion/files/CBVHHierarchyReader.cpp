// Reads the joint blocks of a BVH file by recursive descent. Real files vary: braces share a line with a
// name, keywords are unknown, blocks are not closed. Unknown lines are skipped, and recursion is limited by
// the nesting limit of the scene tree that will be built.

#include "CBVHHierarchyReader.h"

#include "CGraphCheck.h"
#include "CTextLines.h"
#include "MotionNode.h"
#include "Numbers.h"
#include "TKBVHFile.h"
#include "Text.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace gw {

namespace {

// Reads a finite number; kind is None or Unusual if there is none.
float TakeNumber(std::string_view& rest, std::string_view& token, ENumber& kind)
{
    token = NextToken(rest);
    const auto value = static_cast<float>(ParseDouble(token, kind));
    if (!std::isfinite(value))
        kind = ENumber::Unusual;
    return value;
}

bool IsNoNumber(ENumber kind)
{
    return kind == ENumber::None || kind == ENumber::Unusual;
}

} // namespace

bool CBVHHierarchyReader::Fail(EFailure reason, std::string_view name)
{
    return record_.Fail(reason, lines_.LineNumber(), Quote(name));
}

bool CBVHHierarchyReader::Read()
{
    file_.root = std::make_unique<TKBVHJoint>();
    file_.root->name = "Global";
    file_.jointCount = 0;
    file_.nodeCount = 0;
    for (std::string_view rest; lines_.Next(rest);)
    {
        const std::string_view keyword = NextToken(rest);
        if (keyword == "MOTION")
        {
            lines_.StepBack();
            return true;
        }
        if (keyword == "ROOT" && !ReadJoint(file_.root->AddChild(EJointKind::Root), rest, 1))
            return false;
        if (keyword == "JOINT" && !ReadTopJoint(rest))
            return false;
    }
    if (m_uiSwallowedMotion > 0)
        return record_.Fail(EFailure::BadBrace, m_uiSwallowedMotion, "}");
    return Fail(EFailure::MissingSection, "MOTION");
}

// A joint outside all blocks is attached to the first root.
bool CBVHHierarchyReader::ReadTopJoint(std::string_view rest)
{
    TKBVHJoint* const root = file_.FirstRoot();
    if (!root)
        return Fail(EFailure::NoRoot, NextToken(rest));
    return ReadJoint(root->AddChild(EJointKind::Joint), rest, 2);
}

bool CBVHHierarchyReader::ReadJoint(TKBVHJoint& joint, std::string_view rest, size_t depth)
{
    if (!ReadName(joint, rest))
        return false;
    // A bone mesh is nested one level deeper than its joint.
    if (depth >= kNestingLimit)
        return Fail(EFailure::TooDeep, joint.name);
    if (++file_.jointCount > kBoneLimit)
        return Fail(EFailure::TooLarge, joint.name);
    file_.nodeCount += joint.MakesNode() ? 1 : 0;
    return ReadBody(joint, depth);
}

bool CBVHHierarchyReader::ReadName(TKBVHJoint& joint, std::string_view rest)
{
    joint.name = NextToken(rest);
    if (!MayBeName(joint.name) || (joint.name.empty() && joint.kind != EJointKind::EndSite))
        return Fail(EFailure::BadName, joint.name);
    // A brace here will be reported as missing below, which says more than a warning about a two-word name.
    const std::string_view more = NextToken(rest);
    if (!more.empty() && more != "{")
        record_.Warn(EFailure::CutName, lines_.LineNumber(), joint.name);
    return true;
}

// If the file ends inside a block, the caller notices when it looks for "MOTION".
bool CBVHHierarchyReader::ReadBody(TKBVHJoint& joint, size_t depth)
{
    bool open = false;
    for (std::string_view rest; lines_.Next(rest);)
    {
        const std::string_view keyword = NextToken(rest);
        if (keyword == "}")
            return open || Fail(EFailure::BadBrace, keyword);
        if (keyword == "{" && open)
            return Fail(EFailure::BadBrace, keyword);
        open = open || keyword == "{";
        if (!ReadBodyLine(joint, keyword, rest, depth))
            return false;
    }
    return true;
}

bool CBVHHierarchyReader::ReadBodyLine(TKBVHJoint& joint, std::string_view keyword, std::string_view rest,
                                       size_t depth)
{
    if (keyword == "JOINT")
        return ReadJoint(joint.AddChild(EJointKind::Joint), rest, depth + 1);
    if (keyword == "End")
        return ReadJoint(joint.AddChild(EJointKind::EndSite), rest, depth + 1);
    if (keyword == "OFFSET")
        return ReadOffset(joint, rest);
    if (keyword == "CHANNELS")
        return ReadChannels(joint, rest);
    if (keyword == "MOTION" && m_uiSwallowedMotion == 0)
        m_uiSwallowedMotion = lines_.LineNumber();
    return true;
}

bool CBVHHierarchyReader::ReadOffset(TKBVHJoint& joint, std::string_view rest)
{
    for (float* const component : {&joint.offset.x, &joint.offset.y, &joint.offset.z})
    {
        std::string_view token;
        ENumber kind;
        *component = TakeNumber(rest, token, kind);
        if (token.empty())
            return Fail(EFailure::MissingTokens, joint.name);
        if (IsNoNumber(kind))
            return Fail(EFailure::BadNumber, token);
        if (kind == ENumber::Stuck)
            record_.Warn(EFailure::StuckNumber, lines_.LineNumber(), Quote(token));
    }
    return true;
}

bool CBVHHierarchyReader::ReadChannels(TKBVHJoint& joint, std::string_view rest)
{
    const std::string_view number = NextToken(rest);
    int32_t count = 0;
    if (number.empty())
        return Fail(EFailure::MissingTokens, joint.name);
    if (!ScanInt(number, count))
        return Fail(EFailure::BadNumber, number);
    for (; count > 0; --count)
    {
        const std::string_view channel = NextToken(rest);
        if (channel.empty())
            return Fail(EFailure::MissingTokens, joint.name);
        const auto known = std::ranges::find(kChannelNames, channel);
        if (known != std::end(kChannelNames))
            joint.channels.push_back(static_cast<int>(known - std::begin(kChannelNames)));
        else
            record_.Warn(EFailure::UnknownChannel, lines_.LineNumber(), Quote(channel));
    }
    return true;
}

} // namespace gw
