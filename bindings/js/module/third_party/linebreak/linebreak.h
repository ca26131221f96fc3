#pragma once

#include <stddef.h>
#include <stdint.h>

// Of libunibreak's <linebreak.h> what text/ asks for.

#ifdef __cplusplus
extern "C" {
#endif

typedef uint32_t utf32_t;

enum { LINEBREAK_MUSTBREAK, LINEBREAK_ALLOWBREAK, LINEBREAK_NOBREAK };

void init_linebreak(void);

/// Writes for each of `length` characters whether a line may break behind it. `language` is null.
void set_linebreaks_utf32(const utf32_t* text, size_t length, const char* language, char* breaks);

#ifdef __cplusplus
}
#endif
