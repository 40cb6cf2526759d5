// Reads a BVH hierarchy tolerantly: it accepts misspelled keywords, braces in odd places and wrong channel
// counts, reports each as a finding, and records the edit that repairs it. The strict reader is the
// reference: whatever it would misread must become a finding here.

#include "CHierarchyCheck.h"

#include "CFindings.h"
#include "CTextEdits.h"
#include "CTextLines.h"
#include "LineParts.h"
#include "MotionNode.h"
#include "NumberText.h"
#include "Numbers.h"
#include "TKBVHFile.h"

#include <algorithm>
#include <iterator>
#include <string>
#include <utility>

namespace gw {

namespace {

int ChannelOf(std::string_view word)
{
    const auto isWord = [=](std::string_view name) { return EqualNoCase(name, word); };
    const auto* const known = std::ranges::find_if(kChannelNames, isWord);
    return known == std::end(kChannelNames) ? OutlineJoint::kNoChannel
                                            : static_cast<int>(known - std::begin(kChannelNames));
}

} // namespace

struct CHierarchyCheck::KeywordRow
{
    std::string_view keyword;
    void (CHierarchyCheck::*read)(std::string_view rest);
};

const CHierarchyCheck::KeywordRow CHierarchyCheck::kKeywords[] = {
    {"HIERARCHY", &CHierarchyCheck::BeginHierarchy},
    {"ROOT",      &CHierarchyCheck::OpenRoot      },
    {"JOINT",     &CHierarchyCheck::OpenJoint     },
    {"End",       &CHierarchyCheck::OpenEndSite   },
    {"{",         &CHierarchyCheck::OpenBlock     },
    {"}",         &CHierarchyCheck::CloseBlock    },
    {"OFFSET",    &CHierarchyCheck::ReadOffset    },
    {"CHANNELS",  &CHierarchyCheck::ReadChannels  },
    {"MOTION",    &CHierarchyCheck::BeginMotion   },
};

bool CHierarchyCheck::Read(BVHOutline& outline)
{
    // The reader refuses more joints than its limit; up to there, their number is proportional to the file.
    while (!m_bMotion && m_kJoints.size() <= kBoneLimit && lines_.Next())
        ReadLine();
    PartLines();
    PlanColumns(outline);
    outline.joints = std::move(m_kJoints);
    return m_bMotion;
}

// A brace only counts on a line of its own; shared lines are split.
void CHierarchyCheck::ReadLine()
{
    std::string_view rest = lines_.Line();
    bool first = true;
    for (std::string_view part = NextPart(rest); !part.empty(); part = NextPart(rest), first = false)
    {
        if (!first && m_bHierarchy && m_kShared.size() < CTextEdits::kMost)
            m_kShared.push_back({lines_.Number(), lines_.OffsetOf(part)});
        ReadWords(part);
    }
}

// Only if all blocks are closed afterwards; otherwise the braces are not what they seem.
void CHierarchyCheck::PartLines()
{
    const bool closed = m_bBracesFit && m_kOpen.empty();
    size_t told = 0;
    for (const auto& [line, offset] : m_kShared)
    {
        if (closed)
            edits_.Replace(offset, 0, "\n");
        if (std::exchange(told, line) == line)
            continue;
        if (closed)
            findings_.Add(EFailure::BraceOnLine, line);
        else
            findings_.AddUnmended(EFailure::BraceOnLine, line);
    }
}

// Text before the hierarchy is ignored.
void CHierarchyCheck::ReadWords(std::string_view words)
{
    std::string_view rest = words;
    const std::string_view word = NextToken(rest);
    const auto isWord = [&](const KeywordRow& row) { return EqualNoCase(row.keyword, word); };
    const auto* const row = std::ranges::find_if(kKeywords, isWord);
    if (row == std::end(kKeywords) || (!m_bHierarchy && row != kKeywords))
        return;
    CheckSpelling(word, row->keyword);
    (this->*row->read)(rest);
}

void CHierarchyCheck::CheckSpelling(std::string_view word, std::string_view wanted)
{
    if (word == wanted)
        return;
    findings_.Add(EFailure::KeywordSpelling, lines_.Number(), std::string(word));
    edits_.Replace(lines_.OffsetOf(word), word.size(), wanted);
}

void CHierarchyCheck::OpenRoot(std::string_view name)
{
    if (++m_uiRoots > 1)
    {
        findings_.Add(EFailure::SecondRoot, lines_.Number(), Quote(NextToken(name)));
        return m_kOpen.push_back({OutlineJoint::kNoParent});
    }
    Add(name, OutlineJoint::kNoParent);
}

// A joint outside all blocks belongs to the root; one in a skipped block is skipped too.
void CHierarchyCheck::OpenJoint(std::string_view name)
{
    const size_t parent = m_kOpen.empty() ? 0 : m_kOpen.back().joint;
    if (m_kJoints.empty() || parent == OutlineJoint::kNoParent)
        return m_kOpen.push_back({OutlineJoint::kNoParent});
    Add(name, parent);
}

void CHierarchyCheck::Add(std::string_view name, size_t parent)
{
    m_kOpen.push_back({m_kJoints.size()});
    OutlineJoint joint;
    joint.parent = parent;
    joint.line = lines_.Number();
    joint.name = ReadName(name);
    m_kJoints.push_back(std::move(joint));
}

// All words up to a comment are treated as the name.
std::string CHierarchyCheck::ReadName(std::string_view name)
{
    const std::string_view first = NextToken(name);
    std::string joined(first.substr(0, kNameLimit));
    const char* end = first.data() + first.size();
    for (std::string_view word = NextToken(name); !word.empty() && word.front() != '#';
         word = NextToken(name))
    {
        joined.append(1, '_').append(word.substr(0, kNameLimit));
        joined.resize(std::min(joined.size(), size_t{kNameLimit}));
        end = word.data() + word.size();
    }
    const std::string_view whole(first.data(), static_cast<size_t>(end - first.data()));
    if (whole.size() == first.size())
        return joined;
    findings_.Add(EFailure::BlankInName, lines_.Number(), Quote(whole));
    edits_.Replace(lines_.OffsetOf(whole), whole.size(), joined);
    return joined;
}

void CHierarchyCheck::OpenBlock(std::string_view)
{
    m_bBracesFit = m_bBracesFit && !m_kOpen.empty() && !m_kOpen.back().braced;
    if (!m_kOpen.empty())
        m_kOpen.back().braced = true;
}

void CHierarchyCheck::CloseBlock(std::string_view)
{
    m_bBracesFit = m_bBracesFit && !m_kOpen.empty() && m_kOpen.back().braced;
    if (!m_kOpen.empty())
        m_kOpen.pop_back();
}

OutlineJoint* CHierarchyCheck::Joint()
{
    const bool none = m_kOpen.empty() || m_kOpen.back().joint == OutlineJoint::kNoParent;
    return none ? nullptr : &m_kJoints[m_kOpen.back().joint];
}

void CHierarchyCheck::ReadOffset(std::string_view numbers)
{
    std::string points;
    if (HasDecimalCommas(numbers, 3))
    {
        points = WithPoints(numbers);
        findings_.Add(EFailure::DecimalComma, lines_.Number());
        edits_.Replace(lines_.OffsetOf(numbers), numbers.size(), points);
        numbers = points;
    }
    Vec3 offset = kVec3Zero;
    for (float* const component : {&offset.x, &offset.y, &offset.z})
    {
        const std::string_view token = NextToken(numbers);
        ScanFloat(token, *component);
        if (const auto fault = FailureOfNumber(token); fault && !token.empty())
            findings_.AddUnmended(*fault, lines_.Number(), Quote(token));
    }
    if (OutlineJoint* const joint = Joint())
    {
        joint->offset = offset;
        joint->offsetLine = lines_.Number();
    }
}

// Channels beyond the count are assumed to be meant, because the rows contain a value for them. Other words
// are comments.
void CHierarchyCheck::ReadChannels(std::string_view rest)
{
    const auto count = static_cast<size_t>(std::max(ParseInt(NextToken(rest)), 0));
    std::vector<int> channels;
    for (std::string_view word = NextToken(rest); !word.empty(); word = NextToken(rest))
    {
        const int channel = ChannelOf(word);
        if (channel == OutlineJoint::kNoChannel && channels.size() >= count)
            break;
        CheckChannel(word, channel);
        channels.push_back(channel);
    }
    if (channels.size() > count)
        findings_.Add(EFailure::ChannelCount, lines_.Number());
    if (OutlineJoint* const joint = Joint())
        joint->channels = std::move(channels);
}

void CHierarchyCheck::CheckChannel(std::string_view word, int channel)
{
    if (channel == OutlineJoint::kNoChannel)
        findings_.Add(EFailure::IgnoredChannel, lines_.Number(), Quote(word));
    else
        CheckSpelling(word, kChannelNames[channel]);
}

// The root takes a value even without channels.
void CHierarchyCheck::PlanColumns(BVHOutline& outline)
{
    for (OutlineJoint& joint : m_kJoints)
    {
        const size_t least = joint.parent == OutlineJoint::kNoParent ? 1 : 0;
        joint.firstColumn = outline.columnCount;
        outline.columnCount += std::max(joint.channels.size(), least);
    }
}

} // namespace gw
