#include "Packaging.h"

#include "CCustomData.h"
#include "CMappedFile.h"
#include "COrrinStream.h"
#include "CPackageFile.h"
#include "Paths.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kPieceBytes = size_t{8} << 20;

bool CopyMotion(CMappedFile& motion, CPackageFile& package)
{
    const std::span<const std::byte> bytes = motion.Bytes();
    size_t done = 0;
    while (done < bytes.size())
    {
        const size_t count = std::min(bytes.size() - done, kPieceBytes);
        if (!package.Write(bytes.subspan(done, count)))
            return false;
        done += count;
        motion.Forget(done);
    }
    return true;
}

} // namespace

Ref<CRawData> LoadFileAsRawData(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return nullptr;
    Ref<CRawData> data = new CRawData;
    data->SetData(file.Bytes());
    return data;
}

bool PackageMotion(const std::string& sourcePath, const std::string& targetPath, float third, float fourth,
                   CFailureRecord& record)
{
    uint64_t byteCount = 0;
    if (FileSize(sourcePath, byteCount) && byteCount > kContainerBytesLimit)
        return record.Fail(EFailure::TooLarge, 0, sourcePath);
    CMappedFile motion;
    if (motion.Open(sourcePath) != EFailure::None)
        return record.Fail(EFailure::NotFound, 0, sourcePath);
    CPackageFile package;
    if (!package.Open(targetPath, {FormatCode(sourcePath), third, fourth}) || !CopyMotion(motion, package) ||
        !package.Commit())
        record.Fail(package.Failure(), 0, targetPath);
    return true;
}

} // namespace gw
