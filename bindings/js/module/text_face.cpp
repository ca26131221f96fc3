#include "text_face.h"

#include <cstring>
#include <exception>
#include <memory>
#include <new>
#include <optional>
#include <sstream>
#include <string>
#include <string_view>
#include <utility>

#include "answers.h"
#include "byte_fonts.h"
#include "compose/vorelcompose.h"
#include "json_writer.h"
#include "look_states.h"
#include "requests.h"

using namespace vorelscript;
using vorelcompose::Composition;

struct vorel_fonts {
    ByteFonts source;
    std::optional<vorelcompose::Workbench> bench{source};
};

struct vorel_style {
    vorelcompose::FoundStyle found;
};

struct vorel_steps {
    ByteFonts::Held bytes;  // of the fonts in which the text is set
    Composition composition;
    vorelcompose::PaintingSteps steps{composition};
    bool isReady = false;
};

struct vorel_answer {
    Answer answer;
};

namespace {

using vorelcompose::LayerSet;
using vorelstyle::Style;
using vorelstyle::StyleError;

std::string& lastError() {
    static std::string text;
    return text;
}

vorel_status failed(vorel_status status, const char* why) {
    try {
        lastError() = why;
    } catch (const std::bad_alloc&) {
        lastError().clear();
    }
    return status;
}

/// Runs the body of a call, and tells of what it throws by a status.
template <typename Body>
vorel_status called(const Body& body) noexcept {
    lastError().clear();
    try {
        body();
        return VOREL_OK;
    } catch (const RequestError& error) {
        return failed(VOREL_REQUEST_ERROR, error.what());
    } catch (const FontError& error) {
        return failed(VOREL_FONT_ERROR, error.what());
    } catch (const StyleError& error) {
        return failed(VOREL_STYLE_ERROR, error.what());
    } catch (const voreltext::TextError& error) {
        return failed(VOREL_TEXT_ERROR, error.what());
    } catch (const vorelcompose::ComposeError& error) {
        return failed(VOREL_TEXT_ERROR, error.what());
    } catch (const std::bad_alloc&) {
        return VOREL_NO_MEMORY;
    } catch (const std::exception& error) {
        return failed(VOREL_TOO_LARGE, error.what());  // a list that is longer than any can be
    }
}

/// The same for a call that makes something.
template <typename Made, typename Make>
vorel_status made(Made** out, const Make& make) noexcept {
    if (out == nullptr) return VOREL_BAD_ARGUMENT;
    *out = nullptr;
    return called([&] { *out = std::make_unique<Made>(make()).release(); });
}

std::string_view viewOf(const char* text, size_t length) {
    return {text, length};
}

bool isWhole(const vorel_pixels& pixels) {
    return pixels.data != nullptr && pixels.width > 0 && pixels.height > 0 &&
           (pixels.stride == 0 || pixels.stride / 4 >= pixels.width);
}

bool areWhole(const vorel_named_pixels* images, size_t count) {
    if (count != 0 && images == nullptr) return false;
    for (size_t i = 0; i < count; ++i) {
        if (images[i].name == nullptr || !isWhole(images[i].pixels)) return false;
    }
    return true;
}

vorelstyle::PatternImage copyOf(const vorel_pixels& pixels) {
    const auto row = static_cast<size_t>(pixels.width) * 4;
    vorelstyle::PatternImage image{pixels.width, pixels.height, {}};
    image.pixels.reserve(row * static_cast<size_t>(pixels.height));
    const auto stride = pixels.stride == 0 ? static_cast<std::ptrdiff_t>(row) : pixels.stride;
    for (int y = 0; y < pixels.height; ++y) {
        const uint8_t* const from = pixels.data + y * stride;
        image.pixels.insert(image.pixels.end(), from, from + row);
    }
    return image;
}

vorel_style styleOf(Style style, const vorel_named_pixels* images, size_t count) {
    auto held = std::make_shared<Images>();
    for (size_t i = 0; i < count; ++i)
        (*held)[images[i].name] = copyOf(images[i].pixels);
    const auto load = [held](const std::string& name) {
        const auto image = held->find(name);
        if (image == held->end()) throw StyleError("'" + name + "' is not among the images");
        return image->second;
    };
    return {{std::make_shared<const Style>(std::move(style)), load, {}, true}};
}

vorelcompose::FoundStyle foundIn(const vorel_style* style) {
    if (style != nullptr) return style->found;
    return {std::make_shared<const Style>(), {}};
}

/// The looks as those of a font size.
LayerSet layersOf(const vorel_style& style, int size, float scale) {
    return {sizeRequest(size, scale), *style.found.style, style.found.load, size, {},
            [](const std::string&) {}};
}

Answer factsOf(const vorel_style& style, int size, float scale) {
    const LayerSet layers = layersOf(style, size, scale);
    const voreltext::Margins margins = marginsOf(layers.layers());
    JsonWriter json;
    json.beginObject().entry("description", style.found.style->description);
    json.key("margins").beginArray();
    json.value(margins.left).value(margins.top).value(margins.right).value(margins.bottom).endArray();
    json.entry("key", vorelstyle::hexadecimal(layers.stack().key())).endObject();
    return {json.text(), {}};
}

Answer looksOf(const vorel_style& style, int size, float scale) {
    sizeRequest(size, scale);
    const Style resolved = resolvedStyle(*style.found.style, size, scale, {});
    const vorelstyle::Place inPlace;
    Answer answer;
    JsonWriter json;
    json.beginArray();
    size_t position = 0;
    for (const vorelstyle::Place& place : placesOf(resolved)) {
        const bool isInPlace = place.offsetX == inPlace.offsetX && place.offsetY == inPlace.offsetY &&
                               place.span == inPlace.span;
        if (!isInPlace) {
            throw StyleError(vorelstyle::faultPrefix(resolved.name) + lookPath(resolved, position) +
                             "offset, span: a look alone is not moved, and is of the whole block");
        }
        writeState(json, resolved.looks[position++], style.found.load, answer.bytes);
    }
    answer.json = json.endArray().text();
    return answer;
}

Answer sourceOf(const vorel_style& style, const SourceRequest& asked) {
    const vorelcompose::Request& request = asked.request;
    const Style resolved = resolvedStyle(*style.found.style, request.size, request.effectScale, {});
    std::ostringstream out;
    writeCpp(out, asked.name, resolved, request.color, request.opacity, style.found.load);
    JsonWriter json;
    json.beginObject().entry("source", out.str()).endObject();
    return {json.text(), {}};
}

Composition composed(vorel_fonts& fonts, const TextRequest& asked, const vorel_style* style) {
    return {asked.request, vorelcompose::SourceText(asked.text, asked.hasMarkup),
            [=] { return foundIn(style); }, *fonts.bench};
}

/// What of a step can be looked at: the effect is asked for of an effect alone.
bool isStep(const vorelcompose::PaintingSteps& steps, int32_t kind, int32_t look, int32_t effect) {
    const std::vector<vorelcompose::StackedPlan>& plans = steps.plans();
    const auto position = static_cast<size_t>(look);
    if (kind < VOREL_STEP_GLYPHS || kind > VOREL_STEP_FONT || look < 0 || position >= plans.size())
        return false;
    const bool isOfPlan =
        effect >= 0 && static_cast<size_t>(effect) < plans[position].look.effects.size();
    return kind != VOREL_STEP_EFFECT || isOfPlan;
}

voreltext::Image pictureOf(const Composition& composition, int32_t kind, size_t look, size_t effect) {
    switch (kind) {
        case VOREL_STEP_GLYPHS:
            return coveragePicture(composition, look);
        case VOREL_STEP_EFFECT:
            return effectPicture(composition, look, effect);
        case VOREL_STEP_FONT:
            return fontPicture(composition, look);
        default:
            return lookPicture(composition, look);
    }
}

}  // namespace

const char* vorel_text_error() {
    return lastError().c_str();
}

vorel_status vorel_fonts_new(vorel_fonts** fonts) {
    if (fonts == nullptr) return VOREL_BAD_ARGUMENT;
    *fonts = nullptr;
    return called([&] { *fonts = new vorel_fonts; });
}

void vorel_fonts_free(vorel_fonts* fonts) {
    delete fonts;
}

vorel_status vorel_fonts_add(vorel_fonts* fonts, const char* name, const uint8_t* data, size_t size,
                             int32_t index, vorel_answer** answer) {
    if (fonts == nullptr || name == nullptr || (data == nullptr && size != 0)) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] {
        if (index < 0) throw RequestError("index: no whole number from 0 on");
        const ByteFonts::Names names = fonts->source.add(name, {data, data + size}, index);
        JsonWriter json;
        json.beginObject().entry("name", names.name).entry("family", names.family).endObject();
        return vorel_answer{{json.text(), {}}};
    });
}

void vorel_fonts_remove(vorel_fonts* fonts, const char* name) {
    if (fonts == nullptr || name == nullptr) return;
    fonts->bench.emplace(fonts->source);  // the fonts that are open read the bytes
    fonts->source.remove(name);
}

vorel_status vorel_style_new(const char* json, size_t length, const char* name,
                             const vorel_named_pixels* images, size_t count, vorel_style** style) {
    if (json == nullptr || name == nullptr || !areWhole(images, count)) return VOREL_BAD_ARGUMENT;
    return made(style, [&] {
        if (length > vorelcompose::kMaxStyleBytes) {
            throw StyleError("a style of more than " + std::to_string(vorelcompose::kMaxStyleBytes) +
                             " bytes");
        }
        return styleOf(vorelstyle::parseStyle(viewOf(json, length), name), images, count);
    });
}

vorel_status vorel_style_of_looks(const char* json, size_t length, const vorel_named_pixels* images,
                                  size_t count, vorel_style** style) {
    if (json == nullptr || !areWhole(images, count)) return VOREL_BAD_ARGUMENT;
    return made(style, [&] { return styleOf(styleOfStates(viewOf(json, length)), images, count); });
}

void vorel_style_free(vorel_style* style) {
    delete style;
}

vorel_status vorel_style_facts(const vorel_style* style, int32_t size, float scale,
                               vorel_answer** answer) {
    if (style == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] { return vorel_answer{factsOf(*style, size, scale)}; });
}

vorel_status vorel_style_looks(const vorel_style* style, int32_t size, float scale,
                               vorel_answer** answer) {
    if (style == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] { return vorel_answer{looksOf(*style, size, scale)}; });
}

vorel_status vorel_style_cpp(const vorel_style* style, const char* request, size_t length,
                             vorel_answer** answer) {
    if (style == nullptr || request == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer,
                [&] { return vorel_answer{sourceOf(*style, sourceRequest(viewOf(request, length)))}; });
}

vorel_status vorel_text_picture(vorel_fonts* fonts, const char* request, size_t length,
                                const vorel_style* style, vorel_answer** answer) {
    if (fonts == nullptr || request == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] {
        const TextRequest asked = textRequest(viewOf(request, length));
        return vorel_answer{
            pictureAnswer(composed(*fonts, asked, style), asked.isPremultiplied, asked.background)};
    });
}

vorel_status vorel_text_layout(vorel_fonts* fonts, const char* request, size_t length,
                               vorel_answer** answer) {
    if (fonts == nullptr || request == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] {
        return vorel_answer{
            layoutAnswer(composed(*fonts, textRequest(viewOf(request, length)), nullptr))};
    });
}

vorel_status vorel_style_plan(const vorel_style* style, int32_t size, float scale,
                              vorel_answer** answer) {
    if (style == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] { return vorel_answer{planAnswer(layersOf(*style, size, scale))}; });
}

vorel_status vorel_steps_new(vorel_fonts* fonts, const char* request, size_t length,
                             const vorel_style* style, vorel_steps** steps) {
    if (fonts == nullptr || request == nullptr || steps == nullptr) return VOREL_BAD_ARGUMENT;
    *steps = nullptr;
    return called([&] {
        const TextRequest asked = textRequest(viewOf(request, length));
        *steps = new vorel_steps{fonts->source.held(), composed(*fonts, asked, style)};
    });
}

void vorel_steps_free(vorel_steps* steps) {
    delete steps;
}

vorel_status vorel_steps_plan(const vorel_steps* steps, vorel_answer** answer) {
    if (steps == nullptr) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] { return vorel_answer{planAnswer(steps->composition.looks())}; });
}

vorel_status vorel_steps_prepare(vorel_steps* steps, vorel_step* step) {
    if (steps == nullptr || step == nullptr) return VOREL_BAD_ARGUMENT;
    return called([&] {
        steps->isReady = steps->steps.prepare();
        const vorelcompose::PaintingStep& next = steps->steps.step();
        *step = {steps->isReady ? static_cast<int32_t>(next.look) : -1, static_cast<int32_t>(next.span),
                 static_cast<int32_t>(next.kind), static_cast<int32_t>(next.effect)};
    });
}

vorel_status vorel_steps_paint(vorel_steps* steps) {
    if (steps == nullptr || !steps->isReady) return VOREL_BAD_ARGUMENT;
    steps->isReady = false;
    return called([&] { steps->steps.paint(); });
}

vorel_status vorel_steps_picture(const vorel_steps* steps, int32_t kind, int32_t look, int32_t effect,
                                 vorel_answer** answer) {
    if (steps == nullptr || !isStep(steps->steps, kind, look, effect)) return VOREL_BAD_ARGUMENT;
    return made(answer, [&] {
        return vorel_answer{imageAnswer(pictureOf(steps->composition, kind, static_cast<size_t>(look),
                                                  static_cast<size_t>(effect)))};
    });
}

void vorel_answer_free(vorel_answer* answer) {
    delete answer;
}

const char* vorel_answer_text(const vorel_answer* answer) {
    return answer == nullptr ? nullptr : answer->answer.json.data();
}

size_t vorel_answer_length(const vorel_answer* answer) {
    return answer == nullptr ? 0 : answer->answer.json.size();
}

const uint8_t* vorel_answer_data(const vorel_answer* answer) {
    return answer == nullptr ? nullptr : answer->answer.bytes.data();
}

size_t vorel_answer_size(const vorel_answer* answer) {
    return answer == nullptr ? 0 : answer->answer.bytes.size();
}
