#pragma once

#include <filesystem>

#include "compose/file_mark.h"

namespace vorelcompose {

/// The mark of a file as it is now.
FileMark markOf(const std::filesystem::path& path);

}  // namespace vorelcompose
