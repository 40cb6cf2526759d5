#include "MotionTexts.h"

#include "CKeyframeControl.h"
#include "CMotionSampler.h"
#include "SceneBytes.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace gw {
namespace {

const struct
{
    EFailure reason;
    const char* text;
} kReasons[] = {
    {EFailure::NotFound, "NotFound"},
    {EFailure::NotRegular, "NotRegular"},
    {EFailure::Changed, "Changed"},
    {EFailure::WriteError, "WriteError"},
    {EFailure::UnknownFormat, "UnknownFormat"},
    {EFailure::MissingSection, "MissingSection"},
    {EFailure::UnexpectedLine, "UnexpectedLine"},
    {EFailure::BlankLine, "BlankLine"},
    {EFailure::BadNumber, "BadNumber"},
    {EFailure::BadCount, "BadCount"},
    {EFailure::BadName, "BadName"},
    {EFailure::BadBrace, "BadBrace"},
    {EFailure::MissingTokens, "MissingTokens"},
    {EFailure::TooFewRows, "TooFewRows"},
    {EFailure::NoRoot, "NoRoot"},
    {EFailure::UnknownSegment, "UnknownSegment"},
    {EFailure::TooDeep, "TooDeep"},
    {EFailure::TooLarge, "TooLarge"},
    {EFailure::ShortRow, "ShortRow"},
    {EFailure::StuckNumber, "StuckNumber"},
    {EFailure::DoubledOffsets, "DoubledOffsets"},
    {EFailure::RestPose, "RestPose"},
    {EFailure::UnknownChannel, "UnknownChannel"},
    {EFailure::CutName, "CutName"},
    {EFailure::OpenHeader, "OpenHeader"},
    {EFailure::BadHeader, "BadHeader"},
    {EFailure::BadVersion, "BadVersion"},
    {EFailure::Truncated, "Truncated"},
};

std::string FailureText(const Finding& failure)
{
    const auto row =
        std::ranges::find_if(kReasons, [&](const auto& r) { return r.reason == failure.reason; });
    const std::string reason = row == std::end(kReasons) ? "another reason" : row->text;
    return reason + " " + std::to_string(failure.where) + " " + failure.name + "\n";
}

bool IsFinite(const Mat4& matrix)
{
    return std::ranges::all_of(matrix.m, [](float value) { return std::isfinite(value); });
}

} // namespace

CLoadedMotion::CLoadedMotion(std::string_view text, const std::string& fileName) : path(folder.Path(fileName))
{
    WriteBytes(path, text);
    loaded = motion.Load(path);
}

std::string TreeText(CNode* root)
{
    if (!root)
        return {};
    std::string children;
    for (size_t i = 0; i < root->GetChildCount(); ++i)
    {
        if (CNode* child = RecordCast<CNode>(root->ChildAt(i)))
            children.append(children.empty() ? "" : " ").append(TreeText(child));
    }
    const std::string name(root->NameView());
    return children.empty() ? name : name + "(" + children + ")";
}

std::string RecordText(const CFailureRecord& record)
{
    std::string text = record.Failure() ? "failed " + FailureText(record.Failure()) : "";
    for (const Finding& warning : record.Warnings())
        text += FailureText(warning);
    return text;
}

const CNode& PosedNode(CMotionFile& motion, const char* name, int frame)
{
    motion.motionRoot->UpdateScene(TimeOfFrame(frame, motion.GetFrequency()), true);
    const CNode* node = FindNode(motion.motionRoot.Get(), name);
    EXPECT_TRUE(node) << name;
    return node ? *node : *motion.motionRoot;
}

bool IsFinite(CNode& root)
{
    return std::ranges::all_of(NodesOf(root), [](const CNode* node) {
        return IsFinite(node->m_kMatrix) && IsFinite(node->m_kWorldMatrix);
    });
}

const CKeyframeControl& TrackOf(const CMotionFile& motion, const char* name)
{
    return static_cast<const CKeyframeControl&>(*FindNode(motion.motionRoot.Get(), name)->GetControl());
}

std::string WithCarriageReturns(std::string_view text)
{
    std::string out;
    for (const char c : text)
        out += c == '\n' ? std::string("\r\n") : std::string(1, c);
    return out;
}

std::string Changed(std::string_view text, const Change& change)
{
    std::string changed(text);
    const size_t at = changed.find(change.from);
    EXPECT_NE(at, changed.npos) << change.from;
    return change.from.empty() ? change.to : changed.replace(at, change.from.size(), change.to);
}

void ExpectSame(std::string_view text, const char* fileName, std::span<const Change> rows)
{
    const CLoadedMotion plain(text, fileName);
    for (const Change& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CLoadedMotion file(Changed(text, row), fileName);
        EXPECT_EQ(RecordText(file.motion.Record()), "");
        ASSERT_TRUE(file.loaded);
        EXPECT_EQ(file.motion.GetKeyCount(), plain.motion.GetKeyCount());
        EXPECT_EQ(file.motion.GetFrequency(), plain.motion.GetFrequency());
        EXPECT_EQ(DescribeRoot(file.motion.motionRoot.Get()), DescribeRoot(plain.motion.motionRoot.Get()));
    }
}

void ExpectRead(std::string_view text, const char* fileName, std::span<const Change> rows)
{
    const auto keysOfLast = [](const CMotionFile& motion) {
        const CNode& last = *NodesOf(*motion.motionRoot).back();
        return static_cast<int>(TrackOf(motion, last.GetName()).m_kRotationKeys.size());
    };
    const CLoadedMotion plain(text, fileName);
    for (const Change& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CLoadedMotion file(Changed(text, row), fileName);
        EXPECT_EQ(RecordText(file.motion.Record()), row.record);
        ASSERT_EQ(TreeText(file.motion.motionRoot.Get()),
                  row.tree ? row.tree : TreeText(plain.motion.motionRoot.Get()));
        EXPECT_EQ(keysOfLast(file.motion), row.keys < 0 ? keysOfLast(plain.motion) : row.keys);
    }
}

void ExpectRefused(std::string_view text, const char* fileName, std::span<const Change> rows)
{
    for (const Change& row : rows)
    {
        SCOPED_TRACE(row.what);
        const CLoadedMotion file(Changed(text, row), fileName);
        EXPECT_FALSE(file.loaded);
        EXPECT_FALSE(file.motion.motionRoot);
        const std::string record = RecordText(file.motion.Record());
        EXPECT_EQ(record.substr(0, record.find('\n')), "failed " + row.record);
    }
}

} // namespace gw
