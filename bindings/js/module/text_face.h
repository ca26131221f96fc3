#pragma once

#include <voreleffect/voreleffect_c.h>

#ifdef __cplusplus
extern "C" {
#endif

/// @file
/// Texts in fonts and styles, for languages that call C: what compose/vorelcompose.h has, behind
/// handles.
///
/// The conventions are those of voreleffect_c.h, but for these:
///  - What is asked of a picture is one JSON text, `request`, of `length` bytes of UTF-8. Its keys are
///  those of
///    requests.h; one that is not there has its usual value.
///  - What is told is an answer: a JSON text, and bytes for pixels, of which the text tells the places.
///  - Why a call failed is told in a line of text, until the next call: vorel_text_error.
///  - Everything is used by one thread. Fonts, styles and answers are independent of who handed over the
///    bytes that they are made of: these are copied.

/// What became of a call, beside those of voreleffect_c.h.
enum {
    VOREL_STYLE_ERROR = 16,   ///< something is wrong with a style, or with the markup of a text
    VOREL_TEXT_ERROR = 17,    ///< a text cannot be painted as it is asked for
    VOREL_FONT_ERROR = 18,    ///< a font cannot be read, or is not there
    VOREL_REQUEST_ERROR = 19  ///< something of a request is out of its range
};

/// Fonts, and what is kept from one text in them to the next.
typedef struct vorel_fonts vorel_fonts;
/// A style with the pictures of its patterns.
typedef struct vorel_style vorel_style;
/// A text that is painted step by step.
typedef struct vorel_steps vorel_steps;
/// What a call tells.
typedef struct vorel_answer vorel_answer;

/// What a step of painting does, and what vorel_steps_picture shows.
enum {
    VOREL_STEP_GLYPHS = 0,  ///< the coverage of the glyphs; its picture is white
    VOREL_STEP_EFFECT = 1,  ///< one effect
    VOREL_STEP_MERGE = 2,   ///< the whole of a look, laid on the canvas
    VOREL_STEP_FONT = 3     ///< pictures of colour fonts; they are part of the merge
};

/// A step of painting: compose/painting_steps.h.
typedef struct vorel_step {
    int32_t look;    ///< position in the stack, 0 the lowest
    int32_t span;    ///< position in reading order
    int32_t kind;    ///< of the step
    int32_t effect;  ///< of an effect: position in the plan of the look, 0 the topmost
} vorel_step;

/// A picture that a pattern of a style names.
typedef struct vorel_named_pixels {
    const char* name;
    vorel_pixels pixels;
} vorel_named_pixels;

/// One line that says why the last call failed; empty when it did not, or where memory ran out.
VF_API const char* vorel_text_error(void);

VF_API vorel_status vorel_fonts_new(vorel_fonts** fonts);
/// Frees it; null may be freed.
VF_API void vorel_fonts_free(vorel_fonts* fonts);
/// Adds a font of a file's bytes, the one at `index` in it, under a name of its own by which requests
/// ask for it. Tells "name", the family with the style, and "family". VOREL_FONT_ERROR for what is no
/// font or of a name that is taken.
VF_API vorel_status vorel_fonts_add(vorel_fonts* fonts, const char* name, const uint8_t* data,
                                    size_t size, int32_t index, vorel_answer** answer);
/// Takes a font away, if it is there, and its bytes.
VF_API void vorel_fonts_remove(vorel_fonts* fonts, const char* name);

/// The style of the text of a style file. Messages call it `name`, which may be empty. Of its patterns
/// those have pictures whose names are among the images.
VF_API vorel_status vorel_style_new(const char* json, size_t length, const char* name,
                                    const vorel_named_pixels* images, size_t count, vorel_style** style);
/// The style of a list of looks, the last on top: a JSON array of what vorel_style_looks tells of each.
/// A pattern has "image" in place of its pixels: the name of one of the images.
VF_API vorel_status vorel_style_of_looks(const char* json, size_t length,
                                         const vorel_named_pixels* images, size_t count,
                                         vorel_style** style);
/// Frees it; null may be freed.
VF_API void vorel_style_free(vorel_style* style);
/// Tells what a style is for a font of `size` pixels, 1 to 1000, its lengths multiplied by `scale`, 0.05
/// to 20: "description"; "margins"; "key", in hexadecimal.
VF_API vorel_status vorel_style_facts(const vorel_style* style, int32_t size, float scale,
                                      vorel_answer** answer);
/// Tells its looks, the lowest first, as states of looks (look_states.h). The pixels of patterns are
/// among the bytes, from "at" on. VOREL_STYLE_ERROR when one is moved, or of lines, words or glyphs.
VF_API vorel_status vorel_style_looks(const vorel_style* style, int32_t size, float scale,
                                      vorel_answer** answer);
/// Tells "source", C++17 that makes the library's calls (style/write_cpp.h). The request has "name",
/// "size" and, as in requests.h, "color", "opacity" and "effectScale".
VF_API vorel_status vorel_style_cpp(const vorel_style* style, const char* request, size_t length,
                                    vorel_answer** answer);

/// Paints a text in a style, or in black without one (null). The bytes of the answer are the picture's,
/// in packed rows of R, G, B, A; it tells what answers.h says.
VF_API vorel_status vorel_text_picture(vorel_fonts* fonts, const char* request, size_t length,
                                       const vorel_style* style, vorel_answer** answer);
/// Sets a text without painting it. The bytes are the coverage of its glyphs; the answer tells of glyphs
/// and lines what answers.h says.
VF_API vorel_status vorel_text_layout(vorel_fonts* fonts, const char* request, size_t length,
                                      vorel_answer** answer);
/// Tells how a style is painted for a font of a size: what answers.h says of a plan.
VF_API vorel_status vorel_style_plan(const vorel_style* style, int32_t size, float scale,
                                     vorel_answer** answer);

/// Makes a text ready to be painted step by step, in a style or without one. Its fonts and style may be
/// freed before it.
VF_API vorel_status vorel_steps_new(vorel_fonts* fonts, const char* request, size_t length,
                                    const vorel_style* style, vorel_steps** steps);
/// Frees it; null may be freed.
VF_API void vorel_steps_free(vorel_steps* steps);
/// Tells what vorel_style_plan does, of this text.
VF_API vorel_status vorel_steps_plan(const vorel_steps* steps, vorel_answer** answer);
/// Makes the next step ready and tells of it; `look` is -1 when there is none.
VF_API vorel_status vorel_steps_prepare(vorel_steps* steps, vorel_step* step);
/// Paints the step that was made ready last.
VF_API vorel_status vorel_steps_paint(vorel_steps* steps);
/// Tells the picture of one step alone, of one effect or all of a look (compose/step_pictures.h):
/// "width" and "height", with premultiplied pixels.
VF_API vorel_status vorel_steps_picture(const vorel_steps* steps, int32_t kind, int32_t look,
                                        int32_t effect, vorel_answer** answer);

/// Frees it; null may be freed.
VF_API void vorel_answer_free(vorel_answer* answer);
/// Its text: JSON, `vorel_answer_length` bytes of UTF-8; as long as the answer lives.
VF_API const char* vorel_answer_text(const vorel_answer* answer);
VF_API size_t vorel_answer_length(const vorel_answer* answer);
/// Its bytes, `vorel_answer_size` of them; as long as the answer lives.
VF_API const uint8_t* vorel_answer_data(const vorel_answer* answer);
VF_API size_t vorel_answer_size(const vorel_answer* answer);

#ifdef __cplusplus
}
#endif
