#include "CBlendMaterial.h"
#include "CImage.h"
#include "CMultiMaterial.h"
#include "CStandardMaterial.h"
#include "CTextureMap.h"
#include "MaterialSamples.h"
#include "SceneBytes.h"

#include <gtest/gtest.h>

namespace gw {
namespace {

CSceneBytes& AddStandardMaterial(CSceneBytes& bytes, uint32_t id, const std::vector<uint32_t>& textures)
{
    bytes.Object("CStandardMaterial", id).Byte(0);
    for (const float value : {0.2f, 0.2f, 0.2f, 0.8f, 0.0f, 0.0f, 0.5f, 0.5f, 0.5f, 0.0f, 0.0f, 0.0f})
        bytes.Float(value);
    for (const float value : {0.5f, 1.0f, 0.0f, 1.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f, 0.0f})
        bytes.Float(value);
    bytes.Word(static_cast<uint32_t>(textures.size()));
    for (const uint32_t texture : textures)
        bytes.Word(texture);
    return bytes;
}

std::vector<std::byte> BytesOfRoot(CObject* root)
{
    COrrinStream stream;
    stream.AddRoot(root);
    return SaveBytes(stream);
}

} // namespace

TEST(MaterialFile, EveryValueComesBack)
{
    ExpectComesBack(SampleMaterial().Get());
}

TEST(MaterialFile, AsManyTexturesAreReadAsAreStoredAndTwelveAreKept)
{
    const std::pair<std::vector<uint32_t>, std::vector<uint32_t>> rows[] = {
        {{}, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {{7}, {2, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}},
        {{0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 7, 0, 7}, {0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 2, 0}},
    };
    for (const auto& [stored, kept] : rows)
    {
        SCOPED_TRACE(stored.size());
        CSceneBytes bytes = Scene().Root();
        AddStandardMaterial(bytes, 1, stored).Root().Object("CTextureMap", 7).Byte(7).Words({0, 0});
        CSceneBytes written = Scene().Root();
        AddStandardMaterial(written, 1, kept).Root().Object("CTextureMap", 2).Byte(1).Words({0, 0});
        COrrinStream stream;
        ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
        EXPECT_EQ(SaveBytes(stream), written.Bytes());
    }
    CSceneBytes damaged = Scene().Root();
    AddStandardMaterial(damaged, 1, {});
    std::vector<std::byte> bytes = damaged.Bytes();
    std::fill(bytes.end() - 4, bytes.end(), std::byte{0xff});
    COrrinStream stream;
    EXPECT_FALSE(LoadBytes(stream, bytes));
}

TEST(MaterialFile, DamageStaysInside)
{
    ExpectDamageStaysInside(SampleMaterial(EPixelStorage::Heap).Get(),
                            {0xffffffffu, 0x80000000u, 0x15555556u, 1u}, [](CObject&) {});
}

TEST(MaterialFile, LinksOfAnotherClassAreNullAndAbstractClassesEndTheReading)
{
    CSceneBytes bytes = Scene().Root();
    AddStandardMaterial(bytes, 1, {1, 2, 3, 9, 0, 0, 0, 0, 0, 0, 0, 0}); // a material is not a texture
    bytes.Object("CTextureMap", 2).Byte(0).Words({0, 2});                // a texture is not an image
    // a texture can be used as a material
    bytes.Object("CBlendMaterial", 3).Byte(0).Float(0).Words({2, 2, 1});
    bytes.Root().Object("CBlendMaterial", 4).Byte(0).Float(0).Words({2, 9, 1});
    COrrinStream stream;
    ASSERT_TRUE(LoadBytes(stream, bytes.Bytes()));
    const auto& material = static_cast<CStandardMaterial&>(*stream.GetRoot(0));
    EXPECT_EQ(material.m_aspkTexture[0].Get(), nullptr);
    ASSERT_NE(material.m_aspkTexture[1].Get(), nullptr);
    EXPECT_EQ(static_cast<CTextureMap&>(*material.m_aspkTexture[1]).m_spkImage.Get(), nullptr);
    EXPECT_EQ(material.m_aspkTexture[2].Get(), nullptr);
    const auto& blend = static_cast<CBlendMaterial&>(*stream.GetRoot(1));
    EXPECT_EQ(blend.m_spkMask.Get(), material.m_aspkTexture[1].Get());
    EXPECT_EQ(blend.m_aspkMtl[0].Get(), nullptr);
    EXPECT_EQ(blend.m_aspkMtl[1].Get(), &material);

    for (const char* name : {"CMultiTex", "CBlendTex", "CTexture", "CMaterial", "CMaterialBase"})
    {
        COrrinStream other;
        EXPECT_FALSE(LoadBytes(other, Scene().Root().Object(name, 1).Byte(0).Bytes())) << name;
        EXPECT_EQ(other.Record().Failure().reason, EFailure::UnknownClass);
    }
}

TEST(Clone, MaterialsShareTheCopyOfWhatTheyShare)
{
    const Ref<CObject> root = SampleMaterial();
    CCloneMap map;
    const Ref<CObject> copy = root->Clone(map);
    EXPECT_EQ(DescribeRoot(copy.Get()), DescribeRoot(root.Get()));
    const Ref<CObject> bare = root->CreateClone();
    EXPECT_TRUE(bare->HeldObjects().empty()) << "a copy starts without what is attached";
}

TEST(Find, MaterialsAreSearchedInStoredOrderThemselvesFirst)
{
    const Ref<CObject> root = SampleMaterial();
    EXPECT_EQ(root->FindObject(nullptr, &CMaterialBase::ms_kRTTI, true), root.Get());
    std::vector<CObject*> found;
    root->FindObjects(found, nullptr, &CImage::ms_kRTTI, false);
    ASSERT_EQ(found.size(), 3u) << "a shared image is met at each of its places";
    EXPECT_EQ(found[0]->NameView(), "wood");
    EXPECT_EQ(found[1], found[0]);
    EXPECT_EQ(found[2]->NameView(), "bricks");
    EXPECT_EQ(root->FindObject("wood", &CTexture::ms_kRTTI, true)->GetRTTI(), &CTextureMap::ms_kRTTI)
        << "the texture before its image of the same name";
}

TEST(CMultiMaterial, ANewCountDropsEveryEntry)
{
    const Ref<CMultiMaterial> multi = new CMultiMaterial;
    const Ref<CStandardMaterial> material = new CStandardMaterial;
    multi->SetSubMaterialCount(2);
    multi->m_kSubMaterials[0] = material.Get();
    multi->SetSubMaterialCount(3);
    EXPECT_EQ(multi->m_kSubMaterials.size(), 3u);
    EXPECT_EQ(multi->m_kSubMaterials[0].Get(), nullptr);
    EXPECT_EQ(material->GetRefCount(), 1u);
    EXPECT_EQ(BytesOfRoot(new CMultiMaterial).size(), 58 + 14 + multi->GetDiskUsed() - 12)
        << "0 entries are a count";
}

} // namespace gw
