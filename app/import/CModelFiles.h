#pragma once

#include <assimp/IOSystem.hpp>

#include <filesystem>
#include <string>
#include <string_view>

namespace gw {

/// The files that the library may open: a model, and what it refers to in the same folder or below. Anything
/// else, such as a path that leads elsewhere, a pipe or a device, does not exist for it.
class CModelFiles : public Assimp::IOSystem
{
public:
    explicit CModelFiles(const std::string& model);

    /// Returns the name under which the library must open the model. It chooses its reader by the extension,
    /// and does not know all of them.
    const std::string& ModelName() const { return m_kModelName; }
    bool IsCollada() const;
    /// Returns why the first file that could not be opened could not; empty if there was none.
    const std::string& WhyNot() const { return m_kWhyNot; }

    bool Exists(const char* file) const override;
    char getOsSeparator() const override { return '/'; }
    Assimp::IOStream* Open(const char* file, const char* mode) override;
    void Close(Assimp::IOStream* stream) override;

private:
    std::filesystem::path PathOf(std::string_view file) const;
    bool IsInside(const std::filesystem::path& path) const;
    Assimp::IOStream* Refuse(std::string_view file, std::string_view why);

    const std::string m_kModel;
    const std::string m_kModelName;
    const std::filesystem::path m_kFolder; // without links
    std::string m_kWhyNot;
};

} // namespace gw
