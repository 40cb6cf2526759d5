#include "MotionTexts.h"

#include "CKeyframeControl.h"
#include "CMotionSampler.h"
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

} // namespace gw
