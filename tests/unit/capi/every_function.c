/* Every function of the C face, called by a program in C. It is compiled as C99 and as C11; it prints
 * the first thing that is not as it should be, and ends with 1 then. */
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <voreleffect/voreleffect_c.h>

#define SIDE 40

#define CHECK(condition)                                                    \
    do {                                                                    \
        if (!(condition)) {                                                 \
            fprintf(stderr, "%s:%d: %s\n", __FILE__, __LINE__, #condition); \
            exit(1);                                                        \
        }                                                                   \
    } while (0)
#define DONE(call) CHECK((call) == VOREL_OK)

static const uint8_t kCoverage[9] = {255, 255, 255, 255, 255, 255, 255, 255, 255};
static uint8_t gPixels[4 * SIDE * SIDE];

static vorel_glyph square(void) {
    vorel_glyph glyph = {10, 10, kCoverage, 3, 3, 0};
    return glyph;
}

static vorel_view clearPage(void) {
    vorel_view view = {gPixels, SIDE, SIDE, 0, VOREL_RGBA};
    memset(gPixels, 0, sizeof gPixels);
    return view;
}

static int isPixel(int x, int y, int r, int g, int b, int a) {
    const uint8_t* p = gPixels + 4 * (y * SIDE + x);
    return p[0] == r && p[1] == g && p[2] == b && p[3] == a;
}

static void checkVersion(void) {
    CHECK(strcmp(vorel_version(), VOREL_VERSION_STRING) == 0);
    CHECK(vorel_version_number() == VOREL_VERSION);
    CHECK(VOREL_VERSION >= VOREL_VERSION_NUMBER(0, 9, 0));
    CHECK(strcmp(vorel_status_text(VOREL_OK), vorel_status_text(VOREL_NO_MEMORY)) != 0);
    CHECK(vorel_status_text(-7) != NULL);
}

/* A red fill with a white outline of 2 pixels. */
static vorel_look* outlined(void) {
    vorel_look* look = NULL;
    DONE(vorel_look_new(&look));
    DONE(vorel_look_fill(look, 0xFF0000, 1));
    DONE(vorel_look_stroke(look, 2, 0xFFFFFF, 1, VOREL_OUTSIDE));
    return look;
}

static void addEveryEffect(vorel_look* look) {
    const vorel_stop stops[] = {{0xFF0000, 1, 0}, {0x0000FF, 0.5F, 1}};
    const uint8_t tile[] = {1, 2, 3, 255, 4, 5, 6, 255};
    vorel_pixels pixels = {tile, 2, 1, 0};
    DONE(vorel_look_outer_shadow(look, 135, 4, 4, 0, 0.5F));
    DONE(vorel_look_inner_shadow(look, 135, 4, 4, 0, 0.5F));
    DONE(vorel_look_outer_glow(look, 4, 0xFFFF00, 0.5F, NULL, 0));
    DONE(vorel_look_inner_glow(look, 4, 0xFFFF00, 0.5F, stops, 2));
    DONE(vorel_look_linear_gradient(look, 90, 1, 0.5F, stops, 2));
    DONE(vorel_look_radial_gradient(look, 1, 0.5F, stops, 2));
    DONE(vorel_look_pattern(look, &pixels, 1, 0.5F));
    DONE(vorel_look_text_opacity(look, 0.5F));
    DONE(vorel_look_no_fill(look));
}

static void checkLooks(void) {
    vorel_look* look = outlined();
    vorel_look* copy = NULL;
    int32_t equal = 7;
    vorel_margins margins;
    size_t length = 0;
    char* key;
    DONE(vorel_look_copy(look, &copy));
    DONE(vorel_look_equal(look, copy, &equal));
    CHECK(equal == 1);
    addEveryEffect(copy);
    DONE(vorel_look_equal(look, copy, &equal));
    CHECK(equal == 0);
    DONE(vorel_look_margins(look, &margins));
    CHECK(margins.left >= 2 && margins.top >= 2 && margins.right >= 2 && margins.bottom >= 2);

    DONE(vorel_look_key(look, NULL, 0, &length));
    CHECK(length > 0);
    key = malloc(length);
    CHECK(key != NULL);
    CHECK(vorel_look_key(look, key, length - 1, &length) == VOREL_TOO_LARGE);
    DONE(vorel_look_key(look, key, length, &length));
    CHECK(memchr(key, 0, length) == NULL);
    free(key);
    vorel_look_free(copy);
    vorel_look_free(look);
}

static void checkPages(void) {
    vorel_look* look = outlined();
    vorel_glyph glyph = square();
    vorel_view page = clearPage();
    vorel_box touched;
    DONE(vorel_paint(&look, 1, &glyph, 1, &page, 1, 0, &touched));
    CHECK(isPixel(12, 11, 255, 0, 0, 255));
    CHECK(isPixel(9, 11, 255, 255, 255, 255));
    CHECK(isPixel(8, 11, 0, 0, 0, 0));
    CHECK(touched.left <= 9 && touched.right >= 16 && touched.top <= 8 && touched.bottom >= 15);
    page = clearPage();
    page.order = VOREL_BGRA;
    DONE(vorel_paint(&look, 1, &glyph, 1, &page, 0, 0, NULL));
    CHECK(isPixel(11, 11, 0, 0, 255, 255));
    vorel_look_free(look);
}

static void checkPictures(const vorel_painter* painter, vorel_picture* picture) {
    vorel_margins margins;
    vorel_view page = clearPage();
    vorel_view own;
    vorel_box touched;
    DONE(vorel_painter_margins(painter, &margins));
    CHECK(vorel_picture_left(picture) == 10 - margins.left);
    CHECK(vorel_picture_top(picture) == 10 - margins.top);
    CHECK(vorel_picture_width(picture) == 3 + margins.left + margins.right);
    CHECK(vorel_picture_height(picture) == 3 + margins.top + margins.bottom);
    CHECK(vorel_picture_stride(picture) == 4 * vorel_picture_width(picture));
    DONE(vorel_picture_view(picture, &own));
    CHECK(own.data == vorel_picture_data(picture) && own.data != NULL);
    CHECK(own.width == vorel_picture_width(picture) && own.height == vorel_picture_height(picture));
    CHECK(own.order == VOREL_RGBA && (own.stride == 0 || own.stride == 4 * own.width));
    DONE(vorel_picture_lay_over(picture, &page, 0, 0, &touched));
    CHECK(touched.left == vorel_picture_left(picture));
    CHECK(isPixel(11, 11, 0, 0, 255, 255));
}

/* The upper of two looks is blue. */
static void checkPainters(void) {
    vorel_look* looks[2];
    vorel_painter* painter = NULL;
    vorel_picture* picture = NULL;
    vorel_glyph glyph = square();
    vorel_view page = clearPage();
    looks[0] = outlined();
    DONE(vorel_look_new(&looks[1]));
    DONE(vorel_look_fill(looks[1], 0x0000FF, 1));
    DONE(vorel_painter_new(looks, 2, &painter));
    vorel_look_free(looks[0]);
    vorel_look_free(looks[1]);
    DONE(vorel_painter_paint(painter, &glyph, 1, &page, 0, 0, NULL));
    CHECK(isPixel(11, 11, 0, 0, 255, 255));
    CHECK(isPixel(9, 11, 255, 255, 255, 255));
    DONE(vorel_painter_picture(painter, &glyph, 1, &picture));
    checkPictures(painter, picture);
    vorel_picture_free(picture);
    vorel_painter_free(painter);
}

int main(void) {
    checkVersion();
    checkLooks();
    checkPages();
    checkPainters();
    vorel_look_free(NULL);
    vorel_painter_free(NULL);
    vorel_picture_free(NULL);
    return 0;
}
