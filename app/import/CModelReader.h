#pragma once

#include <assimp/Importer.hpp>

#include <string>

namespace gw {

class CModelFiles;

/// The library, set up to read skeletons and motions.
class CModelReader
{
public:
    explicit CModelReader(const std::string& path);

    /// Returns the file's scene, which lives as long as the reader; null if it cannot be read.
    const aiScene* Read();
    /// Returns whether there was not enough memory for it.
    bool IsOutOfMemory() const;
    /// Returns why not, in words.
    std::string WhyNot() const;

private:
    Assimp::Importer m_kImporter;
    CModelFiles* m_pkFiles; // owned by the importer
};

} // namespace gw
