/* A letter in a look, painted on a grey page: title FILE writes the page's pixels, R, G, B, A. */
#include <stdio.h>
#include <string.h>
#include <voreleffect/voreleffect_c.h>

static uint8_t letter[60 * 72];
static uint8_t page[4 * 100 * 110];

static vorel_status describe(vorel_look* look) {
    const vorel_stop sun[] = {{0xFFD75E, 1, 0}, {0xFFD75E, 0, 1}};
    vorel_status status = vorel_look_fill(look, 0xE8412C, 1);
    if (status == VOREL_OK) status = vorel_look_outer_shadow(look, 135, 6, 8, 0x1B2A41, 0.6F);
    if (status == VOREL_OK) status = vorel_look_stroke(look, 4, 0xFFFFFF, 1, VOREL_OUTSIDE);
    if (status == VOREL_OK) status = vorel_look_linear_gradient(look, 270, 1, 1, sun, 2);
    return status;
}

int main(int argc, char** argv) {
    const vorel_glyph glyph = {0, 0, letter, 60, 72, 0};
    const vorel_view view = {page, 100, 110, 0, VOREL_RGBA};
    vorel_look* look = NULL;
    vorel_status status = vorel_look_new(&look);

    for (int y = 0; y < 72; ++y) /* an H */
        for (int x = 0; x < 60; ++x)
            letter[y * 60 + x] = x < 18 || x >= 42 || (y >= 27 && y < 45) ? 255 : 0;
    memset(page, 200, sizeof page);
    for (size_t i = 3; i < sizeof page; i += 4)
        page[i] = 255;
    if (status == VOREL_OK) status = describe(look);
    if (status == VOREL_OK) status = vorel_paint(&look, 1, &glyph, 1, &view, 20, 18, NULL);
    vorel_look_free(look);
    if (status != VOREL_OK) {
        fprintf(stderr, "%s\n", vorel_status_text(status));
        return 1;
    }

    FILE* file = argc > 1 ? fopen(argv[1], "wb") : NULL;
    if (file == NULL) return 1;
    const int is_written = fwrite(page, sizeof page, 1, file) == 1;
    return fclose(file) == 0 && is_written ? 0 : 1;
}
