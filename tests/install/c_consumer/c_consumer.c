#include <voreleffect/voreleffect_c.h>

#include <stdio.h>
#include <string.h>

/* A program in C outside the project: prints the version of the library when it paints one covered pixel in
 * a blue fill with a white outline of one pixel. */
int main(void) {
    const uint8_t covered = 255;
    const vorel_glyph glyph = {0, 0, &covered, 1, 1, 0};
    const uint8_t row[] = {0xFF, 0xFF, 0xFF, 0xFF, 0x33, 0x66, 0xCC, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};
    uint8_t pixels[4 * 3 * 3] = {0};
    const vorel_view view = {pixels, 3, 3, 0, VOREL_RGBA};
    vorel_look* look = NULL;
    if (vorel_look_new(&look) != VOREL_OK) return 1;
    if (vorel_look_fill(look, 0x3366CC, 1) != VOREL_OK) return 1;
    if (vorel_look_stroke(look, 1, 0xFFFFFF, 1, VOREL_OUTSIDE) != VOREL_OK) return 1;
    if (vorel_paint(&look, 1, &glyph, 1, &view, 1, 1, NULL) != VOREL_OK) return 1;
    vorel_look_free(look);
    if (memcmp(pixels + 12, row, sizeof row) != 0) return 1;
    if (vorel_version_number() != VOREL_VERSION) return 1;
    puts(vorel_version());
    return 0;
}
