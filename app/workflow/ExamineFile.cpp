#include "ExamineFile.h"

#include "CFileExam.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "Paths.h"

namespace gw {

namespace {

// Containers have no poses to examine. Returns false if the file is not a container; a damaged one is.
bool ReadContainer(const std::string& path, CFailureRecord& record)
{
    COrrinStream scene;
    scene.SetPictureLimit(0);
    const bool isContainer = scene.LoadFile(path, false);
    record = scene.Record();
    return isContainer;
}

// Returns the record of a file whose extension is unknown. It may be a container, or not a file at all.
CFailureRecord UnknownRecord(const std::string& path, const CFailureRecord& asMotion)
{
    CFailureRecord asContainer;
    const bool isContainer = ReadContainer(path, asContainer);
    const EFailure reason = asContainer.Failure().reason;
    const bool isUnreachable =
        reason == EFailure::NotFound || reason == EFailure::NotRegular || reason == EFailure::ReadError;
    return isContainer || isUnreachable ? asContainer : asMotion;
}

void ExamineMotion(const std::string& path, CFileExam& exam)
{
    CMotionFile motion;
    const bool isLoaded = motion.Load(path);
    const bool isUnknown = motion.Record().Failure().reason == EFailure::UnknownFormat;
    exam.TakeRecord(path, isUnknown ? UnknownRecord(path, motion.Record()) : motion.Record());
    if (isLoaded)
        exam.ExaminePoses(motion);
}

} // namespace

void ExamineFile(const std::string& path, CFileExam& exam)
{
    if (HasExtension(path, ".bvh"))
        return exam.ExamineBVH(path);
    if (!HasExtension(path, ".orn") && !HasExtension(path, ".Kinetra"))
        return ExamineMotion(path, exam);
    CFailureRecord record;
    ReadContainer(path, record);
    exam.TakeRecord(path, record);
}

} // namespace gw
