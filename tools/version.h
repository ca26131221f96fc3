#pragma once

#if __has_include(<voreleffect/VFVersion.h>)
#include <voreleffect/VFVersion.h>
#endif
#ifndef VOREL_VERSION_STRING
#define VOREL_VERSION_STRING VORELPAINT_VERSION
#endif

namespace vorelpaint {

constexpr const char* kVersion = VOREL_VERSION_STRING;

}  // namespace vorelpaint
