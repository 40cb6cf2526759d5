#include "CCamera.h"
#include "CLight.h"
#include "CPackageFile.h"
#include "Packaging.h"
#include "Paths.h"
#include "SceneBytes.h"
#include "SceneSamples.h"
#include "TempFolder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <tuple>

namespace gw {
namespace {

CNode* RootNode(const COrrinStream& stream)
{
    return RecordCast<CNode>(stream.GetRoot(0));
}

TEST(COrrinStream, NoRootsAre79Bytes)
{
    const CTempFolder folder;
    COrrinStream stream;
    ASSERT_TRUE(stream.SaveFile(folder.Path("empty.orn")));
    const std::string written = ReadBytes(folder.Path("empty.orn"));
    EXPECT_EQ(written, CSceneBytes().Header().EmptyThumbnail().View());
    EXPECT_EQ(written.size(), 79u);
    COrrinStream again;
    EXPECT_TRUE(again.LoadFile(folder.Path("empty.orn"), false));
    EXPECT_EQ(again.GetBaseDirectory() + kPathSeparator, folder.Path());
}

TEST(COrrinStream, WritesWhatTheFormatSays)
{
    const Ref<CNode> node = new CNode;
    node->SetName("n");
    node->AttachChild(new CPointLight);
    node->AttachControl(new CKeyframeControl);
    COrrinStream stream;
    stream.AddRoot(node.Get());
    CSceneBytes bytes = Scene().Root().Node(1, {3, 0}, "n", {2, 0, 0}).Track(2, 1, 0);
    bytes.Object("CPointLight", 3).Spatial().Words({0, 0, 0}).Float(1).Byte(1).Words({0, 0, 0});
    EXPECT_EQ(SaveBytes(stream), bytes.Bytes());
}

TEST(PackageMotion, EveryByteIsWhereItBelongs)
{
    const std::tuple<const char*, const char*, const char*, uint32_t> rows[] = {
        {"htr in capitals", "walk.HTR", "abc", 3},  {"cha", "walk.cha", "x", 1},  {"chb", "walk.chb", "y", 2},
        {"another ending", "walk.htr.bak", "z", 0}, {"empty", "none.htr", "", 3},
    };
    for (const auto& [what, source, inside, format] : rows)
    {
        SCOPED_TRACE(what);
        const CTempFolder folder;
        const std::string_view content = inside;
        const uint32_t size = static_cast<uint32_t>(content.size());
        WriteBytes(folder.Path(source), content);
        CFailureRecord record;
        ASSERT_TRUE(PackageMotion(folder.Path(source), folder.Path("out"), 30.0f, 60.0f, record));
        EXPECT_FALSE(record.Failure());

        CSceneBytes bytes;
        bytes.Header().EmptyThumbnail().Root().Node(1).Root();
        bytes.Object("CRawData", 2, "MotionInfo").Text("It's me 3").Words({300, 0, 3, 16, 1});
        bytes.Words({1, format}).Float(30).Float(60);
        bytes.Object("CRawData", 3, "MotionFile").Text("It's me 3").Words({300, 0, 0, size});
        bytes.Word(size ? 1 : 0).Raw(content);
        EXPECT_EQ(bytes.Bytes().size(), 381 + content.size());
        EXPECT_EQ(ReadBytes(folder.Path("out")), bytes.View());
    }
}

TEST(CPackageFile, PiecesMakeThePackageOfTheWholeMotion)
{
    const CTempFolder folder;
    const std::string motion(100'000, 'm'); // more than the write buffer
    WriteBytes(folder.Path("a.htr"), motion);
    CFailureRecord record;
    ASSERT_TRUE(PackageMotion(folder.Path("a.htr"), folder.Path("whole"), 30.0f, 60.0f, record));
    for (const size_t pieceBytes : {size_t{1} << 16, size_t{4099}, size_t{200'000}})
    {
        SCOPED_TRACE(pieceBytes);
        CPackageFile package;
        ASSERT_TRUE(package.Open(folder.Path("pieces"), {3, 30.0f, 60.0f}));
        const std::string bytes = (pieceBytes > 4099 ? package.TakeHead() : std::string()) + motion;
        for (std::string_view rest = bytes; !rest.empty();
             rest.remove_prefix(std::min(pieceBytes, rest.size())))
            EXPECT_TRUE(package.Write(std::as_bytes(std::span(rest.substr(0, pieceBytes)))));
        EXPECT_TRUE(package.Commit());
        EXPECT_EQ(ReadBytes(folder.Path("pieces")), ReadBytes(folder.Path("whole")));
    }
}

TEST(CPackageFile, WhatIsNotCommittedOrTooLargeLeavesTheOldFile)
{
    const CTempFolder folder;
    WriteBytes(folder.Path("out"), "old");
    const std::byte piece[] = {std::byte{'m'}};
    {
        CPackageFile package;
        ASSERT_TRUE(package.Open(folder.Path("out"), {}));
        EXPECT_TRUE(package.Write(piece));
    }
    CPackageFile package;
    ASSERT_TRUE(package.Open(folder.Path("out"), {}));
    EXPECT_FALSE(package.Write({piece, kContainerBytesLimit})) << "looked at before it is read";
    EXPECT_EQ(package.Failure(), EFailure::TooLarge);
    EXPECT_FALSE(package.Write(piece));
    EXPECT_FALSE(package.Commit());
    EXPECT_EQ(ReadBytes(folder.Path("out")), "old");
}

TEST(PackageMotion, ASourceThatIsNotThereIsRefusedAndATargetThatCannotBeIsTold)
{
    const CTempFolder folder;
    CFailureRecord record;
    EXPECT_FALSE(PackageMotion(folder.Path("none.htr"), folder.Path("out"), 30, 60, record));
    EXPECT_EQ(record.Failure().reason, EFailure::NotFound);
    EXPECT_FALSE(FileExists(folder.Path("out")));
    record.Clear();
    WriteBytes(folder.Path("a.htr"), {});
    EXPECT_TRUE(PackageMotion(folder.Path("a.htr"), folder.Path("no/such/folder"), 30, 60, record));
    EXPECT_EQ(record.Failure().reason, EFailure::WriteError);
}

TEST(COrrinStream, HeadersAreRefusedByTheirRules)
{
    // text: 20 characters, followed by more bytes
    const std::tuple<const char*, EFailure> rows[] = {
        {"TKOrrin Version 1.20", EFailure::None},       {"TKOrrin Version 0.01", EFailure::None},
        {"TKOrrin Version 1. 2", EFailure::None},       {"TKOrrin Version 1.1x", EFailure::None},
        {"TKOrrin Version 1.21", EFailure::BadVersion}, {"TKOrrin Version 0.00", EFailure::BadVersion},
        {"TKOrrin Version 1,20", EFailure::BadHeader},  {"TKOrrin Version 12.0", EFailure::BadHeader},
        {"TKOrrin version 1.20", EFailure::BadHeader},  {"TKOrrin Version 1.200", EFailure::BadHeader},
    };
    const CTempFolder folder;
    for (const auto& [text, reason] : rows)
    {
        SCOPED_TRACE(text);
        CSceneBytes bytes;
        bytes.Raw(text).Byte(0).EmptyThumbnail();
        WriteBytes(folder.Path("a.orn"), bytes.View());
        COrrinStream stream;
        stream.AddRoot(new CNode); // stays if the file is refused
        EXPECT_EQ(stream.LoadFile(folder.Path("a.orn"), false), reason == EFailure::None);
        EXPECT_EQ(stream.Record().Failure().reason, reason);
        EXPECT_EQ(stream.GetRootCount(), reason == EFailure::None ? 0u : 1u);
    }
    for (const size_t size : {0u, 1u, 19u, 20u})
    {
        WriteBytes(folder.Path("a.orn"), std::string_view("TKOrrin Version 1.20").substr(0, size));
        COrrinStream stream;
        EXPECT_FALSE(stream.LoadFile(folder.Path("a.orn"), false)) << size;
    }
}

TEST(COrrinStream, OldVersionsHaveOneChainHeadAndNewerOnesThree)
{
    const CTempFolder folder;
    for (const char* version : {"0.01", "1.00", "1.01", "1.20"})
    {
        SCOPED_TRACE(version);
        const bool three = std::string_view(version) > "1.00";
        CSceneBytes bytes;
        bytes.Header(version).EmptyThumbnail().Root().Text("CNode").Word(9).Text("old");
        three ? bytes.Words({7, 0, 8}) : bytes.Word(7);
        bytes.Spatial().Word(1).Byte(1).Byte(1).Word(0);
        bytes.Text("CKeyframeControl").Word(7).Text("");
        three ? bytes.Words({0, 0, 0}) : bytes.Word(0);
        bytes.Word(0).Float(0).Float(0).Float(0).Float(1).Byte(1).Words({9, 0});
        bytes.Add(kMat4Identity).Byte(0).Words({0, 0, 0, 0, 0, 0, 0, 0});
        if (three)
            bytes.RawData(8, 0);
        WriteBytes(folder.Path("old.orn"), bytes.View());

        COrrinStream stream;
        ASSERT_TRUE(stream.LoadFile(folder.Path("old.orn"), false));
        EXPECT_FALSE(stream.Record().Failure());
        CNode* node = RootNode(stream);
        ASSERT_NE(node, nullptr);
        ASSERT_NE(node->GetControl(), nullptr);
        EXPECT_EQ(node->GetControl()->GetTarget(), node);
        EXPECT_EQ(node->GetCustomData() != nullptr, three);
        EXPECT_TRUE(SurvivesRewriting(stream));
    }
}

TEST(COrrinStream, EveryClassComesBackAsItWas)
{
    ExpectComesBack(SampleGraph().Get());
}

TEST(COrrinStream, SizesAreThoseOfTheFormat)
{
    // memory: 0 if the size is not fixed
    const std::tuple<Ref<CObject>, uint64_t, uint64_t> rows[] = {
        {new CNode, 108, 212},         {new CBillboardNode, 117, 212},     {new CCamera, 170, 284},
        {new CCameraTarget, 106, 188}, {new CPointLight, 133, 236},        {new CRawData, 56, 56},
        {new CAuthorInfo, 71, 68},     {new CKeyframeClipControl, 178, 0}, {new CKeyframeControl, 166, 0},
    };
    for (const auto& [object, disk, memory] : rows)
    {
        SCOPED_TRACE(object->GetRTTI()->m_pcName);
        EXPECT_EQ(object->GetDiskUsed(), disk);
        EXPECT_TRUE(!memory || object->GetMemoryUsed() == memory);
        object->SetName("four");
        EXPECT_EQ(object->GetDiskUsed(), disk + 4);
    }
}

TEST(COrrinStream, RootsAreListedOnceAndWrittenAtTheirPlaceInTheWalk)
{
    const Ref<CNode> outer = new CNode;
    const Ref<CNode> inner = new CNode;
    outer->AttachChild(inner.Get());
    COrrinStream stream;
    EXPECT_FALSE(stream.AddRoot(nullptr));
    EXPECT_TRUE(stream.AddRoot(outer.Get()));
    EXPECT_TRUE(stream.AddRoot(inner.Get()));
    EXPECT_FALSE(stream.AddRoot(outer.Get()));
    EXPECT_EQ(stream.GetRoot(2), nullptr);
    EXPECT_EQ(inner->GetRefCount(), 3u);
    EXPECT_EQ(SaveBytes(stream), Scene().Root().Node(1, {2, 0}).Root().Node(2).Bytes());
    stream.RemoveAllRoots();
    EXPECT_FALSE(stream.IsRoot(outer.Get()));
    EXPECT_EQ(outer->GetRefCount(), 1u);
}

TEST(COrrinStream, TextsAndThumbnailsAreCarriedAlong)
{
    CSceneBytes bytes;
    bytes.Text("any tag").Words({2, 2, 1}).Add<uint16_t>(1).Words({72, 73, 0xdead});
    bytes.Raw("row one.row two.").Words({5, 6}).Byte(7).Word(8); // 6 bytes per row, rounded up to 8
    bytes.Root().Node(1, {}, std::string_view("cut\0off", 7));
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
    EXPECT_EQ(RootNode(stream)->NameView(), "cut");
    EXPECT_EQ(stream.Thumbnail().m_kPixels.size(), 16u);
    CSceneBytes written;
    written.Text("_OrrinThumbnail").Words({2, 2, 1}).Add<uint16_t>(1).Words({72, 73, 1});
    written.Raw("row one.row two.").Words({5, 6}).Byte(7).Word(8).Root().Node(1, {}, "cut");
    EXPECT_EQ(SaveBytes(stream), written.Bytes());

    CSceneBytes odd; // more pixels than there are
    odd.Text("").Words({99, 99, 5}).Add<uint16_t>(0).Words({96, 96, 1, 1, 0}).Byte(0).Word(0).Root().Node(1);
    COrrinStream refused;
    EXPECT_FALSE(LoadBytes(refused, odd.Bytes()));
    EXPECT_TRUE(refused.Thumbnail().m_kPixels.empty());
    EXPECT_TRUE(refused.LoadThumbnailOnly(bytes.Bytes(), 0));
    EXPECT_EQ(refused.Thumbnail().m_kPixels.size(), 16u) << "after a failure too";
}

TEST(DamagedContainer, IsReadUpToItsLastWholeRecordAndHarmsNothing)
{
    ExpectDamageStaysInside(SampleGraph().Get(), {0xffffffffu, 0x80000000u, 0x15555556u, 1u},
                            [](CObject& root) { root.Update(1.0f); });
}

TEST(DamagedContainer, ReadingStopsAtWhatCannotBeMade)
{
    for (const char* name : {"CSpatial", "cnode", "CNode ", ""})
    {
        SCOPED_TRACE(name);
        CSceneBytes bytes = Scene().Root().Node(1, {2}).Node(2);
        const size_t end = bytes.Bytes().size();
        bytes.Object(name, 3).Root().Node(4);
        COrrinStream stream;
        EXPECT_FALSE(LoadBytes(stream, bytes.Bytes()));
        EXPECT_EQ(stream.Record().Failure().reason, EFailure::UnknownClass);
        EXPECT_EQ(stream.Record().Failure().where, end);
        EXPECT_EQ(stream.Record().Failure().name, name);
        ASSERT_EQ(stream.GetRootCount(), 1u);
        EXPECT_EQ(RootNode(stream)->ChildAt(0), nullptr) << "the roots read so far stay unlinked";
    }
}

TEST(Links, OfAWrongClassOrOfNothingAreNull)
{
    CSceneBytes bytes = Scene();
    bytes.Root().Node(1, {6, 77, 0, 4}, "", {4, 4, 4}); // children: raw data, nothing, null, node
    bytes.Node(4, {}, "first");
    bytes.Root().Node(4, {6}, "second of the id");
    bytes.Root().Node(0, {4}, "without id");
    bytes.Track(5, 6, 4);
    bytes.RawData(6, 5);
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
    CNode* node = RootNode(stream);
    EXPECT_EQ(node->GetControl(), nullptr);
    EXPECT_EQ(node->GetCustomData(), nullptr);
    ASSERT_NE(node->GetModifier(), nullptr) << "any object may head the modifiers";
    EXPECT_EQ(node->GetModifier()->NameView(), "first");
    EXPECT_EQ(node->ChildAt(0), nullptr);
    EXPECT_EQ(node->ChildAt(1), nullptr);
    EXPECT_EQ(node->ChildAt(3)->NameView(), "first");
    EXPECT_EQ(stream.GetRoot(1)->NameView(), "second of the id");
    EXPECT_TRUE(stream.GetRoot(1)->HeldObjects().empty()) << "stays unlinked";
    EXPECT_EQ(stream.GetRoot(2)->NameView(), "without id");
    EXPECT_TRUE(SurvivesRewriting(stream));
}

TEST(Links, APlainPointerToWhatNobodyHoldsIsNull)
{
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, Scene().Root().Node(1, {}, "", {2, 0, 0}).Track(2, 3, 0).Node(3).Bytes()));
    ASSERT_NE(RootNode(stream)->GetControl(), nullptr);
    EXPECT_EQ(RootNode(stream)->GetControl()->GetTarget(), nullptr);
    EXPECT_FALSE(RootNode(stream)->GetControl()->UpdateTransform(1.0f));
}

TEST(Links, RingsAreRefusedAndFreed)
{
    const auto expectCycle = [](const char* what, const CSceneBytes& bytes) {
        SCOPED_TRACE(what);
        const uint32_t before = g_uiObjectCount;
        COrrinStream stream;
        EXPECT_FALSE(LoadBytes(stream, bytes.Bytes()));
        EXPECT_EQ(stream.Record().Failure().reason, EFailure::Cycle);
        EXPECT_EQ(stream.GetRootCount(), 0u);
        EXPECT_EQ(g_uiObjectCount, before);
    };
    expectCycle("own child", Scene().Root().Node(1, {1}));
    expectCycle("among its descendants", Scene().Root().Node(1, {2}).Node(2, {3}).Node(3, {2}));
    expectCycle("control chain", Scene().Root().Node(1, {}, "", {2, 0, 0}).Track(2, 1, 3).Track(3, 1, 2));
    expectCycle("custom data chain", Scene().Root().RawData(1, 2).RawData(2, 1));
    expectCycle("out of reach of any root", Scene().Root().Node(1).RawData(2, 2));
    COrrinStream stream;
    const CSceneBytes upward = Scene().Root().Node(1, {2}).Node(2, {}, "", {3, 0, 0}).Track(3, 1, 0);
    EXPECT_TRUE(LoadBytes(stream, upward.Bytes())) << "a target is no count";
}

// Returns a root with nodes nested to a total depth of `levels`. Written leaf first, so that ids do not
// follow the nesting.
std::vector<std::byte> NestedNodes(uint32_t levels)
{
    CSceneBytes bytes = Scene();
    for (uint32_t level = levels; level > 0; --level)
    {
        if (level == 1)
            bytes.Root();
        level == levels ? bytes.Node(level) : bytes.Node(level, {level + 1});
    }
    return bytes.Bytes();
}

TEST(Nesting, UpToTheLimitEveryWalkStandsAndBeyondItIsRefused)
{
    const uint32_t before = g_uiObjectCount;
    {
        COrrinStream stream;
        ASSERT_TRUE(LoadBytes(stream, NestedNodes(kNestingLimit)));
        CNode* root = RootNode(stream);
        root->m_kMatrix.SetTranslation({1, 0, 0});
        root->UpdateScene(0.0f, true);
        root->PushAndApply(nullptr);
        std::vector<CObject*> found;
        root->FindObjects(found, nullptr, &CNode::ms_kRTTI, false);
        EXPECT_EQ(found.size(), kNestingLimit);
        EXPECT_EQ(static_cast<CNode*>(found.back())->m_kWorldMatrix, root->m_kWorldMatrix);
        root->Bind(*root);
        CCloneMap map;
        const Ref<CObject> clone = root->Clone(map);
        const Ref<CNode> skeleton = root->CopySkeleton();
        EXPECT_EQ(map.size(), kNestingLimit);
        EXPECT_TRUE(SurvivesRewriting(stream));
    }
    for (const size_t levels : {kNestingLimit + 1, size_t{100'000}})
    {
        COrrinStream stream;
        EXPECT_FALSE(LoadBytes(stream, NestedNodes(static_cast<uint32_t>(levels))));
        EXPECT_EQ(stream.Record().Failure().reason, EFailure::TooDeep);
        EXPECT_EQ(stream.GetRootCount(), 0u);
    }
    EXPECT_EQ(g_uiObjectCount, before);
}

TEST(Nesting, LongChainsCountLikeChildren)
{
    CSceneBytes controls = Scene().Root().Node(1, {}, "", {2, 0, 0});
    CSceneBytes data = Scene().Root();
    for (uint32_t id = 2; id < 50'000; ++id)
    {
        controls.Track(id, 1, id + 1);
        data.RawData(id, id + 1);
    }
    for (const CSceneBytes* bytes : {&controls, &data})
    {
        COrrinStream stream;
        EXPECT_FALSE(LoadBytes(stream, bytes->Bytes()));
        EXPECT_EQ(stream.Record().Failure().reason, EFailure::TooDeep);
    }
}

TEST(Nesting, SharedNodesAreLegalUntilTheirPlacesExplode)
{
    // Each level holds the next one twice: the number of visits is two to the power of the levels.
    const auto lattice = [](uint32_t levels) {
        CSceneBytes bytes = Scene().Root();
        for (uint32_t level = 1; level < levels; ++level)
            bytes.Node(level, {level + 1, level + 1});
        return bytes.Node(levels).Bytes();
    };
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, lattice(10)));
    std::vector<CObject*> found;
    stream.GetRoot(0)->FindObjects(found, nullptr, nullptr, false);
    EXPECT_EQ(found.size(), 1023u) << "once per place";
    EXPECT_EQ(stream.ObjectsInSaveOrder().size(), 10u);
    EXPECT_TRUE(SurvivesRewriting(stream));
    for (const uint32_t levels : {30u, 3000u})
    {
        EXPECT_FALSE(LoadBytes(stream, lattice(levels)));
        EXPECT_EQ(stream.Record().Failure().reason, EFailure::TooLarge);
    }
}

TEST(COrrinStream, AHundredThousandRootsLoadAndSave)
{
    CSceneBytes roots = Scene();
    for (uint32_t id = 1; id <= 100'000; ++id)
        roots.Root().Node(id);
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, roots.Bytes()));
    EXPECT_EQ(SaveBytes(stream), roots.Bytes());
}

} // namespace
} // namespace gw
