#include "Packaging.h"

#include "CCustomData.h"
#include "CMappedFile.h"
#include "COrrinStream.h"
#include "CPackageFile.h"
#include "Paths.h"

#include <utility>

namespace gw {

Ref<CRawData> LoadFileAsRawData(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return nullptr;
    Ref<CRawData> data = new CRawData;
    data->SetData(std::move(file));
    return data;
}

bool PackageMotion(const std::string& sourcePath, const std::string& targetPath, float third, float fourth,
                   CFailureRecord& record)
{
    uint64_t byteCount = 0;
    if (FileSize(sourcePath, byteCount) && byteCount > kContainerBytesLimit)
        return record.Fail(EFailure::TooLarge, 0, sourcePath);
    const Ref<CRawData> motion = LoadFileAsRawData(sourcePath);
    if (!motion)
        return record.Fail(EFailure::NotFound, 0, sourcePath);
    CPackageFile package;
    const CByteSink sink = [&](std::span<const std::byte> bytes) { return package.Write(bytes); };
    if (package.Open(targetPath, {FormatCode(sourcePath), third, fourth}) && motion->WriteData(sink) &&
        package.Commit())
        return true;
    if (!motion->IsWhole())
        return record.Fail(EFailure::Changed, 0, sourcePath);
    record.Fail(package.Failure(), 0, targetPath);
    return true;
}

} // namespace gw
