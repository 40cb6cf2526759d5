#pragma once

#include "CFailureRecord.h"

#include <cstddef>
#include <string>

namespace gw {

class CMotionFile;

// Texts of the map tool's status line, safe to print. Paths are shortened to the file name.

/// A motion was loaded; includes only the first warning.
std::string LoadedWords(const std::string& path, const CMotionFile& motion, const CFailureRecord& record);
/// Text for a file that could not be read.
std::string FailedWords(const std::string& path, const Finding& failure);
/// Text for a result that could not be saved.
std::string NotSavedWords(const std::string& path, const Finding& failure);
std::string ConvertedWords(const CMotionFile& result, const CFailureRecord& record);
/// Text for a file that was written.
std::string SavedWords(const std::string& path);
/// A map was loaded; includes the number of lines and of mappings left out.
std::string MapWords(const std::string& path, size_t lineCount, size_t leftOut);
/// Text for a map that could not be read.
std::string NoMapWords(const std::string& path);
/// Appended after a motion was loaded and removed lines of the map; empty if it removed none.
std::string PrunedWords(size_t lineCount);

} // namespace gw
