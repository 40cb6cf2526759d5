#pragma once

#include <string>

namespace gw {

class CFileExam;

/// Examines a file of any format: the text of a BVH file, the poses of another motion, or whether a container
/// is intact. If the extension is unknown, the file may still be a container.
void ExamineFile(const std::string& path, CFileExam& exam);

} // namespace gw
