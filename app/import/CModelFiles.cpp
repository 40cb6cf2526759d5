#include "CModelFiles.h"

#include "Paths.h"

#include <algorithm>
#include <charconv>
#include <cstdio>
#include <cstring>
#include <optional>
#include <system_error>

#include <assimp/DefaultIOStream.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

namespace fs = std::filesystem;

class CFileStream : public Assimp::DefaultIOStream
{
public:
    CFileStream(FILE* file, const std::string& name) : DefaultIOStream(file, name) {}
};

std::string NameForLibrary(const std::string& model)
{
    return HasExtension(model, ".vrm") ? model + ".glb" : model;
}

fs::path FolderWithoutLinks(const std::string& model)
{
    std::error_code ignored;
    const fs::path parent = fs::path(model).parent_path();
    return fs::weakly_canonical(parent.empty() ? "." : parent, ignored);
}

// Returns the text with "%20" and the like replaced. Files refer to others by addresses, not by paths.
std::string Decoded(std::string_view address)
{
    std::string path;
    for (size_t i = 0; i < address.size(); ++i)
    {
        unsigned char byte = 0;
        const char* const digits = address.data() + i + 1;
        const bool isCode = address[i] == '%' && i + 2 < address.size() &&
                            std::from_chars(digits, digits + 2, byte, 16).ptr == digits + 2;
        path += isCode ? static_cast<char>(byte) : address[i];
        i += isCode ? 2 : 0;
    }
    return path;
}

// Opens a regular file only. Without O_NONBLOCK, opening a pipe waits for somebody to write to it.
FILE* OpenRegular(const fs::path& path)
{
    const int descriptor = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC | O_NOCTTY);
    if (descriptor < 0)
        return nullptr;
    struct stat facts = {};
    FILE* const file =
        fstat(descriptor, &facts) == 0 && S_ISREG(facts.st_mode) ? fdopen(descriptor, "rb") : nullptr;
    if (!file)
        close(descriptor);
    return file;
}

} // namespace

CModelFiles::CModelFiles(const std::string& model)
    : m_kModel(model), m_kModelName(NameForLibrary(model)), m_kFolder(FolderWithoutLinks(model))
{
}

bool CModelFiles::IsCollada() const
{
    return HasExtension(m_kModel, ".dae");
}

fs::path CModelFiles::PathOf(std::string_view file) const
{
    if (file == m_kModelName)
        return m_kModel;
    std::error_code ignored;
    const fs::path asWritten(file);
    return fs::exists(asWritten, ignored) ? asWritten : fs::path(Decoded(file));
}

bool CModelFiles::IsInside(const fs::path& path) const
{
    if (path == m_kModel)
        return true;
    std::error_code error;
    const fs::path real = fs::weakly_canonical(path, error);
    return !error && std::ranges::mismatch(m_kFolder, real).in1 == m_kFolder.end();
}

bool CModelFiles::Exists(const char* file) const
{
    std::error_code ignored;
    const fs::path path = PathOf(file);
    return IsInside(path) && fs::is_regular_file(path, ignored);
}

Assimp::IOStream* CModelFiles::Refuse(std::string_view file, std::string_view why)
{
    const std::string folder = fs::path(m_kModel).parent_path().string();
    if (!folder.empty() && file.starts_with(folder + '/'))
        file.remove_prefix(folder.size() + 1);
    if (m_kWhyNot.empty())
        m_kWhyNot.append("it refers to the file ").append(file).append(", which ").append(why);
    return nullptr;
}

Assimp::IOStream* CModelFiles::Open(const char* file, const char* mode)
{
    if (std::strpbrk(mode, "wa+"))
        return nullptr;
    const fs::path path = PathOf(file);
    if (!IsInside(path))
        return Refuse(file, "is not in its folder");
    if (FILE* const stream = OpenRegular(path))
        return new CFileStream(stream, path.string()); // which asks for the size by name
    std::error_code ignored;
    return Refuse(file, fs::exists(path, ignored) ? "cannot be read" : "is missing");
}

void CModelFiles::Close(Assimp::IOStream* stream)
{
    delete stream;
}

} // namespace gw
