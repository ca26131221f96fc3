#pragma once

#include <string>

#include "literal_image.h"

/// Pictures as PNG files. The bytes of a pixel are stored as they are, premultiplied.
namespace vorel_test {

/// An empty picture when there is no such file or it is none.
literal::Picture readPng(const std::string& path);

/// Returns whether it could be written.
bool writePng(const std::string& path, const literal::Picture& picture);

/// Expected, the absolute difference of the bytes (opaque), and actual, side by side. Both pictures
/// must have one size.
literal::Picture sideBySide(const literal::Picture& expected, const literal::Picture& actual);

}  // namespace vorel_test
