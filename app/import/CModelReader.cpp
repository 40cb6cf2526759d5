#include "CModelReader.h"

#include "CModelFiles.h"
#include "CSceneNodes.h"

#include <new>
#include <string_view>

#include <assimp/config.h>

namespace gw {

namespace {

bool AnyNameIsShared(const aiScene& scene)
{
    const CSceneNodes nodes(scene);
    for (size_t i = 0; i < nodes.Count(); ++i)
    {
        if (!nodes[i].isThing && nodes.Find(nodes[i].name) != i)
            return true;
    }
    return false;
}

} // namespace

CModelReader::CModelReader(const std::string& path) : m_pkFiles(new CModelFiles(path))
{
    m_kImporter.SetIOHandler(m_pkFiles);
    m_kImporter.SetPropertyBool(AI_CONFIG_IMPORT_REMOVE_EMPTY_BONES, false);
    m_kImporter.SetPropertyBool(AI_CONFIG_IMPORT_NO_SKELETON_MESHES, true); // with a bone for every node
    m_kImporter.SetPropertyBool(AI_CONFIG_IMPORT_FBX_READ_TEXTURES, false);
    m_kImporter.SetPropertyBool(AI_CONFIG_IMPORT_FBX_READ_MATERIALS, false);
    m_kImporter.SetPropertyBool(AI_CONFIG_IMPORT_COLLADA_USE_COLLADA_NAMES, true);
}

// A node of a Collada file has a name that its user gave it, and an identifier that only programs see. The
// library identifies nodes by one of them, so names must be unique.
const aiScene* CModelReader::Read()
{
    const aiScene* scene = m_kImporter.ReadFile(m_pkFiles->ModelName(), 0);
    if (scene && scene->mRootNode && m_pkFiles->IsCollada() && AnyNameIsShared(*scene))
    {
        m_kImporter.SetPropertyBool(AI_CONFIG_IMPORT_COLLADA_USE_COLLADA_NAMES, false);
        scene = m_kImporter.ReadFile(m_pkFiles->ModelName(), 0);
    }
    return scene && scene->mRootNode ? scene : nullptr;
}

// The library catches that too, and passes on the text of the exception.
bool CModelReader::IsOutOfMemory() const
{
    return std::string_view(m_kImporter.GetErrorString()) == std::bad_alloc().what();
}

// The library's own words for a file that is of no format repeat its path.
std::string CModelReader::WhyNot() const
{
    const std::string_view words = m_kImporter.GetErrorString();
    if (!m_pkFiles->WhyNot().empty())
        return m_pkFiles->WhyNot();
    return words.starts_with("No suitable reader") ? "it is not of the format that its name says"
                                                   : std::string(words);
}

} // namespace gw
