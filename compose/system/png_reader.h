#pragma once

#include <filesystem>

#include "text/voreltext.h"

namespace vorelcompose {

/// Reads a PNG file as straight R, G, B, A. Throws ComposeError when it cannot be read, is no PNG or
/// has more than 4096 pixels on a side.
voreltext::Image readPng(const std::filesystem::path& path);

}  // namespace vorelcompose
