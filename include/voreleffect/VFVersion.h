#pragma once

/// The version of the library, by the rules of semantic versioning: a caller that was written for one
/// version builds with every later one of the same major number. Whether a compiled program still
/// runs is told by the number in the library's file name (libvoreleffect.so.1), which counts apart.
#define VOREL_VERSION_MAJOR 0
/// The minor number: raised by what is added.
#define VOREL_VERSION_MINOR 9
/// The patch number: raised by what is mended.
#define VOREL_VERSION_PATCH 0

/// A version as one number, in the order of versions: 0.9.0 is 9000, 1.2.3 is 1002003.
#define VOREL_VERSION_NUMBER(major, minor, patch) ((major)*1000000 + (minor)*1000 + (patch))

/// The version as one number: `#if VOREL_VERSION >= VOREL_VERSION_NUMBER(0, 9, 0)`.
#define VOREL_VERSION VOREL_VERSION_NUMBER(VOREL_VERSION_MAJOR, VOREL_VERSION_MINOR, VOREL_VERSION_PATCH)

/// The version as a text: "0.9.0".
#define VOREL_VERSION_STRING           \
    VOREL_TEXT_OF(VOREL_VERSION_MAJOR) \
    "." VOREL_TEXT_OF(VOREL_VERSION_MINOR) "." VOREL_TEXT_OF(VOREL_VERSION_PATCH)

#define VOREL_TEXT_OF(number) VOREL_TEXT_OF_TOKEN(number)
#define VOREL_TEXT_OF_TOKEN(token) #token
