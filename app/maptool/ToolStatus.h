#pragma once

#include "CFailure.h"

#include <cstddef>
#include <string>

namespace gw {

class CMotionFile;

// What the map tool says in its status line, safe to print. Paths are cut to the file's name.

/// A motion was loaded; of the warnings the first.
std::string LoadedWords(const std::string& path, const CMotionFile& motion, const CFailureRecord& record);
/// A file could not be read.
std::string FailedWords(const std::string& path, const CFailure& failure);
/// The result could not be saved.
std::string NotSavedWords(const std::string& path, const CFailure& failure);
std::string ConvertedWords(const CMotionFile& result, const CFailureRecord& record);
/// A file was written.
std::string SavedWords(const std::string& path);
/// A map was loaded: the lines there are now, and how many mappings were left out.
std::string MapWords(const std::string& path, size_t lineCount, size_t leftOut);
/// A map could not be read.
std::string NoMapWords(const std::string& path);
/// What follows a loaded motion's words where it took lines out of the map; empty where it took none.
std::string PrunedWords(size_t lineCount);

} // namespace gw
