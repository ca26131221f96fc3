#pragma once

#include <freetype/config/ftoption.h>

// What asks a system for files or its environment, which a module has not, and what belongs to formats
// of fonts that are left out.
#undef FT_CONFIG_OPTION_ENVIRONMENT_PROPERTIES
#undef FT_CONFIG_OPTION_MAC_FONTS
#undef FT_CONFIG_OPTION_USE_LZW
#define FT_CONFIG_OPTION_DISABLE_STREAM_SUPPORT
