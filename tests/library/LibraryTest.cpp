// The library as a foreign program uses it: through its header only. What it returns is compared with what
// the shell program prints and writes.

#include "TempFolder.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <functional>
#include <gaitwright/gaitwright.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <string>

namespace gaitwright {

namespace {

const std::string kWalk = EXAMPLES "walk.bvh";

std::string TextOf(const std::vector<std::byte>& bytes)
{
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

std::string TextOf(std::span<const float> numbers)
{
    return {reinterpret_cast<const char*>(numbers.data()), numbers.size_bytes()};
}

/// A folder to work in, and the shell program.
class Library : public testing::Test
{
protected:
    std::string Path(const std::string& name) const { return m_kFolder.Path(name); }

    /// Runs the program in the folder; its output goes to a file there.
    bool RunShell(const std::string& arguments) const
    {
        return std::system(
                   ("cd " + Path("") + " && " SHELL_PROGRAM " " + arguments + " > output 2>&1").c_str()) == 0;
    }
    bool HasShell() const { return std::filesystem::exists(SHELL_PROGRAM); }

    Motion Walk(const LoadOptions& options = {}) const
    {
        Outcome<Motion> motion = Load(kWalk, options);
        EXPECT_TRUE(motion) << Line(motion.Error());
        return *motion;
    }

    gw::CTempFolder m_kFolder;
};

TEST_F(Library, WritesWhatTheShellWrites)
{
    if (!HasShell())
        GTEST_SKIP() << "no program";
    const struct
    {
        const char* arguments;
        ConvertOptions options;
        LoadOptions source = {};
    } rows[] = {
        {"", {}},
        {"--align --faithful", {.align = true, .faithful = true}},
        {"--faithful --no-hands --no-legs", {.faithful = true, .hands = false, .legs = false}},
        {"--frames 10-20 --mirror --in-place", {.frames = {10, 20}, .inPlace = true, .mirror = true}},
        {"--profile 'Poser BVH' --rate 25", {.mapName = "Poser BVH"}, {.rate = 25.0f}},
    };
    for (const auto& row : rows)
    {
        const Motion walk = Walk(row.source);
        const std::string poses = TextOf(*walk.Poses());
        for (const char* extension : {".Kinetra", ".htr", ".bvh", ".glb"})
        {
            SCOPED_TRACE(std::string(row.arguments) + extension);
            const std::string name = std::string("shell") + extension;
            std::string line = "convert ";
            line.append(kWalk).append(" --force -o ").append(name).append(" ").append(row.arguments);
            ASSERT_TRUE(RunShell(line));
            const Outcome<Conversion> conversion = Convert(walk, row.options);
            ASSERT_TRUE(conversion) << Line(conversion.Error());
            EXPECT_TRUE(conversion->Check()) << "a check before saving changes nothing";
            ASSERT_TRUE(conversion->Save(Path("own") + extension));
            EXPECT_EQ(gw::ReadBytes(Path("own") + extension), gw::ReadBytes(Path(name)));
            EXPECT_EQ(TextOf(*conversion->Bytes(extension)), gw::ReadBytes(Path(name)));
        }
        EXPECT_EQ(TextOf(*Walk(row.source).Poses()), poses);
    }
}

TEST_F(Library, ReturnsThePosesThatTheShellWrites)
{
    if (!HasShell())
        GTEST_SKIP() << "no program";
    const Motion walk = Walk();
    ASSERT_TRUE(RunShell("pose " + kWalk + " --all -o poses.npy"));
    EXPECT_EQ(TextOf(*walk.Poses()), gw::ReadBytes(Path("poses.npy")).substr(128));
    EXPECT_EQ(TextOf(*walk.Positions()), gw::ReadBytes(Path("poses.positions.npy")).substr(128));
    std::string names;
    for (const std::string& name : walk.BoneNames())
        names += name + '\n';
    EXPECT_EQ(names, gw::ReadBytes(Path("poses.names.txt")));

    EXPECT_EQ(walk.Poses()->size(), walk.FrameCount() * walk.BoneCount() * 16);
    EXPECT_EQ(walk.RestPose()->size(), walk.BoneCount() * 16);
    for (size_t bone = 0; bone < walk.BoneCount(); ++bone)
        EXPECT_LT(walk.Parents()[bone], static_cast<int32_t>(bone)) << "parents come first";
    EXPECT_EQ(std::ranges::count(walk.Parents(), -1), 1);
}

TEST_F(Library, ChecksAsTheShellDoes)
{
    if (!HasShell())
        GTEST_SKIP() << "no program";
    ASSERT_TRUE(RunShell("convert " + kWalk + " -o shell.Kinetra --faithful --check --json"));
    const auto check = nlohmann::json::parse(gw::ReadBytes(Path("output")))["check"];
    const Outcome<Conversion> conversion = Convert(Walk(), {.faithful = true, .inPlace = true});
    ASSERT_TRUE(conversion);
    const Outcome<Figures> figures = conversion->Check();
    ASSERT_TRUE(figures);
    EXPECT_FLOAT_EQ(float(figures->meanError), check["meanError"]);
    EXPECT_FLOAT_EQ(float(figures->trunkMean.value()), check["trunkMean"]);
    EXPECT_FLOAT_EQ(float(figures->ankleSlide.largest), check["ankleSlide"]["largest"]);
    EXPECT_EQ(figures->worstFrames.front().fault, check["worstFrames"][0]["fault"]);
    ASSERT_EQ(figures->bones.size(), check["bones"].size());
    for (size_t i = 0; i < figures->bones.size(); ++i)
        EXPECT_FLOAT_EQ(float(figures->bones[i].meanError), check["bones"][i]["meanError"]);
    ASSERT_EQ(figures->feet.size(), 2u);
    EXPECT_EQ(figures->feet[1].resultContacts, check["feet"][1]["resultContacts"]);
}

TEST_F(Library, ReturnsFailuresAsValues)
{
    std::string cut = gw::ReadBytes(kWalk);
    cut = cut.substr(0, cut.find("CHANNELS")) + "CHANNELS six\n";
    gw::WriteBytes(Path("broken.bvh"), cut);
    gw::WriteBytes(Path("there.glb"), "kept");
    gw::WriteBytes(Path("other.prf"), "Other\nnobody hip 0,0,0\n");
    const size_t line = static_cast<size_t>(std::ranges::count(cut, '\n'));
    const Motion walk = Walk();
    const Outcome<Conversion> done = Convert(walk);
    ASSERT_TRUE(done);
    const auto failureOf = [](const auto& outcome) { return outcome ? Failure() : outcome.Error(); };
    const struct
    {
        const char* what;
        Failure failure;
        const char* reason;
        size_t line = 0;
    } rows[] = {
        {"no file", failureOf(Load(Path("none.bvh"))), "not-found"},
        {"a folder", failureOf(Load(Path(""))), "unknown-format"},
        {"unknown extension", failureOf(Load(Path("there.mp3"))), "unknown-format"},
        {"damaged text", failureOf(Load(Path("broken.bvh"))), "bad-number", line},
        {"damaged memory", failureOf(LoadBytes(std::as_bytes(std::span("HIERARCHY")), "bvh")),
         "missing-section", 1},
        {"rate", failureOf(Load(kWalk, {.rate = -1.0f})), "bad-number"},
        {"no such map", failureOf(LoadMap("Nobody")), "not-installed"},
        {"no data", failureOf(Convert(walk, {.dataFolder = Path("")})), "not-found"},
        {"rows of other bones", failureOf(Convert(walk, {.mapName = Path("other.prf")})), "misfit"},
        {"frames past the end", failureOf(Convert(walk, {.frames = {500, 600}})), "no-such-frame"},
        {"format of a result", failureOf(done->Save(Path("a.fbx"))), "unknown-format"},
        {"existing file", failureOf(done->Save(Path("there.glb"), Existing::Keep)), "exists"},
        {"no folder", failureOf(done->Save(Path("none/a.glb"))), "write-error"},
        {"a source as HTR", failureOf(walk.Save(Path("a.htr"))), "unknown-format"},
        {"repair in place", failureOf(Mend(kWalk, kWalk)), "own-source"},
    };
    for (const auto& row : rows)
    {
        SCOPED_TRACE(row.what);
        EXPECT_EQ(row.failure.reason, row.reason) << row.failure.words;
        EXPECT_EQ(row.failure.line, row.line);
        EXPECT_FALSE(row.failure.words.empty());
    }
    EXPECT_EQ(gw::ReadBytes(Path("there.glb")), "kept");
    EXPECT_TRUE(done->Save(Path("there.glb"))) << "a refusal leaves no mark";
}

TEST_F(Library, ReadsWhatItWrites)
{
    const Outcome<Conversion> conversion = Convert(Walk());
    ASSERT_TRUE(conversion);
    EXPECT_EQ(conversion->Map().map.Name(), "Poser BVH");
    for (const char* format : {"kinetra", ".HTR", "bvh"})
    {
        SCOPED_TRACE(format);
        const Outcome<std::vector<std::byte>> bytes = conversion->Bytes(format);
        ASSERT_TRUE(bytes) << Line(bytes.Error());
        const Outcome<Motion> again = LoadBytes(*bytes, format);
        ASSERT_TRUE(again) << Line(again.Error());
        EXPECT_EQ(again->BoneCount(), conversion->Result().BoneCount());
        EXPECT_TRUE(again->Bytes("bvh"));
    }
    const Outcome<Conversion> chained = Convert(conversion->Result(), {.draft = true});
    EXPECT_TRUE(chained || chained.Error().reason == "misfit");
}

TEST_F(Library, HasTheVersionOfItsHeader)
{
    const int version[] = {GAITWRIGHT_VERSION_MAJOR, GAITWRIGHT_VERSION_MINOR, GAITWRIGHT_VERSION_PATCH};
    EXPECT_EQ(LibraryVersion(), std::to_string(version[0]) + '.' + std::to_string(version[1]) + '.' +
                                    std::to_string(version[2]));
}

TEST_F(Library, DraftsAndChoosesMaps)
{
    const Motion walk = Walk();
    const Outcome<Suggestion> draft = Suggest(walk);
    ASSERT_TRUE(draft);
    ASSERT_TRUE(draft->map.Save(Path("draft.prf")));
    const Outcome<BoneMap> saved = LoadMap(Path("draft.prf"));
    ASSERT_TRUE(saved);
    EXPECT_EQ(saved->Text().operator*(), *draft->map.Text());
    EXPECT_TRUE(Convert(walk, {.map = *saved}));

    const auto choices = RankMaps(walk);
    ASSERT_TRUE(choices);
    EXPECT_EQ(choices->size(), InstalledMaps()->size());
    EXPECT_EQ(choices->front().map.Name(), ChooseMap(walk)->map.Name());
    EXPECT_FALSE(choices->back().fits);
}

TEST_F(Library, ExaminesAndMends)
{
    std::string text = gw::ReadBytes(kWalk);
    text.insert(text.find("Frames:"), "\n");
    gw::WriteBytes(Path("blank.bvh"), text);
    const Outcome<Examination> faulty = Doctor(Path("blank.bvh"));
    ASSERT_TRUE(faulty);
    EXPECT_FALSE(faulty->healthy);
    ASSERT_FALSE(faulty->findings.empty());
    EXPECT_TRUE(faulty->findings[0].fixable && faulty->findings[0].line > 0);
    EXPECT_TRUE(Load(Path("blank.bvh"), {.mend = true}));
    const Outcome<Examination> mended = Mend(Path("blank.bvh"), Path("mended.bvh"));
    ASSERT_TRUE(mended) << Line(mended.Error());
    EXPECT_TRUE(mended->healthy);
    EXPECT_EQ(mended->facts.value().jointCount, Walk().BoneCount());
    EXPECT_EQ(Mend(Path("blank.bvh"), Path("mended.bvh")).Error().reason, "exists");
}

} // namespace

} // namespace gaitwright
