// Conversions: the steps of the shell program, for a motion in memory, and their results.

#include "CorrectionWords.h"
#include "Corrections.h"
#include "Figures.h"
#include "FindingWords.h"
#include "HTRPose.h"
#include "MapContent.h"
#include "MeasureResult.h"
#include "MotionContent.h"
#include "Paths.h"
#include "ResultFile.h"
#include "Writing.h"

#include <algorithm>
#include <mutex>
#include <optional>

namespace gaitwright {

/// What the handles of a conversion share.
struct Conversion::Content
{
    Motion source;
    ConvertOptions options;
    Motion result;
    MapChoice map;
    bool isDrafted = false;
    std::string corrections = {};
    std::vector<Failure> warnings = {};

    std::mutex mutex = {}; ///< of the next member
    std::optional<Figures> figures = {};
};

namespace {

gw::MotionEdits EditsOf(const ConvertOptions& options)
{
    return {.firstFrame = options.frames.first,
            .lastFrame = options.frames.last,
            .inPlace = options.inPlace,
            .mirror = options.mirror};
}

gw::ConversionChoices ChoicesOf(const ConvertOptions& options)
{
    return {options.align, options.faithful, options.hands};
}

bool Run(CMotionConversion& conversion, const Motion& motion, const ConvertOptions& options)
{
    if (!conversion.Open(motion))
        return false;
    if (options.map)
        conversion.UseMap(*options.map);
    else if (!(options.mapName.empty() ? conversion.ChooseMap() : conversion.SelectProfile()))
        return false;
    return conversion.HasFrames() && conversion.Convert(options.legs) && !conversion.Notices().HasFailed() &&
           conversion.HasFrames();
}

std::optional<Failure> WhyNoFrames(const FrameRange& frames, const gw::CMotionFile& result)
{
    const int count = result.GetKeyCount();
    if (frames.first >= 0 && frames.first <= frames.last && frames.first < count)
        return std::nullopt;
    return FailureOf("no-such-frame", "frames " + std::to_string(frames.first) + " to " +
                                          std::to_string(frames.last) + ": the motion has " +
                                          std::to_string(count) + " frames, starting at 0");
}

// The result keeps the target's tree; the conversion ends here.
Outcome<Motion> ResultOf(const gw::CMotionFile& result, const ConvertOptions& options)
{
    const gw::MotionEdits edits = EditsOf(options);
    auto content = std::make_shared<Access::MotionContent>();
    content->format = "htr";
    content->source = std::make_shared<gw::CSourceMotion>(result);
    if (edits.IsAny())
        content->edited.emplace(content->source->Motion(), edits);
    const Outcome<void> described = content->Describe();
    if (!described)
        return described.Error();
    return Access::Make(std::move(content));
}

Outcome<Conversion> ConvertMotion(const Motion& motion, const ConvertOptions& options)
{
    const std::lock_guard lock(Access::Of(motion).mutex);
    CMotionConversion conversion(options.dataFolder, options.mapName, ChoicesOf(options), options.draft);
    if (!Run(conversion, motion, options))
        return conversion.Notices().FirstError();
    if (std::optional<Failure> failure = WhyNoFrames(options.frames, conversion.Result()))
        return std::move(*failure);
    const Outcome<Motion> result = ResultOf(conversion.Result(), options);
    if (!result)
        return result.Error();
    const gw::Corrections corrections = conversion.Corrected();
    return Access::Make(std::shared_ptr<Access::ConversionContent>(new Access::ConversionContent{
        .source = motion,
        .options = options,
        .result = *result,
        .map = conversion.Choice(),
        .isDrafted = conversion.IsDrafted(),
        .corrections = corrections.list.empty() ? std::string() : gw::CorrectionWords(corrections),
        .warnings = conversion.Notices().Warnings()}));
}

// Converts again, because measuring changes the result's tracks to those of its file.
Outcome<Figures> Measure(const Access::ConversionContent& content)
{
    const std::lock_guard lock(Access::Of(content.source).mutex);
    CMotionConversion conversion(content.options.dataFolder, {}, ChoicesOf(content.options), false);
    ConvertOptions options = content.options;
    options.map = content.map.map;
    if (!Run(conversion, content.source, options))
        return conversion.Notices().FirstError();
    gw::TakeWrittenPoses(conversion.Result());
    const gw::MotionClip source = gw::SourceClipOf(conversion);
    const gw::MotionClip result = gw::ClipOf(conversion.Result());
    std::vector<gw::BonePair> pairs;
    std::vector<gw::MissingBone> missing;
    gw::PairBones(gw::TextOf(conversion.Profile()), source.root, result.root, pairs, missing);
    const auto measured = gw::MeasureResult(source, result, pairs);
    if (!measured)
        return FailureOf("no-frames", "the source or the result has no frames");
    return FiguresOf(*measured);
}

Outcome<void> WriteConverted(const Access::ConversionContent& content, const std::string& path)
{
    Access::MotionContent& result = Access::Of(content.result);
    const std::lock_guard lock(result.mutex);
    gw::CMotionFile file(result.source->Motion());
    gw::CFailureRecord record;
    bool isWritten = false;
    if (gw::HasExtension(path, ".bvh") || gw::HasExtension(path, ".glb"))
        isWritten = gw::WriteExchangeFile(file, path, record);
    else if (gw::HasExtension(path, ".Kinetra") || gw::HasExtension(path, ".htr"))
        isWritten = gw::WriteResultFile(file, path, content.map.map.FrameRate(), record);
    else
        return FailureOf("unknown-format", "a result can be written as .Kinetra, .htr, .bvh or .glb");
    if (!isWritten)
        return FailureOf(path, record);
    return {};
}

} // namespace

Conversion::Conversion(std::shared_ptr<Content> content) noexcept : m_spContent(std::move(content)) {}
Conversion::Conversion(const Conversion& other) noexcept = default;
Conversion& Conversion::operator=(const Conversion& other) noexcept = default;
Conversion::~Conversion() = default;

const Motion& Conversion::Result() const noexcept
{
    return m_spContent->result;
}

const MapChoice& Conversion::Map() const noexcept
{
    return m_spContent->map;
}

bool Conversion::IsDrafted() const noexcept
{
    return m_spContent->isDrafted;
}

std::span<const Failure> Conversion::Warnings() const noexcept
{
    return m_spContent->warnings;
}

const std::string& Conversion::Corrections() const noexcept
{
    return m_spContent->corrections;
}

Outcome<Figures> Conversion::Check() const noexcept
{
    return Guarded([&]() -> Outcome<Figures> {
        const std::lock_guard lock(m_spContent->mutex);
        if (m_spContent->figures)
            return *m_spContent->figures;
        Outcome<Figures> figures = Measure(*m_spContent);
        if (figures)
            m_spContent->figures = *figures;
        return figures;
    });
}

Outcome<void> Conversion::Save(const std::string& path, Existing existing) const noexcept
{
    return Guarded([&] {
        return WriteFile(path, existing,
                         [&](const std::string& to) { return WriteConverted(*m_spContent, to); });
    });
}

Outcome<std::vector<std::byte>> Conversion::Bytes(std::string_view format) const noexcept
{
    return Guarded([&] {
        return BytesOf(ExtensionOf(format),
                       [&](const std::string& to) { return WriteConverted(*m_spContent, to); });
    });
}

Outcome<Conversion> Convert(const Motion& motion, const ConvertOptions& options) noexcept
{
    return Guarded([&] { return ConvertMotion(motion, options); });
}

} // namespace gaitwright
